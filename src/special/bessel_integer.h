// Bessel functions of integer order n >= 0 and x >= 0.
#pragma once

namespace krnumer {

double BesselJ0(double x);
double BesselJ1(double x);
double BesselJn(double n, double x);

// For x > 0. -infinity where the value is beyond the largest double.
double BesselY0(double x);
double BesselY1(double x);
double BesselYn(double n, double x);

// J_n(x) / J_(n - 1)(x), for any real order.
double BesselRatio(double n, double x);

}  // namespace krnumer

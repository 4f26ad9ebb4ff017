// Modified Bessel functions.
#pragma once

#include <cstdint>

namespace krnumer {

double BesselI0(double x);
double BesselI1(double x);

// I_v(x) of real order.
double BesselI(double v, double x);

// K_n(x) of integer order.
double BesselK(int32_t n, double x);

}  // namespace krnumer

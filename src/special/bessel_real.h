// Bessel functions of real order.
#pragma once

#include <cstdint>

namespace krnumer {

double BesselJ(double v, double x);
double BesselY(double v, double x);

// Spherical: sqrt(pi / (2 x)) times J and Y of order n + 1/2.
double SphericalBesselJ(int32_t n, double x);
double SphericalBesselY(int32_t n, double x);

}  // namespace krnumer

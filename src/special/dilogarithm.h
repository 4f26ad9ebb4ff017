#pragma once

namespace krnumer {

// Li2(1 - x), the integral of ln(t) / (1 - t) from 1 to x, for x >= 0.
double Dilogarithm(double x);

}  // namespace krnumer

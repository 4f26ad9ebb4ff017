#pragma once

#include <cstdint>

namespace krnumer {

// The exponential integral E_n(x), the integral of e^(-x t) / t^n from 1 to infinity.
double ExponentialIntegral(int32_t n, double x);

}  // namespace krnumer

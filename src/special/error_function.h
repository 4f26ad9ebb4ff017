// The error function and its complement.
#pragma once

namespace krnumer {

double Erf(double x);

// 1 - erf(x), with full relative accuracy for positive x.
double ErfC(double x);

}  // namespace krnumer

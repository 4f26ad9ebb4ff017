// The hyperbolic sine integral, of sinh(t) / t from 0 to x, and cosine integral, gamma + ln|x| plus that of
// (cosh(t) - 1) / t.
#pragma once

namespace krnumer {

double Shi(double x);
double Chi(double x);

}  // namespace krnumer

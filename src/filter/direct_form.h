// Recursive filter in direct form: one difference equation of any order.
#pragma once

#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// a[0] y[i] = b[0] x[i] + ... + b[nb-1] x[i-nb+1] - a[1] y[i-1] - ... - a[na-1] y[i-na+1]
//
// forward_state holds the last nb - 1 inputs, reverse_state the last na - 1 outputs, the oldest first; both are read
// and brought up to date. Without `a` (null, or na < 1) there is no feedback, no divisor and no reverse_state. The sum
// of every sample runs from the oldest input to the newest, then from the oldest output to the newest. `y` may be `x`.
//
// Real coefficients do not mix the parts of a complex signal.
int32_t DirectFormFilter(const double* x, int32_t n, const double* a, int32_t na, const double* b, int32_t nb,
                         double* forward_state, double* reverse_state, double* y);
int32_t DirectFormFilter(const Complex* x, int32_t n, const double* a, int32_t na, const double* b, int32_t nb,
                         Complex* forward_state, Complex* reverse_state, Complex* y);
int32_t DirectFormFilter(const Complex* x, int32_t n, const Complex* a, int32_t na, const Complex* b, int32_t nb,
                         Complex* forward_state, Complex* reverse_state, Complex* y);
int32_t DirectFormFilter(const double* x, int32_t n, const Complex* a, int32_t na, const Complex* b, int32_t nb,
                         double* forward_state, Complex* reverse_state, Complex* y);

}  // namespace krnumer

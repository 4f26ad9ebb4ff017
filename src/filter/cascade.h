// Filter made of sections of second or fourth order.
#pragma once

#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// ns = (order + 1) / 2 sections of order m = na / ns, which is 2 or 4. Section k has the m feedback coefficients
// a[k m] ..., behind a leading 1 that is not stored, the m + 1 feedforward coefficients b[k (m + 1)] ... and a state of
// m values, the newest first.
template <class Signal>
struct Cascade {
    int32_t order;
    bool reset;  // clear the state first; cleared itself by doing so
    const double* a;
    int32_t na;
    const double* b;
    int32_t nb;
    Signal* state;
    int32_t state_size;
};

// Filters x in place, each section in direct form II:
//
//     t = v - (a[1] w[1] + ... + a[m] w[m]),  v' = b[0] t + (b[1] w[1] + ... + b[m] w[m]),  then t becomes w[1]
int32_t CascadeFilter(double* x, int32_t n, Cascade<double>* cascade);
int32_t CascadeFilter(Complex* x, int32_t n, Cascade<Complex>* cascade);

}  // namespace krnumer

// A least-squares problem as its orthogonal solvers take it.
#pragma once

#include <cstdint>

#include "frame/scratch.h"

namespace krnumer {

// The problem with every row multiplied by the root of its weight. It is a copy, for the solvers to use up.
//
// A long and narrow one is reduced to its triangle: R and Q'y take the place of h and y, k rows for m. With elements
// that cannot be used it stays whole, since each solver has its own way with them.
struct ScaledSystem {
    // h_in is m by k, m >= k >= 1; no weights where w is null. kOutOfMemory.
    int32_t Load(const double* h_in, int32_t m, int32_t k, const double* y_in, const double* w);

    int32_t rows = 0;
    Scratch<double> h;  // rows by k
    Scratch<double> y;

  private:
    int32_t Copy(const double* h_in, int32_t m, int32_t k, const double* y_in, const double* w);
    int32_t Reduce(const double* h_in, int32_t m, int32_t k, const double* y_in, const double* w, int32_t block);
};

}  // namespace krnumer

// Values of a polynomial.
#pragma once

#include <cstddef>
#include <cstdint>

#include "frame/status.h"

namespace krnumer {

// Replaces each of `count` values x by c[0] + c[1] x + ... + c[n-1] x^(n-1), summed from the low powers up with a
// running power: not Horner's rule, which meets infinities and underflow elsewhere. kEmptyInput where count or n is
// below 1.
inline int32_t EvaluatePowers(double* x, std::size_t count, const double* c, int32_t n) {
    if (count < 1 || n < 1) return kEmptyInput;
    for (std::size_t i = 0; i < count; ++i) {
        double value = c[0];
        double power = 1.0;
        for (int32_t k = 1; k < n; ++k) {
            power *= x[i];
            value += power * c[k];
        }
        x[i] = value;
    }
    return kOk;
}

}  // namespace krnumer

#pragma once

#include <cmath>

namespace krnumer {

// Of a double that holds an integer.
inline bool IsOdd(double integer) {
    const double half = 0.5 * integer;
    return half != std::floor(half);
}

}  // namespace krnumer

// Integers among the doubles, by conversion: std::floor is a call on processors that have no instruction for it.
#pragma once

#include <cmath>
#include <cstdint>

namespace krnumer {

// True for the infinities, false for NaN.
inline bool IsWhole(double x) {
    constexpr double kAllWhole = 4503599627370496.0;  // 2^52
    return std::abs(x) < kAllWhole ? x == static_cast<double>(static_cast<int64_t>(x)) : x == x;
}

// Of a double that holds an integer.
inline bool IsOdd(double integer) {
    constexpr double kAllEven = 9007199254740992.0;  // 2^53
    return std::abs(integer) < kAllEven && (static_cast<int64_t>(integer) & 1) != 0;
}

}  // namespace krnumer

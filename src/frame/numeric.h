// The numeric ground rules that every core shares: the constants of failure and the conversions whose result
// C++ leaves open for values that do not fit.
#pragma once

#include <bit>
#include <cstddef>
#include <cstdint>
#include <limits>

namespace krnumer {

// What every scalar output holds after a failure: the quiet NaN of positive sign and empty payload.
inline constexpr double kQuietNaN = std::bit_cast<double>(std::uint64_t{0x7FF8000000000000});
inline constexpr double kInfinity = std::numeric_limits<double>::infinity();

// Spacing of the doubles at 1, 2^-52: the unit of all relative tolerances.
inline constexpr double kEpsilon = 2.220446049250313e-16;

inline constexpr double kPi = 3.141592653589793;

// Truncates toward zero. NaN and whatever does not fit give INT32_MIN, as the conversion instruction of x86 does.
constexpr std::int32_t TruncateToInt32(double value) {
    constexpr double kLimit = 2147483648.0;
    return value > -kLimit - 1.0 && value < kLimit ? static_cast<std::int32_t>(value)
                                                   : std::numeric_limits<std::int32_t>::min();
}

// Truncates toward zero and saturates; NaN gives 0. For values that are limited to a range afterwards.
constexpr std::int32_t SaturateToInt32(double value) {
    if (value >= 2147483647.0) return std::numeric_limits<std::int32_t>::max();
    if (value <= -2147483648.0) return std::numeric_limits<std::int32_t>::min();
    return value == value ? static_cast<std::int32_t>(value) : 0;
}

// Integer arithmetic modulo 2^32, read as two's complement.
constexpr std::int32_t WrappingAdd(std::int32_t a, std::int32_t b) {
    return static_cast<std::int32_t>(static_cast<std::uint32_t>(a) + static_cast<std::uint32_t>(b));
}

constexpr std::int32_t WrappingMultiply(std::int32_t a, std::int32_t b) {
    return static_cast<std::int32_t>(static_cast<std::uint32_t>(a) * static_cast<std::uint32_t>(b));
}

// A count of elements out of an int32 that a malformed block may have made negative.
constexpr std::size_t Count(std::int32_t size) {
    return size > 0 ? static_cast<std::size_t>(size) : 0;
}

}  // namespace krnumer

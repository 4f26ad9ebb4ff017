// Comparing numbers: bit patterns, units in the last place, and matchers whose messages say how far off a value is.
#pragma once

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <bit>
#include <cstdint>
#include <initializer_list>
#include <iosfwd>
#include <string>
#include <vector>

#include "frame/complex.h"

namespace krnumer {

void PrintTo(Complex z, std::ostream* out);

// The one NaN of failed scalar outputs: positive, quiet, empty payload.
inline bool IsQuietNaN(double x) {
    return std::bit_cast<std::uint64_t>(x) == 0x7FF8000000000000;
}
inline bool IsQuietNaN(Complex z) {
    return IsQuietNaN(z.re) && IsQuietNaN(z.im);
}

// Equal to the last bit: tells 0 from -0, and one NaN from another.
inline bool SameBits(double a, double b) {
    return std::bit_cast<std::uint64_t>(a) == std::bit_cast<std::uint64_t>(b);
}
inline bool SameBits(Complex a, Complex b) {
    return SameBits(a.re, b.re) && SameBits(a.im, b.im);
}

// Doubles between a and b, counting b; 0 for equal values and for 0 and -0. The largest number if one is NaN.
std::uint64_t UlpDistance(double a, double b);

// |actual - expected| <= relative |expected| + absolute. NaN is near NaN, an infinity near itself; complex values
// are compared by modulus, or part by part when one of the expected parts is not finite.
bool IsNear(double actual, double expected, double relative, double absolute = 0.0);
bool IsNear(Complex actual, Complex expected, double relative, double absolute = 0.0);

// With all the digits that tell it from its neighbours.
std::string Show(double x);
std::string Show(Complex z);

// EXPECT_THAT(x, Near(2.0, 1e-15)), with a third argument for an absolute tolerance: as by IsNear.
MATCHER_P3(Near, expected, relative, absolute, "is near " + Show(expected)) {
    *result_listener << "which is " << Show(arg);
    return IsNear(arg, expected, relative, absolute);
}
template <class T>
auto Near(T expected, double relative) {
    return Near(expected, relative, 0.0);
}

// EXPECT_THAT(x, WithinUlps(2.0, 3))
MATCHER_P2(WithinUlps, expected, ulps,
           "is within " + ::testing::PrintToString(ulps) + " units in the last place of " + Show(expected)) {
    const std::uint64_t distance = UlpDistance(arg, expected);
    *result_listener << "which is " << Show(arg) << ", off by " << distance;
    return distance <= static_cast<std::uint64_t>(ulps);
}

// EXPECT_THAT(x, QuietNaN())
MATCHER(QuietNaN, "is the quiet NaN 0x7FF8000000000000") {
    return IsQuietNaN(arg);
}

// EXPECT_THAT(y.values(), AllNear(expected, 1e-14)), or with a list in braces: every element as by Near. The message
// names the first element that is not, instead of listing them all.
MATCHER_P3(AllNear, expected, relative, absolute, "is near, element by element, to what is expected") {
    if (arg.size() != expected.size()) {
        *result_listener << "which has " << arg.size() << " elements instead of " << expected.size();
        return false;
    }
    for (std::size_t i = 0; i < arg.size(); ++i) {
        if (!IsNear(arg[i], expected[i], relative, absolute)) {
            *result_listener << "whose element " << i << " is " << Show(arg[i]) << " instead of " << Show(expected[i]);
            return false;
        }
    }
    return true;
}
template <class T>
auto AllNear(const std::vector<T>& expected, double relative) {
    return AllNear(expected, relative, 0.0);
}
template <class T>
auto AllNear(std::initializer_list<T> expected, double relative, double absolute = 0.0) {
    return AllNear(std::vector<T>(expected), relative, absolute);
}

// EXPECT_THAT(y.values(), SameBitsAs(expected)): equal to the last bit, NaNs and signs of zeros included.
MATCHER_P(SameBitsAs, expected, "is equal, bit by bit, to what is expected") {
    if (arg.size() != expected.size()) {
        *result_listener << "which has " << arg.size() << " elements instead of " << expected.size();
        return false;
    }
    for (std::size_t i = 0; i < arg.size(); ++i) {
        if (!SameBits(arg[i], expected[i])) {
            *result_listener << "whose element " << i << " is " << Show(arg[i]) << " instead of " << Show(expected[i]);
            return false;
        }
    }
    return true;
}

}  // namespace krnumer

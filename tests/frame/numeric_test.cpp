#include "frame/numeric.h"

#include <gtest/gtest.h>

#include "support/numbers.h"

namespace krnumer {
namespace {

constexpr int32_t kLeast = INT32_MIN;
constexpr int32_t kMost = INT32_MAX;

TEST(TruncateToInt32, DropsTheFraction) {
    EXPECT_EQ(TruncateToInt32(2.9), 2);
    EXPECT_EQ(TruncateToInt32(-2.9), -2);
    EXPECT_EQ(TruncateToInt32(-0.5), 0);
}

TEST(TruncateToInt32, KeepsTheEndsOfTheRange) {
    EXPECT_EQ(TruncateToInt32(2147483647.9), kMost);
    EXPECT_EQ(TruncateToInt32(-2147483648.0), kLeast);
    EXPECT_EQ(TruncateToInt32(-2147483648.9), kLeast);
}

TEST(TruncateToInt32, GivesTheLeastForWhatDoesNotFit) {
    for (const double value : {2147483648.0, -2147483649.0, 1e300, -1e300, kInfinity, -kInfinity, kQuietNaN})
        EXPECT_EQ(TruncateToInt32(value), kLeast) << value;
}

TEST(SaturateToInt32, KeepsTheNearestEnd) {
    EXPECT_EQ(SaturateToInt32(1e300), kMost);
    EXPECT_EQ(SaturateToInt32(kInfinity), kMost);
    EXPECT_EQ(SaturateToInt32(-1e300), kLeast);
    EXPECT_EQ(SaturateToInt32(-kInfinity), kLeast);
    EXPECT_EQ(SaturateToInt32(2147483646.5), 2147483646);
    EXPECT_EQ(SaturateToInt32(-7.9), -7);
}

TEST(SaturateToInt32, TakesNaNAsNothing) {
    EXPECT_EQ(SaturateToInt32(kQuietNaN), 0);
}

TEST(WrappingArithmetic, IsModulo2To32) {
    EXPECT_EQ(WrappingAdd(kMost, 1), kLeast);
    EXPECT_EQ(WrappingAdd(kLeast, -1), kMost);
    EXPECT_EQ(WrappingMultiply(65536, 65536), 0);
    EXPECT_EQ(WrappingMultiply(46341, 46341), -2147479015);
    EXPECT_EQ(WrappingMultiply(-3, 5), -15);
}

TEST(QuietNaN, HasThePositiveEmptyPattern) {
    EXPECT_EQ(std::bit_cast<uint64_t>(kQuietNaN), 0x7FF8000000000000u);
    EXPECT_TRUE(IsQuietNaN(kQuietNaN));
}

}  // namespace
}  // namespace krnumer

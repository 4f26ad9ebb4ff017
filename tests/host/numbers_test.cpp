// The comparisons that all other tests rest on.

#include "support/numbers.h"

#include <gtest/gtest-spi.h>

#include <cmath>
#include <limits>

namespace krnumer {
namespace {

using ::testing::Not;

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
constexpr double kInfinity = std::numeric_limits<double>::infinity();

TEST(UlpDistance, CountsDoublesInBetween) {
    EXPECT_EQ(UlpDistance(1.0, 1.0), 0U);
    EXPECT_EQ(UlpDistance(1.0, std::nextafter(1.0, 2.0)), 1U);
    EXPECT_EQ(UlpDistance(std::nextafter(-1.0, 0.0), -1.0), 1U);
    EXPECT_EQ(UlpDistance(0.0, -0.0), 0U);
    EXPECT_EQ(UlpDistance(5e-324, -5e-324), 2U);
    EXPECT_EQ(UlpDistance(1.0, 2.0), uint64_t{1} << 52);
    EXPECT_EQ(UlpDistance(kNaN, kNaN), UINT64_MAX);
    EXPECT_EQ(UlpDistance(-kInfinity, kInfinity), 0xFFE0000000000000);
}

TEST(IsQuietNaN, AcceptsOneBitPatternOnly) {
    EXPECT_TRUE(IsQuietNaN(std::bit_cast<double>(uint64_t{0x7FF8000000000000})));
    EXPECT_FALSE(IsQuietNaN(std::bit_cast<double>(uint64_t{0xFFF8000000000000})));
    EXPECT_FALSE(IsQuietNaN(std::bit_cast<double>(uint64_t{0x7FF8000000000001})));
    EXPECT_FALSE(IsQuietNaN(1.0));
    EXPECT_FALSE(IsQuietNaN(Complex{kNaN, 1.0}));
    EXPECT_TRUE(IsQuietNaN(Complex{kNaN, kNaN}));
}

TEST(Near, BoundsTheError) {
    EXPECT_THAT(100.0, Near(101.0, 0.01));
    EXPECT_THAT(100.0, Not(Near(102.0, 0.01)));
    EXPECT_THAT(0.001, Near(0.0, 0.0, 0.001));
    EXPECT_THAT(0.001, Not(Near(0.0, 1.0)));
    EXPECT_THAT((Complex{3.0, 4.0}), Near(Complex{3.0, 4.05}, 0.01));
    EXPECT_THAT((Complex{3.0, 4.0}), Not(Near(Complex{3.0, 4.1}, 0.01)));
}

TEST(Near, KeepsNaNAndInfinityApart) {
    EXPECT_THAT(kNaN, Near(kNaN, 0.0));
    EXPECT_THAT(1.0, Not(Near(kNaN, 1.0)));
    EXPECT_THAT(kNaN, Not(Near(1.0, 1.0)));
    EXPECT_THAT(kInfinity, Near(kInfinity, 0.0));
    EXPECT_THAT(-kInfinity, Not(Near(kInfinity, 1.0)));
    EXPECT_THAT(kInfinity, Not(Near(1.0, 1.0)));
    EXPECT_THAT((Complex{kNaN, 1.0}), Near(Complex{kNaN, 1.0}, 1e-15));
    EXPECT_THAT((Complex{kNaN, 2.0}), Not(Near(Complex{kNaN, 1.0}, 1e-15)));
}

TEST(AllNear, ComparesLengthAndEveryElement) {
    const std::vector<double> values{1.0, 2.0, 3.0};
    EXPECT_THAT(values, AllNear({1.0, 2.0, 3.0}, 0.0));
    EXPECT_THAT(values, AllNear(std::vector<double>{1.0, 2.0, 3.01}, 0.01));
    EXPECT_THAT(values, Not(AllNear({1.0, 2.0}, 1.0)));
    EXPECT_NONFATAL_FAILURE(EXPECT_THAT((std::vector<double>{1.0, 2.0}), AllNear({1.0, 2.1}, 1e-3)),
                            "whose element 1 is 2 instead of 2.1");
}

TEST(SameBitsAs, TellsZerosAndNaNsApart) {
    EXPECT_THAT((std::vector<double>{0.0, kNaN}), SameBitsAs(std::vector<double>{0.0, kNaN}));
    EXPECT_THAT((std::vector<double>{0.0}), Not(SameBitsAs(std::vector<double>{-0.0})));
    EXPECT_THAT((std::vector<double>{kNaN}), Not(SameBitsAs(std::vector<double>{-kNaN})));
    EXPECT_THAT((std::vector<double>{1.0}), Not(SameBitsAs(std::vector<double>{})));
}

TEST(WithinUlps, BoundsTheDistance) {
    EXPECT_THAT(std::nextafter(1.0, 2.0), WithinUlps(1.0, 1));
    EXPECT_THAT(1.0 + 4 * std::numeric_limits<double>::epsilon(), Not(WithinUlps(1.0, 3)));
}

}  // namespace
}  // namespace krnumer

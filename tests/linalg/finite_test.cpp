#include "linalg/finite.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <vector>

#include "frame/numeric.h"

namespace krnumer {
namespace {

constexpr double kLargest = std::numeric_limits<double>::max();
constexpr double kLowerBound = -1.7976931348623e308;

TEST(CheckFiniteArray, RejectsWhatIsNoNumber) {
    for (const double bad : {kQuietNaN, -kQuietNaN, kInfinity, -kInfinity, kLargest, -kLargest, kLowerBound})
        EXPECT_EQ(CheckFiniteArray(&bad, 1), 1) << bad;
}

TEST(CheckFiniteArray, AcceptsEverythingBetweenItsLopsidedBounds) {
    for (const double good : {std::nextafter(kLargest, 0.0), std::nextafter(kLowerBound, 0.0), 0.0, -0.0, 5e-324})
        EXPECT_EQ(CheckFiniteArray(&good, 1), 0) << good;
    EXPECT_EQ(CheckFiniteArray(nullptr, 0), 0);
}

TEST(CheckFiniteArray, SeesEveryPlace) {
    for (const std::size_t count : {1u, 2u, 7u, 511u, 512u, 513u, 1100u}) {
        std::vector<double> a(count, 1.0);
        ASSERT_EQ(CheckFiniteArray(a.data(), count), 0);
        for (std::size_t i = 0; i < count; ++i) {
            a[i] = kQuietNaN;
            ASSERT_EQ(CheckFiniteArray(a.data(), count), 1) << i << " of " << count;
            ASSERT_EQ(CheckFiniteArray(a.data(), i), 0);
            a[i] = 1.0;
        }
    }
}

TEST(CheckFiniteCxArray, LooksAtBothParts) {
    std::vector<Complex> a(5, Complex{1.0, -1.0});
    EXPECT_EQ(CheckFiniteCxArray(a.data(), a.size()), 0);
    a[4] = {0.0, kInfinity};
    EXPECT_EQ(CheckFiniteCxArray(a.data(), a.size()), 1);
    EXPECT_EQ(CheckFiniteCxArray(a.data(), 4), 0);
    a[4] = {kQuietNaN, 0.0};
    EXPECT_EQ(CheckFiniteCxArray(a.data(), a.size()), 1);
}

}  // namespace
}  // namespace krnumer

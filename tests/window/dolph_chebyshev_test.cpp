#include "window/dolph_chebyshev.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <vector>

#include "frame/numeric.h"
#include "support/numbers.h"
#include "window/kernels.h"

namespace krnumer {
namespace {

using ::testing::ElementsAre;

std::vector<double> DolphChebyshev(int32_t n, double ratio, bool symmetric) {
    return Weights([=](double* x, int32_t count) { return DolphChebyshevWindow(x, count, ratio, symmetric); }, n);
}

TEST(DolphChebyshevWindow, IsSymmetricOrDropsTheLastWeightOfALongerOne) {
    for (const int32_t n : {2, 3, 4, 5, 16, 33, 100}) {
        const std::vector<double> w = DolphChebyshev(n, 100.0, true), longer = DolphChebyshev(n + 1, 100.0, true);
        EXPECT_TRUE(std::equal(w.begin(), w.end(), w.rbegin()));
        EXPECT_EQ(DolphChebyshev(n, 100.0, false), std::vector<double>(longer.begin(), longer.end() - 1));
    }
}

TEST(DolphChebyshevWindow, DividesByItsGreatestWeight) {
    for (const int32_t n : {2, 3, 8, 33}) {
        const std::vector<double> w = DolphChebyshev(n, 1000.0, true);
        EXPECT_EQ(*std::max_element(w.begin(), w.end()), 1.0);
    }
    // In a wide window the ends rise above the middle.
    const std::vector<double> wide = DolphChebyshev(32, 1.5, true);
    EXPECT_EQ(wide.front(), 1.0);
    EXPECT_LT(wide[16], 0.5);
}

TEST(DolphChebyshevWindow, HoldsItsSideLobesAtTheRatio) {
    const std::vector<double> w = DolphChebyshev(64, 1000.0, true);
    double main_lobe = 0.0, side_lobe = 0.0;
    for (const double weight : w) main_lobe += weight;
    for (int32_t f = 300; f <= 3200; ++f) {  // beyond the first zero, up to half the sampling frequency
        double re = 0.0, im = 0.0;
        for (std::size_t i = 0; i < w.size(); ++i) {
            const double angle = 2.0 * kPi * f * static_cast<double>(i) / 6400.0;
            re += w[i] * std::cos(angle);
            im += w[i] * std::sin(angle);
        }
        side_lobe = std::max(side_lobe, std::hypot(re, im));
    }
    EXPECT_THAT(main_lobe / side_lobe, Near(1000.0, 1e-5));
}

TEST(DolphChebyshevWindow, OfTwoSamples) {
    EXPECT_THAT(DolphChebyshev(2, 50.0, true), ElementsAre(1.0, 1.0));
    // Length 3: T_2(x0) = ratio, weights 1 : 2 (ratio - 1) / (ratio + 1) : 1 by their transform.
    const double x0 = std::cosh(std::acosh(50.0) / 2.0);
    EXPECT_THAT(DolphChebyshev(2, 50.0, false)[0], Near(x0 * x0 / (2.0 * (x0 * x0 - 1.0)), 1e-14));
    EXPECT_EQ(DolphChebyshev(2, 50.0, false)[1], 1.0);
}

TEST(DolphChebyshevWindow, TakesOneForARatioBelow) {
    for (const bool symmetric : {false, true}) {
        const std::vector<double> expected = DolphChebyshev(9, 1.0, symmetric);
        for (const double ratio : {0.5, 0.0, -3.0, -kInfinity, kQuietNaN})
            EXPECT_EQ(DolphChebyshev(9, ratio, symmetric), expected) << ratio;
    }
}

TEST(DolphChebyshevWindow, OverflowsBeyondTheRootOfTheLargestNumber) {
    for (const bool symmetric : {false, true}) {
        for (const int32_t n : {3, 4, 20}) {
            for (const double weight : DolphChebyshev(n, 1.3e154, symmetric)) EXPECT_TRUE(std::isfinite(weight));
            for (const double ratio : {1.4e154, 1e300, kInfinity})
                for (const double weight : DolphChebyshev(n, ratio, symmetric))
                    EXPECT_TRUE(std::isnan(weight)) << ratio;
        }
    }
}

}  // namespace
}  // namespace krnumer

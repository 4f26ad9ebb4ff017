#include "window/shaped.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <vector>

#include "frame/numeric.h"
#include "frame/status.h"
#include "support/numbers.h"
#include "window/cosine_sum.h"
#include "window/kernels.h"
#include "window/type.h"

namespace krnumer {
namespace {

using ::testing::Each;
using ::testing::ElementsAre;

std::vector<double> Tapered(int32_t n, double fraction) {
    return Weights([=](double* x, int32_t count) { return CosineTaper(x, count, fraction); }, n);
}

std::vector<double> Kaiser(int32_t n, double beta) {
    return Weights([=](double* x, int32_t count) { return KaiserWindow(x, count, beta); }, n);
}

std::vector<double> Gaussian(int32_t n, double sigma, bool symmetric) {
    return Weights([=](double* x, int32_t count) { return GaussianWindow(x, count, sigma, symmetric); }, n);
}

TEST(TriangleWindow, Rises) {
    const auto triangle = [](double* x, int32_t n) { return TriangleWindow(x, n); };
    EXPECT_THAT(Weights(triangle, 1), ElementsAre(0.0));
    EXPECT_THAT(Weights(triangle, 2), ElementsAre(0.0, 1.0));
    EXPECT_THAT(Weights(triangle, 3), ElementsAre(0.0, 2.0 / 3.0, 2.0 / 3.0));
    EXPECT_THAT(Weights(triangle, 4), ElementsAre(0.0, 0.5, 1.0, 0.5));
}

TEST(TriangleWindow, SetsItsFirstSample) {
    std::vector<double> x = {kQuietNaN, -1.0};
    EXPECT_EQ(TriangleWindow(x.data(), 2), 0);
    EXPECT_TRUE(SameBits(x[0], 0.0));
    std::vector<Complex> z = {{kInfinity, kQuietNaN}};
    EXPECT_EQ(TriangleWindow(z.data(), 1), 0);
    EXPECT_TRUE(SameBits(z[0], Complex{0.0, 0.0}));
}

TEST(CosineTaper, RoundsOffBothEnds) {
    const std::vector<double> w = Tapered(20, 0.4);  // 4 samples at each end
    EXPECT_EQ(w[0], 0.0);
    for (std::size_t i = 1; i < 4; ++i)
        EXPECT_NEAR(w[i], std::pow(std::sin(static_cast<double>(i) * kPi / 8), 2), 1e-15);
    for (std::size_t i = 4; i < 16; ++i) EXPECT_EQ(w[i], 1.0);
    for (std::size_t i = 0; i < 20; ++i) EXPECT_EQ(w[i], w[19 - i]);
}

TEST(CosineTaper, SetsItsEnds) {
    std::vector<double> x(20, kQuietNaN);
    EXPECT_EQ(CosineTaper(x.data(), 20, 0.2), 0);
    EXPECT_TRUE(SameBits(x.front(), 0.0));
    EXPECT_TRUE(SameBits(x.back(), 0.0));
    EXPECT_TRUE(std::isnan(x[1]));
}

TEST(CosineTaper, NeedsASampleToTaper) {
    EXPECT_THAT(Tapered(9, 0.2), Each(1.0));  // 0.9 samples
    EXPECT_EQ(Tapered(10, 0.2)[0], 0.0);      // 1
    EXPECT_THAT(Tapered(100, 0.0), Each(1.0));
    EXPECT_THAT(Tapered(100, -kInfinity), Each(1.0));
    EXPECT_THAT(Tapered(100, kQuietNaN), Each(1.0));
    EXPECT_THAT(Tapered(100, 5e-324), Each(1.0));
}

TEST(CosineTaper, IsThePeriodicHannWindowFromOneOn) {
    for (const int32_t n : {2, 3, 8, 99}) {
        const std::vector<double> hann =
            Weights([](double* x, int32_t count) { return NamedCosineWindow(x, count, kWindowHann, false); }, n);
        for (const double fraction : {1.0, 1.5, kInfinity}) EXPECT_EQ(Tapered(n, fraction), hann);
    }
    const std::vector<double> w = Tapered(8, std::nextafter(1.0, 0.0));  // still symmetric, of 3 samples at each end
    EXPECT_EQ(w[7], 0.0);
    EXPECT_EQ(w[3], 1.0);
}

TEST(CosineTaper, AddsUpTheAnglesOfRealSamplesOnly) {
    constexpr int32_t n = 4000, m = 2000 / 2;
    std::vector<double> x(n, 1.0);
    std::vector<Complex> z(n, {1.0, -1.0});
    ASSERT_EQ(CosineTaper(x.data(), n, 0.5), 0);
    ASSERT_EQ(CosineTaper(z.data(), n, 0.5), 0);
    double angle = 0.0;
    for (int32_t i = 1; i < m; ++i) {
        angle += kPi / (2.0 * m);
        const double real = std::sin(angle), complex = std::sin(i * kPi / (2.0 * m));
        const std::size_t at = static_cast<std::size_t>(i);
        ASSERT_TRUE(SameBits(x[at], real * real)) << i;
        ASSERT_TRUE(SameBits(z[at], Complex{complex * complex, -(complex * complex)})) << i;
    }
}

TEST(ExponentialWindow, EndsAtItsFinalValue) {
    for (const int32_t n : {2, 3, 100, 10000}) {
        for (const double final_value : {1e-300, 0.01, 0.5, 2.0, 1e100}) {
            const std::vector<double> w =
                Weights([=](double* x, int32_t count) { return ExponentialWindow(x, count, final_value); }, n);
            EXPECT_EQ(w.front(), 1.0);
            EXPECT_THAT(w.back(), Near(final_value, 1e-9));  // its exponent is a running sum
        }
    }
}

TEST(ExponentialWindow, OfFinalValueOneLeavesTheSamples) {
    EXPECT_THAT(Weights([](double* x, int32_t n) { return ExponentialWindow(x, n, 1.0); }, 50), Each(1.0));
}

TEST(ExponentialWindow, NeedsTwoSamplesAndThenAPositiveValue) {
    std::vector<double> x = {1.0, 1.0};
    EXPECT_EQ(ExponentialWindow(x.data(), 0, 0.0), kFewerThanTwo);
    EXPECT_EQ(ExponentialWindow(x.data(), 1, 0.0), kFewerThanTwo);
    for (const double bad : {0.0, -0.0, -1.0, -kInfinity, kQuietNaN})
        EXPECT_EQ(ExponentialWindow(x.data(), 2, bad), kBadFinalValue) << bad;
    EXPECT_EQ(ExponentialWindow(x.data(), 2, 5e-324), 0);
}

TEST(ForceWindow, KeepsItsShareOfTheSamples) {
    const auto kept = [](int32_t n, double duty) {
        const std::vector<double> w = Weights([=](double* x, int32_t count) { return ForceWindow(x, count, duty); }, n);
        const auto first_zero = std::find(w.begin(), w.end(), 0.0);
        EXPECT_EQ(std::count(w.begin(), first_zero, 1.0) + std::count(first_zero, w.end(), 0.0), n);
        return first_zero - w.begin();
    };
    EXPECT_EQ(kept(4, 50.0), 2);
    EXPECT_EQ(kept(10, 39.9), 3);
    for (const double all : {100.0, 150.0, 1e300, kInfinity}) EXPECT_EQ(kept(4, all), 4) << all;
    for (const double none : {0.0, -1.0, -1e300, -kInfinity, kQuietNaN}) EXPECT_EQ(kept(4, none), 0) << none;
    EXPECT_EQ(kept(100, 29.0), 28);  // 29 * 0.01 is a little less than 0.29
}

TEST(ForceWindow, SetsTheOthersToZero) {
    std::vector<double> x = {kQuietNaN, kQuietNaN};
    EXPECT_EQ(ForceWindow(x.data(), 2, 50.0), 0);
    EXPECT_TRUE(IsQuietNaN(x[0]));
    EXPECT_TRUE(SameBits(x[1], 0.0));
    std::vector<Complex> z = {{1.0, 2.0}, {kInfinity, -1.0}};
    EXPECT_EQ(ForceWindow(z.data(), 2, 50.0), 0);
    EXPECT_THAT(z, ElementsAre(Complex{1.0, 2.0}, Complex{0.0, 0.0}));
    EXPECT_FALSE(std::signbit(z[1].im));
}

TEST(ForceWindow, NeedsTwoSamples) {
    double x = 1.0;
    EXPECT_EQ(ForceWindow(&x, 1, 50.0), kFewerThanTwo);
    EXPECT_EQ(ForceWindow(&x, 0, 50.0), kFewerThanTwo);
    EXPECT_EQ(x, 1.0);
}

TEST(KaiserWindow, OfBetaZeroLeavesTheSamples) {
    for (const int32_t n : {1, 2, 5, 16}) EXPECT_THAT(Kaiser(n, 0.0), Each(1.0));
}

TEST(KaiserWindow, DividesOneSampleByItsPeak) {
    EXPECT_THAT(Kaiser(1, 2.0)[0], Near(1.0 / std::cyl_bessel_i(0.0, 2.0), 1e-8));
}

TEST(KaiserWindow, LeavesTheMiddleOfAnEvenLength) {
    std::vector<double> x(6, 1.0);
    x[3] = -0.0;
    EXPECT_EQ(KaiserWindow(x.data(), 6, kQuietNaN), 0);
    EXPECT_TRUE(SameBits(x[3], -0.0));
    for (std::size_t i = 0; i < 6; ++i) EXPECT_EQ(std::isnan(x[i]), i != 3) << i;
}

TEST(KaiserWindow, EndsItsSeriesAfter25Terms) {
    // Up to beta = 10 or so the window is Kaiser's; at 40 it is 4 percent off somewhere, at 60 a factor.
    const auto worst = [](double beta) {
        const std::vector<double> w = Kaiser(40, beta);
        double most = 0.0;
        for (std::size_t i = 0; i < w.size(); ++i) {
            const double u = 1.0 - static_cast<double>(i) / 20.0;
            const double full = std::cyl_bessel_i(0.0, beta * std::sqrt(1.0 - u * u)) / std::cyl_bessel_i(0.0, beta);
            most = std::max(most, std::fabs(w[i] / full - 1.0));
        }
        return most;
    };
    EXPECT_LT(worst(10.0), 1e-8);
    EXPECT_GT(worst(40.0), 0.02);
    EXPECT_LT(worst(40.0), 0.06);
    EXPECT_GT(worst(60.0), 1.0);
}

TEST(KaiserWindow, EndsItsSeriesAtAnAbsoluteChange) {
    // I0(0.0001): the term 2.5e-9 counts and ends the series. I0(0.02): 2.5e-9 ends it again and leaves off 2.8e-14.
    const auto peak = [](double beta) { return 1.0 / Kaiser(1, beta)[0]; };
    EXPECT_NEAR(peak(1e-4), 1.0 + 2.5e-9, 1e-15);
    EXPECT_NEAR(peak(0.02), 1.0 + 1e-4 + 2.5e-9, 3e-16);
}

TEST(GaussianWindow, MeasuresSigmaByNPlusOneWhenPeriodic) {
    for (const int32_t n : {2, 3, 10, 11}) {
        const std::vector<double> symmetric = Gaussian(n, 0.3, true), periodic = Gaussian(n, 0.3, false);
        for (int32_t i = 0; i < n; ++i) {
            const double d = i - (n - 1) / 2.0, e = i - n / 2.0;
            EXPECT_NEAR(symmetric[static_cast<std::size_t>(i)], std::exp(-d * d / (2 * 0.09 * n * n)), 1e-15);
            EXPECT_NEAR(periodic[static_cast<std::size_t>(i)], std::exp(-e * e / (2 * 0.09 * (n + 1) * (n + 1))),
                        1e-15);
        }
    }
}

TEST(GaussianWindow, TakesOneFifthForASigmaThatIsNotPositive) {
    for (const bool symmetric : {false, true}) {
        const std::vector<double> expected = Gaussian(9, 0.2, symmetric);
        for (const double sigma : {0.0, -0.0, -3.0, -kInfinity, kQuietNaN})
            EXPECT_EQ(Gaussian(9, sigma, symmetric), expected) << sigma;
        EXPECT_THAT(Gaussian(9, kInfinity, symmetric), Each(1.0));
    }
}

TEST(GaussianWindow, PeaksAtOneHoweverNarrow) {
    EXPECT_THAT(Gaussian(5, 1e-300, true), ElementsAre(0.0, 0.0, 1.0, 0.0, 0.0));
    EXPECT_THAT(Gaussian(4, 1e-300, false), ElementsAre(0.0, 0.0, 1.0, 0.0));
}

}  // namespace
}  // namespace krnumer

#include "window/cosine_sum.h"

#include <gtest/gtest.h>

#include <cmath>
#include <cstddef>
#include <vector>

#include "frame/numeric.h"
#include "frame/status.h"
#include "support/numbers.h"
#include "window/kernels.h"
#include "window/type.h"

namespace krnumer {
namespace {

using ::testing::ElementsAre;

std::vector<double> CosineWeights(int32_t n, const std::vector<double>& a, bool scaled) {
    return Weights(
        [&](double* x, int32_t count) {
            return CosineSumWindow(x, count, a.data(), static_cast<int32_t>(a.size()), scaled);
        },
        n);
}

std::vector<double> NamedWeights(int32_t n, int32_t type, bool scaled) {
    return Weights([&](double* x, int32_t count) { return NamedCosineWindow(x, count, type, scaled); }, n);
}

// The recurrence, one term and one sample after the other.
std::vector<double> PlainRecurrence(int32_t n, std::vector<double> c, bool scaled) {
    const std::size_t m = c.size();
    const double divisor = scaled ? c[0] : 1.0;
    std::vector<double> s(m, 0.0), alpha(m), beta(m), w(static_cast<std::size_t>(n));
    for (std::size_t k = 0; k < m; ++k) {
        c[k] = (k % 2 == 0 ? c[k] : -c[k]) / divisor;
        alpha[k] = 2.0 * std::pow(std::sin(static_cast<double>(k) * kPi / n), 2);
        beta[k] = std::sin(2.0 * static_cast<double>(k) * kPi / n);
    }
    for (std::size_t i = 0; i <= w.size() / 2; ++i) {
        double sum = c[0];
        for (std::size_t k = 1; k < m; ++k) sum += c[k];
        w[i] = sum;
        if (i > 0) w[w.size() - i] = sum;
        for (std::size_t k = 1; k < m; ++k) {
            const double old = c[k];
            c[k] = old - (old * alpha[k] + s[k] * beta[k]);
            s[k] = s[k] - (s[k] * alpha[k] - old * beta[k]);
        }
    }
    return w;
}

TEST(CosineSumWindow, IsTheRecurrenceToTheBitHoweverItIsArranged) {
    for (int32_t m = 1; m <= 20; ++m) {
        const std::vector<double> a = Samples(m, static_cast<uint32_t>(m));
        for (const int32_t n : {2, 3, 4, 5, 8, 31, 32, 33, 34, 35, 63, 64, 65, 66, 67, 100, 1009, 4096}) {
            for (const bool scaled : {false, true}) {
                const std::vector<double> w = CosineWeights(n, a, scaled), expected = PlainRecurrence(n, a, scaled);
                for (std::size_t i = 0; i < w.size(); ++i)
                    ASSERT_TRUE(SameBits(w[i], expected[i])) << m << " terms, " << i << " of " << n;
            }
        }
    }
}

TEST(CosineSumWindow, StaysAccurateOverAMillionSamples) {
    constexpr int32_t n = 1000000;
    const std::vector<double> w = NamedWeights(n, kWindowBlackmanHarris7, false);
    const std::span<const double> a = WinCosTerms(kWindowBlackmanHarris7);
    for (int32_t i = 0; i < n; i += 997) {
        double expected = 0.0;
        for (std::size_t k = 0; k < a.size(); ++k)
            expected += (k % 2 == 0 ? a[k] : -a[k]) * std::cos(2.0 * kPi * static_cast<double>(k) * i / n);
        ASSERT_NEAR(w[static_cast<std::size_t>(i)], expected, 1e-11) << i;
    }
}

TEST(CosineSumWindow, Hann) {
    EXPECT_THAT(NamedWeights(4, kWindowHann, false), AllNear(std::vector{0.0, 0.5, 1.0, 0.5}, 0.0, 5e-16));
    EXPECT_THAT(NamedWeights(4, kWindowHann, true), AllNear(std::vector{0.0, 1.0, 2.0, 1.0}, 0.0, 5e-16));
    EXPECT_THAT(NamedWeights(2, kWindowHann, false), ElementsAre(0.0, 1.0));
}

TEST(CosineSumWindow, DividesByItsFirstCoefficientWhenScaled) {
    for (const int32_t type : {1, 2, 3, 4, 5, 6, 7, 8, 9, 11}) {
        const std::vector<double> plain = NamedWeights(40, type, false), scaled = NamedWeights(40, type, true);
        const double first = WinCosTerms(type)[0];
        for (std::size_t i = 0; i < plain.size(); ++i) EXPECT_NEAR(scaled[i] * first, plain[i], 1e-15) << type;
    }
}

TEST(CosineSumWindow, OneTermIsAConstant) {
    EXPECT_THAT(CosineWeights(5, {0.25}, false), ElementsAre(0.25, 0.25, 0.25, 0.25, 0.25));
    EXPECT_THAT(CosineWeights(4, {0.25}, true), ElementsAre(1.0, 1.0, 1.0, 1.0));
}

TEST(CosineSumWindow, TheRectangleTouchesNothing) {
    std::vector<double> x = {kQuietNaN, kInfinity, -0.0};
    EXPECT_EQ(NamedCosineWindow(x.data(), 3, kWindowRectangle, true), 0);
    EXPECT_TRUE(IsQuietNaN(x[0]));
    EXPECT_EQ(x[1], kInfinity);
    EXPECT_TRUE(SameBits(x[2], -0.0));
}

TEST(CosineSumWindow, MultipliesByAWeightOfZero) {
    std::vector<double> x = {kInfinity, 1.0, 1.0, 1.0};
    EXPECT_EQ(NamedCosineWindow(x.data(), 4, kWindowHann, false), 0);
    EXPECT_TRUE(std::isnan(x[0]));
    std::vector<Complex> z = {{-1.0, kInfinity}, {1.0, 1.0}};
    EXPECT_EQ(NamedCosineWindow(z.data(), 2, kWindowHann, false), 0);
    EXPECT_TRUE(SameBits(z[0].re, -0.0));
    EXPECT_TRUE(std::isnan(z[0].im));
}

TEST(CosineSumWindow, TakesCoefficientsOutOfTheSamplesThemselves) {
    std::vector<double> x = {0.5, 0.25, 0.125, 3.0};
    const std::vector<double> a(x.begin(), x.begin() + 3), w = CosineWeights(4, a, true), before = x;
    EXPECT_EQ(CosineSumWindow(x.data(), 4, x.data(), 3, true), 0);
    for (std::size_t i = 0; i < x.size(); ++i) EXPECT_EQ(x[i], before[i] * w[i]);
}

TEST(CosineSumWindow, ChecksSamplesBeforeCoefficients) {
    double x = 3.0;
    EXPECT_EQ(CosineSumWindow(&x, 0, &x, 0, false), kEmptyInput);
    EXPECT_EQ(CosineSumWindow(&x, 1, &x, 0, false), 0);  // one sample asks for no coefficients
    EXPECT_EQ(x, 3.0);
    std::vector<double> two(2, 1.0);
    EXPECT_EQ(CosineSumWindow(two.data(), 2, nullptr, 0, false), kEmptyInput);
    EXPECT_EQ(CosineSumWindow(two.data(), 2, nullptr, -5, false), kEmptyInput);
}

TEST(NamedCosineWindow, KnowsTheTypesOfTheTable) {
    std::vector<double> x(3, 1.0);
    for (const int32_t type : {-1, 10, 12, 29, 30, 34, 60, 62, 1000, INT32_MIN, INT32_MAX}) {
        EXPECT_TRUE(WinCosTerms(type).empty()) << type;
        EXPECT_EQ(NamedCosineWindow(x.data(), 3, type, false), kBadSelector) << type;
        EXPECT_EQ(NamedCosineWindow(x.data(), 1, type, false), kBadSelector) << type;
        EXPECT_EQ(NamedCosineWindow(x.data(), 0, type, false), kEmptyInput) << type;
    }
    EXPECT_THAT(x, ElementsAre(1.0, 1.0, 1.0));
}

TEST(WinCosTerms, SumToOneButForTheFlatTop) {
    const std::vector<std::pair<int32_t, std::size_t>> counts = {{0, 1}, {1, 2}, {2, 2}, {3, 3}, {4, 3}, {5, 3},
                                                                 {6, 5}, {7, 4}, {8, 7}, {9, 5}, {11, 4}};
    for (const auto& [type, count] : counts) {
        const std::span<const double> a = WinCosTerms(type);
        ASSERT_EQ(a.size(), count);
        double sum = 0.0;
        for (const double coefficient : a) sum += coefficient;
        EXPECT_NEAR(sum, type == kWindowFlatTop ? 1.000000001 : 1.0, 1e-15) << type;
    }
}

}  // namespace
}  // namespace krnumer

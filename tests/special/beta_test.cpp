#include "special/beta.h"

#include <gtest/gtest.h>

#include <cmath>

#include "krnumer/special.h"
#include "special/golden.h"
#include "special/values.h"
#include "support/numbers.h"

namespace krnumer {
namespace {

double B(double a, double b) {
    return Value(KR_Beta, a, b, kQuietNaN);
}
double I(double a, double b, double x) {
    return Value(KR_Beta, a, b, x);
}

// Digits go with the size of the logarithms that are added.
TEST(Beta, AgreesWithGoldenData) {
    ExpectGolden(
        "beta", [](const double* x) { return B(x[0], x[1]); },
        {{"moderate", 5e-13}, {"small", 2e-13}, {"large", 1e-8}, {"negative a", 2e-13}, {"negative a + b", 3e-12}});
}

TEST(Beta, IsNaNAtPolesEvenWhereTheyCancel) {
    EXPECT_THAT(B(-0.5, 0.5), QuietNaN());
    EXPECT_THAT(B(0.0, 1.0), QuietNaN());
    EXPECT_THAT(B(-2.0, 5.0), QuietNaN());
    EXPECT_THAT(B(-2.0, -3.0), QuietNaN());
}

TEST(Beta, IsNaNForInfinities) {
    EXPECT_THAT(B(kInfinity, 1.0), QuietNaN());
    EXPECT_THAT(B(1.0, -kInfinity), QuietNaN());
    EXPECT_THAT(B(kQuietNaN, 1.0), QuietNaN());
    EXPECT_THAT(B(1.0, kQuietNaN), QuietNaN());
}

TEST(IncompleteBeta, AgreesWithGoldenData) {
    // 100 passes of the fraction are not enough for small b near x = 1.
    ExpectGolden("incomplete_beta", [](const double* x) { return I(x[0], x[1], x[2]); },
                 {{"a = 1", 4 * kEpsilon, 2 * kEpsilon},
                  {"0.1 to 300", 1e-12},
                  {"near the mean", 3e-12},
                  {"half-integers", 1e-13},
                  {"small b", 0.0, 2e-5},
                  {"1000 to 10000", 2e-10}});
}

TEST(IncompleteBeta, IsXForOnes) {
    for (const double x : {0.0, 1e-300, 0.3, 0.7, 1.0}) EXPECT_EQ(I(1.0, 1.0, x), x);
}

TEST(IncompleteBeta, HasAClosedFormForAOfOne) {
    EXPECT_EQ(I(1.0, 3.0, 0.25), 1.0 - std::pow(0.75, 3.0));
    EXPECT_EQ(I(1.0, 1e-13, 0.5), -std::log(0.5) * 1e-13);
    EXPECT_THAT(I(3.0, 1.0, 0.25), Near(0.015625, 1e-14));  // not for b of one
    EXPECT_THAT(I(3.0, 1.0, 0.9), Near(0.729, 1e-14));
}

TEST(IncompleteBeta, KnowsTheEndsOfX) {
    EXPECT_EQ(I(2.0, 3.0, 0.0), 0.0);
    EXPECT_EQ(I(2.0, 3.0, 1.0), 1.0);
    EXPECT_EQ(I(200.0, 300.0, 1e-300), 0.0);
    EXPECT_THAT(I(0.5, 1e-3, 1e-20), Near(1.9972326127213066e-13, 1e-12));
}

TEST(IncompleteBeta, IsNaNOutsideItsDomain) {
    for (const double bad : {0.0, -1.0, kInfinity, -kInfinity, kQuietNaN}) {
        EXPECT_THAT(I(bad, 1.0, 0.5), QuietNaN());
        EXPECT_THAT(I(1.0, bad, 0.5), QuietNaN());
        EXPECT_THAT(I(bad, 1.0, 0.0), QuietNaN());
    }
    for (const double bad : {-0.1, 1.1, kInfinity, -kInfinity}) EXPECT_THAT(I(2.0, 3.0, bad), QuietNaN());
}

TEST(IncompleteBeta, IsSymmetric) {
    for (double a = 0.3; a < 100.0; a *= 2.1) {
        for (double b = 0.3; b < 100.0; b *= 2.3) {
            for (double x = 0.0625; x < 1.0; x += 0.0625) {
                EXPECT_THAT(I(a, b, x) + I(b, a, 1.0 - x), Near(1.0, 1e-12)) << a << ' ' << b << ' ' << x;
            }
        }
    }
}

TEST(IncompleteBeta, StopsAfterAHundredPasses) {
    EXPECT_NEAR(I(200.0, 0.1, 0.999) - 0.12070868099917828, -1.7e-10, 1e-11);
    EXPECT_NEAR(I(1e6, 1e6, 0.5), 0.446, 1e-3);  // true: 0.5
}

}  // namespace
}  // namespace krnumer

#include "special/incomplete_gamma.h"

#include <gtest/gtest.h>

#include <cmath>

#include "krnumer/special.h"
#include "special/golden.h"
#include "special/values.h"
#include "support/numbers.h"

namespace krnumer {
namespace {

double P(double a, double x) {
    return Value(KR_Gamma, a, x);
}
double Q(double a, double x) {
    return Value(KR_GammaC, a, x);
}

// Digits go with a: the exponent a ln x - x - ln Gamma(a) is a difference of large numbers.
TEST(IncompleteGamma, AgreesWithGoldenData) {
    ExpectGolden(
        "lower_gamma", [](const double* x) { return P(x[0], x[1]); },
        {{"small a", 1e-14}, {"moderate", 1e-13}, {"x near a", 4e-11}, {"large a", 4e-9}, {"lower tail", 2e-13}});
}

TEST(IncompleteGammaC, AgreesWithGoldenData) {
    ExpectGolden("upper_gamma", [](const double* x) { return Q(x[0], x[1]); },
                 {{"small a", 0.0, 1e-14},
                  {"moderate", 2e-13, 1e-14},
                  {"x near a", 4e-11, 4e-11},
                  {"large a", 4e-9},
                  {"upper tail", 2e-13}});
}

TEST(IncompleteGamma, AddsUpToOne) {
    for (double a = 0.1; a < 2000.0; a *= 1.7) {
        for (double x = 0.01; x < 4000.0; x *= 1.9) EXPECT_THAT(P(a, x) + Q(a, x), Near(1.0, 2e-15)) << a << ' ' << x;
    }
}

TEST(IncompleteGamma, IsTheExponentialForOne) {
    for (const double x : {0.25, 0.999, 1.0, 1.001, 30.0}) EXPECT_THAT(Q(1.0, x), Near(std::exp(-x), 1e-14));
}

TEST(IncompleteGamma, KnowsTheEndsOfX) {
    EXPECT_EQ(P(2.5, 0.0), 0.0);
    EXPECT_EQ(Q(2.5, 0.0), 1.0);
    EXPECT_EQ(P(2.5, kInfinity), 1.0);
    EXPECT_EQ(Q(2.5, kInfinity), 0.0);
    EXPECT_EQ(P(2.5, 1e6), 1.0);
    EXPECT_EQ(Q(2.5, 1e6), 0.0);
}

TEST(IncompleteGamma, IsNaNOutsideItsDomain) {
    for (const double a : {0.0, -1.0}) {
        EXPECT_THAT(P(a, 1.0), QuietNaN());
        EXPECT_THAT(Q(a, 1.0), QuietNaN());
        EXPECT_THAT(P(a, 0.0), QuietNaN());
        EXPECT_THAT(Q(a, 0.0), QuietNaN());
    }
    EXPECT_THAT(P(1.0, -1.0), QuietNaN());
    EXPECT_THAT(Q(1.0, -1.0), QuietNaN());
    EXPECT_THAT(P(1.0, -kInfinity), QuietNaN());
    EXPECT_THAT(Q(1.0, -kInfinity), QuietNaN());
    EXPECT_THAT(Q(1.0, kQuietNaN), QuietNaN());
    for (const double a : {kQuietNaN, -kInfinity}) {
        EXPECT_THAT(P(a, 1.0), QuietNaN());
        EXPECT_THAT(Q(a, 1.0), QuietNaN());
    }
}

TEST(IncompleteGamma, LooksAtInfiniteXBeforeAnythingElse) {
    EXPECT_EQ(P(-3.0, kInfinity), 1.0);
    EXPECT_EQ(P(kQuietNaN, kInfinity), 1.0);
    EXPECT_EQ(Q(-3.0, kInfinity), 0.0);
    EXPECT_EQ(Q(kQuietNaN, kInfinity), 0.0);
}

TEST(IncompleteGamma, IsInfiniteForInfiniteA) {
    EXPECT_EQ(P(kInfinity, 1.0), kInfinity);
    EXPECT_EQ(P(kInfinity, 0.0), 0.0);
    EXPECT_THAT(P(kInfinity, -1.0), QuietNaN());
    for (const double x : {1.0, 0.0, -1.0}) EXPECT_EQ(Q(kInfinity, x), kInfinity);
}

TEST(IncompleteGamma, IsInfiniteWhereItsExponentIs) {
    EXPECT_EQ(P(1e306, 0.5), kInfinity);
    EXPECT_EQ(P(1e-310, 0.5), kInfinity);
}

TEST(IncompleteGamma, SurvivesHugeX) {
    for (const double x : {1e10, 1e103, 1e104, 1e200, 1e308}) {
        EXPECT_EQ(Q(3.0, x), 0.0) << x;
        EXPECT_EQ(P(3.0, x), 1.0) << x;
    }
}

TEST(IncompleteGamma, ReachesAsFarAsAnIntegerDegreeOfFreedom) {
    const double a = std::ldexp(1.0, 30);
    EXPECT_THAT(P(a, a), Near(0.5, 0.0, 5e-5));
    EXPECT_THAT(Q(a, a), Near(0.5, 0.0, 5e-5));
    EXPECT_THAT(P(a, std::nextafter(a, 2 * a)), Near(0.5, 0.0, 5e-5));
}

TEST(IncompleteGamma, GivesUpWhereItWouldNotEnd) {
    for (const double a : {1e16, 1e17, 1e100}) EXPECT_THAT(P(a, a), QuietNaN()) << a;
    EXPECT_TRUE(std::isnan(Q(1e100, 1e100)));
    EXPECT_EQ(P(1e17, 1e16), 0.0);  // far from the mean the series is short
}

}  // namespace
}  // namespace krnumer

#include "special/hypergeometric.h"

#include <gtest/gtest.h>

#include <cmath>

#include "krnumer/special.h"
#include "special/golden.h"
#include "special/hypergeometric_series.h"
#include "special/values.h"
#include "support/numbers.h"

namespace krnumer {
namespace {

// Arguments in the order of the literature; the exports take x first.
double F(double a, double b, double c, double x) {
    return Value(KR_Gauss, x, a, b, c);
}
double M(double a, double b, double x) {
    return Value(KR_Kummer, x, a, b);
}
double U(double a, double b, double x) {
    return Value(KR_Tricomi, x, a, b);
}
double D(double v, double x) {
    return Value(KR_ParabolicCylinder, x, v);
}

TEST(Gauss, AgreesWithGoldenData) {
    ExpectGolden("gauss", [](const double* x) { return F(x[0], x[1], x[2], x[3]); },
                 {{"series", 1e-13},
                  {"x below -0.5", 2e-14},
                  {"0.9 to 1", 1e-13},
                  {"0.9 to 1, d an integer", 5e-15},
                  {"0.9 to 1, d a negative integer", 5e-15},
                  {"d below 0", 1e-13},
                  {"polynomial", 1e-9},
                  {"c - a a negative integer", 1e-13},
                  {"at 1", 5e-15},
                  {"large parameters", 2e-11}});
}

TEST(Gauss, IsAPowerWhereTwoParametersCancel) {
    for (const double x : {-0.75, 0.5, 0.99}) {
        EXPECT_EQ(F(1.5, 2.5, 2.5, x), std::pow(1.0 - x, -1.5));
        EXPECT_EQ(F(2.5, 1.5, 2.5, x), std::pow(1.0 - x, -1.5));
    }
}

TEST(Gauss, ExtendsToPolynomials) {
    EXPECT_THAT(F(-2.0, 1.5, 0.5, 2.0), Near(9.0, 1e-15));
    EXPECT_THAT(F(1.5, -2.0, 0.5, 2.0), Near(9.0, 1e-15));
    EXPECT_THAT(F(-1.0, 3.0, 2.0, 5.0), Near(-6.5, 1e-15));
    EXPECT_THAT(F(-1.0, 3.0, 2.0, -5.0), Near(8.5, 1e-15));
    EXPECT_THAT(F(-2.0, -5.5, 0.5, -1000.0), Near(1.0 - 22000.0 + 33.0e6, 1e-12));
    EXPECT_THAT(F(-1.0, 1.0, -2.0, 0.5), Near(1.25, 1e-15));  // ended before the pole of c
}

TEST(Gauss, IsInfiniteBeyondOneAndAtPolesOfC) {
    for (const double x : {1.5, -1.5, 1e300, std::nextafter(1.0, 2.0)}) EXPECT_EQ(F(1.0, 1.0, 2.0, x), kInfinity) << x;
    EXPECT_EQ(F(1.0, 1.0, -2.0, 0.5), kInfinity);
    EXPECT_EQ(F(-3.0, 1.0, -2.0, 0.5), kInfinity);
    EXPECT_EQ(F(1.0, 1.0, 0.0, 0.5), kInfinity);
    EXPECT_EQ(F(1.0, 1.0, 2.0, 1.0), kInfinity);
    EXPECT_EQ(F(1.0, 2.0, 1.5, 1.0), kInfinity);
}

TEST(Gauss, IsExactAboutOne) {
    const double limit = std::tgamma(3.0) * std::tgamma(1.5) / (std::tgamma(2.0) * std::tgamma(2.5));
    EXPECT_THAT(F(1.0, 0.5, 3.0, 1.0), Near(limit, 1e-14));
    EXPECT_THAT(F(1.0, 0.5, 3.0, 1.0 - 1e-9), Near(limit, 1e-8));
}

TEST(Gauss, IsNaNWhereArgumentsAreNotFinite) {
    for (const double bad : {kInfinity, -kInfinity, kQuietNaN}) {
        EXPECT_THAT(F(bad, 1.0, 2.0, 0.5), QuietNaN());
        EXPECT_THAT(F(1.0, bad, 2.0, 0.5), QuietNaN());
        EXPECT_THAT(F(1.0, 1.0, bad, 0.5), QuietNaN());
        EXPECT_THAT(F(1.0, 1.0, 2.0, bad), QuietNaN());
    }
}

TEST(Gauss, GivesUpRecurrencesWithoutEnd) {
    for (const double huge : {1e7, 1e9, 1e100, 1e300}) {
        const double value = F(huge, 1.0, 2.0, 0.95);
        EXPECT_TRUE(std::isnan(value) || value == kInfinity) << huge;
    }
    EXPECT_THAT(F(1.0, 1.5, 1e9, 0.95), Near(1.0 + 1.425e-9, 1e-15));
}

TEST(Kummer, AgreesWithGoldenData) {
    // Below 0 the terms alternate and cancel; from -30 down the asymptotic form takes over.
    ExpectGolden("kummer", [](const double* x) { return M(x[0], x[1], x[2]); },
                 {{"0 to 12", 1e-12},
                  {"-12 to 0", 1e-13, 1e-7},
                  {"12 to 30", 1e-12},
                  {"-30 to -12", 1e-4, 0.02},
                  {"-300 to -30", 2e-9},
                  {"30 to 100", 3e-14},
                  {"100 to 600", 3e-11},
                  {"b near a", 3e-15},
                  {"polynomial", 1e-10},
                  {"negative b", 1e-6}});
}

TEST(Kummer, CancelsBelowMinusTwelve) {
    EXPECT_NEAR(M(1.5, 2.5, -15.0) / 0.022882249242741685 - 1.0, 2e-10, 1e-10);
    EXPECT_THAT(M(1.5, 2.5, -40.0), Near(0.005254679265373058, 1e-14));
}

TEST(Kummer, TrustsASeriesCutShortByItsLastTerm) {
    EXPECT_NEAR(M(1.5, 2.5, 120.0) / 1.6234048253384022e+50 - 1.0, -6e-12, 1e-12);  // cut short, and good enough
    EXPECT_THAT(M(1.5, 2.5, 140.0), Near(6.7550915884041422e+58, 1e-14));           // the asymptotic form is better
    EXPECT_THAT(M(1.5, 2.5, 200.0), Near(5.4058974962565643e+84, 3e-14));
}

TEST(Kummer, IsTheExponentialForEqualParameters) {
    for (const double x : {-700.0, -20.0, 0.5, 300.0}) EXPECT_EQ(M(2.5, 2.5, x), std::exp(x));
    EXPECT_EQ(M(-2.0, -2.0, 0.5), std::exp(0.5));
}

TEST(Kummer, EndsAtNegativeIntegers) {
    EXPECT_EQ(M(0.0, 2.0, 50.0), 1.0);
    EXPECT_THAT(M(-1.0, 2.0, 50.0), Near(-24.0, 1e-15));
    EXPECT_THAT(M(-2.0, 3.0, -40.0), Near(1.0 + 80.0 / 3.0 + 1600.0 / 12.0, 1e-14));
    EXPECT_THAT(M(-1.0, -3.0, 2.0), Near(5.0 / 3.0, 1e-15));
}

TEST(Kummer, IsInfiniteAtPolesOfB) {
    EXPECT_EQ(M(1.0, 0.0, 2.0), kInfinity);
    EXPECT_EQ(M(1.0, -1.0, 2.0), kInfinity);
    EXPECT_EQ(M(-3.0, -1.0, 2.0), kInfinity);
    EXPECT_EQ(M(0.0, 0.0, 2.0), kInfinity);
}

TEST(Kummer, KnowsInfiniteX) {
    EXPECT_EQ(M(1.0, 2.0, kInfinity), kInfinity);
    EXPECT_EQ(M(-0.5, 2.0, kInfinity), -kInfinity);
    EXPECT_EQ(M(1.0, -0.5, kInfinity), -kInfinity);
    EXPECT_EQ(M(-2.0, 3.0, kInfinity), kInfinity);
    EXPECT_EQ(M(-3.0, 3.0, kInfinity), -kInfinity);
    EXPECT_EQ(M(0.0, 3.0, kInfinity), 1.0);
    EXPECT_EQ(M(0.0, 0.0, kInfinity), kInfinity);
    EXPECT_EQ(M(kInfinity, kInfinity, kInfinity), kInfinity);
    for (const double a : {1.0, 0.5, 3.0, 1e300}) EXPECT_EQ(M(a, 1.0, -kInfinity), 0.0) << a;
    EXPECT_EQ(M(-0.5, -2.5, -kInfinity), 0.0);
    EXPECT_EQ(M(0.0, 3.0, -kInfinity), 1.0);
    EXPECT_EQ(M(1.0, -1.0, -kInfinity), kInfinity);
    for (const double a : {-0.5, -1.0, -2.0, -3.0, -3.5}) {
        for (const double b : {2.0, 0.5, -1.25, -1.75, -3.25}) {
            EXPECT_EQ(M(a, b, -kInfinity), std::copysign(kInfinity, M(a, b, -1e6))) << a << " " << b;
        }
    }
    EXPECT_THAT(M(kInfinity, kInfinity, 1.0), QuietNaN());
    EXPECT_THAT(M(kInfinity, 1.0, kInfinity), QuietNaN());
    EXPECT_THAT(M(1.0, -kInfinity, 1.0), QuietNaN());
    EXPECT_THAT(M(kQuietNaN, 1.0, kInfinity), QuietNaN());
    EXPECT_THAT(M(1.0, kQuietNaN, 1.0), QuietNaN());
    EXPECT_THAT(M(1.0, 1.0, kQuietNaN), QuietNaN());
}

TEST(Tricomi, AgreesWithGoldenData) {
    ExpectGolden("tricomi", [](const double* x) { return U(x[0], x[1], x[2]); },
                 {{"to 6", 1e-8},
                  {"to 6, integer b", 1e-4},
                  {"to 6, b near an integer", 1e-3},
                  {"to 6, polynomial", 1e-13},
                  {"6 to 15", 1e-4},
                  {"15 to 40", 2e-5},
                  {"above 40", 1e-15}});
}

TEST(Tricomi, IsTheSameAllAboutAnIntegerB) {
    for (const double b : {0.9996, 1.0, 1.0001, 1.0004}) EXPECT_EQ(U(0.7, b, 2.0), U(0.7, 1.0, 2.0)) << b;
    EXPECT_THAT(U(0.7, 1.0, 2.0), Near(0.5194424599861771, 1e-8));
    EXPECT_TRUE(std::isfinite(U(0.7, 2.0001, 2.0)));
}

TEST(Tricomi, LeavesOutWhatAPoleOfGammaTakesAway) {
    EXPECT_THAT(U(-1.0, 0.5, 2.0), Near(1.5, 4 * kEpsilon));
    EXPECT_THAT(U(0.0, 0.5, 2.0), Near(1.0, 4 * kEpsilon));
    EXPECT_THAT(U(0.5, 1.5, 4.0), Near(0.5, 4 * kEpsilon));  // 1 + a - b = 0: x^(1 - b)
}

TEST(Tricomi, IsOnlyAsymptoticFromSixOn) {
    EXPECT_THAT(U(-3.0, 1.5, 8.0), Near(512.0, 1e-15));  // true: 36.875
    EXPECT_NEAR(U(3.0, 2.0, 6.0) / 0.0022628163977857583, 1.24, 0.005);
    EXPECT_NEAR(U(2.0, 1.5, 6.0) / 0.018950546758214216, 1.0017, 1e-4);
    EXPECT_LT(U(10.0, 1.0, 6.0), 0.0);  // true: 6.4e-12
}

TEST(Tricomi, GivesUpSeriesWithoutEnd) {
    for (const double huge : {1e9, 1e16, 1e300}) EXPECT_THAT(U(0.5, huge, huge), QuietNaN()) << huge;
}

TEST(Tricomi, KnowsItsLimits) {
    EXPECT_EQ(U(1.0, 1.0, 0.0), kInfinity);
    EXPECT_THAT(U(1.0, 1.0, -1.0), QuietNaN());
    for (const double bad : {kInfinity, -kInfinity, kQuietNaN}) {
        EXPECT_THAT(U(bad, 1.0, 1.0), QuietNaN());
        EXPECT_THAT(U(1.0, bad, 1.0), QuietNaN());
        EXPECT_THAT(U(1.0, 1.0, bad), QuietNaN());
    }
    EXPECT_THAT(U(1.0, 1.0, 1e300), Near(1e-300, 1e-14));
    EXPECT_THAT(U(2.0, 1.0, 1e15), Near(1e-30, 1e-14));
}

TEST(ParabolicCylinder, AgreesWithGoldenData) {
    // Stirling's series gives the factors of both solutions to 4e-9, and for x above 0 the solutions cancel.
    ExpectGolden("parabolic_cylinder", [](const double* x) { return D(x[0], x[1]); },
                 {{"-4 to 4", 1e-8, 1e-5},
                  {"integer v", 1e-8, 1e-4},
                  {"large v", 1e-6},
                  {"negative v", 2e-4},
                  {"below -4", 1e-8},
                  {"4 to 6", 1e-3, 1e-3},
                  {"6 to 8", 0.0, 1.0}});
}

TEST(ParabolicCylinder, HasOneSolutionForIntegers) {
    for (const double x : {-2.0, -0.5, 0.0, 1.0}) {
        EXPECT_THAT(D(0.0, x), Near(std::exp(-x * x / 4), 1e-8));
        EXPECT_THAT(D(1.0, x), Near(x * std::exp(-x * x / 4), 1e-8));
        EXPECT_THAT(D(2.0, x), Near((x * x - 1) * std::exp(-x * x / 4), 1e-8, 1e-12));
    }
}

TEST(ParabolicCylinder, LosesItsDigitsForLargeX) {
    EXPECT_NEAR(D(0.5, 4.0) / 0.03690288047866577 - 1.0, 0.0, 2e-7);
    EXPECT_NEAR(D(0.5, 6.0) / 0.0003033151186296071 - 1.0, 0.0, 2e-3);
    EXPECT_NEAR(D(0.5, 8.0), -2.0e-4, 1e-5);  // true: 3.2e-7
}

TEST(ParabolicCylinder, KnowsInfiniteArguments) {
    for (const double v : {0.5, -3.0, 1e300, kInfinity, -kInfinity}) EXPECT_EQ(D(v, kInfinity), 0.0) << v;
    EXPECT_THAT(D(kInfinity, 1.0), QuietNaN());
    EXPECT_THAT(D(kInfinity, -kInfinity), QuietNaN());
    EXPECT_EQ(D(-kInfinity, -kInfinity), kInfinity);
    EXPECT_EQ(D(-0.5, -kInfinity), kInfinity);
    EXPECT_EQ(D(0.0, -kInfinity), 0.0);
    EXPECT_EQ(D(7.0, -kInfinity), 0.0);
    EXPECT_EQ(D(0.5, -kInfinity), -kInfinity);
    EXPECT_EQ(D(1.5, -kInfinity), kInfinity);
    EXPECT_EQ(D(2.5, -kInfinity), -kInfinity);
    EXPECT_THAT(D(kQuietNaN, kInfinity), QuietNaN());
    EXPECT_THAT(D(1.0, kQuietNaN), QuietNaN());
}

TEST(ParabolicCylinder, EndsForHugeArguments) {
    EXPECT_EQ(D(2.0, 1e6), 0.0);
    EXPECT_EQ(D(0.5, 1e300), 0.0);
    EXPECT_EQ(D(-1e300, 1.0), 0.0);
    for (const double v : {1e4 + 0.5, 1e10, 1e300}) EXPECT_TRUE(std::isnan(D(v, 1.0))) << v;
}

TEST(OneF2, SumsItsSeries) {
    const Estimate f = OneF2(1.0, 1.5, 1.5, -0.25);  // (pi / 2) H_0(1)
    EXPECT_THAT(f.value, Near(0.56865662704828795 * kPi / 2, 1e-15));
    EXPECT_LT(f.error, 1e-13);
    EXPECT_EQ(OneF2(1.0, -1.0, 1.5, 2.0).error, 1e35);
    EXPECT_GT(OneF2(1.0, 1.5, 1.5, -1e6).error, 1.0);
}

TEST(ThreeF0, EndsBeforeItGrows) {
    const Estimate f = ThreeF0(1.0, 0.5, 0.5, -4.0 / 400.0);
    EXPECT_LT(f.error, 1e-7);
    EXPECT_GT(f.error, 1e-12);
    const Estimate finite = ThreeF0(1.0, 0.5, -1.0, -0.01);
    EXPECT_THAT(finite.value, Near(1.005, 1e-15));
    EXPECT_LT(finite.error, 1e-13);
    EXPECT_GE(ThreeF0(1.0, 0.5, 0.5, -8.0).error, 1.0);
}

}  // namespace
}  // namespace krnumer

#include "special/gamma.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "krnumer/special.h"
#include "special/golden.h"
#include "special/values.h"
#include "support/numbers.h"

namespace krnumer {
namespace {

constexpr int32_t kIntMax = std::numeric_limits<int32_t>::max();
constexpr int32_t kIntMin = std::numeric_limits<int32_t>::min();

double GammaOf(double a) {
    return Value(KR_Gamma, a, kQuietNaN);
}

TEST(Gamma, AgreesWithGoldenData) {
    ExpectGolden("gamma", [](const double* x) { return GammaOf(x[0]); },
                 {{"2 to 3", 4 * kEpsilon},
                  {"3 to 33", 6 * kEpsilon},
                  {"33 to 171", 5 * kEpsilon},
                  {"0 to 2", 3 * kEpsilon},
                  {"-33 to 0", 6 * kEpsilon},
                  {"near poles", 6 * kEpsilon},
                  {"-170 to -33", 5 * kEpsilon},
                  {"near poles, below -33", 5 * kEpsilon}});
}

TEST(Gamma, IsExactAtSmallIntegers) {
    EXPECT_EQ(GammaOf(1.0), 1.0);
    EXPECT_EQ(GammaOf(2.0), 1.0);
    EXPECT_EQ(GammaOf(3.0), 2.0);
    EXPECT_EQ(GammaOf(4.0), 6.0);
}

TEST(Gamma, StaysNearOneWhereTheArgumentIsRoundedUpToThree) {
    EXPECT_THAT(GammaOf(std::nextafter(2.0, 0.0)), Near(1.0, 2 * kEpsilon));
    EXPECT_THAT(GammaOf(std::nextafter(1.0, 0.0)), Near(1.0, 2 * kEpsilon));
}

TEST(Gamma, IsNaNAtItsPoles) {
    for (const double pole : {0.0, -0.0, -1.0, -2.0, -33.0, -34.0, -1e6, -1e300}) {
        EXPECT_THAT(GammaOf(pole), QuietNaN()) << pole;
    }
}

TEST(Gamma, OverflowsToInfinity) {
    EXPECT_EQ(GammaOf(171.7), kInfinity);
    EXPECT_EQ(GammaOf(710.0), kInfinity);
    EXPECT_EQ(GammaOf(1e308), kInfinity);
    EXPECT_EQ(GammaOf(kInfinity), kInfinity);
}

TEST(Gamma, UnderflowsToASignedZero) {
    EXPECT_TRUE(SameBits(GammaOf(-200.5), -0.0));
    EXPECT_TRUE(SameBits(GammaOf(-201.5), 0.0));
}

TEST(Gamma, KeepsItsSignAcrossTheReflection) {
    EXPECT_GT(GammaOf(-33.5), 0.0);
    EXPECT_LT(GammaOf(-34.5), 0.0);
    EXPECT_LT(GammaOf(-32.5), 0.0);
}

TEST(Gamma, IsNaNForMinusInfinityAndNaN) {
    EXPECT_THAT(GammaOf(-kInfinity), QuietNaN());
    EXPECT_THAT(GammaOf(kQuietNaN), QuietNaN());
}

TEST(Gamma, HasAReciprocalThatIsZeroAtThePoles) {
    EXPECT_EQ(ReciprocalGamma(0.0), 0.0);
    EXPECT_EQ(ReciprocalGamma(-40.0), 0.0);
    EXPECT_EQ(ReciprocalGamma(3.0), 0.5);
}

TEST(LnGamma, AgreesWithGoldenData) {
    ExpectGolden("ln_gamma", [](const double* x) { return Value(KR_LnGamma, x[0]); },
                 {{"0 to 1", 3 * kEpsilon, 3 * kEpsilon},
                  {"near 1 and 2", 3 * kEpsilon, 3 * kEpsilon},
                  {"3 to 33", 3 * kEpsilon},
                  {"33 to 1000", 3 * kEpsilon},
                  {"above 1000", 3 * kEpsilon}});
}

TEST(LnGamma, HasNoReflection) {
    EXPECT_THAT(Value(KR_LnGamma, -0.5), QuietNaN());
    EXPECT_THAT(Value(KR_LnGamma, -40.5), QuietNaN());
    EXPECT_THAT(Value(KR_LnGamma, -kInfinity), QuietNaN());
    EXPECT_THAT(Value(KR_LnGamma, kQuietNaN), QuietNaN());
}

TEST(LnGamma, IsInfiniteAtBothEnds) {
    EXPECT_EQ(Value(KR_LnGamma, 0.0), kInfinity);
    EXPECT_EQ(Value(KR_LnGamma, -0.0), kInfinity);
    EXPECT_EQ(Value(KR_LnGamma, 5e-309), kInfinity);  // 1 / x overflows
    EXPECT_EQ(Value(KR_LnGamma, 1.7e308), kInfinity);
    EXPECT_EQ(Value(KR_LnGamma, kInfinity), kInfinity);
}

TEST(Stirling, AgreesWithGammaToItsTerms) {
    ExpectGolden("stirling", [](const double* x) { return Value(KR_Stirling, x[0]); },
                 {{"33 to 171", 5 * kEpsilon}, {"10 to 33", 3e-11}, {"1 to 10", 2e-4}});
}

TEST(Stirling, IsFarOffWhereItWasNotMeantToServe) {
    EXPECT_NEAR(Value(KR_Stirling, 1.2) / std::tgamma(1.2) - 1.0, 8e-5, 1e-5);
}

TEST(Stirling, TellsOfItsLimits) {
    EXPECT_EQ(Value(KR_Stirling, 0.0), kInfinity);
    EXPECT_EQ(Value(KR_Stirling, std::nextafter(709.782712893384, 710.0)), kInfinity);
    EXPECT_EQ(Value(KR_Stirling, 709.0), kInfinity);  // the value itself overflows from 171.7
    EXPECT_EQ(Value(KR_Stirling, 1e-310), kInfinity);
    EXPECT_EQ(Value(KR_Stirling, kInfinity), kInfinity);
    EXPECT_THAT(Value(KR_Stirling, -1.0), QuietNaN());
    EXPECT_THAT(Value(KR_Stirling, -kInfinity), QuietNaN());
    EXPECT_THAT(Value(KR_Stirling, kQuietNaN), QuietNaN());
}

TEST(Factorial, AgreesWithGoldenData) {
    ExpectGolden("factorial", [](const double* x) { return Value(KR_Fact, static_cast<int32_t>(x[0])); },
                 {{"table", 0.0}, {"product", 3 * kEpsilon}, {"gamma", 5 * kEpsilon}});
}

TEST(Factorial, MultipliesFromTheTopDown) {
    double product = Value(KR_Fact, 33);
    for (int32_t k = 50; k >= 34; --k) product *= k;
    EXPECT_EQ(Value(KR_Fact, 50), product);
    EXPECT_EQ(Value(KR_Fact, 51), GammaOf(52.0));
}

TEST(Factorial, TellsOfItsLimits) {
    EXPECT_THAT(Value(KR_Fact, -1), QuietNaN());
    EXPECT_THAT(Value(KR_Fact, kIntMin), QuietNaN());
    EXPECT_EQ(Value(KR_Fact, 171), kInfinity);
    EXPECT_EQ(Value(KR_Fact, kIntMax), kInfinity);
}

TEST(LnFactorial, AgreesWithGoldenData) {
    ExpectGolden("ln_factorial", [](const double* x) { return Value(KR_LnFact, static_cast<int32_t>(x[0])); },
                 {{"to 32", 3 * kEpsilon}, {"to 1000", 3 * kEpsilon}, {"large", 3 * kEpsilon}});
}

TEST(LnFactorial, TellsOfItsLimits) {
    EXPECT_TRUE(SameBits(Value(KR_LnFact, 1), 0.0));
    EXPECT_EQ(Value(KR_LnFact, 0), 0.0);
    EXPECT_THAT(Value(KR_LnFact, -1), QuietNaN());
    EXPECT_THAT(Value(KR_LnFact, kIntMin), QuietNaN());
}

TEST(Digamma, AgreesWithGoldenData) {
    // No reduction before the tangent of the reflection: digits go with the distance from 0 and near the poles.
    ExpectGolden("psi", [](const double* x) { return Value(KR_Psi, x[0]); },
                 {{"0 to 1", 10 * kEpsilon},
                  {"1 to 10", 4 * kEpsilon, 4 * kEpsilon},
                  {"above 10", 2 * kEpsilon},
                  {"-30 to 0", 1e-12, 1e-13},
                  {"near poles", 5e-9},
                  {"just below 0", 3e-4},
                  {"far below 0", 1e-9, 1e-10}});
}

TEST(Digamma, IsPlusInfinityAtItsPoles) {
    for (const double pole : {0.0, -0.0, -1.0, -30.0, -1e300}) EXPECT_EQ(Value(KR_Psi, pole), kInfinity) << pole;
    EXPECT_EQ(Value(KR_Psi, kInfinity), kInfinity);
    EXPECT_THAT(Value(KR_Psi, -kInfinity), QuietNaN());
    EXPECT_THAT(Value(KR_Psi, kQuietNaN), QuietNaN());
}

TEST(Digamma, CannotTellTheNearestNegativesFromZero) {
    EXPECT_EQ(Value(KR_Psi, -1e-16), -kInfinity);
    EXPECT_EQ(Value(KR_Psi, -5e-324), -kInfinity);
}

TEST(Digamma, SumsReciprocalsAtSmallIntegers) {
    EXPECT_EQ(Value(KR_Psi, 1.0), -kEulerGamma);
    EXPECT_EQ(Value(KR_Psi, 2.0), 1.0 - kEulerGamma);
    EXPECT_EQ(Value(KR_Psi, 3.0), 1.5 - kEulerGamma);
}

}  // namespace
}  // namespace krnumer

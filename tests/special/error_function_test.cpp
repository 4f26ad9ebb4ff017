#include "special/error_function.h"

#include <gtest/gtest.h>

#include <cmath>

#include "krnumer/special.h"
#include "special/golden.h"
#include "special/values.h"
#include "support/numbers.h"

namespace krnumer {
namespace {

TEST(Erf, AgreesWithGoldenData) {
    ExpectGolden("erf", [](const double* x) { return Value(KR_Erf, x[0]); },
                 {{"to 1", 3 * kEpsilon}, {"above 1", 3 * kEpsilon}, {"negative", 4 * kEpsilon}});
}

TEST(Erf, IsOdd) {
    for (const double x : {1e-300, 0.3, 1.0, 1.5, 6.0}) EXPECT_EQ(Value(KR_Erf, -x), -Value(KR_Erf, x)) << x;
}

TEST(Erf, KnowsTheEnds) {
    EXPECT_EQ(Value(KR_Erf, 0.0), 0.0);
    EXPECT_EQ(Value(KR_Erf, 7.0), 1.0);
    EXPECT_EQ(Value(KR_Erf, kInfinity), 1.0);
    EXPECT_EQ(Value(KR_Erf, -kInfinity), -1.0);
    EXPECT_THAT(Value(KR_Erf, kQuietNaN), QuietNaN());
}

TEST(ErfC, AgreesWithGoldenData) {
    // From e^(-x^2), whose exponent is not split: digits go with x^2.
    ExpectGolden("erfc", [](const double* x) { return Value(KR_ErfC, x[0]); },
                 {{"to 1", 6 * kEpsilon}, {"1 to 8", 1e-14}, {"above 8", 1.5e-13}, {"negative", 2 * kEpsilon}});
}

TEST(ErfC, MeetsItselfWhereItsBranchesDo) {
    EXPECT_THAT(Value(KR_ErfC, 1.0), Near(1.0 - Value(KR_Erf, 1.0), 2 * kEpsilon));
    EXPECT_THAT(Value(KR_ErfC, -1.0), Near(1.0 + Value(KR_Erf, 1.0), kEpsilon));
    EXPECT_THAT(Value(KR_ErfC, std::nextafter(8.0, 0.0)), Near(Value(KR_ErfC, 8.0), 3e-14));
}

TEST(ErfC, UnderflowsToItsLimits) {
    EXPECT_EQ(Value(KR_ErfC, 26.7), 0.0);
    EXPECT_EQ(Value(KR_ErfC, 1e200), 0.0);
    EXPECT_EQ(Value(KR_ErfC, kInfinity), 0.0);
    EXPECT_EQ(Value(KR_ErfC, -30.0), 2.0);
    EXPECT_EQ(Value(KR_ErfC, -1e200), 2.0);
    EXPECT_EQ(Value(KR_ErfC, -kInfinity), 2.0);
    EXPECT_THAT(Value(KR_ErfC, kQuietNaN), QuietNaN());
}

TEST(Dawson, AgreesWithGoldenData) {
    ExpectGolden("dawson", [](const double* x) { return Value(KR_Dawson, x[0]); },
                 {{"to 3.25", 4 * kEpsilon},
                  {"1 to 3.25", 4 * kEpsilon},
                  {"3.25 to 6.25", 4 * kEpsilon},
                  {"above 6.25", 3 * kEpsilon},
                  {"negative", 4 * kEpsilon}});
}

TEST(Dawson, EndsInAReciprocal) {
    EXPECT_EQ(Value(KR_Dawson, 1e10), 0.5 / 1e10);
    EXPECT_EQ(Value(KR_Dawson, -1e10), -0.5 / 1e10);
    EXPECT_EQ(Value(KR_Dawson, 1e308), 0.5 / 1e308);
}

TEST(Dawson, KnowsItsLimits) {
    EXPECT_TRUE(SameBits(Value(KR_Dawson, 0.0), 0.0));
    EXPECT_TRUE(SameBits(Value(KR_Dawson, -0.0), 0.0));
    for (const double x : {kInfinity, -kInfinity, kQuietNaN}) EXPECT_THAT(Value(KR_Dawson, x), QuietNaN()) << x;
}

}  // namespace
}  // namespace krnumer

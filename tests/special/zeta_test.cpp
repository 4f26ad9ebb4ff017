#include "special/zeta.h"

#include <gtest/gtest.h>

#include <cmath>

#include "krnumer/special.h"
#include "special/golden.h"
#include "special/values.h"
#include "support/numbers.h"

namespace krnumer {
namespace {

TEST(Zeta, AgreesWithGoldenData) {
    ExpectGolden("zeta", [](const double* x) { return Value(KR_Zeta, x[0]); },
                 {{"below 0", 3e-14, 1e-14},
                  {"near its zeros", 1e-13, 2e-13},
                  {"0 to 1", 5 * kEpsilon},
                  {"near 1", 5 * kEpsilon},
                  {"1 to 10", 4 * kEpsilon},
                  {"10 to 50", kEpsilon},
                  {"above 50", 2 * kEpsilon}});
}

TEST(Zeta, KnowsItsIntegers) {
    EXPECT_EQ(Value(KR_Zeta, 0.0), -0.5);
    EXPECT_EQ(Value(KR_Zeta, -0.0), -0.5);
    EXPECT_EQ(Value(KR_Zeta, 1.0), kInfinity);
    EXPECT_THAT(Value(KR_Zeta, 2.0), Near(kPi * kPi / 6, 2 * kEpsilon));
    EXPECT_THAT(Value(KR_Zeta, 31.0), WithinUlps(1.0000000004656629, 1));  // the first beyond the table
}

TEST(Zeta, IsNotQuiteZeroAtItsZeros) {
    const double zero = Value(KR_Zeta, -20.0);
    EXPECT_NE(zero, 0.0);
    EXPECT_NEAR(zero, 1e-13, 2e-14);
}

TEST(Zeta, KnowsItsLimits) {
    EXPECT_EQ(Value(KR_Zeta, 127.0), 1.0);
    EXPECT_EQ(Value(KR_Zeta, 200.0), 1.0);
    EXPECT_EQ(Value(KR_Zeta, kInfinity), 1.0);
    EXPECT_EQ(Value(KR_Zeta, std::nextafter(-30.8148, -31.0)), 0.0);
    EXPECT_NE(Value(KR_Zeta, -30.8148), 0.0);
    EXPECT_EQ(Value(KR_Zeta, -1e300), 0.0);
    EXPECT_THAT(Value(KR_Zeta, -kInfinity), QuietNaN());
    EXPECT_THAT(Value(KR_Zeta, kQuietNaN), QuietNaN());
}

TEST(Dilogarithm, AgreesWithGoldenData) {
    ExpectGolden("dilogarithm", [](const double* x) { return Value(KR_Diln, x[0]); },
                 {{"to 0.5", 3e-15}, {"0.5 to 1.5", 4e-15}, {"1.5 to 2", 4e-15}, {"above 2", 3 * kEpsilon}});
}

TEST(Dilogarithm, KnowsItsLimits) {
    EXPECT_EQ(Value(KR_Diln, 0.0), 1.6449340668482264);
    EXPECT_EQ(Value(KR_Diln, -0.0), 1.6449340668482264);
    EXPECT_EQ(Value(KR_Diln, 1.0), 0.0);
    EXPECT_THAT(Value(KR_Diln, 2.0), Near(-kPi * kPi / 12, 2e-15));
    EXPECT_THAT(Value(KR_Diln, -1e-300), QuietNaN());
    for (const double x : {kInfinity, -kInfinity, kQuietNaN}) EXPECT_THAT(Value(KR_Diln, x), QuietNaN());
}

}  // namespace
}  // namespace krnumer

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "krnumer/special.h"
#include "special/bessel_integer.h"
#include "special/golden.h"
#include "special/values.h"
#include "support/numbers.h"

namespace krnumer {
namespace {

constexpr int32_t kIntMax = std::numeric_limits<int32_t>::max();
constexpr int32_t kIntMin = std::numeric_limits<int32_t>::min();

double J(double v, double x) {
    return Value(KR_BesselJr, v, x);
}
double Y(double v, double x) {
    return Value(KR_BesselYr, v, x);
}
double SphericalJ(int32_t n, double x) {
    return Value(KR_BesselJs, n, x);
}
double SphericalY(int32_t n, double x) {
    return Value(KR_BesselYs, n, x);
}
int32_t Order(const double* x) {
    return static_cast<int32_t>(x[0]);
}

TEST(BesselJ, AgreesWithGoldenData) {
    ExpectGolden("bessel_j", [](const double* x) { return J(x[0], x[1]); },
                 {{"v = 0", 0.0, 1e-14},
                  {"v = 1", 0.0, 1e-14},
                  {"integer v, x above v", 0.0, 1e-14},
                  {"integer v, x below v", 0.0, 2e-15},
                  {"integer v, negative v or x", 0.0, 2e-15},
                  {"0 to 17", 0.0, 5e-12},
                  {"near an integer", 0.0, 2e-12},
                  {"17 to 200", 0.0, 2e-14},
                  {"17 to 200, small x", 1e-12},
                  {"17 to 200, large x", 0.0, 2e-14},
                  {"200 to 300", 0.0, 1e-11},
                  {"300 to 3000", 0.0, 2e-12},
                  {"300 to 3000, x near v", 0.0, 2e-12},
                  {"negative v", 0.0, 2e-14},
                  {"negative v, small x", 5e-12, 5e-12},
                  {"huge x", 0.0, 1e-11}});
}

TEST(BesselJ, IsAccurateForIntegers) {
    EXPECT_THAT(J(3.0, 60.0), Near(-0.040396711521655157, 1e-13));
    EXPECT_THAT(J(10.0, 1000.0), Near(-0.024520622306036558, 1e-13));
    EXPECT_THAT(J(10.0, 1.0), Near(2.6306151236874532e-10, 1e-14));
    EXPECT_THAT(J(150.0, 1.0), Near(1.2243010020861061e-308, 1e-14));  // rescaled on its way
}

TEST(BesselJ, IsZeroWhereIntegersUnderflow) {
    EXPECT_EQ(J(2.0, 0.0), 0.0);
    EXPECT_EQ(J(0.0, 0.0), 1.0);
    EXPECT_EQ(J(40.0, 1e-10), 0.0);
    EXPECT_EQ(J(200.0, 1.0), 0.0);
    EXPECT_EQ(J(2147483647.0, 1000.0), 0.0);
    EXPECT_EQ(J(-2147483648.0, 1000.0), 0.0);
    EXPECT_EQ(J(1e300, 1.0), 0.0);
}

TEST(BesselJ, FollowsTheParityOfIntegers) {
    for (const int32_t n : {0, 1, 2, 3, 6, 7}) {
        const double sign = n % 2 == 0 ? 1.0 : -1.0;
        for (const double x : {0.5, 2.0, 30.0}) {
            EXPECT_EQ(J(-n, x), sign * J(n, x)) << n;
            EXPECT_EQ(J(n, -x), sign * J(n, x)) << n;
            EXPECT_EQ(J(-n, -x), J(n, x)) << n;
        }
    }
}

// 1 / r(n) + r(n + 1) = 2 n / x for r(n) = J_n / J_(n - 1).
// Beyond x = 2^55 n no order differs from the second before it but by its sign.
TEST(BesselJ, OnlyTurnsItsSignFarOut) {
    for (const double x : {1e30, 3.7e100, 1e308}) {
        EXPECT_EQ(J(2147483646.0, x), -J(0.0, x)) << x;
        EXPECT_EQ(J(2147483647.0, x), J(3.0, x)) << x;
        EXPECT_EQ(J(2147483644.0, x), J(4.0, x)) << x;
        EXPECT_EQ(Y(2147483645.0, x), Y(5.0, x)) << x;
        EXPECT_EQ(Y(2147483647.0, x), Y(3.0, x)) << x;
    }
}

TEST(BesselRatio, ObeysTheRecurrenceUpToTheLargestOrders) {
    for (const double n : {2.0, 16.5, 1000.0, 1e6, 1e9, 2147483646.0}) {
        for (const double z : {1e-3, 0.5, 0.999, 1.0}) {
            const double x = z * n;
            EXPECT_THAT(1.0 / BesselRatio(n, x) + BesselRatio(n + 1.0, x), Near(2.0 * n / x, 1e-11)) << n << " " << z;
        }
    }
}

TEST(BesselJ, IsZeroForRealOrdersBelowEps) {
    EXPECT_EQ(J(0.5, 1e-20), 0.0);
    EXPECT_EQ(J(0.5, 0.0), 0.0);
    EXPECT_EQ(J(-0.5, 1e-20), 0.0);
    EXPECT_GT(J(0.5, 3e-16), 0.0);
}

TEST(BesselJ, IsNaNOutsideItsDomain) {
    EXPECT_THAT(J(0.5, -1.0), QuietNaN());
    EXPECT_THAT(J(-200.5, 1.0), QuietNaN());
    EXPECT_THAT(J(-1e9 - 0.5, 1.0), QuietNaN());
    for (const double bad : {kInfinity, -kInfinity, kQuietNaN}) {
        EXPECT_THAT(J(bad, 1.0), QuietNaN());
        EXPECT_THAT(J(1.0, bad), QuietNaN());
        EXPECT_THAT(J(0.5, bad), QuietNaN());
    }
    EXPECT_TRUE(std::isfinite(J(-199.5, 100.0)));
}

TEST(BesselJ, IsNaNWhereAiryOverflows) {
    EXPECT_THAT(J(1000.3, 300.0), QuietNaN());
    EXPECT_THAT(J(5000.5, 2500.25), QuietNaN());
    EXPECT_EQ(J(1000.3, 50.0), 0.0);  // the power series serves up to 3.6 sqrt(v)
}

TEST(BesselJ, TurnsFromOneExpansionToTheOther) {
    const double width = 0.7 * std::cbrt(500.5);
    for (const double x : {500.5 - width, 500.5 + width}) {
        EXPECT_NEAR(J(500.5, x * (1.0 - 1e-14)), J(500.5, x * (1.0 + 1e-14)), 5e-12);
    }
}

TEST(BesselY, AgreesWithGoldenData) {
    // Near an integer the quotient loses digits as 1 / |v - n|.
    ExpectGolden("bessel_y", [](const double* x) { return Y(x[0], x[1]); },
                 {{"v = 0", 1e-14, 1e-14},
                  {"v = 1", 1e-14, 1e-14},
                  {"integer v, x above v", 0.0, 1e-14},
                  {"integer v, x below v", 1e-14, 1e-14},
                  {"negative integer v", 0.0, 1e-14},
                  {"0 to 17", 0.0, 1e-12},
                  {"near an integer", 0.0, 1e-7},
                  {"negative v", 0.0, 2e-13}});
}

TEST(BesselY, IsNegativeInfinityOnceItOverflows) {
    EXPECT_EQ(Y(200.0, 1.0), -kInfinity);
    EXPECT_EQ(Y(400.0, 10.0), -kInfinity);
    EXPECT_EQ(Y(-200.0, 1.0), -kInfinity);
    EXPECT_EQ(Y(-201.0, 1.0), kInfinity);
    EXPECT_EQ(Y(2147483647.0, 1.0), -kInfinity);
    EXPECT_EQ(Y(2147483647.0, 2.1e9), -kInfinity);
    EXPECT_EQ(Y(-2147483648.0, 1.0), -kInfinity);
    EXPECT_EQ(Y(5.0, 1e-300), -kInfinity);
}

TEST(BesselY, IsNaNOutsideItsDomain) {
    for (const double x : {0.0, -0.0, -1.0, kInfinity, -kInfinity, kQuietNaN}) {
        EXPECT_THAT(Y(1.0, x), QuietNaN()) << x;
        EXPECT_THAT(Y(0.5, x), QuietNaN()) << x;
    }
    for (const double v : {2147483648.0, -2147483649.0, 1e300, -1e300, -200.5, kInfinity, -kInfinity, kQuietNaN}) {
        EXPECT_THAT(Y(v, 1.0), QuietNaN()) << v;
    }
    EXPECT_THAT(Y(200.5, 300.0), QuietNaN());  // J of the negative order has none
    EXPECT_TRUE(std::isfinite(Y(-300.0, 1000.0)));
}

TEST(BesselY, ObeysTheWronskian) {
    for (const double v : {0.0, 1.0, 0.3, 2.5, 7.0, 40.6}) {
        for (const double x : {20.0, 30.5, 77.0}) {
            const double wronskian = J(v + 1.0, x) * Y(v, x) - J(v, x) * Y(v + 1.0, x);
            EXPECT_THAT(wronskian * kPi * x / 2.0, Near(1.0, 1e-11)) << v << ' ' << x;
        }
    }
}

TEST(SphericalBessel, AgreesWithGoldenData) {
    ExpectGolden("spherical_j", [](const double* x) { return SphericalJ(Order(x), x[1]); },
                 {{"n to 10", 0.0, 1e-12}, {"n to 150", 0.0, 1e-14}, {"negative n", 0.0, 5e-12}});
    ExpectGolden("spherical_y", [](const double* x) { return SphericalY(Order(x), x[1]); },
                 {{"n to 10", 0.0, 1e-12}, {"n to 10, small x", 2e-11, 2e-12}, {"n to 150", 0.0, 5e-13}});
}

TEST(SphericalBessel, KnowsItsLimits) {
    EXPECT_EQ(SphericalJ(0, 0.0), 1.0);
    EXPECT_EQ(SphericalJ(1, 0.0), 0.0);
    EXPECT_EQ(SphericalJ(-3, 0.0), 0.0);
    EXPECT_EQ(SphericalJ(0, 1e-20), 0.0);  // J is 0 below eps
    EXPECT_EQ(SphericalJ(3, kInfinity), 0.0);
    EXPECT_EQ(SphericalY(0, 0.0), -kInfinity);
    EXPECT_EQ(SphericalY(-3, 0.0), -kInfinity);
    EXPECT_EQ(SphericalY(3, kInfinity), 0.0);
    for (const double x : {-1.0, -kInfinity, kQuietNaN}) {
        EXPECT_THAT(SphericalJ(2, x), QuietNaN());
        EXPECT_THAT(SphericalY(2, x), QuietNaN());
    }
    EXPECT_TRUE(std::isfinite(SphericalY(199, 300.0)));
    EXPECT_THAT(SphericalY(200, 300.0), QuietNaN());
    EXPECT_EQ(SphericalJ(kIntMax, 1.0), 0.0);
    EXPECT_THAT(SphericalJ(kIntMin, 1.0), QuietNaN());
    EXPECT_THAT(SphericalY(kIntMax, 1.0), QuietNaN());
    EXPECT_THAT(SphericalY(kIntMin, 1.0), QuietNaN());
}

}  // namespace
}  // namespace krnumer

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

double I(double v, double x) {
    return Value(KR_BesselIr, v, x);
}
double K(int32_t n, double x) {
    return Value(KR_BesselKn, n, x);
}

struct Kelvin {
    Kelvin(void (*function)(double, int32_t, double*, double*), int32_t n, double x) {
        function(x, n, &real, &imaginary);
    }
    double real = kUntouched, imaginary = kUntouched;
};
Kelvin First(int32_t n, double x) {
    return {KR_KelvinI, n, x};
}
Kelvin Second(int32_t n, double x) {
    return {KR_KelvinK, n, x};
}
int32_t Order(const double* x) {
    return static_cast<int32_t>(x[0]);
}

TEST(BesselI, AgreesWithGoldenData) {
    // The downward recurrence starts at 2 (n + sqrt(100 n)) whatever x is: too low for large x.
    ExpectGolden("bessel_i", [](const double* x) { return I(x[0], x[1]); },
                 {{"v = 0 and 1", 1e-15},
                  {"integer v, to 30", 1e-13},
                  {"integer v, 30 to 200", 1e-3},
                  {"integer v, large x", 0.3},
                  {"real v", 1e-13},
                  {"real v, large x", 2e-11},
                  {"negative v", 1e-13},
                  {"negative half-integers", 2e-14}});
}

TEST(BesselI, StartsItsRecurrenceTooLowForLargeX) {
    EXPECT_NEAR(I(2.0, 40.0) / 1.4159404985256928e16 - 1.0, 6e-13, 3e-13);
    EXPECT_NEAR(I(3.0, 500.0) / 2.4823450100727290e215 - 1.0, -0.07, 0.005);
}

TEST(BesselI, KeepsTheSmallestArguments) {
    EXPECT_THAT(I(2.0, 1e-19), Near(1.25e-39, 1e-14));
    EXPECT_THAT(I(5.0, 1e-16), Near(1e-80 / 3840.0, 1e-14));
    EXPECT_THAT(I(2.0, -1e-100), Near(1.25e-201, 1e-14));
    EXPECT_EQ(I(5.0, 1e-100), 0.0);
    EXPECT_EQ(I(300.0, 1e-3), 0.0);
}

TEST(BesselI, FollowsTheParityOfIntegers) {
    for (const double n : {0.0, 1.0, 2.0, 3.0}) {
        const double sign = std::fmod(n, 2.0) == 0.0 ? 1.0 : -1.0;
        EXPECT_EQ(I(n, -2.5), sign * I(n, 2.5));
        EXPECT_EQ(I(-n, 2.5), I(n, 2.5));
    }
}

TEST(BesselI, HasItsPowerSeriesAtNegativeHalfIntegers) {
    const double x = 2.0, scale = std::sqrt(2.0 / (kPi * x));
    EXPECT_THAT(I(-0.5, x), Near(scale * std::cosh(x), 1e-15));
    EXPECT_THAT(I(-1.5, x), Near(scale * (std::sinh(x) - std::cosh(x) / x), 4e-15));
    EXPECT_THAT(I(-0.5, 50.0), Near(std::sqrt(2.0 / (kPi * 50.0)) * std::cosh(50.0), 1e-14));
}

TEST(BesselI, KnowsZero) {
    EXPECT_EQ(I(0.0, 0.0), 1.0);
    EXPECT_EQ(I(3.0, 0.0), 0.0);
    EXPECT_EQ(I(-3.0, 0.0), 0.0);
    EXPECT_EQ(I(0.5, 0.0), 0.0);
    EXPECT_EQ(I(-0.5, 0.0), kInfinity);
    EXPECT_EQ(I(-1.5, 0.0), -kInfinity);
    EXPECT_EQ(I(-2.5, 0.0), kInfinity);
}

TEST(BesselI, KnowsInfiniteAndHugeArguments) {
    EXPECT_EQ(I(kInfinity, 0.0), 0.0);
    EXPECT_THAT(I(kInfinity, 1.0), QuietNaN());
    EXPECT_THAT(I(kInfinity, kInfinity), QuietNaN());
    EXPECT_EQ(I(0.0, kInfinity), kInfinity);
    EXPECT_EQ(I(-1e300, kInfinity), kInfinity);
    for (const double v : {0.0, 2.0, 0.5}) {
        EXPECT_THAT(I(v, -kInfinity), QuietNaN());
        EXPECT_THAT(I(v, kQuietNaN), QuietNaN());
    }
    EXPECT_THAT(I(-kInfinity, 1.0), QuietNaN());
    EXPECT_THAT(I(kQuietNaN, kInfinity), QuietNaN());
    for (const double v : {3e9, -3e9, 3e9 + 0.5, 1e300}) EXPECT_THAT(I(v, 1.0), QuietNaN()) << v;
    EXPECT_EQ(I(2147483647.0, 1.0), 0.0);
    EXPECT_EQ(I(-2147483648.0, 700.0), 0.0);
    EXPECT_EQ(I(2147483647.0, 1e300), kInfinity);
    EXPECT_EQ(I(0.0, 720.0), kInfinity);
}

TEST(BesselI, IsNaNOutsideItsDomain) {
    EXPECT_THAT(I(-200.5, 1.0), QuietNaN());
    EXPECT_THAT(I(-200.5, 0.0), QuietNaN());
    EXPECT_THAT(I(0.5, -1.0), QuietNaN());
}

TEST(BesselK, AgreesWithGoldenData) {
    ExpectGolden("bessel_k", [](const double* x) { return K(Order(x), x[1]); },
                 {{"n = 0 and 1", 1e-15}, {"n to 50", 3e-15}, {"n to 1000", 1e-14}});
}

TEST(BesselK, KnowsItsLimits) {
    EXPECT_EQ(K(0, 0.0), kInfinity);
    EXPECT_EQ(K(5, -0.0), kInfinity);
    EXPECT_EQ(K(5, kInfinity), 0.0);
    EXPECT_EQ(K(-4, 2.0), K(4, 2.0));
    for (const double x : {-1.0, -kInfinity, kQuietNaN}) EXPECT_THAT(K(2, x), QuietNaN());
    for (const int32_t n : {kIntMax, kIntMin}) {
        EXPECT_EQ(K(n, 1.0), kInfinity);
        EXPECT_EQ(K(n, 1e5), 0.0);
    }
    EXPECT_EQ(K(2, 1e-310), kInfinity);
}

// Half of it is 0, whose logarithm is no number to go on with.
TEST(BesselK, TakesTheLeastDouble) {
    constexpr double kLeast = std::numeric_limits<double>::denorm_min();
    EXPECT_THAT(K(0, kLeast), Near(744.5560034370397, 1e-15));
    for (const int32_t n : {1, 2, -3, kIntMax, kIntMin}) EXPECT_EQ(K(n, kLeast), kInfinity) << n;
}

TEST(KelvinFirst, AgreesWithGoldenData) {
    // Terms cancel as e^(x (1 - 1 / sqrt 2)), and the series ends by an absolute measure where the sum is small.
    const std::vector<Bound> bounds = {
        {"to 10", 1e-13, 1e-12}, {"10 to 60", 1e-8, 1e8}, {"60 to 74", 1e-4, 1e15}, {"large n", 1e-6, 1e-8}};
    ExpectGolden(
        "kelvin_ber", [](const double* x) { return First(Order(x), x[1]).real; }, bounds);
    ExpectGolden(
        "kelvin_bei", [](const double* x) { return First(Order(x), x[1]).imaginary; }, bounds);
}

TEST(KelvinFirst, KnowsZero) {
    EXPECT_EQ(First(0, 0.0).real, 1.0);
    EXPECT_EQ(First(0, 0.0).imaginary, 0.0);
    for (const int32_t n : {1, -2, kIntMax, kIntMin}) {
        EXPECT_EQ(First(n, 0.0).real, 0.0);
        EXPECT_EQ(First(n, 0.0).imaginary, 0.0);
    }
}

TEST(KelvinFirst, FollowsTheParityOfItsOrder) {
    for (const int32_t n : {0, 1, 2, 3}) {
        const double sign = n % 2 == 0 ? 1.0 : -1.0;
        const Kelvin f = First(n, 2.5);
        EXPECT_EQ(First(n, -2.5).real, sign * f.real);
        EXPECT_EQ(First(-n, 2.5).imaginary, sign * f.imaginary);
        EXPECT_EQ(First(-n, -2.5).real, f.real);
    }
}

TEST(KelvinFirst, IsNaNWhereItsTermsOverflow) {
    for (const double x : {80.0, 1e10, 1e300, kInfinity, -kInfinity, kQuietNaN}) {
        EXPECT_TRUE(std::isnan(First(0, x).real)) << x;
        EXPECT_TRUE(std::isnan(First(3, x).imaginary)) << x;
    }
    EXPECT_TRUE(std::isfinite(First(0, 74.0).real));
    EXPECT_EQ(First(kIntMax, 1000.0).real, 0.0);
    EXPECT_EQ(First(1000, 1.0).real, 0.0);
}

TEST(KelvinSecond, AgreesWithGoldenData) {
    // Both parts of ker and kei grow while they fall.
    const std::vector<Bound> bounds = {{"to 2", 1e-11, 1e-13}, {"2 to 10", 0.0, 5e-12}, {"10 to 15", 0.0, 2e-10}};
    ExpectGolden(
        "kelvin_ker", [](const double* x) { return Second(Order(x), x[1]).real; }, bounds);
    ExpectGolden(
        "kelvin_kei", [](const double* x) { return Second(Order(x), x[1]).imaginary; }, bounds);
}

TEST(KelvinSecond, FollowsTheParityOfItsOrder) {
    for (const int32_t n : {1, 2, 3}) {
        const double sign = n % 2 == 0 ? 1.0 : -1.0;
        EXPECT_EQ(Second(-n, 2.5).real, sign * Second(n, 2.5).real);
        EXPECT_EQ(Second(-n, 2.5).imaginary, sign * Second(n, 2.5).imaginary);
    }
}

TEST(KelvinSecond, TakesTheLeastDouble) {
    const Kelvin least = Second(0, std::numeric_limits<double>::denorm_min());
    EXPECT_THAT(least.real, Near(744.5560034370397, 1e-15));
    EXPECT_THAT(least.imaginary, Near(-0.7853981633974483, 1e-15));
}

TEST(KelvinSecond, IsNaNOutsideItsDomain) {
    for (const double x : {0.0, -0.0, -1.0, 80.0, kInfinity, -kInfinity, kQuietNaN}) {
        EXPECT_TRUE(std::isnan(Second(2, x).real)) << x;
        EXPECT_TRUE(std::isnan(Second(2, x).imaginary)) << x;
    }
}

TEST(KelvinSecond, IsInfiniteForHugeOrders) {
    for (const int32_t n : {1000, kIntMax, kIntMin}) {
        EXPECT_TRUE(std::isinf(Second(n, 1.0).real)) << n;
        EXPECT_TRUE(std::isinf(Second(n, 1.0).imaginary)) << n;
    }
}

}  // namespace
}  // namespace krnumer

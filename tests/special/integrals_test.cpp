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

struct Fresnel {
    explicit Fresnel(double x) { KR_FresnelIntegrals(x, &c, &s); }
    double c = kUntouched, s = kUntouched;
};

double E(int32_t n, double x) {
    return Value(KR_ExpI, x, n);
}

TEST(FresnelIntegrals, AgreeWithGoldenData) {
    // The phase pi x^2 / 2 loses digits as x^2, and the amplitude gives 1 / x back.
    const std::vector<Bound> bounds = {{"to 1.6", 5 * kEpsilon},
                                       {"1.6 to 40", 0.0, 1e-14},
                                       {"40 to 36974", 0.0, 1e-11},
                                       {"above 36974", 0.0, 8.7e-6},
                                       {"negative", 0.0, 4e-15}};
    ExpectGolden(
        "fresnel_c", [](const double* x) { return Fresnel(x[0]).c; }, bounds);
    ExpectGolden(
        "fresnel_s", [](const double* x) { return Fresnel(x[0]).s; }, bounds);
}

TEST(FresnelIntegrals, AreTheirLimitOnlyWhereFinite) {
    EXPECT_EQ(Fresnel(40000.0).c, 0.5);
    EXPECT_EQ(Fresnel(40000.0).s, 0.5);
    EXPECT_EQ(Fresnel(-1e300).c, -0.5);
    EXPECT_EQ(Fresnel(-1e300).s, -0.5);
    EXPECT_NE(Fresnel(36974.0).c, 0.5);
    for (const double x : {kInfinity, -kInfinity}) {
        EXPECT_EQ(Fresnel(x).c, x);
        EXPECT_EQ(Fresnel(x).s, x);
    }
    EXPECT_THAT(Fresnel(kQuietNaN).c, QuietNaN());
    EXPECT_THAT(Fresnel(kQuietNaN).s, QuietNaN());
}

TEST(FresnelIntegrals, AreOdd) {
    for (const double x : {0.0, 0.5, 1.7, 30.0, 36975.0}) {
        EXPECT_EQ(Fresnel(-x).c, -Fresnel(x).c);
        EXPECT_EQ(Fresnel(-x).s, -Fresnel(x).s);
    }
}

TEST(FresnelIntegrals, TakeEitherPointerAlone) {
    for (const double x : {0.5, 2.0, 40000.0, kInfinity, kQuietNaN}) {
        const Fresnel both(x);
        double c = kUntouched, s = kUntouched;
        KR_FresnelIntegrals(x, &c, nullptr);
        KR_FresnelIntegrals(x, nullptr, &s);
        KR_FresnelIntegrals(x, nullptr, nullptr);
        EXPECT_TRUE(SameBits(c, both.c)) << x;
        EXPECT_TRUE(SameBits(s, both.s)) << x;
    }
}

TEST(ExponentialIntegral, AgreesWithGoldenData) {
    ExpectGolden("exp_integral", [](const double* x) { return E(static_cast<int32_t>(x[0]), x[1]); },
                 {{"n = 0", 2 * kEpsilon},
                  {"series", 1e-15, 2e-15},
                  {"series, large n", 5 * kEpsilon},
                  {"fraction", 1e-14},
                  {"large n", 3e-15}});
}

TEST(ExponentialIntegral, ObeysItsRecurrence) {
    for (const double x : {0.1, 0.9, 1.0, 1.1, 5.0, 80.0}) {
        for (int32_t n = 1; n < 190; ++n) {
            EXPECT_THAT(n * E(n + 1, x) + x * E(n, x), Near(std::exp(-x), 1e-13)) << n << ' ' << x;
        }
    }
}

TEST(ExponentialIntegral, KnowsZero) {
    EXPECT_EQ(E(0, 0.0), kInfinity);
    EXPECT_EQ(E(1, 0.0), kInfinity);
    EXPECT_EQ(E(2, 0.0), 1.0);
    EXPECT_EQ(E(5, 0.0), 0.25);
    EXPECT_EQ(E(kIntMax, 0.0), 1.0 / 2147483646.0);
}

TEST(ExponentialIntegral, TellsOfItsLimits) {
    EXPECT_EQ(E(1, 709.79), 0.0);
    EXPECT_EQ(E(0, 1e308), 0.0);
    EXPECT_GT(E(1, 700.0), 0.0);
    EXPECT_THAT(E(-1, 1.0), QuietNaN());
    EXPECT_THAT(E(kIntMin, 1000.0), QuietNaN());
    EXPECT_THAT(E(1, -0.5), QuietNaN());
    for (const double x : {kInfinity, -kInfinity, kQuietNaN}) EXPECT_THAT(E(1, x), QuietNaN()) << x;
    EXPECT_THAT(E(kIntMax, 1.0), Near(std::exp(-1.0) / 2147483648.0, 1e-9));
}

TEST(ExponentialIntegral, MeetsItselfWhereItsBranchesDo) {
    EXPECT_THAT(E(5001, 2.0), Near(E(5000, 2.0), 3e-4));
    EXPECT_THAT(E(3, std::nextafter(1.0, 2.0)), Near(E(3, 1.0), 1e-14));
    EXPECT_THAT(E(171, 0.5), Near(E(170, 0.5), 1e-2));
}

TEST(SinIntegral, AgreesWithGoldenData) {
    ExpectGolden("sin_integral", [](const double* x) { return Value(KR_SinI, x[0]); },
                 {{"to 4", 3 * kEpsilon},
                  {"4 to 8", 3 * kEpsilon},
                  {"8 to 100", 3 * kEpsilon},
                  {"above 100", 3 * kEpsilon},
                  {"negative", 3 * kEpsilon}});
}

TEST(SinIntegral, KnowsItsLimits) {
    EXPECT_EQ(Value(KR_SinI, 0.0), 0.0);
    EXPECT_EQ(Value(KR_SinI, kInfinity), kPi / 2);
    EXPECT_EQ(Value(KR_SinI, -kInfinity), -kPi / 2);
    EXPECT_EQ(Value(KR_SinI, 1e300), kPi / 2);
    EXPECT_THAT(Value(KR_SinI, kQuietNaN), QuietNaN());
}

TEST(CosIntegral, AgreesWithGoldenData) {
    ExpectGolden("cos_integral", [](const double* x) { return Value(KR_CosI, x[0]); },
                 {{"to 4", 2e-15, 3e-16}, {"4 to 8", 0.0, 2e-16}, {"8 to 100", 0.0, 1e-16}, {"above 100", 1e-15}});
}

TEST(CosIntegral, IsTakenAtTheSizeOfItsArgument) {
    for (const double x : {0.5, 5.0, 50.0}) EXPECT_EQ(Value(KR_CosI, -x), Value(KR_CosI, x));
}

TEST(CosIntegral, KnowsItsLimits) {
    EXPECT_EQ(Value(KR_CosI, 0.0), -kInfinity);
    EXPECT_EQ(Value(KR_CosI, kInfinity), 0.0);
    EXPECT_THAT(Value(KR_CosI, -kInfinity), QuietNaN());
    EXPECT_THAT(Value(KR_CosI, kQuietNaN), QuietNaN());
    EXPECT_NEAR(Value(KR_CosI, 1e300), 0.0, 1e-300);
}

TEST(SinhIntegral, AgreesWithGoldenData) {
    ExpectGolden("sinh_integral", [](const double* x) { return Value(KR_SinhI, x[0]); },
                 {{"to 8", 3 * kEpsilon},
                  {"8 to 18", 4 * kEpsilon},
                  {"18 to 88", 4 * kEpsilon},
                  {"88 to 709", 1e-8},  // the series is fitted up to 88
                  {"negative", 4 * kEpsilon}});
}

TEST(SinhIntegral, KnowsItsLimits) {
    EXPECT_EQ(Value(KR_SinhI, 0.0), 0.0);
    EXPECT_EQ(Value(KR_SinhI, 720.0), kInfinity);
    EXPECT_EQ(Value(KR_SinhI, 880.0), kInfinity);
    EXPECT_EQ(Value(KR_SinhI, 881.0), kInfinity);
    EXPECT_EQ(Value(KR_SinhI, -881.0), -kInfinity);
    EXPECT_EQ(Value(KR_SinhI, kInfinity), kInfinity);
    EXPECT_EQ(Value(KR_SinhI, -kInfinity), -kInfinity);
    EXPECT_THAT(Value(KR_SinhI, kQuietNaN), QuietNaN());
}

TEST(CoshIntegral, AgreesWithGoldenData) {
    ExpectGolden("cosh_integral", [](const double* x) { return Value(KR_CoshI, x[0]); },
                 {{"to 8", 3 * kEpsilon, 2 * kEpsilon},
                  {"8 to 18", 4 * kEpsilon},
                  {"18 to 88", 4 * kEpsilon},
                  {"88 to 709", 2e-8}});
}

TEST(CoshIntegral, IsEven) {
    for (const double x : {0.5, 8.5, 50.0}) EXPECT_EQ(Value(KR_CoshI, -x), Value(KR_CoshI, x));
}

TEST(CoshIntegral, KnowsItsLimits) {
    EXPECT_EQ(Value(KR_CoshI, 0.0), -kInfinity);
    EXPECT_EQ(Value(KR_CoshI, 720.0), kInfinity);
    for (const double x : {880.0, 881.0, -881.0, kInfinity, -kInfinity}) EXPECT_EQ(Value(KR_CoshI, x), kInfinity);
    EXPECT_THAT(Value(KR_CoshI, kQuietNaN), QuietNaN());
}

}  // namespace
}  // namespace krnumer

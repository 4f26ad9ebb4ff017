#include "special/airy.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "krnumer/special.h"
#include "special/golden.h"
#include "special/values.h"
#include "support/numbers.h"

namespace krnumer {
namespace {

constexpr double kLargest = std::numeric_limits<double>::max();

struct Functions {
    explicit Functions(double x) { KR_Airy(x, &ai, &bi, &ai_prime, &bi_prime); }
    double ai = kUntouched, bi = kUntouched, ai_prime = kUntouched, bi_prime = kUntouched;
};

double H(double v, double x) {
    return Value(KR_Struve, x, v);
}

TEST(Airy, AgreesWithGoldenData) {
    const auto bounds = [](double near_zero, double positive, double negative, double far) {
        return std::vector<Bound>{{"-2.09 to 2.09", 0.0, near_zero},
                                  {"2.09 to 8.32", 1e-14},
                                  {"8.32 to 103", positive},
                                  {"-100 to -2.09", 0.0, negative},
                                  {"below -100", 0.0, far}};
    };
    ExpectGolden(
        "airy_ai", [](const double* x) { return Functions(x[0]).ai; }, bounds(2e-15, 3e-13, 1e-13, 1e-9));
    ExpectGolden(
        "airy_bi", [](const double* x) { return Functions(x[0]).bi; }, bounds(4e-15, 3e-13, 1e-13, 1e-9));
    ExpectGolden(
        "airy_ai_prime", [](const double* x) { return Functions(x[0]).ai_prime; }, bounds(3e-15, 3e-13, 1e-12, 1e-7));
    ExpectGolden(
        "airy_bi_prime", [](const double* x) { return Functions(x[0]).bi_prime; }, bounds(5e-15, 3e-13, 1e-12, 1e-7));
}

TEST(Airy, ObeysTheWronskian) {
    for (double x = -30.0; x < 90.0; x += 0.71) {
        const Functions f(x);
        EXPECT_THAT(kPi * (f.ai * f.bi_prime - f.ai_prime * f.bi), Near(1.0, 4e-13)) << x;
    }
}

TEST(Airy, EndsWhereBiOverflows) {
    for (const double x : {103.9, 200.0, 1e300, kInfinity}) {
        const Functions f(x);
        EXPECT_EQ(f.ai, 0.0);
        EXPECT_EQ(f.bi, kInfinity);
        EXPECT_EQ(f.ai_prime, kLargest);
        EXPECT_EQ(f.bi_prime, kLargest);
    }
    EXPECT_GT(Functions(103.892).ai, 0.0);
    EXPECT_TRUE(std::isfinite(Functions(103.892).bi));
}

TEST(Airy, KnowsItsLowerEnd) {
    const Functions f(-kInfinity);
    EXPECT_EQ(f.ai, 0.0);
    EXPECT_EQ(f.bi, 0.0);
    EXPECT_EQ(f.ai_prime, kLargest);
    EXPECT_EQ(f.bi_prime, kLargest);
    EXPECT_TRUE(std::isfinite(Functions(-1e200).ai));
    EXPECT_TRUE(std::isnan(Functions(-1e206).ai));  // its phase is infinite
}

TEST(Airy, IsNaNForNaN) {
    const Functions f(kQuietNaN);
    EXPECT_THAT(f.ai, QuietNaN());
    EXPECT_THAT(f.bi, QuietNaN());
    EXPECT_THAT(f.ai_prime, QuietNaN());
    EXPECT_THAT(f.bi_prime, QuietNaN());
}

TEST(Airy, WritesDerivativesOnlyWhereWanted) {
    for (const double x : {0.5, -5.0, 5.0, 20.0, 200.0, kQuietNaN}) {
        const Functions f(x);
        double ai = kUntouched, bi = kUntouched, bi_prime = kUntouched;
        KR_Airy(x, &ai, &bi, nullptr, &bi_prime);
        EXPECT_TRUE(SameBits(ai, f.ai));
        EXPECT_TRUE(SameBits(bi, f.bi));
        EXPECT_EQ(bi_prime, kUntouched);
        KR_Airy(x, &ai, &bi, nullptr, nullptr);
    }
}

TEST(Struve, AgreesWithGoldenData) {
    ExpectGolden("struve", [](const double* x) { return H(x[0], x[1]); },
                 {{"to 18", 1e-12, 5e-9},
                  {"18 to 30", 2e-9, 5e-9},
                  {"above 30", 1e-9, 1e-9},
                  {"large v", 1e-10},
                  {"negative x", 1e-12, 5e-9},
                  {"negative v", 1e-12, 5e-9},
                  {"negative half-integers", 0.0, 1e-12}});
}

TEST(Struve, TakesXFirst) {
    double out = kUntouched;
    KR_Struve(1.0, 0.0, &out);
    EXPECT_THAT(out, Near(0.56865662704828795, 1e-14));
}

TEST(Struve, FollowsTheParityOfIntegers) {
    for (const double x : {0.5, 20.0, 50.0, 200.0}) {
        EXPECT_EQ(H(0.0, -x), -H(0.0, x));
        EXPECT_EQ(H(1.0, -x), H(1.0, x));
        EXPECT_EQ(H(-3.0, -x), H(-3.0, x));
    }
    EXPECT_THAT(H(1.0, -50.0), Near(0.5800784479454417, 1e-10));
}

TEST(Struve, IsABesselFunctionForNegativeHalfIntegers) {
    for (const double x : {1.0, 7.5, 40.0}) {
        EXPECT_EQ(H(-0.5, x), Value(KR_BesselJr, 0.5, x));
        EXPECT_EQ(H(-1.5, x), -Value(KR_BesselJr, 1.5, x));
        EXPECT_EQ(H(-2.5, x), Value(KR_BesselJr, 2.5, x));
    }
}

TEST(Struve, KnowsItsLimits) {
    EXPECT_EQ(H(0.0, 0.0), 0.0);
    EXPECT_EQ(H(2.5, 0.0), 0.0);
    EXPECT_THAT(H(-1.0, 0.0), QuietNaN());
    EXPECT_THAT(H(-0.5, 0.0), QuietNaN());
    EXPECT_THAT(H(0.5, -1.0), QuietNaN());
    EXPECT_THAT(H(-0.5, -1.0), QuietNaN());
    EXPECT_TRUE(std::isfinite(H(170.0, 1.0)));
    EXPECT_THAT(H(170.2, 1.0), QuietNaN());  // Gamma overflows
    for (const double bad : {kInfinity, -kInfinity, kQuietNaN}) {
        EXPECT_THAT(H(1.0, bad), QuietNaN());
        EXPECT_THAT(H(bad, 1.0), QuietNaN());
    }
}

}  // namespace
}  // namespace krnumer

#include "special/elliptic.h"

#include <gtest/gtest.h>

#include <cmath>

#include "krnumer/special.h"
#include "special/golden.h"
#include "special/values.h"
#include "support/numbers.h"

namespace krnumer {
namespace {

constexpr double kHalfPi = 1.5707963267948966;

double K(double m) {
    return Value(KR_Elliptic1, m, kQuietNaN);
}
double E(double m) {
    return Value(KR_Elliptic2, m, kQuietNaN);
}
double F(double phi, double m) {
    return Value(KR_Elliptic1, m, phi);
}
double E(double phi, double m) {
    return Value(KR_Elliptic2, m, phi);
}

struct Jacobi {
    Jacobi(double u, double m) { KR_EllipticJ(u, m, &sn, &cn, &dn, &phi); }
    double sn = kUntouched, cn = kUntouched, dn = kUntouched, phi = kUntouched;
};

TEST(EllipticK, AgreesWithGoldenData) {
    // From 1 - m = 7e-6 down only the logarithm is left, whose error is of the size of (1 - m) ln(1 - m).
    ExpectGolden("elliptic_k", [](const double* x) { return K(x[0]); },
                 {{"0 to 0.9", 2 * kEpsilon}, {"0.9 to 1 - 7e-6", 2 * kEpsilon}, {"from 1 - 7e-6", 1.6e-6}});
}

TEST(EllipticK, KnowsItsLimits) {
    EXPECT_THAT(K(0.0), WithinUlps(kHalfPi, 1));
    EXPECT_EQ(K(1.0), kInfinity);
    for (const double m : {-1e-300, std::nextafter(1.0, 2.0), kInfinity, -kInfinity, kQuietNaN}) {
        EXPECT_THAT(K(m), QuietNaN()) << m;
    }
}

TEST(EllipticE, AgreesWithGoldenData) {
    ExpectGolden("elliptic_e", [](const double* x) { return E(x[0]); },
                 {{"0 to 0.9", 2 * kEpsilon}, {"0.9 to 1 - 7e-6", 2 * kEpsilon}, {"from 1 - 7e-6", 2 * kEpsilon}});
}

TEST(EllipticE, KnowsItsLimits) {
    EXPECT_THAT(E(0.0), WithinUlps(kHalfPi, 1));
    EXPECT_EQ(E(1.0), 1.0);
    for (const double m : {-0.1, 1.1, kInfinity, -kInfinity, kQuietNaN}) EXPECT_THAT(E(m), QuietNaN()) << m;
}

TEST(EllipticF, AgreesWithGoldenData) {
    ExpectGolden("elliptic_f_phi", [](const double* x) { return F(x[0], x[1]); },
                 {{"quarter period", 4 * kEpsilon},
                  {"several periods", 4 * kEpsilon},
                  {"many periods", 3 * kEpsilon},
                  {"m near 1", 4 * kEpsilon},
                  {"m near 1, several periods", 1.6e-6},
                  {"m = 0", 2 * kEpsilon}});
}

TEST(EllipticF, IsAMultipleOfTheQuarterPeriod) {
    const double quarter = K(0.5);
    for (int k = 1; k < 10; ++k) {
        EXPECT_THAT(F(k * kHalfPi, 0.5), Near(k * quarter, 2 * kEpsilon)) << k;
        EXPECT_EQ(F(-k * kHalfPi, 0.5), -F(k * kHalfPi, 0.5));
    }
    EXPECT_THAT(F(std::nextafter(kHalfPi, 0.0), 0.5), Near(quarter, 4 * kEpsilon));
}

// Where F = K / 2, tan^2 phi sqrt(1 - m) is 1, and a step of the Landen transformation meets a quarter period. For some
// of these doubles it does so exactly.
TEST(EllipticF, CrossesHalfTheQuarterPeriod) {
    for (const double m : {0.123, 0.25, 0.3, 0.5, 0.9}) {
        const double complement = std::sqrt(1.0 - m), middle = std::atan(1.0 / std::sqrt(std::sqrt(1.0 - m)));
        for (int i = -40; i <= 40; ++i) {
            const double phi = middle + i * 0x1p-53;
            EXPECT_THAT(F(phi, m), Near(K(m) / 2, 3e-14)) << phi << " " << m;
            EXPECT_THAT(E(phi, m), Near((E(m) + 1.0 - complement) / 2, 3e-14)) << phi << " " << m;
        }
    }
}

TEST(EllipticF, IsInfiniteForMOfOneBeyondAQuarter) {
    EXPECT_THAT(F(1.0, 1.0), Near(std::log(std::tan(0.5 + kHalfPi / 2)), 1e-15));
    EXPECT_EQ(F(-1.0, 1.0), -F(1.0, 1.0));
    for (const double phi : {kHalfPi, 1.6, 3.0, 3 * kHalfPi, 100.0}) {
        EXPECT_EQ(F(phi, 1.0), kInfinity) << phi;
        EXPECT_EQ(F(-phi, 1.0), -kInfinity) << phi;
    }
}

TEST(EllipticF, KnowsItsLimits) {
    EXPECT_EQ(F(0.0, 0.5), 0.0);
    EXPECT_EQ(F(1.25, 0.0), 1.25);
    for (const double bad : {kInfinity, -kInfinity}) {
        EXPECT_THAT(F(bad, 0.5), QuietNaN());
        EXPECT_THAT(F(bad, 0.0), QuietNaN());
        EXPECT_THAT(F(1.0, bad), QuietNaN());
    }
    EXPECT_THAT(F(1.0, -0.1), QuietNaN());
    EXPECT_THAT(F(1.0, 1.1), QuietNaN());
    EXPECT_TRUE(std::isfinite(F(3e9, 0.5)));
    EXPECT_THAT(F(4e9, 0.5), QuietNaN());
    EXPECT_THAT(F(-1e300, 1.0), QuietNaN());
}

TEST(EllipticEOfPhi, AgreesWithGoldenData) {
    // It stands on K(m), so that the latter's error shows near m = 1.
    ExpectGolden("elliptic_e_phi", [](const double* x) { return E(x[0], x[1]); },
                 {{"quarter period", 8 * kEpsilon},
                  {"several periods", 6 * kEpsilon},
                  {"many periods", 4 * kEpsilon},
                  {"m near 1", 6e-7},
                  {"m near 1, several periods", 2e-6},
                  {"m = 0", 0.0}});
}

TEST(EllipticEOfPhi, IsAMultipleOfTheQuarterPeriod) {
    for (const int k : {1, 2, 3, 4, 7}) {
        EXPECT_THAT(E(k * kHalfPi, 0.5), Near(k * E(0.5), 2 * kEpsilon));
        EXPECT_EQ(E(-k * kHalfPi, 0.5), -E(k * kHalfPi, 0.5));
    }
}

TEST(EllipticEOfPhi, FollowsTheSineForMOfOne) {
    EXPECT_EQ(E(1.0, 1.0), std::sin(1.0));
    EXPECT_THAT(E(2.0, 1.0), Near(2.0 - std::sin(2.0), 1e-15));
    EXPECT_THAT(E(-7.0, 1.0), Near(-4.0 - std::sin(7.0), 1e-15));
}

TEST(EllipticEOfPhi, KnowsItsLimits) {
    EXPECT_EQ(E(0.0, 0.5), 0.0);
    EXPECT_EQ(E(1e300, 0.0), 1e300);
    EXPECT_THAT(E(1.0, -0.1), QuietNaN());
    EXPECT_THAT(E(1.0, 1.1), QuietNaN());
    EXPECT_THAT(E(kInfinity, 0.5), QuietNaN());
    EXPECT_THAT(E(-kInfinity, 0.0), QuietNaN());
    EXPECT_THAT(E(1.0, kInfinity), QuietNaN());
    EXPECT_TRUE(std::isfinite(E(3e9, 0.5)));
    EXPECT_THAT(E(4e9, 0.5), QuietNaN());
    EXPECT_THAT(E(-4e9, 1.0), QuietNaN());
}

TEST(JacobiElliptic, AgreesWithGoldenData) {
    ExpectGolden("jacobi_sn", [](const double* x) { return Jacobi(x[0], x[1]).sn; },
                 {{"quarter period", 4 * kEpsilon},
                  {"several periods", 0.0, 1e-14},
                  {"m near 0", 0.0, 5 * kEpsilon},
                  {"m near 1", 3 * kEpsilon},
                  {"m at 1", 3 * kEpsilon}});
    ExpectGolden("jacobi_cn", [](const double* x) { return Jacobi(x[0], x[1]).cn; },
                 {{"quarter period", 0.0, 6 * kEpsilon},
                  {"several periods", 0.0, 1e-14},
                  {"m near 0", 0.0, 5 * kEpsilon},
                  {"m near 1", 0.0, 1e-14},
                  {"m at 1", 2e-15}});
    ExpectGolden("jacobi_dn", [](const double* x) { return Jacobi(x[0], x[1]).dn; },
                 {{"quarter period", 0.0, 1e-14},
                  {"several periods", 0.0, 1e-14},
                  {"m near 0", 0.0, 1e-14},
                  {"m near 1", 0.0, 1e-14},
                  {"m at 1", 2e-15}});
    ExpectGolden("jacobi_am", [](const double* x) { return Jacobi(x[0], x[1]).phi; },
                 {{"quarter period", 5 * kEpsilon},
                  {"several periods", 5 * kEpsilon},
                  {"m near 0", 3 * kEpsilon},
                  {"m near 1", 1e-14},
                  {"m at 1", 1e-14}});
}

TEST(JacobiElliptic, ObeysItsIdentities) {
    for (double m = 0.0; m <= 1.0; m += 0.0625) {
        for (double u = -8.0; u <= 8.0; u += 0.37) {
            const Jacobi f(u, m);
            EXPECT_NEAR(f.sn * f.sn + f.cn * f.cn, 1.0, 1e-14) << u << ' ' << m;
            EXPECT_NEAR(f.dn * f.dn + m * f.sn * f.sn, 1.0, 3e-14) << u << ' ' << m;
            EXPECT_NEAR(std::sin(f.phi), f.sn, 1e-14) << u << ' ' << m;
        }
    }
}

TEST(JacobiElliptic, IsOddOrEven) {
    for (const double m : {1e-12, 1e-6, 0.05, 0.5, 0.95, 0.9999}) {
        for (const double u : {0.0, 5e-324, 1e-9, 0.7, 2.0, 31.4, 1e6}) {
            const Jacobi f(u, m), reflected(-u, m);
            EXPECT_EQ(reflected.sn, -f.sn) << u << ' ' << m;
            EXPECT_EQ(reflected.cn, f.cn) << u << ' ' << m;
            EXPECT_EQ(reflected.dn, f.dn) << u << ' ' << m;
            EXPECT_EQ(reflected.phi, -f.phi) << u << ' ' << m;
            EXPECT_TRUE(std::signbit(reflected.phi)) << u << ' ' << m;
        }
    }
}

TEST(JacobiElliptic, InvertsTheIntegral) {
    for (const double m : {0.1, 0.5, 0.9}) {
        for (const double phi : {0.2, 1.0, 2.5, -4.0}) EXPECT_THAT(Jacobi(F(phi, m), m).phi, Near(phi, 2e-14));
    }
}

TEST(JacobiElliptic, EndsInHyperbolicFunctions) {
    for (const double u : {0.1, 3.0, -40.0, 354.0}) {
        EXPECT_THAT(Jacobi(u, 1.0).sn, Near(std::tanh(u), kEpsilon));
        EXPECT_THAT(Jacobi(u, 1.0).cn, Near(1.0 / std::cosh(u), kEpsilon));
    }
    for (const double u : {356.0, 800.0, 1e300}) {
        for (const double sign : {1.0, -1.0}) {
            const Jacobi f(sign * u, 0.9999999999);
            EXPECT_EQ(f.sn, sign);
            EXPECT_EQ(f.cn, 0.0);
            EXPECT_EQ(f.dn, 0.0);
            EXPECT_NEAR(f.phi, sign * kHalfPi, 1e-9);
        }
    }
}

TEST(JacobiElliptic, IsZeroOutsideItsDomain) {
    for (const double m : {-1e-300, 1.5}) {
        const Jacobi f(1.0, m);
        EXPECT_EQ(f.sn, 0.0);
        EXPECT_EQ(f.cn, 0.0);
        EXPECT_EQ(f.dn, 0.0);
        EXPECT_EQ(f.phi, 0.0);
    }
}

TEST(JacobiElliptic, IsNaNWhereItsArgumentsAreNotFinite) {
    for (const double bad : {kInfinity, -kInfinity, kQuietNaN}) {
        for (const Jacobi& f : {Jacobi(bad, 0.5), Jacobi(0.5, bad)}) {
            EXPECT_THAT(f.sn, QuietNaN());
            EXPECT_THAT(f.cn, QuietNaN());
            EXPECT_THAT(f.dn, QuietNaN());
            EXPECT_THAT(f.phi, QuietNaN());
        }
    }
}

TEST(JacobiElliptic, NeedsNoAmplitude) {
    for (const double m : {0.5, 0.0, 1.0, -1.0, kQuietNaN}) {
        const Jacobi f(1.5, m);
        double sn = kUntouched, cn = kUntouched, dn = kUntouched;
        KR_EllipticJ(1.5, m, &sn, &cn, &dn, nullptr);
        EXPECT_TRUE(SameBits(sn, f.sn));
        EXPECT_TRUE(SameBits(cn, f.cn));
        EXPECT_TRUE(SameBits(dn, f.dn));
    }
}

}  // namespace
}  // namespace krnumer

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "filter/cascade_response.h"
#include "filter/elliptic_function.h"
#include "filter/iir_design.h"
#include "frame/numeric.h"
#include "frame/status.h"
#include "krnumer/filter.h"
#include "support/host_arrays.h"

namespace krnumer {
namespace {

enum Family : int32_t { kButterworth, kBessel, kChebyshev, kInverseChebyshev, kElliptic };
constexpr Family kFamilies[] = {kButterworth, kBessel, kChebyshev, kInverseChebyshev, kElliptic};

struct DesignReference {
    struct Point {
        double frequency;
        Complex response;
    };

    int32_t family, type, order;
    double fl, fh, ripple, attenuation;
    std::vector<Point> points;
};

#include "reference/filter/iir_design.inc"

// One design, by the entry point of its family.
struct Design {
    double fs = 1000.0, fl = 100.0, fh = 200.0, ripple = 1.0, attenuation = 40.0;
    int32_t order = 4, type = 0;
    int32_t err = 77;
    HostArray<double> a{9, 9}, b{9, 9, 9};

    int32_t Make(int32_t family) {
        const KrHandle ha = a.handle(), hb = b.handle();
        switch (family) {
            case kButterworth:
                return BWCoefs(&fs, &fl, &fh, &order, &type, ha, hb, &err);
            case kBessel:
                return BesselCoefs(&fs, &fl, &fh, &order, &type, ha, hb, &err);
            case kChebyshev:
                return ChebyshevCoefs(&fs, &fl, &fh, &ripple, &order, &type, ha, hb, &err);
            case kInverseChebyshev:
                return InvChebyshevCoefs(&fs, &fl, &fh, &attenuation, &order, &type, ha, hb, &err);
            default:
                return EllipticCoefs(&fs, &fl, &fh, &ripple, &attenuation, &order, &type, ha, hb, &err);
        }
    }

    // The code of a design that leaves its outputs empty and its result 0.
    int32_t Refusal(int32_t family) {
        EXPECT_EQ(Make(family), 0);
        EXPECT_TRUE(a.empty() && b.empty());
        return err;
    }

    Complex Response(double frequency) const { return CascadeResponse(a.values(), b.values(), frequency / fs); }
    double Decibels(double frequency) const { return 20.0 * std::log10(Modulus(Response(frequency))); }
};

class IirDesign : public testing::TestWithParam<Family> {
  protected:
    LeakCheck leaks_;
    Family family_ = GetParam();
};
INSTANTIATE_TEST_SUITE_P(Families, IirDesign, testing::ValuesIn(kFamilies),
                         [](const auto& family) { return std::to_string(family.param); });

TEST_P(IirDesign, RespondsAsTheReference) {
    int32_t compared = 0;
    for (const DesignReference& reference : kDesigns) {
        if (reference.family != family_) continue;
        Design design;
        design.fl = reference.fl;
        design.fh = reference.fh;
        design.ripple = reference.ripple;
        design.attenuation = reference.attenuation;
        design.order = reference.order;
        design.type = reference.type;
        ASSERT_EQ(design.Make(family_), 0);
        ASSERT_EQ(design.err, kOk);
        for (const auto& [frequency, response] : reference.points)
            EXPECT_THAT(design.Response(frequency), Near(response, 0.0, 1e-9))
                << "type " << design.type << ", order " << design.order << ", at " << frequency;
        ++compared;
    }
    EXPECT_EQ(compared, 80);
}

// Every pole inside the unit circle, by the recursion of Schur and Cohn on each section.
TEST_P(IirDesign, IsStable) {
    for (int32_t type = 0; type < 4; ++type) {
        for (int32_t order = 1; order <= 20; ++order) {
            for (const auto& [fl, fh] : {std::pair{0.1, 499.0}, {20.0, 25.0}, {249.0, 251.0}, {480.0, 495.0}}) {
                Design design;
                design.type = type;
                design.order = order;
                design.fl = fl;
                design.fh = fh;
                ASSERT_EQ(design.Make(family_), 0);
                ASSERT_EQ(design.err, kOk);
                const int32_t m = type < 2 ? 2 : 4;
                const std::vector<double> a = design.a.values();
                for (std::size_t k = 0; k < a.size(); k += static_cast<std::size_t>(m))
                    EXPECT_TRUE(IsStableSection(&a[k], m))
                        << "type " << type << ", order " << order << ", edges " << fl << ", " << fh << ", section "
                        << k / static_cast<std::size_t>(m);
            }
        }
    }
}

TEST_P(IirDesign, SizesTheCoefficients) {
    for (int32_t order = 1; order <= 9; ++order) {
        for (int32_t type = 0; type < 4; ++type) {
            Design design;
            design.order = order;
            design.type = type;
            design.Make(family_);
            const int32_t sections = (order + 1) / 2, m = type < 2 ? 2 : 4;
            EXPECT_EQ(design.a.size(), m * sections);
            EXPECT_EQ(design.b.size(), (m + 1) * sections);
            if (order % 2 == 0) continue;
            for (int32_t i = m / 2; i < m; ++i) {
                EXPECT_TRUE(SameBits(design.a[i], 0.0));
                EXPECT_TRUE(SameBits(design.b[i + 1], 0.0));
            }
        }
    }
}

TEST_P(IirDesign, DoesNotLookAtTheUpperEdgeOfOneCutoff) {
    for (const int32_t type : {0, 1}) {
        Design design, other;
        design.type = other.type = type;
        other.fh = -std::numeric_limits<double>::infinity();
        design.Make(family_);
        other.Make(family_);
        EXPECT_EQ(other.err, kOk);
        EXPECT_THAT(other.a.values(), SameBitsAs(design.a.values()));
        EXPECT_THAT(other.b.values(), SameBitsAs(design.b.values()));
        EXPECT_EQ(other.fh, -std::numeric_limits<double>::infinity());
    }
}

TEST_P(IirDesign, TakesACutoffAtHalfTheSamplingFrequency) {
    for (int32_t type = 0; type < 4; ++type) {
        Design design;
        design.type = type;
        design.fl = type < 2 ? 500.0 : 100.0;
        design.fh = 500.0;
        EXPECT_EQ(design.Make(family_), 0);
        EXPECT_EQ(design.err, kOk);
        for (const double coefficient : design.a.values()) EXPECT_TRUE(std::isfinite(coefficient));
        for (const double coefficient : design.b.values()) EXPECT_TRUE(std::isfinite(coefficient));
    }
}

TEST_P(IirDesign, RefusesInAFixedOrder) {
    constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
    Design design;
    design.order = 0;
    design.fl = design.ripple = design.attenuation = -1.0;
    design.fs = 0.0;
    design.type = 7;
    EXPECT_EQ(design.Refusal(family_), kBadOrder);
    for (const int32_t order : {-1, -2, -3, std::numeric_limits<int32_t>::min()}) {
        design.order = order;
        for (const int32_t type : {0, 3}) {
            design.type = type;
            EXPECT_EQ(design.Refusal(family_), kBadOrder);
        }
    }
    design.type = 7;
    design.order = 3;
    for (const double fl : {-1.0, 0.0, kNaN}) {
        design.fl = fl;
        EXPECT_EQ(design.Refusal(family_), kBadFrequency);
    }
    design.fl = 600.0;
    for (const double fh : {-1.0, 0.0, 600.0, 599.0, kNaN}) {
        design.fh = fh;
        EXPECT_EQ(design.Refusal(family_), kBadFrequency);
    }
    design.fh = 700.0;
    for (const double fs : {-1000.0, 0.0, kNaN}) {
        design.fs = fs;
        EXPECT_EQ(design.Refusal(family_), kBadFrequency);
    }
    design.fs = 1000.0;
    EXPECT_EQ(design.Refusal(family_), kCutoffAboveNyquist);
    design.fl = 100.0;
    EXPECT_EQ(design.Refusal(family_), kCutoffAboveNyquist);
    design.fh = 200.0;
    if (family_ == kChebyshev || family_ == kElliptic) {
        for (const double ripple : {-1.0, 0.0, kNaN}) {
            design.ripple = ripple;
            EXPECT_EQ(design.Refusal(family_), kBadRipple);
        }
        design.ripple = 1.0;
    }
    if (family_ == kInverseChebyshev || family_ == kElliptic) {
        for (const double attenuation : {-1.0, 0.0, kNaN}) {
            design.attenuation = attenuation;
            EXPECT_EQ(design.Refusal(family_), kBadAttenuation);
        }
        design.attenuation = 0.5;
    }
    if (family_ == kElliptic) {
        for (const double attenuation : {0.5, 1.0}) {
            design.attenuation = attenuation;
            EXPECT_EQ(design.Refusal(family_), kAttenuationBelowRipple);
        }
        design.attenuation = 2.0;
    }
    for (const int32_t type : {7, 4, -1, std::numeric_limits<int32_t>::min(), std::numeric_limits<int32_t>::max()}) {
        design.type = type;
        EXPECT_EQ(design.Refusal(family_), kBadSelector);
    }
}

TEST_P(IirDesign, RefusesACutoffAboveHalfTheSamplingFrequencyInEveryType) {
    for (int32_t type = 0; type < 4; ++type) {
        Design design;
        design.type = type;
        design.fl = 500.1;
        design.fh = 500.2;
        EXPECT_EQ(design.Refusal(family_), kCutoffAboveNyquist);
    }
}

// A number that is no type has the sizes of two edges, and an upper edge that is looked at.
TEST_P(IirDesign, SizesBeforeItChecks) {
    for (const int32_t type : {7, -1}) {
        Design design;
        design.type = type;
        ResizeLog log;
        EXPECT_EQ(design.Refusal(family_), kBadSelector);
        ASSERT_EQ(log.size(), 4);
        EXPECT_EQ(log[0].totalElements, 8);
        EXPECT_EQ(log[1].totalElements, 10);
        EXPECT_EQ(log[2].totalElements, 0);
        EXPECT_EQ(log[3].totalElements, 0);
    }
    Design design;
    design.type = -1;
    design.fh = 50.0;
    EXPECT_EQ(design.Refusal(family_), kBadFrequency);
}

TEST_P(IirDesign, HandsOnTheHostsRefusal) {
    for (const int32_t nth : {1, 2}) {
        Design design;
        design.type = 7;  // comes too late to be noticed
        const FailResize failure(nth, 4711);
        EXPECT_EQ(design.Make(family_), 4711);
        EXPECT_EQ(design.err, kOutOfMemory);
        EXPECT_TRUE(design.a.empty() && design.b.empty());
    }
}

TEST_P(IirDesign, RefusesAnOrderWhoseCoefficientsNoArrayHolds) {
    Design design;
    for (const int32_t type : {0, 2}) {
        design.type = type;
        for (const int32_t order : {std::numeric_limits<int32_t>::max(), 1500000000}) {
            design.order = order;
            EXPECT_EQ(design.Refusal(family_), kOutOfMemory);
        }
    }
}

TEST(IirDesign, PassesDirectCallsOnlyWithRoomForTheCoefficients) {
    double a[8], b[10];
    for (int32_t type = 0; type < 4; ++type) {
        const FilterBand band{1000.0, 100.0, 200.0, 3, type};
        const CascadeLengths lengths = LengthsOf(band.order, type);
        const int32_t na = static_cast<int32_t>(lengths.a), nb = static_cast<int32_t>(lengths.b);
        EXPECT_EQ(ButterworthDesign(band, {a, na, b, nb}), kOk);
        EXPECT_EQ(ButterworthDesign(band, {a, na - 1, b, nb}), kBadCoefficientCount);
        EXPECT_EQ(EllipticDesign(band, 1.0, 40.0, {a, na, b, nb - 1}), kBadCoefficientCount);
    }
}

TEST(IirDesign, HalvesAtAQuarterOfTheSamplingFrequency) {
    Design design;
    design.fs = 4.0;
    design.fl = 1.0;
    design.order = 1;
    design.Make(kButterworth);
    EXPECT_THAT(design.a.values(), AllNear({0.0, 0.0}, 0.0, 1e-16));
    EXPECT_THAT(design.b.values(), AllNear({0.5, 0.5, 0.0}, 1e-15));
}

TEST(IirDesign, BringsTheEdgesToTheirStatedLevel) {
    for (int32_t type = 0; type < 4; ++type) {
        for (int32_t order = 1; order <= 11; ++order) {
            Design design;
            design.type = type;
            design.order = order;
            for (const double edge : {100.0, 200.0}) {
                if (type < 2 && edge == 200.0) continue;
                design.Make(kButterworth);
                EXPECT_NEAR(design.Decibels(edge), -10.0 * std::log10(2.0), 1e-9);
                design.Make(kChebyshev);
                const bool butterworth = type >= 2 && order == 1;
                EXPECT_NEAR(design.Decibels(edge), butterworth ? -10.0 * std::log10(2.0) : -1.0, 1e-8);
                design.Make(kInverseChebyshev);
                EXPECT_NEAR(design.Decibels(edge), -40.0, 1e-8);
                design.Make(kElliptic);
                EXPECT_NEAR(design.Decibels(edge), -1.0, 1e-7);
            }
        }
    }
}

// Neither bound is passed anywhere, and the even orders start at the lower bound of the ripple.
TEST(IirDesign, KeepsWithinItsRipples) {
    for (int32_t order = 1; order <= 12; ++order) {
        for (const Family family : {kChebyshev, kElliptic}) {
            Design design;
            design.order = order;
            design.Make(family);
            EXPECT_NEAR(design.Decibels(0.0), order % 2 == 0 ? -1.0 : 0.0, 1e-9);
            for (double f = 0.5; f < 100.0; f += 0.5) {
                EXPECT_LT(design.Decibels(f), 1e-8);
                EXPECT_GT(design.Decibels(f), -1.0 - 1e-8);
            }
        }
        Design design;
        design.order = order;
        design.Make(kInverseChebyshev);
        for (double f = 100.0; f < 500.0; f += 0.5) EXPECT_LT(design.Decibels(f), -40.0 + 1e-8);
    }
}

TEST(EllipticFunction, AgreesWithTables) {
    // M. Abramowitz, I. Stegun, tables 17.1 and 17.5, and 16.4 worked out to the last digit.
    EXPECT_THAT(CompleteK(std::sqrt(0.5)), Near(1.8540746773013719, 1e-15));
    EXPECT_THAT(CompleteK(1.0), Near(kPi / 2.0, 1e-15));
    EXPECT_THAT(CompleteK(0.1), Near(3.6956373629898747, 1e-15));
    // At the modulus sqrt(1/2) both periods are equal.
    EXPECT_THAT(ModulusFromRatio(1.0), Near(std::sqrt(0.5), 1e-15));
    EXPECT_EQ(ModulusFromRatio(0.0), 1.0);
    // An amplitude of pi/2 gives the complete integral.
    EXPECT_THAT(IncompleteEl1(1e300, 0.1), Near(CompleteK(0.1), 1e-14));
    EXPECT_THAT(IncompleteEl1(1.0, 1.0), Near(kPi / 4.0, 1e-14));
}

TEST(EllipticFunction, KeepsItsIdentities) {
    EXPECT_EQ(JacobiSnCnDn(0.0, 0.3).cn, 1.0);
    for (const double complementary : {1.0, 0.999, 0.6, 0.1, 1e-3, 1e-8}) {
        const double modulus_square = 1.0 - complementary * complementary;
        const double quarter = CompleteK(complementary);
        for (const double part : {0.01, 0.2, 0.5, 0.9, 1.0, 1.3}) {
            const JacobiValues u = JacobiSnCnDn(part * quarter, complementary);
            EXPECT_THAT(u.sn * u.sn + u.cn * u.cn, Near(1.0, 1e-14));
            EXPECT_THAT(u.dn * u.dn + modulus_square * u.sn * u.sn, Near(1.0, 1e-13));
            if (part < 1.0) {
                EXPECT_THAT(IncompleteEl1(u.sn / u.cn, complementary), Near(part * quarter, 1e-12));
            }
        }
    }
}

// Moduli out of all reason end the iterations, not the process.
TEST(EllipticFunction, EndsAtEveryArgument) {
    for (const double x : {0.0, -1.0, kInfinity, kQuietNaN, 1e-320}) {
        CompleteK(x);
        JacobiSnCnDn(0.5, x);
        JacobiSnCnDn(x, 0.5);
        IncompleteEl1(x, 0.5);
        IncompleteEl1(0.5, x);
        ModulusFromRatio(x);
    }
    Design design;
    design.attenuation = 1e308;
    for (const double ripple : {1e-300, 1.0, 4000.0}) {
        design.ripple = ripple;
        EXPECT_EQ(design.Make(kElliptic), 0);
        EXPECT_EQ(design.err, kOk);
    }
}

}  // namespace
}  // namespace krnumer

#include "filter/fir_design.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "filter/cascade_response.h"
#include "filter/equiripple.h"
#include "filter/fir_reference.h"
#include "frame/numeric.h"
#include "frame/status.h"
#include "krnumer/filter.h"
#include "support/host_arrays.h"

namespace krnumer {
namespace {

struct FirReference {
    int32_t type, taps;
    double fl, fh;
    std::vector<double> half;
};
struct EquirippleReference {
    int32_t type, taps;
    std::vector<KrFirBand> bands;
    std::vector<double> half;
};

#include "reference/filter/fir_design.inc"

constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();

// ---- Cut off, without a window --------------------------------------------------------------------------------------

struct Truncated {
    double fs = 1000.0, fl = 100.0, fh = 200.0;
    int32_t taps = 7, type = 0, err = 77;
    HostArray<double> h{9.0, 9.0};

    int32_t Make() { return FIRCoefs(&fs, &fl, &fh, &taps, h.handle(), &type, &err); }
    int32_t Refusal() {
        EXPECT_EQ(Make(), 0);
        EXPECT_TRUE(h.empty());
        return err;
    }
};

TEST(FirCoefs, AgreesWithTheReference) {
    for (const FirReference& reference : kTruncated) {
        Truncated design;
        design.type = reference.type;
        design.taps = reference.taps;
        design.fl = reference.fl;
        design.fh = reference.fh;
        EXPECT_EQ(design.Make(), 0);
        EXPECT_EQ(design.err, kOk);
        EXPECT_THAT(design.h.values(), AllNear(Mirrored(reference.half, reference.taps, 1.0), 0.0, 1e-13));
    }
}

TEST(FirCoefs, OfOneTapIsTheWidthOfTheBand) {
    Truncated design;
    design.taps = 1;
    const double expected[] = {0.2, 0.8, 0.2, 0.8};
    for (design.type = 0; design.type < 4; ++design.type) {
        design.Make();
        ASSERT_EQ(design.h.size(), 1);
        EXPECT_THAT(design.h[0], Near(expected[design.type], 1e-15));
    }
}

// The width of the band times 1 / pi, formed as that: the middle tap has no other rounding.
TEST(FirCoefs, HasTheWidthOfTheBandInTheMiddle) {
    Truncated design;
    for (int32_t fl = 1; fl < 250; ++fl) {
        design.fl = fl;
        design.fh = 2.0 * fl - 0.5;
        const double width = 2.0 * kPi * design.fh / 1000.0 - 2.0 * kPi * design.fl / 1000.0;
        design.type = 2;
        design.Make();
        EXPECT_EQ(design.h[3], width * 0.3183098861837907);
        design.type = 3;
        design.Make();
        EXPECT_EQ(design.h[3], 1.0 - width * 0.3183098861837907);
    }
}

TEST(FirCoefs, DoesNotLookAtTheUpperEdgeOfOneCutoff) {
    Truncated design;
    design.fh = -kInfinity;
    for (design.type = 0; design.type < 2; ++design.type) {
        design.Make();
        EXPECT_EQ(design.err, kOk);
        for (const double tap : design.h.values()) EXPECT_TRUE(std::isfinite(tap));
    }
}

TEST(FirCoefs, RefusesInAFixedOrder) {
    Truncated design;
    design.taps = 0;
    design.type = 4;
    design.fl = 600.0;
    EXPECT_EQ(design.Refusal(), kBadOrder);
    design.taps = -5;
    EXPECT_EQ(design.Refusal(), kBadOrder);
    design.taps = 4;
    for (const int32_t type : {4, -1, std::numeric_limits<int32_t>::min()}) {
        design.type = type;
        EXPECT_EQ(design.Refusal(), kBadSelector);
    }
    design.type = 3;
    design.fh = -1.0;
    EXPECT_EQ(design.Refusal(), kCutoffAboveNyquist);
    design.fl = -1.0;
    design.fh = 501.0;
    EXPECT_EQ(design.Refusal(), kCutoffAboveNyquist);
    design.fs = 0.0;
    design.fl = 1.0;
    EXPECT_EQ(design.Refusal(), kCutoffAboveNyquist);  // above half of nothing
    design.fl = design.fh = 0.0;
    EXPECT_EQ(design.Refusal(), kBadFrequency);
    design.fs = kNaN;
    EXPECT_EQ(design.Refusal(), kBadFrequency);
    design.fs = 1000.0;
    for (const double fl : {-1.0, 0.0, kNaN}) {
        design.fl = fl;
        design.fh = 200.0;
        EXPECT_EQ(design.Refusal(), kBadFrequency);
    }
    design.fl = 100.0;
    for (const double fh : {-1.0, 0.0, 100.0, 99.0, kNaN}) {
        design.fh = fh;
        EXPECT_EQ(design.Refusal(), kBadFrequency);
    }
    design.fh = 200.0;
    EXPECT_EQ(design.Refusal(), kEvenLength);
    design.type = 1;
    EXPECT_EQ(design.Refusal(), kEvenLength);
    design.type = 2;
    design.Make();
    EXPECT_EQ(design.err, kOk);
}

TEST(FirCoefs, HandsOnTheHostsRefusal) {
    Truncated design;
    design.type = 4;  // comes too late to be noticed
    const FailResize failure(1, 4711);
    EXPECT_EQ(design.Make(), 4711);
    EXPECT_EQ(design.err, kOutOfMemory);
    EXPECT_TRUE(design.h.empty());
}

TEST(FirCoefs, TellsDirectCallsOfTooFewTaps) {
    EXPECT_EQ(TruncatedIdealDesign(1.0, 0.1, 0.2, 0, nullptr, 0), kBadOrder);
    EXPECT_EQ(TruncatedIdealDesign(1.0, 0.1, 0.2, 9, nullptr, 0), kBadSelector);
}

// ---- Equiripple -----------------------------------------------------------------------------------------------------

struct Equiripple {
    int32_t taps = 21;
    double fs = 1000.0;
    std::vector<KrFirBand> bands{{1.0, 0.0, 100.0, 1.0}, {0.0, 150.0, 500.0, 5.0}};
    int32_t type = 0, iterations = 0;
    double ripple = -1.0;
    int32_t err = 77;
    HostArray<double> h{9.0, 9.0};

    int32_t Make() {
        const HostArray<KrFirBand> records(bands);
        return Parks(&taps, &fs, records.handle(), &type, h.handle(), &ripple, &iterations, &err);
    }
    int32_t Refusal(int32_t result = 0) {
        ripple = -1.0;
        EXPECT_EQ(Make(), result);
        EXPECT_TRUE(h.empty());
        EXPECT_TRUE(IsQuietNaN(ripple));
        return err;
    }

    // Response without its linear phase: real, and with the sign of the desired one.
    double Response(double f) const {
        const std::vector<double> taps_now = h.values();
        double sum = 0.0;
        const double middle = (static_cast<double>(taps_now.size()) - 1.0) / 2.0;
        for (std::size_t i = 0; i < taps_now.size(); ++i) {
            const double angle = 2.0 * kPi * f / fs * (static_cast<double>(i) - middle);
            sum += taps_now[i] * (type == 0 ? std::cos(angle) : -std::sin(angle));
        }
        return sum;
    }
};

TEST(Parks, AgreesWithTheReference) {
    for (const EquirippleReference& reference : kEquiripple) {
        Equiripple design;
        design.type = reference.type;
        design.taps = reference.taps;
        design.bands = reference.bands;
        EXPECT_EQ(design.Make(), 0);
        EXPECT_EQ(design.err, kOk);
        EXPECT_THAT(design.h.values(),
                    AllNear(Mirrored(reference.half, reference.taps, reference.type == 0 ? 1.0 : -1.0), 0.0, 1e-12))
            << reference.type << ' ' << reference.taps;
    }
}

// The filter is the best there is if and only if its error alternates as often as it has degrees of freedom, and once
// more.
TEST(Parks, RipplesEqually) {
    for (const EquirippleReference& reference : kEquiripple) {
        Equiripple design;
        design.type = reference.type;
        design.taps = reference.taps;
        design.bands = reference.bands;
        design.Make();
        const int32_t cosines = reference.taps / 2 + (reference.type == 0 && reference.taps % 2 != 0 ? 1 : 0);
        int32_t alternations = 0;
        double sign = 0.0, largest = 0.0;
        for (const KrFirBand& band : design.bands) {
            constexpr int32_t kSteps = 4000;
            for (int32_t i = 0; i <= kSteps; ++i) {
                const double f = band.lowEdge + (band.highEdge - band.lowEdge) * i / kSteps;
                if (design.type == 1 && f == 0.0) continue;
                const double desired = design.type == 1 ? band.desired * f / design.fs : band.desired;
                const bool relative = design.type == 1 && band.desired > 0.0;
                const double weight = relative ? band.weight * design.fs / f : band.weight;
                const double error = weight * (design.Response(f) - desired);
                largest = std::max(largest, std::fabs(error));
                if (std::fabs(error) > 0.98 * design.ripple && error * sign <= 0.0) {
                    sign = error;
                    ++alternations;
                }
            }
        }
        EXPECT_GE(alternations, cosines + 1) << reference.type << ' ' << reference.taps;
        EXPECT_LT(largest, 1.03 * design.ripple) << reference.type << ' ' << reference.taps;
        EXPECT_GT(largest, 0.999999 * design.ripple) << reference.type << ' ' << reference.taps;
    }
}

TEST(Parks, TakesAnyNumberOfRoundsBelowOneForAHundred) {
    Equiripple design, other;
    design.Make();
    other.iterations = -7;
    other.Make();
    EXPECT_EQ(other.err, kOk);
    EXPECT_THAT(other.h.values(), SameBitsAs(design.h.values()));
    other.iterations = 100;
    other.Make();
    EXPECT_THAT(other.h.values(), SameBitsAs(design.h.values()));
}

// The last round has to leave one over, so a single one is none.
TEST(Parks, FailsWhenItsRoundsAreUsedUp) {
    Equiripple design;
    int32_t needed = 1;
    for (; needed < 100; ++needed) {
        design.iterations = needed;
        design.Make();
        if (design.err == kOk) break;
        EXPECT_EQ(design.Refusal(), kBadBands) << needed;
    }
    EXPECT_GT(needed, 3);
    EXPECT_LT(needed, 20);
    EXPECT_EQ(design.err, kOk);
}

// The upper end is looked at once only, so now and then a better filter is missed.
TEST(Parks, TriesOnlyTheLastPointAtTheUpperEnd) {
    Equiripple design;
    design.taps = 16;
    design.bands = {{1.0, 0.0, 20.0, 1.0}, {0.0, 112.857, 500.0, 5.0}};
    design.Make();
    ASSERT_EQ(design.err, kOk);
    EXPECT_NEAR(design.ripple, 0.0432876, 1e-7);
    double largest = 0.0;
    for (double f = 112.857; f <= 500.0; f += 0.05) largest = std::max(largest, 5.0 * std::fabs(design.Response(f)));
    EXPECT_NEAR(largest, 0.0998, 1e-4);
}

// As long as no point lies in the pass band there is no error anywhere, and the points run along it.
TEST(Parks, FailsWhereNoFirstPointMeetsAPassBand) {
    Equiripple design;
    design.taps = 41;
    design.bands = {{0.0, 0.0, 125.714, 5.0}, {1.0, 165.0, 175.0, 1.0}, {0.0, 214.286, 500.0, 5.0}};
    EXPECT_EQ(design.Refusal(), kBadBands);
}

TEST(Parks, RefusesInAFixedOrder) {
    Equiripple design;
    const std::vector<KrFirBand> good = design.bands;
    design.taps = 0;
    design.type = 3;
    design.bands.clear();
    EXPECT_EQ(design.Refusal(), kBadOrder);
    design.taps = 2;
    for (const int32_t type : {3, -1, std::numeric_limits<int32_t>::max(), std::numeric_limits<int32_t>::min()}) {
        design.type = type;
        EXPECT_EQ(design.Refusal(), kBadFrequency);
    }
    design.type = 0;
    EXPECT_EQ(design.Refusal(), kBadBands);  // no bands

    design.bands = good;
    design.bands[1].weight = 0.0;
    design.fs = 0.0;
    EXPECT_EQ(design.Refusal(), kBadBands);  // two taps
    design.taps = 22;
    EXPECT_EQ(design.Refusal(), kBadFrequency);
    design.fs = -1.0;
    EXPECT_EQ(design.Refusal(), kBadFrequency);
    design.fs = 1000.0;
    for (const double bad : {-1.0, kNaN}) {
        for (double KrFirBand::*field :
             {&KrFirBand::desired, &KrFirBand::lowEdge, &KrFirBand::highEdge, &KrFirBand::weight}) {
            design.bands = good;
            design.bands[1].highEdge = 600.0;  // found later
            design.bands[0].*field = bad;
            EXPECT_EQ(design.Refusal(), kBadFrequency);
        }
    }
    design.bands = good;
    design.bands[0].weight = 0.0;
    EXPECT_EQ(design.Refusal(), kBadFrequency);

    design.bands = good;
    design.bands[0].lowEdge = 100.0;
    design.bands[1].highEdge = 500.1;
    EXPECT_EQ(design.Refusal(), kCutoffAboveNyquist);
    design.bands[1].highEdge = 400.0;
    EXPECT_EQ(design.Refusal(), kBadFrequency);  // not ascending
    design.bands[0].lowEdge = 10.0;
    design.bands[0].highEdge = 150.0;
    EXPECT_EQ(design.Refusal(), kBadFrequency);
    design.bands[0].highEdge = 100.0;
    design.bands[1].desired = 1.0;
    EXPECT_EQ(design.Refusal(), kBadBands);  // does not begin at 0
    design.bands[0].lowEdge = 0.0;
    EXPECT_EQ(design.Refusal(), kBadBands);  // ends too early
    design.bands[1].highEdge = 499.1;
    EXPECT_EQ(design.Refusal(), kEvenLength);
    design.bands[1].desired = 0.0;
    design.Make();
    EXPECT_EQ(design.err, kOk);
}

TEST(Parks, RefusesBandsWhereNoResponseIsToBeHad) {
    Equiripple design;
    const auto status = [&](int32_t type, int32_t taps, double low, double high) {
        design.type = type;
        design.taps = taps;
        design.bands = {{1.0, low, high, 1.0}};
        design.Make();
        EXPECT_EQ(design.h.empty(), design.err != kOk);
        return design.err;
    };
    for (const int32_t taps : {8, 20, 32}) {
        EXPECT_EQ(status(1, taps, 0.0, 500.0), kOk);
        EXPECT_EQ(status(1, taps, 0.0, 400.0), kOk);
        EXPECT_EQ(status(2, taps, 0.0, 500.0), kBadBands);
        EXPECT_EQ(status(2, taps, 20.0, 500.0), kOk);
        EXPECT_EQ(status(2, taps, 100.0, 500.0), kOk);
    }
    for (const int32_t taps : {9, 21, 33}) {
        EXPECT_EQ(status(1, taps, 0.0, 500.0), kBadBands);
        EXPECT_EQ(status(1, taps, 0.0, 450.0), kOk);
        EXPECT_EQ(status(2, taps, 50.0, 500.0), kBadBands);
        EXPECT_EQ(status(2, taps, 0.0, 450.0), kBadBands);
        EXPECT_EQ(status(2, taps, 20.0, 480.0), kOk);
        EXPECT_EQ(status(2, taps, 100.0, 400.0), kOk);
    }
}

TEST(Parks, ReportsTooManyTapsAsTheHostReportsMemory) {
    Equiripple design;
    for (const int32_t taps : {4091, 4093, 100001}) {
        design.taps = taps;
        EXPECT_EQ(design.Refusal(2), kOutOfMemory) << taps;
    }
}

TEST(Parks, HandsOnTheHostsRefusal) {
    Equiripple design;
    const FailResize failure(1, 4711);
    EXPECT_EQ(design.Refusal(4711), kOutOfMemory);
}

TEST(Parks, DesignsLongFilters) {
    Equiripple design;
    design.taps = 1601;
    design.bands = {{1.0, 0.0, 100.0, 1.0}, {0.0, 102.5, 500.0, 1.0}};
    design.Make();
    EXPECT_EQ(design.err, kOk);
    EXPECT_LT(design.ripple, 3e-4);
    for (double f = 0.0; f < 100.0; f += 0.37) EXPECT_NEAR(design.Response(f), 1.0, 1.02 * design.ripple);
    for (double f = 103.0; f < 500.0; f += 0.37) EXPECT_NEAR(design.Response(f), 0.0, 1.02 * design.ripple);
}

// Numbers out of all reason end in a status.
TEST(Parks, EndsWhateverItIsGiven) {
    for (const double fs : {1e-300, 1e300, kInfinity, 1000.0}) {
        for (const double edge : {0.0, 1e-320, 1e-9, 499.9999, 1e299}) {
            for (const double value : {0.0, 1e-320, 1e308, kInfinity}) {
                for (int32_t type = 0; type < 3; ++type) {
                    for (const int32_t taps : {3, 4, 10, 11}) {
                        Equiripple design;
                        design.taps = taps;
                        design.type = type;
                        design.fs = fs;
                        design.bands = {{value, 0.0, edge, value}, {value, edge + edge / 4, fs / 2, 1.0}};
                        design.Make();
                        EXPECT_EQ(design.h.empty(), design.err != kOk);
                        design.bands = {{1.0, edge, fs / 2, value}};
                        design.Make();
                        EXPECT_EQ(design.h.empty(), design.err != kOk);
                        for (const double tap : design.h.values()) EXPECT_TRUE(std::isfinite(tap));
                    }
                }
            }
        }
    }
}

TEST(Parks, TellsDirectCallsOfMissingBands) {
    double h[3], ripple;
    EXPECT_EQ(EquirippleDesign(3, 1.0, nullptr, 0, kMultiband, 0, h, &ripple), kEmptyInput);
    EXPECT_EQ(EquirippleDesign(2, 1.0, nullptr, 0, kMultiband, 0, h, &ripple), kBadBands);
}

}  // namespace
}  // namespace krnumer

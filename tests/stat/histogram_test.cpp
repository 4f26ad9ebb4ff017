#include "stat/histogram.h"

#include <algorithm>
#include <limits>

#include "frame/status.h"
#include "stat/samples.h"
#include "support/numbers.h"

namespace krnumer {
namespace {

using ::testing::Each;
using ::testing::ElementsAre;
using ::testing::IsEmpty;
using Samples = std::vector<double>;
using Counts = std::vector<int32_t>;

constexpr int32_t kUntouched = -77;

struct Bins {
    explicit Bins(int32_t n) : counts(Count(n), kUntouched), centers(Count(n), kUntouched) {}

    Counts counts;
    Samples centers;
    int32_t status = 0;
};

Bins HistogramOf(const Samples& x, int32_t bins) {
    Bins b(bins);
    b.status = Histogram(x.data(), Size(x), b.counts.data(), b.centers.data(), bins);
    return b;
}

Bins EqualWidthOf(const Samples& x, double lo, double hi, int32_t bins) {
    Bins b(bins);
    b.status = EqualWidthHistogram(x.data(), Size(x), lo, hi, b.counts.data(), b.centers.data(), bins);
    return b;
}

TEST(EqualWidthHistogram, ChecksTheBoundsBeforeTheSizes) {
    EXPECT_EQ(EqualWidthOf({}, 1, 1, 0).status, kNoSpread);
    EXPECT_EQ(EqualWidthOf({}, 2, 1, 3).status, kNoSpread);
    EXPECT_EQ(EqualWidthOf({}, 0, 1, 3).status, kEmptyInput);
    EXPECT_EQ(EqualWidthOf({1}, 0, 1, 0).status, kEmptyInput);
    EXPECT_EQ(EqualWidthOf({1}, 0, 1, -5).status, kEmptyInput);
    EXPECT_EQ(EqualWidthOf({1}, 0, 1, std::numeric_limits<int32_t>::min()).status, kEmptyInput);
    EXPECT_THAT(EqualWidthOf({}, 0, 1, 3).counts, Each(kUntouched));
}

TEST(EqualWidthHistogram, BinsHoldTheirLowerEndAndTheLastBinBothEnds) {
    const Bins b = EqualWidthOf({0, 1, 2, 3, 4, 4, 1.5}, 0, 4, 4);
    EXPECT_EQ(b.status, kOk);
    EXPECT_THAT(b.counts, ElementsAre(1, 2, 1, 3));
    EXPECT_THAT(b.centers, ElementsAre(0.5, 1.5, 2.5, 3.5));
}

TEST(EqualWidthHistogram, DropsSamplesOutside) {
    const Bins b = EqualWidthOf({-0.001, -1e300, -kInfinity, 4.001, 1e300, kInfinity, 2}, 0, 4, 2);
    EXPECT_THAT(b.counts, ElementsAre(0, 1));
}

TEST(EqualWidthHistogram, CountsNaNInTheLastBin) {
    EXPECT_THAT(EqualWidthOf({kQuietNaN, 0.5, -kQuietNaN, 9}, 0, 4, 4).counts, ElementsAre(1, 0, 0, 2));
}

TEST(EqualWidthHistogram, WithNaNForABoundCountsAllInTheLastBin) {
    const Bins b = EqualWidthOf({1, 2, 3}, 1, kQuietNaN, 2);
    EXPECT_EQ(b.status, kOk);
    EXPECT_THAT(b.counts, ElementsAre(0, 3));
    EXPECT_TRUE(std::isnan(b.centers[0]) && std::isnan(b.centers[1]));
    EXPECT_THAT(EqualWidthOf({1, 2, 3}, kQuietNaN, 3, 2).counts, ElementsAre(0, 1));
}

TEST(EqualWidthHistogram, WithInfiniteBounds) {
    // The width is infinite, and everything finite lies 0 widths above lo.
    EXPECT_THAT(EqualWidthOf({-5, 0, 1e308, kInfinity}, -5, kInfinity, 3).counts, ElementsAre(3, 0, 1));
    EXPECT_THAT(EqualWidthOf({-1e308, 0, 1e308}, -1e308, 1e308, 2).counts, ElementsAre(2, 1));
    // NaN widths above lo, and not hi.
    EXPECT_THAT(EqualWidthOf({-kInfinity, 0, 5}, -kInfinity, 5, 2).counts, ElementsAre(0, 1));
}

TEST(EqualWidthHistogram, WithAWidthThatUnderflowsKeepsOnlyTheUpperEnd) {
    EXPECT_THAT(EqualWidthOf({0, 4.94e-324}, 0, 4.94e-324, 4).counts, ElementsAre(0, 0, 0, 1));
}

TEST(EqualWidthHistogram, AddsTheWidthFromCenterToCenter) {
    const Bins b = EqualWidthOf({0}, 0, 1, 10);
    double center = 0.05;
    for (const double c : b.centers) {
        EXPECT_EQ(c, center);
        center += 0.1;
    }
    EXPECT_NE(b.centers[9], 0.95);
}

TEST(Histogram, RefusesNoSamplesAndNoBins) {
    EXPECT_EQ(HistogramOf({}, 3).status, kEmptyInput);
    EXPECT_EQ(HistogramOf({1, 2}, 0).status, kEmptyInput);
    EXPECT_EQ(HistogramOf({1, 2}, -1).status, kEmptyInput);
    EXPECT_EQ(HistogramOf({}, 0).status, kEmptyInput);
}

TEST(Histogram, HasNoBinsWithoutSpread) {
    EXPECT_EQ(HistogramOf({7, 7}, 4).status, kNoSpread);
    EXPECT_EQ(HistogramOf({7}, 1).status, kNoSpread);
    EXPECT_EQ(HistogramOf({-0.0, 0.0}, 4).status, kNoSpread);
}

TEST(Histogram, SpansTheSamples) {
    const Bins b = HistogramOf({1, 2, 3}, 2);
    EXPECT_EQ(b.status, kOk);
    EXPECT_THAT(b.centers, ElementsAre(1.5, 2.5));
    EXPECT_THAT(b.counts, ElementsAre(1, 2));
}

TEST(Histogram, NaNTakesOverTheMinimum) {
    EXPECT_EQ(HistogramOf({1, kQuietNaN, 2}, 2).status, kNoSpread);  // from 2 to 1
    const Bins later = HistogramOf({kQuietNaN, 2, 1}, 2);            // from 1 to NaN
    EXPECT_EQ(later.status, kOk);
    EXPECT_THAT(later.counts, ElementsAre(0, 3));
    const Bins last = HistogramOf({1, 2, kQuietNaN}, 2);  // from NaN to 2
    EXPECT_EQ(last.status, kOk);
    EXPECT_THAT(last.counts, ElementsAre(0, 2));
    const Bins between = HistogramOf({0, 4, kQuietNaN, 0, 4}, 2);
    EXPECT_EQ(between.status, kOk);
    EXPECT_THAT(between.counts, ElementsAre(2, 3));
}

TEST(Histogram, CountsAgreeWithExactArithmetic) {
    for (const auto& [set, bins, counts] : GoldenResults("counts")) {
        EXPECT_EQ(HistogramOf(GoldenSamples().at(set), std::stoi(bins)).counts, Counts(counts.begin(), counts.end()))
            << set << ", " << bins << " bins";
    }
}

TEST(Histogram, CentersAgreeWithExactArithmetic) {
    for (const auto& [set, parameter, centers] : GoldenResults("centers")) {
        const int32_t bins = std::stoi(parameter);
        const Samples& samples = GoldenSamples().at(set);
        double largest = 0.0;
        for (const double x : samples) largest = std::max(largest, std::fabs(x));
        EXPECT_THAT(HistogramOf(samples, bins).centers, AllNear(centers, 0.0, 2.0 * (bins + 2) * kEpsilon * largest))
            << set << ", " << bins << " bins";
    }
}

struct IntervalCounts {
    Counts counts;
    OutOfRange out_of_range{kUntouched, kUntouched, kUntouched};
    int32_t status = 0;
};

IntervalCounts CountIn(const Samples& x, const std::vector<Interval>& intervals) {
    IntervalCounts c{.counts = Counts(intervals.size(), kUntouched)};
    c.status = IntervalHistogram(x.data(), Size(x), intervals.data(), static_cast<int32_t>(intervals.size()),
                                 c.counts.data(), &c.out_of_range);
    return c;
}

void ExpectOutOfRange(const IntervalCounts& c, int32_t outside, int32_t below, int32_t above) {
    EXPECT_EQ(c.status, kOk);
    EXPECT_EQ(c.out_of_range.outside, outside);
    EXPECT_EQ(c.out_of_range.below, below);
    EXPECT_EQ(c.out_of_range.above, above);
}

TEST(IntervalHistogram, CountsInsideBelowAndAbove) {
    const IntervalCounts c = CountIn({-1, 0.5, 1, 2}, {{0, 1, Inclusion::kLower}, {1, 2, Inclusion::kLower}});
    EXPECT_THAT(c.counts, ElementsAre(1, 1));
    ExpectOutOfRange(c, 2, 1, 1);
}

TEST(IntervalHistogram, WithoutSamplesZeroesTheCountersOnly) {
    const IntervalCounts c = CountIn({}, {{0, 1, Inclusion::kLower}});
    EXPECT_EQ(c.status, kEmptyInput);
    EXPECT_THAT(c.counts, ElementsAre(kUntouched));
    EXPECT_EQ(c.out_of_range.outside, 0);
    EXPECT_EQ(c.out_of_range.below, 0);
    EXPECT_EQ(c.out_of_range.above, 0);
}

TEST(IntervalHistogram, WithoutIntervalsCountsNothing) {
    const IntervalCounts c = CountIn({1, kQuietNaN}, {});
    EXPECT_THAT(c.counts, IsEmpty());
    ExpectOutOfRange(c, 0, 0, 0);
}

TEST(IntervalHistogram, EndsBelongAsTheInclusionSays) {
    const Samples samples{1, 1.5, 2};
    const auto count = [&](Inclusion inclusion) { return CountIn(samples, {{1, 2, inclusion}}); };
    EXPECT_THAT(count(Inclusion::kLower).counts, ElementsAre(2));
    ExpectOutOfRange(count(Inclusion::kLower), 1, 0, 1);
    EXPECT_THAT(count(Inclusion::kUpper).counts, ElementsAre(2));
    ExpectOutOfRange(count(Inclusion::kUpper), 1, 1, 0);
    EXPECT_THAT(count(Inclusion::kBoth).counts, ElementsAre(3));
    ExpectOutOfRange(count(Inclusion::kBoth), 0, 0, 0);
    EXPECT_THAT(count(Inclusion::kNeither).counts, ElementsAre(1));
    ExpectOutOfRange(count(Inclusion::kNeither), 2, 1, 1);
}

TEST(IntervalHistogram, AnyOtherInclusionTakesEverything) {
    for (const int32_t other : {4, -1, std::numeric_limits<int32_t>::max(), std::numeric_limits<int32_t>::min()}) {
        const IntervalCounts c =
            CountIn({-kInfinity, 1.5, kQuietNaN, 9}, {{1, 2, static_cast<Inclusion>(other)}, {3, 4, Inclusion::kBoth}});
        EXPECT_THAT(c.counts, ElementsAre(4, 0));
        ExpectOutOfRange(c, 0, 0, 0);
    }
}

TEST(IntervalHistogram, NaNSamplesAreBelow) {
    for (int32_t inclusion = 0; inclusion < 4; ++inclusion) {
        const Interval interval{-kInfinity, kInfinity, static_cast<Inclusion>(inclusion)};
        const IntervalCounts c = CountIn({kQuietNaN, 0}, {interval, interval});
        EXPECT_THAT(c.counts, ElementsAre(1, 1));
        ExpectOutOfRange(c, 1, 1, 0);
    }
}

TEST(IntervalHistogram, WithNaNForAnEnd) {
    EXPECT_EQ(CountIn({1}, {{kQuietNaN, 2, Inclusion::kBoth}}).out_of_range.below, 1);
    EXPECT_EQ(CountIn({1}, {{0, kQuietNaN, Inclusion::kBoth}}).out_of_range.above, 1);
}

TEST(IntervalHistogram, OverlappingIntervalsCountASampleInEach) {
    const IntervalCounts c =
        CountIn({1, 2, 3, 4}, {{0, 3, Inclusion::kBoth}, {2, 5, Inclusion::kBoth}, {2.5, 3.5, Inclusion::kBoth}});
    EXPECT_THAT(c.counts, ElementsAre(3, 3, 1));
    ExpectOutOfRange(c, 0, 0, 0);
}

TEST(IntervalHistogram, SamplesInAGapAreOutsideOnly) {
    const IntervalCounts c = CountIn({0.5, 1.5, 2.5, 3.5}, {{0, 1, Inclusion::kLower}, {2, 3, Inclusion::kLower}});
    EXPECT_THAT(c.counts, ElementsAre(1, 1));
    ExpectOutOfRange(c, 2, 0, 1);
}

TEST(IntervalHistogram, ThePositionBesideTheLastIntervalMakesASampleAbove) {
    // 3.5 is above the last interval and outside; 4.5 is above it too, but lies in the first.
    const IntervalCounts c = CountIn({3.5, 4.5}, {{4, 5, Inclusion::kLower}, {2, 3, Inclusion::kLower}});
    EXPECT_THAT(c.counts, ElementsAre(1, 0));
    ExpectOutOfRange(c, 1, 1, 0);
    const IntervalCounts d = CountIn({4.5, 5.5}, {{4, 5, Inclusion::kLower}, {2, 3, Inclusion::kLower}});
    EXPECT_THAT(d.counts, ElementsAre(1, 0));
    ExpectOutOfRange(d, 1, 0, 1);
}

TEST(IntervalHistogram, WhatIsBelowTheFirstIntervalIsLookedAtNoFurther) {
    const IntervalCounts c =
        CountIn({0.5, 1.5, 2.5}, {{2, 3, Inclusion::kLower}, {1, 2, Inclusion::kLower}, {0, 1, Inclusion::kLower}});
    EXPECT_THAT(c.counts, ElementsAre(1, 0, 0));
    ExpectOutOfRange(c, 2, 2, 0);
}

// Counts by ranks in the sorted data, which know nothing of a walk over intervals.
TEST(IntervalHistogram, AgreesWithRanksInSortedData) {
    std::mt19937_64 random(4);
    std::uniform_int_distribution<int32_t> digit(0, 12);
    for (int32_t round = 0; round < 300; ++round) {
        const int32_t n = 1 + round;
        Samples samples;
        for (int32_t i = 0; i < n; ++i) samples.push_back(digit(random) - 2);
        std::vector<Interval> intervals;
        for (int32_t j = 0; j < round % 6 + 1; ++j) {
            const double lower = digit(random);
            intervals.push_back({lower, lower + digit(random), static_cast<Inclusion>(random() % 4)});
        }
        std::sort(intervals.begin(), intervals.end(), [](const Interval& a, const Interval& b) {
            const bool a_open = a.inclusion == Inclusion::kUpper || a.inclusion == Inclusion::kNeither;
            const bool b_open = b.inclusion == Inclusion::kUpper || b.inclusion == Inclusion::kNeither;
            return a.lower != b.lower ? a.lower < b.lower : a_open < b_open;
        });

        Samples sorted = samples;
        std::sort(sorted.begin(), sorted.end());
        const auto below_lower = [&](const Interval& i) {
            return i.inclusion == Inclusion::kLower || i.inclusion == Inclusion::kBoth
                       ? std::lower_bound(sorted.begin(), sorted.end(), i.lower)
                       : std::upper_bound(sorted.begin(), sorted.end(), i.lower);
        };
        const auto within_upper = [&](const Interval& i) {
            return i.inclusion == Inclusion::kUpper || i.inclusion == Inclusion::kBoth
                       ? std::upper_bound(sorted.begin(), sorted.end(), i.upper)
                       : std::lower_bound(sorted.begin(), sorted.end(), i.upper);
        };
        std::vector<bool> covered(Count(n), false);
        Counts expected;
        for (const Interval& interval : intervals) {
            const auto from = below_lower(interval) - sorted.begin();
            const auto to = std::max(within_upper(interval) - sorted.begin(), from);
            expected.push_back(static_cast<int32_t>(to - from));
            std::fill(covered.begin() + from, covered.begin() + to, true);
        }
        const IntervalCounts c = CountIn(samples, intervals);
        EXPECT_EQ(c.counts, expected);
        EXPECT_EQ(c.out_of_range.outside, std::count(covered.begin(), covered.end(), false));
        EXPECT_EQ(c.out_of_range.below, below_lower(intervals.front()) - sorted.begin());
        const auto last_upper = std::max(within_upper(intervals.back()), below_lower(intervals.back()));
        EXPECT_EQ(c.out_of_range.above,
                  std::count(covered.begin() + (last_upper - sorted.begin()), covered.end(), false));
    }
}

}  // namespace
}  // namespace krnumer

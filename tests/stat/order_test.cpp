#include "stat/order.h"

#include <algorithm>
#include <functional>
#include <limits>

#include "frame/status.h"
#include "stat/quicksort.h"
#include "stat/samples.h"
#include "support/numbers.h"
#include "support/quicksort_killer.h"

namespace krnumer {
namespace {

using ::testing::ElementsAre;
using Samples = std::vector<double>;

constexpr double kSignallingNaN = std::bit_cast<double>(std::uint64_t{0x7FF0000000000001});

Samples Sorted(const Samples& samples, int32_t descending = 0) {
    Samples sorted(samples.size(), -99.0);
    EXPECT_EQ(SortDoubles(samples.data(), Size(samples), descending, sorted.data()), kOk);
    return sorted;
}

// By the standard library, with NaNs in front.
Samples SortedByStandard(Samples samples, bool descending) {
    const auto numbers = std::partition(samples.begin(), samples.end(), [](double x) { return std::isnan(x); });
    std::fill(samples.begin(), numbers, kQuietNaN);
    std::sort(numbers, samples.end());
    if (descending) std::reverse(numbers, samples.end());
    return samples;
}

// Equal element by element, where NaN has to be the quiet NaN and the zeros may change places.
bool SameOrder(const Samples& a, const Samples& b) {
    return std::equal(a.begin(), a.end(), b.begin(), b.end(),
                      [](double x, double y) { return x == y || (IsQuietNaN(x) && IsQuietNaN(y)); });
}

int64_t NegativeZeros(const Samples& samples) {
    return std::count_if(samples.begin(), samples.end(), [](double x) { return SameBits(x, -0.0); });
}

TEST(SortDoubles, RefusesLengthsBelowOne) {
    double in = 1.0;
    double out = 2.0;
    for (const int32_t n : {0, -1, std::numeric_limits<int32_t>::min()}) {
        EXPECT_EQ(SortDoubles(&in, n, 0, &out), kEmptyInput);
        EXPECT_EQ(SortDoubles(&in, n, 0, nullptr), kEmptyInput);
    }
    EXPECT_EQ(out, 2.0);
}

TEST(SortDoubles, LeavesASingleSampleAloneAndWritesNoOutput) {
    const double in = -kQuietNaN;
    double out = 2.0;
    EXPECT_EQ(SortDoubles(&in, 1, 0, &out), kOk);
    EXPECT_EQ(out, 2.0);
    EXPECT_EQ(SortDoubles(&in, 1, 0, nullptr), kOk);
    EXPECT_TRUE(SameBits(in, -kQuietNaN));
}

TEST(SortDoubles, SortsBothWays) {
    EXPECT_THAT(Sorted({3, 1, 2}), ElementsAre(1, 2, 3));
    EXPECT_THAT(Sorted({3, 1, 2}, 1), ElementsAre(3, 2, 1));
    EXPECT_THAT(Sorted({3, 1, 2}, -7), ElementsAre(3, 2, 1));
    EXPECT_THAT(Sorted({kInfinity, -kInfinity, 4.94e-324, -0.5}), ElementsAre(-kInfinity, -0.5, 4.94e-324, kInfinity));
}

TEST(SortDoubles, PutsQuietNaNsInFrontInEitherDirection) {
    const Samples samples{3, kSignallingNaN, 1, -kQuietNaN, 2};
    for (const int32_t descending : {0, 1}) {
        const Samples sorted = Sorted(samples, descending);
        EXPECT_TRUE(IsQuietNaN(sorted[0]));
        EXPECT_TRUE(IsQuietNaN(sorted[1]));
        EXPECT_EQ(sorted[2], descending ? 3 : 1);
        EXPECT_EQ(sorted[3], 2);
        EXPECT_EQ(sorted[4], descending ? 1 : 3);
    }
    for (const double x : Sorted(Samples(100, -kQuietNaN))) EXPECT_TRUE(IsQuietNaN(x));
}

TEST(SortDoubles, SortsInPlaceOrIntoTheOutput) {
    Samples samples{3, 1, 2};
    EXPECT_THAT(Sorted(samples), ElementsAre(1, 2, 3));
    EXPECT_THAT(samples, ElementsAre(3, 1, 2));

    EXPECT_EQ(SortDoubles(samples.data(), 3, 0, samples.data()), kOk);
    EXPECT_THAT(samples, ElementsAre(1, 2, 3));

    EXPECT_EQ(SortDoubles(samples.data(), 3, 1, nullptr), kOk);
    EXPECT_THAT(samples, ElementsAre(3, 2, 1));
}

TEST(SortDoubles, AllowsOverlap) {
    Samples samples{5, 4, 3, 2, 1, 0};
    EXPECT_EQ(SortDoubles(samples.data(), 5, 0, samples.data() + 1), kOk);
    EXPECT_THAT(samples, ElementsAre(5, 1, 2, 3, 4, 5));
}

TEST(SortDoubles, AgreesWithTheStandardLibraryOnAllKindsAndSizes) {
    std::mt19937_64 random(1);
    for (const Kind kind : kAllKinds) {
        for (int32_t n = 2; n < 5000; n = n < 200 ? n + 1 : 2 * n + 1) {
            SCOPED_TRACE("kind " + std::to_string(static_cast<int>(kind)) + ", n = " + std::to_string(n));
            const Samples samples = RandomSamples(kind, n, random);
            const Samples ascending = Sorted(samples);
            ASSERT_TRUE(SameOrder(ascending, SortedByStandard(samples, false)));
            ASSERT_EQ(NegativeZeros(ascending), NegativeZeros(samples));
            ASSERT_TRUE(SameOrder(Sorted(samples, 1), SortedByStandard(samples, true)));

            Samples in_place = samples;
            ASSERT_EQ(SortDoubles(in_place.data(), n, 0, in_place.data()), kOk);
            ASSERT_TRUE(SameOrder(in_place, ascending));
        }
    }
}

// The part that the adversary can attack: it would answer the look for data in order with data in order.
void SortByPivots(int32_t* first, int32_t* last, const std::function<bool(int32_t, int32_t)>& before) {
    quicksort::Sort(first, last, before, quicksort::MostLevels(last - first));
}

TEST(SortDoubles, SortsItsOwnWorstCase) {
    for (const int32_t n : {17, 100, 1000, 10007}) {
        const Samples samples = QuicksortKiller(n, SortByPivots).values();
        ASSERT_FALSE(std::is_sorted(samples.begin(), samples.end()));
        EXPECT_TRUE(SameOrder(Sorted(samples), SortedByStandard(samples, false)));
        EXPECT_TRUE(SameOrder(Sorted(samples, 1), SortedByStandard(samples, true)));
    }
}

TEST(QuickSort, SurvivesItsAdversary) {
    for (const int32_t n : {1000, 10000, 100000}) {
        Samples worst = QuicksortKiller(n, SortByPivots).values();
        int64_t comparisons = 0;
        QuickSort(worst.data(), worst.data() + n, [&](double a, double b) {
            ++comparisons;
            return a < b;
        });
        EXPECT_TRUE(std::is_sorted(worst.begin(), worst.end()));
        EXPECT_LT(static_cast<double>(comparisons), 2.0 * n * std::log2(n));
    }
}

TEST(QuickSort, WouldBeQuadraticByMediansOfThreeAlone) {
    const auto sort = [](int32_t* first, int32_t* last, auto before) {
        while (last - first > quicksort::kRun) {
            const auto quarter = (last - first) / 4;
            const int32_t pivot =
                quicksort::MedianOfThree(first[quarter], first[2 * quarter], first[3 * quarter], before);
            first = quicksort::Partition(first, last, [&](int32_t value) { return before(value, pivot); });
        }
    };
    EXPECT_GT(QuicksortKiller(4000, sort).comparisons(), 4000 * 4000 / 8);
}

TEST(QuickSort, EndsInHeapSortWhenItsLevelsAreUsedUp) {
    std::mt19937_64 random(3);
    for (const int levels : {0, 1, 2, 5}) {
        const Samples samples = RandomSamples(Kind::kUniform, 1000, random);
        Samples sorted = samples;
        quicksort::Sort(sorted.data(), sorted.data() + sorted.size(), std::less<>(), levels);
        EXPECT_EQ(sorted, SortedByStandard(samples, false));
    }
}

TEST(Remedian, IsCentralAndKeepsAllElements) {
    std::mt19937_64 random(4);
    for (int32_t depth = 0; depth < 7; ++depth) {
        const auto n = static_cast<int32_t>(std::pow(3, depth));
        const Samples samples = RandomSamples(Kind::kUniform, n, random);
        Samples moved = samples;
        const double median = quicksort::Remedian(moved.data(), n, std::less<>());
        const auto sorted = SortedByStandard(samples, false);
        const auto rank = std::find(sorted.begin(), sorted.end(), median) - sorted.begin();
        EXPECT_GE(rank + 1, 1 << depth);
        EXPECT_GE(n - rank, 1 << depth);
        std::sort(moved.begin(), moved.end());
        EXPECT_EQ(moved, sorted);
    }
}

TEST(Remedian, KeepsBothZeros) {
    Samples zeros = {0.0, -0.0, 0.0};
    quicksort::Remedian(zeros.data(), 3, std::less<>());
    EXPECT_EQ(std::count_if(zeros.begin(), zeros.end(), [](double x) { return std::signbit(x); }), 1);
}

TEST(QuickSort, TakesAFewPassesOnFewValues) {
    Samples samples(100000);
    std::mt19937_64 random(6);
    for (double& x : samples) x = static_cast<double>(random() % 4);
    int64_t comparisons = 0;
    QuickSort(samples.data(), samples.data() + samples.size(), [&](double a, double b) {
        ++comparisons;
        return a < b;
    });
    EXPECT_TRUE(std::is_sorted(samples.begin(), samples.end()));
    // Three partitions between the four values and four that find their equals, each of less than all the data.
    EXPECT_LT(comparisons, 7 * Size(samples));
}

TEST(QuickSort, TakesLinearTimeOnDataInOrder) {
    std::vector<double> samples(1000);
    for (const double step : {1.0, -1.0, 0.0}) {
        for (std::size_t i = 0; i < samples.size(); ++i) samples[i] = step * static_cast<double>(i);
        int64_t comparisons = 0;
        QuickSort(samples.data(), samples.data() + samples.size(), [&](double a, double b) {
            ++comparisons;
            return a < b;
        });
        EXPECT_LT(comparisons, 2 * Size(samples));
        EXPECT_TRUE(std::is_sorted(samples.begin(), samples.end()));
    }
}

TEST(Partition, SeparatesAndKeepsAllElements) {
    std::mt19937_64 random(2);
    for (int32_t n = 0; n < 100; ++n) {
        Samples samples = RandomSamples(Kind::kUniform, n, random);
        Samples separated = samples;
        const auto negative = [](double x) { return x < 0.0; };
        double* end = separated.data() + n;
        const double* middle = quicksort::Partition(separated.data(), end, negative);
        EXPECT_EQ(middle - separated.data(), std::count_if(samples.begin(), samples.end(), negative));
        EXPECT_TRUE(std::is_partitioned(separated.begin(), separated.end(), negative));
        std::sort(samples.begin(), samples.end());
        std::sort(separated.begin(), separated.end());
        EXPECT_EQ(separated, samples);
    }
}

int32_t MedianOf(const Samples& samples, double* median) {
    return Median(samples.data(), Size(samples), median);
}

TEST(Median, IsTheMiddleOrTheMeanOfTheTwoInTheMiddle) {
    double median = 0.0;
    EXPECT_EQ(MedianOf({2}, &median), kOk);
    EXPECT_EQ(median, 2.0);
    EXPECT_EQ(MedianOf({4, 1, 3, 2}, &median), kOk);
    EXPECT_EQ(median, 2.5);
    EXPECT_EQ(MedianOf({9, -1, 3}, &median), kOk);
    EXPECT_EQ(median, 3.0);
    EXPECT_EQ(MedianOf({-kInfinity, kInfinity, 1}, &median), kOk);
    EXPECT_EQ(median, 1.0);
}

TEST(Median, AddsBeforeItHalves) {
    double median = 0.0;
    EXPECT_EQ(MedianOf({1.7e308, 1.7e308}, &median), kOk);
    EXPECT_EQ(median, kInfinity);
    EXPECT_EQ(MedianOf({4.94e-324, 4.94e-324}, &median), kOk);
    EXPECT_EQ(median, 4.94e-324);
    EXPECT_EQ(MedianOf({-kInfinity, kInfinity}, &median), kOk);
    EXPECT_TRUE(std::isnan(median));
}

TEST(Median, RefusesEmptyDataAndNaN) {
    double median = 5.0;
    EXPECT_EQ(MedianOf({}, &median), kEmptyInput);
    EXPECT_EQ(Median(&median, -3, &median), kEmptyInput);
    EXPECT_EQ(MedianOf({1, kQuietNaN, 3}, &median), kHoldsNaN);
    EXPECT_EQ(MedianOf({kQuietNaN}, &median), kHoldsNaN);
    EXPECT_EQ(median, 5.0);
}

TEST(Median, LeavesTheSamplesAlone) {
    const Samples samples{3, 1, 2};
    double median = 0.0;
    EXPECT_EQ(MedianOf(samples, &median), kOk);
    EXPECT_THAT(samples, ElementsAre(3, 1, 2));
}

TEST(Median, AgreesWithExactArithmetic) {
    for (const auto& [set, parameter, values] : GoldenResults("median")) {
        double median = 0.0;
        EXPECT_EQ(MedianOf(GoldenSamples().at(set), &median), kOk);
        EXPECT_THAT(median, WithinUlps(values[0], 1)) << set;
    }
}

struct Extrema {
    double max = 0.0, min = 0.0;
    int32_t max_index = -7, min_index = -7, status = 0;
};

Extrema ExtremaOf(const Samples& x) {
    Extrema e;
    e.status = MinMaxIgnoreNaN(x.data(), Size(x), &e.max, &e.max_index, &e.min, &e.min_index);
    return e;
}

TEST(MinMaxIgnoreNaN, RefusesEmptyData) {
    EXPECT_EQ(ExtremaOf({}).status, kEmptyInput);
    EXPECT_EQ(ExtremaOf({}).max_index, -7);
}

TEST(MinMaxIgnoreNaN, TellsTheFirstOfEqualValues) {
    const Extrema e = ExtremaOf({2, 5, 1, 5, 1});
    EXPECT_EQ(e.status, kOk);
    EXPECT_EQ(e.max, 5);
    EXPECT_EQ(e.max_index, 1);
    EXPECT_EQ(e.min, 1);
    EXPECT_EQ(e.min_index, 2);

    const Extrema zeros = ExtremaOf({-0.0, 0.0});
    EXPECT_TRUE(SameBits(zeros.max, -0.0));
    EXPECT_EQ(zeros.max_index, 0);
    EXPECT_EQ(zeros.min_index, 0);
}

TEST(MinMaxIgnoreNaN, SkipsNaN) {
    const Extrema e = ExtremaOf({kQuietNaN, 3, kQuietNaN, kInfinity, -1, -kQuietNaN});
    EXPECT_EQ(e.status, kOk);
    EXPECT_EQ(e.max, kInfinity);
    EXPECT_EQ(e.max_index, 3);
    EXPECT_EQ(e.min, -1);
    EXPECT_EQ(e.min_index, 4);
}

TEST(MinMaxIgnoreNaN, HasNaNAndNoPositionWhereAllIsNaN) {
    const Extrema e = ExtremaOf({-kQuietNaN, kSignallingNaN});
    EXPECT_EQ(e.status, kOk);
    EXPECT_TRUE(IsQuietNaN(e.max));
    EXPECT_TRUE(IsQuietNaN(e.min));
    EXPECT_EQ(e.max_index, -1);
    EXPECT_EQ(e.min_index, -1);
}

TEST(MinMaxIgnoreNaN, AgreesWithTheStandardLibrary) {
    std::mt19937_64 random(3);
    for (const Kind kind : kAllKinds) {
        if (kind == Kind::kNaNLaden) continue;
        for (const int32_t n : {1, 2, 3, 16, 101, 500}) {
            const Samples samples = RandomSamples(kind, n, random);
            const Extrema e = ExtremaOf(samples);
            EXPECT_EQ(e.max_index, std::max_element(samples.begin(), samples.end()) - samples.begin());
            EXPECT_EQ(e.min_index, std::min_element(samples.begin(), samples.end()) - samples.begin());
            EXPECT_EQ(e.max, samples[Count(e.max_index)]);
            EXPECT_EQ(e.min, samples[Count(e.min_index)]);
        }
    }
}

}  // namespace
}  // namespace krnumer

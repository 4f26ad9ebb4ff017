// The exports: order of checks, what failures leave behind, and how long a context remembers.

#include <cstring>
#include <limits>

#include "frame/numeric.h"
#include "frame/status.h"
#include "measure/measuring.h"

namespace krnumer {
namespace {

Block Square() {
    Block block;
    block.samples = {0, 0, 1, 1, 0, 0, 1, 1, 0, 0, 1, 1, 0, 0};
    return block;
}

// The first context of the process, before any test creates one.
const uint32_t kFirstContext = [] {
    uint32_t id = 0;
    measurements_create(&id);
    return id;
}();

TEST(MeasurementContexts, AreNumberedFrom1112) {
    EXPECT_EQ(kFirstContext, 1112u);
    uint32_t first = 0, second = 0;
    ASSERT_EQ(measurements_create(&first), 0);
    ASSERT_EQ(measurements_create(&second), 0);
    EXPECT_GT(first, kFirstContext);
    EXPECT_EQ(second, first + 1);
    EXPECT_EQ(measurements_destroy(static_cast<int32_t>(first)), 0);
    EXPECT_EQ(measurements_destroy(static_cast<int32_t>(second)), 0);
}

TEST(MeasurementContexts, NeedAPlaceForTheirIdentifier) {
    EXPECT_EQ(measurements_create(nullptr), kNullResult);
}

TEST(MeasurementContexts, UnknownOnes) {
    uint32_t id = 0;
    ASSERT_EQ(measurements_create(&id), 0);
    EXPECT_EQ(measurements_destroy(static_cast<int32_t>(id)), 0);
    for (const int32_t unknown :
         {static_cast<int32_t>(id), 0, 1, 1111, 1 << 30, -2, std::numeric_limits<int32_t>::min()}) {
        const Outcome outcome = Fetch(unknown, KRN_MEAN, Square());
        EXPECT_EQ(outcome.status, kUnknownContext);
        EXPECT_EQ(outcome.value, 0.0);
        EXPECT_EQ(measurements_clear(unknown), kUnknownContext);
        EXPECT_EQ(measurements_destroy(unknown), kUnknownContext);
    }
    EXPECT_EQ(measurements_clear(-1), kUnknownContext) << "nothing is kept of a single call";
    EXPECT_EQ(measurements_destroy(-1), kUnknownContext);
}

TEST(MeasurementContexts, ASingleCallLeavesNone) {
    uint32_t before = 0, after = 0;
    ASSERT_EQ(measurements_create(&before), 0);
    EXPECT_EQ(ValueOf(KRN_MEAN, Square()), 6.0 / 14.0);
    ASSERT_EQ(measurements_create(&after), 0);
    EXPECT_EQ(after, before + 1);
    EXPECT_EQ(measurements_destroy(static_cast<int32_t>(before)), 0);
    EXPECT_EQ(measurements_destroy(static_cast<int32_t>(after)), 0);
}

// From a call in which everything is wrong, fault after fault is mended.
TEST(Fetch, ChecksInItsOrder) {
    const Block good = Square();
    const double samples[] = {1, 2, 3};
    KrLevels levels{1, 2, 3, 7};
    KrStateMethod method{7, 0};
    double result = -7.0;
    KrMarkers box = kUntouched;
    int32_t id = 5, selector = 99, occurrence = 0, count = 0;
    double dt = -1.0;
    const KrLevels* given_levels = nullptr;
    const KrStateMethod* given_method = nullptr;
    double* given_result = nullptr;
    KrMarkers* given_box = nullptr;
    const double* given_samples = nullptr;
    const auto fetch = [&] {
        return measurements_fetch(id, selector, given_levels, given_method, occurrence, 0.0, dt, given_samples, count,
                                  given_result, given_box);
    };
    EXPECT_EQ(fetch(), kNullRecord);
    given_levels = &levels;
    EXPECT_EQ(fetch(), kNullRecord);
    given_levels = nullptr;
    given_method = &method;
    EXPECT_EQ(fetch(), kNullRecord);
    given_levels = &levels;
    EXPECT_EQ(fetch(), kLevelsOutOfOrder);
    levels.high = 10;
    EXPECT_EQ(fetch(), kLevelsOutOfOrder) << "mid is still below low";
    levels.low = 2;
    EXPECT_EQ(fetch(), kNullResult);
    given_result = &result;
    EXPECT_EQ(fetch(), kNullMarkers);
    given_box = &box;
    EXPECT_EQ(fetch(), kNoSamples);
    EXPECT_EQ(result, -7.0) << "nothing is written before all arguments are there";
    given_samples = samples;
    selector = KRN_NO_MEASUREMENT;
    EXPECT_EQ(fetch(), 0) << "neither context nor interval nor count matter";
    EXPECT_EQ(result, 0.0);
    EXPECT_EQ(box, kUntouched);
    result = -7.0;
    selector = 99;
    EXPECT_EQ(fetch(), kUnknownContext);
    EXPECT_EQ(result, 0.0);
    id = -1;
    for (const double bad : {-1.0, 0.0, -0.0, kQuietNaN, -kInfinity}) {
        dt = bad;
        EXPECT_EQ(fetch(), kBadMeasurementInterval);
    }
    dt = 1.0;
    EXPECT_EQ(fetch(), kNoSamples);
    count = -4;
    EXPECT_EQ(fetch(), kNoSamples);
    count = 3;
    EXPECT_EQ(fetch(), kUnexpectedKind);
    selector = KRN_PERIOD;
    EXPECT_EQ(fetch(), kBadOccurrence);
    occurrence = 1;
    EXPECT_EQ(fetch(), kBadUnits);
    levels.units = KRN_LEVELS_PERCENT;
    EXPECT_EQ(fetch(), kBadStateMethod);
    method.method = KRN_STATES_BY_HISTOGRAM;
    EXPECT_EQ(fetch(), kNoBins);
    method.bins = 3;
    EXPECT_EQ(fetch(), kTooFewCrossings);
    EXPECT_EQ(result, 0.0);
    EXPECT_EQ(box, kUntouched) << "failures leave no markers";
}

TEST(Fetch, KnowsItsMeasurements) {
    Block block = Square();
    for (const int32_t unknown : {21, 35, 49, 50, 51, 52, 53, 54, 1000, -1, std::numeric_limits<int32_t>::min(),
                                  std::numeric_limits<int32_t>::max()}) {
        const Outcome outcome = Fetch(unknown, block);
        EXPECT_EQ(outcome.status, kUnexpectedKind) << unknown;
        EXPECT_EQ(outcome.value, 0.0);
    }
    for (const int32_t kind : AllMeasurements()) EXPECT_EQ(StatusOf(kind, block), 0) << kind;
    EXPECT_EQ(ValueOf(KRN_NO_MEASUREMENT, block), 0.0);
}

TEST(Fetch, EqualLevelsAreInOrder) {
    Block block = Square();
    block.levels = {0.5, 0.5, 0.5, KRN_LEVELS_ABSOLUTE};
    EXPECT_EQ(ValueOf(KRN_PERIOD, block), 4.0);
}

TEST(Fetch, CountsOccurrencesFromOne) {
    Block block = Square();
    for (const int32_t kind : AllMeasurements()) {
        const bool counts = kind >= KRN_PERIOD;
        for (const int32_t occurrence : {0, -1, std::numeric_limits<int32_t>::min()}) {
            block.occurrence = occurrence;
            EXPECT_EQ(StatusOf(kind, block), counts ? kBadOccurrence : kOk) << kind;
        }
        for (const int32_t occurrence : {100, 1000000000, std::numeric_limits<int32_t>::max()}) {
            block.occurrence = occurrence;
            EXPECT_EQ(StatusOf(kind, block), counts ? kTooFewCrossings : kOk) << kind;
        }
    }
}

// Whatever was wrong with the levels: the occurrence is looked at first.
TEST(Fetch, BadOccurrenceComesBeforeBadLevels) {
    Block block = Square();
    block.occurrence = 0;
    block.levels.units = 3;
    for (const int32_t kind : CountingMeasurements()) EXPECT_EQ(StatusOf(kind, block), kBadOccurrence) << kind;
}

TEST(Fetch, NotFiniteResults) {
    Block block = Square();
    block.samples[3] = kInfinity;
    for (const int32_t kind : {KRN_LARGEST, KRN_MEAN, KRN_RMS, KRN_RANGE}) {
        const Outcome outcome = Fetch(kind, block);
        EXPECT_EQ(outcome.status, kResultNotFinite) << kind;
        EXPECT_EQ(outcome.value, 0.0);
        EXPECT_EQ(outcome.box, kUntouched);
    }
    EXPECT_EQ(ValueOf(KRN_SMALLEST, block), 0.0);
    block.samples.assign(5, kQuietNaN);
    for (const int32_t kind : AllMeasurements()) {
        block.method.method = kind % 3;
        EXPECT_LT(StatusOf(kind, block), 0) << kind;
    }
}

TEST(Fetch, LevelsThatAreNoNumbers) {
    Block block = Square();
    block.levels = {kQuietNaN, kQuietNaN, kQuietNaN, KRN_LEVELS_ABSOLUTE};
    EXPECT_EQ(StatusOf(KRN_MID_REFERENCE, block), kResultNotFinite);
    EXPECT_EQ(StatusOf(KRN_PERIOD, block), kTooFewCrossings);
    EXPECT_EQ(StatusOf(KRN_RISE_TIME, block), kTooFewCrossings);
}

TEST(Fetch, NeedsNoAlignmentOfItsPointers) {
    const Block block = Square();
    const int32_t n = block.count();
    std::vector<unsigned char> bytes(static_cast<std::size_t>(n) * 8 + 4 + 8 + 48 + 26 + 8);
    unsigned char* const samples = bytes.data() + 4;
    unsigned char* const result = samples + n * 8;
    unsigned char* const box = result + 8;
    unsigned char* const levels = box + 48;
    unsigned char* const method = levels + 26;
    std::memcpy(samples, block.samples.data(), static_cast<std::size_t>(n) * 8);
    std::memcpy(levels, &block.levels, 26);
    std::memcpy(method, &block.method, 8);
    EXPECT_EQ(
        measurements_fetch(-1, KRN_PERIOD, reinterpret_cast<KrLevels*>(levels),
                           reinterpret_cast<KrStateMethod*>(method), 1, 0.0, 1.0, reinterpret_cast<double*>(samples), n,
                           reinterpret_cast<double*>(result), reinterpret_cast<KrMarkers*>(box)),
        0);
    double period;
    std::memcpy(&period, result, sizeof period);
    EXPECT_EQ(period, 4.0);
}

class Cache : public testing::Test {
  protected:
    Cache() { other_.samples = {5, 5, 9, 9, 9, 5, 5, 5, 9, 9, 9, 5, 5, 5, 9, 9, 9, 5, 5}; }

    double Mean(const Block& block) { return Fetch(context_.id(), KRN_MEAN, block).value; }

    NewContext context_;
    Block block_ = Square();
    Block other_;
    const double mean_ = 6.0 / 14.0;
    const double other_mean_ = (9 * 9 + 10 * 5) / 19.0;
};

TEST_F(Cache, KeepsValuesUntilCleared) {
    EXPECT_EQ(Mean(block_), mean_);
    other_.t0 = 50.0;
    other_.dt = 0.5;
    EXPECT_EQ(Mean(other_), mean_) << "neither samples nor their times are compared";
    EXPECT_EQ(Fetch(context_.id(), KRN_RMS, other_).value, std::sqrt((9 * 81 + 10 * 25) / 19.0)) << "not known yet";
    EXPECT_EQ(measurements_clear(context_.id()), 0);
    EXPECT_EQ(Mean(other_), other_mean_);
    EXPECT_EQ(measurements_clear(context_.id()), 0);
    EXPECT_EQ(measurements_clear(context_.id()), 0);
}

TEST_F(Cache, ForgetsWhenAnyParameterChanges) {
    const auto expect_forgotten = [this](const char* what) {
        EXPECT_EQ(Mean(other_), other_mean_) << what;
        block_.levels = other_.levels;
        block_.method = other_.method;
        block_.occurrence = other_.occurrence;
        measurements_clear(context_.id());
        EXPECT_EQ(Mean(block_), mean_);
        EXPECT_EQ(Mean(other_), mean_) << what;
    };
    EXPECT_EQ(Mean(block_), mean_);
    other_.levels.high += 1.0;
    expect_forgotten("high");
    other_.levels.mid += 1.0;
    expect_forgotten("mid");
    other_.levels.low += 1.0;
    expect_forgotten("low");
    other_.levels.units = KRN_LEVELS_ABSOLUTE;
    expect_forgotten("units");
    other_.method.method = KRN_STATES_BY_EITHER;
    expect_forgotten("method");
    other_.method.bins += 1;
    expect_forgotten("bins");
    other_.occurrence += 1;
    expect_forgotten("occurrence");
}

TEST_F(Cache, OccurrencesOfCyclesCountCrossings) {
    EXPECT_EQ(Mean(block_), mean_);
    EXPECT_EQ(Fetch(context_.id(), KRN_PERIOD, block_).value, 4.0);
    EXPECT_EQ(Mean(other_), mean_) << "1 and 2 * 1 - 1 are the same";
    block_.occurrence = other_.occurrence = 2;
    EXPECT_EQ(Mean(block_), mean_);
    EXPECT_EQ(Fetch(context_.id(), KRN_PERIOD, other_).value, 6.0) << "2 and 3 are not";
    block_.occurrence = 3;
    EXPECT_EQ(Mean(block_), mean_);
    EXPECT_EQ(Fetch(context_.id(), KRN_RANGE, block_).value, 4.0) << "found for the other signal's period";
}

TEST_F(Cache, KeepsAFailureNot) {
    Block flat = block_;
    flat.samples.assign(8, 1.0);
    flat.method.method = block_.method.method = KRN_STATES_BY_HISTOGRAM;
    EXPECT_EQ(Fetch(context_.id(), KRN_HIGH_STATE, flat).status, kFlatHistogram);
    measurements_clear(context_.id());
    EXPECT_EQ(Fetch(context_.id(), KRN_HIGH_STATE, block_).status, 0);
}

// Extremes are found together, and well filled states serve as top and base.
TEST_F(Cache, FillsWhatItComesBy) {
    EXPECT_EQ(Fetch(context_.id(), KRN_SMALLEST, block_).value, 0.0);
    EXPECT_EQ(Fetch(context_.id(), KRN_LARGEST, other_).value, 1.0);
    measurements_clear(context_.id());
    const Outcome high = Fetch(context_.id(), KRN_HIGH_STATE, block_);
    const Outcome top = Fetch(context_.id(), KRN_TOP, other_);
    EXPECT_EQ(top.value, high.value);
    EXPECT_EQ(top.box, high.box);
    const Outcome low = Fetch(context_.id(), KRN_LOW_STATE, block_);
    EXPECT_EQ(Fetch(context_.id(), KRN_BASE, other_).value, low.value);
}

// Edges that were found in a long block are asked for in a short one.
TEST_F(Cache, StaysWithinAShorterBlock) {
    Block longer = block_;
    for (int i = 0; i < 100; ++i) longer.samples.insert(longer.samples.end(), {1, 1, 0, 0});
    longer.occurrence = block_.occurrence = 40;
    EXPECT_EQ(Fetch(context_.id(), KRN_RISE_TIME, longer).status, 0);
    EXPECT_EQ(Fetch(context_.id(), KRN_PERIOD, longer).status, 0);
    longer.occurrence = block_.occurrence = 9;
    EXPECT_EQ(Fetch(context_.id(), KRN_RISE_TIME, longer).status, 0);
    for (const int32_t kind : {KRN_OVERSHOOT, KRN_UNDERSHOOT, KRN_NEXT_OVERSHOOT, KRN_NEXT_UNDERSHOOT})
        EXPECT_EQ(Fetch(context_.id(), kind, block_).status, kTooFewCrossings);
    longer.occurrence = block_.occurrence = 5;
    EXPECT_EQ(Fetch(context_.id(), KRN_PERIOD, longer).status, 0);
    for (const int32_t kind : {KRN_CYCLE_MEAN, KRN_CYCLE_RMS})
        EXPECT_EQ(Fetch(context_.id(), kind, block_).status, kNoPeriod);
}

}  // namespace
}  // namespace krnumer

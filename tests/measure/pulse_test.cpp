// Every measurement on pulses that can be computed by hand.

#include "frame/numeric.h"
#include "frame/status.h"
#include "measure/measuring.h"

namespace krnumer {
namespace {

// Pulses of height 10: rise from 10 to 14, fall from 30 to 38, period 50; so the middle is crossed at 12, 34, 62, 84,
// 112 and 134.
Block Trapezoids() {
    Block block;
    block.samples = Polyline(160, {{10, 0},
                                   {14, 10},
                                   {30, 10},
                                   {38, 0},
                                   {60, 0},
                                   {64, 10},
                                   {80, 10},
                                   {88, 0},
                                   {110, 0},
                                   {114, 10},
                                   {130, 10},
                                   {138, 0},
                                   {200, 0}});
    return block;
}

// The same, from the middle of the first pulse on.
Block FromAPulse() {
    Block block = Trapezoids();
    block.samples.erase(block.samples.begin(), block.samples.begin() + 20);
    return block;
}

TEST(Pulses, Levels) {
    Block block = Trapezoids();
    EXPECT_EQ(ValueOf(KRN_SMALLEST, block), 0.0);
    EXPECT_EQ(ValueOf(KRN_LARGEST, block), 10.0);
    EXPECT_EQ(ValueOf(KRN_RANGE, block), 10.0);
    EXPECT_EQ(ValueOf(KRN_LOW_REFERENCE, block), 1.0);
    EXPECT_EQ(ValueOf(KRN_MID_REFERENCE, block), 5.0);
    EXPECT_EQ(ValueOf(KRN_HIGH_REFERENCE, block), 9.0);
    EXPECT_EQ(ValueOf(KRN_BAND, block), 4.0);
    block.levels = {8.0, 6.0, 1.5, KRN_LEVELS_ABSOLUTE};
    EXPECT_EQ(ValueOf(KRN_LOW_REFERENCE, block), 1.5);
    EXPECT_EQ(ValueOf(KRN_MID_REFERENCE, block), 6.0);
    EXPECT_EQ(ValueOf(KRN_HIGH_REFERENCE, block), 8.0);
    EXPECT_EQ(ValueOf(KRN_BAND, block), 2.0);
    block.method = {99, -1};  // absolute levels need no states
    EXPECT_EQ(ValueOf(KRN_PERIOD, block), 50.0);
}

TEST(Pulses, Cycles) {
    Block block = Trapezoids();
    for (block.occurrence = 1; block.occurrence <= 2; ++block.occurrence) {
        EXPECT_EQ(ValueOf(KRN_PERIOD, block), 50.0);
        EXPECT_EQ(ValueOf(KRN_FREQUENCY, block), 0.02);
        EXPECT_EQ(ValueOf(KRN_CYCLE_MEAN, block), 4.4);
        EXPECT_EQ(ValueOf(KRN_CYCLE_RMS, block), std::sqrt(40.125));
        EXPECT_EQ(ValueOf(KRN_DUTY_HIGH, block), 0.44);
        EXPECT_EQ(ValueOf(KRN_DUTY_LOW, block), 0.56);
        EXPECT_EQ(ValueOf(KRN_POSITIVE_WIDTH, block), 22.0);
        EXPECT_EQ(ValueOf(KRN_NEGATIVE_WIDTH, block), 28.0);
        EXPECT_EQ(ValueOf(KRN_POSITIVE_CENTER, block), 50 * block.occurrence - 27.0);
        EXPECT_EQ(ValueOf(KRN_NEGATIVE_CENTER, block), 50 * block.occurrence - 2.0);
    }
    for (const int32_t kind : {KRN_PERIOD, KRN_FREQUENCY, KRN_CYCLE_MEAN, KRN_CYCLE_RMS, KRN_DUTY_HIGH, KRN_DUTY_LOW,
                               KRN_POSITIVE_WIDTH, KRN_NEGATIVE_WIDTH, KRN_POSITIVE_CENTER, KRN_NEGATIVE_CENTER})
        EXPECT_EQ(StatusOf(kind, block), kTooFewCrossings) << kind << ": the third cycle has no end";
}

TEST(Pulses, CyclesOfASignalThatStartsHigh) {
    Block block = FromAPulse();
    EXPECT_EQ(ValueOf(KRN_PERIOD, block), 50.0);
    EXPECT_EQ(ValueOf(KRN_CYCLE_MEAN, block), 4.4 - 0.05 + 0.05) << "samples 14 to 63";
    EXPECT_EQ(ValueOf(KRN_DUTY_HIGH, block), 0.44);
    EXPECT_EQ(ValueOf(KRN_DUTY_LOW, block), 0.56);
    EXPECT_EQ(ValueOf(KRN_POSITIVE_WIDTH, block), 22.0);
    EXPECT_EQ(ValueOf(KRN_NEGATIVE_WIDTH, block), 28.0);
    EXPECT_EQ(ValueOf(KRN_NEGATIVE_CENTER, block), 28.0) << "the first complete one is from 14 to 42";
    EXPECT_EQ(ValueOf(KRN_POSITIVE_CENTER, block), 53.0) << "the first complete one is from 42 to 64";
    block.occurrence = 2;
    EXPECT_EQ(ValueOf(KRN_POSITIVE_CENTER, block), 103.0);
    EXPECT_EQ(ValueOf(KRN_NEGATIVE_CENTER, block), 78.0);
}

TEST(Pulses, Transitions) {
    Block block = Trapezoids();
    for (block.occurrence = 1; block.occurrence <= 3; ++block.occurrence) {
        EXPECT_THAT(ValueOf(KRN_RISE_TIME, block), Near(3.2, 1e-13));
        EXPECT_THAT(ValueOf(KRN_FALL_TIME, block), Near(6.4, 1e-13));
        EXPECT_THAT(ValueOf(KRN_RISING_SLEW, block), Near(2.5, 1e-13));
        EXPECT_THAT(ValueOf(KRN_FALLING_SLEW, block), Near(1.25, 1e-13));
    }
    for (const int32_t kind : {KRN_RISE_TIME, KRN_FALL_TIME, KRN_RISING_SLEW, KRN_FALLING_SLEW})
        EXPECT_EQ(StatusOf(kind, block), kTooFewCrossings) << kind;
    block = FromAPulse();
    EXPECT_THAT(ValueOf(KRN_RISE_TIME, block), Near(3.2, 1e-13));
    EXPECT_THAT(ValueOf(KRN_FALL_TIME, block), Near(6.4, 1e-13));
    block.occurrence = 3;
    EXPECT_EQ(StatusOf(KRN_FALL_TIME, block), kTooFewCrossings) << "edge 5 is there, 6 is not";
}

TEST(Pulses, ALoneStepHasNoRiseTime) {
    Block block;
    block.samples = {0, 0, 5, 10, 10};
    EXPECT_EQ(StatusOf(KRN_RISE_TIME, block), kTooFewCrossings);
    block.samples = {0, 0, 5, 10, 10, 0};
    EXPECT_THAT(ValueOf(KRN_RISE_TIME, block), Near(1.6, 1e-15));
    EXPECT_THAT(ValueOf(KRN_FALL_TIME, block), Near(0.8, 1e-15));
}

TEST(Pulses, SquareWaveRisesBetweenTwoSamples) {
    Block block;
    block.samples = {0, 0, 1, 1, 0, 0, 1, 1, 0};
    EXPECT_THAT(ValueOf(KRN_RISE_TIME, block), Near(0.8, 1e-15));
    EXPECT_EQ(ValueOf(KRN_PERIOD, block), 4.0);
}

TEST(Pulses, OnATimeAxis) {
    Block block = Trapezoids();
    block.t0 = -3.0;
    block.dt = 0.5;
    EXPECT_EQ(ValueOf(KRN_PERIOD, block), 25.0);
    EXPECT_EQ(ValueOf(KRN_POSITIVE_CENTER, block), 8.5);
    EXPECT_EQ(ValueOf(KRN_CYCLE_MEAN, block), 4.4);
    EXPECT_THAT(ValueOf(KRN_RISING_SLEW, block), Near(5.0, 1e-13));
}

// Bins of width 1 about whole numbers: the states are exactly 0 and 10.
Block Ringing() {
    Block block;
    block.method = {KRN_STATES_BY_HISTOGRAM, 11};
    for (int pulse = 0; pulse < 3; ++pulse) {
        block.samples.insert(block.samples.end(), {0, 0, 0, 0, 0, 0, 10.5, 10, 10, 10, 10, 10, 10, -0.5, 0});
    }
    return block;
}

TEST(Pulses, Overshoot) {
    Block block = Ringing();
    EXPECT_EQ(ValueOf(KRN_LOW_STATE, block), 0.0);
    EXPECT_EQ(ValueOf(KRN_HIGH_STATE, block), 10.0);
    for (block.occurrence = 1; block.occurrence <= 2; ++block.occurrence) {
        EXPECT_EQ(ValueOf(KRN_UNDERSHOOT, block), 5.0) << "a falling edge";
        EXPECT_EQ(ValueOf(KRN_OVERSHOOT, block), 0.0);
        EXPECT_EQ(ValueOf(KRN_NEXT_OVERSHOOT, block), 5.0) << "a rising edge";
        EXPECT_EQ(ValueOf(KRN_NEXT_UNDERSHOOT, block), 0.0);
    }
    EXPECT_EQ(ValueOf(KRN_UNDERSHOOT, block), 5.0) << "behind the last edge the signal counts to its end";
    EXPECT_EQ(StatusOf(KRN_NEXT_OVERSHOOT, block), kTooFewCrossings);
    block.samples.erase(block.samples.begin(), block.samples.begin() + 8);  // starts high
    block.occurrence = 1;
    EXPECT_EQ(ValueOf(KRN_OVERSHOOT, block), 5.0);
    EXPECT_EQ(ValueOf(KRN_UNDERSHOOT, block), 0.0);
    EXPECT_EQ(ValueOf(KRN_NEXT_UNDERSHOOT, block), 5.0);
}

// The stretch about edge j: from half way after edge j - 1 to half way before edge j + 1, both samples included.
TEST(Pulses, StretchAboutAnEdge) {
    Block block = Ringing();
    // Edges lie behind samples 5, 12, 20, 27, 35 and 42; so the stretch of edge 2 goes from 8 to 16.
    const auto overshoot_with = [&](std::size_t sample) {
        Block changed = block;
        changed.samples[sample] = changed.samples[sample] > 5.0 ? 10.5 : -0.5;
        return std::pair(ValueOf(KRN_OVERSHOOT, changed), ValueOf(KRN_UNDERSHOOT, changed));
    };
    block.samples[13] = 0.0;
    EXPECT_EQ(overshoot_with(7), std::pair(0.0, 0.0));
    EXPECT_EQ(overshoot_with(8), std::pair(5.0, 0.0));
    EXPECT_EQ(overshoot_with(16), std::pair(0.0, 5.0));
    EXPECT_EQ(overshoot_with(17), std::pair(0.0, 0.0));
    const KrMarkers box = Fetch(KRN_OVERSHOOT, block).box;
    EXPECT_EQ(box.left, 8.0);
    EXPECT_EQ(box.right, 16.0);
}

TEST(Pulses, StatesOfTheHistogram) {
    Block block;
    block.method = {KRN_STATES_BY_HISTOGRAM, 5};
    block.samples = {0, 1, 2, 3, 4, 5};  // counts 1 1 1 1 2, from bins 3 up and 2 down
    EXPECT_EQ(ValueOf(KRN_HIGH_STATE, block), 4.5);
    EXPECT_EQ(ValueOf(KRN_LOW_STATE, block), 0.5) << "of equal bins the lowest";
    block.samples = {0, 1, 1, 2, 3, 3, 4};  // width 0.8, counts 1 2 1 2 1
    EXPECT_THAT(ValueOf(KRN_HIGH_STATE, block), Near(2.8, 1e-15));
    EXPECT_THAT(ValueOf(KRN_LOW_STATE, block), Near(1.2, 1e-15));
    EXPECT_THAT(ValueOf(KRN_AMPLITUDE, block), Near(1.6, 1e-15));
    block.method.bins = 1;
    EXPECT_EQ(ValueOf(KRN_HIGH_STATE, block), 2.0);
    EXPECT_EQ(ValueOf(KRN_LOW_STATE, block), 2.0);
    EXPECT_EQ(StatusOf(KRN_UNDERSHOOT, block), kResultNotFinite) << "in percent of nothing";
    for (const int32_t bins : {0, -1, -2147483647}) {
        block.method.bins = bins;
        EXPECT_EQ(StatusOf(KRN_HIGH_STATE, block), kNoBins);
        EXPECT_EQ(StatusOf(KRN_TOP, block), kNoBins);
    }
    block.method.bins = 1000000;
    EXPECT_THAT(ValueOf(KRN_HIGH_STATE, block), Near(3.0, 1e-6));
}

TEST(Pulses, NumbersThatAreNoneCountInTheFirstBin) {
    Block block;
    block.method = {KRN_STATES_BY_HISTOGRAM, 4};
    block.samples = {0, kQuietNaN, kQuietNaN, 1.1, 1.2, 4};
    EXPECT_EQ(ValueOf(KRN_LOW_STATE, block), 0.5);
}

// 20 samples: a bin with one of them holds five percent and is not well filled.
TEST(Pulses, TopAndBaseNeedMoreThanFivePercent) {
    Block block;
    block.method = {KRN_STATES_BY_HISTOGRAM, 10};
    block.samples.assign(20, 5.0);
    block.samples[3] = 0.0;
    block.samples[9] = 10.0;
    EXPECT_EQ(ValueOf(KRN_HIGH_STATE, block), 9.5);
    EXPECT_EQ(ValueOf(KRN_TOP, block), 10.0) << "the largest sample";
    EXPECT_EQ(ValueOf(KRN_LOW_STATE, block), 5.5 - 5.0) << "bin 5 is not looked at";
    EXPECT_EQ(ValueOf(KRN_BASE, block), 0.0);
    EXPECT_EQ(ValueOf(KRN_TOP_TO_BASE, block), 10.0);
    block.samples[10] = 10.0;
    EXPECT_EQ(ValueOf(KRN_TOP, block), 9.5) << "two of twenty are enough";
    EXPECT_EQ(ValueOf(KRN_TOP_TO_BASE, block), 9.5);
}

TEST(Pulses, PercentagesByEachMethod) {
    Block block;
    block.samples.assign(20, 5.0);
    block.samples[3] = 0.0;
    block.samples[9] = block.samples[10] = 10.0;
    block.method = {KRN_STATES_BY_HISTOGRAM, 10};
    block.levels = {90, 50, 20, KRN_LEVELS_PERCENT};
    EXPECT_EQ(ValueOf(KRN_MID_REFERENCE, block), 5.0);
    EXPECT_EQ(ValueOf(KRN_BAND, block), 2.7);
    block.method.method = KRN_STATES_BY_EXTREMES;
    EXPECT_EQ(ValueOf(KRN_LOW_REFERENCE, block), 2.0);
    EXPECT_EQ(ValueOf(KRN_BAND, block), 3.0);
    block.method.method = KRN_STATES_BY_EITHER;
    EXPECT_EQ(ValueOf(KRN_MID_REFERENCE, block), 4.75);
    EXPECT_THAT(ValueOf(KRN_BAND, block), Near(2.85, 1e-15));
    for (const int32_t bad : {-1, 3}) {
        block.method.method = bad;
        for (const int32_t kind : {KRN_LOW_REFERENCE, KRN_BAND, KRN_PERIOD, KRN_RISE_TIME, KRN_OVERSHOOT})
            EXPECT_EQ(StatusOf(kind, block), kBadStateMethod);
        EXPECT_EQ(ValueOf(KRN_AMPLITUDE, block), 9.0);
    }
    for (const int16_t bad : {int16_t{-1}, int16_t{2}}) {
        block.levels.units = bad;
        for (const int32_t kind : {KRN_LOW_REFERENCE, KRN_BAND, KRN_PERIOD, KRN_RISE_TIME, KRN_OVERSHOOT})
            EXPECT_EQ(StatusOf(kind, block), kBadUnits);
    }
}

TEST(Pulses, FlatSignals) {
    Block block;
    block.samples.assign(30, -3.0);
    EXPECT_EQ(ValueOf(KRN_RMS, block), 3.0);
    EXPECT_EQ(ValueOf(KRN_MEAN, block), -3.0);
    EXPECT_EQ(ValueOf(KRN_RANGE, block), 0.0);
    const auto expect_all = [&](int32_t status) {
        for (const int32_t kind : CountingMeasurements()) EXPECT_EQ(StatusOf(kind, block), status) << kind;
    };
    expect_all(kTooFewCrossings);  // levels right on the signal, without a band
    block.levels = {-3, -3, -3, KRN_LEVELS_ABSOLUTE};
    expect_all(kTooFewCrossings);
    block.levels = {90, 50, 10, KRN_LEVELS_PERCENT};
    for (const int32_t method : {KRN_STATES_BY_HISTOGRAM, KRN_STATES_BY_EITHER}) {
        block.method.method = method;
        expect_all(kFlatHistogram);
    }
    for (const int32_t kind : {KRN_LOW_STATE, KRN_HIGH_STATE, KRN_AMPLITUDE, KRN_TOP, KRN_BASE, KRN_TOP_TO_BASE})
        EXPECT_EQ(StatusOf(kind, block), kFlatHistogram);
}

TEST(Pulses, NoSlewWithoutDuration) {
    Block block;
    block.samples = {0, 0, 1, 1, 0, 0, 1};
    block.levels = {0.5, 0.5, 0.5, KRN_LEVELS_ABSOLUTE};
    EXPECT_EQ(ValueOf(KRN_RISE_TIME, block), 0.0);
    for (const int32_t kind : {KRN_RISING_SLEW, KRN_FALLING_SLEW}) {
        const Outcome outcome = Fetch(kind, block);
        EXPECT_EQ(outcome.status, kZeroTransition);
        EXPECT_EQ(outcome.value, 0.5) << "the high reference level";
        EXPECT_EQ(outcome.box, kUntouched);
    }
}

TEST(Pulses, SignalsRightOnALevelWithoutABand) {
    Block block;
    block.levels = {0, 0, 0, KRN_LEVELS_ABSOLUTE};
    block.samples = {0, 0, 0, 0, 0, 1};
    EXPECT_EQ(ValueOf(KRN_PERIOD, block), 2.0) << "every sample is a crossing";
    block.samples = {-1, 0, 0, 1, 1};
    EXPECT_EQ(ValueOf(KRN_PERIOD, block), 1.0);
    block.samples = {0, 0, 1, 1, 1};
    EXPECT_EQ(StatusOf(KRN_PERIOD, block), kTooFewCrossings);
}

// So late on the time axis that all samples are at the same time.
TEST(Pulses, CyclesWithoutDuration) {
    Block block = Trapezoids();
    block.t0 = 1e20;
    EXPECT_EQ(ValueOf(KRN_PERIOD, block), 0.0);
    EXPECT_EQ(StatusOf(KRN_FREQUENCY, block), kNoPeriod);
    EXPECT_EQ(StatusOf(KRN_CYCLE_MEAN, block), kNoPeriod);
    EXPECT_EQ(StatusOf(KRN_CYCLE_RMS, block), kNoPeriod);
    EXPECT_EQ(StatusOf(KRN_DUTY_HIGH, block), kResultNotFinite);
    EXPECT_EQ(StatusOf(KRN_RISING_SLEW, block), kZeroTransition);
}

TEST(Pulses, Markers) {
    Block block = Trapezoids();
    block.t0 = 100.0;
    block.dt = 2.0;
    const double end = 100.0 + 2.0 * 160;
    EXPECT_EQ(Fetch(KRN_MID_REFERENCE, block).box, (KrMarkers{100, 100, {end, 5.0, 0, 0}}));
    EXPECT_EQ(Fetch(KRN_MEAN, block).box.values[0], end);
    EXPECT_EQ(Fetch(KRN_RANGE, block).box, (KrMarkers{100, 100, {end, 0.0, 10.0, 0}}));
    block.method.bins = 10;
    EXPECT_EQ(Fetch(KRN_HIGH_STATE, block).box, (KrMarkers{100, 100, {end, 9.0, 9.5, 10.0}}));
    EXPECT_EQ(Fetch(KRN_TOP, block).box, (KrMarkers{100, 100, {end, 9.0, 9.5, 10.0}}));
    EXPECT_EQ(Fetch(KRN_LOW_STATE, block).box, (KrMarkers{100, 100, {end, 0.0, 0.5, 1.0}}));
    EXPECT_EQ(Fetch(KRN_PERIOD, block).box, (KrMarkers{124, 224, {5, 5, 0, 0}}));
    EXPECT_EQ(Fetch(KRN_NEGATIVE_WIDTH, block).box, (KrMarkers{168, 224, {5, 5, 0, 0}}));
    const KrMarkers rise = Fetch(KRN_RISE_TIME, block).box;
    EXPECT_THAT(rise.left, Near(120.8, 1e-14));
    EXPECT_THAT(rise.right, Near(127.2, 1e-14));
    EXPECT_EQ(rise.values[0], 1.0);
    EXPECT_EQ(rise.values[1], 9.0);
    EXPECT_EQ(Fetch(KRN_FALL_TIME, block).box.values[0], 9.0);
}

}  // namespace
}  // namespace krnumer

// Measures of a pulse, as core and as export.

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cmath>

#include "frame/numeric.h"
#include "frame/status.h"
#include "krnumer/sigop.h"
#include "sigop/pulse_parameters.h"
#include "sigop/signals.h"
#include "support/host_arrays.h"

namespace krnumer {
namespace {

using testing::Each;
using testing::ElementsAre;

PulseMeasures Measured(const std::vector<double>& x) {
    PulseMeasures measures{};
    EXPECT_EQ(MeasurePulse(x.data(), Size(x), &measures), kOk);
    return measures;
}

// 20 samples of 0, 10 rising by 1, 30 of 10, 20 falling by 0.5, 20 of 0.
std::vector<double> Trapezoid() {
    std::vector<double> x;
    for (int i = 0; i < 20; ++i) x.push_back(0);
    for (int i = 1; i <= 10; ++i) x.push_back(i);
    for (int i = 0; i < 30; ++i) x.push_back(10);
    for (int i = 1; i <= 20; ++i) x.push_back(10 - 0.5 * i);
    for (int i = 0; i < 20; ++i) x.push_back(0);
    return x;
}

// Bins are a 101st of the span wide, and the states are their centers.
TEST(Pulse, MeasuresATrapezoid) {
    const PulseMeasures m = Measured(Trapezoid());
    const double half_bin = 10.0 / 202;
    EXPECT_NEAR(m.base, half_bin, 1e-13);
    EXPECT_NEAR(m.top, 10 - half_bin, 1e-13);
    EXPECT_NEAR(m.amplitude, 10 - 2 * half_bin, 1e-13);
    EXPECT_NEAR(m.overshoot, half_bin, 1e-13);
    EXPECT_NEAR(m.undershoot, half_bin, 1e-13);
    // The rising edge is at value v at time 19 + v, the falling one at 59 + 2 (10 - v).
    EXPECT_NEAR(m.delay, 24, 1e-12);
    EXPECT_NEAR(m.width, 69 - 24, 1e-12);
    EXPECT_NEAR(m.rise_time, 0.8 * m.amplitude, 1e-12);
    EXPECT_NEAR(m.fall_time, 1.6 * m.amplitude, 1e-12);
    EXPECT_NEAR(m.slew_rate, 1, 1e-12);
}

TEST(Pulse, ANegativePulseHasTheTimesOfItsMirrorImage) {
    std::vector<double> x = Trapezoid();
    x[35] = 10.7;
    x[5] = -0.4;
    const PulseMeasures up = Measured(x);
    for (double& value : x) value = -value;
    const PulseMeasures down = Measured(x);
    EXPECT_NEAR(down.amplitude, -up.amplitude, 1e-12);
    EXPECT_NEAR(down.top, -up.top, 1e-12);
    EXPECT_NEAR(down.base, -up.base, 1e-12);
    EXPECT_NEAR(down.overshoot, up.undershoot, 1e-12);  // of the upper and of the lower level, whichever is the top
    EXPECT_NEAR(down.undershoot, up.overshoot, 1e-12);
    EXPECT_NEAR(down.delay, up.delay, 1e-12);
    EXPECT_NEAR(down.width, up.width, 1e-12);
    EXPECT_NEAR(down.rise_time, up.rise_time, 1e-12);
    EXPECT_NEAR(down.fall_time, up.fall_time, 1e-12);
    EXPECT_NEAR(down.slew_rate, -up.slew_rate, 1e-12);
}

TEST(Pulse, AConstantHasNeitherAmplitudeNorTimes) {
    for (const int n : {2, 3, 50}) {
        const PulseMeasures m = Measured(std::vector<double>(Count(n), 3.5));
        EXPECT_EQ(m.top, 3.5);
        EXPECT_EQ(m.base, 3.5);
        EXPECT_EQ(m.amplitude, 0);
        EXPECT_EQ(m.overshoot, 0);
        EXPECT_EQ(m.undershoot, 0);
        EXPECT_EQ(m.delay, 0);
        EXPECT_EQ(m.width, 0);
        EXPECT_EQ(m.rise_time, 0);
        EXPECT_EQ(m.fall_time, 0);
        EXPECT_EQ(m.slew_rate, 1e30);
    }
}

TEST(Pulse, ASingleSampleIsItsOwnEnd) {
    const PulseMeasures m = Measured({7});
    EXPECT_EQ(m.top, 7);
    EXPECT_EQ(m.delay, 0);
    EXPECT_EQ(m.rise_time, 2);
    EXPECT_EQ(m.width, 0);
    EXPECT_EQ(m.fall_time, 2);
    EXPECT_EQ(m.slew_rate, 0);
}

TEST(Pulse, APulseThatEndsHighIsMeasuredToItsEnd) {
    std::vector<double> x = Trapezoid();
    x.resize(60);  // to the end of the top
    const PulseMeasures m = Measured(x);
    EXPECT_NEAR(m.delay, 24, 1e-12);
    EXPECT_NEAR(m.width, 59 - m.delay, 1e-12);
    EXPECT_EQ(m.fall_time, 2);
}

// A level that only the last sample meets is not interpolated.
TEST(Pulse, ACrossingAtTheLastSampleIsTheEnd) {
    const PulseMeasures m = Measured({0, 0, 0, 0, 1});
    EXPECT_EQ(m.delay, 4);
    EXPECT_EQ(m.rise_time, 5 - 3);
    EXPECT_EQ(m.width, 0);
    EXPECT_EQ(m.fall_time, 6);
}

// The middle bin belongs to the upper half and needs more samples than any other there.
TEST(Pulse, TheMiddleBinCompetesForTheTop) {
    std::vector<double> x{0, 0, 0, 50.5, 50.5, 101, 101};
    EXPECT_NEAR(Measured(x).top, 100.5, 1e-9);
    x.insert(x.begin() + 4, 50.5);
    const PulseMeasures m = Measured(x);
    EXPECT_NEAR(m.top, 50.5, 1e-9);
    EXPECT_NEAR(m.base, 0.5, 1e-9);
    EXPECT_NEAR(m.overshoot, 50.5, 1e-9);
}

TEST(Pulse, SurvivesWhatIsNotFinite) {
    PulseMeasures m{};
    for (const double value : {kQuietNaN, kInfinity, -kInfinity}) {
        for (size_t place = 0; place < 5; ++place) {
            std::vector<double> x{0, 1, 2, 1, 0};
            x[place] = value;
            EXPECT_EQ(MeasurePulse(x.data(), 5, &m), kOk);
        }
        const std::vector<double> all(4, value);
        EXPECT_EQ(MeasurePulse(all.data(), 4, &m), kOk);
    }
}

TEST(Pulse, ExportDeliversAllMeasures) {
    const LeakCheck leaks;
    const std::vector<double> samples = Trapezoid();
    const HostArray<double> x(samples), none;
    double m[10];
    int32_t err = 77;
    const auto measure = [&](KrHandle handle) {
        std::fill_n(m, 10, -1.0);
        return PulseParameters(handle, m, m + 1, m + 2, m + 3, m + 4, m + 5, m + 6, m + 7, m + 8, m + 9, &err);
    };
    EXPECT_EQ(measure(x.handle()), 0);
    EXPECT_EQ(err, 0);
    const PulseMeasures p = Measured(samples);
    EXPECT_THAT(m, ElementsAre(p.top, p.base, p.amplitude, p.delay, p.width, p.slew_rate, p.fall_time, p.rise_time,
                               p.overshoot, p.undershoot));
    EXPECT_EQ(measure(none.handle()), 0);
    EXPECT_EQ(err, kEmptyInput);
    EXPECT_THAT(m, Each(0.0));
}

}  // namespace
}  // namespace krnumer

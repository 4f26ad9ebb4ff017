// Frequency and phase modulation, as cores and as exports.

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cmath>

#include "frame/numeric.h"
#include "frame/status.h"
#include "krnumer/sigop.h"
#include "sigop/angle_modulation.h"
#include "sigop/signals.h"
#include "support/host_arrays.h"

namespace krnumer {
namespace {

constexpr double kTurn = 6.283185307179586;

TEST(AngleModulation, AgreesWithSinesOfUnwrappedAngles) {
    const Golden golden("time_domain");
    for (const std::string& name : golden.Cases("carrier")) {
        SCOPED_TRACE(name);
        const auto& parameters = golden.Reals(name + ".parameters");
        const double c = parameters[0], f = parameters[1];
        auto x = golden.Reals(name + ".x");
        AngleModulator modulator{parameters[2], 0.0};
        ModulateFrequency(x.data(), Size(x), c, f, &modulator);
        EXPECT_THAT(x, AllNear(golden.Reals(name + ".frequency"), 0.0, 1e-12));
        x = golden.Reals(name + ".x");
        for (double& sample : x) sample *= 100;
        modulator = {parameters[2], 0.0};
        ModulatePhase(x.data(), Size(x), c, f, &modulator);
        EXPECT_THAT(x, AllNear(golden.Reals(name + ".phase"), 0.0, 1e-12));
    }
}

TEST(AngleModulation, BlocksContinueEachOther) {
    RandomSignals random;
    const auto message = random.Samples<double>(500);
    for (const auto modulate : {FreqMod, PhasMod}) {
        auto whole = message, blocks = message;
        double angle = 0, peak = 0, phase = 0.3, block_angle = 0, block_peak = 0, block_phase = 0.3;
        EXPECT_EQ(modulate(500, 0.7, &angle, 0.2, whole.data(), &peak, &phase), 0);
        for (int32_t first = 0; first < 500;) {
            const int32_t n = std::min(random.Integer(0, 30), 500 - first);
            EXPECT_EQ(modulate(n, 0.7, &block_angle, 0.2, blocks.data() + first, &block_peak, &block_phase), 0);
            first += n;
        }
        EXPECT_THAT(blocks, SameBitsAs(whole));
        EXPECT_EQ(block_phase, phase);
        EXPECT_EQ(block_peak, peak);
        EXPECT_EQ(block_angle, angle);
    }
}

TEST(AngleModulation, ThePhaseGoesUpBelowItsPeriodAndDownAboveIt) {
    double angle = 0, peak = 0, phase = 0;
    double x = 0;
    FreqMod(1, 2.0, &angle, 0.25, &x, &peak, &phase);
    const double quarter = 0.25 * kTurn;
    EXPECT_EQ(phase, quarter + kTurn / 2.0);
    EXPECT_EQ(x, std::sin(2.0 * phase));
    EXPECT_EQ(angle, 2.0 * phase * 57.29577951308232);
    x = 0;
    const double before = phase + quarter;
    PhasMod(1, 2.0, &angle, 0.25, &x, &peak, &phase);
    EXPECT_EQ(phase, before - kTurn / 2.0);
    EXPECT_EQ(angle, 2.0 * phase * 57.29577951308232 + x);
}

TEST(AngleModulation, ThePeakComparesWholeNumbersAndKeepsTheSample) {
    const auto peak_after = [](double peak, std::vector<double> message) {
        double angle = 0, phase = 0;
        FreqMod(Size(message), 1.0, &angle, 0.0, message.data(), &peak, &phase);
        return peak;
    };
    EXPECT_EQ(peak_after(0, {0.9, -0.9}), 0);
    EXPECT_EQ(peak_after(0, {1.9, 1.2, -1.99}), 1.9);
    EXPECT_EQ(peak_after(0, {1.9, -2.5, 2.7}), -2.5);
    EXPECT_EQ(peak_after(5, {4e9, -4e9, kQuietNaN, kInfinity, 2147483648.0}), 5);
    EXPECT_EQ(peak_after(5, {2147483647.5}), 2147483647.5);
    EXPECT_EQ(peak_after(4e9, {1.5}), 1.5);
}

TEST(AngleModulation, NoSamplesGiveTheAngleOfThePhase) {
    double angle = 0, peak = 3, phase = 0.5, data = 9;
    for (const int32_t n : {0, -5}) {
        EXPECT_EQ(FreqMod(n, 2.0, &angle, 0.1, &data, &peak, &phase), 0);
        EXPECT_EQ(angle, 57.29577951308232);
        EXPECT_EQ(PhasMod(n, 2.0, &angle, 0.1, &data, &peak, &phase), 0);
        EXPECT_EQ(angle, 57.29577951308232);
    }
    EXPECT_EQ(data, 9);
    EXPECT_EQ(peak, 3);
    EXPECT_EQ(phase, 0.5);
}

}  // namespace
}  // namespace krnumer

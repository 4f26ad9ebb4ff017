#include <algorithm>
#include <cmath>

#include "frame/numeric.h"
#include "frame/status.h"
#include "gen/reference.h"
#include "gen/wave.h"

namespace krnumer {
namespace {

#include "reference/gen/sine_wave.inc"

// The recurrence written down as it is defined, sine and cosine side by side, with no regard to speed.
std::vector<double> PlainRecurrence(int32_t n, double amplitude, double frequency, double phase) {
    const double w = 2.0 * kPi * frequency;
    const double p = phase * 0.017453292519943295;
    const double limit = std::fabs(amplitude);
    std::vector<double> y = {amplitude * std::sin(p), amplitude * std::sin(p + w)};
    std::vector<double> c = {amplitude * std::cos(p), amplitude * std::cos(p + w)};
    y.resize(std::max<std::size_t>(Count(n), 2));
    c.resize(y.size());
    for (std::size_t k = 2; k < Count(n); ++k) {
        y[k] = y[k - 2] + 2.0 * std::sin(w) * c[k - 1];
        if (y[k] > limit) y[k] = limit;
        if (y[k] < -limit) y[k] = -limit;
        c[k] = c[k - 2] - 2.0 * std::sin(w) * y[k - 1];
    }
    y.resize(Count(n));
    return y;
}

TEST(SineWave, IsTheRecurrenceToTheLastBit) {
    Numbers numbers;
    std::vector<double> frequencies = {0.0, 0.25, -0.25, 0.125, 0.5, 0.01, 1e-9, 0.2500001, 1e7 + 0.137};
    for (int i = 0; i < 20; ++i) frequencies.push_back(numbers.Between(-1.0, 1.0));
    for (const double frequency : frequencies) {
        for (const int32_t n : kLengths) {
            for (const double start : {0.0, 90.0, numbers.Between(-720.0, 720.0)}) {
                const double amplitude = numbers.Between(-5.0, 5.0);
                double phase = start;
                auto y = Samples(n);
                ASSERT_EQ(SineWave(y.data(), n, amplitude, frequency, &phase), kOk);
                const auto expected = PlainRecurrence(n, amplitude, frequency, start);
                for (std::size_t k = 0; k < y.size(); ++k)
                    ASSERT_TRUE(SameBits(y[k], expected[k])) << y[k] << " is not " << expected[k] << " at " << k
                                                             << " of " << n << ", frequency " << frequency;
            }
        }
    }
}

TEST(SineWave, AgreesWithTheRecurrenceInPython) {
    for (const auto& reference : kSineRecurrences) {
        const auto& a = reference.arguments;
        double phase = a[2];
        auto y = Samples(reference.n);
        ASSERT_EQ(SineWave(y.data(), reference.n, a[0], a[1], &phase), kOk);
        ExpectSamples(y, reference, 4.0 * kEpsilon * std::fabs(a[0]));
        ExpectEndPhase(phase, reference, 0.0);
    }
}

// Each step adds a rounding, and the frequency itself is rounded by half an ulp of the step.
TEST(SineWave, StaysCloseToTheTrueSine) {
    for (const auto& reference : kTrueSines) {
        const auto& a = reference.arguments;
        double phase = a[2];
        auto y = Samples(reference.n);
        ASSERT_EQ(SineWave(y.data(), reference.n, a[0], a[1], &phase), kOk);
        ExpectSamples(y, reference, std::fabs(a[0]) * 4.0 * kEpsilon * reference.n);
    }
}

TEST(SineWave, FollowsTheRoundedStepAndNotTheTrueSine) {
    const Reference& reference = kFastSines.front();
    const auto& a = reference.arguments;
    double phase = a[2];
    auto y = Samples(reference.n);
    ASSERT_EQ(SineWave(y.data(), reference.n, a[0], a[1], &phase), kOk);
    double largest = 0.0;
    for (const auto& [index, value] : reference.samples)
        largest = std::max(largest, std::fabs(y.at(static_cast<std::size_t>(index)) - value));
    EXPECT_GT(largest, 1e-8);
    EXPECT_LT(largest, 1e-6);
}

TEST(SineWave, NeverPassesTheAmplitude) {
    int cut_off = 0;
    for (const double amplitude : {1.0, -1.0, 0.3, -7e200, 1e-310}) {
        for (const double frequency : {0.25, 0.249, 0.01, 0.125, 1.0 / 3.0, 1e-4}) {
            double phase = 0.0;
            auto y = Samples(5000);
            ASSERT_EQ(SineWave(y.data(), 5000, amplitude, frequency, &phase), kOk);
            for (const double value : y) {
                ASSERT_LE(std::fabs(value), std::fabs(amplitude)) << "frequency " << frequency;
                cut_off += std::fabs(value) == std::fabs(amplitude);
            }
        }
    }
    EXPECT_GT(cut_off, 0);
}

TEST(SineWave, GoesOnWithoutASeam) {
    for (const int32_t first : {1, 2, 9, 64}) {
        double phase = 77.0;
        auto whole = Samples(150);
        ASSERT_EQ(SineWave(whole.data(), 150, -2.0, 0.0317, &phase), kOk);
        const double end = phase;

        phase = 77.0;
        auto blocks = Samples(150);
        ASSERT_EQ(SineWave(blocks.data(), first, -2.0, 0.0317, &phase), kOk);
        ASSERT_EQ(SineWave(blocks.data() + first, 150 - first, -2.0, 0.0317, &phase), kOk);
        EXPECT_THAT(blocks, AllNear(whole, 0.0, 2e-13));
        EXPECT_THAT(phase, Near(end, 1e-12));
    }
}

TEST(SineWave, TellsWhereTheNextBlockStarts) {
    const auto phase_after = [](int32_t n, double frequency, double phase) {
        auto y = Samples(n);
        EXPECT_EQ(SineWave(y.data(), n, 1.0, frequency, &phase), kOk);
        return phase;
    };
    EXPECT_EQ(phase_after(3, 0.25, 45.0), 315.0);
    EXPECT_EQ(phase_after(4, 0.25, 45.0), 45.0);
    EXPECT_EQ(phase_after(1, 0.25, 270.0), 0.0);
    EXPECT_EQ(phase_after(1, -0.25, 45.0), 315.0);
    EXPECT_EQ(phase_after(2, 0.0, -360.0), 0.0);
    EXPECT_EQ(phase_after(1, 0.0, 1e14 + 0.5), std::fmod(1e14 + 0.5, 360.0));
    EXPECT_EQ(phase_after(1, 0.0, -1e-20), 0.0) << "360 itself is no phase";
}

TEST(SineWave, LetsWhatIsNotFiniteThrough) {
    for (const double bad : {kQuietNaN, kInfinity, -kInfinity}) {
        double phase = bad;
        auto y = Samples(9);
        EXPECT_EQ(SineWave(y.data(), 9, 1.0, 0.1, &phase), kOk);
        EXPECT_TRUE(std::isnan(y[0]) && std::isnan(y[8]) && std::isnan(phase));
        phase = 0.0;
        EXPECT_EQ(SineWave(y.data(), 9, 1.0, bad, &phase), kOk);
        EXPECT_EQ(y[0], 0.0);
        EXPECT_TRUE(std::isnan(y[1]) && std::isnan(y[8]) && std::isnan(phase));
    }
    double phase = 90.0;
    auto y = Samples(9);
    EXPECT_EQ(SineWave(y.data(), 9, kQuietNaN, 0.1, &phase), kOk);
    EXPECT_TRUE(std::isnan(y[0]) && std::isnan(y[8]));
    EXPECT_THAT(phase, Near(54.0, 1e-14));
}

TEST(SineWave, NeedsASample) {
    for (const int32_t n : {0, -1, std::numeric_limits<int32_t>::min()}) {
        double phase = 400.0;
        double y = 5.0;
        EXPECT_EQ(SineWave(&y, n, 1.0, 0.1, &phase), kEmptyInput);
        EXPECT_EQ(y, 5.0);
        EXPECT_EQ(phase, 400.0);
    }
}

}  // namespace
}  // namespace krnumer

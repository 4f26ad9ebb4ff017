#include "gen/pattern.h"

#include <cmath>

#include "frame/numeric.h"
#include "frame/status.h"
#include "gen/reference.h"
#include "gen/wave.h"

namespace krnumer {
namespace {

#include "reference/gen/pattern.inc"

constexpr int32_t kLeast = std::numeric_limits<int32_t>::min();
constexpr int32_t kMost = std::numeric_limits<int32_t>::max();

// The samples of a pattern of length n, or the one sample 7 if the pattern fails and leaves it alone.
template <class Pattern>
std::vector<double> Make(int32_t n, Pattern pattern) {
    std::vector<double> y(Count(n), 7.0);
    EXPECT_EQ(pattern(y.data(), n), kOk);
    return y;
}

template <class Pattern>
void ExpectFailure(int32_t status, int32_t n, Pattern pattern) {
    std::vector<double> y(Count(n) + 1, 7.0);
    EXPECT_EQ(pattern(y.data(), n), status);
    EXPECT_EQ(y, std::vector<double>(Count(n) + 1, 7.0)) << "a failure touches no sample";
}

// ---- Sine ----------------------------------------------------------------------------------------------------------

TEST(SinePattern, AgreesWithTheSine) {
    for (const auto& reference : kSinePatterns) {
        const auto& a = reference.arguments;
        auto y = Samples(reference.n);
        ASSERT_EQ(SinePattern(y.data(), reference.n, a[0], a[1], a[2]), kOk);
        ExpectSamples(y, reference, 1e-15 * std::fabs(a[0]) * (reference.n + 2));
    }
}

TEST(SinePattern, IsTheSineWave) {
    for (const int32_t n : kLengths) {
        double phase = 31.0;
        auto wave = Samples(n);
        ASSERT_EQ(SineWave(wave.data(), n, -1.5, 0.75 / n, &phase), kOk);
        EXPECT_EQ(Make(n, [](double* y, int32_t size) { return SinePattern(y, size, -1.5, 31.0, 0.75); }), wave);
    }
}

TEST(SinePattern, TakesAsManyCyclesAsSamples) {
    for (const int32_t n : {1, 2, 3, 10}) {
        const auto with = [](double cycles) {
            return [=](double* y, int32_t size) { return SinePattern(y, size, 1.0, 0.0, cycles); };
        };
        Make(n, with(n));
        Make(n, with(5e-324));
        for (const double cycles : {std::nextafter(n, kInfinity), kInfinity, 0.0, -0.0, -1.0, -kInfinity})
            ExpectFailure(kBadCycles, n, with(cycles));
    }
}

TEST(SinePattern, LooksAtTheCyclesBeforeTheSamples) {
    for (const int32_t n : {0, -5}) {
        for (const double cycles : {1.0, 0.0, -1.0, -7.0})
            ExpectFailure(kBadCycles, n,
                          [=](double* y, int32_t size) { return SinePattern(y, size, 1.0, 0.0, cycles); });
        ExpectFailure(kEmptyInput, n,
                      [](double* y, int32_t size) { return SinePattern(y, size, 1.0, 0.0, kQuietNaN); });
    }
}

// ---- Square --------------------------------------------------------------------------------------------------------

auto Square(double amplitude, double duty, double cycles) {
    return [=](double* y, int32_t n) { return SquarePattern(y, n, amplitude, duty, cycles); };
}

TEST(SquarePattern, FallsToZero) {
    EXPECT_EQ(Make(8, Square(3.0, 50.0, 2.0)), (std::vector<double>{3, 3, 0, 0, 3, 3, 0, 0}));
    EXPECT_EQ(Make(7, Square(-3.0, 25.0, 2.0)), (std::vector<double>{-3, 0, 0, 0, -3, 0, 0}));
    EXPECT_EQ(Make(1, Square(3.0, 50.0, 1.0)), (std::vector<double>{3}));
    EXPECT_EQ(Make(2, Square(3.0, 50.0, 0.5)), (std::vector<double>{3, 3}));
    EXPECT_EQ(Make(3, Square(3.0, 30.0, 1.0)), (std::vector<double>{3, 0, 0}));
}

// Period and high part rounded to whole samples, halves upwards.
TEST(SquarePattern, RepeatsAfterAWholeNumberOfSamples) {
    Numbers numbers;
    for (const int32_t n : kLengths) {
        for (int repeat = 0; repeat < 20; ++repeat) {
            const double cycles = n * numbers.Between(0.001, 1.0);
            const double duty = numbers.Between(0.0, 130.0);
            const int64_t period = static_cast<int64_t>(n / cycles + 0.5);
            const int64_t high = static_cast<int64_t>(static_cast<double>(period) * duty * 0.01 + 0.5);
            const auto y = Make(n, Square(2.0, duty, cycles));
            for (int32_t i = 0; i < n; ++i)
                ASSERT_EQ(y[Count(i)], i % period < high ? 2.0 : 0.0) << i << " of " << n << ", cycles " << cycles;
        }
    }
    EXPECT_EQ(Make(5, Square(1.0, 50.0, 2.0)), (std::vector<double>{1, 1, 0, 1, 1})) << "5 / 2 rounds to 3";
}

TEST(SquarePattern, IsHighThroughoutAtFullDuty) {
    for (const double duty : {100.0, 150.0, 1e300, kInfinity}) {
        EXPECT_EQ(Make(9, Square(-2.0, duty, 2.0)), Samples(9, -2.0));
        EXPECT_EQ(Make(9, Square(-2.0, duty, 9.0)), Samples(9, -2.0));
    }
}

TEST(SquarePattern, IsLowThroughoutWithoutDuty) {
    for (const double duty : {0.0, -5.0, -kInfinity, kQuietNaN})
        EXPECT_EQ(Make(9, Square(2.0, duty, 2.0)), Samples(9)) << duty;
}

TEST(SquarePattern, IsHighOrLowThroughoutWhenThePeriodIsOneSample) {
    EXPECT_EQ(Make(4, Square(2.0, 49.0, 4.0)), Samples(4));
    EXPECT_EQ(Make(4, Square(2.0, 50.0, 4.0)), Samples(4, 2.0));
    EXPECT_EQ(Make(4, Square(2.0, 49.0, kQuietNaN)), Samples(4)) << "no period at all counts as one sample";
}

TEST(SquarePattern, OfHardlyAnyCyclesIsOnePeriod) {
    for (const double cycles : {1e-8, 1e-12, 1e-300, 5e-324}) {
        EXPECT_EQ(Make(6, Square(2.0, 50.0, cycles)), Samples(6, 2.0)) << cycles;
        EXPECT_EQ(Make(6, Square(2.0, kQuietNaN, cycles)), Samples(6)) << cycles;
    }
}

TEST(SquarePattern, RefusesCyclesOutOfRange) {
    for (const double cycles : {6.000000000000001, kInfinity, 0.0, -0.0, -1.0, -kInfinity}) {
        ExpectFailure(kBadCycles, 6, Square(1.0, 50.0, cycles));
        ExpectFailure(kBadCycles, 6, Square(1.0, 100.0, cycles));
    }
    for (const int32_t n : {0, -2, kLeast}) ExpectFailure(kBadCycles, n, Square(1.0, 100.0, 1.0));
    ExpectFailure(kEmptyInput, 0, Square(1.0, 100.0, kQuietNaN));
}

// ---- Impulse and pulse ---------------------------------------------------------------------------------------------

TEST(ImpulsePattern, IsOneSampleHigh) {
    for (const int32_t n : kLengths) {
        for (const int32_t delay : {0, n / 2, n - 1}) {
            auto expected = Samples(n);
            expected[Count(delay)] = -3.0;
            EXPECT_EQ(Make(n, [=](double* y, int32_t size) { return ImpulsePattern(y, size, -3.0, delay); }), expected);
        }
    }
}

TEST(ImpulsePattern, NeedsASampleForTheImpulse) {
    for (const int32_t delay : {-1, 4, 5, kLeast, kMost}) {
        ExpectFailure(kBadIndex, 4, [=](double* y, int32_t n) { return ImpulsePattern(y, n, 1.0, delay); });
        ExpectFailure(kEmptyInput, 0, [=](double* y, int32_t n) { return ImpulsePattern(y, n, 1.0, delay); });
        ExpectFailure(kEmptyInput, kLeast, [=](double* y, int32_t n) { return ImpulsePattern(y, n, 1.0, delay); });
    }
}

auto Pulse(int32_t delay, int32_t width) {
    return [=](double* y, int32_t n) { return PulsePattern(y, n, 2.0, delay, width); };
}

TEST(PulsePattern, IsHighForItsWidth) {
    EXPECT_EQ(Make(5, Pulse(1, 3)), (std::vector<double>{0, 2, 2, 2, 0}));
    EXPECT_EQ(Make(5, Pulse(0, 5)), Samples(5, 2.0));
    EXPECT_EQ(Make(5, Pulse(0, 0)), Samples(5));
    EXPECT_EQ(Make(5, Pulse(5, 0)), Samples(5));
    EXPECT_EQ(Make(1, Pulse(0, 1)), Samples(1, 2.0));
    EXPECT_EQ(Make(300, Pulse(299, 1)).back(), 2.0);
}

TEST(PulsePattern, LiesInThePatternAsAWhole) {
    for (const auto& [delay, width] : std::vector<std::pair<int32_t, int32_t>>{
             {-1, 2}, {2, -1}, {3, 3}, {6, 0}, {0, 6}, {kMost, 1}, {1, kMost}, {kMost, kMost}, {kLeast, kLeast}}) {
        ExpectFailure(kPulseDoesNotFit, 5, Pulse(delay, width));
        ExpectFailure(kEmptyInput, 0, Pulse(delay, width));
        ExpectFailure(kEmptyInput, -1, Pulse(delay, width));
    }
}

// ---- Sinc ----------------------------------------------------------------------------------------------------------

auto Sinc(double amplitude, double delay, double dt) {
    return [=](double* y, int32_t n) { return SincPattern(y, n, amplitude, delay, dt); };
}

// The argument of the sine carries the rounding of up to 10 pi.
TEST(SincPattern, AgreesWithTheSinc) {
    for (const auto& reference : kSincPatterns) {
        const auto& a = reference.arguments;
        ExpectSamples(Make(reference.n, Sinc(a[0], a[1], a[2])), reference, 4.0 * kEpsilon * std::fabs(a[0]));
    }
}

TEST(SincPattern, PeaksAtItsDelay) {
    EXPECT_EQ(Make(5, Sinc(-3.0, 1.0, 0.5))[2], -3.0);
    EXPECT_EQ(Make(1, Sinc(0.1, 0.0, 1.0))[0], 0.1);
}

TEST(SincPattern, TakesATimeThatIsNotANumberAsThePeak) {
    EXPECT_EQ(Make(3, Sinc(-3.0, kQuietNaN, 0.5)), Samples(3, -3.0));
    EXPECT_EQ(Make(3, Sinc(-3.0, 0.0, kQuietNaN)), Samples(3, -3.0));
    EXPECT_TRUE(std::isnan(Make(3, Sinc(-3.0, kInfinity, 0.5))[1])) << "the sine of infinity";
}

TEST(SincPattern, NeedsASampleAndAnInterval) {
    for (const double dt : {0.0, -0.0, -1.0, -kInfinity}) {
        ExpectFailure(kBadSamplingInterval, 3, Sinc(1.0, 0.0, dt));
        ExpectFailure(kEmptyInput, 0, Sinc(1.0, 0.0, dt));
        ExpectFailure(kEmptyInput, -1, Sinc(1.0, 0.0, dt));
    }
}

// ---- Ramp ----------------------------------------------------------------------------------------------------------

auto Ramp(double start, double end, int32_t exclude_end) {
    return [=](double* y, int32_t n) { return RampPattern(y, n, start, end, exclude_end); };
}

TEST(RampPattern, AgreesWithLinspace) {
    for (const auto& reference : kRamps) {
        const auto& a = reference.arguments;
        ExpectSamples(Make(reference.n, Ramp(a[0], a[1], static_cast<int32_t>(a[2]))), reference, 0.0);
    }
}

TEST(RampPattern, EndsAtOrBeforeItsEnd) {
    EXPECT_EQ(Make(4, Ramp(0.0, 4.0, 1)), (std::vector<double>{0, 1, 2, 3}));
    EXPECT_EQ(Make(5, Ramp(0.0, 4.0, 0)), (std::vector<double>{0, 1, 2, 3, 4}));
    EXPECT_EQ(Make(1, Ramp(3.0, 4.0, 1)), (std::vector<double>{3}));
    for (const int32_t other : {2, -1, kLeast}) EXPECT_EQ(Make(4, Ramp(0.0, 4.0, other)), Make(4, Ramp(0.0, 4.0, 1)));
    for (const int32_t n : kLengths)
        EXPECT_EQ(Make(n + 1, Ramp(0.1, 1e17 / 3.0, 0)).back(), 1e17 / 3.0) << "exactly, not to rounding";
}

TEST(RampPattern, OfOneSampleIsItsEnd) {
    EXPECT_EQ(Make(1, Ramp(2.5, 2.5, 0)), (std::vector<double>{2.5}));
    EXPECT_TRUE(SameBits(Make(1, Ramp(0.0, -0.0, 0))[0], -0.0));
    EXPECT_TRUE(SameBits(Make(1, Ramp(-0.0, 0.0, 0))[0], 0.0));
    EXPECT_EQ(Make(1, Ramp(kInfinity, kInfinity, 0))[0], kInfinity);
    ExpectFailure(kFewerThanTwo, 1, Ramp(1.0, 2.0, 0));
    ExpectFailure(kFewerThanTwo, 1, Ramp(kQuietNaN, kQuietNaN, 0));
}

TEST(RampPattern, NeedsSamples) {
    for (const int32_t n : {0, -1, kLeast}) {
        ExpectFailure(kFewerThanTwo, n, Ramp(1.0, 1.0, 0));
        ExpectFailure(kNoSample, n, Ramp(1.0, 1.0, 1));
        ExpectFailure(kNoSample, n, Ramp(1.0, 1.0, 2));
    }
}

}  // namespace
}  // namespace krnumer

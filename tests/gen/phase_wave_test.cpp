// Sawtooth, triangle and square: waves that are a shape of their phase.
#include <cmath>
#include <functional>

#include "frame/numeric.h"
#include "frame/status.h"
#include "gen/phase.h"
#include "gen/reference.h"
#include "gen/wave.h"
#include "support/vector_units.h"

namespace krnumer {
namespace {

#include "reference/gen/phase_wave.inc"

using Wave = std::function<int32_t(double* y, int32_t n, double amplitude, double frequency, double* phase)>;
using Shape = std::function<double(double degrees)>;

Wave Square(double duty) {
    return [=](double* y, int32_t n, double amplitude, double frequency, double* phase) {
        return SquareWave(y, n, amplitude, frequency, phase, duty);
    };
}

double SawtoothShape(double m) {
    const double s = m * 0.005555555555555556;
    return m < 180.0 ? s : s - 2.0;
}

double TriangleShape(double m) {
    const double v = m * 0.005555555555555556;
    if (v < 0.5) return 2.0 * v;
    if (v < 1.5) return 2.0 * (1.0 - v);
    return 2.0 * (v - 2.0);
}

Shape SquareShape(double duty) {
    return [=](double m) { return m < duty * 3.6 ? 1.0 : -1.0; };
}

// One sample at the phase.
double At(const Wave& wave, double phase) {
    double y = kQuietNaN;
    EXPECT_EQ(wave(&y, 1, 1.0, 0.0, &phase), kOk);
    return y;
}

TEST(Period, LeavesWhatFmodLeaves) {
    Numbers numbers;
    for (const double length : {1.0, 2.0, 3.0, 7.0, 100.0, 360.0, 65537.0, 2147483647.0}) {
        const Period period(length);
        const auto expect_remainder = [&](double value) {
            double expected = std::fmod(value, length);
            if (expected < 0.0) expected += length;
            if (expected == length) expected = 0.0;
            ASSERT_EQ(period.Remainder(value), expected) << value << " modulo " << length;
        };
        for (int i = 0; i < 2000; ++i) {
            const double magnitude = std::exp2(numbers.Between(-70.0, 60.0));
            const double edge = std::floor(numbers.Between(-1e4, 1e4)) * length;
            const double half_edge = edge + length / 2.0;
            for (const double value :
                 {magnitude, -magnitude, edge, std::nextafter(edge, kInfinity), std::nextafter(edge, -kInfinity),
                  half_edge, std::nextafter(half_edge, kInfinity), std::nextafter(half_edge, -kInfinity)})
                expect_remainder(value);
        }
        for (const double value : {0.0, 5e-324, -5e-324, 0x1p40, -0x1p40, std::nextafter(0x1p40, 0.0),
                                   std::nextafter(-0x1p40, 0.0), 1e300, -1e300})
            expect_remainder(value);
        for (const double value : {kQuietNaN, kInfinity, -kInfinity}) EXPECT_TRUE(std::isnan(period.Remainder(value)));
    }
}

TEST(PhaseWaves, AgreeWithExactFractions) {
    const auto expect = [](const std::vector<Reference>& references, auto wave) {
        for (const auto& reference : references) {
            const auto& a = reference.arguments;
            double phase = a[2];
            auto y = Samples(reference.n);
            ASSERT_EQ(wave(y.data(), reference.n, a, &phase), kOk);
            ExpectSamples(y, reference, 1e-14 * std::fabs(a[0]) * reference.n);
            ExpectEndPhase(phase, reference, 1e-11);
        }
    };
    expect(kSawtooths, [](double* y, int32_t n, const std::vector<double>& a, double* phase) {
        return SawtoothWave(y, n, a[0], a[1], phase);
    });
    expect(kTriangles, [](double* y, int32_t n, const std::vector<double>& a, double* phase) {
        return TriangleWave(y, n, a[0], a[1], phase);
    });
    expect(kSquares, [](double* y, int32_t n, const std::vector<double>& a, double* phase) {
        return SquareWave(y, n, a[0], a[1], phase, a[3]);
    });
}

// Whatever the loops look like, each sample is the shape of start + i frequency 360, with fmod for the remainder.
void ExpectShapeOfThePhaseOfEachSample(const Wave& wave, const Shape& shape) {
    const auto reduced = [](double degrees) {
        const double m = std::fmod(degrees, 360.0);
        return m < 0.0 ? m + 360.0 : m;
    };
    Numbers numbers;
    for (const int32_t n : kLengths) {
        for (const double scale : {1.0, 1e3, 1e10, 1e13, 1e300}) {
            const double amplitude = numbers.Between(-5.0, 5.0);
            const double frequency = numbers.Between(-1.0, 1.0) * (n % 2 == 0 ? scale : 1.0);
            const double start = numbers.Between(-720.0, 720.0) * (n % 2 == 0 ? 1.0 : scale);
            double phase = start;
            auto y = Samples(n);
            ASSERT_EQ(wave(y.data(), n, amplitude, frequency, &phase), kOk);
            for (int32_t i = 0; i < n; ++i)
                ASSERT_EQ(y[Count(i)], amplitude * shape(reduced(start + i * frequency * 360.0)))
                    << "sample " << i << " of " << n << ", start " << start << ", frequency " << frequency;
            ASSERT_EQ(phase, reduced(start + n * frequency * 360.0));
        }
    }
}

TEST(PhaseWaves, AreTheirShapeOfThePhaseOfEachSample) {
    OnEveryVectorUnit([] {
        ExpectShapeOfThePhaseOfEachSample(SawtoothWave, SawtoothShape);
        ExpectShapeOfThePhaseOfEachSample(TriangleWave, TriangleShape);
        ExpectShapeOfThePhaseOfEachSample(Square(30.0), SquareShape(30.0));
        ExpectShapeOfThePhaseOfEachSample(Square(100.0), SquareShape(100.0));
    });
}

TEST(PhaseWaves, GoOnWithoutASeam) {
    for (const Wave& wave : {Wave(SawtoothWave), Wave(TriangleWave), Square(25.0)}) {
        double phase = 33.0;
        auto whole = Samples(20);
        ASSERT_EQ(wave(whole.data(), 20, 3.0, 0.0713, &phase), kOk);
        const double end = phase;
        phase = 33.0;
        auto blocks = Samples(20);
        ASSERT_EQ(wave(blocks.data(), 10, 3.0, 0.0713, &phase), kOk);
        ASSERT_EQ(wave(blocks.data() + 10, 10, 3.0, 0.0713, &phase), kOk);
        EXPECT_THAT(blocks, AllNear(whole, 0.0, 1e-13));
        EXPECT_THAT(phase, Near(end, 1e-13));
    }
}

TEST(PhaseWaves, NeedASample) {
    for (const Wave& wave : {Wave(SawtoothWave), Wave(TriangleWave), Square(50.0)}) {
        for (const int32_t n : {0, -1, std::numeric_limits<int32_t>::min()}) {
            double phase = 400.0;
            double y = 5.0;
            EXPECT_EQ(wave(&y, n, 1.0, 0.1, &phase), kEmptyInput);
            EXPECT_EQ(y, 5.0);
            EXPECT_EQ(phase, 400.0);
        }
    }
}

TEST(PhaseWaves, LetWhatIsNotFiniteThrough) {
    for (const double bad : {kQuietNaN, kInfinity, -kInfinity}) {
        for (const Wave& wave : {Wave(SawtoothWave), Wave(TriangleWave), Square(50.0)}) {
            double phase = 10.0;
            auto y = Samples(5);
            EXPECT_EQ(wave(y.data(), 5, 1.0, bad, &phase), kOk);
            EXPECT_TRUE(std::isnan(phase));
            phase = bad;
            EXPECT_EQ(wave(y.data(), 5, 1.0, 0.1, &phase), kOk);
            EXPECT_TRUE(std::isnan(phase));
        }
        EXPECT_TRUE(std::isnan(At(SawtoothWave, bad)));
        EXPECT_TRUE(std::isnan(At(TriangleWave, bad)));
        EXPECT_EQ(At(Square(100.0), bad), -1.0);
    }
}

TEST(SawtoothWave, RisesFromZeroAndFallsAtHalfATurn) {
    EXPECT_EQ(At(SawtoothWave, 0.0), 0.0);
    EXPECT_EQ(At(SawtoothWave, 90.0), 0.5);
    EXPECT_THAT(At(SawtoothWave, std::nextafter(180.0, 0.0)), Near(1.0, 1e-15));
    EXPECT_EQ(At(SawtoothWave, 180.0), -1.0);
    EXPECT_EQ(At(SawtoothWave, 270.0), -0.5);
    EXPECT_EQ(At(SawtoothWave, -90.0), -0.5);
    EXPECT_EQ(At(SawtoothWave, 360.0), 0.0);
    EXPECT_EQ(At(SawtoothWave, -1e-20), 0.0) << "a phase of 360 would give 2 - 2, but one of 359.99 nearly the same";
}

TEST(TriangleWave, PeaksAtAQuarterAndAtThreeQuarters) {
    EXPECT_EQ(At(TriangleWave, 0.0), 0.0);
    EXPECT_EQ(At(TriangleWave, 45.0), 0.5);
    EXPECT_EQ(At(TriangleWave, 90.0), 1.0);
    EXPECT_EQ(At(TriangleWave, 180.0), 0.0);
    EXPECT_EQ(At(TriangleWave, 270.0), -1.0);
    EXPECT_EQ(At(TriangleWave, -45.0), -0.5);
}

TEST(TriangleWave, ReachesTheLargestAmplitude) {
    constexpr double kLargest = std::numeric_limits<double>::max();
    for (const double amplitude : {kLargest, -kLargest, kLargest / 2.0, kInfinity}) {
        double phase = -90.0;
        auto y = Samples(36);
        ASSERT_EQ(TriangleWave(y.data(), 36, amplitude, 0.125, &phase), kOk);
        for (std::size_t i = 0; i < y.size(); i += 4) {
            EXPECT_EQ(y[i], i % 8 == 0 ? -amplitude : amplitude);
            EXPECT_EQ(y[i + 1], i % 8 == 0 ? -amplitude / 2.0 : amplitude / 2.0);
        }
    }
}

TEST(SquareWave, IsLowAtItsEdge) {
    EXPECT_EQ(At(Square(50.0), 0.0), 1.0);
    EXPECT_EQ(At(Square(50.0), std::nextafter(180.0, 0.0)), 1.0);
    EXPECT_EQ(At(Square(50.0), 180.0), -1.0);
    EXPECT_EQ(At(Square(50.0), 540.0), -1.0);
    EXPECT_EQ(At(Square(25.0), -270.0), -1.0);
    EXPECT_EQ(At(Square(25.0), -1e-20), 1.0) << "a phase that rounds to 360 is one of 0";
}

TEST(SquareWave, TakesADutyOutsideItsRangeAsTheLimit) {
    for (const double phase : {0.0, 180.0, 359.99999999999994, -1e-20, -1.0, 1e15}) {
        for (const double duty : {100.0, 150.0, 1e300, kInfinity}) EXPECT_EQ(At(Square(duty), phase), 1.0) << phase;
        for (const double duty : {0.0, -0.0, -5.0, -1e300, -kInfinity, kQuietNaN})
            EXPECT_EQ(At(Square(duty), phase), -1.0) << phase;
    }
}

}  // namespace
}  // namespace krnumer

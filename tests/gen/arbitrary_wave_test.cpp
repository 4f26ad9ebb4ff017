#include <cmath>

#include "frame/numeric.h"
#include "frame/status.h"
#include "gen/reference.h"
#include "gen/wave.h"

namespace krnumer {
namespace {

#include "reference/gen/table_wave.inc"

const std::vector<double> kTable = {0.5, -1.25, 3.0, 2.0, 7.5};

int32_t Read(std::vector<double>& y, double amplitude, double frequency, double* phase,
             const std::vector<double>& table, int32_t interpolation) {
    return ArbitraryWave(y.data(), static_cast<int32_t>(y.size()), amplitude, frequency, phase, table.data(),
                         static_cast<int32_t>(table.size()), interpolation);
}

TEST(ArbitraryWave, AgreesWithExactFractions) {
    for (const auto& reference : kTableWaves) {
        const auto& a = reference.arguments;
        double phase = a[2];
        auto y = Samples(reference.n);
        ASSERT_EQ(Read(y, a[0], a[1], &phase, kTable, static_cast<int32_t>(a[3])), kOk);
        ExpectSamples(y, reference, 1e-13 * std::fabs(a[0]) * reference.n);
        ExpectEndPhase(phase, reference, 1e-12 * reference.n + 1e-12);
    }
}

// Position as a running sum, fmod for the remainder.
TEST(ArbitraryWave, IsTheTableAtEachPosition) {
    Numbers numbers;
    for (const std::size_t size : {1u, 2u, 3u, 7u, 64u, 501u}) {
        std::vector<double> table(size);
        for (double& value : table) value = numbers.Between(-1.0, 1.0);
        const double length = static_cast<double>(size);
        for (const double scale : {1.0, 1e2, 1e15}) {
            for (const int32_t interpolation : {0, 1}) {
                const double amplitude = numbers.Between(-5.0, 5.0);
                const double frequency = numbers.Between(-1.0, 1.0) * scale;
                const double start = numbers.Between(-720.0, 720.0) * scale;
                double phase = start;
                auto y = Samples(211);
                ASSERT_EQ(Read(y, amplitude, frequency, &phase, table, interpolation), kOk);
                double position = start * length * 0.002777777777777778;
                for (const double sample : y) {
                    double q = std::fmod(position, length);
                    if (q < 0.0) q += length;
                    if (q == length) q = 0.0;
                    const std::size_t k = static_cast<std::size_t>(q);
                    double value = table[k];
                    if (interpolation == 1) value = table[k] + (q - std::floor(q)) * (table[(k + 1) % size] - table[k]);
                    ASSERT_EQ(sample, value * amplitude);
                    position += length * frequency;
                }
                double end = std::fmod(360.0 / length * position, 360.0);
                if (end < 0.0) end += 360.0;
                ASSERT_EQ(phase, end);
            }
        }
    }
}

TEST(ArbitraryWave, ReadsTheEntryBeforeOrTheLineBetween) {
    double phase = 0.0;
    auto y = Samples(8);
    ASSERT_EQ(Read(y, 2.0, 0.125, &phase, {1.0, 3.0, 5.0, 0.0}, 0), kOk);
    EXPECT_EQ(y, (std::vector<double>{2, 2, 6, 6, 10, 10, 0, 0}));
    EXPECT_EQ(phase, 0.0);
    ASSERT_EQ(Read(y, 2.0, 0.125, &phase, {1.0, 3.0, 5.0, 0.0}, 1), kOk);
    EXPECT_EQ(y, (std::vector<double>{2, 4, 6, 8, 10, 5, 0, 1}));
    for (const int32_t other : {2, -1, std::numeric_limits<int32_t>::max()}) {
        ASSERT_EQ(Read(y, 2.0, 0.125, &phase, {1.0, 3.0, 5.0, 0.0}, other), kOk);
        EXPECT_EQ(y, (std::vector<double>{2, 2, 6, 6, 10, 10, 0, 0}));
    }
}

TEST(ArbitraryWave, GoesOnWithoutASeam) {
    for (const int32_t interpolation : {0, 1}) {
        double phase = 33.0;
        auto whole = Samples(20);
        ASSERT_EQ(Read(whole, 3.0, 0.0713, &phase, kTable, interpolation), kOk);
        const double end = phase;
        phase = 33.0;
        auto blocks = Samples(10);
        for (std::ptrdiff_t block = 0; block < 20; block += 10) {
            ASSERT_EQ(Read(blocks, 3.0, 0.0713, &phase, kTable, interpolation), kOk);
            EXPECT_THAT(blocks, AllNear(std::vector(whole.begin() + block, whole.begin() + block + 10), 0.0, 1e-12));
        }
        EXPECT_THAT(phase, Near(end, 1e-13));
    }
}

TEST(ArbitraryWave, IsZeroWithoutATable) {
    for (const int32_t size : {0, -7}) {
        double phase = 123.0;
        auto y = Samples(5, 9.0);
        ASSERT_EQ(ArbitraryWave(y.data(), 5, 3.0, 0.1, &phase, nullptr, size, 1), kOk);
        EXPECT_EQ(y, Samples(5));
        EXPECT_EQ(phase, 0.0);
    }
}

TEST(ArbitraryWave, ReadsTheFirstEntryJustBelowZero) {
    for (const int32_t interpolation : {0, 1}) {
        double phase = -1e-20;
        auto y = Samples(1);
        ASSERT_EQ(Read(y, 1.0, 0.0, &phase, kTable, interpolation), kOk);
        EXPECT_EQ(y[0], kTable[0]);
        EXPECT_EQ(phase, 0.0);
    }
}

TEST(ArbitraryWave, ReadsTheFirstEntryAtAPositionThatIsNotFinite) {
    for (const double bad : {kQuietNaN, kInfinity, -kInfinity}) {
        for (const int32_t interpolation : {0, 1}) {
            double phase = bad;
            auto y = Samples(3);
            ASSERT_EQ(Read(y, 2.0, 0.1, &phase, kTable, interpolation), kOk);
            EXPECT_EQ(y, Samples(3, 2.0 * kTable[0]));
            EXPECT_TRUE(std::isnan(phase));
            phase = 144.0;
            ASSERT_EQ(Read(y, 2.0, bad, &phase, kTable, interpolation), kOk);
            EXPECT_EQ(y, (std::vector<double>{2.0 * kTable[2], 2.0 * kTable[0], 2.0 * kTable[0]}));
            EXPECT_TRUE(std::isnan(phase));
        }
    }
}

TEST(ArbitraryWave, NeedsASample) {
    double phase = 400.0;
    double y = 5.0;
    for (const int32_t n : {0, -1}) {
        EXPECT_EQ(ArbitraryWave(&y, n, 1.0, 0.1, &phase, kTable.data(), 5, 0), kEmptyInput);
        EXPECT_EQ(ArbitraryWave(&y, n, 1.0, 0.1, &phase, nullptr, 0, 0), kEmptyInput);
    }
    EXPECT_EQ(y, 5.0);
    EXPECT_EQ(phase, 400.0);
}

}  // namespace
}  // namespace krnumer

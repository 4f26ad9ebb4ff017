#include "stat/mode.h"

#include <limits>

#include "frame/status.h"
#include "stat/samples.h"
#include "support/numbers.h"

namespace krnumer {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using Samples = std::vector<double>;

// The modes; also sees that there is an array exactly where there are modes.
Samples ModesOf(const Samples& x, int32_t intervals) {
    Scratch<double> modes(3);
    int32_t count = -7;
    EXPECT_EQ(Mode(x.data(), Size(x), intervals, &modes, &count), kOk);
    EXPECT_EQ(static_cast<bool>(modes), count > 0);
    return count > 0 ? Samples(modes.data(), modes.data() + count) : Samples();
}

TEST(Mode, RefusesEmptyData) {
    for (const int32_t n : {0, -1, std::numeric_limits<int32_t>::min()}) {
        for (const int32_t intervals : {0, 3}) {
            const double x = 1.0;
            Scratch<double> modes(3);
            int32_t count = -7;
            EXPECT_EQ(Mode(&x, n, intervals, &modes, &count), kEmptyInput);
            EXPECT_FALSE(modes);
            EXPECT_EQ(count, 0);
        }
    }
}

TEST(Mode, ASingleSampleHasNone) {
    EXPECT_THAT(ModesOf({5}, 0), IsEmpty());
    EXPECT_THAT(ModesOf({5}, 4), IsEmpty());
    EXPECT_THAT(ModesOf({kQuietNaN}, 0), IsEmpty());
}

TEST(Mode, DataWithoutSpreadAreTheirOwnMode) {
    for (const int32_t intervals : {std::numeric_limits<int32_t>::min(), -1, 0, 1, 7}) {
        EXPECT_THAT(ModesOf({4, 4, 4}, intervals), ElementsAre(4));
        EXPECT_THAT(ModesOf({0, -0.0}, intervals), ElementsAre(0));
    }
    EXPECT_THAT(ModesOf({4, 4, 4}, std::numeric_limits<int32_t>::max()), ElementsAre(4));
    // Values one spacing apart count as equal; exact values give the smallest, bins the largest.
    EXPECT_THAT(ModesOf({1 + kEpsilon, 1}, 0), ElementsAre(1));
    EXPECT_THAT(ModesOf({1 + kEpsilon, 1}, 3), ElementsAre(1 + kEpsilon));
}

TEST(Mode, OfExactValues) {
    EXPECT_THAT(ModesOf({1, 2, 3}, 0), IsEmpty());
    EXPECT_THAT(ModesOf({1, 1, 2, 2, 3}, 0), ElementsAre(1, 2));
    EXPECT_THAT(ModesOf({3, 2, 1, 3, 2}, 0), ElementsAre(2, 3));
    EXPECT_THAT(ModesOf({1, 2, 2, 3, 3, 3}, 0), ElementsAre(3));
    EXPECT_THAT(ModesOf({1, 1, 2, 2, 2, 3, 3}, 0), ElementsAre(2));
    EXPECT_THAT(ModesOf({-2, 5, -2, 7, 5, 0, 0}, 0), ElementsAre(-2, 0, 5));
}

TEST(Mode, ToleranceIsThatOfTheFirstValueOfARun) {
    // 1 + 2 epsilon is near 1 + epsilon, but the run began at 1.
    const double third = 1 + 2 * kEpsilon;
    EXPECT_THAT(ModesOf({1, 1 + kEpsilon, third, third}, 0), ElementsAre(1, third));
    EXPECT_THAT(ModesOf({-1 - 2 * kEpsilon, -1 - kEpsilon, 3}, 0), ElementsAre(-1 - 2 * kEpsilon));
    EXPECT_THAT(ModesOf({0, 4.94e-324, 1}, 0), IsEmpty());
}

TEST(Mode, OfExactValuesWithNaNIsNaN) {
    // Sorted, NaN comes first, and no spread exceeds its tolerance.
    for (const Samples& samples : {Samples{1, -kQuietNaN, 2}, Samples{kQuietNaN, 1, 1}}) {
        const Samples modes = ModesOf(samples, 0);
        ASSERT_EQ(modes.size(), 1u);
        EXPECT_TRUE(IsQuietNaN(modes[0]));
    }
}

TEST(Mode, OfExactValuesWithInfinities) {
    EXPECT_THAT(ModesOf({1, kInfinity, kInfinity}, 0), IsEmpty());  // their difference is NaN
    EXPECT_THAT(ModesOf({1, 1, kInfinity, kInfinity}, 0), ElementsAre(1));
    EXPECT_THAT(ModesOf({-kInfinity, 1, 2}, 0), ElementsAre(-kInfinity));  // an infinite tolerance
    EXPECT_THAT(ModesOf({kInfinity, kInfinity}, 0), ElementsAre(kInfinity));
}

TEST(Mode, OfBins) {
    EXPECT_THAT(ModesOf({1, 2, 3}, 2), ElementsAre(2.5));
    EXPECT_THAT(ModesOf({1, 2, 3}, 3), IsEmpty());
    EXPECT_THAT(ModesOf({0, 0.25, 1.5, 1.75, 4}, 4), ElementsAre(0.5, 1.5));
    EXPECT_THAT(ModesOf({0, 1.5, 1.75, 4}, 4), ElementsAre(1.5));
    EXPECT_THAT(ModesOf({1, 5, 9}, 1), ElementsAre(5));
}

TEST(Mode, OfBinsSpansTheNumbersAndCountsNaNInTheLastBin) {
    EXPECT_THAT(ModesOf({kQuietNaN, 1, kQuietNaN, 1, 3}, 2), ElementsAre(2.5));
    const Samples modes = ModesOf({-kQuietNaN, -kQuietNaN}, 2);
    ASSERT_EQ(modes.size(), 1u);
    EXPECT_TRUE(IsQuietNaN(modes[0]));
}

TEST(Mode, OfBinsWithInfinities) {
    EXPECT_THAT(ModesOf({1, 2, kInfinity}, 3), ElementsAre(kInfinity));  // an infinite tolerance
    EXPECT_THAT(ModesOf({-kInfinity, 1, 2}, 3), IsEmpty());              // only the maximum is placed
}

TEST(Mode, LeavesTheSamplesAlone) {
    const Samples samples{3, 1, 2, 1};
    ModesOf(samples, 0);
    ModesOf(samples, 2);
    EXPECT_THAT(samples, ElementsAre(3, 1, 2, 1));
}

TEST(Mode, AgreesWithExactArithmetic) {
    for (const auto& [set, parameter, values] : GoldenResults("modes")) {
        const int32_t intervals = std::stoi(parameter);
        double magnitude = 0.0;
        for (const double x : GoldenSamples().at(set)) magnitude = std::max(magnitude, std::fabs(x));
        EXPECT_THAT(ModesOf(GoldenSamples().at(set), intervals),
                    AllNear(values, 0.0, (intervals + 2) * kEpsilon * (intervals > 0 ? 2.0 * magnitude : 0.0)))
            << set << ", " << intervals << " intervals";
    }
}

TEST(Mode, AgreesWithCountingOnRandomData) {
    std::mt19937_64 random(5);
    for (int32_t n = 2; n < 200; ++n) {
        Samples samples;
        std::map<double, int32_t> frequencies;
        for (int32_t i = 0; i < n; ++i) {
            samples.push_back(static_cast<double>(random() % static_cast<uint64_t>(n)) - 0.5 * n);
            ++frequencies[samples.back()];
        }
        int32_t highest = 2;
        for (const auto& [value, frequency] : frequencies) highest = std::max(highest, frequency);
        Samples expected;
        for (const auto& [value, frequency] : frequencies) {
            if (frequency == highest) expected.push_back(value);
        }
        EXPECT_EQ(ModesOf(samples, 0), expected);
    }
}

}  // namespace
}  // namespace krnumer

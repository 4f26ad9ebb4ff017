// Crossings and edges: what counts as one, where it lies, and that lists go on from where they stopped.

#include "measure/transitions.h"

#include <gmock/gmock.h>

#include <limits>

#include "measure/measuring.h"

namespace krnumer::measure {
namespace {

constexpr int64_t kAll = std::numeric_limits<int64_t>::max();

Signal On(const Samples& samples, double t0 = 0.0, double dt = 1.0) {
    return Signal(samples.data(), static_cast<int32_t>(samples.size()), t0, dt);
}

std::vector<double> Times(const CrossingList& list) {
    std::vector<double> times;
    for (int64_t i = 0; i < list.size(); ++i) times.push_back(list[i].time);
    return times;
}

CrossingList Crossings(const Samples& samples, double level, double band) {
    CrossingList list;
    list.Extend(On(samples), level, band, kAll);
    return list;
}

EdgeList Edges(const Samples& samples, double lower, double upper) {
    EdgeList list;
    list.Extend(On(samples), lower, upper, kAll);
    return list;
}

using testing::ElementsAre;

TEST(CrossingList, InterpolatesAndAlternates) {
    const CrossingList list = Crossings({0, 4, 4, 0, 0, 1, 4}, 1, 0.5);
    EXPECT_THAT(Times(list), ElementsAre(0.25, 2.75, 5.0));
    EXPECT_TRUE(list[0].rising);
    EXPECT_FALSE(list[1].rising);
    EXPECT_TRUE(list[2].rising);
}

TEST(CrossingList, LiesOnTheTimeAxis) {
    CrossingList list;
    list.Extend(On({0, 4, 0}, 100.0, 0.5), 1, 0.5, kAll);
    EXPECT_THAT(Times(list), ElementsAre(100.125, 100.875));
}

TEST(CrossingList, IgnoresNoiseWithinTheBand) {
    EXPECT_THAT(Times(Crossings({-2, 0.5, -0.5, 0.5, -0.5, 2, 0.5, -0.5, 2, -2}, 0, 1)), ElementsAre(0.8, 6.5));
}

TEST(CrossingList, NeedsAStateFirst) {
    EXPECT_THAT(Times(Crossings({0.5, -0.5, 0.5, 2, -2}, 0, 1)), ElementsAre(3.5));
    EXPECT_EQ(Crossings({0.5, -0.5, 0.5, -0.5}, 0, 1).size(), 0);
}

TEST(CrossingList, TakesASampleRightOnTheLevelAsACrossing) {
    EXPECT_THAT(Times(Crossings({-1, 0, 1}, 0, 0.5)), ElementsAre(1.0));
    // Without a band the level is both states at once, so that every sample on it is a crossing.
    EXPECT_THAT(Times(Crossings({-1, 0, 0, 0, 1}, 0, 0)), ElementsAre(1.0, 1.0, 2.0, 3.0));
}

TEST(CrossingList, GoesOnFromWhereItStopped) {
    const Samples samples{0, 4, 4, 0, 0, 1, 4, 2, 1, -1, 3};
    CrossingList list;
    for (int64_t wanted = 1; wanted <= 3; ++wanted) {
        list.Extend(On(samples), 1, 0.5, wanted);
        EXPECT_EQ(list.size(), wanted);
    }
    list.Extend(On(samples), 1, 0.5, 1);
    EXPECT_EQ(list.size(), 3);
    list.Extend(On(samples), 1, 0.5, kAll);
    EXPECT_THAT(Times(list), ElementsAre(0.25, 2.75, 5.0, 8.0, 9.5));
    list.Clear();
    EXPECT_EQ(list.size(), 0);
    list.Extend(On(samples), 1, 0.5, kAll);
    EXPECT_EQ(list.size(), 5);
}

TEST(CrossingList, SurvivesNumbersThatAreNone) {
    const double nan = std::numeric_limits<double>::quiet_NaN();
    EXPECT_EQ(Crossings({nan, nan, nan}, 0, 1).size(), 0);
    EXPECT_EQ(Crossings({-2, nan, 2}, 0, 1).size(), 0);
    EXPECT_EQ(Crossings({-2, 2}, nan, 1).size(), 0);
    EXPECT_EQ(Crossings({}, 0, 1).size(), 0);
    EXPECT_EQ(Crossings({5}, 0, 1).size(), 0);
}

TEST(EdgeList, HasBothPassages) {
    const EdgeList list = Edges({0, 4, 8, 8, 6, 0, 0}, 1, 7);
    ASSERT_EQ(list.size(), 2);
    EXPECT_TRUE(list[0].rising);
    EXPECT_EQ(list[0].lower.index, 0);
    EXPECT_EQ(list[0].lower.time, 0.25);
    EXPECT_EQ(list[0].upper.index, 1);
    EXPECT_EQ(list[0].upper.time, 1.75);
    EXPECT_FALSE(list[1].rising);
    EXPECT_EQ(list[1].first().time, 3.5);
    EXPECT_EQ(list[1].last().time, 4.0 + 5.0 / 6.0);
    EXPECT_EQ(list[1].last().index, 4);
}

TEST(EdgeList, BothPassagesMayLieBetweenTwoSamples) {
    const EdgeList list = Edges({0, 10}, 1, 9);
    ASSERT_EQ(list.size(), 1);
    EXPECT_EQ(list[0].lower.time, 0.1);
    EXPECT_EQ(list[0].upper.time, 0.9);
}

TEST(EdgeList, StartsWithTheLastPassageAndEndsWithTheFirst) {
    const EdgeList list = Edges({0, 2, 0, 2, 5, 8, 6, 8, 6, 2, 0, 2, 0}, 1, 7);
    ASSERT_EQ(list.size(), 2);
    EXPECT_EQ(list[0].lower.time, 2.5);
    EXPECT_EQ(list[0].upper.time, 4.0 + 2.0 / 3.0);
    EXPECT_EQ(list[1].upper.time, 7.5);
    EXPECT_EQ(list[1].lower.time, 9.5);
}

TEST(EdgeList, IgnoresRuntsAndAnUnfinishedStart) {
    const EdgeList list = Edges({4, 8, 4, 8, 0, 4, 0, 6, 0, 8}, 1, 7);
    ASSERT_EQ(list.size(), 2);
    EXPECT_FALSE(list[0].rising);
    EXPECT_EQ(list[0].upper.index, 3);
    EXPECT_TRUE(list[1].rising);
    EXPECT_EQ(list[1].lower.index, 8);
}

TEST(EdgeList, PlateausRightOnTheLevels) {
    const EdgeList list = Edges({0, 0, 0, 5, 10, 10, 10, 5, 0, 0}, 0, 10);
    ASSERT_EQ(list.size(), 2);
    EXPECT_EQ(list[0].lower.time, 2.0);
    EXPECT_EQ(list[0].upper.time, 4.0);
    EXPECT_EQ(list[1].upper.time, 6.0);
    EXPECT_EQ(list[1].lower.time, 8.0);
}

TEST(EdgeList, AlternatesWhenTheLevelsCoincide) {
    const EdgeList list = Edges({0, 5, 5, 5, 5, 0, 5, 5, 0}, 5, 5);
    ASSERT_GT(list.size(), 2);
    for (int64_t i = 1; i < list.size(); ++i) EXPECT_NE(list[i].rising, list[i - 1].rising);
}

TEST(EdgeList, GoesOnFromWhereItStopped) {
    const Samples samples{0, 4, 8, 8, 6, 0, 0, 9, 9, 1, 0, 8};
    const EdgeList all = Edges(samples, 1, 7);
    EdgeList list;
    for (int64_t wanted = 1; wanted <= all.size(); ++wanted) {
        list.Extend(On(samples), 1, 7, wanted);
        ASSERT_EQ(list.size(), wanted);
        EXPECT_EQ(list[wanted - 1].lower.time, all[wanted - 1].lower.time);
        EXPECT_EQ(list[wanted - 1].upper.time, all[wanted - 1].upper.time);
    }
}

TEST(Signal, ReadsSamplesWithoutAlignment) {
    unsigned char bytes[20];
    const double samples[2] = {1.5, -2.5};
    std::memcpy(bytes + 4, samples, sizeof samples);
    const Signal signal(reinterpret_cast<const double*>(bytes + 4), 2, 0.0, 1.0);
    EXPECT_EQ(signal[0], 1.5);
    EXPECT_EQ(signal[1], -2.5);
}

}  // namespace
}  // namespace krnumer::measure

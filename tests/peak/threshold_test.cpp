// Runs of samples above a threshold.

#include <algorithm>
#include <limits>
#include <random>
#include <vector>

#include "frame/numeric.h"
#include "frame/status.h"
#include "krnumer/peak.h"
#include "peak/threshold_peaks.h"
#include "support/host_arrays.h"

namespace krnumer {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class ThresholdPeaks : public testing::Test {
  protected:
    std::vector<int32_t> Find(const std::vector<double>& samples, double threshold, int32_t width) {
        HostArray<double> x(samples);
        EXPECT_EQ(PeakDetector(x.handle(), &threshold, &width, indices_.handle(), &count_, &err_), 0);
        EXPECT_EQ(err_, 0);
        EXPECT_EQ(count_, indices_.size());
        return indices_.values();
    }

    LeakCheck leaks_;
    HostArray<int32_t> indices_{5, 6, 7};
    int32_t count_ = -7;
    int32_t err_ = 77;
};

TEST_F(ThresholdPeaks, BeginsOfRuns) {
    EXPECT_THAT(Find({0, 2, 2, 0, 3, 0, 2, 2, 2, 0}, 2, 2), ElementsAre(1, 6));
    EXPECT_THAT(Find({0, 2, 2, 0, 3, 0, 2, 2, 2, 0}, 2, 1), ElementsAre(1, 4, 6));
    EXPECT_THAT(Find({0, 2, 2, 0, 3, 0, 2, 2, 2, 0}, 2, 3), ElementsAre(6));
    EXPECT_THAT(Find({0, 2, 2, 0, 3, 0, 2, 2, 2, 0}, 2, 4), IsEmpty());
}

TEST_F(ThresholdPeaks, RunsAtTheEnds) {
    EXPECT_THAT(Find({2, 2, 0, 2, 2}, 1, 2), ElementsAre(0, 3));
    EXPECT_THAT(Find({2, 2, 0, 0, 2}, 1, 2), ElementsAre(0));
    EXPECT_THAT(Find({2, 2, 2}, 1, 2), ElementsAre(0));
}

TEST_F(ThresholdPeaks, TheThresholdItselfCounts) {
    EXPECT_THAT(Find({0, 1, 0.5, 1}, 1, 1), ElementsAre(1, 3));
    EXPECT_THAT(Find({kQuietNaN, 1, kQuietNaN, 1}, 1, 1), ElementsAre(1, 3));
    EXPECT_THAT(Find({1, 2}, kQuietNaN, 1), IsEmpty());
}

TEST_F(ThresholdPeaks, AsManyAsFit) {
    std::vector<double> comb;
    for (int i = 0; i < 51; ++i) comb.push_back(i % 2 == 0);
    EXPECT_EQ(Find(comb, 1, 1).size(), 26u);
    for (int32_t width = 1; width < 12; ++width) {
        comb.clear();
        for (int32_t i = 0; i < 100; ++i) comb.push_back(i % (width + 1) != width);
        const auto found = Find(comb, 1, width);
        EXPECT_LE(static_cast<int32_t>(found.size()), MostThresholdPeaks(100, width));
        for (std::size_t i = 0; i < found.size(); ++i) EXPECT_EQ(found[i], static_cast<int32_t>(i) * (width + 1));
    }
}

TEST_F(ThresholdPeaks, RandomSignalsRunByRun) {
    std::mt19937 random(1);
    for (int round = 0; round < 200; ++round) {
        std::vector<double> x(2 + random() % 60);
        for (double& sample : x) sample = static_cast<double>(random() % 4);
        const auto width = static_cast<int32_t>(1 + random() % std::min<std::size_t>(x.size() - 1, 6));
        std::vector<int32_t> expected;
        for (auto run = x.begin(); run != x.end();) {
            run = std::find_if(run, x.end(), [](double sample) { return sample >= 1; });
            const auto end = std::find_if(run, x.end(), [](double sample) { return sample < 1; });
            if (end - run >= width) expected.push_back(static_cast<int32_t>(run - x.begin()));
            run = end;
        }
        EXPECT_EQ(Find(x, 1, width), expected);
    }
}

TEST_F(ThresholdPeaks, TheHostIsAskedForDoubles) {
    const double threshold = 1;
    const int32_t width = 2;
    HostArray<double> x{0, 1, 1, 0, 0, 0, 1, 1, 1};
    const ResizeLog log;
    EXPECT_EQ(PeakDetector(x.handle(), &threshold, &width, indices_.handle(), &count_, &err_), 0);
    ASSERT_EQ(log.size(), 2);
    EXPECT_EQ(log[0].typeCode, KRRT_DOUBLE);
    EXPECT_EQ(log[0].totalElements, 9 / 2 + 1);
    EXPECT_EQ(log[1].typeCode, KRRT_DOUBLE);
    EXPECT_EQ(log[1].totalElements, 2);
    EXPECT_THAT(indices_.values(), ElementsAre(1, 6));
}

TEST_F(ThresholdPeaks, Refusals) {
    const double threshold = 1;
    const auto expect = [&](const std::vector<double>& samples, int32_t width, int32_t status) {
        HostArray<double> x(samples);
        HostArray<int32_t> indices{1, 2, 3};
        EXPECT_EQ(PeakDetector(x.handle(), &threshold, &width, indices.handle(), &count_, &err_), 0);
        EXPECT_EQ(err_, status);
        EXPECT_EQ(count_, 0);
        EXPECT_TRUE(indices.empty());
    };
    expect({}, 0, kEmptyInput);
    for (const int32_t width : {0, -1, 3, 4, std::numeric_limits<int32_t>::max(), std::numeric_limits<int32_t>::min()})
        expect({1, 2, 3}, width, kBadWidth);
    expect({1}, 1, kBadWidth);
}

TEST_F(ThresholdPeaks, RefusedSizes) {
    const double threshold = 1;
    const int32_t width = 1;
    HostArray<double> x{0, 1, 0};
    for (int32_t nth = 1; nth <= 2; ++nth) {
        const FailResize refused(nth, 4711);
        EXPECT_EQ(PeakDetector(x.handle(), &threshold, &width, indices_.handle(), &count_, &err_), 4711);
        EXPECT_EQ(err_, kOutOfMemory);
        EXPECT_EQ(count_, 0);
        EXPECT_TRUE(indices_.empty());
    }
}

}  // namespace
}  // namespace krnumer

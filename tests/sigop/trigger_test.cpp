// Triggers on levels.

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cmath>

#include "frame/numeric.h"
#include "frame/status.h"
#include "krnumer/sigop.h"
#include "sigop/signals.h"
#include "support/host_arrays.h"

namespace krnumer {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class Trigger : public testing::Test {
  protected:
    // Every channel with the same settings.
    int32_t Run(const HostMatrix<double>& x, double level, double previous, double hysteresis, int32_t slope,
                int32_t most) {
        const auto channels = static_cast<size_t>(x.rows());
        HostArray<double> levels(std::vector<double>(channels, level)), before(std::vector<double>(channels, previous)),
            widths(std::vector<double>(channels, hysteresis));
        HostArray<int32_t> slopes(std::vector<int32_t>(channels, slope));
        EXPECT_EQ(Triggerh(x.handle(), levels.handle(), before.handle(), widths.handle(), slopes.handle(), most,
                           found_.handle(), counts_.handle(), flags_.handle(), last_.handle(), &err_),
                  0);
        return err_;
    }

    LeakCheck leaks_;
    HostArray<int32_t> found_{-1, -1, -1, -1, -1, -1}, counts_{7, 7}, flags_{7, 7};
    HostArray<double> last_;
    int32_t err_ = 77;
};

TEST_F(Trigger, HitsTheLevelOnceArmed) {
    const HostMatrix<double> x(1, 8, {0, 1, 2, 1, 0.4, 1, 3, 0});
    EXPECT_EQ(Run(x, 1, 0, 0.5, 1, 5), 0);
    EXPECT_THAT(counts_.values(), ElementsAre(2));
    EXPECT_THAT(flags_.values(), ElementsAre(1));
    EXPECT_EQ(found_.size(), 5);
    EXPECT_EQ(found_[0], 1);  // exactly at the level
    EXPECT_EQ(found_[1], 5);
    EXPECT_THAT(last_.values(), ElementsAre(0));
    EXPECT_EQ(Run(x, 1, 0, 0.5, 0, 5), 0);
    EXPECT_THAT(counts_.values(), ElementsAre(2));
    EXPECT_EQ(found_[0], 3);
    EXPECT_EQ(found_[1], 7);
}

TEST_F(Trigger, ArmsStrictlyBeyondTheHysteresis) {
    const HostMatrix<double> x(1, 4, {0.5, 1, 0.5, 1});
    EXPECT_EQ(Run(x, 1, 0.5, 0.5, 1, 3), 0);
    EXPECT_THAT(counts_.values(), ElementsAre(0));
    EXPECT_EQ(Run(x, 1, 0.4, -0.5, 1, 3), 0);  // armed by the sample before; the sign does not matter
    EXPECT_THAT(counts_.values(), ElementsAre(1));
    EXPECT_EQ(found_[0], 1);
    EXPECT_EQ(Run(x, 0.75, 1.5, 0.25, 0, 3), 0);
    EXPECT_THAT(counts_.values(), ElementsAre(1));
    EXPECT_EQ(found_[0], 0);
}

TEST_F(Trigger, OtherSlopesNeverHit) {
    const HostMatrix<double> x(1, 4, {0, 3, 0, 3});
    for (const int32_t slope : {-1, 2}) {
        EXPECT_EQ(Run(x, 1, 0, 0.1, slope, 3), 0);
        EXPECT_THAT(counts_.values(), ElementsAre(0));
        EXPECT_THAT(flags_.values(), ElementsAre(0));
    }
}

TEST_F(Trigger, AChannelWithoutAHitTakesASlot) {
    const HostMatrix<double> x(3, 3, {0, 2, 0, 0, 0, 0.5, 0, 0, 2});
    EXPECT_EQ(Run(x, 1, 0, 0, 1, 2), 0);
    EXPECT_THAT(counts_.values(), ElementsAre(1, 0, 1));
    EXPECT_THAT(flags_.values(), ElementsAre(1, 0, 1));
    EXPECT_EQ(found_.size(), 6);
    EXPECT_EQ(found_[0], 1);
    EXPECT_EQ(found_[1], 0);
    EXPECT_EQ(found_[2], 2);
    EXPECT_EQ(found_[3], -1);  // not written
    EXPECT_THAT(last_.values(), ElementsAre(0, 0.5, 2));
}

TEST_F(Trigger, StopsAtTheMostHitsOfAChannel) {
    const HostMatrix<double> x(1, 6, {0, 2, 0, 2, 0, 2});
    EXPECT_EQ(Run(x, 1, 0, 0, 1, 2), 0);
    EXPECT_THAT(counts_.values(), ElementsAre(2));
    EXPECT_EQ(Run(x, 1, 0, 0, 1, 0), 0);
    EXPECT_THAT(counts_.values(), ElementsAre(0));
    EXPECT_THAT(last_.values(), ElementsAre(2));
    EXPECT_EQ(found_.size(), 0);
    EXPECT_EQ(Run(x, 1, 0, 0, 1, -3), 0);
    EXPECT_THAT(counts_.values(), ElementsAre(0));
    EXPECT_EQ(found_.size(), 0);
}

TEST_F(Trigger, StoresFiftyHitsAndCountsAll) {
    std::vector<double> row;
    for (int i = 0; i < 40; ++i) row.insert(row.end(), {0.0, 2.0});
    std::vector<double> both = row;
    both.insert(both.end(), row.begin(), row.end());
    found_ = HostArray<int32_t>(std::vector<int32_t>(200, -1));
    EXPECT_EQ(Run(HostMatrix<double>(2, 80, both), 1, 0, 0, 1, 100), 0);
    EXPECT_THAT(counts_.values(), ElementsAre(40, 40));
    EXPECT_EQ(found_[39], 79);
    EXPECT_EQ(found_[40], 1);
    EXPECT_EQ(found_[49], 19);
    for (int32_t i = 50; i < 200; ++i) EXPECT_EQ(found_[i], -1);
}

TEST_F(Trigger, CarriesOnFromBlockToBlock) {
    RandomSignals random;
    const auto x = random.Samples<double>(400);
    const HostMatrix<double> all(1, 400, x);
    EXPECT_EQ(Run(all, 0.1, 0, 0.3, 1, 400), 0);
    const int32_t whole = counts_[0];
    EXPECT_GT(whole, 40);
    // A block that begins armed by its predecessor's last sample only: cut where the signal is low.
    int32_t hits = 0;
    double previous = 0;
    for (size_t first = 0, end = 0; first < 400; first = end) {
        for (end = first + 1; end < 400 && !(x[end - 1] < -0.2); ++end) {
        }
        const auto block =
            std::vector<double>(x.begin() + static_cast<ptrdiff_t>(first), x.begin() + static_cast<ptrdiff_t>(end));
        EXPECT_EQ(Run(HostMatrix<double>(1, Size(block), block), 0.1, previous, 0.3, 1, 400), 0);
        hits += counts_[0];
        previous = last_[0];
    }
    EXPECT_EQ(hits, whole);
}

TEST_F(Trigger, WithoutSamplesThePreviousOnesAreTheLast) {
    EXPECT_EQ(Run(HostMatrix<double>(2, 0), 1, 0.25, 0, 1, 2), 0);
    EXPECT_THAT(last_.values(), ElementsAre(0.25, 0.25));
    EXPECT_THAT(counts_.values(), ElementsAre(0, 0));
    EXPECT_EQ(found_.size(), 4);
    EXPECT_EQ(found_[0], 0);
    EXPECT_EQ(found_[1], 0);
    EXPECT_EQ(Run(HostMatrix<double>(0, 0), 1, 0.25, 0, 1, 2), 0);
    EXPECT_THAT(last_.values(), IsEmpty());
    EXPECT_THAT(found_.values(), IsEmpty());
}

TEST_F(Trigger, RefusesArraysShorterThanTheChannels) {
    const HostMatrix<double> x(2, 2);
    const HostArray<double> two(2), one(1);
    const HostArray<int32_t> slopes(2), slope(1);
    for (int which = 0; which < 4; ++which) {
        found_ = HostArray<int32_t>{1};
        last_ = HostArray<double>{1};
        EXPECT_EQ(
            Triggerh(x.handle(), which == 0 ? one.handle() : two.handle(), which == 1 ? one.handle() : two.handle(),
                     which == 2 ? one.handle() : two.handle(), which == 3 ? slope.handle() : slopes.handle(), 2,
                     found_.handle(), counts_.handle(), flags_.handle(), last_.handle(), &err_),
            0);
        EXPECT_EQ(err_, kSizesDiffer);
        EXPECT_TRUE(found_.empty() && counts_.empty() && flags_.empty() && last_.empty());
    }
}

TEST_F(Trigger, EmptiesAllOutputsWhenAResizeIsRefused) {
    const HostMatrix<double> x(2, 2);
    for (int32_t nth = 1; nth <= 4; ++nth) {
        found_ = HostArray<int32_t>{1};
        counts_ = HostArray<int32_t>{1};
        flags_ = HostArray<int32_t>{1};
        last_ = HostArray<double>{1};
        const FailResize fail(nth);
        EXPECT_EQ(Run(x, 1, 0, 0, 1, 2), kOutOfMemory);
        EXPECT_TRUE(fail.happened());
        EXPECT_TRUE(found_.empty() && counts_.empty() && flags_.empty() && last_.empty());
    }
    EXPECT_EQ(Run(x, 1, 0, 0, 1, 2000000000), kOutOfMemory);
}

}  // namespace
}  // namespace krnumer

// The exports of the family: statuses, their order, and what they leave in their outputs.

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cmath>

#include "frame/numeric.h"
#include "frame/status.h"
#include "krnumer/stat.h"
#include "support/host_arrays.h"

namespace krnumer {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class StatEntry : public testing::Test {
  protected:
    LeakCheck leaks_;
    HostArray<double> none_;
    double value_ = -1.0;
    int32_t err_ = 77;
};

TEST_F(StatEntry, MeanOfSamples) {
    HostArray<double> x{1, 2, 6};
    EXPECT_EQ(Mean_head(x.handle(), &value_, &err_), 0);
    EXPECT_EQ(err_, 0);
    EXPECT_EQ(value_, 3.0);
}

TEST_F(StatEntry, MeanIsARunningSum) {
    HostArray<double> x{1e16, 1, -1e16, 1};
    EXPECT_EQ(Mean_head(x.handle(), &value_, &err_), 0);
    EXPECT_EQ(value_, 0.25) << "the first 1 is lost in 1e16";
}

TEST_F(StatEntry, MeanLetsNaNThrough) {
    HostArray<double> x{1, kQuietNaN};
    EXPECT_EQ(Mean_head(x.handle(), &value_, &err_), 0);
    EXPECT_EQ(err_, 0);
    EXPECT_TRUE(std::isnan(value_));
}

TEST_F(StatEntry, ScalarsOfNothingAreNaN) {
    const int32_t order = 0;
    const auto expect_empty = [this](int32_t result) {
        EXPECT_EQ(result, 0);
        EXPECT_EQ(err_, kEmptyInput);
        EXPECT_TRUE(IsQuietNaN(value_));
        value_ = -1.0;
        err_ = 77;
    };
    HostArray<double> one{1};
    expect_empty(Mean_head(none_.handle(), &value_, &err_));
    expect_empty(Median_head(none_.handle(), &value_, &err_));
    expect_empty(RMS_head(none_.handle(), &value_, &err_));
    expect_empty(Moment_head(none_.handle(), &order, &value_, &err_));  // before the order is looked at
    expect_empty(MSE_head(none_.handle(), one.handle(), &value_, &err_));
    expect_empty(MSE_head(one.handle(), none_.handle(), &value_, &err_));
}

TEST_F(StatEntry, MedianOfOddAndEvenCounts) {
    HostArray<double> even{4, 1, 3, 2};
    EXPECT_EQ(Median_head(even.handle(), &value_, &err_), 0);
    EXPECT_EQ(value_, 2.5);
    EXPECT_THAT(even.values(), ElementsAre(4, 1, 3, 2));
    HostArray<double> odd{4, 1, 3};
    EXPECT_EQ(Median_head(odd.handle(), &value_, &err_), 0);
    EXPECT_EQ(value_, 3.0);
    HostArray<double> single{2};
    EXPECT_EQ(Median_head(single.handle(), &value_, &err_), 0);
    EXPECT_EQ(value_, 2.0);
}

TEST_F(StatEntry, MedianRefusesNaN) {
    for (const std::vector<double>& samples : {std::vector{1.0, kQuietNaN, 3.0}, std::vector{kQuietNaN}}) {
        HostArray<double> x(samples);
        value_ = -1.0;
        EXPECT_EQ(Median_head(x.handle(), &value_, &err_), 0);
        EXPECT_EQ(err_, kHoldsNaN);
        EXPECT_TRUE(IsQuietNaN(value_));
    }
}

TEST_F(StatEntry, MomentsByOrder) {
    HostArray<double> x{1, 3};
    int32_t order = 2;
    EXPECT_EQ(Moment_head(x.handle(), &order, &value_, &err_), 0);
    EXPECT_EQ(err_, 0);
    EXPECT_EQ(value_, 1.0);
    order = 0;
    EXPECT_EQ(Moment_head(x.handle(), &order, &value_, &err_), 0);
    EXPECT_EQ(err_, kBadOrder);
    EXPECT_TRUE(IsQuietNaN(value_));
}

TEST_F(StatEntry, MseWarnsOfDifferentLengths) {
    HostArray<double> x{1, 2};
    HostArray<double> y{1, 4, 9};
    EXPECT_EQ(MSE_head(x.handle(), y.handle(), &value_, &err_), 0);
    EXPECT_EQ(err_, kWarnSizesDiffer);
    EXPECT_EQ(value_, 2.0);
    EXPECT_EQ(MSE_head(x.handle(), x.handle(), &value_, &err_), 0);
    EXPECT_EQ(err_, 0);
    EXPECT_EQ(value_, 0.0);
}

TEST_F(StatEntry, MseCancelsAsItsFormSays) {
    HostArray<double> x{1e8 + 0.3};
    HostArray<double> y{1e8 + 0.7};
    EXPECT_EQ(MSE_head(x.handle(), y.handle(), &value_, &err_), 0);
    EXPECT_EQ(value_, 0.0) << "not 0.16, as (x - y)^2 would give";
}

TEST_F(StatEntry, RmsOfSamples) {
    HostArray<double> x{1, 7};
    EXPECT_EQ(RMS_head(x.handle(), &value_, &err_), 0);
    EXPECT_EQ(err_, 0);
    EXPECT_EQ(value_, 5.0);
}

TEST_F(StatEntry, ModesOfValues) {
    HostArray<double> x{1, 2, 2, 3, 3};
    HostArray<double> modes{9, 9, 9};
    EXPECT_EQ(ModeH(x.handle(), 0, modes.handle()), 0);
    EXPECT_THAT(modes.values(), ElementsAre(2, 3));
    HostArray<double> equal{4, 4, 4};
    for (const int32_t intervals : {-1, 0, 1, 5}) {
        EXPECT_EQ(ModeH(equal.handle(), intervals, modes.handle()), 0);
        EXPECT_THAT(modes.values(), ElementsAre(4));
    }
}

TEST_F(StatEntry, ModesOfBins) {
    HostArray<double> x{0, 0.1, 0.2, 5, 9.9, 10};
    HostArray<double> modes;
    EXPECT_EQ(ModeH(x.handle(), 5, modes.handle()), 0);
    EXPECT_THAT(modes.values(), ElementsAre(1));
    EXPECT_EQ(ModeH(x.handle(), 2, modes.handle()), 0);
    EXPECT_THAT(modes.values(), ElementsAre(2.5, 7.5)) << "5 lies in the upper half: three samples each";
}

TEST_F(StatEntry, NoModeLeavesTheArrayAsItCame) {
    HostArray<double> modes{9, 8};
    for (const std::vector<double>& samples : {std::vector{5.0}, std::vector{1.0, 2.0, 3.0}}) {
        HostArray<double> x(samples);
        const ResizeLog log;
        EXPECT_EQ(ModeH(x.handle(), 0, modes.handle()), 0);
        EXPECT_EQ(log.size(), 0);
        EXPECT_THAT(modes.values(), ElementsAre(9, 8));
    }
}

TEST_F(StatEntry, ModesOfNothing) {
    HostArray<double> modes{9};
    EXPECT_EQ(ModeH(none_.handle(), 0, modes.handle()), kEmptyInput);
    EXPECT_THAT(modes.values(), IsEmpty());
}

TEST_F(StatEntry, ModesHandOnTheHostsStatusAndKeepTheArray) {
    HostArray<double> x{1, 1};
    HostArray<double> modes{9, 9};
    const FailResize fail(1, 4711);
    EXPECT_EQ(ModeH(x.handle(), 0, modes.handle()), 4711);
    EXPECT_THAT(modes.values(), ElementsAre(9, 9));
}

class GeneralHistogram : public StatEntry {
  protected:
    KrOutOfRange counters_{-1, -1, -1};
    HostArray<int32_t> histogram_{7, 7, 7};
    HostArray<KrInterval> bins_{{0, 1, 0}, {1, 2, 0}};

    void ExpectFailure(KrHandle x, KrHandle bins) {
        counters_ = {-1, -1, -1};
        EXPECT_EQ(GenHistH(x, bins, histogram_.handle(), &counters_, &err_), 0);
        EXPECT_EQ(err_, kOutOfMemory);
        EXPECT_EQ(counters_.outside, 0);
        EXPECT_EQ(counters_.below, 0);
        EXPECT_EQ(counters_.above, 0);
        EXPECT_EQ(KrrtBytes(histogram_.handle()), sizeof(int32_t)) << "no elements are left";
    }
};

TEST_F(GeneralHistogram, CountsAndTellsTheRest) {
    HostArray<double> x{-1, 0.5, 1, 2};
    EXPECT_EQ(GenHistH(x.handle(), bins_.handle(), histogram_.handle(), &counters_, &err_), 0);
    EXPECT_EQ(err_, 0);
    EXPECT_THAT(histogram_.values(), ElementsAre(1, 1));
    EXPECT_EQ(counters_.outside, 2);
    EXPECT_EQ(counters_.below, 1);
    EXPECT_EQ(counters_.above, 1);
}

TEST_F(GeneralHistogram, NeedsNoIntervals) {
    HostArray<double> x{1, 2};
    HostArray<KrInterval> bins;
    EXPECT_EQ(GenHistH(x.handle(), bins.handle(), histogram_.handle(), &counters_, &err_), 0);
    EXPECT_EQ(err_, 0);
    EXPECT_THAT(histogram_.values(), IsEmpty());
    EXPECT_EQ(counters_.outside, 0);
}

TEST_F(GeneralHistogram, HidesTheCauseOfAFailure) {
    HostArray<double> x{1, 2};
    ExpectFailure(none_.handle(), bins_.handle());
    EXPECT_EQ(histogram_.size(), 2) << "the dimension word goes on telling the intervals";
    {
        const FailResize fail;
        HostArray<int32_t> untouched{7, 7, 7};
        histogram_ = std::move(untouched);
        ExpectFailure(x.handle(), bins_.handle());
        EXPECT_EQ(histogram_.size(), 3) << "the caller's word, when the array was never sized";
    }
    bins_.SetDimension(0, -1);
    ExpectFailure(x.handle(), bins_.handle());
}

class EqualHistogram : public StatEntry {
  protected:
    HostArray<int32_t> histogram_{7};
    HostArray<double> centers_{7, 7};

    int32_t Call(KrHandle x, int32_t bins) {
        return histgran_head(x, &bins, histogram_.handle(), centers_.handle(), &err_);
    }
    void ExpectEmptied(int32_t status) {
        EXPECT_EQ(err_, status);
        EXPECT_TRUE(histogram_.empty());
        EXPECT_TRUE(centers_.empty());
    }
};

TEST_F(EqualHistogram, PutsTheMaximumIntoTheLastBin) {
    HostArray<double> x{1, 2, 3};
    EXPECT_EQ(Call(x.handle(), 2), 0);
    EXPECT_EQ(err_, 0);
    EXPECT_THAT(histogram_.values(), ElementsAre(1, 2));
    EXPECT_THAT(centers_.values(), ElementsAre(1.5, 2.5));
}

TEST_F(EqualHistogram, RefusesNothing) {
    HostArray<double> x{1, 2};
    EXPECT_EQ(Call(none_.handle(), 2), 0);
    ExpectEmptied(kEmptyInput);
    EXPECT_EQ(Call(x.handle(), 0), 0);
    ExpectEmptied(kEmptyInput);
}

TEST_F(EqualHistogram, RefusesDataWithoutSpread) {
    HostArray<double> x{7, 7};
    EXPECT_EQ(Call(x.handle(), 2), 0);
    ExpectEmptied(kNoSpread);
}

TEST_F(EqualHistogram, FindsItsBoundsInOnePassThatNaNDisturbs) {
    HostArray<double> middle{1, kQuietNaN, 2};
    EXPECT_EQ(Call(middle.handle(), 2), 0);
    ExpectEmptied(kNoSpread);  // the NaN took the minimum over, and 2 after it
    HostArray<double> first{kQuietNaN, 2, 1};
    EXPECT_EQ(Call(first.handle(), 2), 0);
    EXPECT_EQ(err_, 0);
    EXPECT_THAT(histogram_.values(), ElementsAre(0, 3)) << "the maximum stays NaN, so all land in the last bin";
}

TEST_F(EqualHistogram, HandsOnTheHostsStatus) {
    HostArray<double> x{1, 2};
    for (const int32_t nth : {1, 2}) {
        const FailResize fail(nth, 4711);
        EXPECT_EQ(Call(x.handle(), 2), 4711);
        ExpectEmptied(kOutOfMemory);
    }
}

TEST_F(EqualHistogram, SizesTheCentersFirst) {
    HostArray<double> x{1, 2};
    const ResizeLog log;
    EXPECT_EQ(Call(x.handle(), 2), 0);
    ASSERT_EQ(log.size(), 2);
    EXPECT_EQ(log[0].typeCode, KRRT_DOUBLE);
    EXPECT_EQ(log[1].typeCode, KRRT_INT32);
}

}  // namespace
}  // namespace krnumer

// Rational resampling, as core and as exports.

#include "sigop/polyphase.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "frame/numeric.h"
#include "frame/status.h"
#include "krnumer/sigop.h"
#include "sigop/signals.h"
#include "support/host_arrays.h"

namespace krnumer {
namespace {

using testing::ElementsAre;

// A stream with its buffers, as a caller keeps them.
template <class T>
class Stream {
  public:
    Stream(int32_t up, int32_t down, std::vector<double> filter, int32_t start)
        : filter_(std::move(filter)), rate_{up, down, filter_.data(), Size(filter_)}, state_{start, 0} {
        history_.resize(Count(RationalHistory(rate_)));
    }

    std::vector<T> Next(const std::vector<T>& x) {
        std::vector<T> y(static_cast<size_t>(RationalOutputCount(rate_, state_, Size(x))));
        EXPECT_EQ(
            PolyphaseResample(x.data(), 1, Size(x), rate_, &state_, history_.data(), Size(history_), y.data(), Size(y)),
            kOk);
        return y;
    }

    const RationalStream& state() const { return state_; }

  private:
    std::vector<double> filter_;
    RationalRate rate_;
    RationalStream state_;
    std::vector<T> history_;
};

template <class T>
class PolyphaseTest : public testing::Test {
  protected:
    RandomSignals random_;
};
using Elements = testing::Types<double, Complex>;
TYPED_TEST_SUITE(PolyphaseTest, Elements);

TYPED_TEST(PolyphaseTest, AgreesWithGoldenData) {
    using T = TypeParam;
    const Golden golden("resample");
    for (const std::string& name : golden.Cases(std::is_same_v<T, Complex> ? "rational_complex" : "rational_float")) {
        SCOPED_TRACE(name);
        const auto rate = golden.Integers(name + ".rate");
        Stream<T> stream(rate[0], rate[1], golden.Reals(name + ".filter"), rate[2]);
        EXPECT_THAT(stream.Next(golden.Get<T>(name + ".x")), AllNear(golden.Get<T>(name + ".y"), 0.0, 3e-14));
    }
}

// The sum by its definition: zeros put between samples, a filter with its centre on the output.
TYPED_TEST(PolyphaseTest, IsAFilterBetweenTheRates) {
    using T = TypeParam;
    for (int round = 0; round < 100; ++round) {
        const int32_t up = this->random_.Integer(1, 9), down = this->random_.Integer(1, 9);
        const int32_t centre = this->random_.Integer(0, 40), start = this->random_.Integer(0, 20);
        const auto filter = this->random_.template Samples<double>(2 * centre + 1);
        const auto x = this->random_.template Samples<T>(this->random_.Integer(1, 60));
        const auto y = Stream<T>(up, down, filter, start).Next(x);
        std::vector<T> expected;
        for (int32_t p = start; p + centre < Size(x) * up; p += down) {
            ExactSum<T> sum;
            for (int32_t t = 0; t < Size(filter); ++t) {
                const int32_t fine = p - centre + t;
                if (fine >= 0 && fine % up == 0) sum.Add(up * filter[Count(t)], x[Count(fine / up)]);
            }
            expected.push_back(sum.value());
        }
        EXPECT_THAT(y, AllNear(expected, 0.0, 1e-13)) << up << "/" << down << ", " << centre << ", " << start;
    }
}

// Blocks of any length, none and one sample among them.
TYPED_TEST(PolyphaseTest, BlocksGiveWhatTheWholeGives) {
    using T = TypeParam;
    for (int round = 0; round < 400; ++round) {
        const int32_t up = this->random_.Integer(1, 12), down = this->random_.Integer(1, 12);
        const int32_t centre = this->random_.Integer(up - 1, up + 60), start = this->random_.Integer(0, 30);
        const auto filter = this->random_.template Samples<double>(2 * centre + 1);
        const auto x = this->random_.template Samples<T>(this->random_.Integer(1, 120));
        Stream<T> stream(up, down, filter, start), whole_stream(up, down, filter, start);
        const auto whole = whole_stream.Next(x);
        std::vector<T> pieces;
        for (auto first = x.begin(); first != x.end();) {
            const auto end =
                first + std::min<ptrdiff_t>(x.end() - first, this->random_.Integer(0, round % 3 == 0 ? 1 : 20));
            const auto piece = stream.Next({first, end});
            pieces.insert(pieces.end(), piece.begin(), piece.end());
            first = end;
        }
        ASSERT_THAT(pieces, SameBitsAs(whole)) << up << "/" << down << ", " << centre << ", " << start;
    }
}

TEST(Polyphase, SkipsBlocksThatLieBeforeTheNextOutput) {
    Stream<double> stream(1, 3, {1}, 0);
    EXPECT_THAT(stream.Next({0, 1, 2, 3, 4, 5, 6, 7, 8, 9}), ElementsAre(0, 3, 6, 9));
    EXPECT_EQ(stream.state().start, 2);
    EXPECT_EQ(stream.state().history_count, 0);
    EXPECT_THAT(stream.Next({10}), ElementsAre());
    EXPECT_EQ(stream.state().start, 1);
    EXPECT_THAT(stream.Next({11, 12, 13}), ElementsAre(12));
}

TEST(Polyphase, AShortFilterFallsBehindItsSamples) {
    const double filter[5] = {1, 1, 1, 1, 1};
    const double x[2] = {1, 2};
    double history[1] = {}, y[4];
    RationalStream stream{4, 0};
    EXPECT_EQ(PolyphaseResample(x, 1, 1, {6, 6, filter, 5}, &stream, history, 1, y, 0), kOk);
    EXPECT_EQ(stream.start, -2);
    EXPECT_EQ(PolyphaseResample(x, 1, 1, {6, 6, filter, 5}, &stream, history, 1, y, 0), kNegativeState);
    stream = {1, 0};
    EXPECT_EQ(PolyphaseResample(x, 1, 2, {6, 1, filter, 1}, &stream, history, 1, y, 0), kOk);
    EXPECT_EQ(stream.start, -5);
}

TEST(Polyphase, RefusesInOrder) {
    const double filter[3] = {1, 2, 3};
    const double x[2] = {1, 2};
    double history[2] = {5, 6}, y[4] = {};
    const auto run = [&](RationalRate rate, RationalStream stream, int32_t capacity) {
        const RationalStream before = stream;
        const int32_t status = PolyphaseResample(x, 1, 2, rate, &stream, history, capacity, y, 1);
        EXPECT_EQ(stream.start, before.start);
        EXPECT_EQ(stream.history_count, before.history_count);
        return status;
    };
    EXPECT_EQ(run({0, 0, filter, 2}, {-1, 0}, 2), kNegativeState);
    EXPECT_EQ(run({0, 0, filter, 2}, {0, -1}, 2), kNegativeState);
    EXPECT_EQ(run({0, 1, filter, 2}, {0, 0}, 2), kNotPositive);
    EXPECT_EQ(run({1, 0, filter, 2}, {0, 0}, 2), kNotPositive);
    EXPECT_EQ(run({1, 1, filter, 2}, {0, 9}, 2), kEvenLength);
    EXPECT_EQ(run({1, 1, filter, 0}, {0, 9}, 2), kEvenLength);
    EXPECT_EQ(run({1, 1, filter, 3}, {0, 3}, 2), kHistoryTooSmall);
    EXPECT_EQ(run({1, 1, filter, 3}, {0, 0}, 1), kHistoryTooSmall);
    EXPECT_THAT(history, ElementsAre(5, 6));
}

TEST(Polyphase, CountsOutputsBeyondIntegers) {
    EXPECT_EQ(RationalOutputCount({2147483647, 1, nullptr, 1}, {0, 2147483647}, 2147483647), 9223372028264841218);
    EXPECT_EQ(RationalOutputCount({1, 1, nullptr, 9}, {0, 2}, 2), 0);
    EXPECT_EQ(RationalOutputCount({1, 1, nullptr, 9}, {0, 2}, 3), 1);
}

class PolyphaseExports : public testing::Test {
  protected:
    LeakCheck leaks_;
    HostArray<double> x_{1, 2, 3, 4, 5, 6}, filter_{0.25, 0.5, 0.25}, history_{9}, y_{9};
    HostMatrix<double> mx_{2, 3, {1, 2, 3, 10, 20, 30}}, mhistory_, my_{1, 1};
    HostArray<Complex> cx_{{1, 1}, {2, 0}, {3, -1}}, chistory_, cy_;
    HostMatrix<Complex> mcx_{2, 2, {{1, 1}, {2, 0}, {3, -1}, {0, 4}}}, mchistory_, mcy_;
    int32_t start_ = 0, count_ = 5;
};

TEST_F(PolyphaseExports, ResampleStreams) {
    EXPECT_EQ(
        RationalResample_H(x_.handle(), 2, 3, 1, &start_, filter_.handle(), history_.handle(), &count_, y_.handle()),
        0);
    EXPECT_THAT(y_.values(), ElementsAre(1, 2.5, 4, 5.5));
    EXPECT_EQ(history_.size(), 2);
    EXPECT_EQ(count_, 0);
    EXPECT_EQ(start_, 0);
    EXPECT_EQ(CxRationalResample_H(cx_.handle(), 2, 1, 1, &start_, filter_.handle(), chistory_.handle(), &count_,
                                   cy_.handle()),
              0);
    EXPECT_THAT(cy_.values(),
                ElementsAre(Complex{1, 1}, Complex{1.5, 0.5}, Complex{2, 0}, Complex{2.5, -0.5}, Complex{3, -1}));
    EXPECT_EQ(count_, 1);
    EXPECT_EQ(chistory_[0], (Complex{3, -1}));
    EXPECT_EQ(start_, 1);
}

TEST_F(PolyphaseExports, ResetKeepsTheStart) {
    start_ = 4;
    EXPECT_EQ(
        RationalResample_H(x_.handle(), 2, 3, 1, &start_, filter_.handle(), history_.handle(), &count_, y_.handle()),
        0);
    EXPECT_THAT(y_.values(), ElementsAre(3, 4.5, 6));
}

TEST_F(PolyphaseExports, MalformedFilterHasNoTaps) {
    for (const int32_t taps : {-7, INT32_MIN}) {
        filter_.SetDimension(0, taps);
        EXPECT_EQ(RationalResample_H(x_.handle(), 2, 3, 1, &start_, filter_.handle(), history_.handle(), &count_,
                                     y_.handle()),
                  kEvenLength);
        EXPECT_TRUE(y_.empty());
    }
}

TEST_F(PolyphaseExports, ChannelsShareTheirPosition) {
    for (int block = 0; block < 2; ++block) {
        EXPECT_EQ(RationalResampleMultiCh_H(mx_.handle(), 2, 3, block == 0, &start_, filter_.handle(),
                                            mhistory_.handle(), &count_, my_.handle()),
                  0);
        EXPECT_EQ(my_.rows(), 2);
        EXPECT_EQ(my_.columns(), 2);
        EXPECT_THAT(my_.values(), ElementsAre(1, 2.5, 10, 25));
        EXPECT_EQ(mhistory_.rows(), 2);
        EXPECT_EQ(mhistory_.columns(), 2);
        EXPECT_EQ(count_, 0);
    }
    EXPECT_EQ(CxRationalResampleMCh_H(mcx_.handle(), 1, 1, 1, &start_, filter_.handle(), mchistory_.handle(), &count_,
                                      mcy_.handle()),
              0);
    EXPECT_THAT(mcy_.values(), ElementsAre(Complex{1, 0.5}, Complex{1.5, 0.5}));
    EXPECT_EQ(count_, 2);
    EXPECT_THAT(mchistory_.values(),
                ElementsAre(Complex{1, 1}, Complex{2, 0}, Complex{}, Complex{3, -1}, Complex{0, 4}, Complex{}));
}

TEST_F(PolyphaseExports, EveryChannelGivesWhatItGivesAlone) {
    RandomSignals random;
    const auto filter = random.Samples<double>(45);
    const HostArray<double> taps(filter);
    Stream<double> first(4, 7, filter, 3), second(4, 7, filter, 3);
    start_ = 3;
    for (int block = 0; block < 20; ++block) {
        const auto a = random.Samples<double>(block), b = random.Samples<double>(block);
        std::vector<double> both = a;
        both.insert(both.end(), b.begin(), b.end());
        const HostMatrix<double> x(2, block, both);
        EXPECT_EQ(RationalResampleMultiCh_H(x.handle(), 4, 7, block == 0, &start_, taps.handle(), mhistory_.handle(),
                                            &count_, my_.handle()),
                  0);
        std::vector<double> expected = first.Next(a);
        const auto other = second.Next(b);
        expected.insert(expected.end(), other.begin(), other.end());
        EXPECT_THAT(my_.values(), SameBitsAs(expected));
    }
}

TEST_F(PolyphaseExports, AHistoryWithoutRowsIsSizedWithoutReset) {
    count_ = 0;
    EXPECT_EQ(RationalResampleMultiCh_H(mx_.handle(), 2, 3, 0, &start_, filter_.handle(), mhistory_.handle(), &count_,
                                        my_.handle()),
              0);
    EXPECT_EQ(mhistory_.rows(), 2);
    EXPECT_EQ(mhistory_.columns(), 2);
    HostMatrix<double> fresh;  // the count stays: two samples of 0
    count_ = 2;
    start_ = 0;
    EXPECT_EQ(RationalResampleMultiCh_H(mx_.handle(), 2, 4, 0, &start_, filter_.handle(), fresh.handle(), &count_,
                                        my_.handle()),
              0);
    EXPECT_THAT(my_.values(), ElementsAre(0, 1, 3, 0, 10, 30));
}

TEST_F(PolyphaseExports, AHistoryOfOtherChannelsIsRefused) {
    HostMatrix<double> other(3, 2);
    count_ = 0;
    EXPECT_EQ(RationalResampleMultiCh_H(mx_.handle(), 2, 3, 0, &start_, filter_.handle(), other.handle(), &count_,
                                        my_.handle()),
              kBadDimension);
    EXPECT_TRUE(other.empty());
    EXPECT_TRUE(my_.empty());
    other = HostMatrix<double>(3, 2);
    EXPECT_EQ(RationalResampleMultiCh_H(mx_.handle(), 2, 3, 1, &start_, filter_.handle(), other.handle(), &count_,
                                        my_.handle()),
              0);
    EXPECT_EQ(other.rows(), 2);
}

TEST_F(PolyphaseExports, NoChannelsGiveNone) {
    HostMatrix<double> none;
    EXPECT_EQ(RationalResampleMultiCh_H(none.handle(), 2, 3, 1, &start_, filter_.handle(), mhistory_.handle(), &count_,
                                        my_.handle()),
              0);
    EXPECT_TRUE(mhistory_.empty());
    EXPECT_TRUE(my_.empty());
    EXPECT_EQ(count_, 0);
}

TEST_F(PolyphaseExports, ABlockWithoutOutputEmptiesIt) {
    start_ = 100;
    EXPECT_EQ(
        RationalResample_H(x_.handle(), 2, 3, 1, &start_, filter_.handle(), history_.handle(), &count_, y_.handle()),
        0);
    EXPECT_TRUE(y_.empty());
    EXPECT_EQ(start_, 88);
    EXPECT_EQ(history_.size(), 2);
    start_ = 13;
    EXPECT_EQ(
        RationalResample_H(x_.handle(), 2, 3, 0, &start_, filter_.handle(), history_.handle(), &count_, x_.handle()),
        0);
    EXPECT_TRUE(x_.empty());  // the block itself, once it has been taken in
    EXPECT_EQ(start_, 1);
}

TEST_F(PolyphaseExports, RefuseInOrderAndEmptyHistoryAndOutput) {
    HostArray<double> even{1, 2};
    const auto expect = [&](int32_t status, int32_t up, int32_t down, int32_t reset, int32_t start, int32_t count,
                            const HostArray<double>& filter) {
        history_ = HostArray<double>{9};
        y_ = HostArray<double>{9};
        start_ = start;
        count_ = count;
        EXPECT_EQ(RationalResample_H(x_.handle(), up, down, reset, &start_, filter.handle(), history_.handle(), &count_,
                                     y_.handle()),
                  status);
        EXPECT_TRUE(history_.empty());
        EXPECT_TRUE(y_.empty());
        EXPECT_EQ(start_, start);
    };
    expect(kNegativeState, 0, 0, 1, -1, 0, even);
    expect(kNegativeState, 0, 0, 1, 0, -1, even);
    expect(kNotPositive, 0, 1, 1, 0, 0, even);
    expect(kNotPositive, 1, 0, 1, 0, 0, even);
    expect(kEvenLength, 1, 1, 1, 0, 0, even);
    expect(kEvenLength, 1, 1, 1, 0, 0, HostArray<double>());
    expect(kHistoryTooSmall, 1, 1, 0, 0, 0, filter_);
    expect(kHistoryTooSmall, 1, 1, 0, 0, 2, filter_);
    expect(kHistoryTooSmall, 1, 1, 0, 100, 1, filter_);
}

TEST_F(PolyphaseExports, ReportRefusedResizes) {
    for (int32_t nth = 1; nth <= 2; ++nth) {
        const FailResize fail(nth, 4711);
        EXPECT_EQ(RationalResample_H(x_.handle(), 2, 3, 1, &start_, filter_.handle(), history_.handle(), &count_,
                                     y_.handle()),
                  kOutOfMemory);
        EXPECT_TRUE(history_.empty());
        EXPECT_TRUE(y_.empty());
    }
    EXPECT_EQ(RationalResample_H(x_.handle(), 2147483647, 1, 1, &start_, filter_.handle(), history_.handle(), &count_,
                                 y_.handle()),
              kOutOfMemory);
}

}  // namespace
}  // namespace krnumer

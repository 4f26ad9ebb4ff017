// The exports of resampling at any ratio: statuses, their order, and what they leave in states and outputs.

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cmath>
#include <cstring>

#include "frame/numeric.h"
#include "frame/status.h"
#include "krnumer/sigop.h"
#include "sigop/signals.h"
#include "support/host_arrays.h"

namespace krnumer {
namespace {

using testing::ElementsAre;

// A stream of Resample_Const. The record owns its arrays: the library may store other handles there.
template <class T>
class ResampleConstExports : public testing::Test {
  protected:
    int32_t Run(const HostArray<T>& x, int32_t initialize, int32_t scale_kernel = 1) {
        state_.history = history_.handle();
        state_.taps = taps_.handle();
        spec_.kernel = kernel_.handle();
        outputs_ = -1;
        if constexpr (std::is_same_v<T, Complex>) {
            return CxResample_Const(x.handle(), &state_, &spec_, initialize, y_.handle(), &outputs_, scale_kernel);
        } else {
            return Resample_Const(x.handle(), &state_, &spec_, initialize, y_.handle(), &outputs_, scale_kernel);
        }
    }

    std::vector<T> Outputs() const {
        auto y = y_.values();
        y.resize(Count(outputs_));
        return y;
    }

    LeakCheck leaks_;
    HostArray<double> kernel_{0, 0.25, 0.5, 0.25, 0}, taps_;
    HostArray<T> history_, y_;
    KrResampleState state_{};
    KrResampleSpec spec_{1.0, 0, 0.0, nullptr, 2};
    int32_t outputs_ = -1;
};
using Elements = testing::Types<double, Complex>;
TYPED_TEST_SUITE(ResampleConstExports, Elements);

TYPED_TEST(ResampleConstExports, ContinueAStream) {
    using T = TypeParam;
    RandomSignals random;
    const auto x = random.Samples<T>(40);
    this->spec_.ratio = 0.73;
    this->spec_.start = 0.5;
    ASSERT_EQ(this->Run(HostArray<T>(x), 1), 0);
    const auto whole = this->Outputs();
    EXPECT_GT(whole.size(), 50u);

    std::vector<T> pieces;
    bool first = true;
    for (size_t begin = 0, end = 0; begin < x.size(); begin = end) {
        end = std::min(x.size(), begin + Count(random.Integer(0, 5)));
        const HostArray<T> block(std::span<const T>(x.data() + begin, end - begin));
        ASSERT_EQ(this->Run(block, first ? 1 : 0), 0);
        EXPECT_LE(this->outputs_, this->y_.size());
        const auto piece = this->Outputs();
        pieces.insert(pieces.end(), piece.begin(), piece.end());
        first = false;
        this->spec_.ratio = -5;  // looked at in the first call only
        this->spec_.start = 1e300;
        this->spec_.mode = 1;
    }
    EXPECT_THAT(pieces, AllNear(whole, 0.0, 1e-13));
}

TYPED_TEST(ResampleConstExports, InitialiseTheState) {
    using T = TypeParam;
    this->spec_.ratio = 2.0;
    this->spec_.mode = 1;
    this->spec_.start = 1.75;
    EXPECT_EQ(this->Run(HostArray<T>(3), 1), 0);
    EXPECT_EQ(this->history_.size(), 6);  // 3 samples before the position, 2 behind it, and one more
    EXPECT_EQ(this->taps_.size(), 6);
    EXPECT_EQ(this->y_.size(), 2);  // room for 3 / 2, rounded up
    EXPECT_EQ(this->outputs_, 0);
    // The fields of the record have no address that fits them: + makes them values.
    EXPECT_EQ(+this->state_.historyCount, 3);
    EXPECT_EQ(+this->state_.gain, 1.0);
    EXPECT_EQ(+this->state_.left, 2);
    EXPECT_EQ(+this->state_.right, 2);
    EXPECT_EQ(+this->state_.mode, 1);
    EXPECT_EQ(+this->state_.ratio, 2.0);
    EXPECT_EQ(+this->state_.frac, 0.75);
    EXPECT_EQ(+this->state_.index, 1);
    EXPECT_THAT(this->taps_.values(), ElementsAre(0, 0.25, 0.5, 0.25, 0, 0));
}

TYPED_TEST(ResampleConstExports, LeaveTheTapsOfTheNextOutput) {
    using T = TypeParam;
    this->spec_ = {0.75, 0, 0.0, nullptr, 2};
    ASSERT_EQ(this->Run(HostArray<T>(50), 1), 0);
    ASSERT_GT(this->outputs_, 50);
    for (const int32_t block : {0, 1, 2, 3}) {
        ASSERT_EQ(this->Run(HostArray<T>(block), 0), 0);
        const double frac = this->state_.frac;
        const int32_t left = this->state_.left;
        const int32_t right = this->state_.right;
        const auto taps = this->taps_.values();
        const auto kernel = this->kernel_.values();
        for (int32_t t = 0; t < left + right; ++t) {
            const double position = 2.0 - 2.0 * frac - 2.0 * (left - 1) + 2.0 * t;
            const double next = position < 4.0 ? kernel[Count(static_cast<int32_t>(position)) + 1] : 0.0;
            const double value = kernel[Count(static_cast<int32_t>(position))];
            EXPECT_EQ(taps[Count(t)], value + (next - value) * (position - std::floor(position))) << frac;
        }
    }
}

TYPED_TEST(ResampleConstExports, AFailureLeavesTheStateAndEmptiesTheOutput) {
    using T = TypeParam;
    ASSERT_EQ(this->Run(HostArray<T>(5), 1), 0);
    const KrResampleState before = this->state_;
    const auto expect = [&](int32_t status, int32_t initialize) {
        EXPECT_EQ(this->Run(HostArray<T>(5), initialize), status);
        // NOLINTNEXTLINE(bugprone-suspicious-memory-comparison): the record has no padding
        EXPECT_EQ(std::memcmp(&this->state_, &before, sizeof before), 0);
        EXPECT_TRUE(this->y_.empty());
        EXPECT_EQ(this->outputs_, 0);
        this->y_ = HostArray<T>(3);
    };
    for (const double ratio : {0.0, -1.0, kQuietNaN}) {
        this->spec_ = {ratio, 0, 1e300, nullptr, 0};
        expect(kNotPositive, 1);
    }
    HostArray<double> kernel;
    std::swap(kernel, this->kernel_);
    this->spec_ = {1.0, 0, 1e300, nullptr, 0};
    expect(kNotPositive, 1);
    expect(kNotPositive, 0);
    this->spec_ = {1.0, 0, 1e300, nullptr, 1};
    expect(kEmptyInput, 1);
    expect(kEmptyInput, 0);
    std::swap(kernel, this->kernel_);
    for (const double start : {3e9, -3e9, kInfinity, kQuietNaN}) {
        this->spec_.start = start;
        expect(kBadSelector, 1);
    }
    this->spec_ = {1e300, 0, 0.0, nullptr, 1};
    expect(kOutOfMemory, 1);  // a kernel stretched over more samples than there are integers
    this->spec_ = {1e-12, 0, 0.0, nullptr, 1};
    expect(kOutOfMemory, 1);  // as many outputs
}

TYPED_TEST(ResampleConstExports, RefuseArraysThatTheStateDoesNotFit) {
    using T = TypeParam;
    ASSERT_EQ(this->Run(HostArray<T>(5), 1), 0);
    const KrResampleState before = this->state_;
    this->state_.historyCount = -1;
    EXPECT_EQ(this->Run(HostArray<T>(5), 0), kNegativeState);
    EXPECT_TRUE(this->y_.empty());
    this->state_ = before;
    this->taps_ = HostArray<double>(1);
    EXPECT_EQ(this->Run(HostArray<T>(5), 0), kTooManyTaps);
    this->taps_ = HostArray<double>(9);
    this->history_ = HostArray<T>(1);
    EXPECT_EQ(this->Run(HostArray<T>(5), 0), kHistoryTooSmall);
}

TYPED_TEST(ResampleConstExports, ReportRefusedResizes) {
    using T = TypeParam;
    for (int32_t nth = 1; nth <= 3; ++nth) {
        this->history_ = HostArray<T>();
        this->taps_ = HostArray<double>();
        this->y_ = HostArray<T>(1);
        const FailResize fail(nth, 4711);
        EXPECT_EQ(this->Run(HostArray<T>(5), 1), kOutOfMemory);
        EXPECT_TRUE(fail.happened());
        EXPECT_TRUE(this->y_.empty());
    }
}

class ResampleVariableExports : public testing::Test {
  protected:
    LeakCheck leaks_;
    HostArray<double> x_{1, 2, 3, 4, 5}, times_{0.5, 2.5, 4.0, 9.0}, kernel_{0, 1, 0};
    HostArray<Complex> cx_{{1, 1}, {2, 0}, {3, -1}, {4, 2}, {5, 0}}, y_;
    KrVariableResampleSpec spec_{0, 0, kernel_.handle(), 1};
    double last_time_ = -1.5;
    int32_t outputs_ = -1, consumed_ = -1;
};

TEST_F(ResampleVariableExports, PutRealOutputsInPlaceOfTheirTimes) {
    EXPECT_EQ(Resample_Variable(x_.handle(), times_.handle(), &spec_, &last_time_, &outputs_, &consumed_), 0);
    EXPECT_EQ(outputs_, 2);
    EXPECT_EQ(consumed_, 3);  // for the position 4.0, which needs the sample 5
    EXPECT_EQ(last_time_, -0.5);
    EXPECT_THAT(times_.values(), ElementsAre(1.5, 3.5, 1.0, 6.0));
}

TEST_F(ResampleVariableExports, PutComplexOutputsIntoTheirOwnArray) {
    EXPECT_EQ(
        CxResample_Variable(cx_.handle(), times_.handle(), &spec_, y_.handle(), &last_time_, &outputs_, &consumed_), 0);
    EXPECT_EQ(outputs_, 2);
    EXPECT_EQ(y_.size(), 4);
    EXPECT_EQ(y_[0], (Complex{1.5, 0.5}));
    EXPECT_EQ(y_[1], (Complex{3.5, 0.5}));
    EXPECT_EQ(y_[2], Complex{});
    EXPECT_EQ(consumed_, 3);
    EXPECT_EQ(last_time_, -0.5);
    EXPECT_THAT(times_.values(), ElementsAre(0.5, 2.5, 1.0, 6.0));
}

TEST_F(ResampleVariableExports, StretchTheKernelIfAsked) {
    spec_.adaptive = 200;
    HostArray<double> times{2.0};
    last_time_ = 0.0;  // a step of 2: weights 0.25, 0.5, 0.25
    EXPECT_EQ(Resample_Variable(x_.handle(), times.handle(), &spec_, &last_time_, &outputs_, &consumed_), 0);
    EXPECT_THAT(times.values(), ElementsAre(3));
    EXPECT_EQ(consumed_, 0);
    x_ = HostArray<double>{0, 0, 1, 0, 0};
    times = HostArray<double>{2.0};
    last_time_ = 0.0;
    EXPECT_EQ(Resample_Variable(x_.handle(), times.handle(), &spec_, &last_time_, &outputs_, &consumed_), 0);
    EXPECT_THAT(times.values(), ElementsAre(0.5));
}

TEST_F(ResampleVariableExports, WithoutTimesTheyDoNothing) {
    HostArray<double> none;
    HostArray<double> no_kernel;
    spec_.kernel = no_kernel.handle();
    spec_.oversampling = 0;
    EXPECT_EQ(Resample_Variable(x_.handle(), none.handle(), &spec_, &last_time_, &outputs_, &consumed_), 0);
    EXPECT_EQ(outputs_, 0);
    EXPECT_EQ(consumed_, 0);
    EXPECT_EQ(last_time_, -1.5);
    EXPECT_EQ(CxResample_Variable(cx_.handle(), none.handle(), &spec_, y_.handle(), &last_time_, &outputs_, &consumed_),
              0);
    EXPECT_TRUE(y_.empty());
}

TEST_F(ResampleVariableExports, RefuseInOrder) {
    HostArray<double> no_kernel;
    const auto expect = [&](int32_t status) {
        for (const bool complex : {false, true}) {
            HostArray<double> times{0.5, 3e9};
            y_ = HostArray<Complex>(1);
            EXPECT_EQ(complex
                          ? CxResample_Variable(cx_.handle(), times.handle(), &spec_, y_.handle(), &last_time_,
                                                &outputs_, &consumed_)
                          : Resample_Variable(x_.handle(), times.handle(), &spec_, &last_time_, &outputs_, &consumed_),
                      status);
            EXPECT_TRUE(times.empty());
            EXPECT_EQ(y_.size(), complex ? 0 : 1);
            EXPECT_EQ(outputs_, 0);
            EXPECT_EQ(consumed_, 0);
            EXPECT_EQ(last_time_, -1.5);
        }
    };
    spec_ = {0, 0, no_kernel.handle(), 0};
    expect(kNotPositive);
    spec_ = {0, 0, no_kernel.handle(), 1};
    expect(kEmptyInput);
    spec_ = {0, 0, kernel_.handle(), 1};
    expect(kBadSelector);
    spec_ = {0, 1, kernel_.handle(), 1};
    HostArray<double> far{1e300};  // a kernel stretched over more samples than there are integers
    EXPECT_EQ(Resample_Variable(x_.handle(), far.handle(), &spec_, &last_time_, &outputs_, &consumed_), kOutOfMemory);
}

TEST_F(ResampleVariableExports, ReportARefusedResize) {
    const FailResize fail(1, 4711);
    EXPECT_EQ(
        CxResample_Variable(cx_.handle(), times_.handle(), &spec_, y_.handle(), &last_time_, &outputs_, &consumed_),
        kOutOfMemory);
    EXPECT_TRUE(y_.empty());
    EXPECT_EQ(outputs_, 0);
}

}  // namespace
}  // namespace krnumer

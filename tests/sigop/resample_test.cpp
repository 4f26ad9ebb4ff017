// Resampling at any ratio, as cores.

#include "sigop/resample.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cmath>

#include "frame/numeric.h"
#include "frame/status.h"
#include "sigop/signals.h"
#include "support/numbers.h"
#include "support/vector_units.h"

namespace krnumer {
namespace {

using testing::ElementsAre;

const Golden& Reference() {
    static const Golden golden("resample");
    return golden;
}

ResampleKernel Kernel(bool nearest = false) {
    const auto& table = Reference().Reals("kernel.points");
    return {table.data(), Size(table), 16, nearest};
}

// A stream of constant ratio with its buffers.
template <class T>
class Stream {
  public:
    Stream(const ResampleKernel& kernel, double ratio, double start, bool scale_kernel = true)
        : kernel_(kernel), scale_kernel_(scale_kernel) {
        const KernelPhase phase = ResamplePhase(kernel, ratio, 0.0);
        history_.resize(Count(phase.left + phase.right + 1));
        taps_.resize(history_.size());
        state_.ratio = ratio;
        state_.index = static_cast<int32_t>(start);
        state_.frac = start - state_.index;
    }

    std::vector<T> Next(const std::vector<T>& x) {
        std::vector<T> y;
        EXPECT_EQ(TryNext(x, static_cast<int32_t>(std::ceil((Size(x) + state_.history_count) / state_.ratio)), &y),
                  kOk);
        return y;
    }

    int32_t TryNext(const std::vector<T>& x, int32_t capacity, std::vector<T>* y) {
        state_.history = history_.data();
        state_.history_capacity = Size(history_);
        state_.taps = taps_.data();
        state_.taps_capacity = Size(taps_);
        y->resize(Count(capacity));
        int32_t count = -1;
        const int32_t status =
            ResampleRun(x.data(), Size(x), kernel_, &state_, y->data(), capacity, &count, scale_kernel_);
        y->resize(Count(count));
        return status;
    }

    ResampleStream<T>& state() { return state_; }
    std::vector<double>& taps() { return taps_; }
    std::vector<T>& history() { return history_; }

  private:
    ResampleKernel kernel_;
    bool scale_kernel_;
    std::vector<T> history_;
    std::vector<double> taps_;
    ResampleStream<T> state_{};
};

template <class T>
class ResampleTest : public testing::Test {
  protected:
    // Blocks of any length, none and one sample among them, until all is taken in.
    template <class Take>
    void ForEachBlock(const std::vector<T>& x, int32_t longest, Take take) {
        for (auto first = x.begin(); first != x.end();) {
            const auto end = first + std::min<ptrdiff_t>(x.end() - first, random_.Integer(0, longest));
            take(std::vector<T>(first, end));
            first = end;
        }
    }

    RandomSignals random_;
};
using Elements = testing::Types<double, Complex>;
TYPED_TEST_SUITE(ResampleTest, Elements);

TYPED_TEST(ResampleTest, AgreesWithGoldenData) {
    using T = TypeParam;
    for (const auto& name : Reference().Cases(std::is_same_v<T, Complex> ? "constant_complex" : "constant_float")) {
        SCOPED_TRACE(name);
        const auto& spec = Reference().Reals(name + ".spec");
        Stream<T> stream(Kernel(spec[1] != 0), spec[0], spec[2]);
        EXPECT_THAT(stream.Next(Reference().Get<T>(name + ".x")), AllNear(Reference().Get<T>(name + ".y"), 0.0, 1e-13));
    }
}

// The kernel at positions that add up, products from the last tap backwards.
template <class T>
std::vector<T> OneAtATime(const std::vector<T>& x, const ResampleKernel& kernel, double ratio, double start) {
    std::vector<T> y;
    for (;;) {
        const double position = static_cast<double>(y.size()) * ratio + start;
        const auto index = static_cast<int32_t>(position);
        const KernelPhase phase = ResamplePhase(kernel, ratio, position - index);
        if (index + phase.right >= Size(x)) return y;
        std::vector<double> taps;
        double place = phase.first;
        for (int32_t t = 0; t < phase.left + phase.right; ++t, place += phase.delta) {
            const auto point = std::min(static_cast<int32_t>(kernel.nearest ? place + 0.5 : place), kernel.points - 1);
            double tap = kernel.table[point];
            if (!kernel.nearest && point < kernel.points - 1) tap += (kernel.table[point + 1] - tap) * (place - point);
            taps.push_back(tap);
        }
        T sum{};
        for (int32_t t = Size(taps) - 1; t >= 0; --t) {
            const int32_t sample = index - phase.left + 1 + t;
            if (sample >= 0) sum += taps[Count(t)] * x[Count(sample)];
        }
        y.push_back(sum * phase.delta);
    }
}

TYPED_TEST(ResampleTest, GivesWhatOneOutputAtATimeGives) {
    using T = TypeParam;
    for (int round = 0; round < 100; ++round) {
        const auto table = this->random_.template Samples<double>(this->random_.Integer(1, 90));
        const ResampleKernel kernel{table.data(), Size(table), this->random_.Integer(1, 20), round % 2 == 0};
        // Wholes and halves meet points and ends of the table.
        const double ratio = round % 5 == 0 ? this->random_.Integer(1, 8) * 0.5 : this->random_.Between(0.1, 5.0);
        const double start = this->random_.Integer(0, 9) * 0.25;
        auto x = this->random_.template Samples<T>(this->random_.Integer(0, 100));
        if (round % 3 == 0 && !x.empty()) x.back() = x.back() * kInfinity;
        const auto expected = OneAtATime(x, kernel, ratio, start);
        OnEveryVectorUnit([&] {
            ASSERT_THAT(Stream<T>(kernel, ratio, start).Next(x), SameBitsAs(expected))
                << table.size() << " points, " << kernel.oversampling << " per sample, ratio " << ratio;
        });
    }
}

TYPED_TEST(ResampleTest, BlocksGiveWhatTheWholeGives) {
    using T = TypeParam;
    for (int round = 0; round < 300; ++round) {
        const double ratio = this->random_.Between(0.1, round % 2 == 0 ? 1.5 : 9.0);
        const double start = this->random_.Between(0.0, 20.0);
        const bool scale_kernel = round % 4 < 2;
        const auto x = this->random_.template Samples<T>(200);
        const auto whole = Stream<T>(Kernel(), ratio, start, scale_kernel).Next(x);
        Stream<T> stream(Kernel(), ratio, start, scale_kernel);
        std::vector<T> pieces;
        this->ForEachBlock(x, round % 3 == 0 ? 1 : 50, [&](const std::vector<T>& block) {
            const auto piece = stream.Next(block);
            pieces.insert(pieces.end(), piece.begin(), piece.end());
        });
        ASSERT_THAT(pieces, AllNear(whole, 0.0, 1e-11)) << "ratio " << ratio << ", start " << start;
    }
}

// The kernel falls on its own points: with a table that is 1 in the middle and 0 at whole samples, outputs are samples.
TYPED_TEST(ResampleTest, ARatioOfOneReadsTheKernelOnItsGrid) {
    using T = TypeParam;
    const std::vector<double> triangle{0, 0.25, 0.5, 0.25, 0};
    const ResampleKernel kernel{triangle.data(), 5, 2, false};
    const KernelPhase phase = ResamplePhase(kernel, 1.0, 0.0);
    EXPECT_EQ(phase.delta, 2);
    EXPECT_EQ(phase.left, 2);
    EXPECT_EQ(phase.right, 1);
    EXPECT_EQ(phase.first, 0);
    const auto x = this->random_.template Samples<T>(9);
    auto expected = x;
    expected.pop_back();
    EXPECT_THAT(Stream<T>(kernel, 1.0, 0.0).Next(x), AllNear(expected, 0.0, 0.0));
}

TYPED_TEST(ResampleTest, TheKernelIsStretchedOnlyAboveOneAndOnlyIfAsked) {
    using T = TypeParam;
    const auto x = this->random_.template Samples<T>(60);
    const auto stretched = Stream<T>(Kernel(), 2.0, 5.0).Next(x);
    const auto plain = Stream<T>(Kernel(), 2.0, 5.0, false).Next(x);
    const auto dense = Stream<T>(Kernel(), 0.5, 5.0).Next(x);
    EXPECT_THAT(Stream<T>(Kernel(), 0.5, 5.0, false).Next(x), SameBitsAs(dense));
    ASSERT_GE(plain.size(), stretched.size());
    for (size_t k = 0; 4 * k < dense.size() && k < plain.size(); ++k)
        EXPECT_THAT(plain[k], Near(dense[4 * k], 0.0, 1e-14));
    EXPECT_FALSE(IsNear(stretched[3], plain[3], 0.0, 1e-6));
}

TEST(ResamplePhase, CountsSamplesUnderTheKernel) {
    const std::vector<double> table(33);
    const ResampleKernel kernel{table.data(), 33, 8, false};
    const auto expect = [&](double ratio, double frac, int32_t left, int32_t right, double delta) {
        const KernelPhase phase = ResamplePhase(kernel, ratio, frac);
        EXPECT_EQ(phase.left, left);
        EXPECT_EQ(phase.right, right);
        EXPECT_EQ(phase.delta, delta);
        EXPECT_DOUBLE_EQ(phase.first, 16 - frac * delta - (left - 1) * delta);
        EXPECT_GE(phase.first, 0);
        EXPECT_LE(phase.first + (left + right - 1) * delta, 32);
    };
    expect(1.0, 0.0, 3, 2, 8);
    expect(1.0, 0.5, 2, 2, 8);
    expect(0.25, 0.5, 2, 2, 8);
    expect(2.0, 0.0, 5, 4, 4);
    expect(2.0, 0.25, 4, 4, 4);
    const KernelPhase nothing = ResamplePhase({table.data(), 1, 1, false}, kInfinity, 0.0);
    EXPECT_EQ(nothing.left, 0);
    EXPECT_EQ(nothing.right, 0);
}

// The point behind the last must not be looked at, not even times 0.
TEST(Resample, TheLastPointOfTheKernelHasNoneBehindIt) {
    std::vector<double> table{0.5, 1, 0.5, kQuietNaN};
    for (const bool nearest : {false, true}) {
        Stream<double> stream({table.data(), 3, 1, nearest}, 1.0, 0.0);
        EXPECT_THAT(stream.Next({2, 4, 8, 16}), ElementsAre(4, 9, 18));
    }
}

// The first output stands before all samples, the next at the ratio less one. So there is one more than room is made
// for.
TEST(Resample, ANegativeStartIsTakenOnceAndThenForgotten) {
    const double one = 1.0;
    std::vector<double> y;
    Stream<double> stream({&one, 1, 1, false}, 2.0, -2.0, false);
    EXPECT_EQ(stream.TryNext({1, 2, 3, 4, 5, 6}, 4, &y), kOk);
    EXPECT_THAT(y, ElementsAre(0, 2, 4, 6));
    EXPECT_EQ(stream.state().index, 1);
    EXPECT_EQ(Stream<double>({&one, 1, 1, false}, 2.0, -2.0, false).TryNext({1, 2, 3, 4, 5, 6}, 3, &y), kOutputFull);
}

TEST(Resample, FailsWhenAnOutputHasNoRoom) {
    const double one = 1.0;
    std::vector<double> y;
    Stream<double> exact({&one, 1, 1, false}, 1.0, 0.0);
    EXPECT_EQ(exact.TryNext({1, 2, 3}, 3, &y), kOk);
    EXPECT_THAT(y, ElementsAre(1, 2, 3));
    Stream<double> short_of_one({&one, 1, 1, false}, 1.0, 0.0);
    EXPECT_EQ(short_of_one.TryNext({1, 2, 3}, 2, &y), kOutputFull);
    EXPECT_THAT(y, ElementsAre(1, 2));
}

TEST(Resample, RefusesBuffersThatAreTooSmall) {
    std::vector<double> y;
    Stream<double> few_taps(Kernel(), 1.0, 0.0);
    few_taps.taps().resize(5);
    EXPECT_EQ(few_taps.TryNext({1, 2, 3}, 3, &y), kTooManyTaps);
    Stream<double> no_history(Kernel(), 1.0, 0.0);
    no_history.history().resize(2);
    EXPECT_EQ(no_history.TryNext({1, 2, 3}, 3, &y), kHistoryTooSmall);
    Stream<double> lying(Kernel(), 1.0, 0.0);
    lying.state().history_count = 1000;
    EXPECT_EQ(lying.TryNext({1, 2, 3}, 3, &y), kHistoryTooSmall);
    lying.state().history_count = -1;
    EXPECT_EQ(lying.TryNext({1, 2, 3}, 3, &y), kNegativeState);
}

TEST(Resample, RefusesPositionsThatAreNoIntegers) {
    std::vector<double> y;
    Stream<double> far({Reference().Reals("kernel.points").data(), 1, 1, false}, 1e12, 0.0, false);
    EXPECT_EQ(far.TryNext({1, 2, 3}, 3, &y), kBadSelector);
    Stream<double> lost(Kernel(), 1.0, 0.0);
    lost.state().frac = kQuietNaN;
    lost.state().index = -5;
    EXPECT_EQ(lost.TryNext({1, 2, 3}, 3, &y), kBadSelector);
}

TEST(CheckResampling, AsksForARatioAnOversamplingAndAKernel) {
    const double table = 1;
    for (const double ratio : {0.0, -1.0, kQuietNaN})
        EXPECT_EQ(CheckResampling({&table, 0, 1, false}, ratio), kNotPositive);
    EXPECT_EQ(CheckResampling({&table, 0, 0, false}, 1.0), kNotPositive);
    EXPECT_EQ(CheckResampling({&table, 0, 1, false}, 1.0), kEmptyInput);
    EXPECT_EQ(CheckResampling({&table, 1, 1, false}, 1.0), kOk);
}

// Whatever a caller puts into a state, nothing outside the buffers is touched.
TEST(Resample, IsSafeWithStatesThatNoBlockLeft) {
    RandomSignals random;
    constexpr int32_t kNumbers[] = {0, 1, 7, 2147483647, -1, -7, -2147483647 - 1};
    constexpr double kFractions[] = {0, 0.5, -3.7, 5.1, 1e300, -1e300, kInfinity, kQuietNaN};
    for (const int32_t index : kNumbers) {
        for (const double frac : kFractions) {
            for (const double ratio : {0.3, 1.0, 4.0, 1e9, 1e300}) {
                for (const int32_t n : {0, 1, 13}) {
                    Stream<double> stream(Kernel(), std::min(ratio, 4.0), 0.0);
                    stream.state().ratio = ratio;
                    stream.state().index = index;
                    stream.state().frac = frac;
                    stream.state().history_count = 3;
                    std::vector<double> y;
                    EXPECT_LE(stream.TryNext(random.Samples<double>(n), 60, &y), kOk);
                }
            }
        }
    }
}

// ---- At given positions -------------------------------------------------------------------------------------------

template <class T>
struct Outputs {
    std::vector<T> y;
    std::vector<double> left;  // times that were not reached
    VariableProgress progress;
};

template <class T>
Outputs<T> At(const std::vector<T>& x, std::vector<double> times, bool adaptive, double last_time) {
    std::vector<T> y(times.size());
    VariableProgress progress{last_time, -1, -1};
    EXPECT_EQ(ResampleVariable(x.data(), Size(x), times.data(), Size(times), Kernel(), adaptive, y.data(), &progress),
              kOk);
    y.resize(Count(progress.outputs));
    times.erase(times.begin(), times.begin() + progress.outputs);
    return {y, times, progress};
}

TYPED_TEST(ResampleTest, EqualStepsGiveWhatAConstantRatioGives) {
    using T = TypeParam;
    const auto x = this->random_.template Samples<T>(80);
    for (const double ratio : {0.4, 1.0, 2.3}) {
        std::vector<double> times;
        for (double t = 0.25; t < 100; t += ratio) times.push_back(t);
        const auto outputs = At(x, times, true, 0.25 - ratio);
        EXPECT_THAT(outputs.y, AllNear(Stream<T>(Kernel(), ratio, 0.25).Next(x), 0.0, 1e-12));
        const auto fixed = At(x, times, false, 0.0);
        EXPECT_THAT(fixed.y, AllNear(Stream<T>(Kernel(), ratio, 0.25, false).Next(x), 0.0, 1e-12));
    }
}

// The caller takes the consumed samples off the front, and adds new samples and new times behind.
TYPED_TEST(ResampleTest, BlocksOfTimesGiveWhatTheWholeGives) {
    using T = TypeParam;
    for (int round = 0; round < 100; ++round) {
        const bool adaptive = round % 2 == 0;
        const auto x = this->random_.template Samples<T>(150);
        std::vector<double> times;
        // Steps that grow would ask for samples that were consumed under a narrower kernel.
        double step = 3.0;
        for (double t = this->random_.Between(0, 3); t < 140; t += step) {
            times.push_back(t);
            step = adaptive ? step * this->random_.Between(0.97, 1.0) : this->random_.Between(0.05, 3);
        }
        const double before = times[0] - 3.0;
        const auto whole = At(x, times, adaptive, before);
        std::vector<T> pieces, buffer;
        std::vector<double> waiting = times;
        double last_time = before;
        this->ForEachBlock(x, 40, [&](const std::vector<T>& block) {
            buffer.insert(buffer.end(), block.begin(), block.end());
            const auto outputs = At(buffer, waiting, adaptive, last_time);
            pieces.insert(pieces.end(), outputs.y.begin(), outputs.y.end());
            waiting = outputs.left;
            last_time = outputs.progress.last_time;
            buffer.erase(buffer.begin(), buffer.begin() + std::min(Size(buffer), outputs.progress.consumed));
        });
        ASSERT_THAT(pieces, AllNear(whole.y, 0.0, 1e-11));
        EXPECT_THAT(last_time + 150 - Size(buffer), Near(whole.progress.last_time + whole.progress.consumed, 1e-12));
    }
}

TEST(ResampleVariable, TellsWhatItConsumedAndWhatIsLeft) {
    const std::vector<double> x(30, 1.0);
    const auto outputs = At(x, {10.5, 20.25, 26.75, 29.0}, false, 0.0);
    EXPECT_EQ(outputs.progress.outputs, 2);  // the kernel spans 4 samples to both sides
    EXPECT_EQ(outputs.progress.consumed, 26 - 4 + 1);
    EXPECT_EQ(outputs.progress.last_time, 20.25 - 23);
    EXPECT_THAT(outputs.left, ElementsAre(3.75, 6.0));
    const auto early = At(x, {0.5, 1.5}, false, 0.0);
    EXPECT_EQ(early.progress.consumed, 0);
    EXPECT_EQ(early.progress.outputs, 2);
    EXPECT_EQ(early.progress.last_time, 1.5);
}

TEST(ResampleVariable, NoTimesAskForNothing) {
    VariableProgress progress{3.5, 7, 7};
    EXPECT_EQ(ResampleVariable<double>(nullptr, 0, nullptr, 0, {nullptr, 0, 0, false}, true, nullptr, &progress), kOk);
    EXPECT_EQ(progress.outputs, 0);
    EXPECT_EQ(progress.consumed, 0);
    EXPECT_EQ(progress.last_time, 3.5);
}

TEST(ResampleVariable, RefusesPositionsThatAreNoIntegers) {
    const std::vector<double> x(3);
    for (const double time : {3e9, -3e9, kInfinity, kQuietNaN}) {
        std::vector<double> times{time};
        double y = 0;
        VariableProgress progress{0, 0, 0};
        EXPECT_EQ(ResampleVariable(x.data(), 3, times.data(), 1, Kernel(), false, &y, &progress), kBadSelector);
        EXPECT_EQ(ResampleVariable(x.data(), 3, times.data(), 1, {nullptr, 0, 1, false}, false, &y, &progress),
                  kEmptyInput);
        EXPECT_EQ(ResampleVariable(x.data(), 3, times.data(), 1, {nullptr, 0, 0, false}, false, &y, &progress),
                  kNotPositive);
    }
}

}  // namespace
}  // namespace krnumer

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cmath>
#include <limits>

#include "filter/draw.h"
#include "filter/median_filter.h"
#include "filter/savitzky_golay.h"
#include "filter/zero_phase.h"
#include "frame/numeric.h"
#include "frame/status.h"
#include "krnumer/filter.h"
#include "stat/order.h"
#include "support/host_arrays.h"

namespace krnumer {
namespace {

using testing::ElementsAre;

struct MedianReference {
    int32_t rank;
    std::vector<double> x, y;
};
struct SavitzkyGolayReference {
    int32_t order, frame;
    std::vector<double> weights, differentiators, smoothing, x, y;
};
struct ZeroPhaseReference {
    std::vector<double> a, b, x, y;
};

#include "reference/filter/smoothing.inc"

constexpr int32_t kMost = std::numeric_limits<int32_t>::max();

// ---- Median ---------------------------------------------------------------------------------------------------------

// Every window sorted anew.
std::vector<double> MediansOneByOne(const std::vector<double>& x, int32_t left, int32_t right) {
    std::vector<double> medians;
    const auto n = static_cast<int32_t>(x.size());
    for (int32_t i = 0; i < n; ++i) {
        std::vector<double> window;
        for (int32_t k = i - left; k <= i + right; ++k)
            window.push_back(k >= 0 && k < n ? x[static_cast<std::size_t>(k)] : 0.0);
        SortDoubles(window.data(), static_cast<int32_t>(window.size()), 0, nullptr);
        const std::size_t half = window.size() / 2;
        medians.push_back(window.size() % 2 != 0 ? window[half] : (window[half - 1] + window[half]) / 2.0);
    }
    return medians;
}

TEST(MedianFilter, AgreesWithTheReference) {
    for (const auto& [rank, x, y] : kMedians) {
        HostArray<double> signal(x);
        int32_t err = 77;
        EXPECT_EQ(MedianFilterCIN(signal.handle(), &rank, &err), 0);
        EXPECT_EQ(err, kOk);
        EXPECT_EQ(signal.values(), y);
    }
}

TEST(MedianFilter, SortsEveryWindow) {
    std::mt19937 random(1);
    for (int32_t round = 0; round < 600; ++round) {
        const std::size_t n = 1 + random() % 60;
        auto x = DrawArray<double>(n, random);
        // In every second round values repeat, and in every fourth some are none.
        if (round % 2 != 0)
            for (double& sample : x) sample = std::round(2.0 * sample);
        if (round % 4 == 1)
            for (double& sample : x)
                if (random() % 5 == 0) sample = random() % 2 != 0 ? kQuietNaN : kInfinity;
        const auto left = static_cast<int32_t>(random() % 80), right = static_cast<int32_t>(random() % n);
        auto y = x;
        ASSERT_EQ(MedianFilter(y.data(), static_cast<int32_t>(n), left, right), kOk);
        const auto expected = MediansOneByOne(x, left, right);
        for (std::size_t i = 0; i < n; ++i)
            ASSERT_TRUE(IsNear(y[i], expected[i], 0.0)) << i << ": " << y[i] << " instead of " << expected[i];
    }
}

TEST(MedianFilter, SeesZerosOutside) {
    HostArray<double> x{5.0, 5.0, 5.0};
    EXPECT_EQ(MedianFilter81_H(x.handle(), 1, 1), kOk);
    EXPECT_THAT(x.values(), ElementsAre(5.0, 5.0, 5.0));
    EXPECT_EQ(MedianFilter81_H(x.handle(), 2, 2), kOk);
    EXPECT_THAT(x.values(), ElementsAre(5.0, 5.0, 5.0));
    EXPECT_EQ(MedianFilter81_H(x.handle(), 9, 0), kOk);  // more on the left than there are samples
    EXPECT_THAT(x.values(), ElementsAre(0.0, 0.0, 0.0));
}

TEST(MedianFilter, NeedsNoMemoryForZerosThatAreTheMajority) {
    HostArray<double> x{3.0, -1.0, kInfinity};
    EXPECT_EQ(MedianFilter81_H(x.handle(), kMost - 1, 0), kOk);
    EXPECT_THAT(x.values(), ElementsAre(0.0, 0.0, 0.0));
    for (int32_t left = 0; left < 12; ++left) {
        for (int32_t right = 0; right < 4; ++right) {
            std::vector<double> samples{3.0, 1.0, 2.0, 5.0};
            const auto expected = MediansOneByOne(samples, left, right);
            ASSERT_EQ(MedianFilter(samples.data(), 4, left, right), kOk);
            EXPECT_EQ(samples, expected) << left << " " << right;
        }
    }
}

TEST(MedianFilter, TakesTheMeanInAnEvenWindow) {
    HostArray<double> x{1.0, 5.0, 3.0};
    EXPECT_EQ(MedianFilter81_H(x.handle(), 1, 0), kOk);
    EXPECT_THAT(x.values(), ElementsAre(0.5, 3.0, 4.0));
}

TEST(MedianFilter, TakesTheLeftSideForANegativeRightOne) {
    for (const int32_t right : {-1, -1000, std::numeric_limits<int32_t>::min()}) {
        HostArray<double> x{1.0, 5.0, 3.0, 9.0};
        EXPECT_EQ(MedianFilter81_H(x.handle(), 1, right), kOk);
        EXPECT_THAT(x.values(), ElementsAre(1.0, 3.0, 5.0, 3.0));
    }
    HostArray<double> x{1.0, 5.0};
    EXPECT_EQ(MedianFilter81_H(x.handle(), 2, -1), kBadDimension);
}

TEST(MedianFilter, LeavesTheSignalWithoutAWindow) {
    HostArray<double> x{1.0, kQuietNaN, 3.0}, none;
    const int32_t rank = 0;
    int32_t err = 77;
    EXPECT_EQ(MedianFilterCIN(x.handle(), &rank, &err), 0);
    EXPECT_EQ(err, kOk);
    EXPECT_THAT(x.values(), SameBitsAs(std::vector<double>{1.0, kQuietNaN, 3.0}));
    for (const int32_t any : {0, 5, kMost}) {
        err = 77;
        EXPECT_EQ(MedianFilterCIN(none.handle(), &any, &err), 0);
        EXPECT_EQ(err, kOk);
        EXPECT_EQ(MedianFilter81_H(none.handle(), any, any), kOk);
    }
}

TEST(MedianFilter, RefusesInAFixedOrder) {
    const auto status = [](const std::vector<double>& samples, int32_t left, int32_t right) {
        HostArray<double> x(samples);
        const int32_t result = MedianFilter81_H(x.handle(), left, right);
        EXPECT_TRUE(x.empty());
        if (left == right) {
            HostArray<double> other(samples);
            int32_t err = 77;
            EXPECT_EQ(MedianFilterCIN(other.handle(), &left, &err), 0);
            EXPECT_EQ(err, result);
            EXPECT_TRUE(other.empty());
        }
        return result;
    };
    EXPECT_EQ(status({}, -1, -1), kBadRank);
    EXPECT_EQ(status({1.0}, -1, 5), kBadRank);
    EXPECT_EQ(status({1.0}, 1, 1), kBadDimension);
    EXPECT_EQ(status({1.0, 2.0}, 0, 2), kBadDimension);
    EXPECT_EQ(status({1.0, 2.0}, kMost, kMost), kBadDimension);
    EXPECT_EQ(status({1.0, 2.0}, kMost, 0), kOutOfMemory);
    EXPECT_EQ(status({1.0, 2.0}, kMost - 1, 1), kOutOfMemory);
}

// ---- Savitzky-Golay -------------------------------------------------------------------------------------------------

struct Matrices {
    HostMatrix<double> smoothing{1, 2, {9.0, 9.0}}, differentiators{2, 1, {8.0, 8.0}};

    int32_t Make(int32_t order, int32_t frame, const std::vector<double>& weights = {}, int32_t wanted = 1) {
        const HostArray<double> w(weights);
        return SavitzkyGolayCoefH(order, frame, w.handle(), wanted, smoothing.handle(), differentiators.handle());
    }
    int32_t Refusal(int32_t order, int32_t frame, const std::vector<double>& weights = {}, int32_t wanted = 1) {
        const int32_t status = Make(order, frame, weights, wanted);
        EXPECT_TRUE(smoothing.empty() && differentiators.empty());
        return status;
    }
};

TEST(SavitzkyGolayCoef, AgreesWithTheReference) {
    for (const SavitzkyGolayReference& reference : kSavitzkyGolay) {
        Matrices made;
        EXPECT_EQ(made.Make(reference.order, reference.frame, reference.weights), kOk);
        EXPECT_EQ(made.smoothing.rows(), reference.frame);
        EXPECT_EQ(made.smoothing.columns(), reference.frame);
        EXPECT_EQ(made.differentiators.rows(), reference.order + 1);
        EXPECT_EQ(made.differentiators.columns(), reference.frame);
        EXPECT_THAT(made.smoothing.values(), AllNear(reference.smoothing, 0.0, 1e-12));
        EXPECT_THAT(made.differentiators.values(), AllNear(reference.differentiators, 0.0, 1e-12));
    }
}

// The published weights of the quadratic in five points.
TEST(SavitzkyGolayCoef, AgreesWithThePaper) {
    Matrices made;
    made.Make(2, 5);
    for (int32_t j = 0; j < 5; ++j) {
        const double smoothing[] = {-3, 12, 17, 12, -3}, slope[] = {-2, -1, 0, 1, 2}, bend[] = {2, -1, -2, -1, 2};
        EXPECT_NEAR(made.smoothing(2, j), smoothing[j] / 35, 1e-15);
        EXPECT_NEAR(made.differentiators(0, j), smoothing[j] / 35, 1e-15);
        EXPECT_NEAR(made.differentiators(1, j), slope[j] / 10, 1e-15);
        EXPECT_NEAR(made.differentiators(2, j), bend[j] / 14, 1e-15);  // half of the second derivative
    }
}

TEST(SavitzkyGolayCoef, LeavesDifferentiatorsThatAreNotWanted) {
    Matrices made;
    EXPECT_EQ(made.Make(2, 5, {}, 0), kOk);
    EXPECT_EQ(made.smoothing.rows(), 5);
    EXPECT_THAT(made.differentiators.values(), ElementsAre(8.0, 8.0));
    EXPECT_EQ(made.Make(2, 5, {}, -1), kOk);
    EXPECT_EQ(made.differentiators.rows(), 3);
}

TEST(SavitzkyGolayCoef, CountsOnlyTheMagnitudeOfWeights) {
    Matrices made, other;
    made.Make(2, 5, {1.0, 2.0, 3.0, 4.0, 5.0});
    other.Make(2, 5, {-1.0, 2.0, -3.0, -4.0, 5.0});
    EXPECT_THAT(other.smoothing.values(), SameBitsAs(made.smoothing.values()));
}

// A projection keeps what it has projected, and a polynomial of the order. Powers of up to 12 cost the normal equations
// some six digits.
TEST(SavitzkyGolayCoef, ProjectsAtHighOrders) {
    for (const auto& [order, frame] : {std::pair{8, 51}, {10, 101}, {12, 41}, {5, 301}}) {
        Matrices made;
        ASSERT_EQ(made.Make(order, frame), kOk) << order << ' ' << frame;
        const auto size = static_cast<std::size_t>(frame);
        const std::vector<double> s = made.smoothing.values();
        for (std::size_t i = 0; i < size; ++i) {
            double sum_of_power = 0.0;
            const auto t = [middle = frame / 2](std::size_t j) {
                return (static_cast<double>(j) - middle) / (middle + 0.5);
            };
            for (std::size_t j = 0; j < size; ++j) sum_of_power += s[i * size + j] * std::pow(t(j), order);
            EXPECT_NEAR(sum_of_power, std::pow(t(i), order), 1e-9);
            for (std::size_t j = 0; j < size; ++j) {
                double square = 0.0;
                for (std::size_t k = 0; k < size; ++k) square += s[i * size + k] * s[k * size + j];
                ASSERT_NEAR(square, s[i * size + j], 1e-9);
            }
        }
    }
}

TEST(SavitzkyGolayCoef, RefusesInAFixedOrder) {
    Matrices made;
    EXPECT_EQ(made.Refusal(0, 0, {1.0}), kBadCoefficient);
    EXPECT_EQ(made.Refusal(-1, -3, {1.0}), kBadCoefficient);
    EXPECT_EQ(made.Refusal(4, 4, {1.0}), kUnderdetermined);
    EXPECT_EQ(made.Refusal(4, -1, {1.0}), kUnderdetermined);
    EXPECT_EQ(made.Refusal(2, 4, {1.0}), kSizesDiffer);
    EXPECT_EQ(made.Refusal(2, 4), kEvenLength);
    EXPECT_EQ(made.Refusal(2, 4, {}, 0), kEvenLength);
    EXPECT_EQ(made.Refusal(1, 3, {1.0, 0.0, 0.0}), kNotPositiveDefinite);
    EXPECT_EQ(made.Refusal(1, 3, {0.0, 0.0, 0.0}), kNotPositiveDefinite);
    EXPECT_EQ(made.Refusal(2, 5, {1.0, 0.0, 0.0, 0.0, 1.0}), kNotPositiveDefinite);
    EXPECT_EQ(made.Refusal(1, 3, {1.0, kQuietNaN, 1.0}), kNotFinite);
    EXPECT_EQ(made.Refusal(1, kMost), kOutOfMemory);
    for (const int32_t nth : {1, 2}) {
        const FailResize failure(nth, 4711);
        EXPECT_EQ(made.Refusal(2, 5), kOutOfMemory);
    }
}

TEST(SavitzkyGolayCoef, ChecksDirectCallsToo) {
    double matrix[9];
    EXPECT_EQ(SavitzkyGolayMatrices(0, 3, nullptr, matrix, nullptr), kBadCoefficient);
    EXPECT_EQ(SavitzkyGolayMatrices(3, 3, nullptr, matrix, nullptr), kUnderdetermined);
    EXPECT_EQ(SavitzkyGolayFilter(matrix, 3, 0, 3, nullptr, matrix), kBadCoefficient);
    EXPECT_EQ(SavitzkyGolayFilter(matrix, 3, 3, 3, nullptr, matrix), kUnderdetermined);
}

struct Smoothing {
    HostArray<double> y{9.0, 9.0};

    int32_t Make(const std::vector<double>& samples, int32_t order, int32_t frame,
                 const std::vector<double>& weights = {}) {
        const HostArray<double> x(samples), w(weights);
        const int32_t status = SavitzkyGolayFiltH(x.handle(), order, frame, w.handle(), y.handle());
        EXPECT_THAT(x.values(), SameBitsAs(samples));
        return status;
    }
    int32_t Refusal(const std::vector<double>& samples, int32_t order, int32_t frame,
                    const std::vector<double>& weights = {}) {
        const int32_t status = Make(samples, order, frame, weights);
        EXPECT_TRUE(y.empty());
        return status;
    }
};

TEST(SavitzkyGolayFilter, AgreesWithTheReference) {
    for (const SavitzkyGolayReference& reference : kSavitzkyGolay) {
        Smoothing smoothing;
        EXPECT_EQ(smoothing.Make(reference.x, reference.order, reference.frame, reference.weights), kOk);
        EXPECT_THAT(smoothing.y.values(), AllNear(reference.y, 0.0, 1e-11));
    }
}

TEST(SavitzkyGolayFilter, LeavesPolynomialsToTheEnds) {
    for (const auto& [order, frame] : {std::pair{1, 3}, {2, 5}, {3, 5}, {3, 21}, {5, 31}}) {
        for (const int32_t n : {frame, frame + 1, 200}) {
            std::vector<double> x;
            for (int32_t i = 0; i < n; ++i) x.push_back(std::pow(i / 50.0 - 1.0, order) + 0.5 * i);
            Smoothing smoothing;
            EXPECT_EQ(smoothing.Make(x, order, frame), kOk);
            EXPECT_THAT(smoothing.y.values(), AllNear(x, 1e-10, 1e-10));
            const std::vector<double> weights(static_cast<std::size_t>(frame), -2.5);
            smoothing.Make(x, order, frame, weights);
            EXPECT_THAT(smoothing.y.values(), AllNear(x, 1e-10, 1e-10));
        }
    }
}

TEST(SavitzkyGolayFilter, MayReplaceItsInput) {
    const auto& reference = kSavitzkyGolay[1];
    HostArray<double> x(reference.x);
    const HostArray<double> weights;
    EXPECT_EQ(SavitzkyGolayFiltH(x.handle(), reference.order, reference.frame, weights.handle(), x.handle()), kOk);
    EXPECT_THAT(x.values(), AllNear(reference.y, 0.0, 1e-11));
}

TEST(SavitzkyGolayFilter, RefusesInAFixedOrder) {
    Smoothing smoothing;
    const std::vector<double> four{1.0, 2.0, 3.0, 4.0}, none;
    EXPECT_EQ(smoothing.Refusal(none, 0, 0, {1.0}), kBadCoefficient);
    EXPECT_EQ(smoothing.Refusal(none, 2, 2, {1.0}), kUnderdetermined);
    EXPECT_EQ(smoothing.Refusal(none, 2, 6, {1.0}), kSizesDiffer);
    EXPECT_EQ(smoothing.Refusal(none, 2, 6), kBadDimension);
    EXPECT_EQ(smoothing.Refusal(four, 2, 6), kBadDimension);  // too short comes before even
    EXPECT_EQ(smoothing.Refusal(four, 2, 4), kEvenLength);
    EXPECT_EQ(smoothing.Refusal(four, 1, 3, {1.0, 0.0, 0.0}), kNotPositiveDefinite);
    HostArray<double> malformed;
    malformed.SetDimension(0, -1);
    const HostArray<double> weights;
    EXPECT_EQ(SavitzkyGolayFiltH(malformed.handle(), 2, 5, weights.handle(), smoothing.y.handle()), kBadDimension);
    malformed.SetDimension(0, 0);
    const FailResize failure(1, 4711);
    EXPECT_EQ(smoothing.Refusal(four, 1, 3), kOutOfMemory);
}

// ---- Zero phase -----------------------------------------------------------------------------------------------------

class ZeroPhase : public testing::Test {
  protected:
    int32_t Call(HostArray<double>& x, const std::vector<double>& a, const std::vector<double>& b, int32_t keep = 0) {
        const HostArray<double> feedback(a), feedforward(b);
        return zeroPhaseFiltH(x.handle(), feedback.handle(), feedforward.handle(), forward1_.handle(),
                              forward2_.handle(), reverse1_.handle(), reverse2_.handle(), keep);
    }
    bool AllEmpty() const { return forward1_.empty() && forward2_.empty() && reverse1_.empty() && reverse2_.empty(); }
    bool Untouched() const {
        return forward1_.values() == kState && forward2_.values() == kState && reverse1_.values() == kState &&
               reverse2_.values() == kState;
    }

    const std::vector<double> kState{5.0};
    LeakCheck leaks_;
    HostArray<double> forward1_{5.0}, forward2_{5.0}, reverse1_{5.0}, reverse2_{5.0};
};

TEST_F(ZeroPhase, AgreesWithTheReference) {
    for (const auto& [a, b, x, y] : kZeroPhase) {
        HostArray<double> signal(x);
        EXPECT_EQ(Call(signal, a, b), kOk);
        EXPECT_THAT(signal.values(), AllNear(y, 0.0, 1e-13));
        EXPECT_EQ(forward1_.size(), static_cast<int32_t>(b.size()) - 1);
        EXPECT_EQ(forward2_.size(), static_cast<int32_t>(b.size()) - 1);
        EXPECT_EQ(reverse2_.size(), a.empty() ? 1 : static_cast<int32_t>(a.size()) - 1);
        reverse2_ = HostArray<double>{5.0};
    }
}

TEST_F(ZeroPhase, LeavesASymmetricSignalSymmetric) {
    HostArray<double> x(401);
    x.Set(200, 1.0);
    EXPECT_EQ(Call(x, {1.0, -0.9}, {0.1}), kOk);
    for (int32_t i = 1; i < 100; ++i) EXPECT_THAT(x[200 + i], Near(x[200 - i], 1e-12, 1e-12));
    EXPECT_GT(x[200], x[201]);
}

TEST_F(ZeroPhase, LeavesTheSignalWithOneCoefficient) {
    for (const int32_t keep : {0, 1}) {
        HostArray<double> x{1.0, 2.0, 3.0};
        EXPECT_EQ(Call(x, {}, {1.0}, keep), kOk);
        EXPECT_THAT(x.values(), ElementsAre(1.0, 2.0, 3.0));
    }
    EXPECT_EQ(reverse1_.values(), kState);  // not looked at
    EXPECT_EQ(reverse2_.values(), kState);
}

TEST_F(ZeroPhase, KeepsStatesThatFitWhenAskedTo) {
    // The states come into the zeros before the signal, so a delay of one sample does not reach it, but a feedback
    // does.
    HostArray<double> x{0.0, 0.0}, y{0.0, 0.0};
    EXPECT_EQ(Call(x, {1.0, -1.0}, {0.0, 1.0}, 0), kOk);
    EXPECT_THAT(x.values(), ElementsAre(0.0, 0.0));
    forward1_ = HostArray<double>{3.0};
    forward2_ = HostArray<double>{7.0, 7.0};  // does not fit, and counts as cleared; the others are kept
    reverse1_ = HostArray<double>{5.0};
    reverse2_ = HostArray<double>{0.0};
    EXPECT_EQ(Call(y, {1.0, -1.0}, {0.0, 1.0}, 1), kOk);
    // Forward: 8 all along; backward: its running sum over two zeros of padding and the signal.
    EXPECT_THAT(y.values(), ElementsAre(24.0, 16.0));
}

TEST_F(ZeroPhase, DoesNothingWithoutCoefficients) {
    HostArray<double> x{1.0, 2.0};
    ResizeLog log;
    EXPECT_EQ(Call(x, {}, {}), kOk);
    EXPECT_EQ(log.size(), 0);
    EXPECT_THAT(x.values(), ElementsAre(1.0, 2.0));
    EXPECT_TRUE(Untouched());
}

TEST_F(ZeroPhase, RefusesAnEmptySignalAndTouchesNothing) {
    HostArray<double> x;
    for (const std::vector<double>& b : {std::vector<double>{}, {1.0}}) {
        ResizeLog log;
        EXPECT_EQ(Call(x, {1.0}, b), kEmptyInput);
        EXPECT_EQ(log.size(), 0);
        EXPECT_TRUE(Untouched());
    }
}

TEST_F(ZeroPhase, RefusesFeedbackAloneAndKeepsTheSignal) {
    HostArray<double> x{1.0, 2.0};
    EXPECT_EQ(Call(x, {1.0}, {}), kBadDimension);
    EXPECT_TRUE(AllEmpty());
    EXPECT_THAT(x.values(), ElementsAre(1.0, 2.0));
}

TEST_F(ZeroPhase, ReportsTheHostsRefusalAndKeepsTheSignal) {
    for (const int32_t nth : {1, 2, 3, 4}) {
        HostArray<double> x{1.0, 2.0};
        for (HostArray<double>* state : {&forward1_, &forward2_, &reverse1_, &reverse2_})
            *state = HostArray<double>{5.0};
        const FailResize failure(nth, 4711);
        EXPECT_EQ(Call(x, {1.0, 0.5, 0.5}, {1.0, 1.0, 1.0}), kOutOfMemory);
        EXPECT_TRUE(AllEmpty());
        EXPECT_THAT(x.values(), ElementsAre(1.0, 2.0));
    }
}

TEST_F(ZeroPhase, TellsDirectCallsOfMissingSamples) {
    const ZeroPhaseFilter filter{};
    EXPECT_EQ(FilterBothWays(filter, nullptr, 0), kEmptyInput);
    double x = 1.0;
    EXPECT_EQ(FilterBothWays(filter, &x, 1), kEmptyInput);  // no coefficient
}

}  // namespace
}  // namespace krnumer

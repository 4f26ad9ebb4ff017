#include "filter/direct_form.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "filter/draw.h"
#include "frame/numeric.h"
#include "frame/status.h"
#include "krnumer/filter.h"
#include "support/host_arrays.h"
#include "support/vector_units.h"

namespace krnumer {
namespace {

using testing::ElementsAre;

template <class Input, class Coefficient, class Output>
struct DirectFormReference {
    std::vector<Input> x;
    std::vector<Coefficient> a, b;
    std::vector<Output> y;
};

#include "reference/filter/direct_form.inc"

// Elements by the types of signal, coefficients and filtered signal.
struct Real {
    using Input = double;
    using Coefficient = double;
    using Output = double;
    static constexpr auto& kReferences = kReal;
    static constexpr auto kExport = IIR_Filter;
};
struct ComplexByReal {
    using Input = Complex;
    using Coefficient = double;
    using Output = Complex;
    static constexpr auto& kReferences = kComplexByReal;
    static constexpr auto kExport = CxSigIIR_Filter;
};
struct AllComplex {
    using Input = Complex;
    using Coefficient = Complex;
    using Output = Complex;
    static constexpr auto& kReferences = kComplex;
    static constexpr auto kExport = CxIIR_Filter_H;
};
struct RealByComplex {
    using Input = double;
    using Coefficient = Complex;
    using Output = Complex;
    static constexpr auto& kReferences = kRealByComplex;
};

template <class Types>
class DirectForm : public testing::Test {
  protected:
    using InputT = typename Types::Input;
    using CoefficientT = typename Types::Coefficient;
    using OutputT = typename Types::Output;

    struct States {
        std::vector<InputT> forward;
        std::vector<OutputT> reverse;
    };

    static States AtRest(std::size_t na, std::size_t nb) {
        return {std::vector<InputT>(nb - 1), std::vector<OutputT>(na > 0 ? na - 1 : 0)};
    }

    static std::vector<OutputT> Filter(const std::vector<InputT>& x, const std::vector<CoefficientT>& a,
                                       const std::vector<CoefficientT>& b, States* states) {
        std::vector<OutputT> y(x.size());
        EXPECT_EQ(DirectFormFilter(x.data(), static_cast<int32_t>(x.size()), a.empty() ? nullptr : a.data(),
                                   static_cast<int32_t>(a.size()), b.data(), static_cast<int32_t>(b.size()),
                                   states->forward.data(), states->reverse.data(), y.data()),
                  kOk);
        return y;
    }

    // The difference equation as it is written, one sample after the other.
    static std::vector<OutputT> FilterSimply(const std::vector<InputT>& x, const std::vector<CoefficientT>& a,
                                             const std::vector<CoefficientT>& b, States* states) {
        std::vector<InputT> inputs = states->forward;
        std::vector<OutputT> outputs = states->reverse;
        for (const InputT& sample : x) {
            inputs.push_back(sample);
            OutputT sum{};
            for (std::size_t k = b.size(); k-- > 0;) sum = sum + b[k] * inputs[inputs.size() - 1 - k];
            for (std::size_t k = a.size(); k-- > 1;) sum = sum - a[k] * outputs[outputs.size() - k];
            outputs.push_back(a.empty() ? sum : sum / a[0]);
        }
        const std::vector<OutputT> y(outputs.end() - static_cast<std::ptrdiff_t>(x.size()), outputs.end());
        states->forward.assign(inputs.end() - static_cast<std::ptrdiff_t>(states->forward.size()), inputs.end());
        states->reverse.assign(outputs.end() - static_cast<std::ptrdiff_t>(states->reverse.size()), outputs.end());
        return y;
    }

    std::mt19937 random_{7};
};
using AllForms = testing::Types<Real, ComplexByReal, AllComplex, RealByComplex>;
TYPED_TEST_SUITE(DirectForm, AllForms);

TYPED_TEST(DirectForm, FiltersAsTheReference) {
    for (const auto& [x, a, b, y] : TypeParam::kReferences) {
        auto states = this->AtRest(a.size(), b.size());
        EXPECT_THAT(this->Filter(x, a, b, &states), AllNear(y, 1e-13, 1e-12)) << a.size() << ' ' << b.size();
    }
}

// Whatever runs side by side, every sum has its own order.
TYPED_TEST(DirectForm, KeepsTheOrderOfItsSums) {
    using Coefficient = typename TypeParam::Coefficient;
    using Input = typename TypeParam::Input;
    using Output = typename TypeParam::Output;
    OnEveryVectorUnit([&] {
        for (const std::size_t na : {0, 1, 2, 7, 8, 9, 10, 32, 33, 34, 64, 65, 66, 140}) {
            for (const std::size_t nb : {1, 2, 9, 64, 65, 66, 150}) {
                for (const std::size_t n : {1, 7, 40, 64, 65, 200}) {
                    auto a = DrawArray<Coefficient>(na, this->random_);
                    for (std::size_t k = 1; k < na; ++k) a[k] = a[k] * (1.0 / static_cast<double>(na));
                    if (na > 0) a[0] = a[0] + FromReal<Coefficient>(2.0);
                    const auto b = DrawArray<Coefficient>(nb, this->random_);
                    const auto x = DrawArray<Input>(n, this->random_);
                    auto states = this->AtRest(na, nb);
                    states.forward = DrawArray<Input>(states.forward.size(), this->random_);
                    states.reverse = DrawArray<Output>(states.reverse.size(), this->random_);
                    auto expected_states = states;
                    const auto expected = this->FilterSimply(x, a, b, &expected_states);
                    ASSERT_THAT(this->Filter(x, a, b, &states), SameBitsAs(expected)) << na << ' ' << nb << ' ' << n;
                    ASSERT_THAT(states.forward, SameBitsAs(expected_states.forward)) << na << ' ' << nb << ' ' << n;
                    ASSERT_THAT(states.reverse, SameBitsAs(expected_states.reverse)) << na << ' ' << nb << ' ' << n;
                }
            }
        }
    });
}

TYPED_TEST(DirectForm, FiltersBlocksAsTheWhole) {
    using Coefficient = typename TypeParam::Coefficient;
    using Input = typename TypeParam::Input;
    using Output = typename TypeParam::Output;
    for (int32_t round = 0; round < 200; ++round) {
        const std::size_t na = this->random_() % 20, nb = 1 + this->random_() % 20;
        auto a = DrawArray<Coefficient>(na, this->random_);
        if (na > 0) a[0] = a[0] + FromReal<Coefficient>(static_cast<double>(na));
        const auto b = DrawArray<Coefficient>(nb, this->random_);
        const auto x = DrawArray<Input>(300, this->random_);
        auto states = this->AtRest(na, nb);
        const auto whole = this->Filter(x, a, b, &states);

        auto block_states = this->AtRest(na, nb);
        std::vector<Output> joined;
        while (joined.size() < x.size()) {
            const std::size_t length = std::min<std::size_t>(1 + this->random_() % 90, x.size() - joined.size());
            const auto from = x.begin() + static_cast<std::ptrdiff_t>(joined.size());
            const auto block = this->Filter({from, from + static_cast<std::ptrdiff_t>(length)}, a, b, &block_states);
            joined.insert(joined.end(), block.begin(), block.end());
        }
        ASSERT_THAT(joined, SameBitsAs(whole)) << na << ' ' << nb;
        ASSERT_THAT(block_states.forward, SameBitsAs(states.forward));
        ASSERT_THAT(block_states.reverse, SameBitsAs(states.reverse));
    }
}

TEST(DirectForm, NeedsASampleAndACoefficient) {
    double x = 1.0, y = 9.0;
    const double b = 2.0;
    EXPECT_EQ(DirectFormFilter(&x, 0, nullptr, 0, &b, 1, nullptr, nullptr, &y), kEmptyInput);
    EXPECT_EQ(DirectFormFilter(&x, 1, nullptr, 0, &b, 0, nullptr, nullptr, &y), kEmptyInput);
    EXPECT_EQ(y, 9.0);
    EXPECT_EQ(DirectFormFilter(&x, 1, &b, 0, &b, 1, nullptr, nullptr, &y), kOk);  // no feedback, no divisor
    EXPECT_EQ(y, 2.0);
}

TEST(DirectForm, DoesNotMixThePartsOfASignalFilteredByRealCoefficients) {
    HostArray<Complex> x{{kInfinity, 1.0}, {0.0, 2.0}, {3.0, kInfinity}}, forward, reverse;
    const HostArray<double> a{1.0, -0.5}, b{1.0, 0.0};
    const uint8_t init = 0;
    int32_t err = 77;
    EXPECT_EQ(CxSigIIR_Filter(x.handle(), a.handle(), b.handle(), forward.handle(), reverse.handle(), &init, &err), 0);
    EXPECT_EQ(x[0], (Complex{kInfinity, 1.0}));
    EXPECT_EQ(x[1].im, 2.5);
    EXPECT_EQ(x[2].im, kInfinity);
}

// The entry points that filter in place.
template <class Types>
class InPlace : public testing::Test {
  protected:
    using SignalT = typename Types::Input;
    using CoefficientT = typename Types::Coefficient;

    int32_t Call(HostArray<SignalT>& x, const HostArray<CoefficientT>& a, const HostArray<CoefficientT>& b,
                 uint8_t init = 0) {
        err_ = 77;
        return Types::kExport(x.handle(), a.handle(), b.handle(), forward_.handle(), reverse_.handle(), &init, &err_);
    }

    LeakCheck leaks_;
    HostArray<SignalT> forward_{RealValues<SignalT>({5.0, 6.0, 7.0})}, reverse_{RealValues<SignalT>({8.0})};
    int32_t err_ = 77;
};
using FormsInPlace = testing::Types<Real, ComplexByReal, AllComplex>;
TYPED_TEST_SUITE(InPlace, FormsInPlace);

TYPED_TEST(InPlace, FiltersAsTheReference) {
    using Signal = typename TypeParam::Input;
    using Coefficient = typename TypeParam::Coefficient;
    for (const auto& [x, a, b, y] : TypeParam::kReferences) {
        HostArray<Signal> signal(x);
        EXPECT_EQ(this->Call(signal, HostArray<Coefficient>(a), HostArray<Coefficient>(b)), 0);
        EXPECT_EQ(this->err_, kOk);
        EXPECT_THAT(signal.values(), AllNear(y, 1e-13, 1e-12));
    }
}

TYPED_TEST(InPlace, GoesOnFromItsStates) {
    using Signal = typename TypeParam::Input;
    using Coefficient = typename TypeParam::Coefficient;
    const auto& [x, a, b, y] = TypeParam::kReferences[7];
    const HostArray<Coefficient> feedback(a), feedforward(b);
    HostArray<Signal> whole(x);
    this->Call(whole, feedback, feedforward, 2);  // not 1: the states are cleared
    const auto forward = this->forward_.values(), reverse = this->reverse_.values();
    EXPECT_EQ(forward.size(), b.size() - 1);
    EXPECT_EQ(reverse.size(), a.size() - 1);

    HostArray<Signal> head(std::vector<Signal>(x.begin(), x.begin() + 33)),
        tail(std::vector<Signal>(x.begin() + 33, x.end()));
    this->Call(head, feedback, feedforward, 0);
    this->Call(tail, feedback, feedforward, 1);
    auto joined = head.values();
    for (const Signal& sample : tail.values()) joined.push_back(sample);
    EXPECT_THAT(joined, SameBitsAs(whole.values()));
    EXPECT_THAT(this->forward_.values(), SameBitsAs(forward));
    EXPECT_THAT(this->reverse_.values(), SameBitsAs(reverse));
}

// Here the forward state fits and the reverse state does not. What the fitting one holds is void all the same.
TYPED_TEST(InPlace, StartsAnewWhenAStateDoesNotFit) {
    using Signal = typename TypeParam::Input;
    using Coefficient = typename TypeParam::Coefficient;
    const HostArray<Coefficient> a(RealValues<Coefficient>({1.0, 0.0, 0.0})),
        b(RealValues<Coefficient>({1.0, 1.0, 1.0, 1.0}));
    HostArray<Signal> x(RealValues<Signal>({1.0}));
    this->Call(x, a, b, 1);
    EXPECT_EQ(this->err_, kOk);
    EXPECT_THAT(x.values(), SameBitsAs(RealValues<Signal>({1.0})));
    EXPECT_EQ(this->forward_.values(), RealValues<Signal>({0.0, 0.0, 1.0}));
    EXPECT_EQ(this->reverse_.values(), RealValues<Signal>({0.0, 1.0}));
    // The next block goes on.
    this->Call(x, a, b, 1);
    EXPECT_EQ(x.values(), RealValues<Signal>({2.0}));
}

TYPED_TEST(InPlace, DoesNotResizeAStateThatFits) {
    using Signal = typename TypeParam::Input;
    using Coefficient = typename TypeParam::Coefficient;
    const HostArray<Coefficient> a(RealValues<Coefficient>({1.0, 0.0})),
        b(RealValues<Coefficient>({1.0, 1.0, 1.0, 1.0}));
    HostArray<Signal> x(RealValues<Signal>({1.0}));
    const FailResize failure;
    ResizeLog log;
    EXPECT_EQ(this->Call(x, a, b, 2), 0);
    EXPECT_EQ(this->err_, kOk);
    EXPECT_EQ(log.size(), 0);
    EXPECT_EQ(x.values(), RealValues<Signal>({1.0}));
}

TYPED_TEST(InPlace, WithoutFeedbackLeavesTheReverseStateAlone) {
    using Signal = typename TypeParam::Input;
    using Coefficient = typename TypeParam::Coefficient;
    const HostArray<Coefficient> none, b(RealValues<Coefficient>({0.0, 2.0}));
    for (uint8_t init = 0; init < 3; ++init) {
        HostArray<Signal> x(RealValues<Signal>({1.0, 2.0, 3.0}));
        EXPECT_EQ(this->Call(x, none, b, init), 0);
        EXPECT_EQ(this->err_, kOk);
        EXPECT_EQ(x.values(), RealValues<Signal>({init == 1 ? 6.0 : 0.0, 2.0, 4.0}));
        EXPECT_EQ(this->forward_.values(), RealValues<Signal>({3.0}));
        EXPECT_EQ(this->reverse_.values(), RealValues<Signal>({8.0}));
    }
}

TYPED_TEST(InPlace, CopiesBySingleCoefficient) {
    using Signal = typename TypeParam::Input;
    using Coefficient = typename TypeParam::Coefficient;
    const HostArray<Coefficient> none, one(RealValues<Coefficient>({1.0})), two(RealValues<Coefficient>({2.0}));
    for (uint8_t init = 0; init < 3; ++init) {
        HostArray<Signal> x(RealValues<Signal>({1.0, 2.0}));
        this->Call(x, none, one, init);
        EXPECT_EQ(this->err_, kOk);
        EXPECT_EQ(x.values(), RealValues<Signal>({1.0, 2.0}));
        EXPECT_TRUE(this->forward_.empty());
        this->Call(x, two, one, init);
        EXPECT_EQ(x.values(), RealValues<Signal>({0.5, 1.0}));
    }
    EXPECT_TRUE(this->reverse_.empty());
}

TYPED_TEST(InPlace, DoesNothingWithoutCoefficients) {
    using Signal = typename TypeParam::Input;
    using Coefficient = typename TypeParam::Coefficient;
    const HostArray<Coefficient> none;
    HostArray<Signal> x(RealValues<Signal>({1.0}));
    ResizeLog log;
    EXPECT_EQ(this->Call(x, none, none), 0);
    EXPECT_EQ(this->err_, kOk);
    EXPECT_EQ(log.size(), 0);
    EXPECT_EQ(x.values(), RealValues<Signal>({1.0}));
    EXPECT_EQ(this->forward_.values(), RealValues<Signal>({5.0, 6.0, 7.0}));
    EXPECT_EQ(this->reverse_.values(), RealValues<Signal>({8.0}));
}

TYPED_TEST(InPlace, RefusesAnEmptySignalAndTouchesNothing) {
    using Signal = typename TypeParam::Input;
    using Coefficient = typename TypeParam::Coefficient;
    HostArray<Signal> x;
    for (const bool feedforward : {false, true}) {
        ResizeLog log;
        EXPECT_EQ(
            this->Call(x, HostArray<Coefficient>(RealValues<Coefficient>({1.0})),
                       feedforward ? HostArray<Coefficient>(RealValues<Coefficient>({1.0})) : HostArray<Coefficient>()),
            0);
        EXPECT_EQ(this->err_, kEmptyInput);
        EXPECT_EQ(log.size(), 0);
        EXPECT_EQ(this->forward_.size(), 3);
        EXPECT_EQ(this->reverse_.size(), 1);
    }
}

TYPED_TEST(InPlace, RefusesFeedbackAlone) {
    using Signal = typename TypeParam::Input;
    using Coefficient = typename TypeParam::Coefficient;
    HostArray<Signal> x(RealValues<Signal>({1.0}));
    EXPECT_EQ(this->Call(x, HostArray<Coefficient>(RealValues<Coefficient>({1.0})), HostArray<Coefficient>()), 0);
    EXPECT_EQ(this->err_, kBadDimension);
    EXPECT_TRUE(x.empty() && this->forward_.empty() && this->reverse_.empty());
}

TYPED_TEST(InPlace, HandsOnTheHostsRefusal) {
    using Signal = typename TypeParam::Input;
    using Coefficient = typename TypeParam::Coefficient;
    const HostArray<Coefficient> three(RealValues<Coefficient>({1.0, 1.0, 1.0}));
    for (const int32_t nth : {1, 2}) {
        HostArray<Signal> x(RealValues<Signal>({1.0}));
        this->forward_ = HostArray<Signal>(RealValues<Signal>({5.0}));
        this->reverse_ = HostArray<Signal>(RealValues<Signal>({5.0}));
        const FailResize failure(nth, 4711);
        EXPECT_EQ(this->Call(x, three, three), 4711);
        EXPECT_EQ(this->err_, kOutOfMemory);
        EXPECT_TRUE(x.empty() && this->forward_.empty() && this->reverse_.empty());
    }
}

class RealSignalByComplex : public testing::Test {
  protected:
    int32_t Call(const HostArray<double>& x, const HostArray<Complex>& a, const HostArray<Complex>& b,
                 uint8_t init = 0) {
        return CxIIRReSig_Filter_H(x.handle(), y_.handle(), a.handle(), b.handle(), forward_.handle(),
                                   reverse_.handle(), &init);
    }

    LeakCheck leaks_;
    HostArray<Complex> y_{{9.0, 9.0}};
    HostArray<double> forward_{5.0};
    HostArray<Complex> reverse_{{6.0, 6.0}};
    const HostArray<Complex> two_{{1.0, 1.0}, {0.0, 1.0}}, none_;
};

TEST_F(RealSignalByComplex, FiltersAsTheReference) {
    for (const auto& [x, a, b, y] : kRealByComplex) {
        const HostArray<double> signal(x);
        EXPECT_EQ(Call(signal, HostArray<Complex>(a), HostArray<Complex>(b)), kOk);
        EXPECT_THAT(y_.values(), AllNear(y, 1e-13, 1e-12));
        EXPECT_EQ(signal.values(), x);
    }
}

TEST_F(RealSignalByComplex, GoesOnFromItsStates) {
    const auto& [x, a, b, y] = kRealByComplex[7];
    const HostArray<Complex> feedback(a), feedforward(b);
    Call(HostArray<double>(std::vector<double>(x.begin(), x.begin() + 70)), feedback, feedforward);
    auto joined = y_.values();
    Call(HostArray<double>(std::vector<double>(x.begin() + 70, x.end())), feedback, feedforward, 1);
    for (const Complex& sample : y_.values()) joined.push_back(sample);
    EXPECT_THAT(joined, AllNear(y, 1e-13, 1e-12));
    EXPECT_EQ(forward_.size(), static_cast<int32_t>(b.size()) - 1);
    EXPECT_EQ(reverse_.size(), static_cast<int32_t>(a.size()) - 1);
}

TEST_F(RealSignalByComplex, EmptiesItsOutputForAnEmptySignalAndLeavesTheStates) {
    EXPECT_EQ(Call(HostArray<double>(), two_, two_), kEmptyInput);
    EXPECT_TRUE(y_.empty());
    EXPECT_EQ(forward_.values(), std::vector<double>{5.0});
    EXPECT_EQ(reverse_.size(), 1);
}

TEST_F(RealSignalByComplex, DoesNothingWithoutCoefficients) {
    EXPECT_EQ(Call(HostArray<double>{1.0, 2.0}, none_, none_), kOk);
    EXPECT_THAT(y_.values(), ElementsAre(Complex{9.0, 9.0}));
    EXPECT_EQ(forward_.values(), std::vector<double>{5.0});
}

TEST_F(RealSignalByComplex, RefusesFeedbackAlone) {
    const HostArray<double> x{1.0};
    EXPECT_EQ(Call(x, two_, none_), kBadDimension);
    EXPECT_TRUE(y_.empty() && forward_.empty() && reverse_.empty());
    EXPECT_EQ(x.size(), 1);
}

TEST_F(RealSignalByComplex, ReportsTheHostsRefusal) {
    const HostArray<Complex> three{{1.0, 1.0}, {0.0, 1.0}, {2.0, 0.0}};
    for (const int32_t nth : {1, 2, 3}) {
        const HostArray<double> x{1.0};
        forward_ = HostArray<double>{5.0};
        reverse_ = HostArray<Complex>{{5.0, 1.0}};
        const FailResize failure(nth, 4711);
        EXPECT_EQ(Call(x, three, three), kOutOfMemory);
        EXPECT_TRUE(y_.empty() && forward_.empty() && reverse_.empty());
        EXPECT_EQ(x.size(), 1);
    }
}

}  // namespace
}  // namespace krnumer

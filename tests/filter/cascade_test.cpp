#include "filter/cascade.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "filter/draw.h"
#include "frame/status.h"
#include "krnumer/filter.h"
#include "support/host_arrays.h"

namespace krnumer {
namespace {

template <class Signal>
struct CascadeReference {
    int32_t structure;
    std::vector<Signal> x;
    std::vector<double> a, b;
    std::vector<Signal> y;
};

#include "reference/filter/cascade.inc"

template <class Signal>
class CascadeTest : public testing::Test {
  protected:
    static constexpr bool kIsReal = std::is_same_v<Signal, double>;
    static constexpr auto Export = [] {
        if constexpr (kIsReal) return IIR_Filter2;
        if constexpr (!kIsReal) return CxSigIIR_Filter2;
    }();
    static const auto& References() {
        if constexpr (kIsReal) return kReal;
        if constexpr (!kIsReal) return kComplex;
    }

    int32_t Call(HostArray<Signal>& x, const HostArray<double>& a, const HostArray<double>& b, int32_t structure = 0,
                 uint8_t init = 0) {
        err_ = 77;
        return Export(x.handle(), &structure, a.handle(), b.handle(), state_.handle(), &init, &err_);
    }

    // Sections with their poles inside the unit circle, the first coefficients of products (1 - r/z)...
    static std::vector<double> StableSections(std::size_t sections, std::size_t m, std::mt19937& random) {
        std::vector<double> a;
        for (std::size_t k = 0; k < sections; ++k) {
            std::vector<double> polynomial{1.0};
            for (std::size_t i = 0; i < m; ++i) {
                const double pole = 0.9 * Draw<double>(random);
                polynomial.push_back(0.0);
                for (std::size_t j = polynomial.size() - 1; j > 0; --j) polynomial[j] -= pole * polynomial[j - 1];
            }
            a.insert(a.end(), polynomial.begin() + 1, polynomial.end());
        }
        return a;
    }

    LeakCheck leaks_;
    HostArray<Signal> state_{RealValues<Signal>({5.0})};
    int32_t err_ = 77;
    std::mt19937 random_{3};
};
using Signals = testing::Types<double, Complex>;
TYPED_TEST_SUITE(CascadeTest, Signals);

TYPED_TEST(CascadeTest, FiltersAsTheReference) {
    for (const auto& [structure, x, a, b, y] : this->References()) {
        HostArray<TypeParam> signal(x);
        EXPECT_EQ(this->Call(signal, HostArray<double>(a), HostArray<double>(b), structure), 0);
        EXPECT_EQ(this->err_, kOk);
        EXPECT_THAT(signal.values(), AllNear(y, 0.0, 1e-11));
        EXPECT_EQ(this->state_.size(), static_cast<int32_t>(a.size()));
    }
}

// However many sections are at work at once, each does what it would do alone.
TYPED_TEST(CascadeTest, FiltersAsItsSectionsOneByOne) {
    using Signal = TypeParam;
    for (const std::size_t m : {2, 4}) {
        for (std::size_t sections = 1; sections <= 10; ++sections) {
            for (const std::size_t n : {1, 2, 3, 4, 5, 9, 40}) {
                const auto a = this->StableSections(sections, m, this->random_);
                const auto b = DrawArray<double>(sections * (m + 1), this->random_);
                auto state = DrawArray<Signal>(sections * m, this->random_);
                auto x = DrawArray<Signal>(n, this->random_);

                auto expected = x;
                auto expected_state = state;
                for (std::size_t k = 0; k < sections; ++k) {
                    Signal* w = &expected_state[k * m];
                    for (Signal& v : expected) {
                        Signal back = a[k * m] * w[0], forward = b[k * (m + 1) + 1] * w[0];
                        for (std::size_t i = 1; i < m; ++i) {
                            back = back + a[k * m + i] * w[i];
                            forward = forward + b[k * (m + 1) + i + 1] * w[i];
                        }
                        const Signal t = v - back;
                        v = b[k * (m + 1)] * t + forward;
                        for (std::size_t i = m - 1; i > 0; --i) w[i] = w[i - 1];
                        w[0] = t;
                    }
                }
                Cascade<Signal> cascade{static_cast<int32_t>(2 * sections),
                                        false,
                                        a.data(),
                                        static_cast<int32_t>(a.size()),
                                        b.data(),
                                        static_cast<int32_t>(b.size()),
                                        state.data(),
                                        static_cast<int32_t>(state.size())};
                ASSERT_EQ(CascadeFilter(x.data(), static_cast<int32_t>(n), &cascade), kOk);
                ASSERT_THAT(x, SameBitsAs(expected)) << m << ' ' << sections << ' ' << n;
                ASSERT_THAT(state, SameBitsAs(expected_state)) << m << ' ' << sections << ' ' << n;
            }
        }
    }
}

TYPED_TEST(CascadeTest, FiltersBlocksAsTheWhole) {
    using Signal = TypeParam;
    for (int32_t round = 0; round < 100; ++round) {
        const std::size_t m = round % 2 == 0 ? 2 : 4, sections = 1 + this->random_() % 6;
        const HostArray<double> a(this->StableSections(sections, m, this->random_)),
            b(DrawArray<double>(sections * (m + 1), this->random_));
        const auto x = DrawArray<Signal>(60, this->random_);
        HostArray<Signal> whole(x);
        this->Call(whole, a, b, round % 2, 0);
        ASSERT_EQ(this->err_, kOk);
        const auto state = this->state_.values();

        std::vector<Signal> joined;
        while (joined.size() < x.size()) {
            const std::size_t length = std::min<std::size_t>(1 + this->random_() % 12, x.size() - joined.size());
            const auto from = x.begin() + static_cast<std::ptrdiff_t>(joined.size());
            HostArray<Signal> block(std::vector<Signal>(from, from + static_cast<std::ptrdiff_t>(length)));
            this->Call(block, a, b, round % 2, joined.empty() ? 0 : 1);
            for (const Signal& sample : block.values()) joined.push_back(sample);
        }
        ASSERT_THAT(joined, SameBitsAs(whole.values()));
        ASSERT_THAT(this->state_.values(), SameBitsAs(state));
    }
}

TYPED_TEST(CascadeTest, TakesTheDesigns) {
    using Signal = TypeParam;
    const double fs = 1.0, fl = 0.1, fh = 0.3;
    for (int32_t type = 0; type < 4; ++type) {
        for (int32_t order = 1; order <= 9; ++order) {
            HostArray<double> a, b;
            BWCoefs(&fs, &fl, &fh, &order, &type, a.handle(), b.handle(), &this->err_);
            const int32_t structure = type < 2 ? 0 : 1;
            HostArray<Signal> x(RealValues<Signal>({1.0, 2.0})), other(RealValues<Signal>({1.0}));
            EXPECT_EQ(this->Call(x, a, b, structure), 0);
            EXPECT_EQ(this->err_, kOk);
            EXPECT_EQ(x.size(), 2);
            EXPECT_EQ(this->Call(other, a, b, 1 - structure), 0);
            EXPECT_EQ(this->err_, kBadCoefficientCount);
            EXPECT_TRUE(other.empty() && this->state_.empty());
        }
    }
}

TYPED_TEST(CascadeTest, ResizesAndClearsAStateThatDoesNotFit) {
    using Signal = TypeParam;
    const HostArray<double> a{0.0, 0.0}, b{1.0, 1.0, 1.0};
    this->state_ = HostArray<Signal>(RealValues<Signal>({1.0, 2.0, 3.0}));
    HostArray<Signal> x(RealValues<Signal>({1.0}));
    this->Call(x, a, b, 0, 1);
    EXPECT_EQ(this->err_, kOk);
    EXPECT_EQ(x[0], FromReal<Signal>(1.0));
    EXPECT_THAT(this->state_.values(), SameBitsAs(RealValues<Signal>({1.0, 0.0})));
    // Now it fits: with 1 the filter goes on, with 2 it does not.
    const FailResize failure;
    this->Call(x, a, b, 0, 1);
    EXPECT_EQ(x[0], FromReal<Signal>(2.0));
    this->Call(x, a, b, 0, 2);
    EXPECT_EQ(x[0], FromReal<Signal>(2.0));
    EXPECT_EQ(this->err_, kOk);
}

TYPED_TEST(CascadeTest, DoesNothingWithoutCoefficients) {
    using Signal = TypeParam;
    HostArray<Signal> x(RealValues<Signal>({1.0}));
    EXPECT_EQ(this->Call(x, HostArray<double>(), HostArray<double>()), 0);
    EXPECT_EQ(this->err_, kOk);
    EXPECT_EQ(x[0], FromReal<Signal>(1.0));
    EXPECT_EQ(this->state_[0], FromReal<Signal>(5.0));
}

TYPED_TEST(CascadeTest, RefusesInAFixedOrder) {
    using Signal = TypeParam;
    const HostArray<double> none, two{0.0, 0.0}, three{1.0, 1.0, 1.0};
    HostArray<Signal> empty, x(RealValues<Signal>({1.0}));
    // These touch nothing.
    EXPECT_EQ(this->Call(empty, two, none, 7), 0);
    EXPECT_EQ(this->err_, kEmptyInput);
    for (const int32_t structure : {2, -1}) {
        EXPECT_EQ(this->Call(x, two, none, structure), 0);
        EXPECT_EQ(this->err_, kBadSelector);
        EXPECT_EQ(this->Call(x, none, none, structure), 0);
        EXPECT_EQ(this->err_, kBadSelector);
    }
    EXPECT_EQ(x[0], FromReal<Signal>(1.0));
    EXPECT_EQ(this->state_[0], FromReal<Signal>(5.0));

    for (const bool feedback : {false, true}) {
        x = HostArray<Signal>(RealValues<Signal>({1.0}));
        this->state_ = HostArray<Signal>(RealValues<Signal>({5.0}));
        EXPECT_EQ(this->Call(x, feedback ? two : none, feedback ? none : three), 0);
        EXPECT_EQ(this->err_, kBadDimension);
        EXPECT_TRUE(x.empty() && this->state_.empty());
    }
}

TYPED_TEST(CascadeTest, RefusesLengthsThatDoNotFit) {
    using Signal = TypeParam;
    for (const int32_t structure : {0, 1}) {
        for (int32_t na = 1; na <= 13; ++na) {
            for (int32_t nb = 1; nb <= 16; ++nb) {
                const int32_t m = structure == 0 ? 2 : 4;
                const bool fits = na % m == 0 && nb == na / m * (m + 1);
                HostArray<Signal> x(RealValues<Signal>({1.0}));
                EXPECT_EQ(this->Call(x, HostArray<double>(na), HostArray<double>(nb), structure), 0);
                EXPECT_EQ(this->err_, fits ? kOk : kBadCoefficientCount) << structure << ' ' << na << ' ' << nb;
                EXPECT_EQ(x.empty(), !fits);
                EXPECT_EQ(this->state_.size(), fits ? na : 0);
            }
        }
    }
}

TYPED_TEST(CascadeTest, HandsOnTheHostsRefusal) {
    using Signal = TypeParam;
    HostArray<Signal> x(RealValues<Signal>({1.0}));
    const FailResize failure(1, 4711);
    EXPECT_EQ(this->Call(x, HostArray<double>{0.0, 0.0}, HostArray<double>{1.0, 0.0, 0.0}), 4711);
    EXPECT_EQ(this->err_, kOutOfMemory);
    EXPECT_TRUE(x.empty() && this->state_.empty());
}

TYPED_TEST(CascadeTest, TellsDirectCallsWhatDoesNotFit) {
    const double a[4] = {}, b[6] = {};
    TypeParam state[4] = {}, x[1] = {FromReal<TypeParam>(1.0)};
    const auto status = [&](int32_t order, int32_t na, int32_t nb, int32_t state_size) {
        Cascade<TypeParam> cascade{order, true, a, na, b, nb, state, state_size};
        const int32_t result = CascadeFilter(x, 1, &cascade);
        EXPECT_EQ(cascade.reset, result != kOk);
        return result;
    };
    EXPECT_EQ(status(4, 4, 6, 4), kOk);
    EXPECT_EQ(status(3, 4, 6, 4), kOk);
    EXPECT_EQ(status(2, 4, 5, 4), kOk);
    EXPECT_EQ(status(1, 4, 5, 4), kOk);
    for (const int32_t order : {0, -1, -2147483647 - 1, 2147483647, 5})
        EXPECT_EQ(status(order, 4, 6, 4), kBadCoefficientCount);
    EXPECT_EQ(status(4, 4, 5, 4), kBadCoefficientCount);
    EXPECT_EQ(status(4, 4, 6, 3), kBadCoefficientCount);
    EXPECT_EQ(status(4, 3, 6, 3), kBadCoefficientCount);
}

}  // namespace
}  // namespace krnumer

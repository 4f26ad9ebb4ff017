// Power and cross spectra, moving sums and modulators, through their exports.

#include "krnumer/spectrum.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cmath>
#include <numbers>

#include "frame/numeric.h"
#include "frame/status.h"
#include "support/host_arrays.h"
#include "transform/samples.h"

namespace krnumer {
namespace {

using testing::ElementsAre;

class Spectra : public testing::Test {
  protected:
    LeakCheck leaks_;
    HostInstance instance_;
    void* slot_ = nullptr;
    HostArray<double> power_{9};
    HostArray<Complex> cross_{{9, 9}};
};

std::vector<Complex> AsComplex(const std::vector<double>& x) {
    std::vector<Complex> z;
    for (const double value : x) z.push_back({value, 0.0});
    return z;
}

TEST_F(Spectra, AgreeWithSciPy) {
    for (const auto& one : Reference("power")) {
        HostArray<double> x(one.input);
        EXPECT_EQ(SpectrumH(x.handle(), &slot_), 0);
        EXPECT_EQ(CxSpectrumH(HostArray<Complex>(AsComplex(one.input)).handle(), power_.handle(), &slot_), 0);
        for (int32_t k = 0; k < x.size(); ++k) {
            EXPECT_NEAR(x[k], one.output[static_cast<size_t>(k)], 1e-15);
            EXPECT_NEAR(power_[k], one.output[static_cast<size_t>(k)], 1e-15);
        }
    }
}

TEST_F(Spectra, AgreeWithTheirDefinition) {
    for (const int32_t n : {1, 2, 3, 4, 7, 12, 53, 64, 300}) {
        const std::vector<Complex> x = RandomComplexes(n, 1);
        const std::vector<Complex> y = RandomComplexes(n, 2);
        const auto fx = Fourier(x);
        const auto fy = Fourier(y);
        const long double scale = 1.0L / n / n;
        ASSERT_EQ(CxSpectrumH(HostArray<Complex>(x).handle(), power_.handle(), &slot_), 0);
        ASSERT_EQ(
            CxCrossSpectrumH(HostArray<Complex>(x).handle(), HostArray<Complex>(y).handle(), cross_.handle(), &slot_),
            0);
        for (int32_t k = 0; k < n; ++k) {
            const auto i = static_cast<size_t>(k);
            EXPECT_NEAR(power_[k], static_cast<double>(std::norm(fx[i]) * scale), 1e-14);
            const auto product = std::conj(fx[i]) * fy[i] * scale;
            EXPECT_NEAR(cross_[k].re, static_cast<double>(product.real()), 1e-14);
            EXPECT_NEAR(cross_[k].im, static_cast<double>(product.imag()), 1e-14);
        }
    }
}

TEST_F(Spectra, OfRealPairsAreThoseOfComplexPairs) {
    HostArray<Complex> expected;
    for (const int32_t n : {1, 2, 3, 4, 7, 12, 53, 64, 301}) {
        const std::vector<double> x = RandomReals(n, 1);
        const std::vector<double> y = RandomReals(n, 2);
        ASSERT_EQ(CrossSpectrumH(HostArray<double>(x).handle(), HostArray<double>(y).handle(), cross_.handle(), &slot_),
                  0);
        ASSERT_EQ(CxCrossSpectrumH(HostArray<Complex>(AsComplex(x)).handle(), HostArray<Complex>(AsComplex(y)).handle(),
                                   expected.handle(), &slot_),
                  0);
        for (int32_t k = 0; k < n; ++k) {
            EXPECT_NEAR(cross_[k].re, expected[k].re, 1e-15);
            EXPECT_NEAR(cross_[k].im, expected[k].im, 1e-15);
        }
        EXPECT_EQ(cross_[0].im, 0.0);
    }
}

TEST_F(Spectra, OfAConstantIsItsSquareAtAnyLength) {
    for (const int32_t n : {1, 2, 5, 16}) {
        HostArray<double> x(std::vector<double>(static_cast<size_t>(n), 3.0));
        EXPECT_EQ(SpectrumH(x.handle(), &slot_), 0);
        EXPECT_NEAR(x[0], 9.0, 1e-14);
    }
    HostArray<double> many(70000);  // whose square does not fit an int32
    for (int32_t i = 0; i < many.size(); ++i) many.Set(i, 2.0);
    EXPECT_EQ(SpectrumH(many.handle(), &slot_), 0);
    EXPECT_NEAR(many[0], 4.0, 1e-12);
}

TEST_F(Spectra, CheckInOrder) {
    HostArray<double> none;
    HostArray<double> two{1, 2};
    HostArray<double> three{1, 2, 3};
    EXPECT_EQ(SpectrumH(none.handle(), &slot_), kEmptyInput);
    EXPECT_EQ(CxSpectrumH(HostArray<Complex>().handle(), power_.handle(), &slot_), kEmptyInput);
    EXPECT_TRUE(power_.empty());
    EXPECT_EQ(CrossSpectrumH(none.handle(), two.handle(), cross_.handle(), &slot_), kEmptyInput);
    EXPECT_TRUE(cross_.empty());
    EXPECT_EQ(CrossSpectrumH(two.handle(), none.handle(), cross_.handle(), &slot_), kEmptyInput);
    EXPECT_EQ(CrossSpectrumH(two.handle(), three.handle(), cross_.handle(), &slot_), kSizesDiffer);
    EXPECT_EQ(slot_, nullptr);
    {
        const FailResize fail(1, 4711);
        EXPECT_EQ(CrossSpectrumH(two.handle(), two.handle(), cross_.handle(), &slot_), kOutOfMemory);
        EXPECT_EQ(slot_, nullptr) << "the size comes before the table";
    }
    const FailResize fail(1, 4711);
    EXPECT_EQ(CxSpectrumH(HostArray<Complex>(2).handle(), power_.handle(), &slot_), kOutOfMemory);
    EXPECT_NE(slot_, nullptr) << "and after it here";
}

TEST_F(Spectra, KeepASlotThatWasBoundWhenTheSizeIsRefused) {
    HostArray<double> two{1, 2};
    ASSERT_EQ(CrossSpectrumH(two.handle(), two.handle(), cross_.handle(), &slot_), 0);
    void* const bound = slot_;
    {
        const FailResize fail(1, 4711);
        EXPECT_EQ(CrossSpectrumH(two.handle(), two.handle(), cross_.handle(), &slot_), kOutOfMemory);
    }
    EXPECT_EQ(slot_, bound);
    EXPECT_EQ(CrossSpectrumH(two.handle(), two.handle(), cross_.handle(), &slot_), 0);
}

// The streaming blocks, real and complex.
template <class T>
struct Stream;
template <>
struct Stream<double> {
    using Scalar = double;
    static constexpr auto Cascade = ReCascadedMovingAverageH;
    static constexpr auto Decimate = ReDecimatedMovingAverageH;
    static std::vector<double> Random(int32_t n) { return RandomReals(n); }
    static double One() { return 1.0; }
};
template <>
struct Stream<Complex> {
    using Scalar = KrComplex;
    static constexpr auto Cascade = CxCascadedMovingAverageH;
    static constexpr auto Decimate = CxDecimatedMovingAverageH;
    static std::vector<Complex> Random(int32_t n) { return RandomComplexes(n); }
    static Complex One() { return {1.0, -2.0}; }
};

template <class T>
std::vector<T> Slice(const std::vector<T>& samples, size_t first, size_t count) {
    const auto begin = samples.begin() + static_cast<std::ptrdiff_t>(first);
    return {begin, begin + static_cast<std::ptrdiff_t>(count)};
}

void ExpectNear(double a, double b) {
    EXPECT_NEAR(a, b, 1e-12);
}
void ExpectNear(Complex a, Complex b) {
    EXPECT_NEAR(a.re, b.re, 1e-12);
    EXPECT_NEAR(a.im, b.im, 1e-12);
}

template <class T>
class MovingSums : public testing::Test {
  protected:
    LeakCheck leaks_;
    HostArray<T> sums_;
    HostMatrix<T> history_;
    int32_t index_ = 0;
    typename Stream<T>::Scalar sum_{};
    int32_t count_ = 0;
    int32_t out_count_ = -1;

    int32_t Cascade(HostArray<T>& x, int32_t stages, int32_t window, int32_t reset = 0) {
        return Stream<T>::Cascade(x.handle(), stages, window, sums_.handle(), history_.handle(), &index_, reset);
    }
    int32_t Decimate(HostArray<T>& x, int32_t m, int32_t reset = 0) {
        return Stream<T>::Decimate(x.handle(), m, &sum_, &count_, reset, &out_count_);
    }
};

using Elements = testing::Types<double, Complex>;
TYPED_TEST_SUITE(MovingSums, Elements);

TYPED_TEST(MovingSums, CascadeIsARepeatedSumOverTheWindow) {
    for (const int32_t stages : {1, 2, 5}) {
        for (const int32_t window : {2, 3, 10, 100}) {
            std::vector<TypeParam> expected = Stream<TypeParam>::Random(60);
            HostArray<TypeParam> x(expected);
            ASSERT_EQ(this->Cascade(x, stages, window, 1), 0);
            for (int32_t stage = 0; stage < stages; ++stage) {
                std::vector<TypeParam> summed;
                for (size_t i = 0; i < expected.size(); ++i) {
                    TypeParam sum{};
                    for (size_t j = 0; j <= i && j < static_cast<size_t>(window); ++j) sum = sum + expected[i - j];
                    summed.push_back(sum);
                }
                expected = summed;
            }
            const double scale = std::pow(window, stages);
            for (int32_t i = 0; i < x.size(); ++i)
                ExpectNear(x[i] * (1.0 / scale), expected[static_cast<size_t>(i)] * (1.0 / scale));
            EXPECT_EQ(this->index_, 60 % window);
        }
    }
}

TYPED_TEST(MovingSums, StagesOfACascadeRoundAsOneAfterTheOther) {
    const std::vector<TypeParam> samples = Stream<TypeParam>::Random(50);
    HostArray<TypeParam> expected(samples);
    for (int32_t stages = 1; stages < 10; ++stages) {
        ASSERT_EQ(this->Cascade(expected, 1, 7, 1), 0);
        HostArray<TypeParam> x(samples);
        ASSERT_EQ(this->Cascade(x, stages, 7, 1), 0);
        EXPECT_EQ(x.values(), expected.values()) << stages << " stages";
    }
}

TYPED_TEST(MovingSums, CascadeGoesOnFromBlockToBlock) {
    const std::vector<TypeParam> samples = Stream<TypeParam>::Random(200);
    HostArray<TypeParam> whole(samples);
    ASSERT_EQ(this->Cascade(whole, 3, 7, 1), 0);
    const std::vector<TypeParam> expected = whole.values();
    int32_t made = 0;
    for (const int32_t size : {1, 0, 6, 7, 13, 1, 100, 72}) {
        HostArray<TypeParam> block(Slice(samples, static_cast<size_t>(made), static_cast<size_t>(size)));
        ASSERT_EQ(this->Cascade(block, 3, 7, made == 0), 0);
        for (int32_t i = 0; i < size; ++i) EXPECT_EQ(block[i], expected[static_cast<size_t>(made + i)]);
        made += size;
    }
    EXPECT_EQ(made, 200);
}

TYPED_TEST(MovingSums, CascadeBeginsAnewWhenItsStateDoesNotFit) {
    const TypeParam one = Stream<TypeParam>::One();
    const auto first_output = [&](int32_t stages, int32_t window) {
        HostArray<TypeParam> x{one, one};
        EXPECT_EQ(this->Cascade(x, stages, window), 0);
        return x[0];
    };
    EXPECT_EQ(first_output(2, 3), one);
    EXPECT_EQ(this->history_.rows(), 2);
    EXPECT_EQ(this->history_.columns(), 3);
    EXPECT_NE(first_output(2, 3), one) << "goes on";
    EXPECT_EQ(first_output(2, 4), one);
    EXPECT_EQ(first_output(1, 4), one);
    EXPECT_NE(first_output(1, 4), one);
    this->index_ = 5;
    EXPECT_EQ(first_output(1, 4), one);
    this->index_ = -1;
    EXPECT_EQ(first_output(1, 4), one);
}

TYPED_TEST(MovingSums, CascadeTakesThePositionBehindTheRingAsItsStart) {
    const std::vector<TypeParam> samples = Stream<TypeParam>::Random(9);
    HostArray<TypeParam> x(samples);
    this->Cascade(x, 1, 3, 1);
    ASSERT_EQ(this->index_, 0);
    HostArray<TypeParam> from_start(samples);
    this->Cascade(from_start, 1, 3);
    this->index_ = 0;
    HostArray<TypeParam> again(samples);
    this->Cascade(again, 1, 3, 1);
    this->index_ = 3;
    HostArray<TypeParam> from_end(samples);
    this->Cascade(from_end, 1, 3);
    EXPECT_EQ(from_end.values(), from_start.values());
    EXPECT_EQ(this->index_, 0);
}

TYPED_TEST(MovingSums, CascadeOfNarrowWindows) {
    const std::vector<TypeParam> samples = Stream<TypeParam>::Random(4);
    HostArray<TypeParam> x(samples);
    EXPECT_EQ(this->Cascade(x, 2, 1), 0);
    EXPECT_TRUE(this->sums_.empty()) << "nothing is done without a reset";
    EXPECT_EQ(this->Cascade(x, 0, 5, 1), 0);
    EXPECT_TRUE(this->sums_.empty()) << "nor without stages";
    EXPECT_EQ(this->Cascade(x, 2, 1, 1), 0);
    EXPECT_EQ(this->sums_.size(), 2);
    EXPECT_EQ(x.size(), 4);
    this->index_ = 7;
    HostArray<TypeParam> y(samples);
    EXPECT_EQ(this->Cascade(y, 3, 0, 1), 0);
    EXPECT_EQ(y.values(), samples);
    EXPECT_EQ(this->sums_.size(), 3);
    EXPECT_EQ(this->history_.rows(), 3);
    EXPECT_EQ(this->history_.columns(), 0);
    EXPECT_EQ(this->index_, 0);
}

TYPED_TEST(MovingSums, CascadeWithoutStateLeavesTheSamples) {
    for (const int32_t nth : {1, 2}) {
        const std::vector<TypeParam> samples = Stream<TypeParam>::Random(4);
        HostArray<TypeParam> x(samples);
        const FailResize fail(nth, 4711);
        EXPECT_EQ(this->Cascade(x, 2, 3, 1), 0);
        EXPECT_EQ(x.values(), samples);
        EXPECT_TRUE(this->sums_.empty());
        EXPECT_TRUE(this->history_.empty());
    }
}

TYPED_TEST(MovingSums, DecimatedSumsAreSumsOfBlocks) {
    const std::vector<TypeParam> samples = Stream<TypeParam>::Random(100);
    for (const int32_t m : {2, 3, 7, 100, 101}) {
        std::vector<TypeParam> expected;
        for (size_t first = 0; first + static_cast<size_t>(m) <= samples.size(); first += static_cast<size_t>(m)) {
            TypeParam sum{};
            for (size_t i = first; i < first + static_cast<size_t>(m); ++i) sum = sum + samples[i];
            expected.push_back(sum);
        }
        // Blocks of all sizes add up in the same order.
        std::vector<TypeParam> made;
        size_t next = 0;
        for (const size_t size : {1u, 0u, 1u, 2u, 5u, 60u, 31u}) {
            HostArray<TypeParam> block(Slice(samples, next, size));
            ASSERT_EQ(this->Decimate(block, m, next == 0), 0);
            EXPECT_EQ(block.size(), static_cast<int32_t>(size));
            for (int32_t k = 0; k < this->out_count_; ++k) made.push_back(block[k]);
            next += size;
        }
        EXPECT_EQ(made, expected) << m;
        EXPECT_EQ(this->count_, 100 % m);
    }
}

TYPED_TEST(MovingSums, DecimationByLessThanTwoLeavesTheSamples) {
    const std::vector<TypeParam> samples = Stream<TypeParam>::Random(5);
    for (const int32_t m : {1, 0, -3}) {
        HostArray<TypeParam> x(samples);
        this->count_ = 4;
        EXPECT_EQ(this->Decimate(x, m), 0);
        EXPECT_EQ(this->out_count_, 5);
        EXPECT_EQ(this->count_, 4);
        EXPECT_EQ(x.values(), samples);
        EXPECT_EQ(this->Decimate(x, m, 1), 0);
        EXPECT_EQ(this->count_, 0) << "a reset clears all the same";
    }
}

TYPED_TEST(MovingSums, ADecimationThatWasBegunWiderBeginsAnew) {
    const TypeParam one = Stream<TypeParam>::One();
    for (const int32_t count : {2, 9, -1}) {
        HostArray<TypeParam> x{one, one, one};
        this->count_ = count;
        std::memcpy(&this->sum_, &one, sizeof one);
        EXPECT_EQ(this->Decimate(x, 2), 0);
        EXPECT_EQ(this->out_count_, 1);
        EXPECT_EQ(x[0], one + one);
        EXPECT_EQ(this->count_, 1);
    }
}

class Modulators : public testing::Test {
  protected:
    LeakCheck leaks_;
    double phase_ = 0.5;
    HostArray<Complex> y_{{9, 9}};
};

TEST_F(Modulators, TurnByTheRatioOfFrequencies) {
    const std::vector<Complex> samples = RandomComplexes(500);
    HostArray<Complex> x(samples);
    EXPECT_EQ(CxComplexModulatorH(x.handle(), -3.0, 40.0, &phase_), 0);
    const double step = 2.0 * std::numbers::pi * -3.0 / 40.0;
    for (int32_t k = 0; k < x.size(); ++k) {
        const Complex& in = samples[static_cast<size_t>(k)];
        const Complex expected = in * Complex{std::cos(0.5 + k * step), std::sin(0.5 + k * step)};
        EXPECT_NEAR(x[k].re, expected.re, 1e-12);
        EXPECT_NEAR(x[k].im, expected.im, 1e-12);
    }
    EXPECT_GE(phase_, 0.0);
    EXPECT_LT(phase_, 2.0 * std::numbers::pi);
    EXPECT_NEAR(std::remainder(phase_ - 0.5 - 500 * step, 2.0 * std::numbers::pi), 0.0, 1e-12);
}

TEST_F(Modulators, OfRealSamplesAreThoseOfComplexOnes) {
    const std::vector<double> samples = RandomReals(64);
    HostArray<Complex> expected(AsComplex(samples));
    double phase = phase_;
    EXPECT_EQ(CxComplexModulatorH(expected.handle(), 3.0, 10.0, &phase), 0);
    EXPECT_EQ(ReComplexModulatorH(HostArray<double>(samples).handle(), 3.0, 10.0, &phase_, y_.handle()), 0);
    EXPECT_EQ(y_.values(), expected.values());
    EXPECT_EQ(phase_, phase);
}

TEST_F(Modulators, GoOnFromBlockToBlock) {
    const std::vector<Complex> samples = RandomComplexes(50);
    HostArray<Complex> whole(samples);
    double phase = phase_;
    CxComplexModulatorH(whole.handle(), 3.0, 10.0, &phase);
    size_t next = 0;
    for (const size_t size : {1u, 2u, 17u, 30u}) {
        HostArray<Complex> block(Slice(samples, next, size));
        CxComplexModulatorH(block.handle(), 3.0, 10.0, &phase_);
        for (int32_t i = 0; i < block.size(); ++i) {
            EXPECT_NEAR(block[i].re, whole[static_cast<int32_t>(next) + i].re, 1e-13);
            EXPECT_NEAR(block[i].im, whole[static_cast<int32_t>(next) + i].im, 1e-13);
        }
        next += size;
    }
    EXPECT_NEAR(phase_, phase, 1e-13);
}

TEST_F(Modulators, OfNoFrequencyChangeNothing) {
    HostArray<Complex> x{{1, 2}};
    phase_ = 100.0;
    EXPECT_EQ(CxComplexModulatorH(x.handle(), 0.0, 10.0, &phase_), 0);
    EXPECT_THAT(x.values(), ElementsAre(Complex{1, 2}));
    EXPECT_EQ(phase_, 100.0) << "not even the wrap";
    HostArray<double> real{1, 2};
    EXPECT_EQ(ReComplexModulatorH(real.handle(), 0.0, 10.0, &phase_, y_.handle()), 0);
    EXPECT_EQ(y_.size(), 2);
}

TEST_F(Modulators, OfNoSamples) {
    phase_ = 100.0;
    HostArray<double> none;
    EXPECT_EQ(ReComplexModulatorH(none.handle(), 3.0, 10.0, &phase_, y_.handle()), 0);
    EXPECT_EQ(phase_, 100.0);
    EXPECT_EQ(y_.size(), 1) << "untouched";
    HostArray<Complex> no_complex;
    EXPECT_EQ(CxComplexModulatorH(no_complex.handle(), 3.0, 10.0, &phase_), 0);
    EXPECT_LT(phase_, 2.0 * std::numbers::pi) << "the complex form wraps all the same";
}

TEST_F(Modulators, WithoutOutputDoNothing) {
    HostArray<double> x{1, 2};
    const FailResize fail(1, 4711);
    EXPECT_EQ(ReComplexModulatorH(x.handle(), 3.0, 10.0, &phase_, y_.handle()), 0);
    EXPECT_TRUE(y_.empty());
    EXPECT_EQ(phase_, 0.5);
}

}  // namespace
}  // namespace krnumer

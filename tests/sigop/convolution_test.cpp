// Convolution, correlation and deconvolution of sequences, as cores.

#include "sigop/convolution.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>

#include "fft/fft.h"
#include "frame/status.h"
#include "sigop/half_complex_arithmetic.h"
#include "sigop/signals.h"
#include "sigop/spectrum.h"
#include "support/numbers.h"
#include "support/vector_units.h"

namespace krnumer {
namespace {

using testing::Each;
using testing::ElementsAre;

constexpr double kUnwritten = 77.0;

int32_t Convolve(const std::vector<double>& x, const std::vector<double>& y, int32_t algorithm, double* z) {
    return ConvolveReal(x.data(), Size(x), y.data(), Size(y), algorithm, z);
}
int32_t Convolve(const std::vector<Complex>& x, const std::vector<Complex>& y, int32_t algorithm, Complex* z) {
    return ConvolveComplex(x.data(), Size(x), y.data(), Size(y), algorithm, z);
}
int32_t Correlate(const std::vector<double>& x, const std::vector<double>& y, int32_t algorithm, double* z,
                  int32_t normalization) {
    return CorrelateReal(x.data(), Size(x), y.data(), Size(y), algorithm, z, normalization);
}
int32_t Correlate(const std::vector<Complex>& x, const std::vector<Complex>& y, int32_t algorithm, Complex* z,
                  int32_t normalization) {
    return CorrelateComplex(x.data(), Size(x), y.data(), Size(y), algorithm, z, normalization);
}

template <class T>
std::vector<T> Convolution(const std::vector<T>& x, const std::vector<T>& y, int32_t algorithm) {
    std::vector<T> z(x.size() + y.size() - 1);
    EXPECT_EQ(Convolve(x, y, algorithm, z.data()), kOk);
    return z;
}
template <class T>
std::vector<T> Correlation(const std::vector<T>& x, const std::vector<T>& y, int32_t algorithm,
                           int32_t normalization = kNotNormalized) {
    std::vector<T> z(x.size() + y.size() - 1);
    EXPECT_EQ(Correlate(x, y, algorithm, z.data(), normalization), kOk);
    return z;
}

template <class T>
std::vector<T> ExactConvolution(const std::vector<T>& x, const std::vector<T>& y) {
    std::vector<ExactSum<T>> sums(x.size() + y.size() - 1);
    for (size_t i = 0; i < x.size(); ++i)
        for (size_t j = 0; j < y.size(); ++j) sums[i + j].Add(x[i], y[j]);
    std::vector<T> z;
    for (const ExactSum<T>& sum : sums) z.push_back(sum.value());
    return z;
}

// What the spectral route loses with sequences of about unit samples.
double SpectralTolerance(size_t nx, size_t ny) {
    return 2e-15 * std::sqrt(static_cast<double>(nx) * static_cast<double>(ny));
}

template <class T>
class ConvolutionTest : public testing::Test {
  protected:
    RandomSignals random_;
};
using Elements = testing::Types<double, Complex>;
TYPED_TEST_SUITE(ConvolutionTest, Elements);

TYPED_TEST(ConvolutionTest, AgreesWithGoldenData) {
    using T = TypeParam;
    const Golden golden("convolution");
    const std::string kind = std::is_same_v<T, Complex> ? "complex" : "float";
    for (const std::string& name : golden.Cases(kind)) {
        SCOPED_TRACE(name);
        const auto x = golden.Get<T>(name + ".x");
        const auto y = golden.Get<T>(name + ".y");
        const auto near = [&](const char* what) { return AllNear(golden.Get<T>(name + what), 0.0, 1e-13); };
        for (const int32_t algorithm : {kDirect, kFrequencyDomain}) {
            EXPECT_THAT(Convolution(x, y, algorithm), near(".convolution"));
            EXPECT_THAT(Correlation(x, y, algorithm), near(".correlation"));
            EXPECT_THAT(Correlation(x, y, algorithm, kUnbiased), near(".unbiased"));
            EXPECT_THAT(Correlation(x, y, algorithm, kBiased), near(".biased"));
        }
    }
}

TYPED_TEST(ConvolutionTest, BothAlgorithmsGiveTheExactSums) {
    using T = TypeParam;
    for (int round = 0; round < 60; ++round) {
        const auto x = this->random_.template Samples<T>(this->random_.Integer(1, round < 30 ? 40 : 300));
        const auto y = this->random_.template Samples<T>(this->random_.Integer(1, round % 2 == 0 ? 10 : 300));
        const auto exact = ExactConvolution(x, y);
        const double tolerance = SpectralTolerance(x.size(), y.size());
        EXPECT_THAT(Convolution(x, y, kDirect), AllNear(exact, 0.0, tolerance)) << x.size() << " by " << y.size();
        EXPECT_THAT(Convolution(x, y, kFrequencyDomain), AllNear(exact, 0.0, tolerance))
            << x.size() << " by " << y.size();
    }
}

TYPED_TEST(ConvolutionTest, CorrelationIsTheConvolutionWithTheReversedConjugate) {
    using T = TypeParam;
    for (int round = 0; round < 30; ++round) {
        const auto x = this->random_.template Samples<T>(this->random_.Integer(1, 70));
        const auto y = this->random_.template Samples<T>(this->random_.Integer(1, 70));
        std::vector<T> reversed(x.rbegin(), x.rend());
        if constexpr (std::is_same_v<T, Complex>) {
            for (Complex& value : reversed) value = Conjugate(value);
        }
        const auto exact = ExactConvolution(reversed, y);
        const double tolerance = SpectralTolerance(x.size(), y.size());
        EXPECT_THAT(Correlation(x, y, kDirect), AllNear(exact, 0.0, tolerance));
        EXPECT_THAT(Correlation(x, y, kFrequencyDomain), AllNear(exact, 0.0, tolerance));
    }
}

TYPED_TEST(ConvolutionTest, NormalizationCountsTermsOrTakesTheLongerLength) {
    using T = TypeParam;
    for (const auto& [nx, ny] : {std::pair{3, 7}, {7, 3}, {5, 5}, {1, 4}, {4, 1}, {1, 1}}) {
        const auto x = this->random_.template Samples<T>(nx);
        const auto y = this->random_.template Samples<T>(ny);
        const auto plain = Correlation(x, y, kDirect);
        const auto unbiased = Correlation(x, y, kDirect, kUnbiased);
        const auto biased = Correlation(x, y, kDirect, kBiased);
        for (int32_t k = 0; k < Size(plain); ++k) {
            int terms = 0;
            for (int32_t i = 0; i < nx; ++i) terms += k - i >= 0 && k - i < ny ? 1 : 0;
            EXPECT_TRUE(SameBits(unbiased[Count(k)], plain[Count(k)] / terms));
            EXPECT_TRUE(SameBits(biased[Count(k)], plain[Count(k)] / std::max(nx, ny)));
        }
    }
}

TYPED_TEST(ConvolutionTest, LongSequencesAgreeBetweenTheAlgorithms) {
    using T = TypeParam;
    const auto x = this->random_.template Samples<T>(5003);
    const auto y = this->random_.template Samples<T>(1201);
    EXPECT_THAT(Convolution(x, y, kFrequencyDomain), AllNear(Convolution(x, y, kDirect), 0.0, 1e-12));
    EXPECT_THAT(Convolution(y, x, kFrequencyDomain), AllNear(Convolution(y, x, kDirect), 0.0, 1e-12));
}

TYPED_TEST(ConvolutionTest, EmptySequencesAreRefusedFirst) {
    using T = TypeParam;
    const std::vector<T> none, one(1);
    T z{};
    for (const int32_t algorithm : {0, 1, 2}) {
        EXPECT_EQ(Convolve(none, one, algorithm, &z), kEmptyInput);
        EXPECT_EQ(Convolve(one, none, algorithm, &z), kEmptyInput);
        EXPECT_EQ(Correlate(none, one, algorithm, &z, 9), kEmptyInput);
        EXPECT_EQ(Correlate(one, none, algorithm, &z, 9), kEmptyInput);
    }
    EXPECT_EQ(z, T{});
}

TYPED_TEST(ConvolutionTest, NormalizationsThatAreNoneAreRefused) {
    using T = TypeParam;
    const std::vector<T> x(2);
    std::vector<T> z(3);
    for (const int32_t algorithm : {0, 1, 2})
        for (const int32_t normalization : {-1, 3})
            EXPECT_EQ(Correlate(x, x, algorithm, z.data(), normalization), kBadSelector);
}

TEST(ConvolveReal, TakesAnyAlgorithmAndThenWritesNothing) {
    const std::vector<double> x{1, 2}, y{3, 4};
    for (const int32_t algorithm : {-1, 2, 1000}) {
        std::vector<double> z(3, kUnwritten);
        EXPECT_EQ(Convolve(x, y, algorithm, z.data()), kOk);
        EXPECT_THAT(z, Each(kUnwritten));
        for (const int32_t normalization : {kNotNormalized, kUnbiased, kBiased})
            EXPECT_EQ(Correlate(x, y, algorithm, z.data(), normalization), kOk);
        EXPECT_THAT(z, Each(kUnwritten));
    }
}

TEST(ConvolveComplex, RefusesUnknownAlgorithms) {
    const std::vector<Complex> x(2);
    std::vector<Complex> z(3);
    for (const int32_t algorithm : {-1, 2}) {
        EXPECT_EQ(Convolve(x, x, algorithm, z.data()), kBadSelector);
        EXPECT_EQ(Correlate(x, x, algorithm, z.data(), kNotNormalized), kBadSelector);
    }
}

// Sums of a signal with far apart magnitudes tell in which order they were taken.
TEST(ConvolveReal, AddsProductsInTheOrderOfTheFirstSequence) {
    RandomSignals random;
    for (int round = 0; round < 60; ++round) {
        auto x = random.Samples<double>(random.Integer(1, 150));
        auto y = random.Samples<double>(random.Integer(1, 150));
        for (double& value : x) value *= random.Integer(0, 1) == 0 ? 1e9 : 1.0;
        std::vector<double> convolution(x.size() + y.size() - 1), correlation(convolution);
        for (size_t i = 0; i < x.size(); ++i)
            for (size_t j = 0; j < y.size(); ++j) convolution[i + j] += x[i] * y[j];
        OnEveryVectorUnit([&] { EXPECT_THAT(Convolution(x, y, kDirect), SameBitsAs(convolution)); });
        for (size_t j = 0; j < y.size(); ++j)
            for (size_t i = x.size(); i-- > 0;) correlation[j + x.size() - 1 - i] += y[j] * x[i];
        OnEveryVectorUnit([&] { EXPECT_THAT(Correlation(x, y, kDirect), SameBitsAs(correlation)); });
    }
}

TEST(ConvolveComplex, AddsProductsInTheOrderOfTheLongerSequence) {
    RandomSignals random;
    for (int round = 0; round < 60; ++round) {
        const auto x = random.Samples<Complex>(random.Integer(1, 90));
        const auto y = random.Samples<Complex>(random.Integer(1, 90));
        const auto& longer = x.size() < y.size() ? y : x;
        const auto& shorter = x.size() < y.size() ? x : y;
        std::vector<Complex> expected(x.size() + y.size() - 1);
        for (size_t i = 0; i < longer.size(); ++i)
            for (size_t j = 0; j < shorter.size(); ++j) expected[i + j] += longer[i] * shorter[j];
        OnEveryVectorUnit([&] { EXPECT_THAT(Convolution(x, y, kDirect), SameBitsAs(expected)); });
    }
}

TEST(CorrelateComplex, AddsProductsInTheOrderOfTheLongerOrReversedSequence) {
    RandomSignals random;
    for (int round = 0; round < 60; ++round) {
        const int32_t nx = random.Integer(1, 60);
        const auto x = random.Samples<Complex>(nx);
        const auto y = random.Samples<Complex>(round % 2 == 0 ? nx : random.Integer(1, 60));
        std::vector<Complex> reversed(x.rbegin(), x.rend());
        for (Complex& value : reversed) value = Conjugate(value);
        EXPECT_THAT(Correlation(x, y, kDirect), SameBitsAs(Convolution(reversed, y, kDirect)));
    }
}

// A product that is not part of an output must not reach it, not even times zero.
TYPED_TEST(ConvolutionTest, AnInfinityReachesOnlyTheOutputsItBelongsTo) {
    using T = TypeParam;
    auto x = this->random_.template Samples<T>(100);
    const auto y = this->random_.template Samples<T>(50);
    x[60] = T{} + x[60] * kInfinity;
    const auto z = Convolution(x, y, kDirect);
    for (int32_t k = 0; k < Size(z); ++k) {
        const bool finite = IsNear(z[Count(k)] - z[Count(k)], T{}, 0.0, 0.0);
        EXPECT_EQ(finite, k < 60 || k >= 110) << k;
    }
}

TEST(ConvolveReal, SquaresASequencePassedTwice) {
    const std::vector<double> x{1, 2, 3};
    EXPECT_THAT(Convolution(x, x, kDirect), ElementsAre(1, 4, 10, 12, 9));
    EXPECT_THAT(Convolution(x, x, kFrequencyDomain), AllNear({1.0, 4.0, 10.0, 12.0, 9.0}, 1e-15, 1e-14));
}

TEST(CorrelateReal, TakesThePowerSpectrumOfASequencePassedTwice) {
    RandomSignals random;
    for (const int32_t n : {1, 2, 3, 8, 12, 23, 47, 100}) {
        const auto x = random.Samples<double>(n);
        const std::vector<double> copy(x.begin(), x.end());  // by another pointer
        const auto general = Correlation(x, copy, kFrequencyDomain);
        const auto own = Correlation(x, x, kFrequencyDomain);
        EXPECT_THAT(own, AllNear(general, 0.0, 1e-13));
        double energy = 0.0;
        for (const double value : x) energy += value * value;
        EXPECT_NEAR(own[Count(n - 1)], energy, 1e-13);
        EXPECT_THAT(Correlation(x, x, kFrequencyDomain, kBiased).at(Count(n - 1)), Near(energy / n, 1e-13));
    }
}

TEST(CorrelateReal, PartOfASequenceAgainstItselfIsNoAutocorrelation) {
    RandomSignals random;
    const auto x = random.Samples<double>(20);
    std::vector<double> direct(26), spectral(26);
    EXPECT_EQ(CorrelateReal(x.data(), 20, x.data(), 7, kDirect, direct.data(), kNotNormalized), kOk);
    EXPECT_EQ(CorrelateReal(x.data(), 20, x.data(), 7, kFrequencyDomain, spectral.data(), kNotNormalized), kOk);
    EXPECT_THAT(spectral, AllNear(direct, 0.0, 1e-14));
}

TEST(FullLength, IsNegativeWhereItDoesNotFit) {
    EXPECT_EQ(FullLength(3, 4), 6);
    EXPECT_EQ(FullLength(2147483647, 1), 2147483647);
    EXPECT_LT(FullLength(2147483647, 2), 0);
    EXPECT_LT(FullLength(2147483647, 2147483647), 0);
    double x = 0.0;
    for (const int32_t algorithm : {kDirect, kFrequencyDomain})
        EXPECT_EQ(ConvolveReal(&x, 2147483647, &x, 2, algorithm, &x), kOutOfMemory);
}

// ---- Half-complex arithmetic --------------------------------------------------------------------------------------

std::vector<double> Spectrum(const std::vector<double>& x) {
    const HeldTable table(Size(x));
    std::vector<double> spectrum(x.size());
    EXPECT_EQ(RealFFT(table.get(), x.data(), spectrum.data(), 1, 1, Size(x)), 0);
    return spectrum;
}

// Value k of a spectrum in half-complex form.
Complex Value(const std::vector<double>& h, int32_t k) {
    const int32_t n = Size(h);
    return {h[Count(k)], k == 0 || 2 * k == n ? 0.0 : h[Count(n - k)]};
}

TEST(HalfComplex, ProductsAndQuotientsAreThoseOfTheComplexValues) {
    RandomSignals random;
    for (int32_t n = 1; n < 20; ++n) {
        const auto a = Spectrum(random.Samples<double>(n));
        const auto b = Spectrum(random.Samples<double>(n));
        std::vector<double> product(a.size()), quotient(a.size()), power(a);
        HalfComplexMultiply(a.data(), b.data(), product.data(), n);
        HalfComplexDivide(a.data(), b.data(), quotient.data(), n);
        HalfComplexMultiply(power.data(), power.data(), power.data(), n);
        for (int32_t k = 0; k <= n / 2; ++k) {
            EXPECT_THAT(Value(product, k), Near(Value(a, k) * Value(b, k), 1e-15));
            EXPECT_THAT(Value(quotient, k), Near(Value(a, k) / Value(b, k), 1e-14));
            EXPECT_THAT(Value(power, k), Near(Value(a, k) * Conjugate(Value(a, k)), 1e-15));
        }
        std::vector<double> in_place = a;
        HalfComplexMultiply(in_place.data(), b.data(), in_place.data(), n);
        EXPECT_THAT(in_place, SameBitsAs(product));
        in_place = b;
        HalfComplexDivide(a.data(), in_place.data(), in_place.data(), n);
        EXPECT_THAT(in_place, SameBitsAs(quotient));
    }
}

// The short way back from a product gives what multiplication and the inverse transform give.
TEST(HalfComplex, ProductsGoBackByWayOfTheHartleyTransform) {
    RandomSignals random;
    for (int32_t n = 1; n < 40; ++n) {
        const HeldTable table(n);
        const auto a = Spectrum(random.Samples<double>(n));
        const auto b = Spectrum(random.Samples<double>(n));
        std::vector<double> product(a.size()), expected(a.size()), work(a.size());
        HalfComplexMultiply(a.data(), b.data(), product.data(), n);
        ASSERT_EQ(InverseRealFFT(table.get(), product.data(), expected.data(), 1, 1, n), 0);
        for (int32_t count = 1; count <= n; ++count) {
            std::vector<double> scratch = b, x(Count(count));
            ASSERT_EQ(InverseOfProduct(table.get(), a.data(), scratch.data(), n, work.data(), x.data(), count), 0);
            EXPECT_THAT(x, SameBitsAs(std::vector(expected.begin(), expected.begin() + count))) << n;
        }
    }
}

// ---- Deconvolution ------------------------------------------------------------------------------------------------

TEST(Deconvolve, UndoesAConvolution) {
    RandomSignals random;
    for (int round = 0; round < 40; ++round) {
        const auto x = random.Samples<double>(random.Integer(1, 60));
        auto y = random.Samples<double>(random.Integer(1, 20));
        y[0] += y[0] < 0 ? -12.0 : 12.0;  // keeps the spectrum away from zero
        auto z = Convolution(x, y, kDirect);
        EXPECT_EQ(Deconvolve(z.data(), Size(z), y.data(), Size(y)), kOk);
        z.resize(x.size());
        EXPECT_THAT(z, AllNear(x, 0.0, 1e-12));
    }
}

TEST(Deconvolve, DividesASingleSampleOnce) {
    double x = 6.0;
    const double y = 4.0;
    EXPECT_EQ(Deconvolve(&x, 1, &y, 1), kOk);
    EXPECT_EQ(x, 1.5);
}

TEST(Deconvolve, ZerosOfTheSpectrumGiveWhatIsNotFinite) {
    std::vector<double> x{1, 2, 3, 4};
    const std::vector<double> y{1, 1};  // nothing at half the sampling rate
    EXPECT_EQ(Deconvolve(x.data(), 4, y.data(), 2), kOk);
    for (int i = 0; i < 3; ++i) EXPECT_FALSE(std::abs(x[Count(i)]) < kInfinity);
}

TEST(Deconvolve, RefusesInOrder) {
    double x[2] = {1, 2};
    EXPECT_EQ(Deconvolve(x, kLongestDeconvolution + 1, x, 0), kTooLong);
    EXPECT_EQ(Deconvolve(x, 0, x, kLongestDeconvolution + 1), kTooLong);
    EXPECT_EQ(Deconvolve(x, 0, x, 1), kEmptyInput);
    EXPECT_EQ(Deconvolve(x, 1, x, 0), kEmptyInput);
    EXPECT_EQ(Deconvolve(x, 1, x, 2), kBadDimension);
    EXPECT_THAT(x, ElementsAre(1, 2));
}

}  // namespace
}  // namespace krnumer

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <random>
#include <vector>

#include "fft/fft.h"
#include "fft/long_dft.h"
#include "fft/samples.h"
#include "fft/table.h"
#include "frame/complex.h"
#include "frame/status.h"
#include "support/numbers.h"

namespace krnumer {
namespace {

// Two arrays of doubles at a stride inside a larger one that holds a marker everywhere else.
class StridedArray {
  public:
    StridedArray(int32_t n, int32_t stride) : stride_(stride), data_(static_cast<size_t>(n * stride + 5), kMarker) {}

    double* data() { return data_.data() + 2; }
    double& operator[](int32_t k) { return data_[static_cast<size_t>(k * stride_ + 2)]; }

    // Whether the places between the elements were left alone.
    bool GapsUntouched() const {
        for (size_t i = 0; i < data_.size(); ++i) {
            const bool element = i >= 2 && i < data_.size() - 3 && (i - 2) % static_cast<size_t>(stride_) == 0;
            if (!element && data_[i] != kMarker) return false;
        }
        return true;
    }

    friend bool operator==(const StridedArray&, const StridedArray&) = default;

  private:
    static constexpr double kMarker = -12345.5;

    int32_t stride_;
    std::vector<double> data_;
};

std::vector<Complex> Transform(const std::vector<Complex>& x, bool inverse = false) {
    const auto n = static_cast<int32_t>(x.size());
    const HeldTable table(n);
    std::vector<Complex> y(x.size());
    const auto transform = inverse ? InverseComplexFFT : ComplexFFT;
    EXPECT_EQ(transform(table.get(), &x[0].re, &x[0].im, &y[0].re, &y[0].im, 2, 2, n), kOk);
    return y;
}

std::vector<double> Transform(const std::vector<double>& x) {
    const auto n = static_cast<int32_t>(x.size());
    const HeldTable table(n);
    std::vector<double> y(x.size());
    EXPECT_EQ(RealFFT(table.get(), x.data(), y.data(), 1, 1, n), kOk);
    return y;
}

std::vector<double> InverseTransform(std::vector<double> x) {
    const auto n = static_cast<int32_t>(x.size());
    const HeldTable table(n);
    std::vector<double> y(x.size());
    EXPECT_EQ(InverseRealFFT(table.get(), x.data(), y.data(), 1, 1, n), kOk);
    return y;
}

std::vector<Complex> Expanded(const std::vector<double>& half_complex) {
    const size_t n = half_complex.size();
    std::vector<Complex> full(n);
    for (size_t k = 0; 2 * k <= n; ++k) {
        const double im = k == 0 || 2 * k == n ? 0.0 : half_complex[n - k];
        full[k] = {half_complex[k], im};
        if (k > 0) full[n - k] = {half_complex[k], -im};
    }
    return full;
}

bool HasOnlyFactors(int32_t n, std::initializer_list<int32_t> primes) {
    for (int32_t prime : primes)
        while (n % prime == 0) n /= prime;
    return n == 1;
}

// What the construction allows: the rounding of its own butterflies, and through every level of a Rader prime once
// more; the twiddles' recurrence with the root of the length.
double ErrorBound(int32_t n) {
    double bound = (HasOnlyFactors(n, {2, 3, 5}) ? 6e-16 : 1e-15) + 2e-17 * std::sqrt(static_cast<double>(n));
    const HeldTable table(n);
    for (int32_t i = 0; i < table.get()->factorCount; ++i) {
        const int32_t r = table.get()->factors[i];
        if (table.get()->kinds[i] == kRader) {
            bound += 2 * ErrorBound(r - 1);
        } else if (r == 29 || r == 31 || r == 43) {
            bound += 5e-15;
        }
    }
    return bound;
}

// The spectrum of the real parts of what has this spectrum.
std::vector<LongComplex> HermitianPart(const std::vector<LongComplex>& y) {
    std::vector<LongComplex> part;
    for (size_t k = 0; k < y.size(); ++k) part.push_back((y[k] + std::conj(y[(y.size() - k) % y.size()])) / 2.0L);
    return part;
}

void ExpectAgreesWithDefinition(int32_t n) {
    const double bound = ErrorBound(n);
    const std::vector<Complex> x = RandomComplex(n);
    const std::vector<LongComplex> exact = ReferenceOf(x);
    EXPECT_LT(RelativeError(Transform(x), exact), bound) << "complex, n = " << n;
    std::vector<double> r;
    for (Complex z : x) r.push_back(z.re);
    const std::vector<double> half_complex = Transform(r);
    EXPECT_LT(RelativeError(Expanded(half_complex), HermitianPart(exact)), bound) << "real, n = " << n;

    EXPECT_LT(RelativeError(Transform(Transform(x), true), x), 2 * bound) << "complex and back, n = " << n;
    const std::vector<double> back = InverseTransform(half_complex);
    double error = 0.0, size = 0.0;
    for (size_t k = 0; k < r.size(); ++k) {
        error += (back[k] - r[k]) * (back[k] - r[k]);
        size += r[k] * r[k];
    }
    EXPECT_LT(std::sqrt(error / size), 2 * bound) << "real and back, n = " << n;
}

TEST(LongDft, AgreesWithItsDefinition) {
    for (int32_t n : {1, 2, 3, 17, 64, 97}) {
        std::vector<LongComplex> x;
        for (Complex z : RandomComplex(n)) x.emplace_back(z.re, z.im);
        const std::vector<LongComplex> fast = LongDft(x), slow = LongDftByDefinition(x);
        for (size_t k = 0; k < fast.size(); ++k) EXPECT_LT(std::abs(fast[k] - slow[k]), 1e-16L) << n;
    }
}

TEST(Fft, AgreesWithTheDefinitionUpTo2000) {
    for (int32_t n = 1; n <= 2000; ++n) ExpectAgreesWithDefinition(n);
}

TEST(Fft, AgreesWithTheDefinitionAtLargeLengths) {
    for (int32_t n : {2048, 2187, 2809, 3125, 3127, 4096, 5000, 8192, 10000, 10007, 12167, 16384, 30030, 65536, 65537,
                      100000, 146410, 262144, 1048576}) {
        ExpectAgreesWithDefinition(n);
    }
}

// Few samples that are not zero make every value of the spectrum a short sum.
TEST(Fft, AgreesWithTheDefinitionOfSparseSamplesAtTheLargestLengths) {
    for (int32_t n : {2000000, 4194304}) {
        std::mt19937 random(static_cast<uint32_t>(n));
        std::vector<int32_t> places(20);
        std::vector<Complex> x(static_cast<size_t>(n));
        for (int32_t& place : places) {
            place = static_cast<int32_t>(random() % static_cast<uint32_t>(n));
            x[static_cast<size_t>(place)] = {1.0 + static_cast<double>(place) / n, 0.5};
        }
        const std::vector<Complex> y = Transform(x);
        std::vector<double> real(x.size());
        for (size_t j = 0; j < x.size(); ++j) real[j] = x[j].re;
        const std::vector<double> half_complex = Transform(real);

        std::vector<Complex> computed, exact, computed_real, exact_real;
        std::sort(places.begin(), places.end());
        places.erase(std::unique(places.begin(), places.end()), places.end());
        for (int i = 0; i < 2000; ++i) {
            const auto k = static_cast<int32_t>(random() % static_cast<uint32_t>(n / 2 - 1)) + 1;
            LongComplex sum, real_sum;
            for (int32_t place : places) {
                const long double angle =
                    6.28318530717958647692529L * static_cast<long double>(int64_t{k} * place % n) / n;
                const LongComplex rotation(std::cos(angle), -std::sin(angle));
                const Complex sample = x[static_cast<size_t>(place)];
                sum += LongComplex(sample.re, sample.im) * rotation;
                real_sum += static_cast<long double>(sample.re) * rotation;
            }
            computed.push_back(y[static_cast<size_t>(k)]);
            exact.push_back({static_cast<double>(sum.real()), static_cast<double>(sum.imag())});
            computed_real.push_back({half_complex[static_cast<size_t>(k)], half_complex[static_cast<size_t>(n - k)]});
            exact_real.push_back({static_cast<double>(real_sum.real()), static_cast<double>(real_sum.imag())});
        }
        EXPECT_LT(RelativeError(computed, exact), ErrorBound(n)) << "complex, n = " << n;
        EXPECT_LT(RelativeError(computed_real, exact_real), ErrorBound(n)) << "real, n = " << n;
    }
}

TEST(Fft, GivesThePlainFormsOfTheSmallestLengths) {
    EXPECT_EQ(Transform(std::vector<double>{2.5}), std::vector<double>{2.5});
    EXPECT_EQ(InverseTransform({2.5}), std::vector<double>{2.5});
    EXPECT_EQ(Transform(std::vector<Complex>{{1.5, -2.0}}), (std::vector<Complex>{{1.5, -2.0}}));
    EXPECT_EQ(Transform(std::vector<Complex>{{1.5, -2.0}}, true), (std::vector<Complex>{{1.5, -2.0}}));
    EXPECT_EQ(Transform(std::vector<double>{2.5, 1.0}), (std::vector<double>{3.5, 1.5}));
    const std::vector<double> y = Transform(std::vector<double>{1.0, 2.0, 4.0});
    EXPECT_EQ(y[0], 7.0);
    EXPECT_NEAR(y[1], -2.0, 1e-15);
    EXPECT_EQ(y[2], 2.0 * 0.8660254037844386);
}

TEST(Fft, TouchesNothingWhenTheLengthIsNotThatOfTheTable) {
    const HeldTable table(8);
    std::vector<double> in(32, 1.0), out(32, 7.0);
    EXPECT_EQ(RealFFT(table.get(), in.data(), out.data(), 1, 1, 9), -1);
    EXPECT_EQ(InverseRealFFT(table.get(), in.data(), out.data(), 1, 1, 7), -1);
    EXPECT_EQ(ComplexFFT(table.get(), in.data(), in.data() + 1, out.data(), out.data() + 1, 2, 2, 0), -1);
    EXPECT_EQ(InverseComplexFFT(table.get(), in.data(), in.data() + 1, out.data(), out.data() + 1, 2, 2, -8), -1);
    EXPECT_EQ(in, std::vector<double>(32, 1.0));
    EXPECT_EQ(out, std::vector<double>(32, 7.0));
}

// One of every combination of kinds, parities and places, and several stages.
const std::vector<int32_t> kVariedLengths = {1,   2,   3,   4,   6,   8,   12,   15,   16,   17,
                                             20,  32,  46,  53,  64,  92,  96,   100,  106,  120,
                                             128, 141, 210, 243, 360, 500, 1000, 1024, 1081, 2809};

TEST(Fft, GivesTheSameBitsAtEveryStride) {
    for (int32_t n : kVariedLengths) {
        const HeldTable table(n);
        const std::vector<Complex> x = RandomComplex(n);
        const std::vector<Complex> expected = Transform(x);
        const std::vector<double> real = RandomReal(n);
        const std::vector<double> expected_real = Transform(real);
        for (int32_t in_stride : {1, 2, 3}) {
            for (int32_t out_stride : {1, 2, 5}) {
                StridedArray in_re(n, in_stride), in_im(n, in_stride), out_re(n, out_stride), out_im(n, out_stride);
                for (int32_t k = 0; k < n; ++k) {
                    in_re[k] = x[static_cast<size_t>(k)].re;
                    in_im[k] = x[static_cast<size_t>(k)].im;
                }
                const StridedArray before_re = in_re, before_im = in_im;
                ASSERT_EQ(ComplexFFT(table.get(), in_re.data(), in_im.data(), out_re.data(), out_im.data(), in_stride,
                                     out_stride, n),
                          kOk);
                EXPECT_TRUE(in_re == before_re && in_im == before_im) << n;
                EXPECT_TRUE(out_re.GapsUntouched() && out_im.GapsUntouched()) << n;
                for (int32_t k = 0; k < n; ++k) {
                    ASSERT_TRUE(SameBits(Complex{out_re[k], out_im[k]}, expected[static_cast<size_t>(k)]))
                        << n << " at " << k << " with strides " << in_stride << ", " << out_stride;
                }

                StridedArray in(n, in_stride), out(n, out_stride);
                for (int32_t k = 0; k < n; ++k) in[k] = real[static_cast<size_t>(k)];
                const StridedArray before = in;
                ASSERT_EQ(RealFFT(table.get(), in.data(), out.data(), in_stride, out_stride, n), kOk);
                EXPECT_TRUE(in == before && out.GapsUntouched()) << n;
                for (int32_t k = 0; k < n; ++k) {
                    ASSERT_TRUE(SameBits(out[k], expected_real[static_cast<size_t>(k)]))
                        << n << " at " << k << " with strides " << in_stride << ", " << out_stride;
                }
            }
        }
    }
}

TEST(Fft, InvertsAtEveryStride) {
    for (int32_t n : kVariedLengths) {
        const HeldTable table(n);
        const std::vector<Complex> x = RandomComplex(n);
        const std::vector<Complex> expected = Transform(x, true);
        const std::vector<double> expected_real = InverseTransform(RandomReal(n));
        for (int32_t stride : {1, 2, 3}) {
            StridedArray in_re(n, stride), in_im(n, stride), out_re(n, stride + 1), out_im(n, stride + 1);
            for (int32_t k = 0; k < n; ++k) {
                in_re[k] = x[static_cast<size_t>(k)].re;
                in_im[k] = x[static_cast<size_t>(k)].im;
            }
            ASSERT_EQ(InverseComplexFFT(table.get(), in_re.data(), in_im.data(), out_re.data(), out_im.data(), stride,
                                        stride + 1, n),
                      kOk);
            StridedArray in(n, stride), out(n, stride + 1);
            for (int32_t k = 0; k < n; ++k) in[k] = x[static_cast<size_t>(k)].re;
            ASSERT_EQ(InverseRealFFT(table.get(), in.data(), out.data(), stride, stride + 1, n), kOk);
            EXPECT_TRUE(out_re.GapsUntouched() && out_im.GapsUntouched() && in.GapsUntouched() && out.GapsUntouched());
            for (int32_t k = 0; k < n; ++k) {
                ASSERT_TRUE(SameBits(Complex{out_re[k], out_im[k]}, expected[static_cast<size_t>(k)])) << n;
                ASSERT_TRUE(SameBits(out[k], expected_real[static_cast<size_t>(k)])) << n;
            }
        }
    }
}

// The forward transform of a spectrum is n times the samples backwards; scaling multiplies by 1/n.
TEST(Fft, InvertsByReversal) {
    for (int32_t n : {2, 3, 8, 15, 100}) {
        const std::vector<Complex> x = RandomComplex(n);
        const std::vector<Complex> forward = Transform(x), inverse = Transform(x, true);
        for (int32_t k = 0; k < n; ++k) {
            const Complex expected = forward[static_cast<size_t>((n - k) % n)] * (1.0 / n);
            EXPECT_TRUE(SameBits(inverse[static_cast<size_t>(k)], expected)) << n;
        }
    }
}

TEST(Fft, LeavesTheInputOfTheInverseRealTransformScaledAndFolded) {
    std::vector<double> spectrum{6.0, 2.0, 1.0, 3.0, 5.0}, samples(5);
    const HeldTable table(5);
    ASSERT_EQ(InverseRealFFT(table.get(), spectrum.data(), samples.data(), 1, 1, 5), kOk);
    const double c = 1.0 / 5;
    const std::vector<double> expected{6.0 * c, 2.0 * c - 5.0 * c, 1.0 * c - 3.0 * c, 1.0 * c + 3.0 * c,
                                       2.0 * c + 5.0 * c};
    EXPECT_EQ(spectrum, expected);
}

TEST(Fft, IsLinear) {
    for (int32_t n : kVariedLengths) {
        const std::vector<Complex> x = RandomComplex(n, 1), y = RandomComplex(n, 2);
        std::vector<Complex> sum(x.size());
        for (size_t k = 0; k < x.size(); ++k) sum[k] = 2.0 * x[k] - y[k];
        const std::vector<Complex> fx = Transform(x), fy = Transform(y);
        std::vector<Complex> expected(x.size());
        for (size_t k = 0; k < x.size(); ++k) expected[k] = 2.0 * fx[k] - fy[k];
        EXPECT_LT(RelativeError(Transform(sum), expected), 2 * ErrorBound(n)) << n;
    }
}

TEST(Fft, TurnsADelayIntoARotation) {
    for (int32_t n : kVariedLengths) {
        std::vector<Complex> x(static_cast<size_t>(n));
        const int32_t delay = n / 3;
        x[static_cast<size_t>(delay)] = {1.0, 0.0};
        const std::vector<Complex> y = Transform(x);
        for (int32_t k = 0; k < n; ++k) {
            const double angle = 6.283185307179586 * static_cast<double>(int64_t{k} * delay % n) / n;
            EXPECT_NEAR(y[static_cast<size_t>(k)].re, std::cos(angle), 3e-14) << n;
            EXPECT_NEAR(y[static_cast<size_t>(k)].im, -std::sin(angle), 3e-14) << n;
        }
    }
}

}  // namespace
}  // namespace krnumer

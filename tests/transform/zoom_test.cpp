// Chirp-Z and zoom transforms against their definitions in extended precision, through their exports.

#include "krnumer/zoom.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <numbers>

#include "frame/numeric.h"
#include "frame/status.h"
#include "support/host_arrays.h"
#include "transform/chirp_z.h"
#include "transform/samples.h"

namespace krnumer {
namespace {

using Extended = std::complex<long double>;

std::vector<Extended> ByDefinition(const std::vector<Complex>& x, Extended a, Extended w, int32_t m) {
    std::vector<Extended> values;
    for (int32_t k = 0; k < m; ++k) {
        const Extended z = Extended(1) / a * std::pow(w, k);  // 1 / z_k
        Extended sum = 0;
        Extended power = 1;
        for (const Complex& sample : x) {
            sum += Extended(sample.re, sample.im) * power;
            power *= z;
        }
        values.push_back(sum);
    }
    return values;
}

void ExpectNear(const HostArray<Complex>& actual, const std::vector<Extended>& expected, double tolerance) {
    ASSERT_EQ(actual.size(), static_cast<int32_t>(expected.size()));
    long double scale = 0;
    for (const Extended& value : expected) scale = std::max(scale, std::abs(value));
    for (int32_t k = 0; k < actual.size(); ++k) {
        const Extended difference = Extended(actual[k].re, actual[k].im) - expected[static_cast<size_t>(k)];
        EXPECT_LE(static_cast<double>(std::abs(difference) / scale), tolerance) << "value " << k;
    }
}

std::vector<Complex> AsComplex(const std::vector<double>& x) {
    std::vector<Complex> z;
    for (const double value : x) z.push_back({value, 0.0});
    return z;
}

class ChirpTransforms : public testing::Test {
  protected:
    LeakCheck leaks_;
    HostInstance instance_;
    void* slot_ = nullptr;
    HostArray<Complex> y_{{9, 9}};

    void ExpectEmptied() {
        EXPECT_TRUE(y_.empty());
        HostArray<Complex> fresh{{9, 9}};
        y_ = std::move(fresh);
    }
};

struct Spiral {
    KrComplex a, w;
};
const Spiral kSpirals[] = {{{1, 0}, {0.8, -0.6}}, {{1.1, 0.3}, {0.99, 0.05}}, {{-0.9, 0.5}, {1.002, -0.1}}};

TEST_F(ChirpTransforms, AgreeWithTheirDefinitionByBothAlgorithms) {
    for (const auto& [a, w] : kSpirals) {
        const Extended ea(a.re, a.im);
        const Extended ew(w.re, w.im);
        for (const auto& [n, m] : {std::pair{1, 1}, {1, 5}, {2, 3}, {7, 7}, {16, 5}, {31, 40}, {100, 64}}) {
            const std::vector<double> real = RandomReals(n);
            const std::vector<Complex> complex = RandomComplexes(n);
            // Off the unit circle the chirp of the convolution spans many magnitudes, and rounding errors with it.
            const double span = std::pow(std::max(n, m), 2) / 2.0 * std::fabs(std::log(std::hypot(w.re, w.im)));
            for (const int32_t algorithm : {0, 1}) {
                // Powers of W have angles of thousands of radians, each rounded.
                const double tolerance = 1e-12 * (algorithm == 0 ? 1.0 : std::exp(span));
                ASSERT_EQ(ChirpZT_head(HostArray<double>(real).handle(), &a, &w, m, algorithm, y_.handle()), 0);
                ExpectNear(y_, ByDefinition(AsComplex(real), ea, ew, m), tolerance);
                ASSERT_EQ(CxChirpZT_head(HostArray<Complex>(complex).handle(), &a, &w, m, algorithm, y_.handle()), 0);
                ExpectNear(y_, ByDefinition(complex, ea, ew, m), tolerance);
            }
        }
    }
}

TEST_F(ChirpTransforms, OnTheUnitCircleAreFourierTransforms) {
    for (const int32_t n : {1, 2, 3, 8, 31, 100}) {
        const double turn = 2.0 * std::numbers::pi / n;
        const KrComplex a{1, 0};
        const KrComplex w{std::cos(turn), -std::sin(turn)};
        const std::vector<Complex> x = RandomComplexes(n);
        for (const int32_t algorithm : {0, 1}) {
            ASSERT_EQ(CxChirpZT_head(HostArray<Complex>(x).handle(), &a, &w, 0, algorithm, y_.handle()), 0);
            ExpectNear(y_, Fourier(x), 1e-11);
        }
        const HostArray<Complex> spectrum(y_.values());
        ASSERT_EQ(InvChirpZT_head(spectrum.handle(), &a, &w, -1, y_.handle()), 0);
        std::vector<Extended> expected;
        for (const Complex& value : x) expected.emplace_back(value.re, value.im);
        ExpectNear(y_, expected, 1e-9);
    }
}

TEST_F(ChirpTransforms, AreInvertedFromTheValuesNearestTheUnitCircle) {
    for (const auto& [n, m] : {std::pair{1, 1}, {5, 2}, {12, 12}, {20, 7}, {40, 10}}) {
        // The m points taken go once round; far from the unit circle, where the walk must not stop, the spiral begins.
        for (const auto& [modulus, ratio] : {std::pair{1.0, 0.995}, {1.2, 1.01}, {0.8, 0.98}}) {
            const double turn = -2.0 * std::numbers::pi / m;
            const KrComplex a{modulus, 0.0};
            const KrComplex w{ratio * std::cos(turn), ratio * std::sin(turn)};
            const std::vector<Complex> x = RandomComplexes(m);
            ASSERT_EQ(CxChirpZT_head(HostArray<Complex>(x).handle(), &a, &w, n, 0, y_.handle()), 0);
            const HostArray<Complex> values(y_.values());
            ASSERT_EQ(InvChirpZT_head(values.handle(), &a, &w, m, y_.handle()), 0);
            std::vector<Extended> expected;
            for (const Complex& value : x) expected.emplace_back(value.re, value.im);
            ExpectNear(y_, expected, 1e-11);
        }
    }
}

TEST_F(ChirpTransforms, CheckInOrder) {
    const KrComplex one{1, 0};
    const KrComplex zero{0, 0};
    const KrComplex tiny{1e-170, 0};  // whose square is 0
    const KrComplex infinite{1, kInfinity};
    HostArray<double> none;
    HostArray<double> x{1, 2, 3};
    EXPECT_EQ(ChirpZT_head(none.handle(), &infinite, &zero, 3, 7, y_.handle()), kEmptyInput);
    ExpectEmptied();
    for (const int32_t algorithm : {-1, 2}) {
        EXPECT_EQ(ChirpZT_head(x.handle(), &infinite, &zero, 3, algorithm, y_.handle()), kBadSelector);
        ExpectEmptied();
    }
    const auto expect = [&](const KrComplex& a, const KrComplex& w, int32_t status) {
        for (const int32_t algorithm : {0, 1}) {
            EXPECT_EQ(ChirpZT_head(x.handle(), &a, &w, 3, algorithm, y_.handle()), status);
            ExpectEmptied();
        }
        EXPECT_EQ(InvChirpZT_head(HostArray<Complex>(3).handle(), &a, &w, 3, y_.handle()), status);
        ExpectEmptied();
    };
    expect(infinite, zero, kNotFinite);
    expect(zero, infinite, kZeroParameter);
    expect(tiny, one, kZeroParameter);
    expect(one, infinite, kNotFinite);
    expect(one, zero, kZeroParameter);
    constexpr double kMost = std::numeric_limits<double>::max();
    for (const double refused : {kMost, -kMost, -1.7976931348623e308, -kInfinity, kQuietNaN}) {
        expect({refused, 0}, one, kNotFinite);
        expect({1, refused}, one, kNotFinite);
    }
    EXPECT_EQ(InvChirpZT_head(HostArray<Complex>(3).handle(), &infinite, &one, 4, y_.handle()), kBadDimension);
    ExpectEmptied();
}

TEST_F(ChirpTransforms, TakeTheNeighbourOfTheLargestDouble) {
    const KrComplex a{std::nextafter(std::numeric_limits<double>::max(), 0.0), 0};
    const KrComplex one{1, 0};
    HostArray<double> x{1};
    EXPECT_EQ(ChirpZT_head(x.handle(), &a, &one, 1, 0, y_.handle()), 0);
}

TEST_F(ChirpTransforms, CannotBeInvertedWherePointsCoincide) {
    const KrComplex one{1, 0};
    EXPECT_EQ(InvChirpZT_head(HostArray<Complex>(3).handle(), &one, &one, 0, y_.handle()), kZeroBase);
    ExpectEmptied();
}

TEST_F(ChirpTransforms, CannotBeInvertedWhereTheReciprocalOfTheRatioVanishes) {
    const KrComplex one{1, 0};
    const KrComplex huge{1e200, 0};
    for (const int32_t n : {1, 3}) {
        EXPECT_EQ(InvChirpZT_head(HostArray<Complex>(n).handle(), &one, &huge, 0, y_.handle()), kZeroParameter);
        ExpectEmptied();
    }
}

TEST_F(ChirpTransforms, ReportARefusedSize) {
    const KrComplex one{1, 0};
    HostArray<double> x{1, 2};
    for (const int32_t host : {4711, -5}) {
        const FailResize fail(1, host);
        EXPECT_EQ(ChirpZT_head(x.handle(), &one, &one, 2, 0, y_.handle()), kOutOfMemory);
        ExpectEmptied();
    }
}

TEST(RootsToPolynomial, MultipliesTheRootsOut) {
    Complex roots[] = {{1, 0}, {2, 0}, {-3, 0}};
    double weights[3];
    Complex c[3];
    RootsToPolynomial(roots, 3, weights, c);  // z^3 - 7 z + 6
    EXPECT_EQ(c[0], (Complex{6, 0}));
    EXPECT_EQ(c[1], (Complex{-7, 0}));
    EXPECT_EQ(c[2], (Complex{0, 0}));
    EXPECT_EQ(roots[0], (Complex{-3, 0})) << "the largest comes first";
    EXPECT_EQ(roots[1], (Complex{2, 0})) << "and then the farthest";
}

std::vector<Extended> Lines(std::vector<Complex> x, int32_t length, int32_t start, int32_t count) {
    x.resize(static_cast<size_t>(length));
    const auto spectrum = Fourier(x);
    std::vector<Extended> lines;
    for (int32_t i = 0; i < count; ++i) {
        const int32_t line = ((start + i) % length + length) % length;
        lines.push_back(spectrum[static_cast<size_t>(line)]);
    }
    return lines;
}

TEST_F(ChirpTransforms, ZoomIntoLinesOfALongTransform) {
    struct Case {
        int32_t n, p, k, start, count;
    };
    for (const auto& [n, p, k, start, count] : {Case{8, 1, 8, 0, 8},
                                                {8, 2, 4, 0, 8},
                                                {12, 3, 4, -5, 9},
                                                {5, 3, 4, 2, 30},
                                                {1, 4, 3, -40, 5},
                                                {60, 5, 12, 17, 3},
                                                {97, 7, 16, -1, 20},
                                                {10, 2, 5, 123456, 4}}) {
        const std::vector<Complex> complex = RandomComplexes(n);
        const std::vector<double> real = RandomReals(n);
        HostArray<Complex> x(complex);
        ASSERT_EQ(CxDZTH(x.handle(), p, k, start, count, y_.handle(), &slot_), 0);
        ExpectNear(y_, Lines(complex, p * k, start, count), 1e-12);
        EXPECT_EQ(x.values(), complex) << "nothing to fold";
        ASSERT_EQ(ReDZTH(HostArray<double>(real).handle(), p, k, start, count, y_.handle(), &slot_), 0);
        ExpectNear(y_, Lines(AsComplex(real), p * k, start, count), 1e-12);
    }
}

TEST_F(ChirpTransforms, ZoomFoldsWhatDoesNotFit) {
    // One phase: the samples behind the first k are added up at its distance.
    HostArray<double> alias{1, 2, 3, 10, 20, 30, 100};
    ASSERT_EQ(ReDZTH(alias.handle(), 1, 3, 0, 3, y_.handle(), &slot_), 0);
    EXPECT_THAT(alias.values(), testing::ElementsAre(111, 22, 33, 10, 20, 30, 100));
    // Two phases: what is added comes from behind the first k samples, too.
    HostArray<double> odd{1, 2, 3, 10, 20, 30, 100};
    ASSERT_EQ(ReDZTH(odd.handle(), 2, 3, 0, 1, y_.handle(), &slot_), 0);
    EXPECT_THAT(odd.values(), testing::ElementsAre(11, 2, 3, 10, 20, 30, 100));
    EXPECT_NEAR(y_[0].re, 76.0, 1e-12);
}

TEST_F(ChirpTransforms, ZoomChecksInOrder) {
    HostArray<double> none;
    HostArray<double> x{1, 2, 3};
    EXPECT_EQ(ReDZTH(none.handle(), 0, 0, 0, 0, y_.handle(), &slot_), kBadOrder);
    ExpectEmptied();
    EXPECT_EQ(ReDZTH(none.handle(), 1, 0, 0, 0, y_.handle(), &slot_), kNoChannel);
    ExpectEmptied();
    EXPECT_EQ(ReDZTH(none.handle(), 1, 0, 0, 1, y_.handle(), &slot_), 0);
    EXPECT_EQ(y_.size(), 1) << "no samples: nothing is touched";
    EXPECT_EQ(slot_, nullptr);
    EXPECT_EQ(ReDZTH(x.handle(), 1, 0, 0, 1, y_.handle(), &slot_), kOutOfMemory);
    ExpectEmptied();
    EXPECT_EQ(slot_, nullptr);
    const FailResize fail(1, 4711);
    EXPECT_EQ(ReDZTH(x.handle(), 1, 3, 0, 1, y_.handle(), &slot_), 4711);
    ExpectEmptied();
    EXPECT_NE(slot_, nullptr);
    EXPECT_EQ(ReDZTH(x.handle(), 65536, 65536, INT32_MIN, 2, y_.handle(), &slot_), 0) << "a length beyond int32";
}

}  // namespace
}  // namespace krnumer

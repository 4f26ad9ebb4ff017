// The exports of the family: statuses, their order, and what they leave in their outputs.

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cmath>
#include <functional>

#include "frame/numeric.h"
#include "frame/status.h"
#include "krnumer/window.h"
#include "support/host_arrays.h"

namespace krnumer {
namespace {

using testing::DoubleNear;
using testing::ElementsAre;
using testing::Pointwise;

// A window as a function of real samples, of complex samples, and of real samples with its status in err.
struct Windows {
    const char* name;
    std::function<int32_t(KrHandle)> real, complex;
    std::function<int32_t(KrHandle, int32_t*)> by_reference;
};

const std::vector<Windows>& AllWindows() {
    static HostArray<double> coefficients{0.4, 0.5, 0.1};
    static const double value = 0.3;
    static const double duty = 40.0;
    static const std::vector<Windows> all{
        {"AllCos",
         [](KrHandle x) { return AllCosWinH(x, 2, 0); },
         [](KrHandle x) { return CxAllCosWinH(x, 2, 0); },
         {}},
        {"GenCos",
         [](KrHandle x) { return GenCosWinH(x, coefficients.handle()); },
         [](KrHandle x) { return CxGenCosWinH(x, coefficients.handle()); },
         {}},
        {"ScaledGenCos",
         [](KrHandle x) { return ScaledGenCosWinH(x, coefficients.handle()); },
         [](KrHandle x) { return ScaledCxGenCosWinH(x, coefficients.handle()); },
         {}},
        {"BartHann", BartHannWinH, CxBartHannWinH, {}},
        {"Bohman", BohmanWinH, CxBohmanWinH, {}},
        {"Parzen", ParzenWinH, CxParzenWinH, {}},
        {"Welch", WelchWinH, CxWelchWinH, {}},
        {"Triangle", TriangleWinH, CxTriangleWinH, TriangleWin},
        {"CosTapered", [](KrHandle x) { return CosTaperedH(x, 0.2); }, [](KrHandle x) { return CxCosTaperedH(x, 0.2); },
         CosTapered},
        {"Exp", [](KrHandle x) { return ExpWinH(x, value); }, [](KrHandle x) { return CxExpWinH(x, value); },
         [](KrHandle x, int32_t* err) { return ExpWindCIN(x, &value, err); }},
        {"Force", [](KrHandle x) { return ForceWinH(x, duty); }, [](KrHandle x) { return CxForceWinH(x, duty); },
         [](KrHandle x, int32_t* err) { return ForceWindCIN(x, &duty, err); }},
        {"Kaiser", [](KrHandle x) { return KaiserH(x, value); }, [](KrHandle x) { return CxKaiserH(x, value); },
         [](KrHandle x, int32_t* err) { return Kaiser_Bessel(x, &value, err); }},
        {"Gauss",
         [](KrHandle x) { return GaussWinH(x, 0.2, 1); },
         [](KrHandle x) { return CxGaussWinH(x, 0.2, 1); },
         {}},
        {"DolCheby",
         [](KrHandle x) { return DolChebyWinH(x, 50, 0); },
         [](KrHandle x) { return CxDolChebyWinH(x, 50, 0); },
         {}},
    };
    return all;
}

bool NeedsTwoSamples(const Windows& window) {
    return window.name == std::string("Exp") || window.name == std::string("Force");
}

std::vector<double> Ones(int32_t n) {
    return std::vector<double>(static_cast<size_t>(n), 1.0);
}

class WindowEntry : public testing::Test {
  protected:
    static void SetUpTestSuite() { AllWindows(); }  // its coefficients outlive the tests

    LeakCheck leaks_;
    int32_t err_ = 77;
};

TEST_F(WindowEntry, NothingIsRefused) {
    for (const Windows& window : AllWindows()) {
        SCOPED_TRACE(window.name);
        HostArray<double> real;
        HostArray<Complex> complex;
        const int32_t status = NeedsTwoSamples(window) ? kFewerThanTwo : kEmptyInput;
        EXPECT_EQ(window.real(real.handle()), status);
        EXPECT_EQ(window.complex(complex.handle()), status);
        EXPECT_TRUE(real.empty());
        EXPECT_TRUE(complex.empty());
        if (!window.by_reference) continue;
        EXPECT_EQ(window.by_reference(real.handle(), &err_), 0);
        EXPECT_EQ(err_, status);
    }
}

TEST_F(WindowEntry, ComplexSamplesHaveBothPartsWeighed) {
    for (const Windows& window : AllWindows()) {
        for (const int32_t n : {2, 3, 4, 5, 16, 37}) {
            SCOPED_TRACE(window.name);
            HostArray<double> re(n);
            HostArray<double> im(n);
            HostArray<Complex> both(n);
            for (int32_t i = 0; i < n; ++i) {
                re.Set(i, 1.0 + i);
                im.Set(i, 2.0 - 3.0 * i);
                both.Set(i, {re[i], im[i]});
            }
            EXPECT_EQ(window.real(re.handle()), 0);
            EXPECT_EQ(window.real(im.handle()), 0);
            EXPECT_EQ(window.complex(both.handle()), 0);
            for (int32_t i = 0; i < n; ++i) {
                EXPECT_NEAR(both[i].re, re[i], 4e-15 * n);
                EXPECT_NEAR(both[i].im, im[i], 8e-15 * n);
            }
        }
    }
}

TEST_F(WindowEntry, BothFormsOfAnExportAgree) {
    for (const Windows& window : AllWindows()) {
        if (!window.by_reference) continue;
        SCOPED_TRACE(window.name);
        HostArray<double> by_value(Ones(11));
        HostArray<double> by_reference(Ones(11));
        EXPECT_EQ(window.real(by_value.handle()), 0);
        EXPECT_EQ(window.by_reference(by_reference.handle(), &err_), 0);
        EXPECT_EQ(err_, 0);
        EXPECT_EQ(by_value.values(), by_reference.values());
    }
}

TEST_F(WindowEntry, ASingleSampleStaysWithMostWindows) {
    for (const Windows& window : AllWindows()) {
        SCOPED_TRACE(window.name);
        HostArray<double> x{5};
        const std::string name = window.name;
        if (NeedsTwoSamples(window)) {
            EXPECT_EQ(window.real(x.handle()), kFewerThanTwo);
            EXPECT_TRUE(x.empty());
            continue;
        }
        EXPECT_EQ(window.real(x.handle()), 0);
        ASSERT_EQ(x.size(), 1);
        if (name == "Triangle") {
            EXPECT_EQ(x[0], 0.0);
        } else if (name == "Kaiser") {
            EXPECT_NEAR(x[0], 5.0 / std::cyl_bessel_i(0, 0.3), 1e-8);
        } else {
            EXPECT_EQ(x[0], 5.0);
        }
    }
}

TEST_F(WindowEntry, HannIsExactOnFourSamples) {
    HostArray<double> x(Ones(4));
    EXPECT_EQ(AllCosWinH(x.handle(), 1, 0), 0);
    EXPECT_THAT(x.values(), Pointwise(DoubleNear(1e-15), {0.0, 0.5, 1.0, 0.5}));
    HostArray<double> scaled(Ones(4));
    EXPECT_EQ(AllCosWinH(scaled.handle(), 1, -7), 0) << "any value but 0 asks for scaling";
    EXPECT_THAT(scaled.values(), Pointwise(DoubleNear(1e-15), {0.0, 1.0, 2.0, 1.0}));
}

TEST_F(WindowEntry, UnknownSumsOfCosinesAreRefused) {
    for (const int32_t type : {10, 12, 30, 60, -1, INT32_MAX, INT32_MIN}) {
        for (const int32_t n : {1, 4}) {
            HostArray<double> x(Ones(n));
            EXPECT_EQ(AllCosWinH(x.handle(), type, 0), kBadSelector);
            EXPECT_TRUE(x.empty());
        }
        HostArray<double> none;
        EXPECT_EQ(AllCosWinH(none.handle(), type, 0), kEmptyInput);
    }
}

TEST_F(WindowEntry, CoefficientsMayOnlyBeMissingForOneSample) {
    HostArray<double> none;
    HostArray<double> one{5};
    EXPECT_EQ(GenCosWinH(one.handle(), none.handle()), 0);
    EXPECT_THAT(one.values(), ElementsAre(5));
    HostArray<double> two{5, 5};
    EXPECT_EQ(GenCosWinH(two.handle(), none.handle()), kEmptyInput);
    EXPECT_TRUE(two.empty());
}

TEST_F(WindowEntry, CoefficientsMayBeTheSamples) {
    HostArray<double> apart{1, 0.5, 0.25};
    HostArray<double> coefficients{1, 0.5, 0.25};
    HostArray<double> both{1, 0.5, 0.25};
    EXPECT_EQ(GenCosWinH(apart.handle(), coefficients.handle()), 0);
    EXPECT_EQ(GenCosWinH(both.handle(), both.handle()), 0);
    EXPECT_EQ(apart.values(), both.values());
}

TEST_F(WindowEntry, ExponentialNeedsAPositiveEnd) {
    for (const double value : {0.0, -1.0, kQuietNaN}) {
        HostArray<double> x{1, 1};
        EXPECT_EQ(ExpWinH(x.handle(), value), kBadFinalValue);
        EXPECT_TRUE(x.empty());
        HostArray<double> y{1, 1};
        EXPECT_EQ(ExpWindCIN(y.handle(), &value, &err_), 0);
        EXPECT_EQ(err_, kBadFinalValue);
        HostArray<double> one{1};
        EXPECT_EQ(ExpWinH(one.handle(), value), kFewerThanTwo);
    }
}

TEST_F(WindowEntry, ForceLimitsItsDuty) {
    const auto kept = [](double duty) {
        HostArray<double> x{1, 1, 1, 1};
        EXPECT_EQ(ForceWinH(x.handle(), duty), 0);
        const auto values = x.values();
        return std::count(values.begin(), values.end(), 1.0);
    };
    EXPECT_EQ(kept(50), 2);
    for (const double duty : {100.0, 150.0, 1e300, kInfinity}) EXPECT_EQ(kept(duty), 4);
    for (const double duty : {0.0, -1.0, -1e300, -kInfinity, kQuietNaN}) EXPECT_EQ(kept(duty), 0);
}

TEST_F(WindowEntry, ConstantsOfMeasuredWeights) {
    HostArray<double> ones(Ones(7));
    KrWindowConstants constants{-1, -1};
    EXPECT_EQ(NumWinConstH(ones.handle(), &constants), 0);
    EXPECT_EQ(constants.enbw, 1.0);
    EXPECT_EQ(constants.coherentGain, 1.0);
    EXPECT_EQ(ones.size(), 7);
    HostArray<double> zeros(3);
    EXPECT_EQ(NumWinConstH(zeros.handle(), &constants), 0);
    EXPECT_FALSE(std::isfinite(constants.enbw));
    HostArray<double> none;
    EXPECT_EQ(NumWinConstH(none.handle(), &constants), kEmptyInput);
    EXPECT_TRUE(IsQuietNaN(constants.enbw));
    EXPECT_TRUE(IsQuietNaN(constants.coherentGain));
}

template <class T>
struct Twin;
template <>
struct Twin<double> {
    static constexpr auto Scaled = ScaledWinH;
    static constexpr auto Symmetric = SymmWinH;
};
template <>
struct Twin<Complex> {
    static constexpr auto Scaled = CxScaledWinH;
    static constexpr auto Symmetric = CxSymmWinH;
};

template <class T>
class ScaledWindowEntry : public WindowEntry {
  protected:
    KrWindowConstants constants_{-1, -1};

    void ExpectConstants(double enbw, double coherent_gain) const {
        EXPECT_EQ(constants_.enbw, enbw);
        EXPECT_EQ(constants_.coherentGain, coherent_gain);
    }
    void ExpectNaN() {
        EXPECT_TRUE(IsQuietNaN(constants_.enbw));
        EXPECT_TRUE(IsQuietNaN(constants_.coherentGain));
        constants_ = {-1, -1};
    }
};

using Elements = testing::Types<double, Complex>;
TYPED_TEST_SUITE(ScaledWindowEntry, Elements);

TYPED_TEST(ScaledWindowEntry, ReportsTheConstantsOfTheTable) {
    HostArray<TypeParam> x(4);
    EXPECT_EQ(Twin<TypeParam>::Scaled(x.handle(), 1, 0, &this->constants_), 0);
    this->ExpectConstants(1.5, 0.5);
    EXPECT_EQ(Twin<TypeParam>::Scaled(x.handle(), 11, 0, &this->constants_), 0);
    this->ExpectConstants(1.9761117, 0.3635819);
    EXPECT_EQ(Twin<TypeParam>::Scaled(x.handle(), 0, 0, &this->constants_), 0);
    this->ExpectConstants(1.0, 1.0);
}

TYPED_TEST(ScaledWindowEntry, ReportsTheTableForNoSamplesToo) {
    HostArray<TypeParam> none;
    for (const int32_t type : {1, 9, 0}) {
        EXPECT_EQ(Twin<TypeParam>::Scaled(none.handle(), type, 0, &this->constants_), 0);
        EXPECT_FALSE(std::isnan(this->constants_.enbw));
    }
    EXPECT_EQ(Twin<TypeParam>::Scaled(none.handle(), 60, 5, &this->constants_), kEmptyInput);
    this->ExpectNaN();
}

TYPED_TEST(ScaledWindowEntry, RefusesUnknownWindowsAtEveryLength) {
    for (const int32_t type : {10, 12, 29, 35, 63, -1}) {
        for (const int32_t n : {0, 1, 4}) {
            HostArray<TypeParam> x(n);
            const ResizeLog log;
            EXPECT_EQ(Twin<TypeParam>::Scaled(x.handle(), type, 0, &this->constants_), kBadSelector);
            EXPECT_TRUE(x.empty());
            ASSERT_EQ(log.size(), 1);
            EXPECT_EQ(log[0].typeCode, KRRT_DOUBLE) << "of both twins";
            this->ExpectNaN();
        }
    }
}

TYPED_TEST(ScaledWindowEntry, LeavesTheConstantsAtANegativeLength) {
    HostArray<TypeParam> x(2);
    x.SetDimension(0, -1);
    EXPECT_EQ(Twin<TypeParam>::Scaled(x.handle(), 10, 0, &this->constants_), kNegativeLength);
    this->ExpectConstants(-1, -1);
    EXPECT_TRUE(x.empty());
}

TYPED_TEST(ScaledWindowEntry, SymmetricOfOneSampleLooksAtNoType) {
    HostArray<TypeParam> one(1);
    EXPECT_EQ(Twin<TypeParam>::Symmetric(one.handle(), 10, 0), 0);
    EXPECT_EQ(one.size(), 1);
    HostArray<TypeParam> none;
    EXPECT_EQ(Twin<TypeParam>::Symmetric(none.handle(), 10, 0), kEmptyInput);
    for (const int32_t type : {10, 12, 35, 63, -1, INT32_MIN}) {
        HostArray<TypeParam> x(3);
        EXPECT_EQ(Twin<TypeParam>::Symmetric(x.handle(), type, 0), kBadSelector);
        EXPECT_TRUE(x.empty());
    }
}

TEST_F(WindowEntry, ScaledHannHasUnitGain) {
    HostArray<double> x(Ones(4));
    KrWindowConstants constants;
    EXPECT_EQ(ScaledWinH(x.handle(), 1, 0, &constants), 0);
    EXPECT_THAT(x.values(), Pointwise(DoubleNear(1e-15), {0.0, 1.0, 2.0, 1.0}));
}

TEST_F(WindowEntry, ScaledTriangleOfOneSampleIsNaN) {
    HostArray<double> x{5};
    KrWindowConstants constants;
    EXPECT_EQ(ScaledWinH(x.handle(), 30, 0, &constants), 0);
    EXPECT_EQ(constants.coherentGain, 0.0);
    EXPECT_TRUE(std::isnan(constants.enbw));
    EXPECT_TRUE(std::isnan(x[0]));
}

TEST_F(WindowEntry, SymmetricWindowsRepeatTheirFirstWeight) {
    HostArray<double> hann(Ones(5));
    EXPECT_EQ(SymmWinH(hann.handle(), 1, 0), 0);
    EXPECT_THAT(hann.values(), Pointwise(DoubleNear(1e-15), {0.0, 0.5, 1.0, 0.5, 0.0}));
    HostArray<double> two(Ones(2));
    EXPECT_EQ(SymmWinH(two.handle(), 2, 0), 0);
    EXPECT_THAT(two.values(), ElementsAre(1, 1)) << "the periodic window of one sample";
}

}  // namespace
}  // namespace krnumer

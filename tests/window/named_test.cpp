#include "window/named.h"

#include <gtest/gtest.h>

#include <cmath>
#include <cstddef>
#include <vector>

#include "frame/numeric.h"
#include "frame/status.h"
#include "support/numbers.h"
#include "window/cosine_sum.h"
#include "window/dolph_chebyshev.h"
#include "window/generated.h"
#include "window/kernels.h"
#include "window/shaped.h"
#include "window/type.h"

namespace krnumer {
namespace {

using ::testing::Each;
using ::testing::ElementsAre;

constexpr int32_t kCosineTypes[] = {1, 2, 3, 4, 5, 6, 7, 8, 9, 11};
constexpr int32_t kComputedTypes[] = {30, 31, 32, 33, 34, 60, 61, 62};
constexpr int32_t kUnknownTypes[] = {-1, 10, 12, 29, 35, 59, 63, 100, INT32_MIN, INT32_MAX};
constexpr int32_t kLengths[] = {1, 2, 3, 4, 5, 12, 37, 256};

constexpr WindowConstants kBefore{-7.0, -8.0};

testing::AssertionResult IsNaN(const WindowConstants& constants) {
    if (IsQuietNaN(constants.enbw) && IsQuietNaN(constants.coherentGain)) return testing::AssertionSuccess();
    return testing::AssertionFailure() << constants.enbw << ", " << constants.coherentGain;
}

testing::AssertionResult IsAsItCame(const WindowConstants& constants) {
    if (constants.enbw == kBefore.enbw && constants.coherentGain == kBefore.coherentGain)
        return testing::AssertionSuccess();
    return testing::AssertionFailure() << constants.enbw << ", " << constants.coherentGain;
}

// A parameter that makes sense for the type.
double Parameter(int32_t type) {
    return type == kWindowDolphChebyshev ? 500.0 : type == kWindowGaussian ? 0.25 : 4.0;
}

// The periodic window of a type by its own kernel.
int32_t Plain(double* x, int32_t n, int32_t type) {
    const double parameter = Parameter(type);
    switch (type) {
        case kWindowTriangle:
            return TriangleWindow(x, n);
        case kWindowBartlettHanning:
            return BartlettHanningWindow(x, n);
        case kWindowBohman:
            return BohmanWindow(x, n);
        case kWindowParzen:
            return ParzenWindow(x, n);
        case kWindowWelch:
            return WelchWindow(x, n);
        case kWindowKaiser:
            return KaiserWindow(x, n, parameter);
        case kWindowDolphChebyshev:
            return DolphChebyshevWindow(x, n, parameter, false);
        case kWindowGaussian:
            return GaussianWindow(x, n, parameter, false);
        default:
            return NamedCosineWindow(x, n, type, false);
    }
}

std::vector<double> PlainWeights(int32_t n, int32_t type) {
    return Weights([=](double* x, int32_t count) { return Plain(x, count, type); }, n);
}

std::vector<double> Symmetric(int32_t n, int32_t type) {
    return Weights([=](double* x, int32_t count) { return SymmetricWindow(x, count, type, Parameter(type)); }, n);
}

TEST(ScaledWindow, ReportsTheTableForSumsOfCosines) {
    for (const int32_t type : kCosineTypes) {
        WindowConstants table;
        WinConstants(type, table);
        for (const int32_t n : kLengths) {
            WindowConstants constants = kBefore;
            std::vector<double> x = Samples(n, 5), expected = x;
            EXPECT_EQ(ScaledWindow(x.data(), n, type, kQuietNaN, constants), 0);
            EXPECT_EQ(NamedCosineWindow(expected.data(), n, type, true), 0);
            EXPECT_EQ(x, expected) << type;
            EXPECT_EQ(constants.enbw, table.enbw);
            EXPECT_EQ(constants.coherentGain, table.coherentGain);
        }
        WindowConstants constants = kBefore;
        EXPECT_EQ(ScaledWindow<double>(nullptr, 0, type, 0.0, constants), 0);
        EXPECT_EQ(constants.enbw, table.enbw);
        EXPECT_EQ(constants.coherentGain, table.coherentGain);
    }
}

TEST(ScaledWindow, Hann) {
    std::vector<double> x(4, 1.0);
    WindowConstants constants;
    EXPECT_EQ(ScaledWindow(x.data(), 4, kWindowHann, 0.0, constants), 0);
    EXPECT_THAT(x, AllNear(std::vector{0.0, 1.0, 2.0, 1.0}, 0.0, 5e-16));
    EXPECT_EQ(constants.enbw, 1.5);
    EXPECT_EQ(constants.coherentGain, 0.5);
}

TEST(ScaledWindow, TheRectangleLeavesTheSamples) {
    for (const int32_t n : {0, 1, 3}) {
        std::vector<double> x = {kQuietNaN, kInfinity, -0.0};
        WindowConstants constants = kBefore;
        EXPECT_EQ(ScaledWindow(x.data(), n, kWindowRectangle, 0.0, constants), 0);
        EXPECT_TRUE(IsQuietNaN(x[0]) && x[1] == kInfinity && SameBits(x[2], -0.0));
        EXPECT_EQ(constants.enbw, 1.0);
        EXPECT_EQ(constants.coherentGain, 1.0);
    }
}

TEST(ScaledWindow, MeasuresTheOthers) {
    for (const int32_t type : kComputedTypes) {
        for (const int32_t n : kLengths) {
            if (type == kWindowTriangle && n == 1) continue;
            const std::vector<double> w = PlainWeights(n, type), samples = Samples(n, 6);
            WindowConstants constants = kBefore, measured;
            MeasureWindow(w.data(), n, measured);
            std::vector<double> x = samples;
            EXPECT_EQ(ScaledWindow(x.data(), n, type, Parameter(type), constants), 0);
            EXPECT_EQ(constants.enbw, measured.enbw) << type;
            EXPECT_EQ(constants.coherentGain, measured.coherentGain) << type;
            const double gain = 1.0 / measured.coherentGain;
            for (std::size_t i = 0; i < x.size(); ++i) EXPECT_EQ(x[i], w[i] * samples[i] * gain) << type;
        }
    }
}

TEST(ScaledWindow, HasUnitGainWhereItIsMeasured) {
    for (const int32_t type : kComputedTypes) {
        std::vector<double> x(37, 1.0);
        WindowConstants constants;
        EXPECT_EQ(ScaledWindow(x.data(), 37, type, Parameter(type), constants), 0);
        double sum = 0.0;
        for (const double weight : x) sum += weight;
        EXPECT_NEAR(sum / 37.0, 1.0, 1e-14) << type;
    }
}

TEST(ScaledWindow, TheTriangleOfOneSampleHasNothingToScale) {
    double x = 5.0;
    WindowConstants constants = kBefore;
    EXPECT_EQ(ScaledWindow(&x, 1, kWindowTriangle, 0.0, constants), 0);
    EXPECT_TRUE(std::isnan(x));
    EXPECT_TRUE(std::isnan(constants.enbw));
    EXPECT_EQ(constants.coherentGain, 0.0);
}

TEST(ScaledWindow, LeavesTheConstantsOfAMalformedLength) {
    for (const int32_t type : {0, 1, 10, 30, 60}) {
        WindowConstants constants = kBefore;
        EXPECT_EQ(ScaledWindow<double>(nullptr, -1, type, 0.0, constants), kNegativeLength);
        EXPECT_EQ(ScaledWindow<Complex>(nullptr, INT32_MIN, type, 0.0, constants), kNegativeLength);
        EXPECT_TRUE(IsAsItCame(constants));
    }
}

TEST(ScaledWindow, HasNoConstantsForAnUnknownType) {
    for (const int32_t type : kUnknownTypes) {
        for (const int32_t n : {0, 1, 2}) {
            std::vector<double> x(2, 1.0);
            WindowConstants constants = kBefore;
            EXPECT_EQ(ScaledWindow(x.data(), n, type, 0.0, constants), kBadSelector) << type;
            EXPECT_TRUE(IsNaN(constants));
        }
    }
}

TEST(ScaledWindow, HasNoConstantsForAComputedTypeOfNothing) {
    for (const int32_t type : kComputedTypes) {
        WindowConstants constants = kBefore;
        EXPECT_EQ(ScaledWindow<double>(nullptr, 0, type, 0.0, constants), kEmptyInput) << type;
        EXPECT_TRUE(IsNaN(constants));
    }
}

TEST(SymmetricWindow, ClosesThePeriod) {
    for (const int32_t n : kLengths) {
        if (n == 1) continue;
        for (const int32_t type : kCosineTypes) {
            std::vector<double> expected = PlainWeights(n - 1, type);
            expected.push_back(expected[0]);
            EXPECT_EQ(Symmetric(n, type), expected) << type;
        }
        for (const int32_t type : {30, 31, 32, 33, 34, 60}) {
            std::vector<double> expected = PlainWeights(n - 1, type);
            expected.push_back(expected[0]);
            EXPECT_EQ(Symmetric(n, type), expected) << type;
        }
        EXPECT_EQ(Symmetric(n, kWindowDolphChebyshev),
                  Weights([](double* x, int32_t m) { return DolphChebyshevWindow(x, m, 500.0, true); }, n));
        EXPECT_EQ(Symmetric(n, kWindowGaussian),
                  Weights([](double* x, int32_t m) { return GaussianWindow(x, m, 0.25, true); }, n));
        EXPECT_THAT(Symmetric(n, kWindowRectangle), Each(1.0));
    }
}

TEST(SymmetricWindow, Hann) {
    EXPECT_THAT(Symmetric(5, kWindowHann), AllNear(std::vector{0.0, 0.5, 1.0, 0.5, 0.0}, 0.0, 5e-16));
}

TEST(SymmetricWindow, OfTwoRepeatsThePeriodicWindowOfOne) {
    EXPECT_THAT(Symmetric(2, kWindowHamming), ElementsAre(1.0, 1.0));
    EXPECT_THAT(Symmetric(2, kWindowTriangle), ElementsAre(0.0, 0.0));
    EXPECT_THAT(Symmetric(2, kWindowWelch), ElementsAre(1.0, 1.0));
}

TEST(SymmetricWindow, MirrorsAboutItsMiddle) {
    for (const int32_t n : kLengths) {
        for (const int32_t type : {1, 2, 6, 8, 30, 31, 32, 33, 34, 60, 61, 62}) {
            const std::vector<double> w = Symmetric(n, type);
            EXPECT_TRUE(std::equal(w.begin(), w.end(), w.rbegin())) << type << ", " << n;
        }
    }
}

TEST(SymmetricWindow, LeavesOneSampleWhateverTheType) {
    for (const int32_t type : {0, 1, 10, 30, 60, 1000, -1}) {
        double x = 3.0;
        EXPECT_EQ(SymmetricWindow(&x, 1, type, 0.0), 0);
        EXPECT_EQ(x, 3.0);
        EXPECT_EQ(SymmetricWindow(&x, 0, type, 0.0), kEmptyInput);
        EXPECT_EQ(SymmetricWindow(&x, -1, type, 0.0), kEmptyInput);
    }
}

TEST(SymmetricWindow, RefusesUnknownTypes) {
    for (const int32_t type : kUnknownTypes) {
        for (const int32_t n : {2, 3, 10}) {
            std::vector<double> x(static_cast<std::size_t>(n), 1.0);
            EXPECT_EQ(SymmetricWindow(x.data(), n, type, 0.0), kBadSelector) << type;
        }
    }
}

TEST(NamedWindows, WeighBothPartsOfComplexSamplesLikeRealOnes) {
    for (const int32_t type : {0, 1, 6, 8, 11, 30, 31, 32, 33, 34, 60, 61, 62}) {
        for (const int32_t n : kLengths) {
            for (const bool symmetric : {false, true}) {
                WindowConstants constants = kBefore, complex_constants = kBefore;
                const auto apply = [&](auto* x, WindowConstants& record) {
                    return symmetric ? SymmetricWindow(x, n, type, Parameter(type))
                                     : ScaledWindow(x, n, type, Parameter(type), record);
                };
                std::vector<double> re = Samples(n, 8), im = Samples(n, 9);
                std::vector<Complex> z;
                for (std::size_t i = 0; i < re.size(); ++i) z.push_back({re[i], im[i]});
                EXPECT_EQ(apply(re.data(), constants), 0);
                EXPECT_EQ(apply(im.data(), constants), 0);
                EXPECT_EQ(apply(z.data(), complex_constants), 0);
                EXPECT_TRUE(SameBits(constants.enbw, complex_constants.enbw));
                EXPECT_TRUE(SameBits(constants.coherentGain, complex_constants.coherentGain));
                for (std::size_t i = 0; i < re.size(); ++i)
                    EXPECT_TRUE(IsNear(z[i], Complex{re[i], im[i]}, 0.0, 0.0)) << type << ", " << i << " of " << n;
            }
        }
    }
}

}  // namespace
}  // namespace krnumer

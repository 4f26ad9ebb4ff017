#include "window/constants.h"

#include <gtest/gtest.h>

#include <vector>

#include "frame/numeric.h"
#include "frame/status.h"
#include "support/numbers.h"
#include "window/cosine_sum.h"
#include "window/generated.h"
#include "window/kernels.h"
#include "window/type.h"

namespace krnumer {
namespace {

WindowConstants Tabulated(int32_t type) {
    WindowConstants constants{-1.0, -2.0};
    WinConstants(type, constants);
    return constants;
}

WindowConstants Measured(const std::vector<double>& w) {
    WindowConstants constants{-1.0, -2.0};
    EXPECT_EQ(MeasureWindow(w.data(), static_cast<int32_t>(w.size()), constants), 0);
    return constants;
}

TEST(WinConstants, FollowFromTheCoefficients) {
    // coherent gain a[0]; noise bandwidth 1 + sum (a[k] / a[0])^2 / 2
    for (const int32_t type : {0, 1, 2, 3, 4, 5, 6, 7, 8, 9, 11}) {
        const std::span<const double> a = WinCosTerms(type);
        double enbw = 1.0;
        for (std::size_t k = 1; k < a.size(); ++k) enbw += a[k] * a[k] / (a[0] * a[0]) / 2.0;
        const WindowConstants constants = Tabulated(type);
        EXPECT_NEAR(constants.coherentGain, a[0], 5e-12) << type;
        EXPECT_NEAR(constants.enbw, enbw, type == kWindowBlackmanNuttall ? 3e-6 : 5e-7) << type;
    }
    EXPECT_EQ(Tabulated(kWindowBlackmanNuttall).enbw, 1.9761117);
    EXPECT_EQ(Tabulated(kWindowFlatTop).enbw, 3.770246506303);
    EXPECT_EQ(Tabulated(kWindowLowSideLobe).enbw, 2.215350782519);
}

TEST(WinConstants, OfTheGeneratedWindowsAreNearTheirMeasuredOnes) {
    const std::pair<int32_t, int32_t (*)(double*, int32_t)> kernels[] = {
        {kWindowBartlettHanning, BartlettHanningWindow<double>},
        {kWindowBohman, BohmanWindow<double>},
        {kWindowParzen, ParzenWindow<double>},
        {kWindowWelch, WelchWindow<double>},
    };
    for (const auto& [type, kernel] : kernels) {
        const WindowConstants measured = Measured(Weights(kernel, 100000)), tabulated = Tabulated(type);
        EXPECT_NEAR(measured.enbw, tabulated.enbw, 2e-7) << type;
        EXPECT_NEAR(measured.coherentGain, tabulated.coherentGain, 1e-8) << type;
    }
}

TEST(WinConstants, LeaveTheRecordOfAnUnlistedType) {
    for (const int32_t type : {-1, 10, 12, 30, 35, 60, 61, 62, INT32_MIN}) {
        EXPECT_EQ(Tabulated(type).enbw, -1.0) << type;
        EXPECT_EQ(Tabulated(type).coherentGain, -2.0) << type;
    }
}

TEST(MeasureWindow, OfOnes) {
    for (const int32_t n : {1, 2, 7, 1000}) {
        const WindowConstants ones = Measured(std::vector<double>(static_cast<std::size_t>(n), 1.0));
        EXPECT_EQ(ones.enbw, 1.0);
        EXPECT_EQ(ones.coherentGain, 1.0);
    }
}

TEST(MeasureWindow, SumsInOrder) {
    const WindowConstants constants = Measured({1e16, 1.0, -1e16, 1.0});
    EXPECT_EQ(constants.coherentGain, 0.25);  // the first 1 is lost
    EXPECT_EQ(constants.enbw, 8e32);
}

TEST(MeasureWindow, OfZerosHasNoBandwidth) {
    const WindowConstants constants = Measured({0.0, 0.0});
    EXPECT_FALSE(std::isfinite(constants.enbw));
    EXPECT_EQ(constants.coherentGain, 0.0);
}

TEST(MeasureWindow, OfNothing) {
    for (const int32_t n : {0, -1}) {
        WindowConstants constants{1.0, 1.0};
        EXPECT_EQ(MeasureWindow(nullptr, n, constants), kEmptyInput);
        EXPECT_THAT(constants.enbw, QuietNaN());
        EXPECT_THAT(constants.coherentGain, QuietNaN());
    }
}

}  // namespace
}  // namespace krnumer

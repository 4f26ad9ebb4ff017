#include "window/generated.h"

#include <gtest/gtest.h>

#include <cmath>
#include <vector>

#include "frame/numeric.h"
#include "support/numbers.h"
#include "window/kernels.h"

namespace krnumer {
namespace {

using ::testing::ElementsAre;

const Kernel kKernels[] = {
    {"bartlett-hanning", [](auto* x, int32_t n) { return BartlettHanningWindow(x, n); }},
    {"bohman", [](auto* x, int32_t n) { return BohmanWindow(x, n); }},
    {"parzen", [](auto* x, int32_t n) { return ParzenWindow(x, n); }},
    {"welch", [](auto* x, int32_t n) { return WelchWindow(x, n); }},
};

TEST(GeneratedWindows, OfTwoSamplesAreZeroAndOne) {
    for (const Kernel& kernel : kKernels) EXPECT_THAT(Weights(kernel.real, 2), ElementsAre(0.0, 1.0)) << kernel.name;
}

TEST(GeneratedWindows, PeakInTheMiddleOfAnEvenLength) {
    for (const Kernel& kernel : kKernels) {
        for (const int32_t n : {4, 6, 100, 4096}) {
            const std::vector<double> w = Weights(kernel.real, n);
            EXPECT_NEAR(w[w.size() / 2], 1.0, 1e-13) << kernel.name << n;
        }
    }
}

TEST(GeneratedWindows, MultiplyTheirZeroSample) {
    for (const Kernel& kernel : kKernels) {
        std::vector<double> x = {kInfinity, 1.0, 1.0};
        EXPECT_EQ(kernel.real(x.data(), 3), 0);
        EXPECT_TRUE(std::isnan(x[0])) << kernel.name;
        x[0] = -1.0;
        EXPECT_EQ(kernel.real(x.data(), 3), 0);
        EXPECT_TRUE(SameBits(x[0], -0.0)) << kernel.name;
    }
}

TEST(GeneratedWindows, TurnWithLittleLossOverManySamples) {
    constexpr int32_t n = 100000;
    const std::vector<double> w = Weights(kKernels[0].real, n), v = Weights(kKernels[1].real, n);
    for (int32_t i = 1; i < n; i += 313) {
        const double t = static_cast<double>(i) / n, u = std::fabs(2.0 * t - 1.0);
        const std::size_t at = static_cast<std::size_t>(i);
        ASSERT_NEAR(w[at], 0.62 - 0.48 * std::fabs(t - 0.5) - 0.38 * std::cos(2.0 * kPi * t), 1e-11);
        ASSERT_NEAR(v[at], (1.0 - u) * std::cos(kPi * u) + std::sin(kPi * u) / kPi, 1e-11);
    }
}

TEST(ParzenWindow, JoinsItsTwoCubicsAtAQuarter) {
    // At d = h/2 both give 1/4; the inner one is taken there.
    const std::vector<double> w = Weights(kKernels[2].real, 8);
    EXPECT_THAT(w, ElementsAre(0.0, 0.03125, 0.25, 0.71875, 1.0, 0.71875, 0.25, 0.03125));
}

TEST(WelchWindow, IsAParabola) {
    EXPECT_THAT(Weights(kKernels[3].real, 4), ElementsAre(0.0, 0.75, 1.0, 0.75));
}

}  // namespace
}  // namespace krnumer

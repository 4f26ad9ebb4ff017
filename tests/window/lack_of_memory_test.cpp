// What windows leave behind when an allocation fails.
#if defined(KRNUMER_REFUSES_ALLOCATIONS)

#include <gtest/gtest.h>

#include <cstdint>
#include <vector>

#include "frame/status.h"
#include "support/numbers.h"
#include "sweep/allocator.h"
#include "window/kernels.h"
#include "window/named.h"

namespace krnumer {
namespace {

using ::testing::Each;

constexpr int32_t kComputedTypes[] = {30, 31, 32, 33, 34, 60, 61, 62};

constexpr WindowConstants kBefore{-7.0, -8.0};

// Runs on nine ones while the nth allocation fails; the status.
template <class Run>
int32_t Refused(int32_t nth, std::vector<double>& x, Run run) {
    x.assign(9, 1.0);
    const sweep::ArmedAllocator refuse(nth);
    return run(x.data(), 9);
}

TEST(LackOfMemory, EndsEveryWindowThatNeedsMemory) {
    for (const Kernel& kernel : AllKernels()) {
        for (int32_t nth = 1;; ++nth) {
            std::vector<double> x;
            const int32_t status = Refused(nth, x, kernel.real);
            EXPECT_EQ(sweep::LiveAllocations(), 0) << kernel.name;
            if (!sweep::ArmedAllocator::refused()) {
                EXPECT_EQ(status, 0) << kernel.name;
                break;
            }
            EXPECT_EQ(status, kOutOfMemory) << kernel.name;
            EXPECT_THAT(x, Each(1.0)) << kernel.name;
        }
    }
}

TEST(LackOfMemory, LeavesTheConstantsWhenItComesFirst) {
    for (const int32_t type : kComputedTypes) {
        std::vector<double> x;
        WindowConstants constants = kBefore;
        const int32_t status =
            Refused(1, x, [&](double* samples, int32_t n) { return ScaledWindow(samples, n, type, 2.0, constants); });
        EXPECT_EQ(status, kOutOfMemory) << type;
        EXPECT_EQ(constants.enbw, kBefore.enbw) << type;
        EXPECT_EQ(constants.coherentGain, kBefore.coherentGain) << type;
        EXPECT_EQ(sweep::LiveAllocations(), 0);
    }
}

TEST(LackOfMemory, LeavesNoConstantsWhenItComesInTheKernel) {
    // the first allocation of a sum of cosines; the second, and third, of weights generated into a temporary
    const std::pair<int32_t, int32_t> refusals[] = {{1, 1},  {8, 1},  {31, 2}, {32, 2},
                                                    {33, 2}, {34, 2}, {61, 2}, {61, 3}};
    for (const auto& [type, nth] : refusals) {
        std::vector<double> x;
        WindowConstants constants = kBefore;
        const int32_t status = Refused(
            nth, x, [&, t = type](double* samples, int32_t n) { return ScaledWindow(samples, n, t, 2.0, constants); });
        EXPECT_EQ(status, kOutOfMemory) << type;
        EXPECT_THAT(constants.enbw, QuietNaN()) << type;
        EXPECT_THAT(constants.coherentGain, QuietNaN()) << type;
        EXPECT_EQ(sweep::LiveAllocations(), 0);
    }
}

TEST(LackOfMemory, EndsSymmetricWindowsBeforeTheirTypeIsLookedAt) {
    for (const int32_t type : {0, 1, 10, 30, 31, 61}) {
        std::vector<double> x;
        const int32_t status =
            Refused(1, x, [=](double* samples, int32_t n) { return SymmetricWindow(samples, n, type, 2.0); });
        EXPECT_EQ(status, kOutOfMemory) << type;
        EXPECT_THAT(x, Each(1.0));
        EXPECT_EQ(sweep::LiveAllocations(), 0);
    }
}

}  // namespace
}  // namespace krnumer

#endif

// What tests can ask of the host: bad placement, moving blocks, limits, failures at a given call, the calls seen.

#include <gtest/gtest-spi.h>

#include <algorithm>

#include "support/host_arrays.h"

#if defined(KRNUMER_ASAN)
#include <sanitizer/asan_interface.h>
#endif

namespace krnumer {
namespace {

using ::testing::Each;
using ::testing::ElementsAre;

int32_t Resize(KrHandle handle, int32_t total) {
    return ResizeNumberBlock(KRRT_DOUBLE, 1, &handle, total);
}

uintptr_t ElementAddress(KrHandle handle) {
    return reinterpret_cast<uintptr_t>(KrrtElements(handle));
}

TEST(LeastAlignment, PutsElementsAtAnOddMultipleOfFour) {
    const LeastAlignment guard;
    const HostArray<double> x{1, 2};
    const HostMatrix<Complex> m(1, 2, {{1, 2}, {3, 4}});
    const HostCube<double> c(1, 1, 2, {1, 2});
    KrHandle const block = MakeBlock(10);
    EXPECT_EQ(ElementAddress(x.handle()) % 8, 4U);
    EXPECT_EQ(ElementAddress(m.handle()) % 8, 4U);
    EXPECT_EQ(ElementAddress(c.handle()) % 8, 4U);
    EXPECT_EQ(ElementAddress(block) % 8, 4U);
    DropBlock(block);

    EXPECT_THAT(x.values(), ElementsAre(1, 2));
    EXPECT_THAT(m.values(), ElementsAre(Complex{1, 2}, Complex{3, 4}));
}

TEST(LeastAlignment, AppliesToEveryResizeInItsScope) {
    const HostArray<double> x{1, 2};
    {
        const LeastAlignment guard;
        for (const int32_t size : {2, 3, 10000, 2}) {
            ASSERT_EQ(Resize(x.handle(), size), KRRT_OK);
            EXPECT_EQ(ElementAddress(x.handle()) % 8, 4U);
            EXPECT_THAT(x.values(), ElementsAre(1, 2));
        }
    }
    ASSERT_EQ(Resize(x.handle(), 2), KRRT_OK);
    EXPECT_EQ(ElementAddress(x.handle()) % 64, 0U);
    EXPECT_THAT(x.values(), ElementsAre(1, 2));
}

TEST(MovingBlocks, MoveEvenToTheSameSize) {
    const LeakCheck leaks;
    const MovingBlocks guard;
    const HostArray<double> x{1, 2};
    for (const int32_t size : {2, 2, 5, 2}) {
        const KrBlock* const before = *x.handle();
        ASSERT_EQ(Resize(x.handle(), size), KRRT_OK);
        EXPECT_NE(*x.handle(), before);
        EXPECT_THAT(x.values(), ElementsAre(1, 2));
    }
}

TEST(MovingBlocks, GainGarbage) {
    const MovingBlocks guard;
    HostArray<double> x{1};
    ASSERT_EQ(Resize(x.handle(), 3), KRRT_OK);
    const auto* const gained = static_cast<const uint8_t*>(KrrtElements(x.handle())) + sizeof(double);
    EXPECT_THAT(std::vector<uint8_t>(gained, gained + 16), Each(KRRT_FRESH_BYTE));
    EXPECT_EQ(x[0], 1);

    KrHandle const block = MakeBlock(8);
    const auto* const bytes = reinterpret_cast<const uint8_t*>(*block);
    EXPECT_THAT(std::vector<uint8_t>(bytes, bytes + 8), Each(KRRT_FRESH_BYTE));
    DropBlock(block);
}

#if defined(KRNUMER_ASAN)

TEST(MovingBlocks, LeaveMemoryThatTheSanitizerForbids) {
    const MovingBlocks guard;
    const HostArray<double> x{1, 2};
    void* const before = KrrtElements(x.handle());
    ASSERT_EQ(Resize(x.handle(), 2), KRRT_OK);
    EXPECT_TRUE(__asan_address_is_poisoned(before));
}

TEST(Blocks, EndWhereTheSanitizerSeesIt) {
    const HostArray<double> x{1, 2};
    auto* const elements = static_cast<char*>(KrrtElements(x.handle()));
    EXPECT_FALSE(__asan_address_is_poisoned(elements + 15));
    EXPECT_TRUE(__asan_address_is_poisoned(elements + 16));
    EXPECT_TRUE(__asan_address_is_poisoned(elements - 9));
    ASSERT_EQ(Resize(x.handle(), 1), KRRT_OK);
    EXPECT_TRUE(__asan_address_is_poisoned(elements + 8)) << "memory kept in reserve";
}

#else

TEST(MovingBlocks, LeavePoisonBehind) {
    const MovingBlocks guard;
    const HostArray<double> x{1, 2};
    const auto* const before = static_cast<const uint8_t*>(KrrtElements(x.handle()));
    ASSERT_EQ(Resize(x.handle(), 2), KRRT_OK);
    EXPECT_THAT(std::vector<uint8_t>(before, before + 16), Each(KRRT_STALE_BYTE));
}

// The last byte of a block is written through a pointer that a resize has made stale.
void WriteStale() {
    const HostArray<double> x{1, 2};
    auto* const before = static_cast<uint8_t*>(KrrtElements(x.handle()));
    Resize(x.handle(), 4);
    before[15] = 0;
}

TEST(MovingBlocks, NoticeWritesToWhatTheyLeft) {
    const int64_t writes = KrrtStaleWrites();
    EXPECT_NONFATAL_FAILURE(
        {
            const MovingBlocks guard;
            WriteStale();
        },
        "stale");
    EXPECT_EQ(KrrtStaleWrites(), writes + 1);
}

#endif

TEST(BlockLimit, CountsDimensionWords) {
    const BlockLimit guard(84);
    const HostArray<double> x(10);
    EXPECT_EQ(KrrtNewArray(KRRT_DOUBLE, 11), nullptr);
    EXPECT_EQ(Resize(x.handle(), 11), KRRT_OUT_OF_MEMORY);
    EXPECT_EQ(Resize(x.handle(), 10), KRRT_OK);
}

TEST(BlockLimit, NeverRefusesALesserSize) {
    const HostArray<double> x(1000);
    const BlockLimit guard(10);
    const MovingBlocks moving;
    EXPECT_EQ(Resize(x.handle(), 1000), KRRT_OK);
    EXPECT_EQ(Resize(x.handle(), 900), KRRT_OK);
    EXPECT_EQ(Resize(x.handle(), 901), KRRT_OUT_OF_MEMORY);
}

TEST(Settings, ReturnTheFormerOnesAndAreOffByDefault) {
    EXPECT_EQ(KrrtLeastAlignment(1), 0);
    EXPECT_EQ(KrrtLeastAlignment(0), 1);
    EXPECT_EQ(KrrtMovingBlocks(1), 0);
    EXPECT_EQ(KrrtMovingBlocks(0), 1);
    EXPECT_EQ(KrrtBlockLimit(5), 0U);
    EXPECT_EQ(KrrtBlockLimit(0), 5U);
    EXPECT_EQ(KrrtBlockLimit(0), 0U);
}

TEST(FailResize, FailsTheNthSizingOnce) {
    const HostArray<double> x{1};
    const FailResize failure(2, -777);
    EXPECT_EQ(Resize(x.handle(), 10), KRRT_OK);
    EXPECT_EQ(Resize(x.handle(), 0), KRRT_OK) << "emptying does not count";
    EXPECT_FALSE(failure.happened());
    EXPECT_EQ(Resize(x.handle(), 20), -777);
    EXPECT_TRUE(failure.happened());
    EXPECT_EQ(KrrtBytes(x.handle()), 4U) << "a failed resize changes nothing";
    EXPECT_EQ(Resize(x.handle(), 20), KRRT_OK);
}

TEST(FailResize, CountsEveryResizeIfAsked) {
    const HostArray<double> x{1};
    const FailResize failure(2, 42, KRRT_RESIZES);
    EXPECT_EQ(Resize(x.handle(), 10), KRRT_OK);
    EXPECT_EQ(Resize(x.handle(), 0), 42);
    EXPECT_EQ(Resize(x.handle(), 0), KRRT_OK);
}

TEST(FailResize, CountsRefusedCallsToo) {
    const HostArray<double> x{1};
    const FailResize failure(2, 42, KRRT_RESIZES);
    EXPECT_EQ(Resize(x.handle(), -1), KRRT_BAD_ARGUMENT);
    EXPECT_EQ(Resize(x.handle(), 1), 42);
}

TEST(FailResize, EndsWithItsScope) {
    const HostArray<double> x{1};
    { const FailResize failure; }
    EXPECT_EQ(Resize(x.handle(), 10), KRRT_OK);
}

TEST(FailBlock, FailsTheNthBlockCall) {
    const LeakCheck leaks;
    {
        const FailBlock failure;
        EXPECT_EQ(MakeBlock(10), nullptr);
        EXPECT_TRUE(failure.happened());
    }
    const FailBlock failure(2, -9);
    KrHandle const block = MakeBlock(10);
    ASSERT_NE(block, nullptr);
    EXPECT_EQ(SizeBlock(block, 20), -9);
    EXPECT_EQ(KrrtBytes(block), 10U);
    EXPECT_EQ(SizeBlock(block, 20), KRRT_OK);
    DropBlock(block);
}

TEST(Failures, OfTheThreeCountsAreIndependent) {
    const HostArray<double> x{1};
    const FailResize of_all(1, 11, KRRT_RESIZES);
    const FailResize of_sizings(2, 22, KRRT_SIZINGS);
    const FailBlock of_blocks(1);
    EXPECT_EQ(Resize(x.handle(), 5), 11);
    EXPECT_EQ(KrrtFailurePending(KRRT_SIZINGS), 1) << "the failed call was a sizing as well";
    EXPECT_EQ(Resize(x.handle(), 5), 22);
    EXPECT_EQ(KrrtFailurePending(KRRT_BLOCKS), 1);
}

TEST(Failures, AreTakenBack) {
    const HostArray<double> x{1};
    KrrtFail(KRRT_SIZINGS, 1, 5);
    KrrtFail(KRRT_SIZINGS, 0, 5);
    EXPECT_EQ(Resize(x.handle(), 5), KRRT_OK);
    KrrtFail(KRRT_SIZINGS, 1, 0);
    EXPECT_EQ(KrrtFailurePending(KRRT_SIZINGS), 0) << "no failure has status 0";
    for (const int32_t unknown : {-1, 3}) {
        KrrtFail(unknown, 1, 5);
        EXPECT_EQ(KrrtFailurePending(unknown), 0);
    }
}

TEST(ResizeLog, TellsTheCallsInOrder) {
    const HostArray<double> x{1};
    const HostMatrix<Complex> m;
    KrHandle handle = m.handle();
    const ResizeLog log;
    EXPECT_EQ(log.size(), 0);
    Resize(x.handle(), 7);
    ResizeNumberBlock(KRRT_COMPLEX, 2, &handle, 6);
    ResizeNumberBlock(KRRT_COMPLEX, 1, nullptr, 5);
    KrrtFail(KRRT_RESIZES, 1, 99);
    Resize(x.handle(), 0);

    ASSERT_EQ(log.size(), 4);
    const auto call = [&log](int32_t i) {
        return std::tuple(log[i].typeCode, log[i].numDims, log[i].totalElements, log[i].status, log[i].handle);
    };
    EXPECT_EQ(call(0), std::tuple(KRRT_DOUBLE, 1, 7, KRRT_OK, x.handle()));
    EXPECT_EQ(call(1), std::tuple(KRRT_COMPLEX, 2, 6, KRRT_OK, m.handle()));
    EXPECT_EQ(call(2), std::tuple(KRRT_COMPLEX, 1, 5, KRRT_BAD_ARGUMENT, KrHandle{nullptr}));
    EXPECT_EQ(call(3), std::tuple(KRRT_DOUBLE, 1, 0, 99, x.handle()));
    EXPECT_THROW(log[4], std::out_of_range);
    EXPECT_THROW(log[-1], std::out_of_range);
}

TEST(ResizeLog, KeepsTheLast64Calls) {
    const HostArray<double> x;
    const ResizeLog log;
    for (int32_t i = 0; i < 100; ++i) Resize(x.handle(), i);
    EXPECT_EQ(log.size(), 100);
    EXPECT_THROW(log[35], std::out_of_range);
    EXPECT_EQ(log[36].totalElements, 36);
    EXPECT_EQ(log[99].totalElements, 99);
    KrrtForgetResizes();
    EXPECT_EQ(log.size(), 0);
    EXPECT_THROW(log[0], std::out_of_range);
    EXPECT_EQ(KrrtResizeCall(0, nullptr), 0);
}

TEST(LeakCheck, FailsTheTestThatLeaks) {
    static KrHandle leaked;
    EXPECT_NONFATAL_FAILURE(
        {
            const LeakCheck leaks;
            leaked = KrrtNewArray(KRRT_DOUBLE, 1);
        },
        "not freed");
    KrrtFree(leaked);
}

}  // namespace
}  // namespace krnumer

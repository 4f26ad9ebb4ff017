// The five services as krnumer calls them.

#include <numeric>

#include "support/host_arrays.h"

namespace krnumer {
namespace {

using ::testing::ElementsAre;

int32_t Resize(int32_t type_code, int32_t rank, KrHandle handle, int32_t total) {
    const KrHandle before = handle;
    const int32_t status = ResizeNumberBlock(type_code, rank, &handle, total);
    EXPECT_EQ(handle, before) << "a handle is for life";
    return status;
}

std::vector<int32_t> Counting(int32_t n) {
    std::vector<int32_t> values(static_cast<std::size_t>(n));
    std::iota(values.begin(), values.end(), 1);
    return values;
}

TEST(ResizeNumberBlock, MakesRoomForWordsAndElements) {
    const LeakCheck leaks;
    const HostArray<double> x;
    const HostMatrix<Complex> m;
    EXPECT_EQ(Resize(KRRT_DOUBLE, 1, x.handle(), 10), KRRT_OK);
    EXPECT_EQ(KrrtBytes(x.handle()), 84U);
    EXPECT_EQ(Resize(KRRT_COMPLEX, 2, m.handle(), 6), KRRT_OK);
    EXPECT_EQ(KrrtBytes(m.handle()), 104U);
}

TEST(ResizeNumberBlock, LeavesDimensionWordsToTheCaller) {
    const HostArray<double> x{1, 2, 3};
    EXPECT_EQ(Resize(KRRT_DOUBLE, 1, x.handle(), 1000), KRRT_OK);
    EXPECT_EQ(x.size(), 3);
    EXPECT_EQ(Resize(KRRT_DOUBLE, 1, x.handle(), 0), KRRT_OK);
    EXPECT_EQ(x.size(), 3);
}

TEST(ResizeNumberBlock, KeepsContentsUpToTheLesserSize) {
    HostArray<int32_t> x(Counting(5));
    for (const int32_t size : {50, 5000, 500000, 7000, 600}) {
        ASSERT_EQ(Resize(KRRT_INT32, 1, x.handle(), size), KRRT_OK);
        EXPECT_THAT(x.values(), ElementsAre(1, 2, 3, 4, 5)) << "resized to " << size;
    }
    ASSERT_EQ(Resize(KRRT_INT32, 1, x.handle(), 2), KRRT_OK);
    x.SetDimension(0, 2);
    EXPECT_THAT(x.values(), ElementsAre(1, 2));
}

TEST(ResizeNumberBlock, KeepsLongContentsWhileShrinking) {
    HostArray<int32_t> x(Counting(100000));
    ASSERT_EQ(Resize(KRRT_INT32, 1, x.handle(), 3000), KRRT_OK);
    x.SetDimension(0, 3000);
    EXPECT_EQ(x.values(), Counting(3000));
}

TEST(ResizeNumberBlock, KeepsElementsAtTheirBoundary) {
    const HostArray<double> x;
    const HostMatrix<double> m;
    const auto misplaced = [](KrHandle handle) { return reinterpret_cast<uintptr_t>(KrrtElements(handle)) % 64; };
    for (const int32_t size : {1, 100, 10000, 2, 0}) {
        ASSERT_EQ(Resize(KRRT_DOUBLE, 1, x.handle(), size), KRRT_OK);
        EXPECT_EQ(misplaced(x.handle()), 0U);
        ASSERT_EQ(Resize(KRRT_DOUBLE, 2, m.handle(), size), KRRT_OK);
        EXPECT_EQ(misplaced(m.handle()), 0U);
    }
}

// Libraries empty arrays by a type code at hand, and reserve room for small elements by the code of large ones.
TEST(ResizeNumberBlock, TakesAnyTypeCodeOnAnyArray) {
    HostArray<double> x{1, 2, 3};
    EXPECT_EQ(Resize(KRRT_UINT8, 1, x.handle(), 24), KRRT_OK);
    EXPECT_THAT(x.values(), ElementsAre(1, 2, 3));
    EXPECT_EQ(Resize(KRRT_COMPLEX, 1, x.handle(), 0), KRRT_OK);
    x.SetDimension(0, 0);
    EXPECT_TRUE(x.empty());
}

TEST(ResizeNumberBlock, RefusesWhatHasNoMeaning) {
    const HostArray<double> x{1, 2, 3};
    EXPECT_EQ(Resize(KRRT_DOUBLE, 1, x.handle(), -1), KRRT_BAD_ARGUMENT);
    EXPECT_EQ(Resize(KRRT_DOUBLE, 1, x.handle(), INT32_MIN), KRRT_BAD_ARGUMENT);
    EXPECT_EQ(Resize(KRRT_DOUBLE, 0, x.handle(), 1), KRRT_BAD_ARGUMENT);
    EXPECT_EQ(Resize(KRRT_DOUBLE, 3, x.handle(), 1), KRRT_BAD_ARGUMENT);
    EXPECT_EQ(Resize(0, 1, x.handle(), 1), KRRT_BAD_ARGUMENT);
    EXPECT_EQ(Resize(11, 1, x.handle(), 1), KRRT_BAD_ARGUMENT);
    EXPECT_EQ(Resize(KRRT_DOUBLE, 1, nullptr, 1), KRRT_BAD_ARGUMENT);
    EXPECT_EQ(ResizeNumberBlock(KRRT_DOUBLE, 1, nullptr, 1), KRRT_BAD_ARGUMENT);
    EXPECT_THAT(x.values(), ElementsAre(1, 2, 3));
}

TEST(ResizeNumberBlock, LeavesTheArrayAloneWhenThereIsNoMemory) {
    const BlockLimit limit(1 << 20);
    const HostArray<double> x{1, 2, 3};
    EXPECT_EQ(Resize(KRRT_COMPLEX, 1, x.handle(), INT32_MAX), KRRT_OUT_OF_MEMORY);
    EXPECT_EQ(KrrtBytes(x.handle()), 28U);
    EXPECT_THAT(x.values(), ElementsAre(1, 2, 3));
}

TEST(ByteBlocks, AreMadeSizedAndDropped) {
    const LeakCheck leaks;
    KrHandle const block = MakeBlock(100);
    ASSERT_NE(block, nullptr);
    EXPECT_EQ(KrrtLiveBlocks(), leaks.live_before() + 1);
    EXPECT_EQ(KrrtRank(block), 0);
    EXPECT_EQ(KrrtBytes(block), 100U);
    EXPECT_EQ(KrrtElements(block), *block);
    EXPECT_EQ(reinterpret_cast<uintptr_t>(*block) % 64, 0U);
    std::memset(*block, 'x', 100);

    for (const int32_t bytes : {100000, 50}) {
        ASSERT_EQ(SizeBlock(block, bytes), KRRT_OK);
        EXPECT_EQ(KrrtBytes(block), static_cast<uint64_t>(bytes));
        EXPECT_EQ(std::string(reinterpret_cast<const char*>(*block), 50), std::string(50, 'x'));
    }
    DropBlock(block);
}

TEST(ByteBlocks, MayBeEmpty) {
    const LeakCheck leaks;
    KrHandle const block = MakeBlock(0);
    ASSERT_NE(block, nullptr);
    EXPECT_NE(*block, nullptr);
    EXPECT_EQ(SizeBlock(block, 10), KRRT_OK);
    EXPECT_EQ(SizeBlock(block, 0), KRRT_OK);
    EXPECT_NE(*block, nullptr);
    DropBlock(block);
}

TEST(ByteBlocks, RefuseWhatHasNoMeaning) {
    const LeakCheck leaks;
    EXPECT_EQ(MakeBlock(-1), nullptr);
    EXPECT_EQ(SizeBlock(nullptr, 10), KRRT_BAD_ARGUMENT);
    DropBlock(nullptr);

    KrHandle const block = MakeBlock(10);
    EXPECT_EQ(SizeBlock(block, -1), KRRT_BAD_ARGUMENT);
    EXPECT_EQ(KrrtBytes(block), 10U);
    DropBlock(block);
}

TEST(ByteBlocks, AreRefusedWithoutMemory) {
    const LeakCheck leaks;
    const BlockLimit limit(1000);
    EXPECT_EQ(MakeBlock(1001), nullptr);
    KrHandle const block = MakeBlock(1000);
    ASSERT_NE(block, nullptr);
    EXPECT_EQ(SizeBlock(block, 1001), KRRT_OUT_OF_MEMORY);
    EXPECT_EQ(KrrtBytes(block), 1000U);
    DropBlock(block);
}

}  // namespace
}  // namespace krnumer

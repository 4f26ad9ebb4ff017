// Arrays as a program creates and reads them: layout, placement, refusals.

#include <cstdint>

#include "support/host_arrays.h"

namespace krnumer {
namespace {

using ::testing::Each;
using ::testing::ElementsAre;

struct Kind {
    int32_t type_code;
    uint64_t bytes;
};

class ArraysOfKind : public ::testing::TestWithParam<Kind> {};

INSTANTIATE_TEST_SUITE_P(AllKinds, ArraysOfKind,
                         ::testing::Values(Kind{KRRT_INT32, 4}, Kind{KRRT_UINT8, 1}, Kind{KRRT_UINT32, 4},
                                           Kind{KRRT_DOUBLE, 8}, Kind{KRRT_COMPLEX, 16}));

const char* BlockOf(KrHandle handle) {
    return reinterpret_cast<const char*>(*handle);
}

uintptr_t Address(const void* pointer) {
    return reinterpret_cast<uintptr_t>(pointer);
}

// Dimension words first, then zeros from the next byte on, nothing else.
void ExpectZerosBehind(KrHandle handle, std::vector<int32_t> sizes, uint64_t element_bytes) {
    ASSERT_NE(handle, nullptr);
    ASSERT_EQ(KrrtRank(handle), static_cast<int32_t>(sizes.size()));
    uint64_t bytes = element_bytes;
    for (std::size_t i = 0; i < sizes.size(); ++i) {
        int32_t word;
        std::memcpy(&word, BlockOf(handle) + 4 * i, 4);
        EXPECT_EQ(word, sizes[i]);
        EXPECT_EQ(KrrtSize(handle, static_cast<int32_t>(i)), sizes[i]);
        bytes *= static_cast<uint64_t>(sizes[i]);
    }
    const char* const elements = BlockOf(handle) + 4 * sizes.size();
    EXPECT_EQ(KrrtElements(handle), elements);
    EXPECT_EQ(Address(elements) % 64, 0U);
    ASSERT_EQ(KrrtBytes(handle), 4 * sizes.size() + bytes);
    EXPECT_THAT(std::vector<char>(elements, elements + bytes), Each(0));
    KrrtFree(handle);
}

TEST_P(ArraysOfKind, StartAsZerosBehindTheirDimensionWords) {
    const auto [type_code, bytes] = GetParam();
    ExpectZerosBehind(KrrtNewArray(type_code, 7), {7}, bytes);
    ExpectZerosBehind(KrrtNewMatrix(type_code, 3, 5), {3, 5}, bytes);
    ExpectZerosBehind(KrrtNewCube(type_code, 2, 3, 4), {2, 3, 4}, bytes);
}

TEST_P(ArraysOfKind, HaveABlockEvenWhenEmpty) {
    const auto [type_code, bytes] = GetParam();
    ExpectZerosBehind(KrrtNewArray(type_code, 0), {0}, bytes);
    ExpectZerosBehind(KrrtNewMatrix(type_code, 0, 0), {0, 0}, bytes);
    ExpectZerosBehind(KrrtNewCube(type_code, 0, 0, 0), {0, 0, 0}, bytes);
    ExpectZerosBehind(KrrtNewMatrix(type_code, 0, 5), {0, 5}, bytes);
}

TEST(Arrays, OfRecordsArePacked) {
    ExpectZerosBehind(KrrtNewRecords(20, 3), {3}, 20);
}

TEST(Arrays, AreRefusedWithNothingHeld) {
    const LeakCheck leaks;
    for (const int32_t unknown : {-1, 0, 1, 4, 6, 8, 9, 11, 12, 14}) EXPECT_EQ(KrrtNewArray(unknown, 1), nullptr);
    EXPECT_EQ(KrrtNewArray(KRRT_DOUBLE, -1), nullptr);
    EXPECT_EQ(KrrtNewMatrix(KRRT_DOUBLE, -1, 0), nullptr);
    EXPECT_EQ(KrrtNewMatrix(KRRT_DOUBLE, 0, -1), nullptr);
    EXPECT_EQ(KrrtNewCube(KRRT_DOUBLE, 1, 1, INT32_MIN), nullptr);
    EXPECT_EQ(KrrtNewRecords(0, 1), nullptr);
    EXPECT_EQ(KrrtNewRecords(-4, 1), nullptr);
    EXPECT_EQ(KrrtNewRecords(4, -1), nullptr);
}

TEST(Arrays, BeyondAllMemoryAreRefused) {
    const LeakCheck leaks;
    EXPECT_EQ(KrrtNewMatrix(KRRT_UINT8, INT32_MAX, INT32_MAX), nullptr);  // 2^62 bytes
    EXPECT_EQ(KrrtNewMatrix(KRRT_COMPLEX, INT32_MAX, INT32_MAX), nullptr);
    EXPECT_EQ(KrrtNewCube(KRRT_COMPLEX, INT32_MAX, INT32_MAX, INT32_MAX), nullptr);
    EXPECT_EQ(KrrtNewCube(KRRT_UINT8, 1 << 22, 1 << 21, 1 << 21), nullptr);  // 2^64 bytes
}

TEST(Arrays, OfOneEmptyDimensionHoldNothingHoweverLongTheOthers) {
    KrHandle const empty = KrrtNewCube(KRRT_COMPLEX, INT32_MAX, INT32_MAX, 0);
    ASSERT_NE(empty, nullptr);
    EXPECT_EQ(KrrtBytes(empty), 12U);
    KrrtFree(empty);
}

TEST(Arrays, AnswerForANullHandle) {
    EXPECT_EQ(KrrtRank(nullptr), 0);
    EXPECT_EQ(KrrtSize(nullptr, 0), 0);
    EXPECT_EQ(KrrtElements(nullptr), nullptr);
    EXPECT_EQ(KrrtBytes(nullptr), 0U);
    KrrtSetSize(nullptr, 0, 1);
    KrrtFree(nullptr);
}

TEST(Arrays, HaveNoDimensionBeyondTheirRank) {
    const HostArray<int32_t> x{1, 2, 3};
    EXPECT_EQ(KrrtSize(x.handle(), -1), 0);
    EXPECT_EQ(KrrtSize(x.handle(), 1), 0);
    KrrtSetSize(x.handle(), 1, 99);
    EXPECT_THAT(x.values(), ElementsAre(1, 2, 3));
}

TEST(Arrays, TakeMalformedDimensionWords) {
    HostArray<double> x{1, 2};
    x.SetDimension(0, -5);
    EXPECT_EQ(x.size(), -5);
    EXPECT_EQ(KrrtBytes(x.handle()), 20U);
}

}  // namespace
}  // namespace krnumer

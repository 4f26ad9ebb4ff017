#include "frame/scratch.h"

#include <gtest/gtest.h>

#include <algorithm>

namespace krnumer {
namespace {

TEST(Scratch, HoldsWhatWasAskedFor) {
    Scratch<double> numbers(3, Scratch<double>::kZeroed);
    ASSERT_TRUE(numbers);
    EXPECT_EQ(numbers[2], 0.0);
    numbers[1] = 5.0;
    ASSERT_TRUE(numbers.Grow(1000));
    EXPECT_EQ(numbers[1], 5.0);
}

TEST(Scratch, HoldsMoreThanAHugePage) {
    constexpr std::size_t kCount = (std::size_t{5} << 20) / sizeof(double) + 1;
    for (int round = 0; round < 3; ++round) {  // the later ones in memory that was written to
        Scratch<double> numbers(kCount, Scratch<double>::kZeroed);
        ASSERT_TRUE(numbers);
        EXPECT_EQ(std::count(numbers.data(), numbers.data() + kCount, 0.0), kCount);
        std::fill_n(numbers.data(), kCount, 7.0);
        ASSERT_TRUE(numbers.Grow(2 * kCount));
        EXPECT_EQ(std::count(numbers.data(), numbers.data() + kCount, 7.0), kCount);
        numbers[2 * kCount - 1] = 1.0;
    }
}

TEST(Scratch, IsNoFailureWithoutElements) {
    EXPECT_TRUE(Scratch<double>(0));
}

TEST(Scratch, FailsWhereTheBytesCannotBeCounted) {
    EXPECT_FALSE(Scratch<double>(SIZE_MAX / 8 + 2));
    Scratch<double> kept(1);
    kept[0] = 7.0;
    EXPECT_FALSE(kept.Grow(SIZE_MAX / 4));
    EXPECT_EQ(kept[0], 7.0);
}

TEST(Scratch, MovesItsElements) {
    Scratch<int> first(1);
    first[0] = 9;
    Scratch<int> second = std::move(first);
    EXPECT_FALSE(first);  // NOLINT(bugprone-use-after-move)
    EXPECT_EQ(second[0], 9);
}

}  // namespace
}  // namespace krnumer

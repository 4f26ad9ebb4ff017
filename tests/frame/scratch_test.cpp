#include "frame/scratch.h"

#include <gtest/gtest.h>

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

#include "frame/complex.h"

#include <gtest/gtest.h>

#include "frame/numeric.h"

namespace krnumer {
namespace {

TEST(Complex, MultipliesPlainly) {
    EXPECT_EQ((Complex{1, 2} * Complex{3, -4}), (Complex{11, 2}));
    const Complex infinite = Complex{kInfinity, 0} * Complex{0, 1};
    EXPECT_TRUE(infinite.re != infinite.re) << "no part is repaired: 0 times infinity is NaN";
}

TEST(Complex, DividesBySmithsRule) {
    EXPECT_EQ((Complex{11, 2} / Complex{3, -4}), (Complex{1, 2}));
    EXPECT_EQ((Complex{4, 2} / Complex{0, 2}), (Complex{1, -2}));
    EXPECT_EQ((Complex{1e300, 1e300} / Complex{1e300, 1e300}), (Complex{1, 0})) << "squares would overflow";
    EXPECT_EQ((Complex{1e-300, 0} / Complex{1e-300, 0}), (Complex{1, 0})) << "squares would vanish";
    const Complex by_zero = Complex{1, 0} / Complex{0, 0};
    EXPECT_TRUE(by_zero.re != by_zero.re && by_zero.im != by_zero.im);
}

TEST(Complex, HasAnUnscaledModulus) {
    EXPECT_EQ(Modulus({3, -4}), 5.0);
    EXPECT_EQ(Modulus({1e200, 0}), kInfinity);
}

TEST(Complex, CombinesWithReals) {
    EXPECT_EQ((2.0 * Complex{1, -3}), (Complex{2, -6}));
    EXPECT_EQ((Complex{1, -3} / 2.0), (Complex{0.5, -1.5}));
    EXPECT_EQ(Conjugate({1, -3}), (Complex{1, 3}));
    EXPECT_EQ(-(Complex{1, -3}), (Complex{-1, 3}));
}

}  // namespace
}  // namespace krnumer

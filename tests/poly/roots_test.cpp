// Roots of polynomials without guesses, through their exports.

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cmath>
#include <random>

#include "frame/numeric.h"
#include "frame/status.h"
#include "krnumer/polynomial.h"
#include "support/host_arrays.h"

namespace krnumer {
namespace {

using testing::ElementsAre;
using ComplexValues = std::vector<Complex>;

// Coefficients from the constant up, the highest one 1.
ComplexValues Product(const ComplexValues& roots) {
    ComplexValues c{{1, 0}};
    for (const Complex root : roots) {
        c.insert(c.begin(), Complex{});
        for (std::size_t k = 0; k + 1 < c.size(); ++k) c[k] -= root * c[k + 1];
    }
    return c;
}

// The distance to the nearest of the values.
double Distance(Complex z, const ComplexValues& values) {
    double nearest = kInfinity;
    for (const Complex value : values) nearest = std::min(nearest, Modulus(z - value));
    return nearest;
}

// ---- By Newton's method and deflation ----

class ComplexRoots : public testing::Test {
  protected:
    LeakCheck leaks_;

    int32_t Find(const ComplexValues& coef, int32_t limit = 20) {
        HostArray<Complex> array(coef);
        int32_t err = 77;
        EXPECT_EQ(CxPolyRoots_head(array.handle(), &limit, &err), 0);
        roots_ = array.values();
        return err;
    }

    ComplexValues roots_;
};

TEST_F(ComplexRoots, SolveLowDegreesDirectly) {
    ASSERT_EQ(Find({{-6, 2}, {2, 0}}), 0);
    EXPECT_THAT(roots_, ElementsAre(Complex{3, -1}));
    ASSERT_EQ(Find({{1, 0}, {1e9, 0}, {1, 0}}), 0);
    EXPECT_THAT(roots_, AllNear(ComplexValues{{-1e9, 0}, {-1e-9, 0}}, 1e-15, 0.0)) << "no cancellation";
    ASSERT_EQ(Find({{2e200, 0}, {-3e200, 0}, {1e200, 0}}), 0);
    EXPECT_THAT(roots_, AllNear(ComplexValues{{2, 0}, {1, 0}}, 1e-15, 0.0)) << "no overflow";
}

TEST_F(ComplexRoots, FindWhatAPolynomialWasMadeOf) {
    const ComplexValues expected{{1, 1}, {-2, 0.5}, {0.25, -3}, {4, 0}, {-1, -1}, {0, 2}, {3, -2}};
    ASSERT_EQ(Find(Product(expected)), 0);
    ASSERT_EQ(roots_.size(), expected.size());
    for (const Complex root : expected) EXPECT_LT(Distance(root, roots_), 1e-12);
}

TEST_F(ComplexRoots, FindRootsOfUnity) {
    ComplexValues c(13);
    c[0] = {-1, 0};
    c[12] = {1, 0};
    ASSERT_EQ(Find(c), 0);
    for (int32_t k = 0; k < 12; ++k) EXPECT_LT(Distance({std::cos(kPi * k / 6), std::sin(kPi * k / 6)}, roots_), 1e-14);
}

TEST_F(ComplexRoots, FindRootsOfManyPolynomials) {
    std::mt19937 random(4);
    std::normal_distribution<double> normal;
    for (int32_t i = 0; i < 400; ++i) {
        ComplexValues coef(static_cast<std::size_t>(4 + i % 13));
        for (Complex& c : coef) c = {normal(random), normal(random)};
        ASSERT_EQ(Find(coef), 0) << i;
        // Built up again from its roots.
        const ComplexValues again = Product(roots_);
        for (std::size_t k = 0; k < coef.size(); ++k)
            EXPECT_LT(Modulus(again[k] * coef.back() - coef[k]), 1e-11) << i << ": " << k;
    }
}

TEST_F(ComplexRoots, FindCloseAndMultipleRoots) {
    const ComplexValues expected{{1, 0}, {1, 0}, {1, 0}, {-2, 1}, {-2, 1}, {3, 0}};
    ASSERT_EQ(Find(Product(expected)), 0);
    for (const Complex root : roots_) EXPECT_LT(Distance(root, expected), 1e-4);
}

TEST_F(ComplexRoots, FindWideRanges) {
    ASSERT_EQ(Find({{1e-200, 0}, {1, 0}, {0, 0}, {1e-150, 0}}), 0);
    ASSERT_EQ(roots_.size(), 3U);
    EXPECT_NEAR(roots_[0].re / -1e-200, 1.0, 1e-14);
    EXPECT_NEAR(Modulus(roots_[1]) / 1e75, 1.0, 1e-12);
}

TEST_F(ComplexRoots, PutZerosFirst) {
    ASSERT_EQ(Find({{0, 0}, {0, 0}, {-6, 0}, {2, 0}}), 0);
    EXPECT_THAT(roots_, ElementsAre(Complex{0, 0}, Complex{0, 0}, Complex{3, 0}));
    ASSERT_EQ(Find({{0, 0}, {0, 0}, {0, 0}, {5, 1}}), 0);
    EXPECT_THAT(roots_, ElementsAre(Complex{0, 0}, Complex{0, 0}, Complex{0, 0}));
}

TEST_F(ComplexRoots, KeepTheSizeWhereHighCoefficientsVanish) {
    ASSERT_EQ(Find({{-6, 0}, {2, 0}, {0, 0}, {0, 0}}), 0);
    ASSERT_EQ(roots_.size(), 3U);
    EXPECT_EQ(roots_[0], (Complex{3, 0}));
}

TEST_F(ComplexRoots, RefuseWhatHasNoRoots) {
    EXPECT_EQ(Find({}), kEmptyInput);
    for (const double bad : {kQuietNaN, kInfinity, -kInfinity}) {
        EXPECT_EQ(Find({{1, 0}, {2, bad}}), kBadCoefficient);
        EXPECT_TRUE(roots_.empty());
    }
    EXPECT_EQ(Find({{5, 0}}), kBadCoefficient);
    EXPECT_EQ(Find({{5, 0}, {0, 0}}), kBadCoefficient);
    EXPECT_EQ(Find({{0, 0}, {0, 0}}), kBadCoefficient);
    EXPECT_TRUE(roots_.empty());
}

}  // namespace
}  // namespace krnumer

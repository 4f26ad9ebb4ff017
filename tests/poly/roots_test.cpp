// Roots of polynomials without guesses, through their exports.

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
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

TEST_F(ComplexRoots, FindRootsAcrossTheRangeOfDoubles) {
    // Newton's polygon has a corner at every coefficient: each root is close to minus the quotient of two neighbours.
    for (const ComplexValues& coef : {ComplexValues{{1e300, 0}, {0, 1e150}, {-1e-100, 0}},
                                      ComplexValues{{1e-300, 0}, {1e-100, 1e-100}, {1e50, 0}, {1e150, 0}, {0, 1e200}},
                                      ComplexValues{{1e-320, 0}, {1e-100, 0}, {1e100, 0}, {1e290, 1e290}},
                                      ComplexValues{{1e308, 0}, {1e120, 0}, {-1e-90, 0}, {1e-320, 0}}}) {
        ASSERT_EQ(Find(coef), 0);
        for (std::size_t k = 0; k < roots_.size(); ++k) {
            const Complex expected = -coef[k] / coef[k + 1];
            const Complex nearest = *std::min_element(roots_.begin(), roots_.end(), [&](Complex a, Complex b) {
                return Modulus((a - expected) / expected) < Modulus((b - expected) / expected);
            });
            EXPECT_LT(Modulus(nearest / expected - Complex{1, 0}), 1e-3) << expected.re << ' ' << expected.im;
        }
    }
}

TEST_F(ComplexRoots, AreNotFoundBeyondTheRangeOfDoubles) {
    for (const ComplexValues& coef :
         {ComplexValues{{1e300, 0}, {1e-300, 0}}, ComplexValues{{1, 0}, {1e300, 0}, {1e-300, 0}},
          ComplexValues{{1, 0}, {2, 0}, {3, 0}, {4, 0}, {1e-320, 0}}}) {
        EXPECT_EQ(Find(coef), kNoConvergence);
        EXPECT_TRUE(roots_.empty());
    }
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

// ---- With multiplicities ----

class MultipleRoots : public testing::Test {
  protected:
    LeakCheck leaks_;

    int32_t Find(const std::vector<double>& coef, int32_t distinct = 1, double tol = 0.0) {
        return Run(coef, distinct, tol, MultPolyRoots_head);
    }
    int32_t FindComplex(const ComplexValues& coef, int32_t distinct = 1, double tol = 0.0) {
        return Run(coef, distinct, tol, CxMultPolyRoots_head);
    }
    void ExpectRefined(const ComplexValues& expected, const std::vector<int32_t>& multiplicities, double tolerance) {
        EXPECT_THAT(distinct_, AllNear(expected, tolerance, 0.0));
        EXPECT_EQ(mult_, multiplicities);
        EXPECT_EQ(roots_.size(), expected.size());
    }

    ComplexValues roots_;
    ComplexValues distinct_;
    std::vector<int32_t> mult_;
    bool coef_kept_ = false;

  private:
    template <class T, class Export>
    int32_t Run(const std::vector<T>& coef, int32_t distinct, double tol, Export run) {
        HostArray<T> array(coef);
        HostArray<Complex> roots{{9, 9}};
        HostArray<Complex> distinct_roots{{9, 9}};
        HostArray<int32_t> mult{9};
        const int32_t status =
            run(array.handle(), distinct, tol, roots.handle(), distinct_roots.handle(), mult.handle());
        roots_ = roots.values();
        distinct_ = distinct_roots.values();
        mult_ = mult.values();
        coef_kept_ = array.size() == static_cast<int32_t>(coef.size()) && !coef.empty();
        return status;
    }
};

std::vector<double> RealProduct(const ComplexValues& roots) {
    std::vector<double> c;
    for (const Complex value : Product(roots)) c.push_back(value.re);
    return c;
}

ComplexValues Repeated(const ComplexValues& roots, const std::vector<int32_t>& multiplicities) {
    ComplexValues all;
    for (std::size_t i = 0; i < roots.size(); ++i)
        all.insert(all.end(), static_cast<std::size_t>(multiplicities[i]), roots[i]);
    return all;
}

TEST_F(MultipleRoots, AreOneRootEach) {
    ASSERT_EQ(Find({-1, 5, -10, 10, -5, 1}), 0);
    ExpectRefined({{1, 0}}, {5}, 1e-14);
    EXPECT_TRUE(coef_kept_);
    const ComplexValues roots{{4, 0}, {-3, 0}, {2, 0}, {1, 0}};
    for (const std::vector<int32_t>& mult :
         {std::vector{1, 1, 1, 1}, {1, 2, 3, 4}, {3, 1, 2, 2}, {2, 2, 2, 2}, {1, 1, 5, 1}}) {
        ASSERT_EQ(Find(RealProduct(Repeated(roots, mult))), 0);
        ExpectRefined(roots, mult, 1e-11);
        EXPECT_THAT(roots_, AllNear(roots, 1e-5, 0.0));
    }
}

TEST_F(MultipleRoots, KeepTheirStructureAtHighDegree) {
    const ComplexValues roots{{3, 0}, {2, 0}, {1, 0}};
    const std::vector<int32_t> mult{4, 6, 10};
    ASSERT_EQ(Find(RealProduct(Repeated(roots, mult))), 0);
    ExpectRefined(roots, mult, 1e-9);
}

TEST_F(MultipleRoots, MayBeComplex) {
    const ComplexValues pairs{{1, 2}, {1, -2}};
    ASSERT_EQ(Find(RealProduct(Repeated(pairs, {3, 3}))), 0);
    ASSERT_EQ(distinct_.size(), 2U);
    EXPECT_THAT(mult_, ElementsAre(3, 3));
    for (const Complex root : pairs) EXPECT_LT(Distance(root, distinct_), 1e-12);

    const ComplexValues roots{{3, -1}, {0, 2}, {1, 0.5}};
    ASSERT_EQ(FindComplex(Product(Repeated(roots, {2, 1, 4}))), 0);
    ExpectRefined(roots, {2, 1, 4}, 1e-11);
}

TEST_F(MultipleRoots, MayLieSymmetrically) {
    // The first divisor is exact to the last bit, and the eigenvalues of what is left lie on two circles.
    for (const double root : {0.5, 1.5, 2.0, 2.5}) {
        ASSERT_EQ(Find(RealProduct(Repeated({{root, 0}, {-root, 0}}, {6, 6}))), 0) << root;
        EXPECT_THAT(mult_, ElementsAre(6, 6));
        for (const Complex expected : {Complex{root, 0}, Complex{-root, 0}})
            EXPECT_LT(Distance(expected, distinct_), 1e-14);
    }
}

TEST_F(MultipleRoots, AreScaledToTheirSize) {
    const ComplexValues roots{{3e6, 0}, {1e6, 0}};
    ASSERT_EQ(Find(RealProduct(Repeated(roots, {2, 3}))), 0);
    ExpectRefined(roots, {2, 3}, 1e-12);
    for (const Complex root : distinct_) EXPECT_EQ(root.im, 0.0);
}

TEST_F(MultipleRoots, CountZeros) {
    ASSERT_EQ(Find({0, 0, 3}), 0);
    ExpectRefined({{0, 0}}, {2}, 0.0);
    ASSERT_EQ(Find({0, 0, 3, 0}, 0), 0);
    EXPECT_THAT(roots_, ElementsAre(Complex{0, 0}));
    EXPECT_TRUE(distinct_.empty());
    EXPECT_THAT(mult_, ElementsAre(2));
    ASSERT_EQ(Find({0, 0, 0, 4, -4, 1}), 0);
    ExpectRefined({{2, 0}, {0, 0}}, {2, 3}, 1e-13);
}

TEST_F(MultipleRoots, BelongToTheFirstStageWithoutTheSecond) {
    ASSERT_EQ(Find(RealProduct({{2, 0}, {2, 0}, {-5, 0}, {0, 0}}), 0), 0);
    EXPECT_TRUE(distinct_.empty());
    ASSERT_EQ(roots_.size(), 3U);
    ASSERT_EQ(mult_.size(), 3U);
    for (std::size_t i = 0; i < 2; ++i) EXPECT_EQ(mult_[i], roots_[i].re > 0 ? 2 : 1);
    EXPECT_EQ(roots_[2], (Complex{0, 0}));
    EXPECT_EQ(mult_[2], 1);
}

TEST_F(MultipleRoots, SurviveScalesThatUnderflow) {
    ASSERT_EQ(Find({1e-300, 1, 1e300}), 0);
    EXPECT_EQ(mult_.size(), distinct_.size());
    EXPECT_FALSE(distinct_.empty());
}

TEST_F(MultipleRoots, FallBackToEigenvalues) {
    // Roots of so high a multiplicity that rounding hides the divisors.
    ASSERT_EQ(Find(RealProduct(Repeated({{1, 0}, {2, 0}, {3, 0}, {4, 0}}, {20, 15, 10, 5}))), 0);
    int32_t sum = 0;
    for (const int32_t multiplicity : mult_) sum += multiplicity;
    EXPECT_EQ(sum, 50);
    EXPECT_EQ(mult_.size(), distinct_.size());
}

TEST_F(MultipleRoots, NeedAPolynomial) {
    EXPECT_EQ(Find({}), kEmptyInput);
    EXPECT_EQ(Find({0, kQuietNaN}), kBadCoefficient);
    EXPECT_EQ(Find({1, 1.7976931348623157e308}), kBadCoefficient);
    EXPECT_EQ(Find({1e300, 1e-300}), kBadCoefficient);
    EXPECT_EQ(Find({0, 0}), kZeroPolynomial);
    EXPECT_FALSE(coef_kept_);
    EXPECT_EQ(FindComplex({{3, 1}, {0, 0}}), kBadOrder);
    EXPECT_FALSE(coef_kept_);
    EXPECT_TRUE(roots_.empty() && distinct_.empty() && mult_.empty());
}

}  // namespace
}  // namespace krnumer

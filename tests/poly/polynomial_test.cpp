// Values, guessed roots and divisors of polynomials, through their exports.

#include "krnumer/polynomial.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>

#include "frame/numeric.h"
#include "frame/status.h"
#include "support/host_arrays.h"

namespace krnumer {
namespace {

using testing::ElementsAre;
using Values = std::vector<double>;
using ComplexValues = std::vector<Complex>;

TEST(PolynomialValues, AreSumsOfPowers) {
    int32_t err = 77;
    HostArray<double> x{0, 1, 2, -3};
    HostArray<double> coef{1, -2, 0.5};
    EXPECT_EQ(PolyEv(x.handle(), coef.handle(), &err), 0);
    EXPECT_EQ(err, 0);
    EXPECT_THAT(x.values(), ElementsAre(1, -0.5, -1, 11.5));
    HostMatrix<double> m(2, 2, {0, 1, 2, -3});
    EXPECT_EQ(EvPoly2D(m.handle(), coef.handle(), &err), 0);
    EXPECT_THAT(m.values(), ElementsAre(1, -0.5, -1, 11.5));
    EXPECT_EQ(m.rows(), 2);
    HostArray<double> constant{7};
    EXPECT_EQ(PolyEv(x.handle(), constant.handle(), &err), 0);
    EXPECT_THAT(x.values(), ElementsAre(7, 7, 7, 7));
}

TEST(PolynomialValues, MeetInfinitiesByPowers) {
    int32_t err;
    HostArray<double> infinite{kInfinity};
    EXPECT_EQ(PolyEv(infinite.handle(), HostArray<double>{1, 0}.handle(), &err), 0);
    EXPECT_TRUE(std::isnan(infinite[0]));
    HostArray<double> tiny{1e-200};
    EXPECT_EQ(PolyEv(tiny.handle(), HostArray<double>{0, 0, 1e300}.handle(), &err), 0);
    EXPECT_EQ(tiny[0], 0.0);
}

TEST(PolynomialValues, NeedArgumentsAndCoefficients) {
    int32_t err = 77;
    HostArray<double> x{1};
    HostArray<double> none;
    EXPECT_EQ(PolyEv(x.handle(), none.handle(), &err), 0);
    EXPECT_EQ(err, kEmptyInput);
    EXPECT_TRUE(x.empty());
    EXPECT_EQ(PolyEv(none.handle(), HostArray<double>{1}.handle(), &err), 0);
    EXPECT_EQ(err, kEmptyInput);
    HostMatrix<double> m(3, 0);
    EXPECT_EQ(EvPoly2D(m.handle(), HostArray<double>{1}.handle(), &err), 0);
    EXPECT_EQ(err, kEmptyInput);
    EXPECT_TRUE(m.empty());
}

// ---- Roots from guesses ----

class GuessedRoots : public testing::Test {
  protected:
    LeakCheck leaks_;
    HostArray<Complex> roots_{{9, 9}};

    int32_t Refine(const Values& coef, const Values& real, int32_t real_limit, const ComplexValues& pairs,
                   int32_t pair_limit) {
        return PolyRootsNtBst_head(HostArray<double>(coef).handle(), HostArray<double>(real).handle(), real_limit,
                                   1e-14, HostArray<Complex>(pairs).handle(), pair_limit, 1e-14, roots_.handle());
    }
};

TEST_F(GuessedRoots, ConvergeFromNearby) {
    const Values coef{-6, 11, -6, 1};  // (x - 1)(x - 2)(x - 3)
    ASSERT_EQ(Refine(coef, {0.9, 2.1, 3.3}, 50, {}, 0), 0);
    for (int32_t i = 0; i < 3; ++i) {
        EXPECT_NEAR(roots_[i].re, i + 1.0, 1e-12);
        EXPECT_EQ(roots_[i].im, 0.0);
    }
}

TEST_F(GuessedRoots, EndAfterOneStepWhereAChangeCannotFall) {
    ASSERT_EQ(Refine({36, 0, 13, 0, 1}, {}, 0, {{0, 2.05}, {0, -2.05}}, 50), 0);
    EXPECT_NEAR(roots_[0].im, 1.99777, 1e-5);
    EXPECT_NEAR(roots_[1].im, -1.99777, 1e-5);
}

TEST_F(GuessedRoots, CountTheirSteps) {
    const Values coef{-1, 0, 1};
    ASSERT_EQ(Refine(coef, {0}, 1, {}, 0), 0);
    EXPECT_EQ(roots_[0].re, 0.0) << "the point after the last step is not looked at";
    ASSERT_EQ(Refine(coef, {0}, 2, {}, 0), 0);
    EXPECT_EQ(roots_[0].re, -1.0);
    ASSERT_EQ(Refine(coef, {5, 1}, 0, {}, 0), 0);
    EXPECT_THAT(roots_.values(), ElementsAre(Complex{5, 0}, Complex{1, 0}));
}

TEST_F(GuessedRoots, ComeRealOnesFirst) {
    // (x - 1)(x - 2)(x^2 + 2 x + 5)
    const Values coef{10, -11, 1, -1, 1};
    ASSERT_EQ(Refine(coef, {}, 0, {{-1.01, 2.01}, {-1.01, -2.01}, {1.01, 0}, {2.01, 0}}, 50), 0);
    ASSERT_EQ(roots_.size(), 4);
    EXPECT_NEAR(roots_[0].re, 2.0, 1e-9);
    EXPECT_NEAR(roots_[1].re, 1.0, 1e-9);
    EXPECT_NEAR(roots_[2].re, -1.0, 1e-9);
    EXPECT_NEAR(roots_[2].im, 2.0, 1e-9);
    EXPECT_NEAR(roots_[3].im, -2.0, 1e-9);
}

TEST_F(GuessedRoots, PairALastGuessWithItself) {
    const Values coef{10, -11, 1, -1, 1};
    ASSERT_EQ(Refine(coef, {1.01}, 50, {{2, 0}}, 50), 0);
    EXPECT_EQ(roots_.size(), 2) << "and count it once";
    ASSERT_EQ(Refine({-1, 0, 1}, {}, 0, {{3, 4}, {5, 6}, {7, 8}}, 50), 0);
    EXPECT_THAT(roots_.values(), ElementsAre(Complex{3, 4}, Complex{5, 6}, Complex{7, 8})) << "degree 2 and below";
}

TEST_F(GuessedRoots, OfNothing) {
    ASSERT_EQ(Refine({1, 2}, {}, 5, {}, 5), 0);
    EXPECT_TRUE(roots_.empty());
    HostArray<Complex> some{{1, 1}};
    roots_ = std::move(some);
    EXPECT_EQ(Refine({}, {1, 2}, 5, {}, 5), kWarnEmptyPolynomial);
    EXPECT_TRUE(roots_.empty());
}

TEST_F(GuessedRoots, TakeMalformedGuessesForNone) {
    const HostArray<double> cubic{-6, 11, -6, 1};
    HostArray<double> real{0.9, 2.1, 3.1};
    HostArray<Complex> pairs{{1, 0}, {2, 0}};
    const auto refine = [&] {
        return PolyRootsNtBst_head(cubic.handle(), real.handle(), 50, 1e-14, pairs.handle(), 50, 1e-14,
                                   roots_.handle());
    };
    pairs.SetDimension(0, -2);
    ASSERT_EQ(refine(), 0);
    EXPECT_EQ(roots_.size(), 3);
    pairs.SetDimension(0, 2);
    real.SetDimension(0, -1);
    ASSERT_EQ(refine(), 0);
    EXPECT_EQ(roots_.size(), 2);
}

// ---- Divisors ----

Values Product(const Values& a, const Values& b) {
    Values c(a.size() + b.size() - 1, 0.0);
    for (size_t i = 0; i < a.size(); ++i)
        for (size_t j = 0; j < b.size(); ++j) c[i + j] += a[i] * b[j];
    return c;
}

class Divisors : public testing::Test {
  protected:
    LeakCheck leaks_;
    HostArray<double> gcd_{9}, u_{9}, v_{9};

    int32_t Divide(const Values& p, const Values& q, double tol = -1.0, int32_t want = 1) {
        return PolyGCD_H(HostArray<double>(p).handle(), HostArray<double>(q).handle(), tol, gcd_.handle(), u_.handle(),
                         v_.handle(), want);
    }
    static void ExpectNear(const HostArray<double>& actual, const Values& expected, double tolerance) {
        ASSERT_EQ(actual.size(), static_cast<int32_t>(expected.size()));
        for (int32_t i = 0; i < actual.size(); ++i)
            EXPECT_NEAR(actual[i], expected[static_cast<size_t>(i)], tolerance) << "coefficient " << i;
    }
};

TEST_F(Divisors, OfProductsAreTheCommonFactor) {
    const Values common{-2, 3, 1};
    const Values left{5, -1, 0.5, 1};
    const Values right{-3, 1};
    for (const bool swapped : {false, true}) {
        const Values& a = swapped ? right : left;
        const Values& b = swapped ? left : right;
        Values p = Product(common, a);
        for (double& c : p) c *= 7.0;
        ASSERT_EQ(Divide(p, Product(common, b)), 0);
        ExpectNear(gcd_, common, 1e-12);
        ExpectNear(u_, a, 1e-11);
        ExpectNear(v_, b, 1e-11);
    }
}

TEST_F(Divisors, TolerateSmallErrors) {
    const Values common{-2, 3, 1};
    Values p = Product(common, {5, -1, 1});
    const Values q = Product(common, {-3, 1});
    p[1] += 1e-6;
    ASSERT_EQ(Divide(p, q, 1e-4), 0);
    ExpectNear(gcd_, common, 1e-5);
    ASSERT_EQ(Divide(p, q, 1e-12), 0);
    ExpectNear(gcd_, {1}, 0.0);
}

TEST_F(Divisors, OfCoprimePolynomialsAreOne) {
    ASSERT_EQ(Divide({2, 4, 2}, {6, 3}), 0);
    ExpectNear(gcd_, {1}, 0.0);
    ExpectNear(u_, {1, 2, 1}, 1e-15);
    ExpectNear(v_, {2, 1}, 1e-15);
    ASSERT_EQ(Divide({5}, {1, 1}), 0);
    ExpectNear(gcd_, {1}, 0.0);
    ExpectNear(u_, {1}, 0.0);
}

TEST_F(Divisors, HoldCommonPowersOfX) {
    ASSERT_EQ(Divide({0, 0, -2, 1}, {0, -2, 1}), 0);
    ExpectNear(gcd_, {0, -2, 1}, 1e-14);
    ASSERT_EQ(Divide({0, 0, 3}, {0, 0, 0, 5, 0}), 0);
    ExpectNear(gcd_, {0, 0, 1}, 0.0);
    ExpectNear(u_, {1}, 0.0);
    ExpectNear(v_, {0, 1}, 0.0);
}

TEST_F(Divisors, LeaveCofactorsThatAreNotWanted) {
    for (const int32_t want : {0, 2, -1}) {
        ASSERT_EQ(Divide({-1, 0, 1}, {1, 1}, -1.0, want), 0);
        ExpectNear(gcd_, {1, 1}, 1e-14);
        EXPECT_THAT(u_.values(), ElementsAre(9));
        EXPECT_THAT(v_.values(), ElementsAre(9));
    }
}

TEST_F(Divisors, RefuseWhatCannotBeDivided) {
    const auto expect = [this](const Values& p, const Values& q, int32_t status) {
        EXPECT_EQ(Divide(p, q, -1.0, 0), status);
        EXPECT_TRUE(gcd_.empty() && u_.empty() && v_.empty()) << "all three, wanted or not";
        HostArray<double> fresh{9};
        u_ = std::move(fresh);
    };
    expect({}, {kQuietNaN}, kEmptyInput);
    expect({1}, {}, kEmptyInput);
    expect({0}, {kQuietNaN}, kBadCoefficient);
    expect({kInfinity}, {1}, kBadCoefficient);
    expect({1e300, 1e-300}, {5}, kBadCoefficient);
    expect({0, 0}, {1, 1}, kZeroPolynomial);
    expect({1, 1}, {0}, kZeroPolynomial);
}

TEST_F(Divisors, OfComplexPolynomials) {
    const Complex i{0, 1};
    // (x - i)(x - 2) and (x - i)(x + 3 i)
    HostArray<Complex> p{i * 2.0, Complex{-2, -1}, {1, 0}};
    HostArray<Complex> q{{3, 0}, {0, 2}, {1, 0}};
    HostArray<Complex> gcd, u, v;
    ASSERT_EQ(CxPolyGCD_H(p.handle(), q.handle(), -1.0, gcd.handle(), u.handle(), v.handle(), 1), 0);
    const auto expect = [](const HostArray<Complex>& c, Complex constant) {
        ASSERT_EQ(c.size(), 2);
        EXPECT_NEAR(Modulus(c[0] - constant), 0.0, 1e-14);
        EXPECT_EQ(c[1], (Complex{1, 0}));
    };
    expect(gcd, {0, -1});
    expect(u, {-2, 0});
    expect(v, {0, 3});
}

TEST_F(Divisors, OfComplexPolynomialsAreMonicToTheLastBit) {
    HostArray<Complex> p{{-10, 0}, {-21, -2}, {6, 10}, {6, 17}, {2, -5}, {2, 0}};
    HostArray<Complex> q{{-22, 4}, {-5, -20}, {19, -14}, {6, -12}, {5, -5}, {1, 0}};
    HostArray<Complex> gcd, u, v;
    ASSERT_EQ(CxPolyGCD_H(p.handle(), q.handle(), 1e-4, gcd.handle(), u.handle(), v.handle(), 1), 0);
    ASSERT_EQ(gcd.size(), 2);
    EXPECT_NEAR(Modulus(gcd[0] - Complex{2, -4}), 0.0, 1e-12);
    for (const auto* monic : {&gcd, &u, &v}) EXPECT_EQ((*monic)[monic->size() - 1], (Complex{1, 0}));
}

}  // namespace
}  // namespace krnumer

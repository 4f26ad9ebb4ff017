#include "linalg/svd_solve.h"

#include <gtest/gtest.h>

#include <cmath>
#include <random>
#include <vector>

#include "frame/numeric.h"
#include "frame/status.h"
#include "linalg/products.h"

namespace krnumer {
namespace {

template <class T>
T Random(std::mt19937& random) {
    std::normal_distribution<> normal;
    if constexpr (std::is_same_v<T, Complex>) {
        const double re = normal(random);
        return {re, normal(random)};
    } else {
        return normal(random);
    }
}

template <class T>
T Element(double value) {
    if constexpr (std::is_same_v<T, Complex>) {
        return {value, 0.0};
    } else {
        return value;
    }
}

double Magnitude(double a) {
    return std::fabs(a);
}
double Magnitude(Complex a) {
    return Modulus(a);
}

template <class T>
std::vector<T> RandomMatrix(int32_t rows, int32_t columns, uint32_t seed = 1) {
    std::mt19937 random(seed);
    std::vector<T> a(Count(rows) * Count(columns));
    for (T& element : a) element = Random<T>(random);
    return a;
}

template <class T>
std::vector<T> Multiply(const std::vector<T>& a, const std::vector<T>& b, int32_t m, int32_t k, int32_t n) {
    std::vector<T> c(Count(m) * Count(n));
    EXPECT_EQ(MatMulCore(a.data(), b.data(), m, k, n, c.data()), kOk);
    return c;
}

template <class T>
void ExpectNear(const std::vector<T>& a, const std::vector<T>& b, double tolerance) {
    ASSERT_EQ(a.size(), b.size());
    for (size_t i = 0; i < a.size(); ++i) EXPECT_LE(Magnitude(a[i] - b[i]), tolerance) << "element " << i;
}

template <class T>
class SvdSolver : public testing::Test {};
using Elements = testing::Types<double, Complex>;
TYPED_TEST_SUITE(SvdSolver, Elements);

TYPED_TEST(SvdSolver, PseudoInverseSatisfiesPenrosesEquations) {
    for (const auto& [m, n] : {std::pair{1, 1}, {1, 4}, {5, 1}, {3, 3}, {7, 4}, {4, 7}, {30, 20}}) {
        const auto a = RandomMatrix<TypeParam>(m, n);
        std::vector<TypeParam> inverse(a.size());
        auto copy = a;
        ASSERT_EQ(PseudoInverseCore(copy.data(), m, n, -1.0, inverse.data()), kOk);
        ExpectNear(Multiply(Multiply(a, inverse, m, n, m), a, m, m, n), a, 1e-12);
        ExpectNear(Multiply(Multiply(inverse, a, n, m, n), inverse, n, n, m), inverse, 1e-12);
        ASSERT_EQ(PseudoInverseCore<TypeParam>(copy.data(), m, n, -1.0, nullptr), kOk);
        EXPECT_EQ(copy, inverse) << "null overwrites the matrix";
    }
}

TYPED_TEST(SvdSolver, PseudoInverseTakesItsToleranceAsAbsolute) {
    std::vector<TypeParam> a{Element<TypeParam>(4), Element<TypeParam>(0), Element<TypeParam>(0),
                             Element<TypeParam>(0.5)};
    std::vector<TypeParam> inverse(4);
    ASSERT_EQ(PseudoInverseCore(a.data(), 2, 2, 0.5, inverse.data()), kOk);
    ExpectNear(inverse, {Element<TypeParam>(0.25), Element<TypeParam>(0), Element<TypeParam>(0), Element<TypeParam>(0)},
               1e-15);
    ASSERT_EQ(PseudoInverseCore(a.data(), 2, 2, 0.0, inverse.data()), kOk);
    ExpectNear(inverse, {Element<TypeParam>(0.25), Element<TypeParam>(0), Element<TypeParam>(0), Element<TypeParam>(2)},
               1e-15);
    std::vector<TypeParam> zero(6);
    ASSERT_EQ(PseudoInverseCore<TypeParam>(zero.data(), 2, 3, -1.0, nullptr), kOk);
    ExpectNear(zero, std::vector<TypeParam>(6), 0.0);
}

TYPED_TEST(SvdSolver, SolvesAndMinimises) {
    for (const auto& [m, n] : {std::pair{1, 1}, {4, 4}, {9, 4}, {4, 9}, {40, 25}}) {
        const auto a = RandomMatrix<TypeParam>(m, n);
        const auto x = RandomMatrix<TypeParam>(n, 2, 2);
        const auto b = Multiply(a, x, m, n, 2);
        std::vector<TypeParam> solution(x.size());
        ASSERT_EQ(SvdSolve(a.data(), m, n, b.data(), 2, solution.data(), -1.0), kOk);
        ExpectNear(Multiply(a, solution, m, n, 2), b, 1e-12);
        if (m >= n) ExpectNear(solution, x, 1e-11);
    }
}

TYPED_TEST(SvdSolver, WarnsOfRankDeficiencyAndTakesTheLeastNorm) {
    const std::vector<TypeParam> a{Element<TypeParam>(1), Element<TypeParam>(1), Element<TypeParam>(1),
                                   Element<TypeParam>(1)};
    const std::vector<TypeParam> b{Element<TypeParam>(2), Element<TypeParam>(2)};
    std::vector<TypeParam> x(2);
    EXPECT_EQ(SvdSolve(a.data(), 2, 2, b.data(), 1, x.data(), -1.0), kWarnRankDeficient);
    ExpectNear(x, {Element<TypeParam>(1), Element<TypeParam>(1)}, 1e-14);
}

TYPED_TEST(SvdSolver, TakesItsToleranceAsAFactor) {
    const std::vector<TypeParam> a{Element<TypeParam>(4), Element<TypeParam>(0), Element<TypeParam>(0),
                                   Element<TypeParam>(1)};
    const std::vector<TypeParam> b{Element<TypeParam>(4), Element<TypeParam>(1)};
    std::vector<TypeParam> x(2);
    EXPECT_EQ(SvdSolve(a.data(), 2, 2, b.data(), 1, x.data(), 0.1), kOk);
    EXPECT_EQ(SvdSolve(a.data(), 2, 2, b.data(), 1, x.data(), 0.125), kWarnRankDeficient) << "1 <= 2 4 / 8";
    ExpectNear(x, {Element<TypeParam>(1), Element<TypeParam>(0)}, 1e-15);
    for (const double tol : {0.0, -5.0, kQuietNaN})
        EXPECT_EQ(SvdSolve(a.data(), 2, 2, b.data(), 1, x.data(), tol), kOk);
}

TYPED_TEST(SvdSolver, RefusesWhatItCannotUse) {
    std::vector<TypeParam> a{Element<TypeParam>(1)};
    std::vector<TypeParam> x(1);
    EXPECT_EQ(SvdSolve(a.data(), 0, 1, a.data(), 1, x.data(), -1.0), kEmptyInput);
    EXPECT_EQ(SvdSolve(a.data(), 1, 0, a.data(), 1, x.data(), -1.0), kEmptyInput);
    EXPECT_EQ(SvdSolve(a.data(), 1, 1, a.data(), 0, x.data(), -1.0), kEmptyInput);
    EXPECT_EQ(PseudoInverseCore<TypeParam>(a.data(), 0, 1, -1.0, nullptr), kEmptyInput);
    const std::vector<TypeParam> bad{Element<TypeParam>(kQuietNaN)};
    EXPECT_EQ(SvdSolve(a.data(), 1, 1, bad.data(), 1, x.data(), -1.0), kNotFinite);
    EXPECT_EQ(SvdSolve(bad.data(), 1, 1, a.data(), 1, x.data(), -1.0), kNotFinite);
}

}  // namespace
}  // namespace krnumer

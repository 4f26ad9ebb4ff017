#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <string>
#include <vector>

#include "frame/status.h"
#include "linalg/eigen_general.h"
#include "linalg/test_matrices.h"
#include "support/numbers.h"

namespace krnumer {
namespace {

int32_t Core(const DenseMatrix<double>& a, int32_t want_vectors, Complex* w, Complex* v) {
    return EigenGeneralCore(a.data(), a.rows, want_vectors, w, v);
}
int32_t Core(const DenseMatrix<Complex>& a, int32_t want_vectors, Complex* w, Complex* v) {
    return CxEigenGeneralCore(a.data(), a.rows, want_vectors, w, v);
}

struct Eigen {
    explicit Eigen(int32_t n) : w(Count(n)), v(n, n) {}

    int32_t status = 1;
    std::vector<Complex> w;
    DenseMatrix<Complex> v;
};

template <class T>
Eigen Decompose(const DenseMatrix<T>& a) {
    Eigen e(a.rows);
    e.status = Core(a, 1, e.w.data(), e.v.data());
    return e;
}

template <class T>
std::vector<Complex> Values(const DenseMatrix<T>& a) {
    std::vector<Complex> w(Count(a.rows));
    EXPECT_EQ(Core(a, 0, w.data(), nullptr), kOk);
    return w;
}

// ||A V - V diag(w)||
double Residual(const DenseMatrix<Complex>& a, const Eigen& e) {
    const auto scaled =
        Generate<Complex>(a.rows, a.rows, [&e](int32_t i, int32_t j) { return e.v(i, j) * e.w[Count(j)]; });
    return Distance(Product(a, e.v), scaled);
}

void ExpectUnitColumns(const DenseMatrix<Complex>& v) {
    for (int32_t j = 0; j < v.columns; ++j) {
        double squares = 0.0;
        for (int32_t i = 0; i < v.rows; ++i) squares += SquaredModulus(v(i, j));
        EXPECT_NEAR(squares, 1.0, 1e-14);
    }
}

void ExpectConjugatePairs(const Eigen& e) {
    for (std::size_t j = 0; j < e.w.size(); ++j) {
        const int32_t column = static_cast<int32_t>(j);
        if (e.w[j].im == 0.0) {
            for (int32_t i = 0; i < e.v.rows; ++i) EXPECT_EQ(e.v(i, column).im, 0.0);
            continue;
        }
        ASSERT_LT(j + 1, e.w.size());
        EXPECT_GT(e.w[j].im, 0.0);
        EXPECT_EQ(e.w[j + 1], Conjugate(e.w[j]));
        for (int32_t i = 0; i < e.v.rows; ++i) EXPECT_EQ(e.v(i, column + 1), Conjugate(e.v(i, column)));
        ++j;
    }
}

// Every expected eigenvalue has one near it, one to one.
void ExpectEigenvalues(std::vector<Complex> actual, const std::vector<Complex>& expected, double tolerance) {
    ASSERT_EQ(actual.size(), expected.size());
    for (const Complex& wanted : expected) {
        const auto nearest = std::min_element(actual.begin(), actual.end(), [&wanted](Complex a, Complex b) {
            return SquaredModulus(a - wanted) < SquaredModulus(b - wanted);
        });
        EXPECT_LE(Modulus(*nearest - wanted), tolerance) << testing::PrintToString(wanted);
        actual.erase(nearest);
    }
}

template <class T>
class EigenGeneral : public testing::Test {
  protected:
    static void ExpectEigen(const DenseMatrix<T>& a) {
        const double unit = kEpsilon * FrobeniusNorm(a);
        const Eigen e = Decompose(a);
        ASSERT_EQ(e.status, kOk);
        EXPECT_LE(Residual(ToComplex(a), e), 10.0 * a.rows * unit);
        ExpectUnitColumns(e.v);
        if (!kIsComplex<T>) ExpectConjugatePairs(e);
        EXPECT_THAT(Values(a), AllNear(e.w, 0.0, 10.0 * a.rows * unit));
    }
};

using Elements = testing::Types<double, Complex>;
TYPED_TEST_SUITE(EigenGeneral, Elements);

TYPED_TEST(EigenGeneral, DecomposesMatricesOfEverySizeAndKind) {
    using T = TypeParam;
    for (int32_t n = 1; n <= 60; n += n < 12 ? 1 : 8) {
        SCOPED_TRACE(n);
        const uint64_t seed = static_cast<uint64_t>(n);
        this->ExpectEigen(RandomMatrix<T>(n, n, seed));
        this->ExpectEigen(RankDeficientMatrix<T>(n, n, (n + 1) / 2, seed));
        this->ExpectEigen(HilbertMatrix<T>(n, n));
        this->ExpectEigen(IntegerMatrix<T>(n, n, seed));
        this->ExpectEigen(RandomHermitian<T>(n, seed));
        this->ExpectEigen(DenseMatrix<T>(n, n));
    }
}

TYPED_TEST(EigenGeneral, DecomposesALargeMatrix) {
    this->ExpectEigen(RandomMatrix<TypeParam>(200, 200, 1));
}

TYPED_TEST(EigenGeneral, DecomposesMatricesThatNeedBalancing) {
    using T = TypeParam;
    DenseMatrix<T> a = RandomMatrix<T>(12, 12, 2);
    for (int32_t i = 0; i < 12; ++i)
        for (int32_t j = 0; j < 12; ++j) a(i, j) = a(i, j) * std::ldexp(1.0, 5 * (i - j));
    const Eigen e = Decompose(a);
    ASSERT_EQ(e.status, kOk);
    ExpectUnitColumns(e.v);
    // Scaling by powers of 2 leaves the eigenvalues of the matrix that was scaled apart.
    ExpectEigenvalues(e.w, Values(RandomMatrix<T>(12, 12, 2)), 1e-12);
}

TYPED_TEST(EigenGeneral, DecomposesBlocksWithIsolatedEigenvalues) {
    using T = TypeParam;
    // Permuted block triangular matrices: some eigenvalues stand alone, others in a block.
    for (uint64_t seed = 0; seed < 20; ++seed) {
        RandomBits bits(seed);
        const int32_t n = 9;
        std::vector<int32_t> order(n);
        for (int32_t i = 0; i < n; ++i) order[Count(i)] = i;
        std::shuffle(order.begin(), order.end(), bits);
        const auto a = Generate<T>(n, n, [&](int32_t i, int32_t j) {
            const int32_t row = order[Count(i)], column = order[Count(j)];
            const bool within = row >= 3 && row < 7 && column >= 3 && column < 7;
            return within || column >= row ? RandomElement<T>(bits) : T{};
        });
        this->ExpectEigen(a);
    }
}

TYPED_TEST(EigenGeneral, DecomposesDefectiveMatrices) {
    using T = TypeParam;
    for (const int32_t n : {2, 3, 5, 8}) {
        for (const double eigenvalue : {0.0, 1.0, -3.0}) {
            DenseMatrix<T> a(n, n);
            const DenseMatrix<double> jordan = JordanMatrix(n, eigenvalue);
            for (std::size_t i = 0; i < a.elements.size(); ++i) a.elements[i] = FromReal<T>(jordan.elements[i]);
            const Eigen e = Decompose(a);
            ASSERT_EQ(e.status, kOk);
            EXPECT_LE(Residual(ToComplex(a), e), 1e-13 * n);
            ExpectUnitColumns(e.v);
            // A perturbation of rounding moves an n-fold eigenvalue by its n-th root.
            for (const Complex& w : e.w) {
                const double spread = std::pow(1e3 * kEpsilon, 1.0 / n);
                EXPECT_LE(Modulus(w - Complex{eigenvalue, 0.0}), 4.0 * spread);
            }
        }
    }
}

TYPED_TEST(EigenGeneral, TakesTriangularMatricesApartWithoutASweep) {
    using T = TypeParam;
    for (const int32_t n : {1, 2, 5, 30}) {
        DenseMatrix<T> a = RandomMatrix<T>(n, n, 3);
        for (int32_t i = 0; i < n; ++i)
            for (int32_t j = 0; j < i; ++j) a(i, j) = T{};
        const Eigen e = Decompose(a);
        ASSERT_EQ(e.status, kOk);
        for (int32_t i = 0; i < n; ++i) EXPECT_EQ(e.w[Count(i)], ToComplex(a)(i, i));
        EXPECT_LE(Residual(ToComplex(a), e), 1e-13);
    }
}

TYPED_TEST(EigenGeneral, ConvergesOnCyclicPermutationsByTheExceptionalShift) {
    using T = TypeParam;
    for (const int32_t n : {3, 4, 5, 8, 20}) {
        const auto a =
            Generate<T>(n, n, [n](int32_t i, int32_t j) { return FromReal<T>((i + 1) % n == j ? 1.0 : 0.0); });
        SCOPED_TRACE(n);
        this->ExpectEigen(a);
        std::vector<Complex> roots;
        for (int32_t k = 0; k < n; ++k) roots.push_back({std::cos(2.0 * kPi * k / n), std::sin(2.0 * kPi * k / n)});
        ExpectEigenvalues(Values(a), roots, 1e-13);
    }
}

TYPED_TEST(EigenGeneral, GivesUnitVectorsForTheZeroMatrixAndTheIdentity) {
    using T = TypeParam;
    for (const double diagonal : {0.0, 1.0}) {
        const auto a = Generate<T>(4, 4, [&](int32_t i, int32_t j) { return FromReal<T>(i == j ? diagonal : 0.0); });
        const Eigen e = Decompose(a);
        ASSERT_EQ(e.status, kOk);
        EXPECT_EQ(e.w, std::vector<Complex>(4, Complex{diagonal, 0.0}));
        EXPECT_EQ(Distance(e.v, Generate<Complex>(4, 4,
                                                  [](int32_t i, int32_t j) {
                                                      return Complex{i == j ? 1.0 : 0.0, 0.0};
                                                  })),
                  0.0);
    }
}

TYPED_TEST(EigenGeneral, RejectsWhatItCannotDecompose) {
    using T = TypeParam;
    DenseMatrix<T> a = RandomMatrix<T>(3, 3, 4);
    Eigen e(3);
    DenseMatrix<T> none(0, 0);
    EXPECT_EQ(Core(none, 1, e.w.data(), e.v.data()), kEmptyInput);
    EXPECT_EQ(Core(none, 7, e.w.data(), e.v.data()), kEmptyInput);
    for (const int32_t bad : {-1, 2, 256}) EXPECT_EQ(Core(a, bad, e.w.data(), e.v.data()), kBadSelector);
    for (const double bad : {kQuietNaN, kInfinity, -kInfinity, 1.7976931348623157e308, -1.7976931348623e308}) {
        a(2, 1) = FromReal<T>(bad);
        EXPECT_EQ(Core(a, 1, e.w.data(), e.v.data()), kNotFinite);
        EXPECT_EQ(Core(a, 2, e.w.data(), e.v.data()), kBadSelector);
    }
}

// Sums of magnitudes that overflow end neither in a crash nor in an endless loop.
TYPED_TEST(EigenGeneral, EndsOnOverflow) {
    using T = TypeParam;
    for (const int32_t n : {2, 3, 4, 7}) {
        for (const double huge : {1e308, 1e200, 1e-300, 1e-320}) {
            DenseMatrix<T> a = RandomMatrix<T>(n, n, 6);
            for (T& x : a.elements) x = x * huge;
            Eigen e(n);
            const int32_t status = Core(a, 1, e.w.data(), e.v.data());
            EXPECT_TRUE(status == kOk || status == kNoConvergence) << status;
            for (T& x : a.elements) x = FromReal<T>(huge);
            EXPECT_LE(Core(a, 1, e.w.data(), e.v.data()), 0);
        }
    }
    DenseMatrix<T> a = RandomMatrix<T>(3, 3, 7);
    a(0, 1) = FromReal<T>(5e-324);
    a(0, 2) = FromReal<T>(0.0);
    a(1, 0) = FromReal<T>(1e308);
    Eigen e(3);
    EXPECT_LE(Core(a, 1, e.w.data(), e.v.data()), 0);
}

TYPED_TEST(EigenGeneral, LeavesTheMatrixAsItWas) {
    const DenseMatrix<TypeParam> a = RandomMatrix<TypeParam>(6, 6, 8);
    const DenseMatrix<TypeParam> before = a;
    Decompose(a);
    Values(a);
    EXPECT_EQ(a.elements, before.elements);
}

TEST(EigenGeneralCore, PutsThePairOfARotationInOrder) {
    DenseMatrix<double> a(2, 2);
    a.elements = {std::cos(0.5), -std::sin(0.5), std::sin(0.5), std::cos(0.5)};
    const Eigen e = Decompose(a);
    ASSERT_EQ(e.status, kOk);
    EXPECT_THAT(e.w[0], Near(Complex{std::cos(0.5), std::sin(0.5)}, 1e-15));
    EXPECT_EQ(e.w[1], Conjugate(e.w[0]));
    ExpectUnitColumns(e.v);
    ExpectConjugatePairs(e);
    EXPECT_LE(Residual(ToComplex(a), e), 1e-15);
}

TEST(EigenGeneralCore, DecomposesTheMatricesOfCollections) {
    for (const auto& a : {WilkinsonMatrix(21), GrcarMatrix(20), GrcarMatrix(60), RosserMatrix(), ClementMatrix(11),
                          ClementMatrix(50)}) {
        SCOPED_TRACE(a.rows);
        const Eigen e = Decompose(a);
        ASSERT_EQ(e.status, kOk);
        EXPECT_LE(Residual(ToComplex(a), e), 10.0 * a.rows * kEpsilon * FrobeniusNorm(a));
        ExpectUnitColumns(e.v);
        ExpectConjugatePairs(e);
    }
}

// Balancing scales the rows of a Frank matrix by factors as different as 2^(2n/3), and with them the errors made in the
// balanced basis.
TEST(EigenGeneralCore, DecomposesFrankMatrices) {
    for (const int32_t n : {3, 12, 30}) {
        const DenseMatrix<double> a = FrankMatrix(n);
        const Eigen e = Decompose(a);
        ASSERT_EQ(e.status, kOk);
        const double growth = std::pow(2.0, 2.0 * n / 3.0);
        EXPECT_LE(Residual(ToComplex(a), e), n * kEpsilon * FrobeniusNorm(a) * growth);
        ExpectUnitColumns(e.v);
        ExpectConjugatePairs(e);
    }
}

TEST(EigenGeneralCore, FindsTheIntegersOfTheClementMatrix) {
    std::vector<Complex> expected;
    for (int32_t k = 10; k >= -10; k -= 2) expected.push_back({static_cast<double>(k), 0.0});
    ExpectEigenvalues(Values(ClementMatrix(11)), expected, 1e-12);
}

TEST(EigenGeneralCore, FindsTheValuesOfTheRosserMatrix) {
    const double root = 10.0 * std::sqrt(10405.0), small = 100.0 * std::sqrt(26.0);
    std::vector<Complex> expected;
    for (const double value : {root, -root, 510.0 + small, 510.0 - small, 1000.0, 1000.0, 1020.0, 0.0})
        expected.push_back({value, 0.0});
    ExpectEigenvalues(Values(RosserMatrix()), expected, 1e-11);
}

}  // namespace
}  // namespace krnumer

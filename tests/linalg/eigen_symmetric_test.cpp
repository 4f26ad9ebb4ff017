#include "linalg/eigen_symmetric.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <vector>

#include "frame/status.h"
#include "linalg/test_matrices.h"
#include "support/numbers.h"

namespace krnumer {
namespace {

int32_t Core(const double* a, int32_t n, int32_t want_vectors, double* w, double* v) {
    return SymEigenCore(a, n, want_vectors, w, v);
}
int32_t Core(const Complex* a, int32_t n, int32_t want_vectors, double* w, Complex* v) {
    return HermitianEigenCore(a, n, want_vectors, w, v);
}
int32_t InPlace(double* a, int32_t n, double* w) {
    return SymEigenCore(a, n, 1, w, nullptr);
}
int32_t InPlace(Complex* a, int32_t n, double* w) {
    return HermitianEigenCore(a, n, 1, w, nullptr);
}

template <class T>
class EigenSymmetric : public testing::Test {
  protected:
    static void ExpectEigen(const DenseMatrix<T>& a) {
        const int32_t n = a.rows;
        const double unit = kEpsilon * FrobeniusNorm(a);
        std::vector<double> w(Count(n)), values(Count(n)), again(Count(n));
        DenseMatrix<T> v(n, n);
        ASSERT_EQ(Core(a.data(), n, 1, w.data(), v.data()), kOk);
        EXPECT_LE(Distance(Product(a, v), ColumnsScaled(v, w)), 10.0 * n * unit);
        EXPECT_LE(Unorthogonality(v), 10.0 * n * kEpsilon);
        EXPECT_TRUE(std::is_sorted(w.begin(), w.end()));

        ASSERT_EQ(Core(a.data(), n, 0, values.data(), static_cast<T*>(nullptr)), kOk);
        EXPECT_EQ(values, w);

        DenseMatrix<T> copy = a;
        ASSERT_EQ(InPlace(copy.data(), n, again.data()), kOk);
        EXPECT_EQ(copy.elements, v.elements);
        EXPECT_EQ(again, w);
    }
};

using Elements = testing::Types<double, Complex>;
TYPED_TEST_SUITE(EigenSymmetric, Elements);

TYPED_TEST(EigenSymmetric, DecomposesMatricesOfEverySizeAndKind) {
    using T = TypeParam;
    for (int32_t n = 1; n <= 60; n += n < 12 ? 1 : 8) {
        SCOPED_TRACE(n);
        const uint64_t seed = static_cast<uint64_t>(n);
        this->ExpectEigen(RandomHermitian<T>(n, seed));
        const DenseMatrix<T> factor = RandomMatrix<T>(n, (n + 1) / 2, seed);
        DenseMatrix<T> semidefinite = Product(factor, Adjoint(factor));
        this->ExpectEigen(semidefinite);
        this->ExpectEigen(HilbertMatrix<T>(n, n));
        this->ExpectEigen(DenseMatrix<T>(n, n));
        DenseMatrix<T> graded = RandomHermitian<T>(n, seed);
        for (int32_t i = 0; i < n; ++i)
            for (int32_t j = 0; j < n; ++j) graded(i, j) = graded(i, j) * std::pow(10.0, -8.0 * (i + j) / n);
        this->ExpectEigen(graded);
    }
}

TYPED_TEST(EigenSymmetric, DecomposesALargeMatrix) {
    this->ExpectEigen(RandomHermitian<TypeParam>(200, 1));
}

TYPED_TEST(EigenSymmetric, DecomposesDiagonalAndTridiagonalMatrices) {
    using T = TypeParam;
    for (const int32_t n : {2, 3, 21}) {
        this->ExpectEigen(Generate<T>(n, n, [](int32_t i, int32_t j) { return FromReal<T>(i == j ? 7.0 - i : 0.0); }));
        this->ExpectEigen(Generate<T>(n, n, [](int32_t i, int32_t j) { return FromReal<T>(i == j ? 1.0 : 0.0); }));
        const DenseMatrix<double> wilkinson = WilkinsonMatrix(n);
        this->ExpectEigen(Generate<T>(n, n, [&](int32_t i, int32_t j) { return FromReal<T>(wilkinson(i, j)); }));
    }
}

TYPED_TEST(EigenSymmetric, ReadsTheLowerTriangleOnly) {
    using T = TypeParam;
    const DenseMatrix<T> a = RandomHermitian<T>(5, 2);
    DenseMatrix<T> other = a;
    for (int32_t i = 0; i < 5; ++i)
        for (int32_t j = i + 1; j < 5; ++j) other(i, j) = FromReal<T>(100.0);
    if constexpr (kIsComplex<T>) other(3, 3).im = 50.0;
    std::vector<double> w(5), w_other(5);
    DenseMatrix<T> v(5, 5), v_other(5, 5);
    ASSERT_EQ(Core(a.data(), 5, 1, w.data(), v.data()), kOk);
    ASSERT_EQ(Core(other.data(), 5, 1, w_other.data(), v_other.data()), kOk);
    EXPECT_EQ(w, w_other);
    EXPECT_EQ(v.elements, v_other.elements);
}

TYPED_TEST(EigenSymmetric, ChecksSizeBeforeSelector) {
    using T = TypeParam;
    const DenseMatrix<T> a = RandomHermitian<T>(2, 3);
    std::vector<double> w(2);
    DenseMatrix<T> v(2, 2);
    EXPECT_EQ(Core(a.data(), 0, 5, w.data(), v.data()), kEmptyInput);
    EXPECT_EQ(Core(a.data(), -1, 1, w.data(), v.data()), kEmptyInput);
    EXPECT_EQ(Core(a.data(), 2, 2, w.data(), v.data()), kBadSelector);
    EXPECT_EQ(Core(a.data(), 2, -1, w.data(), v.data()), kBadSelector);
}

TYPED_TEST(EigenSymmetric, EndsOnOverflow) {
    using T = TypeParam;
    for (const int32_t n : {2, 3, 4, 9}) {
        const auto a = Generate<T>(n, n, [](int32_t i, int32_t j) { return FromReal<T>(i == j ? -1e308 : 1e308); });
        std::vector<double> w(Count(n));
        DenseMatrix<T> v(n, n);
        const int32_t status = Core(a.data(), n, 1, w.data(), v.data());
        EXPECT_TRUE(status == kOk || status == kNoConvergence) << status;
    }
}

TEST(SymEigenCore, LooksAtAllData) {
    DenseMatrix<double> a = RandomHermitian<double>(3, 4);
    a(0, 2) = kQuietNaN;
    std::vector<double> w(3);
    DenseMatrix<double> v(3, 3);
    EXPECT_EQ(Core(a.data(), 3, 1, w.data(), v.data()), kNotFinite);
    EXPECT_EQ(Core(a.data(), 3, 2, w.data(), v.data()), kBadSelector);
}

TEST(HermitianEigenCore, DoesNotConvergeOnNaN) {
    DenseMatrix<Complex> a = RandomHermitian<Complex>(3, 5);
    a(1, 0).re = kQuietNaN;
    std::vector<double> w(3);
    EXPECT_EQ(Core(a.data(), 3, 0, w.data(), static_cast<Complex*>(nullptr)), kNoConvergence);
}

TEST(HermitianEigenCore, TakesTheRealPartOfASingleElement) {
    DenseMatrix<Complex> a(1, 1), v(1, 1);
    a(0, 0) = {-2.5, 7.0};
    double w = 0.0;
    EXPECT_EQ(Core(a.data(), 1, 1, &w, v.data()), kOk);
    EXPECT_EQ(w, -2.5);
    EXPECT_EQ(v(0, 0), (Complex{1.0, 0.0}));
}

// Eigenvalues of the second difference matrix: 2 - 2 cos(k pi / (n + 1)).
TEST(SymEigenCore, FindsTheValuesOfTheSecondDifference) {
    for (const int32_t n : {1, 2, 10, 57}) {
        const auto a = Generate<double>(
            n, n, [](int32_t i, int32_t j) { return i == j ? 2.0 : (std::abs(i - j) == 1 ? -1.0 : 0.0); });
        std::vector<double> w(Count(n)), expected;
        ASSERT_EQ(Core(a.data(), n, 0, w.data(), static_cast<double*>(nullptr)), kOk);
        for (int32_t k = 1; k <= n; ++k) expected.push_back(2.0 - 2.0 * std::cos(k * kPi / (n + 1)));
        EXPECT_THAT(w, AllNear(expected, 0.0, 1e-14));
    }
}

TEST(SymEigenCore, FindsTheValuesOfTheRosserMatrix) {
    const double root = 10.0 * std::sqrt(10405.0), small = 100.0 * std::sqrt(26.0);
    std::vector<double> expected{root, -root, 510.0 + small, 510.0 - small, 1000.0, 1000.0, 1020.0, 0.0};
    std::sort(expected.begin(), expected.end());
    std::vector<double> w(8);
    ASSERT_EQ(Core(RosserMatrix().data(), 8, 0, w.data(), static_cast<double*>(nullptr)), kOk);
    EXPECT_THAT(w, AllNear(expected, 0.0, 2e-12));
}

}  // namespace
}  // namespace krnumer

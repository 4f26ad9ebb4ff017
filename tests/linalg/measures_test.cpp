#include "linalg/measures.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <limits>
#include <vector>

#include "frame/status.h"
#include "krnumer/linalg_measures.h"
#include "linalg/matrices.h"
#include "support/numbers.h"

namespace krnumer {
namespace {

template <class T>
struct Outcome {
    T value;
    int32_t err;
};

template <class T>
KrComplex* Target(T* value) {
    return reinterpret_cast<KrComplex*>(value);
}

template <class T>
Outcome<T> Determinant(const DenseMatrix<T>& a, int32_t type) {
    HostMatrix<T> matrix = ToHost(a);
    Outcome<T> result{FromReal<T>(-99.0), 77};
    if constexpr (kIsComplex<T>) {
        EXPECT_EQ(CxDeterminant_head(matrix.handle(), &type, Target(&result.value), &result.err), 0);
    } else {
        EXPECT_EQ(Determinant_head(matrix.handle(), &type, &result.value, &result.err), 0);
    }
    EXPECT_THAT(matrix.values(), AllNear(a.elements, 0.0));
    return result;
}

template <class T>
Outcome<double> Norm(const DenseMatrix<T>& a, int32_t type) {
    HostMatrix<T> matrix = ToHost(a);
    Outcome<double> result{-99.0, 77};
    EXPECT_EQ((kIsComplex<T> ? CxNorm_head : Norm_head)(matrix.handle(), &type, &result.value, &result.err), 0);
    return result;
}

template <class T>
Outcome<double> Condition(const DenseMatrix<T>& a, int32_t type) {
    HostMatrix<T> matrix = ToHost(a);
    Outcome<double> result{-99.0, 77};
    EXPECT_EQ((kIsComplex<T> ? CxCondNumber_head : CondNumber_head)(matrix.handle(), &type, &result.value, &result.err),
              0);
    return result;
}

template <class T>
Outcome<int32_t> Rank(const DenseMatrix<T>& a, double tolerance) {
    HostMatrix<T> matrix = ToHost(a);
    Outcome<int32_t> result{-99, 77};
    EXPECT_EQ((kIsComplex<T> ? CxRank_head : Rank_head)(matrix.handle(), &tolerance, &result.value, &result.err), 0);
    return result;
}

template <class T>
Outcome<int32_t> PositiveDefinite(const DenseMatrix<T>& a) {
    HostMatrix<T> matrix = ToHost(a);
    Outcome<int32_t> result{-99, 77};
    EXPECT_EQ((kIsComplex<T> ? CxCheckPosdef_head : CheckPosdef_head)(matrix.handle(), &result.value, &result.err), 0);
    return result;
}

template <class Value>
void ExpectFailure(const Outcome<Value>& outcome, int32_t status) {
    EXPECT_EQ(outcome.err, status);
    EXPECT_TRUE(IsQuietNaN(outcome.value));
}

template <class T>
DenseMatrix<T> Reals(int32_t m, int32_t n, const std::vector<double>& elements) {
    return Generate<T>(m, n, [&](int32_t i, int32_t j) { return FromReal<T>(elements[Count(i * n + j)]); });
}

template <class T>
class Measures : public testing::Test {};
using Elements = testing::Types<double, Complex>;
TYPED_TEST_SUITE(Measures, Elements);

// ---- Determinant ---------------------------------------------------------------------------------------------------

TYPED_TEST(Measures, DeterminantOfSmallIntegersIsExact) {
    using T = TypeParam;
    EXPECT_EQ(Determinant(Reals<T>(1, 1, {-7}), 0).value, FromReal<T>(-7));
    EXPECT_EQ(Determinant(Reals<T>(2, 2, {1, 2, 4, 3}), 0).value, FromReal<T>(-5));
    EXPECT_EQ(Determinant(Reals<T>(3, 3, {0, 1, 0, 0, 0, 1, 1, 0, 0}), 0).value, FromReal<T>(1));
    EXPECT_EQ(Determinant(Reals<T>(3, 3, {0, 1, 0, 1, 0, 0, 0, 0, 1}), 0).value, FromReal<T>(-1));
}

TYPED_TEST(Measures, DeterminantOfAProductIsTheProduct) {
    using T = TypeParam;
    for (int32_t n = 1; n <= 20; ++n) {
        const DenseMatrix<T> a = RandomMatrix<T>(n, n, 1), b = RandomMatrix<T>(n, n, 2);
        const T product = Determinant(a, 0).value * Determinant(b, 0).value;
        EXPECT_THAT(Determinant(Product(a, b), 0).value, Near(product, 1e-11));
    }
}

TYPED_TEST(Measures, DeterminantOfASingularMatrixIsZero) {
    using T = TypeParam;
    for (const auto& a : {DenseMatrix<T>(3, 3), Reals<T>(2, 2, {1, 2, 2, 4}), Reals<T>(2, 2, {0, 1, 0, 5})}) {
        const Outcome<T> result = Determinant(a, 0);
        EXPECT_EQ(result.err, 0);
        EXPECT_EQ(result.value, T{});
    }
}

TYPED_TEST(Measures, DeterminantOfATriangularMatrixReadsTheDiagonalAlone) {
    using T = TypeParam;
    DenseMatrix<T> a = Reals<T>(3, 3, {2, 9, 9, 9, -3, 9, 9, 9, 5});
    a(0, 1) = a(2, 0) = FromReal<T>(kQuietNaN);
    for (const int32_t type : {2, 3}) {
        const Outcome<T> result = Determinant(a, type);
        EXPECT_EQ(result.err, 0);
        EXPECT_EQ(result.value, FromReal<T>(-30));
    }
}

TYPED_TEST(Measures, DeterminantByCholeskyReadsTheLowerTriangle) {
    using T = TypeParam;
    DenseMatrix<T> a = Reals<T>(3, 3, {4, kQuietNaN, kQuietNaN, 2, 5, kQuietNaN, 6, 3, 14});
    EXPECT_THAT(Determinant(a, 1).value, Near(FromReal<T>(80.0), 1e-15));
    const DenseMatrix<T> b = RandomMatrix<T>(6, 6, 3);
    const DenseMatrix<T> definite = Product(b, Adjoint(b));
    const T by_cholesky = Determinant(definite, 1).value;
    EXPECT_THAT(by_cholesky, Near(FromReal<T>(RealPart(Determinant(definite, 0).value)), 1e-10));
    EXPECT_EQ(by_cholesky, FromReal<T>(RealPart(by_cholesky)));
}

TYPED_TEST(Measures, DeterminantFailsWhereTheMatrixIsNotDefinite) {
    using T = TypeParam;
    ExpectFailure(Determinant(Reals<T>(2, 2, {1, 2, 2, 1}), 1), kNotPositiveDefinite);
    ExpectFailure(Determinant(DenseMatrix<T>(2, 2), 1), kNotPositiveDefinite);
}

TYPED_TEST(Measures, DeterminantChecksShapeBeforeType) {
    using T = TypeParam;
    for (const int32_t type : {-1, 0, 1, 3, 4}) {
        ExpectFailure(Determinant(DenseMatrix<T>(0, 0), type), kEmptyInput);
        ExpectFailure(Determinant(DenseMatrix<T>(0, 3), type), kNotSquare);
        ExpectFailure(Determinant(DenseMatrix<T>(3, 0), type), kNotSquare);
        ExpectFailure(Determinant(DenseMatrix<T>(2, 3), type), kNotSquare);
    }
    for (const int32_t type : {-1, 4, 256}) ExpectFailure(Determinant(Identity<T>(2), type), kBadSelector);
}

// A NaN is never a pivot, so a column of nothing else counts as zero.
TYPED_TEST(Measures, DeterminantOfANaNColumnIsZero) {
    using T = TypeParam;
    const Outcome<T> result = Determinant(Reals<T>(2, 2, {kQuietNaN, 1, 0, 1}), 0);
    EXPECT_EQ(result.err, 0);
    EXPECT_EQ(result.value, T{});
}

TEST(CxDeterminant_head, MultipliesComplexPivots) {
    const DenseMatrix<Complex> a(2, 2, {{1, 1}, {2, 0}, {0, 3}, {4, -1}});
    EXPECT_THAT(Determinant(a, 0).value, Near(Complex{5, -3}, 1e-15));
}

// ---- Rank ----------------------------------------------------------------------------------------------------------

TYPED_TEST(Measures, RankCountsWhatIsAboveTheTolerance) {
    using T = TypeParam;
    const DenseMatrix<T> a = Reals<T>(3, 4, {8, 0, 0, 0, 0, 0.5, 0, 0, 0, 0, 2, 0});
    for (const double standard : {-1.0, -kInfinity, kQuietNaN}) EXPECT_EQ(Rank(a, standard).value, 3);
    EXPECT_EQ(Rank(a, 0.0).value, 3);
    EXPECT_EQ(Rank(a, 0.4).value, 3);
    EXPECT_EQ(Rank(a, 0.6).value, 2);
    EXPECT_EQ(Rank(a, 7.0).value, 1);
    EXPECT_EQ(Rank(a, kInfinity).value, 0);
    EXPECT_EQ(Rank(Reals<T>(1, 1, {-3}), 3.0).value, 0) << "the comparison is strict";
    EXPECT_EQ(Rank(Reals<T>(1, 1, {-3}), 2.9).value, 1);
}

TYPED_TEST(Measures, RankOfTheZeroMatrixIsZero) {
    const Outcome<int32_t> result = Rank(DenseMatrix<TypeParam>(3, 2), -1.0);
    EXPECT_EQ(result.err, 0);
    EXPECT_EQ(result.value, 0);
}

TYPED_TEST(Measures, RankSeesDependence) {
    using T = TypeParam;
    for (int32_t rank = 1; rank <= 6; ++rank) {
        EXPECT_EQ(Rank(RankDeficientMatrix<T>(8, 6, rank, 4), -1.0).value, rank);
        EXPECT_EQ(Rank(RankDeficientMatrix<T>(6, 8, rank, 5), -1.0).value, rank);
    }
}

TYPED_TEST(Measures, RankIsMinusOneOnFailure) {
    using T = TypeParam;
    const auto expect_failure = [](const DenseMatrix<T>& a, int32_t status) {
        const Outcome<int32_t> result = Rank(a, -1.0);
        EXPECT_EQ(result.err, status);
        EXPECT_EQ(result.value, -1);
    };
    for (const auto& [m, n] : {std::pair{0, 0}, {0, 3}, {3, 0}}) expect_failure(DenseMatrix<T>(m, n), kEmptyInput);
    expect_failure(Reals<T>(1, 2, {1, kInfinity}), kNotFinite);
    expect_failure(Reals<T>(2, 2, {1e308, 1e308, 1e308, 1e308}), kNoConvergence);
}

// ---- Norms ---------------------------------------------------------------------------------------------------------

TYPED_TEST(Measures, NormsOfASmallMatrix) {
    using T = TypeParam;
    const DenseMatrix<T> a = Reals<T>(2, 3, {1, -2, 3, -4, 5, 6});
    EXPECT_EQ(Norm(a, 1).value, 9.0);
    EXPECT_EQ(Norm(a, 3).value, 15.0);
    EXPECT_THAT(Norm(a, 2).value, Near(std::sqrt(91.0), 1e-15));
    // Squares of the singular values: the eigenvalues of [14 4; 4 77].
    EXPECT_THAT(Norm(a, 0).value, Near(std::sqrt((91.0 + std::sqrt(63.0 * 63.0 + 64.0)) / 2.0), 1e-14));
    for (const int32_t type : {0, 1, 2, 3}) EXPECT_EQ(Norm(DenseMatrix<T>(2, 2), type).value, 0.0);
}

TYPED_TEST(Measures, NormsOfManyColumnsAreThoseOfTheTranspose) {
    using T = TypeParam;
    for (const int32_t n : {1, 63, 64, 65, 200}) {
        const DenseMatrix<T> a = RandomMatrix<T>(7, n, 6);
        EXPECT_THAT(Norm(a, 1).value, Near(Norm(Adjoint(a), 3).value, 1e-14));
        EXPECT_THAT(Norm(a, 0).value, Near(Norm(Adjoint(a), 0).value, 1e-13));
    }
}

TYPED_TEST(Measures, NormChecksSizeThenDataThenSelector) {
    using T = TypeParam;
    for (const int32_t type : {-1, 0, 3, 4})
        for (const auto& [m, n] : {std::pair{0, 0}, {0, 3}, {3, 0}})
            ExpectFailure(Norm(DenseMatrix<T>(m, n), type), kEmptyInput);
    for (const double bad : {kQuietNaN, kInfinity, std::numeric_limits<double>::max(), -1.7976931348623e308})
        for (const int32_t type : {-1, 0, 1, 2, 3, 4}) ExpectFailure(Norm(Reals<T>(1, 2, {1, bad}), type), kNotFinite);
    for (const int32_t type : {-1, 4}) ExpectFailure(Norm(Identity<T>(2), type), kBadSelector);
}

TEST(CxNorm_head, TakesPlainModuli) {
    const DenseMatrix<Complex> a(1, 2, {{3, 4}, {5, -12}});
    EXPECT_EQ(Norm(a, 1).value, 13.0);
    EXPECT_EQ(Norm(a, 3).value, 18.0);
    EXPECT_THAT(Norm(a, 2).value, Near(std::sqrt(194.0), 1e-15));
    const DenseMatrix<Complex> huge(1, 1, {{1e200, 0}}), tiny(1, 1, {{1e-200, 0}});
    EXPECT_EQ(Norm(huge, 1).value, kInfinity);
    EXPECT_EQ(Norm(tiny, 3).value, 0.0);
    EXPECT_EQ(Norm(huge, 2).value, kInfinity);
}

TEST(Norm_head, KeepsLargeMagnitudes) {
    EXPECT_EQ(Norm(Reals<double>(1, 1, {-1e200}), 1).value, 1e200);
    EXPECT_EQ(Norm(Reals<double>(1, 1, {-1e-200}), 3).value, 1e-200);
    EXPECT_EQ(Norm(Reals<double>(1, 1, {1e200}), 2).value, kInfinity);
}

// Below epsilon the bidiagonal form counts as diagonal.
TYPED_TEST(Measures, TwoNormOfATinyMatrixIsThatOfItsBidiagonalForm) {
    using T = TypeParam;
    const DenseMatrix<T> a = Reals<T>(2, 2, {1e-20, 2e-20, 3e-20, 4e-20});
    EXPECT_THAT(Norm(a, 0).value, Near(std::sqrt(10.0) * 1e-20, 1e-14));
    EXPECT_THAT(Condition(a, 0).value, Near(5.0, 1e-14));
}

// ---- Condition -----------------------------------------------------------------------------------------------------

TYPED_TEST(Measures, ConditionOfSmallMatrices) {
    using T = TypeParam;
    const DenseMatrix<T> a = Reals<T>(2, 2, {1, 2, 3, 4});  // inverse [-2 1; 1.5 -0.5]
    EXPECT_THAT(Condition(a, 1).value, Near(6.0 * 3.5, 1e-14));
    EXPECT_THAT(Condition(a, 3).value, Near(7.0 * 3.0, 1e-14));
    EXPECT_THAT(Condition(a, 2).value, Near(std::sqrt(30.0) * std::sqrt(7.5), 1e-14));
    EXPECT_THAT(Condition(a, 0).value, Near((15.0 + std::sqrt(221.0)) / 2.0, 1e-13));
    for (const int32_t type : {0, 1, 3}) EXPECT_EQ(Condition(Identity<T>(5), type).value, 1.0);
}

TYPED_TEST(Measures, ConditionOfAHilbertMatrix) {
    using T = TypeParam;
    // Two-norm condition of order 6: 1.495105864225466e7; one-norm: 2.907027900294878e7.
    EXPECT_THAT(Condition(HilbertMatrix<T>(6, 6), 0).value, Near(1.495105864225466e7, 1e-8));
    EXPECT_THAT(Condition(HilbertMatrix<T>(6, 6), 1).value, Near(2.907027900294878e7, 1e-8));
}

TYPED_TEST(Measures, ConditionOfASingularMatrixIsInfinite) {
    using T = TypeParam;
    for (const int32_t type : {0, 1, 2, 3}) {
        for (const auto& a : {Reals<T>(2, 2, {1, 2, 2, 4}), DenseMatrix<T>(3, 3)}) {
            const Outcome<double> result = Condition(a, type);
            EXPECT_EQ(result.err, 0);
            EXPECT_EQ(result.value, kInfinity);
        }
    }
}

TYPED_TEST(Measures, ConditionOfAnyShapeByTheTwoNormOnly) {
    using T = TypeParam;
    const DenseMatrix<T> a = Reals<T>(2, 3, {3, 0, 0, 0, 4, 0});
    EXPECT_THAT(Condition(a, 0).value, Near(4.0 / 3.0, 1e-15));
    EXPECT_EQ(Condition(a, 0).err, 0);
    for (const int32_t type : {1, 2, 3}) ExpectFailure(Condition(a, type), kNotSquare);
}

TYPED_TEST(Measures, ConditionChecksSizeThenDataThenSelectorThenShape) {
    using T = TypeParam;
    for (const int32_t type : {-1, 0, 1, 4})
        for (const auto& [m, n] : {std::pair{0, 0}, {0, 3}, {3, 0}})
            ExpectFailure(Condition(DenseMatrix<T>(m, n), type), kEmptyInput);
    for (const int32_t type : {-1, 0, 1, 4}) ExpectFailure(Condition(Reals<T>(1, 2, {1, kQuietNaN}), type), kNotFinite);
    for (const int32_t type : {-1, 4}) ExpectFailure(Condition(DenseMatrix<T>(2, 3), type), kBadSelector);
}

// ---- Definiteness --------------------------------------------------------------------------------------------------

TYPED_TEST(Measures, PositiveDefinitenessFollowsFromTheEigenvalues) {
    using T = TypeParam;
    const auto flag = [](const DenseMatrix<T>& a) {
        const Outcome<int32_t> result = PositiveDefinite(a);
        EXPECT_EQ(result.err, 0);
        return result.value;
    };
    EXPECT_EQ(flag(Identity<T>(4)), 1);
    EXPECT_EQ(flag(Reals<T>(2, 2, {2, -1, -1, 2})), 1);
    EXPECT_EQ(flag(Reals<T>(2, 2, {1, 2, 2, 1})), 0);
    EXPECT_EQ(flag(Reals<T>(2, 2, {-1, 0, 0, -1})), 0);
    EXPECT_EQ(flag(DenseMatrix<T>(2, 2)), 0);
    EXPECT_EQ(flag(Reals<T>(2, 2, {1, 0, 0, kEpsilon})), 0) << "at the threshold";
    EXPECT_EQ(flag(Reals<T>(2, 2, {1, 0, 0, 2.0 * kEpsilon})), 1);
    EXPECT_EQ(flag(Reals<T>(1, 1, {1e-300})), 1);
    EXPECT_EQ(flag(Reals<T>(1, 1, {0})), 0);
}

TYPED_TEST(Measures, PositiveDefinitenessAsksForSymmetryToTheLastBit) {
    using T = TypeParam;
    DenseMatrix<T> a = Reals<T>(3, 3, {4, 1, 0.5, 1, 4, 1, 0.5, 1, 4});
    EXPECT_EQ(PositiveDefinite(a).value, 1);
    a(2, 0) = FromReal<T>(std::nextafter(0.5, 1.0));
    const Outcome<int32_t> result = PositiveDefinite(a);
    EXPECT_EQ(result.value, 0);
    EXPECT_EQ(result.err, 0);
}

TYPED_TEST(Measures, PositiveDefinitenessIsZeroOnFailure) {
    using T = TypeParam;
    const auto expect = [](const DenseMatrix<T>& a, int32_t status) {
        const Outcome<int32_t> result = PositiveDefinite(a);
        EXPECT_EQ(result.err, status);
        EXPECT_EQ(result.value, 0);
    };
    expect(DenseMatrix<T>(0, 0), kEmptyInput);
    for (const auto& [m, n] : {std::pair{0, 3}, {3, 0}, {2, 3}}) expect(DenseMatrix<T>(m, n), kNotSquare);
    expect(Reals<T>(2, 2, {1, kInfinity, kInfinity, 1}), kNotFinite);
    // NaN is no mirror of itself; on the diagonal only the Hermitian form looks at it.
    expect(Reals<T>(2, 2, {1, kQuietNaN, kQuietNaN, 1}), kOk);
    expect(Reals<T>(2, 2, {1, 0, 0, kQuietNaN}), kIsComplex<T> ? kOk : kNotFinite);
}

TEST(CxCheckPosdef_head, AsksForAHermitianMatrix) {
    EXPECT_EQ(PositiveDefinite(DenseMatrix<Complex>(2, 2, {{2, 0}, {0, 1}, {0, -1}, {2, 0}})).value, 1);
    EXPECT_EQ(PositiveDefinite(DenseMatrix<Complex>(2, 2, {{2, 0}, {0, 1}, {0, 1}, {2, 0}})).value, 0);
    EXPECT_EQ(PositiveDefinite(DenseMatrix<Complex>(2, 2, {{2, 1e-30}, {0, 1}, {0, -1}, {2, 0}})).value, 0);
    EXPECT_EQ(PositiveDefinite(DenseMatrix<Complex>(1, 1, {{2, -0.0}})).value, 1);
}

}  // namespace
}  // namespace krnumer

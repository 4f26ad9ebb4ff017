#include "linalg/cholesky.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cmath>

#include "frame/status.h"
#include "krnumer/linalg_factor.h"
#include "linalg/matrices.h"
#include "linalg/packed.h"
#include "reference/linalg/factor.inc"
#include "support/vector_units.h"

namespace krnumer {
namespace {

template <class T>
std::vector<T> PackedLower(const Matrix<T>& a) {
    std::vector<T> packed(PackedCount(a.rows));
    PackTriangle(a.data(), a.rows, kLower, packed.data());
    return packed;
}

template <class T>
Matrix<T> Unpacked(const std::vector<T>& packed, int32_t n) {
    Matrix<T> a(n, n);
    UnpackTriangle(packed.data(), n, kLower, a.data());
    return a;
}

// Column by column, each reduced by all columns before it.
template <class T>
Matrix<T> FactorColumnByColumn(Matrix<T> l) {
    const int32_t n = l.rows;
    for (int32_t j = 0; j < n; ++j) {
        for (int32_t k = 0; k < j; ++k)
            for (int32_t i = j; i < n; ++i) l(i, j) -= l(i, k) * Conjugate(l(j, k));
        l(j, j) = FromReal<T>(std::sqrt(RealPart(l(j, j))));
        for (int32_t i = j + 1; i < n; ++i) l(i, j) = l(i, j) / l(j, j);
        for (int32_t i = 0; i < j; ++i) l(i, j) = T{};
    }
    return l;
}

template <class T>
class Cholesky : public testing::Test {
  protected:
    static constexpr auto Packed = Pick<T>(Cholesky_head, CxCholesky_head);
    static constexpr auto Full = Pick<T>(FullCholesky_head, CxFullCholesky_head);

    int32_t CallPacked(const std::vector<T>& elements) {
        packed_ = HostArray<T>(elements);
        EXPECT_EQ(Packed(packed_.handle(), &err_), 0);
        if (err_ != kOk) {
            EXPECT_TRUE(packed_.empty());
        }
        return err_;
    }

    int32_t CallFull(const Matrix<T>& a) {
        full_ = ToHost(a);
        EXPECT_EQ(Full(full_.handle(), &err_), err_);
        if (err_ != kOk) {
            EXPECT_TRUE(full_.empty());
        }
        return err_;
    }

    static T R(double x) { return FromReal<T>(x); }

    LeakCheck leaks_;
    HostArray<T> packed_;
    HostMatrix<T> full_;
    int32_t err_ = 77;
};
TYPED_TEST_SUITE(Cholesky, ElementTypes);

TYPED_TEST(Cholesky, FactorsLikeTheReference) {
    const auto& golden = GoldenFactor<TypeParam>::Values();
    EXPECT_EQ(this->CallPacked(PackedLower(golden.definite)), kOk);
    EXPECT_THAT(this->packed_.values(), AllNear(golden.packed_l, 1e-13, 1e-13));
    EXPECT_EQ(this->CallFull(golden.definite), kOk);
    const auto upper = Adjoint(Unpacked(golden.packed_l, 5));
    EXPECT_THAT(this->full_.values(), AllNear(upper.elements, 1e-13, 1e-13));
}

TYPED_TEST(Cholesky, ReproducesTheMatrix) {
    using T = TypeParam;
    for (const int32_t n : {1, 2, 3, 4, 5, 6, 7, 8, 9, 13, 20, 35, 60, 200}) {
        const Matrix<T> a = PositiveDefinite<T>(n, static_cast<uint64_t>(n));
        std::vector<T> packed = PackedLower(a);
        ASSERT_EQ(CholeskyPacked(packed.data(), n), kOk);
        const Matrix<T> l = Unpacked(packed, n);
        EXPECT_LE(Distance(Product(l, Adjoint(l)), a), n * kEpsilon * FrobeniusNorm(a)) << n;

        Matrix<T> r = a;
        ASSERT_EQ(CholeskyUpper(r.data(), n), kOk);
        EXPECT_EQ(r, Adjoint(l));
    }
}

TYPED_TEST(Cholesky, RoundsAsColumnByColumn) {
    using T = TypeParam;
    OnEveryVectorUnit([] {
        for (int32_t n = 1; n <= 45; ++n) {
            const Matrix<T> a = PositiveDefinite<T>(n, static_cast<uint64_t>(n));
            std::vector<T> packed = PackedLower(a);
            ASSERT_EQ(CholeskyPacked(packed.data(), n), kOk);
            ASSERT_EQ(Unpacked(packed, n), FactorColumnByColumn(a)) << n;
        }
    });
}

TYPED_TEST(Cholesky, IsExactOnIntegers) {
    using T = TypeParam;
    EXPECT_EQ(this->CallPacked({this->R(4), this->R(2), this->R(-2), this->R(10), this->R(2), this->R(6)}), kOk);
    EXPECT_EQ(this->packed_.values(),
              (std::vector<T>{this->R(2), this->R(1), this->R(-1), this->R(3), this->R(1), this->R(2)}));
}

TYPED_TEST(Cholesky, RefusesWhatIsNotPositiveDefinite) {
    EXPECT_EQ(this->CallPacked({this->R(0)}), kNotPositiveDefinite);
    EXPECT_EQ(this->CallPacked({this->R(-1)}), kNotPositiveDefinite);
    EXPECT_EQ(this->CallPacked({this->R(1), this->R(2), this->R(4)}), kNotPositiveDefinite);
    EXPECT_EQ(this->CallFull(Matrix<TypeParam>(2, 2)), kNotPositiveDefinite);
    // The last of many rows, behind all that is done several rows at a time.
    Matrix<TypeParam> a = PositiveDefinite<TypeParam>(11, 1);
    a(10, 10) = this->R(-1);
    EXPECT_EQ(this->CallFull(a), kNotPositiveDefinite);
}

TYPED_TEST(Cholesky, LetsNaNFlow) {
    const TypeParam nan = this->R(kQuietNaN);
    EXPECT_EQ(this->CallPacked({this->R(1), nan, this->R(4)}), kOk);
    EXPECT_EQ(this->packed_[0], this->R(1));
    EXPECT_TRUE(std::isnan(RealPart(this->packed_[2])));
}

// Only the real factorisation refuses a matrix that is definite but nearly singular.
TYPED_TEST(Cholesky, JudgesSmallPivotsByTheFamily) {
    using T = TypeParam;
    const int32_t verdict = kIsComplex<T> ? kOk : kNotPositiveDefinite;
    const auto diagonal = [this](double a, double b) { return std::vector<T>{this->R(a), T{}, this->R(b)}; };
    EXPECT_EQ(this->CallPacked(diagonal(1.0, 0x1p-52)), kOk);
    EXPECT_EQ(this->CallPacked(diagonal(1.0, 0x1p-53)), verdict);
    // A small pivot fails although it comes first, once a large element follows.
    EXPECT_EQ(this->CallPacked(diagonal(0x1p-53, 1.0)), verdict);
    // Elements off the diagonal count: L is (1; 2^30 2^10).
    EXPECT_EQ(this->CallPacked({this->R(1), this->R(0x1p30), this->R(0x1p60 + 0x1p20)}), verdict);
}

TYPED_TEST(Cholesky, FactorsTheHilbertMatrixUpToOrder13) {
    EXPECT_EQ(this->CallFull(HilbertMatrix<TypeParam>(13, 13)), kOk);
    EXPECT_EQ(this->CallFull(HilbertMatrix<TypeParam>(14, 14)), kNotPositiveDefinite);
}

TYPED_TEST(Cholesky, ReadsTheLowerTriangleOnly) {
    using T = TypeParam;
    const T nan = this->R(kQuietNaN);
    EXPECT_EQ(this->CallFull(Matrix<T>(2, 2, {this->R(4), nan, this->R(2), this->R(5)})), kOk);
    EXPECT_EQ(FromHost(this->full_), Matrix<T>(2, 2, {this->R(2), this->R(1), T{}, this->R(2)}));
}

TYPED_TEST(Cholesky, PackedChecksTheLength) {
    EXPECT_EQ(this->CallPacked({}), kEmptyInput);
    EXPECT_EQ(this->CallPacked(std::vector<TypeParam>(2)), kNotSquare);
    EXPECT_EQ(this->CallPacked(std::vector<TypeParam>(5)), kNotSquare);
}

TYPED_TEST(Cholesky, FullChecksTheSizeLast) {
    const auto status_of = [this](int32_t rows, int32_t columns) {
        HostMatrix<TypeParam> a(2, 3);
        a.SetDimension(0, rows);
        a.SetDimension(1, columns);
        this->err_ = 77;
        EXPECT_EQ(this->Full(a.handle(), &this->err_), this->err_);
        EXPECT_TRUE(a.empty());
        return this->err_;
    };
    EXPECT_EQ(status_of(2, 3), kNotSquare);
    EXPECT_EQ(status_of(0, 3), kEmptyInput);
    EXPECT_EQ(status_of(0, 0), kEmptyInput);
}

TEST(ComplexCholesky, TakesTheRealPartOfTheDiagonal) {
    HostArray<Complex> packed{{4, 100}, {0, 2}, {2, -3}};
    int32_t err = 77;
    CxCholesky_head(packed.handle(), &err);
    EXPECT_EQ(err, kOk);
    EXPECT_EQ(packed.values(), (std::vector<Complex>{{2, 0}, {0, 1}, {1, 0}}));
}

TEST(CholeskyPacked, NeedsAnOrder) {
    double real = 1.0;
    Complex complex{1.0, 0.0};
    EXPECT_EQ(CholeskyPacked(&real, 0), kEmptyInput);
    EXPECT_EQ(CholeskyPacked(&complex, -1), kEmptyInput);
}

}  // namespace
}  // namespace krnumer

// Linear equations by factors and packed triangles that the caller holds.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "frame/status.h"
#include "krnumer/linalg_factor.h"
#include "krnumer/linalg_solve.h"
#include "linalg/cores.h"
#include "linalg/matrices.h"

namespace krnumer {
namespace {

using testing::ElementsAre;

template <class T>
class FactoredSolve : public testing::Test {
  protected:
    static constexpr auto LU = Pick<T>(LULinEqs_head, CxLULinEqs_head);
    static constexpr auto Cholesky = Pick<T>(CholeskyLinEqs_head, CxCholeskyLinEqs_head);
    static constexpr auto Triangular = Pick<T>(TriLinEqs_head, CxTriLinEqs_head);

    static T R(double x) { return FromReal<T>(x); }
    static std::vector<T> Rs(std::initializer_list<double> values) {
        std::vector<T> elements;
        for (const double x : values) elements.push_back(R(x));
        return elements;
    }

    int32_t SolveLU(const HostMatrix<T>& lu, const HostBlock& pivots, const std::vector<T>& b) {
        x_ = HostArray<T>(b);
        EXPECT_EQ(LU(lu.handle(), pivots.handle(), x_.handle(), &err_), 0);
        return Checked();
    }

    int32_t SolveCholesky(const std::vector<T>& l, const std::vector<T>& b) {
        x_ = HostArray<T>(b);
        const HostArray<T> factor(l);
        EXPECT_EQ(Cholesky(factor.handle(), x_.handle(), &err_), 0);
        return Checked();
    }

    int32_t SolveTriangle(const std::vector<T>& elements, int32_t triangle, const std::vector<T>& b) {
        x_ = HostArray<T>(b);
        const HostArray<T> packed(elements);
        const KrTriangle record{packed.handle(), triangle};
        EXPECT_EQ(Triangular(&record, x_.handle(), &err_), 0);
        return Checked();
    }

    int32_t Checked() {
        if (err_ != kOk) {
            EXPECT_TRUE(x_.empty());
        }
        return err_;
    }

    LeakCheck leaks_;
    HostArray<T> x_;
    int32_t err_ = 77;
};
TYPED_TEST_SUITE(FactoredSolve, ElementTypes);

TYPED_TEST(FactoredSolve, LUGoesOnFromTheFactorisation) {
    using T = TypeParam;
    for (const int32_t n : {1, 2, 3, 4, 5, 6, 7, 8, 9, 21, 60}) {
        const Matrix<T> a = RandomMatrix<T>(n, n, 5), b = RandomMatrix<T>(n, 1, 6);
        HostMatrix<T> lu = ToHost(a);
        HostArray<double> pivots;
        int32_t sign = 0;
        Pick<T>(LU_head, CxLU_head)(lu.handle(), pivots.handle(), &sign, &this->err_);
        ASSERT_EQ(this->err_, kOk);
        const Matrix<T> factors = FromHost(lu);
        ASSERT_EQ(this->SolveLU(lu, pivots, b.elements), kOk);
        const Matrix<T> x(n, 1, this->x_.values());
        EXPECT_LE(Distance(Product(a, x), b), 8.0 * n * kEpsilon * FrobeniusNorm(a) * FrobeniusNorm(x)) << n;
        EXPECT_EQ(FromHost(lu), factors);

        // What the driver gives is the same.
        std::vector<T> direct(Count(n));
        ASSERT_EQ(LUSolveDirect(a.data(), n, b.data(), direct.data()), kOk);
        EXPECT_EQ(direct, x.elements);
    }
}

TYPED_TEST(FactoredSolve, LUTakesPivotsOfFourBytesToo) {
    using T = TypeParam;
    const HostMatrix<T> lu(2, 2, {this->R(2), T{}, T{}, this->R(4)});
    const HostArray<int32_t> pivots{1, 1};
    EXPECT_EQ(this->SolveLU(lu, pivots, this->Rs({4, 2})), kOk);
    EXPECT_THAT(this->x_.values(), ElementsAre(this->R(1), this->R(1)));
}

TYPED_TEST(FactoredSolve, LUReportsZerosOnTheDiagonal) {
    using T = TypeParam;
    const auto status_of = [this](double first, double last) {
        const HostMatrix<T> lu(2, 2, {this->R(first), T{}, T{}, this->R(last)});
        return this->SolveLU(lu, Pivots({0, 1}), this->Rs({1, 1}));
    };
    EXPECT_EQ(status_of(0.0, 1.0), kSingular);
    EXPECT_EQ(status_of(1.0, 0.0), kSingular);
    EXPECT_EQ(status_of(1.0, -0.0), kSingular);
    EXPECT_EQ(status_of(1e-300, 1.0), kOk);
    EXPECT_EQ(status_of(kQuietNaN, 1.0), kOk);
}

TYPED_TEST(FactoredSolve, LURefusesPivotsOutsideTheMatrix) {
    using T = TypeParam;
    const HostMatrix<T> singular(2, 2);
    for (const std::vector<int32_t>& pivots : {std::vector<int32_t>{0, 2}, {-1, 1}, {1 << 30, 0}}) {
        EXPECT_EQ(this->SolveLU(singular, Pivots(pivots), this->Rs({1, 1})), kBadIndex);
    }
}

TYPED_TEST(FactoredSolve, LUChecksTheLengthsLast) {
    using T = TypeParam;
    HostMatrix<T> lu(2, 3);
    EXPECT_EQ(this->SolveLU(lu, Pivots({0, 1}), this->Rs({1, 1})), kNotSquare);
    EXPECT_EQ(this->SolveLU(lu, Pivots({0}), this->Rs({1, 1})), kSizesDiffer);
    EXPECT_EQ(this->SolveLU(lu, Pivots({0, 1}), this->Rs({1})), kSizesDiffer);
    lu.SetDimension(0, 0);
    EXPECT_EQ(this->SolveLU(lu, Pivots({}), {}), kNotSquare);
    lu.SetDimension(1, 0);
    EXPECT_EQ(this->SolveLU(lu, Pivots({}), {}), kEmptyInput);
    EXPECT_EQ(this->SolveLU(lu, Pivots({}), this->Rs({1})), kSizesDiffer);
}

TYPED_TEST(FactoredSolve, CholeskyGoesOnFromTheFactorisation) {
    using T = TypeParam;
    for (const int32_t n : {1, 2, 3, 4, 5, 9, 30}) {
        const Matrix<T> a = PositiveDefinite<T>(n, 5), b = RandomMatrix<T>(n, 1, 6);
        std::vector<T> packed(PackedCount(n));
        PackTriangle(a.data(), n, kLower, packed.data());
        ASSERT_EQ(CholeskyPacked(packed.data(), n), kOk);
        ASSERT_EQ(this->SolveCholesky(packed, b.elements), kOk);
        const Matrix<T> x(n, 1, this->x_.values());
        EXPECT_LE(Distance(Product(a, x), b), 4.0 * n * kEpsilon * FrobeniusNorm(a) * FrobeniusNorm(x)) << n;
    }
}

TYPED_TEST(FactoredSolve, CholeskyTestsNeitherDiagonalNorData) {
    EXPECT_EQ(this->SolveCholesky(this->Rs({0}), this->Rs({1})), kOk);
    EXPECT_FALSE(std::isfinite(RealPart(this->x_[0])));
    EXPECT_EQ(this->SolveCholesky(this->Rs({kQuietNaN}), this->Rs({1})), kOk);
    EXPECT_TRUE(std::isnan(RealPart(this->x_[0])));
    EXPECT_EQ(this->SolveCholesky(this->Rs({2}), this->Rs({kInfinity})), kOk);
}

TYPED_TEST(FactoredSolve, CholeskyChecksTheLengthOfTheRightSideLast) {
    EXPECT_EQ(this->SolveCholesky({}, {}), kEmptyInput);
    EXPECT_EQ(this->SolveCholesky({}, this->Rs({1})), kSizesDiffer);
    // 5 elements hold a triangle of order 2.
    EXPECT_EQ(this->SolveCholesky(this->Rs({1, 1, 1, 1, 1}), this->Rs({1, 1})), kNotSquare);
    EXPECT_EQ(this->SolveCholesky(this->Rs({1, 1, 1, 1, 1}), this->Rs({1, 1, 1})), kSizesDiffer);
    EXPECT_EQ(this->SolveCholesky(this->Rs({1, 1, 1}), this->Rs({1, 1, 1})), kSizesDiffer);
}

TYPED_TEST(FactoredSolve, TriangularSolvesBothWays) {
    // (2 .; 1 4) and (2 1; . 4)
    EXPECT_EQ(this->SolveTriangle(this->Rs({2, 1, 4}), 0, this->Rs({2, 9})), kOk);
    EXPECT_THAT(this->x_.values(), ElementsAre(this->R(1), this->R(2)));
    EXPECT_EQ(this->SolveTriangle(this->Rs({2, 1, 4}), 1, this->Rs({4, 8})), kOk);
    EXPECT_THAT(this->x_.values(), ElementsAre(this->R(1), this->R(2)));
}

TYPED_TEST(FactoredSolve, TriangularTakesOtherSelectorsByTheFamily) {
    using T = TypeParam;
    for (const int32_t triangle : {5, 2, -1}) {
        const int32_t status = this->SolveTriangle(this->Rs({2, 1, 4}), triangle, this->Rs({4, 8}));
        if (kIsComplex<T>) {
            EXPECT_EQ(status, kBadSelector);
        } else {
            EXPECT_EQ(status, kOk);
            EXPECT_THAT(this->x_.values(), ElementsAre(this->R(1), this->R(2)));
        }
        // Whatever the selector, the lengths go before it.
        EXPECT_EQ(this->SolveTriangle(this->Rs({2, 1}), triangle, this->Rs({1})), kNotSquare);
        EXPECT_EQ(this->SolveTriangle({}, triangle, {}), kEmptyInput);
        EXPECT_EQ(this->SolveTriangle(this->Rs({2, 1, 4}), triangle, this->Rs({1})), kSizesDiffer);
        EXPECT_EQ(this->SolveTriangle(this->Rs({2, 1}), triangle, this->Rs({1, 2})), kSizesDiffer);
    }
}

TYPED_TEST(FactoredSolve, TriangularRefusesBadData) {
    EXPECT_EQ(this->SolveTriangle(this->Rs({kQuietNaN}), 0, this->Rs({1})), kNotFinite);
    EXPECT_EQ(this->SolveTriangle(this->Rs({1}), 0, this->Rs({-kInfinity})), kNotFinite);
    EXPECT_EQ(this->SolveTriangle(this->Rs({0, kQuietNaN, 1}), 1, this->Rs({1, 1})), kNotFinite);
}

// The cut is relative to the largest element; the complex family compares squares, without scaling.
TYPED_TEST(FactoredSolve, TriangularJudgesSingularityByTheFamily) {
    using T = TypeParam;
    const auto status_of = [this](std::initializer_list<double> elements) {
        return this->SolveTriangle(this->Rs(elements), 0, this->Rs({1, 1}));
    };
    const auto by_family = [](int32_t real, int32_t complex) { return kIsComplex<T> ? complex : real; };
    EXPECT_EQ(status_of({1, 0, 0}), kSingular);
    EXPECT_EQ(status_of({0, 0, 0}), kSingular);
    EXPECT_EQ(status_of({1, 0, 1e-10}), by_family(kOk, kSingular));
    EXPECT_EQ(status_of({1, 0, 1e-7}), kOk);
    EXPECT_EQ(status_of({1, 0, 0x1p-52}), kSingular);
    EXPECT_EQ(status_of({1, 0, 0x1.00001p-52}), by_family(kOk, kSingular));
    EXPECT_EQ(status_of({0x1p-26, 0, 1}), by_family(kOk, kSingular));
    EXPECT_EQ(status_of({0x1.00001p-26, 0, 1}), kOk);
    // The largest element may be off the diagonal.
    EXPECT_EQ(status_of({1, 1e17, 1}), kSingular);
    EXPECT_EQ(status_of({1e200, 0, 1e200}), by_family(kOk, kSingular));
    EXPECT_EQ(status_of({1e-200, 0, 1e-200}), by_family(kOk, kSingular));
}

}  // namespace
}  // namespace krnumer

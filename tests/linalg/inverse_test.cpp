#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "frame/status.h"
#include "krnumer/linalg_factor.h"
#include "krnumer/linalg_inverse.h"
#include "linalg/cores.h"
#include "linalg/matrices.h"
#include "reference/linalg/solve.inc"
#include "support/vector_units.h"

namespace krnumer {
namespace {

template <class T>
class Inverse : public testing::Test {
  protected:
    static constexpr auto LU = Pick<T>(InvMatrixLUDri_head, CxInvMatrixLUDri_head);
    static constexpr auto Cholesky = Pick<T>(InvMatrixChoDri_head, CxInvMatrixChoDri_head);
    static constexpr auto Triangular = Pick<T>(InvMatrixTriDri_head, CxInvMatrixTriDri_head);
    static constexpr auto LUFactors = Pick<T>(LUInvMatrix_head, CxLUInvMatrix_head);
    static constexpr auto CholeskyFactor = Pick<T>(Cholesky_InvMatrix_head, CxCholesky_InvMatrix_head);
    static constexpr auto PackedTriangle = Pick<T>(Tri_InvMatrix_head, CxTri_InvMatrix_head);
    static constexpr auto Pseudo = Pick<T>(PseudoInverse_head, CxPseudoInverse_head);

    static T R(double x) { return FromReal<T>(x); }
    static std::vector<T> Rs(std::initializer_list<double> values) {
        std::vector<T> elements;
        for (const double x : values) elements.push_back(R(x));
        return elements;
    }

    // Calls invert(handle, err) on a copy of the array and gives the status; failures leave it empty.
    template <class Array, class Function>
    int32_t Call(Array& array, Function invert) {
        err_ = 77;
        EXPECT_EQ(invert(array.handle(), &err_), 0);
        if (err_ != kOk) {
            EXPECT_TRUE(array.empty());
        }
        return err_;
    }
    template <class Function>
    int32_t Invert(const Matrix<T>& a, Function invert) {
        matrix_ = ToHost(a);
        return Call(matrix_, invert);
    }
    int32_t InvertTriangle(const Matrix<T>& a, int32_t triangle) {
        return Invert(a, [triangle](KrHandle handle, int32_t* err) { return Triangular(handle, &triangle, err); });
    }
    int32_t InvertLUFactors(const Matrix<T>& a, const HostBlock& pivots) {
        return Invert(a, [&](KrHandle handle, int32_t* err) { return LUFactors(handle, pivots.handle(), err); });
    }
    int32_t InvertPseudo(const Matrix<T>& a, double tol) {
        return Invert(a, [tol](KrHandle handle, int32_t* err) { return Pseudo(handle, &tol, err); });
    }
    int32_t InvertPacked(const std::vector<T>& elements, int32_t triangle) {
        packed_ = HostArray<T>(elements);
        KrTriangle record{packed_.handle(), triangle};
        EXPECT_EQ(PackedTriangle(&record, &err_), 0);
        EXPECT_EQ(record.elements, packed_.handle());
        EXPECT_EQ(record.triangle, triangle);
        if (err_ != kOk) {
            EXPECT_TRUE(packed_.empty());
        }
        return err_;
    }

    void ExpectInverse(const Matrix<T>& a, double units) {
        const Matrix<T> x = FromHost(matrix_);
        EXPECT_LE(Distance(Product(a, x), Identity<T>(a.rows)),
                  units * a.rows * kEpsilon * FrobeniusNorm(a) * FrobeniusNorm(x))
            << a.rows;
    }

    // The status on a matrix whose dimension words say what no matrix can be.
    template <class Function>
    int32_t OnSize(int32_t rows, int32_t columns, Function invert) {
        HostMatrix<T> a(3, 3);
        a.SetDimension(0, rows);
        a.SetDimension(1, columns);
        return Call(a, invert);
    }

    LeakCheck leaks_;
    HostMatrix<T> matrix_;
    HostArray<T> packed_;
    int32_t err_ = 77;
};
TYPED_TEST_SUITE(Inverse, ElementTypes);

TYPED_TEST(Inverse, AgreesWithTheReference) {
    using T = TypeParam;
    const auto& g = GoldenSolve<T>::Values();
    EXPECT_EQ(this->Invert(g.square, this->LU), kOk);
    EXPECT_THAT(this->matrix_.values(), AllNear(g.inverse.elements, 1e-12, 1e-14));
    EXPECT_EQ(this->Invert(g.definite, this->Cholesky), kOk);
    EXPECT_THAT(this->matrix_.values(), AllNear(g.definite_inverse.elements, 1e-10, 1e-14));
    for (const auto& [a, inverse] : {std::tie(g.tall, g.tall_inverse), std::tie(g.wide, g.wide_inverse),
                                     std::tie(g.deficient, g.deficient_inverse)}) {
        EXPECT_EQ(this->InvertPseudo(a, -1.0), kOk);
        EXPECT_EQ(this->matrix_.rows(), inverse.rows);
        EXPECT_EQ(this->matrix_.columns(), inverse.columns);
        EXPECT_THAT(this->matrix_.values(), AllNear(inverse.elements, 1e-12, 1e-14));
    }
}

// --- LU -------------------------------------------------------------------------------------------------------------

TYPED_TEST(Inverse, LULeavesASmallResidual) {
    using T = TypeParam;
    for (const int32_t n : {1, 2, 3, 4, 5, 6, 7, 9, 16, 33, 60, 200}) {
        const Matrix<T> a = RandomMatrix<T>(n, n, 4);
        ASSERT_EQ(this->Invert(a, this->LU), kOk);
        this->ExpectInverse(a, 4.0);
    }
}

// Each column is the solution for a unit vector, to the bit.
TYPED_TEST(Inverse, LUSolvesForEveryUnitVector) {
    using T = TypeParam;
    OnEveryVectorUnit([] {
        for (const int32_t n : {1, 2, 3, 5, 8, 17, 30}) {
            Matrix<T> lu = RandomMatrix<T>(n, n, 7), inverse(n, n);
            std::vector<int32_t> pivots(Count(n));
            int32_t parity = 0;
            ASSERT_EQ(LUFactor(lu.data(), n, pivots.data(), &parity), kOk);
            ASSERT_EQ(LUInverse(lu.data(), pivots.data(), n, inverse.data()), kOk);
            for (int32_t j = 0; j < n; ++j) {
                std::vector<T> x(Count(n));
                x[Count(j)] = FromReal<T>(1.0);
                ASSERT_EQ(LUSolve(lu.data(), pivots.data(), x.data(), n, x.data()), kOk);
                for (int32_t i = 0; i < n; ++i) ASSERT_EQ(inverse(i, j), x[Count(i)]) << n << ' ' << i << ' ' << j;
            }
            ASSERT_EQ(LUInverse(lu.data(), pivots.data(), n, lu.data()), kOk);
            ASSERT_EQ(lu, inverse);
        }
    });
}

TYPED_TEST(Inverse, LUIsExactOnPermutationsAndPowersOfTwo) {
    using T = TypeParam;
    const Matrix<T> a(3, 3, this->Rs({0, 2, 0, 0, 0, 4, 8, 0, 0}));
    EXPECT_EQ(this->Invert(a, this->LU), kOk);
    EXPECT_EQ(FromHost(this->matrix_), Matrix<T>(3, 3, this->Rs({0, 0, 0.125, 0.5, 0, 0, 0, 0.25, 0})));
}

TYPED_TEST(Inverse, LUReportsSingularMatricesUnlessTheyAreFactored) {
    using T = TypeParam;
    EXPECT_EQ(this->Invert(Matrix<T>(2, 2), this->LU), kSingular);
    EXPECT_EQ(this->Invert(Matrix<T>(2, 2, this->Rs({1, 2, 2, 4})), this->LU), kSingular);
    EXPECT_EQ(this->InvertLUFactors(Matrix<T>(2, 2), Pivots({0, 1})), kOk);
    EXPECT_EQ(this->matrix_.rows(), 2);
    EXPECT_EQ(this->matrix_.columns(), 2);
    // The substitution stops at the zero: what is below it is finished, what is above is not.
    EXPECT_EQ(this->InvertLUFactors(Matrix<T>(2, 2, this->Rs({0, 3, 0, 2})), Pivots({0, 1})), kOk);
    EXPECT_EQ(FromHost(this->matrix_), Matrix<T>(2, 2, this->Rs({1, 0, 0, 0.5})));
}

TYPED_TEST(Inverse, LUGoesOnFromTheFactorisation) {
    using T = TypeParam;
    const Matrix<T> a = RandomMatrix<T>(6, 6, 4);
    HostMatrix<T> lu = ToHost(a);
    HostArray<double> pivots;
    int32_t sign = 0;
    Pick<T>(LU_head, CxLU_head)(lu.handle(), pivots.handle(), &sign, &this->err_);
    ASSERT_EQ(this->err_, kOk);
    ASSERT_EQ(this->InvertLUFactors(FromHost(lu), pivots), kOk);
    this->ExpectInverse(a, 4.0);
}

TYPED_TEST(Inverse, LUChecksItsArguments) {
    EXPECT_EQ(this->OnSize(2, 3, this->LU), kNotSquare);
    EXPECT_EQ(this->OnSize(0, 3, this->LU), kNotSquare);
    EXPECT_EQ(this->OnSize(0, 0, this->LU), kEmptyInput);

    const auto factors = [this](int32_t rows, int32_t columns, const std::vector<int32_t>& pivots) {
        const HostArray<double> p = Pivots(pivots);
        return this->OnSize(rows, columns,
                            [&](KrHandle a, int32_t* err) { return this->LUFactors(a, p.handle(), err); });
    };
    EXPECT_EQ(factors(2, 3, {0, 1}), kNotSquare);
    EXPECT_EQ(factors(0, 3, {}), kNotSquare);
    EXPECT_EQ(factors(2, 3, {0}), kSizesDiffer);
    EXPECT_EQ(factors(0, 0, {}), kEmptyInput);
    EXPECT_EQ(factors(0, 0, {0}), kSizesDiffer);
    EXPECT_EQ(factors(2, 2, {0, 2}), kBadIndex);
    EXPECT_EQ(factors(2, 2, {-1, 0}), kBadIndex);
}

// --- Cholesky -------------------------------------------------------------------------------------------------------

TYPED_TEST(Inverse, CholeskyIsHermitianWithASmallResidual) {
    using T = TypeParam;
    for (const int32_t n : {1, 2, 3, 4, 5, 6, 7, 8, 9, 30, 60, 200}) {
        const Matrix<T> a = PositiveDefinite<T>(n, 4);
        ASSERT_EQ(this->Invert(a, this->Cholesky), kOk);
        this->ExpectInverse(a, 4.0);
        Matrix<T> x = FromHost(this->matrix_);
        for (int32_t i = 0; i < n; ++i) x(i, i) = this->R(RealPart(x(i, i)));
        EXPECT_EQ(Adjoint(x), x);
    }
}

TYPED_TEST(Inverse, CholeskyReadsTheLowerTriangle) {
    using T = TypeParam;
    EXPECT_EQ(this->Invert(Matrix<T>(2, 2, this->Rs({4, 99, 2, 5})), this->Cholesky), kOk);
    EXPECT_THAT(this->matrix_.values(), AllNear(this->Rs({0.3125, -0.125, -0.125, 0.25}), 1e-15));
}

TYPED_TEST(Inverse, CholeskyChecksItsArguments) {
    using T = TypeParam;
    EXPECT_EQ(this->OnSize(2, 3, this->Cholesky), kNotSquare);
    EXPECT_EQ(this->OnSize(0, 3, this->Cholesky), kNotSquare);
    EXPECT_EQ(this->OnSize(0, 0, this->Cholesky), kEmptyInput);
    EXPECT_EQ(this->Invert(Matrix<T>(2, 2, this->Rs({1, 2, 2, 1})), this->Cholesky), kNotPositiveDefinite);
    EXPECT_EQ(this->Invert(Matrix<T>(2, 2, this->Rs({1, 0, 0, 1e-17})), this->Cholesky),
              kIsComplex<T> ? kOk : kNotPositiveDefinite);
}

TYPED_TEST(Inverse, CholeskyFactorIsReplacedByTheLowerTriangle) {
    using T = TypeParam;
    for (const int32_t n : {1, 2, 3, 4, 5, 8, 21}) {
        const Matrix<T> a = PositiveDefinite<T>(n, 8);
        std::vector<T> packed(PackedCount(n));
        PackTriangle(a.data(), n, kLower, packed.data());
        ASSERT_EQ(CholeskyPacked(packed.data(), n), kOk);
        this->packed_ = HostArray<T>(packed);
        ASSERT_EQ(this->Call(this->packed_, this->CholeskyFactor), kOk);
        Matrix<T> inverse(n, n);
        UnpackTriangle(this->packed_.values().data(), n, kSymmetric, inverse.data());
        EXPECT_LE(Distance(Product(a, inverse), Identity<T>(n)),
                  4 * n * kEpsilon * FrobeniusNorm(a) * FrobeniusNorm(inverse));
    }
    const auto on_length = [this](int32_t length) {
        this->packed_ = HostArray<T>(length);
        return this->Call(this->packed_, this->CholeskyFactor);
    };
    EXPECT_EQ(on_length(0), kEmptyInput);
    EXPECT_EQ(on_length(5), kNotSquare);
    EXPECT_EQ(on_length(3), kOk);  // zeros on the diagonal are not tested
    EXPECT_FALSE(std::isfinite(RealPart(this->packed_[0])));
}

// --- Triangles ------------------------------------------------------------------------------------------------------

TYPED_TEST(Inverse, TriangleLeavesASmallResidual) {
    using T = TypeParam;
    for (const int32_t n : {1, 2, 3, 4, 7, 30, 60}) {
        for (const int32_t triangle : {0, 1}) {
            Matrix<T> a = RandomMatrix<T>(n, n, 3);
            for (int32_t i = 0; i < n; ++i) a(i, i) = a(i, i) + this->R(n);
            Matrix<T> only = a;
            for (int32_t i = 0; i < n; ++i)
                for (int32_t j = 0; j < n; ++j)
                    if (triangle == 0 ? j > i : j < i) only(i, j) = T{};
            ASSERT_EQ(this->InvertTriangle(a, triangle), kOk);
            this->ExpectInverse(only, 2.0);
            for (int32_t i = 0; i < n; ++i) {
                for (int32_t j = 0; j < n; ++j) {
                    if (only(i, j) == T{}) {
                        ASSERT_EQ(this->matrix_(i, j), T{});
                    }
                }
            }

            std::vector<T> packed(PackedCount(n));
            PackTriangle(a.data(), n, triangle, packed.data());
            ASSERT_EQ(this->InvertPacked(packed, triangle), kOk);
            PackTriangle(FromHost(this->matrix_).data(), n, triangle, packed.data());
            EXPECT_EQ(this->packed_.values(), packed);
        }
    }
}

TYPED_TEST(Inverse, TriangleIsExactOnSmallIntegers) {
    // (1 . .; 2 1 .; 3 4 1) and its mirror image
    EXPECT_EQ(this->InvertPacked(this->Rs({1, 2, 3, 1, 4, 1}), 0), kOk);
    EXPECT_EQ(this->packed_.values(), this->Rs({1, -2, 5, 1, -4, 1}));
    EXPECT_EQ(this->InvertPacked(this->Rs({1, 2, 1, 3, 4, 1}), 1), kOk);
    EXPECT_EQ(this->packed_.values(), this->Rs({1, -2, 1, 5, -4, 1}));
}

TYPED_TEST(Inverse, TriangleChecksItsArguments) {
    using T = TypeParam;
    const auto on_size = [this](int32_t rows, int32_t columns, int32_t triangle) {
        return this->OnSize(rows, columns,
                            [=, this](KrHandle a, int32_t* err) { return this->Triangular(a, &triangle, err); });
    };
    EXPECT_EQ(on_size(2, 3, 9), kNotSquare);
    EXPECT_EQ(on_size(0, 3, 9), kNotSquare);
    EXPECT_EQ(on_size(0, 0, 9), kEmptyInput);
    EXPECT_EQ(this->InvertTriangle(Identity<T>(2), 2), kBadSelector);
    EXPECT_EQ(this->InvertTriangle(Identity<T>(2), -1), kBadSelector);
    EXPECT_EQ(this->InvertPacked({}, 9), kEmptyInput);
    EXPECT_EQ(this->InvertPacked(std::vector<T>(5), 9), kNotSquare);
    EXPECT_EQ(this->InvertPacked(this->Rs({1, 0, 1}), 2), kBadSelector);
    EXPECT_EQ(this->InvertPacked(this->Rs({1, 0, 1}), 5), kBadSelector);

    T x{};
    EXPECT_EQ(TriangularInversePacked(&x, 0, 9, &x), kBadSelector);
    EXPECT_EQ(TriangularInversePacked(&x, 0, kLower, &x), kEmptyInput);
}

// The complex family compares squares with eps^2 here, so its cut is the same as the real one.
TYPED_TEST(Inverse, TriangleJudgesSingularityWithoutLookingAtTheRest) {
    using T = TypeParam;
    EXPECT_EQ(this->InvertPacked(this->Rs({1, 0, 0}), 0), kSingular);
    EXPECT_EQ(this->InvertPacked(this->Rs({1, 0, 1e-10}), 0), kOk);
    EXPECT_EQ(this->InvertPacked(this->Rs({1, 0, 0x1p-52}), 0), kSingular);
    EXPECT_EQ(this->InvertPacked(this->Rs({1, 0, 0x1.00001p-52}), 0), kOk);
    EXPECT_EQ(this->InvertPacked(this->Rs({1, 1e17, 1}), 1), kSingular);
    EXPECT_EQ(this->InvertPacked(this->Rs({1e-200, 0, 1e-200}), 0), kIsComplex<T> ? kSingular : kOk);
    EXPECT_EQ(this->InvertPacked(this->Rs({1e200, 0, 1e200}), 0), kIsComplex<T> ? kSingular : kOk);
    // NaN flows through.
    EXPECT_EQ(this->InvertPacked(this->Rs({1, kQuietNaN, 1}), 0), kOk);
    EXPECT_EQ(this->packed_[0], this->R(1));
    EXPECT_TRUE(std::isnan(RealPart(this->packed_[1])));
}

// --- Pseudoinverse --------------------------------------------------------------------------------------------------

TYPED_TEST(Inverse, PseudoFulfilsThePenroseConditions) {
    using T = TypeParam;
    for (const auto& kind : MatrixKinds<T>()) {
        const std::string name = kind.name;
        if (name == "Hilbert" || name == "Vandermonde" || name == "graded")
            continue;                   // the cut falls into the spectrum
        if (name == "small") continue;  // everything is below the absolute band in which the iteration splits
        for (const auto& [m, n] : {std::pair(1, 1), {1, 4}, {4, 1}, {5, 5}, {9, 4}, {4, 9}}) {
            const Matrix<T> a = kind.make(m, n);
            ASSERT_EQ(this->InvertPseudo(a, -1.0), kOk);
            ASSERT_EQ(this->matrix_.rows(), n);
            ASSERT_EQ(this->matrix_.columns(), m);
            const Matrix<T> x = FromHost(this->matrix_);
            const double condition = FrobeniusNorm(a) * FrobeniusNorm(x), units = 1e-14 * (m + n);
            EXPECT_LE(Distance(Product(Product(a, x), a), a), units * condition * FrobeniusNorm(a)) << name;
            EXPECT_LE(Distance(Product(Product(x, a), x), x), units * condition * FrobeniusNorm(x)) << name;
            EXPECT_LE(Distance(Adjoint(Product(a, x)), Product(a, x)), units * condition) << name;
            EXPECT_LE(Distance(Adjoint(Product(x, a)), Product(x, a)), units * condition) << name;
        }
    }
}

TYPED_TEST(Inverse, PseudoToleranceIsAbsolute) {
    using T = TypeParam;
    const Matrix<T> a(2, 2, this->Rs({10, 0, 0, 1}));
    const auto second = [&](double tol) {
        EXPECT_EQ(this->InvertPseudo(a, tol), kOk);
        return RealPart(this->matrix_(1, 1));
    };
    EXPECT_NEAR(second(0.99), 1.0, 1e-15);
    EXPECT_EQ(second(1.01), 0.0);
    EXPECT_NEAR(second(0.0), 1.0, 1e-15);
    EXPECT_NEAR(second(kQuietNaN), 1.0, 1e-15);
    EXPECT_EQ(this->InvertPseudo(a, kInfinity), kOk);
    EXPECT_EQ(FromHost(this->matrix_), Matrix<T>(2, 2));
}

TYPED_TEST(Inverse, PseudoOfZerosIsZeros) {
    using T = TypeParam;
    for (const double tol : {-1.0, 0.0}) {
        EXPECT_EQ(this->InvertPseudo(Matrix<T>(2, 3), tol), kOk);
        EXPECT_EQ(FromHost(this->matrix_), Matrix<T>(3, 2));
    }
}

TYPED_TEST(Inverse, PseudoNeverAsksForAnotherSize) {
    using T = TypeParam;
    HostMatrix<T> a(2, 3, this->Rs({1, 2, 3, 4, 5, 6}));
    const double tol = -1.0;
    for (const bool least_alignment : {false, true}) {
        const int32_t former = KrrtLeastAlignment(least_alignment);
        HostMatrix<T> other(2, 3, this->Rs({1, 2, 3, 4, 5, 6}));
        KrrtLeastAlignment(former);
        const ResizeLog resizes;
        this->Pseudo(other.handle(), &tol, &this->err_);
        EXPECT_EQ(this->err_, kOk);
        EXPECT_EQ(resizes.size(), 0);
        EXPECT_EQ(other.rows(), 3);
        EXPECT_EQ(other.columns(), 2);
        EXPECT_THAT(RealPart(other(0, 0)), Near(-17.0 / 18, 1e-13));
    }
}

TYPED_TEST(Inverse, PseudoChecksItsArguments) {
    using T = TypeParam;
    const double tol = -1.0;
    const auto pseudo = [&](KrHandle a, int32_t* err) { return this->Pseudo(a, &tol, err); };
    EXPECT_EQ(this->OnSize(0, 3, pseudo), kEmptyInput);
    EXPECT_EQ(this->OnSize(3, 0, pseudo), kEmptyInput);
    EXPECT_EQ(this->InvertPseudo(Matrix<T>(1, 2, this->Rs({1, kQuietNaN})), -1.0), kNotFinite);
    T x{};
    EXPECT_EQ(PseudoInverseCore<T>(&x, 0, 1, -1.0, nullptr), kEmptyInput);
}

}  // namespace
}  // namespace krnumer

// Linear equations by drivers that start from the matrix itself.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <limits>

#include "frame/status.h"
#include "krnumer/linalg_solve.h"
#include "linalg/cores.h"
#include "linalg/matrices.h"
#include "reference/linalg/solve.inc"

namespace krnumer {
namespace {

using testing::ElementsAre;

template <class T>
std::vector<T> FirstColumn(const Matrix<T>& a) {
    std::vector<T> column;
    for (int32_t i = 0; i < a.rows; ++i) column.push_back(a(i, 0));
    return column;
}

template <class T>
HostMatrix<T> Sized(int32_t rows, int32_t columns) {
    HostMatrix<T> a(3, 3);
    a.SetDimension(0, rows);
    a.SetDimension(1, columns);
    return a;
}

template <class T>
class Solve : public testing::Test {
  protected:
    static constexpr auto Svd = Pick<T>(GenLinEqs_head, CxGenLinEqs_head);
    static constexpr auto Svd82 = Pick<T>(GenLinEqs82_head, CxGenLinEqs82_head);
    static constexpr auto SvdSet = Pick<T>(EqsSetBySVDDri_head, CxEqsSetBySVDDri_head);
    static constexpr auto SvdSet82 = Pick<T>(EqsSetBySVDDri82_head, CxEqsSetBySVDDri82_head);
    static constexpr auto LU = Pick<T>(EqsByLUDri_head, CxEqsByLUDri_head);
    static constexpr auto LUSet = Pick<T>(EqsSetByLUDri_head, CxEqsSetByLUDri_head);
    static constexpr auto Cholesky = Pick<T>(EqsByCholeskyDri_head, CxEqsByCholeskyDri_head);
    static constexpr auto CholeskySet = Pick<T>(EqsSetByCholeskyDri_head, CxEqsSetByCholeskyDri_head);
    static constexpr auto TriangularSet = Pick<T>(TriEqsSetDri_head, CxTriEqsSetDri_head);
    static constexpr auto Band = Pick<T>(BandEqsDriH, CxBandEqsDriH);
    static constexpr auto BandSet = Pick<T>(BandEqsSetDriH, CxBandEqsSetDriH);

    static T R(double x) { return FromReal<T>(x); }

    // The status of a by-reference driver. A failure leaves x empty.
    template <class Driver>
    int32_t One(Driver driver, const HostMatrix<T>& a, const HostArray<T>& b) {
        err_ = 77;
        EXPECT_EQ(driver(a.handle(), b.handle(), x_.handle(), &err_), 0);
        if (err_ != kOk) {
            EXPECT_TRUE(x_.empty());
        }
        return err_;
    }
    template <class Driver>
    int32_t One(Driver driver, const Matrix<T>& a, const std::vector<T>& b) {
        return One(driver, ToHost(a), HostArray<T>(b));
    }

    // The same for a by-value driver of a set, driver(a, b, x).
    template <class Driver>
    int32_t Set(Driver driver, const HostMatrix<T>& a, const HostMatrix<T>& b) {
        const int32_t status = driver(a.handle(), b.handle(), set_.handle());
        if (status < 0) {
            EXPECT_TRUE(set_.empty());
        }
        return status;
    }
    template <class Driver>
    int32_t Set(Driver driver, const Matrix<T>& a, const Matrix<T>& b) {
        return Set(driver, ToHost(a), ToHost(b));
    }

    static auto WithTriangle(decltype(CholeskySet) driver, int32_t triangle) {
        return [=](KrHandle a, KrHandle b, KrHandle x) { return driver(a, triangle, b, x); };
    }

    void ExpectSet(const Matrix<T>& expected) {
        EXPECT_EQ(set_.rows(), expected.rows);
        EXPECT_EQ(set_.columns(), expected.columns);
        EXPECT_THAT(set_.values(), AllNear(expected.elements, 1e-12, 1e-13));
    }

    LeakCheck leaks_;
    HostArray<T> x_{T{}, T{}, T{}};
    HostMatrix<T> set_{1, 2};
    int32_t err_ = 77;
};
TYPED_TEST_SUITE(Solve, ElementTypes);

// --- Singular value decomposition -----------------------------------------------------------------------------------

TYPED_TEST(Solve, SvdAgreesWithTheReference) {
    const auto& g = GoldenSolve<TypeParam>::Values();
    for (const auto& [a, b, x] :
         {std::tie(g.square, g.right, g.solution), std::tie(g.tall, g.tall_right, g.tall_solution),
          std::tie(g.wide, g.wide_right, g.wide_solution)}) {
        EXPECT_EQ(this->One(this->Svd, a, FirstColumn(b)), kOk);
        EXPECT_THAT(this->x_.values(), AllNear(FirstColumn(x), 1e-12, 1e-13));
        EXPECT_EQ(this->Set(this->SvdSet, a, b), kOk);
        this->ExpectSet(x);
    }
}

TYPED_TEST(Solve, SvdWarnsOfDeficientRankInSetsOnly) {
    const auto& g = GoldenSolve<TypeParam>::Values();
    EXPECT_EQ(this->One(this->Svd, g.deficient, FirstColumn(g.deficient_right)), kOk);
    EXPECT_THAT(this->x_.values(), AllNear(FirstColumn(g.deficient_solution), 1e-12, 1e-13));
    EXPECT_EQ(this->Set(this->SvdSet, g.deficient, g.deficient_right), kWarnRankDeficient);
    this->ExpectSet(g.deficient_solution);
}

TYPED_TEST(Solve, SvdToleranceIsRelativeAndGrowsWithTheSize) {
    using T = TypeParam;
    const HostMatrix<T> a(2, 2, {this->R(10), T{}, T{}, this->R(1)});
    const HostArray<T> b{this->R(10), this->R(1)};
    const HostMatrix<T> set(2, 1, {this->R(10), this->R(1)});
    const auto second = [&](double tol) {
        this->Svd82(a.handle(), b.handle(), this->x_.handle(), tol, &this->err_);
        EXPECT_EQ(this->err_, kOk);
        const int32_t status = this->SvdSet82(a.handle(), set.handle(), this->set_.handle(), tol);
        EXPECT_EQ(this->set_(1, 0), this->x_[1]);
        const bool cut = std::fabs(RealPart(this->x_[1])) < 1e-15;
        EXPECT_EQ(status, cut ? kWarnRankDeficient : kOk);
        return RealPart(this->x_[1]);
    };
    EXPECT_NEAR(second(0.049), 1.0, 1e-15);  // the cut is 2 * 10 * tol
    EXPECT_NEAR(second(0.051), 0.0, 1e-15);
    EXPECT_NEAR(second(0.5), 0.0, 1e-15);
    for (const double tol : {0.0, -3.0, kQuietNaN}) EXPECT_NEAR(second(tol), 1.0, 1e-15);
}

TYPED_TEST(Solve, SvdOfZerosIsZeroOrUnknown) {
    using T = TypeParam;
    EXPECT_EQ(this->One(this->Svd, Matrix<T>(2, 3), {this->R(1), this->R(2)}), kOk);
    EXPECT_THAT(this->x_.values(), ElementsAre(T{}, T{}, T{}));
    // An infinite tolerance times the singular value 0 cuts nothing, and infinities meet zeros.
    const HostMatrix<T> a(2, 2);
    const HostArray<T> b{this->R(1), this->R(1)};
    this->Svd82(a.handle(), b.handle(), this->x_.handle(), kInfinity, &this->err_);
    EXPECT_EQ(this->err_, kOk);
    for (const T x : this->x_.values()) EXPECT_TRUE(std::isnan(RealPart(x)));
}

// The iteration splits by an absolute band around the norm. In a matrix far below it everything off the diagonal of the
// bidiagonal form counts as zero, and another system is solved.
TYPED_TEST(Solve, SvdLosesTinyMatrices) {
    using T = TypeParam;
    const auto tiny = [this](double x) { return this->R(1e-20 * x); };
    const Matrix<T> a(2, 2, {tiny(1), tiny(2), tiny(3), tiny(4)});
    EXPECT_EQ(this->One(this->Svd, a, {tiny(5), tiny(11)}), kOk);
    EXPECT_THAT(this->x_.values(), AllNear(std::vector<T>{this->R(3.8), this->R(2)}, 1e-14));
}

TYPED_TEST(Solve, SvdChecksItsArguments) {
    using T = TypeParam;
    const HostArray<T> none, two(2), three(3);
    EXPECT_EQ(this->One(this->Svd, Sized<T>(0, 3), none), kEmptyInput);
    EXPECT_EQ(this->One(this->Svd, Sized<T>(3, 0), three), kEmptyInput);
    EXPECT_EQ(this->One(this->Svd, Sized<T>(3, 2), two), kSizesDiffer);
    EXPECT_EQ(this->One(this->Svd, Sized<T>(0, 3), two), kSizesDiffer);
    EXPECT_EQ(this->One(this->Svd, Sized<T>(2, 3), none), kSizesDiffer);
    EXPECT_EQ(this->Set(this->SvdSet, Sized<T>(0, 3), Sized<T>(2, 1)), kEmptyInput);
    EXPECT_EQ(this->Set(this->SvdSet, Sized<T>(2, 3), Sized<T>(3, 0)), kEmptyInput);
    EXPECT_EQ(this->Set(this->SvdSet, Sized<T>(2, 3), Sized<T>(3, 1)), kSizesDiffer);
    EXPECT_EQ(this->Set(this->SvdSet, Sized<T>(2, 3), Sized<T>(0, 1)), kSizesDiffer);

    const Matrix<T> a(1, 1, {this->R(1)}), infinite(1, 1, {this->R(kInfinity)});
    const T largest = this->R(std::numeric_limits<double>::max());
    EXPECT_EQ(this->One(this->Svd, a, {largest}), kNotFinite);
    EXPECT_EQ(this->One(this->Svd, infinite, {this->R(1)}), kNotFinite);
    EXPECT_EQ(this->Set(this->SvdSet, infinite, a), kNotFinite);
    EXPECT_EQ(this->Set(this->SvdSet, a, infinite), kNotFinite);
    const FailResize refusal;
    EXPECT_EQ(this->One(this->Svd, a, {this->R(1)}), kOutOfMemory);
}

// --- LU -------------------------------------------------------------------------------------------------------------

TYPED_TEST(Solve, LUAgreesWithTheReference) {
    const auto& g = GoldenSolve<TypeParam>::Values();
    EXPECT_EQ(this->One(this->LU, g.square, FirstColumn(g.right)), kOk);
    EXPECT_THAT(this->x_.values(), AllNear(FirstColumn(g.solution), 1e-12, 1e-13));
}

TYPED_TEST(Solve, LULeavesASmallResidual) {
    using T = TypeParam;
    for (const auto& kind : MatrixKinds<T>()) {
        for (const int32_t n : {1, 2, 3, 4, 5, 8, 13, 31, 60, 200}) {
            const Matrix<T> a = kind.make(n, n), b = RandomMatrix<T>(n, 1, 3);
            const int32_t status = this->One(this->LU, a, b.elements);
            if (status == kSingular) continue;
            ASSERT_EQ(status, kOk) << kind.name << ' ' << n;
            const Matrix<T> x(n, 1, this->x_.values());
            EXPECT_LE(Distance(Product(a, x), b),
                      8.0 * n * kEpsilon * (FrobeniusNorm(a) * FrobeniusNorm(x) + FrobeniusNorm(b)))
                << kind.name << ' ' << n;
        }
    }
}

TYPED_TEST(Solve, LUIsExactOnIntegers) {
    using T = TypeParam;
    const Matrix<T> a(
        3, 3,
        {this->R(2), this->R(1), this->R(1), this->R(4), this->R(3), this->R(3), this->R(8), this->R(7), this->R(5)});
    EXPECT_EQ(this->One(this->LU, a, {this->R(7), this->R(19), this->R(37)}), kOk);
    EXPECT_THAT(this->x_.values(), AllNear(std::vector<T>{this->R(1), this->R(2), this->R(3)}, 1e-15));
}

TYPED_TEST(Solve, LUReportsSingularMatrices) {
    using T = TypeParam;
    EXPECT_EQ(this->One(this->LU, Matrix<T>(2, 2), {this->R(1), this->R(1)}), kSingular);
    const Matrix<T> rank_one(2, 2, {this->R(1), this->R(2), this->R(2), this->R(4)});
    EXPECT_EQ(this->One(this->LU, rank_one, {this->R(1), this->R(1)}), kSingular);
    EXPECT_EQ(this->One(this->LU, Matrix<T>(1, 1, {this->R(kQuietNaN)}), {this->R(1)}), kSingular);
}

TYPED_TEST(Solve, LULetsNaNThrough) {
    using T = TypeParam;
    EXPECT_EQ(this->One(this->LU, Matrix<T>(1, 1, {this->R(2)}), {this->R(kQuietNaN)}), kOk);
    EXPECT_TRUE(std::isnan(RealPart(this->x_[0])));
}

// A matrix that is too tall is read as a shorter one of the order of its columns.
TYPED_TEST(Solve, LUReadsTallMatricesAsSquare) {
    using T = TypeParam;
    const Matrix<T> a(3, 2, {this->R(2), this->R(0), this->R(0), this->R(4), this->R(9), this->R(9)});
    EXPECT_EQ(this->One(this->LU, a, {this->R(2), this->R(8), this->R(5)}), kOk);
    EXPECT_THAT(this->x_.values(), ElementsAre(this->R(1), this->R(2)));
}

TYPED_TEST(Solve, LUChecksItsArguments) {
    using T = TypeParam;
    const HostArray<T> none, two(2), three(3);
    EXPECT_EQ(this->One(this->LU, Sized<T>(2, 3), two), kNotSquare);
    EXPECT_EQ(this->One(this->LU, Sized<T>(2, 3), three), kSizesDiffer);
    EXPECT_EQ(this->One(this->LU, Sized<T>(0, 3), none), kEmptyInput);
    EXPECT_EQ(this->One(this->LU, Sized<T>(0, 3), two), kSizesDiffer);
    EXPECT_EQ(this->One(this->LU, Sized<T>(0, 0), none), kEmptyInput);
    EXPECT_EQ(this->One(this->LU, Sized<T>(3, 0), three), kEmptyInput);
}

TYPED_TEST(Solve, LUSetIsNotProvided) {
    using T = TypeParam;
    const auto& g = GoldenSolve<T>::Values();
    EXPECT_EQ(this->Set(this->LUSet, g.square, g.right), kNotProvided);
    EXPECT_EQ(this->Set(this->LUSet, Matrix<T>(2, 2), Matrix<T>(2, 1)), kNotProvided);
    EXPECT_EQ(this->Set(this->LUSet, Sized<T>(0, 3), Sized<T>(2, 1)), kEmptyInput);
    EXPECT_EQ(this->Set(this->LUSet, Sized<T>(2, 2), Sized<T>(2, 0)), kEmptyInput);
    EXPECT_EQ(this->Set(this->LUSet, Sized<T>(2, 3), Sized<T>(1, 1)), kNotSquare);
    EXPECT_EQ(this->Set(this->LUSet, Sized<T>(2, 2), Sized<T>(3, 1)), kSizesDiffer);
    const FailResize refusal;
    EXPECT_EQ(this->Set(this->LUSet, g.square, g.right), kOutOfMemory);
}

// --- Cholesky -------------------------------------------------------------------------------------------------------

TYPED_TEST(Solve, CholeskyAgreesWithTheReference) {
    const auto& g = GoldenSolve<TypeParam>::Values();
    EXPECT_EQ(this->One(this->Cholesky, g.definite, FirstColumn(g.right)), kOk);
    EXPECT_THAT(this->x_.values(), AllNear(FirstColumn(g.definite_solution), 1e-10, 1e-12));
    for (const int32_t triangle : {0, 1}) {
        EXPECT_EQ(this->Set(this->WithTriangle(this->CholeskySet, triangle), g.definite, g.right), kOk);
        EXPECT_THAT(this->set_.values(), AllNear(g.definite_solution.elements, 1e-10, 1e-12));
    }
}

TYPED_TEST(Solve, CholeskyLeavesASmallResidual) {
    using T = TypeParam;
    for (const int32_t n : {1, 2, 3, 4, 5, 9, 30, 60, 200}) {
        const Matrix<T> a = PositiveDefinite<T>(n, 2), b = RandomMatrix<T>(n, 3, 3);
        ASSERT_EQ(this->One(this->Cholesky, a, FirstColumn(b)), kOk);
        const Matrix<T> x(n, 1, this->x_.values()), right(n, 1, FirstColumn(b));
        EXPECT_LE(Distance(Product(a, x), right), 2.0 * n * kEpsilon * FrobeniusNorm(a) * FrobeniusNorm(x)) << n;
        for (const int32_t triangle : {0, 1}) {
            ASSERT_EQ(this->Set(this->WithTriangle(this->CholeskySet, triangle), a, b), kOk);
            const Matrix<T> set = FromHost(this->set_);
            EXPECT_LE(Distance(Product(a, set), b), 2.0 * n * kEpsilon * FrobeniusNorm(a) * FrobeniusNorm(set)) << n;
        }
    }
}

TYPED_TEST(Solve, CholeskyReadsOneTriangleOnly) {
    using T = TypeParam;
    const T odd = this->R(99);
    const Matrix<T> upper(2, 2, {this->R(4), this->R(2), odd, this->R(5)}), b(2, 1, {this->R(8), this->R(12)});
    const Matrix<T> lower(2, 2, {this->R(4), odd, this->R(2), this->R(5)});
    const auto solution = std::vector<T>{this->R(1), this->R(2)};
    EXPECT_EQ(this->One(this->Cholesky, upper, b.elements), kOk);
    EXPECT_THAT(this->x_.values(), AllNear(solution, 1e-15));
    EXPECT_EQ(this->Set(this->WithTriangle(this->CholeskySet, 1), upper, b), kOk);
    EXPECT_THAT(this->set_.values(), AllNear(solution, 1e-15));
    EXPECT_EQ(this->Set(this->WithTriangle(this->CholeskySet, 0), lower, b), kOk);
    EXPECT_THAT(this->set_.values(), AllNear(solution, 1e-15));
    EXPECT_EQ(this->One(this->Cholesky, lower, b.elements), kNotPositiveDefinite);
}

TYPED_TEST(Solve, CholeskyRefusesBadDataAnywhere) {
    using T = TypeParam;
    const T nan = this->R(kQuietNaN);
    const Matrix<T> a(2, 2, {this->R(4), this->R(2), nan, this->R(5)}), good = Identity<T>(2);
    const std::vector<T> b{this->R(1), this->R(1)};
    EXPECT_EQ(this->One(this->Cholesky, a, b), kNotFinite);
    EXPECT_EQ(this->One(this->Cholesky, good, {nan, nan}), kNotFinite);
    EXPECT_EQ(this->Set(this->WithTriangle(this->CholeskySet, 1), a, good), kNotFinite);
    EXPECT_EQ(this->Set(this->WithTriangle(this->CholeskySet, 1), good, a), kNotFinite);
}

TYPED_TEST(Solve, CholeskyJudgesSmallPivotsByTheFamily) {
    using T = TypeParam;
    const int32_t verdict = kIsComplex<T> ? kOk : kNotPositiveDefinite;
    const Matrix<T> a(2, 2, {this->R(1), T{}, T{}, this->R(1e-17)});
    EXPECT_EQ(this->One(this->Cholesky, a, {this->R(1), this->R(1e-17)}), verdict);
    EXPECT_EQ(this->Set(this->WithTriangle(this->CholeskySet, 0), a, a), verdict);
}

TYPED_TEST(Solve, CholeskyChecksItsArguments) {
    using T = TypeParam;
    const HostArray<T> none, two(2), three(3);
    // In the real family a shape that is not square ends the checks, in the complex one the length goes before it.
    EXPECT_EQ(this->One(this->Cholesky, Sized<T>(2, 3), three), kIsComplex<T> ? kSizesDiffer : kNotSquare);
    EXPECT_EQ(this->One(this->Cholesky, Sized<T>(2, 3), two), kNotSquare);
    EXPECT_EQ(this->One(this->Cholesky, Sized<T>(0, 3), none), kNotSquare);
    EXPECT_EQ(this->One(this->Cholesky, Sized<T>(0, 0), none), kEmptyInput);
    EXPECT_EQ(this->One(this->Cholesky, Sized<T>(0, 0), two), kSizesDiffer);
    EXPECT_EQ(this->One(this->Cholesky, Sized<T>(2, 2), three), kSizesDiffer);

    const auto set = [this](int32_t triangle, const HostMatrix<T>& a, const HostMatrix<T>& b) {
        const int32_t cholesky = this->Set(this->WithTriangle(this->CholeskySet, triangle), a, b);
        EXPECT_EQ(this->Set(this->WithTriangle(this->TriangularSet, triangle), a, b), cholesky);
        return cholesky;
    };
    EXPECT_EQ(set(9, Sized<T>(0, 3), Sized<T>(2, 1)), kEmptyInput);
    EXPECT_EQ(set(9, Sized<T>(2, 2), Sized<T>(3, 0)), kEmptyInput);
    EXPECT_EQ(set(9, Sized<T>(2, 3), Sized<T>(3, 1)), kNotSquare);
    EXPECT_EQ(set(9, Sized<T>(2, 2), Sized<T>(3, 1)), kSizesDiffer);
    EXPECT_EQ(set(2, Sized<T>(2, 2), Sized<T>(2, 1)), kBadSelector);
    EXPECT_EQ(set(-1, Sized<T>(2, 2), Sized<T>(2, 1)), kBadSelector);
    const FailResize refusal;
    EXPECT_EQ(this->Set(this->WithTriangle(this->CholeskySet, 0), Identity<T>(2), Identity<T>(2)), kOutOfMemory);
}

// --- Triangles ------------------------------------------------------------------------------------------------------

TYPED_TEST(Solve, TriangularAgreesWithTheReference) {
    const auto& g = GoldenSolve<TypeParam>::Values();
    EXPECT_EQ(this->Set(this->WithTriangle(this->TriangularSet, 0), g.square, g.right), kOk);
    this->ExpectSet(g.lower_solution);
    EXPECT_EQ(this->Set(this->WithTriangle(this->TriangularSet, 1), g.square, g.right), kOk);
    this->ExpectSet(g.upper_solution);
}

TYPED_TEST(Solve, TriangularLooksAtItsTriangleOnly) {
    using T = TypeParam;
    const T nan = this->R(kQuietNaN);
    const Matrix<T> lower(2, 2, {this->R(2), nan, this->R(1), this->R(4)}), b(2, 1, {this->R(2), this->R(9)});
    EXPECT_EQ(this->Set(this->WithTriangle(this->TriangularSet, 0), lower, b), kOk);
    EXPECT_THAT(this->set_.values(), ElementsAre(this->R(1), this->R(2)));
    EXPECT_EQ(this->Set(this->WithTriangle(this->TriangularSet, 1), lower, b), kNotFinite);
    EXPECT_EQ(this->Set(this->WithTriangle(this->TriangularSet, 0), b.rows == 2 ? Identity<T>(2) : lower, lower),
              kNotFinite);
}

// --- Bands ----------------------------------------------------------------------------------------------------------

TYPED_TEST(Solve, BandAgreesWithTheReference) {
    using T = TypeParam;
    const auto& g = GoldenSolve<T>::Values();
    const HostMatrix<T> band = ToHost(g.band);
    HostArray<T> one(FirstColumn(g.band_right));
    EXPECT_EQ(this->Band(band.handle(), one.handle(), 1, 2), kOk);
    EXPECT_THAT(one.values(), AllNear(FirstColumn(g.band_solution), 1e-12, 1e-13));
    HostMatrix<T> many = ToHost(g.band_right);
    EXPECT_EQ(this->BandSet(band.handle(), many.handle(), 1, 2), kOk);
    EXPECT_EQ(many.rows(), 7);
    EXPECT_EQ(many.columns(), 2);
    EXPECT_THAT(many.values(), AllNear(g.band_solution.elements, 1e-12, 1e-13));
    EXPECT_EQ(FromHost(band), g.band);
}

TYPED_TEST(Solve, BandAgreesWithTheFullMatrix) {
    using T = TypeParam;
    for (const auto& [n, kl, ku] : {std::tuple(1, 0, 0), {5, 0, 0}, {5, 4, 0}, {5, 0, 4}, {9, 3, 2}, {40, 5, 7}}) {
        const Matrix<T> stored = RandomMatrix<T>(kl + ku + 1, n, 8), b = RandomMatrix<T>(n, 3, 9);
        const Matrix<T> a = Generate<T>(n, n, [&, below = kl, above = ku](int32_t i, int32_t j) {
            return i - j <= below && j - i <= above ? stored(above + i - j, j) : T{};
        });
        const HostMatrix<T> band = ToHost(stored);
        HostMatrix<T> many = ToHost(b);
        ASSERT_EQ(this->BandSet(band.handle(), many.handle(), kl, ku), kOk);
        const Matrix<T> x = FromHost(many);
        EXPECT_LE(Distance(Product(a, x), b), 8 * n * kEpsilon * FrobeniusNorm(a) * FrobeniusNorm(x)) << n;
    }
}

TYPED_TEST(Solve, BandChecksItsArguments) {
    using T = TypeParam;
    const auto one = [this](int32_t rows, int32_t columns, int32_t length, int32_t kl, int32_t ku) {
        HostMatrix<T> band(rows, columns);
        HostArray<T> b(length);
        const int32_t status = this->Band(band.handle(), b.handle(), kl, ku);
        EXPECT_TRUE(b.empty());
        return status;
    };
    EXPECT_EQ(one(3, 4, 4, 1, 2), kBadDimension);
    EXPECT_EQ(one(3, 4, 5, 1, 2), kBadDimension);
    EXPECT_EQ(one(3, 4, 5, 1, 1), kPencilSizesDiffer);
    EXPECT_EQ(one(3, 3, 3, -1, 3), kBadDimension);
    EXPECT_EQ(one(3, 3, 3, 3, -1), kBadDimension);
    EXPECT_EQ(one(4, 3, 3, 2, 1), kBadDimension);
    EXPECT_EQ(one(0, 0, 0, 0, -1), kEmptyInput);
    constexpr int32_t kMost = std::numeric_limits<int32_t>::max();
    EXPECT_EQ(one(1, 4, 4, kMost, kMost), kBadDimension);
    EXPECT_EQ(one(1, 2, 2, 0, 0), kSingular);

    HostMatrix<T> band(1, 2), none(2, 0), other(3, 1), two(2, 2);
    EXPECT_EQ(this->BandSet(band.handle(), none.handle(), 0, 0), kBadDimension);
    EXPECT_EQ(this->BandSet(band.handle(), other.handle(), 0, 0), kPencilSizesDiffer);
    EXPECT_TRUE(other.empty());
    EXPECT_EQ(this->BandSet(band.handle(), two.handle(), 0, 0), kSingular);
    EXPECT_TRUE(two.empty());
}

TYPED_TEST(Solve, BandMayFillTheMatrix) {
    using T = TypeParam;
    const HostMatrix<T> band(3, 3, {T{}, T{}, this->R(1), T{}, this->R(1), T{}, this->R(1), T{}, T{}});
    HostArray<T> b{this->R(1), this->R(2), this->R(3)};
    EXPECT_EQ(this->Band(band.handle(), b.handle(), 0, 2), kSingular);
    const HostMatrix<T> diagonal(3, 3, {T{}, T{}, T{}, this->R(1), this->R(2), this->R(4), T{}, T{}, T{}});
    HostArray<T> right{this->R(1), this->R(2), this->R(4)};
    EXPECT_EQ(this->Band(diagonal.handle(), right.handle(), 1, 1), kOk);
    EXPECT_THAT(right.values(), ElementsAre(this->R(1), this->R(1), this->R(1)));
}

// --- Cores ----------------------------------------------------------------------------------------------------------

TYPED_TEST(Solve, CoresNeedSizes) {
    using T = TypeParam;
    T x{};
    EXPECT_EQ(SvdSolve(&x, 0, 1, &x, 1, &x, -1.0), kEmptyInput);
    EXPECT_EQ(SvdSolve(&x, 1, 1, &x, 0, &x, -1.0), kEmptyInput);
    EXPECT_EQ(CholeskySolveFull(&x, 0, kLower, &x, 1, &x), kEmptyInput);
    EXPECT_EQ(CholeskySolvePacked(&x, 1, &x, 0), kEmptyInput);
    EXPECT_EQ(TriangularSolvePacked(&x, 1, &x, 0, kLower, &x), kEmptyInput);
    EXPECT_EQ(LUSolveDirect(&x, 0, &x, &x), kEmptyInput);
    EXPECT_EQ(BandSolve(&x, 1, 0, 0, &x, 0), kEmptyInput);
}

}  // namespace
}  // namespace krnumer

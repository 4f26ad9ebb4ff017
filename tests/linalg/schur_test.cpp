// Hessenberg form, balancing and Schur decomposition, through their exports: residuals, orders, statuses.

#include <gtest/gtest.h>

#include <cmath>
#include <vector>

#include "frame/numeric.h"
#include "frame/status.h"
#include "krnumer/linalg_schur.h"
#include "linalg/matrices.h"

namespace krnumer {
namespace {

constexpr int32_t kSizes[] = {1, 2, 3, 5, 8, 17, 40};

template <class T>
class Reductions : public testing::Test {
  protected:
    static constexpr auto Hessenberg = Pick<T>(Hessenberg_head, CxHessenberg_head);
    static constexpr auto Balance = Pick<T>(MatrixBalance_head, CxMatrixBalance_head);
    static constexpr auto BackTransform = Pick<T>(EigenVBack_head, CxEigenVBack_head);
    static constexpr auto Schur = Pick<T>(Schur_head, CxSchur_head);
    static constexpr auto Schur80 = Pick<T>(Schur80_head, CxSchur80_head);

    static Matrix<T> FromReals(const Matrix<double>& a) {
        return Generate<T>(a.rows, a.columns, [&a](int32_t i, int32_t j) { return FromReal<T>(a(i, j)); });
    }

    // Expects the Schur form of A with its eigenvalues in this order.
    void ExpectSchurForm(const Matrix<T>& a, int32_t order) {
        const int32_t n = a.rows;
        const auto t = ToHost(a);
        ASSERT_EQ(Schur80(t.handle(), 1, order, z_.handle(), w_.handle()), 0);
        const Matrix<T> z = FromHost(z_);
        EXPECT_LE(Unorthogonality(z), 1e-13 * n);
        EXPECT_LE(Distance(Product(Product(z, FromHost(t)), Adjoint(z)), a), 1e-14 * n * n * FrobeniusNorm(a));
        const auto key = [&](int32_t i) { return order <= 2 ? w_[i].re : std::hypot(w_[i].re, w_[i].im); };
        for (int32_t i = 0; i + 1 < n && order > 0; ++i) {
            const double step = key(i + 1) - key(i);
            EXPECT_GE(order % 2 == 1 ? step : -step, -1e-14 * FrobeniusNorm(a)) << "at " << i;
        }
        for (int32_t i = 1; i < n; ++i) {
            for (int32_t j = 0; j + 1 < i; ++j) EXPECT_EQ(t(i, j), T{});
            const bool pair = w_[i].im < 0.0 && w_[i].im == -w_[i - 1].im;
            if (kIsComplex<T> || !pair) {
                EXPECT_EQ(t(i, i - 1), T{}) << "at " << i;
            }
        }
    }

    LeakCheck leaks_;
    HostMatrix<T> q_{1, 1, {T{}}}, z_{1, 1, {T{}}};
    HostArray<Complex> w_{{9, 9}};
    HostArray<double> scale_{9};
    int32_t ilo_ = -7;
    int32_t ihi_ = -7;
};
TYPED_TEST_SUITE(Reductions, ElementTypes);

TYPED_TEST(Reductions, HessenbergFormIsSimilar) {
    for (const int32_t n : kSizes) {
        const auto a = RandomMatrix<TypeParam>(n, n, 1);
        const auto h = ToHost(a);
        ASSERT_EQ(this->Hessenberg(h.handle(), 0, n - 1, this->q_.handle()), 0);
        const auto q = FromHost(this->q_);
        EXPECT_LE(Unorthogonality(q), 1e-13 * n);
        EXPECT_LE(Distance(Product(Product(q, FromHost(h)), Adjoint(q)), a), 1e-13 * n);
        for (int32_t i = 2; i < n; ++i)
            for (int32_t j = 0; j + 1 < i; ++j) EXPECT_EQ(h(i, j), TypeParam{});
    }
}

TYPED_TEST(Reductions, HessenbergFormOfATriangularMatrixIsItself) {
    const auto random = RandomMatrix<TypeParam>(5, 5, 1);
    const auto a = Generate<TypeParam>(5, 5, [&](int32_t i, int32_t j) { return i <= j ? random(i, j) : TypeParam{}; });
    const auto h = ToHost(a);
    ASSERT_EQ(this->Hessenberg(h.handle(), 0, 4, this->q_.handle()), 0);
    EXPECT_EQ(FromHost(h), a);
    EXPECT_EQ(FromHost(this->q_), Identity<TypeParam>(5));
}

TYPED_TEST(Reductions, HessenbergChecksInOrder) {
    const auto expect = [this](const Matrix<TypeParam>& matrix, int32_t ilo, int32_t ihi, int32_t status) {
        const auto a = ToHost(matrix);
        EXPECT_EQ(this->Hessenberg(a.handle(), ilo, ihi, this->q_.handle()), status);
        EXPECT_TRUE(a.empty());
        EXPECT_TRUE(this->q_.empty());
    };
    const auto a = RandomMatrix<TypeParam>(3, 3, 1);
    expect({0, 3}, 5, 1, kNotSquare);
    expect({0, 0}, 5, 1, kEmptyInput);
    expect(a, 2, 1, kBadIndex);
    expect(a, -1, 1, kBadIndex);
    expect(a, 0, 3, kBadIndex);
    auto bad = a;
    bad(1, 1) = FromReal<TypeParam>(kQuietNaN);
    expect(bad, 2, 1, kBadIndex);
    expect(bad, 0, 2, kNotFinite);
}

TYPED_TEST(Reductions, BalancedMatricesAndTheirVectorsComeBack) {
    // Graded, with a row that can be split off.
    const auto random = RandomMatrix<TypeParam>(4, 4, 1);
    const auto a = Generate<TypeParam>(4, 4, [&](int32_t i, int32_t j) {
        return i == 3 && j < 3 ? TypeParam{} : random(i, j) * std::pow(100.0, i - j);
    });
    for (const int32_t job : {0, 1, 2, 3}) {
        const auto balanced = ToHost(a);
        ASSERT_EQ(this->Balance(balanced.handle(), job, &this->ilo_, &this->ihi_, this->scale_.handle()), 0);
        EXPECT_EQ(this->ilo_, 0);
        EXPECT_EQ(this->ihi_, job == 1 || job == 3 ? 2 : 3);
        if (job == 1) {
            EXPECT_EQ(this->scale_[3], 4.0) << "rows are counted from 1";
        }
        // The back transformation of the unit matrix is the similarity itself.
        const auto transformed_unit = [&](int32_t side) {
            const auto unit = ToHost(Identity<TypeParam>(4));
            EXPECT_EQ(this->BackTransform(unit.handle(), job, side, this->ilo_, this->ihi_, this->scale_.handle()), 0);
            return FromHost(unit);
        };
        const auto back = Product(Product(transformed_unit(0), FromHost(balanced)), Adjoint(transformed_unit(1)));
        for (int32_t i = 0; i < 4; ++i)
            for (int32_t j = 0; j < 4; ++j) EXPECT_LE(Modulus(back(i, j) - a(i, j)), 1e-12 * Modulus(a(i, j))) << job;
    }
}

TYPED_TEST(Reductions, BalancingChecksItsArguments) {
    const auto square = RandomMatrix<TypeParam>(3, 3, 1);
    const auto expect = [this](const Matrix<TypeParam>& matrix, int32_t job, int32_t status) {
        const auto a = ToHost(matrix);
        EXPECT_EQ(this->Balance(a.handle(), job, &this->ilo_, &this->ihi_, this->scale_.handle()), status);
        EXPECT_TRUE(a.empty());
        EXPECT_TRUE(this->scale_.empty());
        EXPECT_EQ(this->ilo_, -7) << "nothing is stored";
        EXPECT_EQ(this->ihi_, -7);
    };
    for (const int32_t job : {9, 4, -1}) expect(square, job, kBadSelector);
    expect({0, 3}, 9, kEmptyInput);
    expect({1, 3}, 9, kNotSquare);
    auto bad = square;
    bad(0, 1) = FromReal<TypeParam>(kQuietNaN);
    for (const int32_t job : {2, 3}) expect(bad, job, kLapackError);

    const auto expect_back = [this](const Matrix<TypeParam>& matrix, int32_t job, int32_t factors, int32_t status) {
        const auto v = ToHost(matrix);
        const HostArray<double> scale(std::vector<double>(Count(factors), 1.0));
        EXPECT_EQ(this->BackTransform(v.handle(), job, 0, 0, 2, scale.handle()), status);
        EXPECT_TRUE(v.empty());
    };
    expect_back(square, 9, 3, kBadSelector);
    expect_back(square, 9, 2, kSizesDiffer);
    expect_back({1, 3}, 9, 2, kNotSquare);
    expect_back({0, 0}, 9, 2, kEmptyInput);
}

TYPED_TEST(Reductions, BackTransformationStaysWithinTheMatrix) {
    const auto a = RandomMatrix<TypeParam>(3, 3, 1);
    for (const auto& [ilo, ihi] : {std::pair{-1, 2}, {0, 3}, {2, 1}, {INT32_MIN, INT32_MAX}}) {
        const auto v = ToHost(a);
        EXPECT_EQ(this->BackTransform(v.handle(), 3, 0, ilo, ihi, HostArray<double>{2, 2, 2}.handle()), 0);
        EXPECT_EQ(FromHost(v), a) << "a part that fits no matrix leaves the vectors";
    }
    for (const double row : {0.0, 4.0, -1.0, 1e300, kQuietNaN}) {
        const auto v = ToHost(a);
        EXPECT_EQ(this->BackTransform(v.handle(), 1, 0, 0, 1, HostArray<double>{1, 1, row}.handle()), kBadIndex);
        EXPECT_TRUE(v.empty());
    }
}

TYPED_TEST(Reductions, SchurFormsAreSimilarAndInOrder) {
    std::vector<Matrix<TypeParam>> matrices;
    for (const int32_t n : kSizes) matrices.push_back(RandomMatrix<TypeParam>(n, n, Count(n)));
    for (const auto& a : {FrankMatrix(9), GrcarMatrix(12), ClementMatrix(8), WilkinsonMatrix(11), RosserMatrix(),
                          JordanMatrix(5, 2.0), JordanMatrix(4, 0.0), Matrix<double>(3, 3)})
        matrices.push_back(this->FromReals(a));
    for (std::size_t which = 0; which < matrices.size(); ++which) {
        for (int32_t order = 0; order <= 4; ++order) {
            SCOPED_TRACE(testing::Message() << "matrix " << which << " order " << order);
            this->ExpectSchurForm(matrices[which], order);
        }
    }
}

TYPED_TEST(Reductions, SchurWithoutVectorsAndOrder) {
    const auto a = RandomMatrix<TypeParam>(4, 4, 1);
    ASSERT_EQ(this->Schur(ToHost(a).handle(), 0, this->z_.handle(), this->w_.handle()), 0);
    EXPECT_TRUE(this->z_.empty());
    const auto w = this->w_.values();
    ASSERT_EQ(this->Schur80(ToHost(a).handle(), 0, 0, this->z_.handle(), this->w_.handle()), 0);
    EXPECT_EQ(this->w_.values(), w);
}

TYPED_TEST(Reductions, UnwantedVectorsNeedNoConsentOfTheHost) {
    const FailResize refusal(1, KRRT_OUT_OF_MEMORY, KRRT_RESIZES);
    const auto a = ToHost(RandomMatrix<TypeParam>(3, 3, 1));
    EXPECT_EQ(this->Schur(a.handle(), 0, this->z_.handle(), this->w_.handle()), 0);
    EXPECT_TRUE(refusal.happened());
    EXPECT_TRUE(this->z_.empty());
}

TYPED_TEST(Reductions, SchurChecksItsArguments) {
    const auto expect = [this](const Matrix<TypeParam>& matrix, int32_t order, int32_t status) {
        const auto a = ToHost(matrix);
        EXPECT_EQ(this->Schur80(a.handle(), 1, order, this->z_.handle(), this->w_.handle()), status);
        EXPECT_TRUE(a.empty() && this->z_.empty() && this->w_.empty());
    };
    auto bad = RandomMatrix<TypeParam>(3, 3, 1);
    bad(0, 1) = FromReal<TypeParam>(kInfinity);
    expect({0, 0}, 9, kEmptyInput);
    expect({2, 3}, 9, kNotSquare);
    expect(bad, 9, kBadSelector);
    expect(bad, -1, kBadSelector);
    expect(bad, 1, kNotFinite);
}

}  // namespace
}  // namespace krnumer

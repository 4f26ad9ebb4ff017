// Generalised Schur decomposition and eigenvalues of pencils, through their exports: residuals, orders, statuses.

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <vector>

#include "frame/numeric.h"
#include "frame/status.h"
#include "krnumer/linalg_schur.h"
#include "linalg/matrices.h"
#include "reference/linalg/pencil.inc"

namespace krnumer {
namespace {

constexpr int32_t kSizes[] = {1, 2, 3, 5, 8, 17, 40};

template <class T>
std::vector<Complex> AsComplex(const std::vector<T>& values) {
    std::vector<Complex> complex;
    for (const T& value : values) complex.push_back(ToComplex(Matrix<T>(1, 1, {value}))(0, 0));
    return complex;
}

// beta A V - alpha B V, column by column.
template <class T>
double Residual(const Matrix<T>& a, const Matrix<T>& b, const Matrix<Complex>& v, const std::vector<Complex>& alpha,
                const std::vector<Complex>& beta) {
    const auto av = Product(ToComplex(a), v), bv = Product(ToComplex(b), v);
    return FrobeniusNorm(Generate<Complex>(
        a.rows, a.rows, [&](int32_t i, int32_t j) { return beta[Count(j)] * av(i, j) - alpha[Count(j)] * bv(i, j); }));
}

// Columns in LAPACK's packed form, a complex pair as its real and imaginary part.
Matrix<Complex> Expanded(const Matrix<double>& packed, const std::vector<Complex>& alpha) {
    return Generate<Complex>(packed.rows, packed.rows, [&](int32_t i, int32_t j) -> Complex {
        if (alpha[Count(j)].im > 0.0) return {packed(i, j), packed(i, j + 1)};
        if (alpha[Count(j)].im < 0.0) return {packed(i, j - 1), -packed(i, j)};
        return {packed(i, j), 0.0};
    });
}
Matrix<Complex> Expanded(const Matrix<Complex>& vectors, const std::vector<Complex>& /*alpha*/) {
    return vectors;
}

template <class T>
class Pencils : public testing::Test {
  protected:
    static constexpr auto QZ = Pick<T>(QZ_head, CxQZ_head);
    static constexpr auto QZ80 = Pick<T>(QZ80_head, CxQZ80_head);
    static constexpr auto TmiQZ = Pick<T>(TmiQZ_head, CxTmiQZ_head);
    static constexpr auto GenEigenEx = Pick<T>(GenEigenEx_head, CxGenEigenEx_head);

    static Matrix<T> Diagonal(const std::vector<double>& values) {
        const auto n = static_cast<int32_t>(values.size());
        return Generate<T>(n, n, [&](int32_t i, int32_t j) { return FromReal<T>(i == j ? values[Count(i)] : 0.0); });
    }

    // Decomposes; Q and Z take the places of A and B.
    int32_t Decompose(const Matrix<T>& a, const Matrix<T>& b, int32_t mode, int32_t order) {
        q_ = ToHost(a);
        z_ = ToHost(b);
        return QZ80(q_.handle(), z_.handle(), mode, order, w_.handle(), beta_.handle(), v_.handle());
    }
    int32_t DecomposeWhole(const HostMatrix<T>& a, const HostMatrix<T>& b, int32_t which) {
        return TmiQZ(a.handle(), b.handle(), q_.handle(), z_.handle(), w_.handle(), beta_.handle(), which, vr_.handle(),
                     vl_.handle());
    }
    int32_t Eigenvalues(const Matrix<T>& a, const Matrix<T>& b, int32_t want_vectors) {
        return GenEigenEx(ToHost(a).handle(), ToHost(b).handle(), want_vectors, w_.handle(), v_.handle());
    }

    double ResidualOf(const Matrix<T>& a, const Matrix<T>& b) {
        return Residual(a, b, FromHost(v_), w_.values(), AsComplex(beta_.values()));
    }

    LeakCheck leaks_;
    HostMatrix<T> q_{1, 1, {T{}}}, z_{1, 1, {T{}}}, vr_{1, 1, {T{}}}, vl_{1, 1, {T{}}};
    HostMatrix<Complex> v_{1, 1, {Complex{}}};
    HostArray<Complex> w_{{9, 9}};
    HostArray<T> beta_{T{}};
};
TYPED_TEST_SUITE(Pencils, ElementTypes);

TYPED_TEST(Pencils, HaveTheirSchurForm) {
    using T = TypeParam;
    for (const int32_t n : kSizes) {
        const auto a = RandomMatrix<T>(n, n, 1), b = RandomMatrix<T>(n, n, 2);
        const auto s = ToHost(a), p = ToHost(b);
        ASSERT_EQ(this->DecomposeWhole(s, p, 3), 0);
        const auto z = FromHost(this->z_);
        const auto q = Transposed(Adjoint(FromHost(this->q_)));  // complex Q lacks its conjugation
        EXPECT_LE(Unorthogonality(q), 1e-13 * n);
        EXPECT_LE(Unorthogonality(z), 1e-13 * n);
        EXPECT_LE(Distance(Product(Product(q, a), z), FromHost(s)), 1e-13 * n * n);
        EXPECT_LE(Distance(Product(Product(q, b), z), FromHost(p)), 1e-13 * n * n);
        for (int32_t i = 1; i < n; ++i)
            for (int32_t j = 0; j < i; ++j) EXPECT_EQ(p(i, j), T{});

        auto alpha = this->w_.values(), beta = AsComplex(this->beta_.values());
        const auto right = Expanded(FromHost(this->vr_), alpha), left = Expanded(FromHost(this->vl_), alpha);
        EXPECT_LE(Residual(a, b, right, alpha, beta), 1e-13 * n * n);
        for (Complex& value : alpha) value = Conjugate(value);
        for (Complex& value : beta) value = Conjugate(value);
        EXPECT_LE(Residual(Adjoint(a), Adjoint(b), left, alpha, beta), 1e-13 * n * n);
    }
}

TYPED_TEST(Pencils, DeliverTheVectorsAskedFor) {
    const auto a = RandomMatrix<TypeParam>(3, 3, 1), b = RandomMatrix<TypeParam>(3, 3, 2);
    for (int32_t which = 0; which <= 3; ++which) {
        ASSERT_EQ(this->DecomposeWhole(ToHost(a), ToHost(b), which), 0);
        EXPECT_EQ(this->vr_.rows(), which == 1 || which == 3 ? 3 : 0);
        EXPECT_EQ(this->vl_.rows(), which >= 2 ? 3 : 0);
    }
    ASSERT_EQ(this->Eigenvalues(a, b, 0), 0);
    EXPECT_TRUE(this->v_.empty());
}

TYPED_TEST(Pencils, UnwantedVectorsNeedNoConsentOfTheHost) {
    const auto a = RandomMatrix<TypeParam>(3, 3, 1), b = RandomMatrix<TypeParam>(3, 3, 2);
    {
        const FailResize refusal(2, KRRT_OUT_OF_MEMORY, KRRT_RESIZES);
        EXPECT_EQ(this->Eigenvalues(a, b, 0), 0);
        EXPECT_TRUE(refusal.happened());
        EXPECT_TRUE(this->v_.empty());
    }
    const FailResize refusal(5, KRRT_OUT_OF_MEMORY, KRRT_RESIZES);
    EXPECT_EQ(this->DecomposeWhole(ToHost(a), ToHost(b), 2), 0);
    EXPECT_TRUE(refusal.happened());
    EXPECT_TRUE(this->vr_.empty());
    EXPECT_EQ(this->vl_.rows(), 3);
}

TYPED_TEST(Pencils, SortTheirEigenvalues) {
    for (const int32_t n : {2, 3, 6, 15}) {
        const auto a = RandomMatrix<TypeParam>(n, n, 3), b = RandomMatrix<TypeParam>(n, n, 4);
        for (int32_t order = 0; order <= 4; ++order) {
            ASSERT_EQ(this->Decompose(a, b, 1, order), 0);
            const auto q = FromHost(this->q_);
            EXPECT_LE(Unorthogonality(q), 1e-13 * n);
            EXPECT_LE(this->ResidualOf(a, b), 1e-12 * n);
            const auto key = [&](int32_t i) {
                const Complex alpha = this->w_[i];
                const double beta = RealPart(this->beta_[i]);
                return order <= 2 ? alpha.re / beta : Modulus(alpha) / std::fabs(beta);
            };
            for (int32_t i = 0; i + 1 < n && order > 0; ++i) {
                const double slack = 1e-10 * std::max(1.0, std::fabs(key(i)));
                EXPECT_GE(order % 2 == 1 ? key(i + 1) - key(i) : key(i) - key(i + 1), -slack) << "order " << order;
            }
            // A = Q S Z^H: what is left of A between the factors is quasi-triangular.
            const auto s = Product(Product(Adjoint(q), a), FromHost(this->z_));
            for (int32_t i = 2; i < n; ++i)
                for (int32_t j = 0; j + 1 < i; ++j) EXPECT_LE(Modulus(s(i, j)), 1e-12);
        }
    }
}

TYPED_TEST(Pencils, HaveTheEigenvaluesOfSciPy) {
    const auto& golden = GoldenPencil<TypeParam>::Values();
    // Descending orders are compared backwards, real pairs aside: their first always has the positive imaginary part.
    const auto expect = [&](int32_t order, const std::vector<Complex>& ascending) {
        ASSERT_EQ(this->Decompose(golden.a, golden.b, 1, order), 0);
        const auto beta = AsComplex(this->beta_.values());
        for (std::size_t i = 0; i < ascending.size(); ++i) {
            const Complex value = this->w_.values()[i] / beta[i];
            Complex expected = ascending[order % 2 == 1 ? i : ascending.size() - 1 - i];
            if (order % 2 == 0 && !kIsComplex<TypeParam>) expected.im = -expected.im;
            EXPECT_LE(Modulus(value - expected), 1e-12 * std::max(1.0, Modulus(expected))) << order << " at " << i;
        }
    };
    expect(1, golden.by_real_part);
    expect(2, golden.by_real_part);
    expect(3, golden.by_modulus);
    expect(4, golden.by_modulus);
    ASSERT_EQ(this->Eigenvalues(golden.a, golden.b, 0), 0);
    for (const Complex& expected : golden.by_modulus) {
        double nearest = kInfinity;
        for (const Complex& value : this->w_.values()) nearest = std::min(nearest, Modulus(value - expected));
        EXPECT_LE(nearest, 1e-12 * std::max(1.0, Modulus(expected)));
    }
}

TYPED_TEST(Pencils, PutInfiniteEigenvaluesAtTheEndsWhateverTheirSign) {
    const auto a = this->Diagonal({-3, -1, 2, -5}), b = this->Diagonal({1, 0, 1, 0});
    const auto is_infinite = [this](int32_t i) { return this->beta_[i] == TypeParam{}; };
    for (const int32_t order : {1, 3}) {
        ASSERT_EQ(this->Decompose(a, b, 1, order), 0);
        EXPECT_TRUE(is_infinite(2) && is_infinite(3)) << "last in ascending order " << order;
    }
    for (const int32_t order : {2, 4}) {
        ASSERT_EQ(this->Decompose(a, b, 1, order), 0);
        EXPECT_TRUE(is_infinite(0) && is_infinite(1)) << "first in descending order " << order;
    }
}

TYPED_TEST(Pencils, DeliverTheirFirstStageInModeZero) {
    const int32_t n = 5;
    const auto a = RandomMatrix<TypeParam>(n, n, 5), b = RandomMatrix<TypeParam>(n, n, 6);
    const auto q = ToHost(a), z = ToHost(b);
    ASSERT_EQ(this->QZ(q.handle(), z.handle(), this->w_.handle(), this->beta_.handle(), this->v_.handle()), 0);
    EXPECT_EQ(z(0, 0), FromReal<TypeParam>(1.0)) << "Z begins with the first unit vector";
    const auto h = Product(Product(Adjoint(FromHost(q)), a), FromHost(z));
    for (int32_t i = 2; i < n; ++i)
        for (int32_t j = 0; j + 1 < i; ++j) EXPECT_LE(Modulus(h(i, j)), 1e-13) << "Hessenberg";
    EXPECT_LE(this->ResidualOf(a, b), 1e-12) << "eigenvalues are final";
}

TYPED_TEST(Pencils, HaveQuotientsAsEigenvalues) {
    for (const int32_t n : kSizes) {
        const auto a = RandomMatrix<TypeParam>(n, n, 7), b = RandomMatrix<TypeParam>(n, n, 8);
        ASSERT_EQ(this->Eigenvalues(a, b, 1), 0);
        const auto w = this->w_.values();
        double largest = 1.0;
        for (const Complex& value : w) largest = std::max(largest, Modulus(value));
        const std::vector<Complex> ones(w.size(), Complex{1.0, 0.0});
        EXPECT_LE(Residual(a, b, FromHost(this->v_), w, ones), 1e-12 * n * largest);
        for (int32_t j = 0; j < n; ++j) {
            double norm = 0.0;
            for (int32_t i = 0; i < n; ++i) norm = std::max(norm, SumOfParts(this->v_(i, j)));
            EXPECT_NEAR(norm, 1.0, 1e-14);
        }
    }
}

TYPED_TEST(Pencils, DivideByZeroWithoutATest) {
    ASSERT_EQ(this->Eigenvalues(this->Diagonal({1, -2}), this->Diagonal({1, 0}), 0), 0);
    const auto w = this->w_.values();
    EXPECT_EQ(w[0], (Complex{1.0, 0.0}));
    EXPECT_TRUE(std::isnan(w[1].im));
    if constexpr (kIsComplex<TypeParam>) {
        EXPECT_TRUE(std::isnan(w[1].re)) << "Smith's quotient";
    } else {
        EXPECT_EQ(w[1].re, -kInfinity);
    }
}

TYPED_TEST(Pencils, EndTheirSortingAtAnIndeterminatePair) {
    const auto a = this->Diagonal({3, 0}), b = this->Diagonal({1, 0});
    EXPECT_EQ(this->Decompose(a, b, 1, 1), kWarnNotReordered);
    EXPECT_EQ(this->w_.size(), 2) << "the results stand";
    for (const int32_t mode : {0, 2}) EXPECT_EQ(this->Decompose(a, b, mode, 1), 0) << "only mode 1 sorts";
}

TYPED_TEST(Pencils, CheckInOrder) {
    using T = TypeParam;
    const auto good = RandomMatrix<T>(2, 2, 1);
    auto bad = good;
    bad(1, 1) = FromReal<T>(kQuietNaN);
    const auto expect = [this](const Matrix<T>& a, const Matrix<T>& b, int32_t selector, int32_t status) {
        EXPECT_EQ(this->Decompose(a, b, 1, selector), status);
        EXPECT_TRUE(this->q_.empty() && this->z_.empty() && this->w_.empty() && this->beta_.empty() &&
                    this->v_.empty());
        const auto s = ToHost(a), p = ToHost(b);
        EXPECT_EQ(this->DecomposeWhole(s, p, selector), status);
        EXPECT_TRUE(s.empty() && p.empty() && this->q_.empty() && this->z_.empty() && this->vr_.empty() &&
                    this->vl_.empty());
        EXPECT_EQ(this->Eigenvalues(a, b, selector), status);
        EXPECT_TRUE(this->w_.empty() && this->v_.empty());
    };
    expect({1, 2}, {0, 0}, 9, kNotSquare);
    expect({0, 0}, {1, 2}, 9, kNotSquare);
    expect({0, 0}, good, 9, kPencilSizesDiffer);
    expect({0, 0}, {0, 0}, 9, kEmptyInput);
    expect(bad, good, 9, kBadSelector);
    expect(bad, good, 1, kNotFinite);
    expect(good, bad, 1, kNotFinite);
}

}  // namespace
}  // namespace krnumer

// Hessenberg form, balancing, Schur decomposition and pencils, through their exports: residuals, orders, statuses.

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cmath>
#include <random>

#include "frame/numeric.h"
#include "frame/status.h"
#include "krnumer/linalg_schur.h"
#include "linalg/element.h"
#include "linalg/products.h"
#include "support/host_arrays.h"

namespace krnumer {
namespace {

template <class T>
using Elements = std::vector<T>;

template <class T>
Elements<T> Random(int32_t n, uint32_t seed = 1) {
    std::mt19937 random(seed);
    std::normal_distribution<> normal;
    Elements<T> a(Count(n) * Count(n));
    for (T& element : a) {
        if constexpr (kIsComplex<T>) {
            const double re = normal(random);
            element = {re, normal(random)};
        } else {
            element = normal(random);
        }
    }
    return a;
}

template <class T>
Elements<T> Multiply(const Elements<T>& a, const Elements<T>& b, int32_t n) {
    Elements<T> c(a.size());
    EXPECT_EQ(MatMulCore(a.data(), b.data(), n, n, n, c.data()), kOk);
    return c;
}

template <class T>
Elements<T> Adjoint(const Elements<T>& a, int32_t n) {
    Elements<T> c(a.size());
    for (size_t i = 0; i < Count(n); ++i)
        for (size_t j = 0; j < Count(n); ++j) c[j * Count(n) + i] = Conjugate(a[i * Count(n) + j]);
    return c;
}

template <class T>
void ExpectNear(const Elements<T>& a, const Elements<T>& b, double tolerance) {
    ASSERT_EQ(a.size(), b.size());
    for (size_t i = 0; i < a.size(); ++i) EXPECT_LE(Modulus(a[i] - b[i]), tolerance) << "element " << i;
}

template <class T>
void ExpectUnitary(const Elements<T>& q, int32_t n) {
    Elements<T> unit(q.size());
    for (size_t i = 0; i < Count(n); ++i) unit[i * Count(n) + i] = FromReal<T>(1.0);
    ExpectNear(Multiply(q, Adjoint(q, n), n), unit, 1e-13 * n);
}

// The exports by the element of their matrices.
template <class T>
struct Exports {
    static constexpr auto Hessenberg = kIsComplex<T> ? CxHessenberg_head : Hessenberg_head;
    static constexpr auto Balance = kIsComplex<T> ? CxMatrixBalance_head : MatrixBalance_head;
    static constexpr auto Back = kIsComplex<T> ? CxEigenVBack_head : EigenVBack_head;
    static constexpr auto Schur = kIsComplex<T> ? CxSchur_head : Schur_head;
    static constexpr auto Schur80 = kIsComplex<T> ? CxSchur80_head : Schur80_head;
    static constexpr auto QZ = kIsComplex<T> ? CxQZ_head : QZ_head;
    static constexpr auto QZ80 = kIsComplex<T> ? CxQZ80_head : QZ80_head;
    static constexpr auto Tmi = kIsComplex<T> ? CxTmiQZ_head : TmiQZ_head;
    static constexpr auto Pencil = kIsComplex<T> ? CxGenEigenEx_head : GenEigenEx_head;
};

constexpr int32_t kSizes[] = {1, 2, 3, 5, 8, 17, 40};

template <class T>
class Reductions : public testing::Test {
  protected:
    LeakCheck leaks_;
    HostMatrix<T> q_{1, 1, {T{}}}, z_{1, 1, {T{}}}, vr_{1, 1, {T{}}}, vl_{1, 1, {T{}}};
    HostMatrix<Complex> v_{1, 1, {Complex{}}};
    HostArray<Complex> w_{{9, 9}};
    HostArray<T> beta_{T{}};
    HostArray<double> scale_{9};
    int32_t ilo_ = -7;
    int32_t ihi_ = -7;

    static HostMatrix<T> Square(int32_t n, const Elements<T>& elements) { return HostMatrix<T>(n, n, elements); }
};
using ElementTypes = testing::Types<double, Complex>;
TYPED_TEST_SUITE(Reductions, ElementTypes);

TYPED_TEST(Reductions, HessenbergFormIsSimilar) {
    for (const int32_t n : kSizes) {
        const auto a = Random<TypeParam>(n);
        auto h = this->Square(n, a);
        ASSERT_EQ(Exports<TypeParam>::Hessenberg(h.handle(), 0, n - 1, this->q_.handle()), 0);
        const auto q = this->q_.values();
        ExpectUnitary(q, n);
        ExpectNear(Multiply(Multiply(q, h.values(), n), Adjoint(q, n), n), a, 1e-13 * n);
        for (int32_t i = 2; i < n; ++i)
            for (int32_t j = 0; j + 1 < i; ++j) EXPECT_EQ(h(i, j), TypeParam{});
    }
}

TYPED_TEST(Reductions, HessenbergChecksInOrder) {
    const auto expect = [this](HostMatrix<TypeParam> a, int32_t ilo, int32_t ihi, int32_t status) {
        EXPECT_EQ(Exports<TypeParam>::Hessenberg(a.handle(), ilo, ihi, this->q_.handle()), status);
        EXPECT_TRUE(a.empty());
        EXPECT_TRUE(this->q_.empty());
    };
    const auto a = Random<TypeParam>(3);
    expect(HostMatrix<TypeParam>(0, 3), 5, 1, kNotSquare);
    expect(HostMatrix<TypeParam>(0, 0), 5, 1, kEmptyInput);
    expect(this->Square(3, a), 2, 1, kBadIndex);
    expect(this->Square(3, a), -1, 1, kBadIndex);
    expect(this->Square(3, a), 0, 3, kBadIndex);
    auto bad = a;
    bad[4] = FromReal<TypeParam>(kQuietNaN);
    expect(this->Square(3, bad), 2, 1, kBadIndex);
    expect(this->Square(3, bad), 0, 2, kNotFinite);
}

TYPED_TEST(Reductions, BalancedMatricesAndTheirVectorsComeBack) {
    // Graded, with a row that can be split off.
    auto a = Random<TypeParam>(4);
    for (size_t i = 0; i < 4; ++i)
        for (size_t j = 0; j < 4; ++j)
            a[i * 4 + j] = a[i * 4 + j] * std::pow(100.0, static_cast<double>(i) - static_cast<double>(j));
    for (size_t j = 0; j < 3; ++j) a[3 * 4 + j] = TypeParam{};
    for (const int32_t job : {0, 1, 2, 3}) {
        auto balanced = this->Square(4, a);
        ASSERT_EQ(Exports<TypeParam>::Balance(balanced.handle(), job, &this->ilo_, &this->ihi_, this->scale_.handle()),
                  0);
        EXPECT_EQ(this->ilo_, 0);
        EXPECT_EQ(this->ihi_, job == 1 || job == 3 ? 2 : 3);
        if (job == 1) {
            EXPECT_EQ(this->scale_[3], 4.0) << "rows are counted from 1";
        }
        // The back transformation of the unit matrix is the similarity itself.
        Elements<TypeParam> unit(16);
        for (size_t i = 0; i < 4; ++i) unit[i * 4 + i] = FromReal<TypeParam>(1.0);
        auto d = this->Square(4, unit);
        ASSERT_EQ(Exports<TypeParam>::Back(d.handle(), job, 0, this->ilo_, this->ihi_, this->scale_.handle()), 0);
        auto inverse = this->Square(4, unit);
        ASSERT_EQ(Exports<TypeParam>::Back(inverse.handle(), job, 1, this->ilo_, this->ihi_, this->scale_.handle()), 0);
        const auto product = Multiply(d.values(), balanced.values(), 4);
        const auto back = Multiply(product, Adjoint(inverse.values(), 4), 4);
        for (size_t i = 0; i < 16; ++i) EXPECT_LE(Modulus(back[i] - a[i]), 1e-12 * Modulus(a[i])) << job;
    }
}

TYPED_TEST(Reductions, BalancingChecksItsArguments) {
    const auto a = Random<TypeParam>(3);
    for (const int32_t job : {9, 4, -1}) {
        auto matrix = this->Square(3, a);
        EXPECT_EQ(Exports<TypeParam>::Balance(matrix.handle(), job, &this->ilo_, &this->ihi_, this->scale_.handle()),
                  kBadSelector);
        EXPECT_TRUE(matrix.empty());
        EXPECT_TRUE(this->scale_.empty());
        EXPECT_EQ(this->ilo_, -7) << "nothing is stored";
        auto vectors = this->Square(3, a);
        EXPECT_EQ(Exports<TypeParam>::Back(vectors.handle(), job, 0, 0, 2, HostArray<double>{1, 1, 1}.handle()),
                  kBadSelector);
        EXPECT_TRUE(vectors.empty());
    }
    HostMatrix<TypeParam> none(0, 3);
    EXPECT_EQ(Exports<TypeParam>::Balance(none.handle(), 9, &this->ilo_, &this->ihi_, this->scale_.handle()),
              kEmptyInput);
    HostMatrix<TypeParam> wide(1, 3);
    EXPECT_EQ(Exports<TypeParam>::Balance(wide.handle(), 9, &this->ilo_, &this->ihi_, this->scale_.handle()),
              kNotSquare);
    HostArray<double> two{1, 1};
    HostMatrix<TypeParam> oblong(1, 3);
    EXPECT_EQ(Exports<TypeParam>::Back(oblong.handle(), 9, 0, 0, 2, two.handle()), kNotSquare);
    HostMatrix<TypeParam> empty(0, 0);
    EXPECT_EQ(Exports<TypeParam>::Back(empty.handle(), 9, 0, 0, 2, two.handle()), kEmptyInput);
    auto square = this->Square(3, a);
    EXPECT_EQ(Exports<TypeParam>::Back(square.handle(), 9, 0, 0, 2, two.handle()), kSizesDiffer);
}

TYPED_TEST(Reductions, BackTransformationStaysWithinTheMatrix) {
    const auto a = Random<TypeParam>(3);
    for (const auto& [ilo, ihi] : {std::pair{-1, 2}, {0, 3}, {2, 1}, {INT32_MIN, INT32_MAX}}) {
        auto v = this->Square(3, a);
        EXPECT_EQ(Exports<TypeParam>::Back(v.handle(), 3, 0, ilo, ihi, HostArray<double>{1, 1, 1}.handle()), 0);
        EXPECT_EQ(v.values(), a) << "a part that fits no matrix leaves the vectors";
    }
    for (const double row : {0.0, 4.0, -1.0, 1e300, kQuietNaN}) {
        auto v = this->Square(3, a);
        EXPECT_EQ(Exports<TypeParam>::Back(v.handle(), 1, 0, 0, 1, HostArray<double>{1, 1, row}.handle()), kBadIndex);
        EXPECT_TRUE(v.empty());
    }
}

TYPED_TEST(Reductions, SchurFormsAreSimilarAndTriangular) {
    for (const int32_t n : kSizes) {
        for (int32_t order = 0; order <= 4; ++order) {
            const auto a = Random<TypeParam>(n, static_cast<uint32_t>(n));
            auto t = this->Square(n, a);
            ASSERT_EQ(Exports<TypeParam>::Schur80(t.handle(), 1, order, this->z_.handle(), this->w_.handle()), 0);
            const auto z = this->z_.values();
            ExpectUnitary(z, n);
            ExpectNear(Multiply(Multiply(z, t.values(), n), Adjoint(z, n), n), a, 1e-12 * n);
            const auto key = [&](int32_t i) {
                return order <= 2 ? this->w_[i].re : std::hypot(this->w_[i].re, this->w_[i].im);
            };
            for (int32_t i = 0; i + 1 < n && order > 0; ++i) {
                const double step = key(i + 1) - key(i);
                EXPECT_GE(order % 2 == 1 ? step : -step, -1e-12) << "order " << order;
            }
            for (int32_t i = 1; i < n; ++i) {
                for (int32_t j = 0; j + 1 < i; ++j) EXPECT_EQ(t(i, j), TypeParam{});
                const bool pair = this->w_[i].im != 0.0 && this->w_[i].im == -this->w_[i - 1].im;
                if (kIsComplex<TypeParam> || !pair) {
                    EXPECT_EQ(t(i, i - 1), TypeParam{});
                }
            }
        }
    }
}

TYPED_TEST(Reductions, SchurWithoutVectorsAndOrder) {
    const auto a = Random<TypeParam>(4);
    auto plain = this->Square(4, a);
    ASSERT_EQ(Exports<TypeParam>::Schur(plain.handle(), 0, this->z_.handle(), this->w_.handle()), 0);
    EXPECT_TRUE(this->z_.empty());
    auto ordered = this->Square(4, a);
    const auto w = this->w_.values();
    ASSERT_EQ(Exports<TypeParam>::Schur80(ordered.handle(), 0, 0, this->z_.handle(), this->w_.handle()), 0);
    EXPECT_EQ(this->w_.values(), w);
}

// The host is told of arrays that are emptied because nobody wants them, but not asked.
TYPED_TEST(Reductions, UnwantedVectorsNeedNoConsent) {
    const auto a = Random<TypeParam>(3);
    const auto b = Random<TypeParam>(3, 2);
    const auto expect_empty = [](const FailResize& refusal, const auto& unwanted) {
        EXPECT_TRUE(refusal.happened());
        EXPECT_EQ(unwanted.rows(), 0);
        EXPECT_EQ(unwanted.columns(), 0);
    };
    {
        const FailResize refusal(1, KRRT_OUT_OF_MEMORY, KRRT_RESIZES);
        EXPECT_EQ(Exports<TypeParam>::Schur(this->Square(3, a).handle(), 0, this->z_.handle(), this->w_.handle()), 0);
        expect_empty(refusal, this->z_);
    }
    {
        const FailResize refusal(2, KRRT_OUT_OF_MEMORY, KRRT_RESIZES);
        EXPECT_EQ(Exports<TypeParam>::Pencil(this->Square(3, a).handle(), this->Square(3, b).handle(), 0,
                                             this->w_.handle(), this->v_.handle()),
                  0);
        expect_empty(refusal, this->v_);
    }
    {
        const FailResize refusal(5, KRRT_OUT_OF_MEMORY, KRRT_RESIZES);
        EXPECT_EQ(Exports<TypeParam>::Tmi(this->Square(3, a).handle(), this->Square(3, b).handle(), this->q_.handle(),
                                          this->z_.handle(), this->w_.handle(), this->beta_.handle(), 2,
                                          this->vr_.handle(), this->vl_.handle()),
                  0);
        expect_empty(refusal, this->vr_);
        EXPECT_EQ(this->vl_.rows(), 3);
    }
}

TYPED_TEST(Reductions, SchurChecksItsArguments) {
    const auto expect = [this](HostMatrix<TypeParam> a, int32_t order, int32_t status) {
        EXPECT_EQ(Exports<TypeParam>::Schur80(a.handle(), 1, order, this->z_.handle(), this->w_.handle()), status);
        EXPECT_TRUE(a.empty() && this->z_.empty() && this->w_.empty());
    };
    auto bad = Random<TypeParam>(3);
    bad[1] = FromReal<TypeParam>(kInfinity);
    expect(HostMatrix<TypeParam>(0, 0), 9, kEmptyInput);
    expect(HostMatrix<TypeParam>(2, 3), 9, kNotSquare);
    expect(this->Square(3, bad), 9, kBadSelector);
    expect(this->Square(3, bad), -1, kBadSelector);
    expect(this->Square(3, bad), 1, kNotFinite);
}

// Largest element of beta A V - alpha B V, column by column.
template <class T>
double PencilResidual(const Elements<T>& a, const Elements<T>& b, const HostMatrix<Complex>& v,
                      const HostArray<Complex>& alpha, const HostArray<T>& beta, int32_t n) {
    double worst = 0.0;
    for (int32_t j = 0; j < n; ++j) {
        for (int32_t i = 0; i < n; ++i) {
            Complex av{};
            Complex bv{};
            for (int32_t k = 0; k < n; ++k) {
                const size_t place = Count(i) * Count(n) + Count(k);
                av += a[place] * v(k, j);
                bv += b[place] * v(k, j);
            }
            worst = std::max(worst, Modulus(beta[j] * av - alpha[j] * bv));
        }
    }
    return worst;
}

TYPED_TEST(Reductions, PencilsHaveTheirSchurForm) {
    for (const int32_t n : kSizes) {
        const auto a = Random<TypeParam>(n, 1);
        const auto b = Random<TypeParam>(n, 2);
        auto s = this->Square(n, a);
        auto p = this->Square(n, b);
        ASSERT_EQ(
            Exports<TypeParam>::Tmi(s.handle(), p.handle(), this->q_.handle(), this->z_.handle(), this->w_.handle(),
                                    this->beta_.handle(), 3, this->vr_.handle(), this->vl_.handle()),
            0);
        // In the complex family Q lacks its conjugation.
        auto q = this->q_.values();
        for (TypeParam& element : q) element = Conjugate(element);
        const auto z = this->z_.values();
        ExpectUnitary(q, n);
        ExpectUnitary(z, n);
        ExpectNear(Multiply(Multiply(q, a, n), z, n), s.values(), 1e-12 * n);
        ExpectNear(Multiply(Multiply(q, b, n), z, n), p.values(), 1e-12 * n);
        for (int32_t i = 1; i < n; ++i)
            for (int32_t j = 0; j < i; ++j) EXPECT_EQ(p(i, j), TypeParam{});
        EXPECT_EQ(this->vr_.rows(), n);
        EXPECT_EQ(this->vl_.rows(), n);
    }
}

TYPED_TEST(Reductions, PencilsSortTheirEigenvalues) {
    for (const int32_t n : {2, 3, 6, 15}) {
        for (int32_t order = 0; order <= 4; ++order) {
            const auto a = Random<TypeParam>(n, 3);
            const auto b = Random<TypeParam>(n, 4);
            auto q = this->Square(n, a);
            auto z = this->Square(n, b);
            ASSERT_EQ(Exports<TypeParam>::QZ80(q.handle(), z.handle(), 1, order, this->w_.handle(),
                                               this->beta_.handle(), this->v_.handle()),
                      0);
            ExpectUnitary(q.values(), n);
            EXPECT_LE(PencilResidual(a, b, this->v_, this->w_, this->beta_, n), 1e-12 * n);
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
            const auto s = Multiply(Multiply(Adjoint(q.values(), n), a, n), z.values(), n);
            for (size_t i = 2; i < Count(n); ++i)
                for (size_t j = 0; j + 1 < i; ++j) EXPECT_LE(Modulus(s[i * Count(n) + j]), 1e-12);
        }
    }
}

TYPED_TEST(Reductions, PencilsInModeZeroDeliverTheirFirstStage) {
    const int32_t n = 5;
    const auto a = Random<TypeParam>(n, 5);
    const auto b = Random<TypeParam>(n, 6);
    auto q = this->Square(n, a);
    auto z = this->Square(n, b);
    ASSERT_EQ(
        Exports<TypeParam>::QZ(q.handle(), z.handle(), this->w_.handle(), this->beta_.handle(), this->v_.handle()), 0);
    EXPECT_EQ(z(0, 0), FromReal<TypeParam>(1.0)) << "Z begins with the first unit vector";
    const auto h = Multiply(Multiply(Adjoint(q.values(), n), a, n), z.values(), n);
    for (size_t i = 2; i < Count(n); ++i)
        for (size_t j = 0; j + 1 < i; ++j) EXPECT_LE(Modulus(h[i * Count(n) + j]), 1e-13) << "Hessenberg";
    EXPECT_LE(PencilResidual(a, b, this->v_, this->w_, this->beta_, n), 1e-12) << "eigenvalues are final";
}

TYPED_TEST(Reductions, PencilEigenvaluesAreQuotients) {
    for (const int32_t n : kSizes) {
        const auto a = Random<TypeParam>(n, 7);
        const auto b = Random<TypeParam>(n, 8);
        ASSERT_EQ(Exports<TypeParam>::Pencil(this->Square(n, a).handle(), this->Square(n, b).handle(), 1,
                                             this->w_.handle(), this->v_.handle()),
                  0);
        HostArray<TypeParam> ones(n);
        for (int32_t i = 0; i < n; ++i) ones.Set(i, FromReal<TypeParam>(1.0));
        double largest = 1.0;
        for (const Complex& w : this->w_.values()) largest = std::max(largest, Modulus(w));
        EXPECT_LE(PencilResidual(a, b, this->v_, this->w_, ones, n), 1e-12 * n * largest);
        for (int32_t j = 0; j < n; ++j) {
            double norm = 0.0;
            for (int32_t i = 0; i < n; ++i) norm = std::max(norm, SumOfParts(this->v_(i, j)));
            EXPECT_NEAR(norm, 1.0, 1e-14);
        }
        ASSERT_EQ(Exports<TypeParam>::Pencil(this->Square(n, a).handle(), this->Square(n, b).handle(), 0,
                                             this->w_.handle(), this->v_.handle()),
                  0);
        EXPECT_TRUE(this->v_.empty());
    }
}

TYPED_TEST(Reductions, SingularPencils) {
    const auto matrix = [](std::initializer_list<double> values) {
        Elements<TypeParam> elements;
        for (const double value : values) elements.push_back(FromReal<TypeParam>(value));
        return elements;
    };
    // diag(1, 2) against diag(1, 0): one eigenvalue is infinite.
    ASSERT_EQ(Exports<TypeParam>::Pencil(this->Square(2, matrix({1, 0, 0, 2})).handle(),
                                         this->Square(2, matrix({1, 0, 0, 0})).handle(), 0, this->w_.handle(),
                                         this->v_.handle()),
              0);
    int not_finite = 0;
    for (const Complex& w : this->w_.values()) not_finite += !std::isfinite(w.re);
    EXPECT_EQ(not_finite, 1);
    // A pair that is 0/0 ends the sorting.
    auto a = this->Square(2, matrix({3, 0, 0, 0}));
    auto b = this->Square(2, matrix({1, 0, 0, 0}));
    EXPECT_EQ(Exports<TypeParam>::QZ80(a.handle(), b.handle(), 1, 1, this->w_.handle(), this->beta_.handle(),
                                       this->v_.handle()),
              kWarnNotReordered);
    EXPECT_EQ(this->w_.size(), 2) << "the results stand";
    for (const int32_t mode : {0, 2}) {
        auto again = this->Square(2, matrix({3, 0, 0, 0}));
        auto other = this->Square(2, matrix({1, 0, 0, 0}));
        EXPECT_EQ(Exports<TypeParam>::QZ80(again.handle(), other.handle(), mode, 1, this->w_.handle(),
                                           this->beta_.handle(), this->v_.handle()),
                  0)
            << "only mode 1 sorts";
    }
}

TYPED_TEST(Reductions, PencilsCheckInOrder) {
    const auto good = Random<TypeParam>(2);
    auto bad = good;
    bad[3] = FromReal<TypeParam>(kQuietNaN);
    const auto expect = [this](const HostMatrix<TypeParam>& a, const HostMatrix<TypeParam>& b, int32_t selector,
                               int32_t status) {
        HostMatrix<TypeParam> a1(a.rows(), a.columns(), a.values());
        HostMatrix<TypeParam> b1(b.rows(), b.columns(), b.values());
        EXPECT_EQ(Exports<TypeParam>::QZ80(a1.handle(), b1.handle(), 1, selector, this->w_.handle(),
                                           this->beta_.handle(), this->v_.handle()),
                  status);
        EXPECT_TRUE(a1.empty() && b1.empty() && this->w_.empty() && this->beta_.empty() && this->v_.empty());
        HostMatrix<TypeParam> a2(a.rows(), a.columns(), a.values());
        HostMatrix<TypeParam> b2(b.rows(), b.columns(), b.values());
        EXPECT_EQ(
            Exports<TypeParam>::Tmi(a2.handle(), b2.handle(), this->q_.handle(), this->z_.handle(), this->w_.handle(),
                                    this->beta_.handle(), selector, this->vr_.handle(), this->vl_.handle()),
            status);
        EXPECT_TRUE(a2.empty() && b2.empty() && this->q_.empty() && this->z_.empty());
        EXPECT_EQ(Exports<TypeParam>::Pencil(a.handle(), b.handle(), selector, this->w_.handle(), this->v_.handle()),
                  status);
        EXPECT_FALSE(status != kNotFinite && status != kBadSelector && a.empty() && !this->w_.empty());
    };
    expect(HostMatrix<TypeParam>(1, 2), HostMatrix<TypeParam>(0, 0), 9, kNotSquare);
    expect(HostMatrix<TypeParam>(0, 0), HostMatrix<TypeParam>(1, 2), 9, kNotSquare);
    expect(HostMatrix<TypeParam>(0, 0), this->Square(2, good), 9, kPencilSizesDiffer);
    expect(HostMatrix<TypeParam>(0, 0), HostMatrix<TypeParam>(0, 0), 9, kEmptyInput);
    expect(this->Square(2, bad), this->Square(2, good), 9, kBadSelector);
    expect(this->Square(2, bad), this->Square(2, good), 1, kNotFinite);
    expect(this->Square(2, good), this->Square(2, bad), 1, kNotFinite);
}

}  // namespace
}  // namespace krnumer

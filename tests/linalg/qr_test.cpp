#include "linalg/qr.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "frame/status.h"
#include "krnumer/linalg_factor.h"
#include "linalg/matrices.h"
#include "reference/linalg/factor.inc"

namespace krnumer {
namespace {

template <class T>
bool IsUpperTrapezoidal(const Matrix<T>& r) {
    for (int32_t i = 0; i < r.rows; ++i)
        for (int32_t j = 0; j < std::min(i, r.columns); ++j)
            if (r(i, j) != T{}) return false;
    return true;
}

// A 1 in each row and each column, zeros elsewhere.
bool IsPermutation(const Matrix<int32_t>& p) {
    const Matrix<int32_t> product = Product(Transposed(p), p);
    for (int32_t i = 0; i < p.rows; ++i)
        for (int32_t j = 0; j < p.rows; ++j)
            if (product(i, j) != (i == j ? 1 : 0) || p(i, j) < 0) return false;
    return true;
}

template <class T>
Matrix<T> ColumnsMoved(const Matrix<T>& a, const Matrix<int32_t>& permutation) {
    return Product(
        a, Generate<T>(a.columns, a.columns, [&](int32_t i, int32_t j) { return FromReal<T>(permutation(i, j)); }));
}

template <class T>
class QR : public testing::Test {
  protected:
    static constexpr auto Decompose = Pick<T>(QRDecH, CxQRDecH);
    static constexpr auto Square = Pick<T>(qrd_head, Cxqrd_head);

    int32_t Dec(const HostMatrix<T>& a, int32_t pivoting, int32_t format) {
        return Decompose(a.handle(), pivoting, format, p_.handle(), q_.handle(), r_.handle());
    }

    int32_t Qrd(const HostMatrix<T>& a, const int32_t* method) {
        EXPECT_EQ(Square(a.handle(), method, q_.handle(), r_.handle(), &err_), 0);
        return err_;
    }
    int32_t Qrd(const HostMatrix<T>& a, int32_t method) { return Qrd(a, &method); }

    void ExpectEmpty() {
        EXPECT_TRUE(q_.empty());
        EXPECT_TRUE(r_.empty());
    }

    // Q R = a within bounds that grow with the size, Q with orthonormal columns, R trapezoidal.
    void ExpectDecomposition(const Matrix<T>& a, const char* name) {
        const Matrix<T> q = FromHost(q_), r = FromHost(r_);
        const double units = 8.0 * kEpsilon * (a.rows + a.columns);
        EXPECT_LE(Distance(Product(q, r), a), units * FrobeniusNorm(a)) << name << ' ' << a.rows << ' ' << a.columns;
        EXPECT_LE(Unorthogonality(q), units) << name << ' ' << a.rows << ' ' << a.columns;
        EXPECT_TRUE(IsUpperTrapezoidal(r)) << name << ' ' << a.rows << ' ' << a.columns;
    }

    LeakCheck leaks_;
    HostMatrix<int32_t> p_{1, 2};
    HostMatrix<T> q_{1, 2}, r_{2, 1};
    int32_t err_ = 77;
};
TYPED_TEST_SUITE(QR, ElementTypes);

constexpr std::pair<int32_t, int32_t> kShapes[] = {{1, 1}, {1, 5},  {5, 1},  {2, 2},   {3, 4},   {4, 3},
                                                   {7, 7}, {12, 5}, {5, 12}, {33, 20}, {20, 33}, {60, 60}};

TYPED_TEST(QR, DecomposesLikeTheReference) {
    const auto& golden = GoldenFactor<TypeParam>::Values();
    const auto expect = [this](const auto& q, const auto& r) {
        EXPECT_THAT(this->q_.values(), AllNear(q.elements, 1e-13, 1e-13));
        EXPECT_THAT(this->r_.values(), AllNear(r.elements, 1e-13, 1e-13));
    };
    ASSERT_EQ(this->Dec(ToHost(golden.tall), 0, kFullQR), kOk);
    expect(golden.tall_q, golden.tall_r);
    ASSERT_EQ(this->Qrd(ToHost(golden.tall), 0), kOk);
    expect(golden.tall_q, golden.tall_r);
    ASSERT_EQ(this->Dec(ToHost(golden.wide), 0, kFullQR), kOk);
    expect(golden.wide_q, golden.wide_r);

    ASSERT_EQ(this->Dec(ToHost(golden.tall), 1, kFullQR), kOk);
    expect(golden.pivoted_q, golden.pivoted_r);
    Matrix<int32_t> permutation(4, 4);
    for (int32_t j = 0; j < 4; ++j) permutation(golden.columns[Count(j)], j) = 1;
    EXPECT_EQ(this->p_.values(), permutation.elements);
}

TYPED_TEST(QR, ReproducesTheMatrixInAllFormats) {
    using T = TypeParam;
    for (const auto& kind : MatrixKinds<T>()) {
        for (const auto& [m, n] : kShapes) {
            const Matrix<T> a = kind.make(m, n);
            const HostMatrix<T> host = ToHost(a);
            const int32_t k = std::min(m, n);
            for (const int32_t pivoting : {0, 1, -5}) {
                for (const int32_t format : {kFullQR, kEconomyQR}) {
                    ASSERT_EQ(this->Dec(host, pivoting, format), kOk);
                    const int32_t rows = format == kFullQR ? m : k;
                    ASSERT_EQ(this->q_.rows(), m);
                    ASSERT_EQ(this->q_.columns(), rows);
                    ASSERT_EQ(this->r_.rows(), rows);
                    ASSERT_EQ(this->r_.columns(), n);
                    if (pivoting == 0) {
                        EXPECT_TRUE(this->p_.empty());
                        this->ExpectDecomposition(a, kind.name);
                    } else {
                        const Matrix<int32_t> p(n, n, this->p_.values());
                        EXPECT_TRUE(IsPermutation(p));
                        this->ExpectDecomposition(ColumnsMoved(a, p), kind.name);
                    }
                }
                const std::vector<T> r = this->r_.values();
                ASSERT_EQ(this->Dec(host, pivoting, kROnly), kOk);
                EXPECT_TRUE(this->q_.empty());
                EXPECT_EQ(this->r_.rows(), k);
                EXPECT_EQ(this->r_.columns(), n);
                EXPECT_EQ(this->r_.values(), r);
            }
        }
    }
}

TYPED_TEST(QR, PivotsByFallingDiagonal) {
    using T = TypeParam;
    ASSERT_EQ(this->Dec(ToHost(RandomMatrix<T>(12, 8, 4)), 1, kEconomyQR), kOk);
    for (int32_t i = 1; i < 8; ++i) EXPECT_LE(Modulus(this->r_(i, i)), Modulus(this->r_(i - 1, i - 1)) * (1 + 1e-14));
}

TYPED_TEST(QR, MethodsReproduceTheMatrix) {
    using T = TypeParam;
    for (const auto& kind : MatrixKinds<T>()) {
        for (const auto& [m, n] : kShapes) {
            const Matrix<T> a = kind.make(m, n);
            for (const int32_t method : {0, 1, 2}) {
                ASSERT_EQ(this->Qrd(ToHost(a), method), kOk);
                ASSERT_EQ(this->q_.rows(), m);
                ASSERT_EQ(this->q_.columns(), m);
                ASSERT_EQ(this->r_.rows(), m);
                ASSERT_EQ(this->r_.columns(), n);
                this->ExpectDecomposition(a, kind.name);
            }
        }
    }
}

TYPED_TEST(QR, LargeOnes) {
    using T = TypeParam;
    const Matrix<T> a = RandomMatrix<T>(200, 200, 6);
    for (const int32_t method : {0, 1, 2}) {
        ASSERT_EQ(this->Qrd(ToHost(a), method), kOk);
        this->ExpectDecomposition(a, "random");
    }
}

TYPED_TEST(QR, TakeArraysThatAreInputAndOutput) {
    using T = TypeParam;
    const Matrix<T> a = RandomMatrix<T>(3, 3, 2);
    HostMatrix<T> both = ToHost(a);
    ASSERT_EQ(this->Decompose(both.handle(), 0, kROnly, this->p_.handle(), both.handle(), this->r_.handle()), kOk);
    EXPECT_TRUE(both.empty());
    ASSERT_EQ(this->Dec(ToHost(a), 0, kFullQR), kOk);
    const std::vector<T> r = this->r_.values();
    both = ToHost(a);
    ASSERT_EQ(this->Decompose(both.handle(), 0, kFullQR, this->p_.handle(), this->q_.handle(), both.handle()), kOk);
    EXPECT_EQ(both.values(), r);
}

TYPED_TEST(QR, DecChecksTheSizeBeforeTheFormat) {
    using T = TypeParam;
    const auto expect = [this](const HostMatrix<T>& a, int32_t format, int32_t status) {
        this->p_ = HostMatrix<int32_t>(1, 2);
        this->q_ = HostMatrix<T>(1, 2);
        this->r_ = HostMatrix<T>(1, 2);
        EXPECT_EQ(this->Dec(a, 1, format), status);
        EXPECT_TRUE(this->p_.empty());
        this->ExpectEmpty();
    };
    HostMatrix<T> a(2, 2);
    expect(a, 3, kBadSelector);
    expect(a, -1, kBadSelector);
    a.SetDimension(0, 0);
    expect(a, 3, kEmptyInput);
    expect(a, 0, kEmptyInput);
    a.SetDimension(0, 2);
    for (const int32_t resize : {1, 2, 3}) {
        const FailResize refusal(resize);
        expect(a, 0, kOutOfMemory);
        EXPECT_TRUE(refusal.happened());
    }
}

TYPED_TEST(QR, QrdChecksTheSizeBeforeTheMethod) {
    using T = TypeParam;
    HostMatrix<T> a(2, 2);
    const int32_t verdict = kIsComplex<T> ? kOk : kBadSelector;
    EXPECT_EQ(this->Qrd(a, 99), verdict);
    EXPECT_EQ(this->Qrd(a, -1), verdict);
    if (!kIsComplex<T>) this->ExpectEmpty();
    a.SetDimension(1, 0);
    EXPECT_EQ(this->Qrd(a, 99), kEmptyInput);
    this->ExpectEmpty();
    a.SetDimension(1, 2);
    const FailResize refusal(2);
    EXPECT_EQ(this->Qrd(a, 0), kOutOfMemory);
    this->ExpectEmpty();
}

// Only the complex function with a method looks at its data first.
TYPED_TEST(QR, NaNFlowsExceptThroughOneOfThem) {
    using T = TypeParam;
    HostMatrix<T> a(2, 2, {FromReal<T>(kQuietNaN), T{}, T{}, FromReal<T>(1)});
    EXPECT_EQ(this->Dec(a, 0, kFullQR), kOk);
    EXPECT_TRUE(std::isnan(RealPart(this->r_(0, 0))));
    EXPECT_EQ(this->Qrd(a, 0), kIsComplex<T> ? kNotFinite : kOk);
    if (kIsComplex<T>) this->ExpectEmpty();
}

TEST(ComplexQR, ReadsNoMethod) {
    const HostMatrix<Complex> a(1, 1, {{1, 1}});
    HostMatrix<Complex> q, r;
    int32_t err = 77;
    Cxqrd_head(a.handle(), nullptr, q.handle(), r.handle(), &err);
    EXPECT_EQ(err, kOk);
    HostMatrix<Complex> infinite(1, 1, {{1, kInfinity}});
    Cxqrd_head(infinite.handle(), nullptr, q.handle(), r.handle(), &err);
    EXPECT_EQ(err, kNotFinite);
}

// --- Givens ---------------------------------------------------------------------------------------------------------

using Rotations = int32_t (*)(const double*, int32_t, int32_t, double*, double*, int32_t*);

class GivensQR : public testing::TestWithParam<Rotations> {
  protected:
    int32_t Rank(const Matrix<double>& a) {
        q_ = Matrix<double>(a.rows, a.rows);
        r_ = Matrix<double>(a.rows, a.columns);
        int32_t rank = -1;
        EXPECT_EQ(GetParam()(a.data(), a.rows, a.columns, q_.data(), r_.data(), &rank), kOk);
        return rank;
    }

    Matrix<double> q_{0, 0}, r_{0, 0};
};
INSTANTIATE_TEST_SUITE_P(, GivensQR, testing::Values(QRGivens, QRFastGivens),
                         [](const auto& method) { return method.param == QRGivens ? "Givens" : "FastGivens"; });

TEST_P(GivensQR, FindsTheRank) {
    EXPECT_EQ(Rank(RandomMatrix<double>(6, 4, 1)), 4);
    EXPECT_EQ(Rank(RandomMatrix<double>(4, 6, 1)), 4);
    EXPECT_EQ(Rank(Matrix<double>(3, 3)), 0);
    EXPECT_EQ(Rank(RankDeficientMatrix<double>(3, 3, 1, 5)), 1);
    EXPECT_EQ(Rank(RankDeficientMatrix<double>(9, 9, 1, 5)), 1);
}

TEST_P(GivensQR, ColumnsWithoutPivotKeepTheRow) {
    EXPECT_EQ(Rank({3, 3, {0, 3, 1, 0, 4, 2, 0, 0, 2}}), 2);
    EXPECT_EQ(r_(0, 0), 0.0);
    EXPECT_NEAR(std::fabs(r_(0, 1)), 5.0, 1e-15);
    EXPECT_NE(r_(1, 2), 0.0);
    EXPECT_EQ(r_(2, 2), 0.0);
    EXPECT_LE(Distance(Product(q_, r_), {3, 3, {0, 3, 1, 0, 4, 2, 0, 0, 2}}), 4e-15);
}

// In the first column nothing is dropped; later elements below the cut become exact zeros.
TEST_P(GivensQR, DropsRoundingErrors) {
    EXPECT_EQ(Rank({2, 1, {1, 1e-300}}), 1);
    EXPECT_EQ(Rank({2, 2, {1, 1, 0, 0.9e-16}}), 1);
    EXPECT_EQ(r_(1, 1), 0.0);
    EXPECT_EQ(Rank({2, 2, {1, 1, 0, 3e-16}}), 2);
    EXPECT_EQ(r_(1, 1), 3e-16);
    // The norm runs over the whole column, finished rows too: the cut is 1e20 eps here.
    EXPECT_EQ(Rank({2, 2, {1, 1e20, 0, 1e4}}), 1);
    EXPECT_EQ(Rank({2, 2, {1, 1e20, 0, 3e4}}), 2);
    // ... and shrinks with the root of the rows to go: eps / sqrt(2) for two of them.
    EXPECT_EQ(Rank({3, 2, {1, 1, 0, 2e-16, 0, 0}}), 2);
    EXPECT_EQ(Rank({3, 2, {1, 1, 0, 1e-16, 0, 0}}), 1);
}

TEST_P(GivensQR, SeesTheSmallestColumns) {
    EXPECT_EQ(Rank({2, 1, {3e-200, 4e-200}}), 1);
    EXPECT_NEAR(std::fabs(r_(0, 0)), 5e-200, 1e-214);
    EXPECT_EQ(r_(1, 0), 0.0);
    EXPECT_EQ(Rank({2, 1, {3e200, 4e200}}), 1);
    EXPECT_NEAR(std::fabs(r_(0, 0)), 5e200, 1e186);
}

TEST_P(GivensQR, LetsNaNThrough) {
    Rank({2, 2, {kQuietNaN, 1, 2, 3}});
    EXPECT_TRUE(std::isnan(r_(0, 0)));
    Rank({2, 2, {kQuietNaN, 1, kQuietNaN, 3}});
    EXPECT_TRUE(std::isnan(r_(0, 0)));
}

TEST_P(GivensQR, NeedsElements) {
    double x = 1.0;
    int32_t rank = 0;
    EXPECT_EQ(GetParam()(&x, 0, 1, &x, &x, &rank), kEmptyInput);
    EXPECT_EQ(GetParam()(&x, 1, -1, &x, &x, &rank), kEmptyInput);
}

TEST(GivensQRSigns, FollowFromTheRotations) {
    // The rotation of (3, 4): cosine 3/5, sine 4/5, so R(0,0) = 5.
    double q[4], r[2];
    const double a[2] = {3, 4};
    int32_t rank = 0;
    QRGivens(a, 2, 1, q, r, &rank);
    EXPECT_DOUBLE_EQ(r[0], 5.0);
    EXPECT_DOUBLE_EQ(q[0], 0.6);
    EXPECT_DOUBLE_EQ(q[1], -0.8);
    EXPECT_DOUBLE_EQ(q[2], 0.8);
    EXPECT_DOUBLE_EQ(q[3], 0.6);
    // Fast: alpha = -3/4, beta = 3/4, gamma = 9/16, the exchanging type; R(0,0) = (3 beta + 4) / (5/4) = 5.
    QRFastGivens(a, 2, 1, q, r, &rank);
    EXPECT_DOUBLE_EQ(r[0], 5.0);
    EXPECT_DOUBLE_EQ(q[0], 0.6);
    EXPECT_DOUBLE_EQ(q[1], 0.8);
    EXPECT_DOUBLE_EQ(q[2], 0.8);
    EXPECT_DOUBLE_EQ(q[3], -0.6);
}

TEST(QRHouseholder, MayReplaceTheMatrix) {
    const Matrix<double> a = RandomMatrix<double>(6, 4, 8);
    Matrix<double> r(6, 4), in_place = a;
    ASSERT_EQ(QRHouseholder(a.data(), 6, 4, kFullQR, nullptr, r.data()), kOk);
    ASSERT_EQ(QRHouseholder(in_place.data(), 6, 4, kFullQR, nullptr, in_place.data()), kOk);
    EXPECT_EQ(in_place, r);
    EXPECT_EQ(QRHouseholder(a.data(), 0, 4, kFullQR, nullptr, r.data()), kEmptyInput);
}

}  // namespace
}  // namespace krnumer

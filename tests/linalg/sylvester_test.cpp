// Sylvester and Lyapunov equations, through their exports: residuals of regular and singular ones, statuses.

#include <gtest/gtest.h>

#include "frame/numeric.h"
#include "frame/status.h"
#include "krnumer/linalg_equations.h"
#include "linalg/matrices.h"
#include "reference/linalg/equations.inc"

namespace krnumer {
namespace {

// Upper triangular with the diagonal start, start + step, ...; `block` makes a pair of rows from there on a 2 by 2
// block of a complex pair, where T is real.
template <class T>
Matrix<T> Triangular(int32_t n, double start, double step, int32_t block, uint64_t seed) {
    const Matrix<T> random = RandomMatrix<T>(n, n, seed);
    auto a = Generate<T>(n, n, [&](int32_t i, int32_t j) {
        if (i == j) return FromReal<T>(start + i * step);
        return i < j ? random(i, j) * 0.1 : T{};
    });
    if (!kIsComplex<T> && block + 1 < n) {
        a(block + 1, block + 1) = a(block, block);
        a(block, block + 1) = FromReal<T>(0.5);
        a(block + 1, block) = FromReal<T>(-0.5);
    }
    return a;
}

// op(A) X + sign X op(B)
template <class T>
Matrix<T> LeftSide(const Matrix<T>& a, const Matrix<T>& b, const Matrix<T>& x, int32_t trans_a, int32_t trans_b,
                   int32_t sign) {
    const Matrix<T> left = Product(trans_a != 0 ? Adjoint(a) : a, x);
    const Matrix<T> right = Product(x, trans_b != 0 ? Adjoint(b) : b);
    return Generate<T>(x.rows, x.columns,
                       [&](int32_t i, int32_t j) { return left(i, j) + right(i, j) * static_cast<double>(sign); });
}

template <class T>
class Equations : public testing::Test {
  protected:
    static constexpr auto Lyapunov = Pick<T>(Lyapunov_head, CxLyapunov_head);
    static constexpr auto Sylvester = Pick<T>(Sylvester_head, CxSylvester_head);
    static constexpr auto Sylvester81 = Pick<T>(Sylvester81_head, CxSylvester81_head);

    LeakCheck leaks_;
    double scale_ = -1.0;
    int32_t singular_ = -1;

    Matrix<T> Solve(const Matrix<T>& a, const Matrix<T>& b, const Matrix<T>& c, int32_t trans_a, int32_t trans_b,
                    int32_t sign, int32_t form) {
        const auto host_a = ToHost(a);
        const auto host_b = ToHost(b);
        const auto host_c = ToHost(c);
        EXPECT_EQ(Sylvester81(host_a.handle(), host_b.handle(), host_c.handle(), trans_a, trans_b, sign, form, &scale_,
                              &singular_),
                  0);
        EXPECT_EQ(host_a.values(), a.elements);
        EXPECT_EQ(host_b.values(), b.elements);
        return FromHost(host_c);
    }

    template <class Check>
    static void ForAllOperators(Check check) {
        for (const int32_t trans_a : {0, 1})
            for (const int32_t trans_b : {0, 1})
                for (const int32_t sign : {1, -1}) {
                    SCOPED_TRACE(testing::Message() << "trans " << trans_a << trans_b << " sign " << sign);
                    check(trans_a, trans_b, sign);
                }
    }

    // A consistent equation with one common eigenvalue must be solved exactly, although not uniquely.
    void ExpectSingularSolved(int32_t m, int32_t n) {
        ForAllOperators([&](int32_t trans_a, int32_t trans_b, int32_t sign) {
            const auto a = Triangular<T>(m, 2.0, 0.5, 1, 1);
            const auto b = Triangular<T>(n, sign * 1.0, sign * 0.75, 1, 2);
            auto shifted = b;
            const int32_t shared = n > 3 ? 3 : 0;
            shifted(shared, shared) = FromReal<T>(sign * -2.0);
            const auto c = LeftSide(a, shifted, RandomMatrix<T>(m, n, 3), trans_a, trans_b, sign);
            const auto x = this->Solve(a, shifted, c, trans_a, trans_b, sign, 1);
            EXPECT_EQ(singular_, 1);
            EXPECT_EQ(scale_, 1.0);
            EXPECT_LE(Distance(LeftSide(a, shifted, x, trans_a, trans_b, sign), c), 1e-9);
        });
    }
};
TYPED_TEST_SUITE(Equations, ElementTypes);

TYPED_TEST(Equations, GeneralOnesHaveNoResidual) {
    for (const auto& [m, n] : {std::pair{1, 1}, {2, 3}, {5, 4}, {1, 6}, {23, 17}}) {
        this->ForAllOperators([&, m = m, n = n](int32_t trans_a, int32_t trans_b, int32_t sign) {
            const auto a = RandomMatrix<TypeParam>(m, m, 1);
            const auto b = RandomMatrix<TypeParam>(n, n, 2);
            const auto c = RandomMatrix<TypeParam>(m, n, 3);
            const auto x = this->Solve(a, b, c, trans_a, trans_b, sign, 0);
            EXPECT_EQ(this->singular_, 0);
            EXPECT_EQ(this->scale_, 1.0);
            EXPECT_LE(Distance(LeftSide(a, b, x, trans_a, trans_b, sign), c), 1e-9);
        });
    }
}

TYPED_TEST(Equations, SolutionsAreThoseOfSciPy) {
    const auto& golden = GoldenEquations<TypeParam>::Values();
    const auto* expected = golden.sylvester.data();
    this->ForAllOperators([&](int32_t trans_a, int32_t trans_b, int32_t sign) {
        const auto x = this->Solve(golden.a, golden.b, golden.c, trans_a, trans_b, sign, 0);
        EXPECT_LE(Distance(x, *expected), 1e-12 * FrobeniusNorm(*expected));
        ++expected;
    });
    const auto q = ToHost(golden.q);
    ASSERT_EQ(this->Lyapunov(ToHost(golden.a).handle(), q.handle(), 0, &this->scale_), 0);
    EXPECT_LE(Distance(FromHost(q), golden.lyapunov), 1e-12 * FrobeniusNorm(golden.lyapunov));

    const auto corner = Generate<TypeParam>(3, 3, [&](int32_t i, int32_t j) { return golden.q(i, j); });
    const auto x = this->Solve(golden.left, golden.right, corner, 0, 0, 1, 1);
    EXPECT_EQ(this->singular_, 1);
    EXPECT_LE(Distance(x, golden.least_norm), 1e-13 * FrobeniusNorm(golden.least_norm));
}

TYPED_TEST(Equations, TriangularOnesAreTakenAsTheyAre) {
    this->ForAllOperators([&](int32_t trans_a, int32_t trans_b, int32_t sign) {
        const auto a = Triangular<TypeParam>(6, 1.0, 1.0, 2, 1);
        const auto b = Triangular<TypeParam>(5, sign * 1.0, sign * 0.5, 1, 2);
        const auto c = RandomMatrix<TypeParam>(6, 5, 3);
        const auto x = this->Solve(a, b, c, trans_a, trans_b, sign, 1);
        EXPECT_EQ(this->singular_, 0);
        EXPECT_LE(Distance(LeftSide(a, b, x, trans_a, trans_b, sign), c), 1e-12);
        const auto short_form = ToHost(c);
        ASSERT_EQ(this->Sylvester(ToHost(a).handle(), ToHost(b).handle(), short_form.handle(), trans_a, trans_b, sign,
                                  &this->scale_, &this->singular_),
                  0);
        EXPECT_EQ(short_form.values(), x.elements);
    });
}

TYPED_TEST(Equations, TheShortFormDoesNotReduce) {
    auto a = Triangular<TypeParam>(4, 1.0, 1.0, 9, 1);
    const auto b = Triangular<TypeParam>(3, 1.0, 0.5, 9, 2);
    const auto c = RandomMatrix<TypeParam>(4, 3, 3);
    const auto x = this->Solve(a, b, c, 0, 0, 1, 1);
    a(3, 0) = FromReal<TypeParam>(7.0);  // two or more below the diagonal
    const auto ignored = ToHost(c);
    ASSERT_EQ(this->Sylvester(ToHost(a).handle(), ToHost(b).handle(), ignored.handle(), 0, 0, 1, &this->scale_,
                              &this->singular_),
              0);
    EXPECT_EQ(ignored.values(), x.elements);
}

TYPED_TEST(Equations, LyapunovSolvesWithTheAdjoint) {
    for (const int32_t n : {1, 2, 5, 16}) {
        const auto a = RandomMatrix<TypeParam>(n, n, 4);
        const auto q = RandomMatrix<TypeParam>(n, n, 5);
        const auto host_q = ToHost(q);
        ASSERT_EQ(this->Lyapunov(ToHost(a).handle(), host_q.handle(), 0, &this->scale_), 0);
        EXPECT_EQ(this->scale_, 1.0);
        EXPECT_LE(Distance(LeftSide(a, a, FromHost(host_q), 0, 1, 1), q), 1e-9);
    }
    const auto t = Triangular<TypeParam>(5, 1.0, 1.0, 1, 4);
    const auto q = RandomMatrix<TypeParam>(5, 5, 5);
    const auto host_q = ToHost(q);
    ASSERT_EQ(this->Lyapunov(ToHost(t).handle(), host_q.handle(), 1, &this->scale_), 0);
    EXPECT_LE(Distance(LeftSide(t, t, FromHost(host_q), 0, 1, 1), q), 1e-12);
}

TYPED_TEST(Equations, SmallSingularOnesAreSolvedAsAWhole) {
    this->ExpectSingularSolved(1, 1);
    this->ExpectSingularSolved(6, 5);
    this->ExpectSingularSolved(4, 7);
}

TYPED_TEST(Equations, LargeSingularOnesAreSolvedByColumns) {
    const int32_t side = kIsComplex<TypeParam> ? 29 : 41;
    this->ExpectSingularSolved(side, side - 1);
    this->ExpectSingularSolved(side - 1, side);
}

TYPED_TEST(Equations, SingularOnesInGeneralForm) {
    // A similarity that is exact keeps the common eigenvalue exact: a permutation.
    Matrix<TypeParam> a{2, 2}, b{2, 2}, x{2, 2};
    a(0, 0) = FromReal<TypeParam>(3.0);
    a(1, 0) = FromReal<TypeParam>(1.0);
    a(1, 1) = FromReal<TypeParam>(2.0);
    b(0, 0) = FromReal<TypeParam>(-2.0);
    b(1, 0) = FromReal<TypeParam>(1.0);
    b(1, 1) = FromReal<TypeParam>(5.0);
    for (TypeParam& element : x.elements) element = FromReal<TypeParam>(1.0);
    const auto c = LeftSide(a, b, x, 0, 0, 1);
    const auto found = this->Solve(a, b, c, 0, 0, 1, 0);
    EXPECT_EQ(this->singular_, 1);
    EXPECT_EQ(this->scale_, 1.0);
    EXPECT_LE(Distance(LeftSide(a, b, found, 0, 0, 1), c), 1e-14);
}

TYPED_TEST(Equations, InconsistentOnesGiveTheLeastNorm) {
    // A = diag(0, 1), B = 0: the first row of C is out of reach, and that of X free.
    Matrix<TypeParam> a{2, 2}, b{1, 1}, c{2, 1};
    a(1, 1) = FromReal<TypeParam>(1.0);
    c(0, 0) = FromReal<TypeParam>(5.0);
    c(1, 0) = FromReal<TypeParam>(3.0);
    const auto x = this->Solve(a, b, c, 0, 0, 1, 0);
    EXPECT_EQ(this->singular_, 1);
    EXPECT_LE(Modulus(x(0, 0)), 1e-15);
    EXPECT_LE(Modulus(x(1, 0) - FromReal<TypeParam>(3.0)), 1e-15);
    const Matrix<TypeParam> zero{1, 1};
    const auto nothing = this->Solve(zero, zero, RandomMatrix<TypeParam>(1, 1, 1), 0, 0, 1, 0);
    EXPECT_EQ(nothing(0, 0), TypeParam{});
}

TYPED_TEST(Equations, ChecksInOrder) {
    const auto expect = [this](int32_t status, Matrix<TypeParam> a, Matrix<TypeParam> b, Matrix<TypeParam> c,
                               int32_t trans_a = 0, int32_t trans_b = 0, int32_t sign = 1, int32_t form = 0) {
        this->scale_ = -1.0;
        this->singular_ = -1;
        const auto host_c = ToHost(c);
        EXPECT_EQ(this->Sylvester81(ToHost(a).handle(), ToHost(b).handle(), host_c.handle(), trans_a, trans_b, sign,
                                    form, &this->scale_, &this->singular_),
                  status);
        EXPECT_TRUE(host_c.empty());
        EXPECT_EQ(this->scale_, 1.0);
        EXPECT_EQ(this->singular_, 0);
    };
    using M = Matrix<TypeParam>;
    const auto a = RandomMatrix<TypeParam>(2, 2, 1);
    const auto b = RandomMatrix<TypeParam>(3, 3, 2);
    const auto c = RandomMatrix<TypeParam>(2, 3, 3);
    auto bad = c;
    bad(1, 2) = FromReal<TypeParam>(kQuietNaN);
    auto bad_a = a;
    bad_a(0, 1) = FromReal<TypeParam>(kInfinity);
    expect(kNotSquare, M{0, 3}, b, M{0, 2}, 9);
    expect(kNotSquare, a, M{3, 2}, c, 9);
    expect(kSizesDiffer, a, b, M{3, 2}, 9);
    expect(kSizesDiffer, M{0, 0}, b, c, 9);
    expect(kEmptyInput, M{0, 0}, b, M{0, 3}, 9);
    expect(kEmptyInput, a, M{0, 0}, M{2, 0}, 9);
    for (const int32_t wrong : {2, -1}) {
        expect(kBadSelector, a, b, bad, wrong);
        expect(kBadSelector, a, b, bad, 0, wrong);
        expect(kBadSelector, a, b, bad, 0, 0, 1, wrong);
    }
    for (const int32_t wrong : {0, 2, -2}) expect(kBadSelector, a, b, bad, 0, 0, wrong);
    expect(kNotFinite, a, b, bad);
    expect(kNotFinite, bad_a, b, c);
}

TYPED_TEST(Equations, LyapunovChecksInOrder) {
    const auto expect = [this](int32_t status, Matrix<TypeParam> a, Matrix<TypeParam> q, int32_t form) {
        this->scale_ = -1.0;
        const auto host_q = ToHost(q);
        EXPECT_EQ(this->Lyapunov(ToHost(a).handle(), host_q.handle(), form, &this->scale_), status);
        EXPECT_TRUE(host_q.empty());
        EXPECT_EQ(this->scale_, 1.0);
    };
    using M = Matrix<TypeParam>;
    const auto a = RandomMatrix<TypeParam>(2, 2, 1);
    auto bad = a;
    bad(0, 0) = FromReal<TypeParam>(kQuietNaN);
    expect(kEmptyInput, M{0, 3}, a, 9);
    expect(kNotSquare, M{2, 3}, M{3, 3}, 9);
    expect(kSizesDiffer, a, M{2, 3}, 9);
    expect(kSizesDiffer, a, M{3, 2}, 9);
    expect(kBadSelector, a, bad, 2);
    expect(kBadSelector, a, bad, -1);
    expect(kNotFinite, a, bad, 1);
}

TYPED_TEST(Equations, OneArrayMayBeEveryArgument) {
    const auto a = Triangular<TypeParam>(3, 1.0, 1.0, 9, 1);
    const auto one = ToHost(a);
    ASSERT_EQ(this->Sylvester81(one.handle(), one.handle(), one.handle(), 0, 0, 1, 0, &this->scale_, &this->singular_),
              0);
    EXPECT_LE(Distance(LeftSide(a, a, FromHost(one), 0, 0, 1), a), 1e-13);
}

}  // namespace
}  // namespace krnumer

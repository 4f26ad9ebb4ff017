// Sylvester and Lyapunov equations, through their exports: residuals of regular and singular ones, statuses.

#include <gtest/gtest.h>

#include <cmath>
#include <random>

#include "frame/numeric.h"
#include "frame/status.h"
#include "krnumer/linalg_equations.h"
#include "linalg/element.h"
#include "support/host_arrays.h"

namespace krnumer {
namespace {

// A row-major matrix.
template <class T>
struct Dense {
    int32_t rows, columns;
    std::vector<T> elements = std::vector<T>(Count(rows) * Count(columns));

    T& operator()(int32_t i, int32_t j) { return elements[Count(i) * Count(columns) + Count(j)]; }
    const T& operator()(int32_t i, int32_t j) const { return elements[Count(i) * Count(columns) + Count(j)]; }
    HostMatrix<T> ToHost() const { return HostMatrix<T>(rows, columns, elements); }
};

template <class T>
Dense<T> Random(int32_t rows, int32_t columns, uint32_t seed, double deviation = 1.0) {
    std::mt19937 random(seed);
    std::normal_distribution<> normal(0.0, deviation);
    Dense<T> a{rows, columns};
    for (T& element : a.elements) {
        element = FromReal<T>(normal(random));
        if constexpr (kIsComplex<T>) element.im = normal(random);
    }
    return a;
}

// Upper triangular with the diagonal start, start + step, ...; `block` makes a pair of rows from there on a 2 by 2
// block of a complex pair, where T is real.
template <class T>
Dense<T> Triangular(int32_t n, double start, double step, int32_t block, uint32_t seed) {
    Dense<T> a = Random<T>(n, n, seed, 0.1);
    for (int32_t i = 0; i < n; ++i) {
        for (int32_t j = 0; j < i; ++j) a(i, j) = T{};
        a(i, i) = FromReal<T>(start + i * step);
    }
    if (!kIsComplex<T> && block + 1 < n) {
        a(block + 1, block + 1) = a(block, block);
        a(block, block + 1) = FromReal<T>(0.5);
        a(block + 1, block) = FromReal<T>(-0.5);
    }
    return a;
}

template <class T>
T Op(const Dense<T>& a, int32_t transposed, int32_t i, int32_t j) {
    return transposed != 0 ? Conjugate(a(j, i)) : a(i, j);
}

// op(A) X + sign X op(B)
template <class T>
Dense<T> LeftSide(const Dense<T>& a, const Dense<T>& b, const Dense<T>& x, int32_t trans_a, int32_t trans_b,
                  int32_t sign) {
    Dense<T> c{x.rows, x.columns};
    for (int32_t i = 0; i < x.rows; ++i) {
        for (int32_t j = 0; j < x.columns; ++j) {
            for (int32_t k = 0; k < x.rows; ++k) c(i, j) += Op(a, trans_a, i, k) * x(k, j);
            for (int32_t k = 0; k < x.columns; ++k)
                c(i, j) += x(i, k) * Op(b, trans_b, k, j) * static_cast<double>(sign);
        }
    }
    return c;
}

template <class T>
double Distance(const Dense<T>& a, const Dense<T>& b, double scale_of_b = 1.0) {
    double largest = 0.0;
    for (size_t i = 0; i < a.elements.size(); ++i) {
        const double difference = Modulus(a.elements[i] - b.elements[i] * scale_of_b);
        largest = difference <= largest ? largest : difference;  // a NaN stays
    }
    return largest;
}

template <class T>
class Equations : public testing::Test {
  protected:
    static constexpr auto Lyapunov = kIsComplex<T> ? CxLyapunov_head : Lyapunov_head;
    static constexpr auto Sylvester = kIsComplex<T> ? CxSylvester_head : Sylvester_head;
    static constexpr auto Sylvester81 = kIsComplex<T> ? CxSylvester81_head : Sylvester81_head;

    LeakCheck leaks_;
    double scale_ = -1.0;
    int32_t singular_ = -1;

    Dense<T> Solve(const Dense<T>& a, const Dense<T>& b, const Dense<T>& c, int32_t trans_a, int32_t trans_b,
                   int32_t sign, int32_t form) {
        const auto host_a = a.ToHost();
        const auto host_b = b.ToHost();
        const auto host_c = c.ToHost();
        EXPECT_EQ(Sylvester81(host_a.handle(), host_b.handle(), host_c.handle(), trans_a, trans_b, sign, form, &scale_,
                              &singular_),
                  0);
        EXPECT_EQ(host_a.values(), a.elements);
        EXPECT_EQ(host_b.values(), b.elements);
        return {c.rows, c.columns, host_c.values()};
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
            const auto c = LeftSide(a, shifted, Random<T>(m, n, 3), trans_a, trans_b, sign);
            const auto x = this->Solve(a, shifted, c, trans_a, trans_b, sign, 1);
            EXPECT_EQ(singular_, 1);
            EXPECT_EQ(scale_, 1.0);
            EXPECT_LE(Distance(LeftSide(a, shifted, x, trans_a, trans_b, sign), c), 1e-9);
        });
    }
};
using ElementTypes = testing::Types<double, Complex>;
TYPED_TEST_SUITE(Equations, ElementTypes);

TYPED_TEST(Equations, GeneralOnesHaveNoResidual) {
    for (const auto& [m, n] : {std::pair{1, 1}, {2, 3}, {5, 4}, {1, 6}, {23, 17}}) {
        this->ForAllOperators([&, m = m, n = n](int32_t trans_a, int32_t trans_b, int32_t sign) {
            const auto a = Random<TypeParam>(m, m, 1);
            const auto b = Random<TypeParam>(n, n, 2);
            const auto c = Random<TypeParam>(m, n, 3);
            const auto x = this->Solve(a, b, c, trans_a, trans_b, sign, 0);
            EXPECT_EQ(this->singular_, 0);
            EXPECT_EQ(this->scale_, 1.0);
            EXPECT_LE(Distance(LeftSide(a, b, x, trans_a, trans_b, sign), c), 1e-9);
        });
    }
}

TYPED_TEST(Equations, TriangularOnesAreTakenAsTheyAre) {
    this->ForAllOperators([&](int32_t trans_a, int32_t trans_b, int32_t sign) {
        const auto a = Triangular<TypeParam>(6, 1.0, 1.0, 2, 1);
        const auto b = Triangular<TypeParam>(5, sign * 1.0, sign * 0.5, 1, 2);
        const auto c = Random<TypeParam>(6, 5, 3);
        const auto x = this->Solve(a, b, c, trans_a, trans_b, sign, 1);
        EXPECT_EQ(this->singular_, 0);
        EXPECT_LE(Distance(LeftSide(a, b, x, trans_a, trans_b, sign), c), 1e-12);
        const auto short_form = c.ToHost();
        ASSERT_EQ(this->Sylvester(a.ToHost().handle(), b.ToHost().handle(), short_form.handle(), trans_a, trans_b, sign,
                                  &this->scale_, &this->singular_),
                  0);
        EXPECT_EQ(short_form.values(), x.elements);
    });
}

TYPED_TEST(Equations, TheShortFormDoesNotReduce) {
    auto a = Triangular<TypeParam>(4, 1.0, 1.0, 9, 1);
    const auto b = Triangular<TypeParam>(3, 1.0, 0.5, 9, 2);
    const auto c = Random<TypeParam>(4, 3, 3);
    const auto x = this->Solve(a, b, c, 0, 0, 1, 1);
    a(3, 0) = FromReal<TypeParam>(7.0);  // two or more below the diagonal
    const auto ignored = c.ToHost();
    ASSERT_EQ(this->Sylvester(a.ToHost().handle(), b.ToHost().handle(), ignored.handle(), 0, 0, 1, &this->scale_,
                              &this->singular_),
              0);
    EXPECT_EQ(ignored.values(), x.elements);
}

TYPED_TEST(Equations, LyapunovSolvesWithTheAdjoint) {
    for (const int32_t n : {1, 2, 5, 16}) {
        const auto a = Random<TypeParam>(n, n, 4);
        const auto q = Random<TypeParam>(n, n, 5);
        const auto host_q = q.ToHost();
        ASSERT_EQ(this->Lyapunov(a.ToHost().handle(), host_q.handle(), 0, &this->scale_), 0);
        EXPECT_EQ(this->scale_, 1.0);
        EXPECT_LE(Distance(LeftSide(a, a, {n, n, host_q.values()}, 0, 1, 1), q), 1e-9);
    }
    const auto t = Triangular<TypeParam>(5, 1.0, 1.0, 1, 4);
    const auto q = Random<TypeParam>(5, 5, 5);
    const auto host_q = q.ToHost();
    ASSERT_EQ(this->Lyapunov(t.ToHost().handle(), host_q.handle(), 1, &this->scale_), 0);
    EXPECT_LE(Distance(LeftSide(t, t, {5, 5, host_q.values()}, 0, 1, 1), q), 1e-12);
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
    Dense<TypeParam> a{2, 2}, b{2, 2}, x{2, 2};
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
    Dense<TypeParam> a{2, 2}, b{1, 1}, c{2, 1};
    a(1, 1) = FromReal<TypeParam>(1.0);
    c(0, 0) = FromReal<TypeParam>(5.0);
    c(1, 0) = FromReal<TypeParam>(3.0);
    const auto x = this->Solve(a, b, c, 0, 0, 1, 0);
    EXPECT_EQ(this->singular_, 1);
    EXPECT_LE(Modulus(x(0, 0)), 1e-15);
    EXPECT_LE(Modulus(x(1, 0) - FromReal<TypeParam>(3.0)), 1e-15);
    const Dense<TypeParam> zero{1, 1};
    const auto nothing = this->Solve(zero, zero, Random<TypeParam>(1, 1, 1), 0, 0, 1, 0);
    EXPECT_EQ(nothing(0, 0), TypeParam{});
}

TYPED_TEST(Equations, ChecksInOrder) {
    const auto expect = [this](int32_t status, Dense<TypeParam> a, Dense<TypeParam> b, Dense<TypeParam> c,
                               int32_t trans_a = 0, int32_t trans_b = 0, int32_t sign = 1, int32_t form = 0) {
        this->scale_ = -1.0;
        this->singular_ = -1;
        const auto host_c = c.ToHost();
        EXPECT_EQ(this->Sylvester81(a.ToHost().handle(), b.ToHost().handle(), host_c.handle(), trans_a, trans_b, sign,
                                    form, &this->scale_, &this->singular_),
                  status);
        EXPECT_TRUE(host_c.empty());
        EXPECT_EQ(this->scale_, 1.0);
        EXPECT_EQ(this->singular_, 0);
    };
    using M = Dense<TypeParam>;
    const auto a = Random<TypeParam>(2, 2, 1);
    const auto b = Random<TypeParam>(3, 3, 2);
    const auto c = Random<TypeParam>(2, 3, 3);
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
    const auto expect = [this](int32_t status, Dense<TypeParam> a, Dense<TypeParam> q, int32_t form) {
        this->scale_ = -1.0;
        const auto host_q = q.ToHost();
        EXPECT_EQ(this->Lyapunov(a.ToHost().handle(), host_q.handle(), form, &this->scale_), status);
        EXPECT_TRUE(host_q.empty());
        EXPECT_EQ(this->scale_, 1.0);
    };
    using M = Dense<TypeParam>;
    const auto a = Random<TypeParam>(2, 2, 1);
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
    const auto one = a.ToHost();
    ASSERT_EQ(this->Sylvester81(one.handle(), one.handle(), one.handle(), 0, 0, 1, 0, &this->scale_, &this->singular_),
              0);
    EXPECT_LE(Distance(LeftSide(a, a, {3, 3, one.values()}, 0, 0, 1), a), 1e-13);
}

}  // namespace
}  // namespace krnumer

#include "linalg/svd.h"

#include <gtest/gtest.h>

#include <cmath>
#include <functional>
#include <string>
#include <vector>

#include "frame/status.h"
#include "linalg/test_matrices.h"
#include "support/numbers.h"

namespace krnumer {
namespace {

template <class T>
struct Decomposed {
    Decomposed(int32_t m, int32_t n, bool full)
        : u(m, full ? m : std::min(m, n)), s(Count(std::min(m, n))), v(n, full ? n : std::min(m, n)) {}

    int32_t status = 1;
    DenseMatrix<T> u;
    std::vector<double> s;
    DenseMatrix<T> v;
};

template <class T>
Decomposed<T> Decompose(const DenseMatrix<T>& a, bool full = false) {
    Decomposed<T> result(a.rows, a.columns, full);
    result.status = SvdCore(a.data(), a.rows, a.columns, result.u.data(), result.s.data(), result.v.data(), full);
    return result;
}

template <class T>
class Svd : public ::testing::Test {
  protected:
    // What every decomposition owes: A multiplied out again, orthonormal vectors, values in descending order, the same
    // values without vectors, and the same everything when U replaces A.
    static void ExpectDecomposition(const DenseMatrix<T>& a) {
        const double units = kEpsilon * std::max(a.rows, a.columns);
        const double norm = FrobeniusNorm(a);
        for (const bool full : {false, true}) {
            const Decomposed<T> d = Decompose(a, full);
            ASSERT_EQ(d.status, kOk);
            EXPECT_LE(Distance(Product(ColumnsScaled(d.u, d.s), LeadingRows(Adjoint(d.v), d.s.size())), a),
                      10.0 * units * norm);
            EXPECT_LE(Unorthogonality(d.u), 10.0 * units);
            EXPECT_LE(Unorthogonality(d.v), 10.0 * units);
            for (std::size_t i = 0; i < d.s.size(); ++i) {
                EXPECT_GE(d.s[i], 0.0);
                EXPECT_LE(d.s[i], d.s[i > 0 ? i - 1 : 0]);
            }
        }

        const Decomposed<T> thin = Decompose(a);
        std::vector<double> values(thin.s.size());
        ASSERT_EQ(SvdValuesCore(a.data(), a.rows, a.columns, values.data()), kOk);
        EXPECT_THAT(values, AllNear(thin.s, 0.0, 10.0 * units * norm));

        Decomposed<T> in_place(a.rows, a.columns, false);
        DenseMatrix<T> copy = a;
        ASSERT_EQ(SvdCore(copy.data(), a.rows, a.columns, copy.data(), in_place.s.data(), in_place.v.data(), false),
                  kOk);
        copy.elements.resize(thin.u.elements.size());
        EXPECT_EQ(copy.elements, thin.u.elements);
        EXPECT_EQ(in_place.s, thin.s);
        EXPECT_EQ(in_place.v.elements, thin.v.elements);
    }

    static DenseMatrix<T> LeadingRows(const DenseMatrix<T>& a, std::size_t rows) {
        return Generate<T>(static_cast<int32_t>(rows), a.columns, [&a](int32_t i, int32_t j) { return a(i, j); });
    }
};

using Elements = ::testing::Types<double, Complex>;
TYPED_TEST_SUITE(Svd, Elements);

TYPED_TEST(Svd, DecomposesMatricesOfEverySizeAndKind) {
    using T = TypeParam;
    std::vector<std::pair<int32_t, int32_t>> sizes = {{1, 1}, {1, 7}, {7, 1}, {2, 5}, {5, 2}, {60, 13}, {13, 60}};
    for (int32_t n = 2; n <= 60; n += n < 10 ? 1 : 7) sizes.insert(sizes.end(), {{n, n}, {n, n + 3}, {n + 1, n}});
    for (const auto& [m, n] : sizes) {
        SCOPED_TRACE(std::to_string(m) + " by " + std::to_string(n));
        const uint64_t seed = static_cast<uint64_t>(100 * m + n);
        this->ExpectDecomposition(RandomMatrix<T>(m, n, seed));
        this->ExpectDecomposition(GradedMatrix<T>(m, n, seed));
        this->ExpectDecomposition(RankDeficientMatrix<T>(m, n, (std::min(m, n) + 1) / 2, seed));
        this->ExpectDecomposition(HilbertMatrix<T>(m, n));
        this->ExpectDecomposition(VandermondeMatrix<T>(m, n));
        this->ExpectDecomposition(IntegerMatrix<T>(m, n, seed));
        this->ExpectDecomposition(DenseMatrix<T>(m, n));
    }
}

TYPED_TEST(Svd, DecomposesALargeMatrix) {
    this->ExpectDecomposition(RandomMatrix<TypeParam>(200, 200, 1));
    this->ExpectDecomposition(RandomMatrix<TypeParam>(200, 40, 2));
}

// Zeros on the diagonal of the bidiagonal form are rotated away, whatever stands above them.
TYPED_TEST(Svd, CancelsZerosOnTheDiagonal) {
    using T = TypeParam;
    RandomBits bits(3);
    for (int32_t n = 2; n <= 9; ++n) {
        for (int32_t zero = 0; zero < n; ++zero) {
            const auto a = Generate<T>(n, n, [&](int32_t i, int32_t j) {
                const bool within = j == i + 1 || (j == i && i != zero);
                return within ? RandomElement<T>(bits) : T{};
            });
            SCOPED_TRACE(std::to_string(n) + ", zero at " + std::to_string(zero));
            this->ExpectDecomposition(a);
        }
    }
}

TYPED_TEST(Svd, DecomposesTriangularAndRepeatedValues) {
    using T = TypeParam;
    this->ExpectDecomposition(Generate<T>(20, 20, [](int32_t i, int32_t j) { return FromReal<T>(j >= i); }));
    this->ExpectDecomposition(Generate<T>(20, 20, [](int32_t i, int32_t j) { return FromReal<T>(i == j); }));
    this->ExpectDecomposition(Generate<T>(30, 12, [](int32_t, int32_t) { return FromReal<T>(2.0); }));
    this->ExpectDecomposition(Generate<T>(12, 12, [](int32_t i, int32_t j) { return FromReal<T>((i + 5) % 12 == j); }));
}

TYPED_TEST(Svd, CompletesTheFullFormWithoutTouchingTheThinOne) {
    using T = TypeParam;
    for (const auto& [m, n] : {std::pair{5, 2}, {2, 5}, {30, 1}, {1, 30}, {17, 16}}) {
        const DenseMatrix<T> a = RandomMatrix<T>(m, n, 7);
        const Decomposed<T> thin = Decompose(a);
        const Decomposed<T> full = Decompose(a, true);
        ASSERT_EQ(full.status, kOk);
        EXPECT_EQ(full.s, thin.s);
        for (const auto& [part, whole] : {std::pair{&thin.u, &full.u}, {&thin.v, &full.v}}) {
            EXPECT_EQ(whole->rows, whole->columns);
            for (int32_t i = 0; i < part->rows; ++i)
                for (int32_t j = 0; j < part->columns; ++j)
                    EXPECT_NEAR(SumOfParts((*whole)(i, j) - (*part)(i, j)), 0.0, 1e-14);
        }
    }
}

TYPED_TEST(Svd, LeavesTheMatrixAsItWas) {
    const DenseMatrix<TypeParam> a = RandomMatrix<TypeParam>(6, 4, 8);
    const DenseMatrix<TypeParam> b = RandomMatrix<TypeParam>(4, 6, 9);
    const DenseMatrix<TypeParam> a_before = a, b_before = b;
    Decompose(a);
    Decompose(b);
    Decompose(a, true);
    Decompose(b, true);
    std::vector<double> s(4);
    SvdValuesCore(a.data(), 6, 4, s.data());
    SvdValuesCore(b.data(), 4, 6, s.data());
    EXPECT_EQ(a.elements, a_before.elements);
    EXPECT_EQ(b.elements, b_before.elements);
}

TYPED_TEST(Svd, RejectsWhatItCannotDecompose) {
    using T = TypeParam;
    DenseMatrix<T> a = RandomMatrix<T>(3, 3, 4);
    Decomposed<T> d(3, 3, false);
    for (const auto& [m, n] : {std::pair{0, 0}, {0, 3}, {3, 0}, {-1, 3}, {3, -1}}) {
        EXPECT_EQ(SvdCore(a.data(), m, n, d.u.data(), d.s.data(), d.v.data(), false), kEmptyInput);
        EXPECT_EQ(SvdCore(a.data(), m, n, d.u.data(), d.s.data(), d.v.data(), true), kEmptyInput);
        EXPECT_EQ(SvdValuesCore(a.data(), m, n, d.s.data()), kEmptyInput);
    }
    for (const double bad : {kQuietNaN, kInfinity, -kInfinity, 1.7976931348623157e308, -1.7976931348623e308}) {
        a(2, 1) = FromReal<T>(bad);
        EXPECT_EQ(SvdCore(a.data(), 3, 3, d.u.data(), d.s.data(), d.v.data(), false), kNotFinite);
        EXPECT_EQ(SvdValuesCore(a.data(), 3, 3, d.s.data()), kNotFinite);
    }
}

// Where the norm overflows nothing counts as zero any more.
TYPED_TEST(Svd, DoesNotConvergeOnOverflow) {
    using T = TypeParam;
    for (const int32_t n : {1, 2, 3, 10}) {
        const auto a = Generate<T>(n + 1, n, [](int32_t, int32_t) { return FromReal<T>(1e308); });
        EXPECT_EQ(Decompose(a).status, kNoConvergence) << n;
        EXPECT_EQ(Decompose(Adjoint(a)).status, kNoConvergence) << n;
        std::vector<double> s(Count(n));
        EXPECT_EQ(SvdValuesCore(a.data(), n + 1, n, s.data()), kNoConvergence) << n;
    }
}

// The band around zero is absolute: below it, a matrix counts as diagonal once it is bidiagonal.
TYPED_TEST(Svd, TakesTinyMatricesForDiagonalOnes) {
    using T = TypeParam;
    DenseMatrix<T> a(2, 2);
    a.elements = {FromReal<T>(1e-20), FromReal<T>(2e-20), FromReal<T>(3e-20), FromReal<T>(4e-20)};
    std::vector<double> s(2);
    ASSERT_EQ(SvdValuesCore(a.data(), 2, 2, s.data()), kOk);
    EXPECT_THAT(s, AllNear(std::vector<double>{std::sqrt(10.0) * 1e-20, std::sqrt(0.4) * 1e-20}, 1e-14));
    EXPECT_EQ(Decompose(a).s, s);
}

TYPED_TEST(Svd, KeepsItsAccuracyAtOtherScales) {
    using T = TypeParam;
    for (const double scale : {1e100, 1e140, 1e4, 1e-3}) {
        DenseMatrix<T> a = RandomMatrix<T>(12, 9, 5);
        for (T& x : a.elements) x = x * scale;
        const Decomposed<T> d = Decompose(a);
        ASSERT_EQ(d.status, kOk);
        DenseMatrix<T> back = Product(ColumnsScaled(d.u, d.s), Adjoint(d.v));
        for (T& x : back.elements) x = x / scale;
        EXPECT_LE(Distance(back, RandomMatrix<T>(12, 9, 5)), 1e-13) << scale;
    }
}

// The phase of a complex element is good even where its modulus has hardly a digit, or nearly nothing beside the
// others.
TYPED_TEST(Svd, ReflectsColumnsThatBeginWithAVanishingElement) {
    using T = TypeParam;
    for (const double tiny : {5e-324, 1.5e-323, 1e-310, 1e-300}) {
        DenseMatrix<T> a = RandomMatrix<T>(4, 3, 11);
        a(0, 0) = FromReal<T>(tiny);
        if constexpr (kIsComplex<T>) a(0, 0).im = -2.0 * tiny;
        this->ExpectDecomposition(a);
        this->ExpectDecomposition(Adjoint(a));
    }
    std::vector<double> s(1);
    const std::vector<T> column = {FromReal<T>(0.5), FromReal<T>(1.7e308)};
    ASSERT_EQ(SvdValuesCore(column.data(), 2, 1, s.data()), kOk);
    EXPECT_DOUBLE_EQ(s[0], 1.7e308);
}

TEST(SvdOfReals, GivesTheReflectorsSignsToSingleElements) {
    const auto single = [](double x) {
        DenseMatrix<double> a(1, 1);
        a(0, 0) = x;
        return Decompose(a);
    };
    const Decomposed<double> negative = single(-3.0);
    EXPECT_EQ(negative.s[0], 3.0);
    EXPECT_EQ(negative.u(0, 0), -1.0);
    EXPECT_EQ(negative.v(0, 0), 1.0);
    const Decomposed<double> positive = single(3.0);
    EXPECT_EQ(positive.s[0], 3.0);
    EXPECT_EQ(positive.u(0, 0), -1.0);
    EXPECT_EQ(positive.v(0, 0), -1.0);
}

}  // namespace
}  // namespace krnumer

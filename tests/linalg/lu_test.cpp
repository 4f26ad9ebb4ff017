#include "linalg/lu.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>

#include "frame/status.h"
#include "krnumer/linalg_factor.h"
#include "linalg/matrices.h"
#include "reference/linalg/factor.inc"
#include "support/vector_units.h"

namespace krnumer {
namespace {

using testing::ElementsAre;

template <class T>
struct Factored {
    int32_t status;
    Matrix<T> lu;
    std::vector<int32_t> pivots;
    int32_t parity;

    friend bool operator==(const Factored&, const Factored&) = default;
};

template <class T>
Factored<T> Factor(const Matrix<T>& a) {
    Factored<T> result{0, a, std::vector<int32_t>(Count(a.rows)), -1};
    result.status = LUFactor(result.lu.data(), a.rows, result.pivots.data(), &result.parity);
    return result;
}

// The elimination column by column, each column reduced by all columns before it when its turn has come.
template <class T>
Factored<T> FactorColumnByColumn(const Matrix<T>& a) {
    const int32_t n = a.rows;
    Factored<T> result{kOk, a, std::vector<int32_t>(Count(n)), 0};
    Matrix<T>& lu = result.lu;
    for (int32_t k = 0; k < n; ++k) result.pivots[Count(k)] = k;
    for (int32_t k = 0; k < n; ++k) {
        double largest = 0.0;
        int32_t pivot = -1;
        for (int32_t i = 0; i < n; ++i) {
            for (int32_t j = 0; j < std::min(i, k); ++j) lu(i, k) -= lu(i, j) * lu(j, k);
            const double size = kIsComplex<T> ? SquaredModulus(lu(i, k)) : Modulus(lu(i, k));
            if (i >= k && size > largest) {
                largest = size;
                pivot = i;
            }
        }
        if (pivot < 0) {
            result.status = kWarnZeroPivot;
            continue;
        }
        if (pivot != k) {
            for (int32_t j = 0; j < n; ++j) std::swap(lu(k, j), lu(pivot, j));
            result.pivots[Count(k)] = pivot;
            result.parity = 1 - result.parity;
        }
        for (int32_t i = k + 1; i < n; ++i) lu(i, k) = lu(i, k) / lu(k, k);
    }
    return result;
}

template <class T>
bool SameToTheBit(const Matrix<T>& a, const Matrix<T>& b) {
    return std::equal(a.elements.begin(), a.elements.end(), b.elements.begin(), b.elements.end(), [](T x, T y) {
        if constexpr (kIsComplex<T>) {
            return IsNear(x.re, y.re, 0, 0) && IsNear(x.im, y.im, 0, 0);
        } else {
            return IsNear(x, y, 0, 0);
        }
    });
}

template <class T>
Matrix<T> RowsExchanged(Matrix<T> a, const std::vector<int32_t>& pivots) {
    for (int32_t k = 0; k < a.rows; ++k)
        for (int32_t j = 0; j < a.columns; ++j) std::swap(a(k, j), a(pivots[Count(k)], j));
    return a;
}

template <class T>
Matrix<T> LowerTimesUpper(const Matrix<T>& lu) {
    const auto lower = [&lu](int32_t i, int32_t j) { return i > j ? lu(i, j) : FromReal<T>(i == j ? 1.0 : 0.0); };
    const auto upper = [&lu](int32_t i, int32_t j) { return i <= j ? lu(i, j) : T{}; };
    return Product(Generate<T>(lu.rows, lu.rows, lower), Generate<T>(lu.rows, lu.rows, upper));
}

template <class T>
class LU : public testing::Test {
  protected:
    static constexpr auto Export = Pick<T>(LU_head, CxLU_head);

    int32_t Call(const Matrix<T>& a) {
        matrix_ = ToHost(a);
        EXPECT_EQ(Export(matrix_.handle(), pivots_.handle(), &sign_, &err_), 0);
        return err_;
    }

    LeakCheck leaks_;
    HostMatrix<T> matrix_;
    HostArray<double> pivots_{1, 2, 3};
    int32_t sign_ = 99, err_ = 77;
};
TYPED_TEST_SUITE(LU, ElementTypes);

TYPED_TEST(LU, FactorsLikeTheReference) {
    const auto& golden = GoldenFactor<TypeParam>::Values();
    const auto factored = Factor(golden.a);
    EXPECT_EQ(factored.status, kOk);
    EXPECT_EQ(factored.pivots, golden.pivots);
    EXPECT_THAT(factored.lu.elements, AllNear(golden.lu.elements, 1e-14, 1e-14));
}

TYPED_TEST(LU, ReproducesTheMatrix) {
    using T = TypeParam;
    for (const auto& kind : MatrixKinds<T>()) {
        for (const int32_t n : {1, 2, 3, 4, 5, 6, 7, 8, 11, 16, 25, 33, 47, 60, 200}) {
            const Matrix<T> a = kind.make(n, n);
            const auto factored = Factor(a);
            const Matrix<T> exchanged = RowsExchanged(a, factored.pivots);
            EXPECT_LE(Distance(LowerTimesUpper(factored.lu), exchanged), 4.0 * n * kEpsilon * FrobeniusNorm(a))
                << kind.name << ' ' << n;
        }
    }
}

// Whatever is done at the same time, each element is reduced in the order of the columns: the same to the bit.
TYPED_TEST(LU, RoundsAsColumnByColumn) {
    using T = TypeParam;
    OnEveryVectorUnit([] {
        for (int32_t n = 1; n <= 40; ++n) {
            const Matrix<T> a = RandomMatrix<T>(n, n, static_cast<uint64_t>(n));
            ASSERT_EQ(Factor(a), FactorColumnByColumn(a)) << n;
        }
        for (const auto& kind : MatrixKinds<T>()) {
            const Matrix<T> a = kind.make(53, 53);
            ASSERT_EQ(Factor(a), FactorColumnByColumn(a)) << kind.name;
        }
    });
}

TYPED_TEST(LU, LetsNaNAndInfinityFlow) {
    using T = TypeParam;
    OnEveryVectorUnit([] {
        for (int32_t place = 0; place < 81; place += 4) {
            for (const double bad : {kQuietNaN, kInfinity}) {
                Matrix<T> a = RandomMatrix<T>(9, 9, 1);
                a.elements[Count(place)] = FromReal<T>(bad);
                const auto factored = Factor(a), reference = FactorColumnByColumn(a);
                ASSERT_EQ(factored.status, reference.status) << place;
                ASSERT_EQ(factored.pivots, reference.pivots) << place;
                ASSERT_TRUE(SameToTheBit(factored.lu, reference.lu)) << place;
            }
        }
    });
}

TYPED_TEST(LU, NeverPivotsOnNaN) {
    using T = TypeParam;
    const T nan = FromReal<T>(kQuietNaN), one = FromReal<T>(1), zero{};
    EXPECT_EQ(Factor(Matrix<T>(2, 2, {nan, one, one, one})).pivots, (std::vector<int32_t>{1, 1}));
    EXPECT_EQ(Factor(Matrix<T>(1, 1, {nan})).status, kWarnZeroPivot);
    const auto left_alone = Factor(Matrix<T>(2, 2, {zero, one, nan, one}));
    EXPECT_EQ(left_alone.status, kWarnZeroPivot);
    EXPECT_THAT(left_alone.pivots, ElementsAre(0, 1));
    EXPECT_EQ(left_alone.lu(0, 0), zero);
}

TYPED_TEST(LU, TakesTheFirstOfEqualPivots) {
    using T = TypeParam;
    const T one = FromReal<T>(1), minus = FromReal<T>(-1), zero{};
    const auto factored = Factor(Matrix<T>(3, 3, {zero, one, zero, minus, zero, zero, one, zero, one}));
    EXPECT_THAT(factored.pivots, ElementsAre(1, 1, 2));
    EXPECT_EQ(factored.parity, 1);
}

TYPED_TEST(LU, IsExactOnIntegers) {
    using T = TypeParam;
    const auto r = [](double x) { return FromReal<T>(x); };
    const auto factored = Factor(Matrix<T>(3, 3, {r(2), r(1), r(1), r(4), r(3), r(3), r(8), r(7), r(9)}));
    EXPECT_EQ(factored.lu.elements,
              (std::vector<T>{r(8), r(7), r(9), r(0.25), r(-0.75), r(-1.25), r(0.5), r(2.0 / 3), factored.lu(2, 2)}));
    EXPECT_THAT(factored.pivots, ElementsAre(2, 2, 2));
    EXPECT_EQ(factored.parity, 0);
    EXPECT_THAT(factored.lu(2, 2), Near(r(-2.0 / 3), 1e-15));
}

// Elements that were exchanged stay exchanges, not a permutation.
TYPED_TEST(LU, PivotsAreExchangesOneAfterTheOther) {
    using T = TypeParam;
    const T one = FromReal<T>(1), zero{};
    const auto cycle = Factor(Matrix<T>(3, 3, {zero, one, zero, zero, zero, one, one, zero, zero}));
    EXPECT_THAT(cycle.pivots, ElementsAre(2, 2, 2));
    EXPECT_EQ(cycle.parity, 0);
}

TYPED_TEST(LU, ExportDeliversPivotsInTheFirstHalf) {
    using T = TypeParam;
    const auto& golden = GoldenFactor<T>::Values();
    for (const bool least_alignment : {false, true}) {
        const int32_t former = KrrtLeastAlignment(least_alignment);
        EXPECT_EQ(this->Call(golden.a), kOk);
        EXPECT_THAT(this->matrix_.values(), AllNear(golden.lu.elements, 1e-14, 1e-14));
        ASSERT_EQ(this->pivots_.size(), 6);
        const std::vector<double> places = this->pivots_.values();
        std::vector<int32_t> pivots(6);
        std::memcpy(pivots.data(), places.data(), 6 * sizeof(int32_t));
        EXPECT_EQ(pivots, golden.pivots);
        KrrtLeastAlignment(former);
    }
}

TYPED_TEST(LU, ExportTellsTheParity) {
    using T = TypeParam;
    const T one = FromReal<T>(1), zero{};
    EXPECT_EQ(this->Call(Matrix<T>(2, 2, {one, zero, zero, one})), kOk);
    EXPECT_EQ(this->sign_, 0);
    EXPECT_EQ(this->Call(Matrix<T>(2, 2, {zero, one, one, zero})), kOk);
    EXPECT_EQ(this->sign_, 1);
}

TYPED_TEST(LU, ExportWarnsOfAZeroColumnAndKeepsTheRest) {
    using T = TypeParam;
    EXPECT_EQ(this->Call(Matrix<T>(2, 2)), kWarnZeroPivot);
    EXPECT_EQ(FromHost(this->matrix_), Matrix<T>(2, 2));
    EXPECT_EQ(this->pivots_.size(), 2);
    int32_t pivots[2];
    const double first = this->pivots_[0];
    std::memcpy(pivots, &first, sizeof pivots);
    EXPECT_THAT(pivots, ElementsAre(0, 1));
    EXPECT_EQ(this->sign_, 0);

    // A zero column in the middle does not end the work.
    const T one = FromReal<T>(1), two = FromReal<T>(2), zero{};
    EXPECT_EQ(this->Call(Matrix<T>(3, 3, {one, zero, one, one, zero, two, zero, zero, one})), kWarnZeroPivot);
    EXPECT_EQ(FromHost(this->matrix_), Matrix<T>(3, 3, {one, zero, one, one, zero, one, zero, zero, one}));
}

TYPED_TEST(LU, ExportChecksTheShapeLast) {
    using T = TypeParam;
    const auto expect_failure = [this](int32_t rows, int32_t columns, int32_t status) {
        HostMatrix<T> a(2, 3);
        a.SetDimension(0, rows);
        a.SetDimension(1, columns);
        HostArray<double> pivots{1, 2};
        this->sign_ = 99;
        EXPECT_EQ(this->Export(a.handle(), pivots.handle(), &this->sign_, &this->err_), 0);
        EXPECT_EQ(this->err_, status);
        EXPECT_TRUE(a.empty());
        EXPECT_TRUE(pivots.empty());
        EXPECT_EQ(this->sign_, 0);
    };
    expect_failure(2, 3, kNotSquare);
    expect_failure(0, 3, kNotSquare);
    expect_failure(0, 0, kEmptyInput);
    expect_failure(-1, -1, kEmptyInput);
    const FailResize refusal;
    expect_failure(2, 2, kOutOfMemory);
}

TEST(ComplexLU, ComparesPivotsByTheirModulus) {
    // |re| + |im| would choose the first, the modulus chooses the second.
    const auto factored = Factor(Matrix<Complex>(2, 2, {{3, 3}, {1, 0}, {5, 0}, {0, 1}}));
    EXPECT_THAT(factored.pivots, ElementsAre(1, 1));
}

TEST(ComplexLU, DoesNotScaleTheSquares) {
    EXPECT_EQ(Factor(Matrix<Complex>(1, 1, {{1e-200, 0}})).status, kWarnZeroPivot);
    EXPECT_EQ(Factor(Matrix<double>(1, 1, {1e-200})).status, kOk);
    const auto overflown = Factor(Matrix<Complex>(2, 2, {{1e200, 0}, {1, 0}, {1e201, 0}, {0, 1}}));
    EXPECT_THAT(overflown.pivots, ElementsAre(0, 1));
}

TEST(LUFactor, NeedsAnOrder) {
    double a = 1.0;
    int32_t pivot = 0, parity = 0;
    EXPECT_EQ(LUFactor(&a, 0, &pivot, &parity), kEmptyInput);
    EXPECT_EQ(LUFactor(&a, -3, &pivot, &parity), kEmptyInput);
}

}  // namespace
}  // namespace krnumer

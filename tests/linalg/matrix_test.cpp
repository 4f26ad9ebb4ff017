// Trace, transposes, matrices made of vectors, zero matrices.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <limits>

#include "frame/status.h"
#include "krnumer/linalg_basic.h"
#include "linalg/cores.h"
#include "linalg/matrices.h"
#include "reference/linalg/basic.inc"

namespace krnumer {
namespace {

using testing::Each;

template <class T>
class SimpleMatrices : public testing::Test {
  protected:
    static constexpr auto Trace = Pick<T>(Trace_head, CxTrace_head);
    static constexpr auto Special = Pick<T>(SpecialMatrix_head, CxSpecialMatrix_head);
    static constexpr auto Zeros = Pick<T>(InitialMatrixH, CxInitialMatrixH);

    // The status of the transposition, wherever the twin puts it.
    int32_t Transpose(const HostMatrix<T>& a) {
        if constexpr (kIsComplex<T>) {
            EXPECT_EQ(CxTranspose_head(a.handle(), out_.handle(), &err_), 0);
            return err_;
        } else {
            return Transpose_head(a.handle(), out_.handle());
        }
    }

    int32_t Make(int32_t kind, int32_t size, const std::vector<T>& x, const std::vector<T>& y) {
        const HostArray<T> first(x), second(y);
        EXPECT_EQ(Special(&kind, &size, first.handle(), second.handle(), out_.handle(), &err_), 0);
        if (err_ != kOk) {
            EXPECT_TRUE(out_.empty());
        }
        return err_;
    }

    LeakCheck leaks_;
    HostMatrix<T> out_{1, 2};
    Scalar<T> scalar_{};
    int32_t err_ = 77;
};
TYPED_TEST_SUITE(SimpleMatrices, ElementTypes);

TYPED_TEST(SimpleMatrices, TraceSumsTheDiagonalOfAnyShape) {
    using T = TypeParam;
    for (const auto& [m, n] : {std::pair(3, 5), {5, 3}, {1, 1}, {4, 4}, {1, 6}}) {
        const Matrix<T> a = IntegerMatrix<T>(m, n, 4);
        T sum{};
        for (int32_t i = 0; i < std::min(m, n); ++i) sum += a(i, i);
        EXPECT_EQ(this->Trace(ToHost(a).handle(), &this->scalar_, &this->err_), 0);
        EXPECT_EQ(this->err_, kOk);
        EXPECT_EQ(Value(this->scalar_), sum) << m << " by " << n;
    }
}

TYPED_TEST(SimpleMatrices, TraceNeedsElements) {
    HostMatrix<TypeParam> a(2, 2);
    a.SetDimension(1, 0);
    EXPECT_EQ(this->Trace(a.handle(), &this->scalar_, &this->err_), 0);
    EXPECT_EQ(this->err_, kEmptyInput);
    EXPECT_TRUE(IsQuietNaN(Value(this->scalar_)));
    a.SetDimension(0, -1);
    this->Trace(a.handle(), &this->scalar_, &this->err_);
    EXPECT_EQ(this->err_, kEmptyInput);
}

TYPED_TEST(SimpleMatrices, TransposeMirrorsEveryShape) {
    using T = TypeParam;
    for (const auto& [m, n] : {std::pair(1, 1), {1, 7}, {9, 1}, {8, 8}, {17, 23}, {3, 40}}) {
        const Matrix<T> a = IntegerMatrix<T>(m, n, 6);
        ASSERT_EQ(this->Transpose(ToHost(a)), kOk);
        EXPECT_EQ(FromHost(this->out_), Adjoint(a)) << m << " by " << n;

        Matrix<T> plain(n, m), in_place = a, conjugated = a;
        ASSERT_EQ(TransposeCore(a.elements.data(), m, n, plain.elements.data()), kOk);
        EXPECT_EQ(plain, Transposed(a));
        ASSERT_EQ(TransposeInPlace(in_place.elements.data(), m, n), kOk);
        EXPECT_EQ(in_place.elements, plain.elements);
        ASSERT_EQ(ConjTransposeInPlace(conjugated.elements.data(), m, n), kOk);
        EXPECT_EQ(conjugated.elements, Adjoint(a).elements);
    }
}

TYPED_TEST(SimpleMatrices, TransposeNeedsElements) {
    HostMatrix<TypeParam> a(2, 2);
    a.SetDimension(0, 0);
    EXPECT_EQ(this->Transpose(a), kEmptyInput);
    EXPECT_TRUE(this->out_.empty());
    const FailResize refusal;
    EXPECT_EQ(this->Transpose(HostMatrix<TypeParam>(2, 2)), kOutOfMemory);
    EXPECT_TRUE(this->out_.empty());
}

TYPED_TEST(SimpleMatrices, SpecialFormsAreThoseOfTheReference) {
    using T = TypeParam;
    const auto& golden = GoldenBasic<T>::Values();
    EXPECT_EQ(this->Make(kIdentity, 3, {}, {}), kOk);
    EXPECT_EQ(FromHost(this->out_), Identity<T>(3));
    EXPECT_EQ(this->Make(kDiagonal, 9, golden.x, golden.y), kOk);
    EXPECT_EQ(FromHost(this->out_), golden.diagonal);
    EXPECT_EQ(this->Make(kToeplitz, -4, golden.x, golden.y), kOk);
    EXPECT_EQ(FromHost(this->out_), golden.toeplitz);
    EXPECT_EQ(this->Make(kVandermonde, 0, golden.x, {}), kOk);
    EXPECT_EQ(FromHost(this->out_), golden.vandermonde);
    EXPECT_EQ(this->Make(kCompanion, 0, golden.y, {}), kOk);
    EXPECT_EQ(this->out_.rows(), golden.companion.rows);
    EXPECT_THAT(this->out_.values(), AllNear(golden.companion.elements, 1e-15));
}

TYPED_TEST(SimpleMatrices, ToeplitzNeverReadsTheFirstOfTheRow) {
    using T = TypeParam;
    const T one = FromReal<T>(1), two = FromReal<T>(2), nan = FromReal<T>(kQuietNaN);
    EXPECT_EQ(this->Make(kToeplitz, 0, {one}, {nan, two}), kOk);
    EXPECT_EQ(FromHost(this->out_), Matrix<T>(1, 2, {one, two}));
}

TYPED_TEST(SimpleMatrices, SpecialFormsCheckSizesBeforeTheKind) {
    using T = TypeParam;
    const std::vector<T> one(1), two(2), none;
    EXPECT_EQ(this->Make(kIdentity, 0, two, two), kEmptyInput);
    EXPECT_EQ(this->Make(kDiagonal, 2, none, two), kEmptyInput);
    EXPECT_EQ(this->Make(kToeplitz, 2, none, two), kEmptyInput);
    EXPECT_EQ(this->Make(kToeplitz, 2, two, none), kEmptyInput);
    EXPECT_EQ(this->Make(kVandermonde, 2, none, two), kEmptyInput);
    EXPECT_EQ(this->Make(kCompanion, 2, one, two), kFewerThanTwo);
    EXPECT_EQ(this->Make(kCompanion, 2, none, two), kFewerThanTwo);
    EXPECT_EQ(this->Make(5, 0, two, two), kEmptyInput);
    EXPECT_EQ(this->Make(5, 1, two, two), kBadSelector);
    EXPECT_EQ(this->Make(-1, 2, two, two), kBadSelector);

    T element{};
    EXPECT_EQ(MakeSpecialMatrix(kCompanion, 1, &element, std::numeric_limits<int32_t>::min(), &element, 1, &element),
              kFewerThanTwo);
}

TYPED_TEST(SimpleMatrices, CompanionDividesByAZeroLeadingCoefficient) {
    using T = TypeParam;
    EXPECT_EQ(this->Make(kCompanion, 0, {T{}, FromReal<T>(1), FromReal<T>(-1), T{}}, {}), kOk);
    if constexpr (kIsComplex<T>) {
        for (int32_t j = 0; j < 3; ++j) EXPECT_TRUE(std::isnan(this->out_(0, j).re));
    } else {
        EXPECT_EQ(this->out_(0, 0), -kInfinity);
        EXPECT_EQ(this->out_(0, 1), kInfinity);
        EXPECT_TRUE(std::isnan(this->out_(0, 2)));
    }
    EXPECT_EQ(this->out_(1, 0), FromReal<T>(1));
    EXPECT_EQ(this->out_(2, 1), FromReal<T>(1));
}

TYPED_TEST(SimpleMatrices, ZerosHaveTheDimensionsAskedFor) {
    EXPECT_EQ(this->Zeros(3, 4, this->out_.handle()), kOk);
    EXPECT_EQ(this->out_.rows(), 3);
    EXPECT_EQ(this->out_.columns(), 4);
    EXPECT_THAT(this->out_.values(), Each(TypeParam{}));
}

TYPED_TEST(SimpleMatrices, ZerosNeedPositiveSizes) {
    for (const auto& [m, n] : {std::pair(0, 3), {3, 0}, {-1, -1}, {-2, 3}}) {
        EXPECT_EQ(this->Zeros(m, n, this->out_.handle()), kEmptyInput);
        EXPECT_TRUE(this->out_.empty());
    }
}

TYPED_TEST(SimpleMatrices, ZerosHandOnWhatTheHostSays) {
    const FailResize refusal(1, 4711);
    EXPECT_EQ(this->Zeros(3, 4, this->out_.handle()), 4711);
    EXPECT_TRUE(this->out_.empty());
}

// More than any memory holds: found before the host is asked.
TYPED_TEST(SimpleMatrices, ZerosBeyondMemoryAreRefusedWithoutTheHost) {
    constexpr int32_t kMost = std::numeric_limits<int32_t>::max();
    const ResizeLog resizes;
    EXPECT_EQ(this->Zeros(kMost, kMost, this->out_.handle()), kOutOfMemory);
    EXPECT_TRUE(this->out_.empty());
    ASSERT_EQ(resizes.size(), 1);
    EXPECT_EQ(resizes[0].totalElements, 0);
}

}  // namespace
}  // namespace krnumer

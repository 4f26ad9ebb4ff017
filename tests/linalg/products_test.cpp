#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "frame/status.h"
#include "krnumer/linalg_basic.h"
#include "linalg/cores.h"
#include "linalg/matrices.h"
#include "reference/linalg/basic.inc"

namespace krnumer {
namespace {

using testing::Each;
using testing::ElementsAre;
using testing::IsEmpty;

template <class T>
class Products : public testing::Test {
  protected:
    static constexpr auto Dot = Pick<T>(DotProduct_head, DotprodCx);
    static constexpr auto Outer = Pick<T>(OuterProd_head, OuterProdCx_head);
    static constexpr auto MatMul = Pick<T>(MatrixMul_head, AxBCxCIN);
    static constexpr auto MatVec = Pick<T>(AxVect_head, AxVectorCx);
    static constexpr auto VecMat = Pick<T>(vectxA_head, CxVectxA_head);
    static constexpr auto Kronecker = Pick<T>(KroneckerProd_H, CxKroneckerProd_H);

    LeakCheck leaks_;
    HostMatrix<T> out_{1, 2};  // what was in the outputs before must not matter
    HostArray<T> vector_out_{T{}, T{}, T{}};
    Scalar<T> scalar_{};
    int32_t err_ = 77;
};
TYPED_TEST_SUITE(Products, ElementTypes);

TYPED_TEST(Products, MultiplyAsTheReferenceDoes) {
    using T = TypeParam;
    const auto& golden = GoldenBasic<T>::Values();
    const HostMatrix<T> a = ToHost(golden.a), b = ToHost(golden.b);
    EXPECT_EQ(this->MatMul(a.handle(), b.handle(), this->out_.handle(), &this->err_), 0);
    EXPECT_EQ(this->err_, kOk);
    EXPECT_EQ(FromHost(this->out_), golden.a_times_b);
    EXPECT_EQ(this->Kronecker(a.handle(), b.handle(), this->out_.handle()), kOk);
    EXPECT_EQ(FromHost(this->out_), golden.a_kronecker_b);

    const HostArray<T> x(golden.x), y(golden.y);
    EXPECT_EQ(this->MatVec(a.handle(), x.handle(), this->vector_out_.handle(), &this->err_), 0);
    EXPECT_EQ(this->vector_out_.values(), golden.a_times_x);
    EXPECT_EQ(this->VecMat(y.handle(), a.handle(), this->vector_out_.handle()), kOk);
    EXPECT_EQ(this->vector_out_.values(), golden.y_times_a);
    EXPECT_EQ(this->Outer(x.handle(), y.handle(), this->out_.handle(), &this->err_), 0);
    EXPECT_EQ(FromHost(this->out_), golden.x_outer_y);
    EXPECT_EQ(this->Dot(x.handle(), x.handle(), &this->scalar_, &this->err_), 0);
    EXPECT_EQ(Value(this->scalar_), golden.x_dot_x);
}

TYPED_TEST(Products, AreExactOnIntegersOfAllSizes) {
    using T = TypeParam;
    for (const int32_t m : {1, 2, 3, 4, 5, 9, 33}) {
        for (const int32_t k : {1, 2, 7, 40}) {
            for (const int32_t n : {1, 3, 8, 31}) {
                const Matrix<T> a = IntegerMatrix<T>(m, k, 1), b = IntegerMatrix<T>(k, n, 2),
                                x = IntegerMatrix<T>(k, 1, 3);
                Matrix<T> c(m, n);
                ASSERT_EQ(MatMulCore(a.elements.data(), b.elements.data(), m, k, n, c.elements.data()), kOk);
                ASSERT_EQ(c, Product(a, b)) << m << ' ' << k << ' ' << n;
                Matrix<T> y(m, 1);
                ASSERT_EQ(MatVecCore(a.elements.data(), m, k, x.elements.data(), y.elements.data()), kOk);
                ASSERT_EQ(y, Product(a, x)) << m << ' ' << k;
            }
        }
    }
}

// Each sum runs from the first term to the last, so a large term swallows the small ones that came before it only.
TYPED_TEST(Products, AddInIndexOrder) {
    using T = TypeParam;
    const T one = FromReal<T>(1.0), large = FromReal<T>(0x1p53), minus = -large;
    const HostArray<T> ones{one, one, one, one};
    const auto sum_of = [&](std::initializer_list<T> terms) {
        const HostArray<T> x(terms);
        this->Dot(x.handle(), ones.handle(), &this->scalar_, &this->err_);
        return RealPart(Value(this->scalar_));
    };
    EXPECT_EQ(sum_of({one, large, one, minus}), 0.0);  // 1 + 2^53 and one more round to 2^53 each
    EXPECT_EQ(sum_of({large, minus, one, one}), 2.0);
    std::vector<T> rows;
    for (int row = 0; row < 6; ++row) rows.insert(rows.end(), {one, large, one, minus});
    const HostMatrix<T> a(6, 4, rows);
    this->MatVec(a.handle(), ones.handle(), this->vector_out_.handle(), &this->err_);
    EXPECT_THAT(this->vector_out_.values(), Each(T{}));
}

TYPED_TEST(Products, TakeArraysThatAreInputAndOutput) {
    using T = TypeParam;
    const Matrix<T> a = IntegerMatrix<T>(3, 3, 5);
    HostMatrix<T> both = ToHost(a);
    EXPECT_EQ(this->MatMul(both.handle(), both.handle(), both.handle(), &this->err_), 0);
    EXPECT_EQ(FromHost(both), Product(a, a));
}

// --- Sizes of 0 and below -------------------------------------------------------------------------------------------

TYPED_TEST(Products, OfInnerDimensionZeroAreUnknown) {
    using T = TypeParam;
    HostMatrix<T> a(2, 3), b(2, 3);
    a.SetDimension(1, 0);
    b.SetDimension(0, 0);
    this->MatMul(a.handle(), b.handle(), this->out_.handle(), &this->err_);
    EXPECT_EQ(this->err_, kOk);
    EXPECT_EQ(this->out_.rows(), 2);
    EXPECT_EQ(this->out_.columns(), 3);
    for (const T element : this->out_.values()) EXPECT_TRUE(IsQuietNaN(element));

    const HostArray<T> none;
    EXPECT_EQ(this->VecMat(none.handle(), b.handle(), this->vector_out_.handle()), kOk);
    EXPECT_EQ(this->vector_out_.size(), 3);
    for (const T element : this->vector_out_.values()) EXPECT_TRUE(IsQuietNaN(element));
    this->MatVec(a.handle(), none.handle(), this->vector_out_.handle(), &this->err_);
    EXPECT_EQ(this->err_, kOk);
    EXPECT_THAT(this->vector_out_.values(), ElementsAre(T{}, T{}));
}

TYPED_TEST(Products, MayHaveNoElements) {
    using T = TypeParam;
    HostMatrix<T> none(1, 3), three(3, 2);
    none.SetDimension(0, 0);
    this->MatMul(none.handle(), three.handle(), this->out_.handle(), &this->err_);
    EXPECT_EQ(this->err_, kOk);
    EXPECT_EQ(this->out_.rows(), 0);
    EXPECT_EQ(this->out_.columns(), 2);

    const HostArray<T> x(3), empty;
    this->MatVec(none.handle(), x.handle(), this->vector_out_.handle(), &this->err_);
    EXPECT_EQ(this->err_, kOk);
    EXPECT_THAT(this->vector_out_.values(), IsEmpty());
    HostMatrix<T> no_columns(3, 1);
    no_columns.SetDimension(1, 0);
    EXPECT_EQ(this->VecMat(x.handle(), no_columns.handle(), this->vector_out_.handle()), kOk);
    EXPECT_THAT(this->vector_out_.values(), IsEmpty());
    const HostMatrix<T> nothing;
    this->MatVec(nothing.handle(), empty.handle(), this->vector_out_.handle(), &this->err_);
    EXPECT_EQ(this->err_, kOk);
    EXPECT_THAT(this->vector_out_.values(), IsEmpty());
}

TYPED_TEST(Products, RefuseNegativeSizes) {
    using T = TypeParam;
    HostMatrix<T> negative(2, 2);
    const HostMatrix<T> two(2, 2);
    const HostArray<T> x(2);
    negative.SetDimension(0, -2);
    this->MatMul(negative.handle(), two.handle(), this->out_.handle(), &this->err_);
    EXPECT_EQ(this->err_, kEmptyInput);
    EXPECT_TRUE(this->out_.empty());
    this->MatVec(negative.handle(), x.handle(), this->vector_out_.handle(), &this->err_);
    EXPECT_EQ(this->err_, kEmptyInput);
    EXPECT_TRUE(this->vector_out_.empty());
    EXPECT_EQ(this->VecMat(x.handle(), negative.handle(), this->vector_out_.handle()), kEmptyInput);
    HostArray<T> negative_vector(2);
    negative_vector.SetDimension(0, -2);  // a fault of the size before one of the length
    EXPECT_EQ(this->VecMat(negative_vector.handle(), two.handle(), this->vector_out_.handle()), kEmptyInput);
    EXPECT_EQ(this->Kronecker(negative.handle(), two.handle(), this->out_.handle()), kEmptyInput);

    const T* none = nullptr;
    T* nowhere = nullptr;
    EXPECT_EQ(MatMulCore(none, none, 1, -1, 1, nowhere), kEmptyInput);
    EXPECT_EQ(MatVecCore(none, -1, 1, none, nowhere), kEmptyInput);
}

// --- The later check of a by-reference function decides, the first of a by-value one -----------------------------

TYPED_TEST(Products, ReportDifferingSizes) {
    using T = TypeParam;
    const HostArray<T> one(1), two(2), none;
    const auto dot = [&](const HostArray<T>& x, const HostArray<T>& y) {
        this->Dot(x.handle(), y.handle(), &this->scalar_, &this->err_);
        EXPECT_TRUE(IsQuietNaN(Value(this->scalar_)));
        return this->err_;
    };
    EXPECT_EQ(dot(one, two), kSizesDiffer);
    EXPECT_EQ(dot(none, two), kSizesDiffer);
    EXPECT_EQ(dot(none, none), kEmptyInput);

    HostMatrix<T> a(2, 2);
    const HostMatrix<T> b(3, 2);
    this->MatMul(a.handle(), b.handle(), this->out_.handle(), &this->err_);
    EXPECT_EQ(this->err_, kInnerSizesDiffer);
    EXPECT_TRUE(this->out_.empty());
    this->MatVec(a.handle(), one.handle(), this->vector_out_.handle(), &this->err_);
    EXPECT_EQ(this->err_, kSizesDiffer);
    EXPECT_TRUE(this->vector_out_.empty());
    EXPECT_EQ(this->VecMat(one.handle(), a.handle(), this->vector_out_.handle()), kSizesDiffer);
    EXPECT_TRUE(this->vector_out_.empty());

    a.SetDimension(0, -1);
    this->MatMul(a.handle(), b.handle(), this->out_.handle(), &this->err_);
    EXPECT_EQ(this->err_, kInnerSizesDiffer);
    this->MatVec(a.handle(), one.handle(), this->vector_out_.handle(), &this->err_);
    EXPECT_EQ(this->err_, kSizesDiffer);
    EXPECT_EQ(this->VecMat(one.handle(), a.handle(), this->vector_out_.handle()), kEmptyInput);
}

TYPED_TEST(Products, RefuseEmptyOperandsWhereASumIsNotMeant) {
    using T = TypeParam;
    const HostArray<T> one(1), none;
    for (const auto& [x, y] : {std::pair(one.handle(), none.handle()), std::pair(none.handle(), one.handle())}) {
        this->Outer(x, y, this->out_.handle(), &this->err_);
        EXPECT_EQ(this->err_, kEmptyInput);
        EXPECT_TRUE(this->out_.empty());
    }
    const HostMatrix<T> a(2, 2), nothing;
    EXPECT_EQ(this->Kronecker(a.handle(), nothing.handle(), this->out_.handle()), kEmptyInput);
    EXPECT_TRUE(this->out_.empty());
    EXPECT_EQ(this->Kronecker(nothing.handle(), a.handle(), this->out_.handle()), kEmptyInput);
}

TYPED_TEST(Products, TooLargeForAnArrayAreOutOfMemory) {
    using T = TypeParam;
    HostMatrix<T> tall(1 << 16, 1);
    EXPECT_EQ(this->Kronecker(tall.handle(), tall.handle(), this->out_.handle()), kOutOfMemory);
    EXPECT_TRUE(this->out_.empty());
    const HostArray<T> x(1 << 16);
    this->Outer(x.handle(), x.handle(), this->out_.handle(), &this->err_);
    EXPECT_EQ(this->err_, kOutOfMemory);
    EXPECT_TRUE(this->out_.empty());
}

TYPED_TEST(Products, ReportARefusedResize) {
    using T = TypeParam;
    const HostMatrix<T> a(2, 2);
    const HostArray<T> x(2);
    {
        const FailResize refusal;
        EXPECT_EQ(this->MatMul(a.handle(), a.handle(), this->out_.handle(), &this->err_), 0);
        EXPECT_EQ(this->err_, kOutOfMemory);
        EXPECT_TRUE(this->out_.empty());
    }
    const FailResize refusal;
    EXPECT_EQ(this->VecMat(x.handle(), a.handle(), this->vector_out_.handle()), kOutOfMemory);
    EXPECT_TRUE(this->vector_out_.empty());
}

// No product conjugates: i times i is -1 wherever it stands.
TEST(ComplexProducts, DoNotConjugate) {
    const Complex i{0, 1}, minus_one{-1, 0};
    const HostArray<Complex> x{i};
    const HostMatrix<Complex> a(1, 1, {i});
    HostMatrix<Complex> matrix;
    HostArray<Complex> vector;
    KrComplex dot{};
    int32_t err = 1;
    DotprodCx(x.handle(), x.handle(), &dot, &err);
    EXPECT_EQ(Value(dot), minus_one);
    OuterProdCx_head(x.handle(), x.handle(), matrix.handle(), &err);
    EXPECT_EQ(matrix(0, 0), minus_one);
    AxBCxCIN(a.handle(), a.handle(), matrix.handle(), &err);
    EXPECT_EQ(matrix(0, 0), minus_one);
    CxKroneckerProd_H(a.handle(), a.handle(), matrix.handle());
    EXPECT_EQ(matrix(0, 0), minus_one);
    AxVectorCx(a.handle(), x.handle(), vector.handle(), &err);
    EXPECT_EQ(vector[0], minus_one);
    CxVectxA_head(x.handle(), a.handle(), vector.handle());
    EXPECT_EQ(vector[0], minus_one);
}

}  // namespace
}  // namespace krnumer

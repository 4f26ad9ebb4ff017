// Packed triangles and their conversion.
#include "linalg/packed.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <limits>

#include "frame/status.h"
#include "krnumer/linalg_basic.h"
#include "linalg/matrices.h"

namespace krnumer {
namespace {

TEST(PackedOrder, InvertsTheTriangularNumbers) {
    constexpr int32_t kMost = std::numeric_limits<int32_t>::max();
    for (int64_t n = 1; n * (n + 1) / 2 <= kMost; n += n < 300 ? 1 : 97) {
        const auto length = static_cast<int32_t>(n * (n + 1) / 2);
        int32_t order = -1;
        ASSERT_EQ(PackedOrder(length, &order), kOk) << n;
        ASSERT_EQ(order, n);
        if (n == 1) continue;
        ASSERT_EQ(PackedOrder(length - 1, &order), kNotSquare) << n;
        ASSERT_EQ(order, n - 1);
    }
    int32_t order = -1;
    EXPECT_EQ(PackedOrder(kMost, &order), kNotSquare);
    EXPECT_EQ(order, 65535);
    for (const int32_t length : {0, -1, std::numeric_limits<int32_t>::min()}) {
        EXPECT_EQ(PackedOrder(length, &order), kEmptyInput);
        EXPECT_EQ(order, 0);
    }
}

TEST(PackedIndices, NameTheDiagonal) {
    EXPECT_EQ(PackedCount(4), 10u);
    EXPECT_EQ(PackedCount(0), 0u);
    EXPECT_EQ(PackedCount(-3), 0u);
    for (size_t j = 0; j < 4; ++j) {
        EXPECT_EQ(LowerDiagonal(j, 4), (std::vector<size_t>{0, 4, 7, 9})[j]);
        EXPECT_EQ(UpperDiagonal(j), (std::vector<size_t>{0, 2, 5, 9})[j]);
    }
}

template <class T>
class PackedTriangles : public testing::Test {
  protected:
    static constexpr auto ToMatrix = Pick<T>(Compact_to_Matrix_head, CxCompact_to_Matrix_head);
    static constexpr auto FromMatrix = Pick<T>(Matrix_to_Compact_head, CxMatrix_to_Compact_head);

    int32_t Unpack(const std::vector<T>& elements, int32_t triangle) {
        const HostArray<T> packed(elements);
        const KrTriangle record{packed.handle(), triangle};
        EXPECT_EQ(ToMatrix(&record, matrix_.handle(), &err_), 0);
        if (err_ != kOk) {
            EXPECT_TRUE(matrix_.empty());
        }
        return err_;
    }

    int32_t Pack(const HostMatrix<T>& a, int32_t triangle) {
        EXPECT_EQ(FromMatrix(a.handle(), &triangle, packed_.handle(), &err_), 0);
        if (err_ != kOk) {
            EXPECT_TRUE(packed_.empty());
        }
        return err_;
    }

    // 1 to 6 with imaginary parts where there are any.
    static std::vector<T> SixElements() {
        std::vector<T> elements;
        for (int i = 1; i <= 6; ++i) elements.push_back(Make<T>(i, 0.5 * i));
        return elements;
    }
    static T Conj(const T& element) { return Conjugate(element); }

    LeakCheck leaks_;
    HostMatrix<T> matrix_{1, 2};
    HostArray<T> packed_{T{}, T{}, T{}};
    int32_t err_ = 77;
};
TYPED_TEST_SUITE(PackedTriangles, ElementTypes);

TYPED_TEST(PackedTriangles, UnpackColumnByColumn) {
    using T = TypeParam;
    const std::vector<T> e = this->SixElements();
    const T zero{};
    EXPECT_EQ(this->Unpack(e, kLower), kOk);
    EXPECT_EQ(FromHost(this->matrix_), Matrix<T>(3, 3, {e[0], zero, zero, e[1], e[3], zero, e[2], e[4], e[5]}));
    EXPECT_EQ(this->Unpack(e, kUpper), kOk);
    EXPECT_EQ(FromHost(this->matrix_), Matrix<T>(3, 3, {e[0], e[1], e[3], zero, e[2], e[4], zero, zero, e[5]}));
    // The diagonal stays as it is, imaginary parts included.
    EXPECT_EQ(this->Unpack(e, kSymmetric), kOk);
    EXPECT_EQ(FromHost(this->matrix_),
              Matrix<T>(3, 3, {e[0], Conjugate(e[1]), Conjugate(e[2]), e[1], e[3], Conjugate(e[4]), e[2], e[4], e[5]}));
}

TYPED_TEST(PackedTriangles, PackUndoesUnpack) {
    using T = TypeParam;
    for (int32_t n = 1; n <= 9; ++n) {
        const std::vector<T> elements = RandomMatrix<T>(1, n * (n + 1) / 2, 8).elements;
        for (const int32_t triangle : {kLower, kUpper, kSymmetric}) {
            ASSERT_EQ(this->Unpack(elements, triangle), kOk);
            ASSERT_EQ(this->Pack(this->matrix_, triangle), kOk);
            ASSERT_EQ(this->packed_.values(), elements) << n << ' ' << triangle;
        }
    }
}

TYPED_TEST(PackedTriangles, PackLooksAtItsTriangleOnly) {
    using T = TypeParam;
    const T nan = FromReal<T>(kQuietNaN);
    const std::vector<T> e = this->SixElements();
    const HostMatrix<T> lower(2, 2, {e[0], nan, e[1], e[2]}), upper(2, 2, {e[0], e[1], nan, e[2]});
    const std::vector<T> three(e.begin(), e.begin() + 3);
    EXPECT_EQ(this->Pack(lower, kLower), kOk);
    EXPECT_EQ(this->packed_.values(), three);
    EXPECT_EQ(this->Pack(lower, kSymmetric), kOk);
    EXPECT_EQ(this->packed_.values(), three);
    EXPECT_EQ(this->Pack(upper, kUpper), kOk);
    EXPECT_EQ(this->packed_.values(), three);
}

TYPED_TEST(PackedTriangles, UnpackChecksTheLengthBeforeTheTriangle) {
    using T = TypeParam;
    EXPECT_EQ(this->Unpack({}, 9), kEmptyInput);
    EXPECT_EQ(this->Unpack(std::vector<T>(5), 9), kNotSquare);
    EXPECT_EQ(this->Unpack(std::vector<T>(6), 9), kBadSelector);
    EXPECT_EQ(this->Unpack(std::vector<T>(6), -1), kBadSelector);
    const FailResize refusal;
    EXPECT_EQ(this->Unpack(std::vector<T>(6), kLower), kOutOfMemory);
}

TYPED_TEST(PackedTriangles, PackChecksTheShapeBeforeTheTriangle) {
    using T = TypeParam;
    HostMatrix<T> a(2, 3);
    EXPECT_EQ(this->Pack(a, kLower), kNotSquare);
    a.SetDimension(0, 0);
    EXPECT_EQ(this->Pack(a, 9), kNotSquare);
    a.SetDimension(1, 0);
    EXPECT_EQ(this->Pack(a, 9), kEmptyInput);
    a.SetDimension(0, -2);
    a.SetDimension(1, -2);
    EXPECT_EQ(this->Pack(a, kLower), kEmptyInput);
    EXPECT_EQ(this->Pack(HostMatrix<T>(2, 2), 3), kBadSelector);
    const FailResize refusal;
    EXPECT_EQ(this->Pack(HostMatrix<T>(2, 2), kLower), kOutOfMemory);
}

TYPED_TEST(PackedTriangles, TakeARecordAtAnyAddress) {
    using T = TypeParam;
    const HostArray<T> packed{FromReal<T>(3)};
    const KrTriangle record{packed.handle(), kLower};
    char memory[sizeof record + 1];
    std::memcpy(memory + 1, &record, sizeof record);
    this->ToMatrix(reinterpret_cast<const KrTriangle*>(memory + 1), this->matrix_.handle(), &this->err_);
    EXPECT_EQ(this->err_, kOk);
    EXPECT_EQ(this->matrix_(0, 0), FromReal<T>(3));
}

}  // namespace
}  // namespace krnumer

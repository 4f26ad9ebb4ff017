#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <limits>
#include <vector>

#include "frame/status.h"
#include "krnumer/linalg_svd.h"
#include "linalg/svd.h"
#include "linalg/test_matrices.h"
#include "support/host_arrays.h"
#include "support/numbers.h"

namespace krnumer {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

// The entry points of one element type.
template <class T>
struct Entries;
template <>
struct Entries<double> {
    static constexpr auto InPlace = SVD_head;
    static constexpr auto InForm = SVDEx_head;
    static constexpr auto Values = SVDS_head;
};
template <>
struct Entries<Complex> {
    static constexpr auto InPlace = CxSVD_head;
    static constexpr auto InForm = CxSVDEx_head;
    static constexpr auto Values = CxSVDS_head;
};

template <class T>
class SvdEntries : public testing::Test {
  protected:
    // `a` as the host has it.
    static HostMatrix<T> Host(const DenseMatrix<T>& a) { return HostMatrix<T>(a.rows, a.columns, a.elements); }

    // Every entry point on `a`, expecting the status and that all outputs are empty.
    static void ExpectFailure(const DenseMatrix<T>& a, int32_t status) {
        HostMatrix<T> in_place = Host(a), left(1, 2), right(2, 1);
        HostArray<T> mixed(3);
        HostArray<double> values(4);
        int32_t err = 77;
        EXPECT_EQ(Entries<T>::InPlace(in_place.handle(), mixed.handle(), right.handle(), &err), 0);
        EXPECT_EQ(err, status);
        EXPECT_THAT(in_place.values(), IsEmpty());
        EXPECT_EQ(in_place.rows() + in_place.columns() + right.rows() + right.columns() + mixed.size(), 0);

        HostMatrix<T> input = Host(a);
        for (const int32_t full : {0, 1}) {
            right = HostMatrix<T>(2, 1);
            EXPECT_EQ(Entries<T>::InForm(input.handle(), full, left.handle(), values.handle(), right.handle()), status);
            EXPECT_EQ(left.rows() + left.columns() + right.rows() + right.columns() + values.size(), 0);
        }

        values = HostArray<double>(4);
        err = 77;
        EXPECT_EQ(Entries<T>::Values(input.handle(), values.handle(), &err), 0);
        EXPECT_EQ(err, status);
        EXPECT_EQ(values.size(), 0);
        EXPECT_EQ(input.rows(), a.rows);
        EXPECT_EQ(input.columns(), a.columns);
    }
};

using Elements = testing::Types<double, Complex>;
TYPED_TEST_SUITE(SvdEntries, Elements);

TYPED_TEST(SvdEntries, DeliverWhatTheCoreComputes) {
    using T = TypeParam;
    for (const auto& [m, n] : {std::pair{4, 4}, {5, 3}, {3, 5}, {1, 4}, {4, 1}}) {
        const int32_t k = std::min(m, n);
        const DenseMatrix<T> a = RandomMatrix<T>(m, n, 11);
        DenseMatrix<T> u(m, k), v(n, k);
        std::vector<double> s(Count(k));
        ASSERT_EQ(SvdCore(a.data(), m, n, u.data(), s.data(), v.data(), false), kOk);

        HostMatrix<T> in_place = this->Host(a), right;
        HostArray<T> mixed;
        int32_t err = 77;
        EXPECT_EQ(Entries<T>::InPlace(in_place.handle(), mixed.handle(), right.handle(), &err), 0);
        EXPECT_EQ(err, 0);
        EXPECT_EQ(in_place.rows(), m);
        EXPECT_EQ(in_place.columns(), k);
        EXPECT_EQ(in_place.values(), u.elements);
        EXPECT_EQ(right.rows(), n);
        EXPECT_EQ(right.columns(), k);
        EXPECT_EQ(right.values(), v.elements);
        ASSERT_EQ(mixed.size(), k);
        for (int32_t i = 0; i < k; ++i) EXPECT_EQ(mixed[i], FromReal<T>(s[Count(i)]));

        HostMatrix<T> input = this->Host(a), left;
        HostArray<double> values;
        EXPECT_EQ(Entries<T>::InForm(input.handle(), 0, left.handle(), values.handle(), right.handle()), 0);
        EXPECT_EQ(left.values(), u.elements);
        EXPECT_EQ(right.values(), v.elements);
        EXPECT_EQ(values.values(), s);
        EXPECT_EQ(input.values(), a.elements);

        EXPECT_EQ(SvdValuesCore(a.data(), m, n, s.data()), kOk);
        values = HostArray<double>(9);
        EXPECT_EQ(Entries<T>::Values(input.handle(), values.handle(), &err), 0);
        EXPECT_EQ(err, 0);
        EXPECT_EQ(values.values(), s);
    }
}

TYPED_TEST(SvdEntries, TakeAnyOtherValueForTheFullForm) {
    using T = TypeParam;
    for (const auto& [m, n] : {std::pair{2, 5}, {5, 2}, {3, 3}}) {
        HostMatrix<T> input = this->Host(RandomMatrix<T>(m, n, 12)), left, right;
        HostArray<double> values;
        for (const int32_t full : {1, 2, -7, std::numeric_limits<int32_t>::min()}) {
            EXPECT_EQ(Entries<T>::InForm(input.handle(), full, left.handle(), values.handle(), right.handle()), 0);
            EXPECT_EQ(left.rows(), m);
            EXPECT_EQ(left.columns(), m);
            EXPECT_EQ(right.rows(), n);
            EXPECT_EQ(right.columns(), n);
            EXPECT_EQ(values.size(), std::min(m, n));
        }
    }
}

TYPED_TEST(SvdEntries, EmptyEverythingOnFailure) {
    using T = TypeParam;
    for (const auto& [m, n] : {std::pair{0, 0}, {0, 3}, {3, 0}}) this->ExpectFailure(DenseMatrix<T>(m, n), kEmptyInput);
    DenseMatrix<T> a = RandomMatrix<T>(3, 2, 13);
    a(2, 0) = FromReal<T>(kQuietNaN);
    this->ExpectFailure(a, kNotFinite);
    for (T& x : a.elements) x = FromReal<T>(1e308);
    this->ExpectFailure(a, kNoConvergence);
}

TYPED_TEST(SvdEntries, EmptyEverythingWhenTheHostRefuses) {
    using T = TypeParam;
    const DenseMatrix<T> a = RandomMatrix<T>(3, 2, 15);
    for (int32_t nth = 1; nth <= 3; ++nth) {
        HostMatrix<T> in_place = this->Host(a), left(1, 2), right(2, 1);
        HostArray<T> mixed(3);
        HostArray<double> values(4);
        int32_t err = 77;
        {
            const FailResize refusal(nth, -5);
            EXPECT_EQ(Entries<T>::InPlace(in_place.handle(), mixed.handle(), right.handle(), &err), 0);
            ASSERT_TRUE(refusal.happened());
        }
        EXPECT_EQ(err, kOutOfMemory);
        EXPECT_EQ(in_place.rows() + in_place.columns() + right.rows() + right.columns() + mixed.size(), 0);

        HostMatrix<T> input = this->Host(a);
        right = HostMatrix<T>(2, 1);
        {
            const FailResize refusal(nth, -5);
            EXPECT_EQ(Entries<T>::InForm(input.handle(), 0, left.handle(), values.handle(), right.handle()),
                      kOutOfMemory);
            ASSERT_TRUE(refusal.happened());
        }
        EXPECT_EQ(left.rows() + left.columns() + right.rows() + right.columns() + values.size(), 0);
    }
    HostMatrix<T> input = this->Host(a);
    HostArray<double> values(4);
    const FailResize refusal(1, -5);
    int32_t err = 77;
    EXPECT_EQ(Entries<T>::Values(input.handle(), values.handle(), &err), 0);
    EXPECT_EQ(err, kOutOfMemory);
    EXPECT_EQ(values.size(), 0);
}

TYPED_TEST(SvdEntries, DecomposeIntoAnArrayThatIsTheInput) {
    using T = TypeParam;
    const DenseMatrix<T> a = RandomMatrix<T>(4, 4, 14);
    HostMatrix<T> separate = this->Host(a), both = this->Host(a), left, right, right_again;
    HostArray<double> values, values_again;
    EXPECT_EQ(Entries<T>::InForm(separate.handle(), 0, left.handle(), values.handle(), right.handle()), 0);
    EXPECT_EQ(Entries<T>::InForm(both.handle(), 0, both.handle(), values_again.handle(), right_again.handle()), 0);
    EXPECT_EQ(both.values(), left.values());
    EXPECT_EQ(values_again.values(), values.values());
    EXPECT_EQ(right_again.values(), right.values());
}

TEST(CxSVD_head, GivesComplexValuesWithoutImaginaryPart) {
    HostMatrix<Complex> a(2, 2, {{0, 2}, {0, 0}, {0, 0}, {3, 4}});
    HostMatrix<Complex> v;
    HostArray<Complex> s;
    const ResizeLog resizes;
    int32_t err = 77;
    EXPECT_EQ(CxSVD_head(a.handle(), s.handle(), v.handle(), &err), 0);
    ASSERT_EQ(s.size(), 2);
    EXPECT_THAT(s[0], Near(Complex{5, 0}, 1e-15));
    EXPECT_THAT(s[1], Near(Complex{2, 0}, 1e-15));
    EXPECT_EQ(s[0].im, 0.0);
    EXPECT_EQ(s[1].im, 0.0);
    for (int32_t i = 0; i < resizes.size(); ++i) EXPECT_EQ(resizes[i].typeCode, 13);
}

TEST(SVDS_head, GivesZeroForTheZeroMatrix) {
    HostMatrix<double> a(3, 2);
    HostArray<double> s;
    int32_t err = 77;
    EXPECT_EQ(SVDS_head(a.handle(), s.handle(), &err), 0);
    EXPECT_EQ(err, 0);
    EXPECT_THAT(s.values(), ElementsAre(0.0, 0.0));
}

}  // namespace
}  // namespace krnumer

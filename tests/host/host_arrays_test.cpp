// The array classes that all other tests use.

#include "support/host_arrays.h"

namespace krnumer {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

// 20 bytes without padding, as records stand in an array.
#pragma pack(push, 4)
struct Record {
    double low, high;
    int32_t closed;
};
#pragma pack(pop)
static_assert(sizeof(Record) == 20);

TEST(HostArray, HoldsEveryKindOfElement) {
    const LeakCheck leaks;
    EXPECT_THAT((HostArray<int32_t>{-1, 2}.values()), ElementsAre(-1, 2));
    EXPECT_THAT((HostArray<uint32_t>{1, UINT32_MAX}.values()), ElementsAre(1, UINT32_MAX));
    EXPECT_THAT((HostArray<uint8_t>{1, 255}.values()), ElementsAre(1, 255));
    EXPECT_THAT((HostArray<double>{0.5, -1}.values()), ElementsAre(0.5, -1));
    EXPECT_THAT((HostArray<Complex>{{1, 2}, {3, 4}}.values()), ElementsAre(Complex{1, 2}, Complex{3, 4}));
    EXPECT_THAT(HostArray<double>(std::vector<double>{1, 2}).values(), ElementsAre(1, 2));
}

TEST(HostArray, HoldsPackedRecords) {
    HostArray<Record> x{{1, 2, 3}, {4, 5, 6}};
    EXPECT_EQ(KrrtBytes(x.handle()), 44U);
    x.Set(0, {7, 8, 9});
    EXPECT_EQ(Record(x[0]).high, 8);
    EXPECT_EQ(Record(x[1]).closed, 6);
}

TEST(HostArray, StartsEmptyOrAsZeros) {
    const HostArray<double> none;
    EXPECT_NE(none.handle(), nullptr);
    EXPECT_TRUE(none.empty());
    EXPECT_THAT(none.values(), IsEmpty());
    EXPECT_THAT(HostArray<double>(3).values(), ElementsAre(0, 0, 0));
    EXPECT_TRUE(HostMatrix<double>().empty());
    EXPECT_TRUE(HostCube<double>().empty());
    EXPECT_FALSE(HostMatrix<double>(0, 3).empty()) << "empty arrays have 0 in all their dimension words";
}

TEST(HostArray, MovesWithoutACopy) {
    const LeakCheck leaks;
    HostArray<double> x{1, 2};
    KrHandle const handle = x.handle();
    HostArray<double> y(std::move(x));
    EXPECT_EQ(y.handle(), handle);
    HostArray<double> z{3};
    z = std::move(y);
    EXPECT_EQ(z.handle(), handle);
    EXPECT_THAT(z.values(), ElementsAre(1, 2));
}

TEST(HostMatrix, GoesRowAfterRow) {
    HostMatrix<double> m(2, 3, {1, 2, 3, 4, 5, 6});
    EXPECT_EQ(m.rows(), 2);
    EXPECT_EQ(m.columns(), 3);
    EXPECT_EQ(m(1, 0), 4);
    m.Set(0, 2, 9);
    EXPECT_THAT(m.values(), ElementsAre(1, 2, 9, 4, 5, 6));
}

TEST(HostCube, GoesPageAfterPage) {
    HostCube<int32_t> c(2, 1, 3, {1, 2, 3, 4, 5, 6});
    EXPECT_EQ(c.pages(), 2);
    EXPECT_EQ(c.rows(), 1);
    EXPECT_EQ(c.columns(), 3);
    EXPECT_EQ(c(1, 0, 2), 6);
    c.Set(1, 0, 0, 9);
    EXPECT_THAT(c.values(), ElementsAre(1, 2, 3, 9, 5, 6));
}

TEST(HostArrays, AreReadAtEveryAlignment) {
    const LeastAlignment guard;
    EXPECT_THAT((HostArray<double>{1, 2}.values()), ElementsAre(1, 2));
    EXPECT_EQ((HostMatrix<double>(1, 2, {1, 2})(0, 1)), 2);
    EXPECT_EQ((HostArray<Complex>{{1, 2}}[0]), (Complex{1, 2}));
}

TEST(HostArrays, RefuseAccessBeyondTheirElements) {
    HostArray<double> x{1, 2};
    EXPECT_THROW(x[2], std::out_of_range);
    EXPECT_THROW(x[-1], std::out_of_range);
    EXPECT_THROW(x.Set(2, 0.0), std::out_of_range);
    HostMatrix<double> m(2, 2);
    EXPECT_THROW(m(0, 2), std::out_of_range);
    EXPECT_THROW(m(2, 0), std::out_of_range);
    EXPECT_THROW(m(-1, 0), std::out_of_range);
    EXPECT_THROW((HostMatrix<double>(2, 2, {1, 2, 3})), std::length_error);
    EXPECT_THROW(HostArray<double>(-1), std::bad_alloc);
}

TEST(HostArrays, RefuseToReadMoreThanTheBlockHolds) {
    HostArray<double> x{1, 2};
    x.SetDimension(0, 3);
    EXPECT_THROW(x.values(), std::length_error);
    x.SetDimension(0, INT32_MAX);
    EXPECT_THROW(x.values(), std::length_error);
    x.SetDimension(0, -1);
    EXPECT_THAT(x.values(), IsEmpty());

    HostCube<double> c(1, 1, 1);
    for (int32_t i = 0; i < 3; ++i) c.SetDimension(i, INT32_MAX);
    EXPECT_THROW(c.values(), std::length_error);
    c.SetDimension(2, 0);
    EXPECT_THAT(c.values(), IsEmpty());
}

}  // namespace
}  // namespace krnumer

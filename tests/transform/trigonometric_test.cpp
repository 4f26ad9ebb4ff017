// Cosine, sine, Hilbert and Hartley transforms, through their exports.

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cmath>

#include "frame/status.h"
#include "krnumer/transform.h"
#include "support/host_arrays.h"
#include "transform/samples.h"

namespace krnumer {
namespace {

using Values = std::vector<double>;

void ExpectNear(const Values& actual, const Values& expected, double tolerance) {
    ASSERT_EQ(actual.size(), expected.size());
    for (size_t i = 0; i < actual.size(); ++i) EXPECT_NEAR(actual[i], expected[i], tolerance) << "element " << i;
}

class Transforms : public testing::Test {
  protected:
    LeakCheck leaks_;
    HostInstance instance_;
    void* slot_ = nullptr;
    void* other_slot_ = nullptr;
    HostArray<double> y_{9};
    HostMatrix<double> m_{1, 1, {9.0}};

    Values Line(int32_t (*transform)(KrHandle, KrHandle, int32_t, void**), const Values& x, int32_t size = 0) {
        EXPECT_EQ(transform(HostArray<double>(x).handle(), y_.handle(), size, &slot_), 0);
        return y_.values();
    }
    Values Inverse(int32_t (*transform)(KrHandle, KrHandle, void**), const Values& x) {
        EXPECT_EQ(transform(HostArray<double>(x).handle(), y_.handle(), &slot_), 0);
        return y_.values();
    }
    Values InPlace(int32_t (*transform)(KrHandle, void**), const Values& x) {
        HostArray<double> samples(x);
        EXPECT_EQ(transform(samples.handle(), &slot_), 0);
        return samples.values();
    }
    Values Matrix(int32_t (*transform)(KrHandle, KrHandle, int32_t, int32_t, void**, void**), int32_t rows,
                  int32_t columns, const Values& x, int32_t to_rows = 0, int32_t to_columns = 0) {
        EXPECT_EQ(transform(HostMatrix<double>(rows, columns, x).handle(), m_.handle(), to_rows, to_columns, &slot_,
                            &other_slot_),
                  0);
        return m_.values();
    }
    Values InverseMatrix(int32_t (*transform)(KrHandle, KrHandle, void**, void**), int32_t rows, int32_t columns,
                         const Values& x) {
        EXPECT_EQ(transform(HostMatrix<double>(rows, columns, x).handle(), m_.handle(), &slot_, &other_slot_), 0);
        return m_.values();
    }
};

TEST_F(Transforms, AgreeWithSciPy) {
    for (const auto& one : Reference("dct")) ExpectNear(Line(DCT_1DH, one.input), one.output, 1e-14);
    for (const auto& one : Reference("dst")) ExpectNear(Line(DST_1DH, one.input), one.output, 1e-13);
    for (const auto& one : Reference("hilbert"))
        ExpectNear(InPlace(FastHilbertTransformH, one.input), one.output, 1e-14);
    for (const auto& one : Reference("hartley")) ExpectNear(InPlace(FHTH, one.input), one.output, 1e-13);
    for (const auto& one : Reference("dct2"))
        ExpectNear(Matrix(DCT_2DH, one.rows, one.columns, one.input), one.output, 1e-14);
    for (const auto& one : Reference("dst2"))
        ExpectNear(Matrix(DST_2DH, one.rows, one.columns, one.input), one.output, 1e-13);
}

TEST_F(Transforms, AreUndoneByTheirInverses) {
    for (const int32_t n : {1, 2, 3, 6, 7, 13, 64, 100, 255, 500, 997}) {
        const Values x = RandomReals(n);
        ExpectNear(Inverse(InvDCT_1DH, Line(DCT_1DH, x)), x, 1e-13);
        ExpectNear(Inverse(InvDST_1DH, Line(DST_1DH, x)), x, 1e-12);
        ExpectNear(InPlace(InvFHTH, InPlace(FHTH, x)), x, 1e-13);
    }
    for (const auto& [rows, columns] : {std::pair{1, 1}, {1, 6}, {5, 1}, {4, 6}, {5, 6}, {9, 7}, {30, 31}}) {
        const Values x = RandomReals(rows * columns);
        ExpectNear(InverseMatrix(InvDCT_2DH, rows, columns, Matrix(DCT_2DH, rows, columns, x)), x, 1e-13);
        ExpectNear(InverseMatrix(InvDST_2DH, rows, columns, Matrix(DST_2DH, rows, columns, x)), x, 1e-12);
    }
}

TEST_F(Transforms, PadAndTruncate) {
    const Values x = RandomReals(6);
    for (const int32_t size : {1, 2, 5, 7, 8, 20}) {
        Values resized = x;
        resized.resize(static_cast<size_t>(size));
        EXPECT_EQ(Line(DCT_1DH, x, size), Line(DCT_1DH, resized));
        EXPECT_EQ(Line(DST_1DH, x, size), Line(DST_1DH, resized));
    }
    EXPECT_EQ(Line(DCT_1DH, x, -3), Line(DCT_1DH, x));
    // 2 by 3 into 3 by 2
    const Values corner{x[0], x[1], x[3], x[4], 0, 0};
    EXPECT_EQ(Matrix(DCT_2DH, 2, 3, x, 3, 2), Matrix(DCT_2DH, 3, 2, corner));
    EXPECT_EQ(Matrix(DST_2DH, 2, 3, x, 3, 2), Matrix(DST_2DH, 3, 2, corner));
    EXPECT_EQ(m_.rows(), 3);
    EXPECT_EQ(m_.columns(), 2);
    EXPECT_EQ(Matrix(DCT_2DH, 2, 3, x, 0, 5).size(), 10u);
}

TEST_F(Transforms, HilbertLosesTheMeanAndTheHighestLine) {
    for (const double value : InPlace(FastHilbertTransformH, Values(7, 3.0))) EXPECT_NEAR(value, 0.0, 1e-15);
    EXPECT_EQ(InPlace(FastHilbertTransformH, {5.0}), Values{0.0});
    for (const int32_t n : {2, 5, 8, 97, 100}) {
        Values x = RandomReals(n);
        double mean = 0.0;
        double highest = 0.0;
        for (int32_t i = 0; i < n; ++i) {
            mean += x[static_cast<size_t>(i)] / n;
            highest += x[static_cast<size_t>(i)] * (i % 2 == 0 ? 1.0 : -1.0) / n;
        }
        const Values back = InPlace(InvFastHilbertTransformH, InPlace(FastHilbertTransformH, x));
        for (int32_t i = 0; i < n; ++i) {
            x[static_cast<size_t>(i)] -= mean;
            if (n % 2 == 0) x[static_cast<size_t>(i)] -= highest * (i % 2 == 0 ? 1.0 : -1.0);
        }
        ExpectNear(back, x, 1e-13);
    }
}

TEST_F(Transforms, HartleyLeavesASingleSample) {
    EXPECT_EQ(InPlace(FHTH, {5.0}), Values{5.0});
    EXPECT_EQ(InPlace(InvFHTH, {5.0}), Values{5.0});
}

TEST_F(Transforms, RefuseNothing) {
    HostArray<double> none;
    for (const auto transform : {DCT_1DH, DST_1DH}) {
        EXPECT_EQ(transform(none.handle(), y_.handle(), 4, &slot_), kEmptyInput);
        EXPECT_TRUE(y_.empty());
    }
    for (const auto transform : {InvDCT_1DH, InvDST_1DH})
        EXPECT_EQ(transform(none.handle(), y_.handle(), &slot_), kEmptyInput);
    for (const auto transform : {FastHilbertTransformH, InvFastHilbertTransformH, FHTH, InvFHTH})
        EXPECT_EQ(transform(none.handle(), &slot_), kEmptyInput);
    HostMatrix<double> no_rows(0, 3);
    HostMatrix<double> no_columns(3, 0);
    for (const HostMatrix<double>* x : {&no_rows, &no_columns}) {
        EXPECT_EQ(DCT_2DH(x->handle(), m_.handle(), 2, 2, &slot_, &other_slot_), kEmptyInput);
        EXPECT_TRUE(m_.empty());
        EXPECT_EQ(DST_2DH(x->handle(), m_.handle(), 2, 2, &slot_, &other_slot_), kEmptyInput);
        EXPECT_EQ(InvDCT_2DH(x->handle(), m_.handle(), &slot_, &other_slot_), kEmptyInput);
        EXPECT_EQ(InvDST_2DH(x->handle(), m_.handle(), &slot_, &other_slot_), kEmptyInput);
    }
    EXPECT_EQ(slot_, nullptr) << "nothing was bound";
}

TEST_F(Transforms, KeepTheOutputOnlyWhereAForwardLineCannotBeSized) {
    HostArray<double> x{1, 2, 3};
    const FailResize forward(1, 4711);
    EXPECT_EQ(DCT_1DH(x.handle(), y_.handle(), 0, &slot_), kOutOfMemory);
    EXPECT_EQ(y_.size(), 1);
    EXPECT_EQ(slot_, nullptr) << "the size comes before the table";
    const FailResize inverse(1, 4711);
    EXPECT_EQ(InvDCT_1DH(x.handle(), y_.handle(), &slot_), kOutOfMemory);
    EXPECT_TRUE(y_.empty());
    HostMatrix<double> m(1, 2, {1, 2});
    const FailResize matrix(1, 4711);
    EXPECT_EQ(DST_2DH(m.handle(), m_.handle(), 0, 0, &slot_, &other_slot_), kOutOfMemory);
    EXPECT_TRUE(m_.empty());
    EXPECT_NE(other_slot_, nullptr) << "the tables come before the size";
}

TEST_F(Transforms, OfLengthsWithoutTableFail) {
    HostArray<double> x{1, 2, 3};
    EXPECT_EQ(DST_1DH(x.handle(), y_.handle(), INT32_MAX, &slot_), kOutOfMemory);
}

TEST_F(Transforms, MayBeDoneInPlace) {
    const Values x = RandomReals(10);
    const Values expected = Line(DCT_1DH, x);
    HostArray<double> both(x);
    EXPECT_EQ(DCT_1DH(both.handle(), both.handle(), 0, &slot_), 0);
    EXPECT_EQ(both.values(), expected);
}

}  // namespace
}  // namespace krnumer

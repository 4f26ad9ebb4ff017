#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <limits>
#include <vector>

#include "fft/samples.h"
#include "frame/status.h"
#include "krnumer/fft.h"
#include "support/host_arrays.h"

namespace krnumer {
namespace {

using testing::ElementsAre;

constexpr int32_t kHostRefusal = 77;
constexpr double kNaN = std::numeric_limits<double>::quiet_NaN();
constexpr double kTolerance = 1e-14;

class Fft2dEntry : public testing::Test {
  protected:
    HostInstance instance;
    void* columns = nullptr;
    void* rows = nullptr;
};

size_t Index(int32_t row, int32_t column, int32_t width) {
    return static_cast<size_t>(row) * static_cast<size_t>(width) + static_cast<size_t>(column);
}

// Rows by columns, row after row.
std::vector<LongComplex> Reference2d(std::vector<LongComplex> x, int32_t height, int32_t width) {
    for (int32_t i = 0; i < height; ++i) {
        const auto row = x.begin() + static_cast<std::ptrdiff_t>(Index(i, 0, width));
        const std::vector<LongComplex> y = LongDft({row, row + width});
        std::copy(y.begin(), y.end(), row);
    }
    for (int32_t c = 0; c < width; ++c) {
        std::vector<LongComplex> column;
        for (int32_t i = 0; i < height; ++i) column.push_back(x[Index(i, c, width)]);
        column = LongDft(column);
        for (int32_t i = 0; i < height; ++i) x[Index(i, c, width)] = column[static_cast<size_t>(i)];
    }
    return x;
}

std::vector<LongComplex> Shifted2d(const std::vector<LongComplex>& x, int32_t height, int32_t width) {
    std::vector<LongComplex> y(x.size());
    for (int32_t i = 0; i < height; ++i)
        for (int32_t c = 0; c < width; ++c)
            y[Index((i + height / 2) % height, (c + width / 2) % width, width)] = x[Index(i, c, width)];
    return y;
}

// A corner of the samples, cut or padded with zeros.
template <class T>
std::vector<LongComplex> Section2d(const std::vector<T>& x, int32_t source_height, int32_t source_width, int32_t row,
                                   int32_t column, int32_t height, int32_t width) {
    std::vector<LongComplex> y(Index(height, 0, width));
    for (int32_t i = 0; i < std::min(height, source_height - row); ++i) {
        for (int32_t c = 0; c < std::min(width, source_width - column); ++c) {
            const T value = x[Index(row + i, column + c, source_width)];
            if constexpr (std::is_same_v<T, Complex>) {
                y[Index(i, c, width)] = {value.re, value.im};
            } else {
                y[Index(i, c, width)] = value;
            }
        }
    }
    return y;
}

TEST_F(Fft2dEntry, AgreesWithTheDefinition) {
    for (const auto& [r, c] : std::vector<std::pair<int32_t, int32_t>>{
             {1, 1}, {1, 7}, {6, 1}, {2, 3}, {4, 4}, {5, 8}, {9, 12}, {16, 10}, {23, 17}, {20, 53}}) {
        const std::vector<Complex> x = RandomComplex(r * c);
        const std::vector<double> real = RandomReal(r * c);
        const HostMatrix<Complex> in(r, c, x);
        const HostMatrix<double> in_real(r, c, real);
        const std::vector<LongComplex> expected = Reference2d(Widened(x), r, c);
        const std::vector<LongComplex> expected_real = Reference2d({real.begin(), real.end()}, r, c);
        for (int32_t shift : {0, 1}) {
            const auto placed = [&, r = r, c = c](const auto& z) { return shift != 0 ? Shifted2d(z, r, c) : z; };
            HostMatrix<Complex> out, back;
            HostMatrix<double> real_back;
            ASSERT_EQ(CxFFT2D_H(in.handle(), 0, 0, r, c, shift, out.handle(), &columns, &rows), kOk);
            ASSERT_EQ(out.rows(), r);
            ASSERT_EQ(out.columns(), c);
            EXPECT_LT(RelativeError(out.values(), placed(expected)), kTolerance) << r << " by " << c;
            ASSERT_EQ(CxInvFFT2D_H(out.handle(), shift, back.handle(), &columns, &rows), kOk);
            EXPECT_LT(RelativeError(back.values(), x), kTolerance) << r << " by " << c;

            ASSERT_EQ(ReFFT2D_H(in_real.handle(), 0, 0, r, c, shift, out.handle(), &columns, &rows), kOk);
            EXPECT_LT(RelativeError(out.values(), placed(expected_real)), kTolerance) << r << " by " << c;
            ASSERT_EQ(ReInvFFT2D_H(out.handle(), shift, real_back.handle(), &columns, &rows), kOk);
            ASSERT_EQ(real_back.rows(), r);
            ASSERT_EQ(real_back.columns(), c);
            for (int32_t i = 0; i < r; ++i)
                for (int32_t j = 0; j < c; ++j) EXPECT_NEAR(real_back(i, j), real[Index(i, j, c)], 20 * kTolerance);
        }
        EXPECT_EQ(in.values(), x);
    }
}

TEST_F(Fft2dEntry, CutsAndPadsItsSamples) {
    const std::vector<Complex> x = RandomComplex(6 * 5);
    const std::vector<double> real = RandomReal(6 * 5);
    const HostMatrix<Complex> in(6, 5, x);
    const HostMatrix<double> in_real(6, 5, real);
    for (int32_t row : {0, 2, 5}) {
        for (int32_t column : {0, 1, 4}) {
            for (const auto& [r, c] :
                 std::vector<std::pair<int32_t, int32_t>>{{1, 1}, {3, 2}, {8, 3}, {4, 9}, {9, 10}}) {
                HostMatrix<Complex> out;
                ASSERT_EQ(CxFFT2D_H(in.handle(), row, column, r, c, 0, out.handle(), &columns, &rows), kOk);
                EXPECT_LT(RelativeError(out.values(), Reference2d(Section2d(x, 6, 5, row, column, r, c), r, c)),
                          kTolerance);
                ASSERT_EQ(ReFFT2D_H(in_real.handle(), row, column, r, c, 0, out.handle(), &columns, &rows), kOk);
                EXPECT_LT(RelativeError(out.values(), Reference2d(Section2d(real, 6, 5, row, column, r, c), r, c)),
                          kTolerance);
            }
        }
    }
}

TEST_F(Fft2dEntry, GivesASingleSampleItself) {
    const HostMatrix<Complex> in(2, 2, {{1, 2}, {3, 4}, {5, 6}, {7, 8}});
    const HostMatrix<double> real(2, 2, {1, 2, 3, 4});
    HostMatrix<Complex> out;
    ASSERT_EQ(CxFFT2D_H(in.handle(), 1, 0, 1, 1, 1, out.handle(), &columns, &rows), kOk);
    EXPECT_THAT(out.values(), ElementsAre(Complex{5, 6}));
    ASSERT_EQ(ReFFT2D_H(real.handle(), 1, 1, 1, 1, 0, out.handle(), &columns, &rows), kOk);
    EXPECT_THAT(out.values(), ElementsAre(Complex{4, 0}));
}

TEST_F(Fft2dEntry, RefusesBadArgumentsInOrder) {
    const HostMatrix<Complex> none, some(2, 3);
    const HostMatrix<double> none_real, some_real(2, 3);
    HostMatrix<Complex> out(1, 1, {{9, 8}});
    HostMatrix<double> out_real(1, 1, {5});
    const auto complex = [&](const HostMatrix<Complex>& x, int32_t row, int32_t column, int32_t r, int32_t c) {
        return CxFFT2D_H(x.handle(), row, column, r, c, 0, out.handle(), &columns, &rows);
    };
    const auto real = [&](const HostMatrix<double>& x, int32_t row, int32_t column, int32_t r, int32_t c) {
        return ReFFT2D_H(x.handle(), row, column, r, c, 0, out.handle(), &columns, &rows);
    };
    EXPECT_EQ(complex(none, 9, 9, 0, 0), kEmptyInput);
    EXPECT_EQ(real(none_real, 9, 9, 0, 0), kEmptyInput);
    EXPECT_EQ(complex(some, 2, 0, 0, 0), kBadIndex);
    EXPECT_EQ(complex(some, 0, 3, 0, 0), kBadIndex);
    EXPECT_EQ(real(some_real, 2, 0, 0, 0), kBadIndex);
    EXPECT_EQ(complex(some, 1, 2, 0, 1), kBadDimension);
    EXPECT_EQ(complex(some, -1, 2, 1, 0), kBadDimension);
    EXPECT_EQ(real(some_real, -1, 2, 1, -3), kBadDimension);
    EXPECT_EQ(CxInvFFT2D_H(none.handle(), 0, out.handle(), &columns, &rows), kEmptyInput);
    EXPECT_EQ(ReInvFFT2D_H(none.handle(), 0, out_real.handle(), &columns, &rows), kEmptyInput);
    EXPECT_THAT(out.values(), ElementsAre(Complex{9, 8}));
    EXPECT_THAT(out_real.values(), ElementsAre(5));
    EXPECT_EQ(columns, nullptr);
    EXPECT_EQ(rows, nullptr);
}

// The core finds them, when the slots are bound and the output has its size.
TEST_F(Fft2dEntry, FindsNegativeOffsetsLast) {
    const HostMatrix<Complex> in(2, 3);
    HostMatrix<Complex> out(1, 1, {{9, 8}});
    EXPECT_EQ(CxFFT2D_H(in.handle(), -1, 0, 2, 3, 0, out.handle(), &columns, &rows), kBadIndex);
    EXPECT_TRUE(out.empty());
    EXPECT_NE(columns, nullptr);
    EXPECT_NE(rows, nullptr);
    const HostMatrix<double> real(2, 3);
    HostMatrix<Complex> real_out(1, 1, {{9, 8}});
    EXPECT_EQ(ReFFT2D_H(real.handle(), 0, -1, 1, 1, 0, real_out.handle(), &columns, &rows), kBadIndex);
    EXPECT_TRUE(real_out.empty());
}

TEST_F(Fft2dEntry, BindsTheSlotOfTheRowsTransformFirst) {
    const HostMatrix<Complex> in(4, 6);
    HostMatrix<Complex> out;
    ASSERT_EQ(CxFFT2D_H(in.handle(), 0, 0, 5, 7, 0, out.handle(), &columns, &rows), kOk);
    EXPECT_EQ(**static_cast<int32_t**>(columns), 7);  // length of the table along the rows
    EXPECT_EQ(**static_cast<int32_t**>(rows), 5);
    EXPECT_EQ(instance.pending_cleanups(), 2);
}

TEST_F(Fft2dEntry, EmptiesItsOutputWhenTheHostRefuses) {
    const HostMatrix<Complex> in(2, 3);
    const HostMatrix<double> real(2, 3);
    const auto expect = [&](int32_t status, auto output, auto&& call) {
        const FailResize fail(1, kHostRefusal);
        EXPECT_EQ(call(output), status);
        EXPECT_TRUE(output.empty());
    };
    const auto complex_out = [] { return HostMatrix<Complex>(1, 1, {{9, 8}}); };
    expect(kHostRefusal, complex_out(),
           [&](auto& y) { return CxFFT2D_H(in.handle(), 0, 0, 2, 3, 0, y.handle(), &columns, &rows); });
    expect(kHostRefusal, complex_out(),
           [&](auto& y) { return ReFFT2D_H(real.handle(), 0, 0, 2, 3, 0, y.handle(), &columns, &rows); });
    expect(kHostRefusal, complex_out(),
           [&](auto& y) { return CxInvFFT2D_H(in.handle(), 0, y.handle(), &columns, &rows); });
    expect(kOutOfMemory, HostMatrix<double>(1, 1, {5}),
           [&](auto& y) { return ReInvFFT2D_H(in.handle(), 0, y.handle(), &columns, &rows); });
}

TEST_F(Fft2dEntry, RefusesMoreElementsThanAnInt32Counts) {
    const HostMatrix<Complex> in(1, 1, {{1, 0}});
    HostMatrix<Complex> out(1, 1, {{9, 8}});
    EXPECT_EQ(CxFFT2D_H(in.handle(), 0, 0, 65536, 65536, 0, out.handle(), &columns, &rows), kOutOfMemory);
    EXPECT_TRUE(out.empty());
}

TEST_F(Fft2dEntry, ReadsOneHalfOfHermitianColumns) {
    // Along the columns of a single-column spectrum.
    const HostMatrix<Complex> spectrum(4, 1, {{6, kNaN}, {1, 2}, {4, kNaN}, {kNaN, kNaN}});
    const HostMatrix<Complex> clean(4, 1, {{6, 0}, {1, 2}, {4, 0}, {1, -2}});
    HostMatrix<double> x, y;
    ASSERT_EQ(ReInvFFT2D_H(spectrum.handle(), 0, x.handle(), &columns, &rows), kOk);
    ASSERT_EQ(ReInvFFT2D_H(clean.handle(), 0, y.handle(), &columns, &rows), kOk);
    EXPECT_EQ(x.values(), y.values());
}

TEST_F(Fft2dEntry, TransformsASquareThroughOneSlot) {
    const std::vector<Complex> x = RandomComplex(36);
    const HostMatrix<Complex> in(6, 6, x);
    HostMatrix<Complex> out;
    ASSERT_EQ(CxFFT2D_H(in.handle(), 0, 0, 6, 6, 0, out.handle(), &rows, &rows), kOk);
    EXPECT_LT(RelativeError(out.values(), Reference2d(Widened(x), 6, 6)), kTolerance);
}

}  // namespace
}  // namespace krnumer

#include "sigop/convolution2d.h"

#include <algorithm>
#include <type_traits>

#include "frame/scratch.h"
#include "frame/status.h"
#include "sigop/direct_convolution.h"
#include "sigop/spectrum.h"

namespace krnumer {
namespace {

// Neighbouring columns of a plane.
template <class T>
struct Columns {
    using Value = T;

    T Get(int32_t row, int32_t column) const { return data[row * stride + column]; }
    void Set(int32_t row, int32_t column, T value) const { data[row * stride + column] = value; }

    T* data;
    ptrdiff_t stride;
};

// Neighbouring complex columns of rows in half-complex form: their imaginary parts stand in the opposite order.
struct HalfComplexColumns {
    using Value = Complex;

    Complex Get(int32_t row, int32_t column) const { return {re[row * stride + column], im[row * stride - column]}; }
    void Set(int32_t row, int32_t column, Complex value) const {
        re[row * stride + column] = value.re;
        im[row * stride - column] = value.im;
    }

    double* re;
    double* im;
    ptrdiff_t stride;
};

// Convolves rows in the frequency domain along columns, x in place.
class ColumnConvolution {
  public:
    static constexpr int32_t kTogether = 8;  // columns, so that lines of the cache are used whole

    ColumnConvolution(int32_t rx, int32_t ry)
        : rx_(rx), ry_(ry), rows_(FullLength(rx, ry)), table_(rows_), work_((2 * kTogether + 2) * Count(rows_)) {}

    explicit operator bool() const { return table_ && work_; }

    // `count` columns, at most kTogether.
    template <class Columns>
    int32_t Run(Columns x, Columns y, int32_t count) {
        using T = typename Columns::Value;
        const ptrdiff_t length = rows_;
        T* const x_lines = reinterpret_cast<T*>(work_.data());
        T* const y_lines = x_lines + kTogether * length;
        T* const a = y_lines + kTogether * length;
        T* const b = a + length;
        Gather(x, rx_, count, x_lines);
        Gather(y, ry_, count, y_lines);
        for (int32_t c = 0; c < count; ++c) {
            T* const x_line = x_lines + c * length;
            T* const y_line = y_lines + c * length;
            if (const int32_t status = Forward(table_.get(), x_line, a, rows_)) return status;
            if (const int32_t status = Forward(table_.get(), y_line, b, rows_)) return status;
            if (const int32_t status = InverseOfProduct(table_.get(), a, b, rows_, y_line, x_line, rows_))
                return status;
        }
        for (int32_t r = 0; r < rows_; ++r)
            for (int32_t c = 0; c < count; ++c) x.Set(r, c, x_lines[c * length + r]);
        return kOk;
    }

  private:
    template <class Columns, class T>
    void Gather(Columns columns, int32_t rows, int32_t count, T* lines) const {
        const ptrdiff_t length = rows_;
        for (int32_t r = 0; r < rows; ++r)
            for (int32_t c = 0; c < count; ++c) lines[c * length + r] = columns.Get(r, c);
        for (int32_t c = 0; c < count; ++c) std::fill(lines + c * length + rows, lines + (c + 1) * length, T{});
    }

    int32_t rx_;
    int32_t ry_;
    int32_t rows_;
    HeldTable table_;
    Scratch<Complex> work_;
};

// The part of a full plane that is kept.
struct Crop {
    int32_t row, column;
    PlaneSize size;
};

template <class T>
Crop CropOf(Plane<T> x, Plane<T> y, int32_t output_size) {
    const PlaneSize size = OutputSize({x.rows, x.columns}, {y.rows, y.columns}, output_size);
    switch (output_size) {
        case kSameOutput:
            return {y.rows / 2, y.columns / 2, size};
        case kValidOutput:
            return {y.rows - 1, y.columns - 1, size};
        default:
            return {0, 0, size};
    }
}

// Rows, zeros added up to n columns, to their spectra.
template <class T>
int32_t TransformRows(Plane<T> plane, const HeldTable& table, int32_t n, T* padded, T* spectra) {
    for (int32_t r = 0; r < plane.rows; ++r) {
        CopyPadded(plane.data + ptrdiff_t{r} * plane.columns, plane.columns, padded, n);
        if (const int32_t status = Forward(table.get(), padded, spectra + ptrdiff_t{r} * n, n)) return status;
    }
    return kOk;
}

// A spectrum of n values in a row, as columns of its own kind.
int32_t ConvolveColumns(ColumnConvolution& convolution, Complex* x, Complex* y, int32_t n) {
    int32_t status = kOk;
    for (int32_t c = 0; c < n && status == kOk; c += convolution.kTogether) {
        const int32_t count = std::min(n - c, convolution.kTogether);
        status = convolution.Run(Columns<Complex>{x + c, n}, Columns<Complex>{y + c, n}, count);
    }
    return status;
}
int32_t ConvolveColumns(ColumnConvolution& convolution, double* x, double* y, int32_t n) {
    int32_t status = convolution.Run(Columns<double>{x, n}, Columns<double>{y, n}, 1);
    const int32_t half = (n - 1) / 2;
    for (int32_t c = 1; c <= half && status == kOk; c += convolution.kTogether) {
        status = convolution.Run(HalfComplexColumns{x + c, x + (n - c), n}, HalfComplexColumns{y + c, y + (n - c), n},
                                 std::min(half - c + 1, convolution.kTogether));
    }
    if (n % 2 == 0 && status == kOk) {
        status = convolution.Run(Columns<double>{x + n / 2, n}, Columns<double>{y + n / 2, n}, 1);
    }
    return status;
}

// Sizes are taken as they are, whatever their factors.
template <class T>
int32_t ConvolveSpectra(Plane<T> x, Plane<T> y, Crop crop, T* z) {
    const int32_t rows = FullLength(x.rows, y.rows);
    const int32_t columns = FullLength(x.columns, y.columns);
    const HeldTable table(columns);
    ColumnConvolution convolution(x.rows, y.rows);
    Scratch<T> spectra_x(Count(rows) * Count(columns));
    Scratch<T> spectra_y(Count(y.rows) * Count(columns));
    Scratch<T> row(Count(columns));
    if (!table || !convolution || !spectra_x || !spectra_y || !row) return kOutOfMemory;

    if (const int32_t status = TransformRows(x, table, columns, row.data(), spectra_x.data())) return status;
    if (const int32_t status = TransformRows(y, table, columns, row.data(), spectra_y.data())) return status;
    if (const int32_t status = ConvolveColumns(convolution, spectra_x.data(), spectra_y.data(), columns)) return status;
    for (int32_t r = 0; r < crop.size.rows; ++r) {
        T* spectrum = spectra_x.data() + ptrdiff_t{crop.row + r} * columns;
        if (const int32_t status = Inverse(table.get(), spectrum, row.data(), columns)) return status;
        z = std::copy_n(row.data() + crop.column, crop.size.columns, z);
    }
    return kOk;
}

// The plane of fewer elements is the kernel.
template <class T>
int32_t ConvolveDirectly(Plane<T> x, Plane<T> y, Crop crop, T* z) {
    const int32_t columns = FullLength(x.columns, y.columns);
    const size_t elements = Count(FullLength(x.rows, y.rows)) * Count(columns);
    const bool cropped = Count(crop.size.rows) * Count(crop.size.columns) < elements;
    Scratch<T> scratch(cropped ? elements : 0);
    if (!scratch) return kOutOfMemory;
    T* full = cropped ? scratch.data() : z;
    if (Count(x.rows) * Count(x.columns) < Count(y.rows) * Count(y.columns)) {
        DirectConvolution(x, y, TapOrder::kAscending, full);
    } else {
        DirectConvolution(y, x, TapOrder::kAscending, full);
    }
    if (!cropped) return kOk;
    for (int32_t r = 0; r < crop.size.rows; ++r)
        z = std::copy_n(full + ptrdiff_t{crop.row + r} * columns + crop.column, crop.size.columns, z);
    return kOk;
}

template <class T>
int32_t Convolve(Plane<T> x, Plane<T> y, T* z, int32_t output_size, int32_t algorithm) {
    if (x.rows < 1 || x.columns < 1 || y.rows < 1 || y.columns < 1) return kEmptyInput;
    if (output_size == kValidOutput) {
        // Complex planes are compared rows to columns, each with itself: a wide one has no valid part.
        const bool fits = std::is_same_v<T, Complex> ? x.rows >= x.columns && y.rows >= y.columns
                                                     : x.rows >= y.rows && x.columns >= y.columns;
        if (!fits) return kBadDimension;
    }
    if (FullLength(x.rows, y.rows) < 0 || FullLength(x.columns, y.columns) < 0) return kOutOfMemory;
    const Crop crop = CropOf(x, y, output_size);
    switch (algorithm) {
        case kDirect:
            return ConvolveDirectly(x, y, crop, z);
        case kFrequencyDomain:
            return ConvolveSpectra(x, y, crop, z);
        default:
            return kBadSelector;
    }
}

template <class T>
int32_t Correlate(Plane<T> x, Plane<T> y, T* z, int32_t algorithm) {
    if (x.rows < 1 || x.columns < 1) return kEmptyInput;
    const size_t elements = Count(x.rows) * Count(x.columns);
    Scratch<T> reversed(elements);
    if (!reversed) return kOutOfMemory;
    CopyReversed(x.data, elements, reversed.data());
    return Convolve({reversed.data(), x.rows, x.columns}, y, z, kFullOutput, algorithm);
}

}  // namespace

int32_t Convolve2DReal(const double* x, int32_t rx, int32_t cx, const double* y, int32_t ry, int32_t cy, double* z,
                       int32_t output_size, int32_t algorithm) {
    return Convolve(Plane<double>{x, rx, cx}, Plane<double>{y, ry, cy}, z, output_size, algorithm);
}
int32_t Convolve2DComplex(const Complex* x, int32_t rx, int32_t cx, const Complex* y, int32_t ry, int32_t cy,
                          Complex* z, int32_t output_size, int32_t algorithm) {
    return Convolve(Plane<Complex>{x, rx, cx}, Plane<Complex>{y, ry, cy}, z, output_size, algorithm);
}

int32_t Correlate2DReal(const double* x, int32_t rx, int32_t cx, const double* y, int32_t ry, int32_t cy, double* z,
                        int32_t algorithm) {
    return Correlate(Plane<double>{x, rx, cx}, Plane<double>{y, ry, cy}, z, algorithm);
}
int32_t Correlate2DComplex(const Complex* x, int32_t rx, int32_t cx, const Complex* y, int32_t ry, int32_t cy,
                           Complex* z, int32_t algorithm) {
    return Correlate(Plane<Complex>{x, rx, cx}, Plane<Complex>{y, ry, cy}, z, algorithm);
}

}  // namespace krnumer

#include "fft/fft2d.h"

#include <algorithm>
#include <cstddef>
#include <type_traits>

#include "fft/half_complex.h"
#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"

namespace krnumer {
namespace {

// Columns that are gathered together, so that cache lines of the array are used whole.
constexpr int32_t kColumnsAtOnce = 8;

using ComplexTransform = decltype(ComplexFFT);

int32_t Transform(ComplexTransform* transform, const qmfft_table* table, const Complex* in, Complex* out, int32_t n) {
    return transform(table, &in->re, &in->im, &out->re, &out->im, 2, 2, n);
}

// How the columns of a pass are read and written.
struct ColumnPass {
    ComplexTransform* transform;
    const qmfft_table* table;
    int32_t rows, columns;
    int32_t used;           // rows that hold data; those below are taken for zero
    int32_t first_read;     // row of the sample 0: rows/2 for a shifted spectrum
    int32_t first_written;  // row of the value 0
};

// Row i of `rows` in the cyclic order that starts with row `first`.
ptrdiff_t CyclicRow(int32_t i, int32_t first, int32_t rows) {
    const int32_t left = rows - first;
    return i < left ? i + first : i - left;
}

// Columns start .. start + width - 1 of an array of `columns` columns, and where they are kept one behind the other.
struct ColumnBlock {
    int32_t rows, columns, start, width;

    size_t operator()(int32_t column, int32_t row) const { return Count(column) * Count(rows) + Count(row); }
};

// Reads the first `used` rows in the cyclic order that starts with row `first`.
void GatherColumns(const ColumnBlock& block, const Complex* x, int32_t first, int32_t used, Scratch<Complex>& to) {
    for (int32_t i = 0; i < used; ++i) {
        const Complex* row = x + CyclicRow(i, first, block.rows) * block.columns + block.start;
        for (int32_t c = 0; c < block.width; ++c) to[block(c, i)] = row[c];
    }
}

template <class T>
void ScatterColumns(const ColumnBlock& block, const Scratch<T>& from, int32_t first, T* y) {
    for (int32_t i = 0; i < block.rows; ++i) {
        T* row = y + CyclicRow(i, first, block.rows) * block.columns + block.start;
        for (int32_t c = 0; c < block.width; ++c) row[c] = from[block(c, i)];
    }
}

// Calls run(block) for all columns.
template <class Run>
int32_t ForEachBlock(int32_t rows, int32_t columns, Run run) {
    for (int32_t start = 0; start < columns; start += kColumnsAtOnce) {
        const ColumnBlock block{rows, columns, start, std::min(kColumnsAtOnce, columns - start)};
        if (const int32_t status = run(block)) return status;
    }
    return kOk;
}

size_t BlockSize(int32_t rows, int32_t columns) {
    return Count(rows) * Count(std::min(kColumnsAtOnce, columns));
}

// Transforms all columns of y in place.
int32_t TransformColumns(const ColumnPass& pass, Complex* y) {
    const size_t size = BlockSize(pass.rows, pass.columns);
    Scratch<Complex> in(size, Scratch<Complex>::kZeroed), out(size);
    if (!in || !out) return kOutOfMemory;
    return ForEachBlock(pass.rows, pass.columns, [&](const ColumnBlock& block) {
        GatherColumns(block, y, pass.first_read, pass.used, in);
        for (int32_t c = 0; c < block.width; ++c) {
            const size_t column = block(c, 0);
            if (const int32_t status = Transform(pass.transform, pass.table, &in[column], &out[column], pass.rows))
                return status;
        }
        ScatterColumns(block, out, pass.first_written, y);
        return kOk;
    });
}

// One row forward, shifted if asked for.
int32_t TransformRow(const qmfft_table* table, const Complex* in, int32_t shift, Complex* out, int32_t n) {
    if (const int32_t status = Transform(ComplexFFT, table, in, out, n)) return status;
    if (shift != 0) ShiftSpectrum(out, n);
    return kOk;
}

int32_t TransformRow(const qmfft_table* table, const double* in, int32_t shift, Complex* out, int32_t n) {
    if (const int32_t status = RealFFT(table, in, HalfComplexPart(out, n), 1, 1, n)) return status;
    ExpandHalfComplex(out, n, shift);
    return kOk;
}

// All rows back, into `out`.
int32_t InvertRows(const Complex* x, int32_t rows, int32_t columns, int32_t shift, Complex* out,
                   const qmfft_table* table) {
    Scratch<Complex> unshifted;
    if (shift != 0 && !unshifted.Allocate(Count(columns))) return kOutOfMemory;
    for (int32_t i = 0; i < rows; ++i) {
        const Complex* in = x + ptrdiff_t{i} * columns;
        if (shift != 0) {
            CopyUnshifted(in, columns, unshifted.data());
            in = unshifted.data();
        }
        if (const int32_t status = Transform(InverseComplexFFT, table, in, out + ptrdiff_t{i} * columns, columns))
            return status;
    }
    return kOk;
}

// Columns of the spectrum of a real array back into samples. One half of them says all.
int32_t InvertHermitianColumns(const Complex* x, int32_t rows, int32_t columns, int32_t shift, double* y,
                               const qmfft_table* table) {
    const size_t size = BlockSize(rows, columns);
    Scratch<Complex> spectra(size);
    Scratch<double> half_complex(Count(rows)), samples(size);
    if (!spectra || !half_complex || !samples) return kOutOfMemory;
    return ForEachBlock(rows, columns, [&](const ColumnBlock& block) {
        GatherColumns(block, x, shift != 0 ? rows / 2 : 0, rows / 2 + 1, spectra);
        for (int32_t c = 0; c < block.width; ++c) {
            const size_t column = block(c, 0);
            PackHalfComplex(&spectra[column], rows, 0, half_complex.data());
            if (const int32_t status = InverseRealFFT(table, half_complex.data(), &samples[column], 1, 1, rows))
                return status;
        }
        ScatterColumns(block, samples, 0, y);
        return kOk;
    });
}

}  // namespace

template <class T>
int32_t ForwardFFT2D(const T* x, const Section& s, int32_t shift, Complex* y, const Tables2D& tables) {
    if (s.row_offset < 0 || s.row_offset >= s.source_rows) return kBadIndex;
    if (s.column_offset < 0 || s.column_offset >= s.source_columns) return kBadIndex;
    const int32_t used = std::min(s.rows, s.source_rows - s.row_offset);
    const int32_t available = std::min(s.columns, s.source_columns - s.column_offset);
    Scratch<T> padded;
    if (available < s.columns && !padded.Allocate(Count(s.columns), padded.kZeroed)) return kOutOfMemory;
    for (int32_t i = 0; i < used; ++i) {
        const T* in = x + ptrdiff_t{s.row_offset + i} * s.source_columns + s.column_offset;
        if (padded) in = std::copy_n(in, available, padded.data()) - available;
        if (const int32_t status =
                TransformRow(tables.along_rows, in, shift, y + ptrdiff_t{i} * s.columns, s.columns)) {
            return status;
        }
    }
    const int32_t first = shift != 0 ? s.rows / 2 : 0;
    return TransformColumns({ComplexFFT, tables.along_columns, s.rows, s.columns, used, 0, first}, y);
}

template <class T>
int32_t InverseFFT2D(const Complex* x, int32_t rows, int32_t columns, int32_t shift, T* y, const Tables2D& tables) {
    if constexpr (std::is_same_v<T, Complex>) {
        if (const int32_t status = InvertRows(x, rows, columns, shift, y, tables.along_rows)) return status;
        const int32_t first = shift != 0 ? rows / 2 : 0;
        return TransformColumns({InverseComplexFFT, tables.along_columns, rows, columns, rows, first, 0}, y);
    } else {
        Scratch<Complex> half_done(Count(rows) * Count(columns));
        if (!half_done) return kOutOfMemory;
        if (const int32_t status = InvertRows(x, rows, columns, shift, half_done.data(), tables.along_rows))
            return status;
        return InvertHermitianColumns(half_done.data(), rows, columns, shift, y, tables.along_columns);
    }
}

template int32_t ForwardFFT2D(const double*, const Section&, int32_t, Complex*, const Tables2D&);
template int32_t ForwardFFT2D(const Complex*, const Section&, int32_t, Complex*, const Tables2D&);
template int32_t InverseFFT2D(const Complex*, int32_t, int32_t, int32_t, double*, const Tables2D&);
template int32_t InverseFFT2D(const Complex*, int32_t, int32_t, int32_t, Complex*, const Tables2D&);

}  // namespace krnumer

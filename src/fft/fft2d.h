// Two-dimensional transforms: along the rows, then along the columns. Arrays are row-major.
#pragma once

#include <cstdint>

#include "fft/fft.h"
#include "frame/complex.h"

namespace krnumer {

// The tables of both passes: rows have the length of table `along_rows`.
struct Tables2D {
    const qmfft_table* along_rows;
    const qmfft_table* along_columns;
};

// A section of an array of source_rows by source_columns, cut or padded with zeros to rows by columns.
struct Section {
    int32_t source_rows, source_columns;
    int32_t row_offset, column_offset;
    int32_t rows, columns;
};

// T is double or Complex. kBadIndex when an offset lies outside the array, kOutOfMemory.
template <class T>
int32_t ForwardFFT2D(const T* x, const Section& section, int32_t shift, Complex* y, const Tables2D& tables);

// T is Complex, or double for the spectrum of a real array. 0 or kOutOfMemory.
template <class T>
int32_t InverseFFT2D(const Complex* x, int32_t rows, int32_t columns, int32_t shift, T* y, const Tables2D& tables);

}  // namespace krnumer

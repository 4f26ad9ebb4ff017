// The drivers on data whose elements are adjacent: interleaved complex numbers, or doubles.
#pragma once

#include <cstddef>
#include <cstdint>

#include "fft/table.h"

namespace krnumer {

// Whether the last factor of a table has vector kernels, which is what the drivers ask for.
bool HasVectorLeaf(const qmfft_table* table);

// Forward transforms of the table's length, which is above 1; 0 or kOutOfMemory.
int32_t VectorComplexFFT(const qmfft_table* table, const double* in, double* out);
int32_t VectorRealFFT(const qmfft_table* table, const double* in, double* out);

// Twiddles in the order of the vector kernels: vector after vector of rows, and in each the r-1 columns. Rows of a
// complex stage start with 0, real and imaginary parts side by side; rows of a real stage start with 1 and end with
// m/2, real parts before imaginary ones. What is behind the last row is 1.
size_t PackedCountOfComplex(int32_t radix, int32_t m);
void PackComplexTwiddles(const double* re, const double* im, int32_t radix, int32_t m, double* packed);
size_t PackedCountOfReal(int32_t radix, int32_t m);
void PackRealTwiddles(const double* re, const double* im, int32_t radix, int32_t m, double* packed);

}  // namespace krnumer

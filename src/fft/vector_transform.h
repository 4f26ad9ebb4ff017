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

// Twiddles of factor i of a table, which combines blocks of length m, in the order in which transforms of elements T,
// Complex or double, take them.
template <class T>
size_t CountStageTwiddles(const qmfft_table* table, int32_t i, int32_t m);
template <class T>
void PackStageTwiddles(const qmfft_table* table, int32_t i, int32_t m, double* packed);

}  // namespace krnumer

// The drivers on data whose elements are adjacent: interleaved complex numbers, or doubles.
#pragma once

#include <cstddef>
#include <cstdint>

#include "fft/table.h"

namespace krnumer {

// Makes the plan for elements T, Complex or double, of a table whose factors and kernels stand. It remains empty if the
// last factor has no kernels. False without memory.
template <class T>
bool MakePlan(const qmfft_table* table, VectorPlan* plan);

// Forward transforms by plans that are not empty; 0 or kOutOfMemory.
int32_t VectorComplexFFT(const qmfft_table* table, const double* in, double* out);
int32_t VectorRealFFT(const qmfft_table* table, const double* in, double* out);

// Twiddles of factor i of a table, which combines blocks of length m, in the order of the plan for elements T.
template <class T>
size_t CountStageTwiddles(const qmfft_table* table, int32_t i, int32_t m);
template <class T>
void PackStageTwiddles(const qmfft_table* table, int32_t i, int32_t m, double* packed);

}  // namespace krnumer

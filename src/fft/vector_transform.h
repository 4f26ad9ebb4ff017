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

// Forward transforms of `lanes` neighbouring sequences by a plan that is neither empty nor tiled: sample j of sequence
// l is in[l + j step], and its result goes to out[places[l]] and behind.
int32_t VectorComplexFFTs(const qmfft_table* table, const Complex* in, ptrdiff_t step, Complex* out,
                          const ptrdiff_t* places, int32_t lanes);

// Twiddles of factor i of a table, which combines blocks of length m, in the order of the plan for elements T.
template <class T>
size_t CountStageTwiddles(const qmfft_table* table, int32_t i, int32_t m);
template <class T>
void PackStageTwiddles(const qmfft_table* table, int32_t i, int32_t m, double* packed);

}  // namespace krnumer

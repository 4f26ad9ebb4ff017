// One factor of a table, run by its kind.
#pragma once

#include <cstdint>

#include "fft/table.h"

namespace krnumer {

// Families 1 to 4 of factor i; 0 or kOutOfMemory. Strides count doubles.
int32_t RunRealLeaf(const qmfft_table* table, int32_t i, const double* in, double* out, int32_t in_stride,
                    int32_t out_stride, int32_t how_many);
int32_t RunRealStage(const qmfft_table* table, int32_t i, double* data, int32_t stride, int32_t m);
int32_t RunComplexLeaf(const qmfft_table* table, int32_t i, const double* in_re, const double* in_im, double* out_re,
                       double* out_im, int32_t in_stride, int32_t out_stride, int32_t how_many);
int32_t RunComplexStage(const qmfft_table* table, int32_t i, double* re, double* im, int32_t stride, int32_t m);

}  // namespace krnumer

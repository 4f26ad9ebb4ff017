// The transform of an odd prime below 50 without a butterfly, 23 or 47: the defining sum over symmetric pairs.
#pragma once

#include <cstddef>
#include <cstdint>

#include "fft/table.h"
#include "frame/complex.h"

namespace krnumer {

// r real samples to half-complex form; in place is allowed. `work` holds r - 1 doubles.
void DirectReal(int32_t r, const double* in, double* out, const stage_tables& tables, ptrdiff_t in_stride,
                ptrdiff_t out_stride, double* work);

// r complex samples; in place is allowed. `work` holds r - 1 values.
void DirectComplex(int32_t r, const double* in_re, const double* in_im, double* out_re, double* out_im,
                   const stage_tables& tables, ptrdiff_t in_stride, ptrdiff_t out_stride, Complex* work);

// The families of a direct factor; 0 or kOutOfMemory.
int32_t DirectRealLeaf(int32_t r, const stage_tables& tables, const double* in, double* out, int32_t in_stride,
                       int32_t out_stride, int32_t how_many);
int32_t DirectRealStage(int32_t r, const stage_tables& tables, double* data, int32_t stride, int32_t m);
int32_t DirectComplexLeaf(int32_t r, const stage_tables& tables, const double* in_re, const double* in_im,
                          double* out_re, double* out_im, int32_t in_stride, int32_t out_stride, int32_t how_many);
int32_t DirectComplexStage(int32_t r, const stage_tables& tables, double* re, double* im, int32_t stride, int32_t m);

}  // namespace krnumer

// Rader's algorithm for primes of 50 and above: the transform of r values as a cyclic convolution of length r - 1, done
// by transforms of that length.
// Source: C. M. Rader, Discrete Fourier transforms when the number of data samples is prime, Proc. IEEE 56, 1968.
#pragma once

#include <cstdint>

#include "fft/table.h"

namespace krnumer {

// Fills the Rader arrays of a factor whose sub-table is there; false without memory.
bool FillRaderTables(stage_tables* tables, int32_t r);

// The families of a Rader factor; 0 or kOutOfMemory.
int32_t RaderRealLeaf(int32_t r, const stage_tables& tables, const double* in, double* out, int32_t in_stride,
                      int32_t out_stride, int32_t how_many);
int32_t RaderRealStage(int32_t r, const stage_tables& tables, double* data, int32_t stride, int32_t m);
int32_t RaderComplexLeaf(int32_t r, const stage_tables& tables, const double* in_re, const double* in_im,
                         double* out_re, double* out_im, int32_t in_stride, int32_t out_stride, int32_t how_many);
int32_t RaderComplexStage(int32_t r, const stage_tables& tables, double* re, double* im, int32_t stride, int32_t m);

}  // namespace krnumer

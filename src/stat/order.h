// Order statistics: sorting, median and extrema of data that may hold NaN.
#pragma once

#include <cstdint>

namespace krnumer {

// Sorts n samples, ascending or descending, in place where `out` is null and from `in` into `out` otherwise; the two
// may be the same or overlap. All NaNs come first in either direction, each as the quiet NaN, so that looking at the
// first element tells whether there are any. The order of equal values, of -0.0 and 0.0 too, is open.
// A single sample is left alone: nothing is written to `out`. kEmptyInput where n < 1.
int32_t SortDoubles(const double* in, int32_t n, int32_t descending, double* out);

// The middle of the sorted samples, or the mean of the two in the middle. kEmptyInput where n < 1, kOutOfMemory, and
// kHoldsNaN where a sample is NaN; `median` is written on success only.
int32_t Median(const double* x, int32_t n, double* median);

// Largest and smallest sample with their positions, the first among equals; NaNs are skipped. Where all samples are
// NaN, so are both extrema, and both positions are -1. kEmptyInput where n < 1.
int32_t MinMaxIgnoreNaN(const double* x, int32_t n, double* max, int32_t* max_index, double* min, int32_t* min_index);

}  // namespace krnumer

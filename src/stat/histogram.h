// Histograms over bins of equal width and over freely chosen intervals.
#pragma once

#include <cstdint>

namespace krnumer {

// Counts the samples in `bins` intervals of equal width from lo to hi, each with its lower end, the last with both
// ends, and tells the centers. Samples outside are dropped; a NaN counts in the last bin, since it is neither less nor
// greater than hi. kNoSpread where lo >= hi, before kEmptyInput where n < 1 or bins < 1.
int32_t EqualWidthHistogram(const double* x, int32_t n, double lo, double hi, int32_t* counts, double* centers,
                            int32_t bins);

// The same from the smallest to the largest sample. A NaN takes over the minimum until the next number does, so NaNs
// in the data change the bounds or leave none. kEmptyInput where n < 1 or bins < 1, kNoSpread where all samples are
// equal.
int32_t Histogram(const double* x, int32_t n, int32_t* counts, double* centers, int32_t bins);

// Which ends belong to an interval. With any other value in its place, everything lies inside.
enum class Inclusion : int32_t { kLower = 0, kUpper = 1, kBoth = 2, kNeither = 3 };

struct Interval {
    double lower, upper;
    Inclusion inclusion;
};

struct OutOfRange {
    int32_t outside;  // samples in no interval
    int32_t below;    // those below the first interval
    int32_t above;    // those above the last
};

// Counts the samples in each of m intervals, which are expected in ascending order and may overlap: a sample below the
// first is looked at no further, any other counts in every interval that it lies in. A NaN is below everything.
// kEmptyInput where n < 1, with `out_of_range` zeroed and `counts` as they were.
int32_t IntervalHistogram(const double* x, int32_t n, const Interval* intervals, int32_t m, int32_t* counts,
                          OutOfRange* out_of_range);

}  // namespace krnumer

// Discrete cosine transform of type II, orthonormal, and sine transform of type I, unnormalised, with their inverses:
//
//     cosine: y[k] = s(k) sum of x[i] cos(pi (2i+1) k / (2n)),  s(0) = sqrt(1/n), s(k) = sqrt(2/n)
//     sine:   y[k] = sum of x[i] sin(pi (i+1) (k+1) / (n+1)),   inverse with the factor 2/(n+1)
//
// Cosine transforms of even length reorder their input (J. Makhoul, IEEE Trans. ASSP 28, 27, 1980); those of odd length
// extend it evenly to 2n, sine transforms oddly to 2(n+1).
#pragma once

#include <cstddef>
#include <cstdint>

#include "fft/fft.h"

namespace krnumer {

// A line of samples in memory: `available` of them, `stride` doubles apart, and zeros behind them.
struct Line {
    const double* samples;
    int32_t available;
    int32_t stride;
};

// Transforms n samples of a line into y, whose elements are out_stride doubles apart; y may be where the line is.
// `work` holds LineWork(n) doubles, and the table has the length that goes with the transform.
using LineFunction = int32_t(Line x, double* y, int32_t out_stride, int32_t n, double* work, const qmfft_table* table);

LineFunction CosineTransform, InverseCosineTransform, SineTransform, InverseSineTransform;

inline std::size_t LineWork(int32_t n) {
    return 4 * (static_cast<std::size_t>(n) + 1);
}

// Length of the table of a transform of n samples; 0 where no int32 is long enough.
int32_t CosineTableLength(int32_t n);
int32_t SineTableLength(int32_t n);

// A transform and the length of its table.
struct LineTransform {
    LineFunction* transform;
    int32_t (*table_length)(int32_t n);
};

inline constexpr LineTransform kCosine{CosineTransform, CosineTableLength};
inline constexpr LineTransform kInverseCosine{InverseCosineTransform, CosineTableLength};
inline constexpr LineTransform kSine{SineTransform, SineTableLength};
inline constexpr LineTransform kInverseSine{InverseSineTransform, SineTableLength};

// The rows or the columns of a matrix of rows by columns, from x to y; x may be y.
int32_t TransformRows(LineFunction* transform, const double* x, double* y, int32_t rows, int32_t columns, double* work,
                      const qmfft_table* table);
int32_t TransformColumns(LineFunction* transform, const double* x, double* y, int32_t rows, int32_t columns,
                         double* work, const qmfft_table* table);

}  // namespace krnumer

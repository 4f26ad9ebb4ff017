// Waves that carry a phase from one block of samples to the next.
//
// Frequencies are in cycles per sample. `phase` is in degrees: the phase of the first sample on entry, and on return
// that of the sample behind the last, from 0 to 360 exclusive, so that a long signal can be made in blocks without a
// seam. All return -20003 and touch nothing when n is less than 1.
#pragma once

#include <cstdint>

namespace krnumer {

// Sine by the two-step recurrence sin(p + kw) = sin(p + (k-2)w) + 2 sin w cos(p + (k-1)w), which costs five
// trigonometric calls for the whole block. Rounding can carry a peak past the amplitude; it is cut off there.
int32_t SineWave(double* y, int32_t n, double amplitude, double frequency, double* phase);

// The phase of sample i is phase + i frequency 360, a product and not a running sum, so that rounding does not add up.
int32_t SawtoothWave(double* y, int32_t n, double amplitude, double frequency, double* phase);
int32_t TriangleWave(double* y, int32_t n, double amplitude, double frequency, double* phase);

// `duty` is the high part of the period in percent; what lies outside 0 to 100 acts as the limit, NaN as 0.
int32_t SquareWave(double* y, int32_t n, double amplitude, double frequency, double* phase, double duty);

// `table` holds one period, read at the nearest entry before the phase or, with `interpolation` 1, on the straight line
// to the next. The position in the table is a running sum. An empty table gives zeros and leaves phase 0.
int32_t ArbitraryWave(double* y, int32_t n, double amplitude, double frequency, double* phase, const double* table,
                      int32_t table_size, int32_t interpolation);

// Sine whose frequency runs linearly from f1 at sample 0 to f2 at sample n, starting at phase 0.
int32_t Chirp(double* y, int32_t n, double amplitude, double f1, double f2);

}  // namespace krnumer

// Patterns that start afresh with every call.
//
// Delays and widths are in samples unless an argument says otherwise. On failure the samples are left as they were.
#pragma once

#include <cstdint>

namespace krnumer {

// `cycles` whole or broken periods of a sine over n samples, starting at `phase` degrees.
// -20012 unless 0 < cycles <= n; -20003 when n is less than 1.
int32_t SinePattern(double* y, int32_t n, double amplitude, double phase, double cycles);

// `cycles` periods of `amplitude` and 0 over n samples; period and high part, which is `duty` percent of it, are
// rounded to whole samples. -20012 unless 0 < cycles <= n.
int32_t SquarePattern(double* y, int32_t n, double amplitude, double duty, double cycles);

// -20003 when n is less than 1, -20017 when there is no sample `delay`.
int32_t ImpulsePattern(double* y, int32_t n, double amplitude, int32_t delay);

// -20003 when n is less than 1, -20014 when the pulse does not lie in the pattern as a whole.
int32_t PulsePattern(double* y, int32_t n, double amplitude, int32_t delay, int32_t width);

// sin(u) / u at u = pi (i dt - delay), times `amplitude`.
// -20003 when n is less than 1, -20016 when dt is not positive.
int32_t SincPattern(double* y, int32_t n, double amplitude, double delay, double dt);

// Straight line from `start` to `end`; `exclude_end` 0 makes `end` the last sample, anything else the sample behind it.
// With the end, two samples are needed (-20006) unless one can be both ends; without, one (-20005).
int32_t RampPattern(double* y, int32_t n, double start, double end, int32_t exclude_end);

}  // namespace krnumer

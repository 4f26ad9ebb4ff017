// Rational resampling of a stream: up by inserting zeros, an FIR filter at the higher rate, down by keeping every
// M-th sample, with only the products computed that count (R. E. Crochiere and L. R. Rabiner, Multirate Digital Signal
// Processing, chapter 3). Instances exist for double and Complex.
#pragma once

#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// Rates up by L and down by M, with a filter of an odd number of taps, its delay taken off and its gain L.
struct RationalRate {
    int32_t up, down;
    const double* filter;
    int32_t taps;
};

// Where a stream stands between two blocks.
struct RationalStream {
    int32_t start;          // position of the next output at the higher rate, counted from the first sample kept
    int32_t history_count;  // samples kept of earlier blocks
};

// kNegativeState where the stream's numbers are negative, then kNotPositive where L or M is below 1.
int32_t CheckRational(const RationalRate& rate, const RationalStream& stream);

// Samples that a stream has to keep between blocks.
constexpr int32_t RationalHistory(const RationalRate& rate) {
    return (rate.taps - 1) / rate.up + 1;
}

// Outputs that the samples kept and n new ones give.
int64_t RationalOutputCount(const RationalRate& rate, const RationalStream& stream, int32_t n);

// Takes in n samples of each channel and gives `count` outputs each. The rows of x have n columns, those of the history
// `capacity`, those of the output `count`. The statuses of CheckRational; kEvenLength for an even number of taps;
// kHistoryTooSmall where the history has no room for what is or has to be kept. The stream and the history change on
// success only. With less than 2 L - 1 taps a stream can fall behind its samples, and its next block is refused.
template <class T>
int32_t PolyphaseResample(const T* x, int32_t channels, int32_t n, const RationalRate& rate, RationalStream* stream,
                          T* history, int32_t capacity, T* out, int32_t count);

extern template int32_t PolyphaseResample(const double*, int32_t, int32_t, const RationalRate&, RationalStream*,
                                          double*, int32_t, double*, int32_t);
extern template int32_t PolyphaseResample(const Complex*, int32_t, int32_t, const RationalRate&, RationalStream*,
                                          Complex*, int32_t, Complex*, int32_t);

}  // namespace krnumer

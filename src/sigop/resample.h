// Resampling at any ratio: every output is a sum of samples weighed by a symmetric kernel around its position, read
// from a finely sampled table (J. O. Smith and P. Gossett, ICASSP 1984). Instances exist for double and Complex.
#pragma once

#include <cstdint>

#include "frame/complex.h"

namespace krnumer {

// The kernel, symmetric around the middle of its table.
struct ResampleKernel {
    const double* table;
    int32_t points;
    int32_t oversampling;  // points per input sample
    bool nearest;          // read at the nearest point instead of interpolating
};

// How the kernel lies around an output: `left` samples up to its position and `right` behind it, `delta` points of the
// table apart, the first at `first`.
struct KernelPhase {
    int32_t left, right;
    double delta, first;
};

// The phase for an output `frac` behind a sample. A ratio above 1, in inputs per output, stretches the kernel.
KernelPhase ResamplePhase(const ResampleKernel& kernel, double ratio, double frac);

// kNotPositive where the ratio is not above 0 or the oversampling is below 1, then kEmptyInput for an empty kernel.
int32_t CheckResampling(const ResampleKernel& kernel, double ratio);

// What a stream keeps between blocks, in buffers of the caller. Positions count samples from the first one kept.
template <class T>
struct ResampleStream {
    T* history;
    int32_t history_capacity;
    int32_t history_count;
    double* taps;
    int32_t taps_capacity;
    int32_t left, right;
    double gain;
    double ratio;   // inputs per output
    int32_t index;  // the next output stands at index + frac
    double frac;
};

// Takes in n samples and gives the outputs that they allow, with the kernel stretched or, where `scale_kernel` is
// false, never. kHistoryTooSmall, kTooManyTaps and kOutputFull for buffers that are too small; kNegativeState for a
// negative history_count; kBadSelector for a position that no int32 holds. The stream is good for nothing after a
// failure.
template <class T>
int32_t ResampleRun(const T* x, int32_t n, const ResampleKernel& kernel, ResampleStream<T>* stream, T* out,
                    int32_t capacity, int32_t* count, bool scale_kernel);

// What a call of ResampleVariable tells.
struct VariableProgress {
    double last_time;  // position of the last output, counted from the next block
    int32_t outputs;
    int32_t consumed;  // samples that later positions do not need
};

// Outputs at the given positions, in samples from the start of x, up to the first that x does not reach; that one and
// all behind it are then counted from the next block, the one without the samples consumed. `adaptive` stretches the
// kernel by the step from each position to the next. `out` may be `times`. kBadSelector for a position that no int32
// holds, kOutOfMemory.
template <class T>
int32_t ResampleVariable(const T* x, int32_t n, double* times, int32_t count, const ResampleKernel& kernel,
                         bool adaptive, T* out, VariableProgress* progress);

extern template int32_t ResampleRun(const double*, int32_t, const ResampleKernel&, ResampleStream<double>*, double*,
                                    int32_t, int32_t*, bool);
extern template int32_t ResampleRun(const Complex*, int32_t, const ResampleKernel&, ResampleStream<Complex>*, Complex*,
                                    int32_t, int32_t*, bool);
extern template int32_t ResampleVariable(const double*, int32_t, double*, int32_t, const ResampleKernel&, bool, double*,
                                         VariableProgress*);
extern template int32_t ResampleVariable(const Complex*, int32_t, double*, int32_t, const ResampleKernel&, bool,
                                         Complex*, VariableProgress*);

}  // namespace krnumer

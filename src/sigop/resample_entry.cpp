#include <algorithm>
#include <cmath>
#include <cstddef>
#include <limits>

#include "frame/entry.h"
#include "krnumer/sigop.h"
#include "sigop/resample.h"

using namespace krnumer;

static_assert(sizeof(KrResampleSpec) == 24 + sizeof(KrHandle) && offsetof(KrResampleSpec, kernel) == 20);
static_assert(sizeof(KrVariableResampleSpec) == 9 + sizeof(KrHandle) && offsetof(KrVariableResampleSpec, kernel) == 5);
static_assert(sizeof(KrResampleState) == 44 + 2 * sizeof(KrHandle));
static_assert(offsetof(KrResampleState, historyCount) == sizeof(KrHandle));
static_assert(offsetof(KrResampleState, taps) == sizeof(KrHandle) + 4);
static_assert(offsetof(KrResampleState, gain) == 2 * sizeof(KrHandle) + 4);
static_assert(offsetof(KrResampleState, index) == 2 * sizeof(KrHandle) + 40);

namespace {

constexpr int32_t kNearest = 1;

// A field that is only read.
template <class T>
HandleField Field(const T* field) {
    return {const_cast<T*>(field)};
}

bool FitsInt32(double value) {
    return value >= -2147483648.0 && value <= 2147483647.0;
}

// The kernel's taps cover `left` + `right` samples, or one more, depending on where between them an output falls.
template <class T>
int32_t Initialize(const KrResampleSpec* spec, const ResampleKernel& kernel, InOut<T>* history, InOut<double>* taps,
                   ResampleStream<T>* stream) {
    if (!FitsInt32(std::trunc(spec->start))) return kBadSelector;
    const KernelPhase phase = ResamplePhase(kernel, spec->ratio, 0.0);
    const int64_t capacity = int64_t{phase.left} + phase.right + 1;
    if (capacity > std::numeric_limits<int32_t>::max()) return kOutOfMemory;
    if (history->Resize(static_cast<int32_t>(capacity)) != 0) return kOutOfMemory;
    if (taps->Resize(static_cast<int32_t>(capacity)) != 0) return kOutOfMemory;
    stream->history_count = 0;
    stream->index = static_cast<int32_t>(spec->start);
    stream->frac = spec->start - stream->index;
    return kOk;
}

template <class T>
int32_t ResampleConstant(KrHandle x, KrResampleState* state, const KrResampleSpec* spec, int32_t initialize, KrHandle y,
                         int32_t* out_count, int32_t scale_kernel) {
    ByValue call;
    In<T> samples(call, x);
    InOut<T> history(call, Field(&state->history), Access::kReplacedKept);
    InOut<double> taps(call, Field(&state->taps), Access::kReplacedKept);
    In<double> table(call, Field(&spec->kernel));
    Out<T> resampled(call, y);
    *out_count = 0;

    const double ratio = initialize != 0 ? spec->ratio : state->ratio;
    const int32_t mode = initialize != 0 ? spec->mode : state->mode;
    ResampleKernel kernel{nullptr, table.size(), spec->oversampling, mode == kNearest};
    if (const int32_t status = CheckResampling(kernel, ratio)) return call.Fail(status);

    ResampleStream<T> stream{};
    stream.history_count = state->historyCount;
    stream.index = state->index;
    stream.frac = state->frac;
    stream.ratio = ratio;
    if (initialize != 0) {
        if (const int32_t status = Initialize(spec, kernel, &history, &taps, &stream)) return call.Fail(status);
    }
    const double capacity =
        std::ceil(std::max(static_cast<double>(samples.size()) + stream.history_count, 0.0) / ratio);
    if (!FitsInt32(capacity) || resampled.Resize(static_cast<int32_t>(capacity)) != 0) return call.Fail(kOutOfMemory);
    if (const int32_t status = call.Map()) return call.Fail(status);
    if (initialize != 0) {
        std::fill_n(history.data(), history.size(), T{});
        std::fill_n(taps.data(), taps.size(), 0.0);
    }
    kernel.table = table.data();
    stream.history = history.data();
    stream.history_capacity = history.size();
    stream.taps = taps.data();
    stream.taps_capacity = taps.size();
    int32_t count = 0;
    const int32_t status = ResampleRun(samples.data(), samples.size(), kernel, &stream, resampled.data(),
                                       resampled.size(), &count, scale_kernel != 0);
    if (status != kOk) return call.Fail(status);
    std::fill(resampled.data() + count, resampled.data() + resampled.size(), T{});
    *out_count = count;
    state->historyCount = stream.history_count;
    state->gain = stream.gain;
    state->left = stream.left;
    state->right = stream.right;
    state->mode = mode;
    state->ratio = ratio;
    state->frac = stream.frac;
    state->index = stream.index;
    return call.Leave(kOk);
}

template <class T, class Outputs>
int32_t ResampleAtTimes(Call& call, const In<T>& samples, InOut<double>& times, const KrVariableResampleSpec* spec,
                        const In<double>& table, Outputs& outputs, double* last_time, int32_t* out_count,
                        int32_t* consumed) {
    if (const int32_t status = call.Map()) return call.Fail(status);
    const ResampleKernel kernel{table.data(), table.size(), spec->oversampling, spec->mode == kNearest};
    VariableProgress progress{*last_time, 0, 0};
    const int32_t status = ResampleVariable(samples.data(), samples.size(), times.data(), times.size(), kernel,
                                            spec->adaptive != 0, outputs.data(), &progress);
    if (status != kOk) return call.Fail(status);
    *last_time = progress.last_time;
    *out_count = progress.outputs;
    *consumed = progress.consumed;
    return call.Leave(kOk);
}

}  // namespace

int32_t Resample_Const(KrHandle x, KrResampleState* state, const KrResampleSpec* spec, int32_t initialize, KrHandle y,
                       int32_t* outCount, int32_t scaleKernel) {
    return ResampleConstant<double>(x, state, spec, initialize, y, outCount, scaleKernel);
}
int32_t CxResample_Const(KrHandle x, KrResampleState* state, const KrResampleSpec* spec, int32_t initialize, KrHandle y,
                         int32_t* outCount, int32_t scaleKernel) {
    return ResampleConstant<Complex>(x, state, spec, initialize, y, outCount, scaleKernel);
}

int32_t Resample_Variable(KrHandle x, KrHandle times, const KrVariableResampleSpec* spec, double* lastTime,
                          int32_t* outCount, int32_t* consumed) {
    ByValue call;
    In<double> samples(call, x);
    InOut<double> positions(call, times);
    In<double> table(call, Field(&spec->kernel));
    *outCount = *consumed = 0;
    return ResampleAtTimes(call, samples, positions, spec, table, positions, lastTime, outCount, consumed);
}
int32_t CxResample_Variable(KrHandle x, KrHandle times, const KrVariableResampleSpec* spec, KrHandle y,
                            double* lastTime, int32_t* outCount, int32_t* consumed) {
    ByValue call;
    In<Complex> samples(call, x);
    InOut<double> positions(call, times);
    In<double> table(call, Field(&spec->kernel));
    Out<Complex> resampled(call, y);
    *outCount = *consumed = 0;
    if (resampled.Resize(positions.size()) != 0) return call.Fail(kOutOfMemory);
    const int32_t status =
        ResampleAtTimes(call, samples, positions, spec, table, resampled, lastTime, outCount, consumed);
    if (status == kOk) std::fill(resampled.data() + *outCount, resampled.data() + resampled.size(), Complex{});
    return status;
}

#include "sigop/resample.h"

#include <algorithm>
#include <cmath>
#include <limits>

#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"
#include "sigop/history.h"
#include "sigop/resample_group.h"

namespace krnumer {
namespace {

// A position as a whole sample and the fraction behind it.
struct Split {
    int32_t index;
    double frac;
};

bool SplitPosition(double position, Split* split) {
    const double whole = std::floor(position);
    if (!(whole >= -2147483648.0 && whole <= 2147483647.0)) return false;
    *split = {static_cast<int32_t>(whole), position - whole};
    return true;
}

// A point of the table, or the value between it and the next. The last point has none behind it, and the last tap often
// stands exactly there.
double ReadKernel(const ResampleKernel& kernel, double position) {
    const int32_t last = kernel.points - 1;
    if (kernel.nearest) return kernel.table[std::clamp(TruncateToInt32(position + 0.5), 0, last)];
    const int32_t i = std::clamp(TruncateToInt32(position), 0, last);
    const double point = kernel.table[i];
    return i < last ? point + (kernel.table[i + 1] - point) * (position - i) : point;
}

// Moves the kernel to an output `frac` behind a sample.
template <class T>
int32_t PlaceKernel(const ResampleKernel& kernel, double ratio, double frac, ResampleStream<T>* stream) {
    const KernelPhase phase = ResamplePhase(kernel, ratio, frac);
    if (int64_t{phase.left} + phase.right > stream->taps_capacity) return kTooManyTaps;
    stream->left = phase.left;
    stream->right = phase.right;
    stream->gain = phase.delta;
    stream->frac = frac;
    return kOk;
}

// Taps of the output at which the kernel stands.
template <class T>
void BuildResampleTaps(const ResampleKernel& kernel, double ratio, ResampleStream<T>* stream) {
    const KernelPhase phase = ResamplePhase(kernel, ratio, stream->frac);
    const int64_t taps = int64_t{phase.left} + phase.right;
    double position = phase.first;
    for (int64_t i = 0; i < taps; ++i, position += phase.delta) stream->taps[i] = ReadKernel(kernel, position);
}

template <class T>
bool ResampleHasRoom(int32_t n, const ResampleStream<T>& stream) {
    return int64_t{stream.index} + stream.right <= int64_t{stream.history_count} + n - 1;
}

// Sum of taps and the samples around the position, from the last backwards; before the beginning all is 0.
template <class T>
T ResampleDot(const T* x, const ResampleStream<T>& stream) {
    const int64_t taps = int64_t{stream.left} + stream.right;
    const int64_t history_count = stream.history_count;
    const int64_t first = int64_t{stream.index} - stream.left + 1;  // sample of tap 0
    const int64_t newest = std::clamp<int64_t>(history_count - first, 0, std::max<int64_t>(taps, 0));
    const int64_t oldest = std::clamp<int64_t>(-first, 0, newest);
    T sum{};
    for (int64_t t = taps - 1; t >= newest; --t) sum += stream.taps[t] * x[first + t - history_count];
    for (int64_t t = newest - 1; t >= oldest; --t) sum += stream.taps[t] * stream.history[first + t];
    return sum * stream.gain;
}

// Drops what no later output needs and appends the new samples.
template <class T>
int32_t ResampleKeepHistory(const T* x, int32_t n, ResampleStream<T>* stream) {
    const int64_t old = stream->history_count;
    const int64_t unneeded = std::max<int64_t>(int64_t{stream->index} - stream->left + 1, 0);
    const int64_t dropped = std::min(unneeded, old + n);
    const int64_t kept = old + n - dropped;
    if (kept > stream->history_capacity) return kHistoryTooSmall;
    KeepSamples(stream->history, old, dropped, x, n);
    stream->history_count = static_cast<int32_t>(kept);
    stream->index = static_cast<int32_t>(stream->index - dropped);
    return kOk;
}

// The largest step between successive positions, at least 1.
double LargestStep(const double* times, int32_t count, double last_time) {
    double largest = 1.0;
    for (int32_t i = 0; i < count; ++i) {
        largest = std::max(largest, times[i] - last_time);
        last_time = times[i];
    }
    return largest;
}

}  // namespace

KernelPhase ResamplePhase(const ResampleKernel& kernel, double ratio, double frac) {
    const double half = (kernel.points - 1) * 0.5;
    const double delta = kernel.oversampling / (ratio >= 1.0 ? ratio : 1.0);
    const double left = std::floor((half - delta * frac) / delta) + 1.0;
    const double right = std::floor((delta * frac + half) / delta);
    return {SaturateToInt32(left), SaturateToInt32(right), delta, half - frac * delta - (left - 1.0) * delta};
}

int32_t CheckResampling(const ResampleKernel& kernel, double ratio) {
    if (!(ratio > 0.0) || kernel.oversampling < 1) return kNotPositive;
    return kernel.points < 1 ? kEmptyInput : kOk;
}

template <class T>
int32_t ResampleRun(const T* x, int32_t n, const ResampleKernel& kernel, ResampleStream<T>* stream, T* out,
                    int32_t capacity, int32_t* count, bool scale_kernel) {
    *count = 0;
    if (stream->history_count < 0) return kNegativeState;
    if (stream->history_count > stream->history_capacity) return kHistoryTooSmall;
    n = std::max(n, 0);
    double base = stream->index + stream->frac;
    if (base < 0.0) base = stream->history_count - 1;
    const double stretch = scale_kernel ? stream->ratio : std::min(stream->ratio, 1.0);
    if (const int32_t status = PlaceKernel(kernel, stretch, stream->frac, stream)) return status;
    ResampleGroup group{kernel, stream->gain, stream->ratio, base, 0, stream->history_count, n, stream->taps_capacity};
    bool built = false;
    while (ResampleHasRoom(n, *stream)) {
        if (*count >= capacity) return kOutputFull;
        if (!built) BuildResampleTaps(kernel, stretch, stream);
        built = true;
        out[(*count)++] = ResampleDot(x, *stream);
        for (; capacity - *count >= kGroup; *count += kGroup) {
            group.count = *count;
            if (!ResampleTogether(group, x, out + *count)) break;
        }
        Split next{};
        if (!SplitPosition(*count * stream->ratio + base, &next)) return kBadSelector;
        stream->index = next.index;
        if (next.frac == stream->frac) continue;
        if (const int32_t status = PlaceKernel(kernel, stretch, next.frac, stream)) return status;
        built = false;
    }
    // Callers see the taps of the next output in the stream.
    if (!built) BuildResampleTaps(kernel, stretch, stream);
    return ResampleKeepHistory(x, n, stream);
}

template <class T>
int32_t ResampleVariable(const T* x, int32_t n, double* times, int32_t count, const ResampleKernel& kernel,
                         bool adaptive, T* out, VariableProgress* progress) {
    progress->outputs = progress->consumed = 0;
    if (count < 1) return kOk;
    if (const int32_t status = CheckResampling(kernel, 1.0)) return status;

    const KernelPhase widest =
        ResamplePhase(kernel, adaptive ? LargestStep(times, count, progress->last_time) : 1.0, 0.0);
    const int64_t most_taps = int64_t{widest.left} + widest.right + 1;
    if (most_taps > std::numeric_limits<int32_t>::max()) return kOutOfMemory;
    Scratch<double> taps(static_cast<size_t>(most_taps));
    if (!taps) return kOutOfMemory;
    ResampleStream<T> stream{};
    stream.taps = taps.data();
    stream.taps_capacity = static_cast<int32_t>(most_taps);

    double last_time = progress->last_time;
    int64_t consumed = 0;
    int32_t i = 0;
    for (; i < count; ++i) {
        const double time = times[i];
        Split position{};
        if (!SplitPosition(time, &position)) return kBadSelector;
        stream.index = position.index;
        const double ratio = adaptive ? time - last_time : 1.0;
        if (const int32_t status = PlaceKernel(kernel, ratio, position.frac, &stream)) return status;
        consumed = int64_t{stream.index} - stream.left + 1;
        if (!ResampleHasRoom(n, stream)) break;
        BuildResampleTaps(kernel, ratio, &stream);
        last_time = time;
        out[i] = ResampleDot(x, stream);
    }
    consumed = std::clamp<int64_t>(consumed, 0, std::numeric_limits<int32_t>::max());
    progress->outputs = i;
    progress->consumed = static_cast<int32_t>(consumed);
    progress->last_time = last_time - static_cast<double>(consumed);
    for (; i < count; ++i) times[i] -= static_cast<double>(consumed);
    return kOk;
}

template int32_t ResampleRun(const double*, int32_t, const ResampleKernel&, ResampleStream<double>*, double*, int32_t,
                             int32_t*, bool);
template int32_t ResampleRun(const Complex*, int32_t, const ResampleKernel&, ResampleStream<Complex>*, Complex*,
                             int32_t, int32_t*, bool);
template int32_t ResampleVariable(const double*, int32_t, double*, int32_t, const ResampleKernel&, bool, double*,
                                  VariableProgress*);
template int32_t ResampleVariable(const Complex*, int32_t, double*, int32_t, const ResampleKernel&, bool, Complex*,
                                  VariableProgress*);

}  // namespace krnumer

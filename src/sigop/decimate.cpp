#include "sigop/decimate.h"

#include <algorithm>

#include "frame/status.h"

namespace krnumer {
namespace {

template <class T>
T SumOnto(T sum, const T* x, int64_t n) {
    for (int64_t i = 0; i < n; ++i) sum += x[i];
    return sum;
}

// Means of neighbouring blocks of m samples; out may lie at x or before, and one behind it where m > 1. Four blocks
// advance together, because the additions of one have to wait for each other.
template <class T>
void BlockMeans(const T* x, int64_t blocks, int64_t m, T* out) {
    for (; blocks >= 4; blocks -= 4, x += 4 * m, out += 4) {
        T sums[4] = {};
        for (int64_t i = 0; i < m; ++i)
            for (int64_t k = 0; k < 4; ++k) sums[k] += x[k * m + i];
        for (int64_t k = 0; k < 4; ++k) out[k] = sums[k] / static_cast<double>(m);
    }
    for (; blocks > 0; --blocks, x += m, ++out) *out = SumOnto(T{}, x, m) / static_cast<double>(m);
}

template <class T>
void KeepEvery(const T* x, int64_t count, int64_t m, T* out) {
    for (int64_t k = 0; k < count; ++k) out[k] = x[k * m];
}

// Once the first block is complete, all others are whole.
template <class T>
int64_t AverageStream(T* x, int64_t n, int64_t m, DecimationStream<T>* stream) {
    int64_t start = stream->start;
    int64_t partial = stream->partial_count;
    T sum = stream->partial_sum;
    const bool open = partial != 0;
    int64_t means = std::clamp<int64_t>((open ? partial + n : n - start) / m, 0, n);
    if (means > 0) {
        // The open mean comes first, but x[0] itself belongs to a later one where the start is 0.
        const T first = open ? SumOnto(sum, x, std::min(start, n)) / static_cast<double>(m) : T{};
        const int64_t whole = std::clamp<int64_t>((n - start) / m, 0, means - (open ? 1 : 0));
        BlockMeans(x + std::min(start, n), whole, m, x + (open ? 1 : 0));
        means = whole + (open ? 1 : 0);
        partial = n - m * whole - start;
        sum = SumOnto(T{}, x + (n - std::max<int64_t>(partial, 0)), partial);
        if (open) x[0] = first;
        start = (m - partial) % m;
    } else if (open) {
        sum = SumOnto(sum, x, n);
        partial += n;
        start -= n;
    } else if (n > start) {
        partial = n - start;
        sum = SumOnto(T{}, x + start, partial);
        start = m - partial;
    } else {
        start -= n;
    }
    *stream = {static_cast<int32_t>(start), static_cast<int32_t>(partial), sum};
    return means;
}

}  // namespace

template <class T>
int32_t Decimate(T* x, int32_t n, int32_t factor, bool averaging, int32_t* count) {
    if (n < 1) return kEmptyInput;
    if (factor < 1 || factor > n) return kBadDecimation;
    *count = n / factor;
    if (averaging) {
        BlockMeans(x, *count, factor, x);
    } else {
        KeepEvery(x, *count, factor, x);
    }
    return kOk;
}

template <class T>
int32_t DecimateContinuous(T* x, int32_t n, int32_t factor, bool averaging, bool reset, DecimationStream<T>* stream,
                           int32_t* count) {
    if (factor < 1) return kNotPositive;
    if (stream->start < 0) return kNegativeState;
    n = std::max(n, 0);
    if (reset) *stream = {stream->start, 0, T{}};
    if (averaging) {
        *count = static_cast<int32_t>(AverageStream<T>(x, n, factor, stream));
        return kOk;
    }
    const int64_t start = stream->start;
    const int64_t kept = n > start ? (n - start - 1) / factor + 1 : 0;
    if (kept > 0) KeepEvery<T>(x + start, kept, factor, x);
    stream->start = static_cast<int32_t>(start + kept * factor - n);
    *count = static_cast<int32_t>(kept);
    return kOk;
}

template int32_t Decimate(double*, int32_t, int32_t, bool, int32_t*);
template int32_t Decimate(Complex*, int32_t, int32_t, bool, int32_t*);
template int32_t DecimateContinuous(double*, int32_t, int32_t, bool, bool, DecimationStream<double>*, int32_t*);
template int32_t DecimateContinuous(Complex*, int32_t, int32_t, bool, bool, DecimationStream<Complex>*, int32_t*);

}  // namespace krnumer

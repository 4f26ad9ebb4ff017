#include "filter/narrowband_filter.h"

#include <algorithm>

#include "filter/narrowband_design.h"
#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"
#include "sigop/convolution.h"

namespace krnumer {
namespace {

// Convolves a signal with taps that stand `spacing` samples apart. Samples that far apart never meet the others, so the
// signal is that many signals in one; of a complex signal, the parts are signals of their own too.
template <class T>
int32_t ConvolveSpread(const T* x, int32_t n, const double* taps, int32_t taps_size, int32_t spacing, T* y) {
    constexpr int64_t kParts = sizeof(T) / sizeof(double);
    const int64_t step = kParts * spacing;
    const int64_t doubles = kParts * n;
    const double* const in = reinterpret_cast<const double*>(x);
    double* const out = reinterpret_cast<double*>(y);
    if (step == 1) return ConvolveReal(in, n, taps, taps_size, kDirect, out);

    std::fill_n(out, doubles + step * (taps_size - 1), 0.0);
    const int64_t longest = (doubles - 1) / step + 1;
    if (longest + taps_size - 1 > INT32_MAX) return kOutOfMemory;
    Scratch<double> work(static_cast<size_t>(2 * longest + taps_size - 1));
    if (!work) return kOutOfMemory;
    double* const one = work.data();
    double* const convolved = one + longest;
    for (int64_t start = 0; start < std::min(step, doubles); ++start) {
        const int32_t size = static_cast<int32_t>((doubles - 1 - start) / step + 1);
        for (int32_t i = 0; i < size; ++i) one[i] = in[start + i * step];
        if (const int32_t status = ConvolveReal(one, size, taps, taps_size, kDirect, convolved)) return status;
        for (int32_t i = 0; i < size + taps_size - 1; ++i) out[start + i * step] = convolved[i];
    }
    return kOk;
}

template <class T>
int32_t Filter(const NarrowbandParts& filter, const T* x, int32_t n, T* y) {
    if (const int32_t status = filter.Check(n)) return status;
    if (filter.factor != 1) {
        const int32_t between_size = n + filter.interpolator_size - 1;
        Scratch<T> between(Count(between_size));
        if (!between) return kOutOfMemory;
        if (const int32_t status =
                ConvolveSpread(x, n, filter.interpolator, filter.interpolator_size, 1, between.data()))
            return status;
        if (const int32_t status =
                ConvolveSpread(between.data(), between_size, filter.prototype, filter.prototype_size, filter.factor, y))
            return status;
    } else if (const int32_t status = ConvolveSpread(x, n, filter.prototype, filter.prototype_size, 1, y)) {
        return status;
    }
    if (IsComplement(filter.type)) {
        const int64_t delay = (filter.OutputSize(n) - n) / 2;
        for (int32_t i = 0; i < n; ++i) y[delay + i] += x[i];
    }
    return kOk;
}

}  // namespace

int32_t NarrowbandParts::Check(int32_t n) const {
    if (n < 1) return kEmptyInput;
    if (factor < 1) return kBadSelector;
    if (prototype_size < 1 || (factor != 1 && interpolator_size < 1)) return kEmptyInput;
    return OutputSize(n) > INT32_MAX ? kOutOfMemory : kOk;
}

int64_t NarrowbandParts::OutputSize(int32_t n) const {
    return int64_t{prototype_size - 1} * factor + n + (factor != 1 ? interpolator_size - 1 : 0);
}

int32_t FilterNarrowband(const NarrowbandParts& filter, const double* x, int32_t n, double* y) {
    return Filter(filter, x, n, y);
}

int32_t FilterNarrowband(const NarrowbandParts& filter, const Complex* x, int32_t n, Complex* y) {
    return Filter(filter, x, n, y);
}

}  // namespace krnumer

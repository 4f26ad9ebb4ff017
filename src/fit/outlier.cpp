#include "fit/outlier.h"

#include <algorithm>
#include <cmath>

#include "frame/status.h"

namespace krnumer {

namespace {

struct Bounds {
    double lo, hi;

    explicit Bounds(const double* pair) : lo(std::min(pair[0], pair[1])), hi(std::max(pair[0], pair[1])) {}
    bool Excludes(double value) const { return value >= hi || value <= lo; }
};

int32_t CountUnmasked(const uint8_t* mask, int32_t n) {
    return static_cast<int32_t>(std::count(mask, mask + n, uint8_t{0}));
}

}  // namespace

int32_t MaskByIndex(const int32_t* indices, int32_t count, int32_t n, uint8_t* mask, int32_t* left) {
    std::fill_n(mask, n, uint8_t{0});
    for (int32_t i = 0; i < count; ++i) {
        if (indices[i] < 0 || indices[i] >= n) return kBadIndex;
        mask[indices[i]] = 1;
    }
    *left = CountUnmasked(mask, n);
    return kOk;
}

int32_t MaskByRange(const double* x, const double* y, int32_t n, const double* bounds, int32_t count, int32_t selector,
                    uint8_t* mask, int32_t* left) {
    const auto range = OutlierRange{selector};
    if (selector < 0 || range > OutlierRange::kBoth) return kBadSelector;
    const int32_t needed = range == OutlierRange::kBoth ? 4 : 2;
    if (count < needed) return range == OutlierRange::kBoth ? kTooFewForGaussian : kFewerThanTwo;
    if (std::any_of(bounds, bounds + needed, [](double bound) { return std::isnan(bound); })) return kNotFinite;

    const Bounds first(bounds);
    if (range == OutlierRange::kBoth) {
        const Bounds second(bounds + 2);
        for (int32_t i = 0; i < n; ++i) mask[i] = first.Excludes(x[i]) || second.Excludes(y[i]);
    } else {
        const double* const values = range == OutlierRange::kX ? x : y;
        for (int32_t i = 0; i < n; ++i) mask[i] = first.Excludes(values[i]);
    }
    *left = CountUnmasked(mask, n);
    return kOk;
}

void CopyUnmasked(const double* values, const uint8_t* mask, int32_t n, double* kept) {
    for (int32_t i = 0; i < n; ++i)
        if (mask[i] == 0) *kept++ = values[i];
}

}  // namespace krnumer

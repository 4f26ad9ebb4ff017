#include "stat/histogram.h"

#include <algorithm>

#include "frame/status.h"

namespace krnumer {

namespace {

enum class Position { kBelow, kInside, kAbove };

Position Locate(double x, const Interval& interval) {
    bool past_lower = false;
    bool within_upper = false;
    switch (interval.inclusion) {
        case Inclusion::kLower:
            past_lower = x >= interval.lower;
            within_upper = x < interval.upper;
            break;
        case Inclusion::kUpper:
            past_lower = x > interval.lower;
            within_upper = x <= interval.upper;
            break;
        case Inclusion::kBoth:
            past_lower = x >= interval.lower;
            within_upper = x <= interval.upper;
            break;
        case Inclusion::kNeither:
            past_lower = x > interval.lower;
            within_upper = x < interval.upper;
            break;
        default:
            return Position::kInside;
    }
    if (!past_lower) return Position::kBelow;
    return within_upper ? Position::kInside : Position::kAbove;
}

}  // namespace

int32_t EqualWidthHistogram(const double* x, int32_t n, double lo, double hi, int32_t* counts, double* centers,
                            int32_t bins) {
    if (lo >= hi) return kNoSpread;
    if (n < 1 || bins < 1) return kEmptyInput;
    const double width = (hi - lo) / bins;
    centers[0] = lo + width * 0.5;
    for (int32_t k = 1; k < bins; ++k) centers[k] = centers[k - 1] + width;

    std::fill_n(counts, bins, 0);
    const double inverse = 1.0 / width;
    for (int32_t i = 0; i < n; ++i) {
        const double position = (x[i] - lo) * inverse;
        if (position >= 0.0 && position < bins) {
            ++counts[static_cast<int32_t>(position)];
        } else if (!(x[i] < hi) && !(x[i] > hi)) {
            ++counts[bins - 1];
        }
    }
    return kOk;
}

int32_t Histogram(const double* x, int32_t n, int32_t* counts, double* centers, int32_t bins) {
    if (n < 1 || bins < 1) return kEmptyInput;
    double min = x[0];
    double max = x[0];
    for (int32_t i = 0; i < n; ++i) {
        if (!(x[i] >= min)) {
            min = x[i];
        } else if (!(max >= x[i])) {
            max = x[i];
        }
    }
    return EqualWidthHistogram(x, n, min, max, counts, centers, bins);
}

int32_t IntervalHistogram(const double* x, int32_t n, const Interval* intervals, int32_t m, int32_t* counts,
                          OutOfRange* out_of_range) {
    *out_of_range = {};
    if (n < 1) return kEmptyInput;
    std::fill_n(counts, m, 0);
    for (int32_t i = 0; i < n; ++i) {
        bool placed = false;
        for (int32_t j = 0; j < m; ++j) {
            const Position position = Locate(x[i], intervals[j]);
            if (position == Position::kInside) {
                ++counts[j];
                placed = true;
            } else if (j == 0 && position == Position::kBelow) {
                ++out_of_range->outside;
                ++out_of_range->below;
                break;
            } else if (j == m - 1 && !placed) {
                ++out_of_range->outside;
                if (position == Position::kAbove) ++out_of_range->above;
            }
        }
    }
    return kOk;
}

}  // namespace krnumer

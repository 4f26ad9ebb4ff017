// One output alone is a chain of additions to find its taps, and then a chain of additions of its products, each link
// waiting for the one before. Here every lane of a vector is an output, so that the chains run side by side and each
// keeps its order.
#include "sigop/resample_group.h"

#include <algorithm>
#include <type_traits>

#include "frame/vector_targets.h"

#undef HWY_TARGET_INCLUDE
#define HWY_TARGET_INCLUDE "sigop/resample_group.cpp"
#include <hwy/foreach_target.h>
#include <hwy/highway.h>

HWY_BEFORE_NAMESPACE();
namespace krnumer::HWY_NAMESPACE {
namespace {

namespace hn = hwy::HWY_NAMESPACE;
using Tag = hn::CappedTag<double, 8>;
using IndexTag = hn::Rebind<int32_t, Tag>;
using Vector = hn::Vec<Tag>;

constexpr int64_t kMostTaps = 64;

// What is known of the outputs, an element each.
struct Outputs {
    alignas(64) double taps[kGroup];
    alignas(64) double first[kGroup];  // sample that tap 0 meets
    int64_t least, most;               // taps
};

// Row t holds the position of tap t in the table, and later the tap, of all outputs.
struct Rows {
    alignas(64) double row[kMostTaps][kGroup];
};

// The doubles at every address and those behind them.
template <class D>
HWY_INLINE void LoadPairs(D tag, const double* const* at, hn::Vec<D>& first, hn::Vec<D>& second) {
#if HWY_TARGET == HWY_SCALAR
    alignas(64) double pairs[2][kGroup];
    for (size_t k = 0; k < hn::Lanes(tag); ++k)
        for (size_t i = 0; i < 2; ++i) pairs[i][k] = at[k][i];
    first = hn::Load(tag, pairs[0]);
    second = hn::Load(tag, pairs[1]);
#else
    const hn::Full128<double> pair;
    if constexpr (hn::MaxLanes(tag) == 2) {
        const auto even = hn::LoadU(pair, at[0]);
        const auto odd = hn::LoadU(pair, at[1]);
        first = hn::InterleaveLower(tag, even, odd);
        second = hn::InterleaveUpper(tag, even, odd);
    } else if constexpr (hn::MaxLanes(tag) == 4) {
        const auto even = hn::Combine(tag, hn::LoadU(pair, at[2]), hn::LoadU(pair, at[0]));
        const auto odd = hn::Combine(tag, hn::LoadU(pair, at[3]), hn::LoadU(pair, at[1]));
        first = hn::InterleaveLower(tag, even, odd);
        second = hn::InterleaveUpper(tag, even, odd);
    } else {
        const hn::Half<D> half;
        auto upper_first = hn::Zero(half);
        auto upper_second = hn::Zero(half);
        auto lower_first = hn::Zero(half);
        auto lower_second = hn::Zero(half);
        LoadPairs(half, at, lower_first, lower_second);
        LoadPairs(half, at + hn::MaxLanes(half), upper_first, upper_second);
        first = hn::Combine(tag, upper_first, lower_first);
        second = hn::Combine(tag, upper_second, lower_second);
    }
#endif
}

// As ResamplePhase has it. False where outputs cannot be computed together.
bool FindPositions(const ResampleGroup& group, Outputs& outputs, Rows& rows) {
    const Tag tag;
    const Vector half = hn::Set(tag, (group.kernel.points - 1) * 0.5);
    const Vector delta = hn::Set(tag, group.delta);
    const Vector one = hn::Set(tag, 1.0);
    for (int32_t k = 0; k < kGroup; k += static_cast<int32_t>(hn::Lanes(tag))) {
        const Vector number = hn::Iota(tag, group.count + k);
        const Vector position = hn::Add(hn::Mul(number, hn::Set(tag, group.ratio)), hn::Set(tag, group.base));
        const Vector whole = hn::Floor(position);
        const Vector frac = hn::Sub(position, whole);
        const Vector left = hn::Add(hn::Floor(hn::Div(hn::Sub(half, hn::Mul(delta, frac)), delta)), one);
        const Vector right = hn::Floor(hn::Div(hn::Add(hn::Mul(delta, frac), half), delta));
        const Vector before = hn::Sub(left, one);
        hn::Store(hn::Add(left, right), tag, outputs.taps + k);
        hn::Store(hn::Sub(hn::Sub(whole, before), hn::Set(tag, group.origin)), tag, outputs.first + k);
        hn::Store(hn::Sub(hn::Sub(half, hn::Mul(frac, delta)), hn::Mul(before, delta)), tag, rows.row[0] + k);
    }
    if (group.kernel.points < 2) return false;
    const auto [least, most] = std::minmax_element(outputs.taps, outputs.taps + kGroup);
    if (!(*least >= 2.0 && *most <= std::min<double>(kMostTaps, group.most_taps))) return false;
    outputs.least = static_cast<int64_t>(*least);
    outputs.most = static_cast<int64_t>(*most);
    const auto lies_inside = [taps = *most, n = group.n](double first) { return first >= 0.0 && first + taps <= n; };
    if (!std::all_of(outputs.first, outputs.first + kGroup, lies_inside)) return false;

    for (size_t k = 0; k < kGroup; k += hn::Lanes(tag)) {
        Vector position = hn::Load(tag, rows.row[0] + k);
        for (int64_t t = 1; t < outputs.most; ++t) {
            position = hn::Add(position, delta);
            hn::Store(position, tag, rows.row[t] + k);
        }
    }
    return true;
}

// Two points are read at every position; the last point is the second of its pair and has none behind it. What is read
// behind the last tap of an output is not used.
template <bool kNearest>
void ReadTable(const ResampleKernel& kernel, const Outputs& outputs, Rows& rows) {
    const Tag tag;
    const IndexTag index_tag;
    const int64_t values = outputs.most * kGroup;
    const auto lanes = static_cast<int64_t>(hn::Lanes(tag));
    double* const row = rows.row[0];
    alignas(64) int32_t points[kMostTaps * kGroup];
    alignas(64) int32_t pairs[kMostTaps * kGroup];
    const auto last_pair = hn::Set(index_tag, kernel.points - 2);
    for (int64_t i = 0; i < values; i += lanes) {
        const Vector position = hn::Load(tag, row + i);
        const Vector rounded = kNearest ? hn::Add(position, hn::Set(tag, 0.5)) : position;
        const auto point = hn::Max(hn::DemoteTo(index_tag, rounded), hn::Zero(index_tag));
        hn::Store(point, index_tag, points + i);
        hn::Store(hn::Min(point, last_pair), index_tag, pairs + i);
    }
    const Vector last_start = hn::PromoteTo(tag, last_pair);
    for (int64_t i = 0; i < values; i += lanes) {
        const double* at[kGroup];
        for (int64_t k = 0; k < lanes; ++k) at[k] = kernel.table + pairs[i + k];
        Vector value = hn::Zero(tag);
        Vector next = hn::Zero(tag);
        LoadPairs(tag, at, value, next);
        const Vector point = hn::PromoteTo(tag, hn::Load(index_tag, points + i));
        const Vector fraction = hn::Sub(hn::Load(tag, row + i), point);
        const Vector between = kNearest ? value : hn::Add(value, hn::Mul(hn::Sub(next, value), fraction));
        hn::Store(hn::IfThenElse(hn::Gt(point, last_start), next, between), tag, row + i);
    }
}

// sum + tap * sample where the output has the tap.
HWY_INLINE Vector AddIf(const double* row, const double* taps, int64_t t, Vector sample, Vector sum) {
    const Tag tag;
    const Vector more = hn::Add(sum, hn::Mul(hn::Load(tag, row), sample));
    return hn::IfThenElse(hn::Gt(hn::Load(tag, taps), hn::Set(tag, static_cast<double>(t))), more, sum);
}

// The outputs from k on: sums of products from the last tap backwards.
void AddProducts(const Outputs& outputs, const Rows& rows, int32_t k, const double* samples, double* out, double gain) {
    const Tag tag;
    const double* x[kGroup];
    const double* at[kGroup];
    const size_t lanes = hn::Lanes(tag);
    for (size_t i = 0; i < lanes; ++i) x[i] = samples + static_cast<int64_t>(outputs.first[k + i]);
    Vector sum = hn::Zero(tag);
    Vector sample = sum;
    Vector next = sum;
    int64_t t = outputs.most - 1;
    for (; t >= outputs.least; --t) {
        for (size_t i = 0; i < lanes; ++i) at[i] = x[i] + t - 1;
        LoadPairs(tag, at, sample, next);
        sum = AddIf(rows.row[t] + k, outputs.taps + k, t, next, sum);
    }
    for (; t >= 1; t -= 2) {
        for (size_t i = 0; i < lanes; ++i) at[i] = x[i] + t - 1;
        LoadPairs(tag, at, sample, next);
        sum = hn::Add(sum, hn::Mul(hn::Load(tag, rows.row[t] + k), next));
        sum = hn::Add(sum, hn::Mul(hn::Load(tag, rows.row[t - 1] + k), sample));
    }
    if (t == 0) {
        LoadPairs(tag, x, sample, next);
        sum = hn::Add(sum, hn::Mul(hn::Load(tag, rows.row[0] + k), sample));
    }
    hn::StoreU(hn::Mul(sum, hn::Set(tag, gain)), tag, out + k);
}

void AddProducts(const Outputs& outputs, const Rows& rows, int32_t k, const Complex* samples, Complex* out,
                 double gain) {
    const Tag tag;
    const double* x[kGroup];
    const double* at[kGroup];
    const size_t lanes = hn::Lanes(tag);
    for (size_t i = 0; i < lanes; ++i) x[i] = &samples[static_cast<int64_t>(outputs.first[k + i])].re;
    Vector sum_re = hn::Zero(tag);
    Vector sum_im = sum_re;
    Vector re = sum_re;
    Vector im = sum_re;
    int64_t t = outputs.most - 1;
    for (; t >= outputs.least; --t) {
        for (size_t i = 0; i < lanes; ++i) at[i] = x[i] + 2 * t;
        LoadPairs(tag, at, re, im);
        sum_re = AddIf(rows.row[t] + k, outputs.taps + k, t, re, sum_re);
        sum_im = AddIf(rows.row[t] + k, outputs.taps + k, t, im, sum_im);
    }
    for (; t >= 0; --t) {
        for (size_t i = 0; i < lanes; ++i) at[i] = x[i] + 2 * t;
        LoadPairs(tag, at, re, im);
        const Vector tap = hn::Load(tag, rows.row[t] + k);
        sum_re = hn::Add(sum_re, hn::Mul(tap, re));
        sum_im = hn::Add(sum_im, hn::Mul(tap, im));
    }
    const Vector factor = hn::Set(tag, gain);
    hn::StoreInterleaved2(hn::Mul(sum_re, factor), hn::Mul(sum_im, factor), tag, &out[k].re);
}

template <class T>
bool Resample(const ResampleGroup& group, const T* samples, T* out) {
    Outputs outputs;
    Rows rows;
    if (!FindPositions(group, outputs, rows)) return false;
    if (group.kernel.nearest) {
        ReadTable<true>(group.kernel, outputs, rows);
    } else {
        ReadTable<false>(group.kernel, outputs, rows);
    }
    for (int32_t k = 0; k < kGroup; k += static_cast<int32_t>(hn::Lanes(Tag())))
        AddProducts(outputs, rows, k, samples, out, group.delta);
    return true;
}

bool ResampleDoubles(const ResampleGroup& group, const double* samples, double* out) {
    return Resample(group, samples, out);
}
bool ResampleComplexes(const ResampleGroup& group, const Complex* samples, Complex* out) {
    return Resample(group, samples, out);
}

}  // namespace
}  // namespace krnumer::HWY_NAMESPACE
HWY_AFTER_NAMESPACE();

#if HWY_ONCE
namespace krnumer {

HWY_EXPORT(ResampleDoubles);
HWY_EXPORT(ResampleComplexes);

bool ResampleTogether(const ResampleGroup& group, const double* samples, double* out) {
    return HWY_DYNAMIC_DISPATCH(ResampleDoubles)(group, samples, out);
}
bool ResampleTogether(const ResampleGroup& group, const Complex* samples, Complex* out) {
    return HWY_DYNAMIC_DISPATCH(ResampleComplexes)(group, samples, out);
}

}  // namespace krnumer
#endif

// The sum of a window has its order, so speed comes from fitting neighbouring windows side by side, on whatever vector
// unit the machine has.
#include "peak/parabola_fit.h"

#include <cmath>

#include "frame/numeric.h"
#include "frame/vector_targets.h"
#include "linalg/svd_solve.h"

#undef HWY_TARGET_INCLUDE
#define HWY_TARGET_INCLUDE "peak/parabola_fit.cpp"
#include <hwy/foreach_target.h>
#include <hwy/highway.h>

HWY_BEFORE_NAMESPACE();
namespace krnumer::HWY_NAMESPACE {

namespace hn = hwy::HWY_NAMESPACE;

constexpr double kLeastSlope = 1e-10;

// The coefficients of as many parabolas as a vector has lanes.
template <class V>
struct Coefficients {
    V a0, a1, a2;
};

template <class D, class V = hn::Vec<D>>
void AddSample(D d, const Coefficients<V>& weight, const double* x, Coefficients<V>& sum) {
    const V sample = hn::LoadU(d, x);
    sum.a0 = hn::Add(sum.a0, hn::Mul(weight.a0, sample));
    sum.a1 = hn::Add(sum.a1, hn::Mul(weight.a1, sample));
    sum.a2 = hn::Add(sum.a2, hn::Mul(weight.a2, sample));
}

template <class D, class V = hn::Vec<D>>
void StoreFits(D d, const Coefficients<V>& fit, int32_t k, ParabolaFits* fits) {
    hn::StoreU(fit.a0, d, fits->a0 + k);
    hn::StoreU(fit.a1, d, fits->a1 + k);
    hn::StoreU(fit.a2, d, fits->a2 + k);
    const V least = hn::Set(d, kLeastSlope);
    const auto rising =
        hn::Or(hn::Gt(fit.a1, least), hn::And(hn::Le(hn::Abs(fit.a1), least), hn::Gt(fit.a2, hn::Zero(d))));
    uint8_t bits[8];
    hn::StoreMaskBits(d, rising, bits);
    fits->rising |= uint64_t{bits[0] & ((1U << hn::Lanes(d)) - 1U)} << k;
}

// Fits groups of windows from the first on, and gives the number of windows fitted. A group is what the registers
// hold.
int32_t FitGroups(const double* weights, int32_t width, const double* x, int32_t count, ParabolaFits* fits) {
    const hn::CappedTag<double, 8> d;
    using V = hn::Vec<decltype(d)>;
    const auto lanes = static_cast<int32_t>(hn::Lanes(d));
    const V zero = hn::Zero(d);
    int32_t k = 0;
    for (; k + 4 * lanes <= count; k += 4 * lanes) {
        Coefficients<V> sum0{zero, zero, zero}, sum1 = sum0, sum2 = sum0, sum3 = sum0;
        for (int32_t j = 0; j < width; ++j) {
            const Coefficients<V> weight{hn::Set(d, weights[j]), hn::Set(d, weights[int64_t{width} + j]),
                                         hn::Set(d, weights[2 * int64_t{width} + j])};
            const double* const samples = x + k + j;
            AddSample(d, weight, samples, sum0);
            AddSample(d, weight, samples + lanes, sum1);
            AddSample(d, weight, samples + 2 * lanes, sum2);
            AddSample(d, weight, samples + 3 * lanes, sum3);
        }
        StoreFits(d, sum0, k, fits);
        StoreFits(d, sum1, k + lanes, fits);
        StoreFits(d, sum2, k + 2 * lanes, fits);
        StoreFits(d, sum3, k + 3 * lanes, fits);
    }
    return k;
}

void FitWindows(const double* weights, int32_t width, const double* x, int32_t count, ParabolaFits* fits) {
    fits->rising = 0;
    for (int32_t k = FitGroups(weights, width, x, count, fits); k < count; ++k) {
        double a0 = 0.0, a1 = 0.0, a2 = 0.0;
        for (int32_t j = 0; j < width; ++j) {
            const double sample = x[k + j];
            a0 += weights[j] * sample;
            a1 += weights[int64_t{width} + j] * sample;
            a2 += weights[2 * int64_t{width} + j] * sample;
        }
        fits->a0[k] = a0;
        fits->a1[k] = a1;
        fits->a2[k] = a2;
        const bool rising = std::fabs(a1) <= kLeastSlope ? a2 > 0.0 : a1 > 0.0;
        fits->rising |= uint64_t{rising} << k;
    }
}

}  // namespace krnumer::HWY_NAMESPACE
HWY_AFTER_NAMESPACE();

#if HWY_ONCE
namespace krnumer {

HWY_EXPORT(FitWindows);

void FitParabolas(const double* weights, int32_t width, const double* x, int32_t count, ParabolaFits* fits) {
    HWY_DYNAMIC_DISPATCH(FitWindows)(weights, width, x, count, fits);
}

int32_t DesignParabolaWeights(int32_t width, double* weights) {
    const double half = 0.5 * (width - 1);
    for (int32_t i = 0; i < width; ++i) {
        const double x = i - half;
        double* const row = weights + 3 * Count(i);
        row[0] = 1.0;
        row[1] = x;
        row[2] = x * x;
    }
    return PseudoInverseCore<double>(weights, width, 3, -1.0, nullptr);
}

}  // namespace krnumer
#endif  // HWY_ONCE

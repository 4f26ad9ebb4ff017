#include "frame/entry.h"
#include "krnumer/vector.h"
#include "poly/scaling.h"

using namespace krnumer;

namespace {

// All elements of an array, or none where a dimension says so.
int32_t Elements(const ArrayView& array) {
    return SaturateToInt32(static_cast<double>(array.count()));
}

// Scales in place an array of this rank as one run; the core delivers two scalars.
template <int kRank, class Core>
int32_t ScaleInPlace(KrHandle x, double* first, double* second, int32_t* err, Core core) {
    ByReference call(err);
    InOut<double, kRank> samples(call, x);
    Result<double> one(call, first);
    Result<double> two(call, second);
    return call.Run([&] { return core(samples.data(), Elements(samples), one.data(), two.data(), nullptr); });
}

template <int kRank>
int32_t ScaleByMagnitudeInPlace(KrHandle x, double* scale, int32_t* err) {
    ByReference call(err);
    InOut<double, kRank> samples(call, x);
    Result<double> result(call, scale);
    return call.Run([&] { return ScaleByMagnitude(samples.data(), Elements(samples), result.data(), nullptr); });
}

template <int kRank>
int32_t MapInPlace(KrHandle x, const double* slope, const double* intercept, int32_t* err) {
    ByReference call(err);
    InOut<double, kRank> samples(call, x);
    return call.Run([&] { return MapLinearly(samples.data(), Elements(samples), *slope, *intercept, nullptr); });
}

}  // namespace

int32_t Scale(KrHandle x, double* scale, double* offset, int32_t* err) {
    return ScaleInPlace<2>(x, scale, offset, err, ScaleToUnitRange);
}

int32_t Scale1DCIN(KrHandle x, double* offset, double* scale, int32_t* err) {
    return ScaleInPlace<1>(x, scale, offset, err, ScaleToUnitRange);
}

int32_t QScale(KrHandle x, double* scale, int32_t* err) {
    return ScaleByMagnitudeInPlace<2>(x, scale, err);
}

int32_t QS1D(KrHandle x, double* scale, int32_t* err) {
    return ScaleByMagnitudeInPlace<1>(x, scale, err);
}

int32_t Norm2(KrHandle x, double* deviation, double* mean, int32_t* err) {
    return ScaleInPlace<2>(x, deviation, mean, err, Standardize);
}

int32_t Norm1(KrHandle x, double* deviation, double* mean, int32_t* err) {
    return ScaleInPlace<1>(x, deviation, mean, err, Standardize);
}

int32_t Line1(KrHandle x, const double* slope, const double* intercept, int32_t* err) {
    return MapInPlace<1>(x, slope, intercept, err);
}

int32_t LinEv(KrHandle x, const double* slope, const double* intercept, int32_t* err) {
    return MapInPlace<2>(x, slope, intercept, err);
}

#include "frame/entry.h"
#include "krnumer/vector.h"
#include "poly/norms.h"

using namespace krnumer;

namespace {

template <class T>
int32_t UnitVector(Call& call, KrHandle x, double p, double* norm) {
    InOut<T> vector(call, x);
    Result<double> result(call, norm);
    return call.Run([&] { return UnitVectorCore<T>(vector.data(), vector.size(), p, result.data(), nullptr); });
}

}  // namespace

int32_t PolarToRect1D_head(KrHandle r, KrHandle theta, int32_t* err) {
    ByReference call(err);
    InOut<double> radii(call, r);
    InOut<double> angles(call, theta);
    int32_t status = kOk;
    if (radii.size() < 1 || angles.size() < 1) status = kEmptyInput;
    if (radii.size() != angles.size()) status = kSizesDiffer;
    if (status != kOk) return call.Fail(status);
    return call.Run([&] { return PolarToRect(radii.data(), angles.data(), radii.size(), nullptr, nullptr); });
}

int32_t RectToPolar1D_head(KrHandle x, KrHandle y, int32_t* err) {
    ByReference call(err);
    InOut<double> abscissas(call, x);
    InOut<double> ordinates(call, y);
    if (abscissas.size() != ordinates.size()) return call.Fail(kSizesDiffer);
    return call.Run(
        [&] { return RectToPolar(abscissas.data(), ordinates.data(), abscissas.size(), nullptr, nullptr); });
}

int32_t unitVector_head(KrHandle x, double* norm, int32_t* err) {
    ByReference call(err);
    return UnitVector<double>(call, x, 2.0, norm);
}

int32_t unitVector80_head(KrHandle x, double p, double* norm, int32_t* err) {
    ByReference call(err);
    return UnitVector<double>(call, x, p, norm);
}

int32_t CxUnitVector_head(KrHandle x, double* norm) {
    ByValue call;
    return UnitVector<Complex>(call, x, 2.0, norm);
}

int32_t CxUnitVector80_head(KrHandle x, double p, double* norm) {
    ByValue call;
    return UnitVector<Complex>(call, x, p, norm);
}

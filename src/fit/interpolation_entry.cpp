#include "fit/interpolation.h"

#include <numeric>

#include "fit/outlier.h"
#include "fit/smoothing_spline.h"
#include "frame/entry.h"
#include "frame/scratch.h"
#include "krnumer/interpolation.h"

using namespace krnumer;

namespace {

using Interpolation = int32_t(const double* x, const double* y, int32_t n, double x0, double* value, double* error);

int32_t Interpolate(Interpolation* core, KrHandle y, KrHandle x, const double* x0, double* value, double* estimate,
                    int32_t* err) {
    ByReference call(err);
    In<double> ordinates(call, y);
    In<double> abscissas(call, x);
    Result<double> interpolated(call, value);
    Result<double> error(call, estimate);
    if (abscissas.size() != ordinates.size()) return call.Fail(kSizesDiffer);
    return call.Run([&] {
        return core(abscissas.data(), ordinates.data(), ordinates.size(), *x0, interpolated.data(), error.data());
    });
}

}  // namespace

int32_t PolyInterp_head(KrHandle y, KrHandle x, const double* x0, double* value, double* errorEstimate, int32_t* err) {
    return Interpolate(InterpolatePolynomial, y, x, x0, value, errorEstimate, err);
}

int32_t RatInterp_head(KrHandle y, KrHandle x, const double* x0, double* value, double* errorEstimate, int32_t* err) {
    return Interpolate(InterpolateRational, y, x, x0, value, errorEstimate, err);
}

int32_t Spline_head(KrHandle y, KrHandle x, const double* slopeFirst, const double* slopeLast, KrHandle y2,
                    int32_t* err) {
    ByReference call(err);
    In<double> ordinates(call, y);
    In<double> abscissas(call, x);
    Out<double> second(call, y2);
    const int32_t n = ordinates.size();
    if (abscissas.size() != n) return call.Fail(kSizesDiffer);
    if (auto host = second.Resize(n)) return call.HostFailure(host);
    return call.Run([&] {
        return SplineSecondDerivatives(abscissas.data(), ordinates.data(), n, *slopeFirst, *slopeLast, second.data());
    });
}

int32_t SpInterp_head(KrHandle y, KrHandle x, KrHandle y2, const double* x0, double* value, int32_t* err) {
    ByReference call(err);
    Result<double> interpolated(call, value);
    for (const KrHandle table : {y, x, y2})
        if (*table == nullptr) return call.Fail(kEmptyInput);
    In<double> ordinates(call, y);
    In<double> abscissas(call, x);
    In<double> second(call, y2);
    const int32_t n = abscissas.size();
    if (ordinates.size() != n || second.size() != n) return call.Fail(kSizesDiffer);
    return call.Run(
        [&] { return EvaluateSpline(abscissas.data(), ordinates.data(), second.data(), n, *x0, interpolated.data()); });
}

int32_t CubicSplineFit_head(KrHandle y, KrHandle x, KrHandle w, KrHandle smoothWeight, double balance,
                            double* residue) {
    ByValue call;
    InOut<double> ordinates(call, y);
    In<double> abscissas(call, x);
    In<double> weights(call, w);
    In<double> roughness(call, smoothWeight);
    Result<double> left(call, residue);
    const int32_t n = ordinates.size();
    const auto fits = [](int32_t size, int32_t wanted) { return size == 0 || size == wanted; };
    if (!fits(abscissas.size(), n) || !fits(weights.size(), n) || !fits(roughness.size(), WrappingAdd(n, -1)))
        return call.Fail(kSizesDiffer);
    return call.Run([&]() -> int32_t {
        const auto given = [](const In<double>& array) { return array.size() > 0 ? array.data() : nullptr; };
        const double* points = given(abscissas);
        Scratch<double> indices;
        if (points == nullptr) {  // without abscissas the points stand at 0, 1, 2, ...
            if (!indices.Allocate(Count(n))) return kOutOfMemory;
            std::iota(indices.data(), indices.data() + Count(n), 0.0);
            points = indices.data();
        }
        return SmoothingSpline(points, ordinates.data(), n, given(weights), given(roughness), balance, left.data());
    });
}

namespace {

// The points of a data set, and what is left of them.
struct DataSet {
    DataSet(Call& call, KrHandle y_in, KrHandle x_in, KrHandle w_in) : y(call, y_in), x(call, x_in), w(call, w_in) {}

    int32_t Check() const {
        if (y.size() < 1) return kEmptyInput;
        return x.size() == y.size() && (w.size() == y.size() || w.size() == 0) ? kOk : kSizesDiffer;
    }

    In<double> y, x, w;
};

struct Survivors {
    Survivors(Call& call, KrHandle y_out, KrHandle x_out, KrHandle w_out)
        : y(call, y_out), x(call, x_out), w(call, w_out) {}

    void CopyFrom(const DataSet& data, const uint8_t* mask) {
        const int32_t n = data.y.size();
        CopyUnmasked(data.y.data(), mask, n, y.data());
        CopyUnmasked(data.x.data(), mask, n, x.data());
        if (data.w.size() > 0) CopyUnmasked(data.w.data(), mask, n, w.data());
    }

    Out<double> y, x, w;
};

}  // namespace

int32_t RmvOutlierIndx_head(KrHandle y, KrHandle x, KrHandle w, KrHandle indices, KrHandle yOut, KrHandle xOut,
                            KrHandle wOut, KrHandle mask) {
    ByValue call;
    DataSet data(call, y, x, w);
    In<int32_t> list(call, indices);
    Survivors left(call, yOut, xOut, wOut);
    Out<uint8_t> marks(call, mask);
    const int32_t n = data.y.size();
    if (const int32_t status = data.Check()) return call.Fail(status);
    if (list.size() < 1) return call.Fail(kEmptyInput);
    if (marks.Resize(n)) return call.Fail(kOutOfMemory);

    int32_t count = 0;
    int32_t status = call.Map();
    if (status == kOk) status = MaskByIndex(list.data(), list.size(), n, marks.data(), &count);
    if (status != kOk) return call.Fail(status);
    if (left.y.Resize(count) || left.x.Resize(count) || left.w.Resize(data.w.size() > 0 ? count : 0))
        return call.Fail(kOutOfMemory);
    return call.Run([&] {
        left.CopyFrom(data, marks.data());
        return kOk;
    });
}

int32_t RmvOutlierRng_head(KrHandle y, KrHandle x, KrHandle w, KrHandle range, int32_t selector, KrHandle yOut,
                           KrHandle xOut, KrHandle wOut, KrHandle removed) {
    ByValue call;
    DataSet data(call, y, x, w);
    In<double> bounds(call, range);
    Survivors left(call, yOut, xOut, wOut);
    Out<int32_t> indices(call, removed);
    const int32_t n = data.y.size();
    if (const int32_t status = data.Check()) return call.Fail(status);
    if (bounds.size() < 1) return call.Fail(kEmptyInput);

    Scratch<uint8_t> mask(Count(n));
    int32_t count = 0;
    int32_t status = mask ? call.Map() : kOutOfMemory;
    if (status == kOk) {
        status = MaskByRange(data.x.data(), data.y.data(), n, bounds.data(), bounds.size(), selector & 0xFFFF,
                             mask.data(), &count);
    }
    if (status != kOk) return call.Fail(status);
    if (left.y.Resize(count) || left.x.Resize(count) || indices.Resize(n - count) ||
        left.w.Resize(data.w.size() > 0 ? count : 0))
        return call.Fail(kOutOfMemory);
    return call.Run([&] {
        left.CopyFrom(data, mask.data());
        int32_t* index = indices.data();
        for (int32_t i = 0; i < n; ++i)
            if (mask[Count(i)] != 0) *index++ = i;
        return kOk;
    });
}

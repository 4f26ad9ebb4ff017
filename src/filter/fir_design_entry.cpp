#include <cstddef>
#include <limits>

#include "filter/equiripple.h"
#include "filter/fir_design.h"
#include "filter/narrowband_design.h"
#include "filter/narrowband_filter.h"
#include "frame/entry.h"
#include "krnumer/filter.h"

using namespace krnumer;

static_assert(sizeof(KrFirBand) == 32 && sizeof(FirBand) == 32);
static_assert(offsetof(KrFirBand, lowEdge) == 8 && offsetof(FirBand, low) == 8);
static_assert(offsetof(KrFirBand, highEdge) == 16 && offsetof(FirBand, high) == 16);
static_assert(offsetof(KrFirBand, weight) == 24 && offsetof(FirBand, weight) == 24);
static_assert(offsetof(KrNarrowbandFilter, factor) == 4 && offsetof(KrNarrowbandFilter, prototype) == 8);
static_assert(offsetof(KrNarrowbandFilter, interpolator) == 8 + sizeof(KrHandle));
static_assert(sizeof(KrNarrowbandFilter) == 8 + 2 * sizeof(KrHandle));

namespace {

template <class T>
int32_t FilterByNarrowband(KrHandle x, const KrNarrowbandFilter* filter, KrHandle y, int32_t* err) {
    ByReference call(err);
    In<T> signal(call, x);
    In<double> prototype(call, filter->prototype), interpolator(call, filter->interpolator);
    Out<T> filtered(call, y);
    NarrowbandParts parts{filter->type, filter->factor, nullptr, prototype.size(), nullptr, interpolator.size()};
    if (const int32_t status = parts.Check(signal.size())) return call.Fail(status);
    if (filtered.Resize(static_cast<int32_t>(parts.OutputSize(signal.size())))) return call.Fail(kOutOfMemory);
    return call.Run([&] {
        parts.prototype = prototype.data();
        parts.interpolator = interpolator.data();
        return FilterNarrowband(parts, signal.data(), signal.size(), filtered.data());
    });
}

int32_t Deliver(const Taps& taps, Out<double>& output) {
    if (output.Resize(taps.count)) return kOutOfMemory;
    if (taps.count > 0) output.Fill(taps.values.data());
    return kOk;
}

}  // namespace

int32_t FIRCoefs(const double* fs, const double* fl, const double* fh, const int32_t* taps, KrHandle h,
                 const int32_t* type, int32_t* err) {
    ByReference call(err);
    Out<double> response(call, h);
    if (*taps < 1) return call.Fail(kBadOrder);
    if (auto host = response.Resize(*taps)) return call.HostFailure(host);
    return call.Run([&] { return TruncatedIdealDesign(*fs, *fl, *fh, *type, response.data(), response.size()); });
}

int32_t Parks(const int32_t* taps, const double* fs, KrHandle bands, const int32_t* type, KrHandle h, double* ripple,
              const int32_t* maxIterations, int32_t* err) {
    constexpr int32_t kMemoryStatusOfHost = 2;
    ByReference call(err);
    In<FirBand> wanted(call, bands);
    Out<double> response(call, h);
    Result<double> deviation(call, ripple);
    const int64_t fir_class = int64_t{*type} + 1;
    if (*taps < 1) return call.Fail(kBadOrder);
    if (!IsFirClass(fir_class)) return call.Fail(kBadFrequency);
    if (wanted.size() < 1) return call.Fail(kBadBands);
    if (auto host = response.Resize(*taps)) return call.HostFailure(host);
    int32_t status = call.Map();
    if (status == kOk)
        status = EquirippleDesign(*taps, *fs, wanted.data(), wanted.size(), static_cast<FirClass>(fir_class),
                                  *maxIterations, response.data(), deviation.data());
    return status == kOutOfMemory ? call.HostFailure(kMemoryStatusOfHost) : call.Deliver(status);
}

int32_t FIRNarrowCoef_head(const double* fs, const double* fp, const double* fstop, const double* fc,
                           const double* ripple, const double* attenuation, const int32_t* type,
                           KrNarrowbandFilter* filter, int32_t* err) {
    ByReference call(err);
    Out<double> prototype(call, HandleField{&filter->prototype}),
        interpolator(call, HandleField{&filter->interpolator});
    NarrowbandFilter designed;
    int32_t status = NarrowbandDesign({*fs, *fp, *fstop, *fc, *ripple, *attenuation, *type}, &designed);
    if (status == kOk) status = Deliver(designed.prototype, prototype);
    if (status == kOk) status = Deliver(designed.interpolator, interpolator);
    if (status != kOk) return call.Fail(status);
    filter->type = designed.type;
    filter->factor = designed.factor;
    return call.Leave(kOk);
}

int32_t FIRnarrowFilter_head(KrHandle x, const KrNarrowbandFilter* filter, KrHandle y, int32_t* err) {
    return FilterByNarrowband<double>(x, filter, y, err);
}

int32_t CxSigFIRnarrowFilter_head(KrHandle x, const KrNarrowbandFilter* filter, KrHandle y, int32_t* err) {
    return FilterByNarrowband<Complex>(x, filter, y, err);
}

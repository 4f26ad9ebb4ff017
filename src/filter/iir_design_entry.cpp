#include <limits>

#include "filter/iir_design.h"
#include "frame/entry.h"
#include "krnumer/filter.h"

using namespace krnumer;

namespace {

template <class Core>
int32_t Design(Call& call, const FilterBand& band, KrHandle a, KrHandle b, Core core) {
    Out<double> feedback(call, a), feedforward(call, b);
    const CascadeLengths lengths = LengthsOf(band.order, band.type);
    if (lengths.a < 1 || lengths.b < 1) return call.Fail(kBadOrder);
    if (lengths.b > std::numeric_limits<int32_t>::max()) return call.Fail(kOutOfMemory);
    if (auto host = feedback.Resize(static_cast<int32_t>(lengths.a))) return call.HostFailure(host);
    if (auto host = feedforward.Resize(static_cast<int32_t>(lengths.b))) return call.HostFailure(host);
    return call.Run([&] {
        return core(CascadeOutput{feedback.data(), feedback.size(), feedforward.data(), feedforward.size()});
    });
}

}  // namespace

int32_t BWCoefs(const double* fs, const double* fl, const double* fh, const int32_t* order, const int32_t* type,
                KrHandle a, KrHandle b, int32_t* err) {
    ByReference call(err);
    const FilterBand band{*fs, *fl, *fh, *order, *type};
    return Design(call, band, a, b, [&](const CascadeOutput& output) { return ButterworthDesign(band, output); });
}

int32_t BesselCoefs(const double* fs, const double* fl, const double* fh, const int32_t* order, const int32_t* type,
                    KrHandle a, KrHandle b, int32_t* err) {
    ByReference call(err);
    const FilterBand band{*fs, *fl, *fh, *order, *type};
    return Design(call, band, a, b, [&](const CascadeOutput& output) { return BesselDesign(band, output); });
}

int32_t ChebyshevCoefs(const double* fs, const double* fl, const double* fh, const double* ripple, const int32_t* order,
                       const int32_t* type, KrHandle a, KrHandle b, int32_t* err) {
    ByReference call(err);
    const FilterBand band{*fs, *fl, *fh, *order, *type};
    return Design(call, band, a, b,
                  [&](const CascadeOutput& output) { return ChebyshevDesign(band, *ripple, output); });
}

int32_t InvChebyshevCoefs(const double* fs, const double* fl, const double* fh, const double* attenuation,
                          const int32_t* order, const int32_t* type, KrHandle a, KrHandle b, int32_t* err) {
    ByReference call(err);
    const FilterBand band{*fs, *fl, *fh, *order, *type};
    return Design(call, band, a, b,
                  [&](const CascadeOutput& output) { return InverseChebyshevDesign(band, *attenuation, output); });
}

int32_t EllipticCoefs(const double* fs, const double* fl, const double* fh, const double* ripple,
                      const double* attenuation, const int32_t* order, const int32_t* type, KrHandle a, KrHandle b,
                      int32_t* err) {
    ByReference call(err);
    const FilterBand band{*fs, *fl, *fh, *order, *type};
    return Design(call, band, a, b,
                  [&](const CascadeOutput& output) { return EllipticDesign(band, *ripple, *attenuation, output); });
}

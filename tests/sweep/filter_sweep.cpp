#include "krnumer/filter.h"

#include "sweep/sweep.h"

namespace {

const double kFs = 1000.0, kFl = 50.0, kFh = 120.0, kRipple = 1.0, kAttenuation = 40.0;
const int32_t kOrder = 3, kBandpass = 2;

}  // namespace

SWEEP(BWCoefs) {
    const KrHandle a = scene.OutDoubles(), b = scene.OutDoubles();
    return scene.Call([&] { return BWCoefs(&kFs, &kFl, &kFh, &kOrder, &kBandpass, a, b, scene.err()); });
}

SWEEP(BesselCoefs) {
    const KrHandle a = scene.OutDoubles(), b = scene.OutDoubles();
    return scene.Call([&] { return BesselCoefs(&kFs, &kFl, &kFh, &kOrder, &kBandpass, a, b, scene.err()); });
}

SWEEP(ChebyshevCoefs) {
    const KrHandle a = scene.OutDoubles(), b = scene.OutDoubles();
    return scene.Call(
        [&] { return ChebyshevCoefs(&kFs, &kFl, &kFh, &kRipple, &kOrder, &kBandpass, a, b, scene.err()); });
}

SWEEP(InvChebyshevCoefs) {
    const KrHandle a = scene.OutDoubles(), b = scene.OutDoubles();
    return scene.Call(
        [&] { return InvChebyshevCoefs(&kFs, &kFl, &kFh, &kAttenuation, &kOrder, &kBandpass, a, b, scene.err()); });
}

SWEEP(EllipticCoefs) {
    const KrHandle a = scene.OutDoubles(), b = scene.OutDoubles();
    return scene.Call([&] {
        return EllipticCoefs(&kFs, &kFl, &kFh, &kRipple, &kAttenuation, &kOrder, &kBandpass, a, b, scene.err());
    });
}

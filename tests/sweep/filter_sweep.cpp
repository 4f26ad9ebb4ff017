#include "krnumer/filter.h"

#include "sweep/sweep.h"

namespace {

const double kFs = 1000.0, kFl = 50.0, kFh = 120.0, kRipple = 1.0, kAttenuation = 40.0;
const int32_t kOrder = 3, kBandpass = 2, kBiquads = 0, kComplement = 4;
const uint8_t kContinue = 1;

}  // namespace

SWEEP(BWCoefs) {
    const KrHandle a = scene.OutDoubles(), b = scene.OutDoubles();
    return scene.Call(BWCoefs, &kFs, &kFl, &kFh, &kOrder, &kBandpass, a, b, scene.err());
}

SWEEP(BesselCoefs) {
    const KrHandle a = scene.OutDoubles(), b = scene.OutDoubles();
    return scene.Call(BesselCoefs, &kFs, &kFl, &kFh, &kOrder, &kBandpass, a, b, scene.err());
}

SWEEP(ChebyshevCoefs) {
    const KrHandle a = scene.OutDoubles(), b = scene.OutDoubles();
    return scene.Call(ChebyshevCoefs, &kFs, &kFl, &kFh, &kRipple, &kOrder, &kBandpass, a, b, scene.err());
}

SWEEP(InvChebyshevCoefs) {
    const KrHandle a = scene.OutDoubles(), b = scene.OutDoubles();
    return scene.Call(InvChebyshevCoefs, &kFs, &kFl, &kFh, &kAttenuation, &kOrder, &kBandpass, a, b, scene.err());
}

SWEEP(EllipticCoefs) {
    const KrHandle a = scene.OutDoubles(), b = scene.OutDoubles();
    return scene.Call(EllipticCoefs, &kFs, &kFl, &kFh, &kRipple, &kAttenuation, &kOrder, &kBandpass, a, b, scene.err());
}

// States of other lengths than the filters ask for, so that they are resized.
SWEEP(IIR_Filter) {
    const KrHandle x = scene.Replaced(scene.Doubles({1, 2, 3, 4})), a = scene.Doubles({1, -0.5, 0.25}),
                   b = scene.Doubles({1, 2}), forward = scene.Replaced(scene.Doubles({1, 2, 3})),
                   reverse = scene.Replaced(scene.Doubles({1}));
    return scene.Call(IIR_Filter, x, a, b, forward, reverse, &kContinue, scene.err());
}

SWEEP_MORE(IIR_Filter, continued) {
    const KrHandle x = scene.Replaced(scene.Doubles({1, 2, 3, 4})), a = scene.Doubles({1, -0.5, 0.25}),
                   b = scene.Doubles({1, 2}), forward = scene.Replaced(scene.Doubles({1})),
                   reverse = scene.Replaced(scene.Doubles({1, 2}));
    return scene.Call(IIR_Filter, x, a, b, forward, reverse, &kContinue, scene.err());
}

SWEEP(CxSigIIR_Filter) {
    const KrHandle x = scene.Replaced(scene.Complexes({{1, 2}, {3, 4}})), a = scene.Doubles({1, -0.5, 0.25}),
                   b = scene.Doubles({1, 2}), forward = scene.Replaced(scene.Complexes({})),
                   reverse = scene.Replaced(scene.Complexes({{1, 1}}));
    return scene.Call(CxSigIIR_Filter, x, a, b, forward, reverse, &kContinue, scene.err());
}

SWEEP(CxIIR_Filter_H) {
    const KrHandle x = scene.Replaced(scene.Complexes({{1, 2}, {3, 4}})), a = scene.Complexes({{1, 0}, {0, -0.5}}),
                   b = scene.Complexes({{1, 2}, {0, 1}}), forward = scene.Replaced(scene.Complexes({})),
                   reverse = scene.Replaced(scene.Complexes({}));
    return scene.Call(CxIIR_Filter_H, x, a, b, forward, reverse, &kContinue, scene.err());
}

SWEEP(CxIIRReSig_Filter_H) {
    const KrHandle x = scene.Doubles({1, 2, 3}), y = scene.OutComplexes(), a = scene.Complexes({{1, 0}, {0, -0.5}}),
                   b = scene.Complexes({{1, 2}, {0, 1}}), forward = scene.Replaced(scene.Doubles({})),
                   reverse = scene.Replaced(scene.Complexes({}));
    return scene.Call(CxIIRReSig_Filter_H, x, y, a, b, forward, reverse, &kContinue);
}

SWEEP(IIR_Filter2) {
    const KrHandle x = scene.Replaced(scene.Doubles({1, 2, 3, 4})), a = scene.Doubles({-0.5, 0.25}),
                   b = scene.Doubles({1, 2, 1}), state = scene.Replaced(scene.Doubles({1}));
    return scene.Call(IIR_Filter2, x, &kBiquads, a, b, state, &kContinue, scene.err());
}

SWEEP(CxSigIIR_Filter2) {
    const KrHandle x = scene.Replaced(scene.Complexes({{1, 2}, {3, 4}})), a = scene.Doubles({-0.5, 0.25}),
                   b = scene.Doubles({1, 2, 1}), state = scene.Replaced(scene.Complexes({{1, 2}}));
    return scene.Call(CxSigIIR_Filter2, x, &kBiquads, a, b, state, &kContinue, scene.err());
}

SWEEP(FIRCoefs) {
    const int32_t taps = 9;
    const KrHandle h = scene.OutDoubles();
    return scene.Call(FIRCoefs, &kFs, &kFl, &kFh, &taps, h, &kBandpass, scene.err());
}

SWEEP(Parks) {
    const int32_t taps = 12, multiband = 0, rounds = 0;
    const KrHandle bands = scene.Records<KrFirBand>({{1, 0, 100, 1}, {0, 180, 500, 2}}), h = scene.OutDoubles();
    double* const ripple = scene.Number();
    return scene.Call(Parks, &taps, &kFs, bands, &multiband, h, ripple, &rounds, scene.err());
}

SWEEP(FIRNarrowCoef_head) {
    const double fp = 10, fstop = 30, fc = 0, ripple = 0.1, attenuation = 30;
    const int32_t lowpass = 0;
    KrNarrowbandFilter filter{-1, -1, scene.OutDoubles(), scene.OutDoubles()};
    return scene.Call(FIRNarrowCoef_head, &kFs, &fp, &fstop, &fc, &ripple, &attenuation, &lowpass, &filter,
                      scene.err());
}

SWEEP(FIRnarrowFilter_head) {
    const KrHandle x = scene.Doubles({1, 2, 3, 4, 5}), y = scene.OutDoubles();
    const KrNarrowbandFilter filter{kComplement, 2, scene.Doubles({1, 2, 1}), scene.Doubles({1, 1})};
    return scene.Call(FIRnarrowFilter_head, x, &filter, y, scene.err());
}

SWEEP(CxSigFIRnarrowFilter_head) {
    const KrHandle x = scene.Complexes({{1, 2}, {3, 4}, {5, 6}}), y = scene.OutComplexes();
    const KrNarrowbandFilter filter{kComplement, 2, scene.Doubles({1, 2, 1}), scene.Doubles({1, 1})};
    return scene.Call(CxSigFIRnarrowFilter_head, x, &filter, y, scene.err());
}

SWEEP(MedianFilterCIN) {
    const int32_t rank = 1;
    const KrHandle x = scene.Replaced(scene.Doubles({3, 1, 4, 1, 5}));
    return scene.Call(MedianFilterCIN, x, &rank, scene.err());
}

SWEEP(MedianFilter81_H) {
    const KrHandle x = scene.Replaced(scene.Doubles({3, 1, 4, 1, 5}));
    return scene.Call(MedianFilter81_H, x, 2, 1);
}

SWEEP(SavitzkyGolayCoefH) {
    const KrHandle weights = scene.Doubles({1, 2, 3, 2, 1}), smoothing = scene.OutMatrix(),
                   differentiators = scene.OutMatrix();
    return scene.Call(SavitzkyGolayCoefH, 2, 5, weights, 1, smoothing, differentiators);
}

SWEEP(SavitzkyGolayFiltH) {
    const KrHandle x = scene.Doubles({3, 1, 4, 1, 5, 9}), weights = scene.Doubles({}), y = scene.OutDoubles();
    return scene.Call(SavitzkyGolayFiltH, x, 2, 5, weights, y);
}

SWEEP(zeroPhaseFiltH) {
    const KrHandle x = scene.Replaced(scene.Doubles({3, 1, 4}), sweep::OnFailure::kOther), a = scene.Doubles({1, -0.5}),
                   b = scene.Doubles({1, 2, 1}), forward1 = scene.Replaced(scene.Doubles({})),
                   forward2 = scene.Replaced(scene.Doubles({})), reverse1 = scene.Replaced(scene.Doubles({})),
                   reverse2 = scene.Replaced(scene.Doubles({}));
    return scene.Call(zeroPhaseFiltH, x, a, b, forward1, forward2, reverse1, reverse2, 0);
}

#include "krnumer/noise.h"

#include "sweep/sweep.h"

namespace {

constexpr int32_t kSamples = 6;
constexpr int32_t kSeed = 42;
constexpr double kScale = 2.0;

template <class Riffle>
int32_t PlayRiffle(sweep::Scene& scene, KrHandle elements, Riffle riffle) {
    const KrHandle x = scene.Replaced(elements);
    // A positive status of the host does not count while the indices are long enough, and these are not.
    const KrHandle indices = scene.OutIntegers();
    KrRandomState state{};
    return scene.Call(riffle, x, indices, kSeed, &state);
}

}  // namespace

SWEEP(white) {
    const KrHandle x = scene.OutDoubles();
    KrRandomState state{};
    return scene.Call(white, x, &kSamples, &kScale, &kSeed, scene.err(), &state);
}

SWEEP(Gauss) {
    const KrHandle x = scene.OutDoubles();
    KrRandomState state{};
    KrGaussSpare spare{};
    return scene.Call(Gauss, x, &kSamples, &kScale, &kSeed, scene.err(), &state, &spare);
}

SWEEP(PeriodNoise) {
    const KrHandle x = scene.OutDoubles();
    KrRandomState state{};
    return scene.Call(PeriodNoise, &kSamples, &kScale, &kSeed, x, scene.err(), &state);
}

SWEEP(BinomialNoiseH) {
    const KrHandle x = scene.OutIntegers();
    KrRandomState state{};
    KrBinomialCache cache{};
    return scene.Call(BinomialNoiseH, x, kSamples, 100, 0.4, kSeed, &state, &cache);
}

SWEEP(GammaNoiseH) {
    const KrHandle x = scene.OutDoubles();
    KrRandomState state{};
    return scene.Call(GammaNoiseH, x, kSamples, 7, kSeed, &state);
}

SWEEP(PoissonNoiseH) {
    const KrHandle x = scene.OutDoubles();
    KrRandomState state{};
    return scene.Call(PoissonNoiseH, x, kSamples, 20.0, kSeed, &state);
}

SWEEP(RiffleArrayDBL_head) {
    return PlayRiffle(scene, scene.Doubles({1, 2, 3, 4}), RiffleArrayDBL_head);
}
SWEEP(RiffleArrayCDB_head) {
    return PlayRiffle(scene, scene.Complexes({{1, 2}, {3, 4}, {5, 6}, {7, 8}}), RiffleArrayCDB_head);
}
SWEEP(RiffleArrayInt_head) {
    return PlayRiffle(scene, scene.Integers({1, 2, 3, 4}), RiffleArrayInt_head);
}

SWEEP(RiffleIntNum_head) {
    const KrHandle x = scene.OutIntegers();
    KrRandomState state{};
    return scene.Call(RiffleIntNum_head, x, kSamples, kSeed, &state);
}

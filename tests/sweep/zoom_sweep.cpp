#include "krnumer/zoom.h"

#include "sweep/sweep.h"

namespace {

const std::vector<double> kReal{1, 4, -2, 3, 0.5, 7};
const std::vector<krnumer::Complex> kComplex{{1, 2}, {4, -1}, {-2, 3}, {3, 0}, {0.5, 1}};
constexpr KrComplex kA{1.0, 0.5};
constexpr KrComplex kW{0.8, -0.6};

template <class Transform>
int32_t PlayChirp(sweep::Scene& scene, Transform transform, KrHandle x, int32_t algorithm) {
    const KrHandle y = scene.OutComplexes();
    return scene.Call(transform, x, &kA, &kW, 4, algorithm, y);
}

template <class Transform>
int32_t PlayZoom(sweep::Scene& scene, Transform transform, KrHandle x) {
    const KrHandle y = scene.OutComplexes();
    void* slot = nullptr;
    return scene.Call(transform, x, 2, 3, -1, 4, y, &slot);
}

}  // namespace

SWEEP(ChirpZT_head) {
    return PlayChirp(scene, ChirpZT_head, scene.Doubles(kReal), 0);
}
SWEEP_MORE(ChirpZT_head, convolved) {
    return PlayChirp(scene, ChirpZT_head, scene.Doubles(kReal), 1);
}
SWEEP(CxChirpZT_head) {
    return PlayChirp(scene, CxChirpZT_head, scene.Complexes(kComplex), 0);
}
SWEEP_MORE(CxChirpZT_head, convolved) {
    return PlayChirp(scene, CxChirpZT_head, scene.Complexes(kComplex), 1);
}

SWEEP(InvChirpZT_head) {
    const KrHandle x = scene.Complexes(kComplex);
    const KrHandle y = scene.OutComplexes();
    return scene.Call(InvChirpZT_head, x, &kA, &kW, 3, y);
}

SWEEP(CxDZTH) {
    return PlayZoom(scene, CxDZTH, scene.Complexes(kComplex));
}
SWEEP(ReDZTH) {
    return PlayZoom(scene, ReDZTH, scene.Doubles(kReal));
}

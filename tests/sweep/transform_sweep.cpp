#include "krnumer/spectrum.h"
#include "krnumer/transform.h"
#include "sweep/sweep.h"

namespace {

const std::vector<double> kReal{1, 4, -2, 3, 0.5, 7};
const std::vector<krnumer::Complex> kComplex{{1, 2}, {4, -1}, {-2, 3}, {3, 0}, {0.5, 1}};

template <class Transform>
int32_t PlayInPlace(sweep::Scene& scene, Transform transform) {
    const KrHandle x = scene.Replaced(scene.Doubles(kReal));
    void* slot = nullptr;
    return scene.Call(transform, x, &slot);
}

template <class Transform>
int32_t PlayForward(sweep::Scene& scene, Transform transform) {
    const KrHandle x = scene.Doubles(kReal);
    const KrHandle y = scene.OutDoubles(sweep::OnFailure::kOther);
    void* slot = nullptr;
    return scene.Call(transform, x, y, 7, &slot);
}

template <class Transform>
int32_t PlayInverse(sweep::Scene& scene, Transform transform) {
    const KrHandle x = scene.Doubles(kReal);
    const KrHandle y = scene.OutDoubles();
    void* slot = nullptr;
    return scene.Call(transform, x, y, &slot);
}

template <class Transform>
int32_t PlayForwardMatrix(sweep::Scene& scene, Transform transform) {
    const KrHandle x = scene.Matrix(2, 3, kReal);
    const KrHandle y = scene.OutMatrix();
    void* slots[2] = {};
    return scene.Call(transform, x, y, 3, 0, &slots[0], &slots[1]);
}

template <class Transform>
int32_t PlayInverseMatrix(sweep::Scene& scene, Transform transform) {
    const KrHandle x = scene.Matrix(2, 3, kReal);
    const KrHandle y = scene.OutMatrix();
    void* slots[2] = {};
    return scene.Call(transform, x, y, &slots[0], &slots[1]);
}

}  // namespace

SWEEP(DCT_1DH) {
    return PlayForward(scene, DCT_1DH);
}
SWEEP(DST_1DH) {
    return PlayForward(scene, DST_1DH);
}
SWEEP(InvDCT_1DH) {
    return PlayInverse(scene, InvDCT_1DH);
}
SWEEP(InvDST_1DH) {
    return PlayInverse(scene, InvDST_1DH);
}
SWEEP(DCT_2DH) {
    return PlayForwardMatrix(scene, DCT_2DH);
}
SWEEP(DST_2DH) {
    return PlayForwardMatrix(scene, DST_2DH);
}
SWEEP(InvDCT_2DH) {
    return PlayInverseMatrix(scene, InvDCT_2DH);
}
SWEEP(InvDST_2DH) {
    return PlayInverseMatrix(scene, InvDST_2DH);
}
SWEEP(FastHilbertTransformH) {
    return PlayInPlace(scene, FastHilbertTransformH);
}
SWEEP(InvFastHilbertTransformH) {
    return PlayInPlace(scene, InvFastHilbertTransformH);
}
SWEEP(FHTH) {
    return PlayInPlace(scene, FHTH);
}
SWEEP(InvFHTH) {
    return PlayInPlace(scene, InvFHTH);
}
SWEEP(SpectrumH) {
    return PlayInPlace(scene, SpectrumH);
}

SWEEP(CxSpectrumH) {
    const KrHandle x = scene.Complexes(kComplex);
    const KrHandle y = scene.OutDoubles();
    void* slot = nullptr;
    return scene.Call(CxSpectrumH, x, y, &slot);
}

SWEEP(CrossSpectrumH) {
    const KrHandle x = scene.Doubles(kReal);
    const KrHandle y = scene.Doubles({2, 0, 1, -1, 3, 2});
    const KrHandle z = scene.OutComplexes();
    void* slot = nullptr;
    return scene.Call(CrossSpectrumH, x, y, z, &slot);
}

SWEEP(CxCrossSpectrumH) {
    const KrHandle x = scene.Complexes(kComplex);
    const KrHandle y = scene.Complexes({{2, 0}, {1, -1}, {3, 2}, {0, 1}, {1, 1}});
    const KrHandle z = scene.OutComplexes();
    void* slot = nullptr;
    return scene.Call(CxCrossSpectrumH, x, y, z, &slot);
}

SWEEP(ReCascadedMovingAverageH) {
    scene.SurvivesRefusedResize();
    const KrHandle x = scene.Replaced(scene.Doubles(kReal), sweep::OnFailure::kOther);
    const KrHandle sums = scene.OutDoubles(sweep::OnFailure::kOther);
    const KrHandle history = scene.OutMatrix(sweep::OnFailure::kOther);
    int32_t* index = scene.Integer(0);
    return scene.Call(ReCascadedMovingAverageH, x, 2, 3, sums, history, index, 1);
}

SWEEP(CxCascadedMovingAverageH) {
    scene.SurvivesRefusedResize();
    const KrHandle x = scene.Replaced(scene.Complexes(kComplex), sweep::OnFailure::kOther);
    const KrHandle sums = scene.OutComplexes(sweep::OnFailure::kOther);
    const KrHandle history = scene.OutComplexMatrix(sweep::OnFailure::kOther);
    int32_t* index = scene.Integer(0);
    return scene.Call(CxCascadedMovingAverageH, x, 2, 3, sums, history, index, 1);
}

SWEEP(ReDecimatedMovingAverageH) {
    const KrHandle x = scene.Replaced(scene.Doubles(kReal));
    double* sum = scene.State(1.5);
    int32_t* count = scene.Integer(2);
    int32_t* out_count = scene.Integer(-1);
    return scene.Call(ReDecimatedMovingAverageH, x, 3, sum, count, 0, out_count);
}

SWEEP(CxDecimatedMovingAverageH) {
    const KrHandle x = scene.Replaced(scene.Complexes(kComplex));
    KrComplex sum{1.5, -2};
    int32_t* count = scene.Integer(2);
    int32_t* out_count = scene.Integer(-1);
    return scene.Call(CxDecimatedMovingAverageH, x, 3, &sum, count, 0, out_count);
}

SWEEP(ReComplexModulatorH) {
    scene.SurvivesRefusedResize();
    const KrHandle x = scene.Doubles(kReal);
    double* phase = scene.State(0.25);
    const KrHandle y = scene.OutComplexes();
    return scene.Call(ReComplexModulatorH, x, 3.0, 10.0, phase, y);
}

SWEEP(CxComplexModulatorH) {
    const KrHandle x = scene.Replaced(scene.Complexes(kComplex));
    double* phase = scene.State(0.25);
    return scene.Call(CxComplexModulatorH, x, 3.0, 10.0, phase);
}

#include "krnumer/linalg_measures.h"

#include "sweep/sweep.h"

namespace {

KrHandle Definite(sweep::Scene& scene) {
    return scene.Matrix(3, 3, {4, 1, 0, 1, 3, 1, 0, 1, 2});
}
KrHandle ComplexDefinite(sweep::Scene& scene) {
    return scene.ComplexMatrix(2, 2, {{4, 0}, {1, 1}, {1, -1}, {3, 0}});
}

}  // namespace

SWEEP(Determinant_head) {
    const KrHandle a = Definite(scene);
    const int32_t type = 0;
    double* det = scene.Number();
    return scene.Call(Determinant_head, a, &type, det, scene.err());
}

SWEEP_MORE(Determinant_head, definite) {
    const KrHandle a = Definite(scene);
    const int32_t type = 1;
    double* det = scene.Number();
    return scene.Call(Determinant_head, a, &type, det, scene.err());
}

SWEEP(CxDeterminant_head) {
    const KrHandle a = ComplexDefinite(scene);
    const int32_t type = 0;
    KrComplex* det = scene.ComplexNumber();
    return scene.Call(CxDeterminant_head, a, &type, det, scene.err());
}

SWEEP(Rank_head) {
    const KrHandle a = Definite(scene);
    const double tol = -1.0;
    int32_t* rank = scene.Integer(5);
    return scene.Call(Rank_head, a, &tol, rank, scene.err());
}

SWEEP(CxRank_head) {
    const KrHandle a = ComplexDefinite(scene);
    const double tol = -1.0;
    int32_t* rank = scene.Integer(5);
    return scene.Call(CxRank_head, a, &tol, rank, scene.err());
}

SWEEP(Norm_head) {
    const KrHandle a = Definite(scene);
    const int32_t norm_type = 0;
    double* norm = scene.Number();
    return scene.Call(Norm_head, a, &norm_type, norm, scene.err());
}

SWEEP(CxNorm_head) {
    const KrHandle a = ComplexDefinite(scene);
    const int32_t norm_type = 1;
    double* norm = scene.Number();
    return scene.Call(CxNorm_head, a, &norm_type, norm, scene.err());
}

SWEEP(CondNumber_head) {
    const KrHandle a = Definite(scene);
    const int32_t norm_type = 1;
    double* cond = scene.Number();
    return scene.Call(CondNumber_head, a, &norm_type, cond, scene.err());
}

SWEEP(CxCondNumber_head) {
    const KrHandle a = ComplexDefinite(scene);
    const int32_t norm_type = 3;
    double* cond = scene.Number();
    return scene.Call(CxCondNumber_head, a, &norm_type, cond, scene.err());
}

SWEEP(CheckPosdef_head) {
    const KrHandle a = Definite(scene);
    int32_t* flag = scene.Integer(5);
    return scene.Call(CheckPosdef_head, a, flag, scene.err());
}

SWEEP(CxCheckPosdef_head) {
    const KrHandle a = ComplexDefinite(scene);
    int32_t* flag = scene.Integer(5);
    return scene.Call(CxCheckPosdef_head, a, flag, scene.err());
}

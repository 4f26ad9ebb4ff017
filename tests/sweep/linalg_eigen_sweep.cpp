#include "krnumer/linalg_eigen.h"

#include "sweep/sweep.h"

SWEEP(EigenValueVector_head) {
    const KrHandle a = scene.Matrix(3, 3, {1, 2, -3, 4, 5, 6, 7, 8, 10});
    const int32_t want_vectors = 1;
    const KrHandle w = scene.OutComplexes();
    const KrHandle v = scene.OutComplexMatrix();
    return scene.Call(EigenValueVector_head, a, &want_vectors, w, v, scene.err());
}

SWEEP(CxEigenValueVector_head) {
    const KrHandle a = scene.Replaced(scene.ComplexMatrix(2, 2, {{1, 2}, {3, -4}, {5, 6}, {7, 0}}));
    const int32_t kind = 0;
    const int32_t want_vectors = 1;
    const KrHandle w = scene.OutComplexes();
    return scene.Call(CxEigenValueVector_head, a, &kind, &want_vectors, w, scene.err());
}

SWEEP_MORE(CxEigenValueVector_head, hermitian) {
    const KrHandle a = scene.Replaced(scene.ComplexMatrix(2, 2, {{1, 0}, {3, -4}, {3, 4}, {7, 0}}));
    const int32_t kind = 1;
    const int32_t want_vectors = 1;
    const KrHandle w = scene.OutComplexes();
    return scene.Call(CxEigenValueVector_head, a, &kind, &want_vectors, w, scene.err());
}

SWEEP_MORE(CxEigenValueVector_head, values) {
    const KrHandle a = scene.Replaced(scene.ComplexMatrix(2, 2, {{1, 0}, {3, -4}, {3, 4}, {7, 0}}));
    const int32_t kind = 1;
    const int32_t want_vectors = 0;
    const KrHandle w = scene.OutComplexes();
    return scene.Call(CxEigenValueVector_head, a, &kind, &want_vectors, w, scene.err());
}

SWEEP(SymEvectorEvalue_head) {
    const KrHandle a = scene.Replaced(scene.Matrix(3, 3, {2, 1, 0, 1, 3, 1, 0, 1, 4}));
    const int32_t want_vectors = 1;
    const KrHandle w = scene.OutDoubles();
    return scene.Call(SymEvectorEvalue_head, a, &want_vectors, w, scene.err());
}

SWEEP(MatrixCharacteristicPoly_head) {
    const KrHandle a = scene.Matrix(2, 2, {1, 2, 3, 4});
    const KrHandle c = scene.OutDoubles();
    return scene.Call(MatrixCharacteristicPoly_head, a, c, scene.err());
}

SWEEP(CreateMatrixFromEVs_head) {
    const KrHandle lambda = scene.Complexes({{1, 2}, {1, -2}, {3, 0}});
    const KrHandle m = scene.OutMatrix();
    return scene.Call(CreateMatrixFromEVs_head, lambda, m, scene.err());
}

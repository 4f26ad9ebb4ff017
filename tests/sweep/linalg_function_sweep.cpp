#include "krnumer/linalg_function.h"

#include "sweep/sweep.h"

namespace {

KrHandle Real(sweep::Scene& scene) {
    return scene.Matrix(3, 3, {2, 1, 0, 1, 3, 1, 0, 1, 4});
}
KrHandle Complex(sweep::Scene& scene) {
    return scene.ComplexMatrix(2, 2, {{2, 1}, {1, 0}, {0, -1}, {3, 0}});
}

template <class Function>
int32_t PlayInPlace(sweep::Scene& scene, Function function, KrHandle matrix) {
    const KrHandle a = scene.Replaced(matrix);
    return scene.Call(function, a, scene.err());
}

}  // namespace

SWEEP(MatrixExp_head) {
    return PlayInPlace(scene, MatrixExp_head, Real(scene));
}
SWEEP(CxMatrixExp_head) {
    return PlayInPlace(scene, CxMatrixExp_head, Complex(scene));
}
SWEEP(CxMatrixLn_head) {
    return PlayInPlace(scene, CxMatrixLn_head, Complex(scene));
}
SWEEP(MatrixSqrt_head) {
    return PlayInPlace(scene, MatrixSqrt_head, Real(scene));
}
SWEEP(CxMatrixSqrt_head) {
    return PlayInPlace(scene, CxMatrixSqrt_head, Complex(scene));
}

SWEEP(MatrixLn_head) {
    const KrHandle a = Real(scene);
    const KrHandle l = scene.OutComplexMatrix();
    return scene.Call(MatrixLn_head, a, l, scene.err());
}

SWEEP(MatrixSqrtH) {
    const KrHandle a = Real(scene);
    const KrHandle s = scene.OutComplexMatrix();
    return scene.Call(MatrixSqrtH, a, s);
}

SWEEP(MatrixPower_head) {
    const KrHandle a = scene.Replaced(Real(scene));
    return scene.Call(MatrixPower_head, a, -5);
}

SWEEP(CxMatrixPower_head) {
    const KrHandle a = scene.Replaced(Complex(scene));
    return scene.Call(CxMatrixPower_head, a, 6);
}

#include "krnumer/linalg_schur.h"

#include "linalg/element.h"
#include "sweep/sweep.h"

namespace {

using krnumer::Complex;

// A matrix of three rows, and another that makes a pencil of them.
template <class T>
KrHandle First(sweep::Scene& scene) {
    if constexpr (krnumer::kIsComplex<T>) {
        return scene.Replaced(
            scene.ComplexMatrix(3, 3, {{1, 1}, {2, 0}, {0, -1}, {4, 0}, {-1, 2}, {3, 0}, {0, 1}, {2, 2}, {5, 0}}));
    } else {
        return scene.Replaced(scene.Matrix(3, 3, {1, 2, 0, -4, -1, 3, 1, 2, 5}));
    }
}
template <class T>
KrHandle Second(sweep::Scene& scene) {
    if constexpr (krnumer::kIsComplex<T>) {
        return scene.Replaced(
            scene.ComplexMatrix(3, 3, {{2, 0}, {0, 1}, {0, 0}, {1, 0}, {3, 0}, {1, 1}, {0, 0}, {1, 0}, {2, -1}}));
    } else {
        return scene.Replaced(scene.Matrix(3, 3, {2, 1, 0, 1, 3, 1, 0, 1, 2}));
    }
}
template <class T>
KrHandle OutputMatrix(sweep::Scene& scene) {
    return krnumer::kIsComplex<T> ? scene.OutComplexMatrix() : scene.OutMatrix();
}
template <class T>
KrHandle OutputVector(sweep::Scene& scene) {
    return krnumer::kIsComplex<T> ? scene.OutComplexes() : scene.OutDoubles();
}

template <class T, class Function>
int32_t PlayHessenberg(sweep::Scene& scene, Function function) {
    const KrHandle a = First<T>(scene);
    const KrHandle q = OutputMatrix<T>(scene);
    return scene.Call(function, a, 0, 2, q);
}

template <class T, class Function>
int32_t PlayBalance(sweep::Scene& scene, Function function) {
    const KrHandle a = First<T>(scene);
    int32_t* ilo = scene.Integer(-1);
    int32_t* ihi = scene.Integer(-1);
    const KrHandle scale = scene.OutDoubles();
    return scene.Call(function, a, 3, ilo, ihi, scale);
}

template <class T, class Function>
int32_t PlayBack(sweep::Scene& scene, Function function) {
    const KrHandle v = First<T>(scene);
    const KrHandle scale = scene.Doubles({2, 0.5, 1});
    return scene.Call(function, v, 3, 0, 0, 1, scale);
}

template <class T, class Function, class... Order>
int32_t PlaySchur(sweep::Scene& scene, Function function, Order... order) {
    const KrHandle a = First<T>(scene);
    const KrHandle z = OutputMatrix<T>(scene);
    const KrHandle w = scene.OutComplexes();
    return scene.Call(function, a, 1, order..., z, w);
}

template <class T, class Function, class... Settings>
int32_t PlayQZ(sweep::Scene& scene, Function function, Settings... settings) {
    const KrHandle a = First<T>(scene);
    const KrHandle b = Second<T>(scene);
    const KrHandle alpha = scene.OutComplexes();
    const KrHandle beta = OutputVector<T>(scene);
    const KrHandle v = scene.OutComplexMatrix();
    return scene.Call(function, a, b, settings..., alpha, beta, v);
}

template <class T, class Function>
int32_t PlayWholeQZ(sweep::Scene& scene, Function function) {
    const KrHandle a = First<T>(scene);
    const KrHandle b = Second<T>(scene);
    const KrHandle q = OutputMatrix<T>(scene);
    const KrHandle z = OutputMatrix<T>(scene);
    const KrHandle alpha = scene.OutComplexes();
    const KrHandle beta = OutputVector<T>(scene);
    const KrHandle vr = OutputMatrix<T>(scene);
    const KrHandle vl = OutputMatrix<T>(scene);
    return scene.Call(function, a, b, q, z, alpha, beta, 3, vr, vl);
}

template <class T, class Function>
int32_t PlayPencil(sweep::Scene& scene, Function function) {
    const KrHandle a = scene.Replaced(First<T>(scene), sweep::OnFailure::kOther);
    const KrHandle b = scene.Replaced(Second<T>(scene), sweep::OnFailure::kOther);
    const KrHandle w = scene.OutComplexes();
    const KrHandle v = scene.OutComplexMatrix();
    return scene.Call(function, a, b, 1, w, v);
}

}  // namespace

SWEEP(Hessenberg_head) {
    return PlayHessenberg<double>(scene, Hessenberg_head);
}
SWEEP(CxHessenberg_head) {
    return PlayHessenberg<Complex>(scene, CxHessenberg_head);
}
SWEEP(MatrixBalance_head) {
    return PlayBalance<double>(scene, MatrixBalance_head);
}
SWEEP(CxMatrixBalance_head) {
    return PlayBalance<Complex>(scene, CxMatrixBalance_head);
}
SWEEP(EigenVBack_head) {
    return PlayBack<double>(scene, EigenVBack_head);
}
SWEEP(CxEigenVBack_head) {
    return PlayBack<Complex>(scene, CxEigenVBack_head);
}
SWEEP(Schur_head) {
    return PlaySchur<double>(scene, Schur_head);
}
SWEEP(CxSchur_head) {
    return PlaySchur<Complex>(scene, CxSchur_head);
}
SWEEP(Schur80_head) {
    return PlaySchur<double>(scene, Schur80_head, 3);
}
SWEEP(CxSchur80_head) {
    return PlaySchur<Complex>(scene, CxSchur80_head, 3);
}
SWEEP(QZ_head) {
    return PlayQZ<double>(scene, QZ_head);
}
SWEEP(CxQZ_head) {
    return PlayQZ<Complex>(scene, CxQZ_head);
}
SWEEP(QZ80_head) {
    return PlayQZ<double>(scene, QZ80_head, 1, 3);
}
SWEEP(CxQZ80_head) {
    return PlayQZ<Complex>(scene, CxQZ80_head, 1, 3);
}
SWEEP(TmiQZ_head) {
    return PlayWholeQZ<double>(scene, TmiQZ_head);
}
SWEEP(CxTmiQZ_head) {
    return PlayWholeQZ<Complex>(scene, CxTmiQZ_head);
}
SWEEP(GenEigenEx_head) {
    return PlayPencil<double>(scene, GenEigenEx_head);
}
SWEEP(CxGenEigenEx_head) {
    return PlayPencil<Complex>(scene, CxGenEigenEx_head);
}

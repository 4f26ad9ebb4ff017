#include "krnumer/linalg_factor.h"
#include "sweep/sweep.h"

namespace {

const std::vector<double> kSix = {1, 2, 3, 4, 5, 7};
const std::vector<krnumer::Complex> kComplexSix = {{1, 6}, {2, 5}, {3, 4}, {4, 3}, {5, 2}, {6, 1}};

}  // namespace

SWEEP(LU_head) {
    const KrHandle a = scene.Replaced(scene.Matrix(2, 2, {1, 2, 3, 4})),
                   p = scene.OutDoubles(sweep::OnFailure::kEmptied);
    int32_t* const sign = scene.Integer(5);
    return scene.Call(LU_head, a, p, sign, scene.err());
}

SWEEP(CxLU_head) {
    const KrHandle a = scene.Replaced(scene.ComplexMatrix(2, 2, {{1, 2}, {3, 4}, {5, 6}, {7, 8}})),
                   p = scene.OutDoubles();
    int32_t* const sign = scene.Integer(5);
    return scene.Call(CxLU_head, a, p, sign, scene.err());
}

SWEEP(Cholesky_head) {
    const KrHandle l = scene.Replaced(scene.Doubles({4, 2, 1, 5, 2, 6}));
    return scene.Call(Cholesky_head, l, scene.err());
}

SWEEP(CxCholesky_head) {
    const KrHandle l = scene.Replaced(scene.Complexes({{4, 0}, {2, 1}, {5, 0}}));
    return scene.Call(CxCholesky_head, l, scene.err());
}

SWEEP(FullCholesky_head) {
    const KrHandle a = scene.Replaced(scene.Matrix(2, 2, {4, 2, 2, 5}));
    return scene.Call(FullCholesky_head, a, scene.err());
}

SWEEP(CxFullCholesky_head) {
    const KrHandle a = scene.Replaced(scene.ComplexMatrix(2, 2, {{4, 0}, {2, -1}, {2, 1}, {5, 0}}));
    return scene.Call(CxFullCholesky_head, a, scene.err());
}

SWEEP(QRDecH) {
    const KrHandle a = scene.Matrix(3, 2, kSix), p = scene.OutIntegerMatrix(), q = scene.OutMatrix(),
                   r = scene.OutMatrix();
    return scene.Call(QRDecH, a, 1, 0, p, q, r);
}

SWEEP_MORE(QRDecH, economy) {
    const KrHandle a = scene.Matrix(2, 3, kSix), p = scene.OutIntegerMatrix(), q = scene.OutMatrix(),
                   r = scene.OutMatrix();
    return scene.Call(QRDecH, a, 0, 1, p, q, r);
}

SWEEP(CxQRDecH) {
    const KrHandle a = scene.ComplexMatrix(3, 2, kComplexSix), p = scene.OutIntegerMatrix(),
                   q = scene.OutComplexMatrix(), r = scene.OutComplexMatrix();
    return scene.Call(CxQRDecH, a, 1, 0, p, q, r);
}

SWEEP_MORE(CxQRDecH, r_only) {
    const KrHandle a = scene.ComplexMatrix(3, 2, kComplexSix), p = scene.OutIntegerMatrix(),
                   q = scene.OutComplexMatrix(), r = scene.OutComplexMatrix();
    return scene.Call(CxQRDecH, a, 0, 2, p, q, r);
}

SWEEP(qrd_head) {
    const int32_t method = 2;
    const KrHandle a = scene.Matrix(3, 2, kSix), q = scene.OutMatrix(), r = scene.OutMatrix();
    return scene.Call(qrd_head, a, &method, q, r, scene.err());
}

SWEEP(Cxqrd_head) {
    const KrHandle a = scene.ComplexMatrix(2, 3, kComplexSix), q = scene.OutComplexMatrix(),
                   r = scene.OutComplexMatrix();
    return scene.Call(Cxqrd_head, a, nullptr, q, r, scene.err());
}

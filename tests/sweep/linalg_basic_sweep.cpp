#include "krnumer/linalg_basic.h"
#include "sweep/sweep.h"

namespace {

const std::vector<double> kSix = {1, 2, 3, 4, 5, 6};
const std::vector<krnumer::Complex> kComplexSix = {{1, 6}, {2, 5}, {3, 4}, {4, 3}, {5, 2}, {6, 1}};

}  // namespace

SWEEP(DotProduct_head) {
    const KrHandle x = scene.Doubles(kSix);
    double* const dot = scene.Number();
    return scene.Call(DotProduct_head, x, x, dot, scene.err());
}

SWEEP(DotprodCx) {
    const KrHandle x = scene.Complexes(kComplexSix);
    KrComplex* const dot = scene.ComplexNumber();
    return scene.Call(DotprodCx, x, x, dot, scene.err());
}

SWEEP(OuterProd_head) {
    const KrHandle x = scene.Doubles({1, 2}), y = scene.Doubles(kSix), m = scene.OutMatrix();
    return scene.Call(OuterProd_head, x, y, m, scene.err());
}

SWEEP(OuterProdCx_head) {
    const KrHandle x = scene.Complexes({{1, 2}}), y = scene.Complexes(kComplexSix), m = scene.OutComplexMatrix();
    return scene.Call(OuterProdCx_head, x, y, m, scene.err());
}

SWEEP(MatrixMul_head) {
    const KrHandle a = scene.Matrix(2, 3, kSix), b = scene.Matrix(3, 2, kSix), c = scene.OutMatrix();
    return scene.Call(MatrixMul_head, a, b, c, scene.err());
}

SWEEP(AxBCxCIN) {
    const KrHandle a = scene.ComplexMatrix(2, 3, kComplexSix), b = scene.ComplexMatrix(3, 2, kComplexSix),
                   c = scene.OutComplexMatrix();
    return scene.Call(AxBCxCIN, a, b, c, scene.err());
}

SWEEP(AxVect_head) {
    const KrHandle a = scene.Matrix(2, 3, kSix), x = scene.Doubles({1, 2, 3}), y = scene.OutDoubles();
    return scene.Call(AxVect_head, a, x, y, scene.err());
}

SWEEP(AxVectorCx) {
    const KrHandle a = scene.ComplexMatrix(3, 2, kComplexSix), x = scene.Complexes({{1, 2}, {2, 1}}),
                   y = scene.OutComplexes();
    return scene.Call(AxVectorCx, a, x, y, scene.err());
}

SWEEP(vectxA_head) {
    const KrHandle x = scene.Doubles({1, 2}), a = scene.Matrix(2, 3, kSix), y = scene.OutDoubles();
    return scene.Call(vectxA_head, x, a, y);
}

SWEEP(CxVectxA_head) {
    const KrHandle x = scene.Complexes({{1, 2}, {2, 1}}), a = scene.ComplexMatrix(2, 3, kComplexSix),
                   y = scene.OutComplexes();
    return scene.Call(CxVectxA_head, x, a, y);
}

SWEEP(KroneckerProd_H) {
    const KrHandle a = scene.Matrix(1, 2, {1, 2}), b = scene.Matrix(2, 3, kSix), k = scene.OutMatrix();
    return scene.Call(KroneckerProd_H, a, b, k);
}

SWEEP(CxKroneckerProd_H) {
    const KrHandle a = scene.ComplexMatrix(1, 1, {{1, 2}}), b = scene.ComplexMatrix(2, 3, kComplexSix),
                   k = scene.OutComplexMatrix();
    return scene.Call(CxKroneckerProd_H, a, b, k);
}

SWEEP(Trace_head) {
    const KrHandle a = scene.Matrix(2, 3, kSix);
    double* const trace = scene.Number();
    return scene.Call(Trace_head, a, trace, scene.err());
}

SWEEP(CxTrace_head) {
    const KrHandle a = scene.ComplexMatrix(3, 2, kComplexSix);
    KrComplex* const trace = scene.ComplexNumber();
    return scene.Call(CxTrace_head, a, trace, scene.err());
}

SWEEP(Transpose_head) {
    const KrHandle a = scene.Matrix(2, 3, kSix), b = scene.OutMatrix();
    return scene.Call(Transpose_head, a, b);
}

SWEEP(CxTranspose_head) {
    const KrHandle a = scene.ComplexMatrix(2, 3, kComplexSix), b = scene.OutComplexMatrix();
    return scene.Call(CxTranspose_head, a, b, scene.err());
}

SWEEP(SpecialMatrix_head) {
    const int32_t kind = 2, size = 0;
    const KrHandle x = scene.Doubles({1, 2, 3}), y = scene.Doubles({1, 5}), m = scene.OutMatrix();
    return scene.Call(SpecialMatrix_head, &kind, &size, x, y, m, scene.err());
}

SWEEP(CxSpecialMatrix_head) {
    const int32_t kind = 4, size = 0;
    const KrHandle x = scene.Complexes(kComplexSix), y = scene.Complexes({}), m = scene.OutComplexMatrix();
    return scene.Call(CxSpecialMatrix_head, &kind, &size, x, y, m, scene.err());
}

SWEEP(InitialMatrixH) {
    const KrHandle m = scene.OutMatrix();
    return scene.Call(InitialMatrixH, 2, 3, m);
}

SWEEP(CxInitialMatrixH) {
    const KrHandle m = scene.OutComplexMatrix();
    return scene.Call(CxInitialMatrixH, 3, 1, m);
}

SWEEP(Compact_to_Matrix_head) {
    const KrTriangle packed{scene.Doubles(kSix), 1};
    const KrHandle m = scene.OutMatrix();
    return scene.Call(Compact_to_Matrix_head, &packed, m, scene.err());
}

SWEEP(CxCompact_to_Matrix_head) {
    const KrTriangle packed{scene.Complexes(kComplexSix), 2};
    const KrHandle m = scene.OutComplexMatrix();
    return scene.Call(CxCompact_to_Matrix_head, &packed, m, scene.err());
}

SWEEP(Matrix_to_Compact_head) {
    const int32_t triangle = 0;
    const KrHandle a = scene.Matrix(2, 2, {1, 2, 3, 4}), p = scene.OutDoubles();
    return scene.Call(Matrix_to_Compact_head, a, &triangle, p, scene.err());
}

SWEEP(CxMatrix_to_Compact_head) {
    const int32_t triangle = 1;
    const KrHandle a = scene.ComplexMatrix(2, 2, {{1, 2}, {3, 4}, {5, 6}, {7, 8}}), p = scene.OutComplexes();
    return scene.Call(CxMatrix_to_Compact_head, a, &triangle, p, scene.err());
}

#include "frame/status.h"
#include "krnumer/linalg_inverse.h"
#include "krnumer/linalg_solve.h"
#include "sweep/sweep.h"

namespace {

// Symmetric positive definite, and so fit for every solver.
const std::vector<double> kMatrix = {4, 1, 1, 5};
const std::vector<double> kVector = {6, 7};
const std::vector<krnumer::Complex> kComplexMatrix = {{4, 0}, {1, -1}, {1, 1}, {5, 0}};
const std::vector<krnumer::Complex> kComplexVector = {{6, 1}, {7, -2}};
// As LU_head leaves its exchanges: two integers in the first of two places, 0 and 1.
const std::vector<double> kPivots = {0x1p-1042, 0};
const std::vector<double> kTriangle = {4, 1, 5};
const std::vector<krnumer::Complex> kComplexTriangle = {{4, 0}, {1, 1}, {5, 0}};

}  // namespace

SWEEP(GenLinEqs_head) {
    const KrHandle a = scene.Matrix(2, 2, kMatrix), b = scene.Doubles(kVector), x = scene.OutDoubles();
    return scene.Call(GenLinEqs_head, a, b, x, scene.err());
}

SWEEP(GenLinEqs82_head) {
    const KrHandle a = scene.Matrix(2, 2, kMatrix), b = scene.Doubles(kVector), x = scene.OutDoubles();
    return scene.Call(GenLinEqs82_head, a, b, x, 1e-3, scene.err());
}

SWEEP(EqsByLUDri_head) {
    const KrHandle a = scene.Matrix(2, 2, kMatrix), b = scene.Doubles(kVector), x = scene.OutDoubles();
    return scene.Call(EqsByLUDri_head, a, b, x, scene.err());
}

SWEEP(EqsByCholeskyDri_head) {
    const KrHandle a = scene.Matrix(2, 2, kMatrix), b = scene.Doubles(kVector), x = scene.OutDoubles();
    return scene.Call(EqsByCholeskyDri_head, a, b, x, scene.err());
}

SWEEP(EqsSetBySVDDri_head) {
    const KrHandle a = scene.Matrix(2, 2, kMatrix), b = scene.Matrix(2, 1, kVector), x = scene.OutMatrix();
    return scene.Call(EqsSetBySVDDri_head, a, b, x);
}

SWEEP(EqsSetBySVDDri82_head) {
    const KrHandle a = scene.Matrix(2, 2, kMatrix), b = scene.Matrix(2, 1, kVector), x = scene.OutMatrix();
    return scene.Call(EqsSetBySVDDri82_head, a, b, x, 0.0);
}

SWEEP(EqsSetByCholeskyDri_head) {
    const KrHandle a = scene.Matrix(2, 2, kMatrix), b = scene.Matrix(2, 1, kVector), x = scene.OutMatrix();
    return scene.Call(EqsSetByCholeskyDri_head, a, 0, b, x);
}

SWEEP(EqsSetByLUDri_head) {
    scene.AlwaysGives(krnumer::kNotProvided);
    const KrHandle a = scene.Matrix(2, 2, kMatrix), b = scene.Matrix(2, 1, kVector), x = scene.OutMatrix();
    return scene.Call(EqsSetByLUDri_head, a, b, x);
}

SWEEP(TriEqsSetDri_head) {
    const KrHandle a = scene.Matrix(2, 2, kMatrix), b = scene.Matrix(2, 1, kVector), x = scene.OutMatrix();
    return scene.Call(TriEqsSetDri_head, a, 0, b, x);
}

SWEEP(LULinEqs_head) {
    const KrHandle lu = scene.Matrix(2, 2, kMatrix), p = scene.Doubles(kPivots);
    const KrHandle b = scene.Replaced(scene.Doubles(kVector));
    return scene.Call(LULinEqs_head, lu, p, b, scene.err());
}

SWEEP(CholeskyLinEqs_head) {
    const KrHandle l = scene.Doubles(kTriangle), b = scene.Replaced(scene.Doubles(kVector));
    return scene.Call(CholeskyLinEqs_head, l, b, scene.err());
}

SWEEP(TriLinEqs_head) {
    const KrTriangle t{scene.Doubles(kTriangle), 0};
    const KrHandle b = scene.Replaced(scene.Doubles(kVector));
    return scene.Call(TriLinEqs_head, &t, b, scene.err());
}

SWEEP(BandEqsDriH) {
    const KrHandle ab = scene.Matrix(2, 2, kMatrix), b = scene.Replaced(scene.Doubles(kVector));
    return scene.Call(BandEqsDriH, ab, b, 1, 0);
}

SWEEP(BandEqsSetDriH) {
    const KrHandle ab = scene.Matrix(2, 2, kMatrix), b = scene.Replaced(scene.Matrix(2, 2, kMatrix));
    return scene.Call(BandEqsSetDriH, ab, b, 0, 1);
}

SWEEP(InvMatrixLUDri_head) {
    const KrHandle a = scene.Replaced(scene.Matrix(2, 2, kMatrix));
    return scene.Call(InvMatrixLUDri_head, a, scene.err());
}

SWEEP(InvMatrixChoDri_head) {
    const KrHandle a = scene.Replaced(scene.Matrix(2, 2, kMatrix));
    return scene.Call(InvMatrixChoDri_head, a, scene.err());
}

SWEEP(InvMatrixTriDri_head) {
    const int32_t triangle = 1;
    const KrHandle a = scene.Replaced(scene.Matrix(2, 2, kMatrix));
    return scene.Call(InvMatrixTriDri_head, a, &triangle, scene.err());
}

SWEEP(LUInvMatrix_head) {
    const KrHandle lu = scene.Replaced(scene.Matrix(2, 2, kMatrix)), p = scene.Doubles(kPivots);
    return scene.Call(LUInvMatrix_head, lu, p, scene.err());
}

SWEEP(Cholesky_InvMatrix_head) {
    const KrHandle l = scene.Replaced(scene.Doubles(kTriangle));
    return scene.Call(Cholesky_InvMatrix_head, l, scene.err());
}

SWEEP(Tri_InvMatrix_head) {
    KrTriangle t{scene.Replaced(scene.Doubles(kTriangle)), 0};
    return scene.Call(Tri_InvMatrix_head, &t, scene.err());
}

SWEEP(PseudoInverse_head) {
    const double tol = -1.0;
    const KrHandle a = scene.Replaced(scene.Matrix(1, 2, kVector));
    return scene.Call(PseudoInverse_head, a, &tol, scene.err());
}

SWEEP(CxGenLinEqs_head) {
    const KrHandle a = scene.ComplexMatrix(2, 2, kComplexMatrix), b = scene.Complexes(kComplexVector),
                   x = scene.OutComplexes();
    return scene.Call(CxGenLinEqs_head, a, b, x, scene.err());
}

SWEEP(CxGenLinEqs82_head) {
    const KrHandle a = scene.ComplexMatrix(2, 2, kComplexMatrix), b = scene.Complexes(kComplexVector),
                   x = scene.OutComplexes();
    return scene.Call(CxGenLinEqs82_head, a, b, x, 1e-3, scene.err());
}

SWEEP(CxEqsByLUDri_head) {
    const KrHandle a = scene.ComplexMatrix(2, 2, kComplexMatrix), b = scene.Complexes(kComplexVector),
                   x = scene.OutComplexes();
    return scene.Call(CxEqsByLUDri_head, a, b, x, scene.err());
}

SWEEP(CxEqsByCholeskyDri_head) {
    const KrHandle a = scene.ComplexMatrix(2, 2, kComplexMatrix), b = scene.Complexes(kComplexVector),
                   x = scene.OutComplexes();
    return scene.Call(CxEqsByCholeskyDri_head, a, b, x, scene.err());
}

SWEEP(CxEqsSetBySVDDri_head) {
    const KrHandle a = scene.ComplexMatrix(2, 2, kComplexMatrix), b = scene.ComplexMatrix(2, 1, kComplexVector),
                   x = scene.OutComplexMatrix();
    return scene.Call(CxEqsSetBySVDDri_head, a, b, x);
}

SWEEP(CxEqsSetBySVDDri82_head) {
    const KrHandle a = scene.ComplexMatrix(2, 2, kComplexMatrix), b = scene.ComplexMatrix(2, 1, kComplexVector),
                   x = scene.OutComplexMatrix();
    return scene.Call(CxEqsSetBySVDDri82_head, a, b, x, 0.0);
}

SWEEP(CxEqsSetByCholeskyDri_head) {
    const KrHandle a = scene.ComplexMatrix(2, 2, kComplexMatrix), b = scene.ComplexMatrix(2, 1, kComplexVector),
                   x = scene.OutComplexMatrix();
    return scene.Call(CxEqsSetByCholeskyDri_head, a, 1, b, x);
}

SWEEP(CxEqsSetByLUDri_head) {
    scene.AlwaysGives(krnumer::kNotProvided);
    const KrHandle a = scene.ComplexMatrix(2, 2, kComplexMatrix), b = scene.ComplexMatrix(2, 1, kComplexVector),
                   x = scene.OutComplexMatrix();
    return scene.Call(CxEqsSetByLUDri_head, a, b, x);
}

SWEEP(CxTriEqsSetDri_head) {
    const KrHandle a = scene.ComplexMatrix(2, 2, kComplexMatrix), b = scene.ComplexMatrix(2, 1, kComplexVector),
                   x = scene.OutComplexMatrix();
    return scene.Call(CxTriEqsSetDri_head, a, 1, b, x);
}

SWEEP(CxLULinEqs_head) {
    const KrHandle lu = scene.ComplexMatrix(2, 2, kComplexMatrix), p = scene.Doubles(kPivots);
    const KrHandle b = scene.Replaced(scene.Complexes(kComplexVector));
    return scene.Call(CxLULinEqs_head, lu, p, b, scene.err());
}

SWEEP(CxCholeskyLinEqs_head) {
    const KrHandle l = scene.Complexes(kComplexTriangle), b = scene.Replaced(scene.Complexes(kComplexVector));
    return scene.Call(CxCholeskyLinEqs_head, l, b, scene.err());
}

SWEEP(CxTriLinEqs_head) {
    const KrTriangle t{scene.Complexes(kComplexTriangle), 1};
    const KrHandle b = scene.Replaced(scene.Complexes(kComplexVector));
    return scene.Call(CxTriLinEqs_head, &t, b, scene.err());
}

SWEEP(CxBandEqsDriH) {
    const KrHandle ab = scene.ComplexMatrix(2, 2, kComplexMatrix), b = scene.Replaced(scene.Complexes(kComplexVector));
    return scene.Call(CxBandEqsDriH, ab, b, 1, 0);
}

SWEEP(CxBandEqsSetDriH) {
    const KrHandle ab = scene.ComplexMatrix(2, 2, kComplexMatrix),
                   b = scene.Replaced(scene.ComplexMatrix(2, 2, kComplexMatrix));
    return scene.Call(CxBandEqsSetDriH, ab, b, 0, 1);
}

SWEEP(CxInvMatrixLUDri_head) {
    const KrHandle a = scene.Replaced(scene.ComplexMatrix(2, 2, kComplexMatrix));
    return scene.Call(CxInvMatrixLUDri_head, a, scene.err());
}

SWEEP(CxInvMatrixChoDri_head) {
    const KrHandle a = scene.Replaced(scene.ComplexMatrix(2, 2, kComplexMatrix));
    return scene.Call(CxInvMatrixChoDri_head, a, scene.err());
}

SWEEP(CxInvMatrixTriDri_head) {
    const int32_t triangle = 0;
    const KrHandle a = scene.Replaced(scene.ComplexMatrix(2, 2, kComplexMatrix));
    return scene.Call(CxInvMatrixTriDri_head, a, &triangle, scene.err());
}

SWEEP(CxLUInvMatrix_head) {
    const KrHandle lu = scene.Replaced(scene.ComplexMatrix(2, 2, kComplexMatrix)), p = scene.Doubles(kPivots);
    return scene.Call(CxLUInvMatrix_head, lu, p, scene.err());
}

SWEEP(CxCholesky_InvMatrix_head) {
    const KrHandle l = scene.Replaced(scene.Complexes(kComplexTriangle));
    return scene.Call(CxCholesky_InvMatrix_head, l, scene.err());
}

SWEEP(CxTri_InvMatrix_head) {
    KrTriangle t{scene.Replaced(scene.Complexes(kComplexTriangle)), 1};
    return scene.Call(CxTri_InvMatrix_head, &t, scene.err());
}

SWEEP(CxPseudoInverse_head) {
    const double tol = -1.0;
    const KrHandle a = scene.Replaced(scene.ComplexMatrix(1, 2, kComplexVector));
    return scene.Call(CxPseudoInverse_head, a, &tol, scene.err());
}

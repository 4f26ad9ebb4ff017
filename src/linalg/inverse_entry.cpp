// Inverses; each takes the place of what it was made of.
#include "frame/entry.h"
#include "krnumer/linalg_inverse.h"
#include "linalg/cores.h"
#include "linalg/entry_support.h"

using namespace krnumer;

namespace {

// invert(elements, order) for a square matrix.
template <class T, class Invert>
int32_t InvertMatrix(KrHandle a, int32_t* err, Invert&& invert) {
    ByReference call(err);
    InOutMatrix<T> matrix(call, a);
    if (const int32_t status = CheckSquare(matrix)) return call.Fail(status);
    return call.Run([&] { return invert(matrix.data(), matrix.rows()); });
}

// invert(elements, order) for a packed triangle; `where` is its handle or the place of it.
template <class T, class Where, class Invert>
int32_t InvertPacked(Where where, int32_t* err, Invert&& invert) {
    ByReference call(err);
    InOut<T> packed(call, where);
    int32_t n = 0;
    if (const int32_t status = PackedOrder(packed.size(), &n)) return call.Fail(status);
    return call.Run([&] { return invert(packed.data(), n); });
}

template <class T>
int32_t InvertLU(KrHandle a, int32_t* err) {
    return InvertMatrix<T>(a, err, InvertByLU<T>);
}

template <class T>
int32_t InvertDefinite(KrHandle a, int32_t* err) {
    return InvertMatrix<T>(a, err, InvertByCholesky<T>);
}

template <class T>
int32_t InvertTriangular(KrHandle a, const int32_t* triangle, int32_t* err) {
    return InvertMatrix<T>(a, err, [=](T* matrix, int32_t n) { return InvertTriangle(matrix, n, *triangle); });
}

template <class T>
int32_t InvertLUFactors(KrHandle lu, KrHandle p, int32_t* err) {
    ByReference call(err);
    InOutMatrix<T> factors(call, lu);
    In<int32_t> pivots(call, p);
    const int32_t n = factors.rows();
    int32_t status = CheckSquare(factors);
    if (pivots.size() != n) status = kSizesDiffer;
    if (status != kOk) return call.Fail(status);
    return call.Run([&] {
        if (const int32_t unfit = CheckPivots(pivots.data(), n)) return unfit;
        return LUInverse(factors.data(), pivots.data(), n, factors.data());
    });
}

template <class T>
int32_t InvertCholeskyFactor(KrHandle l, int32_t* err) {
    return InvertPacked<T>(l, err, CholeskyInversePacked<T>);
}

template <class T>
int32_t InvertPackedTriangle(KrTriangle* t, int32_t* err) {
    return InvertPacked<T>(HandleField{&t->elements}, err, [=](T* packed, int32_t n) {
        return TriangularInversePacked(packed, n, t->triangle, packed);
    });
}

// The elements of the result are as many as before, so the array is only declared anew.
template <class T>
int32_t InvertPseudo(KrHandle a, const double* tol, int32_t* err) {
    ByReference call(err);
    InOutMatrix<T> matrix(call, a);
    const int32_t m = matrix.rows(), n = matrix.columns();
    if (IsEmpty(matrix)) return call.Fail(kEmptyInput);
    return call.Run([&] {
        if (const int32_t status = PseudoInverseCore<T>(matrix.data(), m, n, *tol, nullptr)) return status;
        matrix.Declare(n, m);
        return kOk;
    });
}

}  // namespace

int32_t InvMatrixLUDri_head(KrHandle a, int32_t* err) {
    return InvertLU<double>(a, err);
}
int32_t CxInvMatrixLUDri_head(KrHandle a, int32_t* err) {
    return InvertLU<Complex>(a, err);
}

int32_t InvMatrixChoDri_head(KrHandle a, int32_t* err) {
    return InvertDefinite<double>(a, err);
}
int32_t CxInvMatrixChoDri_head(KrHandle a, int32_t* err) {
    return InvertDefinite<Complex>(a, err);
}

int32_t InvMatrixTriDri_head(KrHandle a, const int32_t* triangle, int32_t* err) {
    return InvertTriangular<double>(a, triangle, err);
}
int32_t CxInvMatrixTriDri_head(KrHandle a, const int32_t* triangle, int32_t* err) {
    return InvertTriangular<Complex>(a, triangle, err);
}

int32_t LUInvMatrix_head(KrHandle lu, KrHandle p, int32_t* err) {
    return InvertLUFactors<double>(lu, p, err);
}
int32_t CxLUInvMatrix_head(KrHandle lu, KrHandle p, int32_t* err) {
    return InvertLUFactors<Complex>(lu, p, err);
}

int32_t Cholesky_InvMatrix_head(KrHandle l, int32_t* err) {
    return InvertCholeskyFactor<double>(l, err);
}
int32_t CxCholesky_InvMatrix_head(KrHandle l, int32_t* err) {
    return InvertCholeskyFactor<Complex>(l, err);
}

int32_t Tri_InvMatrix_head(KrTriangle* t, int32_t* err) {
    return InvertPackedTriangle<double>(t, err);
}
int32_t CxTri_InvMatrix_head(KrTriangle* t, int32_t* err) {
    return InvertPackedTriangle<Complex>(t, err);
}

int32_t PseudoInverse_head(KrHandle a, const double* tol, int32_t* err) {
    return InvertPseudo<double>(a, tol, err);
}
int32_t CxPseudoInverse_head(KrHandle a, const double* tol, int32_t* err) {
    return InvertPseudo<Complex>(a, tol, err);
}

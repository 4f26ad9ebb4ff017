#include "frame/entry.h"
#include "krnumer/linalg_eigen.h"
#include "linalg/eigen_general.h"
#include "linalg/eigen_polynomial.h"
#include "linalg/eigen_symmetric.h"
#include "linalg/entry_support.h"
#include "linalg/finite.h"

using namespace krnumer;

namespace {

constexpr int32_t kGeneral = 0;
constexpr int32_t kHermitian = 1;

// Eigenvalues as complex numbers, and with want_vectors the eigenvectors in the place of A.
int32_t ComplexEigen(Complex* a, int32_t n, int32_t kind, int32_t want_vectors, Complex* w) {
    if (kind == kGeneral) return CxEigenGeneralCore(a, n, want_vectors, w, a);
    if (kind != kHermitian || (want_vectors != 0 && want_vectors != 1)) return kBadSelector;
    if (HasUnusable(a, Count(n) * Count(n))) return kNotFinite;
    const int32_t status = HermitianEigenCore(a, n, want_vectors, reinterpret_cast<double*>(w), nullptr);
    if (status == kOk) SpreadToComplex(w, n);
    return status;
}

// Delivers the status of a core that put the vectors in the place of the matrix, which goes where nobody wants them.
template <class Matrix>
int32_t DeliverVectors(Call& call, int32_t status, int32_t want_vectors, Matrix& matrix) {
    if (status == kOk && want_vectors == 0) status = matrix.Clear();
    return call.Deliver(status);
}

}  // namespace

int32_t EigenValueVector_head(KrHandle a, const int32_t* want_vectors, KrHandle w, KrHandle v, int32_t* err) {
    ByReference call(err);
    InMatrix<double> matrix(call, a);
    Out<Complex> values(call, w);
    OutMatrix<Complex> vectors(call, v);
    if (values.Clear() || vectors.Clear()) return call.Fail(kOutOfMemory);
    if (const int32_t status = CheckSquare(matrix)) return call.Fail(status);
    const int32_t n = matrix.rows();
    if (values.Resize(n) || (*want_vectors == 1 && vectors.Resize(n, n))) return call.Fail(kOutOfMemory);
    return call.Run([&] { return EigenGeneralCore(matrix.data(), n, *want_vectors, values.data(), vectors.data()); });
}

int32_t CxEigenValueVector_head(KrHandle a, const int32_t* kind, const int32_t* want_vectors, KrHandle w,
                                int32_t* err) {
    ByReference call(err);
    InOutMatrix<Complex> matrix(call, a);
    Out<Complex> values(call, w);
    if (const int32_t status = CheckSquare(matrix)) return call.Fail(status);
    const int32_t n = matrix.rows();
    if (values.Resize(n) || call.Map()) return call.Fail(kOutOfMemory);
    const int32_t status = ComplexEigen(matrix.data(), n, *kind, *want_vectors, values.data());
    return DeliverVectors(call, status, *want_vectors, matrix);
}

int32_t SymEvectorEvalue_head(KrHandle a, const int32_t* want_vectors, KrHandle w, int32_t* err) {
    ByReference call(err);
    InOutMatrix<double> matrix(call, a);
    Out<double> values(call, w);
    if (!IsSquare(matrix)) return call.Fail(kNotSquare);
    const int32_t n = matrix.rows();  // a matrix without elements is the core's to refuse
    if (values.Resize(n) || call.Map()) return call.Fail(kOutOfMemory);
    const int32_t status = SymEigenCore(matrix.data(), n, *want_vectors, values.data(), nullptr);
    return DeliverVectors(call, status, *want_vectors, matrix);
}

int32_t MatrixCharacteristicPoly_head(KrHandle a, KrHandle c, int32_t* err) {
    ByReference call(err);
    InMatrix<double> matrix(call, a);
    Out<double> coefficients(call, c);
    if (const int32_t status = CheckSquare(matrix)) return call.Fail(status);
    const int32_t n = matrix.rows();
    if (coefficients.Resize(n + 1)) return call.Fail(kOutOfMemory);
    return call.Run([&] { return CharacteristicPolynomial(matrix.data(), n, coefficients.data()); });
}

int32_t CreateMatrixFromEVs_head(KrHandle lambda, KrHandle m, int32_t* err) {
    ByReference call(err);
    In<Complex> eigenvalues(call, lambda);
    OutMatrix<double> matrix(call, m);
    const int32_t n = eigenvalues.size();
    if (n < 1) return call.Fail(kEmptyInput);
    if (matrix.Resize(n, n)) return call.Fail(kOutOfMemory);
    return call.Run([&] { return MatrixFromEigenvalues(eigenvalues.data(), n, matrix.data()); });
}

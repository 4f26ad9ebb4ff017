#include <algorithm>

#include "frame/entry.h"
#include "frame/scratch.h"
#include "krnumer/linalg_factor.h"
#include "linalg/cores.h"
#include "linalg/element.h"
#include "linalg/entry_support.h"

using namespace krnumer;

namespace {

template <class T>
int32_t FactorLU(KrHandle a, KrHandle p, int32_t* sign, int32_t* err) {
    ByReference call(err);
    InOutMatrix<T> matrix(call, a);
    Out<double> pivots(call, p);  // n places of 8 bytes for n integers of 4
    *sign = 0;
    int32_t status = kOk;
    if (IsEmpty(matrix)) status = kEmptyInput;
    if (!IsSquare(matrix)) status = kNotSquare;
    if (status != kOk) return call.Fail(status);
    if (pivots.Resize(matrix.rows())) return call.Fail(kOutOfMemory);
    return call.Run(
        [&] { return LUFactor(matrix.data(), matrix.rows(), reinterpret_cast<int32_t*>(pivots.data()), sign); });
}

template <class T>
int32_t FactorCholesky(KrHandle l, int32_t* err) {
    ByReference call(err);
    InOut<T> packed(call, l);
    int32_t n = 0;
    if (const int32_t status = PackedOrder(packed.size(), &n)) return call.Fail(status);
    return call.Run([&] { return CholeskyPacked(packed.data(), n); });
}

// The one by-reference function of the family whose result is the code as well.
template <class T>
int32_t FactorFullCholesky(KrHandle a, int32_t* err) {
    {
        ByReference call(err);
        InOutMatrix<T> matrix(call, a);
        int32_t status = kOk;
        if (!IsSquare(matrix)) status = kNotSquare;
        if (IsEmpty(matrix)) status = kEmptyInput;
        if (status != kOk) {
            call.Fail(status);
        } else {
            call.Run([&] { return CholeskyUpper(matrix.data(), matrix.rows()); });
        }
    }
    return *err;
}

template <class T>
int32_t DecomposePivoted(const T* a, int32_t m, int32_t n, int32_t format, int32_t* permutation, T* q, T* r) {
    Scratch<int32_t> pivots(Count(n));
    if (!pivots) return kOutOfMemory;
    if (const int32_t status = QRPivoted(a, m, n, format, pivots.data(), q, r)) return status;
    std::fill_n(permutation, Count(n) * Count(n), 0);
    for (size_t j = 0; j < Count(n); ++j) permutation[Count(pivots[j]) * Count(n) + j] = 1;
    return kOk;
}

template <class T>
int32_t DecomposeQR(KrHandle a, int32_t pivoting, int32_t format, KrHandle p, KrHandle q, KrHandle r) {
    ByValue call;
    InMatrix<T> matrix(call, a);
    OutMatrix<int32_t> permutation(call, p);
    OutMatrix<T> orthogonal(call, q), triangular(call, r);
    if (IsEmpty(matrix)) return call.Fail(kEmptyInput);
    if (format != kFullQR && format != kEconomyQR && format != kROnly) return call.Fail(kBadSelector);
    const bool pivots = pivoting != 0, forms_q = format != kROnly;
    const int32_t m = matrix.rows(), n = matrix.columns(), rows = QRRows(m, n, format);
    if ((pivots && permutation.Resize(n, n)) || (forms_q && orthogonal.Resize(m, rows)) || triangular.Resize(rows, n)) {
        return call.Fail(kOutOfMemory);
    }
    const int32_t status = call.Run([&] {
        T* const q_data = forms_q ? orthogonal.data() : nullptr;
        return pivots ? DecomposePivoted(matrix.data(), m, n, format, permutation.data(), q_data, triangular.data())
                      : QRHouseholder(matrix.data(), m, n, format, q_data, triangular.data());
    });
    if (!pivots) permutation.Empty();
    if (!forms_q) orthogonal.Empty();
    return status;
}

enum QRMethod : int32_t { kHouseholder = 0, kGivens = 1, kFastGivens = 2 };

int32_t FullQR(int32_t method, const double* a, int32_t m, int32_t n, double* q, double* r) {
    int32_t rank = 0;
    switch (method) {
        case kHouseholder:
            return QRHouseholder(a, m, n, kFullQR, q, r);
        case kGivens:
            return QRGivens(a, m, n, q, r, &rank);
        case kFastGivens:
            return QRFastGivens(a, m, n, q, r, &rank);
        default:
            return kBadSelector;
    }
}

// The complex function knows reflectors only; its method may be anything, even nowhere.
template <class T>
int32_t DecomposeFullQR(KrHandle a, [[maybe_unused]] const int32_t* method, KrHandle q, KrHandle r, int32_t* err) {
    ByReference call(err);
    InMatrix<T> matrix(call, a);
    OutMatrix<T> orthogonal(call, q), triangular(call, r);
    if (IsEmpty(matrix)) return call.Fail(kEmptyInput);
    const int32_t m = matrix.rows(), n = matrix.columns();
    if (orthogonal.Resize(m, m) || triangular.Resize(m, n)) return call.Fail(kOutOfMemory);
    return call.Run([&] {
        if constexpr (kIsComplex<T>) {
            if (HasUnusable(matrix.data(), matrix.count())) return kNotFinite;
            return QRHouseholder(matrix.data(), m, n, kFullQR, orthogonal.data(), triangular.data());
        } else {
            return FullQR(*method, matrix.data(), m, n, orthogonal.data(), triangular.data());
        }
    });
}

}  // namespace

int32_t LU_head(KrHandle a, KrHandle p, int32_t* sign, int32_t* err) {
    return FactorLU<double>(a, p, sign, err);
}
int32_t CxLU_head(KrHandle a, KrHandle p, int32_t* sign, int32_t* err) {
    return FactorLU<Complex>(a, p, sign, err);
}

int32_t Cholesky_head(KrHandle l, int32_t* err) {
    return FactorCholesky<double>(l, err);
}
int32_t CxCholesky_head(KrHandle l, int32_t* err) {
    return FactorCholesky<Complex>(l, err);
}

int32_t FullCholesky_head(KrHandle a, int32_t* err) {
    return FactorFullCholesky<double>(a, err);
}
int32_t CxFullCholesky_head(KrHandle a, int32_t* err) {
    return FactorFullCholesky<Complex>(a, err);
}

int32_t QRDecH(KrHandle a, int32_t pivoting, int32_t format, KrHandle p, KrHandle q, KrHandle r) {
    return DecomposeQR<double>(a, pivoting, format, p, q, r);
}
int32_t CxQRDecH(KrHandle a, int32_t pivoting, int32_t format, KrHandle p, KrHandle q, KrHandle r) {
    return DecomposeQR<Complex>(a, pivoting, format, p, q, r);
}

int32_t qrd_head(KrHandle a, const int32_t* method, KrHandle q, KrHandle r, int32_t* err) {
    return DecomposeFullQR<double>(a, method, q, r, err);
}
int32_t Cxqrd_head(KrHandle a, const int32_t* method, KrHandle q, KrHandle r, int32_t* err) {
    return DecomposeFullQR<Complex>(a, method, q, r, err);
}

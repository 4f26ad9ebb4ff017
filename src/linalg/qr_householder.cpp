#include <algorithm>

#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"
#include "linalg/element.h"
#include "linalg/lapack.h"
#include "linalg/qr.h"
#include "linalg/transpose.h"

namespace krnumer {

int32_t QRRows(int32_t m, int32_t n, int32_t format) {
    return format == kFullQR ? m : std::min(m, n);
}

// To LAPACK the rows of A are the columns of its transpose, and the LQ decomposition of the transpose is the QR
// decomposition of A: R and Q come out row by row.
template <class T>
int32_t QRHouseholder(const T* a, int32_t m, int32_t n, int32_t format, std::type_identity_t<T>* q, T* r) {
    if (m < 1 || n < 1) return kEmptyInput;
    const int32_t reflectors = std::min(m, n), rows = QRRows(m, n, format);
    const int32_t stride = q != nullptr ? std::max(n, rows) : n;
    Scratch<T> rows_of_a(Count(m) * Count(stride)), tau(Count(reflectors)), space;
    if (!rows_of_a || !tau) return kOutOfMemory;
    const auto row = [&](int32_t i) { return rows_of_a.data() + Count(i) * Count(stride); };
    for (int32_t i = 0; i < m; ++i) std::copy_n(a + Count(i) * Count(n), n, row(i));

    int32_t info = 0;
    const auto decompose = [&](T* work, int32_t lwork) {
        return lapack::Gelqf(n, m, rows_of_a.data(), stride, tau.data(), work, lwork);
    };
    if (const int32_t status = lapack::CallWithWorkspace(info, space, decompose)) return status;
    std::fill_n(r, Count(rows) * Count(n), T{});
    for (int32_t i = 0; i < reflectors; ++i) std::copy_n(row(i) + i, n - i, r + Count(i) * Count(n) + i);
    if (q == nullptr) return kOk;

    const auto form_q = [&](T* work, int32_t lwork) {
        return lapack::Orglq(rows, m, reflectors, rows_of_a.data(), stride, tau.data(), work, lwork);
    };
    if (const int32_t status = lapack::CallWithWorkspace(info, space, form_q)) return status;
    for (int32_t i = 0; i < m; ++i) std::copy_n(row(i), rows, q + Count(i) * Count(rows));
    return kOk;
}

template <class T>
int32_t QRPivoted(const T* a, int32_t m, int32_t n, int32_t format, int32_t* pivots, std::type_identity_t<T>* q, T* r) {
    if (m < 1 || n < 1) return kEmptyInput;
    const int32_t reflectors = std::min(m, n), rows = QRRows(m, n, format);
    Scratch<T> columns(Count(m) * Count(std::max(n, rows))), tau(Count(reflectors)), space;
    Scratch<double> column_norms(kIsComplex<T> ? 2 * Count(n) : 0);
    if (!columns || !tau || !column_norms) return kOutOfMemory;
    TransposeCore(a, m, n, columns.data());
    std::fill_n(pivots, n, 0);  // every column may move

    int32_t info = 0;
    const auto decompose = [&](T* work, int32_t lwork) {
        return lapack::Geqp3(m, n, columns.data(), m, pivots, tau.data(), work, lwork, column_norms.data());
    };
    if (const int32_t status = lapack::CallWithWorkspace(info, space, decompose)) return status;
    std::fill_n(r, Count(rows) * Count(n), T{});
    for (size_t j = 0; j < Count(n); ++j) {
        const size_t below = std::min(j + 1, Count(reflectors));
        for (size_t i = 0; i < below; ++i) r[i * Count(n) + j] = columns[j * Count(m) + i];
    }
    for (int32_t j = 0; j < n; ++j) --pivots[j];  // LAPACK counts from 1
    if (q == nullptr) return kOk;

    const auto form_q = [&](T* work, int32_t lwork) {
        return lapack::Orgqr(m, rows, reflectors, columns.data(), m, tau.data(), work, lwork);
    };
    if (const int32_t status = lapack::CallWithWorkspace(info, space, form_q)) return status;
    return TransposeCore(columns.data(), rows, m, q);
}

#define KRNUMER_INSTANTIATE(T)                                                   \
    template int32_t QRHouseholder(const T*, int32_t, int32_t, int32_t, T*, T*); \
    template int32_t QRPivoted(const T*, int32_t, int32_t, int32_t, int32_t*, T*, T*);
KRNUMER_INSTANTIATE(double)
KRNUMER_INSTANTIATE(Complex)
#undef KRNUMER_INSTANTIATE

}  // namespace krnumer

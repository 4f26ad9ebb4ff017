#include "linalg/schur.h"

#include <algorithm>

#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"
#include "linalg/block_sort.h"
#include "linalg/element.h"
#include "linalg/finite.h"
#include "linalg/lapack.h"
#include "linalg/transpose.h"

namespace krnumer {

namespace {

int32_t DecompositionStatus(int32_t info, int32_t n) {
    if (info == 0) return kOk;
    if (info < 0) return kLapackError;
    if (info == n + 1) return kReorderingFailed;
    return info == n + 2 ? kReorderingIllConditioned : kNoConvergence;
}

template <class T>
int32_t Sort(T* t, int32_t n, T* vectors, Complex* w, int32_t order) {
    Scratch<double> work(2 * Count(n));
    Scratch<int32_t> sizes(Count(n));
    if (!work || !sizes) return kOutOfMemory;
    double* const keys = work.data();
    double* const space = keys + n;
    for (int32_t i = 0; i < n; ++i) {
        keys[i] = order <= kRealDescending ? w[i].re : lapack::Lapy2(w[i].re, w[i].im);
        sizes[Count(i)] = 1;
        if (!kIsComplex<T> && w[i].im != 0.0 && i + 1 < n) {
            sizes[Count(i)] = 2;
            keys[i + 1] = keys[i];
            sizes[Count(++i)] = 0;
        }
    }
    const bool ascending = order == kRealAscending || order == kModulusAscending;
    return SortBlocks(
        sizes.data(), n, [=](int32_t i, int32_t j) { return ascending ? keys[i] > keys[j] : keys[i] < keys[j]; },
        [=](int32_t i, int32_t size) {
            const int32_t info =
                lapack::Trexc(vectors != nullptr ? 'V' : 'N', n, t, n, vectors, n, i + 1, i + 1 + size, space);
            return info < 0 ? kLapackError : kOk;
        },
        [=](int32_t first, int32_t middle, int32_t last) {
            std::rotate(keys + first, keys + middle, keys + last);
            std::rotate(w + first, w + middle, w + last);
        });
}

}  // namespace

int32_t DecomposeColumns(double* t, int32_t n, double* vectors, Complex* w, int32_t size) {
    Scratch<double> values(2 * Count(n));
    Scratch<double> work;
    if (!values) return kOutOfMemory;
    double* const wr = values.data();
    double* const wi = wr + n;
    int32_t info = 0;
    const auto call = [&](double* space, int32_t lwork) {
        return lapack::Gees(vectors != nullptr ? 'V' : 'N', n, t, n, wr, wi, vectors, n, space, lwork);
    };
    if (const int32_t status = lapack::CallWithWorkspace(info, work, call)) return status;
    for (int32_t i = 0; i < n; ++i) w[i] = {wr[i], wi[i]};
    return DecompositionStatus(info, size);
}

int32_t DecomposeColumns(Complex* t, int32_t n, Complex* vectors, Complex* w, int32_t size) {
    Scratch<double> rwork(Count(n));
    Scratch<Complex> work;
    if (!rwork) return kOutOfMemory;
    int32_t info = 0;
    const auto call = [&](Complex* space, int32_t lwork) {
        return lapack::Gees(vectors != nullptr ? 'V' : 'N', n, t, n, w, vectors, n, space, lwork, rwork.data());
    };
    if (const int32_t status = lapack::CallWithWorkspace(info, work, call)) return status;
    return DecompositionStatus(info, size);
}

template <class T>
int32_t SchurCore(const T* a, int32_t n, int32_t order, T* z, T* t, Complex* w) {
    if (!IsEigenvalueOrder(order)) return kBadSelector;
    if (n < 1) return kEmptyInput;
    const std::size_t elements = Count(n) * Count(n);
    if (HasUnusable(a, elements)) return kNotFinite;
    Scratch<T> columns(elements);
    Scratch<T> vectors;
    if (!columns || (z != nullptr && !vectors.Allocate(elements))) return kOutOfMemory;
    if (const int32_t status = TransposeCore(a, n, n, columns.data())) return status;
    if (const int32_t status = DecomposeColumns(columns.data(), n, vectors.data(), w, n)) return status;
    if (order != kNoOrder) {
        if (const int32_t status = Sort(columns.data(), n, vectors.data(), w, order)) return status;
    }
    if (const int32_t status = TransposeCore(columns.data(), n, n, t)) return status;
    return z != nullptr ? TransposeCore(vectors.data(), n, n, z) : kOk;
}

template int32_t SchurCore(const double*, int32_t, int32_t, double*, double*, Complex*);
template int32_t SchurCore(const Complex*, int32_t, int32_t, Complex*, Complex*, Complex*);

}  // namespace krnumer

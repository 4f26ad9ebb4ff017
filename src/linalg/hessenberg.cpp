#include "linalg/hessenberg.h"

#include <algorithm>

#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"
#include "linalg/element.h"
#include "linalg/finite.h"
#include "linalg/lapack.h"
#include "linalg/transpose.h"

namespace krnumer {

namespace {

constexpr char kJobs[] = {'N', 'P', 'S', 'B'};

bool IsJob(int32_t job) {
    return job >= 0 && job <= 3;
}

}  // namespace

template <class T>
int32_t HessenbergCore(const T* a, int32_t n, int32_t ilo, int32_t ihi, T* h, T* q) {
    if (n < 1) return kEmptyInput;
    if (ilo < 0 || ihi >= n || ilo > ihi) return kBadIndex;
    const std::size_t order = Count(n);
    if (HasUnusable(a, order * order)) return kNotFinite;
    Scratch<T> columns(order * order);
    Scratch<T> tau(order);
    Scratch<T> work;
    if (!columns || !tau) return kOutOfMemory;
    if (const int32_t status = TransposeCore(a, n, n, columns.data())) return status;

    int32_t info = 0;
    const auto reduce = [&](T* space, int32_t size) {
        return lapack::Gehrd(n, ilo + 1, ihi + 1, columns.data(), n, tau.data(), space, size);
    };
    if (const int32_t status = lapack::CallWithWorkspace(info, work, reduce)) return status;
    std::fill_n(h, order * order, T{});
    for (std::size_t j = 0; j < order; ++j)
        for (std::size_t i = 0; i <= std::min(j + 1, order - 1); ++i) h[i * order + j] = columns[j * order + i];

    const auto form = [&](T* space, int32_t size) {
        return lapack::Orghr(n, ilo + 1, ihi + 1, columns.data(), n, tau.data(), space, size);
    };
    if (const int32_t status = lapack::CallWithWorkspace(info, work, form)) return status;
    return TransposeCore(columns.data(), n, n, q);
}

template <class T>
int32_t BalanceCore(T* a, int32_t n, int32_t job, int32_t* ilo, int32_t* ihi, double* scale) {
    if (!IsJob(job)) return kBadSelector;
    Scratch<T> columns(Count(n) * Count(n));
    if (!columns) return kOutOfMemory;
    if (const int32_t status = TransposeCore(a, n, n, columns.data())) return status;
    int32_t first = 0;
    int32_t last = 0;
    if (lapack::Gebal(kJobs[job], n, columns.data(), n, first, last, scale) != 0) return kLapackError;
    *ilo = first - 1;
    *ihi = last - 1;
    return TransposeCore(columns.data(), n, n, a);
}

template <class T>
int32_t BackTransformCore(T* v, int32_t n, int32_t job, bool left, int32_t ilo, int32_t ihi, const double* scale) {
    if (!IsJob(job)) return kBadSelector;
    if (ilo < 0 || ihi < ilo || ihi >= n) return kOk;  // LAPACK leaves the vectors
    const bool permutes = kJobs[job] == 'P' || kJobs[job] == 'B';
    for (int32_t i = 0; permutes && i < n; ++i)
        if ((i < ilo || i > ihi) && !(scale[i] >= 1.0 && scale[i] < n + 1.0)) return kBadIndex;
    Scratch<T> columns(Count(n) * Count(n));
    if (!columns) return kOutOfMemory;
    if (const int32_t status = TransposeCore(v, n, n, columns.data())) return status;
    lapack::Gebak(kJobs[job], left ? 'L' : 'R', n, ilo + 1, ihi + 1, scale, n, columns.data(), n);
    return TransposeCore(columns.data(), n, n, v);
}

template int32_t HessenbergCore(const double*, int32_t, int32_t, int32_t, double*, double*);
template int32_t HessenbergCore(const Complex*, int32_t, int32_t, int32_t, Complex*, Complex*);
template int32_t BalanceCore(double*, int32_t, int32_t, int32_t*, int32_t*, double*);
template int32_t BalanceCore(Complex*, int32_t, int32_t, int32_t*, int32_t*, double*);
template int32_t BackTransformCore(double*, int32_t, int32_t, bool, int32_t, int32_t, const double*);
template int32_t BackTransformCore(Complex*, int32_t, int32_t, bool, int32_t, int32_t, const double*);

}  // namespace krnumer

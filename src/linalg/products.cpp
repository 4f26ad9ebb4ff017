#include "linalg/products.h"

#include <algorithm>

#include "frame/numeric.h"
#include "frame/status.h"
#include "linalg/element.h"
#include "linalg/lapack.h"
#include "linalg/row_sums.h"

namespace krnumer {
namespace {

// A row of products with one factor.
template <class T>
T* Scaled(T factor, const T* x, size_t n, T* out) {
    return std::transform(x, x + n, out, [factor](T element) { return factor * element; });
}

}  // namespace

template <class T>
int32_t MatMulCore(const T* a, const T* b, int32_t m, int32_t k, int32_t n, T* c) {
    if (m < 0 || k < 0 || n < 0) return kEmptyInput;
    if (m == 0 || n == 0) return kOk;
    if (k == 0) {
        std::fill_n(reinterpret_cast<double*>(c), Count(m) * Count(n) * (sizeof(T) / sizeof(double)), kQuietNaN);
        return kOk;
    }
    lapack::Gemm(lapack::kRowMajor, lapack::kNoTranspose, lapack::kNoTranspose, m, n, k, FromReal<T>(1.0), a, k, b, n,
                 T{}, c, n);
    return kOk;
}

template <class T>
int32_t MatVecCore(const T* a, int32_t m, int32_t n, const T* x, T* y) {
    if (m < 0 || n < 0) return kEmptyInput;
    ForEachRowSum(a, n, m, n, x, [y](std::ptrdiff_t i, T sum) { y[i] = sum; });
    return kOk;
}

template <class T>
int32_t DotCore(const T* x, const T* y, int32_t n, T* out) {
    if (n < 1) return kEmptyInput;
    RowSums<1>(x, 0, n, y, out);
    return kOk;
}

template <class T>
int32_t OuterCore(const T* x, int32_t m, const T* y, int32_t n, T* out) {
    if (m < 1 || n < 1) return kEmptyInput;
    for (size_t i = 0; i < Count(m); ++i) out = Scaled(x[i], y, Count(n), out);
    return kOk;
}

template <class T>
int32_t KroneckerCore(const T* a, int32_t m, int32_t n, const T* b, int32_t p, int32_t q, T* out) {
    if (m < 1 || n < 1 || p < 1 || q < 1) return kEmptyInput;
    for (size_t i = 0; i < Count(m); ++i)
        for (size_t k = 0; k < Count(p); ++k)
            for (size_t j = 0; j < Count(n); ++j) out = Scaled(a[i * Count(n) + j], b + k * Count(q), Count(q), out);
    return kOk;
}

template <class T>
int32_t TraceCore(const T* a, int32_t m, int32_t n, T* out) {
    if (m < 1 || n < 1) return kEmptyInput;
    T sum{};
    for (size_t i = 0; i < Count(std::min(m, n)); ++i) sum += a[i * (Count(n) + 1)];
    *out = sum;
    return kOk;
}

#define KRNUMER_INSTANTIATE(T)                                                                  \
    template int32_t MatMulCore(const T*, const T*, int32_t, int32_t, int32_t, T*);             \
    template int32_t MatVecCore(const T*, int32_t, int32_t, const T*, T*);                      \
    template int32_t DotCore(const T*, const T*, int32_t, T*);                                  \
    template int32_t OuterCore(const T*, int32_t, const T*, int32_t, T*);                       \
    template int32_t KroneckerCore(const T*, int32_t, int32_t, const T*, int32_t, int32_t, T*); \
    template int32_t TraceCore(const T*, int32_t, int32_t, T*);
KRNUMER_INSTANTIATE(double)
KRNUMER_INSTANTIATE(Complex)
#undef KRNUMER_INSTANTIATE

}  // namespace krnumer

#include "linalg/cholesky_solve.h"

#include <algorithm>

#include "frame/scratch.h"
#include "frame/status.h"
#include "linalg/cholesky.h"
#include "linalg/element.h"
#include "linalg/finite.h"
#include "linalg/packed.h"
#include "linalg/substitution.h"

namespace krnumer {
namespace {

template <class T>
void SolveBoth(const T* packed, size_t n, T* x, size_t count) {
    substitution::Forward(packed, n, x, count);
    substitution::BackwardAdjoint(packed, n, x, count);
}

// A row of the upper triangle, conjugated, is a column of the lower one.
template <class T>
void PackUpperAsLower(const T* a, size_t n, T* packed) {
    for (size_t i = 0; i < n; ++i)
        packed = std::transform(a + i * n + i, a + (i + 1) * n, packed, [](T element) { return Conjugate(element); });
}

}  // namespace

template <class T>
int32_t CholeskySolvePacked(const T* packed, int32_t n, T* b, int32_t nrhs) {
    if (n < 1 || nrhs < 1) return kEmptyInput;
    SolveBoth(packed, Count(n), b, Count(nrhs));
    return kOk;
}

template <class T>
int32_t CholeskySolveFull(const T* a, int32_t n, int32_t triangle, const T* b, int32_t nrhs, T* x) {
    if (n < 1 || nrhs < 1) return kEmptyInput;
    const size_t b_count = Count(n) * Count(nrhs);
    if (HasUnusable(a, Count(n) * Count(n)) || HasUnusable(b, b_count)) return kNotFinite;
    Scratch<T> packed(PackedCount(n));
    if (!packed) return kOutOfMemory;
    if (triangle == kLower) {
        PackTriangle(a, n, kLower, packed.data());
    } else {
        PackUpperAsLower(a, Count(n), packed.data());
    }
    if (const int32_t status = CholeskyPacked(packed.data(), n)) return status;
    if (x != b) std::copy_n(b, b_count, x);
    return CholeskySolvePacked(packed.data(), n, x, nrhs);
}

// A few columns of the inverse at a time. Above the diagonal of the first of them there is nothing to compute, and the
// rest of the factor is a packed factor itself, so what is done can be overwritten.
template <class T>
int32_t CholeskyInversePacked(T* packed, int32_t order) {
    if (order < 1) return kEmptyInput;
    constexpr size_t kTogether = 4;
    const size_t n = Count(order);
    Scratch<T> columns(n * kTogether);
    if (!columns) return kOutOfMemory;
    for (size_t first = 0; first < n; first += kTogether) {
        const size_t rest = n - first, count = std::min(kTogether, rest);
        T* const factor = packed + LowerDiagonal(first, n);
        std::fill_n(columns.data(), rest * count, T{});
        for (size_t j = 0; j < count; ++j) columns[j * count + j] = FromReal<T>(1.0);
        SolveBoth(factor, rest, columns.data(), count);
        T* out = factor;
        for (size_t j = 0; j < count; ++j)
            for (size_t i = j; i < rest; ++i) *out++ = columns[i * count + j];
    }
    return kOk;
}

template <class T>
int32_t InvertByCholesky(T* a, int32_t n) {
    Scratch<T> packed(PackedCount(n));
    if (!packed) return kOutOfMemory;
    if (const int32_t status = PackTriangle(a, n, kLower, packed.data())) return status;
    if (const int32_t status = CholeskyPacked(packed.data(), n)) return status;
    if (const int32_t status = CholeskyInversePacked(packed.data(), n)) return status;
    return UnpackTriangle(packed.data(), n, kSymmetric, a);
}

#define KRNUMER_INSTANTIATE(T)                                                             \
    template int32_t CholeskySolvePacked(const T*, int32_t, T*, int32_t);                  \
    template int32_t CholeskySolveFull(const T*, int32_t, int32_t, const T*, int32_t, T*); \
    template int32_t CholeskyInversePacked(T*, int32_t);                                   \
    template int32_t InvertByCholesky(T*, int32_t);
KRNUMER_INSTANTIATE(double)
KRNUMER_INSTANTIATE(Complex)
#undef KRNUMER_INSTANTIATE

}  // namespace krnumer

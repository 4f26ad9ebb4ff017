#include "linalg/transpose.h"

#include <algorithm>

#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"
#include "linalg/element.h"

namespace krnumer {
namespace {

constexpr auto kAsItIs = [](auto element) { return element; };
constexpr auto kConjugated = [](auto element) { return Conjugate(element); };

// In square tiles, so that the cache lines of both sides are used whole.
template <class T, class Change>
int32_t Transpose(const T* a, int32_t rows, int32_t columns, T* out, Change change) {
    if (rows < 1 || columns < 1) return kEmptyInput;
    constexpr size_t kTile = 8;
    const size_t m = Count(rows), n = Count(columns);
    for (size_t top = 0; top < m; top += kTile) {
        const size_t bottom = std::min(top + kTile, m);
        for (size_t left = 0; left < n; left += kTile) {
            const size_t right = std::min(left + kTile, n);
            for (size_t j = left; j < right; ++j)
                for (size_t i = top; i < bottom; ++i) out[j * m + i] = change(a[i * n + j]);
        }
    }
    return kOk;
}

template <class T, class Change>
int32_t TransposeOver(T* a, int32_t rows, int32_t columns, Change change) {
    const size_t count = Count(rows) * Count(columns);
    Scratch<T> copy(count);
    if (!copy) return kOutOfMemory;
    std::copy_n(a, count, copy.data());
    return Transpose(copy.data(), rows, columns, a, change);
}

}  // namespace

template <class T>
int32_t TransposeCore(const T* a, int32_t rows, int32_t columns, T* out) {
    return Transpose(a, rows, columns, out, kAsItIs);
}

template <class T>
int32_t ConjTransposeCore(const T* a, int32_t rows, int32_t columns, T* out) {
    return Transpose(a, rows, columns, out, kConjugated);
}

template <class T>
int32_t TransposeInPlace(T* a, int32_t rows, int32_t columns) {
    return TransposeOver(a, rows, columns, kAsItIs);
}

template <class T>
int32_t ConjTransposeInPlace(T* a, int32_t rows, int32_t columns) {
    return TransposeOver(a, rows, columns, kConjugated);
}

#define KRNUMER_INSTANTIATE(T)                                          \
    template int32_t TransposeCore(const T*, int32_t, int32_t, T*);     \
    template int32_t ConjTransposeCore(const T*, int32_t, int32_t, T*); \
    template int32_t TransposeInPlace(T*, int32_t, int32_t);            \
    template int32_t ConjTransposeInPlace(T*, int32_t, int32_t);
KRNUMER_INSTANTIATE(double)
KRNUMER_INSTANTIATE(Complex)
#undef KRNUMER_INSTANTIATE

}  // namespace krnumer

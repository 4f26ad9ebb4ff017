#include "linalg/triangular.h"

#include <algorithm>

#include "frame/scratch.h"
#include "frame/status.h"
#include "linalg/element.h"
#include "linalg/finite.h"
#include "linalg/packed.h"
#include "linalg/substitution.h"

namespace krnumer {
namespace {

constexpr double kEpsilonSquared = 4.930380657631324e-32;

// What elements are compared by: the magnitude, or its square.
double Size(double a) {
    return Modulus(a);
}
double Size(Complex a) {
    return SquaredModulus(a);
}

size_t Diagonal(size_t j, size_t n, int32_t triangle) {
    return triangle == kLower ? LowerDiagonal(j, n) : UpperDiagonal(j);
}

// Whether an element of the diagonal is not above `tolerance` times the largest element of all.
template <class T>
bool IsSingular(const T* packed, int32_t n, int32_t triangle, double tolerance) {
    double largest = 0.0;
    for (size_t i = 0; i < PackedCount(n); ++i) largest = std::max(largest, Size(packed[i]));
    const double cut = tolerance * largest;
    for (size_t j = 0; j < Count(n); ++j)
        if (Size(packed[Diagonal(j, Count(n), triangle)]) <= cut) return true;
    return false;
}

// Column j of the inverse is -(inverse of the part before or behind it) times column j, divided by the diagonal; that
// part is inverted already when its turn comes, columns running from the tip of the triangle to its base.
//
// x = M x for the upper triangle M of order `order`.
template <class T>
void MultiplyByUpper(const T* upper, size_t order, T* x) {
    for (size_t k = 0; k < order; ++k) {
        const T* const column = upper + (UpperDiagonal(k) - k);
        const T factor = x[k];
        for (size_t i = 0; i < k; ++i) x[i] += factor * column[i];
        x[k] = factor * column[k];
    }
}

// x = M x for the packed lower triangle M of order `order`.
template <class T>
void MultiplyByLower(const T* lower, size_t order, T* x) {
    for (size_t k = order; k-- > 0;) {
        const T* const column = lower + (LowerDiagonal(k, order) - k);
        const T factor = x[k];
        for (size_t i = k + 1; i < order; ++i) x[i] += factor * column[i];
        x[k] = factor * column[k];
    }
}

template <class T>
void InvertInPlace(T* packed, size_t n, int32_t triangle) {
    for (size_t done = 0; done < n; ++done) {
        const size_t j = triangle == kLower ? n - 1 - done : done;
        T* const diagonal = packed + Diagonal(j, n, triangle);
        T* const column = triangle == kLower ? diagonal + 1 : diagonal - done;
        *diagonal = FromReal<T>(1.0) / *diagonal;
        if (triangle == kLower) {
            MultiplyByLower(diagonal + 1 + done, done, column);
        } else {
            MultiplyByUpper(packed, done, column);
        }
        const T factor = -*diagonal;
        for (size_t i = 0; i < done; ++i) column[i] *= factor;
    }
}

}  // namespace

template <class T>
int32_t TriangularSolvePacked(const T* packed, int32_t n, const T* b, int32_t nrhs, int32_t triangle, T* x) {
    if (n < 1 || nrhs < 1) return kEmptyInput;
    const size_t b_count = Count(n) * Count(nrhs);
    if (HasUnusable(packed, PackedCount(n)) || HasUnusable(b, b_count)) return kNotFinite;
    if (x != b) std::copy_n(b, b_count, x);
    if (IsSingular(packed, n, triangle, kEpsilon)) return kSingular;
    if (triangle == kLower) {
        substitution::Forward(packed, Count(n), x, Count(nrhs));
    } else {
        substitution::Backward(packed, Count(n), x, Count(nrhs));
    }
    return kOk;
}

template <class T>
int32_t TriangularSolveFull(const T* a, int32_t n, int32_t triangle, const T* b, int32_t nrhs, T* x) {
    Scratch<T> packed(PackedCount(n));
    if (!packed) return kOutOfMemory;
    if (const int32_t status = PackTriangle(a, n, triangle, packed.data())) return status;
    return TriangularSolvePacked(packed.data(), n, b, nrhs, triangle, x);
}

template <class T>
int32_t TriangularInversePacked(const T* packed, int32_t n, int32_t triangle, T* inverse) {
    if (triangle != kLower && triangle != kUpper) return kBadSelector;
    if (n < 1) return kEmptyInput;
    if (inverse != packed) std::copy_n(packed, PackedCount(n), inverse);
    if (IsSingular(inverse, n, triangle, kIsComplex<T> ? kEpsilonSquared : kEpsilon)) return kSingular;
    InvertInPlace(inverse, Count(n), triangle);
    return kOk;
}

template <class T>
int32_t InvertTriangle(T* a, int32_t n, int32_t triangle) {
    Scratch<T> packed(PackedCount(n));
    if (!packed) return kOutOfMemory;
    PackTriangle(a, n, triangle, packed.data());  // an unknown triangle is found next
    if (const int32_t status = TriangularInversePacked(packed.data(), n, triangle, packed.data())) return status;
    return UnpackTriangle(packed.data(), n, triangle, a);
}

#define KRNUMER_INSTANTIATE(T)                                                                 \
    template int32_t TriangularSolvePacked(const T*, int32_t, const T*, int32_t, int32_t, T*); \
    template int32_t TriangularSolveFull(const T*, int32_t, int32_t, const T*, int32_t, T*);   \
    template int32_t TriangularInversePacked(const T*, int32_t, int32_t, T*);                  \
    template int32_t InvertTriangle(T*, int32_t, int32_t);
KRNUMER_INSTANTIATE(double)
KRNUMER_INSTANTIATE(Complex)
#undef KRNUMER_INSTANTIATE

}  // namespace krnumer

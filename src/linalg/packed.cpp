#include "linalg/packed.h"

#include <cmath>

#include "frame/status.h"
#include "linalg/element.h"

namespace krnumer {
namespace {

int32_t CheckTriangle(int32_t n, int32_t triangle) {
    if (n < 1) return kEmptyInput;
    return triangle == kLower || triangle == kUpper || triangle == kSymmetric ? kOk : kBadSelector;
}

// Calls visit(row, column) for the places of a triangle in packed order.
template <class Visit>
void ForEachPlace(size_t n, int32_t triangle, Visit visit) {
    for (size_t j = 0; j < n; ++j) {
        const size_t first = triangle == kUpper ? 0 : j, last = triangle == kUpper ? j + 1 : n;
        for (size_t i = first; i < last; ++i) visit(i, j);
    }
}

}  // namespace

int32_t PackedOrder(int32_t length, int32_t* n) {
    *n = 0;
    if (length < 1) return kEmptyInput;
    *n = TruncateToInt32(0.5 * (std::sqrt(8.0 * length + 1.0) - 1.0));
    const double order = *n;
    return (order + 1.0) * order * 0.5 == length ? kOk : kNotSquare;
}

template <class T>
int32_t PackTriangle(const T* a, int32_t n, int32_t triangle, T* packed) {
    if (const int32_t status = CheckTriangle(n, triangle)) return status;
    ForEachPlace(Count(n), triangle, [&](size_t i, size_t j) { *packed++ = a[i * Count(n) + j]; });
    return kOk;
}

template <class T>
int32_t UnpackTriangle(const T* packed, int32_t n, int32_t triangle, T* a) {
    if (const int32_t status = CheckTriangle(n, triangle)) return status;
    ForEachPlace(Count(n), triangle, [&](size_t i, size_t j) {
        const T element = *packed++;
        if (i != j) a[j * Count(n) + i] = triangle == kSymmetric ? Conjugate(element) : T{};
        a[i * Count(n) + j] = element;
    });
    return kOk;
}

#define KRNUMER_INSTANTIATE(T)                                     \
    template int32_t PackTriangle(const T*, int32_t, int32_t, T*); \
    template int32_t UnpackTriangle(const T*, int32_t, int32_t, T*);
KRNUMER_INSTANTIATE(double)
KRNUMER_INSTANTIATE(Complex)
#undef KRNUMER_INSTANTIATE

}  // namespace krnumer

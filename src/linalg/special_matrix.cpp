#include "linalg/special_matrix.h"

#include <algorithm>

#include "frame/numeric.h"
#include "frame/status.h"
#include "linalg/element.h"

namespace krnumer {

Dimensions SpecialMatrixDimensions(int32_t kind, int32_t size, int32_t xlen, int32_t ylen) {
    switch (kind) {
        case kDiagonal:
        case kVandermonde:
            return {xlen, xlen};
        case kToeplitz:
            return {xlen, ylen};
        case kCompanion: {
            const int32_t degree = std::max(xlen, 1) - 1;
            return {degree, degree};
        }
        default:
            return {size, size};
    }
}

int32_t CheckSpecialMatrix(int32_t kind, Dimensions dimensions) {
    if (dimensions.rows >= 1 && dimensions.columns >= 1) return kOk;
    return kind == kCompanion ? kFewerThanTwo : kEmptyInput;
}

template <class T>
int32_t MakeSpecialMatrix(int32_t kind, int32_t size, const T* x, int32_t xlen, const T* y, int32_t ylen, T* m) {
    const Dimensions dimensions = SpecialMatrixDimensions(kind, size, xlen, ylen);
    if (const int32_t status = CheckSpecialMatrix(kind, dimensions)) return status;
    const size_t rows = Count(dimensions.rows), n = Count(dimensions.columns);
    const T one = FromReal<T>(1.0);
    const auto clear = [&] { std::fill_n(m, rows * n, T{}); };

    switch (kind) {
        case kIdentity:
            clear();
            for (size_t i = 0; i < n; ++i) m[i * (n + 1)] = one;
            return kOk;
        case kDiagonal:
            clear();
            for (size_t i = 0; i < n; ++i) m[i * (n + 1)] = x[i];
            return kOk;
        case kToeplitz:
            for (size_t i = 0; i < rows; ++i)
                for (size_t j = 0; j < n; ++j) *m++ = i >= j ? x[i - j] : y[j - i];
            return kOk;
        case kVandermonde:
            for (size_t i = 0; i < rows; ++i) {
                T power = one;
                m[i * n + n - 1] = power;
                for (size_t j = n - 1; j-- > 0;) m[i * n + j] = power *= x[i];
            }
            return kOk;
        case kCompanion:
            clear();
            for (size_t j = 0; j < n; ++j) m[j] = -x[j + 1] / x[0];
            for (size_t i = 1; i < n; ++i) m[i * n + i - 1] = one;
            return kOk;
        default:
            return kBadSelector;
    }
}

template int32_t MakeSpecialMatrix(int32_t, int32_t, const double*, int32_t, const double*, int32_t, double*);
template int32_t MakeSpecialMatrix(int32_t, int32_t, const Complex*, int32_t, const Complex*, int32_t, Complex*);

}  // namespace krnumer

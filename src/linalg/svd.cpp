#include "linalg/svd.h"

#include <algorithm>
#include <cstddef>

#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"
#include "linalg/element.h"
#include "linalg/finite.h"
#include "linalg/qr.h"
#include "linalg/svd_engine.h"
#include "linalg/transpose.h"

namespace krnumer {

namespace {

template <class T>
int32_t CheckInput(const T* a, int32_t m, int32_t n) {
    if (std::min(m, n) < 1) return kEmptyInput;
    return HasUnusable(a, Count(m) * Count(n)) ? kNotFinite : kOk;
}

// The decomposition of a tall matrix, or that of the conjugate transpose of a wide one, where the singular vectors
// change sides. `longer` (max by min) takes the vectors of the longer side, `shorter` (square) the others.
template <class T>
int32_t DecomposeThin(const T* a, int32_t m, int32_t n, T* longer, double* s, T* shorter) {
    if (m < n) {
        ConjTransposeCore(a, m, n, longer);
    } else if (longer != a) {
        std::copy_n(a, Count(m) * Count(n), longer);
    }
    return DecomposeTall(longer, std::max(m, n), std::min(m, n), s, shorter);
}

// Adds columns to the q orthonormal ones of `thin` (p by q) until they span the whole space: p by p.
template <class T>
int32_t CompleteBasis(const T* thin, int32_t p, int32_t q, T* basis) {
    const std::size_t rows = Count(p), columns = Count(q);
    Scratch<T> r(rows * columns);
    if (!r) return kOutOfMemory;
    if (const int32_t status = QRHouseholder(thin, p, q, kFullQR, basis, r.data())) return status;
    for (std::size_t i = 0; i < rows; ++i) {
        for (std::size_t j = 0; j < columns; ++j) {
            T& element = basis[i * rows + j];
            if constexpr (kIsComplex<T>) {
                element = thin[i * columns + j];
            } else if (r[j * columns + j] < 0.0) {
                element = -element;
            }
        }
    }
    return kOk;
}

}  // namespace

template <class T>
int32_t SvdCore(const T* a, int32_t m, int32_t n, T* u, double* s, T* v, bool full) {
    if (const int32_t status = CheckInput(a, m, n)) return status;
    T* longer = m < n ? v : u;
    T* shorter = m < n ? u : v;
    if (!full || m == n) return DecomposeThin(a, m, n, longer, s, shorter);

    const int32_t p = std::max(m, n), q = std::min(m, n);
    Scratch<T> thin(Count(p) * Count(q));
    if (!thin) return kOutOfMemory;
    if (const int32_t status = DecomposeThin(a, m, n, thin.data(), s, shorter)) return status;
    return CompleteBasis(thin.data(), p, q, longer);
}

template <class T>
int32_t SvdValuesCore(const T* a, int32_t m, int32_t n, double* s) {
    if (const int32_t status = CheckInput(a, m, n)) return status;
    Scratch<T> copy(Count(m) * Count(n));
    if (!copy) return kOutOfMemory;
    return DecomposeThin<T>(a, m, n, copy.data(), s, nullptr);
}

template int32_t SvdCore(const double*, int32_t, int32_t, double*, double*, double*, bool);
template int32_t SvdCore(const Complex*, int32_t, int32_t, Complex*, double*, Complex*, bool);
template int32_t SvdValuesCore(const double*, int32_t, int32_t, double*);
template int32_t SvdValuesCore(const Complex*, int32_t, int32_t, double*);

}  // namespace krnumer

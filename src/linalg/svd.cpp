#include "linalg/svd.h"

#include <algorithm>
#include <cstddef>

#include "frame/numeric.h"
#include "frame/scratch.h"
#include "frame/status.h"
#include "linalg/element.h"
#include "linalg/finite.h"
#include "linalg/svd_engine.h"

namespace krnumer {

namespace {

template <class T>
int32_t CheckInput(const T* a, int32_t m, int32_t n) {
    if (std::min(m, n) < 1) return kEmptyInput;
    return HasUnusable(a, Count(m) * Count(n)) ? kNotFinite : kOk;
}

// out (n by m) = A^H.
template <class T>
void ConjugateTranspose(const T* a, std::size_t m, std::size_t n, T* out) {
    for (std::size_t i = 0; i < m; ++i)
        for (std::size_t j = 0; j < n; ++j) out[j * m + i] = Conjugate(a[i * n + j]);
}

// The decomposition of a tall matrix, or that of the conjugate transpose of a wide one, where the singular vectors
// change sides. `longer` (max by min) takes the vectors of the longer side, `shorter` (square) the others.
template <class T>
int32_t DecomposeThin(const T* a, int32_t m, int32_t n, T* longer, double* s, T* shorter) {
    if (m < n) {
        ConjugateTranspose(a, Count(m), Count(n), longer);
    } else if (longer != a) {
        std::copy_n(a, Count(m) * Count(n), longer);
    }
    return DecomposeTall(longer, std::max(m, n), std::min(m, n), s, shorter);
}

}  // namespace

template <class T>
int32_t SvdCore(const T* a, int32_t m, int32_t n, T* u, double* s, T* v, bool full) {
    if (const int32_t status = CheckInput(a, m, n)) return status;
    T* longer = m < n ? v : u;
    T* shorter = m < n ? u : v;
    if (!full || m == n) return DecomposeThin(a, m, n, longer, s, shorter);

    return kNotProvided;  // completing the basis of a matrix that is not square takes a QR decomposition
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

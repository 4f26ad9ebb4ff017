#include "frame/scratch.h"
#include "frame/status.h"
#include "linalg/cholesky.h"
#include "linalg/packed.h"
#include "linalg/transpose.h"

namespace krnumer {

template <class T>
int32_t CholeskyUpper(T* a, int32_t n) {
    Scratch<T> packed(PackedCount(n));
    if (!packed) return kOutOfMemory;
    if (const int32_t status = PackTriangle(a, n, kLower, packed.data())) return status;
    if (const int32_t status = CholeskyPacked(packed.data(), n)) return status;
    UnpackTriangle(packed.data(), n, kLower, a);
    return ConjTransposeInPlace(a, n, n);
}

template int32_t CholeskyUpper(double*, int32_t);
template int32_t CholeskyUpper(Complex*, int32_t);

}  // namespace krnumer

#include <cstddef>
#include <limits>

#include "frame/entry.h"
#include "krnumer/linalg_basic.h"
#include "linalg/cores.h"
#include "linalg/element.h"
#include "linalg/entry_support.h"

using namespace krnumer;

static_assert(offsetof(KrTriangle, elements) == 0 && offsetof(KrTriangle, triangle) == sizeof(KrHandle));

namespace {

template <class T>
int32_t Unpack(const KrTriangle* packed, KrHandle m, int32_t* err) {
    ByReference call(err);
    In<T> triangle(call, packed->elements);
    OutMatrix<T> matrix(call, m);
    int32_t n = 0;
    if (const int32_t status = PackedOrder(triangle.size(), &n)) return call.Fail(status);
    if (matrix.Resize(n, n)) return call.Fail(kOutOfMemory);
    return call.Run([&] { return UnpackTriangle(triangle.data(), n, packed->triangle, matrix.data()); });
}

template <class T>
int32_t Pack(KrHandle a, const int32_t* triangle, KrHandle p, int32_t* err) {
    ByReference call(err);
    InMatrix<T> matrix(call, a);
    Out<T> packed(call, p);
    const int32_t n = matrix.rows();
    int32_t status = kOk;
    if (!kIsComplex<T> && IsEmpty(matrix)) status = kEmptyInput;  // the complex core reports it, from behind the resize
    if (!IsSquare(matrix)) status = kNotSquare;
    if (status != kOk) return call.Fail(status);
    if (PackedCount(n) > std::numeric_limits<int32_t>::max() || packed.Resize(static_cast<int32_t>(PackedCount(n)))) {
        return call.Fail(kOutOfMemory);
    }
    return call.Run([&] { return PackTriangle(matrix.data(), n, *triangle, packed.data()); });
}

}  // namespace

int32_t Compact_to_Matrix_head(const KrTriangle* packed, KrHandle m, int32_t* err) {
    return Unpack<double>(packed, m, err);
}
int32_t CxCompact_to_Matrix_head(const KrTriangle* packed, KrHandle m, int32_t* err) {
    return Unpack<Complex>(packed, m, err);
}

int32_t Matrix_to_Compact_head(KrHandle a, const int32_t* triangle, KrHandle p, int32_t* err) {
    return Pack<double>(a, triangle, p, err);
}
int32_t CxMatrix_to_Compact_head(KrHandle a, const int32_t* triangle, KrHandle p, int32_t* err) {
    return Pack<Complex>(a, triangle, p, err);
}

#include <algorithm>

#include "frame/entry.h"
#include "krnumer/linalg_svd.h"
#include "linalg/element.h"
#include "linalg/entry_support.h"
#include "linalg/svd.h"

using namespace krnumer;

namespace {

template <class T>
int32_t SvdInPlace(KrHandle a, KrHandle s, KrHandle v, int32_t* err) {
    ByReference call(err);
    InOutMatrix<T> matrix(call, a);
    Out<T> values(call, s);
    OutMatrix<T> right(call, v);
    if constexpr (!kIsComplex<T>) {
        if (right.Clear() || values.Clear()) return call.Fail(kOutOfMemory);
    }
    const int32_t m = matrix.rows(), n = matrix.columns(), k = std::min(m, n);
    if (k < 1) return call.Fail(kEmptyInput);
    if (right.Resize(n, k) || values.Resize(k) || call.Map()) return call.Fail(kOutOfMemory);
    auto* singular = reinterpret_cast<double*>(values.data());
    if (const int32_t status = SvdCore(matrix.data(), m, n, matrix.data(), singular, right.data(), false))
        return call.Fail(status);
    if constexpr (kIsComplex<T>) SpreadToComplex(values.data(), k);
    if (matrix.Resize(m, k)) return call.Fail(kOutOfMemory);
    return call.Deliver(kOk);
}

template <class T>
int32_t SvdInForm(KrHandle a, bool full, KrHandle u, KrHandle s, KrHandle v) {
    ByValue call;
    InMatrix<T> matrix(call, a);
    OutMatrix<T> left(call, u);
    Out<double> values(call, s);
    OutMatrix<T> right(call, v);
    const int32_t m = matrix.rows(), n = matrix.columns(), k = std::min(m, n);
    if (k < 1) return call.Fail(kEmptyInput);
    if (left.Resize(m, full ? m : k) || values.Resize(k) || right.Resize(n, full ? n : k))
        return call.Fail(kOutOfMemory);
    return call.Run([&] { return SvdCore(matrix.data(), m, n, left.data(), values.data(), right.data(), full); });
}

template <class T>
int32_t SvdValues(KrHandle a, KrHandle s, int32_t* err) {
    ByReference call(err);
    InMatrix<T> matrix(call, a);
    Out<double> values(call, s);
    if constexpr (!kIsComplex<T>) {
        if (values.Clear()) return call.Fail(kOutOfMemory);
    }
    const int32_t k = std::min(matrix.rows(), matrix.columns());
    if (k < 1) return call.Fail(kEmptyInput);
    if (values.Resize(k)) return call.Fail(kOutOfMemory);
    return call.Run([&] { return SvdValuesCore(matrix.data(), matrix.rows(), matrix.columns(), values.data()); });
}

}  // namespace

int32_t SVD_head(KrHandle a, KrHandle s, KrHandle v, int32_t* err) {
    return SvdInPlace<double>(a, s, v, err);
}
int32_t CxSVD_head(KrHandle a, KrHandle s, KrHandle v, int32_t* err) {
    return SvdInPlace<Complex>(a, s, v, err);
}

int32_t SVDEx_head(KrHandle a, int32_t full, KrHandle u, KrHandle s, KrHandle v) {
    return SvdInForm<double>(a, full != 0, u, s, v);
}
int32_t CxSVDEx_head(KrHandle a, int32_t full, KrHandle u, KrHandle s, KrHandle v) {
    return SvdInForm<Complex>(a, full != 0, u, s, v);
}

int32_t SVDS_head(KrHandle a, KrHandle s, int32_t* err) {
    return SvdValues<double>(a, s, err);
}
int32_t CxSVDS_head(KrHandle a, KrHandle s, int32_t* err) {
    return SvdValues<Complex>(a, s, err);
}

#include "frame/entry.h"
#include "krnumer/linalg_basic.h"
#include "linalg/cores.h"
#include "linalg/entry_support.h"

using namespace krnumer;

namespace {

template <class T>
int32_t DotProduct(KrHandle x, KrHandle y, void* dot, int32_t* err) {
    ByReference call(err);
    In<T> left(call, x), right(call, y);
    Result<T> product(call, dot);
    int32_t status = kOk;
    if (IsEmpty(left) || IsEmpty(right)) status = kEmptyInput;
    if (left.size() != right.size()) status = kSizesDiffer;
    if (status != kOk) return call.Fail(status);
    return call.Run([&] { return DotCore(left.data(), right.data(), left.size(), product.data()); });
}

template <class T>
int32_t OuterProduct(KrHandle x, KrHandle y, KrHandle m, int32_t* err) {
    ByReference call(err);
    In<T> left(call, x), right(call, y);
    OutMatrix<T> product(call, m);
    if (IsEmpty(left) || IsEmpty(right)) return call.Fail(kEmptyInput);
    if (product.Resize(left.size(), right.size())) return call.Fail(kOutOfMemory);
    return call.Run([&] { return OuterCore(left.data(), left.size(), right.data(), right.size(), product.data()); });
}

// Sizes of 0 are welcome: the core knows what to make of them.
template <class T>
int32_t MatrixProduct(KrHandle a, KrHandle b, KrHandle c, int32_t* err) {
    ByReference call(err);
    InMatrix<T> left(call, a), right(call, b);
    OutMatrix<T> product(call, c);
    int32_t status = kOk;
    if (IsNegative(left) || IsNegative(right)) status = kEmptyInput;
    if (left.columns() != right.rows()) status = kInnerSizesDiffer;
    if (status != kOk) return call.Fail(status);
    if (product.Resize(left.rows(), right.columns())) return call.Fail(kOutOfMemory);
    return call.Run([&] {
        return MatMulCore(left.data(), right.data(), left.rows(), left.columns(), right.columns(), product.data());
    });
}

template <class T>
int32_t MatrixTimesVector(KrHandle a, KrHandle x, KrHandle y, int32_t* err) {
    ByReference call(err);
    InMatrix<T> matrix(call, a);
    In<T> vector(call, x);
    Out<T> product(call, y);
    int32_t status = kOk;
    if (IsNegative(matrix)) status = kEmptyInput;
    if (vector.size() != matrix.columns()) status = kSizesDiffer;
    if (status != kOk) return call.Fail(status);
    if (product.Resize(matrix.rows())) return call.Fail(kOutOfMemory);
    return call.Run(
        [&] { return MatVecCore(matrix.data(), matrix.rows(), matrix.columns(), vector.data(), product.data()); });
}

template <class T>
int32_t VectorTimesMatrix(KrHandle x, KrHandle a, KrHandle y) {
    ByValue call;
    In<T> vector(call, x);
    InMatrix<T> matrix(call, a);
    Out<T> product(call, y);
    if (vector.size() < 0 || IsNegative(matrix)) return call.Fail(kEmptyInput);
    if (vector.size() != matrix.rows()) return call.Fail(kSizesDiffer);
    if (product.Resize(matrix.columns())) return call.Fail(kOutOfMemory);
    return call.Run(
        [&] { return MatMulCore(vector.data(), matrix.data(), 1, matrix.rows(), matrix.columns(), product.data()); });
}

template <class T>
int32_t KroneckerProduct(KrHandle a, KrHandle b, KrHandle k) {
    ByValue call;
    InMatrix<T> left(call, a), right(call, b);
    OutMatrix<T> product(call, k);
    if (IsEmpty(left) || IsEmpty(right)) return call.Fail(kEmptyInput);
    int32_t rows = 0, columns = 0;
    if (!MultiplySizes(left.rows(), right.rows(), &rows) || !MultiplySizes(left.columns(), right.columns(), &columns) ||
        product.Resize(rows, columns)) {
        return call.Fail(kOutOfMemory);
    }
    return call.Run([&] {
        return KroneckerCore(left.data(), left.rows(), left.columns(), right.data(), right.rows(), right.columns(),
                             product.data());
    });
}

}  // namespace

int32_t DotProduct_head(KrHandle x, KrHandle y, double* dot, int32_t* err) {
    return DotProduct<double>(x, y, dot, err);
}
int32_t DotprodCx(KrHandle x, KrHandle y, KrComplex* dot, int32_t* err) {
    return DotProduct<Complex>(x, y, dot, err);
}

int32_t OuterProd_head(KrHandle x, KrHandle y, KrHandle m, int32_t* err) {
    return OuterProduct<double>(x, y, m, err);
}
int32_t OuterProdCx_head(KrHandle x, KrHandle y, KrHandle m, int32_t* err) {
    return OuterProduct<Complex>(x, y, m, err);
}

int32_t MatrixMul_head(KrHandle a, KrHandle b, KrHandle c, int32_t* err) {
    return MatrixProduct<double>(a, b, c, err);
}
int32_t AxBCxCIN(KrHandle a, KrHandle b, KrHandle c, int32_t* err) {
    return MatrixProduct<Complex>(a, b, c, err);
}

int32_t AxVect_head(KrHandle a, KrHandle x, KrHandle y, int32_t* err) {
    return MatrixTimesVector<double>(a, x, y, err);
}
int32_t AxVectorCx(KrHandle a, KrHandle x, KrHandle y, int32_t* err) {
    return MatrixTimesVector<Complex>(a, x, y, err);
}

int32_t vectxA_head(KrHandle x, KrHandle a, KrHandle y) {
    return VectorTimesMatrix<double>(x, a, y);
}
int32_t CxVectxA_head(KrHandle x, KrHandle a, KrHandle y) {
    return VectorTimesMatrix<Complex>(x, a, y);
}

int32_t KroneckerProd_H(KrHandle a, KrHandle b, KrHandle k) {
    return KroneckerProduct<double>(a, b, k);
}
int32_t CxKroneckerProd_H(KrHandle a, KrHandle b, KrHandle k) {
    return KroneckerProduct<Complex>(a, b, k);
}

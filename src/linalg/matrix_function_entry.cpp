#include <algorithm>

#include "frame/scratch.h"
#include "krnumer/linalg_function.h"
#include "linalg/entry_support.h"
#include "linalg/matrix_function.h"

using namespace krnumer;

namespace {

// A core that works in place, of the older form.
template <class T>
int32_t Replace(KrHandle a, int32_t* err, int32_t (*core)(T*, int32_t)) {
    ByReference call(err);
    InOutMatrix<T> matrix(call, a);
    if (const int32_t status = CheckSquare(matrix)) return call.Fail(status);
    return call.Run([&] { return core(matrix.data(), matrix.rows()); });
}

void Spread(const double* from, int32_t n, Complex* to) {
    std::transform(from, from + Count(n) * Count(n), to, [](double value) { return Complex{value, 0.0}; });
}

template <class T>
int32_t Power(KrHandle a, int32_t power) {
    ByValue call;
    InOutMatrix<T> matrix(call, a);
    const int32_t n = matrix.rows();
    if (IsEmpty(matrix)) return call.Fail(kEmptyInput);
    if (!IsSquare(matrix)) return call.Fail(kNotSquare);
    return call.Run([&] { return PowerCore(matrix.data(), n, power, matrix.data()); });
}

}  // namespace

int32_t MatrixExp_head(KrHandle a, int32_t* err) {
    return Replace(a, err, ExpCore<double>);
}
int32_t CxMatrixExp_head(KrHandle a, int32_t* err) {
    return Replace(a, err, ExpCore<Complex>);
}

int32_t MatrixLn_head(KrHandle a, KrHandle l, int32_t* err) {
    ByReference call(err);
    InMatrix<double> matrix(call, a);
    OutMatrix<Complex> logarithm(call, l);
    const int32_t n = matrix.rows();
    if (const int32_t status = CheckSquare(matrix)) return call.Fail(status);
    if (logarithm.Resize(n, n)) return call.Fail(kOutOfMemory);
    return call.Run([&] {
        Spread(matrix.data(), n, logarithm.data());
        return CxLnCore(logarithm.data(), n);
    });
}
int32_t CxMatrixLn_head(KrHandle a, int32_t* err) {
    return Replace(a, err, CxLnCore);
}

int32_t MatrixSqrt_head(KrHandle a, int32_t* err) {
    ByReference call(err);
    InOutMatrix<double> matrix(call, a);
    const int32_t n = matrix.rows();
    if (const int32_t status = CheckSquare(matrix)) return call.Fail(status);
    return call.Run([&]() -> int32_t {
        const size_t count = Count(n) * Count(n);
        Scratch<Complex> root(count);
        if (!root) return kOutOfMemory;
        Spread(matrix.data(), n, root.data());
        const int32_t status = CxSqrtCore(root.data(), n);
        if (status < 0) return status;
        for (size_t i = 0; i < count; ++i) matrix.data()[i] = root[i].re;
        return status;
    });
}
int32_t CxMatrixSqrt_head(KrHandle a, int32_t* err) {
    return Replace(a, err, CxSqrtCore);
}

int32_t MatrixSqrtH(KrHandle a, KrHandle s) {
    ByValue call;
    InMatrix<double> matrix(call, a);
    OutMatrix<Complex> root(call, s);
    const int32_t n = matrix.rows();
    if (IsEmpty(matrix)) return call.Fail(kEmptyInput);
    if (!IsSquare(matrix)) return call.Fail(kNotSquare);
    if (root.Resize(n, n)) return call.Fail(kOutOfMemory);
    return call.Run([&] {
        Spread(matrix.data(), n, root.data());
        return CxSqrtCore(root.data(), n);
    });
}

int32_t MatrixPower_head(KrHandle a, int32_t power) {
    return Power<double>(a, power);
}
int32_t CxMatrixPower_head(KrHandle a, int32_t power) {
    return Power<Complex>(a, power);
}

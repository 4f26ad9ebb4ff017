#include <algorithm>

#include "frame/entry.h"
#include "frame/scratch.h"
#include "krnumer/linalg_basic.h"
#include "linalg/cores.h"
#include "linalg/element.h"
#include "linalg/entry_support.h"

using namespace krnumer;

namespace {

template <class T>
int32_t Trace(KrHandle a, void* trace, int32_t* err) {
    ByReference call(err);
    InMatrix<T> matrix(call, a);
    Result<T> sum(call, trace);
    return call.Run([&] { return TraceCore(matrix.data(), matrix.rows(), matrix.columns(), sum.data()); });
}

template <class T>
int32_t Transpose(Call& call, KrHandle a, KrHandle b) {
    InMatrix<T> matrix(call, a);
    OutMatrix<T> transpose(call, b);
    if (IsEmpty(matrix)) return call.Fail(kEmptyInput);
    if (transpose.Resize(matrix.columns(), matrix.rows())) return call.Fail(kOutOfMemory);
    return call.Run(
        [&] { return ConjTransposeCore(matrix.data(), matrix.rows(), matrix.columns(), transpose.data()); });
}

template <class T>
int32_t Special(const int32_t* kind, const int32_t* size, KrHandle x, KrHandle y, KrHandle m, int32_t* err) {
    ByReference call(err);
    In<T> first(call, x), second(call, y);
    OutMatrix<T> matrix(call, m);
    const Dimensions wanted = SpecialMatrixDimensions(*kind, *size, first.size(), second.size());
    if (const int32_t status = CheckSpecialMatrix(*kind, wanted)) return call.Fail(status);
    if (matrix.Resize(wanted.rows, wanted.columns)) return call.Fail(kOutOfMemory);
    return call.Run([&] {
        return MakeSpecialMatrix(*kind, *size, first.data(), first.size(), second.data(), second.size(), matrix.data());
    });
}

// Whether malloc has room for so many elements. Volatile, or the compiler drops an allocation that nobody uses.
template <class T>
bool MemoryHolds(size_t count) {
    const Scratch<T> probe(count);
    const T* volatile const memory = probe.data();
    return memory != nullptr;
}

// The one entry point of the family that hands on what the host says to a resize.
template <class T>
int32_t ZeroMatrix(int32_t rows, int32_t columns, KrHandle m) {
    ByValue call;
    OutMatrix<T> matrix(call, m);
    if (rows < 1 || columns < 1) return call.Fail(kEmptyInput);
    if (!MemoryHolds<T>(Count(rows) * Count(columns))) return call.Fail(kOutOfMemory);
    if (const int32_t host = matrix.Resize(rows, columns)) return call.HostFailure(host);
    return call.Run([&] {
        std::fill_n(matrix.data(), matrix.count(), T{});
        return kOk;
    });
}

}  // namespace

int32_t Trace_head(KrHandle a, double* trace, int32_t* err) {
    return Trace<double>(a, trace, err);
}
int32_t CxTrace_head(KrHandle a, KrComplex* trace, int32_t* err) {
    return Trace<Complex>(a, trace, err);
}

int32_t Transpose_head(KrHandle a, KrHandle b) {
    ByValue call;
    return Transpose<double>(call, a, b);
}
int32_t CxTranspose_head(KrHandle a, KrHandle b, int32_t* err) {
    ByReference call(err);
    return Transpose<Complex>(call, a, b);
}

int32_t SpecialMatrix_head(const int32_t* kind, const int32_t* size, KrHandle x, KrHandle y, KrHandle m, int32_t* err) {
    return Special<double>(kind, size, x, y, m, err);
}
int32_t CxSpecialMatrix_head(const int32_t* kind, const int32_t* size, KrHandle x, KrHandle y, KrHandle m,
                             int32_t* err) {
    return Special<Complex>(kind, size, x, y, m, err);
}

int32_t InitialMatrixH(int32_t rows, int32_t columns, KrHandle m) {
    return ZeroMatrix<double>(rows, columns, m);
}
int32_t CxInitialMatrixH(int32_t rows, int32_t columns, KrHandle m) {
    return ZeroMatrix<Complex>(rows, columns, m);
}

// Linear equations by factors or triangles that the caller holds; the solution takes the place of the right-hand side.
#include "frame/entry.h"
#include "krnumer/linalg_solve.h"
#include "linalg/cores.h"
#include "linalg/element.h"
#include "linalg/entry_support.h"

using namespace krnumer;

namespace {

template <class T>
int32_t SolveByLUFactors(KrHandle lu, KrHandle p, KrHandle b, int32_t* err) {
    ByReference call(err);
    InMatrix<T> factors(call, lu);
    In<int32_t> pivots(call, p);
    InOut<T> x(call, b);
    const int32_t n = factors.rows();
    int32_t status = CheckSquare(factors);
    if (pivots.size() != n || x.size() != n) status = kSizesDiffer;
    if (status != kOk) return call.Fail(status);
    return call.Run([&] {
        if (const int32_t unfit = CheckPivots(pivots.data(), n)) return unfit;
        return LUSolve(factors.data(), pivots.data(), x.data(), n, x.data());
    });
}

template <class T>
int32_t SolveByCholeskyFactor(KrHandle l, KrHandle b, int32_t* err) {
    ByReference call(err);
    In<T> factor(call, l);
    InOut<T> x(call, b);
    int32_t n = 0;
    int32_t status = PackedOrder(factor.size(), &n);
    if (x.size() != n) status = kSizesDiffer;
    if (status != kOk) return call.Fail(status);
    return call.Run([&] { return CholeskySolvePacked(factor.data(), n, x.data(), 1); });
}

// The real function takes any triangle but the lower one for the upper one.
template <class T>
int32_t SolveTriangle(const KrTriangle* t, KrHandle b, int32_t* err) {
    ByReference call(err);
    In<T> packed(call, t->elements);
    InOut<T> x(call, b);
    const int32_t triangle = t->triangle;
    int32_t n = 0;
    int32_t status = kOk;
    if (kIsComplex<T> && triangle != kLower && triangle != kUpper) status = kBadSelector;
    if (const int32_t length_status = PackedOrder(packed.size(), &n)) status = length_status;
    if (x.size() != n) status = kSizesDiffer;
    if (status != kOk) return call.Fail(status);
    return call.Run([&] { return TriangularSolvePacked(packed.data(), n, x.data(), 1, triangle, x.data()); });
}

}  // namespace

int32_t LULinEqs_head(KrHandle lu, KrHandle p, KrHandle b, int32_t* err) {
    return SolveByLUFactors<double>(lu, p, b, err);
}
int32_t CxLULinEqs_head(KrHandle lu, KrHandle p, KrHandle b, int32_t* err) {
    return SolveByLUFactors<Complex>(lu, p, b, err);
}

int32_t CholeskyLinEqs_head(KrHandle l, KrHandle b, int32_t* err) {
    return SolveByCholeskyFactor<double>(l, b, err);
}
int32_t CxCholeskyLinEqs_head(KrHandle l, KrHandle b, int32_t* err) {
    return SolveByCholeskyFactor<Complex>(l, b, err);
}

int32_t TriLinEqs_head(const KrTriangle* t, KrHandle b, int32_t* err) {
    return SolveTriangle<double>(t, b, err);
}
int32_t CxTriLinEqs_head(const KrTriangle* t, KrHandle b, int32_t* err) {
    return SolveTriangle<Complex>(t, b, err);
}

// Linear equations by drivers that do everything from the matrix itself.
#include "frame/entry.h"
#include "krnumer/linalg_solve.h"
#include "linalg/cores.h"
#include "linalg/element.h"
#include "linalg/entry_support.h"

using namespace krnumer;

namespace {

constexpr double kDefaultTolerance = -1.0;

template <class T>
int32_t LeastSquares(KrHandle a, KrHandle b, KrHandle x, double tol, int32_t* err) {
    ByReference call(err);
    InMatrix<T> matrix(call, a);
    In<T> right_side(call, b);
    Out<T> solution(call, x);
    int32_t status = kOk;
    if (IsEmpty(matrix)) status = kEmptyInput;
    if (right_side.size() != matrix.rows()) status = kSizesDiffer;
    if (status != kOk) return call.Fail(status);
    if (solution.Resize(matrix.columns())) return call.Fail(kOutOfMemory);
    return call.Run([&] {
        const int32_t solved =
            SvdSolve(matrix.data(), matrix.rows(), matrix.columns(), right_side.data(), 1, solution.data(), tol);
        return solved == kWarnRankDeficient ? kOk : solved;
    });
}

template <class T>
int32_t LeastSquaresSet(KrHandle a, KrHandle b, KrHandle x, double tol) {
    ByValue call;
    InMatrix<T> matrix(call, a), right_sides(call, b);
    OutMatrix<T> solutions(call, x);
    if (IsEmpty(matrix) || right_sides.columns() < 1) return call.Fail(kEmptyInput);
    if (right_sides.rows() != matrix.rows()) return call.Fail(kSizesDiffer);
    if (solutions.Resize(matrix.columns(), right_sides.columns())) return call.Fail(kOutOfMemory);
    return call.Run([&] {
        return SvdSolve(matrix.data(), matrix.rows(), matrix.columns(), right_sides.data(), right_sides.columns(),
                        solutions.data(), tol);
    });
}

// A matrix with more rows than columns is not refused: what is solved has the order of its columns, and takes as many
// elements of the matrix and of the right-hand side as it needs.
template <class T>
int32_t SolveByLU(KrHandle a, KrHandle b, KrHandle x, int32_t* err) {
    ByReference call(err);
    InMatrix<T> matrix(call, a);
    In<T> right_side(call, b);
    Out<T> solution(call, x);
    const int32_t n = matrix.columns();
    int32_t status = kOk;
    if (n > matrix.rows()) status = kNotSquare;
    if (IsEmpty(matrix)) status = kEmptyInput;
    if (right_side.size() != matrix.rows()) status = kSizesDiffer;
    if (status != kOk) return call.Fail(status);
    if (solution.Resize(n)) return call.Fail(kOutOfMemory);
    return call.Run([&] { return LUSolveDirect(matrix.data(), n, right_side.data(), solution.data()); });
}

// What all sets of equations with a square matrix do before their core.
template <class T, class Core>
int32_t SolveSet(KrHandle a, int32_t triangle, KrHandle b, KrHandle x, Core&& core) {
    ByValue call;
    InMatrix<T> matrix(call, a), right_sides(call, b);
    OutMatrix<T> solutions(call, x);
    if (const int32_t status = CheckSquareSystem(matrix, right_sides)) return call.Fail(status);
    if (triangle != kLower && triangle != kUpper) return call.Fail(kBadSelector);
    if (solutions.Resize(matrix.columns(), right_sides.columns())) return call.Fail(kOutOfMemory);
    return call.Run([&] {
        return core(matrix.data(), matrix.rows(), right_sides.data(), right_sides.columns(), solutions.data());
    });
}

// Declared for completeness of the interface; the operation itself is not provided.
template <class T>
int32_t SolveSetByLU(KrHandle a, KrHandle b, KrHandle x) {
    return SolveSet<T>(a, kLower, b, x, [](const T*, int32_t, const T*, int32_t, T*) { return kNotProvided; });
}

template <class T>
int32_t SolveByCholesky(KrHandle a, KrHandle b, KrHandle x, int32_t* err) {
    ByReference call(err);
    InMatrix<T> matrix(call, a);
    In<T> right_side(call, b);
    Out<T> solution(call, x);
    int32_t status = CheckSquare(matrix);
    const bool is_final = !kIsComplex<T> && status == kNotSquare;
    if (right_side.size() != matrix.rows() && !is_final) status = kSizesDiffer;
    if (status != kOk) return call.Fail(status);
    if (solution.Resize(matrix.columns())) return call.Fail(kOutOfMemory);
    return call.Run(
        [&] { return CholeskySolveFull(matrix.data(), matrix.rows(), kUpper, right_side.data(), 1, solution.data()); });
}

template <class T>
int32_t SolveSetByCholesky(KrHandle a, int32_t triangle, KrHandle b, KrHandle x) {
    return SolveSet<T>(a, triangle, b, x, [=](const T* matrix, int32_t n, const T* right, int32_t count, T* solutions) {
        return CholeskySolveFull(matrix, n, triangle, right, count, solutions);
    });
}

template <class T>
int32_t SolveSetTriangular(KrHandle a, int32_t triangle, KrHandle b, KrHandle x) {
    return SolveSet<T>(a, triangle, b, x, [=](const T* matrix, int32_t n, const T* right, int32_t count, T* solutions) {
        return TriangularSolveFull(matrix, n, triangle, right, count, solutions);
    });
}

// Checks and core that one right-hand side and many have in common; the band matrix comes first in the call.
template <class T, class Right>
int32_t SolveBand(Call& call, const InMatrix<T>& band, Right& right, int32_t length, int32_t count, int32_t kl,
                  int32_t ku) {
    if (band.rows() != int64_t{kl} + 1 + ku || count < 1) return call.Fail(kBadDimension);
    if (length != band.columns()) return call.Fail(kPencilSizesDiffer);
    return call.Run([&] { return BandSolve(band.data(), length, kl, ku, right.data(), count); });
}

template <class T>
int32_t SolveBandVector(KrHandle ab, KrHandle b, int32_t kl, int32_t ku) {
    ByValue call;
    InMatrix<T> band(call, ab);
    InOut<T> right_side(call, b);
    return SolveBand(call, band, right_side, right_side.size(), 1, kl, ku);
}

template <class T>
int32_t SolveBandSet(KrHandle ab, KrHandle b, int32_t kl, int32_t ku) {
    ByValue call;
    InMatrix<T> band(call, ab);
    InOutMatrix<T> right_sides(call, b);
    return SolveBand(call, band, right_sides, right_sides.rows(), right_sides.columns(), kl, ku);
}

}  // namespace

int32_t GenLinEqs_head(KrHandle a, KrHandle b, KrHandle x, int32_t* err) {
    return LeastSquares<double>(a, b, x, kDefaultTolerance, err);
}
int32_t CxGenLinEqs_head(KrHandle a, KrHandle b, KrHandle x, int32_t* err) {
    return LeastSquares<Complex>(a, b, x, kDefaultTolerance, err);
}

int32_t GenLinEqs82_head(KrHandle a, KrHandle b, KrHandle x, double tol, int32_t* err) {
    return LeastSquares<double>(a, b, x, tol, err);
}
int32_t CxGenLinEqs82_head(KrHandle a, KrHandle b, KrHandle x, double tol, int32_t* err) {
    return LeastSquares<Complex>(a, b, x, tol, err);
}

int32_t EqsSetBySVDDri_head(KrHandle a, KrHandle b, KrHandle x) {
    return LeastSquaresSet<double>(a, b, x, kDefaultTolerance);
}
int32_t CxEqsSetBySVDDri_head(KrHandle a, KrHandle b, KrHandle x) {
    return LeastSquaresSet<Complex>(a, b, x, kDefaultTolerance);
}

int32_t EqsSetBySVDDri82_head(KrHandle a, KrHandle b, KrHandle x, double tol) {
    return LeastSquaresSet<double>(a, b, x, tol);
}
int32_t CxEqsSetBySVDDri82_head(KrHandle a, KrHandle b, KrHandle x, double tol) {
    return LeastSquaresSet<Complex>(a, b, x, tol);
}

int32_t EqsByLUDri_head(KrHandle a, KrHandle b, KrHandle x, int32_t* err) {
    return SolveByLU<double>(a, b, x, err);
}
int32_t CxEqsByLUDri_head(KrHandle a, KrHandle b, KrHandle x, int32_t* err) {
    return SolveByLU<Complex>(a, b, x, err);
}

int32_t EqsSetByLUDri_head(KrHandle a, KrHandle b, KrHandle x) {
    return SolveSetByLU<double>(a, b, x);
}
int32_t CxEqsSetByLUDri_head(KrHandle a, KrHandle b, KrHandle x) {
    return SolveSetByLU<Complex>(a, b, x);
}

int32_t EqsByCholeskyDri_head(KrHandle a, KrHandle b, KrHandle x, int32_t* err) {
    return SolveByCholesky<double>(a, b, x, err);
}
int32_t CxEqsByCholeskyDri_head(KrHandle a, KrHandle b, KrHandle x, int32_t* err) {
    return SolveByCholesky<Complex>(a, b, x, err);
}

int32_t EqsSetByCholeskyDri_head(KrHandle a, int32_t triangle, KrHandle b, KrHandle x) {
    return SolveSetByCholesky<double>(a, triangle, b, x);
}
int32_t CxEqsSetByCholeskyDri_head(KrHandle a, int32_t triangle, KrHandle b, KrHandle x) {
    return SolveSetByCholesky<Complex>(a, triangle, b, x);
}

int32_t TriEqsSetDri_head(KrHandle a, int32_t triangle, KrHandle b, KrHandle x) {
    return SolveSetTriangular<double>(a, triangle, b, x);
}
int32_t CxTriEqsSetDri_head(KrHandle a, int32_t triangle, KrHandle b, KrHandle x) {
    return SolveSetTriangular<Complex>(a, triangle, b, x);
}

int32_t BandEqsDriH(KrHandle ab, KrHandle b, int32_t kl, int32_t ku) {
    return SolveBandVector<double>(ab, b, kl, ku);
}
int32_t CxBandEqsDriH(KrHandle ab, KrHandle b, int32_t kl, int32_t ku) {
    return SolveBandVector<Complex>(ab, b, kl, ku);
}

int32_t BandEqsSetDriH(KrHandle ab, KrHandle b, int32_t kl, int32_t ku) {
    return SolveBandSet<double>(ab, b, kl, ku);
}
int32_t CxBandEqsSetDriH(KrHandle ab, KrHandle b, int32_t kl, int32_t ku) {
    return SolveBandSet<Complex>(ab, b, kl, ku);
}

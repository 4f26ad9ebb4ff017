#include "frame/entry.h"
#include "krnumer/linalg_measures.h"
#include "linalg/entry_support.h"
#include "linalg/measures.h"

using namespace krnumer;

namespace {

template <class T>
int32_t Determinant(KrHandle a, int32_t type, void* det, int32_t* err) {
    ByReference call(err);
    InMatrix<T> matrix(call, a);
    Result<T> determinant(call, det);
    if (const int32_t status = CheckSquare(matrix)) return call.Fail(status);
    return call.Run([&] { return DeterminantCore(matrix.data(), matrix.rows(), type, determinant.data()); });
}

template <class T>
int32_t Rank(KrHandle a, double tolerance, int32_t* rank, int32_t* err) {
    ByReference call(err);
    InMatrix<T> matrix(call, a);
    *rank = -1;
    if (IsEmpty(matrix)) return call.Fail(kEmptyInput);
    return call.Run([&] { return RankCore(matrix.data(), matrix.rows(), matrix.columns(), tolerance, rank); });
}

template <class T>
int32_t Norm(KrHandle a, int32_t type, double* norm, int32_t* err) {
    ByReference call(err);
    InMatrix<T> matrix(call, a);
    Result<double> result(call, norm);
    return call.Run([&] { return NormCore(matrix.data(), matrix.rows(), matrix.columns(), type, result.data()); });
}

template <class T>
int32_t Condition(KrHandle a, int32_t type, double* cond, int32_t* err) {
    ByReference call(err);
    InMatrix<T> matrix(call, a);
    Result<double> condition(call, cond);
    return call.Run(
        [&] { return ConditionCore(matrix.data(), matrix.rows(), matrix.columns(), type, condition.data()); });
}

template <class T>
int32_t PositiveDefiniteness(KrHandle a, int32_t* flag, int32_t* err) {
    ByReference call(err);
    InMatrix<T> matrix(call, a);
    *flag = 0;
    if (const int32_t status = CheckSquare(matrix)) return call.Fail(status);
    return call.Run([&] { return PositiveDefiniteCore(matrix.data(), matrix.rows(), flag); });
}

}  // namespace

int32_t Determinant_head(KrHandle a, const int32_t* type, double* det, int32_t* err) {
    return Determinant<double>(a, *type, det, err);
}
int32_t CxDeterminant_head(KrHandle a, const int32_t* type, KrComplex* det, int32_t* err) {
    return Determinant<Complex>(a, *type, det, err);
}

int32_t Rank_head(KrHandle a, const double* tol, int32_t* rank, int32_t* err) {
    return Rank<double>(a, *tol, rank, err);
}
int32_t CxRank_head(KrHandle a, const double* tol, int32_t* rank, int32_t* err) {
    return Rank<Complex>(a, *tol, rank, err);
}

int32_t Norm_head(KrHandle a, const int32_t* norm_type, double* norm, int32_t* err) {
    return Norm<double>(a, *norm_type, norm, err);
}
int32_t CxNorm_head(KrHandle a, const int32_t* norm_type, double* norm, int32_t* err) {
    return Norm<Complex>(a, *norm_type, norm, err);
}

int32_t CondNumber_head(KrHandle a, const int32_t* norm_type, double* cond, int32_t* err) {
    return Condition<double>(a, *norm_type, cond, err);
}
int32_t CxCondNumber_head(KrHandle a, const int32_t* norm_type, double* cond, int32_t* err) {
    return Condition<Complex>(a, *norm_type, cond, err);
}

int32_t CheckPosdef_head(KrHandle a, int32_t* flag, int32_t* err) {
    return PositiveDefiniteness<double>(a, flag, err);
}
int32_t CxCheckPosdef_head(KrHandle a, int32_t* flag, int32_t* err) {
    return PositiveDefiniteness<Complex>(a, flag, err);
}

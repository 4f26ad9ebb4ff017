#include "krnumer/distributions.h"

#include "frame/entry.h"
#include "stat/distribution.h"

using namespace krnumer;

int32_t NormDist_head(const double* x, double* p) {
    *p = NormalDistribution(*x);
    return kOk;
}

int32_t InvNdist_head(const double* p, double* x, int32_t* err) {
    ByReference call(err);
    Result<double> result(call, x);
    return call.Deliver(InverseNormalDistribution(*p, result.data()));
}

int32_t TDist_head(const double* t, const int32_t* df, double* p, int32_t* err) {
    ByReference call(err);
    Result<double> result(call, p);
    return call.Deliver(TDistribution(*t, *df, result.data()));
}

int32_t InvTdist_head(const double* p, const int32_t* df, double* t, int32_t* err) {
    ByReference call(err);
    Result<double> result(call, t);
    return call.Deliver(InverseTDistribution(*p, *df, result.data()));
}

int32_t ChiSquare_head(const double* x, const int32_t* df, double* p, int32_t* err) {
    ByReference call(err);
    Result<double> result(call, p);
    return call.Deliver(ChiSquareDistribution(*x, *df, result.data()));
}

int32_t InvChiSquare_head(const double* p, const int32_t* df, double* x, int32_t* err) {
    ByReference call(err);
    Result<double> result(call, x);
    return call.Deliver(InverseChiSquareDistribution(*p, *df, result.data()));
}

int32_t FDist_head(const double* f, const int32_t* n, const int32_t* m, double* p, int32_t* err) {
    ByReference call(err);
    Result<double> result(call, p);
    return call.Deliver(FDistribution(*f, *n, *m, result.data()));
}

int32_t InvFDist_head(const double* p, const int32_t* n, const int32_t* m, double* f, int32_t* err) {
    ByReference call(err);
    Result<double> result(call, f);
    return call.Deliver(InverseFDistribution(*p, *n, *m, result.data()));
}

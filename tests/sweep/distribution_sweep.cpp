#include "krnumer/distributions.h"

#include "sweep/sweep.h"

namespace {

// All arguments by pointer, the result and the status behind them.
template <class... Parameters, class... Arguments>
int32_t Scalars(sweep::Scene& scene, int32_t (*function)(Parameters...), Arguments... arguments) {
    double* const out = scene.Number();
    return scene.Call(function, &arguments..., out, scene.err());
}

}  // namespace

SWEEP(NormDist_head) {
    const double x = 1.5;
    double* const p = scene.Number();
    return scene.Call(NormDist_head, &x, p);
}
SWEEP(InvNdist_head) {
    return Scalars(scene, InvNdist_head, 0.3);
}
SWEEP(TDist_head) {
    return Scalars(scene, TDist_head, 1.5, 4);
}
SWEEP(InvTdist_head) {
    return Scalars(scene, InvTdist_head, 0.95, 4);
}
SWEEP(ChiSquare_head) {
    return Scalars(scene, ChiSquare_head, 1.5, 4);
}
SWEEP(InvChiSquare_head) {
    return Scalars(scene, InvChiSquare_head, 0.95, 4);
}
SWEEP(FDist_head) {
    return Scalars(scene, FDist_head, 1.5, 4, 7);
}
SWEEP(InvFDist_head) {
    return Scalars(scene, InvFDist_head, 0.95, 4, 7);
}

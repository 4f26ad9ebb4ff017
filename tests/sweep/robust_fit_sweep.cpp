#include "krnumer/robust_fit.h"

#include "sweep/sweep.h"

namespace {

const std::vector<double> kX{1, 2, 3, 4, 5, 6, 7};
const std::vector<double> kY{1.5, 4, 5.5, 9, 5, 3.5, 1};
const std::vector<double> kW{1, 2, 1, 1, 2, 1, 1};

}  // namespace

SWEEP(BiExpFit_head) {
    const KrHandle y = scene.Replaced(scene.Doubles(kY));
    const KrHandle x = scene.Doubles(kX);
    const KrHandle w = scene.Doubles(kW);
    const KrHandle init = scene.Doubles({2, 0.1});
    double* a = scene.Number();
    double* b = scene.Number();
    double* residue = scene.Number();
    int32_t* iter = scene.Integer(5);
    return scene.Call(BiExpFit_head, y, x, w, 0.0, init, 1, a, b, residue, iter, 0.0, 0);
}

SWEEP(BiPowerFit_head) {
    const KrHandle y = scene.Replaced(scene.Doubles(kY));
    const KrHandle x = scene.Doubles(kX);
    const KrHandle w = scene.Doubles(kW);
    const KrHandle init = scene.Doubles({2, 0.1});
    double* a = scene.Number();
    double* b = scene.Number();
    double* residue = scene.Number();
    int32_t* iter = scene.Integer(5);
    return scene.Call(BiPowerFit_head, y, x, w, 0.0, init, a, b, residue, iter, 0.0, 0);
}

SWEEP(BiGaussFit_head) {
    const KrHandle y = scene.Replaced(scene.Doubles(kY));
    const KrHandle x = scene.Doubles(kX);
    const KrHandle w = scene.Doubles(kW);
    const KrHandle init = scene.Doubles({6, 3.5, 2});
    double* a = scene.Number();
    double* mu = scene.Number();
    double* sigma = scene.Number();
    double* residue = scene.Number();
    int32_t* iter = scene.Integer(5);
    return scene.Call(BiGaussFit_head, y, x, w, 0.0, init, a, mu, sigma, residue, iter, 0.0, 0);
}

SWEEP(BiLinearFit_head) {
    const KrHandle y = scene.Replaced(scene.Doubles(kY));
    const KrHandle x = scene.Doubles(kX);
    const KrHandle w = scene.Doubles(kW);
    double* slope = scene.Number();
    double* intercept = scene.Number();
    double* residue = scene.Number();
    int32_t* iter = scene.Integer(5);
    return scene.Call(BiLinearFit_head, y, x, w, 0.0, slope, intercept, residue, iter, 0);
}

SWEEP(BiLogFit_head) {
    const KrHandle y = scene.Replaced(scene.Doubles(kY));
    const KrHandle x = scene.Doubles(kX);
    const KrHandle w = scene.Doubles(kW);
    double* a = scene.Number();
    double* b = scene.Number();
    double* residue = scene.Number();
    int32_t* iter = scene.Integer(5);
    return scene.Call(BiLogFit_head, y, x, w, 10.0, 0.0, a, b, residue, iter, 0);
}

SWEEP(LARExpFit_head) {
    const KrHandle y = scene.Replaced(scene.Doubles(kY));
    const KrHandle x = scene.Doubles(kX);
    const KrHandle w = scene.Doubles(kW);
    const KrHandle init = scene.Doubles({2, 0.1});
    double* a = scene.Number();
    double* b = scene.Number();
    double* residue = scene.Number();
    int32_t* iter = scene.Integer(5);
    return scene.Call(LARExpFit_head, y, x, w, 0.0, init, 1, a, b, residue, iter, 0.0, 0);
}

SWEEP(LARPowerFit_head) {
    const KrHandle y = scene.Replaced(scene.Doubles(kY));
    const KrHandle x = scene.Doubles(kX);
    const KrHandle w = scene.Doubles(kW);
    const KrHandle init = scene.Doubles({2, 0.1});
    double* a = scene.Number();
    double* b = scene.Number();
    double* residue = scene.Number();
    int32_t* iter = scene.Integer(5);
    return scene.Call(LARPowerFit_head, y, x, w, 0.0, init, a, b, residue, iter, 0.0, 0);
}

SWEEP(LARGaussFit_head) {
    const KrHandle y = scene.Replaced(scene.Doubles(kY));
    const KrHandle x = scene.Doubles(kX);
    const KrHandle w = scene.Doubles(kW);
    const KrHandle init = scene.Doubles({6, 3.5, 2});
    double* a = scene.Number();
    double* mu = scene.Number();
    double* sigma = scene.Number();
    double* residue = scene.Number();
    int32_t* iter = scene.Integer(5);
    return scene.Call(LARGaussFit_head, y, x, w, 0.0, init, a, mu, sigma, residue, iter, 0.0, 0);
}

SWEEP(LARLinearFit_head) {
    const KrHandle y = scene.Replaced(scene.Doubles(kY));
    const KrHandle x = scene.Doubles(kX);
    const KrHandle w = scene.Doubles(kW);
    double* slope = scene.Number();
    double* intercept = scene.Number();
    double* residue = scene.Number();
    int32_t* iter = scene.Integer(5);
    return scene.Call(LARLinearFit_head, y, x, w, 0.0, slope, intercept, residue, iter, 0.0, 0);
}

SWEEP(LARLogFit_head) {
    const KrHandle y = scene.Replaced(scene.Doubles(kY));
    const KrHandle x = scene.Doubles(kX);
    const KrHandle w = scene.Doubles(kW);
    double* a = scene.Number();
    double* b = scene.Number();
    double* residue = scene.Number();
    int32_t* iter = scene.Integer(5);
    return scene.Call(LARLogFit_head, y, x, w, 10.0, 0.0, a, b, residue, iter, 0.0, 0);
}

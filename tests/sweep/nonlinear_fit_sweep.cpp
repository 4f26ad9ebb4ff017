#include "krnumer/nonlinear_fit.h"

#include "sweep/sweep.h"

namespace {

const std::vector<double> kX{1, 2, 3, 4, 5};
const std::vector<double> kY{1.5, 4, 5.5, 4.5, 2};
const std::vector<double> kW{1, 2, 1, 1, 2};

}  // namespace

SWEEP(ExpFit_head) {
    const KrHandle y = scene.Replaced(scene.Doubles(kY));
    const KrHandle x = scene.Doubles(kX);
    const KrHandle sigma = scene.Doubles(kW);
    double* a = scene.Number();
    double* b = scene.Number();
    double* mse = scene.Number();
    return scene.Call(ExpFit_head, y, x, sigma, a, b, mse);
}

SWEEP(ExpFit80_head) {
    const KrHandle y = scene.Replaced(scene.Doubles(kY));
    const KrHandle x = scene.Doubles(kX);
    const KrHandle w = scene.Doubles(kW);
    const KrHandle init = scene.Doubles({2, 0.1});
    double* a = scene.Number();
    double* b = scene.Number();
    double* mse = scene.Number();
    int32_t* iter = scene.Integer(20);
    return scene.Call(ExpFit80_head, y, x, w, 0.0, init, 1, a, b, mse, iter, 0.0);
}

SWEEP(ExpFitCoef_head) {
    const KrHandle y = scene.Doubles(kY);
    const KrHandle x = scene.Doubles(kX);
    double* a = scene.Number();
    double* b = scene.Number();
    return scene.Call(ExpFitCoef_head, y, x, a, b);
}

SWEEP(ExpFitCoef80_head) {
    const KrHandle y = scene.Doubles(kY);
    const KrHandle x = scene.Doubles(kX);
    const KrHandle w = scene.Doubles(kW);
    const KrHandle init = scene.Doubles({2, 0.1});
    double* a = scene.Number();
    double* b = scene.Number();
    int32_t* iter = scene.Integer(20);
    return scene.Call(ExpFitCoef80_head, y, x, w, 1, 0.0, init, a, b, iter, 0.0);
}

SWEEP(PowerFit_head) {
    const KrHandle y = scene.Replaced(scene.Doubles(kY));
    const KrHandle x = scene.Doubles(kX);
    const KrHandle w = scene.Doubles(kW);
    const KrHandle init = scene.Doubles({2, 0.1});
    double* a = scene.Number();
    double* b = scene.Number();
    double* mse = scene.Number();
    int32_t* iter = scene.Integer(20);
    return scene.Call(PowerFit_head, y, x, w, 0.0, init, a, b, mse, iter, 0.0);
}

SWEEP(PowerFitCoef_head) {
    const KrHandle y = scene.Doubles(kY);
    const KrHandle x = scene.Doubles(kX);
    const KrHandle w = scene.Doubles(kW);
    const KrHandle init = scene.Doubles({2, 0.1});
    double* a = scene.Number();
    double* b = scene.Number();
    int32_t* iter = scene.Integer(20);
    return scene.Call(PowerFitCoef_head, y, x, w, 0.0, init, a, b, iter, 0.0);
}

SWEEP(LogFit_head) {
    const KrHandle y = scene.Replaced(scene.Doubles(kY));
    const KrHandle x = scene.Doubles(kX);
    const KrHandle w = scene.Doubles(kW);
    double* a = scene.Number();
    double* b = scene.Number();
    double* mse = scene.Number();
    return scene.Call(LogFit_head, y, x, w, 10.0, a, b, mse);
}

SWEEP(LogFitCoef_head) {
    const KrHandle y = scene.Doubles(kY);
    const KrHandle x = scene.Doubles(kX);
    const KrHandle w = scene.Doubles(kW);
    double* a = scene.Number();
    double* b = scene.Number();
    return scene.Call(LogFitCoef_head, y, x, w, 10.0, a, b);
}

SWEEP(GaussianPeakFit_head) {
    const KrHandle y = scene.Replaced(scene.Doubles(kY));
    const KrHandle x = scene.Doubles(kX);
    const KrHandle w = scene.Doubles(kW);
    const KrHandle init = scene.Doubles({5, 3, 1});
    double* a = scene.Number();
    double* mu = scene.Number();
    double* sigma = scene.Number();
    double* mse = scene.Number();
    int32_t* iter = scene.Integer(20);
    return scene.Call(GaussianPeakFit_head, y, x, w, 0.0, init, a, mu, sigma, mse, iter, 0.0);
}

SWEEP(GaussianPeakFitCoef_head) {
    const KrHandle y = scene.Doubles(kY);
    const KrHandle x = scene.Doubles(kX);
    const KrHandle w = scene.Doubles(kW);
    const KrHandle init = scene.Doubles({5, 3, 1});
    double* a = scene.Number();
    double* mu = scene.Number();
    double* sigma = scene.Number();
    int32_t* iter = scene.Integer(20);
    return scene.Call(GaussianPeakFitCoef_head, y, x, w, 0.0, init, a, mu, sigma, iter, 0.0);
}

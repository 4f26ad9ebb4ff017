#include "krnumer/nonlinear_fit.h"

#include "sweep/sweep.h"

namespace {

const std::vector<double> kX{1, 2, 3, 4, 5};
const std::vector<double> kY{1.5, 4, 5.5, 4.5, 2};
const std::vector<double> kW{1, 2, 1, 1, 2};

struct Data {
    KrHandle y, x, w;
};

Data Observed(sweep::Scene& scene) {
    return {scene.Doubles(kY), scene.Doubles(kX), scene.Doubles(kW)};
}

// Data whose ordinates the fit replaces.
Data Fitted(sweep::Scene& scene) {
    return {scene.Replaced(scene.Doubles(kY)), scene.Doubles(kX), scene.Doubles(kW)};
}

}  // namespace

SWEEP(ExpFit_head) {
    const KrHandle y = scene.Replaced(scene.Doubles(kY));
    const KrHandle x = scene.Doubles(kX);
    const KrHandle sigma = scene.Doubles(kW);
    double* const found = scene.Numbers(3);  // a, b, mse
    return scene.Call(ExpFit_head, y, x, sigma, found, found + 1, found + 2);
}

SWEEP(ExpFit80_head) {
    const auto [y, x, w] = Fitted(scene);
    const KrHandle init = scene.Doubles({2, 0.1});
    double* const found = scene.Numbers(3);  // a, b, mse
    int32_t* iter = scene.Integer(20);
    return scene.Call(ExpFit80_head, y, x, w, 0.0, init, 1, found, found + 1, found + 2, iter, 0.0);
}

SWEEP(ExpFitCoef_head) {
    const KrHandle y = scene.Doubles(kY);
    const KrHandle x = scene.Doubles(kX);
    double* const found = scene.Numbers(2);  // a, b
    return scene.Call(ExpFitCoef_head, y, x, found, found + 1);
}

SWEEP(ExpFitCoef80_head) {
    const auto [y, x, w] = Observed(scene);
    const KrHandle init = scene.Doubles({2, 0.1});
    double* const found = scene.Numbers(2);  // a, b
    int32_t* iter = scene.Integer(20);
    return scene.Call(ExpFitCoef80_head, y, x, w, 1, 0.0, init, found, found + 1, iter, 0.0);
}

SWEEP(PowerFit_head) {
    const auto [y, x, w] = Fitted(scene);
    const KrHandle init = scene.Doubles({2, 0.1});
    double* const found = scene.Numbers(3);  // a, b, mse
    int32_t* iter = scene.Integer(20);
    return scene.Call(PowerFit_head, y, x, w, 0.0, init, found, found + 1, found + 2, iter, 0.0);
}

SWEEP(PowerFitCoef_head) {
    const auto [y, x, w] = Observed(scene);
    const KrHandle init = scene.Doubles({2, 0.1});
    double* const found = scene.Numbers(2);  // a, b
    int32_t* iter = scene.Integer(20);
    return scene.Call(PowerFitCoef_head, y, x, w, 0.0, init, found, found + 1, iter, 0.0);
}

SWEEP(LogFit_head) {
    const auto [y, x, w] = Fitted(scene);
    double* const found = scene.Numbers(3);  // a, b, mse
    return scene.Call(LogFit_head, y, x, w, 10.0, found, found + 1, found + 2);
}

SWEEP(LogFitCoef_head) {
    const auto [y, x, w] = Observed(scene);
    double* const found = scene.Numbers(2);  // a, b
    return scene.Call(LogFitCoef_head, y, x, w, 10.0, found, found + 1);
}

SWEEP(GaussianPeakFit_head) {
    const auto [y, x, w] = Fitted(scene);
    const KrHandle init = scene.Doubles({5, 3, 1});
    double* const found = scene.Numbers(4);  // a, mu, sigma, mse
    int32_t* iter = scene.Integer(20);
    return scene.Call(GaussianPeakFit_head, y, x, w, 0.0, init, found, found + 1, found + 2, found + 3, iter, 0.0);
}

SWEEP(GaussianPeakFitCoef_head) {
    const auto [y, x, w] = Observed(scene);
    const KrHandle init = scene.Doubles({5, 3, 1});
    double* const found = scene.Numbers(3);  // a, mu, sigma
    int32_t* iter = scene.Integer(20);
    return scene.Call(GaussianPeakFitCoef_head, y, x, w, 0.0, init, found, found + 1, found + 2, iter, 0.0);
}

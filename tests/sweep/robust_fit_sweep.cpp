#include "krnumer/robust_fit.h"

#include "sweep/sweep.h"

namespace {

const std::vector<double> kX{1, 2, 3, 4, 5, 6, 7};
const std::vector<double> kY{1.5, 4, 5.5, 9, 5, 3.5, 1};
const std::vector<double> kW{1, 2, 1, 1, 2, 1, 1};

struct Data {
    KrHandle y, x, w;
};

// Data whose ordinates the fit replaces.
Data Fitted(sweep::Scene& scene) {
    return {scene.Replaced(scene.Doubles(kY)), scene.Doubles(kX), scene.Doubles(kW)};
}

// Bisquare and least absolute residuals take the same arguments.
template <class Fit>
int32_t PlayExp(sweep::Scene& scene, Fit* fit) {
    const auto [y, x, w] = Fitted(scene);
    const KrHandle init = scene.Doubles({2, 0.1});
    double* const found = scene.Numbers(3);  // a, b, residue
    int32_t* iter = scene.Integer(5);
    return scene.Call(fit, y, x, w, 0.0, init, 1, found, found + 1, found + 2, iter, 0.0, 0);
}

template <class Fit>
int32_t PlayPower(sweep::Scene& scene, Fit* fit) {
    const auto [y, x, w] = Fitted(scene);
    const KrHandle init = scene.Doubles({2, 0.1});
    double* const found = scene.Numbers(3);  // a, b, residue
    int32_t* iter = scene.Integer(5);
    return scene.Call(fit, y, x, w, 0.0, init, found, found + 1, found + 2, iter, 0.0, 0);
}

template <class Fit>
int32_t PlayGauss(sweep::Scene& scene, Fit* fit) {
    const auto [y, x, w] = Fitted(scene);
    const KrHandle init = scene.Doubles({6, 3.5, 2});
    double* const found = scene.Numbers(4);  // a, mu, sigma, residue
    int32_t* iter = scene.Integer(5);
    return scene.Call(fit, y, x, w, 0.0, init, found, found + 1, found + 2, found + 3, iter, 0.0, 0);
}

}  // namespace

SWEEP(BiExpFit_head) {
    return PlayExp(scene, BiExpFit_head);
}
SWEEP(LARExpFit_head) {
    return PlayExp(scene, LARExpFit_head);
}
SWEEP(BiPowerFit_head) {
    return PlayPower(scene, BiPowerFit_head);
}
SWEEP(LARPowerFit_head) {
    return PlayPower(scene, LARPowerFit_head);
}
SWEEP(BiGaussFit_head) {
    return PlayGauss(scene, BiGaussFit_head);
}
SWEEP(LARGaussFit_head) {
    return PlayGauss(scene, LARGaussFit_head);
}

SWEEP(BiLinearFit_head) {
    const auto [y, x, w] = Fitted(scene);
    double* const found = scene.Numbers(3);  // slope, intercept, residue
    int32_t* iter = scene.Integer(5);
    return scene.Call(BiLinearFit_head, y, x, w, 0.0, found, found + 1, found + 2, iter, 0);
}

SWEEP(BiLogFit_head) {
    const auto [y, x, w] = Fitted(scene);
    double* const found = scene.Numbers(3);  // a, b, residue
    int32_t* iter = scene.Integer(5);
    return scene.Call(BiLogFit_head, y, x, w, 10.0, 0.0, found, found + 1, found + 2, iter, 0);
}

SWEEP(LARLinearFit_head) {
    const auto [y, x, w] = Fitted(scene);
    double* const found = scene.Numbers(3);  // slope, intercept, residue
    int32_t* iter = scene.Integer(5);
    return scene.Call(LARLinearFit_head, y, x, w, 0.0, found, found + 1, found + 2, iter, 0.0, 0);
}

SWEEP(LARLogFit_head) {
    const auto [y, x, w] = Fitted(scene);
    double* const found = scene.Numbers(3);  // a, b, residue
    int32_t* iter = scene.Integer(5);
    return scene.Call(LARLogFit_head, y, x, w, 10.0, 0.0, found, found + 1, found + 2, iter, 0.0, 0);
}

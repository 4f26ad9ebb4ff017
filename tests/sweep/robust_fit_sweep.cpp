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

}  // namespace

SWEEP(BiExpFit_head) {
    const auto [y, x, w] = Fitted(scene);
    const KrHandle init = scene.Doubles({2, 0.1});
    double* const found = scene.Numbers(3);  // a, b, residue
    int32_t* iter = scene.Integer(5);
    return scene.Call(BiExpFit_head, y, x, w, 0.0, init, 1, found, found + 1, found + 2, iter, 0.0, 0);
}

SWEEP(BiPowerFit_head) {
    const auto [y, x, w] = Fitted(scene);
    const KrHandle init = scene.Doubles({2, 0.1});
    double* const found = scene.Numbers(3);  // a, b, residue
    int32_t* iter = scene.Integer(5);
    return scene.Call(BiPowerFit_head, y, x, w, 0.0, init, found, found + 1, found + 2, iter, 0.0, 0);
}

SWEEP(BiGaussFit_head) {
    const auto [y, x, w] = Fitted(scene);
    const KrHandle init = scene.Doubles({6, 3.5, 2});
    double* const found = scene.Numbers(4);  // a, mu, sigma, residue
    int32_t* iter = scene.Integer(5);
    return scene.Call(BiGaussFit_head, y, x, w, 0.0, init, found, found + 1, found + 2, found + 3, iter, 0.0, 0);
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

SWEEP(LARExpFit_head) {
    const auto [y, x, w] = Fitted(scene);
    const KrHandle init = scene.Doubles({2, 0.1});
    double* const found = scene.Numbers(3);  // a, b, residue
    int32_t* iter = scene.Integer(5);
    return scene.Call(LARExpFit_head, y, x, w, 0.0, init, 1, found, found + 1, found + 2, iter, 0.0, 0);
}

SWEEP(LARPowerFit_head) {
    const auto [y, x, w] = Fitted(scene);
    const KrHandle init = scene.Doubles({2, 0.1});
    double* const found = scene.Numbers(3);  // a, b, residue
    int32_t* iter = scene.Integer(5);
    return scene.Call(LARPowerFit_head, y, x, w, 0.0, init, found, found + 1, found + 2, iter, 0.0, 0);
}

SWEEP(LARGaussFit_head) {
    const auto [y, x, w] = Fitted(scene);
    const KrHandle init = scene.Doubles({6, 3.5, 2});
    double* const found = scene.Numbers(4);  // a, mu, sigma, residue
    int32_t* iter = scene.Integer(5);
    return scene.Call(LARGaussFit_head, y, x, w, 0.0, init, found, found + 1, found + 2, found + 3, iter, 0.0, 0);
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

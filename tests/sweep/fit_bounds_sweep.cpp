#include "krnumer/fit_bounds.h"

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

struct Bounds {
    explicit Bounds(sweep::Scene& scene) : upper(scene.OutDoubles()), lower(scene.OutDoubles()) {}

    KrHandle upper, lower;
};

}  // namespace

SWEEP(ConfBndLinear_head) {
    const auto [y, x, w] = Observed(scene);
    const Bounds of_fit(scene), of_coefficients(scene);
    double* const found = scene.Numbers(2, sweep::OnFailure::kOther);  // d_slope, d_intercept
    return scene.Call(ConfBndLinear_head, y, x, w, 1.5, 0.5, 0.9, of_fit.upper, of_fit.lower, of_coefficients.upper,
                      of_coefficients.lower, found, found + 1);
}

SWEEP(ConfBndExp_head) {
    const auto [y, x, w] = Observed(scene);
    const Bounds of_fit(scene), of_coefficients(scene);
    double* const found = scene.Numbers(2, sweep::OnFailure::kOther);  // d_a, d_b
    return scene.Call(ConfBndExp_head, y, x, w, 2.0, 0.2, 0.9, of_fit.upper, of_fit.lower, of_coefficients.upper,
                      of_coefficients.lower, found, found + 1);
}

SWEEP(ConfBndPower_head) {
    const auto [y, x, w] = Observed(scene);
    const Bounds of_fit(scene), of_coefficients(scene);
    double* const found = scene.Numbers(2, sweep::OnFailure::kOther);  // d_a, d_b
    return scene.Call(ConfBndPower_head, y, x, w, 1.5, 0.7, 0.9, of_fit.upper, of_fit.lower, of_coefficients.upper,
                      of_coefficients.lower, found, found + 1);
}

SWEEP(ConfBndLog_head) {
    const auto [y, x, w] = Observed(scene);
    const Bounds of_fit(scene), of_coefficients(scene);
    double* const found = scene.Numbers(2, sweep::OnFailure::kOther);  // d_a, d_b
    return scene.Call(ConfBndLog_head, y, x, w, 10.0, 4.0, 2.0, 0.9, of_fit.upper, of_fit.lower, of_coefficients.upper,
                      of_coefficients.lower, found, found + 1);
}

SWEEP(ConfBndGauss_head) {
    const auto [y, x, w] = Observed(scene);
    const Bounds of_fit(scene), of_coefficients(scene);
    double* const found = scene.Numbers(3, sweep::OnFailure::kOther);  // d_a, d_mu, d_sigma
    return scene.Call(ConfBndGauss_head, y, x, w, 5.0, 3.0, 1.5, 0.9, of_fit.upper, of_fit.lower, of_coefficients.upper,
                      of_coefficients.lower, found, found + 1, found + 2);
}

SWEEP(PredBndLinear_head) {
    const auto [y, x, w] = Observed(scene);
    const Bounds bounds(scene);
    return scene.Call(PredBndLinear_head, y, x, w, 1.5, 0.5, 0.9, bounds.upper, bounds.lower);
}

SWEEP(PredBndExp_head) {
    const auto [y, x, w] = Observed(scene);
    const Bounds bounds(scene);
    return scene.Call(PredBndExp_head, y, x, w, 2.0, 0.2, 0.9, bounds.upper, bounds.lower);
}

SWEEP(PredBndPower_head) {
    const auto [y, x, w] = Observed(scene);
    const Bounds bounds(scene);
    return scene.Call(PredBndPower_head, y, x, w, 1.5, 0.7, 0.9, bounds.upper, bounds.lower);
}

SWEEP(PredBndLog_head) {
    const auto [y, x, w] = Observed(scene);
    const Bounds bounds(scene);
    return scene.Call(PredBndLog_head, y, x, w, 10.0, 4.0, 2.0, 0.9, bounds.upper, bounds.lower);
}

SWEEP(PredBndGauss_head) {
    const auto [y, x, w] = Observed(scene);
    const Bounds bounds(scene);
    return scene.Call(PredBndGauss_head, y, x, w, 5.0, 3.0, 1.5, 0.9, bounds.upper, bounds.lower);
}

SWEEP(GoodnessOfFit_head) {
    const KrHandle y = scene.Doubles(kY);
    const KrHandle fit = scene.Doubles(kX);
    const KrHandle w = scene.Doubles(kW);
    double* const found = scene.Numbers(3);  // sse, r_square, rmse
    return scene.Call(GoodnessOfFit_head, y, fit, w, 0, found, found + 1, found + 2);
}

#include "krnumer/fit_bounds.h"

#include "sweep/sweep.h"

namespace {

const std::vector<double> kX{1, 2, 3, 4, 5};
const std::vector<double> kY{1.5, 4, 5.5, 4.5, 2};
const std::vector<double> kW{1, 2, 1, 1, 2};

}  // namespace

SWEEP(ConfBndLinear_head) {
    const KrHandle y = scene.Doubles(kY);
    const KrHandle x = scene.Doubles(kX);
    const KrHandle w = scene.Doubles(kW);
    const KrHandle upper = scene.OutDoubles();
    const KrHandle lower = scene.OutDoubles();
    const KrHandle upper_coef = scene.OutDoubles();
    const KrHandle lower_coef = scene.OutDoubles();
    double* d_slope = scene.Number(sweep::OnFailure::kOther);      // 0
    double* d_intercept = scene.Number(sweep::OnFailure::kOther);  // 0
    return scene.Call(ConfBndLinear_head, y, x, w, 1.5, 0.5, 0.9, upper, lower, upper_coef, lower_coef, d_slope,
                      d_intercept);
}

SWEEP(ConfBndExp_head) {
    const KrHandle y = scene.Doubles(kY);
    const KrHandle x = scene.Doubles(kX);
    const KrHandle w = scene.Doubles(kW);
    const KrHandle upper = scene.OutDoubles();
    const KrHandle lower = scene.OutDoubles();
    const KrHandle upper_coef = scene.OutDoubles();
    const KrHandle lower_coef = scene.OutDoubles();
    double* d_a = scene.Number(sweep::OnFailure::kOther);  // 0
    double* d_b = scene.Number(sweep::OnFailure::kOther);  // 0
    return scene.Call(ConfBndExp_head, y, x, w, 2.0, 0.2, 0.9, upper, lower, upper_coef, lower_coef, d_a, d_b);
}

SWEEP(ConfBndPower_head) {
    const KrHandle y = scene.Doubles(kY);
    const KrHandle x = scene.Doubles(kX);
    const KrHandle w = scene.Doubles(kW);
    const KrHandle upper = scene.OutDoubles();
    const KrHandle lower = scene.OutDoubles();
    const KrHandle upper_coef = scene.OutDoubles();
    const KrHandle lower_coef = scene.OutDoubles();
    double* d_a = scene.Number(sweep::OnFailure::kOther);  // 0
    double* d_b = scene.Number(sweep::OnFailure::kOther);  // 0
    return scene.Call(ConfBndPower_head, y, x, w, 1.5, 0.7, 0.9, upper, lower, upper_coef, lower_coef, d_a, d_b);
}

SWEEP(ConfBndLog_head) {
    const KrHandle y = scene.Doubles(kY);
    const KrHandle x = scene.Doubles(kX);
    const KrHandle w = scene.Doubles(kW);
    const KrHandle upper = scene.OutDoubles();
    const KrHandle lower = scene.OutDoubles();
    const KrHandle upper_coef = scene.OutDoubles();
    const KrHandle lower_coef = scene.OutDoubles();
    double* d_a = scene.Number(sweep::OnFailure::kOther);  // 0
    double* d_b = scene.Number(sweep::OnFailure::kOther);  // 0
    return scene.Call(ConfBndLog_head, y, x, w, 10.0, 4.0, 2.0, 0.9, upper, lower, upper_coef, lower_coef, d_a, d_b);
}

SWEEP(ConfBndGauss_head) {
    const KrHandle y = scene.Doubles(kY);
    const KrHandle x = scene.Doubles(kX);
    const KrHandle w = scene.Doubles(kW);
    const KrHandle upper = scene.OutDoubles();
    const KrHandle lower = scene.OutDoubles();
    const KrHandle upper_coef = scene.OutDoubles();
    const KrHandle lower_coef = scene.OutDoubles();
    double* d_a = scene.Number(sweep::OnFailure::kOther);      // 0
    double* d_mu = scene.Number(sweep::OnFailure::kOther);     // 0
    double* d_sigma = scene.Number(sweep::OnFailure::kOther);  // 0
    return scene.Call(ConfBndGauss_head, y, x, w, 5.0, 3.0, 1.5, 0.9, upper, lower, upper_coef, lower_coef, d_a, d_mu,
                      d_sigma);
}

SWEEP(PredBndLinear_head) {
    const KrHandle y = scene.Doubles(kY);
    const KrHandle x = scene.Doubles(kX);
    const KrHandle w = scene.Doubles(kW);
    const KrHandle upper = scene.OutDoubles();
    const KrHandle lower = scene.OutDoubles();
    return scene.Call(PredBndLinear_head, y, x, w, 1.5, 0.5, 0.9, upper, lower);
}

SWEEP(PredBndExp_head) {
    const KrHandle y = scene.Doubles(kY);
    const KrHandle x = scene.Doubles(kX);
    const KrHandle w = scene.Doubles(kW);
    const KrHandle upper = scene.OutDoubles();
    const KrHandle lower = scene.OutDoubles();
    return scene.Call(PredBndExp_head, y, x, w, 2.0, 0.2, 0.9, upper, lower);
}

SWEEP(PredBndPower_head) {
    const KrHandle y = scene.Doubles(kY);
    const KrHandle x = scene.Doubles(kX);
    const KrHandle w = scene.Doubles(kW);
    const KrHandle upper = scene.OutDoubles();
    const KrHandle lower = scene.OutDoubles();
    return scene.Call(PredBndPower_head, y, x, w, 1.5, 0.7, 0.9, upper, lower);
}

SWEEP(PredBndLog_head) {
    const KrHandle y = scene.Doubles(kY);
    const KrHandle x = scene.Doubles(kX);
    const KrHandle w = scene.Doubles(kW);
    const KrHandle upper = scene.OutDoubles();
    const KrHandle lower = scene.OutDoubles();
    return scene.Call(PredBndLog_head, y, x, w, 10.0, 4.0, 2.0, 0.9, upper, lower);
}

SWEEP(PredBndGauss_head) {
    const KrHandle y = scene.Doubles(kY);
    const KrHandle x = scene.Doubles(kX);
    const KrHandle w = scene.Doubles(kW);
    const KrHandle upper = scene.OutDoubles();
    const KrHandle lower = scene.OutDoubles();
    return scene.Call(PredBndGauss_head, y, x, w, 5.0, 3.0, 1.5, 0.9, upper, lower);
}

SWEEP(GoodnessOfFit_head) {
    const KrHandle y = scene.Doubles(kY);
    const KrHandle fit = scene.Doubles(kX);
    const KrHandle w = scene.Doubles(kW);
    double* sse = scene.Number();
    double* r_square = scene.Number();
    double* rmse = scene.Number();
    return scene.Call(GoodnessOfFit_head, y, fit, w, 0, sse, r_square, rmse);
}

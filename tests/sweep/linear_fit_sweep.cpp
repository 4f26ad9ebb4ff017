#include "krnumer/linear_fit.h"

#include "sweep/sweep.h"

namespace {

const std::vector<double> kX{0, 1, 2, 3, 4, 5};
const std::vector<double> kY{1, 3, 2, 5, 7, 6};
const std::vector<double> kW{1, 2, 1, 1, 2, 1};
const std::vector<double> kH{1, 0, 1, 1, 1, 2, 1, 3, 1, 4, 1, 5};

// The data again and again, `copies` times.
std::vector<double> Repeat(const std::vector<double>& values, int32_t copies) {
    std::vector<double> all;
    for (int32_t i = 0; i < copies; ++i) all.insert(all.end(), values.begin(), values.end());
    return all;
}

template <class Fit>
int32_t PlayGeneral(sweep::Scene& scene, Fit fit, int32_t method, int32_t copies = 1) {
    const KrHandle h = scene.Matrix(6 * copies, 2, Repeat(kH, copies));
    const KrHandle y = scene.Doubles(Repeat(kY, copies));
    const KrHandle w = scene.Doubles(Repeat(kW, copies));
    const KrHandle coef = scene.OutDoubles();
    const KrHandle best_fit = scene.OutDoubles();
    const KrHandle covariance = scene.OutMatrix();
    double* mse = scene.Number();
    return scene.Call(fit, h, y, w, method, 1, coef, best_fit, covariance, mse);
}

}  // namespace

SWEEP(LinFit_head) {
    const KrHandle y = scene.Replaced(scene.Doubles(kY));
    const KrHandle x = scene.Doubles(kX);
    const KrHandle w = scene.Doubles(kW);
    double* slope = scene.Number();
    double* intercept = scene.Number();
    double* mse = scene.Number();
    return scene.Call(LinFit_head, y, x, w, slope, intercept, mse);
}

SWEEP(LinFitCoef_head) {
    const KrHandle y = scene.Doubles(kY);
    const KrHandle x = scene.Doubles(kX);
    double* slope = scene.Number();
    double* intercept = scene.Number();
    return scene.Call(LinFitCoef_head, y, x, slope, intercept, scene.err());
}

SWEEP(LinFitCoef80_head) {
    const KrHandle y = scene.Doubles(kY);
    const KrHandle x = scene.Doubles(kX);
    const KrHandle w = scene.Doubles(kW);
    double* slope = scene.Number();
    double* intercept = scene.Number();
    return scene.Call(LinFitCoef80_head, y, x, w, slope, intercept, scene.err());
}

SWEEP(PolyFit_head) {
    const KrHandle x = scene.Doubles(kX);
    const KrHandle y = scene.Doubles(kY);
    const KrHandle best_fit = scene.OutDoubles();
    const KrHandle coef = scene.OutDoubles();
    double* mse = scene.Number();
    return scene.Call(PolyFit_head, x, y, 2, 3, best_fit, coef, mse);
}

SWEEP(PolyFit80_head) {
    const KrHandle x = scene.Doubles(kX);
    const KrHandle y = scene.Doubles(kY);
    const KrHandle powers = scene.Integers({1});
    const KrHandle values = scene.Doubles({0.5});
    const KrHandle best_fit = scene.OutDoubles();
    const KrHandle coef = scene.OutDoubles();
    double* mse = scene.Number();
    return scene.Call(PolyFit80_head, x, y, 2, 0, powers, values, best_fit, coef, mse);
}

SWEEP(PolyFit81_head) {
    const KrHandle x = scene.Doubles(kX);
    const KrHandle y = scene.Doubles(kY);
    const KrHandle w = scene.Doubles(kW);
    const KrHandle powers = scene.Integers({1});
    const KrHandle values = scene.Doubles({0.5});
    const KrHandle best_fit = scene.OutDoubles();
    const KrHandle coef = scene.OutDoubles();
    double* mse = scene.Number();
    return scene.Call(PolyFit81_head, x, y, 2, w, 4, powers, values, best_fit, coef, mse);
}

SWEEP(GenLSFit_head) {
    return PlayGeneral(scene, GenLSFit_head, 0);
}
SWEEP_MORE(GenLSFit_head, qr) {
    return PlayGeneral(scene, GenLSFit_head, 2);
}
SWEEP_MORE(GenLSFit_head, cholesky) {
    return PlayGeneral(scene, GenLSFit_head, 5);
}
SWEEP_MORE(GenLSFit_head, many_rows) {
    return PlayGeneral(scene, GenLSFit_head, 0, 600);
}
SWEEP_MORE(GenLSFit_head, qr_of_many_rows) {
    return PlayGeneral(scene, GenLSFit_head, 1, 600);
}
SWEEP(GenLSFit80_head) {
    return PlayGeneral(scene, GenLSFit80_head, 4);
}

SWEEP(GetNewCoef_head) {
    const KrHandle coef = scene.Replaced(scene.Doubles({1, 2}));
    const KrHandle hessian = scene.Matrix(2, 2, {4, 1, 1, 3});
    const KrHandle gradient = scene.Doubles({1, -1});
    const double lambda = 0.5;
    return scene.Call(GetNewCoef_head, coef, hessian, gradient, &lambda, scene.err());
}

#include "krnumer/fit_bounds.h"

#include <utility>

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

constexpr std::make_index_sequence<2> kTwo;
constexpr std::make_index_sequence<3> kThree;

// The half widths of the coefficients' intervals are 0 after a failure.
template <class Function, size_t... kCoefficient, class... Model>
int32_t PlayConfidence(sweep::Scene& scene, Function* bounds, std::index_sequence<kCoefficient...>, Model... model) {
    const auto [y, x, w] = Observed(scene);
    const Bounds of_fit(scene), of_coefficients(scene);
    double* const half_widths = scene.Numbers(sizeof...(kCoefficient), sweep::OnFailure::kOther);
    return scene.Call(bounds, y, x, w, model..., 0.9, of_fit.upper, of_fit.lower, of_coefficients.upper,
                      of_coefficients.lower, (half_widths + kCoefficient)...);
}

template <class Function, class... Model>
int32_t PlayPrediction(sweep::Scene& scene, Function* bounds, Model... model) {
    const auto [y, x, w] = Observed(scene);
    const Bounds of_fit(scene);
    return scene.Call(bounds, y, x, w, model..., 0.9, of_fit.upper, of_fit.lower);
}

}  // namespace

SWEEP(ConfBndLinear_head) {
    return PlayConfidence(scene, ConfBndLinear_head, kTwo, 1.5, 0.5);
}

SWEEP(ConfBndExp_head) {
    return PlayConfidence(scene, ConfBndExp_head, kTwo, 2.0, 0.2);
}

SWEEP(ConfBndPower_head) {
    return PlayConfidence(scene, ConfBndPower_head, kTwo, 1.5, 0.7);
}

SWEEP(ConfBndLog_head) {
    return PlayConfidence(scene, ConfBndLog_head, kTwo, 10.0, 4.0, 2.0);
}

SWEEP(ConfBndGauss_head) {
    return PlayConfidence(scene, ConfBndGauss_head, kThree, 5.0, 3.0, 1.5);
}

SWEEP(PredBndLinear_head) {
    return PlayPrediction(scene, PredBndLinear_head, 1.5, 0.5);
}

SWEEP(PredBndExp_head) {
    return PlayPrediction(scene, PredBndExp_head, 2.0, 0.2);
}

SWEEP(PredBndPower_head) {
    return PlayPrediction(scene, PredBndPower_head, 1.5, 0.7);
}

SWEEP(PredBndLog_head) {
    return PlayPrediction(scene, PredBndLog_head, 10.0, 4.0, 2.0);
}

SWEEP(PredBndGauss_head) {
    return PlayPrediction(scene, PredBndGauss_head, 5.0, 3.0, 1.5);
}

SWEEP(GoodnessOfFit_head) {
    const KrHandle y = scene.Doubles(kY);
    const KrHandle fit = scene.Doubles(kX);
    const KrHandle w = scene.Doubles(kW);
    double* const found = scene.Numbers(3);  // sse, r_square, rmse
    return scene.Call(GoodnessOfFit_head, y, fit, w, 0, found, found + 1, found + 2);
}

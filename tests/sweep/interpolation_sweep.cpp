#include "krnumer/interpolation.h"

#include "sweep/sweep.h"

namespace {

const std::vector<double> kX{0, 1, 2.5, 3, 4.5, 5, 7, 8};
const std::vector<double> kY{1, 3, 2, 5, 4, 6, 2, 1};
constexpr double kAt = 1.7;

template <class Interpolate>
int32_t PlayInterpolation(sweep::Scene& scene, Interpolate interpolate) {
    const KrHandle y = scene.Doubles(kY);
    const KrHandle x = scene.Doubles(kX);
    double* value = scene.Number();
    double* estimate = scene.Number();
    return scene.Call(interpolate, y, x, &kAt, value, estimate, scene.err());
}

}  // namespace

SWEEP(PolyInterp_head) {
    return PlayInterpolation(scene, PolyInterp_head);
}
SWEEP(RatInterp_head) {
    return PlayInterpolation(scene, RatInterp_head);
}

SWEEP(Spline_head) {
    const KrHandle y = scene.Doubles(kY);
    const KrHandle x = scene.Doubles(kX);
    const KrHandle y2 = scene.OutDoubles();
    const double slope = 0.5;
    return scene.Call(Spline_head, y, x, &slope, &slope, y2, scene.err());
}

SWEEP(SpInterp_head) {
    const KrHandle y = scene.Doubles(kY);
    const KrHandle x = scene.Doubles(kX);
    const KrHandle y2 = scene.Doubles({0, 1, -1, 2, -2, 1, 1, 0});
    double* value = scene.Number();
    return scene.Call(SpInterp_head, y, x, y2, &kAt, value, scene.err());
}

SWEEP(CubicSplineFit_head) {
    const KrHandle y = scene.Replaced(scene.Doubles(kY));
    const KrHandle x = scene.Doubles(kX);
    const KrHandle w = scene.Doubles({1, 2, 1, 2, 1, 2, 1, 2});
    const KrHandle lambda = scene.Doubles({1, 2, 1, 2, 1, 2, 1});
    double* residue = scene.Number();
    return scene.Call(CubicSplineFit_head, y, x, w, lambda, 0.5, residue);
}

SWEEP(RmvOutlierIndx_head) {
    const KrHandle y = scene.Doubles(kY);
    const KrHandle x = scene.Doubles(kX);
    const KrHandle w = scene.Doubles(kX);
    const KrHandle indices = scene.Integers({3, 0, 3});
    const KrHandle y_out = scene.OutDoubles();
    const KrHandle x_out = scene.OutDoubles();
    const KrHandle w_out = scene.OutDoubles();
    const KrHandle mask = scene.Replaced(scene.Bytes({9, 9}));
    return scene.Call(RmvOutlierIndx_head, y, x, w, indices, y_out, x_out, w_out, mask);
}

SWEEP(RmvOutlierRng_head) {
    const KrHandle y = scene.Doubles(kY);
    const KrHandle x = scene.Doubles(kX);
    const KrHandle w = scene.Doubles(kX);
    const KrHandle range = scene.Doubles({7.5, 0.5, 1.5, 5.5});
    const KrHandle y_out = scene.OutDoubles();
    const KrHandle x_out = scene.OutDoubles();
    const KrHandle w_out = scene.OutDoubles();
    const KrHandle removed = scene.OutIntegers();
    return scene.Call(RmvOutlierRng_head, y, x, w, range, 2, y_out, x_out, w_out, removed);
}

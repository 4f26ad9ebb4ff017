#include "krnumer/integration.h"
#include "krnumer/vector.h"
#include "sweep/sweep.h"

SWEEP(NumerIntegration_head) {
    const KrHandle y = scene.Doubles({1, 4, 2, 5, 3, 7});
    const double dt = 0.5;
    const int32_t rule = 1;
    double* integral = scene.Number();
    return scene.Call(NumerIntegration_head, y, &dt, &rule, integral, scene.err());
}

SWEEP(NumerIntegration2D_head) {
    const KrHandle y = scene.Matrix(3, 4, {1, 4, 2, 5, 3, 7, 1, 2, 8, 4, 2, 1});
    const KrHandle steps = scene.Doubles({0.5, 2});
    double* integral = scene.Number();
    return scene.Call(NumerIntegration2D_head, y, steps, 1, integral);
}

SWEEP(NumerIntegration3D_head) {
    const KrHandle y =
        scene.Cube(3, 3, 3, {1, 4, 2, 5, 3, 7, 1, 2, 8, 4, 2, 1, 7, 5, 3, 8, 6, 1, 2, 3, 5, 9, 1, 0, 2, 4, 4});
    const KrHandle steps = scene.Doubles({0.5, 2, 3});
    double* integral = scene.Number();
    return scene.Call(NumerIntegration3D_head, y, steps, 0, integral);
}

SWEEP(Scale) {
    const KrHandle x = scene.Replaced(scene.Matrix(2, 2, {1, 4, 2, 6}));
    double* scale = scene.Number();
    double* offset = scene.Number();
    return scene.Call(Scale, x, scale, offset, scene.err());
}

SWEEP(Scale1DCIN) {
    const KrHandle x = scene.Replaced(scene.Doubles({1, 4, 2, 6}));
    double* offset = scene.Number();
    double* scale = scene.Number();
    return scene.Call(Scale1DCIN, x, offset, scale, scene.err());
}

SWEEP(QScale) {
    const KrHandle x = scene.Replaced(scene.Matrix(2, 2, {1, 4, 2, -6}));
    double* scale = scene.Number();
    return scene.Call(QScale, x, scale, scene.err());
}

SWEEP(QS1D) {
    const KrHandle x = scene.Replaced(scene.Doubles({1, 4, 2, -6}));
    double* scale = scene.Number();
    return scene.Call(QS1D, x, scale, scene.err());
}

SWEEP(Norm2) {
    const KrHandle x = scene.Replaced(scene.Matrix(2, 2, {1, 4, 2, 6}));
    double* deviation = scene.Number();
    double* mean = scene.Number();
    return scene.Call(Norm2, x, deviation, mean, scene.err());
}

SWEEP(Norm1) {
    const KrHandle x = scene.Replaced(scene.Doubles({1, 4, 2, 6}));
    double* deviation = scene.Number();
    double* mean = scene.Number();
    return scene.Call(Norm1, x, deviation, mean, scene.err());
}

SWEEP(Line1) {
    const KrHandle x = scene.Replaced(scene.Doubles({1, 4, 2, 6}));
    const double slope = 0.5, intercept = 3;
    return scene.Call(Line1, x, &slope, &intercept, scene.err());
}

SWEEP(LinEv) {
    const KrHandle x = scene.Replaced(scene.Matrix(2, 2, {1, 4, 2, 6}));
    const double slope = 0.5, intercept = 3;
    return scene.Call(LinEv, x, &slope, &intercept, scene.err());
}

SWEEP(PolarToRect1D_head) {
    const KrHandle r = scene.Replaced(scene.Doubles({1, 4, 2}));
    const KrHandle theta = scene.Replaced(scene.Doubles({0.1, 3, 5}));
    return scene.Call(PolarToRect1D_head, r, theta, scene.err());
}

SWEEP(RectToPolar1D_head) {
    const KrHandle x = scene.Replaced(scene.Doubles({1, -4, 0}));
    const KrHandle y = scene.Replaced(scene.Doubles({0.1, 3, 0}));
    return scene.Call(RectToPolar1D_head, x, y, scene.err());
}

SWEEP(unitVector_head) {
    const KrHandle x = scene.Replaced(scene.Doubles({1, 4, 2}));
    double* norm = scene.Number();
    return scene.Call(unitVector_head, x, norm, scene.err());
}

SWEEP(unitVector80_head) {
    const KrHandle x = scene.Replaced(scene.Doubles({1, 4, 2}));
    double* norm = scene.Number();
    return scene.Call(unitVector80_head, x, 3.0, norm, scene.err());
}

SWEEP(CxUnitVector_head) {
    const KrHandle x = scene.Replaced(scene.Complexes({{1, 4}, {2, -3}}));
    double* norm = scene.Number();
    return scene.Call(CxUnitVector_head, x, norm);
}

SWEEP(CxUnitVector80_head) {
    const KrHandle x = scene.Replaced(scene.Complexes({{1, 4}, {2, -3}}));
    double* norm = scene.Number();
    return scene.Call(CxUnitVector80_head, x, 1.0, norm);
}

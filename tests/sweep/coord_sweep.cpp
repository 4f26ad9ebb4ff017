#include "krnumer/coord.h"

#include "sweep/sweep.h"

namespace {

constexpr std::initializer_list<double> kX{1, 2, -3}, kY{4, 0, 5}, kZ{-1, 7, 0.5};

}  // namespace

SWEEP(CartesianShift2D_head) {
    const KrHandle x = scene.Doubles(kX), y = scene.Doubles(kY);
    const KrHandle X = scene.OutDoubles(), Y = scene.OutDoubles();
    return scene.Call(CartesianShift2D_head, x, y, 1.5, -2.5, X, Y);
}

SWEEP_MORE(CartesianShift2D_head, in_place) {
    const KrHandle x = scene.Replaced(scene.Doubles(kX)), y = scene.Replaced(scene.Doubles(kY));
    return scene.Call(CartesianShift2D_head, x, y, 1.5, -2.5, x, y);
}

SWEEP(CartesianShift3D_head) {
    const KrHandle x = scene.Doubles(kX), y = scene.Doubles(kY), z = scene.Doubles(kZ);
    const KrHandle X = scene.OutDoubles(), Y = scene.OutDoubles(), Z = scene.OutDoubles();
    return scene.Call(CartesianShift3D_head, x, y, z, 1.5, -2.5, 3.5, X, Y, Z);
}

SWEEP(CoordConversion_head) {
    const KrHandle x = scene.Doubles(kX), y = scene.Doubles(kY), z = scene.Doubles(kZ);
    const KrHandle X = scene.OutDoubles(), Y = scene.OutDoubles(), Z = scene.OutDoubles();
    return scene.Call(CoordConversion_head, x, y, z, 0, 1, X, Y, Z);
}

SWEEP(CoordRotation2D_head) {
    const KrHandle x = scene.Doubles(kX), y = scene.Doubles(kY);
    const KrHandle X = scene.OutDoubles(), Y = scene.OutDoubles();
    return scene.Call(CoordRotation2D_head, x, y, 0.7, X, Y);
}

SWEEP(CoordRotationDirect_head) {
    const KrHandle x = scene.Doubles(kX), y = scene.Doubles(kY), z = scene.Doubles(kZ);
    const KrHandle D = scene.Matrix(3, 3, {1.1, 1.2, 1.3, 1.4, 1.5, 1.6, 1.7, 1.8, 1.9});
    const KrHandle X = scene.OutDoubles(), Y = scene.OutDoubles(), Z = scene.OutDoubles();
    return scene.Call(CoordRotationDirect_head, x, y, z, D, 0, X, Y, Z);
}

SWEEP(CoordRotationEuler_head) {
    const KrHandle x = scene.Doubles(kX), y = scene.Doubles(kY), z = scene.Doubles(kZ);
    const KrHandle X = scene.OutDoubles(), Y = scene.OutDoubles(), Z = scene.OutDoubles();
    return scene.Call(CoordRotationEuler_head, x, y, z, 0.1, 0.2, 0.3, X, Y, Z);
}

SWEEP(Direction2Euler_head) {
    const KrHandle D = scene.Matrix(3, 3, {1, 0, 0, 0, 0, 1, 0, -1, 0});
    double* phi = scene.Number();
    double* theta = scene.Number();
    double* psi = scene.Number();
    return scene.Call(Direction2Euler_head, D, phi, theta, psi);
}

SWEEP(Euler2Direction_head) {
    const KrHandle D = scene.OutMatrix();
    return scene.Call(Euler2Direction_head, 0.1, 0.2, 0.3, D);
}

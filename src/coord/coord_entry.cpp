#include <cmath>
#include <cstddef>
#include <utility>

#include "coord/conversion.h"
#include "coord/rotation.h"
#include "frame/entry.h"
#include "krnumer/coord.h"

using namespace krnumer;

namespace {

// Points whose coordinates stand in an array for each axis, and where they go.
template <size_t kAxes>
struct Points {
    int32_t n;
    const double* in[kAxes];
    double* out[kAxes];
};

template <class Core, size_t... kAxis>
int32_t MoveAlong(Call& call, const KrHandle* from, const KrHandle* to, int32_t parameters, Core core,
                  std::index_sequence<kAxis...>) {
    In<double> in[] = {In<double>(call, from[kAxis])...};
    Out<double> out[] = {Out<double>(call, to[kAxis])...};
    const int32_t n = in[0].size();
    if (n < 1) return call.Fail(kEmptyInput);
    for (const auto& axis : in) {
        if (axis.size() != n) return call.Fail(kBadDimension);
    }
    if (parameters != kOk) return call.Fail(parameters);
    for (auto& axis : out) {
        if (axis.Resize(n)) return call.Fail(kOutOfMemory);
    }
    return call.Run([&] {
        core(Points<sizeof...(kAxis)>{n, {in[kAxis].data()...}, {out[kAxis].data()...}});
        return kOk;
    });
}

// `parameters` is the status of the arguments that are no coordinates; sizes come before it.
template <size_t kAxes, class Core>
int32_t Move(Call& call, const KrHandle (&from)[kAxes], const KrHandle (&to)[kAxes], int32_t parameters, Core core) {
    return MoveAlong(call, from, to, parameters, core, std::make_index_sequence<kAxes>());
}

int32_t CheckDirection(const InMatrix<double>& direction) {
    return direction.rows() == 3 && direction.columns() == 3 ? kOk : kBadDimension;
}

}  // namespace

int32_t CartesianShift2D_head(KrHandle x, KrHandle y, double dx, double dy, KrHandle X, KrHandle Y) {
    ByValue call;
    return Move(call, {x, y}, {X, Y}, kOk, [=](const auto& points) {
        Shift(points.in[0], points.n, dx, points.out[0]);
        Shift(points.in[1], points.n, dy, points.out[1]);
    });
}

int32_t CartesianShift3D_head(KrHandle x, KrHandle y, KrHandle z, double dx, double dy, double dz, KrHandle X,
                              KrHandle Y, KrHandle Z) {
    ByValue call;
    return Move(call, {x, y, z}, {X, Y, Z}, kOk, [=](const auto& points) {
        Shift(points.in[0], points.n, dx, points.out[0]);
        Shift(points.in[1], points.n, dy, points.out[1]);
        Shift(points.in[2], points.n, dz, points.out[2]);
    });
}

int32_t CoordConversion_head(KrHandle a, KrHandle b, KrHandle c, int32_t kind, int32_t units, KrHandle p, KrHandle q,
                             KrHandle r) {
    ByValue call;
    const Conversion conversion{static_cast<uint16_t>(kind)};
    const AngleUnit unit{units};
    return Move(call, {a, b, c}, {p, q, r}, CheckConversion(conversion, unit), [=](const auto& points) {
        ConvertCoordinates(points.in[0], points.in[1], points.in[2], points.n, conversion, unit, points.out[0],
                           points.out[1], points.out[2]);
    });
}

int32_t CoordRotation2D_head(KrHandle x, KrHandle y, double angle, KrHandle X, KrHandle Y) {
    ByValue call;
    return Move(call, {x, y}, {X, Y}, kOk, [=](const auto& points) {
        RotatePlane(points.in[0], points.in[1], points.n, angle, points.out[0], points.out[1]);
    });
}

int32_t CoordRotationDirect_head(KrHandle x, KrHandle y, KrHandle z, KrHandle D, int32_t form, KrHandle X, KrHandle Y,
                                 KrHandle Z) {
    constexpr int32_t kAngles = 0, kCosines = 1;
    ByValue call;
    InMatrix<double> direction(call, D);
    int32_t parameters = CheckDirection(direction);
    if (parameters == kOk && form != kAngles && form != kCosines) parameters = kBadSelector;
    return Move(call, {x, y, z}, {X, Y, Z}, parameters, [&](const auto& points) {
        double matrix[9];
        for (int i = 0; i < 9; ++i) {
            matrix[i] = form == kCosines ? direction.data()[i] : std::cos(direction.data()[i]);
        }
        RotateSpace(matrix, points.in[0], points.in[1], points.in[2], points.n, points.out[0], points.out[1],
                    points.out[2]);
    });
}

int32_t CoordRotationEuler_head(KrHandle x, KrHandle y, KrHandle z, double phi, double theta, double psi, KrHandle X,
                                KrHandle Y, KrHandle Z) {
    ByValue call;
    return Move(call, {x, y, z}, {X, Y, Z}, kOk, [=](const auto& points) {
        double matrix[9];
        DirectionFromEuler({phi, theta, psi}, matrix);
        RotateSpace(matrix, points.in[0], points.in[1], points.in[2], points.n, points.out[0], points.out[1],
                    points.out[2]);
    });
}

int32_t Direction2Euler_head(KrHandle D, double* phi, double* theta, double* psi) {
    ByValue call;
    InMatrix<double> direction(call, D);
    Result<double> first(call, phi);
    Result<double> second(call, theta);
    Result<double> third(call, psi);
    if (const int32_t status = CheckDirection(direction)) return call.Fail(status);
    return call.Run([&] {
        const EulerAngles angles = EulerFromDirection(direction.data());
        *first = angles.phi;
        *second = angles.theta;
        *third = angles.psi;
        return kOk;
    });
}

int32_t Euler2Direction_head(double phi, double theta, double psi, KrHandle D) {
    ByValue call;
    OutMatrix<double> direction(call, D);
    if (direction.Resize(3, 3)) return call.Fail(kOutOfMemory);
    return call.Run([&] {
        DirectionFromEuler({phi, theta, psi}, direction.data());
        return kOk;
    });
}

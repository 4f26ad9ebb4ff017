// Cartesian, spherical and cylindrical coordinates of points in space.
#pragma once

#include <cstdint>

namespace krnumer {

// Spherical coordinates are radius, azimuth and polar angle, cylindrical ones radius, azimuth and height.
enum class Conversion : uint16_t {
    kCartesianToSpherical,
    kSphericalToCartesian,
    kCartesianToCylindrical,
    kCylindricalToCartesian,
    kSphericalToCylindrical,
    kCylindricalToSpherical
};

enum class AngleUnit : int32_t { kRadian, kDegree };

// kBadSelector where there is no such conversion or unit.
int32_t CheckConversion(Conversion conversion, AngleUnit unit);

// The n points (a, b, c) to (p, q, r). An azimuth that both forms have is copied as it is. Outputs must not overlap
// inputs. Selectors are checked.
void ConvertCoordinates(const double* a, const double* b, const double* c, int32_t n, Conversion conversion,
                        AngleUnit unit, double* p, double* q, double* r);

}  // namespace krnumer

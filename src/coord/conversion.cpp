#include "coord/conversion.h"

#include <cmath>

#include "frame/status.h"

namespace krnumer {

namespace {

struct Point {
    double a, b, c;
};

// Factors between the caller's angles and radians.
struct Angles {
    double in, out;
};

double Radius(double x, double y) {
    return std::sqrt(x * x + y * y);
}

Point Convert(Point from, Conversion conversion, Angles angles) {
    const auto [a, b, c] = from;
    switch (conversion) {
        case Conversion::kCartesianToSpherical:
            return {std::sqrt(a * a + b * b + c * c), std::atan2(b, a) * angles.out,
                    std::atan2(Radius(a, b), c) * angles.out};
        case Conversion::kSphericalToCartesian: {
            const double azimuth = b * angles.in;
            const double polar = c * angles.in;
            return {a * std::cos(azimuth) * std::sin(polar), a * std::sin(azimuth) * std::sin(polar),
                    a * std::cos(polar)};
        }
        case Conversion::kCartesianToCylindrical:
            return {Radius(a, b), std::atan2(b, a) * angles.out, c};
        case Conversion::kCylindricalToCartesian: {
            const double azimuth = b * angles.in;
            return {a * std::cos(azimuth), a * std::sin(azimuth), c};
        }
        case Conversion::kSphericalToCylindrical: {
            const double polar = c * angles.in;
            return {a * std::sin(polar), b, a * std::cos(polar)};
        }
        case Conversion::kCylindricalToSpherical:
            return {Radius(c, a), b, std::atan2(a, c) * angles.out};
    }
    return from;
}

}  // namespace

int32_t CheckConversion(Conversion conversion, AngleUnit unit) {
    if (conversion > Conversion::kCylindricalToSpherical) return kBadSelector;
    return unit == AngleUnit::kRadian || unit == AngleUnit::kDegree ? kOk : kBadSelector;
}

void ConvertCoordinates(const double* a, const double* b, const double* c, int32_t n, Conversion conversion,
                        AngleUnit unit, double* p, double* q, double* r) {
    const Angles angles =
        unit == AngleUnit::kDegree ? Angles{0.017453292519943295, 57.29577951308232} : Angles{1.0, 1.0};
    for (int32_t i = 0; i < n; ++i) {
        const Point point = Convert({a[i], b[i], c[i]}, conversion, angles);
        p[i] = point.a;
        q[i] = point.b;
        r[i] = point.c;
    }
}

}  // namespace krnumer

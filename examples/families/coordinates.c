/* Two points from spherical to Cartesian coordinates, seen from turned axes, and the angles that turned them. */
#include "arrays.h"

int main(void) {
    KrHandle radius = DOUBLES(1, 2), azimuth = DOUBLES(30, 60), polar = DOUBLES(60, 45);
    KrHandle x = Empty(), y = Empty(), z = Empty(), matrix = KrrtNewMatrix(KRRT_DOUBLE, 0, 0);
    const int32_t sphericalToCartesian = 1, degrees = 1;
    double phi = 0.1, theta = 0.2, psi = 0.3;

    Check(CoordConversion_head(radius, azimuth, polar, sphericalToCartesian, degrees, x, y, z));
    Print("x", x), Print("y", y), Print("z", z);
    Check(CoordRotationEuler_head(x, y, z, phi, theta, psi, x, y, z));
    Print("turned x", x), Print("turned y", y), Print("turned z", z);

    Check(Euler2Direction_head(phi, theta, psi, matrix));
    Check(Direction2Euler_head(matrix, &phi, &theta, &psi));
    printf("Euler angles: %.4f %.4f %.4f\n", phi, theta, psi);
    FREE(radius, azimuth, polar, x, y, z, matrix);
    return 0;
}

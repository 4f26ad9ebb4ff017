#include "coord/rotation.h"

#include <cmath>

#include "linalg/cores.h"

namespace krnumer {

void Shift(const double* x, int32_t n, double distance, double* out) {
    for (int32_t i = 0; i < n; ++i) out[i] = x[i] + distance;
}

void RotatePlane(const double* x, const double* y, int32_t n, double angle, double* out_x, double* out_y) {
    const double c = std::cos(angle);
    const double s = std::sin(angle);
    for (int32_t i = 0; i < n; ++i) {
        out_x[i] = x[i] * c + y[i] * s;
        out_y[i] = y[i] * c - x[i] * s;
    }
}

void RotateSpace(const double* matrix, const double* x, const double* y, const double* z, int32_t n, double* out_x,
                 double* out_y, double* out_z) {
    for (int32_t i = 0; i < n; ++i) {
        const double point[3] = {x[i], y[i], z[i]};
        double turned[3];
        MatVecCore(matrix, 3, 3, point, turned);
        out_x[i] = turned[0];
        out_y[i] = turned[1];
        out_z[i] = turned[2];
    }
}

void DirectionFromEuler(EulerAngles angles, double* matrix) {
    const double cos_phi = std::cos(angles.phi), sin_phi = std::sin(angles.phi);
    const double cos_theta = std::cos(angles.theta), sin_theta = std::sin(angles.theta);
    const double cos_psi = std::cos(angles.psi), sin_psi = std::sin(angles.psi);
    matrix[0] = cos_psi * cos_phi - sin_psi * cos_theta * sin_phi;
    matrix[1] = sin_psi * cos_theta * cos_phi + cos_psi * sin_phi;
    matrix[2] = sin_psi * sin_theta;
    matrix[3] = -sin_psi * cos_phi - cos_psi * cos_theta * sin_phi;
    matrix[4] = cos_psi * cos_theta * cos_phi - sin_psi * sin_phi;
    matrix[5] = cos_psi * sin_theta;
    matrix[6] = sin_theta * sin_phi;
    matrix[7] = -sin_theta * cos_phi;
    matrix[8] = cos_theta;
}

EulerAngles EulerFromDirection(const double* matrix) {
    return {std::atan2(matrix[6], -matrix[7]), std::acos(matrix[8]), std::atan2(matrix[2], matrix[5])};
}

}  // namespace krnumer

// Shifts and rotations of points whose coordinates stand in separate arrays. Outputs must not overlap inputs.
#pragma once

#include <cstdint>

namespace krnumer {

void Shift(const double* x, int32_t n, double distance, double* out);

// By the angle, in radians, that the axes turn counter-clockwise.
void RotatePlane(const double* x, const double* y, int32_t n, double angle, double* out_x, double* out_y);

// By a 3 by 3 direction matrix, row-major, applied to each point as a column.
void RotateSpace(const double* matrix, const double* x, const double* y, const double* z, int32_t n, double* out_x,
                 double* out_y, double* out_z);

// Rotations of the axes about z by phi, about the new x by theta, about the new z by psi (the x convention of
// H. Goldstein, Classical Mechanics, 4-4).
struct EulerAngles {
    double phi, theta, psi;
};

void DirectionFromEuler(EulerAngles angles, double* matrix);

// theta from 0 to pi; without a tilt (theta = 0 or pi) phi and psi are what the arc tangent gives for the zeros there.
EulerAngles EulerFromDirection(const double* matrix);

}  // namespace krnumer

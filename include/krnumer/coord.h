/*
 * Coordinates of points: shift, rotation, conversion, and Euler angles.
 *
 * Points are given as arrays of equal length, one for each coordinate, and outputs may be the inputs. A rotation turns
 * the axes, not the points: the result is what an observer on the turned axes sees.
 *
 * The direction matrix of the Euler angles phi, theta, psi is Rz(psi) Rx(theta) Rz(phi): the axes turn about z by phi,
 * about the new x by theta and about the new z by psi (H. Goldstein, Classical Mechanics, 4-4).
 *
 *     cos psi cos phi - sin psi cos theta sin phi    sin psi cos theta cos phi + cos psi sin phi   sin psi sin theta
 *    -sin psi cos phi - cos psi cos theta sin phi    cos psi cos theta cos phi - sin psi sin phi   cos psi sin theta
 *     sin theta sin phi                             -sin theta cos phi                             cos theta
 */
#ifndef KRNUMER_COORD_H
#define KRNUMER_COORD_H

#include <krnumer/types.h>

/**
 * Shift in the plane: (x + dx, y + dy).
 *
 * @param[in]  x,y    points, 1-D double of equal length
 * @param[in]  dx,dy  distances
 * @param[out] X,Y    shifted points, 1-D double; emptied on failure
 * @return            0; -20003 when `x` is empty; -20008 when the lengths differ; -20001 when an output cannot be sized
 */
KRNUMER_API int32_t CartesianShift2D_head(KrHandle x, KrHandle y, double dx, double dy, KrHandle X, KrHandle Y);

/**
 * Shift in space: (x + dx, y + dy, z + dz).
 *
 * @param[in]  x,y,z     points, 1-D double of equal length
 * @param[in]  dx,dy,dz  distances
 * @param[out] X,Y,Z     shifted points, 1-D double; emptied on failure
 * @return               0; -20003 when `x` is empty; -20008 when the lengths differ; -20001 when an output cannot be
 *                       sized
 */
KRNUMER_API int32_t CartesianShift3D_head(KrHandle x, KrHandle y, KrHandle z, double dx, double dy, double dz,
                                          KrHandle X, KrHandle Y, KrHandle Z);

/**
 * Conversion between Cartesian (x, y, z), spherical (radius, azimuth, polar angle) and cylindrical (radius, azimuth,
 * height) coordinates.
 *
 * | kind | from        | to          | result                                                                |
 * |------|-------------|-------------|-----------------------------------------------------------------------|
 * | 0    | Cartesian   | spherical   | sqrt(x^2 + y^2 + z^2), atan2(y, x), atan2(sqrt(x^2 + y^2), z)         |
 * | 1    | spherical   | Cartesian   | r cos(azimuth) sin(polar), r sin(azimuth) sin(polar), r cos(polar)    |
 * | 2    | Cartesian   | cylindrical | sqrt(x^2 + y^2), atan2(y, x), z                                       |
 * | 3    | cylindrical | Cartesian   | rho cos(azimuth), rho sin(azimuth), z                                 |
 * | 4    | spherical   | cylindrical | r sin(polar), azimuth, r cos(polar)                                   |
 * | 5    | cylindrical | spherical   | sqrt(z^2 + rho^2), azimuth, atan2(rho, z)                             |
 *
 * @param[in]  a,b,c  points, 1-D double of equal length
 * @param[in]  kind   0 to 5; its low 16 bits count
 * @param[in]  units  of all angles: 0 radians, 1 degrees
 * @param[out] p,q,r  converted points, 1-D double; emptied on failure
 * @return            0; -20003 when `a` is empty; -20008 when the lengths differ; -20061 when there is no such
 *                    conversion or unit; -20001 when an output cannot be sized
 */
KRNUMER_API int32_t CoordConversion_head(KrHandle a, KrHandle b, KrHandle c, int32_t kind, int32_t units, KrHandle p,
                                         KrHandle q, KrHandle r);

/**
 * Rotation in the plane: (x cos(angle) + y sin(angle), y cos(angle) - x sin(angle)).
 *
 * @param[in]  x,y    points, 1-D double of equal length
 * @param[in]  angle  by which the axes turn, in radians
 * @param[out] X,Y    rotated points, 1-D double; emptied on failure
 * @return            0; -20003 when `x` is empty; -20008 when the lengths differ; -20001 when an output cannot be sized
 */
KRNUMER_API int32_t CoordRotation2D_head(KrHandle x, KrHandle y, double angle, KrHandle X, KrHandle Y);

/**
 * Rotation in space by a direction matrix, D (x, y, z)^T.
 *
 * @param[in]  x,y,z  points, 1-D double of equal length
 * @param[in]  D      3 by 3 double
 * @param[in]  form   1: `D` holds direction cosines; 0: it holds their angles in radians
 * @param[out] X,Y,Z  rotated points, 1-D double; emptied on failure
 * @return            0, or the first that applies of -20003 when `x` is empty; -20008 when the lengths differ or `D` is
 *                    not 3 by 3; -20061 when `form` is neither; -20001 when an output cannot be sized
 */
KRNUMER_API int32_t CoordRotationDirect_head(KrHandle x, KrHandle y, KrHandle z, KrHandle D, int32_t form, KrHandle X,
                                             KrHandle Y, KrHandle Z);

/**
 * Rotation in space by Euler angles: by their direction matrix, see above.
 *
 * @param[in]  x,y,z           points, 1-D double of equal length
 * @param[in]  phi,theta,psi   Euler angles in radians
 * @param[out] X,Y,Z           rotated points, 1-D double; emptied on failure
 * @return                     0; -20003 when `x` is empty; -20008 when the lengths differ; -20001 when an output cannot
 *                             be sized
 */
KRNUMER_API int32_t CoordRotationEuler_head(KrHandle x, KrHandle y, KrHandle z, double phi, double theta, double psi,
                                            KrHandle X, KrHandle Y, KrHandle Z);

/**
 * Euler angles of a direction matrix: theta = acos(D[2][2]), phi = atan2(D[2][0], -D[2][1]),
 * psi = atan2(D[0][2], D[1][2]).
 *
 * Without a tilt (theta 0 or pi) only the sum or the difference of phi and psi is determined, and they are what the
 * arc tangent gives for zeros: the identity has phi = pi. An element D[2][2] beyond 1 gives a theta that is NaN.
 *
 * @param[in]  D              3 by 3 double
 * @param[out] phi,theta,psi  Euler angles in radians; NaN on failure
 * @return                    0, or -20008 when `D` is not 3 by 3
 */
KRNUMER_API int32_t Direction2Euler_head(KrHandle D, double* phi, double* theta, double* psi);

/**
 * Direction matrix of Euler angles, see above.
 *
 * @param[in]  phi,theta,psi  Euler angles in radians
 * @param[out] D              3 by 3 double; emptied on failure
 * @return                    0, or -20001 when `D` cannot be sized
 */
KRNUMER_API int32_t Euler2Direction_head(double phi, double theta, double psi, KrHandle D);

#endif

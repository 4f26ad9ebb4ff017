#!/usr/bin/python3
"""Makes conversion.txt and rotation.txt: points in other coordinates, and turned ones.

Conversions are computed by mpmath with 50 digits. Rotations come from SciPy's scipy.spatial.transform, which knows
Euler angles as intrinsic rotations of the points, and are held against products of elementary matrices in mpmath.

    conversion.txt    kind, units, the point, the converted point
    rotation.txt      phi, theta, psi, the nine elements of the direction matrix by rows, a point, the turned point

Made with Python 3.11.2, NumPy 1.24.2, SciPy 1.10.1 and mpmath 1.2.1.
"""

import pathlib

import numpy as np
from mpmath import matrix, mp, mpf
from scipy.spatial.transform import Rotation

mp.dps = 50
HERE = pathlib.Path(__file__).parent


def convert(kind, units, point):
    a, b, c = (mpf(v) for v in point)
    rad = mp.pi / 180 if units == 1 else mpf(1)
    if kind == 0:
        r = mp.sqrt(a * a + b * b + c * c)
        polar = mp.acos(c / r) if r else mpf(0)
        return r, mp.arg(mp.mpc(a, b)) / rad, polar / rad
    if kind == 1:
        z = mp.sin(c * rad) * mp.expj(b * rad) * a
        return z.real, z.imag, a * mp.cos(c * rad)
    if kind == 2:
        return abs(mp.mpc(a, b)), mp.arg(mp.mpc(a, b)) / rad, c
    if kind == 3:
        z = a * mp.expj(b * rad)
        return z.real, z.imag, c
    if kind == 4:
        return a * mp.sin(c * rad), b, a * mp.cos(c * rad)
    return abs(mp.mpc(a, c)), b, mp.arg(mp.mpc(c, a)) / rad


def conversions(out):
    rng = np.random.default_rng(121)
    for kind in range(6):
        for units in (0, 1):
            full = 2 * np.pi if units == 0 else 360.0
            for i in range(12):
                point = rng.normal(size=3) * 3
                if kind in (1, 3, 4, 5):
                    point[0] = abs(point[0])
                    point[1] = rng.uniform(-full / 2, full / 2)
                if kind in (1, 4):
                    point[2] = rng.uniform(0, full / 2)
                if i == 11:
                    point[2] = 0.0
                print(kind, units, *map(float, point), *(repr(float(v)) for v in convert(kind, units, point)), file=out)


def elementary(axis, angle):
    """The axes turn, so that coordinates turn the other way."""
    c, s = mp.cos(angle), mp.sin(angle)
    i, j = [(1, 2), (2, 0), (0, 1)][axis]
    m = mp.eye(3)
    m[i, i], m[i, j], m[j, i], m[j, j] = c, s, -s, c
    return m


def rotations(out):
    rng = np.random.default_rng(122)
    for _ in range(30):
        phi, theta, psi = (float(v) for v in rng.uniform((-np.pi, 0, -np.pi), np.pi))
        direction = elementary(2, psi) * elementary(0, theta) * elementary(2, phi)
        rotation = Rotation.from_euler("ZXZ", [phi, theta, psi]).inv()
        assert np.allclose(rotation.as_matrix(), np.array(direction.tolist(), dtype=float), atol=1e-15)
        point = rng.normal(size=3)
        turned = direction * matrix([mpf(v) for v in point])
        assert np.allclose(rotation.apply(point), np.array(turned.tolist(), dtype=float).ravel(), atol=1e-14)
        numbers = [phi, theta, psi, *direction, *point, *turned]
        print(*(repr(float(v)) for v in numbers), file=out)


with open(HERE / "conversion.txt", "w") as file:
    conversions(file)
with open(HERE / "rotation.txt", "w") as file:
    rotations(file)

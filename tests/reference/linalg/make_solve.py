#!/usr/bin/env python3
"""Writes solve.inc: solutions of linear equations, inverses and pseudoinverses by SciPy (LAPACK)."""

import sys

import numpy as np
import scipy.linalg

from tables import matrix, write

random = np.random.default_rng(12)


def fields(is_complex):
    def draw(*shape):
        a = random.integers(-99, 100, shape) / 8
        return a + (1j * random.integers(-99, 100, shape) / 8 if is_complex else 0)

    square, right = draw(5, 5), draw(5, 2)
    tall, tall_right = draw(6, 3), draw(6, 2)
    wide, wide_right = draw(3, 5), draw(3, 2)
    deficient = np.vstack([tall, tall[:2] + tall[2:4]])[:, [0, 1, 0, 2]]
    deficient_right = draw(8, 2)
    root = draw(5, 5)
    definite = root.conj().T @ root
    band = np.triu(np.tril(draw(7, 7), 2), -1)
    band_right = draw(7, 2)
    stored = np.zeros((4, 7), band.dtype)  # one diagonal below, two above
    for i in range(7):
        for j in range(max(0, i - 1), min(7, i + 3)):
            stored[2 + i - j, j] = band[i, j]
    values = {
        "square": square,
        "right": right,
        "solution": scipy.linalg.solve(square, right),
        "inverse": scipy.linalg.inv(square),
        "lower_solution": scipy.linalg.solve_triangular(square, right, lower=True),
        "upper_solution": scipy.linalg.solve_triangular(square, right, lower=False),
        "tall": tall,
        "tall_right": tall_right,
        "tall_solution": scipy.linalg.lstsq(tall, tall_right)[0],
        "tall_inverse": scipy.linalg.pinv(tall),
        "wide": wide,
        "wide_right": wide_right,
        "wide_solution": scipy.linalg.lstsq(wide, wide_right)[0],
        "wide_inverse": scipy.linalg.pinv(wide),
        "deficient": deficient,
        "deficient_right": deficient_right,
        "deficient_solution": scipy.linalg.lstsq(deficient, deficient_right)[0],
        "deficient_inverse": scipy.linalg.pinv(deficient),
        "definite": definite,
        "definite_solution": scipy.linalg.solve(definite, right, assume_a="pos"),
        "definite_inverse": scipy.linalg.inv(definite),
        "band": stored,
        "band_right": band_right,
        "band_solution": scipy.linalg.solve_banded((1, 2), stored, band_right),
    }
    return {name: matrix(value, is_complex) for name, value in values.items()}


MEMBERS = """
    Matrix<T> square, right, solution, inverse, lower_solution, upper_solution;
    Matrix<T> tall, tall_right, tall_solution, tall_inverse;
    Matrix<T> wide, wide_right, wide_solution, wide_inverse;
    Matrix<T> deficient, deficient_right, deficient_solution, deficient_inverse;  // of rank 3
    Matrix<T> definite, definite_solution, definite_inverse;
    Matrix<T> band, band_right, band_solution;
"""

if __name__ == "__main__":
    sys.exit(write("solve", MEMBERS, fields))

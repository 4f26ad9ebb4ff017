#!/usr/bin/env python3
"""Writes functions.inc: functions of matrices by SciPy and NumPy."""

import sys

import numpy as np
import scipy.linalg

from tables import matrix, write

random = np.random.default_rng(11)  # no eigenvalue of the matrices drawn is on the negative real axis


def fields(is_complex):
    def draw(*shape):
        a = random.integers(-9, 10, shape) / 8
        return a + (1j * random.integers(-9, 10, shape) / 8 if is_complex else 0)

    a = draw(4, 4)
    values = {
        "a": a,
        "exponential": scipy.linalg.expm(a),
        "fifth": np.linalg.matrix_power(a, 5),
        "inverse_square": np.linalg.matrix_power(a, -2),
    }
    tables = {name: matrix(value, is_complex) for name, value in values.items()}
    return tables | {
        "logarithm": matrix(scipy.linalg.logm(a), True),
        "root": matrix(scipy.linalg.sqrtm(a), True),
    }


MEMBERS = """
    Matrix<T> a, exponential, fifth, inverse_square;
    Matrix<Complex> logarithm, root;
"""

if __name__ == "__main__":
    sys.exit(write("functions", MEMBERS, fields))

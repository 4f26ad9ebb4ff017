#!/usr/bin/env python3
"""Writes pencil.inc: eigenvalues of a pencil by SciPy (LAPACK), in the orders of the library."""

import sys

import numpy as np
import scipy.linalg

from tables import matrix, vector, write

random = np.random.default_rng(7)

# Ascending; of a conjugate pair the one with positive imaginary part comes first.
KEYS = {"by_real_part": lambda z: (round(z.real, 9), -z.imag), "by_modulus": lambda z: (round(abs(z), 9), -z.imag)}


def fields(is_complex):
    def draw(*shape):
        a = random.integers(-99, 100, shape) / 16
        return a + (1j * random.integers(-99, 100, shape) / 16 if is_complex else 0)

    a, b = draw(6, 6), draw(6, 6)
    eigenvalues = scipy.linalg.eigvals(a, b)
    orders = {name: vector(sorted(eigenvalues, key=key), True) for name, key in KEYS.items()}
    return {"a": matrix(a, is_complex), "b": matrix(b, is_complex)} | orders


MEMBERS = """
    Matrix<T> a, b;
    std::vector<Complex> by_real_part, by_modulus;  // ascending
"""

if __name__ == "__main__":
    sys.exit(write("pencil", MEMBERS, fields))

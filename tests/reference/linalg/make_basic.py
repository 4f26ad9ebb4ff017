#!/usr/bin/env python3
"""Writes basic.inc: products and matrices of special forms, by NumPy and SciPy.

All numbers are small integers, so every result but the companion matrix is exact.
"""

import sys

import numpy as np
import scipy
import scipy.linalg

from tables import element, matrix, vector, write

random = np.random.default_rng(11)


def draw_integers(*shape):
    return random.integers(-9, 10, shape)


def fields(is_complex):
    def draw(*shape):
        return draw_integers(*shape) + (1j * draw_integers(*shape) if is_complex else 0)

    a, b, x, y = draw(3, 4), draw(4, 2), draw(4), draw(3)
    x[0] = y[0]  # the corner of a Toeplitz matrix, which SciPy takes from the column
    return {
        "a": matrix(a, is_complex),
        "b": matrix(b, is_complex),
        "x": vector(x, is_complex),
        "y": vector(y, is_complex),
        "a_times_b": matrix(a @ b, is_complex),
        "a_kronecker_b": matrix(np.kron(a, b), is_complex),
        "a_times_x": vector(a @ x, is_complex),
        "y_times_a": vector(y @ a, is_complex),
        "x_outer_y": matrix(np.outer(x, y), is_complex),
        "x_dot_x": element(x @ x, is_complex),
        "diagonal": matrix(np.diag(x), is_complex),
        "toeplitz": matrix(scipy.linalg.toeplitz(x, y), is_complex),
        "vandermonde": matrix(np.vander(x), is_complex),
        "companion": matrix(scipy.linalg.companion(y), is_complex),
    }


MEMBERS = """
    Matrix<T> a, b;
    std::vector<T> x, y;
    Matrix<T> a_times_b, a_kronecker_b;
    std::vector<T> a_times_x, y_times_a;
    Matrix<T> x_outer_y;
    T x_dot_x;
    Matrix<T> diagonal, toeplitz, vandermonde, companion;
"""

if __name__ == "__main__":
    sys.exit(write("basic", MEMBERS, fields))

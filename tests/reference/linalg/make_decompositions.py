#!/usr/bin/env python3
"""Writes decompositions.csv: singular values and eigenvalues with 60 digits of working precision.

Each line: matrix, quantity, real part, imaginary part, condition. The condition of an eigenvalue is that of its two
eigenvectors, 1 / |y^H x| for vectors of length 1: a perturbation of the matrix moves the eigenvalue by that many times
its size. That of singular values and of eigenvalues of symmetric matrices is 1. The matrices are rebuilt from their
formulas by the tests.
"""

import csv
from pathlib import Path

import mpmath as mp

mp.mp.dps = 60


def by_formula(rows, columns, element):
    return mp.matrix([[mp.mpmathify(element(i, j)) for j in range(columns)] for i in range(rows)])


def double(x):
    """The double that the test computes with."""
    return mp.mpf(float(x))


def integer(i, j):
    return (3 * i + 5 * j + i * j) % 11 - 5


def gauss_integer(i, j):
    return mp.mpc((7 * i + 3 * j) % 11 - 5, (2 * i + 5 * j) % 7 - 3)


def frank(n):
    return by_formula(n, n, lambda i, j: 0 if j + 1 < i else n - max(i, j))


def grcar(n):
    return by_formula(n, n, lambda i, j: -1 if i == j + 1 else (1 if i <= j <= i + 3 else 0))


def clement(n):
    return by_formula(n, n, lambda i, j: n - j if j == i + 1 else (i if i == j + 1 else 0))


def wilkinson(n):
    return by_formula(n, n, lambda i, j: abs(mp.mpf(n - 1) / 2 - i) if i == j else int(abs(i - j) == 1))


hilbert = by_formula(8, 8, lambda i, j: double(1 / (i + j + 1)))
tall = by_formula(7, 4, integer)
square = by_formula(6, 6, integer)
complex_tall = by_formula(6, 4, gauss_integer)
complex_square = by_formula(5, 5, gauss_integer)
hermitian = complex_square + complex_square.H

SINGULAR = {
    "hilbert": hilbert,
    "frank": frank(9),
    "grcar": grcar(10),
    "tall": tall,
    "square": square,
    "complex_tall": complex_tall,
    "complex_square": complex_square,
}
GENERAL = {
    "frank": frank(9),
    "grcar": grcar(10),
    "clement": clement(8),
    "square": square,
    "complex_square": complex_square,
}
HERMITIAN = {"hilbert": hilbert, "wilkinson": wilkinson(11), "hermitian": hermitian}


def length(x):
    return mp.sqrt(sum(abs(z) ** 2 for z in x))


def rows():
    for name, a in SINGULAR.items():
        values = mp.svd_c(a, compute_uv=False)
        for value in sorted((values[i] for i in range(len(values))), reverse=True):
            yield name, "singular", value, 0, 1
    for name, a in GENERAL.items():
        values, left, right = mp.eig(a, left=True, right=True)
        for i, value in enumerate(values):
            y, x = left[i, :], right[:, i]
            product = sum(y[k] * x[k] for k in range(len(values)))
            value = mp.chop(value, 1e-50)
            yield name, "general", mp.re(value), mp.im(value), length(y) * length(x) / abs(product)
    for name, a in HERMITIAN.items():
        values = mp.eighe(a, eigvals_only=True)
        for value in sorted(values[i] for i in range(len(values))):
            yield name, "hermitian", value, 0, 1


def main():
    with open(Path(__file__).with_name("decompositions.csv"), "w", newline="") as file:
        writer = csv.writer(file, lineterminator="\n")
        for name, quantity, re, im, condition in rows():
            writer.writerow([name, quantity, mp.nstr(re, 20), mp.nstr(im, 20), mp.nstr(condition, 4)])


if __name__ == "__main__":
    main()

#!/usr/bin/env python3
"""Writes factor.inc: LU, Cholesky and QR factors by SciPy (LAPACK)."""

import sys

import numpy as np
import scipy.linalg

from tables import integers, matrix, vector, write

random = np.random.default_rng(2)


def draw(*shape, is_complex):
    a = random.integers(-99, 100, shape) / 8
    return a + (1j * random.integers(-99, 100, shape) / 8 if is_complex else 0)


def packed_lower(a):
    return np.concatenate([a[j:, j] for j in range(len(a))])


def fields(is_complex):
    # LAPACK compares complex pivots by |re| + |im|; this matrix has the same ones by the modulus.
    a = draw(6, 6, is_complex=is_complex)
    lu, pivots = scipy.linalg.lu_factor(a)
    b = draw(5, 5, is_complex=is_complex)
    definite = b.conj().T @ b
    tall, wide = draw(6, 4, is_complex=is_complex), draw(3, 5, is_complex=is_complex)
    tall_q, tall_r = scipy.linalg.qr(tall)
    wide_q, wide_r = scipy.linalg.qr(wide)
    pivoted_q, pivoted_r, columns = scipy.linalg.qr(tall, pivoting=True)
    return {
        "a": matrix(a, is_complex),
        "lu": matrix(lu, is_complex),
        "pivots": integers(pivots),
        "definite": matrix(definite, is_complex),
        "packed_l": vector(packed_lower(scipy.linalg.cholesky(definite, lower=True)), is_complex),
        "tall": matrix(tall, is_complex),
        "tall_q": matrix(tall_q, is_complex),
        "tall_r": matrix(tall_r, is_complex),
        "wide": matrix(wide, is_complex),
        "wide_q": matrix(wide_q, is_complex),
        "wide_r": matrix(wide_r, is_complex),
        "pivoted_q": matrix(pivoted_q, is_complex),
        "pivoted_r": matrix(pivoted_r, is_complex),
        "columns": integers(columns),
    }


MEMBERS = """
    Matrix<T> a, lu;
    std::vector<int32_t> pivots;
    Matrix<T> definite;
    std::vector<T> packed_l;
    Matrix<T> tall, tall_q, tall_r, wide, wide_q, wide_r, pivoted_q, pivoted_r;
    std::vector<int32_t> columns;  // of `tall`, in their pivoted order
"""

if __name__ == "__main__":
    sys.exit(write("factor", MEMBERS, fields))

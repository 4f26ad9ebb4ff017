#!/usr/bin/env python3
"""Writes equations.inc: solutions of Sylvester and Lyapunov equations by SciPy.

Regular equations are solved by scipy.linalg.solve_sylvester and solve_continuous_lyapunov. The right-hand side of the
singular one is out of reach; its solution of least norm is that of the Kronecker form by scipy.linalg.lstsq.
"""

import sys

import numpy as np
import scipy.linalg

from tables import matrix, write

random = np.random.default_rng(7)


def op(a, transposed):
    return a.conj().T if transposed else a


def least_norm(a, b, c):
    kronecker = np.kron(a, np.eye(len(b))) + np.kron(np.eye(len(a)), b.T)
    return scipy.linalg.lstsq(kronecker, c.ravel())[0].reshape(c.shape)


def fields(is_complex):
    def draw(*shape):
        a = random.integers(-99, 100, shape) / 16
        return a + (1j * random.integers(-99, 100, shape) / 16 if is_complex else 0)

    a, b, c, q = draw(4, 4), draw(3, 3), draw(4, 3), draw(4, 4)
    solutions = [
        matrix(scipy.linalg.solve_sylvester(op(a, trans_a), sign * op(b, trans_b), c), is_complex)
        for trans_a in (0, 1)
        for trans_b in (0, 1)
        for sign in (1, -1)
    ]
    left = np.triu(draw(3, 3))
    right = np.triu(draw(3, 3))
    np.fill_diagonal(left, [1, 2, 5])
    np.fill_diagonal(right, [3, -2, 4])
    values = {
        "a": a,
        "b": b,
        "c": c,
        "q": q,
        "lyapunov": scipy.linalg.solve_continuous_lyapunov(a, q),
        "left": left,
        "right": right,
        "least_norm": least_norm(left, right, q[:3, :3]),
    }
    tables = {name: matrix(value, is_complex) for name, value in values.items()}
    return tables | {"sylvester": "{" + ", ".join(solutions) + "}"}


MEMBERS = """
    Matrix<T> a, b, c, q, lyapunov;
    Matrix<T> left, right, least_norm;  // triangular, of an equation that is singular, with the corner of q
    std::vector<Matrix<T>> sylvester;   // by transA, transB, and sign 1 and -1
"""

if __name__ == "__main__":
    sys.exit(write("equations", MEMBERS, fields))

#!/usr/bin/python3
"""Makes integration.txt and norms.txt: integrals of samples and norms of vectors, correctly rounded.

Integrals: the polynomials through the samples of each panel are integrated in exact fractions, by Lagrange's form and
not by tabulated weights; SciPy's newton_cotes confirms the weights. Norms: mpmath with 50 digits.

    integration.txt    rule, steps by axis from the fastest on, sizes from the slowest axis on, samples, integral;
                       each list is preceded by its length
    norms.txt          kind (real or complex), p, norm, elements (of complex vectors real and imaginary parts in turn)

Made with Python 3.11.2, NumPy 1.24.2, SciPy 1.10.1 and mpmath 1.2.1.
"""

import pathlib
from fractions import Fraction

import numpy as np
import scipy.integrate
from mpmath import mp, mpf

mp.dps = 50
HERE = pathlib.Path(__file__).parent


def polynomial_product(a, b):
    c = [Fraction(0)] * (len(a) + len(b) - 1)
    for i, x in enumerate(a):
        for j, y in enumerate(b):
            c[i + j] += x * y
    return c


def panel_weights(intervals):
    """Integrals of Lagrange's polynomials over 0 ... intervals."""
    weights = []
    for i in range(intervals + 1):
        basis = [Fraction(1)]
        for j in range(intervals + 1):
            if j != i:
                basis = polynomial_product(basis, [Fraction(-j, i - j), Fraction(1, i - j)])
        weights.append(sum(c * Fraction(intervals) ** (k + 1) / (k + 1) for k, c in enumerate(basis)))
    confirmed, _ = scipy.integrate.newton_cotes(intervals, 1)
    assert np.allclose([float(w) for w in weights], confirmed, rtol=1e-14)
    return weights


WEIGHTS = {k: panel_weights(k) for k in (1, 2, 3, 4)}


def integrate(y, step, rule):
    intervals = rule + 1
    h = abs(Fraction(step))
    begin, total = 0, Fraction(0)
    while begin < len(y) - 1:
        width = min(intervals, len(y) - 1 - begin)
        total += h * sum(w * v for w, v in zip(WEIGHTS[width], y[begin:]))
        begin += width
    return total


def integrate_grid(y, steps, rule):
    if y.ndim == 1:
        return integrate(list(y), steps[0], rule)
    return integrate([integrate_grid(slab, steps, rule) for slab in y], steps[y.ndim - 1], rule)


def integrals(out):
    rng = np.random.default_rng(11)
    shapes = [(n,) for n in range(2, 15)] + [(101,), (3, 5), (5, 6), (7, 9), (8, 5), (3, 4, 3), (5, 6, 7), (6, 5, 8)]
    for rule in range(4):
        for shape in shapes:
            if min(shape) < rule + 2:
                continue
            steps = [float(s) for s in rng.uniform(-2, 2, len(shape))]
            samples = rng.uniform(-1, 3, shape)
            exact = np.vectorize(Fraction, otypes=[object])(samples)
            words = [rule, len(steps), *steps, len(shape), *shape, samples.size, *map(float, samples.flat)]
            print(*words, repr(float(integrate_grid(exact, steps, rule))), file=out)


def norms(out):
    rng = np.random.default_rng(12)
    for kind in ("real", "complex"):
        for p in (2.0, 1.0, 0.5, 1.5, 3.0, 7.25, -1.0, -2.5, -0.3, 40.0, mp.inf, -mp.inf):
            for n in (1, 2, 5, 17):
                x = rng.normal(size=n)
                elements = x if kind == "real" else np.stack([x, rng.normal(size=n)], axis=1).ravel()
                if kind == "real":
                    magnitudes = [abs(mpf(v)) for v in x]
                else:
                    magnitudes = [mp.hypot(a, b) for a, b in zip(elements[::2], elements[1::2])]
                if abs(p) == mp.inf:
                    norm = max(magnitudes) if p > 0 else min(magnitudes)
                else:
                    norm = sum(m ** mpf(p) for m in magnitudes) ** (1 / mpf(p))
                print(kind, float(p), repr(float(norm)), *map(float, elements), file=out)


with open(HERE / "integration.txt", "w") as file:
    integrals(file)
with open(HERE / "norms.txt", "w") as file:
    norms(file)

"""numpy.polyfit, which fits by SVD, beside the lines of fit_bench and each of its methods for polynomials."""

import numpy as np

import peers


def polyfit(n, order):
    x = np.linspace(-1.0, 1.0, n)
    y = 3.0 + 2.0 * x - x * x + 0.1 * np.random.default_rng(1).normal(size=n)
    return lambda: np.polyval(np.polyfit(x, y, order), x)  # with the fitted values, as ours


cases = {f"line/NumPy/n:{n}": polyfit(n, 1) for n in (10000, 1000000)}
for order in (2, 5, 10):
    for method in ("SVD", "QR", "LU", "Cholesky"):
        cases[f"polynomial by {method}/NumPy/n:10000/order:{order}"] = polyfit(10000, order)

peers.measure(cases)

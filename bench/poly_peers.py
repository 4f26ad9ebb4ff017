"""NumPy's eigenvalues of the companion matrix and SciPy's integrals, on data as that of poly_bench."""

import numpy as np
import scipy.integrate

import peers

rng = np.random.default_rng(1)
y = rng.normal(size=1000001)
cases = {
    "integral/SciPy/rule:0": lambda: scipy.integrate.trapezoid(y, dx=0.5),
    "integral/SciPy/rule:1": lambda: scipy.integrate.simpson(y, dx=0.5),
}
for degree in (20, 50, 100):
    c = np.append(1.0, rng.normal(size=degree))
    cases[f"all roots/NumPy/degree:{degree}"] = lambda c=c: np.roots(c)

peers.measure(cases)

"""Functions of matrices and Sylvester's equation by SciPy, on complex matrices where ours are."""

import numpy as np
import scipy.linalg

import peers

cases = {}
for n in (10, 50, 200):
    a, b, c = np.random.default_rng(1).normal(size=(3, n, n))
    cases |= {
        f"exponential/SciPy/n:{n}": lambda a=a: scipy.linalg.expm(a),
        f"square root/SciPy/n:{n}": lambda a=a + 0j: scipy.linalg.sqrtm(a),
        f"logarithm/SciPy/n:{n}": lambda a=a + 0j: scipy.linalg.logm(a, disp=False),
        f"Sylvester equation/SciPy/n:{n}": lambda a=a, b=b, c=c: scipy.linalg.solve_sylvester(a, b, c),
    }

peers.measure(cases)

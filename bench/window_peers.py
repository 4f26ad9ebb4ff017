"""Windows of scipy.signal.windows, and a multiplication of the samples by them: infinite ones, which no weight ever wears
down to denormals."""

import numpy as np
from scipy.signal import windows

import peers

WINDOWS = {
    "Hann": lambda n: windows.hann(n, sym=False),
    "Blackman": lambda n: windows.blackman(n, sym=False),
    "Blackman-Harris 4": lambda n: windows.blackmanharris(n, sym=False),
    "flat top": lambda n: windows.flattop(n, sym=False),
    "Bartlett-Hann": lambda n: windows.barthann(n, sym=False),
    "Bohman": lambda n: windows.bohman(n, sym=False),
    "Parzen": lambda n: windows.parzen(n, sym=False),
    "triangle": lambda n: windows.bartlett(n, sym=False),
    "cosine taper": lambda n: windows.tukey(n, 0.2),
    "exponential": lambda n: windows.exponential(n, 0, n / np.log(10), False),
    "Kaiser": lambda n: windows.kaiser(n, 6, sym=False),
    "Gaussian": lambda n: windows.gaussian(n, 0.2 * n, sym=False),
}


def windowed(window, n, kind=float):
    samples = np.full(n, np.inf, kind)

    def multiply():
        np.multiply(samples, window(n), out=samples)

    return multiply


np.seterr(invalid="ignore")
cases = {}
for n in (1000, 1000000):
    for name, window in WINDOWS.items():
        cases[f"{name}/SciPy/n:{n}"] = windowed(window, n)
        if name in ("Hann", "Blackman", "Blackman-Harris 4", "flat top"):
            cases[f"{name}, complex/SciPy/n:{n}"] = windowed(window, n, complex)
for n in (100, 1000):
    cases[f"Dolph-Chebyshev/SciPy/n:{n}"] = windowed(lambda n: windows.chebwin(n, 80, sym=False), n)

peers.measure(cases)

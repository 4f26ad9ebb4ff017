"""Samples per second of scipy.signal.windows and a multiplication, to stand beside what window_bench measures.

Run with Python 3 and SciPy: python3 window_scipy.py [samples]
"""

import sys
import time

import numpy as np
from scipy.signal import windows

WINDOWS = {
    "Hann": lambda n: windows.hann(n, sym=False),
    "Blackman": lambda n: windows.blackman(n, sym=False),
    "BlackmanHarris4": lambda n: windows.blackmanharris(n, sym=False),
    "FlatTop": lambda n: windows.flattop(n, sym=False),
    "BartlettHanning": lambda n: windows.barthann(n, sym=False),
    "Bohman": lambda n: windows.bohman(n, sym=False),
    "Parzen": lambda n: windows.parzen(n, sym=False),
    "Triangle": lambda n: windows.bartlett(n, sym=False),
    "Taper": lambda n: windows.tukey(n, 0.2),
    "Exponential": lambda n: windows.exponential(n, 0, n / np.log(10), False),
    "Kaiser": lambda n: windows.kaiser(n, 6, sym=False),
    "Gaussian": lambda n: windows.gaussian(n, 0.2 * n, sym=False),
    "DolphChebyshev": lambda n: windows.chebwin(n, 80, sym=False),
}

n = int(sys.argv[1]) if len(sys.argv) > 1 else 1000000
x = np.ones(n)
for name, window in WINDOWS.items():
    calls, start = 0, time.process_time()
    while calls < 3 or time.process_time() - start < 0.3:
        x *= window(n)
        x[:] = 1.0
        calls += 1
    print(f"{name:16s}{n * calls / (time.process_time() - start) / 1e6:10.1f} M/s")

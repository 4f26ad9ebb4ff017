"""Times SciPy on the signal of peak_bench: find_peaks, which compares neighbours only, and the three savgol_filter
passes that give the coefficients of a parabola in every window.

Run with Python 3 and SciPy: python3 peak_scipy.py
"""

import time

import numpy as np
from scipy.signal import find_peaks, savgol_filter


def show(name, function):
    calls, start = 0, time.process_time()
    while calls < 3 or time.process_time() - start < 0.3:
        function()
        calls += 1
    print(f"{name:24s}{1e3 * (time.process_time() - start) / calls:10.2f} ms")


t = np.arange(1000000.0)
x = np.sin(0.0628 * t) + 0.1 * np.sin(0.9 * t)
show("find_peaks", lambda: find_peaks(x, height=0.5))
for width in (3, 5, 15, 51):
    show(f"parabolas, width {width}", lambda: [savgol_filter(x, width, 2, deriv) for deriv in range(3)])

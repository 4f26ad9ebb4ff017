"""SciPy on the signal of peak_bench: find_peaks, which compares neighbours only, and the three savgol_filter passes that
give the coefficients of a parabola in every window."""

import numpy as np
from scipy.signal import find_peaks, savgol_filter

import peers

t = np.arange(1000000.0)
x = np.sin(0.0628 * t) + 0.1 * np.sin(0.9 * t)
cases = {"peaks of runs/SciPy": lambda: find_peaks(x, height=0.5)}
for width in (3, 5, 15, 51):
    cases[f"peaks of parabolas/SciPy/width:{width}/block:1000000"] = lambda width=width: [
        savgol_filter(x, width, 2, deriv) for deriv in range(3)]

peers.measure(cases)

"""Filters of filter_bench beside those of SciPy, in one run: samples per second of both, and their ratio.

Run with Python 3 and SciPy: python3 filter_scipy.py build/release/bench/filter_bench
"""

import json
import subprocess
import sys
import time

import numpy as np
from scipy import signal

n = 1000000
x = np.random.default_rng(1).normal(size=n)
cx = x * (1 + 1j)
shorter = x[:100000]
b = np.full(64, 1 / 64)
a = 0.7 ** np.arange(64)


def cascade(section_order, sections):
    if section_order == 2:
        return signal.butter(2 * sections, 0.2, output="sos")
    return signal.butter(2 * sections, (0.2, 0.6), "bandpass", output="sos")


CASES = {
    "Cascade/2/4": lambda sos=cascade(2, 4): signal.sosfilt(sos, x),
    "Cascade/4/4": lambda sos=cascade(4, 4): signal.sosfilt(sos, x),
    "Cascade/2/1": lambda sos=cascade(2, 1): signal.sosfilt(sos, x),
    "Cascade/2/8": lambda sos=cascade(2, 8): signal.sosfilt(sos, x),
    "CascadeOfComplexSignal/2/4": lambda sos=cascade(2, 4): signal.sosfilt(sos, cx),
    "DirectForm/64/1": lambda: signal.lfilter(b, a, x),
    "DirectForm/64/0": lambda: signal.lfilter(b, [1.0], x),
    "DirectForm/3/1": lambda: signal.lfilter(b[:3], a[:3], x),
    "DirectFormOfComplexSignal/64/1": lambda: signal.lfilter(b, a, cx),
    "DirectFormInComplex/64/1": lambda: signal.lfilter(b + 0j, a + 0j, cx),
    "Median/5": lambda: signal.medfilt(shorter, 5),
    "Median/51": lambda: signal.medfilt(shorter, 51),
    "Median/501": lambda: signal.medfilt(shorter, 501),
    "SavitzkyGolay/11": lambda: signal.savgol_filter(x, 11, 3),
    "SavitzkyGolay/101": lambda: signal.savgol_filter(x, 101, 3),
}


def samples_per_second(filter_all):
    best = np.inf
    for _ in range(3):
        start = time.process_time()
        length = len(filter_all())
        best = min(best, time.process_time() - start)
    return length / best


command = [sys.argv[1], "--benchmark_format=json", "--benchmark_min_time=0.3"]
measured = json.loads(subprocess.run(command, check=True, capture_output=True, text=True).stdout)
print(f"{'':34s}{'krnumer':>10s}{'SciPy':>10s}{'ratio':>8s}")
for benchmark in measured["benchmarks"]:
    name = benchmark["name"]
    if name in CASES:
        ours, theirs = benchmark["items_per_second"], samples_per_second(CASES[name])
        print(f"{name:34s}{ours / 1e6:8.1f}/us{theirs / 1e6:8.2f}/us{ours / theirs:8.1f}")

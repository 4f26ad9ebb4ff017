"""Lines and polynomials of fit_bench beside numpy.polyfit, in one run: milliseconds of CPU of both, and their ratio.

Run with Python 3 and NumPy: python3 fit_numpy.py build/release/bench/fit_bench
"""

import json
import os
import subprocess
import sys
import time

for variable in ("OPENBLAS_NUM_THREADS", "OMP_NUM_THREADS", "MKL_NUM_THREADS"):
    os.environ[variable] = "1"  # as krnumer, which starts no thread

import numpy as np

METHODS = {"0": "SVD", "3": "QR", "4": "LU", "5": "Cholesky", "6": "truncated SVD"}


def polyfit_ms(n, order):
    x = np.linspace(-1.0, 1.0, n)
    y = 3.0 + 2.0 * x - x * x + 0.1 * np.random.default_rng(1).normal(size=n)
    best = np.inf
    for _ in range(5):
        start = time.process_time()
        np.polyval(np.polyfit(x, y, order), x)  # with the fitted values, as ours
        best = min(best, time.process_time() - start)
    return 1e3 * best


command = [sys.argv[1], "--benchmark_format=json", "--benchmark_min_time=0.3", "--benchmark_filter=^(Line|Polynomial)/"]
measured = json.loads(subprocess.run(command, check=True, capture_output=True, text=True).stdout)
theirs = {(n, order): polyfit_ms(n, order) for n in (10000, 1000000) for order in (1, 5, 10)}
print(f"{'points':>8s} {'order':>5s}  {'method':14s}{'krnumer':>9s}{'NumPy':>9s}{'ratio':>7s}")
for benchmark in measured["benchmarks"]:
    name, *arguments = benchmark["name"].split("/")
    n, order, method = (*map(int, arguments[:2]), METHODS[arguments[2]]) if name == "Polynomial" else (
        int(arguments[0]), 1, "closed form")
    ours = benchmark["cpu_time"]
    print(f"{n:8d} {order:5d}  {method:14s}{ours:9.3f}{theirs[n, order]:9.3f}{theirs[n, order] / ours:7.1f}")

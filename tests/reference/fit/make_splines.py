#!/usr/bin/env python3
"""Makes splines.csv: cubic splines and smoothing splines by SciPy.

A line: kind, n, parameters (2), x, y, weights, result. Second derivatives of splines with natural ends or given slopes; values
of the smoothing spline that minimises p sum w (y - f)^2 + (1 - p) integral f''^2.
"""
import csv
import os

import numpy as np
from scipy.interpolate import CubicSpline, make_smoothing_spline

FOLDER = os.path.dirname(os.path.abspath(__file__))
random = np.random.default_rng(20240611)


def numbers(values):
    return [repr(float(v)) for v in values]


def main():
    with open(os.path.join(FOLDER, 'splines.csv'), 'w', newline='') as f:
        rows = csv.writer(f)
        for n in (3, 4, 5, 10, 31, 100):
            x = np.cumsum(random.uniform(0.2, 1.0, n))
            y = random.standard_normal(n)
            ones = np.ones(n)
            natural = CubicSpline(x, y, bc_type='natural')
            rows.writerow(['natural', n, 1e30, 1e30, *numbers(x), *numbers(y), *numbers(ones), *numbers(natural(x, 2))])
            slopes = (0.7, -1.3)
            clamped = CubicSpline(x, y, bc_type=((1, slopes[0]), (1, slopes[1])))
            rows.writerow(['clamped', n, *slopes, *numbers(x), *numbers(y), *numbers(ones), *numbers(clamped(x, 2))])
        for n in (7, 8, 20, 101):
            for p in (0.1, 0.5, 0.9, 0.999):
                x = np.cumsum(random.uniform(0.2, 1.0, n))
                y = np.sin(x) + 0.2 * random.standard_normal(n)
                w = random.uniform(0.3, 3.0, n)
                spline = make_smoothing_spline(x, y, w=w, lam=(1 - p) / p)
                rows.writerow(['smooth', n, p, 0, *numbers(x), *numbers(y), *numbers(w), *numbers(spline(x))])


if __name__ == '__main__':
    main()

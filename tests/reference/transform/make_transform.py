#!/usr/bin/env python3
"""Makes transform.csv: transforms of random data by SciPy. A line: kind, n, m, input, output (complex as re, im pairs)."""
import csv
import os

import numpy as np
import scipy.fft
import scipy.signal

FOLDER = os.path.dirname(os.path.abspath(__file__))
random = np.random.default_rng(20240611)


def numbers(values):
    values = np.asarray(values).ravel()
    if np.iscomplexobj(values):
        values = values.view(float)
    return [repr(float(v)) for v in values]


def main():
    with open(os.path.join(FOLDER, 'transform.csv'), 'w', newline='') as f:
        rows = csv.writer(f)
        for n in (1, 2, 3, 4, 5, 8, 9, 16, 31, 60, 97):
            x = random.standard_normal(n)
            rows.writerow(['dct', n, 1, *numbers(x), *numbers(scipy.fft.dct(x, norm='ortho'))])
            rows.writerow(['dst', n, 1, *numbers(x), *numbers(scipy.fft.dst(x, type=1) / 2)])
            rows.writerow(['hilbert', n, 1, *numbers(x), *numbers(scipy.signal.hilbert(x).imag)])
            z = scipy.fft.fft(x)
            rows.writerow(['hartley', n, 1, *numbers(x), *numbers(z.real - z.imag)])
            rows.writerow(['power', n, 1, *numbers(x), *numbers(abs(z)**2 / (n * n))])
        for n, m in ((1, 1), (1, 4), (3, 1), (2, 3), (4, 4), (5, 7), (8, 9)):
            x = random.standard_normal((n, m))
            rows.writerow(['dct2', n, m, *numbers(x), *numbers(scipy.fft.dctn(x, norm='ortho'))])
            rows.writerow(['dst2', n, m, *numbers(x), *numbers(scipy.fft.dstn(x, type=1) / 4)])


if __name__ == '__main__':
    main()

#!/usr/bin/python3
"""Writes convolution.txt: convolutions, correlations and deconvolutions of sequences, by scipy.signal."""

import numpy as np
import scipy.signal

from golden import Writer, samples

rng = np.random.default_rng(71)

with Writer("convolution", "make_convolution.py") as out:
    for kind in (float, complex):
        for nx, ny in ((1, 1), (1, 6), (7, 1), (5, 5), (4, 9), (31, 8), (66, 23)):
            name = f"{kind.__name__}_{nx}_{ny}"
            x, y = samples(rng, nx, kind), samples(rng, ny, kind)
            lags = scipy.signal.correlate(y, x, method="direct")
            terms = scipy.signal.convolve(np.ones(nx), np.ones(ny), method="direct").round()
            out.put(f"{name}.x", x)
            out.put(f"{name}.y", y)
            out.put(f"{name}.convolution", scipy.signal.convolve(x, y, method="direct"))
            out.put(f"{name}.correlation", lags)
            out.put(f"{name}.unbiased", lags / terms)
            out.put(f"{name}.biased", lags / max(nx, ny))

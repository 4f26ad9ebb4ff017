#!/usr/bin/python3
"""Writes convolution2d.txt: convolutions and correlations of planes, by scipy.signal.

The part of the size of x is cut out at half the kernel's size, rounded down, as Octave's conv2 does; scipy.signal
rounds the other way.
"""

import scipy.signal

from golden import Writer, samples

import numpy as np

rng = np.random.default_rng(72)

SIZES = (
    ((1, 1), (1, 1)),
    ((5, 4), (1, 1)),
    ((6, 5), (2, 3)),
    ((2, 3), (6, 5)),
    ((7, 7), (4, 4)),
    ((3, 9), (3, 2)),
    ((9, 8), (4, 5)),
)

with Writer("convolution2d", "make_convolution2d.py") as out:
    for kind in (float, complex):
        for (rx, cx), (ry, cy) in SIZES:
            name = f"{kind.__name__}_{rx}x{cx}_{ry}x{cy}"
            x, y = samples(rng, (rx, cx), kind), samples(rng, (ry, cy), kind)
            full = scipy.signal.convolve2d(x, y)
            out.put(f"{name}.sizes", (rx, cx, ry, cy))
            out.put(f"{name}.x", x)
            out.put(f"{name}.y", y)
            out.put(f"{name}.full", full)
            out.put(f"{name}.same", full[ry // 2 :, cy // 2 :][:rx, :cx])
            if rx >= ry and cx >= cy:
                out.put(f"{name}.valid", scipy.signal.convolve2d(x, y, "valid"))
            out.put(f"{name}.correlation", scipy.signal.correlate2d(y, x))

"""NumPy and SciPy on the operations of transform_bench."""

import numpy as np
from scipy import fft, ndimage

import peers

x = 1.5 + np.sin(0.7 * np.arange(1000000))
cx = x * (1 + 1j)
turn = 2j * np.pi * 0.1234


def moving_sums(samples, stages, window):
    for _ in range(stages):
        samples = ndimage.uniform_filter1d(samples, window)
    return samples


cases = {
    "modulator/NumPy": lambda: x * np.exp(turn * np.arange(1000000.0)),
    "modulator, complex/NumPy": lambda: cx * np.exp(turn * np.arange(1000000.0)),
}
for name, signal in (("", x), (", complex", cx)):
    for stages, window in ((1, 16), (3, 16), (3, 1000)):
        cases[f"moving sums{name}/SciPy/stages:{stages}/window:{window}"] = lambda s=signal, stages=stages, w=window: (
            moving_sums(s, stages, w))
    for width in (4, 100):
        cases[f"decimated sums{name}/NumPy/width:{width}"] = lambda s=signal, w=width: s.reshape(-1, w).sum(axis=1)
for n in (1000, 1001, 1024, 100000):
    line = x[:n]
    cases[f"cosine transform/SciPy/n:{n}"] = lambda line=line: fft.dct(line, 2)
    cases[f"inverse cosine transform/SciPy/n:{n}"] = lambda line=line: fft.dct(line, 3)
    cases[f"sine transform/SciPy/n:{n}"] = lambda line=line: fft.dst(line, 1)

peers.measure(cases)

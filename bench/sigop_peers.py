"""NumPy and SciPy on the operations of sigop_bench."""

import numpy as np
from scipy import signal

import peers


def samples(n):
    return 1.5 + np.sin(0.7 * np.arange(n))


cases = {}
for nx, ny in ((1000, 1000), (100000, 32), (100000, 1000)):
    x, y = samples(nx), samples(ny)
    shape = f"nx:{nx}/ny:{ny}"
    cases[f"direct convolution/NumPy/{shape}"] = lambda x=x, y=y: np.convolve(x, y)
    cases[f"direct convolution, complex/NumPy/{shape}"] = lambda x=x * (1 + 1j), y=y * (1 + 1j): np.convolve(x, y)
for nx, ny in ((1000, 1000), (100000, 1000), (1000000, 1000000)):
    convolve = lambda x=samples(nx), y=samples(ny): signal.fftconvolve(x, y)
    cases[f"convolution by FFT/SciPy/nx:{nx}/ny:{ny}"] = convolve
    cases[f"convolution by FFT, no table/SciPy/nx:{nx}/ny:{ny}"] = convolve

image, kernel = samples(512 * 512).reshape(512, 512), samples(31 * 31).reshape(31, 31)
cases["plane convolution, direct/SciPy"] = lambda: signal.convolve2d(image, kernel)
cases["plane convolution by FFT/SciPy"] = lambda: signal.fftconvolve(image, kernel)

stream = samples(1000000)
for factor in (4, 100):
    cases[f"decimation/NumPy/factor:{factor}"] = lambda factor=factor: stream[::factor].copy()
    cases[f"decimation by means/NumPy/factor:{factor}"] = lambda factor=factor: stream.reshape(-1, factor).mean(axis=1)

block = samples(14700)
cases["rational resampling/SciPy"] = lambda: signal.resample_poly(block, 160, 147)
cases["rational resampling, complex/SciPy"] = lambda: signal.resample_poly(block * (1 + 1j), 160, 147)

peers.measure(cases)

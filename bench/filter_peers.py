"""SciPy's filters on the signals of filter_bench."""

import numpy as np
from scipy import signal

import peers

x = np.random.default_rng(1).normal(size=1000000)
cx = x * (1 + 1j)
shorter = x[:100000]
b = np.full(64, 1 / 64)
a = 0.7 ** np.arange(64)


def butterworth(order, sections):
    if order == 2:
        return signal.butter(2 * sections, 0.2, output="sos")
    return signal.butter(2 * sections, (0.2, 0.6), "bandpass", output="sos")


cases = {
    "direct form/SciPy/taps:64/recursive:1": lambda: signal.lfilter(b, a, x),
    "direct form/SciPy/taps:64/recursive:0": lambda: signal.lfilter(b, [1.0], x),
    "direct form/SciPy/taps:3/recursive:1": lambda: signal.lfilter(b[:3], a[:3], x),
    "direct form, complex signal/SciPy/taps:64/recursive:1": lambda: signal.lfilter(b, a, cx),
    "complex direct form/SciPy/taps:64/recursive:1": lambda: signal.lfilter(b + 0j, a + 0j, cx),
}
for order, sections in ((2, 1), (2, 4), (2, 8), (4, 4)):
    sos = butterworth(order, sections)
    shape = f"order:{order}/sections:{sections}"
    cases[f"cascade/SciPy/{shape}"] = lambda sos=sos: signal.sosfilt(sos, x)
    cases[f"cascade, complex signal/SciPy/{shape}"] = lambda sos=sos: signal.sosfilt(sos, cx)
for width in (5, 51, 501):
    cases[f"running median/SciPy/width:{width}"] = lambda width=width: signal.medfilt(shorter, width)
for width in (11, 101):
    cases[f"Savitzky-Golay/SciPy/width:{width}"] = lambda width=width: signal.savgol_filter(x, width, 3)

peers.measure(cases)

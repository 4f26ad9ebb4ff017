"""The waves of gen_bench as NumPy and SciPy make them."""

import numpy as np
from scipy import signal, special

import peers

FREQUENCY = 0.0123
TABLE = np.full(512, 0.5)
PLACES = np.arange(512) / 512


def waves(n):
    i = np.arange(float(n))
    t = i / n
    angle = 2 * np.pi * FREQUENCY
    return {
        "sine/NumPy": lambda: 2 * np.sin(angle * i + 0.5),
        "sawtooth/SciPy": lambda: 2 * signal.sawtooth(angle * i + 0.5),
        "triangle/SciPy": lambda: 2 * signal.sawtooth(angle * i + 0.5, 0.5),
        "square/SciPy": lambda: 2 * signal.square(angle * i + 0.5, 0.3),
        "table, sample before/NumPy": lambda: 2 * TABLE[((FREQUENCY * i + 0.1) % 1 * 512).astype(np.int64)],
        "table, interpolated/NumPy": lambda: 2 * np.interp(FREQUENCY * i + 0.1, PLACES, TABLE, period=1),
        "chirp/SciPy": lambda: 2 * signal.chirp(i, 0.0, n, 0.4),
        "square pattern/SciPy": lambda: 2 * signal.square(2 * np.pi / 50 * i, 0.3),
        "pulse pattern/NumPy": lambda: np.where((i >= n // 3) & (i < n // 3 + n // 4), 2.0, 0.0),
        "ramp pattern/NumPy": lambda: np.linspace(0.0, 1.0, n),
        "sinc pattern/NumPy": lambda: 2 * np.sinc(0.1 * (i - 3.0)),
        "triangle pulse/NumPy": lambda: np.interp(t, (0.1, 0.4, 0.7), (0.0, 2.0, 0.0)),
        "Gaussian pulse/SciPy": lambda: 2 * signal.gausspulse(t - 0.5, 10.0, 0.5, -6.0),
        "periodic sinc/SciPy": lambda: 2 * special.diric(0.01 * i - 0.5, 7),
    }


peers.measure({f"{name}/n:{n}": make for n in (1000, 1000000) for name, make in waves(n).items()})

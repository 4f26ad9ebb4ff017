"""Makes windows.csv, the weights of every window at a few lengths.

Each window is evaluated from its definition with mpmath at 50 digits and rounded once. Where scipy.signal.windows has
the same window, the script first makes sure that both agree.

Rows: name, length, weights. Run with Python 3, mpmath and SciPy: python3 make_windows.py
"""

import csv
import pathlib

import mpmath as mp
import numpy as np
import scipy
from mpmath import cos, exp, mpf, pi, sin, sqrt
from scipy.signal import windows as sw

mp.mp.dps = 50

LENGTHS = [2, 3, 4, 5, 8, 13, 40]

COSINE_SUMS = {
    "hann": "0.5 0.5",
    "hamming": "0.54 0.46",
    "blackman-harris-3": "0.42323 0.49755 0.07922",
    "exact-blackman": "0.4265907136715391 0.4965606190885641 0.07684866723989682",
    "blackman": "0.42 0.5 0.08",
    "flat-top": "0.215578948 0.41663158 0.277263158 0.083578947 0.006947368",
    "blackman-harris-4": "0.35875 0.48829 0.14128 0.01168",
    "blackman-harris-7": "0.27105140069342415 0.43329793923448606 0.21812299954311062 0.0659254463880309"
    " 0.010811742098372268 0.0007765848252250934 1.3887217350903198e-05",
    "low-side-lobe": "0.323215218 0.471492057 0.17553428 0.028497078 0.001261367",
    "blackman-nuttall": "0.3635819 0.4891775 0.1365995 0.0106411",
}


def cosine_sum(coefficients):
    a = [mpf(c) for c in coefficients.split()]
    return lambda n: [sum((-1) ** k * a[k] * cos(2 * pi * k * i / n) for k in range(len(a))) for i in range(n)]


def triangle(n):
    return [1 - abs(mpf(2 * i) / n - 1) for i in range(n)]


def bartlett_hanning(n):
    w = [mpf("0.62") - mpf("0.48") * abs(mpf(i) / n - 0.5) - mpf("0.38") * cos(2 * pi * i / n) for i in range(n)]
    return [mpf(0)] + w[1:]


def bohman(n):
    u = [abs(mpf(2 * i) / n - 1) for i in range(n)]
    return [mpf(0)] + [(1 - t) * cos(pi * t) + sin(pi * t) / pi for t in u[1:]]


def parzen(n):
    u = [abs(mpf(2 * i) / n - 1) for i in range(n)]
    return [2 * (1 - t) ** 3 if t > 0.5 else 1 - 6 * t**2 * (1 - t) for t in u]


def welch(n):
    return [1 - (mpf(2 * i) / n - 1) ** 2 for i in range(n)]


def taper(fraction):
    def weights(n):
        m = int(n * fraction * 0.5)
        w = [mpf(1)] * n
        for i in range(m):
            w[i] = w[n - 1 - i] = sin(i * pi / (2 * m)) ** 2
        return w

    return weights


def exponential(final):
    return lambda n: [mpf(final) ** (mpf(i) / (n - 1)) for i in range(n)]


def kaiser_i0(x):
    """The power series, at most 25 terms of it, ended by a change of at most 1e-8."""
    total = term = mpf(1)
    for k in range(1, 26):
        term *= x**2 / (2 * k) ** 2
        total += term
        if term <= mpf("1e-8"):
            break
    return total


def kaiser(beta):
    def weights(n):
        w = [kaiser_i0(beta * sqrt(1 - (1 - mpf(2 * i) / n) ** 2)) / kaiser_i0(mpf(beta)) for i in range(n)]
        return [mpf(1) if 2 * i == n else w[i] for i in range(n)]

    return weights


def gaussian(sigma, symmetric):
    def weights(n):
        deviation = mpf(sigma) * (n if symmetric else n + 1)
        centre = mpf(n - 1 if symmetric else n) / 2
        return [exp(-(((i - centre) / deviation) ** 2) / 2) for i in range(n)]

    return weights


def dolph_chebyshev(ratio, symmetric):
    def weights(n):
        m = n if symmetric else n + 1
        stretch = mp.cosh(mp.acosh(mpf(ratio)) / (m - 1))
        half = (m - 1) // 2
        spectrum = [mp.re(mp.chebyt(m - 1, stretch * cos(k * pi / m))) for k in range(1, half + 1)]
        w = []
        for j in range(m):
            d = j - mpf(m - 1) / 2
            w.append(ratio + 2 * sum(cos(2 * (k + 1) * d * pi / m) * t for k, t in enumerate(spectrum)))
        return [v / max(w) for v in w[:n]]

    return weights


def agree(name, ours, theirs, tolerance):
    worst = max(abs(float(a) - b) for a, b in zip(ours, theirs, strict=True))
    assert worst <= tolerance, (name, len(theirs), worst)


WINDOWS = {name: cosine_sum(a) for name, a in COSINE_SUMS.items()} | {
    "triangle": triangle,
    "bartlett-hanning": bartlett_hanning,
    "bohman": bohman,
    "parzen": parzen,
    "welch": welch,
    "taper 0.2": taper(0.2),
    "taper 0.75": taper(0.75),
    "exponential 0.01": exponential(0.01),
    "exponential 3": exponential(3),
    "kaiser 0.5": kaiser(0.5),
    "kaiser 6": kaiser(6),
    "kaiser 40": kaiser(40),
    "kaiser 60": kaiser(60),
    "gaussian 0.15": gaussian(0.15, False),
    "gaussian 0.15 symmetric": gaussian(0.15, True),
    "gaussian 0.6": gaussian(0.6, False),
    "dolph-chebyshev 31.6": dolph_chebyshev(31.6, False),
    "dolph-chebyshev 31.6 symmetric": dolph_chebyshev(31.6, True),
    "dolph-chebyshev 1e4": dolph_chebyshev(1e4, False),
    "dolph-chebyshev 1e4 symmetric": dolph_chebyshev(1e4, True),
}

PEERS = {
    "bartlett-hanning": lambda n: sw.barthann(n, sym=False),
    "bohman": lambda n: sw.bohman(n, sym=False),
    "triangle": lambda n: sw.bartlett(n, sym=False),
    "kaiser 6": lambda n: sw.kaiser(n, 6, sym=False),
    "gaussian 0.15": lambda n: sw.gaussian(n, 0.15 * (n + 1), sym=False),
    "gaussian 0.15 symmetric": lambda n: sw.gaussian(n, 0.15 * n),
    "gaussian 0.6": lambda n: sw.gaussian(n, 0.6 * (n + 1), sym=False),
    "dolph-chebyshev 1e4": lambda n: sw.chebwin(n, 80, sym=False),
    "dolph-chebyshev 1e4 symmetric": lambda n: sw.chebwin(n, 80) if n > 2 else np.ones(2),
} | {
    name: lambda n, a=a: sw.general_cosine(n, [float(c) for c in a.split()], sym=False) for name, a in COSINE_SUMS.items()
}

for name, peer in PEERS.items():
    for length in LENGTHS:
        agree(name, WINDOWS[name](length), peer(length), 1e-11 if name.startswith("kaiser") else 1e-12)

# The short series of the Kaiser window is visibly not I0 at a large beta.
for beta, low, high in [(10, 0, 1e-9), (40, 0.01, 0.1), (60, 0.5, 10)]:
    difference = max(abs(float(a) / b - 1) for a, b in zip(kaiser(beta)(40), sw.kaiser(40, beta, sym=False), strict=True))
    assert low <= difference <= high, (beta, difference)

path = pathlib.Path(__file__).with_name("windows.csv")
with path.open("w", newline="") as file:
    file.write(f"# make_windows.py, mpmath {mp.__version__}, checked against SciPy {scipy.__version__}\n")
    out = csv.writer(file, lineterminator="\n")
    for name, weights in WINDOWS.items():
        for length in LENGTHS:
            out.writerow([name, length] + [repr(float(w)) for w in weights(length)])

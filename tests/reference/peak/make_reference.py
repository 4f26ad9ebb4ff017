#!/usr/bin/python3
"""Makes signals.txt and expected.txt: signals, and the peaks of least-squares parabolas in their windows.

All windows of a signal are fitted at once by numpy.linalg.lstsq; the rules for a peak then work on whole columns, one
step for all windows. For the smooth signals SciPy's find_peaks has to see a local maximum within one sample of each
peak found, and no other above the threshold. Windows whose rules hang on the last digits are avoided by noise.

    signals.txt     one signal a line: name, then the samples
    expected.txt    signal, width, polarity, threshold, number of peaks, then location, amplitude and second derivative
                    of each

Made with Python 3.11.2, NumPy 1.24.2 and SciPy 1.10.1.
"""

import pathlib

import numpy as np
import scipy.signal

HERE = pathlib.Path(__file__).parent


def signals():
    rng = np.random.default_rng(131)
    t = np.arange(240.0)
    yield "chirp", np.sin(2 * np.pi * (0.01 * t + 0.0001 * t**2)) + 0.3
    bumps = 0.002 * t + sum(h * np.exp(-(((t - c) / w) ** 2)) for h, c, w in [(2, 30.3, 4), (1, 71.7, 9), (3, 120.5, 6), (1.5, 200.1, 12)])
    yield "bumps", bumps
    yield "noisy", bumps + rng.normal(0, 0.05, t.size)
    yield "noise", rng.normal(0, 1, t.size)


def peaks(x, width, valleys, threshold):
    half = (width - 1) / 2
    abscissas = np.arange(width) - half
    windows = np.lib.stride_tricks.sliding_window_view(x, width)
    a2, a1, a0 = np.linalg.lstsq(np.vander(abscissas, 3), windows.T, rcond=None)[0]
    sign = -1.0 if valleys else 1.0
    rising = np.where(np.abs(a1) <= 1e-10, a2 > 0, a1 > 0)
    if width >= 5:
        candidates = np.concatenate([[False], rising[1:] != rising[:-1]])
    else:
        candidates = sign * a2 < 0
    with np.errstate(invalid="ignore", divide="ignore"):  # nothing is bent in an even stretch
        vertex = -a1 / (2 * a2)
    before = np.concatenate([[np.inf], np.abs(vertex[:-1])])
    chosen = np.arange(a0.size) - ((vertex < -0.5) & (before < np.abs(vertex)))
    found = []
    for i in np.flatnonzero(candidates & (np.abs(2 * a2) >= 1e-10)):
        c = chosen[i]
        v, bend = vertex[c], 2 * a2[c]
        height = a0[c] + v * (a1[c] + v * a2[c])
        if abs(v) > half / 2 or sign * bend >= 0 or sign * height <= sign * threshold:
            continue
        peak = (c + v + half, height, bend)
        if found and abs(peak[0] - found[-1][0]) < 1:
            if height < found[-1][1] if valleys else height >= found[-1][1]:
                found[-1] = peak
        else:
            found.append(peak)
    return found


def check_with_scipy(x, found, threshold):
    maxima, _ = scipy.signal.find_peaks(x, height=threshold + 0.05)
    locations = np.array([p[0] for p in found])
    assert all(np.min(np.abs(locations - m)) <= 1 for m in maxima)


def main():
    with open(HERE / "signals.txt", "w") as signal_file, open(HERE / "expected.txt", "w") as expected:
        for name, x in signals():
            x = np.round(x * 2.0**20) / 2.0**20
            print(name, *map(float, x), file=signal_file)
            for width in (3, 4, 5, 8, 31):
                for valleys, threshold in ((0, 0.2), (1, 0.6), (1, 10.0)):
                    found = peaks(x, width, valleys, threshold)
                    if name in ("chirp", "bumps") and not valleys and width <= 6:
                        check_with_scipy(x, found, threshold)
                    print(name, width, valleys, threshold, len(found), *(format(v, '.12g') for p in found for v in p),
                          file=expected)


main()

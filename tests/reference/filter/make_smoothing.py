#!/usr/bin/env python3
"""Writes smoothing.inc: medians, polynomial smoothing and zero-phase filtering by SciPy and NumPy.

Made with Python 3.11.2, NumPy 1.24.2 and SciPy 1.10.1.
"""

from pathlib import Path

import numpy as np
from scipy import signal

random = np.random.default_rng(8)


def array(values):
    return "{" + ", ".join(repr(float(v)) for v in np.ravel(values)) + "}"


def draw(n):
    return np.round(random.normal(size=n), 3)


def medians():
    lines = ["const MedianReference kMedians[] = {"]
    for n, rank in [(5, 1), (20, 2), (30, 7), (40, 39)]:
        x = draw(n)
        # The zeros behind only keep SciPy from noting that the window is longer than the signal.
        median = signal.medfilt(np.r_[x, np.zeros(2 * n)], 2 * rank + 1)[:n]
        lines.append(f"    {{{rank}, {array(x)},\n     {array(median)}}},")
    return lines + ["};", ""]


def fit(t, y, order, weights):
    """Coefficients of the polynomial, the lowest power first; NumPy squares its weights."""
    return np.polynomial.polynomial.polyfit(t, y, order, w=None if weights is None else np.sqrt(np.abs(weights)))


def matrices(order, frame, weights):
    t = np.arange(frame) - (frame - 1) // 2
    d = np.array([fit(t, unit, order, weights) for unit in np.eye(frame)]).T
    return d, np.vander(t, order + 1, increasing=True) @ d


def smoothing():
    lines = ["const SavitzkyGolayReference kSavitzkyGolay[] = {"]
    for order, frame, weighted in [(1, 3, 0), (2, 5, 0), (2, 5, 1), (3, 9, 0), (4, 7, 1), (4, 5, 0), (6, 11, 0)]:
        weights = draw(frame) if weighted else None
        d, s = matrices(order, frame, weights)
        x = draw(frame + 8)
        h = frame // 2
        y = [s[i] @ x[:frame] for i in range(h)]
        y += [s[h] @ x[i - h : i + h + 1] for i in range(h, len(x) - h)]
        y += [s[frame - h + i] @ x[-frame:] for i in range(h)]
        if weights is None:
            assert np.allclose(y, signal.savgol_filter(x, frame, order), atol=1e-10)
            # SciPy's coefficients run backward, and its derivatives have the factor k!.
            assert np.allclose(d[1], signal.savgol_coeffs(frame, order, deriv=1)[::-1], atol=1e-10)
        lines.append(
            f"    {{{order}, {frame}, {array(weights if weighted else [])},\n     {array(d)},\n     {array(s)},\n"
            f"     {array(x)},\n     {array(y)}}},"
        )
    return lines + ["};", ""]


def zero_phase():
    lines = ["const ZeroPhaseReference kZeroPhase[] = {"]
    for a, b, n in [
        ([], [0.25, 0.5, 0.25], 12),
        ([], draw(9), 5),
        ([2.0, -1.0], [1.0], 20),
        ([1.0, -1.2, 0.5], [0.1, 0.2], 30),
        ([1.0, -0.4], draw(6), 25),
    ]:
        x = draw(n)
        padding = max(len(a), len(b))
        y = np.r_[np.zeros(padding), x, np.zeros(padding)]
        for _ in range(2):
            y = signal.lfilter(b, a if len(a) else [1.0], y)[::-1]
        lines.append(f"    {{{array(a)}, {array(b)},\n     {array(x)},\n     {array(y[padding : padding + n])}}},")
    return lines + ["};", ""]


if __name__ == "__main__":
    parts = ["// Made by make_smoothing.py; do not edit.", ""] + medians() + smoothing() + zero_phase()
    Path(__file__).with_name("smoothing.inc").write_text("\n".join(parts))

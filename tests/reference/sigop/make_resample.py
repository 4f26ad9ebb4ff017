#!/usr/bin/python3
"""Writes resample.txt: decimated, rationally and arbitrarily resampled signals.

Rational resampling is scipy.signal.upfirdn at the higher rate; resampling at any ratio is the sum over all samples and
the kernel read by numpy.interp, or at the nearest point.
"""

import numpy as np
import scipy.signal

from golden import Writer, samples

rng = np.random.default_rng(74)


def rational(x, up, down, start, taps):
    """The filter correlates: upfirdn gets it reversed."""
    centre = (len(taps) - 1) // 2
    # Padding gives upfirdn outputs up to the last one that has all its samples.
    fine = up * scipy.signal.upfirdn(taps[::-1], x, up=up)
    last = len(x) * up - centre - 1
    positions = np.arange(start, last + 1, down)
    return np.array([fine[p + centre] for p in positions])


def at(x, positions, kernel, oversampling, ratio, nearest):
    half = (len(kernel) - 1) / 2
    delta = oversampling / max(ratio, 1.0)
    out = []
    for t in positions:
        place = half + (np.arange(len(x)) - t) * delta
        inside = (place >= 0) & (place <= len(kernel) - 1)
        if nearest:
            weights = kernel[np.floor(place[inside] + 0.5).astype(int)]
        else:
            weights = np.interp(place[inside], np.arange(len(kernel)), kernel)
        out.append(delta * np.dot(weights, x[inside]))
    return np.array(out)


def within(positions, n, kernel, oversampling, ratio):
    """Positions up to the first whose kernel reaches beyond the samples."""
    half = (len(kernel) - 1) / 2
    delta = oversampling / max(ratio, 1.0)
    frac = positions - np.floor(positions)
    reach = np.floor(positions) + np.floor((delta * frac + half) / delta)
    beyond = np.nonzero(reach > n - 1)[0]
    return positions[: beyond[0]] if len(beyond) else positions


OVERSAMPLING = 16
KERNEL = np.kaiser(16 * 8 + 1, 6) * np.sinc(np.arange(-64, 65) / 16) / 16

with Writer("resample", "make_resample.py") as out:
    for kind in (float, complex):
        x = samples(rng, 23, kind)
        out.put(f"decimate_{kind.__name__}.x", x)
        for m in (1, 2, 5, 23):
            out.put(f"decimate_{kind.__name__}.every{m}", x[: 23 // m * m : m])
            out.put(f"decimate_{kind.__name__}.means{m}", x[: 23 // m * m].reshape(-1, m).mean(axis=1))

        for up, down, count, start in (
            (1, 1, 1, 0),
            (3, 2, 11, 0),
            (2, 3, 11, 4),
            (7, 5, 63, 2),
            (1, 4, 9, 0),
            (4, 1, 9, 3),
            (5, 9, 3, 1),
        ):
            name = f"rational_{kind.__name__}_{up}_{down}_{count}"
            x = samples(rng, 30, kind)
            taps = samples(rng, count, float)
            out.put(f"{name}.rate", (up, down, start))
            out.put(f"{name}.filter", taps)
            out.put(f"{name}.x", x)
            out.put(f"{name}.y", rational(x, up, down, start, taps))

        for nearest in (False, True):
            for ratio in (0.37, 1.0, 1.73, 3.1):
                name = f"constant_{kind.__name__}_{'nearest' if nearest else 'linear'}_{ratio:g}".replace(".", "p")
                x = samples(rng, 60, kind)
                start = 0.3
                positions = within(start + ratio * np.arange(400), 60, KERNEL, OVERSAMPLING, ratio)
                out.put(f"{name}.spec", (ratio, int(nearest), start, OVERSAMPLING))
                out.put(f"{name}.x", x)
                out.put(f"{name}.y", at(x, positions, KERNEL, OVERSAMPLING, ratio, nearest))
    out.put("kernel.points", KERNEL)

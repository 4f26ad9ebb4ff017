#!/usr/bin/env python3
"""Writes fir_design.inc and narrowband.inc: filters without feedback, by SciPy's firwin and remez.

The narrowband filters are planned here, from the published estimates of lengths, and their parts designed by remez.
Only the first half of the taps is kept where the rest follows by symmetry.

Made with Python 3.11.2, NumPy 1.24.2 and SciPy 1.10.1.
"""

import math
import warnings
from pathlib import Path

import numpy as np
from scipy import signal

HERE = Path(__file__).parent
LOWPASS, HIGHPASS, BANDPASS, BANDSTOP, COMPLEMENTARY_LOWPASS, COMPLEMENTARY_HIGHPASS = range(6)


def array(values):
    return "{" + ", ".join(f"{v:.17g}" for v in values) + "}"


def half(taps):
    return taps[: (len(taps) + 1) // 2]


def truncated_ideal():
    lines = ["const FirReference kTruncated[] = {"]
    names = ["lowpass", "highpass", "bandpass", "bandstop"]
    for type_ in range(4):
        for taps, fl, fh in [(1, 100, 230), (2, 100, 230), (7, 1, 2), (31, 499, 499.5), (64, 240, 260), (65, 33, 480)]:
            if taps % 2 == 0 and type_ in (HIGHPASS, BANDSTOP):
                continue
            edges = fl if type_ < BANDPASS else (fl, fh)
            h = signal.firwin(taps, edges, window="boxcar", pass_zero=names[type_], fs=1000, scale=False)
            lines.append(f"    {{{type_}, {taps}, {fl}, {fh}, {array(half(h))}}},")
    return lines + ["};", ""]


def deviation(taps, bands, fs):
    """Largest weighted error over the grid of the exchange, 16 points per cosine and the ends of all bands."""
    worst = 0.0
    n = len(taps)
    spacing = 0.5 / (16 * ((n + 1) // 2))
    for desired, low, high, weight in bands:
        f = np.append(np.arange(low / fs, high / fs - spacing, spacing), high / fs)
        response = np.cos(2 * np.pi * np.outer(f, np.arange(n) - (n - 1) / 2)) @ taps
        worst = max(worst, weight * np.abs(response - desired).max())
    return worst


def remez(taps, bands, fs, kind="bandpass"):
    edges = [edge for band in bands for edge in band[1:3]]
    with warnings.catch_warnings():
        warnings.simplefilter("ignore")
        return signal.remez(
            taps, edges, [b[0] for b in bands], [b[3] for b in bands], type=kind, maxiter=100, grid_density=16, fs=fs
        )


def equiripple():
    kinds = ["bandpass", "differentiator", "hilbert"]
    designs = [
        (0, 3, [(1, 0, 100, 1), (0, 200, 500, 1)]),
        (0, 4, [(1, 0, 100, 1), (0, 200, 500, 1)]),
        (0, 5, [(1, 0, 100, 1), (0, 200, 500, 1)]),
        (0, 6, [(1, 0, 100, 1), (0, 200, 500, 3)]),
        (0, 22, [(1, 0, 100, 1), (0, 150, 500, 10)]),
        (0, 41, [(0, 0, 100, 5), (1, 150, 220, 1), (0, 270, 500, 7)]),
        (0, 51, [(1, 0, 120, 1), (0, 160, 240, 20), (1, 280, 500, 1)]),
        (0, 60, [(1, 0, 120, 1), (0.5, 160, 240, 2), (0, 280, 500, 3)]),
        (0, 151, [(0, 0, 240, 1), (1, 250, 500, 1)]),
        (1, 3, [(1, 0, 300, 1)]),
        (1, 4, [(1, 0, 500, 1)]),
        (1, 5, [(1, 0, 400, 1)]),
        (1, 24, [(2, 0, 500, 1)]),
        (1, 33, [(1, 0, 450, 1)]),
        (1, 40, [(1, 0, 200, 1), (0, 250, 500, 2)]),
        (2, 3, [(1, 100, 400, 1)]),
        (2, 4, [(1, 100, 500, 1)]),
        (2, 5, [(1, 80, 420, 1)]),
        (2, 26, [(1, 30, 500, 1)]),
        (2, 45, [(1, 20, 480, 1)]),
    ]
    lines = ["const EquirippleReference kEquiripple[] = {"]
    for kind, taps, bands in designs:
        # For a differentiator, SciPy's desired slope is that of the normalised frequency too.
        h = remez(taps, [(b[0], b[1] / 1000, b[2] / 1000, b[3]) for b in bands], 1.0, kinds[kind])
        rows = ", ".join("{" + ", ".join(f"{v:g}" for v in band) + "}" for band in bands)
        lines.append(f"    {{{kind}, {taps}, {{{rows}}}, {array(half(h))}}},")
    return lines + ["};", ""]


def alternated(taps):
    middle = (len(taps) - 1) // 2
    return np.array([-t if (i - middle) % 2 else t for i, t in enumerate(taps)])


def narrowband(fs, fp, fstop, fc, ripple, attenuation, type_):
    d1, d2 = ripple, 10 ** (-attenuation / 20)
    if type_ == HIGHPASS:
        fp, fstop = fs / 2 - fp, fs / 2 - fstop
    if type_ in (LOWPASS, HIGHPASS) and fp > fs / 4:
        type_ += COMPLEMENTARY_LOWPASS
        fp, fstop, d1, d2 = fs / 2 - fstop, fs / 2 - fp, d2, d1
    if type_ == BANDPASS:
        fp, fstop = fp / 2, fstop / 2
    if type_ == BANDSTOP:
        fp, fstop, d1, d2 = fstop / 2, fp / 2, d2, d1
    d1 /= 2
    w = d1 / d2
    d = fstop - fp
    two = (-20 * math.log10(math.sqrt(d1 * d2 / 2)) - 13) / 14.6
    one = (-20 * math.log10(math.sqrt(d1 * d2)) - 13) / 14.6
    if type_ in (BANDPASS, BANDSTOP):
        factor, lengths, x, image, t = 1, (int(one / (d / fs)), 0), fc, 1, 0
        for m in range(2, int(0.25 * fs / fstop) + 1):
            turns, place = divmod(m * fc, fs)
            number = 2 * int(turns) + 1
            if place > fs / 2:
                place, number = fs - place, number + 1
            if not (place + m * fstop < fs / 2 and place - m * fstop > 0):
                continue
            # The gap to the neighbours is the narrower one, above or below.
            above = number == 1 or number == m and m % 2 == 0 or number != m and place > fs / 4
            room = ((fs - 2 * place) if above else 2 * place) / m - fstop - fp
            candidate = int(two / (m * d / fs)), int(two / (room / fs))
            if sum(candidate) < sum(lengths):
                factor, lengths, x, image, t = m, candidate, place, number, room
        prototype_bands = [(0, 0, x - factor * fstop, w), (1, x - factor * fp, x + factor * fp, 1)]
        prototype_bands += [(0, x + factor * fstop, fs / 2, w)]
        if image == 1:
            other_bands = [(1, 0, fc + fp, 1), (0, fc + fp + t, fs / 2, w)]
        elif image == factor:
            other_bands = [(0, 0, fc - fp - t, w), (1, fc - fp, fs / 2, 1)]
        else:
            other_bands = [(0, 0, fc - fp - t, w), (1, fc - fp, fc + fp, 1), (0, fc + fp + t, fs / 2, w)]
    else:
        factor = math.floor(fs / (math.sqrt(d * fs) + fp + fstop) + 0.5)
        while factor * fstop >= fs / 2:
            factor -= 1
        lengths = int(two / (factor * d / fs)), 0
        if factor > 1:
            lengths = lengths[0], int(two / ((fs / factor - fstop - fp) / fs))
        single = int(one / (d / fs))
        if single <= sum(lengths):
            factor, lengths = 1, (single, 0)
        prototype_bands = [(1, 0, factor * fp, 1), (0, factor * fstop, fs / 2, w)]
        other_bands = [(1, 0, fp, 1), (0, fs / factor - fstop, fs / 2, w)]

    def design(length, bands):
        if length > 100:
            length = int(1.1 * length)
        while True:
            length += type_ != LOWPASS and length % 2 == 0
            taps = remez(length, bands, fs)
            if deviation(taps, bands, fs) <= d1 * (1 + 1e-6):
                return taps
            length = math.ceil(1.05 * length)

    prototype = design(lengths[0], prototype_bands)
    interpolator = design(lengths[1], other_bands) if factor > 1 else np.array([])
    whole = prototype if factor == 1 else interpolator
    if type_ in (HIGHPASS, COMPLEMENTARY_LOWPASS):
        whole = alternated(whole)
        if factor > 1 and factor % 2:
            prototype = alternated(prototype)
    if type_ in (BANDSTOP, COMPLEMENTARY_LOWPASS, COMPLEMENTARY_HIGHPASS):
        whole = -whole
    if factor == 1:
        return type_, factor, whole, interpolator
    return type_, factor, prototype, whole


def narrowband_filters():
    requests = [
        (1000, 20, 30, 0, 0.01, 60, LOWPASS),
        (1000, 7, 13, 0, 0.1, 40, LOWPASS),
        (1000, 200, 320, 0, 0.01, 60, LOWPASS),
        (1000, 430, 445, 0, 0.02, 50, LOWPASS),
        (1000, 300, 400, 0, 0.02, 50, LOWPASS),
        (1000, 475, 465, 0, 0.01, 55, HIGHPASS),
        (1000, 490, 480, 0, 0.02, 40, HIGHPASS),
        (1000, 60, 45, 0, 0.01, 60, HIGHPASS),
        (1000, 20, 40, 60, 0.01, 50, BANDPASS),
        (1000, 20, 32, 150, 0.02, 45, BANDPASS),
        (1000, 16, 30, 437, 0.01, 50, BANDPASS),
        (1000, 100, 200, 250, 0.05, 40, BANDPASS),
        (1000, 40, 24, 60, 0.02, 50, BANDSTOP),
        (1000, 32, 18, 187, 0.01, 45, BANDSTOP),
        (1000, 200, 100, 250, 0.05, 40, BANDSTOP),
    ]
    lines = ["const NarrowbandReference kNarrowband[] = {"]
    for request in requests:
        type_, factor, prototype, interpolator = narrowband(*request)
        arguments = ", ".join(f"{v:g}" for v in request)
        lines.append(
            f"    {{{arguments}, {type_}, {factor}, {len(prototype)}, {len(interpolator)}, "
            f"{array(half(prototype))}, {array(half(interpolator))}}},"
        )
    return lines + ["};", ""]


def write(name, lines):
    head = ["// Made by make_fir_design.py; do not edit.", ""]
    (HERE / name).write_text("\n".join(head + lines))


if __name__ == "__main__":
    write("fir_design.inc", truncated_ideal() + equiripple())
    write("narrowband.inc", narrowband_filters())

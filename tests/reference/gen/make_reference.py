#!/usr/bin/env python3
"""Makes the reference data of the waves, patterns and pulse shapes: the .inc files beside this script.

The values are computed by mpmath with 50 digits, or in exact fractions, from the arguments as the doubles that they
are, and rounded once. Wherever NumPy or SciPy has the same signal, the script checks that they agree. The sine wave is
given twice: by its two-step recurrence in double arithmetic, in the order that the library promises, and as the true
sine.

Made with Python 3.11.2, NumPy 1.24.2, SciPy 1.10.1 and mpmath 1.2.1.
"""

import math
import os
from fractions import Fraction

import numpy as np
import scipy.signal
import scipy.special
from mpmath import mp, mpf

mp.dps = 50
HERE = os.path.dirname(os.path.abspath(__file__))


def picked(n):
    """All indices of a short signal; of a long one a few from everywhere, the last always among them."""
    return range(n) if n <= 16 else sorted({(n - 1) * j // 15 for j in range(16)} | {1, 2, 3})


def write(name, groups):
    """One array of references for each group: {n, {arguments}, {{index, value}, ...}}."""
    with open(os.path.join(HERE, name), "w") as out:
        out.write("// Made by make_reference.py; do not edit.\n")
        for group, cases in groups.items():
            out.write(f"\nconst std::vector<Reference> {group} = {{\n")
            for n, arguments, samples in cases:
                numbers = ", ".join(repr(float(a)) for a in arguments)
                pairs = ", ".join(f"{{{i}, {float(samples[i])!r}}}" for i in picked(n))
                out.write(f"    {{{n}, {{{numbers}}}, {{{pairs}}}}},\n")
            out.write("};\n")


def agree(ours, theirs, tolerance):
    ours = np.array([float(v) for v in ours])
    assert np.max(np.abs(ours - np.asarray(theirs))) <= tolerance, np.max(np.abs(ours - np.asarray(theirs)))


# Waves ---------------------------------------------------------------------------------------------------------------


def reduced(phase):
    phase = math.fmod(phase, 360.0)
    return phase + 360.0 if phase < 0 else phase


def sine_recurrence(n, amplitude, frequency, phase):
    """The recurrence step by step in double arithmetic; only the start values are taken from mpmath."""
    w = 2.0 * math.pi * frequency
    p = phase * 0.017453292519943295
    sine = float(mp.sin(w))
    y = [amplitude * float(mp.sin(p)), amplitude * float(mp.sin(p + w))]
    c = [amplitude * float(mp.cos(p)), amplitude * float(mp.cos(p + w))]
    limit = abs(amplitude)
    for k in range(2, n):
        value = y[k - 2] + 2.0 * sine * c[k - 1]
        value = limit if value > limit else value
        value = -limit if value < -limit else value
        y.append(value)
        c.append(c[k - 2] - 2.0 * sine * y[k - 1])
    return y[:n], reduced(n * frequency * 360.0 + phase)


def true_sine(n, amplitude, frequency, phase):
    return [amplitude * mp.sin(2 * mp.pi * mpf(frequency) * k + mpf(phase) * mp.pi / 180) for k in range(n)]


def sawtooth(turns):
    s = 2 * (turns % 1)
    return s if s < 1 else s - 2


def triangle(turns):
    v = 2 * (turns % 1)
    return 2 * v if 2 * v < 1 else 2 * (1 - v) if 2 * v < 3 else 2 * (v - 2)


def shape_wave(shape, n, amplitude, frequency, phase):
    """In exact fractions; the frequency is a double, so that edges are met by nobody unless meant."""
    start, step = Fraction(phase) / 360, Fraction(frequency)
    samples = [Fraction(amplitude) * shape(start + i * step) for i in range(n)]
    return samples, (start + n * step) % 1 * 360


def table_wave(n, amplitude, frequency, phase, interpolation, table):
    samples = []
    for i in range(n):
        position = (Fraction(phase) / 360 + i * Fraction(frequency)) % 1 * len(table)
        k = math.floor(position)
        value = Fraction(table[k])
        if interpolation:
            value += (position - k) * (Fraction(table[(k + 1) % len(table)]) - value)
        samples.append(Fraction(amplitude) * value)
    return samples, (Fraction(phase) / 360 + n * Fraction(frequency)) % 1 * 360


def chirp(n, amplitude, f1, f2):
    sweep = (mpf(f2) - mpf(f1)) * mp.pi / n
    samples = [amplitude * mp.sin((i * sweep + 2 * mp.pi * mpf(f1)) * i) for i in range(n)]
    agree(samples, amplitude * scipy.signal.chirp(np.arange(n), f1, n, f2, phi=-90), 1e-10 * abs(amplitude))
    return samples


def waves():
    settings = [
        (1, 2.5, 0.1, 30.0), (2, 2.5, 0.1, 30.0), (3, -2.5, 0.1, 30.0), (7, 1.0, -0.07, -400.5), (16, 3.0, 0.3, 725.25),
        (97, 0.75, 0.0131, 211.0), (128, 1.0, 0.4999, 10.0), (499, -12.0, 0.01, 1.0), (500, 1e-3, 0.2, 45.0),
    ]
    recurrences, sines = [], []
    for n, amplitude, frequency, phase in settings + [(64, 1.0, 0.25, 0.0), (65, 1.0, 0.0, 90.0), (401, -3.0, 0.01, 0.0),
                                                      (100, 1.0, 1e7 + 0.137, 0.0)]:
        samples, end = sine_recurrence(n, amplitude, frequency, phase)
        recurrences.append((n, (amplitude, frequency, phase, end), samples))
    for setting in settings:
        sines.append((setting[0], setting[1:], true_sine(*setting)))
    fast = (100, 1.0, 1e7 + 0.137, 0.0)
    write("sine_wave.inc", {"kSineRecurrences": recurrences, "kTrueSines": sines,
                            "kFastSines": [(fast[0], fast[1:], true_sine(*fast))]})

    sawtooths, triangles, squares, tables = [], [], [], []
    for n, amplitude, frequency, phase in settings:
        turns = np.array([float((Fraction(phase) / 360 + i * Fraction(frequency)) % 1) for i in range(n)])
        radians = 2 * np.pi * turns
        samples, end = shape_wave(sawtooth, n, amplitude, frequency, phase)
        agree(samples, amplitude * scipy.signal.sawtooth(radians + np.pi), 1e-9 * abs(amplitude))
        sawtooths.append((n, (amplitude, frequency, phase, end), samples))
        samples, end = shape_wave(triangle, n, amplitude, frequency, phase)
        agree(samples, amplitude * scipy.signal.sawtooth(radians + np.pi / 2, 0.5), 1e-9 * abs(amplitude))
        triangles.append((n, (amplitude, frequency, phase, end), samples))
        samples, end = shape_wave(lambda t: 1 if t % 1 < Fraction("0.37") else -1, n, amplitude, frequency, phase)
        agree(samples, amplitude * scipy.signal.square(radians, 0.37), 0)
        squares.append((n, (amplitude, frequency, phase, 37.0, end), samples))
        for interpolation in (0, 1):
            table = [0.5, -1.25, 3.0, 2.0, 7.5]
            samples, end = table_wave(n, amplitude, frequency, phase, interpolation, table)
            tables.append((n, (amplitude, frequency, phase, interpolation, end), samples))
    write("phase_wave.inc", {"kSawtooths": sawtooths, "kTriangles": triangles, "kSquares": squares})
    write("table_wave.inc", {"kTableWaves": tables})

    chirps = []
    for n, amplitude, f1, f2 in [(1, 2.0, 0.1, 0.2), (2, 2.0, 0.1, 0.2), (3, 2.0, 0.0, 0.5), (16, -1.0, 0.5, 0.0),
                                 (101, 1.5, 0.01, 0.4), (500, 1.0, -0.2, 0.2), (256, 1.0, 0.1, 0.1)]:
        chirps.append((n, (amplitude, f1, f2), chirp(n, amplitude, f1, f2)))
    write("chirp.inc", {"kChirps": chirps})


# Patterns ------------------------------------------------------------------------------------------------------------


def patterns():
    cases = {"kSinePatterns": [], "kSincPatterns": [], "kRamps": []}
    for n, amplitude, phase, cycles in [(1, 2.0, 30.0, 1.0), (2, 2.0, 30.0, 0.5), (3, 1.0, -45.0, 3.0),
                                        (16, 1.0, 0.0, 2.0), (97, -4.0, 123.0, 7.5), (300, 1.0, 0.0, 33.0)]:
        samples = [amplitude * mp.sin(2 * mp.pi * mpf(cycles) / n * k + mpf(phase) * mp.pi / 180) for k in range(n)]
        cases["kSinePatterns"].append((n, (amplitude, phase, cycles), samples))
    for n, amplitude, delay, dt in [(1, 3.0, 0.25, 1.0), (2, 3.0, 0.25, 1.0), (3, 3.0, 1.0, 1.0), (16, -1.0, 0.77, 0.1),
                                    (127, 2.0, 6.3, 0.1), (256, 1.0, -3.0, 0.0125)]:
        times = [i * mpf(dt) - mpf(delay) for i in range(n)]
        samples = [amplitude * mp.sincpi(t) for t in times]
        agree(samples, amplitude * np.sinc(np.array([float(t) for t in times])), 1e-13 * abs(amplitude))
        cases["kSincPatterns"].append((n, (amplitude, delay, dt), samples))
    for n, start, end in [(1, 2.0, 2.0), (2, 1.0, -1.0), (3, 0.1, 0.7), (16, -5.0, 3.3), (101, 0.0, 1.0), (300, 1e9, 1e-9)]:
        for exclude_end in (0, 1):
            samples = np.linspace(start, end, n, endpoint=not exclude_end)
            cases["kRamps"].append((n, (start, end, exclude_end), samples))
    write("pattern.inc", cases)


# Pulse shapes --------------------------------------------------------------------------------------------------------


def pulse_shapes():
    axes = [(1, 0.0, 0.1), (2, 0.03, 0.1), (3, 0.1, 0.1), (16, 0.33, 0.07), (97, 1.0, 0.021), (300, -0.01, 0.005)]
    cases = {"kTriangles": [], "kMonopulses": [], "kGaussianPulses": [], "kPeriodicSincs": []}
    for n, delay, dt in axes:
        times = [i * mpf(dt) - mpf(delay) for i in range(n)]
        doubles = np.array([float(t) for t in times])
        for amplitude, width, skew in [(2.0, 0.77, 0.0), (2.0, 0.77, 1.0), (-3.0, 0.77, 0.3), (1.0, 0.5, 0.9)]:
            peak = width * skew
            # Between its corners the triangle is what linear interpolation makes of them.
            corners = ([0, width], [amplitude, 0]) if skew == 0 else ([0, width], [0, amplitude]) if skew == 1 \
                else ([0, peak, width], [0, amplitude, 0])
            samples = np.interp(doubles, *corners, left=0, right=0)
            cases["kTriangles"].append((n, (amplitude, delay, dt, width, skew), samples))
        for amplitude, fc in [(1.0, 1.0), (-2.0, 0.35)]:
            # The derivative of exp(-2 (pi fc t)^2), scaled to extremes of +-1.
            gaussian = [mp.exp(-2 * (mp.pi * mpf(fc) * t) ** 2) for t in times]
            samples = [amplitude * 2 * mp.sqrt(mp.e) * mp.pi * mpf(fc) * t * g for t, g in zip(times, gaussian)]
            cases["kMonopulses"].append((n, (amplitude, delay, dt, fc), samples))
        for amplitude, fc, bandwidth, attenuation in [(1.0, 2.0, 0.5, 6.0), (-2.0, 3.5, 1.2, 20.0)]:
            theirs = amplitude * scipy.signal.gausspulse(doubles, fc, bandwidth, -attenuation)
            decay = (mp.pi * mpf(fc) * mpf(bandwidth)) ** 2 / (4 * mp.log(mpf(10) ** (mpf(attenuation) / 20)))
            samples = [amplitude * mp.exp(-decay * t * t) * mp.cos(2 * mp.pi * mpf(fc) * t) for t in times]
            agree(samples, theirs, 1e-12 * abs(amplitude))
            cases["kGaussianPulses"].append((n, (amplitude, delay, dt, fc, bandwidth, attenuation), samples))
        for amplitude, order in [(1.0, 1), (-2.0, 4), (1.5, 7)]:
            wide_dt, late = 20 * dt, 20 * delay  # over several periods of 2 pi
            times = [i * mpf(wide_dt) - mpf(late) for i in range(n)]
            samples = [amplitude * (mp.sin(order * t / 2) / (order * mp.sin(t / 2)) if t != 0 else mpf(1))
                       for t in times]
            agree(samples, amplitude * scipy.special.diric(np.array([float(t) for t in times]), order), 1e-10)
            cases["kPeriodicSincs"].append((n, (amplitude, order, wide_dt, late), samples))
    write("pulse_shape.inc", cases)


if __name__ == "__main__":
    waves()
    patterns()
    pulse_shapes()

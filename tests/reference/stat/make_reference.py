#!/usr/bin/python3
"""Writes samples.txt and expected.txt: data sets and what is expected of their descriptive statistics.

Every value is computed in exact rational arithmetic from the very doubles of the data set and rounded once, and then
held against NumPy and SciPy with a tolerance that their own rounding needs. Needs NumPy and SciPy.

    samples.txt    one data set a line: name, then the samples as hexadecimal floating-point numbers
    expected.txt   one result a line: data set, statistic, parameter, then its values
"""

import collections
import decimal
import math
import pathlib
import statistics
import warnings
from fractions import Fraction

import numpy as np
import scipy.stats

HERE = pathlib.Path(__file__).parent
decimal.getcontext().prec = 60


def data_sets():
    rng = np.random.default_rng(20240229)
    for n in (1, 2, 3, 4, 7, 16, 17, 64, 101, 257, 500):
        yield f"normal{n}", rng.normal(size=n)
        yield f"offset{n}", 1000 + rng.uniform(-1, 1, size=n)
        yield f"lognormal{n}", rng.lognormal(0, 3, size=n)
        yield f"digits{n}", rng.integers(-4, 5, size=n).astype(float)
    yield "ramp59", np.arange(59) / 8


def root(value):
    quotient = decimal.Decimal(value.numerator) / decimal.Decimal(value.denominator)
    return float(quotient.sqrt())


def agree(ours, theirs, scale, what):
    assert abs(ours - theirs) <= 1e-12 * scale, (what, ours, theirs)


def is_power_of_two(value):
    return value.numerator & (value.numerator - 1) == 0 and value.denominator & (value.denominator - 1) == 0


def histogram(exact, doubles, bins):
    """Counts and centers, or None where a sample lies so near to an edge that rounding would decide."""
    low, high = min(exact), max(exact)
    if low == high:
        return None
    width = (high - low) / bins
    counts = [0] * bins
    for x in exact:
        position = (x - low) / width
        rounds = not is_power_of_two(width) and x not in (low, high)
        if rounds and abs(position - round(position)) < Fraction(1, 10**9):
            return None
        counts[min(math.floor(position), bins - 1)] += 1
    theirs, _ = np.histogram(doubles, bins)
    assert list(theirs) == counts, (bins, counts, theirs)
    return counts, [float(low + width * (k + Fraction(1, 2))) for k in range(bins)]


def results(name, doubles, previous):
    exact = [Fraction(float(x)) for x in doubles]
    n = len(exact)

    mean = sum(exact) / n
    agree(float(mean), doubles.mean(), np.abs(doubles).mean(), "mean")
    yield "mean", 0, [float(mean)]

    ordered = sorted(exact)
    middle = (ordered[(n - 1) // 2] + ordered[n // 2]) / 2
    agree(float(middle), float(np.median(doubles)), abs(float(middle)), "median")
    yield "median", 0, [float(middle)]

    for order in (2, 3, 4, 5, 9):
        moment = sum((x - mean) ** order for x in exact) / n
        scale = float(sum(abs(x - mean) ** (order - 1) for x in exact) / n) * np.abs(doubles).max()
        agree(float(moment), float(scipy.stats.moment(doubles, order)), order * scale, "moment")
        yield "moment", order, [float(moment)]

    rms = root(sum(x * x for x in exact) / n)
    agree(rms, math.sqrt(np.mean(doubles**2)), rms, "rms")
    yield "rms", 0, [rms]

    if previous is not None:
        other_name, other = previous
        pairs = list(zip(exact, (Fraction(float(y)) for y in other)))
        yield "mse", other_name, [float(sum((x - y) ** 2 for x, y in pairs) / len(pairs))]

    frequency = collections.Counter(exact)
    modes = sorted(map(float, statistics.multimode(exact))) if max(frequency.values()) > 1 else []
    if n > 1:
        yield "modes", 0, modes

    for bins in (1, 2, 4, 5, 8, 16, 31):
        found = histogram(exact, doubles, bins)
        if found is None:
            continue
        counts, centers = found
        yield "counts", bins, counts
        yield "centers", bins, centers
        if n > 1:
            fullest = max(counts)
            yield "modes", bins, [c for c, k in zip(centers, counts) if k == fullest] if fullest > 1 else []


def main():
    warnings.filterwarnings("ignore", "Precision loss", RuntimeWarning)  # the reason for exact arithmetic
    samples, expected = [], []
    previous = None
    for name, doubles in data_sets():
        samples.append(" ".join([name, *(float(x).hex() for x in doubles)]))
        for statistic, parameter, values in results(name, doubles, previous):
            expected.append(" ".join([name, statistic, str(parameter), *map(repr, values)]))
        previous = name, doubles
    (HERE / "samples.txt").write_text("\n".join(samples) + "\n")
    (HERE / "expected.txt").write_text("\n".join(expected) + "\n")


if __name__ == "__main__":
    main()

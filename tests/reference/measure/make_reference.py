#!/usr/bin/python3
"""Makes signals.txt and expected.txt: sampled waveforms and what every waveform measurement has to give for them.

The measurements are written here from their definitions with whole-array operations of NumPy, without scanning: state
changes by forward fill, crossings and edges by searching the sign changes between them, histograms by np.histogram.
SciPy adds the noise-free edges' times as a check on the definitions. Results that depend on rounding (a sample on a
bin boundary, a level that a sample just reaches) are avoided by drawing samples on a coarse grid and levels off it.

    signals.txt    one signal a line: name, then the samples
    expected.txt   one result a line: signal, t0, dt, low, mid, high, units, method, bins, occurrence, kind, status,
                   value

Made with Python 3.11.2, NumPy 1.24.2 and SciPy 1.10.1.
"""

import math
import pathlib

import numpy as np
import scipy.interpolate

HERE = pathlib.Path(__file__).parent
KINDS = [k for k in range(34) if k != 21]
CYCLES = (15, 16, 17, 18, 24, 25)


def pulses(n, period, rise, width, fall, low, high, start):
    """A trapezoid pulse train by its corners."""
    corners = [(-1.0, low)]
    begin = start
    while begin < n + period:
        corners += [(begin, low), (begin + rise, high), (begin + rise + width, high), (begin + rise + width + fall, low)]
        begin += period
    t, y = np.array(corners).T
    return np.interp(np.arange(n), t, y)


def ringing(y, frequency, decay):
    """The response of a second-order system of unit gain, so that edges overshoot and plateaus settle."""
    w = 2 * math.pi * frequency
    out = np.empty_like(y)
    state, slope = y[0], 0.0
    steps = 64
    for i, target in enumerate(y):
        for _ in range(steps):
            slope += (w * w * (target - state) - 2 * decay * w * slope) / steps
            state += slope / steps
        out[i] = state
    return out


def signals():
    rng = np.random.default_rng(181)
    trapezoid = pulses(240, 40, 6, 14, 9, -0.5, 2.0, 5.25)
    yield "trapezoid", trapezoid
    yield "starts_high", pulses(200, 32, 4, 12, 4, 1.0, 4.0, -9.5)
    yield "noisy", trapezoid + rng.normal(0, 0.04, trapezoid.size)
    yield "ringing", ringing(pulses(300, 75, 2, 36, 3, 0.0, 1.0, 11.0), 0.11, 0.25)
    yield "sine", 3 * np.sin(2 * np.pi * np.arange(180) / 23.7 + 0.3)
    yield "spikes", pulses(210, 70, 2, 1, 2, 0.0, 5.0, 20.0) + rng.uniform(-0.2, 0.2, 210)
    yield "step", pulses(60, 900, 10, 800, 1, 0.0, 1.0, 20.0)
    yield "random", rng.uniform(-1, 1, 150)


class Failure(Exception):
    pass


class Measurements:
    def __init__(self, x, t0, dt, low, mid, high, units, method, bins, occurrence):
        self.__dict__.update(x=x, t0=t0, dt=dt, low=low, mid=mid, high=high, units=units, method=method, bins=bins,
                             k=occurrence)

    def states(self):
        counts, bounds = np.histogram(self.x, self.bins, (self.x.min(), self.x.max()))
        centers = (bounds[:-1] + bounds[1:]) / 2
        upper, lower = int(0.6 * self.bins), int(0.4 * self.bins)
        high = max(range(upper, self.bins), key=lambda i: (counts[i], i))
        low = max(range(0, lower + 1), key=lambda i: (counts[i], -i))
        return centers[low], centers[high], counts[low] / len(self.x), counts[high] / len(self.x)

    def top_and_base(self):
        low, high, low_part, high_part = self.states()
        return (low if low_part > 0.05 else self.x.min()), (high if high_part > 0.05 else self.x.max())

    def scale(self):
        if self.method == 0:
            low, high = self.states()[:2]
        elif self.method == 1:
            low, high = self.x.min(), self.x.max()
        else:
            low, high = self.top_and_base()
        return low, high - low

    def level(self, given):
        if self.units == 0:
            return given
        base, amplitude = self.scale()
        return base + amplitude * given / 100

    def band(self):
        margin = min(self.high - self.mid, self.mid - self.low)
        return margin if self.units == 0 else self.scale()[1] * margin / 100

    def state_runs(self, lower, upper):
        """First and last sample of every stay in a state, and whether it is the high one."""
        marks = np.where(self.x >= upper, 1, np.where(self.x <= lower, -1, 0))
        where = np.flatnonzero(marks)
        if where.size == 0:
            return []
        cuts = np.flatnonzero(np.diff(marks[where])) + 1
        return [(part[0], part[-1], marks[part[0]] > 0) for part in np.split(where, cuts)]

    def passages(self, level):
        d = self.x - level
        return np.flatnonzero(d[1:] * d[:-1] <= 0)

    def time(self, i, level):
        return float(np.interp(level, *zip(*sorted([(self.x[i], i), (self.x[i + 1], i + 1)])))) * self.dt + self.t0

    def crossings(self):
        m, b = self.level(self.mid), self.band()
        passages = self.passages(m)
        found = []
        for first, _, high in self.state_runs(m - b, m + b):
            at = np.searchsorted(passages, first)
            if at < passages.size:
                found.append((self.time(passages[at], m), not high))
        return found

    def cycle(self, first):
        if first < 1:
            raise Failure(-20323)
        crossings = self.crossings()
        if len(crossings) < first + 2:
            raise Failure(-20310)
        return crossings[first - 1 : first + 2]

    def edges(self):
        lower, upper = self.level(self.low), self.level(self.high)
        runs = self.state_runs(lower, upper)
        found = []
        for (_, last, high), (first, _, _) in zip(runs, runs[1:]):
            leaves, reaches = (upper, lower) if high else (lower, upper)
            begin = self.passages(leaves)
            begin = begin[(begin >= last) & (begin < first)][-1]
            found.append((begin, first - 1, self.time(begin, leaves), self.time(first - 1, reaches), not high))
        return found

    def edge_list(self, number):
        if self.k < 1:
            raise Failure(-20323)
        edges = self.edges()
        if len(edges) < number:
            raise Failure(-20310)
        return edges

    def transition(self, rising):
        pair = self.edge_list(2 * self.k)[2 * self.k - 2 : 2 * self.k]
        edge = next(e for e in pair if e[4] == rising)
        return edge[3] - edge[2]

    def around(self, number):
        edges = self.edge_list(number)
        begin = (edges[number - 2][1] + edges[number - 1][0]) // 2
        end = (edges[number - 1][1] + edges[number][0]) // 2 if len(edges) > number else len(self.x) - 1
        return self.x[begin : end + 1]

    def pulse(self, positive):
        times = self.cycle(2 * self.k - 1)
        first = 0 if times[0][1] == positive else 1
        return times[first][0], times[first + 1][0]

    def cycle_samples(self):
        times = self.cycle(2 * self.k - 1)
        period = times[2][0] - times[0][0]
        count = math.floor(period / self.dt + 0.5)
        begin = math.floor((times[0][0] - self.t0) / self.dt + 0.5)
        if count == 0:
            raise Failure(-20319)
        return self.x[begin : begin + count]

    def measure(self, kind):
        x = self.x
        if kind in (0, 1, 2):
            return (x.min(), x.max(), np.ptp(x))[kind]
        if kind in (3, 4, 5):
            low, high = self.states()[:2]
            return (low, high, high - low)[kind - 3]
        if kind in (6, 7, 8):
            base, top = self.top_and_base()
            return (top, base, top - base)[kind - 6]
        if kind in (9, 10, 11):
            return self.level((self.low, self.mid, self.high)[kind - 9])
        if kind == 12:
            return self.band()
        if kind == 13:
            return np.sqrt(np.mean(x**2))
        if kind == 14:
            return np.mean(x)
        if kind in (15, 16):
            times = self.cycle(2 * self.k - 1)
            period = times[2][0] - times[0][0]
            return period if kind == 15 else 1 / period
        if kind == 17:
            return np.sqrt(np.mean(self.cycle_samples() ** 2))
        if kind == 18:
            return np.mean(self.cycle_samples())
        if kind in (19, 20):
            return self.transition(kind == 20)
        if kind in (22, 23, 30, 31):
            begin, end = self.pulse(kind in (22, 30))
            return end - begin if kind in (22, 23) else (begin + end) / 2
        if kind in (24, 25):
            a, b, c = self.cycle(2 * self.k - 1)
            above = (b[0] - a[0] if a[1] else c[0] - b[0]) / (c[0] - a[0])
            return above if kind == 24 else 1 - above
        if kind in (26, 27, 28, 29):
            part = self.around(2 * self.k + (kind >= 28))
            low, high = self.states()[:2]
            return 100 * ((low - part.min()) if kind in (26, 29) else (part.max() - high)) / (high - low)
        assert kind in (32, 33)
        return (self.level(self.high) - self.level(self.low)) / self.transition(kind == 32)


def check_definitions(x):
    """Rise and fall times of the noise-free train, from the inverse of its linear edges."""
    m = Measurements(x, 0.0, 1.0, 10.0, 50.0, 90.0, 1, 1, 8, 1)
    t = np.arange(x.size)
    edge = scipy.interpolate.interp1d(x[5:13], t[5:13])
    lower, upper = m.level(10.0), m.level(90.0)
    assert abs(m.measure(20) - float(edge(upper) - edge(lower))) < 1e-12
    assert abs(m.measure(20) - 0.8 * 6) < 0.06  # its corners lie between samples
    assert abs(m.measure(19) - 0.8 * 9) < 0.01
    assert abs(m.measure(15) - 40) < 1e-9


def parameter_sets(name, x):
    low, mid, high = np.percentile(x, (0, 50, 100)) @ np.array([[0.87, 0.47, 0.09], [0, 0, 0], [0.13, 0.53, 0.91]])
    yield 0.0, 1.0, round(low, 4) + 1.3e-5, round(mid, 4) + 1.7e-5, round(high, 4) + 1.1e-5, 0, 9, 16, 1
    yield -2.5, 0.25, 10.0, 50.0, 90.0, 1, 0, 31, 1
    yield 100.0, 1e-3, 12.5, 47.0, 88.0, 1, 1, 20, 2
    yield 0.5, 2.0, 21.0, 52.0, 79.0, 1, 2, 64, 3


def main():
    with open(HERE / "signals.txt", "w") as signal_file, open(HERE / "expected.txt", "w") as expected:
        for name, x in signals():
            x = np.round(x * 1024) / 1024
            if name == "trapezoid":
                check_definitions(x)
            signal_file.write(" ".join([name] + [repr(float(v)) for v in x]) + "\n")
            for parameters in parameter_sets(name, x):
                measurements = Measurements(x, *parameters)
                for kind in KINDS:
                    status, value = 0, 0.0
                    try:
                        value = float(measurements.measure(kind))
                    except Failure as failure:
                        status = failure.args[0]
                    words = [name] + [repr(float(p)) for p in parameters[:5]]
                    words += [str(int(p)) for p in parameters[5:]]
                    expected.write(" ".join(words + [str(kind), str(status), repr(value)]) + "\n")


main()

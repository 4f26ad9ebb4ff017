#!/usr/bin/python3
"""Writes time_domain.txt: derivatives, integrals, unwrapped phases and modulated carriers.

Derivatives and integrals are exact fractions of the very doubles, rounded once, and held against NumPy; phases are
unwrapped by numpy.unwrap; carriers are sines of 50 digits by mpmath at the angle that was never wrapped.
"""

from fractions import Fraction

import mpmath
import numpy as np

from golden import Writer, samples

rng = np.random.default_rng(73)
mpmath.mp.dps = 50


def neighbours(x, initial, final):
    return [Fraction(float(v)) for v in (initial, *x, final)]


with Writer("time_domain", f"make_time_domain.py with mpmath {mpmath.__version__}, and") as out:
    for n in (1, 2, 3, 10, 65):
        x = samples(rng, n, float)
        initial, final, dt = rng.uniform(-1, 1), rng.uniform(-1, 1), rng.uniform(0.01, 2)
        f = neighbours(x, initial, final)
        step = Fraction(float(dt))
        derivative = [float((f[i + 2] - f[i]) / (2 * step)) for i in range(n)]
        assert np.allclose(derivative, np.gradient(np.r_[initial, x, final], dt)[1:-1], rtol=0, atol=1e-12)
        terms = [(f[i] + 4 * f[i + 1] + f[i + 2]) * step / 6 for i in range(n)]
        integral = [float(sum(terms[: i + 1])) for i in range(n)]
        out.put(f"calculus{n}.x", x)
        out.put(f"calculus{n}.ends", (initial, final, dt))
        out.put(f"calculus{n}.derivative", derivative)
        out.put(f"calculus{n}.integral", integral)

    for n, largest in ((2, 10), (40, 3), (40, 40)):
        x = np.cumsum(rng.uniform(-largest, largest, n))
        out.put(f"phase{n}_{largest}.x", x)
        out.put(f"phase{n}_{largest}.unwrapped", np.unwrap(x))

    for k, (n, c, f) in enumerate(((1, 1.0, 0.1), (60, 1.0, 0.03), (60, 2.5, 0.21), (60, 0.125, 0.4))):
        x = 0.2 * samples(rng, n, float)
        phase = rng.uniform(0, 1)
        two_pi = 2 * mpmath.pi
        start = mpmath.mpf(float(phase))
        angles = [start + two_pi * sum(mpmath.mpf(f) + mpmath.mpf(float(v)) for v in x[: i + 1]) for i in range(n)]
        out.put(f"carrier{k}.x", x)
        out.put(f"carrier{k}.parameters", (c, f, phase))
        out.put(f"carrier{k}.frequency", [mpmath.sin(c * a) for a in angles])
        degrees = [mpmath.radians(mpmath.mpf(float(v) * 100)) for v in x]
        angles = [start + two_pi * mpmath.mpf(f) * (i + 1) for i in range(n)]
        out.put(f"carrier{k}.phase", [mpmath.sin(c * a + d) for a, d in zip(angles, degrees)])

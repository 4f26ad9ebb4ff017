"""What is known about every special function: how to call it, its true value, and the regions of its arguments.

A region is where one branch of the method is at work, or where the function is hard. The golden data of the tests
(make_golden.py) takes a few arguments of each, the accuracy report (tools/accuracy) many. Both always take the edges:
the ends of the branches from both sides, and whatever a region is about.
"""

import math
import random
from dataclasses import dataclass, field
from typing import Callable

import mpmath

DIGITS = 40
NAN = math.nan


@dataclass
class Region:
    name: str  # as the tests know it
    draw: Callable  # of a random.Random: one tuple of arguments, or one argument
    edges: list = field(default_factory=list)
    in_golden: bool = True  # False where no digit is promised
    note: str = ""  # why the method is not accurate here

    def arguments(self, count, key):
        rng = random.Random(f"{key}/{self.name}")
        drawn = [self.draw(rng) for _ in range(max(0, count - len(self.edges)))] if self.draw else []
        return sorted({a if isinstance(a, tuple) else (a,) for a in list(self.edges) + drawn})


@dataclass
class Function:
    name: str  # of the golden data
    title: str  # in formulas
    export: str
    types: str  # of the arguments in C: d double, i int32
    true: Callable  # mpmath, of the arguments of a region
    regions: list
    pack: Callable = lambda *arguments: arguments  # from those to the arguments in C
    outputs: int = 1
    output: int = 0  # the one looked at
    digits: int = DIGITS

    def value(self, arguments):
        """The true value at exactly these doubles, as an mpf; None where it is not real and finite."""
        with mpmath.workdps(self.digits):
            value = self.true(*(mpmath.mpf(a) if isinstance(a, float) else a for a in arguments))
            value = mpmath.mpmathify(value)
            if isinstance(value, mpmath.mpc):
                value = value.real
            return +value if mpmath.isfinite(value) else None


def around(*points):
    """Each point and the doubles beside it."""
    return [y for x in points for y in (math.nextafter(x, -math.inf), float(x), math.nextafter(x, math.inf))]


def uniform(low, high):
    return lambda rng: rng.uniform(low, high)


def log_uniform(low, high, sign=1.0):
    return lambda rng: sign * math.exp(rng.uniform(math.log(low), math.log(high)))


def integer(low, high):
    return lambda rng: rng.randint(low, high)


def near_integer(low, high, nearest=1e-13, farthest=1e-3):
    """An integer plus or minus something between two distances."""
    distance = log_uniform(nearest, farthest)
    return lambda rng: rng.randint(low, high) + rng.choice((-1, 1)) * distance(rng)


def every(*draws):
    """One of each."""
    return lambda rng: tuple(draw(rng) for draw in draws)


def functions():
    from . import bessel, elliptic, gamma, hypergeometric, integrals

    return [f for family in (gamma, bessel, integrals, elliptic, hypergeometric) for f in family.FUNCTIONS]

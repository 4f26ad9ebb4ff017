"""Measures the library against the true values of the catalogue."""

import ctypes
import math
import pathlib
import sys
from dataclasses import dataclass

import mpmath

ROOT = pathlib.Path(__file__).resolve().parents[2]
sys.path.insert(0, str(ROOT / "tests" / "reference" / "special"))
import catalogue  # noqa: E402

TYPES = {"d": ctypes.c_double, "i": ctypes.c_int32}


@dataclass
class Point:
    arguments: tuple
    true: mpmath.mpf
    computed: float

    @property
    def absolute(self):
        return float(abs(mpmath.mpf(self.computed) - self.true)) if math.isfinite(self.computed) else math.inf

    @property
    def relative(self):
        """Infinite where the true value is 0 and the computed one is not."""
        if self.computed == self.true:
            return 0.0
        return float(self.absolute / abs(self.true)) if self.true else math.inf

    @property
    def ulps(self):
        """Of the double nearest to the true value."""
        return self.absolute / math.ulp(float(self.true))


class Library:
    def __init__(self, path):
        self.library = ctypes.CDLL(str(path))

    def call(self, function, arguments):
        out = (ctypes.c_double * function.outputs)()
        packed = [TYPES[t](a) for t, a in zip(function.types, function.pack(*arguments), strict=True)]
        targets = [ctypes.byref(out, 8 * i) for i in range(function.outputs)]
        getattr(self.library, function.export)(*packed, *targets)
        return out[function.output]


def measure(library, function, region, count):
    """All arguments of the region whose true value a double holds to full precision, with what comes out."""
    points = []
    for arguments in region.arguments(count, function.name):
        true = function.value(arguments)
        if true is not None and (true == 0 or 2.3e-308 < abs(true) < 1.7e308):
            points.append(Point(arguments, true, library.call(function, arguments)))
    return points

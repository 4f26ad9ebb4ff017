"""Writes golden signals: a name and its numbers in a line, complex ones as pairs, with all the digits of a double."""

import pathlib

import numpy as np
import scipy


class Writer:
    def __init__(self, name, script):
        self.path = pathlib.Path(__file__).parent / f"{name}.txt"
        self.lines = [f"# Made by {script} with NumPy {np.__version__} and SciPy {scipy.__version__}."]

    def __enter__(self):
        return self

    def __exit__(self, kind, *_):
        if kind is None:
            self.path.write_text("\n".join(self.lines) + "\n")

    def put(self, name, values):
        values = np.asarray(values).ravel()
        if np.iscomplexobj(values):
            values = values.astype(complex).view(float)
        self.lines.append(" ".join([name, *(repr(float(v)) for v in values)]))


def samples(rng, shape, kind):
    x = rng.uniform(-1, 1, shape)
    return x + 1j * rng.uniform(-1, 1, shape) if kind is complex else x

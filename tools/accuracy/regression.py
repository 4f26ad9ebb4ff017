#!/usr/bin/python3
"""Writes the part of docs/accuracy.md on fits of published regression problems, and its picture.

    regression.py [--build build/release]

The problems are those of NIST's Statistical Reference Datasets in tests/reference/fit/nist, the coefficients certified
to 11 or 15 digits. NumPy solves the linear ones beside the library.
"""

import argparse
import csv
import ctypes
import math
import pathlib
from dataclasses import dataclass

import matplotlib

matplotlib.use("Agg")
import matplotlib.pyplot as plt  # noqa: E402
import numpy as np  # noqa: E402

import host  # noqa: E402
import page  # noqa: E402

PROBLEMS = page.ROOT / "tests" / "reference" / "fit" / "nist"

# Order of the polynomial, or what the columns are besides the given ones.
LINEAR = {"Norris": 1, "Pontius": 2, "NoInt1": "as given", "NoInt2": "as given", "Filip": 10, "Longley": "constant",
          "Wampler1": 5, "Wampler2": 5, "Wampler3": 5, "Wampler4": 5, "Wampler5": 5}
METHODS = {0: "SVD", 1: "QR", 4: "LU", 5: "Cholesky", 6: "truncated SVD"}
REFUSALS = {-20041: "singular", -20071: "not positive definite"}

INTRODUCTION = """\
## Regression

Correct digits, that is the negative decimal logarithm of the relative error of the worst coefficient (at most 15), on
the regression problems of NIST's Statistical Reference Datasets. *Condition* is that of the matrix of observations: a
stable method is sure of 16 minus its logarithm while the residuals are small, the normal equations (LU, Cholesky) of 16
minus twice that; columns of different size count as condition, but do no harm. `tools/accuracy/regression.py` writes
all of this anew.

### General linear least squares · `GenLSFit_head`

Polynomials have the columns 1, x, x², …; `PolyFit_head` builds the same. QR are the methods 1 to 3. NumPy's `lstsq`
(LAPACK's divide and conquer SVD) has the same matrix.
"""

LINEAR_NOTES = """\
- Methods that look at the diagonal refuse what they cannot trust: Cholesky the problems whose smallest pivot is lost
  against the largest.
- The truncated SVD drops the last singular value of Filip as noise. Its fit is another one, with a residual sum of
  squares of 0.00107 in place of 0.000796.
- The SVD (G. H. Golub and C. Reinsch, Numer. Math. 14, 403, 1970) knows all singular values to rounding at the largest.
  Where columns differ by many orders of magnitude, as powers do, QR keeps more.

![Correct digits of the methods](accuracy/regression.png)
"""

DEVIATIONS = """\
### Standard deviations of the coefficients · the covariance of `GenLSFit_head`

The square roots of the covariance's diagonal times the certified residual variance. QR, LU and Cholesky take the
covariance from the normal equations and drop singular values below rounding there: beyond a condition of about 10⁸
nothing is left of the smallest. Problems without residuals have no deviations.
"""

NONLINEAR = """\
### Curves · `PowerFit_head`, `GaussianPeakFit_head`

*Steps* is what comes back in `iter`. The power curve is iterated by Gauss-Newton steps, the Gaussian by steps along the
gradient, whose tolerance decides how far they go.
"""


@dataclass
class Problem:
    coef: np.ndarray
    deviations: np.ndarray
    rss: float
    y: np.ndarray
    x: np.ndarray  # one column after the other


def load(name):
    certified, rows = {}, []
    for cells in csv.reader(line for line in open(PROBLEMS / f"{name}.csv") if not line.startswith("#")):
        if cells[0].isalpha():
            certified[cells[0]] = np.array(cells[1:], float)
        else:
            rows.append([float(cell) for cell in cells])
    data = np.array(rows).T
    return Problem(certified["coef"], certified["sd"], certified["rss"][0], data[0], data[1:])


def matrix(problem, columns):
    if isinstance(columns, int):
        # As PolyFit_head has it: each power is the one before times x.
        powers = [np.ones_like(problem.y)]
        for _ in range(columns):
            powers.append(powers[-1] * problem.x[0])
        return np.array(powers).T
    constant = [np.ones_like(problem.y)] if columns == "constant" else []
    return np.array([*constant, *problem.x]).T


def digits(computed, certified):
    with np.errstate(divide="ignore", invalid="ignore"):
        error = np.where(certified == 0, np.abs(computed), np.abs(computed - certified) / np.abs(certified))
    worst = np.max(error)
    return 0.0 if not worst < 1 else 15.0 if worst < 1e-15 else -math.log10(worst)


class Fits(host.Library):
    def general(self, h, y, method):
        """Coefficients and covariance; or the status."""
        coef, fit, covariance, mse = self.array(), self.array(), self.array(np.empty((0, 0))), ctypes.c_double()
        status = self.exports.GenLSFit_head(self.array(h), self.array(y), self.array(), method, 1, coef, fit,
                                            covariance, ctypes.byref(mse))
        return (self.values(coef), self.values(covariance)) if status == 0 else status

    def curve(self, export, problem, tol, start):
        """Coefficients and steps from start values, or from its own where there are none."""
        coef, mse, steps = [ctypes.c_double() for _ in problem.coef], ctypes.c_double(), ctypes.c_int32(100000)
        status = getattr(self.exports, export)(
            self.array(problem.y), self.array(problem.x[0]), self.array(), ctypes.c_double(tol), self.array(start),
            *map(ctypes.byref, coef), ctypes.byref(mse), ctypes.byref(steps), ctypes.c_double(1e-30))
        assert status == 0, status
        return np.array([c.value for c in coef]), steps.value


def picture(conditions, reached):
    fig, axes = plt.subplots(figsize=(7.2, 4.4), dpi=80)
    names = list(reversed(reached))
    limits = [min(15.0, max(0.0, 16 - math.log10(conditions[name]))) for name in names]
    axes.barh(range(len(names)), limits, height=0.8, color="#e9ecef", label="16 − lg condition")
    for (method, title), marker in zip(METHODS.items(), "osD^x"):
        points = [(reached[name][method], y) for y, name in enumerate(names)
                  if not isinstance(reached[name][method], int)]
        axes.plot(*zip(*points), marker, label=title, markersize=6, markerfacecolor="none")
    axes.set_yticks(range(len(names)), names)
    axes.set_xlim(-0.3, 15.5)
    axes.set_xlabel("correct digits of the worst coefficient")
    axes.grid(axis="x", alpha=0.3)
    axes.legend(loc="center left", bbox_to_anchor=(1.0, 0.5), frameon=False)
    fig.savefig(page.PICTURES / "regression.png", bbox_inches="tight", metadata={"Software": None},
                pil_kwargs={"optimize": True})
    plt.close(fig)


def figure(value):
    return REFUSALS[value] if isinstance(value, int) else f"{value:.1f}"


def linear(library):
    conditions, reached, deviations, peers = {}, {}, {}, {}
    for name, columns in LINEAR.items():
        problem = load(name)
        h = matrix(problem, columns)
        conditions[name] = np.linalg.cond(h)
        peers[name] = digits(np.linalg.lstsq(h, problem.y, rcond=0)[0], problem.coef)
        reached[name], deviations[name] = {}, {}
        variance = problem.rss / (h.shape[0] - h.shape[1])
        for method in METHODS:
            solved = library.general(h, problem.y, method)
            if isinstance(solved, int):
                reached[name][method] = deviations[name][method] = solved
                continue
            reached[name][method] = digits(solved[0], problem.coef)
            if variance > 0:
                with np.errstate(invalid="ignore"):
                    deviations[name][method] = digits(np.sqrt(np.diag(solved[1]) * variance), problem.deviations)
    picture(conditions, reached)
    head = ["Problem", "Condition", *METHODS.values()]
    condition = {name: f"{value:.1e}".replace("e+0", "e").replace("e+", "e") for name, value in conditions.items()}
    coefficients = page.table([*head, "NumPy"], [[name, condition[name], *map(figure, reached[name].values()),
                                                  figure(peers[name])] for name in LINEAR])
    spread = page.table(head, [[name, condition[name], *map(figure, deviations[name].values())]
                               for name in LINEAR if len(deviations[name]) == len(METHODS) and load(name).rss > 0])
    return coefficients, spread


def nonlinear(library):
    cases = [("PowerFit_head", "DanWood", "own", ()), ("PowerFit_head", "DanWood", "1, 5", (1, 5)),
             ("PowerFit_head", "DanWood", "0.7, 4", (0.7, 4)), ("GaussianPeakFit_head", "Eckerle4", "own", ()),
             ("GaussianPeakFit_head", "Eckerle4", "0.3, 450, 5", (0.3, 450, 5))]
    rows = []
    for export, name, start, values in cases:
        problem = load(name)
        if name == "Eckerle4":
            # Its model divides by the width: a = b1 / b2, mu = b3, sigma = b2.
            b1, b2, b3 = problem.coef
            problem.coef = np.array([b1 / b2, b3, b2])
        for tol in (1e-4, 1e-14 if name == "DanWood" else 1e-12):
            coef, steps = library.curve(export, problem, tol, values)
            rows.append([f"{name} · `{export}`", start, f"{tol:.0e}".replace("e-0", "e-"),
                         figure(digits(coef, problem.coef)), str(steps)])
    return page.table(["Problem", "Start", "Tolerance", "Digits", "Steps"], rows)


def main():
    parser = argparse.ArgumentParser(description=__doc__, formatter_class=argparse.RawDescriptionHelpFormatter)
    parser.add_argument("--build", type=pathlib.Path, default=page.ROOT / "build" / "release")
    library = Fits(parser.parse_args().build)
    coefficients, deviations = linear(library)
    page.write("regression", "regression.py", "\n".join([
        INTRODUCTION, coefficients, LINEAR_NOTES, DEVIATIONS, deviations, NONLINEAR, nonlinear(library)]))


if __name__ == "__main__":
    main()

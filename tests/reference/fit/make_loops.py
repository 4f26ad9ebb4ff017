"""Makes loops.csv: where iterated and robust fits of curves.csv end, and after how many steps.

The rules of the loops are written out with NumPy's operations, each linear problem by its lstsq or pinv. A row is
named after the way, the model, the weights, the tolerance (0: the default) and the budget; it holds the coefficients,
the mean square error or the residue, and the steps. Rows whose steps depend on the last digits of the data are left
out.
"""
import csv
import itertools
import pathlib

import numpy as np

HERE = pathlib.Path(__file__).parent
REFERENCE = {row[0]: np.array(row[1:], float) for row in csv.reader(open(HERE / "curves.csv"))}
FLOOR = 1e-12  # of mean square errors


class Line:
    def value(self, p, x):
        return p[0] * x + p[1]

    def jacobian(self, p, x):
        return np.array([x, np.ones_like(x)]).T

    def fit(self, x, y, w, *_):
        root = np.sqrt(np.abs(w))
        p = np.linalg.lstsq(self.jacobian(None, x) * root[:, None], y * root, rcond=None)[0]
        return p, mean_square(self, p, x, y, w), 0


class Log(Line):
    def value(self, p, x):
        return p[0] * np.log10(p[1] * x)

    def jacobian(self, p, x):
        return np.array([np.log10(p[1] * x), np.full_like(x, p[0] / (p[1] * np.log(10.0)))]).T

    def fit(self, x, y, w, *_):
        a, c = Line().fit(np.log10(x), y, w)[0]
        p = np.array([a, 10 ** (c / a)])
        return p, mean_square(self, p, x, y, w), 0


class Exponential:
    def value(self, p, x):
        return p[0] * np.exp(p[1] * x)

    def jacobian(self, p, x):
        return np.array([np.exp(p[1] * x), p[0] * x * np.exp(p[1] * x)]).T

    abscissa = staticmethod(lambda x: x)

    def fit(self, x, y, w, tol, budget, start=None):
        if start is None:
            kept = y > 0  # of these data most are
            b, c = Line().fit(self.abscissa(x[kept]), np.log(y[kept]), w[kept] * y[kept] ** 2)[0]
            start = np.array([np.exp(c), b])
        p = start
        error = mean_square(self, p, x, y, w)
        best, previous, steps = (p, error), 2 * error, 0
        while steps <= budget and abs(previous - error) > previous * tol and error > FLOOR:
            previous = error
            root = np.sqrt(np.abs(w))
            p = p + np.linalg.lstsq(self.jacobian(p, x) * root[:, None], (y - self.value(p, x)) * root, rcond=None)[0]
            error = mean_square(self, p, x, y, w)
            steps += 1
            if not np.isfinite(error) or (steps > budget // 10 and error > previous and error > best[1]):
                break
            if error < best[1]:
                best = (p, error)
        return *best, steps


class Power(Exponential):
    def value(self, p, x):
        return p[0] * x ** p[1]

    def jacobian(self, p, x):
        return np.array([x ** p[1], p[0] * x ** p[1] * np.log(x)]).T

    abscissa = staticmethod(np.log)


class Gaussian:
    def value(self, p, x):
        return p[0] * np.exp(-0.5 * ((x - p[1]) / p[2]) ** 2)

    def jacobian(self, p, x):
        z = (x - p[1]) / p[2]
        e = np.exp(-0.5 * z**2)
        return np.array([e, p[0] * e * z / p[2], p[0] * e * z**2 / p[2]]).T

    def fit(self, x, y, w, tol, budget, start=None):
        if start is None:
            peak = np.argmax(np.abs(y))
            high = np.abs(y) > 0.1 * np.abs(y[peak])
            width = np.sum((x[high] - x[peak]) ** 2) / np.sum(np.log((y[peak] / y[high]) ** 2))
            start = np.array([y[peak], x[peak], np.sqrt(width)])
        p = start
        error = start_error = mean_square(self, p, x, y, w)
        previous, length, steps, moved = error + 1, 1.0, 0, True
        while steps <= budget and abs(previous - error) > previous * tol and error > FLOOR:
            if moved:
                previous = error
                gradient = self.jacobian(p, x).T @ ((y - self.value(p, x)) * np.abs(w))
            candidate = p + length * gradient
            error = mean_square(self, candidate, x, y, w)
            moved = not error > previous
            if moved:
                p = candidate
            else:
                length /= 2
            steps += 1
        if start_error <= error and start_error <= previous:
            p, error = start, start_error
        return np.array([p[0], p[1], abs(p[2])]), error, steps  # the error is that of the last candidate


def mean_square(model, p, x, y, w):
    return np.mean(np.abs(w) * (model.value(p, x) - y) ** 2)


def bisquare(model, x, y, w, tol, budget):
    first, later, later_tol = (500, 300, 1e-8) if isinstance(model, Gaussian) else (100, 50, 1e-4)
    p = model.fit(x, y, w, 1e-4, first)[0]
    steps, before = 0, p
    while steps == 0 or (steps < budget and np.all(np.abs(before) * tol < np.abs(before - p))):
        before = p
        j = model.jacobian(p, x)
        leverage = w * np.einsum("ij,jk,ik->i", j, np.linalg.pinv(j.T @ (w[:, None] * j)), j)
        r = (y - model.value(p, x)) * np.sqrt(w * np.where(leverage <= 0.9999, 1 / (1 - leverage), 10000.0000000011))
        deviations = np.abs(r - np.median(r))
        if np.max(deviations) <= abs(np.median(r)):
            deviations = np.abs(r)
        u = 0.6745 * r / (4.685 * np.median(deviations))
        p = model.fit(x, y, w * np.where(np.abs(u) < 1, (1 - u**2) ** 2, 0), later_tol, later)[0]
        steps += 1
    return p, mean_square(model, p, x, y, w), steps


def best_of(records):
    """The least residue, the first among equals."""
    return min(records, key=lambda record: record[1])


def absolute(model, x, y, w, tol, budget):
    def residue(p):
        return np.mean(np.abs((y - model.value(p, x)) * w))

    wide = isinstance(model, Gaussian)
    p = model.fit(x, y, w, tol, 10 * budget if wide else budget)[0]
    least = np.mean(np.abs((y - p[0] * np.exp(-((x - p[1]) / p[2]) ** 2)) * w)) if wide else residue(p)
    preliminary, steps = (p, least), 0
    before = (p + 100000, 2 * least)
    now = (p, least)
    while steps < budget and abs(before[1] - now[1]) > before[1] * tol and now[1] > FLOOR and before[1] > now[1]:
        before = now
        far = np.abs(y - model.value(now[0], x))
        inverse = w / np.maximum(far, 0.01 * np.median(far))
        p = model.fit(x, y, inverse, tol, 5 * budget if wide else budget, now[0])[0]
        now = (p, residue(p))
        steps += 1
    return *best_of([preliminary, before, now]), steps


def absolute_line(model, x, y, w, tol, budget):
    def residue(p):
        return np.mean(np.abs((y - model.value(p, x)) * w))

    def median(values, weights):
        order = np.argsort(values)
        sums = np.cumsum(weights[order])
        return values[order][np.argmax(sums >= 0.5 * sums[-1])]

    p = model.fit(x, y, w)[0]
    preliminary = now = (p, residue(p))
    before, steps = (p + 100000, 2 * now[1]), 0
    while steps < budget and abs(before[1] - now[1]) > before[1] * tol and now[1] > FLOOR and before[1] > now[1]:
        before = now
        slope = median((y - now[0][1]) / x, np.abs(x * w))
        p = np.array([slope, median(y - slope * x, w)])
        now = (p, residue(p))
        steps += 1
    return *best_of([preliminary, before, now]), steps


MODELS = {"line": Line(), "exponential": Exponential(), "power": Power(), "log": Log(), "gaussian": Gaussian()}
rng = np.random.default_rng(7)
rows = []
for way, name, weighted, tol, budget in itertools.product(
        ("plain", "bisquare", "absolute"), MODELS, (False, True), (0.0, 1e-3, 1e-7), (0, 1, 3, 100)):
    model = MODELS[name]
    if way == "plain" and name in ("line", "log"):
        continue  # closed forms
    robust = bisquare if way == "bisquare" else absolute_line if name == "line" else absolute
    x, y = REFERENCE["x"], REFERENCE[name + (".y" if way == "plain" else ".spoiled")]
    w = REFERENCE["w"] if weighted else np.ones_like(x)

    def run(ordinates):
        arguments = x, ordinates, w, tol or 1e-4, budget
        return model.fit(*arguments) if way == "plain" else robust(model, *arguments)

    p, error, steps = run(y)
    moved = [run(y * (1 + 1e-13 * rng.standard_normal(len(y)))) for _ in range(5)]
    if all(m[2] == steps and np.allclose(m[0], p, rtol=1e-9) for m in moved):
        rows.append([f"{way}.{name}{'.weighted' if weighted else ''}", f"{tol:g}", budget,
                     *(f"{v:.12g}" for v in (*p, error)), steps])
with open(HERE / "loops.csv", "w", newline="") as out:
    csv.writer(out, lineterminator="\n").writerows(rows)

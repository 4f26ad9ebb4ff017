"""Makes curves.csv: data with the fits and bands of SciPy, a row of numbers for each name.

Plain fits are scipy.optimize.curve_fit with the tolerances at their least; those of least absolute residuals minimise
the sum by Nelder and Mead's simplex from several starts, or as a linear program for the line; bisquare fits repeat
curve_fit until nothing changes. Bands are made from the
Jacobian at the fit in the textbook way, with the quantile of scipy.stats.t.
"""
import csv
import pathlib

import numpy as np
from scipy import optimize, stats

rng = np.random.default_rng(20)
rows = {}


def put(name, values):
    rows[name] = [float(v) for v in np.ravel(values)]


def exponential(x, a, b):
    return a * np.exp(b * x)


def power(x, a, b):
    return a * x**b


def logarithmic(base):
    return lambda x, a, b: a * np.log(b * x) / np.log(base)


def gaussian(x, a, mu, sigma):
    return a * np.exp(-0.5 * ((x - mu) / sigma) ** 2)


def line(x, slope, intercept):
    return slope * x + intercept


def jacobian(model, x, p):
    """Central differences of high order."""
    columns = []
    for j in range(len(p)):
        h = 1e-3 * max(1.0, abs(p[j]))
        d = np.zeros(len(p))
        d[j] = h
        columns.append((8 * (model(x, *(p + d)) - model(x, *(p - d)))
                        - (model(x, *(p + 2 * d)) - model(x, *(p - 2 * d)))) / (12 * h))
    return np.array(columns).T


def bisquare(model, x, y, p, omega):
    for _ in range(500):
        j = jacobian(model, x, p)
        leverage = omega * np.einsum("ij,jk,ik->i", j, np.linalg.inv(j.T @ (omega[:, None] * j)), j)
        r = (y - model(x, *p)) * np.sqrt(omega / (1 - leverage))
        u = 0.6745 * r / (4.685 * np.median(np.abs(r - np.median(r))))
        factor = omega * np.where(np.abs(u) < 1, (1 - u**2) ** 2, 0)
        kept = factor > 0
        p, _ = optimize.curve_fit(model, x[kept], y[kept], p, sigma=1 / np.sqrt(factor[kept]), ftol=1e-15, xtol=1e-15,
                                  gtol=1e-15)
    return p


n = 14
x = np.linspace(0.5, 7, n)
w = np.round(rng.uniform(0.3, 3, n), 2)
put("x", x)
put("w", w)
CASES = [("line", line, (1.7, -2.0), 0.3), ("exponential", exponential, (2.5, 0.31), 0.4),
         ("power", power, (1.3, 1.6), 0.4), ("log", logarithmic(10.0), (3.0, 1.8), 0.1),
         ("gaussian", gaussian, (4.0, 3.2, 1.1), 0.15)]
for name, model, truth, noise in CASES:
    y = np.round(model(x, *truth) + noise * rng.standard_normal(n), 3)
    put(f"{name}.y", y)
    for suffix, weights in (("", None), (".weighted", w)):
        sigma = None if weights is None else 1 / np.sqrt(weights)
        p, _ = optimize.curve_fit(model, x, y, truth, sigma=sigma, ftol=1e-15, xtol=1e-15, gtol=1e-15)
        put(f"{name}{suffix}.coef", p)
        omega = np.ones(n) if weights is None else weights
        put(f"{name}{suffix}.mse", np.sum(omega * (y - model(x, *p)) ** 2) / n)

        j = jacobian(model, x, p)
        covariance = np.linalg.inv(j.T @ (omega[:, None] * j))
        freedom = n - len(p)
        variance = np.sum(omega * (y - model(x, *p)) ** 2) / freedom
        t = stats.t.ppf(0.975, freedom)
        spread = np.einsum("ij,jk,ik->i", j, covariance, j)
        put(f"{name}{suffix}.confidence", t * np.sqrt(spread * variance))
        put(f"{name}{suffix}.prediction", t * np.sqrt((spread + 1 / omega) * variance))
        put(f"{name}{suffix}.deltas", t * np.sqrt(np.diag(covariance) * variance))

    # Every fifth ordinate is far off; within the peak of the Gaussian, whose fits start from the largest one.
    spoiled = y.copy()
    spoiled[2::5] += np.array([1.5, -1.2, 1.8] if name == "gaussian" else [6.0, -7.0, 8.0])
    put(f"{name}.spoiled", spoiled)
    for suffix, weights in (("", None), (".weighted", w)):
        omega = np.ones(n) if weights is None else weights
        p, _ = optimize.curve_fit(model, x, spoiled, truth, sigma=1 / np.sqrt(omega))
        put(f"{name}{suffix}.bisquare", bisquare(model, x, spoiled, p, omega))
    if name == "line":
        a_eq = np.hstack([x[:, None], np.ones((n, 1)), np.eye(n), -np.eye(n)])
        cost = np.concatenate([np.zeros(2), np.ones(2 * n)])
        bounds = [(None, None)] * 2 + [(0, None)] * (2 * n)
        best = optimize.linprog(cost, A_eq=a_eq, b_eq=spoiled, bounds=bounds)
        put("line.lar", [*best.x[:2], best.fun / n])
    else:
        def total(p):
            r = np.abs(spoiled - model(x, *p))
            return np.mean(r) if np.all(np.isfinite(r)) else 1e300

        with np.errstate(all="ignore"):
            found = [optimize.minimize(total, np.array(truth) * s, method="Nelder-Mead",
                                       options={"xatol": 1e-12, "fatol": 1e-14, "maxiter": 20000, "maxfev": 20000})
                     for s in (0.9, 1.0, 1.1)]
        best = min(found, key=lambda f: f.fun)
        put(f"{name}.lar", [*best.x, best.fun])

with open(pathlib.Path(__file__).parent / "curves.csv", "w", newline="") as out:
    writer = csv.writer(out, lineterminator="\n")
    for name, values in rows.items():
        writer.writerow([name] + [f"{v:.16g}" for v in values])

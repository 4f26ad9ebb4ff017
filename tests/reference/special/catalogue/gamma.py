"""Gamma family: Gamma, ln Gamma, beta, their incomplete forms, factorials and psi."""

import math

import mpmath as mp

from . import NAN, Function, Region, around, every, integer, log_uniform, near_integer, uniform


def scaled(shape, ratio):
    """a, and x as a multiple of a."""

    def draw(rng):
        a = shape(rng)
        return a, a * ratio(rng)

    return draw


def deviating(shape, deviations):
    """a, and x that many times sqrt(a) away."""

    def draw(rng):
        a = shape(rng)
        return a, max(1e-3 * a, a + deviations(rng) * math.sqrt(a))

    return draw


# B(a, b) and x at so many standard deviations from the mean.
def beta_point(shape, deviations):
    def draw(rng):
        a, b = shape(rng), shape(rng)
        spread = math.sqrt(a * b / (a + b + 1.0)) / (a + b)
        x = a / (a + b) + deviations(rng) * spread
        return a, b, min(max(x, 1e-9), 1.0 - 1e-9)

    return draw


def lower(a, x):
    return mp.gammainc(a, 0, x, regularized=True)


def upper(a, x):
    return mp.gammainc(a, x, mp.inf, regularized=True)


def incomplete_beta(a, b, x):
    """By the hypergeometric series whose terms are all positive, on the side where they fall at once."""
    if x > a / (a + b):
        return 1 - incomplete_beta(b, a, 1 - x)
    sum = term = mp.mpf(1)
    n = 0
    while term > sum * mp.eps:
        term *= (a + b + n) / (a + 1 + n) * x
        sum += term
        n += 1
    return x**a * (1 - x) ** b / (a * mp.beta(a, b)) * sum


INCOMPLETE = [
    Region("small a", every(log_uniform(1e-10, 1.0), log_uniform(1e-10, 20.0)), [(1.0, 1.0), (0.5, 1.0)],
           note="Q is 1 − P, absolutely accurate"),
    Region("moderate", scaled(log_uniform(1.0, 100.0), log_uniform(0.05, 5.0)), [(2.5, 1.0), (2.5, 6.0)]),
    Region("x near a", deviating(log_uniform(1.0, 1e4), uniform(-4.0, 4.0)),
           note="a difference of large logarithms",
           edges=[(a, x) for a in (1.0, 2.5, 10.0, 1000.0) for x in around(a)]),
    Region("large a", deviating(log_uniform(1e4, 1e6), uniform(-4.0, 4.0)), note="the same"),
]

FUNCTIONS = [
    Function("gamma", "Γ(a)", "KR_Gamma", "dd", mp.gamma, pack=lambda a: (a, NAN), regions=[
        Region("2 to 3", uniform(2.0, 3.0), around(2.0, 3.0)),
        Region("3 to 33", uniform(3.0, 33.0), around(33.0) + [float(n) for n in range(4, 33)]),
        Region("33 to 171", uniform(33.0, 171.6), around(143.01608) + [math.nextafter(33.0, 34.0), 171.6]),
        Region("0 to 2", log_uniform(1e-307, 2.0), around(1.0, 1e-9) + [0.5]),
        Region("-33 to 0", uniform(-33.0, 0.0), [-0.5, -32.5] + around(-33.0 + 1e-9)),
        Region("near poles", near_integer(-32, 0)),
        Region("-170 to -33", uniform(-170.0, -33.0), [-33.5, -34.5, -100.5, math.nextafter(-33.0, -34.0)]),
        Region("near poles, below -33", near_integer(-165, -34, 1e-9)),
    ]),
    Function("ln_gamma", "ln Γ(x)", "KR_LnGamma", "d", mp.loggamma, regions=[
        Region("0 to 1", log_uniform(1e-307, 1.0)),
        Region("near 1 and 2", near_integer(1, 2, 1e-12, 0.3), around(1.0, 2.0)),
        Region("3 to 33", uniform(3.0, 33.0), around(3.0)),
        Region("33 to 1000", log_uniform(33.0, 1000.0), around(33.0)),
        Region("above 1000", log_uniform(1000.0, 1e305), around(1000.0)),
    ]),
    Function("psi", "ψ(x)", "KR_Psi", "d", lambda x: mp.psi(0, x), regions=[
        Region("0 to 1", log_uniform(1e-300, 1.0)),
        Region("1 to 10", uniform(1.0, 10.0), around(1.4616321449683622, 10.0) + [float(n) for n in range(1, 11)]),
        Region("above 10", log_uniform(10.0, 1e300), around(1e9)),
        Region("-30 to 0", uniform(-30.0, 0.0), [n - 0.5 for n in range(-29, 1)],
               note="the tangent of πx is taken without reduction"),
        Region("near poles", near_integer(-30, -1, 1e-6), note="the same"),
        Region("just below 0", log_uniform(1e-12, 1e-3, -1.0), note="1 − x rounds x away"),
        Region("far below 0", log_uniform(100.0, 1e4, -1.0), note="the tangent without reduction"),
    ]),
    Function("stirling", "Stirling's Γ(x)", "KR_Stirling", "d", mp.gamma, regions=[
        Region("33 to 171", uniform(33.0, 171.6), around(143.01608)),
        Region("10 to 33", uniform(10.0, 33.0), note="the approximation itself"),
        Region("1 to 10", uniform(1.0, 10.0), [1.2], note="the approximation itself"),
    ]),
    Function("beta", "B(a, b)", "KR_Beta", "ddd", mp.beta, pack=lambda a, b: (a, b, NAN), regions=[
        Region("moderate", every(log_uniform(0.1, 100.0), log_uniform(0.1, 100.0))),
        Region("small", every(log_uniform(1e-150, 1.0), log_uniform(1e-150, 1.0))),
        Region("large", every(log_uniform(100.0, 1e6), log_uniform(0.1, 20.0)), note="a difference of large ln Γ"),
        Region("negative a", every(uniform(-30.0, 0.0), uniform(31.0, 60.0))),
        Region("negative a + b", every(uniform(-30.0, -10.0), uniform(0.0, 9.0))),
    ]),
    Function("factorial", "n!", "KR_Fact", "i", mp.factorial, regions=[
        Region("table", None, list(range(34))),
        Region("product", None, list(range(34, 51))),
        Region("gamma", None, list(range(51, 171))),
    ]),
    Function("ln_factorial", "ln n!", "KR_LnFact", "i", lambda n: mp.loggamma(n + 1), regions=[
        Region("to 32", None, list(range(33))),
        Region("to 1000", integer(33, 1000), [998, 999, 1000]),
        Region("large", lambda rng: int(log_uniform(1000.0, 2147483647.0)(rng)), [2147483647]),
    ]),
    Function("lower_gamma", "P(a, x)", "KR_Gamma", "dd", lower, INCOMPLETE + [
        Region("lower tail", scaled(log_uniform(1.0, 100.0), log_uniform(1e-3, 0.3))),
    ]),
    Function("upper_gamma", "Q(a, x)", "KR_GammaC", "dd", upper, INCOMPLETE + [
        Region("upper tail", scaled(log_uniform(1.0, 100.0), log_uniform(2.0, 6.0))),
    ]),
    Function("incomplete_beta", "I_x(a, b)", "KR_Beta", "ddd", incomplete_beta, regions=[
        Region("a = 1", every(lambda rng: 1.0, log_uniform(1e-3, 50.0), uniform(0.0, 1.0)),
               [(1.0, 3.637978807091712e-13, 0.5), (1.0, 4e-13, 0.5), (1.0, 1.0, 0.3)],
               note="1 − (1 − x)ᵇ cancels for small b"),
        Region("0.1 to 300", every(log_uniform(0.1, 300.0), log_uniform(0.1, 300.0), uniform(0.0, 1.0)),
               [(5.0, 50.0, 0.08), (2.0, 3.0, 0.4), (0.5, 0.5, 0.5)]),
        Region("near the mean", beta_point(log_uniform(0.5, 1000.0), uniform(-4.0, 4.0)),
               [(a, b, x) for a, b in ((2.0, 3.0), (10.0, 10.0), (30.0, 2.5)) for x in around(a / (a + b))]),
        Region("half-integers", every(lambda rng: rng.randint(1, 60) / 2, lambda rng: rng.randint(1, 60) / 2,
                                      uniform(0.0, 1.0))),
        Region("small b", every(log_uniform(1.0, 200.0), log_uniform(1e-3, 0.1), uniform(0.9, 1.0)),
               [(200.0, 0.1, 0.999)], note="100 passes of the fraction are not enough"),
        Region("1000 to 10000", beta_point(log_uniform(1e3, 1e4), uniform(-4.0, 4.0)),
               note="a difference of large logarithms"),
    ]),
]

"""Hypergeometric functions of Gauss, Kummer and Tricomi, and the parabolic cylinder function."""

import math

import mpmath as mp

from . import Function, Region, every, integer, log_uniform, near_integer, uniform


def fixed(value):
    return lambda rng: value


def gauss_arguments(a, b, d, x):
    """Drawn by d = c - a - b."""

    def draw(rng):
        p, q = a(rng), b(rng)
        return p, q, p + q + d(rng), x(rng)

    return draw


def eighths(low, high):
    """So that sums of parameters are exact."""
    return lambda rng: rng.randint(8 * low, 8 * high) / 8.0 + 1 / 32.0


def positive_c(region):
    """Without the poles of c."""
    draw = region.draw

    def redraw(rng):
        while True:
            arguments = draw(rng)
            if arguments[2] > 0.05:
                return arguments

    region.draw = redraw
    return region


GAUSS = [
    Region("series", every(uniform(-5.0, 5.0), uniform(-5.0, 5.0), uniform(0.1, 10.0), uniform(-0.5, 0.9)),
           [(0.5, 1.0, 1.5, 0.25)]),
    Region("x below -0.5", every(uniform(-3.0, 5.0), uniform(-3.0, 5.0), uniform(0.1, 10.0), uniform(-1.0, -0.5)),
           [(0.5, 1.0, 1.5, -0.8)]),
    positive_c(Region("0.9 to 1", gauss_arguments(uniform(0.1, 4.0), uniform(0.1, 4.0), uniform(0.05, 3.0),
                                                  uniform(0.9, 1.0)), [(1.3, 0.7, 2.6, 0.95), (1.3, 0.7, 2.6, 0.999)])),
    positive_c(Region("0.9 to 1, d an integer", gauss_arguments(eighths(0, 4), eighths(0, 4), integer(0, 4),
                                                                uniform(0.9, 1.0)), [(1.3, 0.7, 4.0, 0.95)])),
    positive_c(Region("0.9 to 1, d a negative integer", gauss_arguments(eighths(0, 4), eighths(0, 4), integer(-3, -1),
                                                                        uniform(0.9, 1.0)))),
    positive_c(Region("0.9 to 1, d near an integer", gauss_arguments(
        uniform(0.1, 4.0), uniform(0.1, 4.0), near_integer(0, 3, 1e-12, 1e-3), uniform(0.9, 1.0)), in_golden=False,
        note="two solutions cancel, or stand for those at the integer")),
    positive_c(Region("d below 0", gauss_arguments(uniform(0.1, 5.0), uniform(0.1, 5.0), uniform(-5.0, 0.0),
                                                   uniform(-0.5, 0.999)))),
    Region("polynomial", every(integer(-8, 0), uniform(-5.0, 5.0), uniform(0.1, 10.0), uniform(-3.0, 3.0)),
           [(-2, 1.5, 0.5, 2.0), (-3, 1.5, 0.5, -7.0), (-2, -5.5, 0.5, -10.0)]),
    Region("c - a a negative integer", gauss_arguments(uniform(0.5, 4.0), integer(-2, -1), fixed(0.75),
                                                       uniform(-0.5, 0.999))),
    positive_c(Region("at 1", gauss_arguments(uniform(0.1, 4.0), uniform(0.1, 4.0), uniform(0.5, 3.0), fixed(1.0)))),
    Region("large parameters", every(uniform(5.0, 30.0), uniform(5.0, 30.0), uniform(5.0, 30.0), uniform(-0.5, 0.8))),
]


def parameters(a, b, x):
    return every(uniform(*a), uniform(*b), x)


KUMMER = [
    Region("0 to 12", parameters((-4.0, 6.0), (0.1, 8.0), uniform(0.0, 12.0)), [(1.5, 2.5, 3.0)]),
    Region("-12 to 0", parameters((-4.0, 6.0), (0.1, 8.0), uniform(-12.0, 0.0)), note="the series cancels"),
    Region("12 to 30", parameters((-4.0, 6.0), (0.1, 8.0), uniform(12.0, 30.0))),
    Region("-30 to -12", parameters((0.5, 3.0), (0.5, 5.0), uniform(-30.0, -12.0)),
           [(1.5, 2.5, -15.0), (1.5, 2.5, -20.0), (1.5, 2.5, -29.9)], note="the series cancels"),
    Region("-300 to -30", parameters((0.5, 3.0), (0.5, 5.0), uniform(-300.0, -30.0)), [(1.5, 2.5, -40.0)]),
    Region("30 to 100", parameters((-4.0, 6.0), (0.1, 8.0), uniform(30.0, 100.0)), [(1.5, 2.5, 60.0)]),
    Region("100 to 600", parameters((0.1, 3.0), (0.1, 5.0), uniform(100.0, 600.0)),
           [(1.5, 2.5, x) for x in (120.0, 140.0, 200.0)]),
    Region("b near a", lambda rng: (lambda a: (a, a * (1.0 + rng.uniform(-1e-4, 1e-4)), rng.uniform(-12.0, 12.0)))
           (rng.uniform(0.5, 10.0))),
    Region("polynomial", every(integer(-10, 0), uniform(0.1, 8.0), uniform(-20.0, 20.0))),
    Region("negative b", parameters((0.5, 4.0), (-5.9, -5.1), uniform(-8.0, 8.0)), note="the series cancels"),
]

TRICOMI = [
    Region("to 6", every(uniform(0.1, 3.0), lambda rng: rng.randint(-2, 3) + rng.uniform(0.05, 0.95),
                         log_uniform(1e-3, 6.0)), [(0.7, 1.3, 2.0)], note="two series cancel"),
    Region("to 6, integer b", every(uniform(0.1, 3.0), lambda rng: float(rng.randint(-1, 3)), log_uniform(0.1, 6.0)),
           [(0.7, 1.0, 2.0)], note="the mean of the values on both sides"),
    Region("to 6, b near an integer", every(uniform(0.1, 3.0), lambda rng: rng.randint(0, 2) + rng.uniform(-5e-4, 5e-4),
                                            log_uniform(0.1, 6.0)), [(0.7, 1.0001, 2.0), (0.7, 2.0001, 2.0)],
           note="the value at the integer"),
    Region("to 6, polynomial", every(integer(-3, 0), uniform(0.1, 0.9), log_uniform(0.1, 6.0)), [(-1, 0.5, 2.0)]),
    Region("6 to 15", parameters((0.1, 1.0), (0.1, 1.0), uniform(6.0, 15.0)), note="only asymptotic"),
    Region("15 to 40", parameters((0.1, 2.0), (0.1, 2.0), uniform(15.0, 40.0)), [(0.5, 0.5, 20.0)],
           note="only asymptotic"),
    Region("above 40", parameters((0.1, 2.0), (0.1, 2.0), log_uniform(40.0, 1e10))),
]

def parabolic_cylinder(v, x):
    with mp.workdps(80 + int(x * x / 2)):
        y = x * x / 2
        even = mp.rgamma((1 - v) / 2) * mp.hyp1f1(-v / 2, mp.mpf(1) / 2, y, zeroprec=2000)
        odd = mp.rgamma(-v / 2) * mp.sqrt(2) * x * mp.hyp1f1((1 - v) / 2, mp.mpf(3) / 2, y, zeroprec=2000)
        return mp.sqrt(mp.pi) * mp.power(2, v / 2) * mp.exp(-y / 2) * (even - odd)


FUNCTIONS = [
    Function("gauss", "₂F₁(a, b; c; x)", "KR_Gauss", "dddd", mp.hyp2f1, GAUSS,
             pack=lambda a, b, c, x: (x, float(a), float(b), float(c))),
    Function("kummer", "M(a, b, x)", "KR_Kummer", "ddd", mp.hyp1f1, KUMMER, pack=lambda a, b, x: (x, float(a), b)),
    Function("tricomi", "U(a, b, x)", "KR_Tricomi", "ddd", mp.hyperu, TRICOMI, pack=lambda a, b, x: (x, float(a), b)),
    Function("parabolic_cylinder", "D_v(x)", "KR_ParabolicCylinder", "dd", parabolic_cylinder, pack=lambda v, x: (x, v),
             regions=[
        Region("-4 to 4", every(uniform(-5.0, 10.0), uniform(-4.0, 4.0)), [(0.5, 1.0), (-1.5, 1.0), (2.0, -2.0)],
               note="a short Stirling series for both solutions, 4e-9"),
        Region("integer v", every(lambda rng: float(rng.randint(0, 12)), uniform(-4.0, 4.0)), [(1.0, 0.0), (2.0, 1.0)],
               note="the same"),
        Region("large v", every(uniform(20.0, 150.0), uniform(-0.01, 0.01)), note="the same"),
        Region("negative v", every(uniform(-60.0, -5.0), uniform(-4.0, 0.5)), note="both solutions cancel"),
        Region("below -4", every(uniform(-5.0, 5.0), uniform(-15.0, -4.0)), note="the Stirling series"),
        Region("4 to 6", every(uniform(-3.0, 3.0), uniform(4.0, 6.0)), [(0.5, 4.0), (0.5, 6.0)],
               note="both solutions cancel"),
        Region("6 to 8", every(uniform(-3.0, 3.0), uniform(6.0, 8.0)), [(0.5, 8.0)], note="both solutions cancel"),
    ]),
]

"""Bessel functions of all kinds, Kelvin, Airy and Struve functions."""

import math

import mpmath as mp

from . import Function, Region, around, every, integer, log_uniform, near_integer, uniform


def order_and_argument(order, ratio):
    """v, and x as a multiple of v."""

    def draw(rng):
        v = order(rng)
        return v, v * ratio(rng)

    return draw


def fixed(value):
    return lambda rng: value


def as_float(draw):
    return lambda rng: float(draw(rng))


def first_kind(v, x):
    return mp.besselj(v, x, maxprec=100000)


def upward(function, sign):
    """An integer order by the recurrence from 0 and 1, which is stable for Y and K, with digits to spare."""

    def value(v, x):
        if v != int(v):
            return function(v, x)
        n = abs(int(v))
        with mp.workdps(60):
            before, after = function(0, x), function(1, x)
            for k in range(n):
                before, after = after, 2 * (k + 1) / x * after + sign * before
            return -before if v < 0 and sign < 0 and n % 2 else before

    return value


def half(kind):
    return lambda n, x: mp.sqrt(mp.pi / (2 * x)) * kind(n + mp.mpf(1) / 2, x)


def not_integer(low, high):
    return lambda rng: rng.randint(low, high - 1) + rng.uniform(0.01, 0.99)


def transition(low, high):
    """v, and x within 2 v^(1/3) of it."""

    def draw(rng):
        v = rng.uniform(low, high)
        return v, v + rng.uniform(-2.0, 2.0) * v ** (1 / 3)

    return draw


FIRST_KIND = [
    Region("v = 0", every(fixed(0.0), log_uniform(1e-6, 1e4)), [(0.0, x) for x in around(1e-5, 5.0)]),
    Region("v = 1", every(fixed(1.0), log_uniform(1e-6, 1e4)), [(1.0, x) for x in around(5.0)]),
    Region("integer v, x above v", every(as_float(integer(2, 60)), uniform(60.0, 1000.0)),
           [(3.0, 40.0), (3.0, 60.0), (10.0, 1000.0), (60.0, 60.1)]),
    Region("integer v, x below v", order_and_argument(as_float(integer(2, 60)), uniform(0.01, 1.0)),
           [(40.0, 1.0), (2.0, 1e-8), (50.0, 50.0), (150.0, 80.0), (2.0, 2.0), (1000.0, 990.0)]),
    Region("integer v, negative v or x", every(as_float(integer(-30, 30)), uniform(-50.0, 50.0))),
    Region("0 to 17", every(not_integer(0, 17), uniform(0.0, 60.0)),
           [(v, x) for v in (0.5, 2.25, 5.5) for x in around(12.9, 13.4, 22.3)], note="the series cancels up to 13"),
    Region("near an integer", every(near_integer(1, 16, 1e-12, 1e-4), uniform(0.5, 40.0))),
    Region("17 to 200", order_and_argument(not_integer(17, 200), uniform(0.3, 3.0)), [(50.5, 60.0)]),
    Region("17 to 200, small x", every(not_integer(17, 150), log_uniform(0.5, 13.0))),
    Region("17 to 200, large x", every(not_integer(17, 200), log_uniform(4000.0, 1e5))),
    Region("200 to 300", transition(200.0, 300.0), [(300.5, 250.0), (300.5, 300.0), (300.5, 400.0)],
           note="few terms of the uniform expansions"),
    Region("300 to 3000", order_and_argument(uniform(300.0, 3000.0), uniform(0.8, 2.0))),
    Region("300 to 3000, x near v", transition(300.0, 3000.0)),
    Region("negative v", every(not_integer(-60, 0), uniform(60.0, 400.0)), [(-2.25, 30.0)]),
    Region("negative v, small x", every(not_integer(-10, 0), uniform(0.5, 30.0))),
    Region("huge x", every(not_integer(0, 20), log_uniform(1e5, 1e8)), note="the phase loses digits"),
    Region("integer v, huge x", every(as_float(integer(0, 5)), log_uniform(1e4, 1e12)), in_golden=False,
           note="the phase loses digits"),
]

SECOND_KIND = [
    Region("v = 0", every(fixed(0.0), log_uniform(1e-300, 1e4)), [(0.0, x) for x in around(5.0)]),
    Region("v = 1", every(fixed(1.0), log_uniform(1e-300, 1e4)), [(1.0, x) for x in around(5.0)]),
    Region("integer v, x above v", every(as_float(integer(2, 60)), uniform(60.0, 1000.0))),
    Region("integer v, x below v", order_and_argument(as_float(integer(2, 60)), uniform(0.05, 1.0))),
    Region("negative integer v", every(as_float(integer(-20, -1)), uniform(20.0, 100.0))),
    Region("0 to 17", every(not_integer(0, 17), uniform(17.0, 60.0)), [(0.25, 3.0)]),
    Region("near an integer", every(near_integer(1, 16, 1e-7, 1e-4), uniform(17.0, 40.0)), note="a quotient near 0/0"),
    Region("negative v", every(not_integer(-60, 0), uniform(60.0, 400.0))),
]

KELVIN = [
    Region("to 10", every(integer(-5, 5), uniform(-10.0, 10.0)), [(0, 2.0), (3, 2.0), (0, 0.0), (2, 1e-4)]),
    Region("10 to 60", every(integer(0, 5), uniform(10.0, 60.0)), note="the series cancels"),
    Region("60 to 74", every(integer(0, 5), uniform(60.0, 74.0)), note="the series cancels"),
    Region("large n", every(integer(20, 60), uniform(1.0, 30.0)), note="small values end the series too early"),
]

KELVIN_SECOND = [
    Region("below 0.05", every(integer(-5, 5), log_uniform(1e-6, 0.05)), in_golden=False,
           note="factors that are 0 for even n are 1e-16"),
    Region("to 2", every(integer(-5, 5), log_uniform(0.05, 2.0)), [(n, 2.0) for n in range(-3, 6)]),
    Region("2 to 10", every(integer(0, 5), uniform(2.0, 10.0)), note="growing parts cancel"),
    Region("10 to 15", every(integer(0, 5), uniform(10.0, 15.0)), note="growing parts cancel"),
]

AIRY = [
    Region("-2.09 to 2.09", uniform(-2.09, 2.09), around(-2.09, 2.09) + [0.0, -1.0, 1.0]),
    Region("2.09 to 8.32", uniform(2.09, 8.3203353), around(8.3203353)),
    Region("8.32 to 103", uniform(8.33, 103.0), [10.0]),
    Region("-100 to -2.09", uniform(-100.0, -2.09), [-5.0]),
    Region("below -100", log_uniform(100.0, 1e5, -1.0), note="the phase loses digits"),
]

# The order of the outputs.
AIRY_OUTPUTS = [("ai", "Ai(x)", mp.airyai, 0), ("bi", "Bi(x)", mp.airybi, 0), ("ai_prime", "Ai'(x)", mp.airyai, 1),
                ("bi_prime", "Bi'(x)", mp.airybi, 1)]


def airy(i, name, title, function, derivative):
    return Function(f"airy_{name}", title, "KR_Airy", "d", lambda x: function(x, derivative=derivative), AIRY,
                    outputs=4, output=i)


def kelvin(i, name, kind, export, regions):
    return Function(f"kelvin_{name}", f"{name}ₙ(x)", export, "di", lambda n, x: kind(n, x), regions,
                    pack=lambda n, x: (x, n), outputs=2, output=i, digits=60)


FUNCTIONS = [
    Function("bessel_j", "J_v(x)", "KR_BesselJr", "dd", first_kind, FIRST_KIND),
    Function("bessel_y", "Y_v(x)", "KR_BesselYr", "dd", upward(mp.bessely, -1), SECOND_KIND),
    Function("spherical_j", "jₙ(x)", "KR_BesselJs", "id", half(mp.besselj), regions=[
        Region("n to 10", every(integer(0, 10), uniform(0.1, 60.0)), [(0, 1e-10), (0, 1.0), (5, 13.0)]),
        Region("n to 150", every(integer(10, 150), uniform(1.0, 300.0))),
        Region("negative n", every(integer(-10, -1), uniform(12.0, 60.0))),
    ]),
    Function("spherical_y", "yₙ(x)", "KR_BesselYs", "id", half(mp.bessely), regions=[
        Region("n to 10", every(integer(0, 10), uniform(12.0, 60.0)), [(0, 1.0)]),
        Region("n to 10, small x", every(integer(0, 10), uniform(0.1, 12.0))),
        Region("n to 150", lambda rng: (lambda n: (n, n + rng.uniform(0.0, 200.0)))(rng.randint(10, 150))),
    ]),
    Function("bessel_i", "I_v(x)", "KR_BesselIr", "dd", mp.besseli, regions=[
        Region("v = 0 and 1", every(as_float(integer(0, 1)), uniform(-700.0, 700.0)),
               [(v, x) for v in (0.0, 1.0) for x in (0.0, 1e-300, *around(8.0))]),
        Region("integer v, to 30", every(as_float(integer(-40, 40)), uniform(-30.0, 30.0)),
               [(2.0, 1e-19), (5.0, 1e-16), (2.0, 1e-3), (60.0, 0.5)]),
        Region("integer v, 30 to 200", every(as_float(integer(2, 20)), uniform(30.0, 200.0)),
               [(2.0, 40.0), (2.0, 100.0), (2.0, 200.0)], note="the recurrence starts too low"),
        Region("integer v, large x", every(as_float(integer(2, 5)), uniform(200.0, 700.0)), [(3.0, 500.0)],
               note="the recurrence starts too low"),
        Region("real v", every(not_integer(0, 30), log_uniform(1e-3, 30.0)), [(0.5, 2.0), (2.7, 3.0)]),
        Region("real v, large x", every(not_integer(0, 10), uniform(30.0, 300.0)), [(0.3, 100.0), (0.3, 300.0)]),
        Region("negative v", every(not_integer(-10, 0), log_uniform(0.5, 30.0))),
        Region("negative half-integers", every(lambda rng: 0.5 - rng.randint(1, 20), log_uniform(0.1, 100.0)),
               [(-0.5, 2.0), (-1.5, 2.0), (-2.5, 2.0)]),
    ]),
    Function("bessel_k", "Kₙ(x)", "KR_BesselKn", "id", upward(mp.besselk, 1), regions=[
        Region("n = 0 and 1", every(integer(0, 1), log_uniform(1e-300, 700.0)),
               [(n, x) for n in (0, 1) for x in around(2.0)]),
        Region("n to 50", every(integer(-50, 50), log_uniform(1e-3, 100.0)), [(4, 2.0)]),
        Region("n to 1000", every(integer(50, 1000), uniform(400.0, 700.0))),
    ]),
    kelvin(0, "ber", mp.ber, "KR_KelvinI", KELVIN),
    kelvin(1, "bei", mp.bei, "KR_KelvinI", KELVIN),
    kelvin(0, "ker", mp.ker, "KR_KelvinK", KELVIN_SECOND),
    kelvin(1, "kei", mp.kei, "KR_KelvinK", KELVIN_SECOND),
    *(airy(i, *output) for i, output in enumerate(AIRY_OUTPUTS)),
    Function("struve", "H_v(x)", "KR_Struve", "dd", mp.struveh, pack=lambda v, x: (x, v), regions=[
        Region("to 18", every(uniform(-0.9, 20.0), uniform(0.01, 18.0)), [(0.0, 1.0)]),
        Region("18 to 30", every(uniform(0.0, 20.0), uniform(18.0, 30.0)), [(0.0, 25.0)],
               note="two series, neither at its best"),
        Region("above 30", every(uniform(0.0, 20.0), uniform(31.0, 200.0)), [(0.0, 40.0), (1.0, 50.0), (2.5, 40.0)]),
        Region("large v", every(uniform(20.0, 160.0), uniform(1.0, 18.0))),
        Region("v near and above x", order_and_argument(uniform(20.0, 160.0), uniform(0.5, 1.5)), in_golden=False,
               note="the power series cancels, the asymptotic one misjudges itself"),
        Region("negative x", every(as_float(integer(0, 6)), uniform(-60.0, 0.0)), [(1.0, -50.0)]),
        Region("negative v", every(not_integer(-6, 0), uniform(0.5, 60.0))),
        Region("negative half-integers", every(lambda rng: 0.5 - rng.randint(1, 10), uniform(0.5, 60.0))),
    ]),
]

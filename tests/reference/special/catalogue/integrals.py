"""Error function, Dawson's integral, Fresnel, exponential, trigonometric and hyperbolic integrals."""

import math

import mpmath as mp

from . import Function, Region, around, every, integer, log_uniform, uniform


def dawson(x):
    if abs(x) < 30:
        return mp.sqrt(mp.pi) / 2 * mp.exp(-x * x) * mp.erfi(x)
    sum = term = mp.mpf(1)  # asymptotic, far before its smallest term
    k = 0
    while abs(term) > mp.eps:
        term *= (2 * k + 1) / (2 * x * x)
        sum += term
        k += 1
    return sum / (2 * x)


def exp_integral(n, x):
    if x <= 1:
        return mp.expint(n, x)
    fraction = mp.mpf(0)  # Legendre's, contracted, from far enough down
    for k in range(2000, 0, -1):
        fraction = k * (n + k - 1) / (x + n + 2 * k - fraction)
    return mp.exp(-x) / (x + n - fraction)


FRESNEL = [
    Region("to 1.6", log_uniform(1e-5, math.sqrt(2.5625)), around(math.sqrt(2.5625))),
    Region("1.6 to 40", uniform(1.6008, 40.0), around(1.6008, 3.0)),
    Region("40 to 36974", log_uniform(40.0, 36974.0), [36974.0], note="the phase loses digits as x²"),
    Region("above 36974", log_uniform(36974.1, 1e7), [math.nextafter(36974.0, 1e9)],
           note="the limit stands for the value"),
    Region("negative", uniform(-20.0, 0.0)),
]

SINE = [
    Region("to 4", log_uniform(1e-8, 4.0), around(4.0)),
    Region("4 to 8", uniform(4.0, 8.0), around(8.0)),
    Region("8 to 100", uniform(8.0, 100.0)),
    Region("above 100", log_uniform(100.0, 1e15)),
]

HYPERBOLIC = [
    Region("to 8", log_uniform(1e-8, 8.0), around(8.0)),
    Region("8 to 18", uniform(8.0, 18.0), around(18.0)),
    Region("18 to 88", uniform(18.0, 88.0), around(88.0)),
    Region("88 to 709", uniform(88.0, 709.0), [100.0, 200.0, 500.0, 709.0], note="the series is fitted up to 88"),
]

FUNCTIONS = [
    Function("erf", "erf x", "KR_Erf", "d", mp.erf, regions=[
        Region("to 1", log_uniform(1e-300, 1.0), around(1.0)),
        Region("above 1", uniform(1.0, 7.0), around(1.0)),
        Region("negative", uniform(-7.0, 0.0), around(-1.0)),
    ]),
    Function("erfc", "erfc x", "KR_ErfC", "d", mp.erfc, regions=[
        Region("to 1", uniform(-1.0, 1.0), [math.nextafter(1.0, 0.0)]),
        Region("1 to 8", uniform(1.0, 8.0), [1.0, math.nextafter(1.0, 2.0), math.nextafter(8.0, 0.0)]),
        Region("above 8", uniform(8.0, 26.5), [8.0]),
        Region("negative", uniform(-8.0, -1.0)),
    ]),
    Function("dawson", "Dawson's D(x)", "KR_Dawson", "d", dawson, regions=[
        Region("to 3.25", log_uniform(1e-300, 3.25)),
        Region("1 to 3.25", uniform(1.0, 3.25), around(3.25)),
        Region("3.25 to 6.25", uniform(3.25, 6.25), around(6.25)),
        Region("above 6.25", log_uniform(6.25, 1e100), around(1e9)),
        Region("negative", uniform(-20.0, 0.0)),
    ]),
    Function("fresnel_c", "C(x)", "KR_FresnelIntegrals", "d", mp.fresnelc, FRESNEL, outputs=2, output=0),
    Function("fresnel_s", "S(x)", "KR_FresnelIntegrals", "d", mp.fresnels, FRESNEL, outputs=2, output=1),
    Function("exp_integral", "Eₙ(x)", "KR_ExpI", "di", exp_integral,
             pack=lambda n, x: (x, n), regions=[
        Region("n = 0", every(integer(0, 0), log_uniform(1e-300, 700.0))),
        Region("series", every(integer(1, 20), log_uniform(1e-10, 1.0)), [(1, 0.5), (3, 0.5), (1, 1.0), (20, 1.0)]),
        Region("series, large n", every(integer(20, 5000), log_uniform(1e-10, 1.0)),
               [(170, 0.9), (171, 0.9), (172, 0.9), (5000, 1.0)]),
        Region("fraction", every(integer(1, 50), log_uniform(1.0, 700.0)),
               [(n, x) for n in (1, 5000) for x in (math.nextafter(1.0, 2.0), 1.1)]),
        Region("large n", every(integer(5001, 1000000), log_uniform(1e-3, 700.0)), [(5001, 2.0), (6000, 2.0)]),
    ]),
    Function("sin_integral", "Si(x)", "KR_SinI", "d", mp.si, SINE + [Region("negative", uniform(-20.0, 0.0))]),
    Function("cos_integral", "Ci(x)", "KR_CosI", "d", mp.ci, SINE),
    Function("sinh_integral", "Shi(x)", "KR_SinhI", "d", mp.shi,
             HYPERBOLIC + [Region("negative", uniform(-30.0, 0.0))]),
    Function("cosh_integral", "Chi(x)", "KR_CoshI", "d", mp.chi, HYPERBOLIC),
]

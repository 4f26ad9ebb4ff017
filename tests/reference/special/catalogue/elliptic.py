"""Elliptic integrals and the Jacobian elliptic functions, the dilogarithm and the zeta function."""

import math

import mpmath as mp

from . import NAN, Function, Region, around, every, log_uniform, near_integer, uniform

HALF_PI = math.pi / 2


def complement(low, high):
    """m = 1 - t."""
    draw = log_uniform(low, high)
    return lambda rng: 1.0 - draw(rng)


def complete(near_one):
    return [
        Region("0 to 0.9", uniform(0.0, 0.9), [0.0, 0.5, 5e-324]),
        Region("0.9 to 1 - 7e-6", complement(7.1e-6, 0.1), [1.0 - 7.1e-6]),
        Region("from 1 - 7e-6", complement(1e-15, 6.9e-6), [1.0 - 6.999e-6], note=near_one),
    ]


def incomplete(near_one, at_one):
    return [
        Region("quarter period", every(uniform(-HALF_PI, HALF_PI), uniform(0.0, 0.99)),
               [(phi, 0.5) for phi in (*around(HALF_PI)[:2], *around(-HALF_PI)[1:], 1e-300, 1.0, 0.8716111622538728)]),
        Region("several periods", every(uniform(-12.0, 12.0), uniform(0.0, 0.99)),
               [(k * HALF_PI, 0.5) for k in (2, 3, 4, 5, 6, 7, -3, -4)] + [(math.nextafter(HALF_PI, 2.0), 0.5)]),
        Region("many periods", every(uniform(100.0, 1e5), uniform(0.0, 0.99))),
        Region("m near 1", every(uniform(0.0, HALF_PI), complement(1e-12, 1e-2)), note=near_one),
        Region("m near 1, several periods", every(uniform(2.0, 12.0), complement(1e-10, 1e-5)),
               note="multiples of K"),
        Region("m = 0", every(uniform(-10.0, 10.0), lambda rng: 0.0)),
        Region("m = 1", every(log_uniform(1e-10, 1.57), lambda rng: 1.0), in_golden=False, note=at_one),
    ]


def within_quarter(u_of_k, m_of):
    def draw(rng):
        m = m_of(rng)
        return float(mp.ellipk(m)) * u_of_k(rng), m

    return draw


JACOBI = [
    Region("quarter period", within_quarter(uniform(-1.0, 1.0), uniform(1e-6, 0.99)), [(1.5, 0.6), (0.0, 0.5)]),
    Region("several periods", every(uniform(-20.0, 20.0), uniform(1e-6, 0.99))),
    Region("m near 0", every(uniform(-10.0, 10.0), log_uniform(1e-30, 1e-6)),
           [(u, m) for u in (1.0, 7.0) for m in around(1e-9)]),
    Region("m near 1", within_quarter(uniform(-0.9, 0.9), complement(1.1e-9, 1e-2))),
    Region("m at 1", within_quarter(uniform(-0.5, 0.5), complement(1e-15, 9.9e-10)),
           [(u, 1.0) for u in (0.5, -3.0, 20.0)]),
]


def jacobi(kind):
    return lambda u, m: mp.ellipfun(kind, u=u, m=m) if u else mp.mpf(kind != "sn")


def amplitude(u, m):
    sn, cn = jacobi("sn")(u, m), jacobi("cn")(u, m)
    return mp.atan2(sn, cn) + (2 * mp.pi * mp.nint(u / (4 * mp.ellipk(m))) if m < 1 else 0)


def jacobi_function(i, name):
    return Function(f"jacobi_{name}", f"{name}(u | m)", "KR_EllipticJ", "dd",
                    amplitude if name == "am" else jacobi(name), JACOBI, outputs=4, output=i)


FUNCTIONS = [
    Function("elliptic_k", "K(m)", "KR_Elliptic1", "dd", mp.ellipk, complete("the bare logarithm"),
             pack=lambda m: (m, NAN)),
    Function("elliptic_e", "E(m)", "KR_Elliptic2", "dd", mp.ellipe, complete(""), pack=lambda m: (m, NAN)),
    Function("elliptic_f_phi", "F(φ | m)", "KR_Elliptic1", "dd", mp.ellipf,
             incomplete("", "the logarithm of a tangent near 1"), pack=lambda p, m: (m, p)),
    Function("elliptic_e_phi", "E(φ | m)", "KR_Elliptic2", "dd", mp.ellipe,
             incomplete("E stands on K", ""), pack=lambda p, m: (m, p)),
    *(jacobi_function(i, name) for i, name in enumerate(("sn", "cn", "dn", "am"))),
    Function("dilogarithm", "Li₂(1 − x)", "KR_Diln", "d", lambda x: mp.polylog(2, 1 - x), regions=[
        Region("to 0.5", log_uniform(1e-300, 0.5), around(0.5)),
        Region("0.5 to 1.5", uniform(0.5, 1.5), around(1.0, 1.5)),
        Region("1.5 to 2", uniform(1.5, 2.0), around(2.0)),
        Region("above 2", log_uniform(2.0, 1e300)),
    ]),
    Function("zeta", "ζ(x)", "KR_Zeta", "d", mp.zeta, regions=[
        Region("below 0", uniform(-30.8, 0.0), [-0.5, -3.5, -30.8148, -1.0, -3.0]),
        Region("near its zeros", near_integer(-14, -2, 1e-10), [-2.0, -4.0, -20.0], note="not exactly 0 there"),
        Region("0 to 1", uniform(0.0, 1.0), [0.0, 0.5]),
        Region("near 1", near_integer(1, 1, 1e-12, 0.1)),
        Region("1 to 10", uniform(1.0, 10.0), around(10.0) + [2.0, 3.0]),
        Region("10 to 50", uniform(10.0, 50.0), around(50.0, 30.0)),
        Region("above 50", uniform(50.0, 130.0), around(127.0)),
    ]),
]

#!/usr/bin/env python3
"""Writes direct_form.inc and cascade.inc: signals filtered by SciPy's lfilter and sosfilt, real and complex.

Each case gives the signal, the coefficients and what comes out when the filter starts from rest.

Made with Python 3.11.2, NumPy 1.24.2 and SciPy 1.10.1.
"""

from pathlib import Path

import numpy as np
from scipy import signal

random = np.random.default_rng(5)


def element(z, is_complex):
    return f"{{{z.real!r}, {z.imag!r}}}" if is_complex else repr(float(z.real))


def array(values, is_complex):
    return "{" + ", ".join(element(complex(v), is_complex) for v in values) + "}"


def draw(n, is_complex):
    values = random.normal(size=n) + (1j * random.normal(size=n) if is_complex else 0)
    return np.round(values, 3)


def stable_denominator(order, is_complex):
    """Poles inside a circle of 0.9, in conjugate pairs when the coefficients are real, times a leading coefficient."""
    poles = 0.9 * np.sqrt(random.uniform(size=order)) * np.exp(2j * np.pi * random.uniform(size=order))
    if not is_complex:
        poles[order // 2 * 2:] = poles[order // 2 * 2:].real
        poles[1:order // 2 * 2:2] = poles[0:order // 2 * 2:2].conj()
    polynomial = np.atleast_1d(np.poly(poles))
    lead = draw(1, is_complex)[0]
    return (polynomial if is_complex else polynomial.real) * lead


def direct_form(name, signal_complex, coefficients_complex):
    output_complex = signal_complex or coefficients_complex
    types = ", ".join(map(c, (signal_complex, coefficients_complex, output_complex)))
    lines = [f"const DirectFormReference<{types}> {name}[] = {{"]
    for na, nb, n in [(0, 1, 5), (0, 7, 12), (1, 1, 5), (2, 1, 20), (1, 3, 20), (3, 3, 40), (6, 2, 40), (4, 9, 90)]:
        x, b = draw(n, signal_complex), draw(nb, coefficients_complex)
        a = stable_denominator(na - 1, coefficients_complex) if na > 0 else np.array([])
        y = signal.lfilter(b, a if na > 0 else [1.0], x)
        lines.append(
            f"    {{{array(x, signal_complex)},\n     {array(a, coefficients_complex)},\n"
            f"     {array(b, coefficients_complex)},\n     {array(y, output_complex)}}},"
        )
    return lines + ["};", ""]


def c(is_complex):
    return "Complex" if is_complex else "double"


def cascade(name, signal_complex):
    """Sections of order 2 are SciPy's own; those of order 4 are products of two."""
    lines = [f"const CascadeReference<{c(signal_complex)}> {name}[] = {{"]
    for structure, sections, n in [(0, 1, 30), (0, 2, 30), (0, 5, 60), (1, 1, 30), (1, 3, 50)]:
        biquads = signal.ellip(sections * (structure + 1) * 2, 1, 60, 0.3, output="sos")
        x = draw(n, signal_complex)
        y = signal.sosfilt(biquads, x)
        a, b = [], []
        for k in range(sections):
            if structure == 0:
                b_k, a_k = biquads[k][:3], biquads[k][3:]
            else:
                b_k = np.polymul(biquads[2 * k][:3], biquads[2 * k + 1][:3])
                a_k = np.polymul(biquads[2 * k][3:], biquads[2 * k + 1][3:])
            a.extend(a_k[1:])
            b.extend(b_k)
        lines.append(
            f"    {{{structure},\n     {array(x, signal_complex)},\n     {array(a, False)},\n     {array(b, False)},\n"
            f"     {array(y, signal_complex)}}},"
        )
    return lines + ["};", ""]


def write(name, lines):
    head = ["// Made by make_iir_filter.py; do not edit.", ""]
    Path(__file__).with_name(name).write_text("\n".join(head + lines))


def main():
    lines = direct_form("kReal", False, False)
    lines += direct_form("kComplexByReal", True, False)
    lines += direct_form("kComplex", True, True)
    lines += direct_form("kRealByComplex", False, True)
    write("direct_form.inc", lines)
    write("cascade.inc", cascade("kReal", False) + cascade("kComplex", True))


if __name__ == "__main__":
    main()

#!/usr/bin/env python3
"""Writes iir_design.inc: complex responses of classical filters of every family, type and order 1 to 20.

SciPy gives poles and zeros of the analogue prototypes; the others are written down here. The response of the digital
filter at a frequency is that of the prototype at the point to which frequency transformation and bilinear transform
map it, so no coefficients are formed on the way. Wherever SciPy has the digital filter, the script checks that its
response agrees.

Made with Python 3.11.2, NumPy 1.24.2 and SciPy 1.10.1.
"""

from pathlib import Path

import numpy as np
from scipy import signal

FAMILIES = ["butterworth", "bessel", "chebyshev", "inverse_chebyshev", "elliptic"]
TYPES = ["lowpass", "highpass", "bandpass", "bandstop"]
FS = 1000.0


def prototype(family, type_, order, ripple, attenuation):
    if family == "butterworth":
        return signal.buttap(order)
    if family == "bessel":
        # On the unit circle, imaginary parts evenly spaced between -1 and 1.
        y = 1 - (2 * np.arange(order) + 1) / order
        return np.array([]), -np.sqrt(1 - y * y) + 1j * y, 1.0
    if family == "chebyshev":
        if order == 1 and type_ in ("bandpass", "bandstop"):
            return signal.buttap(1)
        return signal.cheb1ap(order, ripple)
    if family == "inverse_chebyshev":
        return signal.cheb2ap(order, attenuation)
    return signal.ellipap(order, ripple, attenuation)


def response(zpk, type_, fl, fh, f):
    zeros, poles, gain = np.atleast_1d(zpk[0]), np.atleast_1d(zpk[1]), zpk[2]
    s = 1j * np.tan(np.pi * f / FS)
    lower, upper = np.tan(np.pi * fl / FS), np.tan(np.pi * fh / FS)
    if type_ == "lowpass":
        p = s / lower
    elif type_ == "highpass":
        p = lower / s
    else:
        p = (s * s + lower * upper) / (s * (upper - lower))
        if type_ == "bandstop":
            p = 1 / p
    # One factor at a time, poles and zeros alternating: the products stay in range.
    h = complex(gain)
    for k in range(len(poles)):
        h /= p - poles[k]
        if k < len(zeros):
            h *= p - zeros[k]
    return h


def of_scipy(family, type_, order, ripple, attenuation, fl, fh, f):
    edges = fl if type_ in ("lowpass", "highpass") else (fl, fh)
    design = {
        "butterworth": lambda: signal.butter(order, edges, type_, fs=FS, output="sos"),
        "chebyshev": lambda: signal.cheby1(order, ripple, edges, type_, fs=FS, output="sos"),
        "inverse_chebyshev": lambda: signal.cheby2(order, attenuation, edges, type_, fs=FS, output="sos"),
        "elliptic": lambda: signal.ellip(order, ripple, attenuation, edges, type_, fs=FS, output="sos"),
    }[family]
    return signal.sosfreqz(design(), [f], fs=FS)[1][0]


def main():
    lines = ["// Made by make_iir_design.py; do not edit.", "", "const std::vector<DesignReference> kDesigns = {"]
    edges = [(100.0, 230.0), (31.0, 47.0), (240.0, 460.0)]
    ripples = [(1.0, 40.0), (0.1, 80.0), (3.0, 20.0)]
    worst = 0.0
    for family in range(5):
        for type_ in range(4):
            for order in range(1, 21):
                fl, fh = edges[(order + type_) % 3]
                ripple, attenuation = ripples[(order + family) % 3]
                if FAMILIES[family] == "elliptic":
                    # High orders that do little make a modulus so near 1 that double precision cannot tell.
                    attenuation = max(attenuation, 20.0 + 8.0 * order)
                zpk = prototype(FAMILIES[family], TYPES[type_], order, ripple, attenuation)
                # The lower edge, both sides of it, and far off.
                points = []
                for f in (0.9 * fl, fl, 0.6 * fl + 0.4 * fh, fh + 0.25 * (FS / 2 - fh)):
                    h = response(zpk, TYPES[type_], fl, fh, f)
                    points.append(f"{{{f:.12g}, {{{h.real:.13g}, {h.imag:.13g}}}}}")
                    is_ours = FAMILIES[family] == "chebyshev" and order == 1 and type_ > 1
                    if FAMILIES[family] != "bessel" and not is_ours:
                        other = of_scipy(FAMILIES[family], TYPES[type_], order, ripple, attenuation, fl, fh, f)
                        worst = max(worst, abs(h - other))
                lines.append(
                    f"    {{{family}, {type_}, {order}, {fl:g}, {fh:g}, {ripple:g}, {attenuation:g}, "
                    f"{{{', '.join(points)}}}}},"
                )
    lines += ["};", ""]
    assert worst < 1e-9, worst
    print("SciPy's digital filters differ by", worst)
    Path(__file__).with_name("iir_design.inc").write_text("\n".join(lines))


if __name__ == "__main__":
    main()

#!/usr/bin/python3
"""Writes the Fourier transforms' part of docs/accuracy.md and its picture, docs/accuracy/fft.png.

    fft.py [--build build/release]

Every length from 1 to 2000 and chosen ones up to 2^22 are measured through the exports, over the substitute host.
"""

import argparse
import ctypes
import pathlib

import matplotlib

matplotlib.use("Agg")
import matplotlib.pyplot as plt  # noqa: E402
import numpy as np  # noqa: E402
import scipy.fft  # noqa: E402

import host  # noqa: E402
import page  # noqa: E402

INTRODUCTION = """\
## Fourier transforms

Normal random samples are transformed and compared with a transform in long double (SciPy): the error is the root of
the mean square of the differences over that of the spectrum, and of the samples for the way there and back. Every
length from 1 to 2000 is measured, and chosen ones up to 2²². `tools/accuracy/fft.py` writes all of this anew.

The twiddles of a stage follow one another by a recurrence that is never set right again, so the error grows slowly with
the longest of these chains. Beyond that, the largest prime factor decides: the short transforms of 29, 31 and 43 round
more than the others, and Rader's convolution passes through two transforms of the length less one, level by level where
that has large primes again (1439, 719, 359, 179 and 89 are such a chain).

![Error over length](accuracy/fft.png)

The worst length of each kind up to 2000:
"""

LARGE = [
    2048, 2187, 2809, 3125, 4096, 5000, 6561, 7919, 8192, 10000, 10007, 10201, 12167, 15625, 16384, 16807,
    19683, 30030, 32768, 46189, 59049, 65536, 65537, 79507, 99991, 100000, 131072, 161051, 177147, 262144,
    371293, 390625, 524288, 531441, 720720, 823543, 999983, 1000000, 1048576, 1594323, 2000000, 2097152,
    3145728, 4194304,
]

KINDS = {
    "2, 3, 5": "#205080",
    "7 to 19, 37, 41": "#4a9c5d",
    "29, 31, 43": "#d09020",
    "23, 47": "#8050a0",
    "53 and above": "#b03020",
}


def primes(n):
    found = []
    p = 2
    while p * p <= n:
        while n % p == 0:
            found.append(p)
            n //= p
        p += 1
    return found + [n] * (n > 1)


def kind(n):
    """What limits the accuracy of a length."""
    factors = set(primes(n))
    if any(p >= 53 for p in factors):
        return "53 and above"
    if factors & {29, 31, 43}:
        return "29, 31, 43"
    if factors & {23, 47}:
        return "23, 47"
    return "2, 3, 5" if factors <= {2, 3, 5} else "7 to 19, 37, 41"


def written(n):
    """A length as a product of powers of primes."""
    factors = primes(n)
    digits = str.maketrans("0123456789", "⁰¹²³⁴⁵⁶⁷⁸⁹")
    powers = [(p, factors.count(p)) for p in sorted(set(factors))]
    return " · ".join(f"{p}{str(k).translate(digits) if k > 1 else ''}" for p, k in powers) or "1"


class Transforms(host.Library):
    def call(self, export, samples, out_type):
        """The result of an export that takes an array, an array to fill and a table slot."""
        x = self.array(samples, samples.dtype)
        y = self.array(dtype=out_type)
        status = getattr(self.exports, export)(x, y, ctypes.byref(ctypes.c_void_p()))
        assert status == 0, (export, len(samples), status)
        result = self.values(y, out_type)
        self.host.KrrtFree(x)
        self.host.KrrtFree(y)
        self.host.KrrtCloseInstance(None)  # releases the table
        return result


def error(computed, true):
    size = np.sum(np.abs(true) ** 2)
    return float(np.sqrt(np.sum(np.abs(computed - true) ** 2) / size))


def measure(library, n):
    """Errors of the complex transform, of the real one, and of both ways there and back."""
    random = np.random.default_rng(n)
    real = random.standard_normal(n)
    samples = random.standard_normal(n) + 1j * random.standard_normal(n)
    spectrum = library.call("CxQMFFTH", samples, complex)
    real_spectrum = library.call("ReQMFFTH", real, complex)
    return (error(spectrum, scipy.fft.fft(samples.astype(np.clongdouble))),
            error(real_spectrum, scipy.fft.fft(real.astype(np.longdouble))),
            error(library.call("InvCxQMFFTH", spectrum, complex), samples),
            error(library.call("InvReQMFFTH", real_spectrum, float), real))


def picture(errors):
    figure, panels = plt.subplots(2, 1, figsize=(7.2, 7.2), dpi=80, sharex=True, layout="constrained")
    for axes, title, column in zip(panels, ("complex samples", "real samples"), (0, 1), strict=True):
        for name, colour in KINDS.items():
            lengths = [n for n in errors if kind(n) == name]
            axes.scatter(lengths, [max(errors[n][column], 1e-17) for n in lengths], s=5, color=colour, alpha=0.6,
                         linewidths=0, label=name)
        axes.set_xscale("log")
        axes.set_yscale("log")
        axes.set_title(title)
        axes.set_ylabel("relative RMS error")
        axes.axhline(2.0**-53, color="#606060", linewidth=0.8)
        axes.grid(alpha=0.3)
    panels[0].legend(title="largest prime factors", markerscale=2.5, fontsize=8, loc="upper left")
    panels[1].set_xlabel("length")
    figure.savefig(page.PICTURES / "fft.png", metadata={"Software": None}, pil_kwargs={"optimize": True})
    plt.close(figure)


def row(cells, figures):
    return "| " + " | ".join([*cells, *(f"{value:.1e}" for value in figures)]) + " |"


def tables(errors):
    heads = "Complex | Real | Complex and back | Real and back |"
    lines = [f"| Prime factors | Lengths | {heads}", "|---|---:|---:|---:|---:|---:|"]
    for name in KINDS:
        lengths = [n for n in errors if n <= 2000 and kind(n) == name]
        lines.append(row([name, str(len(lengths))], (max(errors[n][c] for n in lengths) for c in range(4))))
    lines += ["", "Chosen lengths above:", "", f"| Length | | {heads}", "|---:|---|---:|---:|---:|---:|"]
    lines += [row([str(n), written(n)], errors[n]) for n in LARGE]
    return "\n".join(lines)


def main():
    parser = argparse.ArgumentParser(description=__doc__, formatter_class=argparse.RawDescriptionHelpFormatter)
    parser.add_argument("--build", type=pathlib.Path, default=page.ROOT / "build" / "release")
    library = Transforms(parser.parse_args().build)
    errors = {n: measure(library, n) for n in [*range(1, 2001), *LARGE]}
    picture(errors)
    page.write("transforms", "fft.py", f"{INTRODUCTION}\n{tables(errors)}")


if __name__ == "__main__":
    main()

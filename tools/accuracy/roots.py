#!/usr/bin/python3
"""Writes the part of docs/accuracy.md on roots and divisors of polynomials, and its picture.

    roots.py [--build build/release]

Coefficients are products of the given roots in 60 digits, rounded to double; errors are measured in 60 digits too.
NumPy's `roots`, the eigenvalues of the companion matrix, are the peer.
"""

import argparse
import ctypes
import pathlib

import matplotlib

matplotlib.use("Agg")
import matplotlib.pyplot as plt  # noqa: E402
import mpmath as mp  # noqa: E402
import numpy as np  # noqa: E402
import scipy.optimize  # noqa: E402

import host  # noqa: E402
import page  # noqa: E402

mp.mp.dps = 60
SAMPLES = 20  # random polynomials of a kind

INTRODUCTION = """\
## Roots of polynomials

*Forward* is the largest distance of a root found to the root that it should be, relative to that root, in the pairing
that makes the distances least. The roots that should be are those the polynomial was made of where some are multiple,
and those of the rounded coefficients, to 60 digits, where all are simple. *Backward* is the largest change of a
coefficient that makes the roots found exact, relative to the largest coefficient. Rows on random polynomials give the
worst of {samples}; *as made* says how often all multiplicities were found. `tools/accuracy/roots.py` writes all of this
anew.

### With multiplicities, and without guesses

`MultPolyRoots_head` and `CxMultPolyRoots_head` with both stages and the default tolerance; `CxPolyRoots_head` with at
most 50 turns, which multiple roots may need; NumPy's eigenvalues.
"""

NOTES = """\
- A root of multiplicity m, seen as m roots, is lost to about 1/m of the digits, whatever finds them. Held together it
  is as well conditioned as a simple one.
- Clusters are told apart as far as the tolerance allows; where they are not, the cluster comes out as one root, and the
  forward error is its width.
- Of degree 50, the thresholds, which only ever shrink from one divisor to the next, refuse the right one at last, and
  the eigenvalues take the place of the structure.
- Of simple roots at high degree the refinement keeps less than Newton's method does: it compares coefficients with the
  product of all factors, and that product rounds.

![A triple of multiple roots](accuracy/roots.png)

In the picture, roots of multiplicity 10, 6 and 4 at 1, 2 and 3: with multiplicities held (circles), each is one point.
"""

GUESSES = """\
### From guesses · `PolyRootsNtBst_head`

Guesses are the true roots, off by a relative error; tolerance 10⁻¹⁴, at most 100 steps, {samples} real polynomials of
normal coefficients each. Bairstow's iteration stops where a change does not fall below that of the step before, and its
first step has to change the factor by less than a tenth: guesses that are far off come back as they were.
"""

DIVISORS = """\
### Greatest common divisors · `PolyGCD_H`, `CxPolyGCD_H`

Products of random factors with a common one of degree d, both of degree n, every coefficient of the products changed by
a relative error, {samples} pairs each. *Found* counts divisors of the right degree; the errors are those of their
coefficients and of the cofactors', relative to the largest, the worst of the pairs.
"""


class Polynomials(host.Library):
    def multiple(self, c):
        """Distinct roots and their multiplicities."""
        complex_ = np.iscomplexobj(c)
        coef, roots, distinct = self.array(c, complex if complex_ else float), self.array((), complex), \
            self.array((), complex)
        mult = self.array((), np.int32)
        find = self.exports.CxMultPolyRoots_head if complex_ else self.exports.MultPolyRoots_head
        status = find(coef, 1, ctypes.c_double(0.0), roots, distinct, mult)
        assert status == 0, status
        return self.values(distinct, complex), self.values(mult, np.int32)

    def single(self, c):
        coef, limit, err = self.array(c, complex), ctypes.c_int32(50), ctypes.c_int32()
        self.exports.CxPolyRoots_head(coef, ctypes.byref(limit), ctypes.byref(err))
        assert err.value == 0, err.value
        return self.values(coef, complex)

    def guessed(self, c, real, pairs):
        roots, limit, tol = self.array((), complex), 100, ctypes.c_double(1e-14)
        status = self.exports.PolyRootsNtBst_head(self.array(c), self.array(real), limit, tol,
                                                  self.array(pairs, complex), limit, tol, roots)
        assert status == 0, status
        return self.values(roots, complex)

    def divisor(self, p, q, tol):
        kind = complex if np.iscomplexobj(p) else float
        outputs = [self.array((), kind) for _ in range(3)]
        divide = self.exports.CxPolyGCD_H if kind is complex else self.exports.PolyGCD_H
        status = divide(self.array(p, kind), self.array(q, kind), ctypes.c_double(tol), *outputs, 1)
        assert status == 0, status
        return [self.values(output, kind) for output in outputs]


def product(roots):
    """Coefficients from the constant up, the highest one 1, in all digits."""
    c = [mp.mpc(1)]
    for root in roots:
        root = mp.mpmathify(root)
        c = [(c[k - 1] if k else 0) - root * (c[k] if k < len(c) else 0) for k in range(len(c) + 1)]
    return c


def rounded(c):
    if all(value.imag == 0 for value in c):
        return np.array([float(value.real) for value in c])
    return np.array([complex(value) for value in c])


def true_roots(c):
    """Simple roots of given coefficients, by Newton's method from NumPy's."""
    highest_first = [mp.mpmathify(value) for value in c[::-1].tolist()]
    roots = []
    for z in np.roots(c[::-1]).tolist():
        z = mp.mpmathify(z)
        for _ in range(60):
            value, slope = mp.polyval(highest_first, z, derivative=True)
            step = value / slope
            z -= step
            if abs(step) < abs(z) * mp.mpf(10) ** -50:
                break
        roots.append(z)
    return roots


def forward(found, true):
    """The largest relative distance in the pairing of least total distance."""
    size = [max(abs(z), mp.mpf(10) ** -300) for z in true]
    distance = np.array([[float(abs(mp.mpmathify(z) - t) / s) for t, s in zip(true, size)] for z in found.tolist()])
    return distance[scipy.optimize.linear_sum_assignment(distance)].max()


def backward(c, found):
    again = product(found.tolist())
    highest = mp.mpmathify(complex(c[-1]))
    change = max(abs(a * highest - mp.mpmathify(complex(b))) for a, b in zip(again, c))
    return float(change / max(abs(mp.mpmathify(complex(b))) for b in c))


def measured(finders, polynomials):
    """Worst forward and backward error of each finder, and how often the multiplicities came out."""
    worst = {name: [0.0, 0.0] for name in finders}
    as_made = 0
    for c, roots, mult in polynomials:
        for name, find in finders.items():
            found = find(c)
            if isinstance(found, tuple):
                as_made += sorted(found[1].tolist()) == sorted(mult)
                found = np.repeat(*found)
            errors = forward(found, roots), backward(c, found)
            worst[name] = [max(pair) for pair in zip(worst[name], errors)]
    return worst, as_made


def with_multiplicities(*pairs):
    """A polynomial of roots and multiplicities."""
    roots = [root for root, m in pairs for _ in range(m)]
    return [(rounded(product(roots)), roots, [m for _, m in pairs])]


def random(degree, complex_, seed):
    rng = np.random.default_rng(seed)
    polynomials = []
    for _ in range(SAMPLES):
        c = rng.normal(size=degree + 1) + (1j * rng.normal(size=degree + 1) if complex_ else 0)
        polynomials.append((c, true_roots(c), [1] * degree))
    return polynomials


def wilkinson():
    c = rounded(product(range(1, 16)))
    return [(c, true_roots(c), [1] * 15)]


TRIPLE = ((1, 10), (2, 6), (3, 4))


def problems():
    i = mp.mpc(0, 1)
    return [
        ("(x − 1)⁵", with_multiplicities((1, 5))),
        ("(x − 1)¹⁰ (x − 2)⁶ (x − 3)⁴", with_multiplicities(*TRIPLE)),
        ("(x − 4) (x + 3)² (x − 2)³ (x − 1)⁴", with_multiplicities((4, 1), (-3, 2), (2, 3), (1, 4))),
        ("(x² − 2x + 5)⁴ (x + 1)³", with_multiplicities((1 + 2 * i, 4), (1 - 2 * i, 4), (-1, 3))),
        ("(x − 3 + i)² (x − 2i) (x − 1 − i/2)⁴", with_multiplicities((3 - i, 2), (2 * i, 1), (1 + i / 2, 4))),
        ("(x − 1)⁴ (x − 1.1)⁴ (x + 1/2)²", with_multiplicities((1, 4), (mp.mpf("1.1"), 4), (mp.mpf("-0.5"), 2))),
        ("(x − 1)³ (x − 1.01)² (x + 2)", with_multiplicities((1, 3), (mp.mpf("1.01"), 2), (-2, 1))),
        ("(x − 1)³ (x − 1.0001)² (x + 2)", with_multiplicities((1, 3), (mp.mpf("1.0001"), 2), (-2, 1))),
        ("(x − 1)³ (x − 1.000001)² (x + 2)", with_multiplicities((1, 3), (mp.mpf("1.000001"), 2), (-2, 1))),
        ("(x − 1)²⁰ (x − 2)¹⁵ (x − 3)¹⁰ (x − 4)⁵", with_multiplicities((1, 20), (2, 15), (3, 10), (4, 5))),
        ("(x − 1) (x − 2) … (x − 15)", wilkinson()),
        ("normal coefficients, degree 20", random(20, False, 1)),
        ("normal coefficients, degree 60", random(60, False, 2)),
        ("complex normal coefficients, degree 20", random(20, True, 3)),
        ("complex normal coefficients, degree 60", random(60, True, 4)),
    ]


def figure(x):
    if x == 0:
        return "0"
    mantissa, exponent = f"{x:.1e}".split("e")
    return f"{mantissa.removesuffix('.0')}e{int(exponent)}"


def root_table(library):
    finders = {"multiplicities": library.multiple, "Madsen": library.single, "NumPy": lambda c: np.roots(c[::-1])}
    rows = []
    for name, polynomials in problems():
        worst, as_made = measured(finders, polynomials)
        rows.append([name, f"{as_made} of {len(polynomials)}",
                     *(figure(error) for pair in worst.values() for error in pair)])
    return page.table(["Polynomial", "As made", *(f"{name}, {error}" for name in finders
                                                  for error in ("forward", "backward"))], rows)


def guess_table(library):
    rows = []
    for degree in (6, 12):
        polynomials = random(degree, False, 5)
        for off in (1e-6, 1e-3, 1e-2, 1e-1):
            rng = np.random.default_rng(6)
            kept = {"real": [], "pairs": []}
            for c, roots, _ in polynomials:
                roots = np.array([complex(z) for z in roots])
                real = roots[roots.imag == 0].real
                upper = roots[roots.imag > 1e-30]
                guesses = upper * (1 + off * rng.choice([-1, 1], upper.size))
                found = library.guessed(c, real * (1 + off * rng.choice([-1, 1], real.size)),
                                        np.ravel(np.column_stack([guesses, guesses.conj()])))
                kept["real"] += list(np.abs(found[: real.size] / real - 1))
                pairs = found[real.size :]
                kept["pairs"] += [min(abs(pairs - z)) / abs(z) for z in upper]
            row = [str(degree), figure(off)]
            for errors in kept.values():
                fine = [error for error in errors if error < off / 1000]
                row += [f"{len(fine)} of {len(errors)}", figure(max(fine)) if fine else ""]
            rows.append(row)
    return page.table(["Degree", "Guesses off by", "Real refined", "worst of these", "Pairs refined",
                       "worst of these"], rows)


def divisor_table(library):
    rows = []
    for complex_ in (False, True):
        for n, d in ((8, 3), (20, 6)):
            for noise, tol in ((0.0, 1e-10), (1e-10, 1e-8), (1e-6, 1e-4)):
                rng = np.random.default_rng(7)

                def factor(degree, rng=rng, complex_=complex_):
                    c = rng.normal(size=degree + 1) + (1j * rng.normal(size=degree + 1) if complex_ else 0)
                    return c / c[-1]

                right, worst = 0, [0.0, 0.0]
                for _ in range(SAMPLES):
                    common, left, other = factor(d), factor(n - d), factor(n - d)
                    p, q = (np.convolve(common, rest) * (1 + noise * rng.uniform(-1, 1, n + 1))
                            for rest in (left, other))
                    gcd, u, v = library.divisor(p, q, tol)
                    if gcd.size != d + 1:
                        continue
                    right += 1
                    error = [max(abs(x - y)) / max(abs(y)) for x, y in ((gcd, common), (u, left), (v, other))]
                    worst = [max(worst[0], error[0]), max(worst[1], *error[1:])]
                rows.append(["complex" if complex_ else "real", str(n), str(d), figure(noise), figure(tol),
                             f"{right} of {SAMPLES}", figure(worst[0]), figure(worst[1])])
    return page.table(["Coefficients", "n", "d", "Changed by", "Tolerance", "Found", "Divisor", "Cofactors"], rows)


def picture(library):
    (c, _, _), = with_multiplicities(*TRIPLE)
    figure_, axes = plt.subplots(figsize=(7.2, 3.4), dpi=80)
    for name, roots, style in (("NumPy", np.roots(c[::-1]), "x"), ("CxPolyRoots_head", library.single(c), "+")):
        axes.plot(roots.real, roots.imag, style, label=name, markersize=6)
    distinct, _ = library.multiple(c)
    axes.plot(distinct.real, distinct.imag, "o", label="MultPolyRoots_head", markersize=11, markerfacecolor="none",
              color="#2b8a3e", markeredgewidth=1.6)
    axes.set_xlabel("real part")
    axes.set_ylabel("imaginary part")
    axes.grid(alpha=0.3)
    axes.legend(loc="center left", bbox_to_anchor=(1.0, 0.5), frameon=False)
    figure_.savefig(page.PICTURES / "roots.png", bbox_inches="tight", metadata={"Software": None},
                    pil_kwargs={"optimize": True})
    plt.close(figure_)


def main():
    parser = argparse.ArgumentParser(description=__doc__, formatter_class=argparse.RawDescriptionHelpFormatter)
    parser.add_argument("--build", type=pathlib.Path, default=page.ROOT / "build" / "release")
    library = Polynomials(parser.parse_args().build)
    picture(library)
    page.write("roots", "roots.py", "\n".join([
        INTRODUCTION.format(samples=SAMPLES), root_table(library), NOTES, GUESSES.format(samples=SAMPLES),
        guess_table(library), DIVISORS.format(samples=SAMPLES), divisor_table(library)]))


if __name__ == "__main__":
    main()

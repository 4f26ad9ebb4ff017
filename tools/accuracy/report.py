#!/usr/bin/python3
"""Writes the special functions' part of docs/accuracy.md and its pictures, docs/accuracy/<function>.png.

    report.py [--library build/release/src/libkrnumer.so] [--points 200] [NAME ...]

Every region of the catalogue is measured at as many arguments, its edges among them. With names, only these functions
are measured, and their rows and pictures are replaced.
"""

import argparse
import json
import math
import pathlib
import statistics
import textwrap

import matplotlib

matplotlib.use("Agg")
import matplotlib.pyplot as plt  # noqa: E402

import measure  # noqa: E402
import page  # noqa: E402

INTRODUCTION = """\
## Special functions

Every function is compared with values of 40 digits (mpmath) at exactly the doubles it was called with, region by
region: a region is where one branch of the method is at work, or where the function is hard. Its arguments are drawn
at random, {points} of them, together with the ends of the branches from both sides. *ulp* is the error in units of the
last place of the true value, so it explodes near a zero of the function, where the absolute error tells more; *relative*
and *absolute* are peaks too, each at its own argument. The last column names what limits a region by its method.
In the pictures each dot is an argument. `tools/accuracy/report.py` writes all of this anew.
"""


def number(x):
    if x == 0:
        return "0"
    if math.isinf(x) or math.isnan(x):
        return "all lost"
    if 0.01 <= x < 1000:
        return f"{x:.3g}"
    mantissa, exponent = f"{x:.1e}".split("e")
    return f"{mantissa}e{int(exponent)}"


def mean(values):
    finite = [v for v in values if math.isfinite(v)]
    return statistics.fmean(finite) if len(finite) == len(values) else math.inf


def argument(a):
    return f"{a:.6g}" if isinstance(a, float) else str(a)


def row(region, points):
    worst = max(points, key=lambda p: p.ulps)
    return [region.name, str(len(points)), number(worst.ulps), number(mean([p.ulps for p in points])),
            number(max(p.relative for p in points if p.true != 0 or p.computed == 0) if any(p.true for p in points)
                   else 0.0),
            number(max(p.absolute for p in points)), ", ".join(map(argument, worst.arguments)), region.note]


def picture(function, measured):
    fig, axes = plt.subplots(figsize=(7.2, 0.6 + 0.32 * len(measured)), dpi=80)
    for y, (region, points) in enumerate(reversed(measured)):
        ulps = [min(max(p.ulps, 1e-2), 1e17) for p in points]
        spread = [y + 0.5 * ((i * 0.6180339887) % 1.0 - 0.5) for i in range(len(points))]
        axes.scatter(ulps, spread, s=4, color="#205080", alpha=0.5, linewidths=0)
    axes.set_xscale("log")
    axes.set_xlim(7e-3, max(1e2, axes.get_xlim()[1]))
    axes.set_yticks(range(len(measured)), [region.name for region, _ in reversed(measured)])
    axes.set_ylim(-0.6, len(measured) - 0.4)
    axes.axvline(1.0, color="#b03020", linewidth=0.8)
    axes.set_xlabel("error in ulp")
    axes.set_title(function.title)
    axes.grid(axis="x", alpha=0.3)
    fig.savefig(page.PICTURES / f"{function.name}.png", bbox_inches="tight", metadata={"Software": None},
                pil_kwargs={"optimize": True})
    plt.close(fig)


def section(function, rows):
    lines = [f"### {function.title} · `{function.export}`", "",
             "| Region | Arguments | Peak ulp | Mean ulp | Relative | Absolute | Worst at | Limited by |",
             "|---|---:|---:|---:|---:|---:|---|---|"]
    lines += ["| " + " | ".join(row) + " |" for row in rows]
    return "\n".join(lines + ["", f"![{function.title}](accuracy/{function.name}.png)", ""])


def main():
    parser = argparse.ArgumentParser(description=textwrap.dedent(__doc__),
                                     formatter_class=argparse.RawDescriptionHelpFormatter)
    parser.add_argument("--library", type=pathlib.Path, default=measure.ROOT / "build/release/src/libkrnumer.so")
    parser.add_argument("--points", type=int, default=200)
    parser.add_argument("names", nargs="*", metavar="NAME")
    options = parser.parse_args()

    page.PICTURES.mkdir(parents=True, exist_ok=True)
    cache = measure.ROOT / "build" / "accuracy.json"  # rows of earlier runs, for those with names
    rows = json.loads(cache.read_text()) if cache.exists() else {}
    library = measure.Library(options.library)
    functions = measure.catalogue.functions()
    for function in functions:
        if options.names and function.name not in options.names:
            continue
        measured = [(region, measure.measure(library, function, region, options.points)) for region in function.regions]
        rows[function.name] = [row(region, points) for region, points in measured]
        picture(function, measured)
        cache.write_text(json.dumps(rows))
        print(function.name, flush=True)
    sections = [section(function, rows[function.name]) for function in functions if function.name in rows]
    page.write("special functions", "report.py", "\n".join([INTRODUCTION.format(points=options.points), *sections]))


if __name__ == "__main__":
    main()

#!/usr/bin/python3
"""Writes the golden data of the special functions: <function>.csv beside this script.

    make_golden.py [NAME ...]     the named functions, or all

A line holds a region, the arguments and the true value at exactly these doubles, from mpmath with 40 digits and more,
rounded to a double. Made with Python 3.11 and mpmath 1.2.1.
"""

import csv
import pathlib
import sys

import catalogue

COUNT = 32  # arguments of a region, at least its edges


def number(x):
    return repr(float(x)) if not isinstance(x, int) else str(x)


def main():
    here = pathlib.Path(__file__).parent
    wanted = set(sys.argv[1:])
    for function in catalogue.functions():
        if wanted and function.name not in wanted:
            continue
        with open(here / f"{function.name}.csv", "w", newline="") as file:
            writer = csv.writer(file, lineterminator="\n")
            for region in filter(lambda region: region.in_golden, function.regions):
                for arguments in region.arguments(COUNT, function.name):
                    value = function.value(arguments)
                    if value is not None and abs(value) < 1.7e308:
                        writer.writerow([region.name, *map(number, arguments), number(value)])


if __name__ == "__main__":
    main()

"""Writes reference values as C++ tables: one structure, filled for double and for Complex."""

from pathlib import Path

import numpy as np
import scipy


def element(value, is_complex):
    if is_complex:
        return f"{{{float(np.real(value))!r}, {float(np.imag(value))!r}}}"
    return repr(float(value))


def vector(values, is_complex):
    return "{" + ", ".join(element(value, is_complex) for value in values) + "}"


def integers(values):
    return "{" + ", ".join(str(int(value)) for value in values) + "}"


def matrix(values, is_complex):
    return f"{{{values.shape[0]}, {values.shape[1]}, {vector(np.ravel(values), is_complex)}}}"


def write(name, members, fields):
    """Writes <name>.inc; fields(is_complex) gives the initialiser of each member."""
    structure = "Golden" + name.capitalize()
    lines = [
        f"// Made by make_{name}.py with NumPy {np.__version__} and SciPy {scipy.__version__}.",
        "#pragma once",
        "",
        "#include <vector>",
        "",
        '#include "linalg/matrices.h"',
        "",
        "namespace krnumer {",
        "",
        "template <class T>",
        f"struct {structure} {{",
        members.strip("\n"),
        "",
        f"    static const {structure}& Values();",
        "};",
    ]
    for kind, is_complex in (("double", False), ("Complex", True)):
        golden = f"{structure}<{kind}>"
        lines += ["", "template <>", f"inline const {golden}& {golden}::Values() {{"]
        lines += [f"    static const {golden} kValues{{"]
        lines += [f"        .{field} = {value}," for field, value in fields(is_complex).items()]
        lines += ["    };", "    return kValues;", "}"]
    lines += ["", "}  // namespace krnumer", ""]
    Path(__file__).with_name(name + ".inc").write_text("\n".join(lines))

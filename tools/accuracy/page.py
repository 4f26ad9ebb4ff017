"""docs/accuracy.md: every script that measures owns the part of the page between two comments of its own."""

import pathlib

ROOT = pathlib.Path(__file__).resolve().parents[2]
PAGE = ROOT / "docs" / "accuracy.md"
PICTURES = ROOT / "docs" / "accuracy"


def write(part, script, text):
    """Replaces the part of that name, or adds it at the end of the page."""
    begin, end = f"<!-- {part}: written by tools/accuracy/{script} -->", f"<!-- end of {part} -->"
    page = PAGE.read_text() if PAGE.exists() else "# Accuracy\n"
    block = f"{begin}\n\n{text.rstrip()}\n\n{end}\n"
    if begin in page:
        page = page[: page.index(begin)] + block + page[page.index(end) + len(end) :].removeprefix("\n")
    else:
        page = f"{page.rstrip()}\n\n{block}"
    PAGE.write_text(page)


def table(head, rows):
    """The first column to the left, the others, figures, to the right."""
    lines = ["| " + " | ".join(head) + " |", "|---|" + "---:|" * (len(head) - 1)]
    return "\n".join(lines + ["| " + " | ".join(row) + " |" for row in rows]) + "\n"

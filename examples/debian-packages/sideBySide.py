"""Runs debian-packages with both forms of elements and shows their figures side by side.

Usage: sideBySide.py PROGRAM [ARGUMENT...]

The arguments are those of the program. Prints what it prints, once, and a table of the figures of
both forms. Fails if the forms print different results, times aside, and as the program does if that
fails.
"""
import difflib
import pathlib
import re
import subprocess
import sys
import tempfile

FORMS = {"generated": [], "run-time": ["--reflective"]}


def run(program, arguments, standard_input, folder):
    """What the program printed, and its figures as pairs; none if it only gave help."""
    table = folder / "figures"
    table.unlink(missing_ok=True)
    standard_input.seek(0)
    # Each form in a process of its own, so that none finds the memory that the other has freed.
    result = subprocess.run([program, "--figures", table, *arguments], stdin=standard_input,
                            stdout=subprocess.PIPE, text=True, errors="surrogateescape")
    if result.returncode != 0 or not table.exists():
        sys.stdout.write(result.stdout)
        sys.exit(result.returncode)
    rows = table.read_text(encoding="utf-8").splitlines()
    return result.stdout, [row.split("\t") for row in rows]


def without_times(text):
    return re.sub(r" in [0-9.]+ ms$", "", text, flags=re.MULTILINE).splitlines()


def expect_equal(outputs):
    (one, left), (other, right) = outputs.items()
    diff = list(difflib.unified_diff(without_times(left), without_times(right), one, other,
                                     lineterm=""))
    if diff:
        sys.exit("\n".join(["debian-packages: the forms have different results", *diff]))


def side_by_side(figures):
    rows = [["", *figures]]
    rows += [[of_all[0][0], *(value for _, value in of_all)] for of_all in zip(*figures.values())]
    widths = [max(map(len, column)) for column in zip(*rows)]
    for name, *values in rows:
        cells = [value.rjust(width) for value, width in zip(values, widths[1:])]
        yield "  ".join(["", name.ljust(widths[0]), *cells])


def main():
    sys.stdout.reconfigure(errors="surrogateescape")
    program, *arguments = sys.argv[1:]
    outputs, figures = {}, {}
    with tempfile.TemporaryDirectory() as name, tempfile.TemporaryFile() as standard_input:
        if "-" in arguments:  # read once, and given to both
            standard_input.write(sys.stdin.buffer.read())
        for form, options in FORMS.items():
            outputs[form], figures[form] = run(program, [*options, *arguments], standard_input,
                                               pathlib.Path(name))
    expect_equal(outputs)
    print(outputs["generated"], *side_by_side(figures), sep="\n")


main()

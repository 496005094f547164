#!/usr/bin/env python3
"""Writes the C++ classes of a metamodel from its description, or checks that they are up to date."""
import argparse
import difflib
import pathlib
import sys

import jinja2

import check
import model

ROOT = pathlib.Path(__file__).resolve().parent
PER_CLASS = {"Handle.h": "{name}.h", "Impl.h": "{name}Impl.h", "Class.cpp": "{name}.cpp"}
PER_PACKAGE = {"Catalogue.h": "Catalogue.h", "CMakeLists.txt": "CMakeLists.txt"}


def environment():
    env = jinja2.Environment(
        loader=jinja2.FileSystemLoader(ROOT / "templates"), undefined=jinja2.StrictUndefined,
        trim_blocks=True, lstrip_blocks=True, keep_trailing_newline=True)
    return env


def render(package, command):
    """Path below the output folder to text, for every generated file."""
    env = environment()
    origin = f"// Made from {package.title} by `{command}`; do not edit."
    files = {}
    for template, pattern in PER_CLASS.items():
        for cls in package.classes:
            text = env.get_template(template + ".jinja").render(c=cls, p=package, origin=origin)
            files[pattern.format(name=cls.name)] = text
    for template, name in PER_PACKAGE.items():
        files[name] = env.get_template(template + ".jinja").render(
            p=package, origin=origin, command=command)
    return files


def write(files, output):
    output.mkdir(parents=True, exist_ok=True)
    for name, text in sorted(files.items()):
        path = output / name
        if not path.exists() or path.read_text() != text:
            path.write_text(text)


def compare(files, output):
    """Prints how `output` differs from `files`; the number of files that do."""
    stale = 0
    for name, text in sorted(files.items()):
        path = output / name
        present = path.read_text() if path.exists() else ""
        if present != text:
            stale += 1
            sys.stdout.writelines(difflib.unified_diff(
                present.splitlines(True), text.splitlines(True), str(path), "generated"))
    for path in sorted(output.glob("*.h")) + sorted(output.glob("*.cpp")):
        if path.name not in files:
            stale += 1
            print(f"{path}: nothing generates this file any more")
    return stale


def main():
    parser = argparse.ArgumentParser(description=__doc__)
    parser.add_argument("description", type=pathlib.Path, help="the facts, NAME.json; NAME.cpp.json lies beside")
    parser.add_argument("output", type=pathlib.Path, help="the folder of the generated files")
    parser.add_argument("--check", action="store_true", help="change nothing, print a diff and fail if stale")
    arguments = parser.parse_args()
    try:
        package = model.Package(arguments.description, arguments.description.with_suffix(".cpp.json"))
    except check.DescriptionError as error:
        print(error, file=sys.stderr)
        return 2
    files = render(package, "tools/metagen/metagen.py")
    if arguments.check:
        return 1 if compare(files, arguments.output) else 0
    write(files, arguments.output)
    return 0


if __name__ == "__main__":
    sys.exit(main())

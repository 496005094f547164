#!/usr/bin/env python3
"""Writes the C++ classes of a metamodel from its description, or checks that they are up to date."""
import argparse
import difflib
import pathlib
import sys

try:
    import jinja2
except ImportError:
    sys.exit("metagen needs the Python package Jinja2; on Debian it is called python3-jinja2")

import builders
import load
import rows
import source

ROOT = pathlib.Path(__file__).resolve().parent
PER_CLASS = {"Handle.h": "{name}.h", "Impl.h": "{name}Impl.h",
             "Builder.h": "{name}Builder.h", "Constrainables.h": "{name}Constrainables.h",
             "Class.cpp": "{name}.cpp"}
ROWS = {"Rows.h": ".h", "Rows.cpp": ".cpp"}
PER_CATALOGUE = {"Catalogue.h": "Catalogue.h", "CMakeLists.txt": "CMakeLists.txt"}
# What a client has besides.
PER_CLIENT = {"Fwd.h": "Fwd.h"}
META_PACKAGE = {"MetaPackage.h": ".h", "MetaPackage.cpp": ".cpp"}
PER_ENUMERATION = {"Enumeration.h": "{name}.h"}
PER_EVENT = {"Event.h": "{name}.h", "Event.cpp": "{name}.cpp"}
PER_DATA_TYPE = {"DataType.h": "{name}.h", "DataType.cpp": "{name}.cpp",
                 "DatatypeSerializer.h": "{name}DatatypeSerializer.h",
                 "DatatypeSerializer.cpp": "{name}DatatypeSerializer.cpp"}


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

    def add(template, name, **names):
        files[name] = env.get_template(template + ".jinja").render(
            p=package, origin=origin, command=command, **names)

    def add_each(templates, entries):
        for template, pattern in templates.items():
            for entry in entries:
                add(template, pattern.format(name=entry.name), c=entry)

    for template, pattern in PER_CLASS.items():
        for cls in package.classes:
            add(template, pattern.format(name=cls.name), c=cls, b=builders.Builder(cls))
    add_each(PER_ENUMERATION, package.enumerations)
    add_each(PER_DATA_TYPE, package.data_types)
    add_each(PER_EVENT, package.events)
    for template, name in (PER_CATALOGUE if package.is_catalogue else PER_CLIENT).items():
        add(template, name)
    if not package.is_catalogue:
        for template, suffix in META_PACKAGE.items():
            add(template, package.meta_package + suffix)
    for template, suffix in ROWS.items():
        add(template, package.rows_file + suffix, r=rows.Rows(package))
    return files


def write(files, output):
    for name, text in sorted(files.items()):
        path = output / name
        path.parent.mkdir(parents=True, exist_ok=True)
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
    parser.add_argument("description", type=pathlib.Path,
                        help="NAME.json; of the catalogue the facts, beside which NAME.cpp.json lies")
    parser.add_argument("output", type=pathlib.Path, help="the folder of the generated files")
    parser.add_argument("--root", action="store_true",
                        help="the files go into the folder below that by which they are included")
    choice = parser.add_mutually_exclusive_group()
    choice.add_argument("--check", action="store_true",
                        help="change nothing, print a diff and fail if stale")
    choice.add_argument("--list", action="store_true",
                        help="write nothing, print the names of the generated files")
    choice.add_argument("--inputs", action="store_true",
                        help="write nothing, print the files that the output depends on")
    arguments = parser.parse_args()
    try:
        package = load.package(arguments.description)
    except source.DescriptionError as error:
        print(error, file=sys.stderr)
        return 2
    if arguments.inputs:
        print("\n".join(inputs(package)))
        return 0
    files = render(package, "tools/metagen/metagen.py" if package.is_catalogue else "metagen.py")
    if arguments.root:
        files = {f"{package.include}/{name}": text for name, text in files.items()}
    if arguments.list:
        print("\n".join(sorted(files)))
        return 0
    if arguments.check:
        return 1 if compare(files, arguments.output) else 0
    write(files, arguments.output)
    return 0


def inputs(package):
    """The generator, its templates, and the descriptions that were read."""
    own = [*ROOT.glob("*.py"), *ROOT.glob("*.json"), *ROOT.glob("templates/**/*.jinja")]
    return sorted(str(path) for path in {*own, *package.sources})


if __name__ == "__main__":
    sys.exit(main())

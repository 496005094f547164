"""Loads descriptions: the catalogue's, which is in two files, and those of clients."""
import functools
import pathlib

import check
import description
import source
from package import Package

ROOT = pathlib.Path(__file__).resolve().parent


def package(file, above=()):
    """The metamodel that `file` describes, with those that it imports."""
    overlay_file = file.with_suffix(".cpp.json")
    if overlay_file.exists():
        return from_halves(file, overlay_file)
    path = file.resolve()
    if path in above:
        raise source.DescriptionError(file, [("/imports", "the imports lead back to this file")])
    return from_description(file, lambda imported: package(imported, (*above, path)))


@functools.cache
def catalogue():
    """The metamodel of the library, on which all others stand."""
    installed = ROOT / "catalogue.json"
    return package(installed if installed.exists()
                   else ROOT.parents[1] / "src/tarnkiln/meta/catalogue.json")


def from_halves(facts_file, overlay_file):
    facts, overlay = source.read(facts_file), source.read(overlay_file)
    check.Rules(source.Problems(facts_file), facts, {}, {}, facts_primitives(facts)).check()
    check.check_overlay(source.Problems(overlay_file), overlay, facts)
    return Package([facts_file, overlay_file], facts, overlay)


def facts_primitives(facts):
    return {entry["name"] for entry in facts["primitiveTypes"]}


def from_description(file, imported):
    base = catalogue()
    facts, overlay, packages = description.load(file, base, imported)
    packages = [base, *packages]
    foreign = {name: cls for each in packages for name, cls in each.qualified_facts.items()}
    literals = {name: names for each in packages for name, names in each.qualified_literals.items()}
    check.Rules(source.Problems(file), facts, foreign, literals, set(base.primitives)).check()
    return Package([file], facts, overlay, packages)

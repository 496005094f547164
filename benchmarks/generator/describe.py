#!/usr/bin/env python3
"""Writes descriptions of metamodels that are as large as somebody wants to measure.

    describe.py classes COUNT    COUNT classes that extend and refer to one another
    describe.py kinds            a class for each kind of property, with eight of it
"""
import json
import sys

# What has the name of a type holds values of it.
KINDS = {
    "BooleanHolder": {"type": "Boolean"},
    "IntegerHolder": {"type": "Integer"},
    "OptionalInteger": {"type": "Integer", "lower": 0},
    "RealHolder": {"type": "Real"},
    "StringHolder": {"type": "String"},
    "OptionalString": {"type": "String", "lower": 0},
    "DateTimeHolder": {"type": "DateTime"},
    "UuidHolder": {"type": "UUID"},
    "Enumeration": {"type": "Colour"},
    "Reference": {"type": "Member"},
    "Numbers": {"type": "Integer", "upper": "*"},
    "References": {"type": "Member", "upper": "*"},
    "Contents": {"type": "Member", "upper": "*", "composite": True},
    "Keyed": {"type": "NamedMember", "upper": "*", "composite": True, "qualifiedBy": "name"},
}


def classes(count):
    """Each class extends one of the ten before it and has six properties."""
    described = []
    for number in range(count):
        described.append({
            "name": f"Class{number}",
            **({"superclass": f"Class{number // 10 - 1}"} if number >= 10 else {}),
            "properties": [
                {"name": f"name{number}", "type": "String"},
                {"name": f"number{number}", "type": "Integer", "lower": 0},
                {"name": f"colour{number}", "type": "Colour"},
                {"name": f"friend{number}", "type": f"Class{(number * 7 + 3) % count}"},
                {"name": f"parts{number}", "type": f"Class{(number + 1) % count}", "upper": "*",
                 "composite": True, "opposite": f"whole{number}"},
                {"name": f"whole{(number - 1) % count}", "type": f"Class{(number - 1) % count}",
                 "opposite": f"parts{(number - 1) % count}"},
            ],
        })
    return described


def kinds():
    described = [{"name": "Member"},
                 {"name": "NamedMember", "properties": [{"name": "name", "type": "String"}]}]
    for name, facts in KINDS.items():
        described.append({"name": name, "properties": [
            {"name": f"value{number}", **facts} for number in range(8)]})
    return described


def main():
    what = sys.argv[1]
    json.dump({
        "name": what,
        "uri": f"{what}/1",
        "enumerations": [{"name": "Colour", "literals": [{"name": "red"}, {"name": "green"}]}],
        "classes": kinds() if what == "kinds" else classes(int(sys.argv[2])),
    }, sys.stdout, indent=1)


if __name__ == "__main__":
    main()

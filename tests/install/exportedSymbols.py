#!/usr/bin/env python3
"""Fails if a shared library exports a symbol outside our namespaces or of an internal class.

Internal classes may stand in the signatures of what is exported: clients can name them, not use them.

Usage: exportedSymbols.py LIBRARY
"""
import re
import subprocess
import sys

# A mangled name in tarn::kiln or tarnkiln: a function or object, type information, a table, a thunk,
# or a guard or local of such a function.
OURS = re.compile(r"_Z(?:T[VTIS]|TC|T[hv]n?\d+_(?:n?\d+_)?|GV)?Z?N[KVRO]*(?:4tarn4kiln|8tarnkiln)")


def exported(library):
    """Pairs of the mangled and the readable name of what the dynamic symbol table defines."""
    listing = subprocess.run(["nm", "--dynamic", "--defined-only", "--format=posix", library],
                             check=True, capture_output=True, text=True).stdout
    mangled = [line.split()[0] for line in listing.splitlines()]
    readable = subprocess.run(["c++filt"], input="\n".join(mangled),
                              check=True, capture_output=True, text=True).stdout
    return list(zip(mangled, readable.splitlines(), strict=True))


def scope(readable):
    """The name of the symbol itself, without template arguments, parameters and what it returns."""
    previous = None
    while previous != readable:
        previous, readable = readable, re.sub(r"<[^<>]*>|\([^()]*\)", "", readable)
    return readable


def is_allowed(mangled, readable):
    return bool(OURS.match(mangled)) and "::internal::" not in scope(readable)


def main():
    (library,) = sys.argv[1:]
    symbols = exported(library)
    if not symbols:
        print("the library exports nothing")
        return 1
    strays = [readable for mangled, readable in symbols if not is_allowed(mangled, readable)]
    for name in strays:
        print("must not be exported:", name)
    print(f"{len(symbols)} symbols, {len(strays)} of them astray")
    return 1 if strays else 0


if __name__ == "__main__":
    sys.exit(main())

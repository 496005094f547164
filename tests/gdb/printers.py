#!/usr/bin/env python3
"""Looks at the variables of a program in gdb and compares what the printers show.

Usage: printers.py GDB PROGRAM PRINTERS
Exit status: 0 if all is as expected, 77 (with the reason) where gdb can't run the program.
"""
import re
import shutil
import subprocess
import sys

UUID = "[0-9a-f]{8}-[0-9a-f]{4}-[0-9a-f]{4}-[0-9a-f]{4}-[0-9a-f]{12}"
ID = "aa000000-0001-4202-8303-000000000004"

# What to print, and the pattern of all that gdb may answer.
EXPECTED = {
    "id": ID,
    "text": 'u?"a text"',
    "node": rf'testkit::Node "alpha é" {ID}.*',
    "child": rf'testkit::Node "beta" {UUID}.*',
    "gone": rf'testkit::Node "" {UUID} \(invalid\).*',
    "empty": "empty testkit::Node",
    "node.getImpl()->m_buddy": rf'testkit::Node "beta" {UUID}',
    "number": "Integer 42",
    "title": 'String u?"a text"',
    "absent": "OptionalSingle of Integer, absent",
    "numbers": r".*PrimitiveSequence<int> holding .*length 2.* = \{3, 5\}",
    "children": rf'.*ElementSequence<testkit::Node> holding .*length 1.*testkit::Node "beta" {UUID}.*',
}
REFUSED = ("ptrace: Operation not permitted", "Could not trace the inferior process")


def main():
    gdb, program, printers = sys.argv[1:]
    if not shutil.which(gdb):
        print("there is no gdb on this machine")
        return 77
    command = [gdb, "--batch", "--nx", "-iex", "set auto-load safe-path /", "-ex",
               f"source {printers}", "-ex", "break stop", "-ex", "run", "-ex", "up"]
    for number, expression in enumerate(EXPECTED):
        command += ["-ex", f"echo ={number}=", "-ex", f"output {expression}", "-ex", "echo \\n"]
    done = subprocess.run(command + [program], text=True, stdout=subprocess.PIPE,
                          stderr=subprocess.STDOUT, errors="replace", timeout=120)
    if any(words in done.stdout for words in REFUSED):
        print("tracing is refused on this machine:\n" + done.stdout)
        return 77
    wrong = 0
    for number, (expression, pattern) in enumerate(EXPECTED.items()):
        found = re.search(rf"={number}=(.*?)(?=^=\d+=|\Z)", done.stdout, re.DOTALL | re.MULTILINE)
        shown = found.group(1).strip() if found else "nothing"
        if not re.fullmatch(pattern, shown, re.DOTALL):
            wrong += 1
            print(f"{expression}: shown as\n  {shown}\nexpected\n  {pattern}")
    if wrong:
        print("All that gdb said:\n" + done.stdout)
    return 1 if wrong else 0


if __name__ == "__main__":
    sys.exit(main())

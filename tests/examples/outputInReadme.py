"""Fails unless a program prints what its README says, as an indented block.

Usage: outputInReadme.py PROGRAM README
"""
import difflib
import subprocess
import sys


def main():
    program, readme = sys.argv[1:]
    with open(readme, encoding="utf-8") as file:
        promised = [line[4:] for line in file.read().splitlines() if line.startswith("    ")]
    result = subprocess.run([program], check=True, capture_output=True, text=True)
    diff = list(difflib.unified_diff(promised, result.stdout.splitlines(), readme, program,
                                     lineterm=""))
    if diff:
        sys.exit("\n".join(diff))


main()

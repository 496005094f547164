"""Fails unless every C++ block of a page stands in a source, which is compiled and run as a test.

Indentation aside, the lines of a block must follow each other in the source.

Usage: blocksInSource.py PAGE SOURCE
"""
import re
import sys


def normal(text):
    """`text` without indentation."""
    return "\n".join(line.strip() for line in text.strip().splitlines())


def main():
    page, source = sys.argv[1:]
    with open(page, encoding="utf-8") as file:
        blocks = re.findall(r"^```cpp\n(.*?)^```$", file.read(), re.MULTILINE | re.DOTALL)
    with open(source, encoding="utf-8") as file:
        compiled = "\n" + normal(file.read()) + "\n"
    if not blocks:
        sys.exit(f"{page} shows no code")
    missing = [block for block in blocks if f"\n{normal(block)}\n" not in compiled]
    if missing:
        sys.exit("\n".join(f"not in {source}:\n{block}" for block in missing))


main()

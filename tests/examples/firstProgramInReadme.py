"""Fails unless the README shows the first program as it is compiled.

Usage: firstProgramInReadme.py README PROGRAM
"""
import difflib
import re
import sys


def main():
    readme_path, program_path = sys.argv[1:]
    with open(readme_path, encoding="utf-8") as readme:
        blocks = re.findall(r"^```cpp\n(.*?)^```$", readme.read(), re.MULTILINE | re.DOTALL)
    with open(program_path, encoding="utf-8") as program:
        text = program.read()
    if not blocks:
        sys.exit(f"{readme_path} shows no program")
    diff = difflib.unified_diff(text.splitlines(), blocks[0].splitlines(), program_path,
                                readme_path, lineterm="")
    lines = list(diff)
    if lines:
        sys.exit("\n".join(lines))


main()

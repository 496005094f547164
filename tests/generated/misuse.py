"""Fails unless the compiler refuses each marked line of a source for the reason that stands there.

Usage: misuse.py SOURCE COMPILER ARGUMENT...

A line is marked by `// error: beginning of the message`. An error inside a template belongs to the
line that called for it.
"""
import re
import subprocess
import sys


def wanted_errors(source):
    """The reason that each marked line gives, by its number."""
    with open(source, encoding="utf-8") as lines:
        marks = enumerate((re.search(r"// error: (.*)", line) for line in lines), 1)
        return {number: mark[1] for number, mark in marks if mark}


def seen_errors(source, diagnostics):
    """All messages of errors, with the line of the source that each belongs to."""
    errors, required = [], None
    for line in diagnostics.splitlines():
        place = re.match(
            rf"{re.escape(source)}:(\d+):\d+:\s+(required from here|error: (.*))", line)
        if place and place[3]:
            errors.append((int(place[1]), place[3]))
            required = None
        elif place:
            required = int(place[1])
        elif match := re.search(r": error: (?:static assertion failed: )?(.*)", line):
            errors.append((required, match[1]))
    return errors


def main():
    source, *command = sys.argv[1:]
    result = subprocess.run([*command, "-fsyntax-only", source], capture_output=True, text=True,
                            env={"LC_ALL": "C", "PATH": "/usr/bin:/bin"})
    wanted = wanted_errors(source)
    seen = seen_errors(source, result.stderr)
    problems = [f"{source}:{number}: no error: {reason}" for number, reason in wanted.items()
                if not any(line == number and message.startswith(reason)
                           for line, message in seen)]
    problems += [f"{source}:{line}: unexpected error: {message}" for line, message in seen
                 if not message.startswith(wanted.get(line, "\0"))]
    if problems or not wanted:
        sys.exit("\n".join(problems + [result.stderr]))


main()

"""Reads JSON files, and tells what is wrong with them as a compiler would: file, place, reason."""
import json


class DescriptionError(Exception):
    """All that is wrong with one file, as pairs of a place inside it and a reason."""

    def __init__(self, file, problems):
        super().__init__("\n".join(f"{file}: {place}: {reason}" if place else f"{file}: {reason}"
                                   for place, reason in problems))
        self.file, self.problems = str(file), problems


class Problems:
    """Collects what is wrong with a file, so that one run tells all of it."""

    def __init__(self, file):
        self.file = file
        self.found = []

    def add(self, pointer, reason):
        if (pointer, reason) not in self.found:
            self.found.append((pointer, reason))

    def stop(self):
        """Raises what was found, if anything was."""
        if self.found:
            raise DescriptionError(self.file, self.found)


def read(file):
    """The contents of a JSON file."""
    try:
        return json.loads(file.read_text(encoding="utf-8"), object_pairs_hook=unique_keys)
    except json.JSONDecodeError as error:
        place = f"line {error.lineno}, column {error.colno}"
        raise DescriptionError(file, [(place, f"no JSON: {error.msg}")]) from error
    except UnicodeDecodeError as error:
        raise DescriptionError(file, [("", f"no UTF-8 at byte {error.start}")]) from error
    except OSError as error:
        raise DescriptionError(file, [("", error.strerror)]) from error
    except RepeatedKey as error:
        raise DescriptionError(file, [("", str(error))]) from error


class RepeatedKey(Exception):
    """An object has one key twice."""


def unique_keys(pairs):
    result = dict(pairs)
    if len(result) < len(pairs):
        keys = [key for key, value in pairs]
        twice = next(key for key in keys if keys.count(key) > 1)
        named = f" of {result['name']!r}" if "name" in result else ""
        raise RepeatedKey(f"the key {twice!r}{named} is given twice in one object")
    return result

"""The description of a metamodel, checked and turned into the names that the templates print.

A description has two halves: the facts (classes, properties, indices, UUIDs) and an overlay with
the decisions that only C++ needs (namespace, documentation, getters, setters). Everything that
templates print is computed here; they only lay it out.
"""
import json
import re
import textwrap

WIDTH = 100
MODEL_ELEMENT = "ModelElement"


class DescriptionError(Exception):
    """A description that contradicts itself; says in which file, where inside it, and why."""

    def __init__(self, file, path, reason):
        super().__init__(f"{file}: {path}: {reason}")
        self.file, self.path, self.reason = str(file), path, reason


def comment(text, indent=0):
    """`text` as the lines of a documentation comment; an empty line parts paragraphs."""
    prefix = " " * indent + "/// "
    lines = []
    for paragraph in text.split("\n"):
        lines += textwrap.wrap(paragraph, WIDTH - len(prefix), break_on_hyphens=False) or [""]
    return "\n".join((prefix + line).rstrip() for line in lines)


class Class:
    def __init__(self, facts, cpp, package):
        self.name = facts["name"]
        self.superclass = facts["superclass"]
        self.abstract = facts["abstract"]
        self.uuid = facts["uuid"]
        self.file = cpp["file"]
        self.brief = cpp["brief"]
        self.details = cpp.get("details", "")
        self.package = package

    @property
    def is_root(self):
        return self.superclass == MODEL_ELEMENT

    @property
    def base(self):
        """The base of the handle, as code in the package's namespace names it."""
        return self.superclass

    @property
    def base_header(self):
        if self.is_root:
            return "tarnkiln/kernel/ModelElement.h"
        return f"{self.package.include}/{self.superclass}.h"

    @property
    def handle_includes(self):
        return sorted([self.base_header, "tarnkiln/Export.h", "tarnkiln/meta/Fwd.h"])

    @property
    def article(self):
        return "an" if self.name[0] in "AEIOU" else "a"

    @property
    def file_doc(self):
        return comment(f"\\file\nThe handle of {self.file}.")

    @property
    def doc(self):
        text = self.brief + "\n\n"
        if self.details:
            text += self.details + "\n\n"
        noun = spoken(self.name)
        text += (f"The handle is shared: copies refer to the same {noun}; it is false when empty or when "
                 f"the {noun} was destroyed.\n\n"
                 "Threads: handles may be copied and dropped anywhere. What belongs to the registry may "
                 "be read on any thread; all else happens on the thread that uses the model.")
        return comment(text)

    @property
    def cast_doc(self):
        return comment(f"The {spoken(self.name)} behind `element`; empty if that is empty or "
                       "something else.", 4)


def spoken(name):
    """`EnumLiteral` as a reader says it: "enum literal"."""
    words = re.findall(r"[A-Z]+(?=[A-Z][a-z])|[A-Z][a-z]*|[A-Z]+", name)
    return " ".join(word if word.isupper() and len(word) > 1 else word.lower() for word in words)


class Package:
    """All classes of one metamodel, base classes first where order matters."""

    def __init__(self, facts_file, overlay_file):
        facts = json.loads(facts_file.read_text())
        overlay = json.loads(overlay_file.read_text())
        self.title = facts_file.name
        self.namespace = overlay["namespace"]
        self.include = overlay["include"]
        self.export = overlay["export"]
        self.classes = [Class(entry, overlay["classes"][entry["name"]], self)
                        for entry in facts["classes"]]
        self.by_name = {c.name: c for c in self.classes}

"""How names and texts are spelled and laid out in C++."""
import re
import textwrap

WIDTH = 100


def comment(text, indent=0):
    """`text` as the lines of a documentation comment; an empty line parts paragraphs."""
    prefix = " " * indent + "/// "
    lines = []
    for paragraph in text.split("\n"):
        lines += textwrap.wrap(paragraph, WIDTH - len(prefix), break_on_hyphens=False) or [""]
    return "\n".join((prefix + line).rstrip() for line in lines)


def fill(head, items, tail, indent, width=WIDTH):
    """A list on one line if it fits; else on lines of its own, `indent` deep, each as full as may
    be."""
    line = head + ", ".join(items) + tail
    if len(line) <= width:
        return line
    lines, current = [head.rstrip()] if head.strip() else [], " " * indent
    for position, item in enumerate(items):
        piece = item + (tail if position == len(items) - 1 else ",")
        gap = "" if current.isspace() else " "
        if len(current) + len(gap) + len(piece) > WIDTH and gap:
            lines.append(current)
            current, gap = " " * indent, ""
        current += gap + piece
    return "\n".join(lines + [current])


def spoken(name):
    """`EnumLiteral` as a reader says it: "enum literal"."""
    words = re.findall(r"[A-Z]+(?=[A-Z][a-z])|[A-Z][a-z0-9]*|[A-Z]+", capital(name))
    return " ".join(word if word.isupper() and len(word) > 1 else word.lower() for word in words)


def constant(name):
    """`importedPackageURIs` as a constant: "IMPORTED_PACKAGE_URIS"."""
    parts = re.findall(r"[A-Z]+s?(?=[A-Z][a-z]|$)|[A-Z]?[a-z0-9]+|[A-Z]+", name)
    return "_".join(part.upper() for part in parts)


def capital(name):
    return name[0].upper() + name[1:]


def is_question(name):
    return re.match(r"is[A-Z]", name) is not None


def article(name):
    return "an" if name[0] in "AEIOU" else "a"


def sentence(text):
    """`text` with a capital and a full stop."""
    return capital(text.rstrip(".")) + "."


def sorted_blocks(headers):
    """Headers in angle brackets, those of Boost before those of the standard library."""
    boost = sorted(h for h in headers if h.startswith("<boost"))
    standard = sorted(headers - set(boost))
    return [block for block in (boost, standard) if block]

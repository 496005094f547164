"""Refuses descriptions that contradict themselves, before anything is generated from them."""
import json
import re

MODEL_ELEMENT = "ModelElement"
UUID_FORM = re.compile(r"[0-9a-f]{8}(-[0-9a-f]{4}){3}-[0-9a-f]{12}")
DEFAULTS = {"Boolean": {"true", "false"}}


class DescriptionError(Exception):
    """Says in which file, where inside it, and why."""

    def __init__(self, file, path, reason):
        super().__init__(f"{file}: {path}: {reason}")
        self.file, self.path, self.reason = str(file), path, reason


def load(facts_file, overlay_file):
    """Both halves of a description, checked."""
    facts, overlay = parse(facts_file), parse(overlay_file)
    Facts(facts_file, facts).check()
    check_overlay(overlay_file, overlay, facts)
    return facts, overlay


def parse(file):
    try:
        return json.loads(file.read_text())
    except (OSError, ValueError) as error:
        raise DescriptionError(file, "", str(error)) from error


class Facts:
    """The rules for the classes, their properties and operations, and the enumerations."""

    def __init__(self, file, facts):
        self.file, self.facts = file, facts
        self.classes = {}
        self.uuids = {}

    def refuse(self, path, reason):
        raise DescriptionError(self.file, path, reason)

    def check(self):
        for name, entry in self.entries("classes"):
            if name in self.classes:
                self.refuse(f"classes/{name}", "there is a class of that name already")
            self.classes[name] = entry
        for name, entry in self.classes.items():
            self.check_superclasses(name)
        for name, entry in self.classes.items():
            self.check_indices(name, entry)
            for prop in entry["properties"]:
                self.check_property(f"classes/{name}/{prop['name']}", name, prop)
        self.check_uuids("", self.facts)

    def entries(self, key):
        return [(entry["name"], entry) for entry in self.facts.get(key, [])]

    def check_superclasses(self, name):
        seen, above = [], name
        while above != MODEL_ELEMENT:
            if above in seen:
                self.refuse(f"classes/{name}", f"the superclasses of {above} lead back to it")
            if above not in self.classes:
                self.refuse(f"classes/{name}", f"there is no superclass {above}")
            seen.append(above)
            above = self.classes[above]["superclass"]

    def check_indices(self, name, entry):
        """Indices run in one sequence, without a gap, down the chain of superclasses."""
        base = entry["superclass"]
        expected = 1 if base == MODEL_ELEMENT else self.classes[base]["slots"]
        for prop in entry["properties"]:
            path = f"classes/{name}/{prop['name']}"
            if prop["derived"] != (prop["index"] is None):
                self.refuse(path, "exactly the derived properties have no index")
            if prop["derived"]:
                continue
            if prop["index"] != expected:
                self.refuse(path, f"the index is {prop['index']}, and {expected} comes next")
            expected += 1
        if entry["slots"] != expected:
            self.refuse(f"classes/{name}", f"slots is {entry['slots']} instead of {expected}")

    def check_property(self, path, owner, prop):
        if prop["lower"] > prop["upper"] or prop["upper"] == 0:
            self.refuse(path, f"the bounds {prop['lower']}..{prop['upper']} leave no room")
        if prop["default"] is not None and \
                prop["default"] not in DEFAULTS.get(prop["type"], {prop["default"]}):
            self.refuse(path, f"{prop['default']!r} is no {prop['type']}")
        if prop["typeKind"] != "Class":
            for role in ("opposite", "qualifiedBy"):
                if prop[role] is not None:
                    self.refuse(path, f"{prop['type']} is no class, so there is no {role}")
            return
        if prop["type"] not in self.classes and prop["type"] != MODEL_ELEMENT:
            self.refuse(path, f"there is no class {prop['type']}")
        if prop["opposite"] is not None:
            self.check_opposite(path, owner, prop)
        if prop["qualifiedBy"] is not None and not self.find(prop["type"], prop["qualifiedBy"]):
            self.refuse(path, f"{prop['type']} has no property {prop['qualifiedBy']} to qualify by")

    def check_opposite(self, path, owner, prop):
        other = self.find(prop["type"], prop["opposite"])
        if other is None:
            self.refuse(path, f"{prop['type']} has no property {prop['opposite']}")
        if other["opposite"] != prop["name"]:
            self.refuse(path, f"the opposite of {prop['opposite']} is {other['opposite']}")
        if other["type"] != owner:
            self.refuse(path, f"its opposite is of type {other['type']}, not {owner}")
        if prop["composite"] and (other["composite"] or other["upper"] != 1):
            self.refuse(path, "the opposite of a composite property is one container")

    def find(self, owner, name):
        while owner in self.classes:
            for prop in self.classes[owner]["properties"]:
                if prop["name"] == name:
                    return prop
            owner = self.classes[owner]["superclass"]
        return None

    def check_uuids(self, path, node):
        """Each UUID is well formed and is given once."""
        if isinstance(node, list):
            for position, entry in enumerate(node):
                name = entry.get("name") if isinstance(entry, dict) else None
                self.check_uuids(f"{path}/{name or position}".lstrip("/"), entry)
        elif isinstance(node, dict):
            uuid = node.get("uuid")
            if uuid is not None:
                if not UUID_FORM.fullmatch(uuid):
                    self.refuse(path, f"{uuid!r} is no UUID in lower case")
                if uuid in self.uuids:
                    self.refuse(path, f"the UUID {uuid} belongs to {self.uuids[uuid]}")
                self.uuids[uuid] = path
            for key, value in node.items():
                self.check_uuids(f"{path}/{key}".lstrip("/"), value)


def check_overlay(file, overlay, facts):
    """Every class and property has its C++ half, and there is none without facts."""
    for key in ("namespace", "include", "export", "types", "classes"):
        if key not in overlay:
            raise DescriptionError(file, "", f"there is no {key!r}")
    described = {entry["name"]: {prop["name"] for prop in entry["properties"]}
                 for entry in facts["classes"]}
    compare(file, "classes", set(overlay["classes"]), set(described))
    for name, properties in described.items():
        compare(file, f"classes/{name}", set(overlay["classes"][name]["properties"]), properties)
    for entry in facts["classes"]:
        for prop in entry["properties"]:
            if prop["typeKind"] != "Class" and prop["type"] not in overlay["types"]:
                raise DescriptionError(file, "types", f"there is no C++ type for {prop['type']}, "
                                       f"as {entry['name']}.{prop['name']} needs")


def compare(file, path, given, wanted):
    for name in sorted(wanted - given):
        raise DescriptionError(file, path, f"there is no entry for {name}")
    for name in sorted(given - wanted):
        raise DescriptionError(file, path, f"the facts know no {name}")

"""Refuses facts that contradict themselves, before anything is generated from them.

All rules are asked, and each violation is told with its place, so that one run shows what is to be
mended. Facts of the catalogue and of clients obey the same rules.
"""
import re

import defaults
import words
from description import MODEL_ELEMENT
from wording import capital

UUID_FORM = re.compile(r"[0-9a-f]{8}(-[0-9a-f]{4}){3}-[0-9a-f]{12}")
# Primitive types by whose values a collection may be keyed.
KEY_TYPES = {"Integer", "Integer8", "Integer16", "Integer64", "UnlimitedNatural", "UInteger8",
             "UInteger16", "UInteger64", "Real", "String", "StdString", "UUID"}


def cpp_name(entry):
    """The name in C++; the catalogue's names are the same there."""
    return entry.get("cppName", entry["name"])


def accessors(prop):
    """The functions that stand for a property."""
    name = capital(cpp_name(prop))
    getter = cpp_name(prop) if re.match("is[A-Z]", cpp_name(prop)) else f"get{name}"
    return [getter, f"get{name}Impl", f"has{name}", f"set{name}", f"make{name}"]


class Rules:
    """The rules for the types of one package.

    :param foreign: the classes of other packages that it may name, by qualified name; what they
        name is qualified as well.
    :param enumerations: the names of the literals of foreign enumerations, by qualified name.
    :param carried: the names of the primitive types that have a C++ type.
    """

    def __init__(self, problems, facts, foreign, enumerations, carried):
        self.problems = problems
        self.facts = facts
        self.carried = carried
        self.own = {entry["name"]: entry for entry in facts["classes"]}
        self.classes = {**foreign, **self.own}
        self.literals = {**enumerations, **{
            entry["name"]: [literal["name"] for literal in entry["literals"]]
            for entry in facts["enumerations"]}}
        self.uuids = {}
        self.sound = set()

    def check(self):
        self.check_type_names()
        for place, cls in self.each("/classes", self.facts["classes"]):
            if self.check_superclasses(place, cls):
                self.sound.add(cls["name"])
        for place, cls in self.each("/classes", self.facts["classes"]):
            if cls["name"] in self.sound:
                self.check_class(place, cls)
        for place, entry in self.each("/dataTypes", self.facts["dataTypes"]):
            self.check_fields(place, entry)
        for place, entry in self.each("/enumerations", self.facts["enumerations"]):
            self.check_literals(place, entry)
        self.check_uuids("", self.facts)
        self.problems.stop()

    def refuse(self, place, reason):
        self.problems.add(place, reason)

    @staticmethod
    def each(place, entries):
        return [(f"{place}/{position}", entry) for position, entry in enumerate(entries)]

    # Names

    def check_type_names(self):
        seen = {}
        for kind in ("classes", "dataTypes", "enumerations"):
            for place, entry in self.each(f"/{kind}", self.facts[kind]):
                self.check_word(f"{place}/name", entry["name"], words.LIBRARY)
                self.check_once(f"{place}/name", entry["name"], seen, "a type")
                if entry["name"] in self.carried:
                    self.refuse(f"{place}/name", f"{entry['name']} is a primitive type")

    def check_once(self, place, name, seen, kind):
        if name in seen:
            self.refuse(place, f"there is {kind} {name} already, at {seen[name]}")
        seen.setdefault(name, place)

    def check_word(self, place, name, also=frozenset()):
        if name in words.RESERVED:
            self.refuse(place, f"{name} is a word of C++")
        elif name in also:
            self.refuse(place, f"{name} means something else in generated code")

    # Classes

    def check_superclasses(self, place, cls):
        """Whether the way up ends."""
        seen, above = [], cls["name"]
        while above != MODEL_ELEMENT:
            if above in seen:
                self.refuse(f"{place}/superclass", f"the superclasses of {above} lead back to it")
                return False
            if above not in self.classes:
                self.refuse(f"{place}/superclass", f"there is no class {above}")
                return False
            seen.append(above)
            above = self.classes[above]["superclass"]
        return True

    def check_class(self, place, cls):
        self.check_indices(place, cls)
        self.check_members(place, cls)
        for where, prop in self.each(f"{place}/properties", cls["properties"]):
            self.check_property(where, cls, prop)
        for where, operation in self.each(f"{place}/operations", cls["operations"]):
            self.check_operation(where, cls, operation)

    def check_indices(self, place, cls):
        """Indices run in one sequence, without a gap, down the chain of superclasses.

        Where they are not given they are added, and so is the number of slots.
        """
        expected = self.slots(cls["superclass"])
        for where, prop in self.each(f"{place}/properties", cls["properties"]):
            if prop["derived"]:
                if prop["index"] is not None:
                    self.refuse(f"{where}/index", "a derived property has no index")
                continue
            if prop["index"] is None:
                prop["index"] = expected
            elif prop["index"] != expected:
                self.refuse(f"{where}/index", f"{prop['index']} leaves a gap or is taken; "
                                              f"{expected} comes next")
            expected += 1
        if cls.setdefault("slots", expected) != expected:
            self.refuse(f"{place}/slots", f"is {cls['slots']} instead of {expected}")

    def slots(self, name):
        """The number of slots of a class; 1 for that of all elements."""
        if name == MODEL_ELEMENT:
            return 1
        cls = self.classes[name]
        if "slots" in cls:
            return cls["slots"]
        return self.slots(cls["superclass"]) + sum(not p["derived"] for p in cls["properties"])

    def check_members(self, place, cls):
        """No two members of a class have one name, nor does one hide what all elements have."""
        seen, functions = {}, {}
        for where, prop in self.each(f"{place}/properties", cls["properties"]):
            self.check_word(f"{where}/name", cpp_name(prop),
                            words.SEARCH_INSTANCES | {cls["name"]})
            self.check_once(f"{where}/name", prop["name"], seen, "a property")
            if self.find(cls["superclass"], prop["name"]):
                self.refuse(f"{where}/name", f"a superclass has a property {prop['name']}")
            for function in accessors(prop):
                functions.setdefault(function, prop["name"])
                if function in words.MEMBERS:
                    self.refuse(f"{where}/name",
                                f"{function} means something else for every element")
                elif functions[function] != prop["name"]:
                    self.refuse(f"{where}/name", f"{function} stands for {functions[function]}")
        for where, operation in self.each(f"{place}/operations", cls["operations"]):
            name = cpp_name(operation)
            self.check_word(f"{where}/name", name, words.MEMBERS)
            if name in functions:
                self.refuse(f"{where}/name", f"{name} stands for {functions[name]}")
            types = ", ".join(argument["type"] for argument in operation["arguments"])
            self.check_once(f"{where}/name", f"{operation['name']}({types})", seen, "an operation")

    # Properties

    def check_property(self, place, owner, prop):
        self.check_bounds(place, prop)
        if not self.check_type(f"{place}/type", prop):
            return
        self.check_default(place, prop)
        if prop["typeKind"] == "Class":
            self.check_qualifier(place, prop)
            self.check_opposite(place, owner["name"], prop)
            return
        for role in ("opposite", "qualifiedBy"):
            if prop[role] is not None:
                self.refuse(f"{place}/{role}", f"{prop['type']} is no class, so there is none")
        if prop["composite"]:
            self.refuse(f"{place}/composite", f"{prop['type']} is no class: its values have no "
                                              "container")

    def check_bounds(self, place, prop):
        if prop["lower"] > prop["upper"] or prop["upper"] == 0:
            self.refuse(f"{place}/lower", f"the bounds {prop['lower']}..{prop['upper']} leave no "
                                          "room")

    def check_type(self, place, typed):
        """Whether the type is known, and one that generated code can carry."""
        known = typed["typeKind"] is not None
        if typed["typeKind"] == "Class":
            known = typed["type"] in self.classes or typed["type"] == MODEL_ELEMENT
        if not known:
            self.refuse(place, f"there is no type {typed['type']}")
        elif typed["typeKind"] == "PrimitiveType" and typed["type"] not in self.carried:
            self.refuse(place, f"there is no C++ type for values of {typed['type']}")
            return False
        return known

    def check_default(self, place, prop):
        text = prop["default"]
        if text is None:
            return
        if prop["upper"] > 1:
            self.refuse(f"{place}/default", "a property of many values has no default")
        elif prop["typeKind"] in ("Class", "DataType"):
            self.refuse(f"{place}/default", f"a property of type {prop['type']} has no default")
        elif prop["typeKind"] == "Enum":
            if text not in self.literals.get(prop["type"], []):
                self.refuse(f"{place}/default", f"{prop['type']} has no literal {text!r}")
        else:
            try:
                defaults.expression(prop["type"], text)
            except defaults.NoDefault as error:
                self.refuse(f"{place}/default", f"{text!r} {error} {prop['type']}"
                            if str(error) == defaults.UNPARSED else str(error))

    def check_qualifier(self, place, prop):
        if prop["qualifiedBy"] is None:
            if not prop["qualificationUnique"]:
                self.refuse(f"{place}/qualificationUnique", "there is nothing to qualify by")
            return
        place = f"{place}/qualifiedBy"
        key = self.find(prop["type"], prop["qualifiedBy"])
        if prop["upper"] == 1:
            self.refuse(place, "a property of one value has no key")
        elif key is None:
            self.refuse(place, f"{prop['type']} has no property {prop['qualifiedBy']} to qualify by")
        elif key["lower"] != 1 or key["upper"] != 1 or key["derived"]:
            self.refuse(place, f"{prop['qualifiedBy']} is no key: it must be stored, required and "
                               "single")
        elif key["type"] not in KEY_TYPES and key["typeKind"] != "Enum":
            self.refuse(place, f"{prop['qualifiedBy']} is no key: values of {key['type']} are none")

    def check_opposite(self, place, owner, prop):
        if prop["opposite"] is None:
            return
        place = f"{place}/opposite"
        other = self.find(prop["type"], prop["opposite"])
        if other is None:
            self.refuse(place, f"{prop['type']} has no property {prop['opposite']}")
        elif other["opposite"] is None:
            self.refuse(place, f"one-sided: {prop['type']}.{prop['opposite']} has no opposite")
        elif other["opposite"] != prop["name"]:
            self.refuse(place, f"one-sided: the opposite of {prop['type']}.{prop['opposite']} is "
                               f"{other['opposite']}")
        elif other["type"] != owner:
            self.refuse(place, f"{prop['type']}.{prop['opposite']} is of type {other['type']}, not "
                               f"{owner}")
        elif prop["composite"] and (other["composite"] or other["upper"] != 1):
            self.refuse(place, "the opposite of a composite property is one container")
        elif prop["qualifiedBy"] is not None and other["upper"] != 1:
            self.refuse(place, "the opposite of a qualified property has one value")

    def find(self, owner, name):
        """The property of that name, in the class or above it."""
        seen = set()
        while owner in self.classes and owner not in seen:
            seen.add(owner)
            for prop in self.classes[owner]["properties"]:
                if prop["name"] == name:
                    return prop
            owner = self.classes[owner]["superclass"]
        return None

    # Operations, data types, enumerations

    def check_operation(self, place, owner, operation):
        if operation["abstract"] and not owner["abstract"]:
            self.refuse(f"{place}/abstract", f"{owner['name']} is not abstract")
        if operation["event"]:
            self.check_event(place, owner, operation)
        above = self.operation_above(owner, operation)
        if above and above["event"] != operation["event"]:
            what = "an event" if above["event"] else "no event"
            self.refuse(f"{place}/event", f"{operation['name']} is {what} in a superclass")
        if operation["result"] is not None and "typeKind" in operation["result"]:
            self.check_type(f"{place}/result/type", operation["result"])
            self.check_invoker(f"{place}/result", operation, operation["result"])
        seen = {}
        for where, argument in self.each(f"{place}/arguments", operation["arguments"]):
            self.check_word(f"{where}/name", argument["name"])
            self.check_once(f"{where}/name", argument["name"], seen, "an argument")
            if "typeKind" in argument:
                self.check_type(f"{where}/type", argument)
                self.check_invoker(where, operation, argument)

    def check_invoker(self, place, operation, typed):
        """Values hold one element or many plain values."""
        if operation["invoker"] and typed["typeKind"] == "Class" and typed["upper"] > 1:
            self.refuse(f"{place}/upper", "many elements can't be passed by reflection; say "
                                          "\"invoker\": false")

    def check_event(self, place, owner, operation):
        """It gives nothing back, and its class and functions have names of their own."""
        if operation["result"] is not None:
            self.refuse(f"{place}/result", "an event has no result")
        if operation["static"]:
            self.refuse(f"{place}/static", "an event happens to an element")
        for where, argument in self.each(f"{place}/arguments", operation["arguments"]):
            if argument["name"] in ("owner", "operation"):
                self.refuse(f"{where}/name", f"{argument['name']} means something else for every "
                                             "event")
            if not argument["isInput"]:
                self.refuse(f"{where}/isInput", "an event gives nothing back")
        name = capital(cpp_name(operation))
        taken = [each["name"] for key in ("classes", "dataTypes", "enumerations")
                 for each in self.facts[key]]
        if f"{owner['name']}{name}Event" in taken:
            self.refuse(f"{place}/name", f"there is a type {owner['name']}{name}Event")
        others = [each for each in owner["operations"] if each is not operation]
        if operation["name"] in [each["name"] for each in others]:
            self.refuse(f"{place}/name", "an event has a name of its own")
        functions = {cpp_name(each) for each in others}
        functions |= {each for prop in owner["properties"] for each in accessors(prop)}
        if f"do{name}" in functions | words.MEMBERS:
            self.refuse(f"{place}/name", f"do{name} means something else")

    def operation_above(self, owner, operation):
        """What `operation` is another body of, in a superclass; or None."""
        types = [argument["type"] for argument in operation["arguments"]]
        at = self.classes.get(owner["superclass"])
        while at:
            for each in at.get("operations", []):
                if cpp_name(each) == cpp_name(operation) and \
                        [argument["type"] for argument in each["arguments"]] == types:
                    return each
            at = self.classes.get(at["superclass"])
        return None

    def check_fields(self, place, entry):
        seen = {}
        for where, prop in self.each(f"{place}/properties", entry["properties"]):
            self.check_word(f"{where}/name", cpp_name(prop))
            self.check_once(f"{where}/name", prop["name"], seen, "a property")
            self.check_bounds(where, prop)
            if prop["typeKind"] == "Class":
                self.refuse(f"{where}/type", "a field of a data type can't be an element")
            elif prop["typeKind"] == "DataType" and self.leads_to(prop["type"], entry["name"]):
                self.refuse(f"{where}/type", f"a {entry['name']} can't hold itself")
            elif self.check_type(f"{where}/type", prop):
                self.check_default(where, prop)

    def leads_to(self, name, wanted, seen=()):
        """Whether values of the data type `name` hold values of `wanted`."""
        if name == wanted:
            return True
        fields = [prop for entry in self.facts["dataTypes"] if entry["name"] == name
                  for prop in entry["properties"] if prop["typeKind"] == "DataType"]
        return name not in seen and any(
            self.leads_to(prop["type"], wanted, (*seen, name)) for prop in fields)

    def check_literals(self, place, entry):
        seen, enumerators = {}, {}
        for where, literal in self.each(f"{place}/literals", entry["literals"]):
            self.check_word(f"{where}/name", capital(cpp_name(literal)))
            self.check_once(f"{where}/name", literal["name"], seen, "a literal")
            self.check_once(f"{where}/name", capital(cpp_name(literal)), enumerators,
                            "an enumerator")

    # UUIDs

    def check_uuids(self, place, node):
        """Each UUID is well formed and is given once."""
        if isinstance(node, list):
            for where, entry in self.each(place, node):
                self.check_uuids(where, entry)
        elif isinstance(node, dict):
            if node.get("uuid") is not None:
                self.check_uuid(self.pointer(place), node["uuid"])
            for key, value in node.items():
                self.check_uuids(f"{place}/{key}", value)

    @staticmethod
    def pointer(place):
        """The root package stands for the description itself."""
        return f"{place}/uuid".removeprefix("/packages/0")

    def check_uuid(self, place, text):
        if not UUID_FORM.fullmatch(text):
            self.refuse(place, f"{text!r} is no UUID in lower case")
        elif text in self.uuids and not self.is_misnamed(place):
            self.refuse(place, f"the UUID {text} belongs to {self.uuids[text]}")
        self.uuids.setdefault(text, place)

    def is_misnamed(self, place):
        """Whether a name on the way to `place` is refused; UUIDs that are made repeat with it."""
        return any(place.startswith(found.removesuffix("name"))
                   for found, reason in self.problems.found if found.endswith("/name"))


def check_overlay(problems, overlay, facts):
    """Every class and property has its C++ half, and there is none without facts."""
    for key in ("namespace", "include", "export", "metaPackage", "types", "classes"):
        if key not in overlay:
            problems.add("", f"the key {key!r} is missing")
    problems.stop()
    described = {entry["name"]: {prop["name"] for prop in entry["properties"]}
                 for entry in facts["classes"]}
    compare(problems, "/classes", set(overlay["classes"]), set(described))
    problems.stop()
    for name, properties in described.items():
        compare(problems, f"/classes/{name}", set(overlay["classes"][name]["properties"]),
                properties)
    for entry in facts["classes"]:
        for prop in entry["properties"]:
            if prop["typeKind"] != "Class" and prop["type"] not in overlay["types"]:
                problems.add("/types", f"there is no C++ type for {prop['type']}, as "
                                       f"{entry['name']}.{prop['name']} needs")
    problems.stop()


def compare(problems, place, given, wanted):
    for name in sorted(wanted - given):
        problems.add(place, f"there is no entry for {name}")
    for name in sorted(given - wanted):
        problems.add(place, f"the facts know no {name}")

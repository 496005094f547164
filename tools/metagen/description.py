"""Turns the description of a client's metamodel into the two halves that the catalogue has: facts
with every column spelled out, and the decisions that only C++ needs.

Lists keep their order and their keys, so a place in the facts is the same place in the description.
"""
import json
import pathlib
import uuid

import shape
import source

SCHEMA = pathlib.Path(__file__).resolve().parent / "description.schema.json"
SCHEMA_BASE = "http://tarnkiln.invalid/tarnkiln/"
UNBOUNDED = 0xFFFFFFFF
MODEL_ELEMENT = "ModelElement"


def load(file, catalogue, imported):
    """Facts, overlay and imports of the description in `file`; `imported` loads the latter."""
    problems = source.Problems(file)
    data = source.read(file)
    shape.Shape(json.loads(SCHEMA.read_text(encoding="utf-8")), problems).complete(data)
    problems.stop()
    packages = [imported(file.parent / path) for path in data["imports"]]
    normal = Normal(data, [catalogue, *packages])
    return normal.facts(), normal.overlay(), packages


def cpp_name(entry):
    return entry["cpp"].get("name", entry["name"])


def capital(name):
    return name[0].upper() + name[1:]


class Normal:
    """One description, with all defaults of the schema in place."""

    def __init__(self, data, packages):
        self.data = data
        self.root = data.get("uuid") or str(uuid.uuid5(uuid.NAMESPACE_URL, self.uri))
        self.kinds = {MODEL_ELEMENT: "Class"}
        for package in packages:
            self.kinds |= package.kinds
        for key, kind in (("classes", "Class"), ("dataTypes", "DataType"), ("enumerations", "Enum")):
            self.kinds |= {entry["name"]: kind for entry in data[key]}

    @property
    def uri(self):
        return SCHEMA_BASE + self.data["uri"]

    def uuid(self, entry, *path):
        """The UUID that is given, or one made from the names that lead to the element."""
        return entry.get("uuid") or str(uuid.uuid5(uuid.UUID(self.root), ".".join(path)))

    # Facts

    def facts(self):
        family, version = self.data["uri"].split("/")
        return {
            "family": family,
            "version": version,
            "packages": self.packages(),
            "classes": self.classes(),
            "dataTypes": [self.data_type(entry) for entry in self.data["dataTypes"]],
            "enumerations": [self.enumeration(entry) for entry in self.data["enumerations"]],
            "packagePrimitiveTypes": [],
        }

    def packages(self):
        """The package of the types and those around it; the outermost one is the root."""
        names = self.data["name"].split(".")
        result = []
        for depth, name in enumerate(names):
            qualified = ".".join(names[:depth + 1])
            result.append({
                "name": name,
                "parent": names[depth - 1] if depth else None,
                "uriTail": self.data["uri"] + (f"/{qualified}" if depth else ""),
                "defaultVobjCategory": self.data.get("defaultVobjCategory")
                                       if depth == len(names) - 1 else None,
                "uuid": None if depth else self.root,
            })
        return result

    def qualified(self, name):
        return f"{self.data['name']}.{name}"

    def common(self, entry, kind):
        return {
            "name": entry["name"],
            "kind": kind,
            "package": self.data["name"],
            "qualifiedName": self.qualified(entry["name"]),
            "vobjName": entry.get("vobjName", self.qualified(entry["name"])),
            "vobjHidden": entry["vobjHidden"],
            "vobjCompactDisplay": entry.get("vobjCompactDisplay", False),
            "vobjDispCategories": entry.get("vobjDispCategories", []),
            "uuid": self.uuid(entry, entry["name"]),
        }

    def classes(self):
        result = []
        for entry in self.data["classes"]:
            owner = entry["name"]
            result.append({
                **self.common(entry, "Class"),
                "superclass": entry["superclass"],
                "abstract": entry["abstract"],
                "properties": [self.property(prop, owner) for prop in entry["properties"]],
                "operations": [self.operation(operation, owner)
                               for operation in entry["operations"]],
            })
        return result

    def data_type(self, entry):
        fields = []
        for prop in entry["properties"]:
            fields.append({**self.property({**FIELD, **prop}, entry["name"]), "index": None})
        return {**self.common(entry, "DataType"), "superclass": None, "abstract": False,
                "slots": None, "properties": fields, "operations": []}

    def property(self, entry, owner):
        kind = self.kinds.get(entry["type"])
        upper = UNBOUNDED if entry["upper"] == "*" else entry["upper"]
        many = upper > 1
        ordered = entry.get("ordered", not many or "qualifiedBy" not in entry)
        lower = entry.get("lower", 0 if many else 1)
        return {
            "name": entry["name"],
            "cppName": cpp_name(entry),
            "index": entry.get("index"),
            "type": entry["type"],
            "typeKind": kind,
            "lower": lower,
            "upper": upper,
            "ordered": ordered,
            "unique": entry.get("unique", not (many and ordered and kind != "Class")),
            "composite": entry["composite"],
            "derived": entry["derived"],
            "readOnly": entry["readOnly"],
            "setOnce": entry["setOnce"],
            "transient": entry["transient"],
            "sparse": entry["sparse"],
            "publicAccessor": entry["publicAccessor"],
            "publicMutator": entry["publicMutator"],
            "qualificationUnique": entry["qualificationUnique"],
            "customQualification": entry["customQualification"],
            "queryIndex": entry["queryIndex"],
            "opposite": entry.get("opposite"),
            "qualifiedBy": entry.get("qualifiedBy"),
            "default": entry.get("default"),
            "vobjHidden": entry["vobjHidden"],
            "vobjDispCategory": entry.get("vobjDispCategory"),
            "vobjDispSkipEmpty": entry["vobjDispSkipEmpty"],
            "uuid": self.uuid(entry, owner, entry["name"]),
            "valueFlags": value_flags(entry, kind, lower, upper, ordered),
        }

    def operation(self, entry, owner):
        types = ",".join(argument["type"] for argument in entry["arguments"])
        path = f"{entry['name']}({types})"
        return {
            "name": entry["name"],
            "cppName": cpp_name(entry),
            "result": self.multiplicity(entry["result"]) if "result" in entry else None,
            "abstract": entry["abstract"],
            "static": entry["static"],
            "public": entry["public"],
            "event": entry["event"],
            "invoker": entry["invoker"],
            "arguments": [self.argument(argument, owner, path) for argument in entry["arguments"]],
            "uuid": self.uuid(entry, owner, path),
        }

    def multiplicity(self, entry):
        upper = UNBOUNDED if entry["upper"] == "*" else entry["upper"]
        return {"type": entry["type"], "typeKind": self.kinds.get(entry["type"]),
                "lower": entry.get("lower", 0 if upper > 1 else 1), "upper": upper}

    def argument(self, entry, owner, path):
        bounds = self.multiplicity(entry)
        return {
            "name": entry["name"],
            **bounds,
            "ordered": entry.get("ordered", bounds["upper"] > 1),
            "isInput": entry["isInput"],
            "uuid": self.uuid(entry, owner, path, entry["name"]),
        }

    def enumeration(self, entry):
        literals, value = [], 0
        for literal in entry["literals"]:
            value = literal.get("value", value)
            literals.append({
                "name": literal["name"],
                "cppName": cpp_name(literal),
                "value": value,
                "publicIdentifier": literal.get("publicIdentifier"),
                "uuid": self.uuid(literal, entry["name"], literal["name"]),
            })
            value += 1
        return {**self.common(entry, "Enum"), "underlyingType": "Integer", "literals": literals}

    # C++

    def overlay(self):
        names = self.data["name"].split(".")
        cpp = self.data["cpp"]
        return {
            "namespace": cpp.get("namespace", "::".join(names)),
            "include": cpp.get("include", "/".join(names)),
            "export": cpp.get("export", ""),
            "exportHeader": cpp.get("exportHeader"),
            "metaPackage": cpp.get("metaPackage", capital(names[-1]) + "MetaPackage"),
            "doc": self.data.get("doc", ""),
            "classes": {entry["name"]: self.class_cpp(entry) for entry in self.data["classes"]},
            "dataTypes": {entry["name"]: self.type_cpp(entry, "properties")
                          for entry in self.data["dataTypes"]},
            "enumerations": {entry["name"]: self.type_cpp(entry, "literals")
                             for entry in self.data["enumerations"]},
        }

    def class_cpp(self, entry):
        cpp = entry["cpp"]
        operations = [{**operation["cpp"], "doc": operation.get("doc", "")}
                      for operation in entry["operations"]]
        declarations = [{"code": each["code"], "doc": each.get("doc")}
                        for each in cpp["declarations"]]
        return {**self.type_cpp(entry, "properties"), "includes": cpp["includes"],
                "operations": operations, "declarations": declarations}

    @staticmethod
    def type_cpp(entry, members):
        brief, _, details = entry.get("doc", "").partition("\n")
        return {"brief": brief, "details": details.strip("\n"),
                members: {member["name"]: {**member["cpp"], "doc": member.get("doc", "")}
                          for member in entry[members]}}


# What a field of a data type has where a property of a class may decide.
FIELD = {
    "upper": 1, "composite": False, "derived": False, "readOnly": False, "setOnce": False,
    "transient": False, "sparse": False, "publicAccessor": True, "publicMutator": True,
    "qualificationUnique": True, "customQualification": False, "queryIndex": False,
    "vobjHidden": False, "vobjDispSkipEmpty": False,
}


def value_flags(entry, kind, lower, upper, ordered):
    """The shape of the property's values."""
    if upper == 1:
        return 1 if lower or kind == "Class" else 0
    if "qualifiedBy" in entry:
        return 5 if entry["qualificationUnique"] else 7
    return 2 if ordered else 3

"""The constant tables of a metamodel: what `templates/Rows.cpp.jinja` prints.

`src/tarnkiln/support/PackageRows.h` explains the form. A row that refers to a type of the same
metamodel gives its number; any other type is given by its qualified name.
"""
import defaults
import wording

FLAGS = {"ordered": "ORDERED", "unique": "UNIQUE", "composite": "COMPOSITE", "derived": "DERIVED",
         "readOnly": "READ_ONLY", "transient": "TRANSIENT", "sparse": "SPARSE",
         "setOnce": "SET_ONCE", "customQualification": "CUSTOM_QUALIFICATION",
         "queryIndex": "QUERY_INDEX", "vobjHidden": "VOBJ_HIDDEN",
         "vobjDispSkipEmpty": "VOBJ_DISP_SKIP_EMPTY"}
NEGATED_FLAGS = {"publicAccessor": "NO_PUBLIC_ACCESSOR", "publicMutator": "NO_PUBLIC_MUTATOR",
                 "qualificationUnique": "QUALIFICATION_NOT_UNIQUE"}
OPERATION_FLAGS = {"abstract": "ABSTRACT", "static": "STATIC", "event": "EVENT"}


UNBOUNDED = 0xFFFFFFFF
ELEMENT_COLLECTION = "support::makeElementCollection"
VALUE_COLLECTION = "support::makePrimitiveCollection"


def text(value):
    """A literal of UTF-16 text."""
    return defaults.wide_text(value)


def narrow(value):
    escaped = value.replace("\\", "\\\\").replace('"', '\\"')
    return f'"{escaped}"'


def optional_narrow(value):
    return None if value is None else narrow(value)


def bound(value):
    return "support::UNBOUNDED" if value == UNBOUNDED else str(value)


def row(items):
    """A row from pairs of a field and its text; a field without a text keeps its default."""
    given = [f".{field} = {value}" for field, value in items if value is not None]
    return "    {" + wording.fill(" " * 5, given, "},", 5).lstrip()


class Table:
    """Rows of one kind, and the names by which C++ knows their numbers."""

    def __init__(self, kind, row_type):
        self.kind = kind
        self.row_type = row_type
        self.names = []
        self.rows = []

    def add(self, name, items):
        if name in self.names:
            raise ValueError(f"two {self.kind} are both called {name}")
        self.names.append(name)
        self.rows.append(row(items))


class Rows:
    """All tables, in the order in which the walker reads them."""

    def __init__(self, package):
        self.metamodel = package
        self.facts = package.facts
        self.methods = {(cls.name, entry["name"]) for cls in package.classes
                        for entry in cls.facts.get("operations", [])
                        if entry["invoker"] and has_method(cls, entry["name"])}
        self.required = self.facts.get("wellKnown", {}).get("resolvedByNameInStep6", [])
        self.imports = [each for each in package.imports if not each.is_catalogue]
        self.includes = sorted({
            *package.collection_headers, *self.headers_of_methods(package),
            *(each.builder_header for each in package.classes if not each.abstract),
            *(each.serializer_header for each in package.data_types),
            *(each.meta_package_header for each in self.imports),
            "tarnkiln/support/ElementInstantiator.h", "tarnkiln/support/InvokerInstaller.h",
            "tarnkiln/support/PrimitiveInstantiator.h",
            "tarnkiln/support/SerializerInstaller.h"})
        self.own_types = {}
        for table, key in (("Classes", "classes"), ("DataTypes", "dataTypes"),
                           ("Enumerations", "enumerations"),
                           ("PrimitiveTypes", "packagePrimitiveTypes")):
            for entry in self.facts.get(key, []):
                scope = table[0].lower() + table[1:]
                self.own_types[entry["name"]] = f"{{{table}, rows::{scope}::{entry['name']}}}"
        self.package_numbers = self.number_packages()
        self.groups = []
        self.tables = {kind: Table(kind, row_type) for kind, row_type in (
            ("packages", "PackageRow"), ("primitiveTypes", "PrimitiveTypeRow"),
            ("classes", "StructuredTypeRow"), ("dataTypes", "StructuredTypeRow"),
            ("properties", "PropertyRow"), ("operations", "OperationRow"),
            ("arguments", "ArgumentRow"), ("enumerations", "EnumRow"),
            ("literals", "LiteralRow"))}
        self.fill_tables()
        self.spans = {kind: kind for kind, table in self.tables.items() if table.rows}
        if self.groups:
            self.spans["displayGroups"] = "displayGroups"
        if self.required:
            self.spans["requiredTypes"] = "requiredTypes"
        if self.imports:
            self.spans["imports"] = "imports"

    @property
    def filled(self):
        return [table for table in self.tables.values() if table.rows]

    @property
    def all_rows(self):
        return wording.fill("constexpr support::PackageRows allRows{",
                          [f".{field} = {array}" for field, array in self.spans.items()], "};", 4)

    def number_packages(self):
        """The row of each package by its qualified name; each lies in one of those before it."""
        numbers, paths = {}, {}
        for number, entry in enumerate(self.facts["packages"]):
            above = paths.get(entry["parent"], "")
            path = f"{above}.{entry['name']}" if above else entry["name"]
            paths[entry["name"]] = path
            numbers[path] = number
        return numbers

    def fill_tables(self):
        parents = {}
        for number, entry in enumerate(self.facts["packages"]):
            self.add_package(entry, parents.get(entry["parent"]))
            parents[entry["name"]] = number
        for entry in self.facts.get("packagePrimitiveTypes", []):
            self.tables["primitiveTypes"].add(entry["name"], [
                ("name", text(entry["name"])), ("package", self.package(entry)),
                ("serializers", f"support::installSerializer<{entry['serializer']}>"),
                ("uuid", narrow(entry["uuid"]))])
        for entry in self.facts["classes"]:
            self.add_structured("classes", entry)
        for entry in self.facts.get("dataTypes", []):
            self.add_structured("dataTypes", entry)
        for entry in self.facts.get("enumerations", []):
            self.add_enumeration(entry)

    def add_package(self, entry, parent):
        number = len(self.tables["packages"].rows)
        self.tables["packages"].add(wording.capital(entry["name"] or "root") + str(number or ""), [
            ("name", text(entry["name"])),
            ("parent", None if parent is None else str(parent)),
            ("uri", text(entry["uriTail"])),
            ("defaultVobjCategory", optional_narrow(entry.get("defaultVobjCategory"))),
            ("uuid", None if entry["uuid"] is None else narrow(entry["uuid"]))])

    def add_structured(self, kind, entry):
        properties = self.range("properties", entry.get("properties", []))
        for prop in entry.get("properties", []):
            self.add_property(entry["name"], prop)
        operations = self.range("operations", entry.get("operations", []))
        for operation in entry.get("operations", []):
            self.add_operation(entry["name"], operation)
        is_class = kind == "classes"
        collection = ELEMENT_COLLECTION if is_class else VALUE_COLLECTION
        self.tables[kind].add(entry["name"], [
            ("name", text(entry["name"])), ("vobjName", narrow(entry["vobjName"])),
            ("package", self.package(entry)),
            ("superclass", self.type(entry["superclass"]) if is_class else None),
            ("isAbstract", "true" if entry["abstract"] else None),
            ("isVobjHidden", "true" if entry.get("vobjHidden") else None),
            ("vobjCompactDisplay", "true" if entry.get("vobjCompactDisplay") else None),
            ("vobjDispCategories", self.display_groups(entry.get("vobjDispCategories", []))),
            ("properties", properties), ("operations", operations),
            ("collection", f"{collection}<{entry['name']}>"),
            ("builder", self.builder(entry) if is_class else None),
            ("serializers", None if is_class else self.datatype_serializer(entry)),
            ("uuid", narrow(entry["uuid"]))])

    def display_groups(self, names):
        """Where the groups of a type stand among those of all types."""
        first = len(self.groups)
        self.groups += [narrow(name) for name in names]
        return f"{{{first}, {len(names)}}}" if names else None

    def builder(self, entry):
        """What makes builders of a class; there is none for an abstract one."""
        return None if entry["abstract"] else f"{entry['name']}::Builder::instantiate"

    def datatype_serializer(self, entry):
        """What enters the serializer of a data type; the catalogue's are entered by hand."""
        if self.metamodel.is_catalogue:
            return None
        return f"support::installDatatypeSerializer<{entry['name']}DatatypeSerializer>"

    def add_property(self, owner, entry):
        flags = [flag for key, flag in FLAGS.items() if entry.get(key)]
        flags += [flag for key, flag in NEGATED_FLAGS.items() if not entry[key]]
        self.tables["properties"].add(property_name(owner, entry["name"]), [
            ("name", text(entry["name"])),
            ("index", None if entry["index"] is None else str(entry["index"])),
            ("type", self.type(entry["type"])),
            ("lower", bound(entry["lower"])), ("upper", bound(entry["upper"])),
            ("flags", " | ".join(flags) or None),
            ("opposite", self.member(entry["type"], entry["opposite"])),
            ("qualifiedBy", self.member(entry["type"], entry["qualifiedBy"])),
            ("defaultText", None if entry["default"] is None else text(entry["default"])),
            ("vobjDispCategory", optional_narrow(entry.get("vobjDispCategory"))),
            ("uuid", narrow(entry["uuid"]))])

    def add_operation(self, owner, entry):
        arguments = self.range("arguments", entry["arguments"])
        operation = self.operation_name(owner, entry)
        for argument in entry["arguments"]:
            self.tables["arguments"].add(operation + wording.capital(argument["name"]), [
                ("name", text(argument["name"])), ("type", self.type(argument["type"])),
                ("lower", bound(argument["lower"])), ("upper", bound(argument["upper"])),
                ("isOrdered", "true" if argument["ordered"] else None),
                ("isInput", None if argument["isInput"] else "false"),
                ("uuid", narrow(argument["uuid"]))])
        flags = [flag for key, flag in OPERATION_FLAGS.items() if entry[key]]
        flags += [] if entry["public"] else ["NOT_PUBLIC"]
        result = entry["result"] or {}
        self.tables["operations"].add(operation, [
            ("name", text(entry["name"])),
            ("type", self.type(result["type"]) if result else None),
            ("lower", bound(result["lower"]) if result else None),
            ("upper", bound(result["upper"]) if result else None),
            ("isOrdered", "true" if result.get("ordered") else None),
            ("flags", " | ".join(flags) or None),
            ("arguments", arguments),
            ("invoker", self.invoker(owner, entry)),
            ("uuid", narrow(entry["uuid"]))])

    def headers_of_methods(self, package):
        owners = {owner for owner, _ in self.methods}
        return [cls.impl_header for cls in package.classes if cls.name in owners]

    def operation_name(self, owner, entry):
        """Several operations of a class may share a name; those after the first are counted."""
        name, count = property_name(owner, entry["name"]), 1
        while (name if count == 1 else f"{name}{count}") in self.tables["operations"].names:
            count += 1
        return name if count == 1 else f"{name}{count}"

    def invoker(self, owner, entry):
        if (owner, entry["name"]) not in self.methods or not entry["invoker"]:
            return None
        method = self.metamodel.by_name[owner].method(entry)
        return f"support::makeInvokerOf<{method}>".replace("static_cast<", "static_cast<\n" + " " * 9)

    def add_enumeration(self, entry):
        literals = self.range("literals", entry["literals"])
        for literal in entry["literals"]:
            identifier = literal["publicIdentifier"]
            self.tables["literals"].add(property_name(entry["name"], literal["name"]), [
                ("name", text(literal["name"])), ("value", str(literal["value"])),
                ("publicIdentifier", None if identifier is None else text(identifier)),
                ("uuid", narrow(literal["uuid"]))])
        self.tables["enumerations"].add(entry["name"], [
            ("name", text(entry["name"])), ("package", self.package(entry)),
            ("underlyingType", self.type(entry["underlyingType"])),
            ("isVobjHidden", "true" if entry.get("vobjHidden") else None),
            ("literals", literals),
            ("collection", f"{VALUE_COLLECTION}<{entry['name']}>"),
            ("serializers", f"support::installEnumSerializers<{entry['name']}>"),
            ("uuid", narrow(entry["uuid"]))])

    def range(self, kind, entries):
        """The rows that `entries` are about to get."""
        return f"{{{len(self.tables[kind].rows)}, {len(entries)}}}" if entries else None

    def package(self, entry):
        return str(self.package_numbers[entry["package"]])

    def type(self, name):
        return self.own_types.get(name) or "{" + text(name) + "}"

    def member(self, owner, name):
        """A property of the class `owner`, or of one above it."""
        if name is None:
            return None
        classes = {entry["name"]: entry for entry in self.facts["classes"]}
        at = owner
        while at in classes:
            if any(prop["name"] == name for prop in classes[at]["properties"]):
                return f"{{rows::properties::{property_name(at, name)}}}"
            at = classes[at]["superclass"]
        return "{" + f"{text(at)}, {text(name)}" + "}"


def has_method(cls, name):
    """Whether the class declares a function of that name; the catalogue's are written by hand."""
    return not cls.package.is_catalogue or any(
        f" {name}(" in each["code"] for each in cls.declarations)


def property_name(owner, name):
    """What a member of `owner` is called among the members of all types."""
    return owner + wording.capital(name)

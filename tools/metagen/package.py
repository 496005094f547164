"""A metamodel with all its types, as the templates see it."""
import classes
import defaults
import values

LIBRARY_NAMESPACE = "tarn::kiln::"


class Package:
    """All types of one metamodel.

    :param imports: the packages whose types it may name, by qualified name.
    """

    def __init__(self, files, facts, overlay, imports=()):
        self.title = files[0].name
        self.sources = {*files, *(file for package in imports for file in package.sources)}
        self.facts = facts
        self.name = ".".join(entry["name"] for entry in facts["packages"] if entry["name"])
        self.namespace = overlay["namespace"]
        self.include = overlay["include"]
        self.export = overlay["export"]
        self.export_header = overlay.get("exportHeader")
        self.meta_package = overlay["metaPackage"]
        self.imports = imports
        self.enumerations = [values.Enumeration(entry, overlay["enumerations"][entry["name"]], self)
                             for entry in facts["enumerations"] if "enumerations" in overlay]
        self.data_types = [values.DataType(entry, overlay["dataTypes"][entry["name"]], self)
                           for entry in facts["dataTypes"] if "dataTypes" in overlay]
        self.carried = self.carried_types(overlay)
        self.types = {name: self.value_type(row) for name, row in self.carried.items()}
        self.classes = [classes.Class(entry, overlay["classes"][entry["name"]], self)
                        for entry in facts["classes"]]
        self.by_name = {c.name: c for c in self.classes}
        for package in imports:
            self.by_name |= package.qualified_classes
        for cls in self.classes:
            cls.link()
        for cls in self.classes:
            cls.link_keys()

    # For the packages that import this one

    def qualified(self, name):
        """The name by which others know a type of this package."""
        own = {entry["name"] for key in ("classes", "dataTypes", "enumerations")
               for entry in self.facts[key]}
        return f"{self.name}.{name}" if name in own else name

    @property
    def qualified_classes(self):
        return {self.qualified(name): cls for name, cls in self.by_name.items()}

    @property
    def qualified_facts(self):
        """The facts of the classes, which name all types as others do."""
        result = {}
        for entry in self.facts["classes"]:
            properties = [{**prop, "type": self.qualified(prop["type"])}
                          for prop in entry["properties"]]
            result[self.qualified(entry["name"])] = {
                **entry, "superclass": self.qualified(entry["superclass"]),
                "properties": properties}
        return result

    @property
    def qualified_literals(self):
        """The literals of the enumerations."""
        return {self.qualified(entry["name"]): [literal["name"] for literal in entry["literals"]]
                for entry in self.facts["enumerations"]}

    @property
    def kinds(self):
        """What kind of type each name means to others."""
        result = {entry["name"]: "PrimitiveType" for entry in self.facts.get("primitiveTypes", [])}
        for key, kind in (("classes", "Class"), ("dataTypes", "DataType"), ("enumerations", "Enum")):
            result |= {self.qualified(entry["name"]): kind for entry in self.facts[key]}
        return result

    @property
    def primitives(self):
        """The primitive types that have a C++ type."""
        return [name for name, row in self.carried.items() if "namespace" not in row]

    # C++

    def carried_types(self, overlay):
        """The C++ types of all plain values, as a table of rows by name."""
        rows = dict(overlay.get("types", {}))
        for package in self.imports:
            rows |= {package.qualified(name): row for name, row in package.carried.items()}
        for each in self.enumerations + self.data_types:
            rows[each.name] = each.carried
        return rows

    def value_type(self, row):
        """A row as it is spelled in the namespace of this package."""
        if "namespace" not in row:
            return row
        cpp = self.spelled(row["namespace"], row["name"])
        initial = f" = {cpp}::{row['first']}" if "first" in row else ""
        return {**row, "cpp": cpp, "initial": initial}

    def default(self, type_name, text):
        """The C++ expression of a default text."""
        value = self.types[type_name]
        if "literals" in value:
            return f"{value['cpp']}::{value['literals'][text]}"
        return defaults.expression(type_name, text)

    def plain(self, typed):
        """The C++ type of one value."""
        is_element = typed["typeKind"] == "Class"
        return self.handle(typed["type"]) if is_element else self.types[typed["type"]]["cpp"]

    def carrier(self, typed):
        """What holds the values of a result or of a derived property."""
        if typed["upper"] > 1:
            return f"std::vector<{self.plain(typed)}>"
        is_optional = typed["lower"] == 0 and typed["typeKind"] != "Class"
        return f"boost::optional<{self.plain(typed)}>" if is_optional else self.plain(typed)

    def parameter(self, typed, name):
        """The parameter of a function that takes such values."""
        by_value = typed["typeKind"] != "Class" and self.types[typed["type"]]["byValue"]
        carrier = self.carrier(typed)
        by_value = by_value and carrier == self.plain(typed)
        return f"{carrier} {name}" if by_value else f"{carrier} const& {name}"

    def carrier_headers(self, typed):
        """Headers of the C++ types around the plain ones."""
        carrier = self.carrier(typed)
        headers = {"std::vector": "<vector>", "boost::optional": "<boost/optional.hpp>"}
        return {header for name, header in headers.items() if carrier.startswith(name)}

    def type_headers(self, typed):
        """Headers of the plain type itself."""
        if typed["typeKind"] != "Class":
            header = self.types[typed["type"]].get("include")
        else:
            cls = self.by_name.get(typed["type"])
            header = cls.handle_header if cls else "tarnkiln/kernel/ModelElement.h"
        return {header} - {None}

    @property
    def events(self):
        return [event for cls in self.classes for event in cls.events]

    @property
    def is_catalogue(self):
        return self.namespace == "tarn::kiln::meta"

    @property
    def value_types(self):
        return sorted(self.data_types + self.enumerations, key=lambda each: each.name)

    @property
    def meta_package_header(self):
        return f"{self.include}/{self.meta_package}.h"

    @property
    def rows_file(self):
        return "CatalogueRows" if self.is_catalogue else self.meta_package + "Rows"

    @property
    def collection_headers(self):
        """What the collections of all own types need."""
        if self.is_catalogue:
            return ["tarnkiln/collections/MetaCollections.h"]
        types = self.data_types + self.enumerations
        return [*(c.impl_header for c in self.classes), *(f"{self.include}/{t.name}.h" for t in types)]

    @property
    def export_word(self):
        """The macro of an exported class, with its blank."""
        return self.export + " " if self.export else ""

    @property
    def common_headers(self):
        """What every handle includes."""
        if self.is_catalogue:
            return ["tarnkiln/Export.h", "tarnkiln/meta/Fwd.h"]
        return [header for header in (self.export_header, f"{self.include}/Fwd.h") if header]

    @property
    def fwd_headers(self):
        """Where the types are named that this package has from others."""
        others = {package.include for package in self.imports if not package.is_catalogue}
        return sorted({"tarnkiln/kernel/Fwd.h", "tarnkiln/meta/Fwd.h",
                       *(f"{include}/Fwd.h" for include in others)})

    @property
    def fwd_lines(self):
        """Declarations of all types, without definitions."""
        lines = [f"class {each.name};" for each in self.classes + self.data_types]
        lines += [f"enum class {each.name} : int;" for each in self.enumerations]
        return sorted(lines, key=lambda line: line.split()[-1 if line.startswith("class") else 2])

    @property
    def thread_rule(self):
        if self.is_catalogue:
            return ("handles may be copied and dropped anywhere. What belongs to the registry may "
                    "be read on any thread; all else happens on the thread that uses the model.")
        return ("handles may be copied and dropped anywhere; all else happens on the thread that "
                "uses the model.")

    def handle(self, type_name):
        """The handle of a class as it is spelled in the namespace of this package."""
        cls = self.by_name.get(type_name)
        return self.spelled(cls.package.namespace, cls.name) if cls else type_name

    def rooted(self, type_name, plain):
        """`plain`, the C++ type of a class or a plain value, with all the scopes around it."""
        cls, row = self.by_name.get(type_name), self.carried.get(type_name, {})
        if cls:
            return f"::{cls.package.namespace}::{cls.name}"
        if "namespace" in row:
            return f"::{row['namespace']}::{row['name']}"
        return f"::{LIBRARY_NAMESPACE}{plain}"

    def spelled(self, namespace, name):
        if namespace == self.namespace:
            return name
        return f"{namespace}::{name}".removeprefix(LIBRARY_NAMESPACE)

"""The enumerations and data types of a metamodel, and the C++ that stands for them."""
import properties
import wording


class Literal:
    def __init__(self, facts, cpp, owner):
        self.facts = facts
        self.name = facts["name"]
        self.value = facts["value"]
        self.enumerator = wording.capital(cpp.get("name", self.name))
        self.doc = wording.comment(wording.sentence(cpp["doc"]), 4) if cpp.get("doc") else ""


class Enumeration:
    def __init__(self, facts, cpp, package):
        self.facts = facts
        self.cpp = cpp
        self.package = package
        self.name = facts["name"]
        self.literals = [Literal(entry, cpp["literals"][entry["name"]], self)
                         for entry in facts["literals"]]

    @property
    def header(self):
        return f"{self.package.include}/{self.name}.h"

    @property
    def file_doc(self):
        return wording.comment(f"\\file\nThe literals of `{self.name}`.")

    @property
    def doc(self):
        brief = self.cpp["brief"] or f"{wording.capital(wording.article(self.name))} " \
                                     f"{wording.spoken(self.name)}."
        return wording.comment("\n\n".join(part for part in (brief, self.cpp["details"]) if part))

    @property
    def qualified(self):
        return f"{self.package.namespace}::{self.name}"

    @property
    def includes(self):
        headers = {"tarnkiln/meta/StandardTypeOf.h", self.package.export_header}
        return sorted(headers - {None})

    @property
    def carried(self):
        """Its row in the table of C++ types; a field begins as the literal of number 0."""
        zeros = [literal for literal in self.literals if literal.value == 0]
        first = (zeros or self.literals)[0]
        return {"namespace": self.package.namespace, "name": self.name, "byValue": True,
                "include": self.header, "literals": {l.name: l.enumerator for l in self.literals},
                "first": first.enumerator}


class Field(properties.Property):
    """A field of a data type: a property that lies in the value and has no slot."""

    @property
    def kind(self):
        return "optional" if self.facts["lower"] == 0 else "scalar"

    @property
    def setter_line(self):
        return f"    void {self.setter}({self.parameter}) {{ {self.field} = {self.argument}; }}"


class DataType:
    """A class of plain values with fields."""

    @property
    def article(self):
        return wording.article(self.name)

    def __init__(self, facts, cpp, package):
        self.facts = facts
        self.cpp = cpp
        self.package = package
        self.name = facts["name"]
        self.fields = [Field(entry, cpp["properties"][entry["name"]], self)
                       for entry in facts["properties"]]

    @property
    def header(self):
        return f"{self.package.include}/{self.name}.h"

    @property
    def file_doc(self):
        return wording.comment(f"\\file\nThe values of the data type `{self.name}`.")

    @property
    def doc(self):
        brief = self.cpp["brief"] or f"{wording.capital(wording.article(self.name))} " \
                                     f"{wording.spoken(self.name)}."
        parts = (brief, self.cpp["details"], "A plain value, copied and compared by its fields.")
        return wording.comment("\n\n".join(part for part in parts if part))

    @property
    def qualified(self):
        return f"{self.package.namespace}::{self.name}"

    @property
    def payload_line(self):
        """Tells `Value` that it may hold these."""
        head = "template <>\ninline constexpr bool tarn::kiln::support::isDataType<"
        return f"{head}{self.qualified}> = true;"

    @property
    def serializer(self):
        return f"{self.name}DatatypeSerializer"

    @property
    def serializer_header(self):
        return f"{self.package.include}/{self.serializer}.h"

    @property
    def serializer_head(self):
        return wording.fill(f"class {self.package.export_word}{self.serializer} final ",
                          [f": public meta::DefaultDatatypeSerializer<{self.name}>"], "", 4)

    @property
    def serializer_fields(self):
        """The fields as the serializer reaches them."""
        return ",\n".join(
            wording.fill(" " * 10 + "field<", [f"&{self.name}::{field.getter}",
                                             f"&{self.name}::{field.setter}"],
                       f'>(u"{field.name}")', 12).lstrip("\n") for field in self.fields)

    @property
    def headers(self):
        return {field.value["include"] for field in self.fields if "include" in field.value}

    @property
    def includes(self):
        return sorted({*self.package.common_headers, "tarnkiln/kernel/Types.h",
                       "tarnkiln/kernel/ValueTraits.h", "tarnkiln/meta/StandardTypeOf.h"}
                      | {h for h in self.headers if not h.startswith("<")})

    @property
    def system_includes(self):
        headers = {h for h in self.headers if h.startswith("<")}
        if any(field.kind == "optional" for field in self.fields):
            headers.add("<boost/optional.hpp>")
        return wording.sorted_blocks(headers)

    @property
    def carried(self):
        """Its row in the table of C++ types."""
        return {"namespace": self.package.namespace, "name": self.name, "byValue": False,
                "include": self.header}

"""The classes of a metamodel, and the names and texts that the templates print of them.

A description has two halves: the facts (classes, properties, indices, UUIDs) and an overlay with
the decisions that only C++ needs (namespace, documentation, C++ types, what is written by hand).
Everything that templates print is computed here and in the modules beside; they only lay it out.
"""
import operations
from description import MODEL_ELEMENT
from properties import Property, Rekeyed
from wording import article, capital, comment, fill, sorted_blocks, spoken


class Class:
    def __init__(self, facts, cpp, package):
        self.facts = facts
        self.cpp = cpp
        self.package = package
        self.name = facts["name"]
        self.superclass = facts["superclass"]
        self.abstract = facts["abstract"]
        self.slots = facts["slots"]
        self.brief = cpp["brief"] or f"{capital(article(self.name))} {spoken(self.name)}."
        self.properties = [Property(entry, cpp["properties"][entry["name"]], self)
                           for entry in facts["properties"]]
        self.declarations = cpp.get("declarations", [])
        self.unmodelled_fields = cpp.get("fields", [])
        self.operations = [operations.Operation(entry, cpp["operations"][position], self)
                           for position, entry in enumerate(facts["operations"])
                           if "operations" in cpp]

    @property
    def functions(self):
        """What stands for the operations."""
        return [function for each in self.operations for function in each.functions]

    @property
    def events(self):
        """The event classes that it brings along."""
        return [operations.Event(each) for each in self.operations if each.has_event_class]

    def method(self, facts):
        """A pointer to the function that stands for an operation."""
        position = self.facts["operations"].index(facts)
        name = facts.get("cppName", facts["name"])
        pointer = f"&{self.name}::Impl::{name}"
        if not self.operations or sum(each.name == name for each in self.operations) == 1:
            return pointer
        return f"{self.operations[position].pointer_type}({pointer})"

    def link(self):
        for prop in self.properties:
            prop.link()

    def link_keys(self):
        """Finds the collections of owners in which elements stand by a key."""
        changes = {}
        for prop in self.stored:
            if prop.opposite and prop.opposite.qualifier:
                changes.setdefault(prop.opposite.qualifier, []).append(Rekeyed(prop))
        for key, rekeyed in changes.items():
            if key.owner is self:
                key.rekeyed = rekeyed
        self.inherited_keys = [each for each in changes.items() if each[0].owner is not self]
        self.rekeyed = [each for rekeyed in changes.values() for each in rekeyed]

    def rekeyed_by(self, to_owner):
        """How it stands in the collection that is the opposite of `to_owner`; or None."""
        return next((each for each in self.rekeyed if each.to_owner is to_owner), None)

    @property
    def stored(self):
        return [p for p in self.properties if p.stored]

    @property
    def computed(self):
        """The derived properties that reflection can read."""
        return [p for p in self.properties if not p.stored and "code" in p.cpp]

    @property
    def slotted(self):
        return self.stored + self.computed

    @property
    def base(self):
        return None if self.superclass == MODEL_ELEMENT else self.package.by_name[self.superclass]

    def find(self, name):
        """The property of that name, here or in a superclass."""
        for prop in self.properties:
            if prop.name == name:
                return prop
        return self.base.find(name) if name and self.base else None

    # Documentation

    @property
    def article(self):
        return article(self.name)

    @property
    def handle_file_doc(self):
        subject = self.cpp.get("file", f"{self.article} `{self.name}`")
        return comment(f"\\file\nThe handle of {subject}.")

    @property
    def handle_doc(self):
        text = self.brief + "\n\n"
        if self.cpp["details"]:
            text += self.cpp["details"] + "\n\n"
        noun = spoken(self.name)
        return comment(
            text + f"The handle is shared: copies refer to the same {noun}; it is false when empty "
            f"or when the {noun} was destroyed.\n\n"
            f"Threads: {self.package.thread_rule}")

    @property
    def cast_doc(self):
        return comment(f"The {spoken(self.name)} behind `element`; empty if that is empty or "
                       "something else.", 4)

    @property
    def impl_doc(self):
        return comment(
            f"The properties of {self.article} `{self.name}`.\n\n"
            "Setters work in the open transaction of the model, or in one of their own. They fail "
            "with `CannotModifyProxy` if this element stands in for another one, and with "
            "`ModelFrozen`, `NoOpenTransaction` or `ChangesProhibited` if the model may not be "
            "changed now. An equal value changes nothing.\n\n"
            "Threads: as the handle.")

    def declaration_doc(self, declaration):
        return comment(declaration["doc"], 4) if declaration["doc"] else ""

    # Includes

    @property
    def handle_includes(self):
        base = "tarnkiln/kernel/ModelElement.h" if self.base is None else self.base.handle_header
        return sorted([base, *self.package.common_headers])

    def header(self, name):
        return f"{self.package.include}/{name}.h"

    @property
    def handle_header(self):
        return self.header(self.name)

    @property
    def impl_header(self):
        return self.header(f"{self.name}Impl")

    @property
    def builder_header(self):
        return self.header(f"{self.name}Builder")

    @property
    def constrainables_header(self):
        return self.header(f"{self.name}Constrainables")

    @property
    def constrainables_includes(self):
        base = self.base.constrainables_header if self.base else \
            "tarnkiln/query/ModelElementConstrainables.h"
        headers = {base, self.handle_header}
        for prop in self.properties:
            form = "RelationWithAttachment" if prop.is_element else "WithAttachment"
            headers.add(f"tarnkiln/query/Constrainable{form}.h")
            if prop.target:
                headers.add(prop.target.handle_header)
        return sorted(headers | {h for h in self.constrained_headers if not h.startswith("<")})

    @property
    def constrainables_system_includes(self):
        headers = {h for h in self.constrained_headers if h.startswith("<")}
        return sorted_blocks(headers | {"<utility>"})

    @property
    def constrained_headers(self):
        """What the types of plain values need."""
        return {prop.value["include"] for prop in self.properties
                if not prop.is_element and "include" in prop.value}

    @property
    def constrainables_head(self):
        return fill(f"class {self.package.export_word}{self.name}::Constrainables ",
                    [f": public {self.base_handle}::Constrainables"], "", 4)

    @property
    def constrainables_initializers(self):
        """What the constructor of a search instance initializes, from the base on."""
        base = f"    : {self.base_handle}::Constrainables(query, metaClass, mode)"
        return ",\n".join([base] + [prop.constrainable_initializer for prop in self.properties])

    @property
    def impl_includes(self):
        headers = {self.handle_header, "tarnkiln/support/Dispatch.h"}
        if self.base:
            headers.add(self.base.impl_header)
        for prop in self.properties:
            if prop.target and prop.cpp.get("getter") != "none":
                headers.add(prop.target.handle_header)
            if prop.stored and prop.many:
                headers.add(prop.collection_header)
        return sorted(h for h in headers | self.value_headers if not h.startswith("<"))

    @property
    def impl_system_includes(self):
        headers = set()
        for prop in self.stored:
            if prop.kind == "optional":
                headers.add("<boost/optional.hpp>")
            if prop.many:
                headers.add("<memory>")
        for typed in self.carried:
            headers |= self.package.carrier_headers(typed)
        return sorted_blocks({h for h in headers | self.value_headers if h.startswith("<")})

    @property
    def carried(self):
        """The facts of what getters and operations take or give by value."""
        derived = [p.facts for p in self.accessors if not p.stored and "code" not in p.cpp]
        return derived + [typed for each in self.operations for typed in each.typed]

    @property
    def value_headers(self):
        """What the plain values of properties need, and what is declared by hand."""
        headers = set(self.cpp.get("includes", []))
        for prop in self.stored:
            if not prop.is_element and "include" in prop.value:
                headers.add(prop.value["include"])
            if prop.facts["default"] and prop.facts["type"] == "DateTime":
                headers.add("<boost/date_time/posix_time/posix_time.hpp>")
        return headers

    @property
    def source_includes(self):
        headers = {self.builder_header, self.constrainables_header,
                   self.package.meta_package_header,
                   "tarnkiln/support/BuilderSteps.h", "tarnkiln/support/DispatchSteps.h",
                   "tarnkiln/support/Handle.h"}
        for prop in self.stored:
            if prop.target:
                headers.add(prop.target.impl_header)
        headers |= self.headers_above
        for rekeyed in self.rekeyed:
            headers.add("tarnkiln/support/Keyed.h")
            headers.add(rekeyed.collection.collection_header)
        headers.discard(self.impl_header)
        return sorted(headers)

    @property
    def headers_above(self):
        """What the references of superclasses need, which the record of the class holds too.

        The sources of the catalogue have them by other ways.
        """
        headers, above = set(), None if self.package.is_catalogue else self.base
        while above:
            headers |= {prop.target.impl_header for prop in above.stored if prop.target}
            above = above.base
        return headers

    # C++

    @property
    def base_impl(self):
        return f"{self.base_handle}::Impl"

    @property
    def base_handle(self):
        return self.package.handle(self.superclass)

    @property
    def class_head(self):
        return fill(f"class {self.package.export_word}{self.name}::Impl ",
                    [f": public support::Dispatched<{self.name}::Impl, {self.base_impl}>"], "", 4)

    def instantiation(self, word, template, base):
        head = f"{word}template class tarn::kiln::support::{template}<"
        return fill(head, [self.qualified_impl, base], ">;", 4)

    @property
    def qualified_impl(self):
        return f"{self.package.namespace}::{self.name}::Impl"

    @property
    def qualified_base_impl(self):
        return self.base.qualified_impl if self.base else "tarn::kiln::ModelElement::Impl"

    @property
    def fields(self):
        return [p for p in self.stored if p.kind != "container"]

    @property
    def has_fields(self):
        return bool(self.fields or self.unmodelled_fields)

    @property
    def collections(self):
        return [p for p in self.stored if p.many]

    @property
    def accessors(self):
        """The properties that have a getter; derived ones may be written by hand."""
        return [p for p in self.properties
                if p.stored or "code" in p.cpp or not self.package.is_catalogue]

    @property
    def private_setters(self):
        """Setters for the class itself, of properties that others can only read."""
        return [p for p in self.stored if not p.many and not p.is_settable]

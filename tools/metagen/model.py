"""The description of a metamodel, checked and turned into the names that the templates print.

A description has two halves: the facts (classes, properties, indices, UUIDs) and an overlay with
the decisions that only C++ needs (namespace, documentation, C++ types, what is written by hand).
Everything that templates print is computed here; they only lay it out.
"""
import re
import textwrap

import operations
import words

WIDTH = 100
MODEL_ELEMENT = "ModelElement"


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


class Property:
    """One property of a class, and the C++ that stands for it."""

    def __init__(self, facts, cpp, owner):
        self.facts = facts
        self.cpp = cpp
        self.owner = owner
        self.name = facts["name"]
        self.index = facts["index"]
        self.stored = self.index is not None
        self.many = facts["upper"] != 1
        self.is_element = facts["typeKind"] == "Class"
        self.composite = facts["composite"]
        self.cpp_name = cpp.get("name", self.name)
        self.constant = constant(self.cpp_name)
        self.field = f"m_{self.cpp_name}"
        self.setter_kind = cpp.get("setter", "generated")
        # A property that may not be set from outside still has a setter, for the class itself.
        self.is_settable = facts.get("setOnce", False) or not facts["readOnly"]
        self.is_set_once = facts.get("setOnce", False)
        self.rekeyed = []

    def link(self):
        """Finds what the description names; all classes exist by now."""
        package = self.owner.package
        self.target = package.by_name.get(self.facts["type"]) if self.is_element else None
        self.opposite = self.target and self.target.find(self.facts["opposite"])
        self.qualifier = self.target and self.target.find(self.facts["qualifiedBy"])
        self.is_container = bool(self.opposite and self.opposite.composite)

    @property
    def kind(self):
        if not self.stored:
            return "derived"
        if self.is_element:
            if self.is_container:
                return "container"
            if self.many:
                return "references"
            return "composite reference" if self.composite else "reference"
        if self.many:
            return "values"
        return "optional" if self.facts["lower"] == 0 else "scalar"

    # Names and types

    @property
    def getter(self):
        return operations.accessor(self.cpp_name)

    @property
    def setter(self):
        return "set" + capital(self.cpp_name)

    @property
    def has(self):
        return "has" + capital(self.cpp_name)

    @property
    def maker(self):
        return "make" + capital(self.cpp_name)

    @property
    def parameter(self):
        if self.is_element:
            return f"{self.type} const& {self.argument}"
        if self.kind == "scalar" and self.value["byValue"]:
            return f"{self.type} {self.argument}"
        return f"{self.type} const& {self.argument}"

    @property
    def argument(self):
        """The name of the setter's argument; no word of the language."""
        plain = re.sub(r"^is(?=[A-Z])", "", self.cpp_name)
        name = plain[0].lower() + plain[1:]
        return "value" if name in words.RESERVED | {"operation"} else name

    @property
    def value(self):
        return self.owner.package.types[self.facts["type"]]

    @property
    def type(self):
        """The handle, the plain value, or the optional value."""
        if self.is_element:
            return self.owner.package.handle(self.facts["type"])
        plain = self.value["cpp"]
        return f"boost::optional<{plain}>" if self.kind == "optional" else plain

    @property
    def target_impl(self):
        """The class behind the handle of a reference, as its headers spell it."""
        return f"{self.type}::Impl"

    @property
    def result(self):
        return self.type if self.value["byValue"] and self.kind == "scalar" else f"{self.type} const&"

    @property
    def initial(self):
        """The initializer of the field, with its blank."""
        text = self.facts["default"]
        if self.kind not in ("scalar", "optional"):
            return ""
        if text:
            return f" = {self.owner.package.default(self.facts['type'], text)}"
        if self.kind == "optional":
            return ""
        return self.value.get("initial", " = 0" if self.value["byValue"] else "")

    @property
    def collection(self):
        """The class of a many-valued property's collection."""
        entry = self.type if self.is_element else self.value["cpp"]
        if self.qualifier:
            form = "ElementMap" if self.facts["qualificationUnique"] else "ElementMultimap"
            return f"{form}<{self.key_type}, {entry}>"
        if self.is_element:
            return f"ElementSequence<{entry}>" if self.facts["ordered"] else \
                f"UnorderedElementSet<{entry}>"
        return f"PrimitiveSequence<{entry}>" if self.facts["ordered"] else f"PrimitiveSet<{entry}>"

    @property
    def key_type(self):
        """The keys of a qualified property; literals go by their numbers."""
        is_literal = self.qualifier.facts["typeKind"] == "Enum"
        return "unsigned long" if is_literal else self.qualifier.value["cpp"]

    def key_of(self, expression):
        """`expression`, a value of the qualifier, as a key."""
        is_literal = self.qualifier.facts["typeKind"] == "Enum"
        return f"static_cast<unsigned long>({expression})" if is_literal else expression

    @property
    def collection_header(self):
        return f"tarnkiln/collections/{self.collection.split('<')[0]}.h"

    @property
    def is_unique(self):
        return "/*unique=*/" + ("true" if self.facts["unique"] else "false")

    def maker_head(self, scope, indent, end):
        """The head of the function that makes the collection, in or outside the class."""
        result = " " * indent + f"{'' if scope else 'static '}std::unique_ptr<{self.collection}>"
        name = f"{scope}{self.maker}(Impl* owner){end}"
        gap = " " if len(result) + 1 + len(name) <= WIDTH else "\n" + " " * indent
        return result + gap + name

    @property
    def key_expression(self):
        member = f"static_cast<{self.type}::Impl*>(member)"
        return self.key_of(f"{member}->{self.qualifier.getter}()")

    @property
    def slot_definition(self):
        parts = [f".index = {self.index if self.stored else 'ModelElement::Impl::NO_INDEX'}"]
        # What is computed contains nothing, whatever its property says.
        if self.composite and self.stored:
            parts.append(".composite = true")
        if self.many:
            parts.append(".single = false")
        if self.qualifier:
            parts.append(".keyed = true")
        if self.opposite:
            parts.append(f".opposite = &{self.opposite.owner.name}::Impl::{self.opposite.constant}")
        parts.append(f".property = {self.element}")
        head = f"constinit Slot const {self.owner.name}::Impl::{self.constant}{{"
        return fill(head, parts, "};", 4)

    @property
    def element(self):
        """The function that gives the metamodel's element; the meta package declares it."""
        return f"propertyOf<rows::properties::{self.owner.name}{capital(self.name)}>"

    # The member of the search instance

    @property
    def constrained(self):
        """The type of its values, as the class of search instances spells it.

        A member of that class may have the name of the type, which then needs a scope.
        """
        plain = self.type if self.is_element else self.value["cpp"]
        hidden = {prop.cpp_name for prop in self.owner.properties}
        return self.owner.package.rooted(self.facts["type"], plain) if plain in hidden else plain

    @property
    def takes_patterns(self):
        """Whether queries can match the values with patterns: they are texts, and required."""
        return self.facts["type"] in ("String", "StdString") and self.facts["lower"] != 0

    @property
    def constrainable(self):
        """The declaration of the member."""
        form = "Reference" if self.is_element else "Value"
        arguments = [self.constrained] + ["true"] * self.takes_patterns
        return fill(f"    query::Constrainable{form}<", arguments, f"> {self.cpp_name};", 8)

    @property
    def constrainable_doc(self):
        doc = self.cpp.get("doc")
        return comment(sentence(doc), 4) if doc else ""

    @property
    def constrainable_initializer(self):
        return fill(f"      {self.cpp_name}(", ["*this", f"{self.element}()"], ")", 10)

    def computed_row(self, end):
        """Its row in the table of what can only be read; `end` closes the line."""
        return fill("        support::Computed<", [f"&Impl::{self.getter}", self.constant],
                    ">" + end, 12)

    def row(self, end):
        """Its row in the table of the class; `end` closes the line."""
        kind, *arguments = {
            "scalar": ["Scalar", self.field_pointer, self.constant, self.setter_pointer],
            "optional": ["Optional", self.field_pointer, self.constant, self.setter_pointer],
            "reference": ["Reference", self.type, self.field_pointer, self.constant,
                          self.setter_pointer],
            "composite reference": ["CompositeReference", self.type, self.field_pointer,
                                    self.constant, self.setter_pointer],
            "container": ["Container", self.type, self.constant, self.setter_pointer],
            "references": ["References", self.field_pointer, self.constant, self.maker_pointer,
                           f"&Impl::{self.getter}"],
            "values": ["Values", self.field_pointer, self.constant, self.maker_pointer,
                       f"&Impl::{self.getter}"],
        }[self.kind]
        return fill(f"        support::{kind}<", arguments, ">" + end, 12)

    @property
    def setter_head(self):
        """The declaration of the setter in its class."""
        virtual = "virtual " if self.overridden else ""
        return f"{virtual}void {self.setter}({self.parameter});"

    @property
    def guards(self):
        """What a setter refuses before anything else."""
        if not self.is_set_once:
            return []
        name = f'u"{self.name}"'
        if self.kind == "container":
            return [self.call("support::refuseSecondTarget", "*this", f"{self.getter}Impl()",
                              f"{self.argument}.getImpl()", name)]
        if self.is_element:
            return [self.call("support::refuseSecondTarget", "*this", f"{self.field}.get()",
                              f"{self.argument}.getImpl()", name)]
        return [self.call("support::refuseSecondValue", "*this", self.field, name)]

    @property
    def code(self):
        """The declaration of the getter of a derived property."""
        if "code" in self.cpp:
            return self.cpp["code"]
        return f"{self.owner.package.carrier(self.facts)} {self.getter}() const;"

    @property
    def field_pointer(self):
        return f"&Impl::{self.field}"

    @property
    def setter_pointer(self):
        return f"&Impl::{self.setter}"

    @property
    def maker_pointer(self):
        return f"&Impl::{self.maker}"

    def call(self, head, *arguments):
        """A call as a statement in a function body."""
        return fill(f"    {head}(", arguments, ");", 8)

    @property
    def doc(self):
        text = sentence(self.cpp["doc"] or self.spoken_name)
        if self.is_set_once:
            text += ("\n\\throws tarnkiln::messages::CannotSetReadOnlyProperty  if it has a value "
                     "already.")
        if any(rekeyed.unique for rekeyed in self.rekeyed):
            text += "\n" + self.rekeyed[0].key_failure
        return comment(text, 4)

    @property
    def spoken_name(self):
        question = re.match(r"is(?=[A-Z])", self.name)
        return f"whether it is {spoken(self.name[2:])}" if question else f"the {spoken(self.name)}"

    @property
    def overridden(self):
        """Whether a derived class gives the setter another body."""
        return any(self in [key for key, rekeyed in c.inherited_keys]
                   for c in self.owner.package.classes)


class Rekeyed:
    """How the elements of a class stand in a collection of an owner by the value of `key`."""

    def __init__(self, to_owner):
        self.to_owner = to_owner
        self.collection = to_owner.opposite
        self.key = self.collection.qualifier
        self.unique = self.collection.facts["qualificationUnique"]
        self.require_free_name = f"requireFreeIn{capital(to_owner.cpp_name)}"

    @property
    def key_failure(self):
        if not self.unique:
            return ""
        return ("\\throws tarnkiln::messages::UniquenessConstraint  if the owner has another such "
                f"{'name' if self.key.name == 'name' else 'key'}.")

    @property
    def doc(self):
        text = f"Gives it another {self.key.name}, under which the owner then keeps it."
        if self.unique:
            text += "\n\n" + self.key_failure
        return comment(text, 4)

    @property
    def require_free(self):
        """Fails if the owner has an element of the new key; in a lambda."""
        return self.key.call("    support::requireFreeKey",
                             f"{self.to_owner.getter}()->{self.collection.getter}()",
                             self.collection.key_of(self.key.argument))

    def change(self, store):
        """The change of the key in the owner's collection."""
        return self.key.call("support::changeKey", "*this", f"{self.key.getter}()",
                             self.key.argument, f"{self.to_owner.getter}()", self.to_owner.constant,
                             "requireFree", store)

    @staticmethod
    def body(rekeyed):
        """The template of a setter of the key, for one collection or for several."""
        return "bodies/change key.jinja" if len(rekeyed) == 1 else "bodies/change keys.jinja"

    def change_all(self, rekeyed):
        """The change of the key in the collections of several owners."""
        owners = [f"support::KeyedBy{{{each.to_owner.getter}(), {each.to_owner.constant}, "
                  f"{each.require_free_name if each.unique else 'support::anyKey'}}}"
                  for each in rekeyed]
        return self.key.call("support::changeKey", "*this", f"{self.key.getter}()",
                             self.key.argument, "store", *owners)


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

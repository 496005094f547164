"""The properties of a class, and the C++ that stands for them."""
import re

import operations
import words
from wording import capital, comment, constant, fill, sentence, spoken, WIDTH


class Property:
    """One property of a class."""

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

"""The names that the templates of builders print.

A builder keeps a value for each stored property, in a form that depends on the property's shape:

| Shape | Field | Functions |
|---|---|---|
| single | the plain value, or a handle | set |
| optional | the same, optional | set, with and without a value |
| contained | an element or its builder | set, with either |
| many | a vector of values or handles | add one or several, clear |
| nested | a vector of builders | add, clear |
"""
from wording import capital, comment, fill, sentence, spoken, WIDTH

SHAPES = {"scalar": "single", "reference": "single", "container": "single",
          "optional": "optional", "composite reference": "contained",
          "values": "many", "references": "many"}
NESTED = "std::unique_ptr<ModelElement::Builder>"


class Field:
    """What a builder keeps for one property."""

    def __init__(self, prop):
        self.prop = prop
        self.shape = "nested" if prop.kind == "references" and prop.composite else SHAPES[prop.kind]
        self.name = prop.field
        self.argument = prop.argument
        self.plain = prop.type if prop.is_element else prop.value["cpp"]
        self.clear = "clear" + capital(prop.cpp_name)
        self.add = "add" + capital(prop.cpp_name)
        self.set = prop.setter

    @property
    def declaration(self):
        form = {"single": self.plain, "optional": f"boost::optional<{self.plain}>",
                "contained": f"support::NestedElement<{self.plain}>",
                "many": f"std::vector<{self.plain}>", "nested": "support::NestedBuilders"}
        return f"    {form[self.shape]} {self.name}{self.prop.initial};"

    @property
    def by_reference(self):
        """The parameter of a setter."""
        by_value = not self.prop.is_element and self.prop.value["byValue"]
        return f"{self.plain}{'' if by_value else ' const&'} {self.argument}"

    @property
    def optional(self):
        return f"boost::optional<{self.plain}> const& {self.argument}"

    @property
    def several(self):
        return f"std::initializer_list<{self.plain}> {self.argument}"

    @property
    def nested(self):
        return f"{NESTED} {self.argument}"

    def store(self, name, parameter, statement):
        """A function of the values that is named after `name`."""
        return function(f"void do{capital(name)}(", parameter, statement)

    def setter(self, name, parameter, give="give", argument=None, store=None):
        """A function of the builder, which hands its argument to the values."""
        arguments = [self.prop.constant, f"&BuilderImpl::do{capital(store or name)}"]
        if parameter:
            arguments.append(argument or self.argument)
        return function(f"Final& {name}(", parameter,
                        fill(f"return this->{give}(", arguments, ");", 12, WIDTH - 8))

    @property
    def doc(self):
        return comment(sentence(self.prop.cpp["doc"] or f"the {spoken(self.prop.name)}"), 4)


def function(head, parameter, body):
    """A function inside a class, on one line if it fits."""
    line = f"    {head}{parameter}) {{ {body} }}"
    if len(line) <= WIDTH and "\n" not in body:
        return line
    head = fill(f"    {head}", [parameter] if parameter else [], ")", 8)
    return f"{head}\n    {{\n        {body}\n    }}"


class Builder:
    """The builder of one class."""

    def __init__(self, cls):
        self.cls = cls
        self.fields = [Field(p) for p in cls.stored]

    @property
    def base_values(self):
        return f"{self.cls.base_impl}::BuilderImpl" if self.cls.base else \
            "support::BuilderRoot"

    @property
    def rung_above(self):
        return f"{self.cls.base_impl}::BuilderBase<Final>" if self.cls.base else \
            "support::BuilderTop<Final>"

    @property
    def constructor_head(self):
        """The constructor by which a builder makes the element."""
        argument = "values" if self.cls.base else "values.getBuilder()"
        name = f"{self.cls.name}::Impl::Impl(BuilderImpl& values, UUID const& id) "
        return fill(name, [f": Dispatched({argument}, id)"], "", 4)

    @property
    def values_head(self):
        cls = self.cls
        return fill(f"class {cls.package.export_word}{cls.name}::Impl::BuilderImpl ",
                    [f": public support::BuilderValues<{cls.name}::Impl, {self.base_values}>"],
                    "", 4)

    @property
    def builder_head(self):
        cls = self.cls
        return fill(f"class {cls.package.export_word}{cls.name}::Builder final ",
                    [f": public {cls.name}::Impl::BuilderBase<{cls.name}::Builder>"], "", 4)

    @property
    def field_list(self):
        return fill("    using Fields = support::BuilderFields<",
                    [f"&BuilderImpl::{field.name}" for field in self.fields], ">;", 8)

    @property
    def includes(self):
        cls = self.cls
        above = cls.base.builder_header if cls.base else "tarnkiln/support/Builder.h"
        return sorted({cls.impl_header, above})

    @property
    def system_includes(self):
        shapes = {field.shape for field in self.fields}
        headers = set()
        if "many" in shapes:
            headers |= {"<initializer_list>", "<vector>"}
        if "nested" in shapes or "contained" in shapes:
            headers |= {"<memory>", "<utility>"}
        return sorted(headers)

    def instantiations(self, word):
        """The lines by which the library compiles the templates once."""
        cls = self.cls
        above = f"{cls.base.qualified_impl}::BuilderImpl" if cls.base else \
            "tarn::kiln::support::BuilderRoot"
        builder = f"{cls.package.namespace}::{cls.name}::Builder"
        return "\n".join([
            cls.instantiation(word, "BuilderValues", above),
            fill(f"{word}template class tarn::kiln::support::BuilderTop<", [builder], ">;", 4)])

"""The operations of a class, as the functions that clients write by hand, and their events."""
import wording

EVENT_DOC = ("An event: it waits, as {article} `{name}`, for the end of the open transaction, and is "
             "dropped by a rollback. Where no transaction is open it happens at once.")
STEP_DOC = "What happens when `{name}` has waited."


class Operation:
    def __init__(self, facts, cpp, owner):
        self.facts = facts
        self.cpp = cpp
        self.owner = owner
        self.name = cpp.get("name", facts["name"])
        self.types = [argument["type"] for argument in facts["arguments"]]
        self.is_virtual = facts["abstract"] or cpp["virtual"]
        self.is_event = facts["event"]

    @property
    def typed(self):
        """The facts of the result and of the arguments."""
        result = [self.facts["result"]] if self.facts["result"] else []
        return result + self.facts["arguments"]

    @property
    def result(self):
        return self.owner.package.carrier(self.facts["result"]) if self.facts["result"] else "void"

    @property
    def parameters(self):
        return [self.owner.package.parameter(argument, argument["name"])
                for argument in self.facts["arguments"]]

    @property
    def overrides(self):
        """Whether a superclass has it too, so that this is another body of that."""
        above = self.owner.base
        while above:
            if any(o.name == self.name and o.types == self.types for o in above.operations):
                return True
            above = above.base
        return False

    @property
    def functions(self):
        """What stands for it in the class: the function written by hand and, for an event, the one
        that is called before."""
        if not self.is_event:
            return [Function(self.doc, self.written(self.name))]
        step = Function(self.step_doc, self.written(self.step))
        return [step] if self.overrides else [Function(self.event_doc, self.emitting), step]

    def written(self, name):
        """The declaration of the function that is written by hand."""
        virtual = "virtual " if self.is_virtual and not self.overrides else ""
        tail = ")" + (" const" if self.cpp["const"] else "")
        tail += " override" if self.overrides else ""
        tail += " = 0;" if self.facts["abstract"] else ";"
        return wording.fill(f"    {virtual}{self.result} {name}(", self.parameters, tail, 8)

    @property
    def pointer_type(self):
        """A cast to the type of a pointer to it, for one of several of its name."""
        types = [self.owner.package.parameter(argument, "").rstrip()
                 for argument in self.facts["arguments"]]
        tail = " const" if self.cpp["const"] else ""
        return (f"static_cast<{self.result} ({self.owner.name}::Impl::*)({', '.join(types)})"
                f"{tail}>")

    @property
    def doc(self):
        return wording.comment(wording.sentence(self.cpp["doc"]), 4) if self.cpp["doc"] else ""

    # Events

    @property
    def has_event_class(self):
        """An event that a superclass has got too is announced there."""
        return self.is_event and not self.overrides

    @property
    def step(self):
        return f"do{wording.capital(self.name)}"

    @property
    def emitting(self):
        return wording.fill(f"    void {self.name}(", self.parameters, ");", 8)

    @property
    def event_doc(self):
        event = Event(self).name
        text = EVENT_DOC.format(article=wording.article(event), name=event)
        brief = wording.sentence(self.cpp["doc"]) + "\n\n" if self.cpp["doc"] else ""
        return wording.comment(brief + text, 4)

    @property
    def step_doc(self):
        return wording.comment(STEP_DOC.format(name=self.name), 4)


class Function:
    """One function of a class, as its header shows it."""

    def __init__(self, doc, declaration):
        self.doc = doc
        self.declaration = declaration


class EventArgument:
    """One argument of an event, and the field that keeps it."""

    def __init__(self, facts, package):
        self.facts = facts
        self.package = package
        self.name = facts["name"]
        self.field = f"m_{self.name}"
        self.type = package.carrier(facts)

    @property
    def getter(self):
        """Gives by value what is passed by value."""
        parameter = self.package.parameter(self.facts, "").rstrip()
        return f"{parameter} {accessor(self.name)}() const {{ return {self.field}; }}"


class Event:
    """The class of the events of one operation."""

    def __init__(self, operation):
        self.operation = operation
        self.owner = operation.owner
        self.package = self.owner.package
        self.name = f"{self.owner.name}{wording.capital(operation.name)}Event"
        self.row = f"{self.owner.name}{wording.capital(operation.facts['name'])}"
        self.arguments = [EventArgument(argument, self.package)
                          for argument in operation.facts["arguments"]]

    @property
    def doc(self):
        brief = wording.sentence(self.operation.cpp["doc"]) if self.operation.cpp["doc"] else \
            f"The event `{self.operation.name}` of {self.owner.article} `{self.owner.name}`."
        return wording.comment(
            f"{brief}\n\nMade by `{self.owner.name}::Impl::{self.operation.name}`. It keeps its "
            "arguments, and holds the elements among them and its owner in memory.\n\n"
            "Threads: as the owner.")

    @property
    def file_doc(self):
        return wording.comment(f"\\file\nThe event `{self.operation.name}` of {self.owner.article} "
                             f"`{self.owner.name}`.")

    @property
    def class_head(self):
        head = f"class {self.package.export_word}{self.name} final : "
        bases = ["public meta::AbstractEvent", "public meta::AbstractDeferredInvocation"]
        line = head + ", ".join(bases)
        return line if len(line) <= wording.WIDTH else head + (",\n" + " " * len(head)).join(bases)

    @property
    def constructor(self):
        """Its parameters, for the declaration and the definition."""
        return [f"{self.owner.name} const& owner", *self.operation.parameters]

    @property
    def declaration(self):
        return wording.fill(f"    {self.name}(", self.constructor, ");", 8)

    @property
    def definition(self):
        return wording.fill(f"{self.name}::{self.name}(", self.constructor, ")", 4)

    @property
    def initializers(self):
        """Of the base and the fields, each on a line of its own."""
        head = "    : AbstractEvent("
        operation = (f"{self.package.meta_package}::getInstance().getOperation("
                     f"rows::operations::{self.row})")
        base = f"{head}{operation}, owner)"
        if len(base) > wording.WIDTH:
            base = f"{head}{operation},\n{' ' * len(head)}owner)"
        fields = [f"      {argument.field}({argument.name})" for argument in self.arguments]
        return ",\n".join([base, *fields])

    @property
    def call(self):
        """The call of what was written by hand."""
        return wording.fill(f"        owner->{self.operation.step}(",
                          [argument.field for argument in self.arguments], ");", 12)

    @property
    def emitter(self):
        return wording.fill(f"void {self.owner.name}::Impl::{self.operation.name}(",
                          self.operation.parameters, ")", 4)

    @property
    def made(self):
        """The making of the event that the emitter hands over."""
        return wording.fill(f"    support::emitEvent(std::make_unique<{self.name}>(",
                          [f"{self.owner.name}(this)", *(a.name for a in self.arguments)], "));", 8)

    @property
    def includes(self):
        headers = {self.owner.handle_header, "tarnkiln/meta/AbstractDeferredInvocation.h",
                   "tarnkiln/meta/AbstractEvent.h", *self.package.common_headers}
        return sorted({h for h in headers | self.argument_headers if not h.startswith("<")})

    @property
    def system_includes(self):
        return wording.sorted_blocks({h for h in self.argument_headers if h.startswith("<")})

    @property
    def argument_headers(self):
        headers = set()
        for argument in self.arguments:
            headers |= self.package.carrier_headers(argument.facts)
            headers |= self.package.type_headers(argument.facts)
        return headers

    @property
    def source_includes(self):
        return sorted([self.owner.impl_header, self.package.meta_package_header,
                       "tarnkiln/support/emitEvent.h"])


def accessor(name):
    """The function that gives what is called `name`."""
    return name if wording.is_question(name) else "get" + wording.capital(name)

"""The operations of a class, as the functions that clients write by hand."""
import model


class Operation:
    def __init__(self, facts, cpp, owner):
        self.facts = facts
        self.cpp = cpp
        self.owner = owner
        self.name = cpp.get("name", facts["name"])
        self.types = [argument["type"] for argument in facts["arguments"]]
        self.is_virtual = facts["abstract"] or cpp["virtual"]

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
    def declaration(self):
        virtual = "virtual " if self.is_virtual and not self.overrides else ""
        tail = ")" + (" const" if self.cpp["const"] else "")
        tail += " override" if self.overrides else ""
        tail += " = 0;" if self.facts["abstract"] else ";"
        return model.fill(f"    {virtual}{self.result} {self.name}(", self.parameters, tail, 8)

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
        return model.comment(model.sentence(self.cpp["doc"]), 4) if self.cpp["doc"] else ""

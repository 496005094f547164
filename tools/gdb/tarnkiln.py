"""Shows handles, values, texts, UUIDs and collections of Tarnkiln readably in gdb.

    (gdb) source <prefix>/share/tarnkiln/gdb/tarnkiln.py

What is printed is read from memory; no code of the program runs. A collection shows what it holds
as it stands, proxies included, and makes or loads nothing.
"""
import gdb
import gdb.printing

NAMESPACE = "tarn::kiln::"


def is_a(kind, base):
    """Whether the type `kind` is, or derives from, the class named `base`."""
    kind = kind.strip_typedefs()
    if kind.code not in (gdb.TYPE_CODE_STRUCT, gdb.TYPE_CODE_UNION):
        return False
    if kind.tag == base:
        return True
    return any(is_a(field.type, base) for field in kind.fields() if field.is_base_class)


def short(name):
    """A name without the library's namespaces: `meta::Class`."""
    return name.replace(NAMESPACE, "")


def utf16(text):
    """The contents of a std::u16string."""
    length = int(text["_M_string_length"])
    units = gdb.selected_inferior().read_memory(text["_M_dataplus"]["_M_p"], 2 * length)
    return units.tobytes().decode("utf-16-le", "replace")


def uuid(value):
    digits = "".join(f"{int(value['data'][i]) & 0xFF:02x}" for i in range(16))
    return "-".join((digits[:8], digits[8:12], digits[12:16], digits[16:20], digits[20:]))


def own_name(impl):
    """The field `m_name` of an implementation object, if its class has one that is text."""
    try:
        return utf16(impl["m_name"])
    except (gdb.error, gdb.MemoryError):
        return None


def describe(pointer):
    """An implementation object in one line: class, name if it has one, UUID."""
    impl = pointer.cast(pointer.dynamic_type).dereference()
    words = [short(impl.type.strip_typedefs().tag or "").removesuffix("::Impl")]
    name = own_name(impl)
    if name is not None:
        words.append(f'"{name}"')
    words.append(uuid(impl["m_uuid"]))
    validity = str(impl["m_validity"]).split("::")[-1]
    if validity.lower() not in ("valid", "live"):
        words.append(f"({validity.lower()})")
    return " ".join(words)


class Handle:
    """`Model`, `ModelElement` and all classes of elements: what the handle leads to."""

    def __init__(self, value):
        self.impl = value["m_impl"]
        self.kind = short(value.type.strip_typedefs().tag)

    def to_string(self):
        return describe(self.impl) if self.impl else f"empty {self.kind}"

    def children(self):
        if self.impl:
            yield "impl", self.impl.cast(self.impl.dynamic_type)


class Counted:
    """A reference field of an element."""

    def __init__(self, value):
        self.target = value["m_target"]

    def to_string(self):
        return describe(self.target) if self.target else "empty"


class Uuid:
    def __init__(self, value):
        self.value = value

    def to_string(self):
        return uuid(self.value)


class Text:
    def __init__(self, value):
        self.value = value

    def to_string(self):
        return utf16(self.value)

    def display_hint(self):
        return "string"


class Value:
    """A `Value`: its type, its shape and what it holds."""

    SCALARS = {
        "Boolean": "bool", "Integer": "int", "Integer8": "signed char", "UInteger8": "unsigned char",
        "UnlimitedNatural": "unsigned int", "Integer16": "short", "UInteger16": "unsigned short",
        "Integer64": "long", "UInteger64": "unsigned long", "Real": "double",
        "String": "tarn::kiln::ustring", "StdString": "std::string", "UUID": "tarn::kiln::UUID",
    }

    def __init__(self, value):
        self.value = value

    def to_string(self):
        type_impl = self.value["m_type"]["m_impl"]
        if not type_impl:
            return "value without a type"
        type_impl = type_impl.cast(type_impl.dynamic_type).dereference()
        name = own_name(type_impl) or "unnamed"
        shape = str(self.value["m_flags"]).split("::")[-1]
        head = name if shape == "Single" else f"{shape} of {name}"
        data = self.value["m_payload"]["m_data"]
        if not data:
            return f"{head}, absent"
        if shape in ("Single", "OptionalSingle"):
            kind = self.payload_type(name, type_impl)
            if kind is not None:
                return f"{head} {data.cast(kind.pointer()).dereference().format_string()}"
        return f"{head} at {data}"

    def payload_type(self, name, type_impl):
        kind = short(type_impl.type.strip_typedefs().tag or "").removesuffix("::Impl")
        if kind == "meta::Enum":
            return gdb.lookup_type("unsigned long")
        if kind == "meta::Class":
            return gdb.lookup_type(NAMESPACE + "ModelElement")
        if name in self.SCALARS and kind == "meta::PrimitiveType":
            return gdb.lookup_type(self.SCALARS[name])
        return None


class Collection:
    """Any collection of an element: its class and its entries."""

    def __init__(self, value):
        self.kind = short(value.type.strip_typedefs().tag)
        self.entries = value["m_entries"]
        self.inner = gdb.default_visualizer(self.entries)

    def to_string(self):
        return f"{self.kind} holding {self.inner.to_string()}" if self.inner else self.kind

    def children(self):
        if self.inner and hasattr(self.inner, "children"):
            yield from self.inner.children()
        else:
            yield "entries", self.entries

    def display_hint(self):
        hint = getattr(self.inner, "display_hint", None)
        return hint() if hint else None


class SequenceEntries:
    """The entries of a sequence, leaf by leaf."""

    def __init__(self, value):
        self.value = value

    def to_string(self):
        return f"entries of length {int(self.value['m_size'])}"

    def children(self):
        if self.value["m_root"]:
            for number, entry in enumerate(self.below(self.value["m_root"])):
                yield f"[{number}]", entry

    def below(self, node):
        count = int(node["count"])
        if int(node["level"]) == 0:
            entries = (node + 1).cast(gdb.lookup_type(NAMESPACE + "ModelElement").pointer())
            yield from ((entries + i).dereference() for i in range(count))
            return
        inner = gdb.lookup_type(NAMESPACE + "support::SequenceEntries::Inner").pointer()
        for i in range(count):
            yield from self.below(node.cast(inner)["children"][i])


class Printers(gdb.printing.PrettyPrinter):
    """Finds the printer of a value by its class, or by the class that it derives from."""

    EXACT = {"boost::uuids::uuid": Uuid, NAMESPACE + "Value": Value,
             NAMESPACE + "support::SequenceEntries": SequenceEntries}
    DERIVED = ((NAMESPACE + "ElementHandle", Handle),
               (NAMESPACE + "AbstractOwnedCollection", Collection))

    def __init__(self):
        super().__init__("tarnkiln")
        self.known = {}

    def __call__(self, value):
        kind = value.type.strip_typedefs()
        if kind.code != gdb.TYPE_CODE_STRUCT or not kind.tag:
            return None
        if kind.tag not in self.known:
            self.known[kind.tag] = self.find(kind)
        found = self.known[kind.tag]
        return found(value) if found else None

    def find(self, kind):
        if kind.tag in self.EXACT:
            return self.EXACT[kind.tag]
        if kind.tag.startswith(NAMESPACE + "support::CountedPointer<"):
            return Counted
        if kind.tag.startswith("std::") and "basic_string<char16_t" in kind.tag:
            return Text
        return next((printer for base, printer in self.DERIVED if is_a(kind, base)), None)


gdb.printing.register_pretty_printer(gdb.current_objfile(), Printers(), replace=True)

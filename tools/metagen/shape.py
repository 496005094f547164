"""Compares JSON with a JSON Schema, as far as the schema of descriptions goes, and fills in the
defaults that the schema gives."""
import difflib
import re

TYPES = {"object": dict, "array": list, "string": str, "integer": int, "boolean": bool}
SPOKEN = {dict: "an object", list: "a list", str: "a text", int: "a whole number",
          bool: "true or false", float: "a number", type(None): "null"}


class Shape:
    def __init__(self, schema, problems):
        self.schema = schema
        self.problems = problems

    def complete(self, value):
        """Enters into `problems` where `value` is not as the schema says, and adds defaults."""
        self.check("", value, self.schema)
        return value

    def definition(self, schema):
        """`schema` with what it refers to; what stands beside the reference goes before."""
        if "$ref" not in schema:
            return schema
        name = schema["$ref"].removeprefix("#/$defs/")
        return {**self.definition(self.schema["$defs"][name]), **schema}

    def check(self, pointer, value, schema):
        schema = self.definition(schema)
        if "anyOf" in schema:
            self.check_any(pointer, value, schema["anyOf"])
        elif not self.has_type(value, schema["type"]):
            self.problems.add(pointer, f"must be {SPOKEN[TYPES[schema['type']]]}, "
                                       f"not {SPOKEN[type(value)]}")
        elif schema["type"] == "object":
            self.check_object(pointer, value, schema)
        elif schema["type"] == "array":
            self.check_list(pointer, value, schema)
        else:
            self.check_plain(pointer, value, schema)

    @staticmethod
    def has_type(value, name):
        return isinstance(value, TYPES[name]) and isinstance(value, bool) == (name == "boolean")

    def check_any(self, pointer, value, choices):
        """The choices of this schema are a whole number and one text."""
        number = next(choice for choice in choices if "type" in choice)
        text = next(choice["const"] for choice in choices if "const" in choice)
        if value == text:
            return
        if self.has_type(value, number["type"]):
            self.check_plain(pointer, value, number)
        else:
            self.problems.add(pointer, f"must be a whole number or {text!r}")

    def check_object(self, pointer, value, schema):
        known = schema["properties"]
        for key in value:
            if key not in known:
                near = difflib.get_close_matches(key, known, 1)
                hint = f"; did you mean {near[0]!r}?" if near else ""
                step = key.replace("~", "~0").replace("/", "~1")
                self.problems.add(f"{pointer}/{step}", f"there is no such key{hint}")
        for key in schema.get("required", []):
            if key not in value:
                self.problems.add(pointer, f"the key {key!r} is missing")
        for key, part in known.items():
            if key in value:
                self.check(f"{pointer}/{key}", value[key], part)
            else:
                self.add_default(pointer, value, key, self.definition(part))

    def add_default(self, pointer, value, key, part):
        if "default" not in part:
            return
        default = part["default"]
        value[key] = type(default)(default) if isinstance(default, (dict, list)) else default
        self.check(f"{pointer}/{key}", value[key], part)

    def check_list(self, pointer, value, schema):
        if len(value) < schema.get("minItems", 0):
            self.problems.add(pointer, "must not be empty")
        for position, entry in enumerate(value):
            self.check(f"{pointer}/{position}", entry, schema["items"])

    def check_plain(self, pointer, value, schema):
        if "pattern" in schema and not re.search(schema["pattern"], value):
            self.problems.add(pointer, f"{value!r} is not of the form {schema['pattern']}")
        if value is not True and value is not False and isinstance(value, int):
            low, high = schema.get("minimum", value), schema.get("maximum", value)
            if not low <= value <= high:
                bounds = [f"at least {low}"] * ("minimum" in schema)
                bounds += [f"at most {high}"] * ("maximum" in schema)
                self.problems.add(pointer, f"{value} must be {' and '.join(bounds)}")

"""What the generator refuses, and that its output in the source tree is up to date."""
import json
import pathlib
import subprocess
import sys
import tempfile
import unittest

ROOT = pathlib.Path(__file__).resolve().parents[2]
METAGEN = ROOT / "tools/metagen/metagen.py"
CATALOGUE = ROOT / "src/tarnkiln/meta/catalogue.json"
OVERLAY = ROOT / "src/tarnkiln/meta/catalogue.cpp.json"
GENERATED = ROOT / "generated/tarnkiln/meta"
GOLDEN = ROOT / "tests/metagen/golden"


def run(description, output, *options):
    return subprocess.run([sys.executable, METAGEN, description, output, *options],
                          capture_output=True, text=True)


def named(entries, name):
    return next(entry for entry in entries if entry["name"] == name)


class GeneratedCatalogue(unittest.TestCase):
    def test_is_up_to_date(self):
        result = run(CATALOGUE, GENERATED, "--check")

        self.assertEqual(result.returncode, 0, result.stdout + result.stderr)

    def test_is_the_same_wherever_it_is_written(self):
        with tempfile.TemporaryDirectory() as folder:
            run(CATALOGUE, folder)

            for path in pathlib.Path(folder).iterdir():
                self.assertEqual(path.read_text(), (GENERATED / path.name).read_text(), path.name)

    def test_has_no_line_that_is_too_long(self):
        for path in sorted(GENERATED.glob("*.h")) + sorted(GENERATED.glob("*.cpp")):
            for number, line in enumerate(path.read_text().splitlines(), 1):
                self.assertLessEqual(len(line), 100, f"{path.name}:{number}")


class GeneratedClient(unittest.TestCase):
    """The output for a metamodel of three classes, to be read when a template changes.

    Made anew by `tools/metagen/metagen.py tests/metagen/golden/garden.json
    tests/metagen/golden/garden`.
    """

    def test_looks_like_the_golden_one(self):
        result = run(GOLDEN / "garden.json", GOLDEN / "garden", "--check")

        self.assertEqual(result.returncode, 0, result.stdout + result.stderr)

    def test_has_no_line_that_is_too_long(self):
        for path in sorted((GOLDEN / "garden").iterdir()):
            for number, line in enumerate(path.read_text().splitlines(), 1):
                self.assertLessEqual(len(line), 100, f"{path.name}:{number}")

    def test_lies_where_it_is_included(self):
        with tempfile.TemporaryDirectory() as folder:
            run(GOLDEN / "garden.json", folder, "--root")
            listed = run(GOLDEN / "garden.json", folder, "--root", "--list").stdout.split()

            written = [str(path.relative_to(folder))
                       for path in sorted(pathlib.Path(folder).glob("acme/garden/*"))]
            self.assertEqual(written, sorted(listed))
            self.assertIn("acme/garden/Bed.h", written)

    def test_depends_on_the_generator_and_all_descriptions(self):
        inputs = run(GOLDEN / "garden.json", "nowhere", "--inputs").stdout.split()

        for path in [GOLDEN / "garden.json", CATALOGUE, OVERLAY, METAGEN,
                     METAGEN.parent / "templates/Class.cpp.jinja"]:
            self.assertIn(str(path), inputs)


class StaleOutput(unittest.TestCase):
    def setUp(self):
        self.folder = tempfile.TemporaryDirectory()
        self.output = pathlib.Path(self.folder.name)
        run(CATALOGUE, self.output)

    def tearDown(self):
        self.folder.cleanup()

    def test_is_reported_as_a_difference(self):
        (self.output / "Enum.h").write_text("edited\n")

        result = run(CATALOGUE, self.output, "--check")

        self.assertEqual(result.returncode, 1)
        self.assertIn("-edited", result.stdout)

    def test_includes_files_that_nothing_makes(self):
        (self.output / "Gone.h").write_text("")

        result = run(CATALOGUE, self.output, "--check")

        self.assertEqual(result.returncode, 1)
        self.assertIn("Gone.h", result.stdout)

    def test_is_not_touched_by_a_check(self):
        (self.output / "Enum.h").write_text("edited\n")

        run(CATALOGUE, self.output, "--check")

        self.assertEqual((self.output / "Enum.h").read_text(), "edited\n")


class WrongDescription(unittest.TestCase):
    """Each test breaks one rule in a copy of the catalogue."""

    def setUp(self):
        self.facts = json.loads(CATALOGUE.read_text())
        self.overlay = json.loads(OVERLAY.read_text())

    def cls(self, name):
        return named(self.facts["classes"], name)

    def property(self, owner, name):
        return named(self.cls(owner)["properties"], name)

    def at(self, owner, name=None):
        """The place of a class or of one of its properties."""
        place = f"/classes/{self.facts['classes'].index(self.cls(owner))}"
        if name is None:
            return place
        return f"{place}/properties/{self.cls(owner)['properties'].index(self.property(owner, name))}"

    def refuse(self, place, reason):
        """Expects that the generator names `place` and `reason`, and writes nothing."""
        with tempfile.TemporaryDirectory() as folder:
            description = pathlib.Path(folder) / "catalogue.json"
            description.write_text(json.dumps(self.facts))
            description.with_suffix(".cpp.json").write_text(json.dumps(self.overlay))
            output = pathlib.Path(folder) / "output"

            result = run(description, output)

            self.assertEqual(result.returncode, 2, result.stdout)
            self.assertIn(str(description.parent), result.stderr)
            self.assertIn(place, result.stderr)
            self.assertIn(reason, result.stderr)
            self.assertFalse(output.exists())

    def test_gives_a_uuid_twice(self):
        self.cls("Enum")["uuid"] = self.cls("Class")["uuid"]
        self.refuse(self.at("Enum") + "/uuid", f"belongs to {self.at('Class')}/uuid")

    def test_gives_a_malformed_uuid(self):
        self.property("Enum", "literals")["uuid"] = "nothing"
        self.refuse(self.at("Enum", "literals") + "/uuid", "is no UUID")

    def test_leaves_a_gap_between_indices(self):
        self.property("EnumLiteral", "parentEnum")["index"] = 4
        self.refuse(self.at("EnumLiteral", "parentEnum") + "/index", "3 comes next")

    def test_does_not_continue_the_indices_of_the_superclass(self):
        self.property("TypedElement", "type")["index"] = 1
        self.refuse(self.at("TypedElement", "type") + "/index", "2 comes next")

    def test_counts_its_slots_wrongly(self):
        self.cls("Enum")["slots"] = 7
        self.refuse(self.at("Enum") + "/slots", "is 7 instead of 6")

    def test_gives_a_derived_property_an_index(self):
        self.property("Type", "qualifiedName")["index"] = 4
        self.refuse(self.at("Type", "qualifiedName") + "/index", "a derived property has no index")

    def test_names_an_opposite_that_is_not_there(self):
        self.property("Enum", "literals")["opposite"] = "owner"
        self.refuse(self.at("Enum", "literals"), "EnumLiteral has no property owner")

    def test_has_opposites_that_are_not_mutual(self):
        self.property("EnumLiteral", "parentEnum")["opposite"] = None
        self.refuse(self.at("Enum", "literals") + "/opposite", "one-sided: EnumLiteral.parentEnum has no")

    def test_has_opposites_of_types_that_do_not_match(self):
        self.property("EnumLiteral", "parentEnum")["type"] = "Type"
        self.refuse(self.at("Enum", "literals") + "/opposite",
                    "EnumLiteral.parentEnum is of type Type, not Enum")

    def test_has_two_containers_for_each_other(self):
        self.property("EnumLiteral", "parentEnum")["composite"] = True
        self.refuse(self.at("Enum", "literals"), "one container")

    def test_qualifies_by_a_property_of_another_class(self):
        self.property("Enum", "literals")["qualifiedBy"] = "uri"
        self.refuse(self.at("Enum", "literals"), "EnumLiteral has no property uri")

    def test_has_a_default_that_does_not_parse(self):
        self.property("Argument", "isInput")["default"] = "maybe"
        self.refuse(self.at("Argument", "isInput") + "/default", "'maybe' does not parse as Boolean")

    def test_has_bounds_that_leave_no_room(self):
        self.property("Argument", "isInput")["lower"] = 2
        self.refuse(self.at("Argument", "isInput") + "/lower", "the bounds 2..1 leave no room")

    def test_has_a_superclass_that_is_not_there(self):
        self.cls("Enum")["superclass"] = "Nothing"
        self.refuse(self.at("Enum") + "/superclass", "there is no class Nothing")

    def test_has_a_ring_of_superclasses(self):
        self.cls("NamedElement")["superclass"] = "Enum"
        self.refuse(self.at("NamedElement") + "/superclass", "lead back to it")

    def test_has_a_property_of_an_unknown_class(self):
        self.property("Class", "superclass")["type"] = "Nothing"
        self.refuse(self.at("Class", "superclass") + "/type", "there is no type Nothing")

    def test_has_a_class_without_cpp(self):
        del self.overlay["classes"]["Enum"]
        self.refuse("catalogue.cpp.json: /classes", "there is no entry for Enum")

    def test_has_cpp_for_a_property_without_facts(self):
        self.overlay["classes"]["Enum"]["properties"]["colour"] = {"doc": "the colour"}
        self.refuse("catalogue.cpp.json: /classes/Enum", "the facts know no colour")

    def test_has_a_type_without_cpp(self):
        del self.overlay["types"]["Integer"]
        self.refuse("catalogue.cpp.json: /types", "there is no C++ type for Integer")


if __name__ == "__main__":
    unittest.main()

"""What the generator refuses in descriptions of clients, and how it tells."""
import copy
import json
import pathlib
import re
import sys
import tempfile
import unittest

ROOT = pathlib.Path(__file__).resolve().parents[2]
METAGEN = ROOT / "tools/metagen"
sys.dont_write_bytecode = True
sys.path.insert(0, str(METAGEN))

import load  # noqa: E402
import source  # noqa: E402

LIBRARY = {
    "name": "library",
    "uri": "library/1",
    "enumerations": [{"name": "Shelf", "literals": [{"name": "open"}, {"name": "locked"}]}],
    "dataTypes": [{"name": "Money", "properties": [{"name": "amount", "type": "Real"}]}],
    "classes": [
        {"name": "Library", "properties": [
            {"name": "books", "type": "Book", "upper": "*", "composite": True,
             "qualifiedBy": "title", "opposite": "library"}]},
        {"name": "Book", "properties": [
            {"name": "title", "type": "String"},
            {"name": "library", "type": "Library", "opposite": "books"},
            {"name": "shelf", "type": "Shelf", "default": "open"},
            {"name": "price", "type": "Money", "lower": 0}],
         "operations": [{"name": "lend", "arguments": [{"name": "days", "type": "Integer"}]}]},
        {"name": "Novel", "superclass": "Book"},
    ],
}


class Folder(unittest.TestCase):
    """A folder with descriptions."""

    def setUp(self):
        folder = tempfile.TemporaryDirectory()
        self.addCleanup(folder.cleanup)
        self.folder = pathlib.Path(folder.name)
        self.data = copy.deepcopy(LIBRARY)
        self.library, self.book, self.novel = self.data["classes"]
        self.books = self.library["properties"][0]
        self.title, self.owner, self.shelf, self.price = self.book["properties"]

    def write(self, data, name="library.json"):
        path = self.folder / name
        path.write_text(data if isinstance(data, str) else json.dumps(data), encoding="utf-8")
        return path

    def load(self):
        return load.package(self.write(self.data))

    def problems(self, data=None):
        """All that is wrong, as pairs of place and reason."""
        path = self.write(self.data if data is None else data)
        with self.assertRaises(source.DescriptionError) as caught:
            load.package(path)
        self.assertTrue(all(line.startswith(f"{path}: ")
                            for line in str(caught.exception).splitlines()))
        return caught.exception.problems

    def refuse(self, place, reason):
        """Expects exactly one problem, at `place`."""
        self.assertEqual(self.problems(), [(place, reason)])


class Description(Folder):
    def test_needs_only_a_name_and_a_uri(self):
        self.data = {"name": "library", "uri": "library/1"}

        self.assertEqual(self.load().namespace, "library")

    def test_counts_slots_down_the_superclasses(self):
        self.novel["properties"] = [{"name": "plot", "type": "String"}]

        book, novel = self.load().classes[1:]

        self.assertEqual([prop.index for prop in book.properties], [1, 2, 3, 4])
        self.assertEqual((book.slots, novel.properties[0].index, novel.slots), (5, 5, 6))

    def test_makes_uuids_from_names(self):
        first, second = self.load(), self.load()

        self.assertEqual(first.facts, second.facts)
        uuids = re.findall('"uuid": "([^"]*)"', json.dumps(first.facts))
        self.assertEqual(len(uuids), len(set(uuids)))
        self.assertEqual({uuid[14] for uuid in uuids}, {"5"})

    def test_makes_other_uuids_below_another_root(self):
        first = self.load().facts["classes"][1]["uuid"]
        self.data["uuid"] = "00010203-0405-0607-0809-0a0b0c0d0e0f"

        self.assertNotEqual(self.load().facts["classes"][1]["uuid"], first)

    def test_keeps_uuids_that_it_gives(self):
        self.title["uuid"] = "00010203-0405-0607-0809-0a0b0c0d0e0f"

        facts = self.load().facts["classes"][1]["properties"][0]

        self.assertEqual(facts["uuid"], "00010203-0405-0607-0809-0a0b0c0d0e0f")

    def test_makes_a_package_of_each_part_of_its_name(self):
        self.data["name"] = "acme.library"

        package = self.load()

        self.assertEqual([(each["name"], each["uriTail"]) for each in package.facts["packages"]],
                         [("acme", "library/1"), ("library", "library/1/acme.library")])
        self.assertEqual((package.namespace, package.include), ("acme::library", "acme/library"))
        self.assertEqual(package.facts["classes"][0]["qualifiedName"], "acme.library.Library")

    def test_gives_many_values_the_flags_of_their_collection(self):
        self.book["properties"] += [{"name": "notes", "type": "String", "upper": "*"},
                                    {"name": "tags", "type": "String", "upper": "*",
                                     "ordered": False},
                                    {"name": "sequels", "type": "Book", "upper": "*"}]

        books = self.load().facts["classes"]
        flags = [(p["ordered"], p["unique"], p["lower"])
                 for p in books[0]["properties"] + books[1]["properties"][4:]]

        self.assertEqual(flags, [(False, True, 0), (True, False, 0), (False, True, 0),
                                 (True, True, 0)])

    def test_may_derive_from_a_class_of_the_catalogue(self):
        self.novel["superclass"] = "tarn.kiln.meta.NamedElement"
        self.novel["properties"] = [{"name": "plot", "type": "tarn.kiln.meta.Language"}]

        novel = self.load().classes[2]

        self.assertEqual(novel.properties[0].index, 2)
        self.assertEqual(novel.base_impl, "meta::NamedElement::Impl")

    def test_may_name_the_types_of_an_imported_one(self):
        self.write(self.data, "base.json")
        self.data = {"name": "press", "uri": "press/1", "imports": ["base.json"], "classes": [
            {"name": "Magazine", "superclass": "library.Book",
             "properties": [{"name": "cover", "type": "library.Shelf", "default": "locked"}]}]}

        magazine = self.load().classes[0]

        self.assertEqual(magazine.properties[0].index, 5)
        self.assertEqual(magazine.properties[0].initial, " = library::Shelf::Locked")


class BrokenJson(Folder):
    def test_is_refused_with_its_line(self):
        self.assertEqual(self.problems('{\n"name": "library",\n"uri" "library/1"}'),
                         [("line 3, column 7", "no JSON: Expecting ':' delimiter")])

    def test_is_refused_for_a_key_that_is_given_twice(self):
        self.assertEqual(self.problems('{"name": "library", "uri": "a/1", "uri": "b/1"}'),
                         [("", "the key 'uri' of 'library' is given twice in one object")])

    def test_is_refused_if_there_is_no_file(self):
        with self.assertRaisesRegex(source.DescriptionError, "No such file"):
            load.package(self.folder / "nothing.json")

    def test_is_refused_in_an_import(self):
        self.write("{", "base.json")
        self.data["imports"] = ["base.json"]

        with self.assertRaisesRegex(source.DescriptionError, r"base\.json: line 1, column 2"):
            self.load()

    def test_is_refused_if_imports_form_a_ring(self):
        self.data["imports"] = ["library.json"]
        self.refuse("/imports", "the imports lead back to this file")


class Shape(Folder):
    def test_has_no_unknown_keys(self):
        self.shelf["defualt"] = "open"
        self.refuse("/classes/1/properties/2/defualt",
                    "there is no such key; did you mean 'default'?")

    def test_escapes_unknown_keys(self):
        self.shelf["a/b~c"] = 1
        self.refuse("/classes/1/properties/2/a~1b~0c", "there is no such key")

    def test_has_all_needed_keys(self):
        del self.shelf["type"]
        self.refuse("/classes/1/properties/2", "the key 'type' is missing")

    def test_has_values_of_the_right_types(self):
        self.books["composite"] = 1
        self.title["lower"] = True
        self.owner["upper"] = "many"
        self.book["properties"].append("year")
        self.assertEqual(self.problems(), [
            ("/classes/0/properties/0/composite", "must be true or false, not a whole number"),
            ("/classes/1/properties/0/lower", "must be a whole number, not true or false"),
            ("/classes/1/properties/1/upper", "must be a whole number or '*'"),
            ("/classes/1/properties/4", "must be an object, not a text")])

    def test_has_names_of_the_right_form(self):
        self.novel["name"] = "A novel"
        self.refuse("/classes/2/name", "'A novel' is not of the form ^[A-Za-z][A-Za-z0-9_]*$")

    def test_has_numbers_within_bounds(self):
        self.data["enumerations"][0]["literals"][0]["value"] = 2 ** 31
        self.refuse("/enumerations/0/literals/0/value",
                    "2147483648 must be at least -2147483648 and at most 2147483647")

    def test_has_no_empty_enumeration(self):
        self.data["enumerations"].append({"name": "Empty", "literals": []})
        self.refuse("/enumerations/1/literals", "must not be empty")

    def test_is_an_object(self):
        self.assertEqual(self.problems("[]"), [("", "must be an object, not a list")])


class Names(Folder):
    def test_of_types_are_given_once(self):
        self.data["enumerations"][0]["name"] = "Book"
        self.shelf["type"] = "String"
        self.assertEqual(self.problems()[0],
                         ("/enumerations/0/name", "there is a type Book already, at /classes/1/name"))

    def test_of_properties_are_given_once(self):
        self.price["name"] = "shelf"
        self.refuse("/classes/1/properties/3/name",
                    "there is a property shelf already, at /classes/1/properties/2/name")

    def test_of_properties_are_not_those_above(self):
        self.novel["properties"] = [{"name": "title", "type": "String"}]
        self.refuse("/classes/2/properties/0/name", "a superclass has a property title")

    def test_of_operations_with_the_same_arguments_are_given_once(self):
        self.book["operations"].append(copy.deepcopy(self.book["operations"][0]))
        self.refuse("/classes/1/operations/1/name",
                    "there is an operation lend(Integer) already, at /classes/1/operations/0/name")

    def test_of_operations_may_be_overloaded(self):
        self.book["operations"].append({"name": "lend"})
        self.load()

    def test_are_no_words_of_cxx(self):
        self.title["name"] = "default"
        self.books["qualifiedBy"] = "default"
        self.refuse("/classes/1/properties/0/name", "default is a word of C++")

    def test_may_be_words_of_cxx_with_another_name_there(self):
        self.title |= {"name": "default", "cpp": {"name": "fallback"}}
        self.books["qualifiedBy"] = "default"
        self.assertEqual(self.load().classes[1].properties[0].getter, "getFallback")

    def test_of_types_mean_nothing_else_in_generated_code(self):
        self.novel["name"] = "Value"
        self.refuse("/classes/2/name", "Value means something else in generated code")

    def test_of_types_are_not_those_of_primitive_types(self):
        self.novel["name"] = "String"
        self.refuse("/classes/2/name", "String is a primitive type")

    def test_of_properties_hide_nothing(self):
        self.title["name"] = "uuid"
        self.books["qualifiedBy"] = "uuid"
        self.refuse("/classes/1/properties/0/name", "getUuid means something else for every element")

    def test_of_properties_are_no_types_of_search_instances(self):
        self.title["name"] = "Handle"
        self.books["qualifiedBy"] = "Handle"
        self.refuse("/classes/1/properties/0/name", "Handle means something else in generated code")

    def test_of_properties_are_not_those_of_their_class(self):
        self.title["name"] = "Book"
        self.books["qualifiedBy"] = "Book"
        self.refuse("/classes/1/properties/0/name", "Book means something else in generated code")

    def test_of_operations_are_no_accessors(self):
        self.book["operations"][0]["name"] = "setTitle"
        self.refuse("/classes/1/operations/0/name", "setTitle stands for title")

    def test_of_literals_differ_in_cxx(self):
        self.data["enumerations"][0]["literals"][1]["name"] = "Open"
        self.refuse("/enumerations/0/literals/1/name",
                    "there is an enumerator Open already, at /enumerations/0/literals/0/name")


class Uuids(Folder):
    def test_are_given_once(self):
        self.title["uuid"] = self.shelf["uuid"] = "00010203-0405-0607-0809-0a0b0c0d0e0f"
        self.refuse("/classes/1/properties/2/uuid",
                    "the UUID 00010203-0405-0607-0809-0a0b0c0d0e0f belongs to "
                    "/classes/1/properties/0/uuid")

    def test_have_lower_case_digits(self):
        self.title["uuid"] = "00010203-0405-0607-0809-0A0B0C0D0E0F"
        self.assertEqual([place for place, reason in self.problems()],
                         ["/classes/1/properties/0/uuid"])


class Classes(Folder):
    def test_have_superclasses_that_exist(self):
        self.novel["superclass"] = "Text"
        self.refuse("/classes/2/superclass", "there is no class Text")

    def test_do_not_derive_from_themselves(self):
        self.book["superclass"] = "Novel"
        self.assertEqual(self.problems(), [
            ("/classes/1/superclass", "the superclasses of Book lead back to it"),
            ("/classes/2/superclass", "the superclasses of Novel lead back to it")])

    def test_leave_no_gap_between_slots(self):
        self.owner["index"] = 3
        self.refuse("/classes/1/properties/1/index", "3 leaves a gap or is taken; 2 comes next")

    def test_are_abstract_if_an_operation_is(self):
        self.book["operations"][0]["abstract"] = True
        self.refuse("/classes/1/operations/0/abstract", "Book is not abstract")


class Events(Folder):
    def setUp(self):
        super().setUp()
        self.event = {"name": "returned", "event": True,
                      "arguments": [{"name": "days", "type": "Integer"}]}
        self.book["operations"].append(self.event)

    def test_have_a_class_each(self):
        self.assertEqual([event.name for event in self.load().events], ["BookReturnedEvent"])

    def test_of_a_superclass_have_no_class_of_their_own(self):
        self.novel["operations"] = [copy.deepcopy(self.event)]

        self.assertEqual([event.name for event in self.load().events], ["BookReturnedEvent"])

    def test_have_no_result(self):
        self.event["result"] = {"type": "Integer"}
        self.refuse("/classes/1/operations/1/result", "an event has no result")

    def test_happen_to_an_element(self):
        self.event["static"] = True
        self.refuse("/classes/1/operations/1/static", "an event happens to an element")

    def test_give_nothing_back(self):
        self.event["arguments"][0]["isInput"] = False
        self.refuse("/classes/1/operations/1/arguments/0/isInput", "an event gives nothing back")

    def test_have_an_owner_and_an_operation_already(self):
        for name in ("owner", "operation"):
            self.event["arguments"][0]["name"] = name
            self.refuse("/classes/1/operations/1/arguments/0/name",
                        f"{name} means something else for every event")

    def test_are_not_overloaded(self):
        self.book["operations"].append({"name": "returned"})
        self.refuse("/classes/1/operations/1/name", "an event has a name of its own")

    def test_do_not_share_the_name_of_what_happens(self):
        self.book["operations"].append({"name": "doReturned"})
        self.refuse("/classes/1/operations/1/name", "doReturned means something else")

    def test_do_not_share_the_name_of_a_type(self):
        self.data["classes"].append({"name": "BookReturnedEvent"})
        self.refuse("/classes/1/operations/1/name", "there is a type BookReturnedEvent")

    def test_are_events_in_subclasses_too(self):
        self.novel["operations"] = [{**copy.deepcopy(self.event), "event": False}]
        self.refuse("/classes/2/operations/0/event", "returned is an event in a superclass")

    def test_are_no_other_operations_in_superclasses(self):
        self.novel["operations"] = [{"name": "lend", "event": True,
                                     "arguments": [{"name": "days", "type": "Integer"}]}]
        self.refuse("/classes/2/operations/0/event", "lend is no event in a superclass")


class Operations(Folder):
    def test_take_many_elements_only_if_nobody_calls_them_by_reflection(self):
        lend = self.book["operations"][0]
        lend["arguments"].append({"name": "readers", "type": "Novel", "upper": "*"})
        self.refuse("/classes/1/operations/0/arguments/1/upper",
                    "many elements can't be passed by reflection; say \"invoker\": false")
        lend["invoker"] = False
        self.load()

    def test_give_many_elements_only_if_nobody_calls_them_by_reflection(self):
        self.book["operations"][0]["result"] = {"type": "Novel", "upper": "*"}
        self.refuse("/classes/1/operations/0/result/upper",
                    "many elements can't be passed by reflection; say \"invoker\": false")


class Properties(Folder):
    def test_have_types_that_exist(self):
        self.title["type"] = "Text"
        self.price["type"] = "tarn.kiln.meta.Nothing"
        self.assertIn(("/classes/1/properties/0/type", "there is no type Text"), self.problems())
        self.assertIn(("/classes/1/properties/3/type",
                       "there is no type tarn.kiln.meta.Nothing"), self.problems())

    def test_have_types_that_cxx_can_carry(self):
        self.shelf |= {"type": "JsonValue"}
        self.refuse("/classes/1/properties/2/type", "there is no C++ type for values of JsonValue")

    def test_have_opposites_on_both_sides(self):
        del self.owner["opposite"]
        self.refuse("/classes/0/properties/0/opposite",
                    "one-sided: Book.library has no opposite")

    def test_have_opposites_that_name_each_other(self):
        self.owner["opposite"] = "shelves"
        self.assertEqual(self.problems(), [
            ("/classes/0/properties/0/opposite",
             "one-sided: the opposite of Book.library is shelves"),
            ("/classes/1/properties/1/opposite", "Library has no property shelves")])

    def test_have_opposites_of_their_own_class(self):
        self.owner["type"] = "Novel"
        self.assertEqual(self.problems()[0],
                         ("/classes/0/properties/0/opposite",
                          "Book.library is of type Novel, not Library"))

    def test_have_opposites_only_if_they_refer_to_elements(self):
        self.title["opposite"] = "books"
        self.refuse("/classes/1/properties/0/opposite", "String is no class, so there is none")

    def test_contain_what_has_one_container(self):
        self.owner["composite"] = True
        self.assertIn(("/classes/0/properties/0/opposite",
                       "the opposite of a composite property is one container"), self.problems())

    def test_contain_elements_only(self):
        self.title["composite"] = True
        self.refuse("/classes/1/properties/0/composite",
                    "String is no class: its values have no container")

    def test_are_qualified_by_a_property_of_their_type(self):
        self.books["qualifiedBy"] = "books"
        self.refuse("/classes/0/properties/0/qualifiedBy",
                    "Book has no property books to qualify by")

    def test_are_qualified_by_what_is_always_there(self):
        self.title["lower"] = 0
        self.refuse("/classes/0/properties/0/qualifiedBy",
                    "title is no key: it must be stored, required and single")

    def test_are_qualified_by_values_that_are_keys(self):
        self.title["type"] = "Boolean"
        self.refuse("/classes/0/properties/0/qualifiedBy",
                    "title is no key: values of Boolean are none")

    def test_are_qualified_if_they_have_many_values(self):
        self.books["upper"] = 1
        self.refuse("/classes/0/properties/0/qualifiedBy", "a property of one value has no key")

    def test_are_qualified_if_their_qualification_is_not_unique(self):
        self.owner["qualificationUnique"] = False
        self.refuse("/classes/1/properties/1/qualificationUnique",
                    "there is nothing to qualify by")

    def test_have_bounds_that_leave_room(self):
        self.title["lower"] = 2
        self.assertIn(("/classes/1/properties/0/lower", "the bounds 2..1 leave no room"),
                      self.problems())


class Defaults(Folder):
    def refuse_default(self, type_name, text, reason=None):
        with self.subTest(type=type_name, text=text):
            self.shelf |= {"type": type_name, "default": text}
            self.refuse("/classes/1/properties/2/default",
                        reason or f"{text!r} does not parse as {type_name}")

    def accept_default(self, type_name, text, expression):
        with self.subTest(type=type_name, text=text):
            self.shelf |= {"type": type_name, "default": text}
            self.assertEqual(self.load().classes[1].properties[2].initial, f" = {expression}")

    def test_parse(self):
        self.refuse_default("Integer", "x")
        self.refuse_default("Integer", "")
        self.refuse_default("Integer8", "128")
        self.refuse_default("UInteger8", "-1")
        self.refuse_default("UInteger16", "65536")
        self.refuse_default("Real", "1.5.2")
        self.refuse_default("Boolean", "True")
        self.refuse_default("UUID", "now")
        self.refuse_default("DateTime", "2026-11-21")

    def test_are_literals_of_an_enumeration(self):
        self.refuse_default("Shelf", "shut", "Shelf has no literal 'shut'")

    def test_are_for_single_plain_values(self):
        self.refuse_default("Novel", "x", "a property of type Novel has no default")
        self.refuse_default("Money", "x", "a property of type Money has no default")
        self.shelf["upper"] = "*"
        self.refuse_default("Integer", "1", "a property of many values has no default")

    def test_become_cxx(self):
        self.accept_default("Integer", "+07", "7")
        self.accept_default("UnlimitedNatural", "-1", "4294967295u")
        self.accept_default("Boolean", "1", "true")
        self.accept_default("Real", "1/5", "1.5")
        self.accept_default("Shelf", "locked", "Shelf::Locked")
        self.accept_default("String", 'a"\u0001\\', 'u"a\\"\\001\\\\"')
        self.accept_default("DateTime", "2026-11-21T08:30:00.5",
                            'boost::posix_time::from_iso_string("20261121T083000.5")')


class DataTypes(Folder):
    def test_hold_no_elements(self):
        self.data["dataTypes"][0]["properties"][0]["type"] = "Book"
        self.refuse("/dataTypes/0/properties/0/type", "a field of a data type can't be an element")

    def test_do_not_hold_themselves(self):
        self.data["dataTypes"].append(
            {"name": "Price", "properties": [{"name": "net", "type": "Money"}]})
        self.data["dataTypes"][0]["properties"].append({"name": "price", "type": "Price"})
        self.assertEqual(self.problems(), [
            ("/dataTypes/0/properties/1/type", "a Money can't hold itself"),
            ("/dataTypes/1/properties/0/type", "a Price can't hold itself")])


class Problems(Folder):
    def test_are_told_all_at_once(self):
        self.owner["index"] = 7
        self.title["type"] = "Text"
        self.shelf["default"] = "shut"
        self.assertEqual([place for place, reason in self.problems()], [
            "/classes/0/properties/0/qualifiedBy", "/classes/1/properties/1/index",
            "/classes/1/properties/0/type", "/classes/1/properties/2/default"])


class Schema(unittest.TestCase):
    """The schema is one for other tools too; they agree with the generator."""

    def setUp(self):
        try:
            import jsonschema
        except ImportError:
            self.skipTest("the Python package jsonschema is not installed")
        schema = json.loads((METAGEN / "description.schema.json").read_text(encoding="utf-8"))
        jsonschema.Draft202012Validator.check_schema(schema)
        self.validator = jsonschema.Draft202012Validator(schema)

    def test_admits_the_descriptions_of_tests_and_examples(self):
        for path in ["tests/generated/shapes.json", "examples/library/library.json",
                     "tests/metagen/golden/garden.json"]:
            self.validator.validate(json.loads((ROOT / path).read_text(encoding="utf-8")))

    def test_refuses_what_the_generator_refuses(self):
        for key, value in [("name", "a b"), ("uri", "x"), ("colour", 1), ("classes", {})]:
            self.assertFalse(self.validator.is_valid({**LIBRARY, key: value}), key)


if __name__ == "__main__":
    unittest.main()

"""That tarnkiln_add_metamodel stops with what is wrong in a description."""
import pathlib
import subprocess
import sys
import tempfile
import unittest

ROOT = pathlib.Path(__file__).resolve().parents[2]

PROJECT = f"""
cmake_minimum_required(VERSION 3.25)
project(Broken LANGUAGES NONE)
include({ROOT}/cmake/TarnkilnMetamodel.cmake)
set_property(GLOBAL PROPERTY TARNKILN_METAGEN {ROOT}/tools/metagen/metagen.py)
add_library(model INTERFACE)
tarnkiln_add_metamodel(TARGET model DESCRIPTION model.json)
"""


class CMakeFunction(unittest.TestCase):
    def configure(self, description):
        with tempfile.TemporaryDirectory() as folder:
            root = pathlib.Path(folder)
            (root / "CMakeLists.txt").write_text(PROJECT)
            (root / "model.json").write_text(description)
            return subprocess.run(
                ["cmake", "-S", root, "-B", root / "build", f"-DPython3_EXECUTABLE={sys.executable}"],
                capture_output=True, text=True)

    def test_tells_what_is_wrong_with_a_description(self):
        result = self.configure('{"name": "model", "uri": "model/1", "classes": [{"name": "class"}]}')

        self.assertNotEqual(result.returncode, 0)
        self.assertIn("The metamodel can't be generated", result.stderr)
        self.assertIn("model.json: /classes/0/name: class is a word of C++", result.stderr)

    def test_tells_the_line_of_broken_json(self):
        result = self.configure('{\n"name" "model"}')

        self.assertNotEqual(result.returncode, 0)
        self.assertIn("model.json: line 2, column 8: no JSON", result.stderr)


if __name__ == "__main__":
    unittest.main()

"""Every synthesis dialect of the table stands in each place that the cookbook lists for a new one."""

from __future__ import annotations

import re
import unittest
from pathlib import Path

PROJECT = Path(__file__).resolve().parents[2]
ROW = re.compile(r'\{HdlOptions::VerilogOption::(\w+),\s*"(\w+)",\s*(?:true|false),\s*'
                 r'(?:WriteNoAttributes|WriteAttributes<&VerilogStatements::(\w+)>)\}')


def text_of(place: str) -> str:
    return (PROJECT / place).read_text()


# The value, the name and the function of each dialect; one that writes nothing has no function.
TABLE = re.search(r"Dialects\[\] = \{\n(.*?)\n\};", text_of("s/Verilog/Dialects.h"), re.S)[1]
ROWS = ROW.findall(TABLE)
NAMES = [name for _, name, _ in ROWS]
FUNCTIONS = [function for _, _, function in ROWS if function]


class Places(unittest.TestCase):
    """One test for each place of the recipe."""

    def test_the_recipe_lists_the_places_of_these_tests(self) -> None:
        recipe = text_of("docs/cookbook.md").split("\n## Add a synthesis dialect\n")[1]
        steps = recipe.split("\n## ")[0]
        listed = [place for place in re.findall(r"`([\w./]+)`", steps) if "/" in place]
        self.assertEqual(listed, [
            "include/Orn_Hdl/Options.h", "include/Orn_Hdl/Writers/Verilog.h",
            "s/Verilog/VerilogStatements.cpp", "s/Verilog/Dialects.h", "tests/golden",
            "tests/reference/orn_reference/options.py", "tests/reference/orn_reference/verilog.py",
            "tests/reference/generate.py", "fuzz/Scripts.cpp", "docs/formats.md"])

    def test_rows(self) -> None:
        self.assertEqual(TABLE.count("HdlOptions::VerilogOption::"), len(ROWS))
        self.assertGreaterEqual(len(ROWS), 6)
        self.assertEqual(len(set(NAMES)), len(NAMES))

    def test_values(self) -> None:
        values = re.search(r"enum SynthesisType \{(.*?)\}", text_of("include/Orn_Hdl/Options.h"), re.S)
        self.assertEqual(re.findall(r"(\w+) = (\d+)", values[1]),
                         [(value, str(number)) for number, (value, _, _) in enumerate(ROWS)])

    def test_functions(self) -> None:
        for place in "include/Orn_Hdl/Writers/Verilog.h", "s/Verilog/VerilogStatements.cpp":
            named = re.findall(r"void (?:VerilogStatements::)?(Write\w+Attr)\(", text_of(place))
            with self.subTest(place):
                self.assertEqual(sorted(named), sorted(FUNCTIONS))

    def test_golden_files(self) -> None:
        golden = PROJECT / "tests" / "golden"
        self.assertEqual(sorted(path.name for path in golden.glob("synthesis_attributes.*.v")),
                         sorted(f"synthesis_attributes.{name}.v" for name in NAMES[1:]))

    def test_independent_model(self) -> None:
        model = text_of("tests/reference/orn_reference/options.py")
        types = re.search(r"SYNTHESIS_TYPES = \((.*?)\)", model, re.S)[1]
        self.assertEqual(re.findall(r'b"(\w+)"', types), NAMES)

    def test_random_scripts(self) -> None:
        generated = re.search(r"SYNTHESIS = \[(.*?)\]", text_of("tests/reference/generate.py"), re.S)
        self.assertLessEqual(set(NAMES), set(re.findall(r"\w+", generated[1].upper())))
        fuzzed = re.search(r"Tools\[\] = \{(.*?)\}", text_of("fuzz/Scripts.cpp"), re.S)
        self.assertLessEqual(set(NAMES), set(re.findall(r'"(\w+)"', fuzzed[1])))

    def test_documented_output(self) -> None:
        page = text_of("docs/formats.md")
        self.assertEqual(re.search(r"for tool in (.*?); do", page)[1].split(), NAMES)
        self.assertEqual([name for name in re.findall(r"^(\w+):$", page, re.M) if name in NAMES], NAMES)

    def test_generated_help(self) -> None:
        listed = f"{', '.join(NAMES[:-1])} or {NAMES[-1]}."
        for place in "docs/commands.md", "README.md", "share/man/man5/orn-hdl.5":
            with self.subTest(place):
                self.assertIn(f"synthesis attributes in Verilog: {listed}", text_of(place))


if __name__ == "__main__":
    unittest.main()

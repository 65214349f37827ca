"""orn-hdl draw: what the picture shows, read back from the SVG that Graphviz makes."""

from __future__ import annotations

import shutil
import unittest
from xml.etree import ElementTree

from support import EXAMPLES, FAILED, FILE, INVERTER, SUCCESS, USAGE, ToolTest, lone_add

SVG = "{http://www.w3.org/2000/svg}"


@unittest.skipIf(shutil.which("dot") is None, "Graphviz is not installed")
class Draw(ToolTest):
    def draw(self, commands: str, *options: str) -> ElementTree.Element:
        self.write("d.cmd", commands)
        self.expect(self.run_tool("draw", "d.cmd", "-o", "o.svg", *options), SUCCESS)
        return ElementTree.parse(self.folder / "o.svg").getroot()

    def texts(self, picture: ElementTree.Element) -> list[str]:
        return [text.text or "" for text in picture.iter(f"{SVG}text")]

    def count(self, picture: ElementTree.Element, kind: str) -> int:
        return sum(group.get("class") == kind for group in picture.iter(f"{SVG}g"))

    def chain(self, length: int) -> str:
        """Inverters in a row, U0 at the port A."""
        lines = ["ADD COMPONENT INV", "ADD PIN INV I input", "ADD PIN INV O output",
                 "ADD PORT A input"]
        net = "A"
        for i in range(length):
            lines += [f"ADD INSTANCE INV U{i}", f"CONNECT SIGNAL {net} U{i}.I",
                      f"CONNECT SIGNAL n{i} U{i}.O"]
            net = f"n{i}"
        return "\n".join(lines)

    def test_one_gate(self) -> None:
        picture = self.draw(INVERTER)
        self.assertEqual(sorted(self.texts(picture)), ["A", "I", "INV", "O", "U1", "Y"])
        self.assertEqual(self.count(picture, "node"), 3)
        self.assertEqual(self.count(picture, "edge"), 2)

    def test_buses_are_thick(self) -> None:
        picture = self.draw("ADD COMPONENT C\nADD PIN C I(3:0) input\nADD PIN C J input\n"
                            "ADD PORT A(3:0) input\nADD PORT B input\nADD INSTANCE C U\n"
                            "CONNECT SIGNAL A(3:0) U.I(3:0)\nCONNECT SIGNAL B U.J\n")
        widths = [path.get("stroke-width") for group in picture.iter(f"{SVG}g")
                  if group.get("class") == "edge" for path in group.iter(f"{SVG}path")]
        self.assertEqual(sorted(map(str, widths)), ["3", "None"])

    def test_parts_of_buses_are_named(self) -> None:
        picture = self.draw("ADD COMPONENT C\nADD PIN C I(3:0) input\nADD PORT A(7:0) input\n"
                            "ADD PORT B input\nADD INSTANCE C U\n"
                            "CONNECT SIGNAL B,A(6:5),A(0) U.I(3:0)\n")
        self.assertIn("A(6:5)", self.texts(picture))
        self.assertIn("A(0)", self.texts(picture))
        self.assertEqual(self.count(picture, "edge"), 3)

    def test_aliases_and_constants(self) -> None:
        picture = self.draw(INVERTER + "ADD PORT Z output\nCONNECT SIGNAL Z Y\n"
                            "ADD PORT K(3:0) output\nASSIGN CONSTANT K(3:0) 4:B:1010\n")
        self.assertIn("4'b1010", self.texts(picture))
        self.assertIn("Z", self.texts(picture))

    def test_nets_with_many_ends_are_named_at_the_pins(self) -> None:
        lines = ["ADD COMPONENT INV", "ADD PIN INV I input", "ADD PORT A input"]
        for i in range(40):
            lines += [f"ADD INSTANCE INV U{i}", f"CONNECT SIGNAL A U{i}.I"]
        picture = self.draw("\n".join(lines))
        self.assertEqual(self.texts(picture).count("I = A"), 40)
        self.assertEqual(self.count(picture, "edge"), 0)

    def test_special_characters(self) -> None:
        name = '{<a>|"b"\\ &'
        self.draw(f"ADD COMPONENT '{name}'\nADD PIN '{name}' '{name}' output\n"
                  f"ADD INSTANCE '{name}' 'x{name}'\nADD PORT 'y{name}' output\n"
                  f"ADD SIGNAL \xff\x01\x80\n")

    def test_write_lines_write_nothing(self) -> None:
        self.draw(INVERTER + "WRITE VERILOG o.v\nwrite vhdl -NOHEADER o.vhd\n")
        self.assertEqual(sorted(p.name for p in self.folder.iterdir()), ["d.cmd", "o.svg"])

    def test_around_an_instance(self) -> None:
        texts = self.texts(self.draw(self.chain(9), "--around", "u4"))
        self.assertEqual([t for t in texts if t.startswith("U")], ["U3", "U4", "U5"])
        self.assertIn("n5 ...", texts)
        self.assertIn("n2 ...", texts)

    def test_depth(self) -> None:
        for depth, count in ((0, 1), (2, 5), (20, 9)):
            texts = self.texts(self.draw(self.chain(9), "--around", "U4", "--depth", str(depth)))
            self.assertEqual(len([t for t in texts if t.startswith("U")]), count)

    def test_around_a_signal(self) -> None:
        texts = self.texts(self.draw(self.chain(9), "--around", "n4", "--depth", "0"))
        self.assertEqual([t for t in texts if t.startswith("U")], ["U4", "U5"])
        texts = self.texts(self.draw(self.chain(9), "--around", "A", "--depth", "0"))
        self.assertEqual([t for t in texts if t.startswith("U")], ["U0"])

    def test_around_nothing(self) -> None:
        self.write("d.cmd", INVERTER)
        self.expect(self.run_tool("draw", "d.cmd", "-o", "o.svg", "--around", "U9"), USAGE,
                    "orn-hdl: there is no instance and no signal U9\n")

    def test_many_instances(self) -> None:
        for count in (200, 1600):
            self.assertEqual(self.count(self.draw(self.chain(count)), "node"), count + 1)

    def test_many_pins_and_long_names(self) -> None:
        # Graphviz reads no more than 16384 characters of a text at once.
        name = "n" * 20000
        pins = "".join(f"ADD PIN C p{i} input\n" for i in range(2000))
        picture = self.draw(f"ADD COMPONENT C\n{pins}ADD INSTANCE C {name}\nADD PORT {name}p input\n"
                            f"CONNECT SIGNAL {name}p {name}.p1999\n")
        texts = self.texts(picture)
        self.assertEqual({name, f"{name}p", "C", *(f"p{i}" for i in range(2000))}, set(texts))

    def test_too_many_instances(self) -> None:
        self.write("d.cmd", self.chain(5001))
        self.expect(self.run_tool("draw", "d.cmd", "-o", "o.svg"), USAGE,
                    "orn-hdl: 5001 instances are too many for a picture, 5000 the most; "
                    "choose a smaller part with --around and --depth\n")
        self.assertEqual(len(self.texts(self.draw(self.chain(5001), "--around", "U5"))), 4 * 3 + 2)

    def test_empty_design(self) -> None:
        self.assertEqual(self.texts(self.draw("")), [])

    def test_failed_command(self) -> None:
        self.write("d.cmd", INVERTER + "ADD\n")
        self.expect(self.run_tool("draw", "d.cmd", "-o", "o.svg"), FAILED,
                    "d.cmd:9: error: Command not find.\n" + lone_add(9))
        self.assertFalse((self.folder / "o.svg").exists())

    def test_unreadable_and_unwritable(self) -> None:
        self.expect(self.run_tool("draw", "none", "-o", "o.svg"), FILE,
                    "orn-hdl: cannot read none: No such file or directory\n")
        self.write("d.cmd", INVERTER)
        self.expect(self.run_tool("draw", "d.cmd", "-o", "no/o.svg"), FILE,
                    "orn-hdl: cannot write no/o.svg: No such file or directory\n")
        self.expect(self.run_tool("draw", "d.cmd", "-o", "/dev/full"), FILE,
                    "orn-hdl: cannot write /dev/full: No space left on device\n")

    def test_the_picture_is_replaced_as_a_whole(self) -> None:
        self.write("d.cmd", INVERTER)
        self.write("o.svg", "before")
        with open(self.folder / "o.svg", encoding="latin-1") as former:
            self.expect(self.run_tool("draw", "d.cmd", "-o", "o.svg"), SUCCESS)
            self.assertEqual(former.read(), "before")
        self.assertIn("</svg>", self.read("o.svg"))
        self.write("o.svg", "before")
        self.expect(self.run_tool("draw", "d.cmd", "-o", "o.svg", PATH="/nowhere"), FILE,
                    "orn-hdl: cannot run dot: No such file or directory; install Graphviz\n")
        self.assertEqual(self.read("o.svg"), "before")

    def test_without_graphviz(self) -> None:
        self.write("d.cmd", INVERTER)
        self.expect(self.run_tool("draw", "d.cmd", "-o", "o.svg", PATH="/nowhere"), FILE,
                    "orn-hdl: cannot run dot: No such file or directory; install Graphviz\n")

    def test_the_picture_that_is_kept(self) -> None:
        """Where Graphviz puts things depends on its version and fonts; what is there does not."""
        def contents(picture: ElementTree.Element) -> list[tuple[str, list[str], str | None]]:
            return [(group.find(f"{SVG}title").text, self.texts(group),
                     next((shape.get("stroke-width") for shape in group
                           if shape.get("stroke-width")), None))
                    for group in picture.iter(f"{SVG}g")]

        folder = EXAMPLES / "accu4"
        drawn = self.draw((folder / "accu4.cmd").read_text("ascii"))
        kept = ElementTree.parse(folder / "accu4.svg").getroot()
        self.assertEqual(contents(drawn), contents(kept))

    def test_usage(self) -> None:
        self.assertEqual(self.run_tool("draw", "d.cmd").status, USAGE)
        self.assertEqual(self.run_tool("draw", "d.cmd", "-o", "o.svg", "--depth", "2").status,
                         USAGE)
        self.assertEqual(self.run_tool("draw", "d.cmd", "-o", "o.svg", "--around", "U",
                                       "--depth", "-1").status, USAGE)

    def test_examples(self) -> None:
        for name in ("and2", "accu4", "counter8", "cpu8"):
            self.expect(self.run_tool("draw", EXAMPLES / name / f"{name}.cmd", "-o", "o.svg"),
                        SUCCESS)
            ElementTree.parse(self.folder / "o.svg")


if __name__ == "__main__":
    unittest.main()

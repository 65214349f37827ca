"""orn-hdl import: netlists in Verilog."""

from __future__ import annotations

import unittest

from support import FAILED, FILE, SUCCESS, USAGE, ToolTest

DESIGN = """\
module top(input [1:0] a, input \\end , output y, output [1:0] q);
  wire n;
  INV u1(.I(a[0]), .O(n));
  AND2 #(.DELAY(3)) u2(.A(n), .B(\\end ), .Y(y));
  AND2 u3(.A(a[1]), .B(n), .Y(q[1]));
  assign q[0] = 1'b1;
endmodule
"""

LIBERTY = """\
library (cells) {
  type (two) { base_type : array; data_type : bit; bit_width : 2; bit_from : 1; bit_to : 0; }
  cell (PAIR) {
    pg_pin (VDD) { pg_type : primary_power; }
    bus (D) { bus_type : two; direction : input; }
    pin (P) { direction : inout; }
  }
}
"""

PAIR = "module top(input [1:0] a, inout p);\n  PAIR u(.D(a), .P(p));\nendmodule\n"


def statements(text: str) -> list[str]:
    """The statements of a netlist, each in one line."""
    return [" ".join(statement.split()) for statement in text.split(";")]


class Verilog(ToolTest):
    def imported(self, text: str, *options: str, err: str = "") -> list[str]:
        """The statements of what becomes of a netlist."""
        self.write("d.v", text)
        self.expect(self.run_tool("import", "d.v", "--verilog", "out.v", "--no-header", *options),
                    SUCCESS, err)
        return statements(self.read("out.v"))

    def test_design_and_directions(self) -> None:
        written = self.imported(DESIGN, err='d.v: warning: "end" cannot be kept as a name in '
                                            "Verilog; the port is renamed to end_2\n")
        for statement in ("INV u1 (.I(a[0]), .O(n))", "AND2 u2 (.A(n), .B(end_2), .Y(y))",
                          "defparam u2.DELAY = 3", "AND2 u3 (.A(a[1]), .B(n), .Y(q[1]))",
                          "assign q[0] = 1"):
            self.assertIn(statement, written)

    def test_both_languages(self) -> None:
        self.write("d.v", DESIGN)
        done = self.run_tool("import", "d.v", "--vhdl", "out.vhd")
        self.expect(done, SUCCESS,
                    'd.v: warning: "end" is not a legal name in VHDL; the port is renamed to end_2\n'
                    'd.v: warning: instances of "AND2" leave out parameters whose defaults are '
                    "unknown; in VHDL they are 0 or empty: DELAY\n2 warnings\n")
        text = " ".join(self.read("out.vhd").split())
        self.assertIn("generic( DELAY : integer := 0); port ( A : in std_logic; B : in std_logic; "
                      "Y : out std_logic);", text)
        self.assertIn("u3 : AND2 port map (A=>a(1), B=>n, Y=>q(1));", text)

    def test_command_file(self) -> None:
        self.write("d.v", DESIGN)
        done = self.run_tool("import", "d.v", "-o", "d.cmd", "--verilog", "d1.v", "--vhdl", "d1.vhd")
        self.assertEqual(done.status, SUCCESS, done.err)
        self.expect(self.run_tool("run", "d.cmd", "--verilog", "d2.v", "--vhdl", "d2.vhd"), SUCCESS)
        for extension in ("v", "vhd"):
            first, second = (self.read(f"d{number}.{extension}") for number in (1, 2))
            self.assertEqual(first, second.replace("d2.", "d1."))
        # Commands that no command file can say are refused.
        self.write("e.v", DESIGN.replace("u2(", "\\u.2 ("))
        self.run_tool("import", "e.v", "-o", "e.cmd")
        self.expect(self.run_tool("run", "e.cmd", "--verilog", "e1.v"), SUCCESS)

    def test_other_extension(self) -> None:
        self.write("d.txt", DESIGN)
        self.expect(self.run_tool("import", "d.txt", "--from", "verilog", "--names", "verilog"),
                    SUCCESS,
                    'd.txt: warning: "end" cannot be kept as a name in Verilog; the port is '
                    "renamed to end_2\n")

    def test_files_that_are_no_netlists(self) -> None:
        for text, what in (("ADD PORT A input\n", "a command file; use orn-hdl run"),
                           ("\x1f\x8b", "a gzip file; unpack it, or let its name end in .gz")):
            self.write("d.v", text)
            done = self.run_tool("import", "d.v")
            self.assertEqual(done.status, FAILED)
            self.assertIn(f"note: this looks like {what}\n", done.err)

    def test_top(self) -> None:
        text = DESIGN + DESIGN.replace("module top", "module other")
        self.write("d.v", text)
        self.expect(self.run_tool("import", "d.v"), FAILED,
                    'd.v: error: no module instantiates "top", "other": say which one to read\n')
        self.assertIn("module other(a, end_2, q, y)",
                      self.imported(text, "--top", "other", "--names", "both", err=(
                          'd.v: warning: "end" is not a legal name in Verilog and VHDL; the port '
                          "is renamed to end_2\n"
                          'd.v: warning: instances of "AND2" leave out parameters whose defaults '
                          "are unknown; in VHDL they are 0 or empty: DELAY\n2 warnings\n"))[0])

    def test_errors_show_their_place(self) -> None:
        self.write("d.v", "module m(input a);\n  wire b;\n\talways @(a) b = a;\nendmodule\n")
        self.expect(self.run_tool("import", "d.v", "--verilog", "out.v"), FAILED,
                    'd.v:3: error: "always" describes behaviour: synthesise the design first\n'
                    "    3 |  always @(a) b = a;\n"
                    "      |  ^~~~~~\n")
        self.assertFalse((self.folder / "out.v").exists())

    def test_errors_as_json(self) -> None:
        self.write("d.v", "module m(input a);\n  always @(a) ;\nendmodule\n")
        done = self.run_tool("import", "d.v", "--diagnostics", "json")
        self.assertEqual(done.status, FAILED)
        self.assertIn('"line":2', done.err)

    def test_cells_without_directions_are_listed(self) -> None:
        self.write("d.v", "module m(inout p);\n  PAD u(.P(p));\nendmodule\n")
        self.expect(self.run_tool("import", "d.v"), FAILED,
                    "d.v:2: error: modules that are not declared, with ports whose direction does "
                    'not follow from the design: "PAD" (P): a library file has to declare them\n'
                    "    2 |   PAD u(.P(p));\n"
                    "      |   ^~~\n"
                    "note: -l FILE names a file that declares cells: Verilog, VHDL, Liberty or "
                    "JSON\n")

    def test_name_map(self) -> None:
        self.write("d.v", "module top(input \\a.b , output a_b);\n"
                          "  \\C.x \\u.1 (.\\p.q (\\a.b ), .p_q(a_b));\nendmodule\n")
        self.run_tool("import", "d.v", "--name-map", "names")
        self.assertEqual(self.read("names").splitlines(), [
            "module\ttop\ttop", "component\tC.x\tC_x", "pin\tC.x.p.q\tC_x.p_q_2",
            "pin\tC.x.p_q\tC_x.p_q", "port\ta.b\ta_b", "port\ta_b\ta_b_2", "cell\tu.1\tu_1"])

    def test_keep_ports(self) -> None:
        self.write("d.v", DESIGN)
        self.expect(self.run_tool("import", "d.v", "--vhdl", "out.vhd", "--keep-ports"), FAILED,
                    'd.v: error: "end" is not a legal name in VHDL, and --keep-ports forbids '
                    "renaming the port\n")
        self.assertFalse((self.folder / "out.vhd").exists())

    def test_reserved_words_of_the_other_language(self) -> None:
        text = "module m(input in, output y);\n  BUF signal(.I(in), .O(y));\nendmodule\n"
        self.assertIn("BUF signal (.I(in), .O(y))", self.imported(text))
        self.assertIn("BUF signal_2 (.I(in_2), .O(y))", self.imported(
            text, "--names", "both",
            err='d.v: warning: "in" is not a legal name in Verilog and VHDL; the port is renamed '
                "to in_2\n"))

    def test_attributes_and_comments(self) -> None:
        text = ("module m(input a);\n  // the one\n  (* keep = \"yes\" *) BUF u(.I(a));\n"
                "endmodule\n")
        plain = "\n".join(self.imported(text))
        self.assertNotIn("keep", plain)
        self.assertNotIn("the one", plain)
        full = "\n".join(self.imported(text, "--attributes", "--comments"))
        self.assertIn("keep", full)
        self.assertIn("the one", full)

    def test_macros_and_included_files(self) -> None:
        (self.folder / "inc").mkdir()
        self.write("inc/cells.vh", "module BUF(input I); endmodule\n")
        text = ("`include \"cells.vh\"\nmodule m(input a);\n`ifdef TWO\n  BUF u(.I(`NET));\n"
                "`endif\nendmodule\n")
        self.assertIn("BUF u (.I(a))", self.imported(text, "-I", "inc", "-D", "NET=a", "-DTWO"))

    def test_legal(self) -> None:
        text = "module m(input a);\n  BUF \\a__b (.I(a));\nendmodule\n"
        self.assertIn("BUF a__b (.I(a))", self.imported(text))
        self.imported(text, "--legal", "--vhdl", "out.vhd", "--name-map", "names")
        self.assertIn("cell\ta__b\ta_b\n", self.read("names"))


class Libraries(ToolTest):
    def test_liberty(self) -> None:
        self.write("cells.lib", LIBERTY)
        self.write("d.v", PAIR)
        for option in ("-l", "--library", "--cells"):
            self.expect(self.run_tool("import", "d.v", option, "cells.lib", "--vhdl", "out.vhd"),
                        SUCCESS)
            self.assertIn("component PAIR port ( D : in std_logic_vector (1 downto 0); P : inout "
                          "std_logic);", " ".join(self.read("out.vhd").split()))

    def test_verilog(self) -> None:
        self.write("cells.v", "module PAIR #(parameter W = 2)(input [W-1:0] D, inout P);\n"
                              "  assign P = D[0] & D[1];\nendmodule\n")
        self.write("d.v", PAIR.replace("(.D(a), .P(p))", "(a, p)"))
        self.expect(self.run_tool("import", "d.v", "-l", "cells.v", "--verilog", "out.v"), SUCCESS)
        self.assertIn("PAIR u (.D(a[1:0]), .P(p))", statements(self.read("out.v")))

    def test_json(self) -> None:
        self.write("cells.json", """{"modules": {"PAIR": {"attributes": {"blackbox": "1"},
            "ports": {"D": {"direction": "input", "bits": [2, 3]},
                      "P": {"direction": "inout", "bits": [4]}}}}}""")
        self.write("d.v", PAIR)
        self.expect(self.run_tool("import", "d.v", "-l", "cells.json"), SUCCESS)

    def test_files_that_cannot_be_read(self) -> None:
        self.write("d.v", PAIR)
        for library in ("none.lib", "none.v", "none.json"):
            self.expect(self.run_tool("import", "d.v", "-l", library), FILE,
                        f"orn-hdl: cannot read {library}: No such file or directory\n")
        self.write("cells.lib", "library (x) {\n  cell (A) { pin (B { } }\n")
        done = self.run_tool("import", "d.v", "-l", "cells.lib")
        self.assertEqual(done.status, FAILED)
        self.assertTrue(done.err.startswith("cells.lib:2: error: "), done.err)
        self.write("cells.v", "module A(input B;\n")
        done = self.run_tool("import", "d.v", "-l", "cells.v")
        self.assertEqual(done.status, FAILED)
        self.assertTrue(done.err.startswith("cells.v:1: error: "), done.err)


class Trouble(ToolTest):
    def test_options_of_the_other_kind(self) -> None:
        self.write("d.v", DESIGN)
        self.expect(self.run_tool("import", "d.v", "--x-as", "0"), USAGE,
                    "orn-hdl: --x-as 0 applies to JSON netlists alone; see --help\n")
        self.write("d.json", "{}")
        for option in (["--comments"], ["-I", "."], ["-D", "A"]):
            self.expect(self.run_tool("import", "d.json", *option), USAGE,
                        f"orn-hdl: {option[0]} does not apply to a JSON netlist; see --help\n")
        self.expect(self.run_tool("import", "d.v", "--from", "edif"), USAGE,
                    'orn-hdl: --from: "edif" is none of verilog, vhdl and json; see --help\n')

    def test_files_that_cannot_be_read(self) -> None:
        self.expect(self.run_tool("import", "none.v"), FILE,
                    "orn-hdl: cannot read none.v: No such file or directory\n")
        self.expect(self.run_tool("import", "-", "--from", "verilog", stdin=DESIGN), FILE,
                    "orn-hdl: cannot read -: a netlist is read twice, which needs a file\n")
        (self.folder / "folder.v").mkdir()
        done = self.run_tool("import", "folder.v")
        self.assertEqual(done.status, FILE)

    def test_files_that_cannot_be_written(self) -> None:
        self.write("d.v", DESIGN)
        for option in ("--verilog", "--name-map"):
            done = self.run_tool("import", "d.v", option, "none/out")
            self.assertEqual(done.status, FILE)
            self.assertIn("orn-hdl: cannot write none/out: No such file or directory\n", done.err)


if __name__ == "__main__":
    unittest.main()

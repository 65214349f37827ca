"""orn-hdl run: warnings of lines that are certain to be slips."""

from __future__ import annotations

import json
import re
import unittest

from support import FAILED, INVERTER, SUCCESS, USAGE, ToolTest

# What the slips work on.
DESIGN = """\
ADD COMPONENT CELL
ADD PIN CELL I input
ADD PIN CELL B(2) input
ADD PIN CELL D(3:0) input
ADD INSTANCE CELL u1
ADD PORT P(7:0) input
ADD SIGNAL BUS(7:0)
ADD SIGNAL A
ADD SIGNAL ATTRIBUTE A K v
ADD MODULE ATTRIBUTE K v
ADD INSTANCE ATTRIBUTE u1 K v
"""

# Of each warning: lines that are warned of, with a part of the message, and lines beside them that are not.
CASES: dict[str, tuple[list[tuple[str, str]], list[str]]] = {
    "constant-digit": (
        [("ASSIGN CONSTANT BUS(7:0) 8:B:00000002", '"2" is no binary digit'),
         ("ASSIGN CONSTANT u1.D(3:0) 4:B:00a0", '"a" is no binary digit'),
         ("ASSIGN CONSTANT BUS(7:0) 6:O:78", '"8" is no octal digit'),
         ("ASSIGN CONSTANT BUS(7:0) 8:h:FG", '"G" is no hexadecimal digit'),
         ("ASSIGN CONSTANT BUS(7:0) 8:D:10", '"D" is no base'),
         ("ASSIGN CONSTANT BUS(7:0) 8:HEX:10", '"HEX" is no base'),
         ("ASSIGN CONSTANT BUS(7:0) FF", '"F" is no decimal digit'),
         ("ASSIGN CONSTANT BUS(7:0) 8:FF", '":" is no decimal digit'),
         ("ASSIGN CONSTANT A true", '"t" is no decimal digit'),
         ("ASSIGN CONSTANT BUS(7:0) 8'hXG", '"\'" is no decimal digit')],
        ["ASSIGN CONSTANT BUS(7:0) 8:B:0000_01xZ", "ASSIGN CONSTANT BUS(7:0) 9:o:701",
         "ASSIGN CONSTANT BUS(7:0) 8:H:fF", "ASSIGN CONSTANT BUS(7:0) 8:B:UWLH-01X",
         "ASSIGN CONSTANT BUS(7:0) 255", "ASSIGN CONSTANT BUS(7:0) 8'hFf",
         "ASSIGN CONSTANT BUS(7:0) -3"]),
    "scalar-constant": (
        [("ASSIGN CONSTANT A 2", '"A" has one bit and is tied to "2"'),
         ("ASSIGN CONSTANT A 10", 'tied to "10"'),
         ("ASSIGN CONSTANT A 4:B:1010", 'tied to "4:B:1010"'),
         ("ASSIGN CONSTANT A 1:H:F", 'tied to "1:H:F"'),
         ("ASSIGN CONSTANT A 2'b10", "tied to"),
         ("ASSIGN CONSTANT fresh 7", '"fresh" has one bit'),
         ("ASSIGN CONSTANT BUS(3) 2", '"BUS(3)" has one bit'),
         ("ASSIGN CONSTANT u1.I 3", '"u1.I" has one bit'),
         ("ASSIGN CONSTANT u1.B(2) 3", '"u1.B(2)" has one bit')],
        ["ASSIGN CONSTANT A 0", "ASSIGN CONSTANT A 1", "ASSIGN CONSTANT A 1:B:1",
         "ASSIGN CONSTANT A 4:B:0001", "ASSIGN CONSTANT A x", "ASSIGN CONSTANT A 1'b1",
         "ASSIGN CONSTANT A 1:H:1", "ASSIGN CONSTANT u1.I 0", "ASSIGN CONSTANT u1.D(3:0) 10",
         "ASSIGN CONSTANT BUS(7:0) 200", "ASSIGN CONSTANT A,BUS(1:0) 7"]),
    "bracket-net": (
        [("CONNECT SIGNAL A BUS[3]", '"BUS[3]" becomes a net of the name "BUS(3)"'),
         ("CONNECT SIGNAL BUS<3> u1.I", '"BUS<3>" becomes a net'),
         ("CONNECT SIGNAL {A,BUS(3)} u1.D(3:0)", 'of the name "(A,BUS(3))"'),
         ("CONNECT SIGNAL A,BUS[3] u1.D(3:0)", 'of the name "A,BUS(3)"'),
         ("ASSIGN CONSTANT NEW[0] 1", 'of the name "NEW(0)"'),
         ("CONNECT SIGNAL A(3 u1.I", 'of the name "A(3"'),
         ("ADD SIGNAL E(3)", '"E(3)" becomes a net'),
         ("ADD PORT F[3] input", '"F[3]" becomes a net')],
        ["CONNECT SIGNAL A BUS(3)", "CONNECT SIGNAL BUS[7:0] u1.D(3:0)",
         "CONNECT SIGNAL NEW[3:0] u1.D(3:0)", "CONNECT SIGNAL NEW<3-0> u1.D[3-0]",
         "CONNECT SIGNAL A,BUS(3) u1.D(3:0)", "ASSIGN CONSTANT u1.B(2) 1", "CONNECT SIGNAL n-1 u1.I",
         "CONNECT SIGNAL P[7:0] BUS<7:0>"]),
    "port-range": (
        [("CONNECT SIGNAL P(15:0) BUS(7:0)", '"P(15:0)" widens the port "P(7:0)"'),
         ("CONNECT SIGNAL BUS(7:0) p(8:1)", '"P(8:1)" moves the range of the port "P(7:0)"'),
         ("CONNECT SIGNAL A,P(8:0),B u1.D(3:0)", '"P(8:0)" widens'),
         ("ASSIGN CONSTANT P(0:7) 1", '"P(0:7)" moves')],
        ["CONNECT SIGNAL P(3:0) BUS(7:0)", "CONNECT SIGNAL P(7:0) BUS(7:0)",
         "CONNECT SIGNAL P(0:3) BUS(7:0)", "CONNECT SIGNAL BUS(15:0) P(7:0)", "CONNECT SIGNAL P(9) A",
         "CONNECT SIGNAL NEW(7:0),NEW(3:0) u1.D(3:0)"]),
    "scalar-beside-bus": (
        [("CONNECT SIGNAL BUS u1.D(3:0)", '"BUS" becomes a net of its own beside the bus "BUS(7:0)"'),
         ("CONNECT SIGNAL A p", '"p" becomes a net of its own beside the bus "P(7:0)"'),
         ("ADD SIGNAL bus", '"bus" becomes a net of its own'),
         ("ASSIGN CONSTANT BUS 1", '"BUS" becomes a net of its own'),
         ("ADD SIGNAL A(3:0)", '"A(3:0)" becomes a bus beside the scalar "A"'),
         ("CONNECT SIGNAL a(3:0) u1.D(3:0)", "becomes a bus beside")],
        ["CONNECT SIGNAL BUS(7:0) u1.D(3:0)", "ADD SIGNAL BUSES", "ADD SIGNAL BUS1",
         "ADD SIGNAL AB(3:0)", "CONNECT SIGNAL A u1.I"]),
    "synthesis-tool": (
        [("SET SYNTHESIS SYNPLIFY", '"SYNPLIFY" is no synthesis tool'),
         ("SET SYNTHESIS QS", "chooses QSN")],
        ["SET SYNTHESIS qsn", "SET SYNTHESIS Synplicity", "SET SYNTHESIS VERILOG2001"]),
    "flag-word": (
        [("SUPPRESS CONFIGURATION off", '"off" is read as true'),
         ("SUPPRESS COMPONENT 0", '"0" is read as true'),
         ("USE DEFAULT LIBRARY no", '"no" is read as true'),
         ("SET OPEN PIN fals", '"fals" is read as true')],
        ["SUPPRESS CONFIGURATION", "SUPPRESS CONFIGURATION FALSE", "SUPPRESS COMPONENT true",
         "USE DEFAULT LIBRARY False", "SET OPEN PIN"]),
    "attribute-option": (
        [("ADD SIGNAL ATTRIBUTE A L -TYPE=Boolean", '"-TYPE=Boolean" becomes the value'),
         ("ADD INSTANCE ATTRIBUTE u1 -SYNATTR=ASSIGN L", '"-SYNATTR=ASSIGN" becomes the name'),
         ("ADD MODULE ATTRIBUTE L -generic=SYN", '"-generic=SYN" becomes the value'),
         ("ADD COMPONENT ATTRIBUTE CELL -TYPE=Bit L -SYNATTR=NONE", "becomes the value"),
         ("SET SIGNAL ATTRIBUTE VALUE A K -SYNATTR=ASSIGN", '"-SYNATTR=ASSIGN" becomes the value')],
        ["ADD SIGNAL ATTRIBUTE A -TYPE=Boolean L true", "ADD MODULE ATTRIBUTE -TYPE=Bit L 1",
         "ADD INSTANCE ATTRIBUTE u1 L -5", "SET SIGNAL ATTRIBUTE OPTION A K -SYNATTR=ASSIGN",
         "SET INSTANCE ATTRIBUTE OPTION u1 K -GENERIC=SYN -SYNATTR=NONE",
         "ADD SIGNAL COMMENT A K -TYPE=Boolean"]),
    "no-effect": (
        [("FLATTEN BUS", "changes nothing"), ("SET SOURCE FILE a.v", "changes nothing"),
         ("set port oneperline", "changes nothing"),
         ("ADD COMPONENT PIN COMMENT CELL.I text", "changes nothing"),
         ("ADD INSTANCE PIN ATTRIBUTE u1.I L v", "changes nothing"),
         ("SET MODULE ATTRIBUTE OPTION K -SYNATTR=ASSIGN", "changes nothing"),
         ("SET SIGNAL ATTRIBUTE OPTION A K -GENERIC=SYN", "changes nothing")],
        ["SET OPEN PIN true", "ADD COMPONENT COMMENT CELL PIN",
         "SET MODULE ATTRIBUTE OPTION K -GENERIC=SYN",
         "SET MODULE ATTRIBUTE OPTION K -SYNATTR=ASSIGN -GENERIC=SYN",
         "SET SIGNAL ATTRIBUTE OPTION A K -SYNATTR=ASSIGN", "NOOP FLATTEN BUS", "USE ATTRTYPE"]),
}
LINE = DESIGN.count("\n") + 1


class Warnings(ToolTest):
    def warn(self, commands: str, *options: str) -> list[dict]:
        """The warnings of a run that succeeds."""
        self.write("d.cmd", commands)
        outcome = self.run_tool("run", "d.cmd", "--diagnostics", "json", *options)
        self.assertEqual(outcome.status, SUCCESS, outcome.err)
        return json.loads(outcome.err)["diagnostics"]

    def test_the_design_has_none(self) -> None:
        self.assertEqual(self.warn(DESIGN), [])

    def test_every_warning_has_cases(self) -> None:
        listed = self.run_tool("warnings").out.splitlines()
        self.assertEqual([line.split()[0] for line in listed], list(CASES))

    def test_slips(self) -> None:
        for name, (slips, _) in CASES.items():
            for line, message in slips:
                with self.subTest(name, line=line):
                    found = self.warn(DESIGN + line + "\n")
                    self.assertEqual([(each["severity"], each["rule"], each["line"])
                                      for each in found], [("warning", name, LINE)])
                    self.assertIn(message, found[0]["message"])

    def test_lines_beside_the_slips(self) -> None:
        for name, (_, lines) in CASES.items():
            for line in lines:
                with self.subTest(name, line=line):
                    self.assertEqual(self.warn(DESIGN + line + "\n"), [])

    def test_examples_of_the_table(self) -> None:
        rows = re.findall(r"^\| `([\w-]+)` \|.*\| `([^`]*)` \|", self.run_tool(
            "warnings", "--markdown").out, re.M)
        self.assertEqual([name for name, _ in rows], list(CASES))
        design = "ADD SIGNAL A\nADD SIGNAL B(15:0)\nADD SIGNAL D(7:0)\nADD PORT P(7:0) input\n"
        for name, slip in rows:
            with self.subTest(name):
                self.assertEqual([each["rule"] for each in self.warn(design + slip + "\n")], [name])

    def test_phrases_without_effect_are_those_whose_help_says_so(self) -> None:
        page = self.run_tool("commands", "--markdown").out
        for phrase, text in re.findall(r"^\| `([^`]+)` \|.*\| (.*) \|$", page, re.M):
            line = {"SET SOURCE FILE": "f", "ADD COMPONENT PIN COMMENT": "CELL.I t",
                    "ADD INSTANCE PIN COMMENT": "u1.I t"}.get(phrase, "true")
            if "PIN ATTRIBUTE" in phrase:
                line = "u1.I K v" if "INSTANCE" in phrase else "CELL.I K v"
                line = line.replace(" v", " -GENERIC=SYN") if "OPTION" in phrase else line
            if "ATTRIBUTE" in phrase and " PIN " not in phrase:
                continue
            with self.subTest(phrase):
                self.write("d.cmd", DESIGN + "ADD INSTANCE PIN ATTRIBUTE u1.I -TYPE=User K v\n"
                           "ADD COMPONENT PIN ATTRIBUTE CELL.I -TYPE=User K v\n"
                           f"{phrase} {line}\n")
                outcome = self.run_tool("run", "d.cmd", "--keep-going", "--diagnostics", "json")
                found = [each for each in json.loads(outcome.err)["diagnostics"]
                         if each["line"] == LINE + 2]
                failed = any(each["severity"] == "error" for each in found)
                rules = [each.get("rule") for each in found]
                if text.endswith("It has no effect on the output.") or "so it has no effect" in text:
                    self.assertFalse(failed, found)
                    self.assertIn("no-effect", rules)
                else:
                    self.assertNotIn("no-effect", rules)

    def test_text(self) -> None:
        self.write("d.cmd", "ADD SIGNAL D(7:0)\nCONNECT SIGNAL A D[3]\n")
        self.expect(self.run_tool("run", "d.cmd"), SUCCESS,
                    'd.cmd:2: warning: "D[3]" becomes a net of the name "D(3)" [bracket-net]\n'
                    "    2 | CONNECT SIGNAL A D[3]\n"
                    "      |                  ^~~~\n"
                    "note: write D(3)\n")

    def test_standard_input_has_lines_too(self) -> None:
        outcome = self.run_tool("run", "-", stdin="ADD SIGNAL A\nASSIGN CONSTANT A 9\n")
        self.assertTrue(outcome.err.startswith("-:2: warning: "), outcome.err)

    def test_later_uses_are_not_told_again(self) -> None:
        found = self.warn("ADD PORT D(7:0) input\nCONNECT SIGNAL A D[3]\nCONNECT SIGNAL B D[3]\n"
                          "CONNECT SIGNAL C(9:0) D(9:0)\nCONNECT SIGNAL C(1:0) D(1:0)\n"
                          "CONNECT SIGNAL C(9:0) D(9:0)\nCONNECT SIGNAL C(11:0) D(11:0)\n")
        self.assertEqual([(each["rule"], each["line"]) for each in found],
                         [("bracket-net", 2), ("port-range", 4), ("port-range", 7)])

    def test_names_that_the_library_makes(self) -> None:
        write = "WRITE VERILOG -NOHEADER o.v\nWRITE VHDL -NOHEADER o.vhd\n"
        self.assertEqual(self.warn(
            DESIGN + "SET OPEN PIN false\nADD PORT Y(3:0) output\nADD INSTANCE CELL u2\n"
            "CONNECT SIGNAL Y(3:0) u2.D(3:0)\nCONNECT SIGNAL Y(2) u2.B(2)\n"
            "ASSIGN CONSTANT u1.B(2) 1\n" + write + "CONNECT SIGNAL Y(1) u2.I\n" + write), [])

    def test_slips_behind_a_write(self) -> None:
        # Each wider bus replaces another one, and the write forgets where these stood.
        wider = "".join(f"CONNECT SIGNAL X({i}:0) Y({i}:0)\n" for i in range(40))
        found = self.warn(wider + "WRITE VERILOG o.v\nCONNECT SIGNAL A Z[3]\nWRITE VERILOG o.v\n"
                          "CONNECT SIGNAL Z[4] A\n")
        self.assertEqual([(each["rule"], each["line"]) for each in found],
                         [("bracket-net", 42), ("bracket-net", 44)])

    def test_lines_that_fail_are_not_warned_of(self) -> None:
        self.write("d.cmd", "ADD PORT D(7:0) input\nCONNECT SIGNAL D(9:0) nothing.I\n"
                   "CONNECT SIGNAL D u9.I\nCONNECT SIGNAL A[2] u9.I\nASSIGN CONSTANT u9.I 8\n"
                   "CONNECT SIGNAL D(1:0) B(1:0)\n")
        outcome = self.run_tool("run", "d.cmd", "--keep-going")
        self.assertEqual(outcome.status, FAILED)
        self.assertNotIn("warning", outcome.err)

    def test_netlists_are_the_same(self) -> None:
        slips = "".join(line + "\n" for cases in CASES.values() for line, _ in cases[0])
        self.write("d.cmd", DESIGN + slips)
        for name, options in (("a", ()), ("b", ("--no-warn", "all"))):
            self.run_tool("run", "d.cmd", "--keep-going", "--no-header", "--verilog", f"{name}.v",
                          "--vhdl", f"{name}.vhd", *options)
        self.assertEqual(self.read("a.v"), self.read("b.v"))
        self.assertEqual(self.read("a.vhd"), self.read("b.vhd"))


class Options(ToolTest):
    TWO = "ADD SIGNAL A\nASSIGN CONSTANT A 9\nFLATTEN BUS\n" + INVERTER

    def setUp(self) -> None:
        super().setUp()
        self.write("d.cmd", self.TWO.replace("ADD PORT A input\n", ""))

    def test_no_warn(self) -> None:
        for options, rules in (((), ["scalar-constant", "no-effect"]),
                               (("--no-warn", "no-effect"), ["scalar-constant"]),
                               (("--no-warn", "no-effect,scalar-constant"), []),
                               (("--no-warn", "no-effect", "--no-warn", "scalar-constant"), []),
                               (("--no-warn=flag-word",), ["scalar-constant", "no-effect"]),
                               (("--no-warn", "all"), [])):
            with self.subTest(options):
                outcome = self.run_tool("run", "d.cmd", *options)
                self.assertEqual(outcome.status, SUCCESS)
                self.assertEqual(re.findall(r"warning: .*\[([\w-]+)\]$", outcome.err, re.M), rules)

    def test_unknown_name(self) -> None:
        outcome = self.run_tool("run", "d.cmd", "--no-warn", "no-efect")
        self.assertEqual(outcome.status, USAGE)
        self.assertIn("there is no warning no-efect; did you mean no-effect?", outcome.err)

    def test_werror(self) -> None:
        self.write("w.cmd", "WRITE VERILOG -NOHEADER early.v\n" + self.read("d.cmd") +
                   "WRITE VERILOG -NOHEADER late.v\n")
        outcome = self.run_tool("run", "w.cmd", "--werror", "--verilog", "o.v")
        self.assertEqual(outcome.status, FAILED)
        self.assertIn('w.cmd:3: error: "A" has one bit and is tied to "9" [scalar-constant]\n',
                      outcome.err)
        self.assertTrue(outcome.err.endswith("2 errors\n"), outcome.err)
        # All lines are carried out, and only the files of the command line are not written.
        self.assertEqual(sorted(path.name for path in self.folder.iterdir()),
                         ["d.cmd", "early.v", "late.v", "w.cmd"])
        self.assertIn("INV U1", self.read("late.v"))

    def test_werror_without_warnings(self) -> None:
        self.expect(self.run_tool("run", "d.cmd", "--werror", "--no-warn", "all", "--verilog",
                                  "o.v"), SUCCESS)
        self.assertIn("INV U1", self.read("o.v"))

    def test_sarif_names_the_rules(self) -> None:
        outcome = self.run_tool("run", "d.cmd", "--diagnostics", "sarif")
        run = json.loads(outcome.err)["runs"][0]
        self.assertEqual([result["ruleId"] for result in run["results"]],
                         ["scalar-constant", "no-effect"])
        self.assertEqual([rule["id"] for rule in run["tool"]["driver"]["rules"]], list(CASES))

    def test_other_commands_do_not_warn(self) -> None:
        self.assertEqual(self.run_tool("stats", "d.cmd").err, "")


if __name__ == "__main__":
    unittest.main()

"""`orn-hdl check` and `orn-hdl run --check`: lines, formats, exit statuses."""

from __future__ import annotations

import json
import unittest

from support import FAILED, FILE, INVERTER, SUCCESS, USAGE, ToolTest

SOUND = "SUPPRESS CONFIGURATION true\n" + INVERTER
TEN = "ASSIGN CONSTANT D(3:0) 1010\n"


class Check(ToolTest):
    def check(self, text: str, *options: str):
        self.write("t.cmd", text)
        return self.run_tool("check", *options, "t.cmd")

    def findings(self, text: str, *options: str) -> list[dict]:
        return json.loads(self.check(text, "--format", "json", *options).out)["findings"]

    def test_sound_design(self) -> None:
        outcome = self.check(SOUND)
        self.assertEqual((outcome.status, outcome.out, outcome.err),
                         (SUCCESS, "0 errors, 0 warnings\n", ""))

    def test_text(self) -> None:
        outcome = self.check(SOUND + TEN, "--target", "icarus,vhdl-93")
        self.assertEqual(outcome.status, FAILED)
        self.assertEqual(outcome.out, """\
t.cmd:10: error: the constant "1010" of "D(3:0)" is a decimal number in Verilog [constant-digits]
   10 | ASSIGN CONSTANT D(3:0) 1010
      |                        ^~~~
note: read otherwise than meant by icarus
note: Verilog reads the bits 0010, VHDL reads 1010
note: what helps: 4:B:1010
1 error, 0 warnings: 1 constant-digits
""")

    def test_both_halves_of_a_clash(self) -> None:
        outcome = self.check(SOUND + "ADD SIGNAL y(3:0)\n", "--target", "ghdl")
        self.assertIn('t.cmd:10: error: the signal "y(3:0)" and the port "Y" bear one name',
                      outcome.out)
        self.assertIn("t.cmd:6: note: the other half is here\n"
                      "    6 | ADD PORT Y output\n"
                      "      |          ^\n", outcome.out)

    def test_lines_of_causes(self) -> None:
        lines = ["ADD COMPONENT buf", "ADD PIN INV end Input", "ADD PORT a_ Input",
                 "ADD INSTANCE INV U__2", "CONNECT SIGNAL out U__2.I",
                 "CONNECT SIGNAL Q(3:0) P(1:0)", "ASSIGN CONSTANT R(1:0) 2:B:12",
                 "ADD LIBRARY 2x", "ADD USE LIBRARY x.y.all", "ADD INCLUDE f.v",
                 "ADD NOTES verilator x", "ADD MODULE ATTRIBUTE process 1",
                 "SET MODULE ATTRIBUTE OPTION process -GENERIC=SYN", "ADD INSTANCE buf U3"]
        found = {(finding["line"], finding["rule"])
                 for finding in self.findings(SOUND + "\n".join(lines) + "\n")}
        for number, rule in ((10, "reserved-word"), (11, "late-pin"), (12, "underscores"),
                             (13, "underscores"), (14, "reserved-word"), (15, "alias-width"),
                             (16, "constant-character"), (17, "library-clause"),
                             (18, "use-clause"), (19, "include-file"), (20, "directive-comment"),
                             (21, "reserved-word")):
            with self.subTest(lines[number - 10]):
                self.assertIn((number, rule), found)

    def test_write_lines_are_where_it_is_checked(self) -> None:
        text = SOUND + "WRITE VERILOG x.v\nADD PORT signal Input\nWRITE VERILOG x.v\n"
        self.assertEqual(self.findings(text), [])
        self.assertEqual(len(self.findings(text + "WRITE VHDL x.vhd\n")), 1)
        self.assertFalse((self.folder / "x.v").exists())

    def test_what_a_write_changes_stays(self) -> None:
        text = SOUND + "LOWERCASE SIGNAL\nADD PORT WIRE Input\nWRITE VERILOG x.v\n" \
                       "LOWERCASE INSTANCE\nWRITE VHDL x.vhd\n"
        self.assertEqual([finding["rule"] for finding in self.findings(text)], ["reserved-word"])

    def test_findings_of_several_writes_are_one(self) -> None:
        text = SOUND + "ADD PORT 2x Input\nWRITE VERILOG x.v\nWRITE VHDL x.vhd\nWRITE VHDL y.vhd\n"
        findings = self.findings(text)
        self.assertEqual(len(findings), 1)
        self.assertEqual({finding["line"] for finding in findings}, {10})

    def test_exit_statuses(self) -> None:
        warning = SOUND + "ADD INCLUDE x.v\n"
        self.assertEqual(self.check(SOUND + TEN).status, FAILED)
        self.assertEqual(self.check(SOUND + TEN, "--fail-on", "never").status, SUCCESS)
        self.assertEqual(self.check(warning).status, SUCCESS)
        self.assertEqual(self.check(warning, "--fail-on", "warning").status, FAILED)
        self.assertEqual(self.check(SOUND, "--target", "ada").status, USAGE)
        self.assertEqual(self.check(SOUND, "--fail-on", "much").status, USAGE)
        self.assertEqual(self.run_tool("check", "--explain", "ada").status, USAGE)
        self.assertEqual(self.run_tool("check").status, USAGE)
        self.assertEqual(self.run_tool("check", "none.cmd").status, FILE)
        self.assertEqual(self.check("NO SUCH LINE\n").status, FAILED)

    def test_standard_input(self) -> None:
        outcome = self.run_tool("check", "-", stdin=SOUND + TEN)
        self.assertIn("-:10: error: the constant", outcome.out)

    def test_several_files(self) -> None:
        self.write("b.cmd", SOUND + TEN)
        outcome = self.check(SOUND + TEN, "b.cmd")
        self.assertIn("t.cmd:10: error", outcome.out)
        self.assertIn("b.cmd:10: error", outcome.out)
        self.assertIn("2 errors", outcome.out)

    def test_components_that_are_designs_of_other_files(self) -> None:
        leaf = "SET NETLIST NAME leaf\nADD PORT a(1:0) Input\nADD PORT y Output\nCONNECT SIGNAL y a(0)\n"
        user = ("SUPPRESS CONFIGURATION TRUE\nADD COMPONENT leaf\nADD PIN leaf %s Input\n"
                "ADD PIN leaf y Output\n" + SOUND)
        self.write("leaf.cmd", leaf)
        outcome = self.check(user % "a", "leaf.cmd")
        self.assertEqual(outcome.status, FAILED)
        self.assertIn('t.cmd:3: error: the pin "a" of the component "leaf" is 1 bit wide, but the '
                      "port has 2 bits\n", outcome.err)
        self.assertIn('leaf.cmd:2: note: the port of "leaf"\n', outcome.err)
        self.assertIn("1 error", outcome.out)
        found = json.loads(self.check(user % "a", "leaf.cmd", "--format", "json").out)["findings"]
        self.assertEqual([(f["file"], f["line"], f["notes"]) for f in found],
                         [("t.cmd", 3, ['leaf.cmd:2: the port of "leaf"'])])
        self.assertEqual(self.check(user % "a(1:0)", "leaf.cmd").status, SUCCESS)
        # By itself the file says nothing of the other one.
        self.assertEqual(self.check(user % "a").status, SUCCESS)

    def test_json(self) -> None:
        found = json.loads(self.check(SOUND + "ADD PORT \xe9\"\xff Input\n", "--format", "json").out)
        self.assertEqual(list(found), ["findings", "counts"])
        for finding in found["findings"]:
            self.assertEqual(list(finding), ["rule", "severity", "file", "line", "targets",
                                             "message", "notes"])
        self.assertEqual(sum(found["counts"].values()), len(found["findings"]))

    def test_sarif(self) -> None:
        found = json.loads(self.check(SOUND + TEN + "ADD SIGNAL y(3:0)\n", "--format", "sarif").out)
        self.assertEqual(found["version"], "2.1.0")
        run, = found["runs"]
        driver = run["tool"]["driver"]
        self.assertEqual(driver["name"], "orn-hdl")
        rules = {rule["id"] for rule in driver["rules"]}
        self.assertGreaterEqual(len(run["results"]), 2)
        for result in run["results"]:
            self.assertIn(result["ruleId"], rules)
            self.assertIn(result["level"], ("error", "warning"))
            self.assertTrue(result["message"]["text"])
            place = result["locations"][0]["physicalLocation"]
            self.assertEqual(place["artifactLocation"]["uri"], "t.cmd")
            self.assertGreaterEqual(place["region"]["startLine"], 1)
        places = [result["locations"][0]["physicalLocation"]["region"] for result in run["results"]]
        self.assertIn({"startLine": 10, "startColumn": 24, "endColumn": 28}, places)

    def test_lines_that_fail(self) -> None:
        """Text has findings and failures in places of their own; a document has both."""
        text = SOUND + "NO SUCH LINE\n"
        outcome = self.check(text)
        self.assertEqual(outcome.out, "1 error, 0 warnings\n")
        self.assertTrue(outcome.err.startswith("t.cmd:10: error: Command not find.\n"), outcome.err)
        for option in ("--format", "--diagnostics"):
            outcome = self.check(text, option, "json")
            self.assertEqual(outcome.err, "")
            finding, = json.loads(outcome.out)["findings"]
            self.assertEqual((finding["line"], finding["severity"], finding["message"]),
                             (10, "error", "Command not find."))
        outcome = self.check(text, "--format", "sarif")
        result, = json.loads(outcome.out)["runs"][0]["results"]
        self.assertEqual((result["level"], outcome.err), ("error", ""))

    def test_rules_are_listed_and_explained(self) -> None:
        listed = self.run_tool("check", "--list").out.splitlines()
        self.assertGreater(len(listed), 50)
        for line in listed:
            name, severity = line.split()[:2]
            self.assertIn(severity, ("error", "warning"))
            told = self.run_tool("check", "--explain", name).out
            self.assertIn("Example:\n", told)
            self.assertIn("What helps: ", told)

    def test_run_refuses_to_write(self) -> None:
        self.write("t.cmd", SOUND + TEN)
        outcome = self.run_tool("run", "--check", "--verilog", "t.v", "--vhdl", "t.vhd", "t.cmd")
        self.assertEqual(outcome.status, FAILED)
        self.assertIn("t.cmd:10: error: the constant", outcome.err)
        self.assertFalse((self.folder / "t.v").exists())
        self.assertTrue((self.folder / "t.vhd").exists())

    def test_run_finds_lines_although_it_writes_elsewhere(self) -> None:
        (self.folder / "out").mkdir()
        self.write("t.cmd", SOUND + TEN + "WRITE VERILOG t.v\n")
        outcome = self.run_tool("run", "--check", "--output-dir", "out", "t.cmd")
        self.assertIn("t.cmd:10: error: the constant", outcome.err)
        self.assertIn("   10 | ASSIGN CONSTANT D(3:0) 1010\n      |                        ^~~~\n",
                      outcome.err)

    def test_run_refuses_a_write_line(self) -> None:
        self.write("t.cmd", SOUND + TEN + "WRITE VERILOG t.v\nWRITE VHDL t.vhd\n")
        outcome = self.run_tool("run", "--check", "--keep-going", "t.cmd")
        self.assertEqual(outcome.status, FAILED)
        self.assertFalse((self.folder / "t.v").exists())
        self.assertTrue((self.folder / "t.vhd").exists())


if __name__ == "__main__":
    unittest.main()

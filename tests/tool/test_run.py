"""orn-hdl run: replay, messages, exit statuses, outputs."""

from __future__ import annotations

import os
import pty
import re
import socket
import subprocess
import threading
import unittest
from collections.abc import Callable

from support import EXAMPLES, FAILED, FILE, INVERTER, SUCCESS, TOOL, USAGE, ToolTest, lone_add


class Replay(ToolTest):
    def test_nothing_is_printed_when_all_goes_well(self) -> None:
        self.write("d.cmd", INVERTER)
        self.expect(self.run_tool("run", "d.cmd"), SUCCESS)
        self.assertEqual(os.listdir(self.folder), ["d.cmd"])

    def test_model_is_named_after_the_file(self) -> None:
        (self.folder / "sub").mkdir()
        self.write("sub/my.design.cmd", INVERTER)
        self.expect(self.run_tool("run", "sub/my.design.cmd", "--verilog", "o.v"), SUCCESS)
        self.assertIn("module my.design(A", self.read("o.v"))

    def test_file_that_begins_with_a_dot(self) -> None:
        self.write(".hidden", INVERTER)
        self.expect(self.run_tool("run", ".hidden", "--verilog", "o.v"), SUCCESS)
        self.assertIn("module .hidden(A", self.read("o.v"))

    def test_model_option(self) -> None:
        self.write("d.cmd", INVERTER)
        self.expect(self.run_tool("run", "d.cmd", "--model", "gate", "--vhdl", "o.vhd"), SUCCESS)
        self.assertIn("entity gate is", self.read("o.vhd"))

    def test_commands_name_the_netlist_last(self) -> None:
        self.write("d.cmd", "SET NETLIST NAME final\n" + INVERTER)
        self.expect(self.run_tool("run", "d.cmd", "--model", "gate", "--verilog", "o.v"), SUCCESS)
        self.assertIn("module final(A", self.read("o.v"))

    def test_standard_input(self) -> None:
        self.expect(self.run_tool("run", "-", "--verilog", "o.v", stdin=INVERTER), SUCCESS)
        self.assertIn("module HDL_NETLIST(A", self.read("o.v"))

    def test_standard_input_is_called_a_dash(self) -> None:
        self.expect(self.run_tool("run", "-", stdin="NOOP\nADD\n"), FAILED,
                    "-:2: error: Command not find.\n" + lone_add(2))

    def test_empty_file(self) -> None:
        self.write("empty", "")
        self.expect(self.run_tool("run", "empty", "--verilog", "o.v", "--no-header"), SUCCESS)
        self.assertIn("module empty();", self.read("o.v"))

    def test_last_line_without_line_end(self) -> None:
        self.write("d.cmd", "NOOP\nADD")
        self.expect(self.run_tool("run", "d.cmd"), FAILED,
                    "d.cmd:2: error: Command not find.\n" + lone_add(2))

    def test_carriage_returns(self) -> None:
        self.write("dos.cmd", INVERTER.replace("\n", "\r\n"))
        self.write("unix.cmd", INVERTER)
        for name in ("dos", "unix"):
            self.expect(self.run_tool("run", f"{name}.cmd", "--model", "m", "--no-header",
                                      "--verilog", f"{name}.v"), SUCCESS)
        self.assertEqual(self.read("dos.v"), self.read("unix.v"))

    def test_a_command_ends_at_its_first_nul(self) -> None:
        self.write("d.cmd", "ADD SIGNAL a\0b c\nADD SIGNAL a\n")
        self.expect(self.run_tool("run", "d.cmd"), FAILED,
                    'd.cmd:2: error: Identifier "a" already defined.\n'
                    "    2 | ADD SIGNAL a\n"
                    "      |            ^\n"
                    "d.cmd:1: note: a is a signal, added here\n"
                    "    1 | ADD SIGNAL a\n"
                    "      |            ^\n")

    def test_blank_lines_count(self) -> None:
        self.write("d.cmd", "\n   \n\r\nADD\n")
        self.expect(self.run_tool("run", "d.cmd"), FAILED,
                    "d.cmd:4: error: Command not find.\n" + lone_add(4))

    def test_long_line(self) -> None:
        name = "x" * 3_000_000
        self.write("d.cmd", f"ADD SIGNAL {name}\nADD SIGNAL {name}\n")
        self.expect(self.run_tool("run", "d.cmd"), FAILED,
                    f'd.cmd:2: error: Identifier "{name}" already defined.\n'
                    f"    2 | ADD SIGNAL {'x' * 149}...\n"
                    f"      |            ^{'~' * 148}\n"
                    f"d.cmd:1: note: {'x' * 60}... is a signal, added here\n"
                    f"    1 | ADD SIGNAL {'x' * 149}...\n"
                    f"      |            ^{'~' * 148}\n")

    def test_the_file_is_called_as_given(self) -> None:
        self.write("d.cmd", "ADD\n")
        self.expect(self.run_tool("run", "./d.cmd"), FAILED,
                    "./d.cmd:1: error: Command not find.\n" + lone_add(1))

    def test_bytes_of_names_are_kept_in_messages(self) -> None:
        self.write("d.cmd", "CONNECT SIGNAL \xff\x80 \xe9%s.%n\n")
        self.expect(self.run_tool("run", "d.cmd"), FAILED,
                    'd.cmd:1: error: Signal "\xe9%s" not found.\n'
                    "    1 | CONNECT SIGNAL \xff\x80 \xe9%s.%n\n"
                    "      |                   ^~~\n"
                    "note: there is no instance \xe9%s\n")


class Failures(ToolTest):
    def test_the_first_failure_ends_the_replay(self) -> None:
        self.write("d.cmd", "NOOP\nADD\nADD\n")
        self.expect(self.run_tool("run", "d.cmd", "--verilog", "o.v"), FAILED,
                    "d.cmd:2: error: Command not find.\n" + lone_add(2))
        self.assertFalse((self.folder / "o.v").exists())

    def test_keep_going_reports_every_failure_and_writes(self) -> None:
        self.write("d.cmd", "ADD\n" + INVERTER + "SET NETLIST NAME\nADD PIN INV I input\n")
        self.expect(self.run_tool("run", "--keep-going", "d.cmd", "--verilog", "o.v"), FAILED,
                    "d.cmd:1: error: Command not find.\n" + lone_add(1) +
                    "d.cmd:10: error: SET NETLIST NAME: Invalid Arguments.\n"
                    "   10 | SET NETLIST NAME\n"
                    "      |                 ^\n"
                    "note: <name> is missing: SET NETLIST NAME <name>\n"
                    'd.cmd:11: error: Component "INV" already has pin "I".\n'
                    "   11 | ADD PIN INV I input\n"
                    "      |             ^\n"
                    "d.cmd:3: note: I was added here\n"
                    "    3 | ADD PIN INV I input\n"
                    "      |             ^\n"
                    "3 errors\n")
        self.assertIn("INV U1", self.read("o.v"))

    def test_only_the_first_failures_are_searched_for(self) -> None:
        self.write("d.cmd", INVERTER + "CONNECT SIGNAL A U9.I\n" * 25)
        outcome = self.run_tool("run", "d.cmd", "--keep-going")
        self.assertEqual(outcome.err.count('error: Signal "U9" not found.\n'), 25)
        self.assertEqual(outcome.err.count("note: there is no instance U9; did you mean U1?\n"), 20)
        self.assertEqual(outcome.err.count("note: there is no instance U9\n"), 5)
        self.assertEqual(outcome.err.count("      |                  ^~\n"), 25)
        self.assertTrue(outcome.err.endswith("\n25 errors\n"))

    def test_error_limit(self) -> None:
        self.write("d.cmd", "ADD\n" * 5)
        for limit, errors in (("1", 1), ("4", 4), ("5", 5), ("6", 5)):
            outcome = self.run_tool("run", "d.cmd", "--keep-going", "--error-limit", limit, "--verilog",
                                    f"o{limit}.v")
            self.assertEqual((outcome.status, outcome.err.count("error:")), (FAILED, errors))
            self.assertEqual((self.folder / f"o{limit}.v").exists(), limit == "6")
        self.assertEqual(self.run_tool("run", "d.cmd", "--keep-going", "--error-limit", "0").status, USAGE)

    def test_standard_input_that_is_a_file_is_read_again(self) -> None:
        self.write("d.cmd", "NOOP\n  ADD   \n")
        with open(self.folder / "d.cmd", "rb") as commands:
            done = subprocess.run([TOOL, "run", "-"], stdin=commands, capture_output=True, check=False)
        self.assertIn(b"\n    2 |   ADD   \n      |      ^\n", done.stderr)

    def test_colours(self) -> None:
        self.write("d.cmd", "ADD\n")
        for options, environment, isColoured in (
                ([], {}, False), (["--color", "always"], {"NO_COLOR": "1"}, True),
                (["--color", "never"], {}, False), (["--color", "auto"], {}, False)):
            outcome = self.run_tool("run", "d.cmd", *options, **environment)
            self.assertEqual("\033[" in outcome.err, isColoured)

    def test_missing_file(self) -> None:
        self.expect(self.run_tool("run", "none", "--keep-going", "--verilog", "o.v"), FILE,
                    "orn-hdl: cannot read none: No such file or directory\n")
        self.assertEqual(os.listdir(self.folder), [])

    def test_folder_for_a_file(self) -> None:
        self.expect(self.run_tool("run", "."), FILE, "orn-hdl: cannot read .: Is a directory\n")

    def test_unreadable_file(self) -> None:
        # What cannot be read although it can be opened; root may read anything else.
        self.expect(self.run_tool("run", "/proc/self/mem"), FILE,
                    "orn-hdl: cannot read /proc/self/mem: Input/output error\n")


class Outputs(ToolTest):
    def setUp(self) -> None:
        super().setUp()
        self.write("d.cmd", INVERTER)

    def test_both_languages(self) -> None:
        self.expect(self.run_tool("run", "d.cmd", "--verilog", "o.v", "--vhdl", "o.vhd"), SUCCESS)
        self.assertTrue(self.read("o.v").startswith("////"))
        self.assertIn("Design Name: d", self.read("o.v"))
        self.assertIn("Filename : o.v", self.read("o.v"))
        self.assertTrue(self.read("o.vhd").startswith("----"))

    def test_no_header(self) -> None:
        self.expect(self.run_tool("run", "d.cmd", "--verilog", "o.v", "--vhdl", "o.vhd",
                                  "--no-header"), SUCCESS)
        self.assertTrue(self.read("o.v").startswith("`timescale 1ns / 1ps\n"))
        self.assertTrue(self.read("o.vhd").lstrip("\n").startswith("library ieee;"))

    def test_no_header_is_no_matter_of_write_lines(self) -> None:
        self.write("w.cmd", INVERTER + "WRITE VERILOG a.v\nWRITE VERILOG -NOHEADER b.v\n")
        self.expect(self.run_tool("run", "w.cmd", "--no-header"), SUCCESS)
        self.assertTrue(self.read("a.v").startswith("////"))
        self.assertTrue(self.read("b.v").startswith("`timescale"))

    def test_write_lines_go_to_the_current_folder(self) -> None:
        (self.folder / "sub").mkdir()
        self.write("sub/w.cmd", INVERTER + "WRITE VHDL o.vhd\n")
        self.expect(self.run_tool("run", "sub/w.cmd"), SUCCESS)
        self.assertTrue((self.folder / "o.vhd").exists())

    def test_same_bytes_as_a_write_line(self) -> None:
        self.write("w.cmd", INVERTER + "WRITE VERILOG -NOHEADER a.v\n")
        self.expect(self.run_tool("run", "w.cmd", "--verilog", "b.v", "--no-header"), SUCCESS)
        self.assertEqual(self.read("a.v"), self.read("b.v"))

    def test_output_that_cannot_be_opened(self) -> None:
        self.expect(self.run_tool("run", "d.cmd", "--verilog", "no/o.v", "--vhdl", "o.vhd"), FILE,
                    "orn-hdl: cannot write no/o.v: No such file or directory\n")
        self.assertIn("entity d is", self.read("o.vhd"))

    def test_folder_for_an_output(self) -> None:
        self.expect(self.run_tool("run", "d.cmd", "--vhdl", "."), FILE,
                    "orn-hdl: cannot write .: Is a directory\n")

    def test_full_device(self) -> None:
        self.expect(self.run_tool("run", "d.cmd", "--verilog", "/dev/full"), FILE,
                    "orn-hdl: cannot write /dev/full: No space left on device\n")

    def test_write_line_that_cannot_be_opened(self) -> None:
        self.write("w.cmd", "NOOP\nWRITE VERILOG no/o.v\nADD\n")
        self.expect(self.run_tool("run", "w.cmd", "--vhdl", "o.vhd"), FILE,
                    "w.cmd:2: error: cannot write no/o.v: No such file or directory\n"
                    "    2 | WRITE VERILOG no/o.v\n"
                    "      |               ^~~~~~\n"
                    "note: there is no folder no\n")
        self.assertFalse((self.folder / "o.vhd").exists())

    def test_write_line_to_a_full_device(self) -> None:
        self.write("w.cmd", INVERTER + "WRITE VHDL -APPEND /dev/full\n")
        self.expect(self.run_tool("run", "w.cmd"), FILE,
                    "w.cmd:9: error: cannot write /dev/full: No space left on device\n"
                    "    9 | WRITE VHDL -APPEND /dev/full\n"
                    "      |                    ^~~~~~~~~\n")

    def test_a_write_failure_is_reported_once_and_outweighs_a_failed_command(self) -> None:
        self.write("w.cmd", "WRITE VERILOG /dev/full\nNOOP\nADD\nWRITE VERILOG fine.v\n")
        self.expect(self.run_tool("run", "w.cmd", "--keep-going"), FILE,
                    "w.cmd:1: error: cannot write /dev/full: No space left on device\n"
                    "    1 | WRITE VERILOG /dev/full\n"
                    "      |               ^~~~~~~~~\n"
                    "w.cmd:3: error: Command not find.\n" + lone_add(3) +
                    "2 errors\n")
        self.assertTrue((self.folder / "fine.v").exists())

    def test_standard_output_as_a_file(self) -> None:
        outcome = self.run_tool("run", "d.cmd", "--verilog", "/dev/stdout", "--no-header")
        self.assertEqual(outcome.status, SUCCESS)
        self.assertIn("module d(A", outcome.out)

    def test_a_dash_is_standard_output(self) -> None:
        for language in ("verilog", "vhdl"):
            with self.subTest(language):
                self.expect(self.run_tool("run", "d.cmd", f"--{language}", "o", "--no-header"), SUCCESS)
                self.expect(self.run_tool("run", "d.cmd", f"--{language}", "-", "--no-header"), SUCCESS,
                            out=self.read("o"))
        self.assertEqual(sorted(os.listdir(self.folder)), ["d.cmd", "o"])

    def test_both_languages_on_standard_output(self) -> None:
        self.expect(self.run_tool("run", "d.cmd", "--verilog", "o.v", "--vhdl", "o.vhd", "--no-header"),
                    SUCCESS)
        self.expect(self.run_tool("run", "d.cmd", "--verilog", "-", "--vhdl", "-", "--no-header"),
                    SUCCESS, out=self.read("o.v") + self.read("o.vhd"))

    def test_header_on_standard_output_names_no_file(self) -> None:
        outcome = self.run_tool("run", "d.cmd", "--verilog", "-")
        self.assertTrue(outcome.out.startswith("////"))
        self.assertRegex(outcome.out, r"Filename : \n")

    def test_standard_output_is_continued(self) -> None:
        # What the caller wrote before stays, and what it writes after follows the netlist.
        with open(self.folder / "out", "wb") as out:
            for text in (b"before\n", b"after\n"):
                out.write(text)
                out.flush()
                subprocess.run([TOOL, "run", "d.cmd", "--verilog", "-", "--no-header"],
                               cwd=self.folder, stdout=out, check=True)
        self.assertRegex(self.read("out"),
                         r"(?s)\Abefore\n`timescale.*endmodule\nafter\n`timescale.*endmodule\n\Z")

    def test_standard_output_may_be_a_socket(self) -> None:
        ours, theirs = socket.socketpair()
        with ours, theirs:
            subprocess.run([TOOL, "run", "d.cmd", "--vhdl", "-"], cwd=self.folder, stdout=theirs,
                           check=True)
            self.assertIn(b"entity d is", ours.recv(65536))

    def test_commands_of_the_final_design(self) -> None:
        self.write("w.cmd", INVERTER + "WRITE VERILOG w.v\nADD SIGNAL N\n")
        self.expect(self.run_tool("run", "w.cmd", "--output-commands", "c.cmd", "--verilog", "a.v"), SUCCESS)
        self.assertTrue(self.read("c.cmd").startswith("SET NETLIST NAME w\nADD COMPONENT INV\n"))
        self.assertIn("ADD SIGNAL N\n", self.read("c.cmd"))
        self.assertTrue((self.folder / "w.v").exists())
        self.expect(self.run_tool("run", "c.cmd", "--output-commands", "-", "--verilog", "b.v"), SUCCESS,
                    out=self.read("c.cmd"))
        self.assertEqual(self.read("a.v").replace("a.v", ""), self.read("b.v").replace("b.v", ""))

    def test_commands_come_before_what_outputs_change(self) -> None:
        self.write("w.cmd", INVERTER + "CONNECT SIGNAL Y U1.I\n")
        self.expect(self.run_tool("run", "w.cmd", "--output-commands", "c.cmd", "--verilog", "a.v"), SUCCESS)
        self.assertIn("Y_DUMMY", self.read("a.v"))
        self.assertNotIn("Y_DUMMY", self.read("c.cmd"))

    def test_commands_name_the_source_that_a_line_names(self) -> None:
        self.write("w.cmd", "NOOP\n")
        self.expect(self.run_tool("run", "w.cmd", "--output-commands", "-"), SUCCESS,
                    out="SET NETLIST NAME w\n")
        self.write("w.cmd", "SET SOURCE FILE w.src\n")
        self.expect(self.run_tool("run", "w.cmd", "--output-commands", "-", "--no-warn", "all"), SUCCESS,
                    out="SET NETLIST NAME w\nSET SOURCE FILE w.src\n")

    def test_commands_need_a_complete_replay(self) -> None:
        self.write("c.cmd", "former\n")
        self.write("w.cmd", "ADD SIGNAL A\nADD\n")
        outcome = self.run_tool("run", "w.cmd", "--output-commands", "c.cmd")
        self.assertEqual((outcome.status, self.read("c.cmd")), (FAILED, "former\n"))
        outcome = self.run_tool("run", "w.cmd", "--output-commands", "c.cmd", "--keep-going")
        self.assertEqual((outcome.status, self.read("c.cmd")),
                         (FAILED, "SET NETLIST NAME w\nADD SIGNAL A\n"))

    def test_commands_that_cannot_be_written(self) -> None:
        self.expect(self.run_tool("run", "d.cmd", "--output-commands", "no/c.cmd"), FILE,
                    "orn-hdl: cannot write no/c.cmd: No such file or directory\n")
        self.expect(self.run_tool("run", "d.cmd", "--output-commands", "/dev/full"), FILE,
                    "orn-hdl: cannot write /dev/full: No space left on device\n")
        # They are replaced only when the netlists have been written.
        self.write("c.cmd", "former\n")
        outcome = self.run_tool("run", "d.cmd", "--output-commands", "c.cmd", "--verilog", "no/a.v")
        self.assertEqual((outcome.status, self.read("c.cmd")), (FILE, "former\n"))

    def test_a_design_that_commands_cannot_express(self) -> None:
        self.write("w.cmd", "Set Open Pin false\nADD COMPONENT C\nADD PIN C I(1:0) in\n"
                            "ADD INSTANCE C U-1\nWRITE VHDL w.vhd\n")
        self.expect(self.run_tool("run", "w.cmd", "--output-commands", "c.cmd"), FAILED,
                    "orn-hdl: No command can express signal \"U:1_I_openSignal(1:0)\": its name is of "
                    "another form.\n")
        self.assertFalse((self.folder / "c.cmd").exists())

    def test_messages_stay_off_standard_output(self) -> None:
        self.write("w.cmd", "ADD\n" + INVERTER)
        outcome = self.run_tool("run", "w.cmd", "--keep-going", "--verilog", "-", "--no-header")
        self.assertEqual((outcome.status, outcome.err),
                         (FAILED, "w.cmd:1: error: Command not find.\n" + lone_add(1)))
        self.assertTrue(outcome.out.startswith("`timescale"))
        self.assertTrue(outcome.out.endswith("endmodule\n"))


# Runs of a test in which another thread changes the folder. A check of the name alone lets about one run
# in ten write outside.
RACES = 16


class WriteRules(ToolTest):
    """A command file that is not trusted writes below one folder, or nothing."""

    def setUp(self) -> None:
        super().setUp()
        (self.folder / "out" / "sub").mkdir(parents=True)
        (self.folder / "outer").mkdir()
        self.write("outer/kept", "kept\n")

    def all_files(self) -> set[str]:
        return {str(path.relative_to(self.folder)) for path in self.folder.rglob("*")
                if not path.is_dir()}

    def replay(self, *lines: str, folder: str = "out") -> tuple[int, list[str]]:
        """The status, and the files that the lines made."""
        self.write("w.cmd", INVERTER + "".join(f"{line}\n" for line in lines))
        before = self.all_files()
        outcome = self.run_tool("run", "w.cmd", "--output-dir", folder, "--keep-going")
        self.errors = re.findall(r"^w\.cmd:\d+: error: (.*)$", outcome.err, re.M)
        return outcome.status, sorted(self.all_files() - before)

    def refuse(self, name: str, reason: str = "it leads out of the output folder") -> None:
        for options in ("", "-APPEND ", "-OVERWRITE ", "-APPEND -NOHEADER "):
            for language in ("VERILOG", "VHDL"):
                with self.subTest(name=name, options=options, language=language):
                    outcome = self.replay(f"WRITE {language} {options}{name}")
                    self.assertEqual(self.errors, [f'Cannot write "{name}": {reason}.'])
                    self.assertEqual(outcome, (FAILED, []))
                    self.assertEqual(self.read("outer/kept"), "kept\n")

    def test_names_begin_in_the_folder(self) -> None:
        self.assertEqual(self.replay("WRITE VERILOG a.v", "WRITE VHDL ./sub/b.vhd",
                                     "WRITE VHDL -APPEND sub/b.vhd", "WRITE VERILOG ..c.v"),
                         (SUCCESS, ["out/..c.v", "out/a.v", "out/sub/b.vhd"]))
        self.assertIn("Filename : a.v", self.read("out/a.v"))
        self.assertEqual(self.read("out/sub/b.vhd").count("architecture"), 2)

    def test_files_that_are_there_are_written(self) -> None:
        self.write("out/a.v", "former\n")
        self.write("out/b.v", "former\n")
        self.replay("WRITE VERILOG a.v", "WRITE VERILOG -APPEND b.v")
        self.assertEqual(self.errors, [])
        self.assertNotIn("former", self.read("out/a.v"))
        self.assertTrue(self.read("out/b.v").startswith("former\n"))

    def test_names_that_climb(self) -> None:
        for name in ("../a.v", "..", "sub/../../a.v", "sub/../a.v", "sub/..", "./../outer/kept",
                     "../outer/kept", "../out/a.v"):
            self.refuse(name)

    def test_absolute_names(self) -> None:
        for name in (self.folder / "outer" / "kept", self.folder / "out" / "a.v", "/dev/stdout",
                     "//a.v", "/"):
            self.refuse(str(name))

    def test_links_that_lead_out(self) -> None:
        (self.folder / "out" / "folder").symlink_to("../outer")
        (self.folder / "out" / "file").symlink_to(self.folder / "outer" / "kept")
        (self.folder / "out" / "new").symlink_to("../outer/new")
        (self.folder / "out" / "again").symlink_to("file")
        (self.folder / "out" / "loop").symlink_to("loop")
        (self.folder / "out" / "null").symlink_to("/dev/null")
        (self.folder / "outx").mkdir()
        (self.folder / "out" / "beside").symlink_to("../outx")
        for name in ("folder/kept", "folder/new", "file", "new", "again", "loop", "null",
                     "folder/../a.v", "sub/../folder/kept", "beside/a.v"):
            self.refuse(name)

    def test_links_within_the_folder(self) -> None:
        self.write("out/sub/real.v", "former\n")
        (self.folder / "out" / "way").symlink_to("sub")
        (self.folder / "out" / "link.v").symlink_to("way/real.v")
        self.assertEqual(self.replay("WRITE VERILOG link.v", "WRITE VHDL way/b.vhd"),
                         (SUCCESS, ["out/sub/b.vhd"]))
        self.assertTrue((self.folder / "out" / "link.v").is_symlink())
        self.assertIn("module", self.read("out/sub/real.v"))

    def test_what_is_no_file(self) -> None:
        os.mkfifo(self.folder / "out" / "pipe")
        self.refuse("pipe", "it is not a regular file")
        self.assertEqual(self.replay("WRITE VERILOG sub", "WRITE VERILOG no/a.v"), (FILE, []))
        self.assertEqual(self.errors, ["cannot write sub: Is a directory",
                                       "cannot write no/a.v: No such file or directory"])

    def test_the_folder_may_be_a_link(self) -> None:
        (self.folder / "alias").symlink_to("out")
        self.assertEqual(self.replay("WRITE VERILOG a.v", folder="alias"), (SUCCESS, ["out/a.v"]))

    def test_outputs_of_the_command_line_go_where_they_say(self) -> None:
        self.write("w.cmd", INVERTER + "WRITE VERILOG a.v\n")
        for rule in (["--output-dir", "out"], ["--no-write"]):
            with self.subTest(rule=rule):
                outcome = self.run_tool("run", "--keep-going", *rule, "w.cmd", "--vhdl", "b.vhd")
                self.assertEqual(outcome.status, FAILED if rule == ["--no-write"] else SUCCESS)
                self.assertIn("entity w is", self.read("b.vhd"))
                (self.folder / "b.vhd").unlink()

    def race(self, swap: Callable[[], None], *lines: str) -> None:
        """Replays the lines while another thread swaps what their files lie in, and checks that
        nothing is ever written outside of the folder."""
        outside = {path.name for path in (self.folder / "outer").iterdir()}
        done = threading.Event()

        def keep_swapping() -> None:
            while not done.is_set():
                swap()

        swapper = threading.Thread(target=keep_swapping)
        swapper.start()
        try:
            for _ in range(RACES):
                self.write("w.cmd", INVERTER + "".join(f"{line}\n" for line in lines))
                self.run_tool("run", "w.cmd", "--output-dir", "out", "--keep-going")
                if {path.name for path in (self.folder / "outer").iterdir()} != outside:
                    break
        finally:
            done.set()
            swapper.join()
        self.assertEqual({path.name for path in (self.folder / "outer").iterdir()}, outside)
        self.assertEqual(self.read("outer/kept"), "kept\n")

    def test_a_folder_that_becomes_a_link_in_the_meantime(self) -> None:
        way, real = self.folder / "out" / "sub", self.folder / "out" / "real"

        def swap() -> None:
            way.rename(real)
            way.symlink_to("../outer")
            way.unlink()
            real.rename(way)

        self.race(swap, *(f"WRITE VERILOG -APPEND sub/a{i}.v" for i in range(100)),
                  *(f"WRITE VHDL sub/b{i}.vhd" for i in range(100)))

    def test_a_file_that_becomes_a_link_in_the_meantime(self) -> None:
        file, link = self.folder / "out" / "a.v", self.folder / "out" / "link"

        def swap() -> None:
            link.symlink_to("../outer/kept")
            link.replace(file)
            file.unlink()
            file.touch()

        self.race(swap, *["WRITE VERILOG -APPEND a.v", "WRITE VHDL a.v"] * 100)

    def test_no_write(self) -> None:
        self.write("w.cmd", INVERTER + "WRITE VERILOG a.v\nWRITE VHDL -APPEND /dev/null\nNOOP\n")
        before = self.all_files()
        self.expect(self.run_tool("run", "w.cmd", "--no-write", "--keep-going"), FAILED,
                    'w.cmd:9: error: Cannot write "a.v": --no-write is in force.\n'
                    "    9 | WRITE VERILOG a.v\n"
                    "      |               ^~~\n"
                    'w.cmd:10: error: Cannot write "/dev/null": --no-write is in force.\n'
                    "   10 | WRITE VHDL -APPEND /dev/null\n"
                    "      |                    ^~~~~~~~~\n"
                    "2 errors\n")
        self.assertEqual(self.all_files(), before)

    def test_a_refused_line_ends_the_replay(self) -> None:
        self.write("w.cmd", "WRITE VERILOG /a.v\nADD\n")
        self.expect(self.run_tool("run", "w.cmd", "--output-dir", "out"), FAILED,
                    'w.cmd:1: error: Cannot write "/a.v": it leads out of the output folder.\n'
                    "    1 | WRITE VERILOG /a.v\n"
                    "      |               ^~~~\n")

    def test_folder_that_cannot_be_entered(self) -> None:
        self.write("w.cmd", "WRITE VERILOG a.v\n")
        before = self.all_files()
        for folder, why in (("none", "No such file or directory"), ("w.cmd", "Not a directory")):
            self.expect(self.run_tool("run", "w.cmd", "--output-dir", folder, "--vhdl", "b.vhd"),
                        FILE, f"orn-hdl: cannot write {folder}: {why}\n")
        self.assertEqual(self.all_files(), before)

    def test_usage(self) -> None:
        self.write("w.cmd", "WRITE VERILOG a.v\n")
        for rules in (["--no-write", "--output-dir", "out"], ["--output-dir", ""],
                      ["--output-dir"]):
            self.assertEqual(self.run_tool("run", "w.cmd", *rules).status, USAGE)
        self.assertFalse((self.folder / "a.v").exists())


class Usage(ToolTest):
    def expect_usage(self, message: str, *arguments: str) -> None:
        self.expect(self.run_tool(*arguments), USAGE, f"orn-hdl: {message}; see --help\n")

    def test_usage_errors(self) -> None:
        self.expect_usage("A subcommand is required")
        self.expect_usage("FILE is required", "run")
        self.expect_usage("The following argument was not expected: b", "stats", "a", "b")
        self.expect_usage("unknown option --nothing", "run", "a", "--nothing")
        self.expect_usage("unknown option --nothing", "run", "a", "--nothing=1")
        self.expect_usage("The following argument was not expected: --verlog", "run", "a", "--",
                          "--verlog")
        self.expect_usage("there is no command replay", "replay", "x")
        self.expect_usage("there is no command replay", "help", "replay")
        self.expect_usage("--verilog: a file name is needed", "run", "a", "--verilog", "")
        self.expect_usage("FILE: a file name is needed", "run", "")
        self.expect_usage("--verilog: 1 required FILE missing", "run", "a", "--verilog")

    def test_suggestions(self) -> None:
        for meant, *arguments in (
                ("--verilog", "run", "a", "--verlog", "o.v"), ("--vhdl", "run", "--vdhl=o.vhd", "a"),
                ("--verilog", "run", "--VERILOG", "o.v"), ("--keep-going", "run", "--keepgoing", "a"),
                ("--top", "import", "--tpo", "t", "a"), ("--around", "draw", "--aroud", "U1", "a"),
                ("--version", "--verson")):
            with self.subTest(arguments):
                word = next(word for word in arguments if word.startswith("--")).partition("=")[0]
                self.expect(self.run_tool(*arguments), USAGE,
                            f"orn-hdl: unknown option {word}; did you mean {meant}?\n")
        for meant, word in (("run", "rnu"), ("run", "RUN"), ("import", "imprt"), ("draw", "darw"),
                            ("commands", "command"), ("help", "hlep")):
            with self.subTest(word):
                self.expect(self.run_tool(word, "x"), USAGE,
                            f"orn-hdl: there is no command {word}; did you mean {meant}?\n")

    def test_a_usage_error_does_nothing(self) -> None:
        self.write("w.cmd", "WRITE VERILOG o.v\n")
        self.assertEqual(self.run_tool("run", "w.cmd", "--nothing").status, USAGE)
        self.assertFalse((self.folder / "o.v").exists())

    def test_help(self) -> None:
        for arguments in (["--help"], ["-h"], ["run", "--help"], ["import", "--help"],
                          ["draw", "--help"], ["commands", "--help"]):
            outcome = self.run_tool(*arguments)
            self.assertEqual((outcome.status, outcome.err), (SUCCESS, ""))
            self.assertIn("Usage: orn-hdl", outcome.out)

    def test_help_command(self) -> None:
        self.expect(self.run_tool("help"), SUCCESS, out=self.run_tool("--help").out)
        for command in ("run", "import", "draw", "commands"):
            self.expect(self.run_tool("help", command), SUCCESS,
                        out=self.run_tool(command, "--help").out)

    def test_version(self) -> None:
        outcome = self.run_tool("--version")
        self.assertEqual((outcome.status, outcome.err), (SUCCESS, ""))
        self.assertRegex(outcome.out, r"^orn-hdl \d+\.\d+\.\d+\n$")

    def test_standard_output_that_is_full(self) -> None:
        self.write("d.cmd", INVERTER)
        for arguments in (["--version"], ["--help"], ["commands"],
                          ["run", self.folder / "d.cmd", "--vhdl", "-"]):
            with open("/dev/full", "w", encoding="ascii") as full:
                done = subprocess.run([TOOL, *arguments], stdout=full, stderr=subprocess.PIPE,
                                      check=False)
            self.assertEqual(done.returncode, FILE)
            self.assertEqual(done.stderr, b"orn-hdl: cannot write standard output: "
                                          b"No space left on device\n")


class ProgressDisplay(ToolTest):
    """The progress line of a replay on a terminal, fed line by line until the line is there."""

    LINES = 10_000  # the tool looks at its clock every some thousand lines

    def replay_until(self, done: Callable[[bytes, int], bool], *options: str) -> tuple[str, int]:
        """Feeds a replay until `done`, of what the terminal shows and the lines fed, and ends it with
        a line that fails. Returns what it shows in all, and the number of the last line."""
        terminal, standard_error = pty.openpty()
        os.set_blocking(terminal, False)
        shown, lines = b"", 0

        def read_terminal() -> bool:
            nonlocal shown
            try:
                while piece := os.read(terminal, 65536):
                    shown += piece
            except BlockingIOError:
                return True
            except OSError:  # the other side is closed
                pass
            return False

        with subprocess.Popen([TOOL, "run", "-", *options], stdin=subprocess.PIPE,
                              stderr=standard_error, cwd=self.folder,
                              env={**os.environ, "NO_COLOR": "1"}) as process:
            os.close(standard_error)
            assert process.stdin is not None
            while not done(shown, lines):
                process.stdin.write(b"\n" * self.LINES)
                process.stdin.flush()
                lines += self.LINES
                read_terminal()
            process.stdin.write(b"ADD\n")
            process.stdin.close()
            os.set_blocking(terminal, True)
            while read_terminal():
                pass
            self.assertEqual(process.wait(timeout=60), FAILED)
        os.close(terminal)
        return shown.decode(), lines + 1

    def test_shown_and_erased(self) -> None:
        def message(last: int) -> str:
            text = f"-:{last}: error: Command not find.\n{lone_add(last)}"
            return text.replace("\n", "\r\n")

        shown, last = self.replay_until(lambda shown, _: b" lines" in shown)
        self.assertRegex(shown, r"^orn-hdl: \d+ lines")
        self.assertTrue(shown.endswith(f"\r\033[K{message(last)}"), shown)
        # As many lines, and the time that they take, show nothing when asked for quiet.
        shown, last = self.replay_until(lambda _, lines: lines >= last, "--quiet")
        self.assertEqual(shown, message(last))


class Examples(ToolTest):
    def test_and_gate(self) -> None:
        self.expect(self.run_tool("run", EXAMPLES / "and2" / "and2.cmd", "--no-header",
                                  "--verilog", "o.v"), SUCCESS)
        self.assertEqual(self.read("o.v"), """\
`timescale 1ns / 1ps

module top(A,\x20
           Y);

    input [1:0] A;
   output Y;

   wire n1;

   AND2 U1 (.I0(A[0]),\x20
            .I1(n1),\x20
            .O(Y));
   // synthesis attribute LOC of U1 is "P1"
endmodule
""")

    def test_all_examples_replay(self) -> None:
        for commands in sorted(EXAMPLES.glob("*/*.cmd")):
            if commands.parent.name == "embed":  # uses commands of its own
                continue
            with self.subTest(commands.name):
                self.expect(self.run_tool("run", commands, "--verilog", "o.v", "--vhdl", "o.vhd"),
                            SUCCESS)


if __name__ == "__main__":
    unittest.main()

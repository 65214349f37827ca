"""Compressed files, by the extension .gz, and pipes."""

from __future__ import annotations

import gzip
import json
import shutil
import subprocess
import unittest

from support import FAILED, FILE, INVERTER, SUCCESS, TOOL, ToolTest, lone_add
from yosys_json import cell, design, port

DESIGN = design({"a": port("input", 2), "y": port("output", 3)},
                {"u": cell("INV", "io", I=[2], O=[3])})
VERILOG = "module INV(input I, output O); endmodule\nmodule top(input a, output y);\n" \
          "   INV u(.I(a), .O(y));\nendmodule\n"


class GzipTest(ToolTest):
    def pack(self, name: str, text: str) -> None:
        (self.folder / name).write_bytes(gzip.compress(text.encode("latin-1")))

    def unpack(self, name: str) -> str:
        return gzip.decompress((self.folder / name).read_bytes()).decode("latin-1")


class Reading(GzipTest):
    def expect_same(self, name: str, text: str, *command: str) -> None:
        """Expects the same of a file and of its compressed form."""
        self.write(name, text)
        self.pack(f"packed/{name}.gz", text)
        plain, packed = (self.run_tool(*[word.format(file) for word in command])
                         for file in (name, f"packed/{name}.gz"))
        self.assertEqual((packed.status, packed.out.replace(f"packed/{name}.gz", name)),
                         (plain.status, plain.out), packed.err)
        self.assertEqual(packed.err, plain.err.replace(name, f"packed/{name}.gz"))
        self.assertNotEqual(plain.out, "")

    def setUp(self) -> None:
        super().setUp()
        (self.folder / "packed").mkdir()

    def test_json(self) -> None:
        self.expect_same("d.json", json.dumps(DESIGN), "import", "{}", "--vhdl", "-", "--no-header")

    def test_verilog(self) -> None:
        self.expect_same("d.v", VERILOG, "import", "{}", "--top", "top", "--vhdl", "-",
                         "--no-header")

    def test_verilog_that_includes(self) -> None:
        """Files beside the netlist are found, and not those beside its contents."""
        self.write("packed/head.v", "wire n;\n")
        self.write("head.v", "wire n;\n")
        self.expect_same("d.v", 'module top(input a, output y);\n`include "head.v"\n'
                                "   INV u(.I(a), .O(n));\n   INV v(.I(n), .O(y));\nendmodule\n",
                         "import", "{}", "--vhdl", "-", "--no-header")

    def test_vhdl(self) -> None:
        self.write("d.cmd", INVERTER + "SUPPRESS CONFIGURATION\n")
        self.expect(self.run_tool("run", "d.cmd", "--vhdl", "d.vhd"), SUCCESS)
        self.expect_same("d.vhd", self.read("d.vhd"), "import", "{}", "--verilog", "-",
                         "--no-header")

    def test_commands(self) -> None:
        self.expect_same("d.cmd", INVERTER, "run", "{}", "--verilog", "-", "--no-header")
        self.expect_same("d.cmd", INVERTER, "check", "{}")
        self.pack("d.cmd.gz", INVERTER)
        outcome = self.run_tool("stats", "d.cmd.gz", "--format", "json")
        self.assertEqual((outcome.status, outcome.err), (SUCCESS, ""))
        self.assertIn('"d"', outcome.out)

    def test_libraries(self) -> None:
        self.write("d.json", json.dumps(DESIGN))
        self.write("net.v", "module top(input a, output y); INV u(.I(a), .O(y)); endmodule\n")
        library = "module INV(input I, output O); endmodule\n"
        self.expect_same("l.v", library, "import", "d.json", "-l", "{}", "--vhdl", "-",
                         "--no-header")
        self.expect_same("l.v", library, "import", "net.v", "-l", "{}", "--vhdl", "-",
                         "--no-header")

    def test_comparing(self) -> None:
        self.write("d.json", json.dumps(DESIGN))
        self.pack("d.v.gz", VERILOG.partition("\n")[2])
        outcome = self.run_tool("diff", "d.json", "d.v.gz")
        self.assertEqual(outcome.status, SUCCESS, outcome.err + outcome.out)

    def test_proof(self) -> None:
        self.pack("d.cmd.gz", INVERTER)
        self.expect(self.run_tool("run", "d.cmd.gz", "--verilog", "d.v.gz", "--verify"), SUCCESS)
        self.expect(self.run_tool("verify", "d.v.gz", "--commands", "d.cmd.gz"), SUCCESS)

    def test_place_in_a_compressed_file(self) -> None:
        self.pack("d.cmd.gz", "NOOP\nADD\n")
        self.expect(self.run_tool("run", "d.cmd.gz"), FAILED,
                    "d.cmd.gz:2: error: Command not find.\n" + lone_add(2))
        self.pack("d.v.gz", "module top(input a);\n   initial x = 1;\nendmodule\n")
        outcome = self.run_tool("import", "d.v.gz")
        self.assertEqual(outcome.status, FAILED)
        self.assertTrue(outcome.err.startswith("d.v.gz:2: error: "), outcome.err)
        self.assertNotIn("/dev/fd", outcome.err)

    def test_files_that_cannot_be_read(self) -> None:
        whole = gzip.compress(b"NOOP\n" * 100_000)
        for name, content, reason in (
                ("cut", whole[:-12], "the compressed file ends too early"),
                ("bad", whole[:20] + b"\xff\xff\xff" + whole[23:], "the compressed file is damaged"),
                ("missing", None, "No such file or directory")):
            for extension, command in ((".cmd.gz", "run"), (".json.gz", "import"),
                                       (".v.gz", "import")):
                file = f"{name}{extension}"
                if content is not None:
                    (self.folder / file).write_bytes(content)
                self.expect(self.run_tool(command, file), FILE,
                            f"orn-hdl: cannot read {file}: {reason}\n")


class Writing(GzipTest):
    def test_netlists_and_commands(self) -> None:
        self.write("d.json", json.dumps(DESIGN))
        plain, packed = (self.run_tool("import", "d.json", "--verilog", f"d.v{end}", "--vhdl",
                                       f"d.vhd{end}", "-o", f"d.cmd{end}", "--name-map",
                                       f"d.map{end}", "--no-header") for end in ("", ".gz"))
        self.expect(plain, SUCCESS)
        self.expect(packed, SUCCESS)
        for name in ("d.v", "d.vhd", "d.cmd", "d.map"):
            self.assertEqual(self.unpack(f"{name}.gz"), self.read(name))

    def test_same_text_gives_the_same_bytes(self) -> None:
        self.write("d.cmd", INVERTER)
        for name in ("a.v.gz", "b.v.gz"):
            self.expect(self.run_tool("run", "d.cmd", "--verilog", name, "--no-header"), SUCCESS)
        self.assertEqual(*((self.folder / name).read_bytes() for name in ("a.v.gz", "b.v.gz")))

    def test_several_designs(self) -> None:
        self.write("a.cmd", INVERTER)
        self.write("b.cmd", INVERTER)
        outcome = self.run_tool("run", "a.cmd", "b.cmd", "--vhdl", "-", "--no-header")
        self.expect(self.run_tool("run", "a.cmd", "b.cmd", "--vhdl", "d.vhd.gz", "--no-header",
                                  "--verify"), SUCCESS)
        self.assertEqual(self.unpack("d.vhd.gz"), outcome.out)

    def test_file_that_cannot_be_written(self) -> None:
        self.write("d.cmd", INVERTER)
        for option in ("--verilog", "--output-commands"):
            self.expect(self.run_tool("run", "d.cmd", option, "none/d.gz"), FILE,
                        "orn-hdl: cannot write none/d.gz: No such file or directory\n")

    def test_long_file(self) -> None:
        self.pack("d.cmd.gz", INVERTER + "".join(f"ADD SIGNAL s{i}\n" for i in range(20_000)))
        self.expect(self.run_tool("run", "d.cmd.gz", "--verilog", "d.v.gz", "--no-warn", "all"),
                    SUCCESS)
        self.assertEqual(self.unpack("d.v.gz").count("wire s"), 20_000)


class Pipes(GzipTest):
    def test_json_from_standard_input(self) -> None:
        outcome = self.run_tool("import", "-", "--vhdl", "-", stdin=json.dumps(DESIGN))
        self.assertEqual((outcome.status, outcome.err), (SUCCESS, ""))
        self.assertIn("entity top is", outcome.out)

    @unittest.skipIf(shutil.which("yosys") is None, "yosys is not installed")
    def test_yosys_before_the_tool(self) -> None:
        self.write("rtl.v", "module low(input a, output y); assign y = ~a; endmodule\n"
                            "module top(input a, output y); low u(.a(a), .y(y)); endmodule\n")
        done = subprocess.run(
            'yosys -q -p "read_verilog rtl.v; synth -top top; write_json /dev/stdout" | '
            f"{TOOL} import - --vhdl - --no-header", shell=True, cwd=self.folder, text=True,
            capture_output=True, timeout=60, check=False)
        self.assertEqual(done.returncode, 0, done.stderr)
        self.assertEqual([line for line in done.stdout.splitlines() if line.startswith("entity")],
                         ["entity low is", "entity top is"])


if __name__ == "__main__":
    unittest.main()

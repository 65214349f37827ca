"""Files that are read and written."""

from __future__ import annotations

import io
import json
import os
import subprocess
import sys
from pathlib import Path

import orn_hdl
import pytest
from support import TOOL, half_adder

CELLS = """\
module AND2(input I0, input I1, output O); endmodule
module XOR2(input I0, input I1, output O); endmodule
"""

JSON = {
    "modules": {"half": {
        "attributes": {"top": "1"},
        "ports": {"A": {"direction": "input", "bits": [2]}, "Y": {"direction": "output", "bits": [3]}},
        "cells": {"u1": {"type": "INV", "parameters": {}, "attributes": {},
                         "port_directions": {"I": "input", "O": "output"},
                         "connections": {"I": [2], "O": [3]}}},
        "netnames": {"A": {"bits": [2], "attributes": {}}, "Y": {"bits": [3], "attributes": {}}}}}}


def test_texts_and_files_are_the_same(tmp_path: Path) -> None:
    d = half_adder()
    for write, text, name in ((d.write_verilog, d.to_verilog, "half.v"),
                              (d.write_vhdl, d.to_vhdl, "half.vhd")):
        path = tmp_path / name
        write(path, header=False)
        expected = path.read_text()
        assert "half" in expected and text() == expected
        into_text, into_bytes = io.StringIO(), io.BytesIO()
        write(into_text, header=False)
        write(into_bytes, header=False)
        assert into_text.getvalue() == expected == into_bytes.getvalue().decode()
        write(str(path), append=True, header=False)
        assert path.read_text() == expected * 2
        assert text(header=True).endswith(expected) and len(text(header=True)) > len(expected)


def test_long_lines_are_broken_in_texts_too() -> None:
    d = orn_hdl.Design("top")
    c = d.component("C", D=("in", 40))
    bus = d.port("A_LONG_NAME_OF_A_BUS", "in", 64)
    d.instance("U", c, D=[bus[i] for i in range(40)])
    assert max(map(len, d.to_verilog().splitlines())) < 200


def test_reading_verilog_and_vhdl(tmp_path: Path) -> None:
    d = half_adder()
    (tmp_path / "cells.v").write_text(CELLS)
    d.write_verilog(tmp_path / "half.v", header=False)
    d.write_vhdl(tmp_path / "half.vhd", header=False)
    for read, name, options in (("read_verilog", "half.v", {"libraries": [tmp_path / "cells.v"]}),
                                ("read_verilog", "half.v", {"infer": True}),
                                ("read_vhdl", "half.vhd", {})):
        again = orn_hdl.Design("other")
        assert getattr(again, read)(tmp_path / name, **options) == {}
        assert again.name == "half" and sorted(again.connections()) == sorted(d.connections())
    escaped = tmp_path / "escaped.v"
    escaped.write_text("module top(input \\a.b , output y);\n`C u1(.I(\\a.b ), .O(y));\nendmodule\n"
                       "module INV(input I, output O); endmodule\n")
    again = orn_hdl.Design()
    assert list(again.read_verilog(escaped, top="top", macros={"C": "INV"})) == ["a.b"]
    assert again.read_verilog(escaped, top="top", macros={"C": "INV"}, literal_names=True) == {}
    assert [port.name for port in again.ports] == ["a.b", "y"]


def test_importing_json(tmp_path: Path) -> None:
    path = tmp_path / "half.json"
    path.write_text(json.dumps(JSON))
    d = orn_hdl.Design("before")
    old = d.net("OLD")
    d.import_json(path)
    assert d.name == "half" and list(d.connections()) == [("A", "u1", "I"), ("Y", "u1", "O")]
    with pytest.raises(orn_hdl.DeletedError):
        old.width
    u1 = d["u1"]
    path.write_text("{")
    with pytest.raises(orn_hdl.NetlistError, match="half.json"):
        d.import_json(path)
    assert u1.component.name == "INV", "the design stays as it was"


def test_dont_cares(tmp_path: Path) -> None:
    path = tmp_path / "x.json"
    path.write_text('{"modules": {"top": {"ports": {"y": {"direction": "output", "bits": ["x", "1"]}}, "cells": {}}}}')
    d = orn_hdl.Design("top")
    with pytest.raises(orn_hdl.NetlistError, match="the value x"):
        d.import_json(path)
    d.import_json(path, x_as="-")
    assert d.options.dont_cares
    assert "assign y = 2'b1x;" in d.to_verilog() and '<= "1-";' in d.to_vhdl()
    for read, text, name in (("read_verilog", d.to_verilog(), "x.v"), ("read_vhdl", d.to_vhdl(), "x.vhd")):
        (tmp_path / name).write_text(text)
        other = orn_hdl.Design("other")
        with pytest.raises(orn_hdl.NetlistError):
            getattr(other, read)(tmp_path / name)
        assert not other.options.dont_cares
        getattr(other, read)(tmp_path / name, dont_cares=True)
        assert other.options.dont_cares and other.to_verilog() == d.to_verilog()


def test_without_the_tool(tmp_path: Path, monkeypatch: pytest.MonkeyPatch) -> None:
    monkeypatch.delenv("ORN_HDL_TOOL", raising=False)
    monkeypatch.setenv("PATH", str(tmp_path))
    if orn_hdl.find_tool() is not None:
        pytest.skip("the package has a tool of its own")
    with pytest.raises(FileNotFoundError):
        half_adder().import_json("x.json")


@pytest.mark.skipif("ASAN_OPTIONS" in os.environ, reason="the interpreter needs the sanitizer's library, and the "
                    "tool that takes its place must not have it")
def test_the_tool_by_the_package(tmp_path: Path) -> None:
    arguments = ["commands", "ADD", "INSTANCE"]
    by_tool = subprocess.run([TOOL, *arguments], cwd=tmp_path, capture_output=True, check=True)
    by_package = subprocess.run([sys.executable, "-m", "orn_hdl", *arguments], cwd=tmp_path, capture_output=True,
                                check=True)
    assert by_package.stdout == by_tool.stdout and b"ADD INSTANCE" in by_tool.stdout
    failed = subprocess.run([sys.executable, "-m", "orn_hdl", "run"], capture_output=True, check=False)
    assert failed.returncode == 2


def test_commands_as_a_file(tmp_path: Path) -> None:
    d = half_adder()
    d.write_commands(tmp_path / "half.cmd")
    assert (tmp_path / "half.cmd").read_text() == d.commands()
    again = orn_hdl.Design()
    again.read_commands(tmp_path / "half.cmd")
    assert again.commands() == d.commands() and again.name == "half"


def test_check_and_verify(tmp_path: Path) -> None:
    d = half_adder()
    assert not any(finding.is_error for finding in d.check()) and d.find_illegal() == []
    assert {finding.rule for finding in d.check()} == {"missing-configuration"}
    d.net("wire")
    (finding,) = [f for f in d.check("verilog-2005") if f.is_error]
    assert "wire" in finding.message and finding.targets == ["verilog-2005"] and finding.rule in str(finding)
    d["wire"].remove()
    d.write_verilog(tmp_path / "half.v")
    d.write_vhdl(tmp_path / "half.vhd")
    assert d.verify_verilog(tmp_path / "half.v") == [] == d.verify_vhdl(tmp_path / "half.vhd")
    text = (tmp_path / "half.v").read_text()
    (tmp_path / "half.v").write_text(text.replace(".I0(A)", ".I0(B)", 1))
    (difference,) = d.verify_verilog(tmp_path / "half.v")
    assert difference.line == text[:text.index(".I0(A)")].count("\n") + 1 and ".I0(B)" in difference.source


def test_legal_netlists(tmp_path: Path) -> None:
    d = half_adder()
    d["U1"].name = "begin"
    d.options.legal = True
    d.write_verilog(tmp_path / "half.v", header=False)
    assert " begin " not in (tmp_path / "half.v").read_text()
    assert d.verify_verilog(tmp_path / "half.v") == [] and d["begin"].name == "begin"
    assert not d.options.verify

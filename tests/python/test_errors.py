"""Every failure is an exception that says what, in which command, in which line."""

from __future__ import annotations

from pathlib import Path
from typing import Type

import orn_hdl
import pytest
from support import half_adder


@pytest.mark.parametrize("line, error, also", [
    ("ADD COMPONENT AND2", orn_hdl.NameTakenError, ValueError),
    ("ADD PIN AND2 O out", orn_hdl.NameTakenError, ValueError),
    ("ADD INSTANCE NONE U9", orn_hdl.NotFoundError, KeyError),
    ("CONNECT SIGNAL A U1.X", orn_hdl.NotFoundError, LookupError),
    ("ADD PORT P sideways", orn_hdl.CommandSyntaxError, ValueError),
    ("ADD NOTHING", orn_hdl.CommandSyntaxError, ValueError),
    ("ADD PORT", orn_hdl.CommandSyntaxError, ValueError),
    ("ADD MODULE ATTRIBUTE -TYPE=Complex X 1", orn_hdl.Error, Exception),
])
def test_commands(line: str, error: Type[orn_hdl.Error], also: Type[Exception]) -> None:
    d = half_adder()
    before = d.commands()
    with pytest.raises(error) as raised:
        d.execute(line)
    assert isinstance(raised.value, also) and isinstance(raised.value, orn_hdl.Error)
    assert raised.value.command == line and raised.value.file is None and raised.value.line is None
    assert raised.value.text and not raised.value.text.endswith("\n")
    assert str(raised.value) == f"{raised.value.text} [{line}]"
    assert d.commands() == before


def test_a_line_of_a_file(tmp_path: Path) -> None:
    path = tmp_path / "bad.cmd"
    path.write_text("ADD COMPONENT C\n\nADD INSTANCE D U1\nADD COMPONENT E\n")
    d = orn_hdl.Design()
    with pytest.raises(orn_hdl.NotFoundError) as raised:
        d.read_commands(path)
    assert (raised.value.file, raised.value.line, raised.value.command) == (
        str(path), 3, "ADD INSTANCE D U1")
    assert str(raised.value) == f'{path}:3: Component "D" not found. [ADD INSTANCE D U1]'
    assert [c.name for c in d.components] == ["C"]


def test_files_that_cannot_be_opened(tmp_path: Path) -> None:
    d = half_adder()
    missing = tmp_path / "missing" / "file"
    with pytest.raises(FileNotFoundError) as raised:
        d.read_commands(missing)
    assert raised.value.filename == str(missing)
    for write in (d.write_verilog, d.write_vhdl, d.write_commands):
        with pytest.raises(FileNotFoundError):
            write(missing)
    with pytest.raises(orn_hdl.NetlistError):
        d.read_verilog(missing)
    with pytest.raises(orn_hdl.Error):
        d.verify_verilog(missing)


def test_a_netlist_with_a_mistake(tmp_path: Path) -> None:
    path = tmp_path / "bad.v"
    path.write_text("module top(input a);\n  INV u1(.I(a);\nendmodule\n")
    d = half_adder()
    u1 = d["U1"]
    with pytest.raises(orn_hdl.NetlistError) as raised:
        d.read_verilog(path)
    assert (raised.value.file, raised.value.line) == (str(path), 2) and raised.value.column
    assert str(raised.value).startswith(f"{path}:2:")
    assert u1.name == "U1", "the design stays as it was"


def test_what_commands_cannot_express() -> None:
    d = half_adder()
    d["AND2"].remove()
    with pytest.raises(orn_hdl.InexpressibleError):
        d.commands()


def test_no_legal_netlist(tmp_path: Path) -> None:
    d = half_adder()
    d["U2"]["O"].net = d["C"]
    d.options.legal = True
    assert d.find_illegal()
    with pytest.raises(orn_hdl.LegalError):
        d.write_verilog(tmp_path / "illegal.v")
    assert not (tmp_path / "illegal.v").exists()


def test_a_proof_that_fails(tmp_path: Path) -> None:
    d = orn_hdl.Design("top")
    d.port("D", "out", 4)
    d.tie("D", "1010")
    d.options.verify = True
    with pytest.raises(orn_hdl.ProofError) as raised:
        d.write_verilog(tmp_path / "wrong.v")
    assert raised.value.differences and raised.value.differences[0].line > 0
    assert raised.value.differences[0].message
    assert not (tmp_path / "wrong.v").exists()


def test_wrong_arguments() -> None:
    d = half_adder()
    for call in (lambda: d._native.connect("A"), lambda: d._native.pins("x", "U1"),
                 lambda: d._native.pins(99, "U1"), lambda: d.add_instances(7, "AND2"),
                 lambda: d.check("no-such-tool"), lambda: d.execute(b"NOOP")):
        with pytest.raises((TypeError, ValueError)):
            call()

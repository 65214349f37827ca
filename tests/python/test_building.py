"""Building a design by calls gives the netlists that the commands give."""

from __future__ import annotations

from pathlib import Path

import orn_hdl
import pytest
from support import half_adder, replay, written

HALF_ADDER = """\
SET NETLIST NAME half
ADD PORT A in
ADD PORT B in
ADD COMPONENT AND2
ADD PIN AND2 I0 in
ADD PIN AND2 I1 in
ADD PIN AND2 O out
ADD COMPONENT XOR2
ADD PIN XOR2 I0 in
ADD PIN XOR2 I1 in
ADD PIN XOR2 O out
ADD PORT C out
ADD INSTANCE AND2 U1
CONNECT SIGNAL A U1.I0
CONNECT SIGNAL B U1.I1
CONNECT SIGNAL C U1.O
ADD PORT S out
ADD INSTANCE XOR2 U2
CONNECT SIGNAL A U2.I0
CONNECT SIGNAL B U2.I1
CONNECT SIGNAL S U2.O
"""

REGISTERS = """\
ADD COMPONENT REG4
ADD PIN REG4 CLK in
ADD PIN REG4 D(3:0) in
ADD PIN REG4 Q(3:0) out
ADD PORT CLK in
ADD PORT D(7:0) in
ADD PORT Q(0:7) out
ADD SIGNAL N(3:0)
ADD INSTANCE REG4 low
CONNECT SIGNAL CLK low.CLK
CONNECT SIGNAL D(3:0) low.D(3:0)
CONNECT SIGNAL Q(4:7) low.Q(3:0)
ADD INSTANCE REG4 high
CONNECT SIGNAL D(7),D(6),N(1:0) high.D(3:0)
CONNECT SIGNAL N(3:0) high.Q(3:0)
ASSIGN CONSTANT high.CLK 1
CONNECT SIGNAL Q(0:3) D(7:4)
ASSIGN CONSTANT N(3:2) 2:B:10
ADD INSTANCE ATTRIBUTE low INIT 7
ADD COMPONENT ATTRIBUTE REG4 -TYPE=Boolean KEEP true
SET COMPONENT ATTRIBUTE OPTION REG4 KEEP -SYNATTR=ASSIGN
ADD SIGNAL COMMENT CLK 'the clock'
"""


def registers() -> orn_hdl.Design:
    d = orn_hdl.Design("top")
    reg4 = d.component("REG4", CLK="in", D=("in", 4), Q=("out", (3, 0)))
    clock, data, q = d.port("CLK", "in"), d.port("D", "in", 8), d.port("Q", "output", (0, 7))
    n = d.net("N", 4)
    d.instance("low", reg4, CLK=clock, D=data[3:0], Q=q[4:7])
    high = d.instance("high", reg4, D=[data[7], data[6], n[1:0]])
    high["Q"].net = "N"
    high["CLK"].net = 1
    q[0:3].assign(data[7:4])
    n[3:2].constant = orn_hdl.Constant("2:B:10")
    d["low"].attributes["INIT"] = "7"
    reg4.set_attribute("KEEP", True, synthesis="ASSIGN")
    clock.add_comment("the clock")
    return d


def test_calls_equal_commands(tmp_path: Path) -> None:
    assert written(half_adder(), tmp_path) == replay(tmp_path, HALF_ADDER)
    assert written(registers(), tmp_path) == replay(tmp_path, REGISTERS)


def test_own_commands_give_the_same(tmp_path: Path) -> None:
    d = registers()
    again = orn_hdl.Design("top")
    for line in d.commands().splitlines():
        again.execute(line)
    assert again.commands() == d.commands()
    assert written(again, tmp_path) == written(d, tmp_path)


def test_many_ways_to_connect() -> None:
    d = half_adder()
    u3 = d.instance("U3", "AND2")
    u3["I0"].net = d["A"]
    u3["I1"].connect("N1")
    d.connect(d["N1"], u3["O"])
    assert [pin.net for pin in u3] == [d["A"], d["N1"], d["N1"]]
    u3["O"].net = None
    assert u3["O"].net is None and u3["I1"].net == d["N1"]
    d["N1"].connect(u3["O"])
    assert d["N1"].pins == [u3["I1"], u3["O"]]
    u3.connect(I0=0, I1=orn_hdl.Constant("1"))
    assert u3["I0"].net.constant == "0" and u3["I1"].net.constant == "1"


def test_a_net_of_another_design_is_refused() -> None:
    d, other = half_adder(), half_adder()
    with pytest.raises(ValueError, match="another design"):
        d["U1"]["I0"].connect(other["A"])
    assert d["U1"]["I0"].net == d["A"]


def test_widths() -> None:
    d = orn_hdl.Design()
    assert d.port("A", "in", 1).full_name == "A(0:0)"
    assert d.port("B", "inout", (0, 3)).full_name == "B(0:3)"
    assert d.net("C(5:2)").width == 4
    with pytest.raises(ValueError):
        d.port("D", "in", 0)
    assert "D" not in d


def test_renaming() -> None:
    d = registers()
    d["low"].name = "first"
    d["REG4"].name = "REGISTER"
    bus = d["N"]
    part = bus[3:2]
    bus.name = "M"
    assert bus.full_name == "M(3:0)" and d["M"] == bus and "N" not in d
    with pytest.raises(orn_hdl.DeletedError):
        part.constant
    assert d["first"].component.name == "REGISTER"
    with pytest.raises(orn_hdl.NameTakenError):
        d["first"].name = "high"
    assert d["first"].name == "first"


def test_direction_makes_a_port() -> None:
    d = orn_hdl.Design()
    n = d.net("N")
    assert not n.is_port and n not in d.ports
    n.direction = "out"
    assert n.direction == "output" and n in d.ports and len(d.ports) == 1
    n.direction = None
    assert n.direction is None and len(d.ports) == 0
    with pytest.raises(orn_hdl.InvalidValueError):
        n.direction = "sideways"


def test_texts_are_any_bytes(tmp_path: Path) -> None:
    (tmp_path / "latin.cmd").write_bytes(b"ADD COMPONENT C\nADD INSTANCE C U\xe9\n")
    d = orn_hdl.Design()
    d.read_commands(tmp_path / "latin.cmd")
    (u,) = d.instances
    assert u.name == "U\udce9" and u in d.instances
    d.add_instances(["Ünder"], "C")
    d.write_verilog(tmp_path / "latin.v", header=False)
    data = (tmp_path / "latin.v").read_bytes()
    assert b"C U\xe9 " in data and "C Ünder ".encode() in data
    for wrong in ("a\0b", 7, None):
        with pytest.raises((TypeError, ValueError)):
            d.instance(wrong, "C")  # type: ignore[arg-type]

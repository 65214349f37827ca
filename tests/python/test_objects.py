"""What objects tell of a design."""

from __future__ import annotations

import orn_hdl
import pytest
from support import half_adder


def test_collections() -> None:
    d = half_adder()
    assert [c.name for c in d.components] == ["AND2", "XOR2"]
    assert [u.name for u in d.instances] == ["U1", "U2"]
    assert [n.name for n in d.nets] == ["A", "B", "C", "S"] == [n.name for n in d.ports]
    assert len(d.components) == 2 and len(d.instances) == 2 and len(d.ports) == 4
    assert d.counts() == (2, 2, 4, 4, 6, 6)
    assert "U1" in d.instances and d["U1"] in d.instances and "A" not in d.instances
    assert d.instances.get("U9") is None
    assert repr(d.ports) == "<4 ports>"
    with pytest.raises(KeyError, match="U9"):
        d.instances["U9"]


def test_names_ignore_letter_case() -> None:
    d = half_adder()
    assert d["u1"] == d["U1"] and hash(d["u1"]) == hash(d["U1"]) and d["u1"].name == "U1"
    assert d["U1"] != d["U2"] and d["U1"] != half_adder()["U1"]
    assert {d["a"], d["A"]} == {d["A"]}


def test_pins() -> None:
    d = half_adder()
    u1 = d["U1"]
    assert [(pin.name, pin.direction, pin.width) for pin in u1] == [
        ("I0", "input", 1), ("I1", "input", 1), ("O", "output", 1)]
    assert u1.component == d["AND2"] and d["AND2"].instances == [u1]
    assert u1.connections == {"I0": d["A"], "I1": d["B"], "O": d["C"]}
    assert u1["O"].owner == u1 and "O" in u1 and "X" not in u1
    assert d["A"].pins == [d["U1"]["I0"], d["U2"]["I0"]]
    with pytest.raises(KeyError):
        u1["X"]
    with pytest.raises(TypeError):
        d["AND2"]["O"].connect(d["A"])


def test_pin_with_a_range_and_a_default() -> None:
    d = orn_hdl.Design()
    c = d.component("C", D=("in", 8))
    c.pin("E", "in", default="1")
    assert c["D"].name == "D(7:0)" == c["d[7:0]"].name and c["D"].width == 8
    assert c["E"].default == "1" and c["D"].default == ""


def test_buses() -> None:
    d = orn_hdl.Design()
    bus = d.port("D", "in", 8)
    assert (bus.name, bus.full_name, bus.width, len(bus), bus.left, bus.right) == (
        "D", "D(7:0)", 8, 8, 7, 0)
    assert d["D"] == bus == d["D(7:0)"] == bus[:] == bus[7:0]
    assert bus[3:0].name == "D(3:0)" and bus[3:0].width == 4 and bus[:4].name == "D(7:4)"
    assert bus[2].name == "D(2)" and bus[2].index == 2 and bus[2].bus == bus
    assert (bus[6:5].left, bus[6:5].right) == (6, 5)
    assert [bit.index for bit in bus] == [7, 6, 5, 4, 3, 2, 1, 0]
    assert bus[2].direction == "input" and bus[3] in bus and bus[2] == bus[2]
    for wrong in (8, -1, slice(8, 0), slice(0, 3), slice(7, 0, 2)):
        with pytest.raises(IndexError):
            bus[wrong]
    assert bus.parts == [], "looking at a bit does not make one"
    assert bus[1].pins == [] and bus[1].constant is None and bus[1].aliases == []
    ascending = d.net("E", (4, 7))
    assert ascending[5:6].name == "E(5:6)" and [bit.index for bit in ascending] == [4, 5, 6, 7]


def test_parts_and_concatenations() -> None:
    d = orn_hdl.Design()
    bus = d.port("D", "in", 8)
    c = d.component("C", D=("in", 3))
    u = d.instance("U", c, D=[bus[7], bus[1:0]])
    compound = u["D"].net
    assert isinstance(compound, orn_hdl.Compound) and compound.width == 3
    assert compound.members == [bus[7], bus[1:0]] == bus.parts
    assert [type(n).__name__ for n in compound.members] == ["Bit", "Slice"]
    assert [n.name for n in d.nets] == ["D"]


def test_a_bus_that_is_widened_stays_the_bus() -> None:
    d = orn_hdl.Design()
    u = d.instance("U", d.component("C", J=("in", 4)), J="N(3:0)")
    bus = d["N"]
    assert bus.full_name == "N(3:0)"
    d.instance("V", d.component("W", J=("in", 10)), J="N(9:0)")
    assert bus.full_name == "N(9:0)" and u["J"].net == bus[3:0] and bus.parts


def test_aliases_and_constants() -> None:
    d = half_adder()
    n = d.net("N")
    n.assign(d["C"])
    d.assign(n, "S")
    assert n.aliases == [d["C"], d["S"]]
    n.unassign(d["C"])
    assert n.aliases == [d["S"]]
    assert n.constant is None
    n.constant = "4:H:A"
    assert n.constant == "4:H:A"
    d.tie("M", 1)
    assert d["M"].constant == "1"


def test_attributes() -> None:
    d = half_adder()
    for holder in (d, d["AND2"], d["U1"], d["A"], d["U1"]["O"], d["AND2"]["O"]):
        assert len(holder.attributes) == 0
        init = holder.set_attribute("INIT", "8:H:A5", "BitVector", generic="SYN")
        assert (init.name, init.type, init.value, init.generic, init.synthesis) == (
            "INIT", "BitVector", "8:H:A5", "SYN", "NONE")
        holder.attributes["COUNT"] = 3
        holder.attributes["KEEP"] = True
        assert [(a.name, a.type, a.value) for a in holder.attributes.values()][1:] == [
            ("COUNT", "Integer", "3"), ("KEEP", "Boolean", "TRUE")]
        init.value = "8:H:FF"
        init.synthesis = "ASSIGN"
        assert holder.attributes["init"].value == "8:H:FF" and init.synthesis == "ASSIGN"
        with pytest.raises(orn_hdl.InvalidValueError):
            init.generic = "PERHAPS"
        with pytest.raises(orn_hdl.InvalidValueError):
            init.user_type = "T"
        with pytest.raises(orn_hdl.InvalidValueError):
            holder.set_attribute("X", 1, "Complex")
        del holder.attributes["COUNT"]
        assert list(holder.attributes) == ["INIT", "KEEP"] and init.holder is holder
        with pytest.raises(KeyError):
            holder.attributes["COUNT"]
    user = d.set_attribute("T", "x", "User")
    user.user_type = "colour"
    assert user.user_type == "colour"


def test_comments() -> None:
    d = half_adder()
    for holder in (d, d["AND2"], d["U1"], d["A"], d["U1"]["O"]):
        assert holder.comment == ""
        holder.add_comment("one")
        holder.add_comment("two")
        assert holder.comment == "one\ntwo\n"


def test_options() -> None:
    options = half_adder().options
    assert options.use_default_library and not options.legal
    options.legal = True
    options.libraries = ["cells", "ieee2"]
    options.device = "xc1"
    options.synthesis = "synopsys"
    options.net_case = "upper"
    assert options.legal and options.libraries == ["cells", "ieee2"] and options.device == "xc1"
    assert options.synthesis == "SYNOPSYS"
    assert options.threads == 1
    options.threads = 2
    assert options.threads == 2
    assert (options.net_case, options.instance_case, options.component_case) == ("upper", "keep", "keep")
    for name, value in (("synthesis", "NONE"), ("net_case", "mixed"), ("threads", -1)):
        with pytest.raises(ValueError):
            setattr(options, name, value)
    with pytest.raises(AttributeError):
        options.colour = "red"  # type: ignore[attr-defined]


def test_every_option_can_be_set() -> None:
    d = half_adder()
    for name in dir(type(d.options)):
        if name.startswith("_") or name == "synthesis" or name.endswith("_case"):
            continue
        value = getattr(d.options, name)
        other = {bool: not value, int: 2, str: "text", list: ["text"]}[type(value)]
        setattr(d.options, name, other)
        assert getattr(d.options, name) == other


def test_repr() -> None:
    d = half_adder()
    d.net("N", 2)
    assert [repr(x) for x in (d, d["U1"], d["AND2"], d["A"], d["N"], d["N"][1], d["N"], d["U1"]["O"])] == [
        "<Design half>", "<Instance U1>", "<Component AND2>", "<Net A>", "<Bus N(1:0)>", "<Bit N(1)>",
        "<Bus N(1:0)>", "<Pin U1.O>"]
    assert repr(orn_hdl.Constant(1)) == "Constant('1')"
    assert repr(d.set_attribute("K", 1)) == "<Attribute K of <Design half>>"


def test_engines() -> None:
    with orn_hdl.Engine() as engine:
        top = engine.design("top", "top.src")
        low = engine.design("low")
        assert list(engine) == [top, low] and engine["TOP"] is top and "low" in engine
        assert top.engine is engine and top.source_file == "top.src"
        with pytest.raises(orn_hdl.NameTakenError):
            engine.design("top")
        top.name = "renamed"
        assert engine["renamed"] is top and "top" not in engine
        engine.remove(top)
        low.close()
        assert len(engine) == 0 and not engine.is_closed
        with pytest.raises(orn_hdl.ClosedError):
            top.name
    with pytest.raises(orn_hdl.ClosedError):
        engine.design("late")
    assert repr(engine) == "<Engine, closed>" and repr(low) == "<Design, closed>"

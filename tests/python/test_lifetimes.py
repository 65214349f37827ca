"""Objects of Python outlive what they stand for, and then raise; nothing is kept longer than needed."""

from __future__ import annotations

import gc
import sys
import weakref
from pathlib import Path

import orn_hdl
import pytest
from support import half_adder


def test_removed_objects_raise() -> None:
    d = half_adder()
    u1, pin, a, and2 = d["U1"], d["U1"]["O"], d["A"], d["AND2"]
    component_pin = and2["I1"]
    init = u1.set_attribute("INIT", 1)
    u1.remove()
    for use in (lambda: u1.name, lambda: u1.pins, lambda: pin.net, lambda: pin.connect(a),
                lambda: init.value, lambda: u1.add_comment("x"), lambda: u1.remove(),
                lambda: setattr(u1, "name", "U7")):
        with pytest.raises(orn_hdl.DeletedError):
            use()
    assert repr(u1) == "<Instance U1>" and repr(pin) == "<Pin U1.O>"
    a.remove()
    with pytest.raises(ReferenceError):
        a.direction
    assert d["U2"]["I0"].net is None
    component_pin.remove()
    with pytest.raises(orn_hdl.DeletedError):
        component_pin.width
    assert [pin.name for pin in d["U2"]] == ["I0", "I1", "O"] and [p.name for p in and2] == ["I0", "O"]
    and2.remove()
    with pytest.raises(orn_hdl.DeletedError):
        and2.pins


def test_another_object_of_the_name_is_another_one() -> None:
    d = half_adder()
    old, old_pin = d["U1"], d["U1"]["O"]
    old_init = old.set_attribute("INIT", 1)
    old.remove()
    new = d.instance("U1", "XOR2")
    new.set_attribute("INIT", 2)
    assert new.component.name == "XOR2" and new["O"].net is None
    for use in (lambda: old.component, lambda: old_pin.net, lambda: old_init.value):
        with pytest.raises(orn_hdl.DeletedError):
            use()
    bus = d.net("N", 4)
    bit = bus[2]
    bus.remove()
    again = d.net("N", 8)
    with pytest.raises(orn_hdl.DeletedError):
        bus.width
    with pytest.raises(orn_hdl.DeletedError):
        bit.width
    assert again[2].width == 1


def test_removed_attributes_raise() -> None:
    d = half_adder()
    init = d["U1"].set_attribute("INIT", 1)
    del d["U1"].attributes["INIT"]
    with pytest.raises(orn_hdl.DeletedError):
        init.value
    d["U1"].attributes["INIT"] = 2
    with pytest.raises(orn_hdl.DeletedError):
        init.value = 3
    assert d["U1"].attributes["INIT"].value == "2"


def test_a_pin_of_an_instance_is_removed() -> None:
    d = half_adder()
    assert len(d["C"].pins) == 1
    pin = d["U1"]["O"]
    pin.remove()
    assert d["C"].pins == [] and [p.name for p in d["U1"]] == ["I0", "I1"]
    with pytest.raises(orn_hdl.DeletedError):
        pin.net


def test_pins_of_a_net_follow_changes() -> None:
    d = half_adder()
    a = d["A"]
    for i in range(50):
        d.instance(f"X{i}", "AND2", I0=a)
        assert len(a.pins) == 3 + i
        d.execute(f"ADD INSTANCE AND2 Y{i}")
        if i % 2:
            d[f"Y{i}"].connect(I0=a)
            assert a.pins[-1].owner == d[f"Y{i}"]
            d[f"Y{i}"].remove()
    d.add_instances([f"Z{i}" for i in range(10)], "AND2")
    d.connect_many("A", [f"Z{i}" for i in range(10)], "I1")
    assert {pin.owner.name for pin in a.pins} >= {"U1", "U2", "X49", "Z9"}


def test_a_design_that_is_read_replaces_all(tmp_path: Path) -> None:
    d = half_adder()
    d.write_verilog(tmp_path / "half.v")
    library = tmp_path / "cells.v"
    library.write_text("module AND2(input I0, I1, output O); endmodule\n"
                       "module XOR2(input I0, I1, output O); endmodule\n")
    u1, walk = d["U1"], iter(d.instances)
    next(walk)
    connections = d.connections()
    next(connections)
    assert d["A"].pins
    d.read_verilog(tmp_path / "half.v", libraries=[library])
    with pytest.raises(orn_hdl.DeletedError):
        u1.component
    with pytest.raises(orn_hdl.ChangedError):
        next(walk)
    with pytest.raises(orn_hdl.ChangedError):
        next(connections)
    assert d["U1"].component.name == "AND2" and [p.owner.name for p in d["A"].pins] == ["U1", "U2"]


def test_changes_during_iterations() -> None:
    d = half_adder()
    seen = []
    for u in d.instances:
        seen.append(u.name)
        if len(seen) < 40:
            d.instance(f"V{len(seen)}", "AND2", I0="A")
        u.remove()
    assert seen[0] == "U1" and len(d.instances) < 40
    d = half_adder()
    for i, (net, instance, pin) in enumerate(d.connections()):
        d.to_vhdl()
        if instance in d:
            d[instance].remove()
    assert len(d.instances) == 0
    for net in d.nets:
        net.remove()
    assert len(d.nets) < 4


def test_closed_designs_raise() -> None:
    d = half_adder()
    objects = [d["U1"], d["A"], d["AND2"], d["U1"]["O"], d.set_attribute("K", 1)]
    walks = [iter(d.instances), d.connections(), iter(d.nets)]
    for walk in walks:
        next(walk)
    d.close()
    d.close()
    for thing in objects:
        repr(thing)
        with pytest.raises(orn_hdl.ClosedError):
            thing.name
    for walk in walks:
        with pytest.raises(orn_hdl.ClosedError):
            next(walk)
    for use in (lambda: d.name, lambda: d.execute("NOOP"), lambda: d.to_verilog(), lambda: d["A"],
                lambda: len(d.instances), lambda: d.options.legal, lambda: d.add_instances(["X"], "AND2")):
        with pytest.raises(orn_hdl.ClosedError):
            use()
    with half_adder() as other:
        u1 = other["U1"]
    with pytest.raises(orn_hdl.ClosedError):
        u1.name


def test_code_that_runs_in_between() -> None:
    """The rows of a column may come from code that works on the design, or ends it."""
    d = half_adder()

    def names():
        for i in range(5):
            d["U1" if i == 0 else f"V{i - 1}"].remove()
            yield f"V{i}"
        d.close()
        yield "V5"

    with pytest.raises(orn_hdl.ClosedError):
        d.add_instances(names(), "AND2")

    d = half_adder()

    def failing():
        yield "A"
        raise ZeroDivisionError

    with pytest.raises(ZeroDivisionError):
        d.connect_many(failing(), "U1", "I1")
    assert d["U1"]["I1"].net == d["A"]


def test_a_finalizer_cannot_work_on_the_design_meanwhile() -> None:
    d = half_adder()
    d.add_instances([f"X{i}" for i in range(2000)], "AND2")
    d.connect_many("A", [f"X{i}" for i in range(2000)], "I0")
    refused = []

    class Trap:
        def __init__(self) -> None:
            self.me = self

        def __del__(self) -> None:
            try:
                d["U1"].name
            except orn_hdl.BusyError:
                refused.append(True)

    threshold = gc.get_threshold()
    walk = iter(d.connections())
    next(walk)
    gc.disable()
    for _ in range(3):
        Trap()
    gc.set_threshold(1)
    gc.enable()
    try:
        # Nothing but the walk makes objects now, so the collector runs in it.
        for _ in walk:
            pass
    finally:
        gc.set_threshold(*threshold)
    assert refused or sys.version_info >= (3, 12), "the collector runs while the walk makes its items"
    assert sum(1 for _ in d.connections()) == 2006


def test_nothing_is_kept() -> None:
    gc.disable()
    try:
        d = half_adder()
        u1 = weakref.ref(d["U1"])
        assert u1() is None, "an object of Python is not kept"
        gone = weakref.ref(d)
        list(d.instances)
        d.commands()
        del d
        assert gone() is None, "a design goes with its last reference"
        d = half_adder()
        net = d["A"]
        gone = weakref.ref(d)
        del d
        assert gone() is not None and net.width == 1, "an object keeps its design"
    finally:
        gc.enable()


def test_objects_of_the_extension_alone() -> None:
    """What the package never does cannot crash either."""
    from orn_hdl import _orn_hdl
    engine = _orn_hdl.Engine()
    model = engine.create("top", "")
    with pytest.raises(TypeError):
        _orn_hdl.Model()
    with pytest.raises(TypeError):
        engine.remove(7)
    with pytest.raises(TypeError):
        engine.create("x")
    _orn_hdl.Engine().remove(model)
    walk = model.walk(2)
    del engine
    model.add_component("C")
    model.add_instance("U", "C")
    del model
    assert list(walk) == ["U"]
    assert list(walk) == []

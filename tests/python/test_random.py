"""Random designs that are built by calls write what the same commands write."""

from __future__ import annotations

import random
from pathlib import Path
from typing import List, Tuple

import orn_hdl
import pytest
from support import replay, written

DIRECTIONS = ("input", "output", "bidirectional")


class Twins:
    """A design that is built by calls, and the commands that do the same."""

    def __init__(self, seed: int) -> None:
        self.random = random.Random(seed)
        self.design = orn_hdl.Design("top")
        self.lines: List[str] = []
        self.pins: List[Tuple[str, str, int]] = []
        self.build()

    def say(self, line: str) -> None:
        self.lines.append(line)

    def build(self) -> None:
        for i in range(self.random.randint(1, 4)):
            self.add_component(f"C{i}")
        for i in range(self.random.randint(2, 6)):
            self.add_signal(f"S{i}", self.random.random() < 0.5)
        for i in range(self.random.randint(1, 12)):
            self.add_instance(f"U{i}")
        for _ in range(self.random.randint(5, 60)):
            self.random.choice([self.connect, self.connect, self.connect, self.tie, self.attribute,
                                self.comment, self.assign])()

    def add_component(self, name: str) -> None:
        component = self.design.component(name)
        self.say(f"ADD COMPONENT {name}")
        for i in range(self.random.randint(1, 5)):
            direction = self.random.choice(DIRECTIONS)
            width = self.random.choice([None, None, 4, (0, 3)])
            pin = component.pin(f"P{i}", direction, width)
            self.say(f"ADD PIN {name} {pin.name} {direction}")

    def add_signal(self, name: str, is_port: bool) -> None:
        width = self.random.choice([None, 4, 8, (0, 7)])
        full = orn_hdl.Design().net(name, width)
        full = full.full_name if isinstance(full, orn_hdl.Bus) else full.name
        if is_port:
            direction = self.random.choice(DIRECTIONS)
            self.design.port(name, direction, width)
            self.say(f"ADD PORT {full} {direction}")
        else:
            self.design.net(name, width)
            self.say(f"ADD SIGNAL {full}")

    def add_instance(self, name: str) -> None:
        component = self.random.choice(list(self.design.components))
        instance = self.design.instance(name, component)
        self.say(f"ADD INSTANCE {component.name} {name}")
        self.pins += [(name, pin.name, pin.width) for pin in instance]

    def net(self, width: int) -> Tuple[object, str]:
        """A net of a width, or a new one, as an object and as text."""
        nets = [net for net in self.design.nets if net.width >= width]
        if not nets or self.random.random() < 0.2:
            name = f"N{self.random.randint(0, 9)}"
            name = name if width == 1 else f"{name}_{width}({width - 1}:0)"
            return name, name
        net = self.random.choice(nets)
        if not isinstance(net, orn_hdl.Bus):
            return net, net.name
        step = -1 if net.left > net.right else 1
        first = net.left + step * self.random.randint(0, len(net) - width)
        part = net[first] if width == 1 else net[first:first + step * (width - 1)]
        return part, part.full_name if isinstance(part, orn_hdl.Bus) else part.name

    def connect(self) -> None:
        instance, pin, width = self.random.choice(self.pins)
        if width > 1 and self.random.random() < 0.3:
            members = [self.net(1) for _ in range(width)]
            net, text = [member for member, _ in members], ",".join(name for _, name in members)
        else:
            net, text = self.net(width)
        self.design[instance][pin].net = net
        self.say(f"CONNECT SIGNAL {text} {instance}.{pin}")

    def assign(self) -> None:
        width = self.random.choice([1, 1, 4])
        first, second = self.net(width), self.net(width)
        if first[1] != second[1]:
            self.design.assign(first[0], second[0])
            self.say(f"CONNECT SIGNAL {first[1]} {second[1]}")

    def tie(self) -> None:
        value = self.random.choice(["0", "1", "4:B:1010", "8:H:A5"])
        if self.random.random() < 0.5:
            instance, pin, _ = self.random.choice(self.pins)
            self.design[instance][pin].net = orn_hdl.Constant(value)
            self.say(f"ASSIGN CONSTANT {instance}.{pin} {value}")
        else:
            net, text = self.net(1)
            self.design.tie(net, value)
            self.say(f"ASSIGN CONSTANT {text} {value}")

    def holder(self) -> Tuple[orn_hdl.Holder, str]:
        kind = self.random.choice(["MODULE", "COMPONENT", "INSTANCE", "SIGNAL"])
        if kind == "MODULE":
            return self.design, "MODULE"
        holders = {"COMPONENT": self.design.components, "INSTANCE": self.design.instances,
                   "SIGNAL": self.design.nets}
        holder = self.random.choice(list(holders[kind]))
        return holder, f"{kind} {getattr(holder, 'full_name', holder.name)}"

    def attribute(self) -> None:
        holder, text = self.holder()
        kind, _, name = text.partition(" ")
        attribute = self.random.choice(["KEEP", "INIT", "LOC"])
        value, type = self.random.choice([(True, "Boolean"), (7, "Integer"), ("8:H:A5", "BitVector"),
                                          ("some", "String"), (1.5, "Float")])
        generic, synthesis = self.random.choice(["NONE", "SYN"]), self.random.choice(["NONE", "ASSIGN"])
        holder.set_attribute(attribute, value, type, generic=generic, synthesis=synthesis)
        spelled = str(value).lower() if isinstance(value, bool) else value
        self.say(f"ADD {kind} ATTRIBUTE {name} -TYPE={type} {attribute} {spelled}")
        self.say(f"SET {kind} ATTRIBUTE OPTION {name} {attribute} -GENERIC={generic} -SYNATTR={synthesis}")

    def comment(self) -> None:
        holder, text = self.holder()
        kind, _, name = text.partition(" ")
        holder.add_comment("a comment")
        self.say(f"ADD {kind} COMMENT {name} 'a comment'")


@pytest.mark.parametrize("seed", range(60))
def test_calls_write_what_commands_write(seed: int, tmp_path: Path) -> None:
    twins = Twins(seed)
    assert written(twins.design, tmp_path) == replay(tmp_path, "".join(line + "\n" for line in twins.lines))


@pytest.mark.parametrize("seed", range(20))
def test_its_own_connections_build_it_again(seed: int) -> None:
    """What the objects tell, built anew by the calls for many objects, has the same connections."""
    design = Twins(seed).design
    again = orn_hdl.Design("top")
    for component in design.components:
        copy = again.component(component.name)
        for pin in component:
            copy.pin(pin.name, pin.direction)
    for net in design.nets:
        name = net.full_name if isinstance(net, orn_hdl.Bus) else net.name
        again.port(name, net.direction) if net.is_port else again.net(name)
    again.add_instances([u.name for u in design.instances], [u.component.name for u in design.instances])
    rows = list(design.connections())
    if rows:
        again.connect_many(*zip(*rows))
    assert sorted(again.connections()) == sorted(rows)
    arrays = design.connection_arrays()
    assert rows == [(arrays.nets[n], arrays.instances[u], arrays.pins[p])
                    for n, u, p in zip(arrays.net, arrays.instance, arrays.pin)]
    nets = {pin.net for u in design.instances for pin in u if pin.net is not None}
    pairs = [(pin.owner.name, pin.name) for net in nets for pin in net.pins]
    # The signal of a constant at a pin does not list that pin.
    constants = {(instance, pin) for net, instance, pin in rows
                 if net.partition("(")[0] == f"{instance}_{pin.partition('(')[0]}_CONST_SIGNAL"}
    assert len(pairs) == len(set(pairs))
    assert set(pairs) | constants == {(instance, pin) for _, instance, pin in rows}

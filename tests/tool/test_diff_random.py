"""orn-hdl diff of random designs: equal to themselves in every format, a change is told as that change,
and designs whose internal names are all different are equal but for these names."""

from __future__ import annotations

import copy
import json
import random
import shutil
import subprocess
import sys
import unittest
from collections.abc import Callable
from dataclasses import dataclass, field
from pathlib import Path

from support import ToolTest

sys.path.insert(0, str(Path(__file__).resolve().parents[1] / "flow"))

from random_designs import Leaf, RandomDesign, random_leaves  # noqa: E402

EQUAL, DIFFERENT = 0, 1

COMPONENTS = {"INV": ["I:i", "O:o"], "AND2": ["A:i", "B:i", "O:o"],
              "DFF": ["C:i", "D:i", "E:i", "Q:o"], "MIX": ["S(1:0):i", "D(3:0):i", "O(1:0):o"]}


@dataclass
class Gates:
    """A design that is changed here. A net is a scalar signal or a bit of a bus."""

    instances: dict[str, str] = field(default_factory=dict)  # name to component
    # For each pin of an instance its nets, leftmost first, a constant, or None for an open one.
    pins: dict[tuple[str, str], list[str] | str | None] = field(default_factory=dict)
    signals: list[str] = field(default_factory=list)
    ties: dict[str, str] = field(default_factory=dict)
    aliases: list[tuple[str, str]] = field(default_factory=list)
    attributes: dict[str, str] = field(default_factory=dict)

    def commands(self) -> str:
        lines = ["SET NETLIST NAME top"]
        for component, pins in COMPONENTS.items():
            lines.append(f"ADD COMPONENT {component}")
            lines += [f"ADD PIN {component} {name} {'input' if way == 'i' else 'output'}"
                      for name, way in (pin.rsplit(":", 1) for pin in pins)]
        lines += ["ADD PORT clk input", "ADD PORT a(3:0) input", "ADD PORT y(3:0) output",
                  "ADD PORT z output"]
        lines += [f"ADD SIGNAL {signal}" for signal in self.signals]
        for name, component in self.instances.items():
            lines.append(f"ADD INSTANCE {component} {name}")
        for (instance, pin), nets in self.pins.items():
            if isinstance(nets, str):
                lines.append(f"ASSIGN CONSTANT {instance}.{pin} {nets}")
            elif nets:
                lines.append(f"CONNECT SIGNAL {','.join(nets)} {instance}.{pin}")
        lines += [f"ASSIGN CONSTANT {net} {value}" for net, value in self.ties.items()]
        lines += [f"CONNECT SIGNAL {target} {source}" for target, source in self.aliases]
        lines += [f"ADD INSTANCE ATTRIBUTE {instance} LOC {value}"
                  for instance, value in self.attributes.items()]
        return "\n".join(lines) + "\n"

    def internal(self) -> list[str]:
        """The nets of signals that are no ports."""
        return [net for signal in self.signals for net in bits(signal)]


def bits(signal: str) -> list[str]:
    if "(" not in signal:
        return [signal]
    base, indices = signal[:-1].split("(")
    left, right = map(int, indices.split(":"))
    return [f"{base}({index})" for index in range(left, right - 1, -1)]


def width(pin: str) -> int:
    return len(bits(pin))


def make(source: random.Random) -> Gates:
    """Gates that are driven by what was made before them."""
    design = Gates()
    ready = ["clk", *bits("a(3:0)")]
    for number in range(source.randint(5, 25)):
        component = source.choice(list(COMPONENTS))
        name = f"U{number}"
        design.instances[name] = component
        for pin, way in (pin.rsplit(":", 1) for pin in COMPONENTS[component]):
            if way == "o":
                signal = f"n{number}" + (f"({width(pin) - 1}:0)" if "(" in pin else "")
                design.signals.append(signal)
                design.pins[name, pin] = bits(signal)
                ready += bits(signal)
            elif source.random() < 0.1:
                design.pins[name, pin] = (f"{width(pin)}:B:" + "".join(
                    source.choices("01", k=width(pin))) if "(" in pin else source.choice("01"))
            else:
                design.pins[name, pin] = source.choices(ready[-12:] + ready[:5], k=width(pin))
    for number in range(source.randint(0, 3)):
        design.signals.append(f"tied{number}")
        design.ties[f"tied{number}"] = source.choice("01")
    for target in source.sample([*bits("y(3:0)"), "z"], 3):
        design.aliases.append((target, source.choice(ready)))
    for name in source.sample(sorted(design.instances), 3):
        design.attributes[name] = "P1"
    return design


# Changes of a design, and what has to be told of each: what changed, the kind of object, and the names.
Told = tuple[str, str, str, str]


def rename_instance(design: Gates, source: random.Random) -> Told:
    old = source.choice(sorted(design.instances))
    design.instances = {"other" if name == old else name: component
                        for name, component in design.instances.items()}
    design.pins = {("other" if instance == old else instance, pin): nets
                   for (instance, pin), nets in design.pins.items()}
    if old in design.attributes:
        design.attributes["other"] = design.attributes.pop(old)
    return "renamed", "instance", old, "other"


def renamed(net: str, old: str, new: str) -> str:
    base, bracket, index = net.partition("(")
    return (new if base == old else base) + bracket + index


def rename_net(design: Gates, source: random.Random) -> Told:
    signal = source.choice(design.signals)
    old = signal.partition("(")[0]
    rename_signals(design, {old: "other"})
    return "renamed", "signal", signal, renamed(signal, old, "other")


def rename_signals(design: Gates, names: dict[str, str]) -> None:
    def new_name(net: str) -> str:
        base = net.partition("(")[0]
        return renamed(net, base, names.get(base, base))

    design.signals = [new_name(signal) for signal in design.signals]
    design.pins = {place: [new_name(net) for net in nets] if isinstance(nets, list) else nets
                   for place, nets in design.pins.items()}
    design.ties = {new_name(net): value for net, value in design.ties.items()}
    design.aliases = [(new_name(target), new_name(origin)) for target, origin in design.aliases]


def wired_input(design: Gates, source: random.Random) -> tuple[str, str]:
    return source.choice([place for place, nets in design.pins.items()
                          if isinstance(nets, list) and place[1] not in ("O", "Q", "O(1:0)")])


def rewire(design: Gates, source: random.Random) -> Told:
    place = wired_input(design, source)
    nets = list(design.pins[place])
    at = source.randrange(len(nets))
    nets[at] = source.choice([net for net in [*design.internal(), "clk"] if net != nets[at]])
    design.pins[place] = nets
    return "rewired", "pin", ".".join(place), ".".join(place)


def open_pin(design: Gates, source: random.Random) -> Told:
    place = wired_input(design, source)
    design.pins[place] = None
    return "rewired", "pin", ".".join(place), ".".join(place)


def flip(digits: str) -> str:
    return digits[:-1] + ("0" if digits[-1] == "1" else "1")


def retie_pin(design: Gates, source: random.Random) -> Told:
    place = wired_input(design, source)
    design.pins[place] = "0" if "(" not in place[1] else f"{width(place[1])}:B:" + "0" * width(place[1])
    return "rewired", "pin", ".".join(place), ".".join(place)


def retie_signal(design: Gates, source: random.Random) -> Told | None:
    if not design.ties:
        return None
    net = source.choice(sorted(design.ties))
    design.ties[net] = flip(design.ties[net])
    return "retied", "signal", net, net


def add_instance(design: Gates, source: random.Random) -> Told:
    component = source.choice(list(COMPONENTS))
    design.instances["other"] = component
    for pin, way in (pin.rsplit(":", 1) for pin in COMPONENTS[component]):
        design.pins["other", pin] = source.choices(["clk", *design.internal()], k=width(pin)) \
            if way == "i" else None
    return "added", "instance", "", "other"


def remove_instance(design: Gates, source: random.Random) -> Told:
    name = source.choice(sorted(design.instances))
    del design.instances[name]
    design.pins = {place: nets for place, nets in design.pins.items() if place[0] != name}
    design.attributes.pop(name, None)
    return "removed", "instance", name, ""


def add_signal(design: Gates, source: random.Random) -> Told:
    signal = source.choice(["other", "other(4:0)"])
    design.signals.append(signal)
    return "added", "signal", "", signal


def remove_alias(design: Gates, source: random.Random) -> Told:
    alias = design.aliases.pop(source.randrange(len(design.aliases)))
    return "removed", "alias", " = ".join(alias), ""


def change_attribute(design: Gates, source: random.Random) -> Told:
    name = source.choice(sorted(design.attributes))
    design.attributes[name] = "P2"
    return "changed", "attribute", f"LOC of instance {name}", f"LOC of instance {name}"


CHANGES: list[Callable[[Gates, random.Random], Told | None]] = [
    rename_instance, rename_net, rewire, open_pin, retie_pin, retie_signal, add_instance,
    remove_instance, add_signal, remove_alias, change_attribute]


class RandomDiff(ToolTest):
    def diff(self, a: str, b: str, *options: str) -> list[Told]:
        self.write("a.cmd", a)
        self.write("b.cmd", b)
        outcome = self.run_tool("diff", "a.cmd", "b.cmd", "--format", "json", "--limit", "0", *options)
        self.assertEqual(outcome.err, "")
        found = json.loads(outcome.out)
        self.assertEqual(outcome.status, DIFFERENT if found["differences"] else EQUAL)
        self.assertEqual(sum(found["counts"].values()), len(found["differences"]))
        return [(each["change"], each["object"], each.get("a", {}).get("name", ""),
                 each.get("b", {}).get("name", "")) for each in found["differences"]]

    def test_one_change(self) -> None:
        for seed in range(110):
            source = random.Random(f"change {seed}")
            design = make(source)
            changed = copy.deepcopy(design)
            told = CHANGES[seed % len(CHANGES)](changed, source)
            if told is None:
                continue
            with self.subTest(seed=seed, change=told):
                self.assertEqual(self.diff(design.commands(), changed.commands()), [told])
                back = self.diff(changed.commands(), design.commands())
                opposite = {"added": "removed", "removed": "added"}
                self.assertEqual(back, [(opposite.get(told[0], told[0]), told[1], told[3], told[2])])

    def test_all_names_changed(self) -> None:
        for seed in range(40):
            source = random.Random(f"names {seed}")
            design = make(source)
            other = copy.deepcopy(design)
            numbers = source.sample(range(1000, 2000), len(design.instances) + len(design.signals))
            rename_signals(other, {signal.partition("(")[0]: f"x{numbers.pop()}"
                                   for signal in design.signals})
            names = {name: f"g{numbers.pop()}" for name in design.instances}
            other.instances = {names[name]: kind for name, kind in design.instances.items()}
            other.pins = {(names[name], pin): nets for (name, pin), nets in other.pins.items()}
            other.attributes = {names[name]: value for name, value in design.attributes.items()}
            order = list(other.instances.items())
            source.shuffle(order)
            other.instances = dict(order)
            with self.subTest(seed=seed):
                self.assertEqual(self.diff(design.commands(), other.commands(), "--ignore", "names"), [])
                found = self.diff(design.commands(), other.commands())
                self.assertEqual({change for change, *_ in found}, {"renamed"})
                self.assertEqual(len(found), len(design.instances) + len(design.signals))

    def test_names_exchanged(self) -> None:
        for seed in range(20):
            source = random.Random(f"exchanged {seed}")
            design = make(source)
            other = copy.deepcopy(design)
            names = source.sample(sorted(design.instances), len(design.instances))
            new = dict(zip(design.instances, names, strict=True))
            other.instances = {new[name]: kind for name, kind in design.instances.items()}
            other.pins = {(new[name], pin): nets for (name, pin), nets in design.pins.items()}
            other.attributes = {new[name]: value for name, value in design.attributes.items()}
            with self.subTest(seed=seed):
                self.assertEqual(self.diff(design.commands(), other.commands(), "--ignore", "names"), [])


def declare(leaf: Leaf) -> str:
    """A black box in Verilog."""
    ways = {"i": "input", "o": "output", "b": "inout"}
    ports = [ways[pin.direction] + (f" [{pin.left}:{pin.right}] " if pin.left is not None else " ") +
             pin.name for pin in leaf.pins]
    generics = ", ".join(f"parameter {name} = {len(digits)}'b{digits}"
                         for name, digits in leaf.generics.items())
    parameters = f"#({generics}) " if generics else ""
    return f"(* blackbox *)\nmodule {leaf.name} {parameters}({', '.join(ports)});\nendmodule\n"


class EveryFormat(ToolTest):
    """One design as commands, Verilog, VHDL and JSON is equal to itself."""

    # Import refuses some designs.
    REFUSED = "two inout ports share this bit"

    def files(self, seed: int) -> list[str]:
        leaves = random_leaves(random.Random(f"leaves {seed // 10}"))
        design = RandomDesign(f"d{seed}", seed, leaves)
        self.write("d.cmd", "\n".join(line for line in design.commands
                                      if not line.startswith("WRITE")) + "\n")
        self.write("leaves.v", "".join(map(declare, leaves)))
        self.expect(self.run_tool("run", "--quiet", "--no-warn", "all", "d.cmd", "--verilog", "d.v",
                                  "--vhdl", "d.vhd"), EQUAL)
        files = ["d.cmd", "d.v", "d.vhd"]
        if shutil.which("yosys") and seed % 5 == 0:
            subprocess.run(["yosys", "-q", "-p", f"read_verilog -lib leaves.v; read_verilog d.v; "
                            f"hierarchy -top {design.name}; write_json d.json"], cwd=self.folder,
                           check=True, capture_output=True)
            files.append("d.json")
        return files

    def test_all_pairs(self) -> None:
        for seed in range(1, 41):
            files = self.files(seed)
            for a in files:
                for b in files:
                    outcome = self.run_tool("diff", a, b, "-l", "leaves.v")
                    if self.REFUSED not in outcome.err:
                        with self.subTest(seed=seed, a=a, b=b):
                            self.expect(outcome, EQUAL, out="no differences\n")


if __name__ == "__main__":
    unittest.main()

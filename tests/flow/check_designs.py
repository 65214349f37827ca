"""Random command files for the check: small designs that are sound but for a few faults.

Each fault is a construct of the command language that some target minds, or nearly one. Few stand in
one design, so that none hides what another one does.
"""

from __future__ import annotations

import random
from collections.abc import Callable
from dataclasses import dataclass

VERILOG_WORDS = ("wire reg module and or buf table tri0 signed generate cell design instance use "
                 "logic bit int string class final do byte bool new package static unique0 "
                 "pulldown wand edge event force forkjoin config library automatic uwire").split()
VHDL_WORDS = ("signal Entity PORT map label group abs context default force parameter sequence "
              "out inout xnor units shared impure vunit protected process block bus").split()
ODD_NAMES = ["_a", "a_", "a__b", "A$1", "2x", "a b", "Ñu", "a.b", "a+b", "\\x ", "x'y", "é", "__",
             "a#", "n!", "BEHAVIORAL", "std_logic", "std_logic_vector", "string", "ieee", "work",
             "kestra", "CFG_X", "integer", "top", "X", "_", "int", "a" * 1023, "a" * 1024,
             "aB" * 600, "character", "true", "bit", "boolean", "open", "OPEN", "double", "TRUE"]
TEXTS = ["plain", 'a"b', "x*/y", "back\\slash", "end\\", "tab\there", "caf\xe9", "", "-- no",
         "// no", "/* no", "it's", "100%", "two words", "\\n", "\x01"]
TYPES = ["String", "Integer", "Float", "Boolean", "Bit", "BitVector", "User"]
VALUES = {"String": TEXTS, "Integer": ["0", "5", "-7", "2147483647", "-2147483648", "abc"],
          "Float": ["0.5", "-3.25", "5", "1e300", ".5"], "Boolean": ["true", "false", "yes"],
          "Bit": ["0", "1", "x"],
          "BitVector": ["8:H:A5", "4:B:1010", "6:O:17", "1010", "0001", "0", "1", "0110100110010110",
                        "8:H:AX", "4:H:A5", "0:B:1", "-2:B:11", "", "4:B:10_10", "12", "12:H:A5",
                        "4:B:", "1" * 33, "0" * 40, "zz", "4:B:2"],
          "User": ["fast", "5", "'1'", '"text"', "true", "5 ns", "", "1.5"]}
USER_TYPES = ["", "integer", "string", "std_logic", "boolean", "real", "time", "mode_t", "bit",
              "signal", "positive", "bit_vector"]
CONSTANTS = ["1010", "0001", "0000", "1", "0", "5", "12", "10", "XXXX", "ZZZZ", "zz", "10_10", "-5",
             "1X0", "abc", "0010", "1000", "4:B:1010", "4:H:A", "4:h:a", "4:O:07", "4:B:10X1",
             "4:B:10z1", "4:H:Z", "4:B:1012", "4:B:10_10", "0:B:1010", "-4:B:1010", "3:B:1010",
             "8:B:1010", "4:B:10", "2:B:10", "8:B:10101010", "4:H:G", "4:B:?01-", "3:O:5", "3:B:101",
             "8:H:5A", "6:O:52", "1:B:1", "4:B:_101", "4:B:1__0", "1" * 36, "0" * 36, "36:B:" + "1" * 36]
DIALECTS = ["QSN", "EXEMPLAR", "SYNPLICITY", "SYNOPSYS", "VERILOG2001", "PRECISION"]
COMMENTS = ["synopsys translate_off", "synopsys full_case", "verilator foo", "verilator lint_off X",
            "synthesis translate_off", "a */ b", "-- x", "// x", "`define", "pragma translate_off",
            "ends with \\", "plain", "synthesis attribute"]


def quote(text: str) -> str:
    """A word of a command line."""
    if text and not any(c in " \"'\\" for c in text):
        return text
    return '"' + text.replace("\\", "\\\\").replace('"', '\\"') + '"'


@dataclass
class Cell:
    name: str
    pins: list[tuple[str, str, int]]  # pin, direction, width


class Generator:
    """One design, as lines."""

    def __init__(self, seed: int) -> None:
        self.random = random.Random(seed)
        self.head: list[str] = []
        self.lines: list[str] = []
        self.tail: list[str] = []
        self.cells: list[Cell] = []
        self.instances: list[tuple[str, Cell]] = []
        self.sources: list[tuple[str, int]] = []  # driven references and their widths
        self.inputs: list[tuple[str, int]] = []
        self.outputs: list[tuple[str, int]] = []
        self.wires: list[str] = []
        self.count = 0

    def chance(self, probability: float) -> bool:
        return self.random.random() < probability

    def pick(self, items):
        return self.random.choice(items)

    def fresh(self, letter: str = "n") -> str:
        self.count += 1
        return self.pick(["{}{}", "{}_{}", "{}x{}"]).format(
            letter.upper() if self.chance(0.3) else letter, self.count)

    def ranged(self, base: str, width: int) -> str:
        if width == 1 and not self.chance(0.1):
            return base
        low = self.pick([0, 0, 0, 1, 4])
        left, right = low + width - 1, low
        if self.chance(0.3):
            left, right = right, left
        return f"{base}({left}:{right})"

    # The sound part.

    def generate(self) -> str:
        self.options()
        for _ in range(self.random.randint(1, 3)):
            self.add_cell()
        for _ in range(self.random.randint(1, 3)):
            self.add_input()
        for _ in range(self.random.randint(1, 2)):
            self.add_output()
        for _ in range(self.random.randint(1, 5)):
            self.add_instance()
        self.drive_outputs()
        for _ in range(self.random.randint(0, 3)):
            self.add_attribute(sound=True)
        faults = self.pick([0, 0, 1, 1, 1, 1, 2, 2, 3])
        for _ in range(faults):
            try:
                self.pick(FAULTS)(self)
            except IndexError:
                pass  # an earlier fault has left nothing to choose from
        if self.chance(0.15):
            self.lines.insert(self.random.randint(0, len(self.lines)),
                              self.pick(["WRITE VHDL w1.vhd", "WRITE VERILOG w1.v"]))
        writes = ["WRITE VERILOG -NOHEADER X.v", "WRITE VHDL -NOHEADER X.vhd"]
        self.random.shuffle(writes)
        return "\n".join([*self.head, *self.lines, *self.tail, *writes]) + "\n"

    def options(self) -> None:
        self.head.append(f"SET NETLIST NAME {self.pick(['X', 'top', 'Design1'])}")
        if self.chance(0.9):
            self.head.append("SUPPRESS CONFIGURATION true")
        if self.chance(0.3):
            self.head.append(f"SET SYNTHESIS {self.pick(DIALECTS)}")
        if self.chance(0.2):
            self.head.append("USE ATTRTYPE")
        if self.chance(0.1):
            self.head.append(f"{self.pick(['UPPERCASE', 'LOWERCASE'])} "
                             f"{self.pick(['INSTANCE', 'COMPONENT'])}")
        if self.chance(0.05):
            self.head.append("LOWERCASE SIGNAL")
        if self.chance(0.05):
            self.head.append("UPPERCASE SIGANL")
        if self.chance(0.1):
            self.head.append("SET OPEN PIN false")
        if self.chance(0.1):
            self.head.append(f"ADD NOTES {self.pick(['a note', 'two  words'])}")

    def add_cell(self) -> Cell:
        name = self.fresh("c")
        pins, used = [], 0
        for direction in ["Input"] * self.random.randint(1, 3) + ["Output"] * self.random.randint(1, 2):
            used += 1
            width = self.pick([1, 1, 1, 2, 4, 4])
            letter = direction[0]
            pins.append((self.ranged(f"{letter}{used}", width), direction, width))
        if self.chance(0.1):
            pins.append(("IO", "BiDirectional", 1))
        self.head.append(f"ADD COMPONENT {name}")
        self.head += [f"ADD PIN {name} {pin} {direction}" for pin, direction, _ in pins]
        if self.chance(0.2):
            self.head.append(f"ADD COMPONENT ATTRIBUTE {name} LEVEL HALVEX")
        self.cells.append(Cell(name, pins))
        return self.cells[-1]

    def add_input(self) -> None:
        width = self.pick([1, 1, 4, 4, 8])
        name = self.ranged(self.fresh("a"), width)
        self.lines.append(f"ADD PORT {name} Input")
        self.inputs.append((name, width))
        self.sources.append((name, width))

    def add_output(self) -> None:
        width = self.pick([1, 1, 4, 4])
        name = self.ranged(self.fresh("y"), width)
        self.lines.append(f"ADD PORT {name} Output")
        self.outputs.append((name, width))

    def piece(self, name: str, width: int) -> str:
        """A part of a bus, as wide as asked for."""
        base, _, rest = name.partition("(")
        left, right = map(int, rest.rstrip(")").split(":"))
        low, high = min(left, right), max(left, right)
        start = self.random.randint(low, high - width + 1)
        a, b = start + width - 1, start
        if width == 1 and self.chance(0.9):
            return f"{base}({start})"
        if (left < right) != self.chance(0.15):
            a, b = b, a
        return f"{base}({a}:{b})"

    def source(self, width: int) -> str:
        """A driven reference of that width."""
        exact = [name for name, its in self.sources if its == width]
        wider = [name for name, its in self.sources if its > width and "(" in name
                 and "," not in name]
        choices: list[Callable[[], str]] = []
        if exact:
            choices += [lambda: self.pick(exact)] * 3
        if wider:
            choices += [lambda: self.piece(self.pick(wider), width)] * 2
        if width > 1 and (not choices or self.chance(0.3)):
            cut = self.random.randint(1, width - 1)
            return f"{self.source(cut)},{self.source(width - cut)}"
        if not choices:
            name = self.fresh("k")
            self.lines.append(f"ASSIGN CONSTANT {name} {self.pick('01')}")
            self.sources.append((name, 1))
            return name
        return self.pick(choices)()

    def target(self, width: int) -> str:
        """A new net, or an output, of that width."""
        free = [output for output in self.outputs if output[1] == width]
        if free and self.chance(0.4):
            output = self.pick(free)
            self.outputs.remove(output)
            if self.chance(0.4):
                self.sources.append(output)  # read inside as well
            return output[0]
        if width > 1 and self.chance(0.15):
            cut = self.random.randint(1, width - 1)
            return f"{self.target(cut)},{self.target(width - cut)}"
        name = self.ranged(self.fresh("n"), width)
        self.sources.append((name, width))
        return name

    def add_instance(self) -> None:
        cell = self.pick(self.cells)
        name = self.fresh("u")
        self.lines.append(f"ADD INSTANCE {cell.name} {name}")
        self.instances.append((name, cell))
        for pin, direction, width in cell.pins:
            if direction == "Input" and self.chance(0.08):
                bits = "".join(self.random.choices("01", k=width))
                self.lines.append(f"ASSIGN CONSTANT {name}.{pin} {width}:B:{bits}")
            elif direction == "Input":
                self.lines.append(f"CONNECT SIGNAL {quote(self.source(width))} {name}.{pin}")
                self.wires.append(self.lines[-1])
            elif direction == "Output" and not self.chance(0.1):
                self.lines.append(f"CONNECT SIGNAL {quote(self.target(width))} {name}.{pin}")

    def drive_outputs(self) -> None:
        outputs = [name for name, _ in self.outputs]
        safe = [(n, w) for n, w in self.sources if not n.lower().startswith("y")]
        for name, width in self.outputs:
            if self.chance(0.3):
                bits = "".join(self.random.choices("01", k=width))
                self.lines.append(f"ASSIGN CONSTANT {name} {width}:B:{bits}")
            elif not self.chance(0.2):
                kept, self.sources = self.sources, safe
                self.lines.append(f"CONNECT SIGNAL {name} {quote(self.source(width))}")
                self.sources = kept
        self.outputs = [(n, 0) for n in outputs][:0]

    # Attributes.

    def owner(self, sound: bool) -> tuple[str, str]:
        kind = self.pick(["SIGNAL", "SIGNAL", "INSTANCE", "COMPONENT", "MODULE"])
        if kind == "SIGNAL":
            return kind, quote(self.pick(self.inputs + self.sources)[0]) + " "
        if kind == "INSTANCE" and self.instances:
            return kind, self.pick(self.instances)[0] + " "
        if kind == "COMPONENT":
            return kind, self.pick(self.cells).name + " "
        return "MODULE", ""

    def add_attribute(self, sound: bool) -> None:
        kind, owner = self.owner(sound)
        name = self.pick(["LOC", "KEEP", "INIT", "WIDTH", "NOTE"]) if sound or self.chance(0.7) \
            else quote(self.pick([*ODD_NAMES, *VHDL_WORDS, *VERILOG_WORDS, "length", "event",
                                  *(n for n, _ in self.instances), *(n for n, _ in self.inputs)]))
        if sound:
            type_ = self.pick(["String", "String", "Integer", "Boolean"])
            name = f"{name}_{type_[0]}"
            value = {"String": "abc", "Integer": "5", "Boolean": "true"}[type_]
        else:
            type_ = self.pick(TYPES)
            value = self.pick(VALUES[type_])
        self.lines.append(f"ADD {kind} ATTRIBUTE {owner}-TYPE={type_} {name} {quote(value)}")
        if type_ == "User" and self.chance(0.8):
            user_type = self.pick(USER_TYPES)
            if user_type:
                self.lines.append(f"SET {kind} ATTRIBUTE USERTYPE {owner}{name} {user_type}")
        option = self.pick(["-SYNATTR=ASSIGN", "-SYNATTR=ASSIGN", "-GENERIC=SYN", "-GENERIC=SYN",
                            "-GENERIC=NOSYN", "-SYNATTR=ASSIGNNODEC", ""])
        if sound:
            option = "-GENERIC=SYN" if kind in ("MODULE", "COMPONENT") and self.chance(0.5) \
                else "-SYNATTR=ASSIGN"
        if option:
            self.lines.append(f"SET {kind} ATTRIBUTE OPTION {owner}{name} {option}")

    # Faults.

    def wire(self, name: str) -> None:
        """Uses a net of that name as an input's source."""
        cell = self.pick(self.cells)
        instance = self.fresh("u")
        self.lines.append(f"ADD INSTANCE {cell.name} {instance}")
        done = False
        for pin, direction, width in cell.pins:
            if direction == "Input":
                used = name if width == 1 and not done else self.source(width)
                done = done or used == name
                self.lines.append(f"CONNECT SIGNAL {quote(used)} {instance}.{pin}")

    def odd_name(self) -> str:
        return self.pick([*ODD_NAMES, *VERILOG_WORDS, *VHDL_WORDS])

    def name_port(self) -> None:
        name = self.odd_name()
        if self.chance(0.3):
            name = f"{name}(3:0)"
        self.lines.append(f"ADD PORT {quote(name)} {self.pick(['Input', 'Input', 'Output', 'Bi'])}")
        if "(" not in name and self.chance(0.5):
            self.wire(name)

    def name_net(self) -> None:
        name = self.odd_name()
        self.lines.append(f"ASSIGN CONSTANT {quote(name)} 1")
        self.wire(name)

    def name_instance(self) -> None:
        cell = self.pick(self.cells)
        name = self.odd_name()
        self.lines.append(f"ADD INSTANCE {cell.name} {quote(name)}")
        for pin, direction, width in cell.pins:
            if direction == "Input":
                self.lines.append(f"CONNECT SIGNAL {quote(self.source(width))} {quote(name + '.' + pin)}")

    def name_cell(self) -> None:
        name, pin = self.pick([(self.odd_name(), "I"), ("cellx", self.odd_name())])
        self.lines += [f"ADD COMPONENT {quote(name)}", f"ADD PIN {quote(name)} {quote(pin)} Input"]
        instance = self.fresh("u")
        if self.chance(0.9):
            self.lines += [f"ADD INSTANCE {quote(name)} {instance}",
                           f"CONNECT SIGNAL {quote(self.source(1))} {quote(instance + '.' + pin)}"]

    def name_design(self) -> None:
        names = [*self.instances, *self.inputs, *((c.name, 0) for c in self.cells)]
        name = self.pick([self.odd_name(), self.pick(names)[0].partition("(")[0]])
        self.head[0] = f"SET NETLIST NAME {quote(name)}"

    def clash(self) -> None:
        names = [n.partition("(")[0] for n, _ in
                 [*self.inputs, *self.instances, *self.sources] if "," not in n]
        names += [cell.name for cell in self.cells]
        base = self.pick(names)
        base = self.pick([base, base, base.lower(), base.upper(), base + "_DUMMY"])
        line = self.pick([f"ADD PORT {base}(2:0) Input", f"ADD SIGNAL {base}(1:0)",
                          f"ADD SIGNAL {base}", f"ADD PORT {base} Output",
                          f"ADD INSTANCE {self.cells[0].name} {base}"])
        self.lines.insert(self.random.randint(0, len(self.lines)), line)

    def bit_pins(self) -> None:
        pins = self.pick([["Q(1)"], ["Q(1)", "Q(0)"], ["Q(1:0)", "Q"], ["Q", "q"], ["Q(3)", "R"]])
        name, instance = self.fresh("c"), self.fresh("u")
        self.lines.append(f"ADD COMPONENT {name}")
        self.lines += [f"ADD PIN {name} {pin} Input" for pin in pins]
        self.lines.append(f"ADD INSTANCE {name} {instance}")
        for pin in pins:
            width = 2 if ":" in pin else 1
            self.lines.append(f"CONNECT SIGNAL {quote(self.source(width))} {instance}.{pin}")

    def pin_width(self) -> None:
        name, cell = self.pick(self.instances)
        pin, direction, width = self.pick(cell.pins)
        other = self.random.randint(1, 5)
        net = self.source(other) if direction == "Input" else self.target(other)
        self.lines.append(f"CONNECT SIGNAL {quote(net)} {name}.{pin}")

    def outside(self) -> None:
        name, width = self.pick([*self.inputs, *self.sources])
        base = name.partition("(")[0]
        reference = self.pick([f"{base}(9)", f"{base}(12:9)", f"{base}(0)", f"{base}(6:5)",
                               f"{base}(5:6)", f"{base}(30)", f"{base}(3:3)"])
        net = self.fresh("n")
        choice = self.random.randint(0, 4)
        if choice == 0:
            self.lines.append(f"CONNECT SIGNAL {net} {reference}")
        elif choice == 1:
            self.lines.append(f"CONNECT SIGNAL {reference} {quote(self.source(1))}")
        elif choice == 2:
            self.lines.append(f"ASSIGN CONSTANT {reference} 1")
        elif self.instances:
            instance, cell = self.pick(self.instances)
            pin = self.pick(cell.pins)[0]
            self.lines.append(f"CONNECT SIGNAL {reference} {instance}.{pin}")

    def slide(self) -> None:
        base = self.fresh("s")
        self.lines += [f"ASSIGN CONSTANT {base}(3:0) 4:B:1010",
                       f"CONNECT SIGNAL {base}({self.pick(['7:4', '7:0', '4:1', '0:3'])}) "
                       f"{quote(self.source(4))}"]

    def alias(self) -> None:
        left = self.ranged(self.fresh("n"), self.random.randint(1, 4))
        if self.chance(0.3):
            left = f"{self.fresh('m')},{left}"
        right = self.source(self.random.randint(1, 4))
        if self.chance(0.2):
            right = f"open,{right}" if self.chance(0.5) else "open"
        if self.chance(0.1):
            left = "open"
        self.lines.append(f"CONNECT SIGNAL {quote(left)} {quote(right)}")

    def alias_port(self) -> None:
        ports = [line.split()[2] for line in self.lines if line.startswith("ADD PORT ")
                 and len(line.split()) == 4]
        left, right = self.pick(ports), self.pick(ports)
        if self.chance(0.3) and "(" in right and ":" in right:
            right = self.piece(right, 1)
        self.lines.append(f"CONNECT SIGNAL {self.pick([left, self.fresh('n')])} {right}")

    def alias_loop(self) -> None:
        one, two, three = (self.fresh("n") for _ in range(3))
        self.lines += [f"CONNECT SIGNAL {one} {two}", f"CONNECT SIGNAL {two} {three}",
                       f"CONNECT SIGNAL {three} {self.pick([one, two])}"]
        self.wire(one)

    def constant(self) -> None:
        value = self.pick(CONSTANTS)
        width = self.pick([4, 4, 4, 3, 2, 1, 8, 36])
        name = self.fresh("k")
        target = self.pick([self.ranged(name, width), f"{name}({width - 1}:0)",
                            f"{name}({width + 1}:2)", f"{name}(0:{width - 1})"])
        if self.chance(0.25) and ":" in target:
            whole = f"{name}({width + 3}:0)" if self.chance(0.5) else f"{name}(0:{width + 3})"
            self.lines.append(f"ADD SIGNAL {whole}")
        elif self.chance(0.2) and width > 1:
            target = f"{name}(0:{width - 2}),{name}b" if width > 2 else f"{name}a,{name}b"
        self.lines.append(f"ASSIGN CONSTANT {quote(target)} {quote(value)}")
        if self.chance(0.5):
            self.sources.append((target, width))
            self.lines.append(f"CONNECT SIGNAL {self.ranged(self.fresh('n'), width)} {quote(target)}")

    def pin_constant(self) -> None:
        name, cell = self.pick(self.instances)
        pin, direction, width = self.pick(cell.pins)
        self.lines.append(f"ASSIGN CONSTANT {name}.{pin} {quote(self.pick(CONSTANTS))}")

    def constant_on_port(self) -> None:
        name, width = self.pick(self.inputs)
        bits = "".join(self.random.choices("01", k=width))
        self.lines.append(f"ASSIGN CONSTANT {name} {width}:B:{bits}")

    def no_ports(self) -> None:
        self.lines = [line.replace("ADD PORT", "ADD SIGNAL") for line in self.lines]
        self.lines = [" ".join(line.split()[:3]) if line.startswith("ADD SIGNAL ") and
                      len(line.split()) == 4 else line for line in self.lines]

    def unwired(self) -> None:
        if self.wires:
            wire = self.pick(self.wires)
            if wire in self.lines:
                self.lines.remove(wire)

    def openings(self) -> None:
        name, cell = self.pick(self.instances)
        pin, direction, width = self.pick(cell.pins)
        net = self.pick(["open", "OPEN", "open", f"open,{self.source(1)}"])
        self.lines.append(f"CONNECT SIGNAL {quote(net)} {name}.{pin}")

    def open_taken(self) -> None:
        self.head.append("SET OPEN PIN false")
        name, cell = self.pick(self.instances)
        pin, direction, width = self.pick(cell.pins)
        base, paren, rest = pin.partition("(")
        signal = f"{name}_{base}_openSignal{paren}{rest}"
        self.lines.append(self.pick([f"ADD SIGNAL {signal}", f"ADD PORT {signal} Input",
                                     f"ADD PORT {signal.partition('(')[0]}(1:0) Input",
                                     f"ADD INSTANCE {cell.name} {signal.partition('(')[0]}"]))
        self.lines = [line for line in self.lines if not line.endswith(f" {name}.{pin}")]

    def late_pin(self) -> None:
        cell = self.pick(self.cells)
        self.lines.append(f"ADD PIN {cell.name} Z9 {self.pick(['Input', 'Output', 'Bi'])}")

    def drive_input(self) -> None:
        name, cell = self.pick(self.instances)
        pins = [(pin, width) for pin, direction, width in cell.pins if direction != "Input"]
        pin, width = self.pick(pins)
        ports = [n for n, w in self.inputs if w == width] + \
                [self.piece(n, width) for n, w in self.inputs if w > width and "(" in n]
        if ports:
            self.lines.append(f"CONNECT SIGNAL {self.pick(ports)} {name}.{pin}")
            if self.chance(0.3):
                base = ports[0].partition("(")[0]
                self.lines.append(f"ADD SIGNAL {base}_DUMMY{self.pick(['', '(1:0)'])}")

    def two_drivers(self) -> None:
        net, width = self.pick(self.sources)
        for name, cell in self.instances:
            for pin, direction, its in cell.pins:
                if direction == "Output" and its == width:
                    self.lines.append(f"CONNECT SIGNAL {quote(net)} {name}.{pin}")
                    return
        self.lines.append(f"CONNECT SIGNAL {quote(net)} {quote(self.source(width))}")

    def read_output(self) -> None:
        name = self.fresh("y")
        self.lines.append(f"ADD PORT {name} Output")
        if self.chance(0.6):
            self.lines.append(self.pick([f"ADD SIGNAL {name}_DUMMY", f"ADD SIGNAL {name}_DUMMY(1:0)",
                                         f"ADD INSTANCE {self.cells[0].name} {name}_DUMMY",
                                         f"ADD PORT {name}_dummy Input",
                                         f"ADD MODULE ATTRIBUTE {name}_DUMMY 1"]))
            if "MODULE" in self.lines[-1]:
                self.lines.append(f"SET MODULE ATTRIBUTE OPTION {name}_DUMMY -GENERIC=SYN")
        self.lines.append(f"ASSIGN CONSTANT {name} 1")
        self.wire(name)

    def widen_after_write(self) -> None:
        name = self.fresh("y")
        self.lines += [f"ADD PORT {name}(1:0) Output", f"ASSIGN CONSTANT {name}(1:0) 2:B:10"]
        self.wire(f"{name}(0)")
        self.lines += [self.pick(["WRITE VHDL w2.vhd", "WRITE VERILOG w2.v", "NOOP"]),
                       f"CONNECT SIGNAL {self.fresh('n')}(3:0) {name}(3:0)"]
        self.wire(f"{name}(3)")

    def undriven(self) -> None:
        self.wire(self.fresh("n"))

    def attribute(self) -> None:
        self.add_attribute(sound=False)

    def generic_pair(self) -> None:
        cell = self.pick(self.cells)
        mine = [name for name, its in self.instances if its is cell]
        name = self.pick(["INIT", "W", cell.pins[0][0].partition("(")[0], "i1"])
        first, second = self.pick(TYPES), self.pick(TYPES)
        if self.chance(0.5):
            second = first
        first_value, second_value = self.pick(VALUES[first]), self.pick(VALUES[second])
        if self.chance(0.8):
            self.lines += [f"ADD COMPONENT ATTRIBUTE {cell.name} -TYPE={first} {name} "
                           f"{quote(first_value)}",
                           f"SET COMPONENT ATTRIBUTE OPTION {cell.name} {name} "
                           f"-GENERIC={self.pick(['SYN', 'SYN', 'NOSYN'])}"]
        if mine and self.chance(0.8):
            self.lines += [f"ADD INSTANCE ATTRIBUTE {mine[0]} -TYPE={second} {name} "
                           f"{quote(second_value)}",
                           f"SET INSTANCE ATTRIBUTE OPTION {mine[0]} {name} -GENERIC=SYN"]

    def attribute_pair(self) -> None:
        self.head.append("USE ATTRTYPE")
        name = self.pick(["LOC", "RATE"])
        for _ in range(2):
            kind, owner = self.owner(True)
            type_ = self.pick(["String", "Integer", "Bit", "User"])
            self.lines += [f"ADD {kind} ATTRIBUTE {owner}-TYPE={type_} {name} 1",
                           f"SET {kind} ATTRIBUTE OPTION {owner}{name} "
                           f"{self.pick(['-SYNATTR=ASSIGN', '-SYNATTR=ASSIGNNODEC'])}"]

    def box_type(self) -> None:
        self.lines += [f"ADD COMPONENT ATTRIBUTE {self.cells[0].name} LEVEL HALVEX",
                       self.pick(["ADD SIGNAL BOX_TYPE", "ADD PORT box_type Input",
                                  "ADD MODULE ATTRIBUTE BOX_TYPE 1"])]

    def comment(self) -> None:
        text = self.pick(COMMENTS)
        kind = self.pick(["NOTES", "SIGNAL COMMENT", "INSTANCE COMMENT", "COMPONENT COMMENT",
                          "MODULE COMMENT"])
        owner = {"SIGNAL COMMENT": self.inputs[0][0], "INSTANCE COMMENT": self.instances[0][0],
                 "COMPONENT COMMENT": self.cells[0].name}.get(kind, "")
        self.lines.append(f"ADD {kind} {owner} {quote(text)}".replace("  ", " "))

    def library(self) -> None:
        self.lines += self.pick([
            ["ADD LIBRARY mylib", "ADD USE LIBRARY mylib.parts.all"], ["ADD LIBRARY ieee"],
            ["ADD LIBRARY 2x"], ["ADD LIBRARY signal"], ["ADD USE LIBRARY mylib.parts.all"],
            ["ADD USE LIBRARY mylib"], ["ADD USE LIBRARY work.all"], ["ADD LIBRARY \"ieee, std\""],
            ["ADD USE LIBRARY ieee.numeric_std.all"], ["ADD LIBRARY other_lib"],
            ["ADD LIBRARY ieee", "ADD USE LIBRARY ieee.numeric_std.all"],
            ["USE DEFAULT LIBRARY false"],
            ["USE DEFAULT LIBRARY false", "ADD LIBRARY ieee",
             "ADD USE LIBRARY ieee.std_logic_1164.all"],
            ["ADD USE LIBRARY std.textio.all"], ["ADD LIBRARY work"], ["ADD LIBRARY a__b"]])

    def include(self) -> None:
        self.lines.append(f"ADD INCLUDE {self.pick(['inc.v', quote('in c.v'), quote(chr(34))])}")

    def suppress(self) -> None:
        self.lines.append(self.pick(["SUPPRESS COMPONENT true", "SUPPRESS CONFIGURATION false",
                                     "FLATTEN BUS true", "SET PORT ONEPERLINE"]))

    def wide(self) -> None:
        self.lines.append(f"ADD PORT {self.fresh('w')}"
                          f"({self.pick(['70000:0', '2147483647:2147483640', '99999999999:99999999990', '-1:0', '+3:+0', '03:00', '1000:0'])})"
                          f" Input")

    def repeat_output(self) -> None:
        name, cell = self.pick(self.instances)
        for pin, direction, width in cell.pins:
            if direction == "Output" and width % 2 == 0:
                half = self.ranged(self.fresh("n"), width // 2)
                self.lines.append(f"CONNECT SIGNAL {quote(half + ',' + half)} {name}.{pin}")

    def own_component(self) -> None:
        self.head[0] = f"SET NETLIST NAME {self.pick([self.cells[0].name, self.cells[0].name.lower()])}"


FAULTS: list[Callable[[Generator], None]] = [
    Generator.name_port, Generator.name_net, Generator.name_instance, Generator.name_cell,
    Generator.name_design, Generator.clash, Generator.clash, Generator.bit_pins,
    Generator.pin_width, Generator.outside, Generator.outside, Generator.slide, Generator.alias,
    Generator.alias, Generator.alias_port, Generator.alias_loop, Generator.constant,
    Generator.constant, Generator.constant, Generator.pin_constant, Generator.constant_on_port,
    Generator.no_ports, Generator.unwired, Generator.openings, Generator.open_taken,
    Generator.late_pin, Generator.drive_input, Generator.two_drivers, Generator.read_output,
    Generator.widen_after_write, Generator.undriven, Generator.attribute, Generator.attribute,
    Generator.generic_pair, Generator.attribute_pair, Generator.box_type, Generator.comment,
    Generator.library, Generator.include, Generator.suppress, Generator.wide,
    Generator.repeat_output, Generator.own_component]


def generate(seed: int) -> str:
    """The command file of a seed, in Latin-1; some of its lines may fail."""
    return Generator(seed).generate()

#!/usr/bin/env python3
"""The simulation models that `orn-hdl import --write-cells` writes, beside Yosys' own models.

Each batch is a netlist with many cells that share their inputs. It is imported to VHDL, with models,
and GHDL simulates it; Icarus simulates the same cells as Yosys' simcells.v and simlib.v have them. Both
must show the same outputs at every step, x and z included. Inputs are 0 and 1: all their combinations
where they are few and nothing is stored, otherwise a random walk that changes one input at a time. A
long walk changes each input of a register of up to six in every state that the register comes to.

Yosys' models of cells with both set and reset, and of those with an asynchronous load, look at these
inputs only when one of them becomes active or the clock ticks. A real cell follows its levels, and so do
the models in VHDL. Where a walk comes to a step that shows this, the two may differ until they agree
again.
"""

from __future__ import annotations

import argparse
import itertools
import json
import random
import re
import tempfile
from collections.abc import Iterable, Iterator
from dataclasses import dataclass, field
from pathlib import Path

from judging import Tally
from judges import KESTRA_PACKAGE, Rejected, run_tool
from tool import Tool

YOSYS = Path("/usr/share/yosys")

# The steps after which a walk has brought all registers to a known state.
WARM_UP = 400

# The most inputs of a register whose every state and change a long walk meets.
SMALL = 6

# The model in simlib.v takes one bit in place of a part of several.
WIDE_BMUX = """\
module wide_bmux(A, S, Y);
  parameter WIDTH = 0;
  parameter S_WIDTH = 0;
  input [(WIDTH << S_WIDTH) - 1:0] A;
  input [S_WIDTH - 1:0] S;
  output [WIDTH - 1:0] Y;
  assign Y = A >> S * WIDTH;
endmodule
"""


@dataclass(frozen=True)
class Pin:
    name: str
    width: int
    is_output: bool = False
    # The bits that are 0.
    tied: frozenset[int] = frozenset()


@dataclass
class Cell:
    """One cell with its parameters; their values are strings of bits, "-" for any value."""
    type: str
    pins: list[Pin]
    parameters: dict[str, str] = field(default_factory=dict)

    @property
    def inputs(self) -> int:
        return sum(pin.width for pin in self.pins if not pin.is_output)

    @property
    def outputs(self) -> int:
        return sum(pin.width for pin in self.pins if pin.is_output)

    def __str__(self) -> str:
        values = ", ".join(f"{name}={bits if '-' in bits else int(bits, 2)}"
                           for name, bits in self.parameters.items())
        return f"{self.type}({values})"


@dataclass
class Batch:
    label: str
    cells: list[Cell]
    steps: list[str]
    warm_up: int = 0
    # Whether the walk must change every input of each cell in every state.
    is_exhaustive: bool = False

    @property
    def width(self) -> int:
        return len(self.steps[0])


def bits_of(value: int, width: int = 32) -> str:
    return format(value % (1 << width), f"0{width}b")


def inputs_of(cells: list[Cell]) -> int:
    return max(cell.inputs for cell in cells)


def walk(cells: list[Cell], count: int, seed: int) -> list[str]:
    """Steps that change one input at a time."""
    draw = random.Random(seed)
    width = inputs_of(cells)
    present = 0
    result = []
    for _ in range(count):
        result.append(bits_of(present, width))
        present ^= 1 << draw.randrange(width)
    return result


def every(width: int) -> list[str]:
    return [bits_of(value, width) for value in range(1 << width)]


# Netlists and test benches.

def as_json(batch: Batch) -> str:
    next_bit = 2 + batch.width
    cells, outputs = {}, []
    for number, cell in enumerate(batch.cells):
        connections, taken = {}, 2
        for pin in cell.pins:
            start = next_bit if pin.is_output else taken
            connections[pin.name] = ["0" if bit in pin.tied else start + bit
                                     for bit in range(pin.width)]
            if pin.is_output:
                outputs += connections[pin.name]
                next_bit += pin.width
            else:
                taken += pin.width
        cells[f"c{number}"] = {
            "type": cell.type, "parameters": cell.parameters, "attributes": {},
            "port_directions": {pin.name: "output" if pin.is_output else "input"
                                for pin in cell.pins},
            "connections": connections}
    ports = {"v": {"direction": "input", "bits": list(range(2, 2 + batch.width))},
             "o": {"direction": "output", "bits": outputs}}
    return json.dumps({"modules": {"batch": {"attributes": {"top": bits_of(1)}, "ports": ports,
                                             "cells": cells, "netnames": {}}}})


def as_verilog(batch: Batch) -> str:
    total = sum(cell.outputs for cell in batch.cells)
    lines = [f"module batch(input [{batch.width - 1}:0] v, output [{total - 1}:0] o);"]
    made = 0
    for number, cell in enumerate(batch.cells):
        values = ", ".join(f".{name}({len(bits)}'b{bits.replace('-', '?')})"
                           for name, bits in cell.parameters.items())
        pins, taken = [], 0
        for pin in cell.pins:
            bus, low = ("o", made) if pin.is_output else ("v", taken)
            wires = ["1'b0" if bit in pin.tied else f"{bus}[{low + bit}]"
                     for bit in range(pin.width)]
            pins.append(f".{pin.name}({{{', '.join(reversed(wires))}}})" if wires else f".{pin.name}()")
            if pin.is_output:
                made += pin.width
            else:
                taken += pin.width
        is_wide = cell.type == "$bmux" and int(cell.parameters["WIDTH"], 2) > 1
        module = "wide_bmux" if is_wide else f"\\{cell.type}"
        lines.append(f"  {module} {f'#({values}) ' if values else ''}c{number}({', '.join(pins)});")
    lines += ["endmodule", "", "module bench;", f"  reg [{batch.width - 1}:0] v;",
              f"  wire [{total - 1}:0] o;", "  batch b(v, o);",
              f"  reg [{batch.width - 1}:0] steps [0:{len(batch.steps) - 1}];", "  integer i, file;",
              "  initial begin", '    $readmemb("steps.txt", steps);',
              '    file = $fopen("verilog.txt");',
              f"    for (i = 0; i < {len(batch.steps)}; i = i + 1) begin",
              "      v = steps[i];", '      #5 $fdisplay(file, "%b", o);', "      #5;", "    end",
              "    $finish;", "  end", "endmodule", ""]
    return WIDE_BMUX + "\n".join(lines)


def vhdl_bench(batch: Batch) -> str:
    total = sum(cell.outputs for cell in batch.cells)
    v_type = "std_logic" if batch.width == 1 else f"std_logic_vector({batch.width - 1} downto 0)"
    o_type = "std_logic" if total == 1 else f"std_logic_vector({total - 1} downto 0)"
    return f"""\
library ieee;
use ieee.std_logic_1164.all;
use std.textio.all;

entity bench is
end bench;

architecture test of bench is
  signal v : {v_type};
  signal o : {o_type};
  component batch
    port (v : in {v_type}; o : out {o_type});
  end component;
begin
  b : batch port map (v => v, o => o);

  process
    file steps : text open read_mode is "steps.txt";
    file results : text open write_mode is "vhdl.txt";
    variable from, to_file : line;
    variable present : bit_vector({batch.width - 1} downto 0);
    variable shown : string(1 to {total});
    constant letters : string(1 to 9) := "xx01zx01x";
  begin
    while not endfile(steps) loop
      readline(steps, from);
      read(from, present);
      v <= to_stdlogicvector(present);
      wait for 5 ns;
      for i in shown'range loop
        shown(i) := letters(std_ulogic'pos(o({total} - i)) + 1);
      end loop;
      write(to_file, shown);
      writeline(results, to_file);
      wait for 5 ns;
    end loop;
    wait;
  end process;
end test;
"""


def simulate(tool: Tool, batch: Batch, work: Path) -> tuple[list[str], list[str]]:
    """What VHDL and Verilog show at each step."""
    (work / "steps.txt").write_text("\n".join(batch.steps) + "\n")
    (work / "batch.json").write_text(as_json(batch))
    (work / "batch.v").write_text(as_verilog(batch))
    (work / "bench.vhd").write_text(vhdl_bench(batch))
    tool.run(work, "import", "batch.json", "--vhdl", "batch.vhd", "--write-cells", "cells.vhd")
    flags = ["--std=93", "--syn-binding", "-P."]
    run_tool(["ghdl", "-a", *flags, "--work=KESTRA", KESTRA_PACKAGE], work)
    # The cell $lut has a parameter LUT.
    run_tool(["ghdl", "-a", *flags, "--warn-error", "--warn-no-hide", "cells.vhd",
              "batch.vhd", "bench.vhd"], work)
    run_tool(["ghdl", "-e", *flags, "--warn-error", "bench"], work)
    run_tool(["ghdl", "-r", *flags, "bench", "--ieee-asserts=disable-at-0",
              "--assert-level=error"], work)
    run_tool(["iverilog", "-g2005", "-s", "bench", "-o", "bench.vvp", "batch.v",
              YOSYS / "simcells.v", YOSYS / "simlib.v"], work)
    run_tool(["vvp", "-n", "bench.vvp"], work)
    return (work / "vhdl.txt").read_text().split(), (work / "verilog.txt").read_text().split()


# What two simulations show.

def compare(tool: Tool, batch: Batch, work: Path) -> None:
    vhdl, verilog = simulate(tool, batch, work)
    if len(vhdl) != len(batch.steps) or len(verilog) != len(batch.steps):
        raise Rejected(f"{len(vhdl)} and {len(verilog)} steps in place of {len(batch.steps)}")
    high = len(vhdl[0])
    wrong = []
    for cell in batch.cells:
        low = high - cell.outputs
        shown = ([line[low:high] for line in vhdl], [line[low:high] for line in verilog])
        difference = first_difference(batch, cell, *shown)
        if not difference and batch.is_exhaustive:
            difference = first_untried(batch, cell, shown[0])
        if difference:
            wrong.append(difference)
        high = low
    if wrong:
        raise Rejected(f"{len(wrong)} of {len(batch.cells)} cells differ:\n" + "\n".join(wrong[:20]))


def first_difference(batch: Batch, cell: Cell, vhdl: list[str], verilog: list[str]) -> str:
    is_tolerated = False
    for step, (before, after) in enumerate(itertools.pairwise(batch.steps), 1):
        if vhdl[step] == verilog[step]:
            is_tolerated = False
            continue
        is_tolerated = is_tolerated or may_differ(cell, before, after)
        if not is_tolerated and step >= batch.warm_up:
            inputs = batch.steps[step][batch.width - cell.inputs:]
            return (f"{cell}: inputs {inputs} at step {step}: VHDL {vhdl[step]}, "
                    f"Verilog {verilog[step]}")
    return ""


def first_untried(batch: Batch, cell: Cell, shown: list[str]) -> str:
    """A change of one input that the walk does not make in a state in which the cell has been."""
    tried: dict[tuple[str, str], set[int]] = {}
    inputs = [step[batch.width - cell.inputs:] for step in batch.steps]
    for step in range(batch.warm_up, len(inputs) - 1):
        before, after = inputs[step], inputs[step + 1]
        changed = {place for place in range(cell.inputs) if before[place] != after[place]}
        tried.setdefault((before, shown[step]), set()).update(changed)
    for (state, output), places in tried.items():
        if len(places) < cell.inputs:
            return f"{cell}: in state {state} with output {output} not all inputs were changed"
    return ""


def may_differ(cell: Cell, before: str, after: str) -> bool:
    """Whether a step changes what levels make of a cell, while no input becomes active."""
    levels = active_inputs(cell)
    def values(step: str) -> dict[str, str]:
        result, taken = {}, 0
        for pin in cell.pins:
            if not pin.is_output:
                result[pin.name] = step[len(step) - taken - pin.width:len(step) - taken]
                taken += pin.width
        return result
    old, new = values(before), values(after)
    if "AD" in new:
        load = "L" if "L" in new else "ALOAD"
        return new[load] == levels[load] and old["AD"] != new["AD"]
    for reset, put in (("R", "S"), ("CLR", "SET")):
        if reset in new and put in new:
            return any(was == levels[reset] != now and on == levels[put]
                       for was, now, on in zip(old[reset], new[reset], new[put]))
    return False


def active_inputs(cell: Cell) -> dict[str, str]:
    """The active levels of set, reset and load."""
    if cell.parameters:
        return {name.removesuffix("_POLARITY"): bits[-1] for name, bits in cell.parameters.items()
                if name.endswith("_POLARITY")}
    code = cell.type.rstrip("_").rsplit("_", 1)[-1]
    roles = {"$_SR": "SR", "$_DFFSR": "CSR", "$_DFFSRE": "CSR", "$_ALDFF": "CL", "$_ALDFFE": "CL",
             "$_DLATCHSR": "ESR"}.get(cell.type.rstrip("_").rsplit("_", 1)[0], "")
    return {role: "1" if letter == "P" else "0" for role, letter in zip(roles, code)}


# The cells.

def gate_cells(models: str) -> Iterator[Cell]:
    """All gate-level cells of Yosys, with the pins that its own models have."""
    for name, pins in re.findall(r"^module \\(\$_\w+_) \((.*)\);", models, re.MULTILINE):
        if name != "$_FF_":  # It has no clock, so it has a meaning for proofs alone.
            yield Cell(name, [Pin(pin, 1, pin in ("Y", "Q")) for pin in pins.split(", ")])


def gate_batches(is_full: bool) -> Iterator[Batch]:
    cells = list(gate_cells((YOSYS / "simcells.v").read_text()))
    stored = [cell for cell in cells if cell.pins[-1].name == "Q"]
    yield Batch("gates that store", stored, walk(stored, 20000 if is_full else 3000, 1), WARM_UP,
                is_full)
    functions = [cell for cell in cells if cell not in stored]
    for few, many in ((0, 6), (6, 11)):
        # A bus of outputs has two bits at least.
        chosen = [cell for cell in functions if few < cell.inputs <= many] * 2
        yield Batch(f"gates of up to {many} inputs", chosen, every(inputs_of(chosen)))
    chosen = [cell for cell in functions if cell.inputs > 11] * 2
    yield Batch("gates of 20 inputs", chosen, every(20) if is_full else walk(chosen, 3000, 2))


UNARY = ["not", "pos", "neg", "reduce_and", "reduce_or", "reduce_xor", "reduce_xnor", "reduce_bool",
         "logic_not"]
BINARY = ["and", "or", "xor", "xnor", "add", "sub", "mul", "div", "mod", "divfloor", "modfloor",
          "eq", "ne", "eqx", "nex", "lt", "le", "gt", "ge", "logic_and", "logic_or", "shl", "shr",
          "sshl", "sshr", "shift", "shiftx", "pow", "alu"]


def operators() -> Iterator[Cell]:
    for name in UNARY:
        for a, y, signed in itertools.product((1, 2, 3, 4), (1, 2, 4, 6), (0, 1)):
            yield Cell(f"${name}", [Pin("A", a), Pin("Y", y, True)],
                       {"A_SIGNED": bits_of(signed), "A_WIDTH": bits_of(a), "Y_WIDTH": bits_of(y)})
    for name in BINARY:
        for a, b, y, signed in itertools.product((1, 2, 4), (1, 3, 4), (1, 2, 4, 6),
                                                 ((0, 0), (0, 1), (1, 0), (1, 1))):
            # Yosys writes operands of equal signs, but for shifts and powers.
            if signed[0] != signed[1] and name not in (
                    "shl", "shr", "sshl", "sshr", "shift", "shiftx", "pow"):
                continue
            # Icarus takes an unsigned base as signed where the exponent is.
            if name == "pow" and signed == (0, 1):
                continue
            pins = [Pin("A", a), Pin("B", b)]
            if name == "alu":
                pins += [Pin("CI", 1), Pin("BI", 1), Pin("X", y, True), Pin("Y", y, True),
                         Pin("CO", y, True)]
            else:
                pins += [Pin("Y", y, True)]
            yield Cell(f"${name}", pins,
                       {"A_SIGNED": bits_of(signed[0]), "A_WIDTH": bits_of(a),
                        "B_SIGNED": bits_of(signed[1]), "B_WIDTH": bits_of(b), "Y_WIDTH": bits_of(y)})


def other_functions() -> Iterator[Cell]:
    draw = random.Random(3)
    for a, y, offset in ((4, 2, 1), (4, 1, 3), (4, 4, 0)):
        yield Cell("$slice", [Pin("A", a), Pin("Y", y, True)],
                   {"OFFSET": bits_of(offset), "A_WIDTH": bits_of(a), "Y_WIDTH": bits_of(y)})
    for a, b in ((1, 1), (3, 2)):
        yield Cell("$concat", [Pin("A", a), Pin("B", b), Pin("Y", a + b, True)],
                   {"A_WIDTH": bits_of(a), "B_WIDTH": bits_of(b)})
    for width in (1, 2, 3):
        size = {"WIDTH": bits_of(width)}
        data = [Pin("A", width), Pin("B", width)]
        yield Cell("$mux", [*data, Pin("S", 1), Pin("Y", width, True)], size)
        yield Cell("$tribuf", [Pin("A", width), Pin("EN", 1), Pin("Y", width, True)], size)
        yield Cell("$fa", [*data, Pin("C", width), Pin("X", width, True), Pin("Y", width, True)], size)
        yield Cell("$lcu", [Pin("P", width), Pin("G", width), Pin("CI", 1),
                            Pin("CO", width, True)], size)
        for table in range(3):
            yield Cell("$lut", [Pin("A", width), Pin("Y", 1, True)],
                       {"LUT": bits_of(draw.getrandbits(1 << width), 1 << width), **size})
            yield Cell("$sop", [Pin("A", width), Pin("Y", 1, True)],
                       {"DEPTH": bits_of(2), "TABLE": bits_of(draw.getrandbits(4 * width), 4 * width),
                        **size})
    for width, selects in ((1, 1), (1, 2), (2, 1), (2, 2), (1, 3)):
        size = {"WIDTH": bits_of(width), "S_WIDTH": bits_of(selects)}
        yield Cell("$pmux", [Pin("A", width), Pin("B", width * selects), Pin("S", selects),
                             Pin("Y", width, True)], size)
        yield Cell("$demux", [Pin("A", width), Pin("S", selects),
                              Pin("Y", width << selects, True)], size)
        yield Cell("$bmux", [Pin("A", width << selects), Pin("S", selects), Pin("Y", width, True)],
                   size)


def sums() -> Iterator[Cell]:
    """Sums of products: of each term its sign, whether it is subtracted, and the widths of its factors."""
    for terms, single, width in (
            (((0, 0, 4, 4), (0, 0, 4, 0), (0, 1, 4, 0)), 0, 8), (((1, 0, 3, 3), (1, 1, 2, 3)), 0, 7),
            (((1, 1, 3, 0), (0, 0, 2, 2), (0, 1, 2, 0)), 3, 4), (((0, 0, 1, 0),), 2, 3),
            (((1, 0, 3, 2), (0, 0, 0, 0), (1, 0, 1, 0)), 1, 2), ((), 3, 4)):
        size = max([1, *(count.bit_length() for term in terms for count in term[2:])])
        config = bits_of(size, 4)
        for is_signed, is_subtracted, first, second in terms:
            config = bits_of(second, size) + bits_of(first, size) + f"{is_subtracted}{is_signed}" + config
        operand = sum(first + second for _, _, first, second in terms)
        yield Cell("$macc", [Pin("A", operand), Pin("B", single), Pin("Y", width, True)],
                   {"A_WIDTH": bits_of(operand), "B_WIDTH": bits_of(single), "CONFIG": config,
                    "CONFIG_WIDTH": bits_of(len(config)), "Y_WIDTH": bits_of(width)})


def state_machines(count: int) -> Iterator[Cell]:
    """Random tables. Some have a row for every input, others patterns of which the last one holds."""
    draw = random.Random(10)
    for number in range(count):
        states, inputs, outputs = draw.randint(2, 4), draw.randint(1, 3), draw.randint(1, 3)
        log2 = draw.choice((2, 3))
        rows = []
        for state in range(states):
            for _ in range(draw.randint(1, 4)):
                pattern = "".join(draw.choice("01" if number % 4 == 0 else "01--")
                                  for _ in range(inputs))
                rows.append(bits_of(state, log2) + pattern + bits_of(draw.randrange(states), log2) +
                            bits_of(draw.getrandbits(outputs), outputs))
        is_one_hot = draw.random() < 0.5
        codes = ["-" * (states - 1 - state) + "1" + "-" * state if is_one_hot else bits_of(state, 2)
                 for state in range(states)]
        yield Cell("$fsm", [Pin("CLK", 1), Pin("ARST", 1), Pin("CTRL_IN", inputs),
                            Pin("CTRL_OUT", outputs, True)],
                   {"CLK_POLARITY": bits_of(draw.getrandbits(1), 1),
                    "ARST_POLARITY": bits_of(draw.getrandbits(1), 1),
                    "CTRL_IN_WIDTH": bits_of(inputs), "CTRL_OUT_WIDTH": bits_of(outputs),
                    "STATE_BITS": bits_of(len(codes[0])), "STATE_NUM": bits_of(states),
                    "STATE_NUM_LOG2": bits_of(log2), "STATE_RST": bits_of(draw.randrange(states)),
                    "STATE_TABLE": "".join(reversed(codes)), "TRANS_NUM": bits_of(len(rows)),
                    "TRANS_TABLE": "".join(rows)})


REGISTERS = {
    "sr": "SET CLR", "dff": "CLK", "dffe": "CLK EN", "dffsr": "CLK SET CLR",
    "dffsre": "CLK SET CLR EN", "adff": "CLK ARST", "adffe": "CLK ARST EN", "aldff": "CLK ALOAD",
    "aldffe": "CLK ALOAD EN", "sdff": "CLK SRST", "sdffe": "CLK SRST EN", "sdffce": "CLK SRST EN",
    "dlatch": "EN", "adlatch": "EN ARST", "dlatchsr": "EN SET CLR",
}


def registers() -> Iterator[Cell]:
    draw = random.Random(4)
    for name, text in REGISTERS.items():
        controls = text.split()
        for width in (1, 2):
            for levels in itertools.product((0, 1), repeat=len(controls)):
                pins = [Pin(pin, width if pin in ("SET", "CLR") else 1) for pin in controls]
                pins += [Pin("AD", width)] if "ALOAD" in controls else []
                pins += [Pin("D", width)] if name != "sr" else []
                values = {f"{pin}_POLARITY": bits_of(level, 1) for pin, level in zip(controls, levels)}
                for reset in ("ARST", "SRST"):
                    if reset in controls:
                        values[f"{reset}_VALUE"] = bits_of(draw.getrandbits(width), width)
                yield Cell(f"${name}", [*pins, Pin("Q", width, True)],
                           {"WIDTH": bits_of(width), **values})


def memories(count: int) -> Iterator[Cell]:
    """Memories with ports of all kinds. Ports that write have a clock, which no two share: Yosys'
    model lets the order of its events show where two write at once."""
    draw = random.Random(5)
    for _ in range(count):
        width, address, read, write = (draw.choice((1, 2)), draw.choice((1, 2)), draw.choice((1, 2)),
                                       draw.choice((1, 1, 2)))
        size = draw.choice((1 << address, (1 << address) - (address > 1)))
        clocked = draw.getrandbits(read)
        def some(bits: int) -> str:
            return bits_of(draw.getrandbits(bits), bits)
        parameters = {
            "MEMID": bits_of(0), "SIZE": bits_of(size), "OFFSET": bits_of(0), "ABITS": bits_of(address),
            "WIDTH": bits_of(width), "INIT": some(size * width), "RD_PORTS": bits_of(read),
            "RD_CLK_ENABLE": bits_of(clocked, read), "RD_CLK_POLARITY": some(read),
            "RD_TRANSPARENCY_MASK": some(read * write), "RD_COLLISION_X_MASK": bits_of(0, read * write),
            "RD_WIDE_CONTINUATION": bits_of(0, read), "RD_CE_OVER_SRST": some(read),
            "RD_ARST_VALUE": some(read * width), "RD_SRST_VALUE": some(read * width),
            "RD_INIT_VALUE": some(read * width), "WR_PORTS": bits_of(write),
            "WR_CLK_ENABLE": bits_of(-1, write), "WR_CLK_POLARITY": some(write),
            "WR_PRIORITY_MASK": bits_of(0, write * write), "WR_WIDE_CONTINUATION": bits_of(0, write)}
        # What is read without a clock has no reset.
        plain = frozenset(port for port in range(read) if not clocked >> port & 1)
        pins = [Pin("RD_CLK", read), Pin("WR_CLK", write), Pin("RD_EN", read),
                Pin("RD_ARST", read, tied=plain), Pin("RD_SRST", read, tied=plain),
                Pin("RD_ADDR", read * address), Pin("WR_EN", write * width),
                Pin("WR_ADDR", write * address), Pin("WR_DATA", write * width),
                Pin("RD_DATA", read * width, True)]
        yield Cell("$mem_v2", pins, parameters)


def in_pieces(label: str, cells: Iterable[Cell], size: int) -> Iterator[Batch]:
    cells = list(cells)
    for start in range(0, len(cells), size):
        piece = cells[start:start + size]
        yield Batch(f"{label} {start + 1}-{start + len(piece)}", piece,
                    every(inputs_of(piece)))


def word_batches(is_full: bool) -> Iterator[Batch]:
    cells = list(operators())
    if not is_full:
        # Of each operator a few sizes.
        draw = random.Random(6)
        kept = {name: [cell for cell in cells if cell.type == name] for name in
                dict.fromkeys(cell.type for cell in cells)}
        cells = [cell for group in kept.values() for cell in draw.sample(group, 5)]
    small = [cell for cell in cells if cell.inputs <= 8]
    yield from in_pieces("operators", small, 400)
    yield from in_pieces("operators of more inputs", [c for c in cells if c not in small], 400)
    yield from in_pieces("other functions", other_functions(), 400)
    adding = list(sums())
    yield Batch("sums of products", adding, walk(adding, 60000 if is_full else 3000, 11))
    machines = list(state_machines(200 if is_full else 30))
    yield Batch("state machines", machines, walk(machines, 30000 if is_full else 3000, 12), WARM_UP)
    stored = list(registers())
    small = [cell for cell in stored if cell.inputs <= SMALL]
    large = [cell for cell in stored if cell.inputs > SMALL]
    yield Batch("registers", small, walk(small, 200000 if is_full else 3000, 7), WARM_UP, is_full)
    yield Batch("registers of more inputs", large, walk(large, 30000 if is_full else 3000, 9), WARM_UP)
    memory = list(memories(60 if is_full else 12))
    yield Batch("memories", memory, walk(memory, 60000 if is_full else 4000, 8), WARM_UP)


def main() -> int:
    parser = argparse.ArgumentParser(description=__doc__.splitlines()[0])
    parser.add_argument("--tool", type=Path, required=True, help="the orn-hdl to be judged")
    parser.add_argument("--full", action="store_true", help="all sizes, and long walks")
    parser.add_argument("--work", type=Path, help="a folder for all files, which are kept")
    options = parser.parse_args()
    tool = Tool(options.tool)
    tally = Tally()
    batches = [*gate_batches(options.full), *word_batches(options.full)]
    for number, batch in enumerate(batches):
        with tempfile.TemporaryDirectory() as scratch:
            work = (options.work or Path(scratch)) / str(number)
            work.mkdir(parents=True, exist_ok=True)
            tally.check(f"{batch.label}: {len(batch.cells)} cells, {len(batch.steps)} steps",
                        compare, tool, batch, work)
    return tally.close()


if __name__ == "__main__":
    raise SystemExit(main())

"""Random vectors for a design and test benches that apply them, in both languages.

Each cycle sets all inputs, lets them settle, prints the outputs as one line of bits, and gives the
clock a pulse. The same vectors through RTL, Verilog netlist and VHDL netlist give the same lines.
"""

from __future__ import annotations

import json
import random
import re
from collections.abc import Callable
from dataclasses import dataclass, field
from pathlib import Path

from judges import Ghdl, Rejected, quoted, run_yosys, simulate_verilog

CYCLES = 400
BENCH = "bench"


@dataclass(frozen=True)
class Stimulus:
    """Which inputs of a design are not just random."""

    clock: str | None = None
    resets: dict[str, int] = field(default_factory=dict)  # name to active level
    # Two-way ports: the input, and its level, at which the design drives them itself.
    driven_when: dict[str, tuple[str, int]] = field(default_factory=dict)
    # Inputs with one level in the first two cycles and another one from then on.
    steady: dict[str, tuple[int, int]] = field(default_factory=dict)


@dataclass(frozen=True)
class Port:
    name: str
    direction: str  # input, output, inout
    width: int


def ports_of(source: Path, top: str, work: Path) -> list[Port]:
    """The ports of a Verilog module, in order."""
    target = work / "ports.json"
    run_yosys(f"read_verilog {quoted(source)}; proc; write_json {quoted(target)}")
    ports = json.loads(target.read_text())["modules"][top]["ports"]
    return [Port(name, port["direction"], len(port["bits"])) for name, port in ports.items()]


class Bench:
    """Vectors for one design, and runs of its forms through them.

    Every run takes `name_of`, which gives that form's name of a port.
    """

    def __init__(self, design: str, ports: list[Port], stimulus: Stimulus, work: Path) -> None:
        self.ports = ports
        self.stimulus = stimulus
        self.work = work
        self.driven = [port for port in ports
                       if port.direction != "output" and port.name != stimulus.clock]
        self.nets = {port.name: f"o{number}" for number, port in enumerate(ports)
                     if port.direction != "input"}
        self.slices = {}  # left and right bit of a port in a vector
        self.width = 0
        for port in reversed(self.driven):
            self.slices[port.name] = (self.width + port.width - 1, self.width)
            self.width += port.width
        self.vectors = work / "vectors.txt"
        self.vectors.write_text("\n".join(self._vectors(random.Random(design))) + "\n")

    def _vectors(self, source: random.Random) -> list[str]:
        return ["".join(format(self._value(port, cycle, source), f"0{port.width}b")
                        for port in self.driven) for cycle in range(CYCLES)]

    def _value(self, port: Port, cycle: int, source: random.Random) -> int:
        """Random; a reset is active at first and then now and again."""
        if port.name in self.stimulus.steady:
            return self.stimulus.steady[port.name][cycle >= 2]
        if port.name not in self.stimulus.resets:
            return source.getrandbits(port.width)
        active = cycle < 2 or source.random() < 1 / 64
        return self.stimulus.resets[port.name] ^ (not active)

    def name_levels(self, shown: list[str]) -> list[dict[str, str]]:
        """The bits of each port in each cycle, inputs as they were set and outputs as they were shown."""
        cycles = []
        for set_, line in zip(self.vectors.read_text().split(), shown, strict=True):
            levels = {}
            for bits, ports in ((set_, self.driven),
                                (line, [port for port in self.ports if port.name in self.nets])):
                for port in ports:
                    levels[port.name], bits = bits[:port.width], bits[port.width:]
            cycles.append(levels)
        return cycles

    def run_verilog(self, sources: list[Path], top: str,
                    name_of: Callable[[str], str] = str) -> list[str]:
        """Simulates Verilog; one line of outputs a cycle."""
        source = self.work / f"{BENCH}.v"
        source.write_text(self._verilog(top, name_of))
        return simulate_verilog([source, *sources], BENCH, self.work).splitlines()

    def run_vhdl(self, ghdl: Ghdl, netlist: Path, top: str,
                 name_of: Callable[[str], str] = str) -> list[str]:
        """Simulates a VHDL netlist that `ghdl` has analysed, through its configuration if any."""
        source = ghdl.work / f"{BENCH}.vhd"
        source.write_text(self._vhdl(netlist.read_text(errors="replace"), top, name_of))
        ghdl.analyse(source)
        return ghdl.run(BENCH).splitlines()

    def _verilog(self, top: str, name_of: Callable[[str], str]) -> str:
        def driven(port: Port) -> str:
            return "in[{}:{}]".format(*self.slices[port.name])

        pins, nets = [], []
        for port in self.ports:
            net = self.nets.get(port.name)
            if net:
                nets.append(f"   wire [{port.width - 1}:0] {net};")
            if port.name in self.stimulus.driven_when:
                enable, level = self.stimulus.driven_when[port.name]
                nets.append(f"   assign {net} = in[{self.slices[enable][1]}] == 1'b{level} ?"
                            f" {port.width}'bz : {driven(port)};")
            actual = net or ("clock" if port.name == self.stimulus.clock else driven(port))
            pins.append(f".\\{name_of(port.name)} ({actual})")
        return _VERILOG_BENCH.format(
            bench=BENCH, width=self.width, cycles=CYCLES, nets="\n".join(nets), top=top,
            pins=", ".join(pins), shown=", ".join(self.nets.values()), vectors=self.vectors)

    def _vhdl(self, netlist: str, top: str, name_of: Callable[[str], str]) -> str:
        vectors = _vector_ports(netlist, top)
        pins, signals, drivers = [], [], []
        for port in self.ports:
            net = self.nets.get(port.name)
            is_vector = name_of(port.name).lower() in vectors
            left, right = self.slices.get(port.name, (0, 0))
            driven = f"stimulus({left} downto {right})" if is_vector else f"stimulus({right})"
            if net:
                kind = f"std_logic_vector({port.width - 1} downto 0)" if is_vector else "std_logic"
                signals.append(f"   signal {net} : {kind};")
            if port.name in self.stimulus.driven_when:
                enable, level = self.stimulus.driven_when[port.name]
                idle = "(others => 'Z')" if is_vector else "'Z'"
                drivers.append(f"   {net} <= {idle} when stimulus({self.slices[enable][1]})"
                               f" = '{level}' else {driven};")
            actual = net or ("clock" if port.name == self.stimulus.clock else driven)
            pins.append(f"{name_of(port.name)} => {actual}")
        configured = f"configuration CFG_{top} of ".lower() in netlist.lower()
        return _VHDL_BENCH.format(
            bench=BENCH, width=self.width, cycles=CYCLES, signals="\n".join(signals),
            unit=f"configuration work.CFG_{top}" if configured else f"entity work.{top}",
            pins=",\n      ".join(pins), drivers="\n".join(drivers), vectors=self.vectors,
            shown=" & ".join(f"image({net})" for net in self.nets.values()))


def _vector_ports(netlist: str, top: str) -> set[str]:
    """The ports of a VHDL entity that are vectors, in small letters; a vector may be one wide."""
    entity = re.search(rf"\bentity {top} is\b(.*?)\bend {top};", netlist.lower(), re.DOTALL)
    if entity is None:
        raise Rejected(f"no entity {top} in the VHDL netlist")
    return set(re.findall(r"(\w+)\s*:\s*(?:in|out|inout)\s+std_logic_vector", entity.group(1)))


def refuse_difference(expected: list[str], found: list[str], what: str) -> None:
    """Rejects the run `what` at the first cycle in which its outputs differ from the expected."""
    if len(expected) != CYCLES or len(found) != CYCLES:
        raise Rejected(f"{what}: {len(found)} cycles and not {len(expected)}:\n" +
                       "\n".join(found[-5:]))
    for cycle, (want, have) in enumerate(zip(expected, found)):
        if want != have:
            raise Rejected(f"{what}: cycle {cycle}: {have} where {want} is expected")


_VERILOG_BENCH = """`timescale 1ns / 1ps

module {bench};
   reg             clock = 1'b0;
   reg [{width}-1:0] in;
   reg [{width}-1:0] vectors [0:{cycles}-1];
   integer         cycle;
{nets}

   {top} dut({pins});

   initial begin
      $readmemb("{vectors}", vectors);
      for (cycle = 0; cycle < {cycles}; cycle = cycle + 1) begin
         in = vectors[cycle];
         #5;
         $display("%b", {{{shown}}});
         clock = 1'b1;
         #5;
         clock = 1'b0;
      end
   end
endmodule
"""

_VHDL_BENCH = """library ieee;
use ieee.std_logic_1164.all;
use std.textio.all;

entity {bench} is
end {bench};

architecture run of {bench} is
   signal clock    : std_logic := '0';
   signal stimulus : std_logic_vector({width} - 1 downto 0);
{signals}

   function image(value : std_logic) return string is
   begin
      case value is
         when '0' => return "0";
         when '1' => return "1";
         when 'Z' => return "z";
         when others => return "x";
      end case;
   end image;

   function image(value : std_logic_vector) return string is
      alias bits : std_logic_vector(1 to value'length) is value;
      variable result : string(1 to value'length);
   begin
      for i in bits'range loop
         result(i to i) := image(bits(i));
      end loop;
      return result;
   end image;
begin
   dut : {unit} port map (
      {pins});
{drivers}

   process
      file vectors   : text open read_mode is "{vectors}";
      variable words : line;
      variable bits  : string(1 to {width});
      variable shown : line;
   begin
      for cycle in 1 to {cycles} loop
         readline(vectors, words);
         read(words, bits);
         for i in bits'range loop
            if bits(i) = '1' then
               stimulus(stimulus'length - i) <= '1';
            else
               stimulus(stimulus'length - i) <= '0';
            end if;
         end loop;
         wait for 5 ns;
         write(shown, string'({shown}));
         writeline(output, shown);
         clock <= '1';
         wait for 5 ns;
         clock <= '0';
      end loop;
      wait;
   end process;
end run;
"""

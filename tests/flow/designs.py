"""The designs of the flow and of the examples, and what is special about each."""

from pathlib import Path

from judging import Design
from judges import DANGLING_INPUT, UNDRIVEN
from vectors import Stimulus

TESTS = Path(__file__).resolve().parents[1]
RTL = TESTS / "flow" / "rtl"
EXAMPLES = TESTS.parent / "examples"
VHDL93 = TESTS / "judges" / "vhdl93"

CLOCK_AND_RESET = Stimulus("clk", {"rst": 1})


def _rtl_design(name: str, stimulus: Stimulus, folder: Path = RTL) -> Design:
    source = folder / f"{name}.v"
    return Design(name, stimulus, source, rtl=source)


RTL_DESIGNS = [
    _rtl_design("counter", CLOCK_AND_RESET),
    _rtl_design("fifo", CLOCK_AND_RESET),
    _rtl_design("uart", CLOCK_AND_RESET),
    _rtl_design("alu", Stimulus()),
    _rtl_design("risc", Stimulus("clk", {"rst_n": 0})),
    _rtl_design("crossbar", CLOCK_AND_RESET),
    _rtl_design("pads", Stimulus("clk", {"rst": 1},
                                 {"pad": ("drive", 1), "single": ("drive_single", 1)})),
    _rtl_design("feedback", CLOCK_AND_RESET),
    _rtl_design("ranges", CLOCK_AND_RESET),
    _rtl_design("names", CLOCK_AND_RESET),
    _rtl_design("lanes", CLOCK_AND_RESET),
    _rtl_design("regfile", CLOCK_AND_RESET),
    _rtl_design("wires", Stimulus()),
    _rtl_design("cpu8", Stimulus("clk", {"reset": 1}), EXAMPLES / "cpu8"),
]


def _case(name: str, stimulus: Stimulus = Stimulus(), **more: tuple[str, ...]) -> Design:
    return Design(name, stimulus, VHDL93 / f"{name}.cmd", **more)


_CELL_CLOCK = Stimulus("CLK", {"CLR": 1})

COMMAND_FILES = [
    Design("top", source=EXAMPLES / "and2" / "and2.cmd", yosys_allows=(UNDRIVEN,)),
    Design("accu4", _CELL_CLOCK, EXAMPLES / "accu4" / "accu4.cmd"),
    Design("counter8", _CELL_CLOCK, EXAMPLES / "counter8" / "counter8.cmd",
           EXAMPLES / "counter8" / "counter8_rtl.v", "counter8_rtl"),
    Design("cpu8", Stimulus("clk", {"reset": 1}), EXAMPLES / "cpu8" / "cpu8.cmd",
           EXAMPLES / "cpu8" / "cpu8.v"),
    _case("read_outputs", _CELL_CLOCK),
    _case("compounds", _CELL_CLOCK),
    _case("open_pins", iverilog_allows=(DANGLING_INPUT,),
          # A write of VHDL leaves its signals for open pins in the design.
          yosys_allows=(f"_openSignal {UNDRIVEN}",)),
    _case("bus_directions"),
    _case("one_bit_buses", _CELL_CLOCK),
    _case("against_parent", _CELL_CLOCK),
    _case("constants"),
    _case("generics", Stimulus(driven_when={"PAD": ("T", 0)})),
    _case("widening"),
    _case("attributes"),
]

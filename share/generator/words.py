"""Models of the word-level cells of Yosys: entities whose generics are the cells' parameters.

A port is never narrower than one bit, as in the components that orn-hdl import makes.
"""

from __future__ import annotations

from dataclasses import dataclass, field
from pathlib import Path

_INDENT = "   "

PACKAGE = (Path(__file__).parent / "words.vhd").read_text(encoding="utf-8")


@dataclass(frozen=True)
class Port:
    """A port, as many bits wide as its expression over the parameters says; empty is one std_logic."""
    name: str
    direction: str = "in"
    width: str = ""
    # What an output has at first.
    start: str = ""


@dataclass(frozen=True)
class Cell:
    name: str
    comment: str
    parameters: list[str]
    ports: list[Port]
    body: list[str]
    declarations: list[str] = field(default_factory=list)
    # Parameters whose digits can be others than 0 and 1, with their defaults.
    texts: dict[str, str] = field(default_factory=dict)
    # How wide ports are, where parameters do not tell it.
    numbers: list[str] = field(default_factory=list)


_ENTITY = "orn_hdl_{}"
_A = Port("A", width="number(A_WIDTH)")
_B = Port("B", width="number(B_WIDTH)")
_Y = Port("Y", "out", "number(Y_WIDTH)")
_WIDTH = "number(WIDTH)"
_UNARY = ["A_SIGNED", "A_WIDTH", "Y_WIDTH"]
_BINARY = ["A_SIGNED", "A_WIDTH", "B_SIGNED", "B_WIDTH", "Y_WIDTH"]
_SIGNED = "constant both_signed : boolean := is_set(A_SIGNED) and is_set(B_SIGNED);"

# What a cell of one operand does with it, once it is as wide as the result.
_EXTENDED = {
    "not": ("not A", "not {}"),
    "pos": ("A", "{}"),
    "neg": ("0 - A", "difference(zeros({}'length), {})"),
}

# What becomes of all bits of the operand.
_REDUCED = {
    "reduce_and": ("whether all bits of A are 1", "all_ones({})"),
    "reduce_or": ("whether A has a 1", "any_one({})"),
    "reduce_bool": ("whether A has a 1", "any_one({})"),
    "reduce_xor": ("whether the number of ones in A is odd", "odd_ones({})"),
    "reduce_xnor": ("whether the number of ones in A is even", "not odd_ones({})"),
    "logic_not": ("whether A is 0", "not any_one({})"),
}

# What becomes of two operands that are both as wide as the result.
_BITWISE = {
    "and": ("A and B", "{0} and {1}"),
    "or": ("A or B", "{0} or {1}"),
    "xor": ("A xor B", "{0} xor {1}"),
    "xnor": ("A xnor B", "not ({0} xor {1})"),
    "add": ("A + B", "sum({0}, {1}, '0')"),
    "sub": ("A - B", "difference({0}, {1})"),
    "mul": ("A * B", "product({0}, {1})"),
}

# What becomes of two operands that are wider than both and than the result by a bit, and signed.
_DIVIDED = {
    "div": ("A / B, rounded towards 0", "quotient({0}, {1}, false)"),
    "mod": ("the remainder of A / B, with the sign of A", "remainder({0}, {1}, false)"),
    "divfloor": ("A / B, rounded downwards", "quotient({0}, {1}, true)"),
    "modfloor": ("the remainder of A / B, with the sign of B", "remainder({0}, {1}, true)"),
}

# What becomes of two operands of the same width, which is a bit more than the wider one has.
_COMPARED = {
    "eq": ("A = B", "equal({0}, {1})"),
    "ne": ("A /= B", "not equal({0}, {1})"),
    "eqx": ("A = B, x and z included", "identical({0}, {1})"),
    "nex": ("A /= B, x and z included", "not identical({0}, {1})"),
    "lt": ("A < B", "less({0}, {1})"),
    "le": ("A <= B", "not less({1}, {0})"),
    "gt": ("A > B", "less({1}, {0})"),
    "ge": ("A >= B", "not less({0}, {1})"),
}

_LOGIC = {"logic_and": ("both A and B have a 1", "and"), "logic_or": ("A or B has a 1", "or")}

# How a shift treats the sign of A, whether B has a sign, and the sign of a distance to the right.
_SHIFTED = {
    "shl": ("A, shifted left by B", "false", "false", "-"),
    "sshl": ("A, shifted left by B", "false", "false", "-"),
    "shr": ("A, shifted right by B", "false", "false", ""),
    "sshr": ("A, shifted right by B, with A's sign", "is_set(A_SIGNED)", "false", ""),
    "shift": ("A, shifted right by B, or left where B is negative", "false", "is_set(B_SIGNED)", ""),
}


def _extended(operand: str, width: str, signed: str) -> str:
    return f"extend({operand}, number({operand}_WIDTH), {signed}, {width})"


def _operators() -> list[Cell]:
    result = []
    for name, (comment, text) in _EXTENDED.items():
        operand = _extended("A", "Y'length", "is_set(A_SIGNED)")
        value = text.format("Y", operand) if name == "neg" else text.format(operand)
        result.append(Cell(name, f"Y is {comment}.", _UNARY, [_A, _Y], [f"Y <= {value};"]))
    for name, (comment, text) in _REDUCED.items():
        value = text.format("extend(A, number(A_WIDTH), false, number(A_WIDTH))")
        result.append(Cell(name, f"Y tells {comment}.", _UNARY, [_A, _Y],
                           [f"Y <= bit_of({value}, Y'length);"]))
    for name, (comment, text) in _BITWISE.items():
        value = text.format(*(_extended(pin, "Y'length", "both_signed") for pin in "AB"))
        result.append(Cell(name, f"Y is {comment}.", _BINARY, [_A, _B, _Y], [f"Y <= {value};"], [_SIGNED]))
    for name, (comment, text) in _DIVIDED.items():
        wide = ["constant width : natural := largest(largest(A'length, B'length), Y'length) + 1;"]
        value = text.format(*(_extended(pin, "width", "both_signed") for pin in "AB"))
        result.append(Cell(name, f"Y is {comment}.", _BINARY, [_A, _B, _Y],
                           [f"Y <= extend({value}, width, true, Y'length);"], [_SIGNED, *wide]))
    for name, (comment, text) in _COMPARED.items():
        wide = ["constant width : natural := largest(A'length, B'length) + 1;"]
        value = text.format(*(_extended(pin, "width", "both_signed") for pin in "AB"))
        result.append(Cell(name, f"Y tells whether {comment}.", _BINARY, [_A, _B, _Y],
                           [f"Y <= bit_of({value}, Y'length);"], [_SIGNED, *wide]))
    for name, (comment, word) in _LOGIC.items():
        operands = [f"any_one(extend({pin}, number({pin}_WIDTH), false, number({pin}_WIDTH)))"
                    for pin in "AB"]
        result.append(Cell(name, f"Y tells whether {comment}.", _BINARY, [_A, _B, _Y],
                           [f"Y <= bit_of({operands[0]} {word} {operands[1]}, Y'length);"]))
    for name, (comment, arithmetic, turns, sign) in _SHIFTED.items():
        wide = ["constant width : natural := largest(A'length, Y'length);"]
        distance = f"distance(B, number(B_WIDTH), {turns})"
        value = (f"moved({_extended('A', 'width', 'is_set(A_SIGNED)')}, "
                 f"{sign}{distance}, {arithmetic})")
        result.append(Cell(name, f"Y is {comment}.", _BINARY, [_A, _B, _Y],
                           [f"Y <= resized({value}, B, Y'length);"], wide))
    return result


def _other_functions() -> list[Cell]:
    width = Port("A", width=_WIDTH)
    both = [width, Port("B", width=_WIDTH)]
    select = Port("S", width="number(S_WIDTH)")
    return [
        Cell("shiftx", "Y is what A has from bit B on; beyond A it is x.", _BINARY, [_A, _B, _Y],
             ["Y <= part(A, number(A_WIDTH), distance(B, number(B_WIDTH), is_set(B_SIGNED)), "
              "B, Y'length);"]),
        Cell("pow", "Y is A to the power of B.", _BINARY, [_A, _B, _Y],
             ["Y <= power(A, number(A_WIDTH), is_set(A_SIGNED), B, number(B_WIDTH), "
              "is_set(B_SIGNED), Y'length);"]),
        Cell("slice", "Y is what A has from bit OFFSET on.", ["OFFSET", "A_WIDTH", "Y_WIDTH"],
             [_A, _Y], ["Y <= extend(moved(extend(A, A'length, false, A'length + Y'length), "
                        "number(OFFSET), false), Y'length, false, Y'length);"]),
        Cell("concat", "Y is B and, below it, A.", ["A_WIDTH", "B_WIDTH"],
             [_A, _B, Port("Y", "out", "number(A_WIDTH) + number(B_WIDTH)")],
             ["Y <= extend(B & A, B'length + A'length, false, Y'length);"]),
        Cell("mux", "Y is B while S is 1, otherwise A.", ["WIDTH"],
             [*both, Port("S"), Port("Y", "out", _WIDTH)], ["Y <= choice(A, B, S);"]),
        Cell("bmux", "Y is part number S of A.", ["WIDTH", "S_WIDTH"],
             [Port("A", width="number(WIDTH) * 2 ** number(S_WIDTH)"), select,
              Port("Y", "out", _WIDTH)],
             ["Y <= chosen_part(A, S, number(S_WIDTH), Y'length);"]),
        Cell("pmux", "Y is the part of B whose bit of S is 1, A where S is 0, x where S has two ones.",
             ["WIDTH", "S_WIDTH"],
             [width, Port("B", width="number(WIDTH) * number(S_WIDTH)"), select,
              Port("Y", "out", _WIDTH)], ["Y <= one_hot(A, B, S);"]),
        Cell("demux", "Part number S of Y is A, the others are 0.", ["WIDTH", "S_WIDTH"],
             [width, select, Port("Y", "out", "number(WIDTH) * 2 ** number(S_WIDTH)")],
             ["Y <= placed(A, S, number(S_WIDTH), Y'length);"]),
        Cell("lut", "Y is bit number A of LUT.", ["LUT", "WIDTH"],
             [width, Port("Y", "out")],
             ["Y <= bit_of_table(LUT, A, number(WIDTH));"]),
        Cell("sop", "Y tells whether A fits a row of TABLE.", ["DEPTH", "TABLE", "WIDTH"],
             [width, Port("Y", "out")], ["Y <= fits(A, TABLE, number(DEPTH));"]),
        Cell("tribuf", "Y is A while EN is 1, otherwise Z.", ["WIDTH"],
             [width, Port("EN"), Port("Y", "out", _WIDTH)],
             ["Y <= A when EN = '1' else (others => 'Z') when EN = '0' else (others => 'X');"]),
        Cell("fa", "Full adders: X has the carries and Y the sums of A, B and C.", ["WIDTH"],
             [*both, Port("C", width=_WIDTH), Port("X", "out", _WIDTH), Port("Y", "out", _WIDTH)],
             ["X <= (A and B) or (C and (A xor B));", "Y <= A xor B xor C;"]),
        Cell("lcu", "CO has the carries of an adder that generates G and propagates P.", ["WIDTH"],
             [Port("P", width=_WIDTH), Port("G", width=_WIDTH), Port("CI"),
              Port("CO", "out", _WIDTH)], ["CO <= carries(P, G, CI);"]),
        Cell("macc", "Y is the sum of products and numbers that A has, as CONFIG says, and of the bits of B.",
             ["A_WIDTH", "B_WIDTH", "CONFIG", "CONFIG_WIDTH", "Y_WIDTH"],
             [Port("A", width="largest(number(A_WIDTH), A_PINS)"),
              Port("B", width="largest(number(B_WIDTH), B_PINS)"), _Y],
             ["Y <= accumulated(A, CONFIG, B, number(B_WIDTH), Y'length);"],
             numbers=["A_PINS", "B_PINS"]),
        Cell("alu", "Y is A + B + CI, with B inverted while BI is 1; X is A xor B, CO has the carries.",
             _BINARY, [_A, _B, Port("CI"), Port("BI"), Port("X", "out", "number(Y_WIDTH)"), _Y,
                       Port("CO", "out", "number(Y_WIDTH)")],
             ["process (A, B, CI, BI)",
              "   variable first, second : std_logic_vector(Y'length - 1 downto 0);",
              "begin",
              "   first := " + _extended("A", "Y'length", "both_signed") + ";",
              "   second := " + _extended("B", "Y'length", "both_signed") +
              " xor copies(BI, Y'length);",
              "   X <= first xor second;",
              "   if is_x(A & B & CI & BI) then",
              "      Y <= copies('X', Y'length);",
              "      CO <= copies('X', Y'length);",
              "   else",
              "      Y <= sum(first, second, CI);",
              "      CO <= carries(first xor second, first and second, CI);",
              "   end if;",
              "end process;"], [_SIGNED]),
    ]


# Registers by what they have beside data: the name, and whether a latch's enable, a clock, a clock
# enable, a set and a clear for each bit, a reset or a load is there.
_REGISTERS = {
    "sr": ["set"],
    "dff": ["clock"], "dffe": ["clock", "enable"],
    "dffsr": ["clock", "set"], "dffsre": ["clock", "set", "enable"],
    "adff": ["clock", "reset"], "adffe": ["clock", "reset", "enable"],
    "aldff": ["clock", "load"], "aldffe": ["clock", "load", "enable"],
    "sdff": ["clock", "synchronous"], "sdffe": ["clock", "synchronous", "enable"],
    "sdffce": ["clock", "synchronous", "enable"],
    "dlatch": ["enable"], "adlatch": ["enable", "reset"], "dlatchsr": ["enable", "set"],
}

_ABOUT = {
    "clock": "a clock", "enable": "an enable", "set": "a set and a clear for each bit",
    "reset": "an asynchronous reset", "load": "an asynchronous load",
    "synchronous": "a synchronous reset",
}

_CONTROLS = {
    "clock": [("CLK", "CLK_POLARITY", "")],
    "enable": [("EN", "EN_POLARITY", "")],
    "set": [("SET", "SET_POLARITY", _WIDTH), ("CLR", "CLR_POLARITY", _WIDTH)],
    "reset": [("ARST", "ARST_POLARITY", "")],
    "load": [("ALOAD", "ALOAD_POLARITY", "")],
    "synchronous": [("SRST", "SRST_POLARITY", "")],
}

_RESET_VALUES = {"reset": "ARST_VALUE", "synchronous": "SRST_VALUE"}


def _register(name: str, parts: list[str]) -> Cell:
    parameters = ["WIDTH"] + [polarity for part in parts for _, polarity, _ in _CONTROLS[part]]
    parameters += [value for part, value in _RESET_VALUES.items() if part in parts]
    ports = [Port(pin, width=width) for part in parts for pin, _, width in _CONTROLS[part]]
    ports += [Port("AD", width=_WIDTH)] if "load" in parts else []
    ports += [Port("D", width=_WIDTH)] if name != "sr" else []
    kind = "A register" if "clock" in parts else "Latches"
    comment = f"{kind} with {', '.join(_ABOUT[part] for part in parts)}"
    comment += ("; the reset needs the enable." if name == "sdffce" else ".")
    comment = comment.replace("Latches with a set", "Latches without data, with a set")
    return Cell(name, comment, sorted(parameters),
                [*ports, Port("Q", "out", _WIDTH, "first_value(INIT, highest(number(WIDTH)) + 1)")],
                _register_body(name, parts), texts={"INIT": "U"})


def _register_body(name: str, parts: list[str]) -> list[str]:
    if "set" in parts:
        bits = _process(name, parts, "(i)")
        return ["bits : for i in Q'range generate", *(_INDENT + line for line in bits),
                "end generate;"]
    return _process(name, parts, "")


def _active(part: str, pin: str, index: str) -> str:
    polarity = next(level for name, level, _ in _CONTROLS[part] if name == pin)
    return f"is_active({pin}{index}, {polarity})"


def _process(name: str, parts: list[str], index: str) -> list[str]:
    if "clock" not in parts:
        return _clocked_process(name, parts, index, "")
    lines = []
    for label, edge, condition in (("rising", "rising_edge", ""), ("falling", "falling_edge", "not ")):
        lines.append(f"{label} : if {condition}is_set(CLK_POLARITY) generate")
        lines += [_INDENT + line for line in _clocked_process(name, parts, index, edge)]
        lines.append("end generate;")
    return lines


def _clocked_process(name: str, parts: list[str], index: str, edge: str) -> list[str]:
    waits, branches = [], []
    if "set" in parts:
        waits += ["CLR" + index, "SET" + index]
        branches += [(_active("set", "CLR", index), ["Q(i) <= '0';"]),
                     (_active("set", "SET", index), ["Q(i) <= '1';"])]
    if "reset" in parts:
        waits.append("ARST")
        branches.append((_active("reset", "ARST", ""), ["Q <= value_of(ARST_VALUE, Q'length);"]))
    if "load" in parts:
        waits += ["ALOAD", "AD"]
        branches.append((_active("load", "ALOAD", ""), ["Q <= AD;"]))
    data = [f"Q{index} <= D{index};"]
    enable = _active("enable", "EN", "") if "enable" in parts else ""
    if edge:
        waits.append("CLK")
        branches.append((f"{edge}(CLK)", _at_edge(name, parts, data, enable)))
    elif name != "sr":
        waits += ["EN", "D" + index]
        branches.append((enable, data))
    return [f"process ({', '.join(waits)})", "begin",
            *(_INDENT + line for line in _if(branches)), "end process;"]


def _at_edge(name: str, parts: list[str], data: list[str], enable: str) -> list[str]:
    if "synchronous" not in parts:
        return _if([(enable, data)]) if enable else data
    reset = (_active("synchronous", "SRST", ""), ["Q <= value_of(SRST_VALUE, Q'length);"])
    if name == "sdffce":
        return _if([(enable, _if([reset, ("", data)]))])
    return _if([reset, (enable, data)])


def _if(branches: list[tuple[str, list[str]]]) -> list[str]:
    """Statements, of which the first one holds whose condition is met; the last may have none."""
    lines: list[str] = []
    for number, (condition, body) in enumerate(branches):
        lines.append(f"{'els' if number else ''}if {condition} then" if condition else "else")
        lines += [_INDENT + line for line in body]
    return [*lines, "end if;"]


_READ = "number(RD_PORTS)"
_WRITE = "number(WR_PORTS)"

_MEMORY = Cell(
    "mem_v2", "A memory with any number of ports to read and to write.",
    ["ABITS", "INIT", "OFFSET", "RD_ARST_VALUE", "RD_CE_OVER_SRST", "RD_CLK_ENABLE",
     "RD_CLK_POLARITY", "RD_COLLISION_X_MASK", "RD_INIT_VALUE", "RD_PORTS", "RD_SRST_VALUE",
     "RD_TRANSPARENCY_MASK", "SIZE", "WIDTH", "WR_CLK_ENABLE", "WR_CLK_POLARITY", "WR_PORTS"],
    [Port("RD_CLK", width=_READ), Port("RD_EN", width=_READ), Port("RD_ARST", width=_READ),
     Port("RD_SRST", width=_READ), Port("RD_ADDR", width=f"{_READ} * number(ABITS)"),
     Port("RD_DATA", "out", f"{_READ} * number(WIDTH)"),
     Port("WR_CLK", width=_WRITE), Port("WR_EN", width=f"{_WRITE} * number(WIDTH)"),
     Port("WR_ADDR", width=f"{_WRITE} * number(ABITS)"),
     Port("WR_DATA", width=f"{_WRITE} * number(WIDTH)")],
    (Path(__file__).parent / "memory.vhd").read_text(encoding="utf-8").splitlines())


_STATE_MACHINE = Cell(
    "fsm", "A state machine. CTRL_OUT is x, and the next state that of a reset, where no row fits.",
    ["ARST_POLARITY", "CLK_POLARITY", "CTRL_IN_WIDTH", "CTRL_OUT_WIDTH", "STATE_NUM_LOG2",
     "STATE_RST", "TRANS_NUM"],
    [Port("CLK"), Port("ARST"), Port("CTRL_IN", width="number(CTRL_IN_WIDTH)"),
     Port("CTRL_OUT", "out", "number(CTRL_OUT_WIDTH)")],
    ["row <= row_of(TRANS_TABLE, number(TRANS_NUM), states, inputs, outputs, state, CTRL_IN);",
     "CTRL_OUT <= outputs_of(TRANS_TABLE, row, states, inputs, outputs, CTRL_OUT'length);",
     "process (CLK, ARST)",
     "begin",
     "   if is_active(ARST, ARST_POLARITY) then",
     "      state <= number(STATE_RST);",
     "   elsif CLK'event and ticks(true, is_set(CLK_POLARITY), CLK'last_value, CLK) then",
     "      state <= next_state(TRANS_TABLE, row, states, inputs, outputs, number(STATE_RST));",
     "   end if;",
     "end process;"],
    ["constant states : natural := number(STATE_NUM_LOG2);",
     "constant inputs : natural := number(CTRL_IN_WIDTH);",
     "constant outputs : natural := number(CTRL_OUT_WIDTH);",
     "-- The number of the state, and of the row that fits; -1 for none.",
     "signal state, row : integer := -1;"],
    {"TRANS_TABLE": "0"})


def cells() -> list[Cell]:
    """All word-level cells that have a model."""
    registers = [_register(name, parts) for name, parts in _REGISTERS.items()]
    return [*_operators(), *_other_functions(), *registers, _MEMORY, _STATE_MACHINE]


def _port(port: Port) -> str:
    if not port.width:
        default = " := '0'" if port.direction == "in" else ""
        return f"{port.name} : {port.direction} std_logic{default}"
    kind = f"std_logic_vector(highest({port.width}) downto 0)"
    default = " := (others => '0')" if port.direction == "in" else f" := {port.start}" if port.start else ""
    return f"{port.name} : {port.direction} {kind}{default}"


def model(cell: Cell) -> str:
    """The entity and architecture of a cell."""
    entity = _ENTITY.format(cell.name)
    lines = [f"-- ${cell.name}: {cell.comment}", "library ieee;", "use ieee.std_logic_1164.all;",
             "use work.orn_hdl_cells.all;", "", f"entity {entity} is", f"{_INDENT}generic ("]
    generics = [f"{name} : bit_vector := b\"0\"" for name in cell.parameters]
    generics += [f"{name} : string := \"{default}\"" for name, default in cell.texts.items()]
    generics += [f"{name} : natural := 0" for name in cell.numbers]
    ports = [_port(port) for port in cell.ports]
    lines += [f"{2 * _INDENT}{text};" for text in generics[:-1]] + [2 * _INDENT + generics[-1]]
    lines += [f"{_INDENT});", f"{_INDENT}port ("]
    lines += [f"{2 * _INDENT}{text};" for text in ports[:-1]] + [2 * _INDENT + ports[-1]]
    lines += [f"{_INDENT});", f"end {entity};", "", f"architecture model of {entity} is"]
    lines += [_INDENT + line for line in cell.declarations]
    return "\n".join([*lines, "begin", *(_INDENT + line if line else "" for line in cell.body),
                      "end model;", ""])

#!/usr/bin/env python3
"""Netlists that real tools reject or read in two ways, each pinned with who rejects it and why.

A judge that is named for a case must reject it in these words; every other one must accept it.
When this fails, either the netlists or the tools have changed: see the limits in the documentation.
"""

from __future__ import annotations

import re
from collections.abc import Callable
from dataclasses import dataclass
from pathlib import Path

from judging import Design, Forms, Tally, judges, main, prove_languages_agree, simulate
from designs import TESTS
from judges import Ghdl, Rejected
from tool import Tool

FOLDER = TESTS / "judges" / "limits"


@dataclass(frozen=True)
class Limit(Design):
    """A case, and a part of what each judge that rejects it says."""

    rejected_by: tuple[tuple[str, str], ...] = ()


def _limit(name: str, **rejected_by: str) -> Limit:
    return Limit(name, source=FOLDER / f"{name}.cmd", rejected_by=tuple(rejected_by.items()))


def _vhdl(words: str) -> dict[str, str]:
    """Both editions of VHDL reject, and so nothing can be simulated or proven in it."""
    return {"ghdl_93": words, "ghdl_08": words}


LIMITS = [
    _limit("attribute_types", **_vhdl("can't match integer literal")),
    _limit("bare_bus_constant", verilator="WIDTH", languages="nproven",
           simulation="is expected"),
    _limit("bare_generic", verilator="Too many digits", languages="nproven",
           simulation="is expected"),
    _limit("comment_in_value", iverilog="syntax error", verilator="Unterminated string",
           yosys="syntax error", languages="syntax error", simulation="syntax error"),
    _limit("constant_against", languages="nproven", simulation="is expected"),
    _limit("constant_width", **_vhdl("string length does not match")),
    _limit("driven_input", verilator="MULTIDRIVEN", yosys="multiple conflicting drivers",
           languages="multiple assignments"),
    _limit("generic_and_attribute", **_vhdl("already used for a declaration")),
    _limit("missing_configuration", **_vhdl('unit "cfg_inv1" not found')),
    _limit("no_ports", **_vhdl("empty interface list")),
    _limit("open_bit", **_vhdl("cannot associate individually with open")),
    _limit("open_input", iverilog="dangling input port", **_vhdl("must be connected")),
    _limit("open_member", iverilog="syntax error", verilator="syntax error",
           yosys="syntax error", **_vhdl("open")),
    _limit("output_alias", ghdl_93="cannot be read"),
    _limit("pin_width", iverilog="expects 4 bits", verilator="WIDTH", yosys="Resizing cell port",
           **_vhdl("constraints don't match")),
    _limit("quotes_in_value", **_vhdl("not terminated")),
    _limit("reserved_word", iverilog="syntax error", verilator="syntax error",
           yosys="syntax error", **_vhdl("identifier is expected")),
    _limit("slice_outside", iverilog="selecting after the vector", verilator="SELRANGE",
           yosys="out of bounds", **_vhdl("static range violates bounds")),
    _limit("sliding_bus", iverilog="out of range", verilator="Internal Error",
           yosys="out of bounds",
           **_vhdl("static range violates bounds")),
    _limit("two_drivers", verilator="MULTIDRIVEN", yosys="multiple conflicting drivers"),
    _limit("undeclared_attribute", **_vhdl('no declaration for "loc"')),
    _limit("undeclared_generic", **_vhdl('no declaration for "init"')),
    _limit("widened_after_write", ghdl_93="actual port of mode out"),
    _limit("underscores", **_vhdl("underscore|can't start with")),
]


def _analyse(standard: str, forms: Forms, top: str, work: Path) -> None:
    ghdl = _ghdl(standard, work / f"vhdl{standard}")
    ghdl.analyse(forms.vhdl)
    ghdl.elaborate(top)


def _ghdl(standard: str, folder: Path) -> Ghdl:
    folder.mkdir()
    return Ghdl(standard, folder)


def _simulate(limit: Limit, forms: Forms, work: Path) -> None:
    ghdl = _ghdl("93", work / "simulation")
    ghdl.analyse(forms.vhdl)
    simulate(limit, forms, {"93": ghdl}, work)


def refuse_other_outcome(words: str | None, judge: Callable[..., None], *arguments) -> None:
    """The judge rejects in these words, or without any accepts."""
    try:
        judge(*arguments)
    except Rejected as rejection:
        if words is None or not re.search(words, str(rejection)):
            raise
        return
    if words is not None:
        raise Rejected("accepted, though a limit says otherwise")


def run_limit(tally: Tally, program: Path, limit: Limit, work: Path) -> None:
    forms = tally.check(f"{limit.name}: replay", Tool(program).replay, limit.source, work)
    if not forms:
        return
    expected = dict(limit.rejected_by)
    top = limit.name
    cases = {
        "iverilog": (judges.iverilog, forms.verilog, top),
        "verilator": (judges.verilator, forms.verilog, top),
        "yosys": (judges.yosys, forms.verilog, top),
        "ghdl_93": (_analyse, "93", forms, top, work),
        "ghdl_08": (_analyse, "08", forms, top, work),
    }
    if "ghdl_93" not in expected:
        cases["languages"] = (prove_languages_agree, top, forms, work)
        cases["simulation"] = (_simulate, limit, forms, work)
    for name, case in cases.items():
        tally.check(f"{limit.name}: {name}", refuse_other_outcome, expected.get(name), *case)


if __name__ == "__main__":
    raise SystemExit(main(__doc__.splitlines()[0], LIMITS, run_limit))

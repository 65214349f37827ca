"""Nothing of Python, and nothing of the library, is left behind by what is done again and again."""

from __future__ import annotations

import ctypes
import gc
import os
import sys
from pathlib import Path
from typing import Tuple

import orn_hdl
import pytest
from support import half_adder


class MallInfo2(ctypes.Structure):
    """What glibc tells of its heap."""

    _fields_ = [(name, ctypes.c_size_t) for name in ("arena", "ordblks", "smblks", "hblks", "hblkhd", "usmblks",
                                                     "fsmblks", "uordblks", "fordblks", "keepcost")]


def in_use() -> Tuple[int, int]:
    """Blocks of Python's own allocator, and bytes of the heap."""
    gc.collect()
    tell = ctypes.CDLL(None).mallinfo2
    tell.restype = MallInfo2
    info = tell()
    return sys.getallocatedblocks(), info.uordblks + info.hblkhd


def refuse(call: object, *arguments: object) -> None:
    """Makes a call that has to fail."""
    with pytest.raises(Exception):
        call(*arguments)  # type: ignore[operator]


def work(folder: Path) -> None:
    d = half_adder()
    d.port("D", "in", 8)[3:0].assign("N(3:0)")
    d.set_attribute("INIT", "8:H:A5", "BitVector").value = "8:H:00"
    d.add_comment("a comment")
    d.write_verilog(folder / "half.v", header=False)
    d.write_vhdl(folder / "half.vhd", header=False)
    d.verify_verilog(folder / "half.v")
    orn_hdl.Design("again").read_verilog(folder / "half.v", infer=True)
    orn_hdl.Design("again").read_vhdl(folder / "half.vhd")
    d.check()
    d.options.libraries = ["one", "two"]
    assert d.options.libraries and d.options.device == "" and d.counts() and d.commands()
    for thing in (*d.components, *d.instances, *d.nets):
        repr(thing), thing.attributes, thing.comment
    for pin in d["U1"]:
        assert pin.net.pins and pin.width and pin.direction
    list(d.connections())
    next(d.connections())
    d.connection_arrays()
    d.add_instances(["X0", "X1"], (["AND2"], [0, 0]))
    d.connect_many(iter(["A", "B"]), ["X0", "X1"], "I0")
    refuse(d.add_instances, ["X2", 7], "AND2")
    refuse(d.execute, "ADD NOTHING")
    refuse(d.execute, b"NOOP")
    refuse(d.read_verilog, folder / "missing.v")
    refuse(d.write_verilog, folder / "missing" / "half.v")
    refuse(d._native.connect, "A")
    refuse(d._native.set_option, "none", 1)
    refuse(d.check, "none")
    d["U1"].remove()
    d["A"].name = "Z"
    with orn_hdl.Engine() as engine:
        engine.design("one")
        engine.remove(engine.design("two"))


@pytest.mark.skipif("ASAN_OPTIONS" in os.environ, reason="a sanitizer has a heap of its own")
def test_nothing_is_left(tmp_path: Path) -> None:
    rounds = 100
    for _ in range(rounds):
        work(tmp_path)
    blocks, heap = in_use()
    for _ in range(rounds):
        work(tmp_path)
    blocks_now, heap_now = in_use()
    # A leak would show in every round.
    assert blocks_now - blocks < rounds // 2
    assert heap_now - heap < rounds * 16

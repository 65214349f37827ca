"""Designs in threads of their own, and one design in two threads."""

from __future__ import annotations

import os
import threading
from pathlib import Path
from typing import List

import orn_hdl
import pytest


def build(name: str, size: int) -> orn_hdl.Design:
    d = orn_hdl.Design(name)
    d.component("INV", I="in", O="out")
    d.add_instances([f"U{i}" for i in range(size)], "INV")
    d.connect_many([f"N{i}" for i in range(size)], [f"U{i}" for i in range(size)], "O")
    return d


def test_designs_of_their_own() -> None:
    texts: List[str] = [""] * 4

    def work(i: int) -> None:
        texts[i] = build("top", 2000).to_verilog()

    threads = [threading.Thread(target=work, args=(i,)) for i in range(4)]
    for thread in threads:
        thread.start()
    for thread in threads:
        thread.join()
    assert texts == [build("top", 2000).to_verilog()] * 4


def test_one_design_in_two_threads(tmp_path: Path) -> None:
    """While one thread is in a long call, others run, and are refused. The call lasts as long as its pipe."""
    pipe = tmp_path / "pipe"
    os.mkfifo(pipe)
    d = orn_hdl.Design()
    thread = threading.Thread(target=d.read_commands, args=(pipe,))
    thread.start()
    with open(pipe, "w") as lines:
        for use in (lambda: d.name, lambda: len(d.components), lambda: d.execute("NOOP"), d.close,
                    lambda: d.add_instances(["U0"], "INV"), lambda: next(iter(d.instances)),
                    lambda: d.options.legal):
            with pytest.raises(orn_hdl.BusyError):
                use()
        lines.write("ADD COMPONENT INV\nADD INSTANCE INV U1\n")
    thread.join()
    assert [u.name for u in d.instances] == ["U1"]

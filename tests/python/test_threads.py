"""Designs in threads of their own, and one design in two threads."""

from __future__ import annotations

import threading
from pathlib import Path
from typing import List

import orn_hdl


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
    """While one thread is in a long call, others run, and are refused."""
    source = tmp_path / "long.cmd"
    source.write_text("ADD COMPONENT INV\n" + "".join(f"ADD INSTANCE INV U{i}\n" for i in range(200000)))
    d = orn_hdl.Design()
    thread = threading.Thread(target=d.read_commands, args=(source,))
    thread.start()
    refused = turns = 0
    while thread.is_alive():
        turns += 1
        try:
            len(d.components)
        except orn_hdl.BusyError:
            refused += 1
    thread.join()
    assert refused > 0 and len(d.instances) == 200000

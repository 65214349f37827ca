"""The comparison of random designs accepts correct netlists and rejects wrong ones."""

from __future__ import annotations

import random
import unittest
from typing import Any

from roundtrip import DIRECTIONS, batches, refuse_other_verilog, refuse_other_vhdl
from judges import Rejected
from random_designs import ONE, ZERO, Bit, RandomDesign, random_leaves

Json = dict[str, Any]


def make_design(seed: int) -> RandomDesign:
    return RandomDesign(f"d{seed}", seed, random_leaves(random.Random(seed)))


class Reading:
    """The module that a tool would read of a design, made of the design's own account."""

    def __init__(self, design: RandomDesign) -> None:
        self._numbers: dict[Bit, int | str] = {ZERO: "0", ONE: "1"}
        ports = {}
        for signal in design.ports():
            ports[signal.name] = {"direction": DIRECTIONS[signal.direction[0]],
                                  "bits": self._read(design.bits_of(signal))}
            low, _ = signal.bounds()
            if low:
                ports[signal.name]["offset"] = low
            if signal.is_bus and signal.left < signal.right:
                ports[signal.name]["upto"] = 1
        cells = {name: {"type": leaf.name, "parameters": dict(design.generics[name]),
                        "connections": {pin.name: self._read(design.bits_at(name, pin))
                                        for pin in leaf.pins}}
                 for name, leaf in design.instances.items()}
        self.modules = {design.name: {"ports": ports, "cells": cells}}

    def _read(self, bits: list[Bit]) -> list[int | str]:
        return [self._numbers.setdefault(bit, len(self._numbers)) for bit in bits[::-1]]


class ComparisonTest(unittest.TestCase):
    def lists_of_bits(self, module: Json) -> list[list[int | str]]:
        return ([port["bits"] for port in module["ports"].values()] +
                [bits for cell in module["cells"].values()
                 for bits in cell["connections"].values() if bits])

    def test_right_readings(self) -> None:
        for seed in range(100):
            design = make_design(seed)
            modules = Reading(design).modules
            refuse_other_verilog(design, modules)
            refuse_other_vhdl(design, modules)

    def test_every_single_wrong_bit(self) -> None:
        """A bit on the net of another bit, or torn off its own, is found wherever it is."""
        for seed in range(60):
            design = make_design(seed)
            modules = Reading(design).modules
            lists = self.lists_of_bits(modules[design.name])
            every = [bit for bits in lists for bit in bits]
            for bits in lists:
                for position, right in enumerate(bits):
                    # A net of one bit may have any number.
                    torn = [-1] if every.count(right) > 1 or right in ("0", "1") else []
                    for wrong in {every[0], every[-1], *torn} - {right}:
                        bits[position] = wrong
                        with self.assertRaises(Rejected):
                            refuse_other_verilog(design, modules)
                    bits[position] = right
            refuse_other_verilog(design, modules)

    def refuse(self, change: Any) -> None:
        """A change to the module of some design with ports, buses, cells and generics is found."""
        refused = 0
        for seed in range(40):
            design = make_design(seed)
            modules = Reading(design).modules
            if change(modules[design.name]):
                refused += 1
                with self.assertRaises(Rejected):
                    refuse_other_verilog(design, modules)
        self.assertGreater(refused, 5)

    def test_other_names(self) -> None:
        for table in ("ports", "cells"):
            self.refuse(lambda module, t=table: module[t].pop(next(iter(module[t]))))
            self.refuse(lambda module, t=table: module[t].update(
                more=next(iter(module[t].values()))) or True)

    def test_other_directions(self) -> None:
        def turn(module: Json) -> bool:
            port = next(iter(module["ports"].values()))
            port["direction"] = "output" if port["direction"] == "input" else "input"
            return True
        self.refuse(turn)

    def test_other_ranges(self) -> None:
        def move(module: Json) -> bool:
            port = next(iter(module["ports"].values()))
            port["offset"] = port.get("offset", 0) + 1
            return True

        def turn(module: Json) -> bool:
            wide = [port for port in module["ports"].values() if len(port["bits"]) > 1]
            for port in wide:
                port["upto"] = 1 - port.get("upto", 0)
            return bool(wide)
        self.refuse(move)
        self.refuse(turn)

    def test_other_types_and_generics(self) -> None:
        def rename(module: Json) -> bool:
            next(iter(module["cells"].values()))["type"] += "x"
            return True

        def change(module: Json) -> bool:
            cells = [cell for cell in module["cells"].values() if cell["parameters"]]
            for cell in cells:
                name = next(iter(cell["parameters"]))
                cell["parameters"][name] += "0"
            return bool(cells)
        self.refuse(rename)
        self.refuse(change)

    def test_unknown_values(self) -> None:
        """A tool may say "x" or "z" where nothing drives, and nowhere else."""
        accepted = refused = 0
        for seed in range(40):
            design = make_design(seed)
            for signal in design.ports():
                modules = Reading(design).modules
                modules[design.name]["ports"][signal.name]["bits"][-1] = "x"
                if design.is_driven(design.bits_of(signal)[0]):
                    refused += 1
                    with self.assertRaises(Rejected):
                        refuse_other_vhdl(design, modules)
                else:
                    accepted += 1
                    refuse_other_vhdl(design, modules)
        self.assertGreater(min(accepted, refused), 5)


class SeedsTest(unittest.TestCase):
    def test_every_seed_once(self) -> None:
        for first, last in ((1, 1), (1, 100), (50, 50), (49, 51), (0, 149)):
            self.assertEqual([seed for batch in batches(first, last) for seed in batch],
                             list(range(first, last + 1)))


if __name__ == "__main__":
    unittest.main()

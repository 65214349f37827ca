"""Sources include only what stands in their own layer or below it; the table in docs/architecture.md
says which files and folders a layer is."""

from __future__ import annotations

import re
import unittest
from pathlib import Path

PROJECT = Path(__file__).resolve().parents[2]
INCLUDE = re.compile(r'^#include "(.*?)"', re.M)

ROW = re.compile(r"^\| (\w+) \|[^|]*\|([^|]*)\|([^|]*)\|$", re.M)


def layers() -> list[tuple[str, list[str]]]:
    """The rows of the page's table, lowest first: the layer's name, then its files and folders as they
    are included, public and private ones alike."""
    page = (PROJECT / "docs" / "architecture.md").read_text()
    rows = [(name, re.findall(r"`([^`]+)`", public) +
             [folder.removeprefix("s/") for folder in re.findall(r"`([^`]+)`", private)])
            for name, public, private in ROW.findall(page)]
    return rows[[name for name, _ in rows].index("tool"):][::-1]


LAYERS = layers()

# What the page names as its exceptions.
UPWARDS = {
    ("HdlModel/Model.cpp", "HdlCmd/Script/CommandScript.h"),
    ("HdlModel/Model.cpp", "Orn_Hdl/Commands.h"),
    ("Options/HdlUtilities.cpp", "Orn_Hdl/Writers/NetlistHeader.h"),
    ("Verilog/VerilogNetlister.cpp", "Orn_Hdl/LegalNetlist.h"),
    ("Vhdl/VhdlNetlister.cpp", "Orn_Hdl/LegalNetlist.h"),
}


def layer_of(file: str) -> int:
    """The layer whose row names the file or the innermost folder around it."""
    inner = file.removeprefix("Orn_Hdl/")
    found = [(len(place), order) for order, (_, places) in enumerate(LAYERS) for place in places
             if inner == place or inner.startswith(place.rstrip("/") + "/")]
    if not found:
        raise AssertionError(f"{file} belongs to no layer")
    return max(found)[1]


def includes() -> list[tuple[str, str]]:
    """Every source or header with each header of the project that it includes."""
    found = []
    for folder, prefix in (("include", ""), ("s", ""), ("tools/orn-hdl", "tools/orn-hdl/")):
        for path in sorted((PROJECT / folder).rglob("*.[ch]*")):
            name = prefix + path.relative_to(PROJECT / folder).as_posix()
            for header in INCLUDE.findall(path.read_text()):
                is_own = prefix and (PROJECT / folder / header).exists()
                found.append((name, prefix + header if is_own else header))
    return found


class Layers(unittest.TestCase):
    def test_no_include_points_upwards(self) -> None:
        self.assertGreater(len(includes()), 100)
        upwards = {(file, header) for file, header in includes()
                   if layer_of(header) > layer_of(file)}
        self.assertEqual(upwards, UPWARDS)

    def test_every_place_of_the_table_exists(self) -> None:
        self.assertEqual(len(LAYERS), 17)
        for name, places in LAYERS:
            for place in places:
                self.assertTrue(any((PROJECT / root / place).exists()
                                    for root in ("include", "include/Orn_Hdl", "s", "")),
                                f"{name}: {place}")


if __name__ == "__main__":
    unittest.main()

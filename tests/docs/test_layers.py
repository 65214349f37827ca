"""Sources include only what stands in their own layer or below it, as docs/architecture.md says."""

from __future__ import annotations

import re
import unittest
from pathlib import Path

PROJECT = Path(__file__).resolve().parents[2]
INCLUDE = re.compile(r'^#include "(.*?)"', re.M)

# From the lowest to the highest; the first pattern that matches a file tells its layer. Headers are
# named as they are included, public and private ones alike.
LAYERS = {
    "portability": r"Port/|Orn_Hdl/Exception\.h|HdlModel/Failure\.",
    "containers": r"(Orn_Hdl/)?Containers(/|\.)",
    "streams": r"(Orn_Hdl/)?Streams(/|\.)",
    "design": r"Orn_Hdl/Attributes\.h|Orn_Hdl/Model/(?!Design\.)|HdlModel/(?!Design\.|ModelUse\.)",
    "options": r"(Orn_Hdl/)?Options(/|\.)",
    "writers": r"(Orn_Hdl/)?Writers(/|\.)|Header/|Verilog/|Vhdl/",
    "model": r"Orn_Hdl/Model(/Design)?\.h|HdlModel/(Design|ModelUse)\.",
    "commands": r"Orn_Hdl/Commands\.h|HdlCmd/",
    "engine": r"Orn_Hdl/(Engine|Orn_Hdl)\.h|HdlEngine/",
}
ORDER = list(LAYERS)

# What the page names as its exceptions.
UPWARDS = {
    ("HdlModel/Design.cpp", "Orn_Hdl/Commands.h"),
    ("Options/HdlUtilities.cpp", "Orn_Hdl/Writers/NetlistHeader.h"),
}


def layer_of(file: str) -> int:
    for order, pattern in enumerate(LAYERS.values()):
        if re.match(pattern, file):
            return order
    raise AssertionError(f"{file} belongs to no layer")


def includes() -> list[tuple[str, str]]:
    """Every source or header of the library with each header of the library that it includes."""
    found = []
    for folder in ("include", "s"):
        for path in sorted((PROJECT / folder).rglob("*.[ch]*")):
            name = path.relative_to(PROJECT / folder).as_posix()
            found += [(name, header) for header in INCLUDE.findall(path.read_text())]
    return found


class Layers(unittest.TestCase):
    def test_no_include_points_upwards(self) -> None:
        self.assertGreater(len(includes()), 100)
        upwards = {(file, header) for file, header in includes()
                   if layer_of(header) > layer_of(file)}
        self.assertEqual(upwards, UPWARDS)

    def test_the_page_names_the_layers_in_this_order(self) -> None:
        page = (PROJECT / "docs" / "architecture.md").read_text()
        rows = re.findall(r"^\| (\w+) \| .*\|$", page, re.M)
        self.assertEqual(rows[rows.index("tool") + 1:], ORDER[::-1])


if __name__ == "__main__":
    unittest.main()

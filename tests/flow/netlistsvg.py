#!/usr/bin/env python3
"""The sample netlists of the npm package netlistsvg: imported and judged, or refused with a reason.

The package is fetched for each run; without a registry that answers, this test is skipped.
"""

from __future__ import annotations

import json
import re
import shutil
import subprocess
import sys
import tarfile
import tempfile
import unittest
from pathlib import Path

sys.path.insert(0, str(Path(__file__).resolve().parents[1] / "tool"))

from yosys_json import ImportTest, Json, make_stubs  # noqa: E402

PACKAGE = "netlistsvg@1.0.2"
SKIPPED = 77  # the exit status that tells CTest so
TIME_LIMIT = 60  # seconds to wait for the registry

IMPORTED = ["analog/and", "analog/common_emitter_full", "analog/mcu", "analog/resistor_divider",
            "digital/generics", "digital/ports_splitjoin", "digital/up3down5"]
WITH_A_COMMA = "analog/vcc_and_gnd"
REFUSED = {
    "digital/hyperedges": "modules.hyperedges.ports.i1.bits[0]: two input ports share this bit",
}
WITH_HIERARCHY = "digital/mux4"
# Schematics have open nets, and nets that several parts drive.
OPEN_INPUT = "dangling input port"
OPEN_NET = "has no driver|conflicting drivers|^    port "

samples: dict[str, Path] = {}


class Samples(ImportTest):
    def test_every_sample_has_its_outcome(self) -> None:
        self.assertEqual(sorted(samples), sorted([*IMPORTED, *REFUSED, WITH_A_COMMA, WITH_HIERARCHY]))

    def test_imported(self) -> None:
        for name in IMPORTED:
            with self.subTest(name):
                self.judge_sample(json.loads(samples[name].read_text("utf-8")))

    def judge_sample(self, contents: Json) -> None:
        """Both languages before the judges, and the wiring that Yosys reads."""
        (top,) = contents["modules"].values()
        # VHDL does not allow a design without ports.
        top["ports"] = top.get("ports") or {"idle": {"direction": "input", "bits": [10**6]}}
        done = self.import_design(contents, allowed=OPEN_INPUT)
        self.write("cells.v", "".join(f"(* blackbox *) {stub}\n"
                                      for stub in make_stubs(done.commands)))
        self.judge(["yosys", "-q", "-p", "read_verilog -lib cells.v; read_verilog x.verilog; "
                    "hierarchy -check; check; proc; write_json x.json"], OPEN_NET)
        name = re.search(r"^module (\w+)", done.verilog, re.MULTILINE)[1]
        self.compare_wiring(top, json.loads(self.read("x.json"))["modules"][name])

    def test_refused(self) -> None:
        for name, message in REFUSED.items():
            with self.subTest(name):
                self.refuse(samples[name].read_text("utf-8"), message)

    def test_a_comma_too_many(self) -> None:
        """Only relatives of JSON allow it."""
        self.refuse(samples[WITH_A_COMMA].read_text("utf-8"),
                    "modules.test.cells.vcc.attributes: invalid JSON: a comma, colon, quote or "
                    "bracket is missing or superfluous", line=16, place="          ^")

    def test_refused_for_a_comma_only(self) -> None:
        text = samples[WITH_A_COMMA].read_text("utf-8")
        self.judge_sample(json.loads(re.sub(r",(\s*})", r"\1", text)))

    def test_hierarchy(self) -> None:
        self.write("d.json", samples[WITH_HIERARCHY].read_text("utf-8"))
        outcome = self.run_tool("import", "d.json", "--top", "MUX4", "--verilog", "-", "--no-header")
        self.assertEqual(outcome.status, 0, outcome.err)
        self.assertEqual(re.findall(r"^module (\w+)", outcome.out, re.MULTILINE),
                         ["MUX2", "MUX4"])

    def test_black_box_in_place_of_a_module(self) -> None:
        contents = json.loads(samples[WITH_HIERARCHY].read_text("utf-8"))
        contents["modules"]["MUX2"]["attributes"] = {"blackbox": "1"}
        (self.folder / "d.json").write_text(json.dumps(contents), encoding="utf-8")
        self.import_file("d.json", "--top", "MUX4")


def fetch(folder: Path) -> str:
    """Unpacks the samples; returns why they cannot be had, or nothing."""
    if shutil.which("npm") is None:
        return "npm is not installed"
    try:
        done = subprocess.run(["npm", "pack", "--loglevel=error", "--fetch-retries=1", PACKAGE],
                              cwd=folder, text=True, capture_output=True, timeout=TIME_LIMIT,
                              check=False)
    except subprocess.TimeoutExpired:
        return "the npm registry does not answer"
    archives = list(folder.glob("*.tgz"))
    if done.returncode != 0 or not archives:
        return f"the npm registry does not give {PACKAGE}: {done.stderr.partition(chr(10))[0]}"
    with tarfile.open(archives[0]) as archive:
        archive.extractall(folder, filter="data")
    root = folder / "package" / "test"
    samples.update((str(path.relative_to(root).with_suffix("")), path)
                   for path in root.glob("*/*.json"))
    return ""


def main() -> int:
    with tempfile.TemporaryDirectory() as folder:
        obstacle = fetch(Path(folder))
        if obstacle:
            print(f"skipped: {obstacle}")
            return SKIPPED
        done = unittest.main(module=__name__, exit=False).result
    return 0 if done.wasSuccessful() else 1


if __name__ == "__main__":
    sys.exit(main())

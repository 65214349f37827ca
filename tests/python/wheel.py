"""The wheel of a build, installed in a clean virtual environment, works there without anything of the build:
wheel.py BUILD_FOLDER"""

from __future__ import annotations

import os
import shutil
import subprocess
import sys
import tempfile
import venv
from pathlib import Path

PROJECT = Path(__file__).resolve().parents[2]

PROGRAM = """\
import orn_hdl, sys
assert orn_hdl.__file__.startswith(sys.prefix), orn_hdl.__file__
design = orn_hdl.Design("top")
design.instance("U1", design.component("INV", I="in", O="out"), I=design.port("A", "in"), O="N")
assert "INV U1" in design.to_verilog()
assert orn_hdl.find_tool().startswith(sys.prefix)
with open("inverter.cmd", "w") as file:
    file.write(design.commands())
assert orn_hdl.run_tool("run", "--quiet", "--verilog", "inverter.v", "inverter.cmd").returncode == 0
print("fine")
"""


def run(*command: object) -> str:
    """Runs a program that has to succeed, without what the build has set for its tests."""
    clean = {name: value for name, value in os.environ.items() if name not in ("PYTHONPATH", "ORN_HDL_TOOL")}
    done = subprocess.run([str(word) for word in command], env=clean, stdout=subprocess.PIPE,
                          stderr=subprocess.STDOUT, text=True, check=False)
    if done.returncode != 0:
        raise SystemExit(f"{command}\n{done.stdout}")
    return done.stdout


def main() -> None:
    build = sys.argv[1]
    with tempfile.TemporaryDirectory() as work:
        os.chdir(work)
        run(sys.executable, "-m", "pip", "wheel", "--no-build-isolation", "--no-deps", "--quiet", "--no-index",
            "--config-settings", f"build={build}", "--wheel-dir", "wheels", PROJECT)
        (wheel,) = Path("wheels").iterdir()
        assert "-cp39-abi3-" in wheel.name, wheel.name
        wheel = wheel.rename(Path(work) / wheel.name)
        venv.create("clean", with_pip=True)
        python = Path(work, "clean", "bin", "python")
        run(python, "-m", "pip", "install", "--no-index", "--quiet", wheel)
        assert run(python, "-c", PROGRAM) == "fine\n"
        assert "NOOP" in run(python, "-m", "orn_hdl", "commands", "NOOP")
        # Nothing of the package may lead back to the build.
        moved = Path(work, "moved")
        shutil.copytree(next(Path("clean").glob("lib/*/site-packages/orn_hdl")), moved / "orn_hdl")
        extension = (moved / "orn_hdl" / "_orn_hdl.abi3.so").read_bytes()
        assert os.fsencode(build) not in extension and os.fsencode(PROJECT) not in extension
        run(sys.executable, "-c", f"import sys; sys.path.insert(0, {str(moved)!r}); import orn_hdl; "
            "assert orn_hdl.Design('t').name == 't'; assert orn_hdl.__file__.startswith(sys.path[0])")
        run(python, "-m", "pip", "uninstall", "--yes", "orn-hdl")
        assert not list(Path("clean").glob("lib/*/site-packages/orn_hdl*"))
    print("wheel: built, installed, used and removed")


if __name__ == "__main__":
    main()

"""Builds the wheel of the package with CMake; the tool, which `python -m orn_hdl` runs, comes with it.

A backend of our own needs nothing but CMake and a compiler, so the package installs where no index can be
reached: pip install --no-build-isolation .

Settings, as in `pip install --config-settings tool=off .`:
  build=FOLDER   use this build folder, which may be configured already, instead of build/wheel
  tool=off       leave the tool out, which needs the packages that scripts/setup.sh build installs
"""

from __future__ import annotations

import base64
import hashlib
import os
import re
import subprocess
import sys
import sysconfig
import tarfile
import tempfile
import zipfile
from pathlib import Path
from typing import Dict, Iterator, List, Mapping, Optional, Tuple

SOURCE = Path(__file__).resolve().parents[1]
NAME = "orn_hdl"
Settings = Optional[Mapping[str, str]]


def version() -> str:
    """The version of the project."""
    found = re.search(r"^project\(Orn_Hdl VERSION (\S+)", (SOURCE / "CMakeLists.txt").read_text(), re.M)
    assert found is not None
    return found[1]


def metadata() -> str:
    """What indexes and installers want to know."""
    return (f"Metadata-Version: 2.1\nName: orn-hdl\nVersion: {version()}\n"
            "Summary: Builds hardware designs and writes them as structural Verilog and VHDL\n"
            "Requires-Python: >=3.9\n"
            "Provides-Extra: graph\nRequires-Dist: networkx; extra == \"graph\"\n"
            "Provides-Extra: pandas\nRequires-Dist: pandas; extra == \"pandas\"\n"
            "Description-Content-Type: text/markdown\n\n"
            + (SOURCE / "docs" / "python.md").read_text(encoding="utf-8"))


def tag() -> str:
    """One wheel for every version from 3.9 on, by the stable interface."""
    platform = sysconfig.get_platform().replace("-", "_").replace(".", "_")
    return f"cp39-abi3-{platform}"


def build(stage: Path, settings: Mapping[str, str]) -> None:
    """Builds, and installs what belongs into the wheel."""
    folder = Path(settings.get("build", SOURCE / "build" / "wheel")).resolve()
    tool = settings.get("tool", "on").lower() not in ("off", "no", "0", "false")
    if not (folder / "CMakeCache.txt").exists():
        options = {"CMAKE_BUILD_TYPE": "Release", "CMAKE_UNITY_BUILD": "ON", "ORN_HDL_BUILD_PYTHON": "ON",
                   "ORN_HDL_PYTHON_EXECUTABLE": sys.executable, "ORN_HDL_BUILD_TESTS": "OFF",
                   "ORN_HDL_BUILD_TOOL": "ON" if tool else "OFF"}
        subprocess.run(["cmake", "-S", str(SOURCE), "-B", str(folder),
                        *(f"-D{name}={value}" for name, value in options.items())], check=True)
    subprocess.run(["cmake", "--build", str(folder), "--parallel", str(os.cpu_count() or 1), "--target",
                    "orn_hdl_python", *(["orn-hdl"] if tool else [])], check=True)
    subprocess.run(["cmake", "--install", str(folder), "--component", "Wheel", "--strip", "--prefix",
                    str(stage)], check=True, stdout=subprocess.DEVNULL)


def files_of(stage: Path) -> Iterator[Tuple[str, Path]]:
    """The files with their names in the wheel. A wheel has no links: a library goes by its link's name."""
    linked = {path.resolve() for path in stage.rglob("*") if path.is_symlink()}
    for path in sorted(stage.rglob("*")):
        if path.is_file() and (path.is_symlink() or path not in linked):
            yield path.relative_to(stage).as_posix(), path


def record_line(name: str, data: bytes) -> str:
    """The line of a file in the wheel's record."""
    digest = base64.urlsafe_b64encode(hashlib.sha256(data).digest()).rstrip(b"=").decode()
    return f"{name},sha256={digest},{len(data)}\n"


def information_texts() -> Dict[str, str]:
    """The files that tell of the wheel."""
    return {"METADATA": metadata(),
            "WHEEL": f"Wheel-Version: 1.0\nGenerator: orn_hdl\nRoot-Is-Purelib: false\nTag: {tag()}\n",
            "LICENSE": (SOURCE / "LICENSE").read_text(encoding="utf-8")}


def prepare_metadata_for_build_wheel(metadata_directory: str, config_settings: Settings = None) -> str:
    """Tells of the wheel without building it: writes a folder, and returns its name."""
    information = f"{NAME}-{version()}.dist-info"
    folder = Path(metadata_directory) / information
    folder.mkdir()
    for name, text in information_texts().items():
        (folder / name).write_text(text, encoding="utf-8")
    return information


def build_wheel(wheel_directory: str, config_settings: Settings = None,
                metadata_directory: Optional[str] = None) -> str:
    """Builds the wheel in a folder and returns its name."""
    information = f"{NAME}-{version()}.dist-info"
    wheel = f"{NAME}-{version()}-{tag()}.whl"
    with tempfile.TemporaryDirectory() as work:
        stage = Path(work).resolve() / "stage"
        build(stage, dict(config_settings or {}))
        contents: List[Tuple[str, bytes, int]] = [
            (name, path.read_bytes(), path.stat().st_mode & 0o777) for name, path in files_of(stage)]
    contents += [(f"{information}/{name}", text.encode(), 0o644) for name, text in information_texts().items()]
    record = "".join(record_line(name, data) for name, data, _ in contents) + f"{information}/RECORD,,\n"
    contents.append((f"{information}/RECORD", record.encode(), 0o644))
    with zipfile.ZipFile(Path(wheel_directory) / wheel, "w", zipfile.ZIP_DEFLATED) as archive:
        for name, data, mode in contents:
            entry = zipfile.ZipInfo(name, (1980, 1, 1, 0, 0, 0))
            entry.external_attr = (0o100000 | mode) << 16
            entry.compress_type = zipfile.ZIP_DEFLATED
            archive.writestr(entry, data)
    return wheel


def build_sdist(sdist_directory: str, config_settings: Settings = None) -> str:
    """Packs the files that are under version control, and returns the archive's name."""
    base = f"{NAME}-{version()}"
    names = subprocess.run(["git", "ls-files", "-z"], cwd=SOURCE, check=True, capture_output=True).stdout
    with tarfile.open(Path(sdist_directory) / f"{base}.tar.gz", "w:gz") as archive:
        for name in names.decode().split("\0"):
            if name and not (SOURCE / name).is_symlink():
                archive.add(SOURCE / name, f"{base}/{name}", recursive=False)
        with tempfile.NamedTemporaryFile("w", encoding="utf-8") as information:
            information.write(metadata())
            information.flush()
            archive.add(information.name, f"{base}/PKG-INFO")
    return f"{base}.tar.gz"

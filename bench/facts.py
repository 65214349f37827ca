"""What one must know of a build and its machine to compare figures."""

import pathlib
import re
import shutil
import subprocess


def first_line(*command: str) -> str:
    """What a program says of its version, without what stands behind in brackets."""
    if not shutil.which(command[0]):
        return "not installed"
    answer = subprocess.run(command, capture_output=True, text=True, check=False)
    lines = [line for line in (answer.stdout + answer.stderr).splitlines() if line.strip()]
    return re.sub(r"\s*\(.*", "", lines[0]) if lines else "unknown"


def cache_entries(build: pathlib.Path) -> dict[str, str]:
    """The variables of a CMake build folder; none when it is no such folder."""
    cache = build / "CMakeCache.txt"
    text = cache.read_text() if cache.is_file() else ""
    return dict(re.findall(r"^(\w+):\w+=(.*)$", text, re.M))


def compiler(build: pathlib.Path) -> str:
    """The make of the build folder's compiler and its version, such as "GNU 12.2.0"."""
    for file in build.glob("CMakeFiles/*/CMakeCXXCompiler.cmake"):
        found = dict(re.findall(r'^set\(CMAKE_CXX_COMPILER_(ID|VERSION) "(.*)"\)$',
                                file.read_text(), re.M))
        return f"{found.get('ID', 'unknown')} {found.get('VERSION', '')}".strip()
    return "unknown"


def build_type(build: pathlib.Path) -> str:
    return cache_entries(build).get("CMAKE_BUILD_TYPE") or "no build type"

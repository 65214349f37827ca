"""The tool `orn-hdl`, which comes with the package or is installed beside it."""

from __future__ import annotations

import os
import shutil
import subprocess
from pathlib import Path
from typing import Optional


def find_tool() -> Optional[str]:
    """The tool: what ORN_HDL_TOOL names, that of the package, or the one on the path; None without any."""
    named = os.environ.get("ORN_HDL_TOOL")
    if named:
        return named
    own = Path(__file__).parent / "bin" / "orn-hdl"
    return str(own) if own.exists() else shutil.which("orn-hdl")


def run_tool(*arguments: str) -> subprocess.CompletedProcess[str]:
    """Runs the tool and collects what it prints. Raises FileNotFoundError if there is no tool."""
    tool = find_tool()
    if tool is None:
        raise FileNotFoundError("the tool orn-hdl is not installed")
    return subprocess.run([tool, *arguments], capture_output=True, text=True, errors="surrogateescape",
                          check=False)

"""`python -m orn_hdl` runs the tool orn-hdl with the same arguments."""

from __future__ import annotations

import os
import sys

from ._tool import find_tool


def main() -> int:
    """Replaces the process by the tool."""
    tool = find_tool()
    if tool is None:
        print("orn_hdl: the tool orn-hdl is not installed", file=sys.stderr)
        return 3
    sys.stdout.flush()
    os.execv(tool, ["orn-hdl", *sys.argv[1:]])


if __name__ == "__main__":
    sys.exit(main())

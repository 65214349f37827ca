"""The types of the package by mypy, as of the oldest Python that it serves, and its stub compared with the
extension by stubtest: check_types.py FOLDER_OF_THE_PACKAGE"""

from __future__ import annotations

import os
import subprocess
import sys
import tempfile


def main() -> int:
    package = sys.argv[1]
    with tempfile.TemporaryDirectory() as cache:
        mypy = subprocess.run([sys.executable, "-m", "mypy", "--strict", "--python-version", "3.9", "--cache-dir",
                               cache, "orn_hdl"], cwd=package, check=False)
        stubs = subprocess.run([sys.executable, "-m", "mypy.stubtest", "orn_hdl._orn_hdl"], cwd=cache,
                               env={**os.environ, "MYPYPATH": package}, check=False)
    return mypy.returncode or stubs.returncode


if __name__ == "__main__":
    sys.exit(main())

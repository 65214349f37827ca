"""The installed headers: docs/interface.md lists each of them, and each compiles by itself as C++17,
without a warning; that of the C interface as C99, too."""

from __future__ import annotations

import os
import re
import shutil
import subprocess
import unittest
from concurrent.futures import ThreadPoolExecutor
from pathlib import Path

PROJECT = Path(__file__).resolve().parents[2]
INCLUDE = PROJECT / "include"
HEADERS = sorted(path.relative_to(INCLUDE).as_posix() for path in INCLUDE.rglob("*.h"))
PAGE = (PROJECT / "docs" / "interface.md").read_text()
COMPILERS = [name for name in ("g++", "clang++") if shutil.which(name)]
FLAGS = ["-std=c++17", "-fsyntax-only", "-Wall", "-Wextra", "-Wpedantic", "-Werror"]
C_FLAGS = ["-std=c99", "-fsyntax-only", "-Wall", "-Wextra", "-pedantic", "-Wstrict-prototypes",
           "-Werror"]


def problems(compiler: str, header: str) -> str:
    """What the compiler says of a program that includes this header alone, twice."""
    program = f"#include <{header}>\n" * 2 + "int main() {}\n"
    return subprocess.run([compiler, *FLAGS, "-x", "c++", "-I", str(INCLUDE), "-"], input=program,
                          capture_output=True, text=True, check=False).stderr


class Headers(unittest.TestCase):
    def test_each_compiles_by_itself(self) -> None:
        self.assertTrue(COMPILERS)
        runs = [(compiler, header) for compiler in COMPILERS for header in HEADERS]
        with ThreadPoolExecutor(os.cpu_count()) as pool:
            for (compiler, header), said in zip(runs, pool.map(lambda run: problems(*run), runs)):
                with self.subTest(compiler=compiler, header=header):
                    self.assertEqual(said, "")

    def test_the_c_header_compiles_by_itself(self) -> None:
        program = "#include <Orn_Hdl/orn_hdl.h>\n" * 2 + "int main(void) { return 0; }\n"
        compilers = [name for name in ("gcc", "clang") if shutil.which(name)]
        self.assertTrue(compilers)
        for compiler in compilers:
            with self.subTest(compiler=compiler):
                done = subprocess.run([compiler, *C_FLAGS, "-x", "c", "-I", str(INCLUDE), "-"],
                                      input=program, capture_output=True, text=True, check=False)
                self.assertEqual(done.stderr, "")

    def test_the_page_lists_each_with_its_purpose(self) -> None:
        listed = re.findall(r"^\| `([\w/]+\.h)` \| (\S.*) \|$", PAGE, re.M)
        self.assertEqual(sorted(name for name, _ in listed), HEADERS)

    def test_the_page_counts_them(self) -> None:
        self.assertIn(f"\n{len(HEADERS)} headers are installed.", PAGE)


if __name__ == "__main__":
    unittest.main()

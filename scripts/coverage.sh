#!/usr/bin/env bash
# Prints the coverage of the library's lines and branches by the unit tests and the fuzz corpora for each
# file, and fails below 95 percent of the lines or 90 percent of the branches. Branches that only an
# exception takes, and those that the compiler generates, do not count.
set -euo pipefail
cd "$(dirname "$0")/.."

scripts/setup.sh test
export CMAKE_CXX_COMPILER_LAUNCHER=ccache CCACHE_BASEDIR="$PWD" CCACHE_NOHASHDIR=1
jobs=${1:-$(nproc)}
cmake --preset coverage
cmake --build --preset coverage -j "$jobs"
find build/coverage -name '*.gcda' -delete
ctest --preset coverage -j "$jobs" --tests-regex '^(unit|fuzz)\.'

gcovr --root . --filter s/ --exclude-throw-branches --exclude-unreachable-branches -j "$jobs" \
    --txt --branches --print-summary --fail-under-line 95 --fail-under-branch 90 build/coverage

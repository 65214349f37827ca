#!/usr/bin/env bash
# What clang-format, clang-tidy and cppcheck have to say of the sources: nothing.
#
#   scripts/lint.sh [--quick]
#
# --quick, as CI calls it, leaves out clang-tidy, which takes minutes.
set -euo pipefail
cd "$(dirname "$0")/.."

scripts/setup.sh test
jobs=$(nproc)
mapfile -t sources < <(git ls-files 's/*.cpp' 'tools/*.cpp')
mapfile -t all < <(git ls-files '*.cpp' '*.h')

echo "== clang-format, ${#all[@]} files"
clang-format --dry-run --Werror "${all[@]}"

echo "== cppcheck"
# What is kept off stands in .cppcheck, with its reason.
cppcheck --quiet --std=c++20 --language=c++ --enable=warning,performance,portability \
    --inline-suppr --error-exitcode=1 --suppressions-list=.cppcheck -j "$jobs" -I include -I s \
    s tools/orn-hdl

[ "${1:-}" != --quick ] || exit 0
echo "== clang-tidy, ${#sources[@]} sources"
# The sources are compiled as the preset says; only the checks are run.
cmake --preset tidy -DCMAKE_EXPORT_COMPILE_COMMANDS=ON >/dev/null
printf '%s\n' "${sources[@]}" |
    xargs -P "$jobs" -n 4 clang-tidy --quiet --warnings-as-errors='*' -p build/tidy 2>/dev/null

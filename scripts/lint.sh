#!/usr/bin/env bash
# Checks the sources with clang-format, cppcheck and clang-tidy, which must report nothing.
#
#   scripts/lint.sh [--quick]
#
# --quick, as CI calls it, leaves out clang-tidy's static analyser, which takes most of its time.
set -euo pipefail
cd "$(dirname "$0")/.."

scripts/setup.sh test
jobs=$(nproc)
checks=()
[ "${1:-}" != --quick ] || checks=('--checks=-clang-analyzer-*')
mapfile -t sources < <(git ls-files 's/*.cpp' 'tools/*.cpp')
mapfile -t all < <(git ls-files '*.cpp' '*.h')

echo "== clang-format, ${#all[@]} files"
clang-format --dry-run --Werror "${all[@]}"

echo "== cppcheck"
# .cppcheck lists the suppressed checks with their reasons.
cppcheck --quiet --std=c++20 --language=c++ --enable=warning,performance,portability \
    --inline-suppr --error-exitcode=1 --suppressions-list=.cppcheck -j "$jobs" -I include -I s \
    s tools/orn-hdl

echo "== clang-tidy, ${#sources[@]} sources"
# The sources are not compiled; the preset provides the compiler's options.
cmake --preset tidy >/dev/null
printf '%s\n' "${sources[@]}" |
    xargs -P "$jobs" -n 1 clang-tidy --quiet --warnings-as-errors='*' "${checks[@]}" -p build/tidy 2>/dev/null

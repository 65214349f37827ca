#!/usr/bin/env bash
# Checks the sources with clang-format, cppcheck and clang-tidy, which must report nothing.
#
#   scripts/lint.sh [--quick]
#
# --quick, as CI calls it, looks at the sources of a folder together, which takes a tenth of the time. It leaves
# out clang-tidy's static analyser, and does not find a using declaration that nothing uses.
set -euo pipefail
cd "$(dirname "$0")/.."

scripts/setup.sh test
jobs=$(nproc)
mapfile -t all < <(git ls-files '*.cpp' '*.h')

echo "== clang-format, ${#all[@]} files"
clang-format --dry-run --Werror "${all[@]}"

# The sources are not compiled; the preset provides the compiler's options.
if [ "${1:-}" = --quick ]; then
    build=build/tidy-united
    cmake --preset tidy -B "$build" -DCMAKE_UNITY_BUILD=ON >/dev/null
    # Sources that are included by others are what this is about.
    checks=('--checks=-clang-analyzer-*,-bugprone-suspicious-include')
    mapfile -t sources < <(python3 -c 'import json, sys
for entry in json.load(sys.stdin):
    print(entry["file"])' <"$build/compile_commands.json")
    inputs=(--project="$build/compile_commands.json")
else
    build=build/tidy
    cmake --preset tidy >/dev/null
    checks=()
    mapfile -t sources < <(git ls-files 's/*.cpp' 'tools/*.cpp' 'python/*.cpp')
    inputs=(-I include -I s s tools/orn-hdl python/extension)
fi

echo "== cppcheck"
# .cppcheck lists the suppressed checks with their reasons.
cppcheck --quiet --std=c++20 --language=c++ --enable=warning,performance,portability \
    --inline-suppr --error-exitcode=1 --suppressions-list=.cppcheck -j "$jobs" "${inputs[@]}"

echo "== clang-tidy, ${#sources[@]} sources"
printf '%s\0' "${sources[@]}" |
    xargs -0 -P "$jobs" -n 1 clang-tidy --quiet --warnings-as-errors='*' "${checks[@]}" -p "$build" 2>/dev/null

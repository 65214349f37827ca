#!/usr/bin/env bash
# Installs the needed packages and runs all tests: static checks, the optimised build with every test,
# including the real tools, the unit tests and the random scripts again with sanitizers, and the fuzzer.
set -euo pipefail
cd "$(dirname "$0")/.."

scripts/setup.sh test
jobs=$(nproc)
export CMAKE_CXX_COMPILER_LAUNCHER=ccache
# Paths below this folder are ignored, so that another clone can use the same compiler cache.
export CCACHE_BASEDIR="$PWD" CCACHE_NOHASHDIR=1

step() {
    echo "== $* ($(date +%T))"
}

step "formatting and static checks"
scripts/lint.sh --quick

step "optimised build"
cmake --preset release
cmake --build --preset release -j "$jobs"

step "sanitizer build"
cmake --preset asan
cmake --build --preset asan -j "$jobs"

step "tests under AddressSanitizer and UndefinedBehaviorSanitizer"
ctest --preset asan -j "$jobs" --exclude-regex '^(flow|install|docs|judges)\.'

step "threads under ThreadSanitizer"
cmake --preset tsan
cmake --build --preset tsan -j "$jobs" --target orn_hdl_Threads_tests
ctest --preset tsan --tests-regex '^unit\.Threads$'

step "tests"
ctest --preset release -j "$jobs"

step "fuzzing"
# A seed, so that what the fuzzer newly finds in old code does not refuse a change.
fuzz/run --seed 1 20

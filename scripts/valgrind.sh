#!/usr/bin/env bash
# Runs unit tests under valgrind, which also detects the use of uninitialised values. It is run by hand,
# because it takes minutes. Without arguments it runs all programs of the library except Robustness, whose
# designs are too large for it, and Threads.
#
#   scripts/valgrind.sh [PROGRAM...]
#
# Each program is named after its folder below tests/.
set -euo pipefail
cd "$(dirname "$0")/.."

scripts/setup.sh test
export CMAKE_CXX_COMPILER_LAUNCHER=ccache CCACHE_BASEDIR="$PWD" CCACHE_NOHASHDIR=1
programs=("$@")
((${#programs[@]} > 0)) || programs=(Port Containers Streams Options Header HdlModel HdlCmd HdlEngine Writers Verilog Vhdl)
cmake --preset release >/dev/null
targets=("${programs[@]/#/orn_hdl_}")
cmake --build --preset release --target "${targets[@]/%/_tests}"
for program in "${programs[@]}"; do
    echo "== $program"
    # Programs that count allocations have operators of their own, of which valgrind replaces some: the
    # tests of the counting itself are left out.
    GTEST_FILTER="-ContainerMemory.*" RC_PARAMS="seed=20261120 max_success=5" \
        valgrind --quiet --error-exitcode=9 --leak-check=full \
        --errors-for-leak-kinds=definite,possible --show-mismatched-frees=no \
        "build/release/tests/orn_hdl_${program}_tests" --gtest_brief=1
done

#!/usr/bin/env bash
# Installs the needed packages, builds the tool, and shows the netlists of an example.
set -euo pipefail
cd "$(dirname "$0")/.."

scripts/setup.sh build
cmake --preset release -DORN_HDL_BUILD_TESTS=OFF -DORN_HDL_BUILD_BENCH=OFF \
    -DORN_HDL_BUILD_PYTHON=OFF -DORN_HDL_BUILD_TCL=OFF -B build/demo >/dev/null
cmake --build build/demo --target orn-hdl >/dev/null

tool=build/demo/tools/orn-hdl/orn-hdl
mkdir -p build/demo/netlists
"$tool" run --verilog build/demo/netlists/and2.v --vhdl build/demo/netlists/and2.vhd \
    examples/and2/and2.cmd
echo "== examples/and2/and2.cmd"
cat examples/and2/and2.cmd
echo
echo "== as Verilog: build/demo/netlists/and2.v"
cat build/demo/netlists/and2.v
echo
echo "== as VHDL: build/demo/netlists/and2.vhd"
cat build/demo/netlists/and2.vhd

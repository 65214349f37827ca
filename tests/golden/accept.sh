#!/usr/bin/env bash
# Shows every golden netlist to the real tools: Icarus, Verilator and Yosys for Verilog, GHDL in two
# editions of the language for VHDL. Ends with an error when one of them refuses a file.
set -euo pipefail

here=$(cd "$(dirname "${BASH_SOURCE[0]}")" && pwd)
cells=$here/../../examples/cells
work=$(mktemp -d)
trap 'rm -rf "$work"' EXIT

# Buses that count upwards and nets of several drivers are legal and part of the output.
for netlist in "$here"/*.v; do
    iverilog -Wall -tnull -I "$here/include" "$netlist" "$cells/cells.v"
    verilator --lint-only -Wno-LITENDIAN -Wno-MULTIDRIVEN "-I$here/include" "$netlist" -v "$cells/cells.v"
    yosys -q -p "read_verilog -I$here/include $netlist"
done

for standard in 93 08; do
    mkdir "$work/$standard"
    ghdl=(ghdl -a --warn-no-library "--std=$standard" "--workdir=$work/$standard" "-P$work/$standard")
    "${ghdl[@]}" --work=KESTRA "$cells/kestra_vcomponents.vhd"
    "${ghdl[@]}" "$cells/cells.vhd"
    for netlist in "$here"/*.vhd; do
        "${ghdl[@]}" "$netlist"
    done
done
echo "accepted: $(find "$here" -name '*.v' -o -name '*.vhd' | wc -l) netlists"

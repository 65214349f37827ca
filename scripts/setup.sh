#!/usr/bin/env bash
# Installs the Debian packages that the project needs; needs root or sudo only if something is
# missing. Usage: setup.sh build | test
set -euo pipefail

build_packages=(g++ cmake make ninja-build libcli11-dev nettle-dev zlib1g-dev
    pkg-config)
test_packages=(ccache clang clang-tidy clang-format cppcheck doxygen gcovr ghdl git graphviz iverilog
    libbenchmark-dev libclang-rt-14-dev libgtest-dev librapidcheck-dev llvm lintian locales man-db mypy
    python3 python3-dev python3-networkx python3-numpy python3-pandas python3-pip python3-pytest
    python3-setuptools python3-venv python3-wheel tcl-dev valgrind verilator vim-tiny yosys zsh)

case "${1:-build}" in
build) packages=("${build_packages[@]}") ;;
test) packages=("${build_packages[@]}" "${test_packages[@]}") ;;
*)
    echo "usage: setup.sh build | test" >&2
    exit 2
    ;;
esac

missing=()
for package in "${packages[@]}"; do
    status=$(dpkg-query -W -f '${db:Status-Status}' "$package" 2>/dev/null || true)
    [ "$status" = installed ] || missing+=("$package")
done
[ ${#missing[@]} -gt 0 ] || exit 0

as_root=()
[ "$(id -u)" -eq 0 ] || as_root=(sudo)
echo "Installing: ${missing[*]}"
"${as_root[@]}" apt-get update -qq
"${as_root[@]}" env DEBIAN_FRONTEND=noninteractive \
    apt-get install -y -qq --no-install-recommends "${missing[@]}" >/dev/null

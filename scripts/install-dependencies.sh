#!/usr/bin/env bash
# Installs the Debian packages that are missing, as root or through sudo.
# Usage: install-dependencies.sh GROUP...   with the groups build, test, tools, check and package
set -euo pipefail

declare -A groups=(
  [build]="g++ cmake ninja-build pkg-config libboost-filesystem-dev libpcre2-dev libcli11-dev
          nlohmann-json3-dev"
  [test]="libgtest-dev libgmock-dev libbenchmark-dev"
  [tools]="ghdl iverilog verilator yosys tcl python3-jsonschema zsh fish"
  [package]="dpkg-dev file libgtest-dev libgmock-dev"
  [check]="clang clang-format clang-tidy libclang-rt-14-dev git python3 valgrind
          doxygen"
)

# For reading SARIF by programs of others; an npm from anywhere will do.
command -v npm >/dev/null || groups[tools]+=" npm"

missing=()
for group in "$@"; do
  if [ -z "${groups[$group]:-}" ]; then
    echo "usage: $0 GROUP...   with the groups ${!groups[*]}" >&2
    exit 2
  fi
  for package in ${groups[$group]}; do
    status=$(dpkg-query --show --showformat '${Status}' "$package" 2>/dev/null || true)
    [ "$status" = "install ok installed" ] || missing+=("$package")
  done
done
[ ${#missing[@]} -gt 0 ] || exit 0

as_root=()
if [ "$(id -u)" -ne 0 ]; then
  if ! command -v sudo >/dev/null; then
    echo "Please let root run: apt-get install ${missing[*]}" >&2
    exit 1
  fi
  as_root=(sudo)
fi
echo "Installing ${missing[*]}"
"${as_root[@]}" apt-get update -qq
"${as_root[@]}" env DEBIAN_FRONTEND=noninteractive \
  apt-get install -y -qq --no-install-recommends "${missing[@]}" >/dev/null

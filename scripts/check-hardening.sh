#!/usr/bin/env bash
# Looks into the programs and libraries of a release build for what its preset asks for: addresses that
# are resolved at the start and then read-only, guarded stacks and checked copies.
# Usage: check-hardening.sh [BUILD_DIRECTORY]
set -euo pipefail
cd "$(dirname "$0")/.."

build=${1:-build/gcc-release}
result=0
for file in "$build"/bin/kel "$build"/lib/libtarvo_kel.so "$build"/lib/libtarvo_platform.so; do
  headers=$(readelf --wide --program-headers --dynamic --dyn-syms "$file")
  for sign in GNU_RELRO BIND_NOW __stack_chk_fail; do
    if ! grep -q "$sign" <<<"$headers"; then
      echo "$file: no $sign"
      result=1
    fi
  done
  if grep -q "GNU_STACK.*RWE" <<<"$headers"; then
    echo "$file: an executable stack"
    result=1
  fi
done
grep -q '_chk@' <<<"$(readelf --wide --dyn-syms "$build"/lib/*.so)" ||
  { echo "$build: no checked copies"; result=1; }
exit $result

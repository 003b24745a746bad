#!/usr/bin/env bash
# Runs clang-tidy over all sources but the comparison of engines; a finding is an error.
set -euo pipefail
cd "$(dirname "$0")/.."

count=0
tidy() { # PRESET PATTERN...
  local preset=$1 sources
  shift
  cmake --preset "$preset" >/dev/null
  mapfile -d '' sources < <(git ls-files -z "$@" ':!bench/regexp_engines_bench.cpp')
  [ ${#sources[@]} -gt 0 ]
  printf '%s\0' "${sources[@]}" | xargs -0 -n 1 -P "$(nproc)" clang-tidy -quiet -p "build/$preset" \
    2> >(grep -v 'warnings\? generated' >&2)
  count=$((count + ${#sources[@]}))
}
tidy clang-debug 'platform/*.cpp' 's/*.cpp' 'tools/*.cpp' 'tests/*.cpp' 'bench/*.cpp'
tidy clang-fuzz 'fuzz/*.cpp'
echo "clang-tidy found nothing in $count sources"

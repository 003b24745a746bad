#!/usr/bin/env bash
# Runs clang-tidy over all sources but the benchmarks; a finding is an error.
set -euo pipefail
cd "$(dirname "$0")/.."

cmake --preset clang-debug >/dev/null
mapfile -d '' sources < <(git ls-files -z 'platform/*.cpp' 's/*.cpp' 'tools/*.cpp' 'tests/*.cpp')
[ ${#sources[@]} -gt 0 ]
printf '%s\0' "${sources[@]}" |
  xargs -0 -n 1 -P "$(nproc)" clang-tidy -quiet -p build/clang-debug 2> >(grep -v 'warnings\? generated' >&2)
echo "clang-tidy found nothing in ${#sources[@]} sources"

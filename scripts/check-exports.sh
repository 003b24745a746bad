#!/usr/bin/env bash
# Compares the names that the libraries export with the lists in scripts/exports, so that a change
# of interface shows in review. Usage: check-exports.sh [--update] [BUILD_DIRECTORY]
set -euo pipefail
cd "$(dirname "$0")/.."

update=false
if [ "${1:-}" = --update ]; then
  update=true
  shift
fi
build=${1:-build/gcc-release}
[ -e "$build/CMakeCache.txt" ] || cmake --preset gcc-release >/dev/null
cmake --build "$build" --target tarvo_kel >/dev/null

result=0
for library in libtarvo_platform libtarvo_kel; do
  list=scripts/exports/$library.txt
  names=$(nm --dynamic --demangle --defined-only "$build/lib/$library.so" |
    cut -d' ' -f3- | LC_ALL=C sort -u)
  if $update; then
    printf '%s\n' "$names" >"$list"
  elif ! diff --label "$list" --label "$library.so as built" -u "$list" <(printf '%s\n' "$names"); then
    echo "The exported names of $library differ from $list; if that is meant, run $0 --update"
    result=1
  fi
done
exit $result

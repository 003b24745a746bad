#!/usr/bin/env bash
# Builds the fuzzers, replays their corpus and runs them side by side for so many minutes each, which
# may be a fraction. What they find stays in build/clang-fuzz/findings, and new inputs beside it.
# Usage: fuzz.sh MINUTES
set -euo pipefail
cd "$(dirname "$0")/.."

[ $# -eq 1 ] || { echo "usage: $0 MINUTES" >&2; exit 2; }
seconds=$(awk -v minutes="$1" 'BEGIN { print int(minutes * 60) }')
build=build/clang-fuzz
scripts/install-dependencies.sh build check
cmake --preset clang-fuzz >/dev/null
cmake --build --preset clang-fuzz

[ -d /dev/shm ] && export TMPDIR=/dev/shm  # where files are made fast
running=()
for subject in readers library; do
  mkdir -p "$build/corpus/$subject" "$build/findings"
  "$build/bin/kel_${subject}_fuzz" "$build/corpus/$subject" "fuzz/corpus/$subject" \
    -dict=fuzz/kel.dict -max_total_time="$seconds" -max_len=4096 -timeout=20 -rss_limit_mb=2048 \
    -print_final_stats=1 -artifact_prefix="$build/findings/" >"$build/$subject.log" 2>&1 &
  running+=("$!:$subject")
done
result=0
for entry in "${running[@]}"; do
  subject=${entry#*:}
  if ! wait "${entry%%:*}"; then
    tail -n 60 "$build/$subject.log"
    result=1
  fi
  echo "$subject: $(grep -c . <(ls "fuzz/corpus/$subject")) inputs kept," \
    "$(sed -n 's/^stat::number_of_executed_units: *//p' "$build/$subject.log") runs," \
    "$(grep -o 'cov: [0-9]*' "$build/$subject.log" | tail -n 1 | cut -d' ' -f2) edges"
done
exit $result

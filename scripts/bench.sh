#!/usr/bin/env bash
# Builds, measures what docs/performance.md states, prints medians and ratios as a table and leaves
# all samples in build/gcc-release/bench.json. Takes some minutes and a gigabyte of temporary space. A
# second table is for other tools: as much again where they are there, and nothing where not.
# Usage: bench.sh [ROUNDS]   by default 9
set -euo pipefail
cd "$(dirname "$0")/.."

scripts/install-dependencies.sh build test
cmake --preset gcc-release >/dev/null
cmake --build --preset gcc-release
KEL_BENCH_DIRECTORY=$(mktemp -d)
export KEL_BENCH_DIRECTORY
trap 'rm -rf "$KEL_BENCH_DIRECTORY"' EXIT
python3 bench/compare.py build/gcc-release/bin build/gcc-release/bench.json "${1:-9}"
python3 bench/beside_others.py build/gcc-release/bin "${1:-9}"

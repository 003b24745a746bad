#!/usr/bin/env bash
# Installs what is missing, builds and runs all tests.
# Usage: test.sh [PRESET]   one of the presets of CMakePresets.json, by default gcc-release
set -euo pipefail
cd "$(dirname "$0")/.."

preset=${1:-gcc-release}
groups=(build test tools)
[[ $preset == gcc-* ]] || groups+=(check)
scripts/install-dependencies.sh "${groups[@]}"
cmake --workflow --preset "$preset"

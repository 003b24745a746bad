#!/usr/bin/env bash
# Fails where clang-format would change a source. Usage: check-format.sh [--fix]
set -euo pipefail
cd "$(dirname "$0")/.."

mode=(--dry-run --Werror)
[ "${1:-}" != --fix ] || mode=(-i)
git ls-files --cached --others --exclude-standard '*.cpp' '*.h' | xargs clang-format "${mode[@]}"

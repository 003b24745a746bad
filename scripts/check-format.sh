#!/usr/bin/env bash
# Fails where clang-format would change a source. Usage: check-format.sh [--fix]
set -euo pipefail
cd "$(dirname "$0")/.."

case "${1:-}" in
  "") mode=(--dry-run --Werror) ;;
  --fix) mode=(-i) ;;
  *) echo "usage: $0 [--fix]" >&2; exit 2 ;;
esac
git ls-files -z --cached --others --exclude-standard '*.cpp' '*.h' |
  while IFS= read -r -d '' file; do [ ! -e "$file" ] || printf '%s\0' "$file"; done |
  xargs -0 clang-format "${mode[@]}"

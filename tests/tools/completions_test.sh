#!/usr/bin/env bash
# Checks what the shell completions of kel offer. Usage: completions_test.sh KEL
set -uo pipefail
[ $# -eq 1 ] || { echo "usage: $0 KEL" >&2; exit 2; }
kel=$(realpath "$1")
cd "$(dirname "$0")/../.."
folder=tools/kel/completions
# shellcheck source=/dev/null
source $folder/kel.bash

failures=0
differs() {  # WHAT EXPECTED GOT
  [ "$2" != "$3" ] || return 0
  printf '%s\n  expected: %s\n  got:      %s\n' "$1" "$2" "$3"
  failures=$((failures + 1))
}

# The candidates for the last of these words, between blanks.
offer() {
  COMP_WORDS=("$@")
  COMP_CWORD=$(($# - 1))
  _kel "$kel"
  echo "${COMPREPLY[*]}"
}

pulse="pulse_counter pulse_counter_v2_00_a pulse_counter_v1_01_b pulse_counter_v1_00_a"
repository=$PWD/examples/repository
# Words, in front of the candidates. The words of a row stand as Readline splits them.
while IFS='|' read -r words expected; do
  [[ $words == *' ' ]] && words+="''"
  eval "split=($words)"
  differs "$words" "$expected" "$(offer "${split[@]}")"
done <<EOT
kel s|show sources
kel help ne|netlists
kel help list|list list-ends
kel check -W no-missing-s|no-missing-source
kel check --format = |text json sarif
kel check --e|--excerpts
kel -L examples/rep|examples/repository
kel --library = examples/o|examples/overlay
kel -L examples/repository show pul|$pulse
kel --library = examples/repository which x tone_|tone_gen tone_gen_v1_00_a
kel -L '"$repository"' list pul|$pulse
kel -L '\$repository' check pul|$pulse
kel -L 'examples/overlay;examples/repository' sources pul|$pulse
kel -L examples/overlay show pul|pulse_counter pulse_counter_v2_00_a
kel -L nowhere show pul|
kel show pul|
kel -L examples/repository show tone_gen tone|
kel show --section p|place parameters ports
kel sources --format = |list json f ghdl edam vhdl_ls tcl
kel sources x --for s|synthesis simulation
kel sources --relative-to examples/o|examples/overlay
kel netlists --set A = |
kel --color a|auto always
kel netlists --t|--trace --table
kel list --v|--version
EOT
# A name of a directory is never run.
differs "a name with a call" "" "$(offer kel -L '$(touch /dev/full)' show '')"

if command -v zsh >/dev/null; then
  differs "zsh -n" "" "$(zsh -n $folder/_kel 2>&1)"
fi
if command -v fish >/dev/null; then
  differs "fish -n" "" "$(fish -n $folder/kel.fish 2>&1)"
  keys=$(PATH="$(dirname "$kel"):$PATH" fish --no-config -c "source $folder/kel.fish
    complete -C 'kel -L examples/repository show pul'" | sort | tr '\n' ' ')
  differs "fish" "$(tr ' ' '\n' <<<"$pulse" | sort | tr '\n' ' ')" "$keys"
fi
[ $failures -eq 0 ] && echo "The completions offer what they should"
exit $((failures > 0))

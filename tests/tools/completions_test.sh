#!/usr/bin/env bash
# Checks what the shells make of a line and of the answer of `kel __complete`, which itself is seen in
# tests/transcripts/completions.md. zsh and fish are tried if they are there.
# Usage: completions_test.sh KEL
set -uo pipefail
[ $# -eq 1 ] || { echo "usage: $0 KEL" >&2; exit 2; }
kel=$(realpath "$1")
cd "$(dirname "$0")/../.."
folder=tools/kel/completions
# shellcheck source=/dev/null
source $folder/kel.bash
export PATH="${kel%/*}:$PATH" HOME=$PWD repository=$PWD/examples/repository line

failures=0
differs() {  # WHAT EXPECTED GOT
  [ "$2" != "$3" ] || return 0
  printf '%s\n  expected: %s\n  got:      %s\n' "$1" "$2" "$3"
  failures=$((failures + 1))
}

# What each shell offers for the last word of $line, sorted. zsh's own operations are stood in for.
in_bash() {  # the words as Readline splits them, but quotes
  local -a split
  read -ra split <<<"${line//=/ = }."
  split[-1]=${split[-1]%.}
  COMP_WORDS=("${split[@]}")
  COMP_CWORD=$((${#split[@]} - 1))
  _kel "$kel"
  printf '%s\n' "${COMPREPLY[@]}"
}
in_zsh() {
  # shellcheck disable=SC2016
  zsh -fc 'words=(${=line%.}) PREFIX=
    [[ $line == *" " ]] || PREFIX=$words[-1] words[-1]=()
    words+=("$PREFIX") CURRENT=$#words
    _describe() { print -rl -- ${candidates%%:*} }
    compset() { lead=$2 PREFIX=${PREFIX#$2} }
    _files() { local -a found=(${~PREFIX}*(/)); print -rl -- $lead$^found }
    source '$folder/_kel
}
in_fish() { fish --no-config -c "source $folder/kel.fish; complete -C \$line" | sed 's/\t.*//; s:/$::'; }

pulse="pulse_counter pulse_counter_v1_00_a pulse_counter_v1_01_b pulse_counter_v2_00_a"
# A line, the candidates, and those of bash if they differ, where a word begins anew behind '='.
while IFS='|' read -r line expected anew; do
  for shell in bash zsh fish; do
    command -v $shell >/dev/null || continue
    [ $shell != bash ] || wanted=${anew:-$expected}
    differs "$shell: $line" "$wanted" "$("in_$shell" | LC_ALL=C sort | xargs)"
    wanted=$expected
  done
done <<EOT
kel net|netlists
kel sources --format=vh|--format=vhdl_ls|vhdl_ls
kel netlists x --set A=|
kel -L examples/rep|examples/repository
kel --library=examples/o|--library=examples/overlay|examples/overlay
kel check -Lexamples/o|-Lexamples/overlay
kel -L examples/repository show pul|$pulse
kel --library=examples/repository show pul|$pulse
kel -L ~/examples/repository list pul|$pulse
kel -L \$repository check pul|$pulse
kel -L "\${repository}/." check pul|$pulse
kel -L 'examples/overlay;examples/repository' sources pul|$pulse
kel show pul|
EOT
# What a name would do if it were run can't be seen above.
marker=$(mktemp -u)
line="kel -L \$(touch\${IFS}$marker) -L \`touch\${IFS}$marker\` show "
for shell in bash zsh fish; do
  ! command -v $shell >/dev/null || "in_$shell" >/dev/null
  differs "$shell runs a name" "" "$(ls "$marker" 2>/dev/null)"
done
[ $failures -eq 0 ] && echo "The completions offer what they should"
exit $((failures > 0))

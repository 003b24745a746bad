# Completion of kel for bash: `kel __complete` knows what may stand where.

# Readline splits words at '=' and ':', which are joined again. Of a word, the quotes go, `~/` and one
# variable are replaced, and nothing in it is run.
_kel() {
  local word line lead='' cur=${COMP_WORDS[COMP_CWORD]}
  local -a words=()
  for word in "${1:-kel}" "${COMP_WORDS[@]:1:COMP_CWORD}"; do
    word=${word//[\"\'\\]/}
    [[ $word != '~/'* ]] || word=$HOME/${word:2}
    if [[ $word =~ ^([^$]*)\$\{?([A-Za-z_][A-Za-z_0-9]*)\}?([^$]*)$ ]]; then
      word=${BASH_REMATCH[1]}${!BASH_REMATCH[2]-}${BASH_REMATCH[3]}
    fi
    if [[ ${#words[@]} -gt 1 && ($word == [=:]* || ${words[-1]} == *[=:]) ]]; then
      lead=${words[-1]}
      words[-1]+=$word
    else
      lead=
      words+=("$word")
    fi
  done
  [[ $cur != [=:]* ]] || lead=${words[-1]} cur=
  COMPREPLY=()
  while IFS=$'\t' read -r word line; do
    if [[ $word == :directory ]]; then
      compopt -o filenames 2>/dev/null
      line=${line#"$lead"}
      cur=${cur//[\"\']/}
      mapfile -t COMPREPLY < <(compgen -d -P "$line" -- "${cur#"$line"}")
    else
      COMPREPLY+=("${word#"$lead"}")
    fi
  done < <(command -- "${words[0]}" __complete "${words[@]:1}" 2>/dev/null </dev/null)
}

complete -F _kel kel

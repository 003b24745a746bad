# Completion of kel for bash.

# What a word of the command line names, in `plain`. Nothing in the word is run.
_kel_plain() {
  plain=${1//[\"\'\\]/}
  [[ $plain == '~/'* ]] && plain=$HOME/${plain:2}
  if [[ $plain =~ ^\$\{?([A-Za-z_][A-Za-z_0-9]*)\}?(/.*)?$ ]]; then
    plain=${!BASH_REMATCH[1]}${BASH_REMATCH[2]}
  fi
}

# Keys and bare names, in `words`. They are asked from kel, and remembered for some seconds.
_kel_keys() {
  local call="$PWD $*" lines keys key name last=
  if [[ $call != "${_kel_call-}" || $SECONDS -gt $((_kel_until)) ]]; then
    mapfile -t lines < <(command -- "$@" --quiet list --all 2>/dev/null </dev/null)
    keys=("${lines[@]%%$'\t'*}")
    _kel_words=()
    for key in "${keys[@]}"; do
      name=${key%_[vV][0-9]*}
      [[ $name == "$last" ]] || _kel_words+=("$name")
      _kel_words+=("$key")
      last=$name
    done
    _kel_call=$call
    _kel_until=$((SECONDS + 10))
  fi
  words=("${_kel_words[@]}")
}

# The codes of diagnostics, in `words`.
_kel_codes() {
  mapfile -t words < <(command -- "$kel" help diagnostics 2>/dev/null | sed -n 's/^\([a-z-]*\) (.*/\1/p')
}

# The options that stand behind a verb, in `words`.
_kel_options() {
  words=(-L --library --json --trace --quiet --color -h --help)
  case $1 in
    '') words+=(--version) ;;
    list) words+=(--all) ;;
    show) words+=(--section) ;;
    sources) words+=(--for --format --relative-to) ;;
    netlists) words+=(--set --table) ;;
    check) words+=(--format --excerpts -W --relative-to) ;;
  esac
}

# What may stand where the cursor is, in `words`: behind an option, or behind a verb and a number
# of arguments.
_kel_candidates() {
  local option=$1 verb=$2 count=$3
  local -a verbs=(list which show sources netlists check help)
  case $option in
    -L | --library | --relative-to)
      compopt -o filenames 2>/dev/null
      mapfile -t words < <(compgen -d -- "${cur//[\"\']/}")
      cur=
      return ;;
    --section) words=(place options parameters ports interfaces); return ;;
    --for) words=(synthesis simulation); return ;;
    --format)
      words=(list json f ghdl edam vhdl_ls tcl)
      [[ $verb != check ]] || words=(text json sarif)
      return ;;
    -W) _kel_codes; words=(error "${words[@]/#/no-}"); return ;;
    --color) words=(auto always never); return ;;
    ?*) return ;;
  esac
  case $cur,$verb,$count in
    -*) _kel_options "$verb" ;;
    *,,*) words=("${verbs[@]}") ;;
    *,help,0) _kel_codes; words=("${verbs[@]}" diagnostics "${words[@]}") ;;
    *,which,* | *,check,* | *,list,0 | *,show,0 | *,sources,0 | *,netlists,0)
      [[ ${#libraries[@]} -eq 0 ]] || _kel_keys "$kel" "${libraries[@]}" ;;
  esac
}

# Readline splits words at '=', so that an option, '=' and its value are three of them.
_kel() {
  local cur=${COMP_WORDS[COMP_CWORD]} kel plain option= expected= verb= word i
  local -i count=0
  local -a words=() libraries=()
  _kel_plain "${1:-kel}"
  kel=$plain
  for ((i = 1; i < ${#COMP_WORDS[@]}; ++i)); do
    word=${COMP_WORDS[i]}
    [[ $word != '=' || -n $option ]] || option=value
    if ((i == COMP_CWORD)); then
      expected=$option
      option=
      [[ $cur != '=' ]] || cur=
      continue
    fi
    [[ $word != '=' ]] || continue
    case $option,$word in
      -L,* | --library,*) _kel_plain "$word"; libraries+=(-L "$plain"); option= ;;
      ?*,*) option= ;;
      ,-L | ,-W | ,--library | ,--section | ,--for | ,--format | ,--relative-to | ,--set | ,--color)
        option=$word ;;
      ,-L?*) _kel_plain "${word#-L}"; libraries+=(-L "$plain") ;;
      ,--library=*) _kel_plain "${word#*=}"; libraries+=(-L "$plain") ;;
      ,-*) ;;
      *) if [[ -z $verb ]]; then verb=$word; else count+=1; fi ;;
    esac
  done
  _kel_candidates "$expected" "$verb" "$count"
  COMPREPLY=()
  for word in "${words[@]}"; do
    [[ $word == "$cur"* ]] && COMPREPLY+=("$word")
  done
}

complete -F _kel kel

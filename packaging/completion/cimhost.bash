# Completion of cimhost for bash. Commands and options are those that the program's own help lists.

# The words up to the cursor, put together again where bash splits at ':' and '=', in _cimhost_words.
_cimhost_split() {
  local line=${COMP_LINE:0:COMP_POINT} i word
  _cimhost_words=()
  for ((i = 0; i <= COMP_CWORD; i++)); do
    word=${COMP_WORDS[i]}
    if ((i > 0)) && [[ -n $word && $line == "$word"* && ${#_cimhost_words[@]} -gt 0 ]]; then
      _cimhost_words[-1]+=$word
    else
      line=${line#"${line%%[![:space:]]*}"}
      _cimhost_words+=("$word")
    fi
    line=${line#"$word"}
  done
}

_cimhost_commands() {
  "$_cimhost_program" --help 2>/dev/null | sed -n '/^Subcommands:/,/^$/s/^  \([^ ]*\).*/\1/p'
}

# _cimhost_options [COMMAND]: adds its options to _cimhost_types, with the type of the value that they
# take (DIR, FILE, NAME, ..., or KIND:{choice,...}), which is empty for flags.
_cimhost_options() {
  local line name names pattern='^  (-[^ ]*)( ([A-Z][^ ]*))?'
  while IFS= read -r line; do
    [[ $line =~ $pattern ]] || continue
    IFS=, read -ra names <<<"${BASH_REMATCH[1]}"
    for name in "${names[@]}"; do
      _cimhost_types[${name%%\{*}]=${BASH_REMATCH[3]}
    done
  done < <("$_cimhost_program" "$@" --help 2>/dev/null)
}

# _cimhost_offer PREFIX: the lines on standard input that begin with it. What stands before the last
# ':' is left out where bash counts it as another word.
_cimhost_offer() {
  local candidate before=
  [[ -n $_cimhost_quote || $COMP_WORDBREAKS != *:* || $1 != *:* ]] || before=${1%:*}:
  while IFS= read -r candidate; do
    [[ $candidate != "$1"* ]] || COMPREPLY+=("${candidate#"$before"}")
  done
}

_cimhost_file() {
  local IFS=$'\n'
  compopt -o filenames 2>/dev/null
  # shellcheck disable=SC2207  # one file per line
  COMPREPLY=($(compgen "$1" -- "$2"))
}

# Namespaces are the folders of mof/; the classes of one are asked for.
_cimhost_namespaces() {
  [[ -d $1/mof ]] || return
  (cd "$1/mof" && find . -mindepth 1 -maxdepth 8 -type d 2>/dev/null | sed 's:^\./::')
  printf 'root/cimv2\n'
}

_cimhost_classes() {
  "$_cimhost_program" --home "$1" classes "$2" 2>/dev/null | sed "s|^|$2:|"
}

_cimhost_target() {
  local home=$1 command=$2 current=$3
  case $command in
    enumerate | names | class | classes | get | modify | invoke | associators | associator-names | \
      references | reference-names) ;;
    dump) _cimhost_file -f "$current"; return ;;
    *) return ;;
  esac
  [[ -n $home ]] || return
  if [[ $current == *:* ]]; then
    _cimhost_offer "$current" < <(_cimhost_classes "$home" "${current%%:*}")
  else
    compopt -o nospace 2>/dev/null
    local suffix=:
    [[ $command != classes ]] || suffix=
    _cimhost_offer "$current" < <(_cimhost_namespaces "$home" | sort -u | sed "s/\$/$suffix/")
  fi
}

_cimhost_value() {
  local type=$1 current=$2
  case $type in
    DIR) _cimhost_file -d "$current" ;;
    FILE) _cimhost_file -f "$current" ;;
    *":{"*"}")
      type=${type#*\{}
      _cimhost_offer "$current" < <(tr , '\n' <<<"${type%\}}")
      ;;
  esac
}

_cimhost() {
  local _cimhost_program=$1 _cimhost_words=() _cimhost_quote='' home='' command='' arguments=0 i word
  local -A _cimhost_types=()
  _cimhost_split
  local last=$((${#_cimhost_words[@]} - 1))
  local current=${_cimhost_words[last]} previous=${_cimhost_words[last - 1]}
  COMPREPLY=()
  _cimhost_options
  for ((i = 1; i < last; i++)); do
    word=${_cimhost_words[i]}
    case $word in
      --home=*) home=${word#*=} ;;
      --home) home=${_cimhost_words[++i]} ;;
      -*) [[ -z ${_cimhost_types[$word]-} ]] || ((++i)) ;;
      *)
        if [[ -z $command ]]; then
          command=$word
          _cimhost_options "$command"
        else
          ((++arguments))
        fi
        ;;
    esac
  done
  home=${home/#\~\//$HOME/}
  if [[ $current == --*=* ]]; then
    previous=${current%%=*}
    current=${current#*=}
  fi
  if [[ $current == [\'\"]* ]]; then
    _cimhost_quote=${current:0:1}
    current=${current:1}
  fi
  if [[ $previous == -* && -n ${_cimhost_types[$previous]-} ]]; then
    _cimhost_value "${_cimhost_types[$previous]}" "$current"
  elif [[ $current == -* ]]; then
    _cimhost_offer "$current" < <(printf '%s\n' "${!_cimhost_types[@]}")
  elif [[ -z $command ]]; then
    _cimhost_offer "$current" < <(_cimhost_commands)
  elif ((arguments == 0)) || [[ $command == dump ]]; then
    _cimhost_target "$home" "$command" "$current"
  fi
}

complete -F _cimhost cimhost

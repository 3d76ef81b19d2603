# completion_test.sh COMPLETION CIMHOST HOME: completes command lines as bash does at the cursor.

set -uo pipefail

cimhost=$2
source "$1"
PATH=${cimhost%/*}:$PATH
folder=$(mktemp -d)
trap 'rm -rf "$folder"' EXIT
ln -s "$3" "$folder/home"
touch "$folder/defs.xml"
cd "$folder" || exit 1
failures=0

# offers LINE CANDIDATE...: exactly these, in any order. The line is cut into words at blanks, ':' and
# '=', as readline does, but for a last word that an open quote begins.
offers() {
  local line=$1 rest=$1 wanted seen
  COMP_LINE=$line
  COMP_POINT=${#line}
  COMP_WORDS=()
  while [[ $rest =~ ^[[:space:]]*([:=]+|\'.*|[^:=[:space:]]+) ]]; do
    COMP_WORDS+=("${BASH_REMATCH[1]}")
    rest=${rest:${#BASH_REMATCH[0]}}
  done
  case $line in *[[:space:]]) COMP_WORDS+=('') ;; esac
  COMP_CWORD=$((${#COMP_WORDS[@]} - 1))
  COMPREPLY=()
  _cimhost cimhost "${COMP_WORDS[COMP_CWORD]}" "${COMP_WORDS[COMP_CWORD - 1]}"
  wanted=$(printf '%s\n' "${@:2}" | sort)
  seen=$(printf '%s\n' "${COMPREPLY[@]-}" | sort)
  [[ $seen == "$wanted" ]] && return
  printf '[%s] offers\n%s\ninstead of\n%s\n' "$line" "$seen" "$wanted"
  failures=$((failures + 1))
}

offers 'cimhost en' enumerate
offers 'cimhost --home home cl' class classes
offers 'cimhost --home home associator' associators associator-names
offers 'cimhost --f' --format
offers 'cimhost --format ' table mof json xml
offers 'cimhost --format=j' json
offers 'cimhost --home h' home
offers 'cimhost --home=h' home
offers 'cimhost get --lo' --local-only
offers 'cimhost --provider d' defs.xml
offers 'cimhost names --lo' ''
offers 'cimhost --home home associators --r' --result-class --role --result-role
offers 'cimhost --home home enumerate root/h' root/host:
offers 'cimhost --home home classes root/h' root/host
offers 'cimhost enumerate --home home root/host:Host_N' Host_NetworkPort
offers 'cimhost --home home enumerate --property check root/h' root/host:
offers 'cimhost --home=home class root/host:' Host_FileSystem Host_IPEndpoint Host_NetworkPort \
  Host_PortEndpoint
offers 'cimhost --home home --format json get root/host:Host_F' Host_FileSystem
offers "cimhost --home home get 'root/host:Host_F" root/host:Host_FileSystem
offers 'cimhost --home home get root/other:H' ''
offers 'cimhost --home nowhere get root/host:H' ''
offers 'cimhost --home home invoke root/host:Host_FileSystem ' ''
offers 'cimhost --home home dump d' defs.xml
offers 'cimhost --home home check ' ''

# A name is a name, whatever it holds.
mkdir -p "$folder/odd/run" "$folder/odd/mof/\$(touch x)/*"
offers 'cimhost --home odd names $' '$(touch x):' '$(touch x)/*:'
[[ ! -e x ]] || failures=$((failures + 1))

exit $((failures > 0))

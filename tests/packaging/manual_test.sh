# manual_test.sh MANUALS CIMHOST: the manual pages are well-formed, and cimhost(1) has every command and
# option that the program's help lists.

set -uo pipefail

command -v man >/dev/null || { echo 'man is not installed'; exit 77; }
failures=0

for page in "$1"/*.[1-8]; do
  warnings=$(LC_ALL=C.UTF-8 MANWIDTH=80 man --warnings --encoding=UTF-8 --local-file "$page" 2>&1 >/dev/null)
  [[ -z $warnings ]] || { printf '%s\n' "$warnings"; failures=1; }
done

# Without hyphenation, so that names stay whole.
manual=$(LC_ALL=C.UTF-8 MANWIDTH=1000 man --no-hyphenation --local-file "$1/cimhost.1" | col -b)
commands=$("$2" --help | sed -n '/^Subcommands:/,/^$/s/^  \([a-z][a-z-]*\).*/\1/p')
[[ $(wc -w <<<"$commands") -ge 13 ]] || { echo 'no list of commands in the help'; failures=1; }
for command in $commands; do
  grep -Eq "^ *$command( |\$)" <<<"$manual" || { echo "no command $command"; failures=1; }
done
for option in $(for command in $commands; do "$2" "$command" --help; done | cat - <("$2" --help) |
  grep -oE '^  -[^ ]*' | grep -oE -- '--[a-z-]+' | sort -u); do
  grep -Eq -- "$option(\$|[^a-z-])" <<<"$manual" || { echo "no option $option"; failures=1; }
done
exit $failures

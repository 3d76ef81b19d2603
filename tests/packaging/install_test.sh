# install_test.sh CMAKE BUILD-FOLDER [CFLAGS]: installs into an empty folder, moves it, and serves from there.

set -euo pipefail

folder=$(mktemp -d)
trap 'rm -rf "$folder"' EXIT
"$1" --install "$2" --prefix "$folder/first" >"$folder/log" || { cat "$folder/log"; exit 1; }
mv "$folder/first" "$folder/moved"
cimhost=$folder/moved/bin/cimhost

# expect TEXT COMMAND...
expect() {
  local seen
  seen=$("${@:2}" 2>&1) || true
  grep -q -- "$1" <<<"$seen" || { printf '%s\nno "%s" in: %s\n' "${*:2}" "$1" "$seen"; exit 1; }
}

expect 'Load_Average.Name="last 15 min"' "$cimhost" --home "$2/home/loadavg" names root/load:Load_Average

# The examples build against the installed header, which is nowhere else.
if command -v pkg-config >/dev/null && command -v make >/dev/null; then
  export PKG_CONFIG_PATH=$folder/moved/share/pkgconfig
  example=$folder/moved/share/doc/commonprovider-dev/examples/loadavg
  make -s -C "$example" CFLAGS="${3-} -Werror"
  expect 'Load_Average.Name="last 1 min"' "$cimhost" --home "$example/home" names root/load:Load_Average
fi

# It is the installed library that answered, and the build's own is not looked for.
rm "$(find "$folder/moved" -name libCommonProvider.so)"
expect 'cannot load the provider library' "$cimhost" --home "$2/home/loadavg" names root/load:Load_Average

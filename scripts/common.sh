# Shared by the scripts: where the project is, and the packages that a step needs.

set -euo pipefail
cd "$(dirname "${BASH_SOURCE[0]}")/.."

jobs=$(nproc)

# need PACKAGE...: installs what is missing from Debian's packages, and says what.
need() {
  local missing=() package
  for package in "$@"; do
    dpkg-query -W -f='${db:Status-Status}\n' "$package" 2>/dev/null | grep -qx installed ||
      missing+=("$package")
  done
  [ ${#missing[@]} -eq 0 ] && return
  local as_root=()
  [ "$(id -u)" -eq 0 ] || as_root=(sudo)
  if [ -n "${as_root[*]}" ] && ! command -v sudo >/dev/null; then
    echo "Debian packages are missing, and there is no sudo to install them. As root:" >&2
    echo "  apt-get install --no-install-recommends ${missing[*]}" >&2
    exit 1
  fi
  echo "Installing Debian packages: ${missing[*]}"
  "${as_root[@]}" apt-get update -qq
  "${as_root[@]}" env DEBIAN_FRONTEND=noninteractive \
    apt-get install -y -qq --no-install-recommends "${missing[@]}" >/dev/null
}

build_packages=(cmake ninja-build g++ libcli11-dev nlohmann-json3-dev libexpat1-dev libmicrohttpd-dev libcrypt-dev libgnutls28-dev)
client_packages=(sblim-wbemcli)
test_packages=(libgtest-dev libgmock-dev googletest curl openssl "${client_packages[@]}")
i386_packages=(g++-multilib)
clang_packages=(clang)
benchmark_packages=(libbenchmark-dev)

package_packages=(dpkg-dev fakeroot file lintian man-db make pkg-config)

# configure PRESET [ARGUMENT...]: quiet unless it fails.
configure() {
  local preset=$1 log
  log=$(mktemp)
  if ! cmake --preset "$preset" "${@:2}" >"$log" 2>&1; then
    cat "$log" >&2
    rm -f "$log"
    return 1
  fi
  rm -f "$log"
}

# build PRESET [TARGET...]
build() {
  local preset=$1
  shift
  [ -e "build/$preset/.ninja_log" ] || echo "Building in build/$preset; this takes some minutes"
  cmake --build --preset "$preset" -j "$jobs" ${1:+--target "$@"} -- --quiet
}

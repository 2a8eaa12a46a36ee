# The Debian packages of each purpose, and the one place that installs them. Sourced.

source "${BASH_SOURCE[0]%/*}/common.sh"

# Purpose, package, and what is there once it is installed: a command or a file. A look at those takes no time, where
# asking dpkg would be felt at every start of the program.
package_table='
build     cmake               cmake
build     ninja-build         ninja
build     g++                 g++
build     rapidjson-dev       /usr/include/rapidjson/reader.h
build     libcli11-dev        /usr/include/CLI/CLI.hpp
build     libtomlplusplus-dev /usr/include/toml++/toml.h
build     libncurses-dev      /usr/include/ncursesw/curses.h
build     zlib1g-dev          /usr/include/zlib.h
build     libjs-dygraphs      /usr/share/javascript/dygraphs/dygraph.min.js
build     protobuf-compiler   protoc
build     libprotobuf-dev     /usr/include/google/protobuf/message.h
build     libprotoc-dev       /usr/include/google/protobuf/compiler/plugin.h
test      libgtest-dev        /usr/include/gtest/gtest.h
bench     libbenchmark-dev    /usr/include/benchmark/benchmark.h
bench     libprotozero-dev    /usr/include/protozero/pbf_reader.hpp
bench     valgrind            valgrind
clang     clang               clang++
clang     libclang-rt-14-dev  /usr/lib/llvm-14/lib/clang/14.0.6/include/fuzzer/FuzzedDataProvider.h
format    clang-format        clang-format
clang     clang-tidy          clang-tidy
readme    groff               groff
readme    jq                  jq
readme    bsdutils            script
captures  jq                  jq
captures  diffutils           cmp
readme    protobuf-compiler   protoc
load      time                /usr/bin/time
load      diffutils           cmp
page      chromium            chromium
page      chromium-driver     chromedriver
page      python3             python3
visitors  python3             python3
metrics   prometheus          prometheus
metrics   curl                curl
metrics   jq                  jq
shell     shellcheck          shellcheck
'

# is_there PROOF
is_there() {
  if [[ $1 == /* ]]; then
    [[ -e $1 ]]
  else
    command -v "$1" >/dev/null
  fi
}

# missing_packages PURPOSE…: sets `missing` to the packages of these purposes that are not installed.
missing_packages() {
  local purpose package proof
  missing=()
  while read -r purpose package proof; do
    if [[ -n $purpose && " $* " == *" $purpose "* ]] && ! is_there "$proof"; then
      missing+=("$package")
    fi
  done <<<"$package_table"
}

# as_root COMMAND…
as_root() {
  if ((EUID == 0)); then
    "$@"
  else
    sudo "$@"
  fi
}

# apt_get WHAT ARGUMENT…: shows how far it is; its other output only when it fails.
apt_get() {
  local what=$1 log=$root/build/apt.log
  shift
  as_root env DEBIAN_FRONTEND=noninteractive apt-get --yes -qq -o APT::Status-Fd=1 -o DPkg::Lock::Timeout=600 "$@" 2>&1 |
    tee "$log" | sed -nu "s/^dlstatus:[^:]*:\([0-9]*\).*/fetching \1/p; s/^pmstatus:[^:]*:\([0-9]*\).*/$what \1/p" |
    show_progress || { grep -vE '^(dl|pm)status:' "$log" >&2 && return 1; }
}

install_packages() {
  command -v apt-get >/dev/null || die "these Debian packages are missing, and there is no apt-get: $*"
  ((EUID == 0)) || command -v sudo >/dev/null ||
    die "these Debian packages are missing; without sudo, root must install them: apt-get install $*"
  say "installing Debian packages: $*"
  # A mirror out of reach is no fault while the lists at hand suffice.
  apt_get updating update || say "apt-get update failed; going on with the lists at hand"
  apt_get installing install --no-install-recommends "$@" ||
    die "the packages could not be installed: $*"
}

# need_packages PURPOSE…: installs what is missing; two scripts at once wait for each other.
need_packages() {
  local missing lock
  missing_packages "$@"
  ((${#missing[@]})) || return 0
  mkdir -p "$root/build"
  exec {lock}>"$root/build/packages.lock"
  flock "$lock"
  missing_packages "$@"
  if ((${#missing[@]})); then
    install_packages "${missing[@]}"
  fi
  exec {lock}>&-
}

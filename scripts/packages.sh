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
build     libncurses-dev      /usr/include/ncursesw/curses.h
build     zlib1g-dev          /usr/include/zlib.h
test      libgtest-dev        /usr/include/gtest/gtest.h
test      protobuf-compiler   protoc
test      libprotobuf-dev     /usr/include/google/protobuf/message.h
bench     libbenchmark-dev    /usr/include/benchmark/benchmark.h
bench     libprotobuf-dev     /usr/include/google/protobuf/message.h
bench     protobuf-compiler   protoc
bench     libprotozero-dev    /usr/include/protozero/pbf_reader.hpp
bench     valgrind            valgrind
clang     clang               clang++
fuzz      libclang-rt-14-dev  /usr/lib/llvm-14/lib/clang/14.0.6/include/fuzzer/FuzzedDataProvider.h
format    clang-format        clang-format
tidy      clang-tidy          clang-tidy
schema    protobuf-compiler   protoc
manual    groff               groff
readme    jq                  jq
readme    bsdutils            script
captures  jq                  jq
captures  diffutils           cmp
load      time                /usr/bin/time
load      diffutils           cmp
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

install_packages() {
  local install=(apt-get install --yes -qq --no-install-recommends)
  command -v apt-get >/dev/null || die "these Debian packages are missing, and there is no apt-get: $*"
  ((EUID == 0)) || command -v sudo >/dev/null ||
    die "these Debian packages are missing; without sudo, root must install them: apt-get install $*"
  say "installing Debian packages: $*"
  # A mirror out of reach is no fault while the lists at hand suffice.
  quietly as_root apt-get update -qq || say "apt-get update failed; going on with the lists at hand"
  quietly as_root env DEBIAN_FRONTEND=noninteractive "${install[@]}" -o DPkg::Lock::Timeout=600 "$@" ||
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

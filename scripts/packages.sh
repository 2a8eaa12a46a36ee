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
bench     libgtest-dev        /usr/include/gtest/gtest.h
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
drives    jq                  jq
drives    diffutils           cmp
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

# apt_get WHAT LOG ARGUMENT…: shows how far it is; what it says otherwise goes to LOG.
apt_get() {
  local what=$1 log=$2
  shift 2
  as_root env DEBIAN_FRONTEND=noninteractive LC_ALL=C \
    apt-get --yes -qq -o APT::Status-Fd=1 -o DPkg::Lock::Timeout=600 "$@" 2>&1 |
    tee "$log" | sed -nu "s/^dlstatus:[^:]*:\([0-9]*\).*/\1 $what/p; s/^pmstatus:[^:]*:\([0-9]*\).*/\1 installing/p" |
    show_progress
}

# is_out_of_reach LOG: whether apt-get could reach no mirror.
is_out_of_reach() {
  grep -qE 'Could not (resolve|connect)|Temporary failure resolving|Unable to connect|Network is unreachable' "$1"
}

install_packages() {
  command -v apt-get >/dev/null || die "these Debian packages are missing, and there is no apt-get: $*"
  ((EUID == 0)) || command -v sudo >/dev/null ||
    die "these Debian packages are missing; without sudo, root must install them: apt-get install $*"
  ((EUID == 0)) || sudo -v ||
    die "these Debian packages are missing; sudo was refused, root must install them: apt-get install $*"
  say "installing Debian packages: $*"
  # A mirror out of reach is no fault while the lists at hand suffice.
  local lists=$root/build/apt-lists.log log=$root/build/apt.log
  apt_get 'package lists' "$lists" update || true
  apt_get fetching "$log" install --no-install-recommends "$@" && return
  if is_out_of_reach "$lists" || is_out_of_reach "$log"; then
    die "these Debian packages are missing, and no Debian mirror can be reached (is there a network?): $*"
  fi
  grep -hE '^[EW]: ' "$lists" "$log" >&2 || true
  die "the packages could not be installed, see build/apt.log: $*"
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

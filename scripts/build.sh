# How a preset is built and tested. Sourced.

source "${BASH_SOURCE[0]%/*}/packages.sh"

# is_configured PRESET TESTS: whether the build directory was made in this very place, from the presets as they stand,
# with the tests or (TESTS is OFF) at least without them.
is_configured() {
  local stamp=$root/build/$1/.configured state
  [[ -e $root/build/$1/build.ninja && -e $stamp && ! $root/CMakePresets.json -nt $stamp ]] || return 1
  read -r state <"$stamp" || return 1
  [[ $state == "ON $root" || $state == "$2 $root" ]]
}

configure() {
  local preset=$1 tests=$2 options=("-DVESK_TESTS=$2")
  # Who only runs the program is served soonest by unity builds, who works on it by builds of single sources.
  [[ $preset != release || $tests == ON ]] || options+=(-DVESK_UNITY=ON)
  say "configuring the build (preset $preset)"
  (cd "$root" && quietly cmake --fresh --preset "$preset" "${options[@]}") ||
    die "the build could not be configured (preset $preset); CMake's messages stand above"
  printf '%s %s\n' "$tests" "$root" >"$root/build/$preset/.configured"
}

# is_built PRESET TARGET…: writes nothing.
is_built() {
  local preset=$1
  shift
  [[ $(ninja -C "$root/build/$preset" -n "$@" 2>&1) == *'no work to do'* ]]
}

# ninja_in PRESET TARGET…
ninja_in() {
  local preset=$1 options=(-C "$root/build/$1")
  shift
  NINJA_STATUS='[%p] ' ninja "${options[@]}" "$@" |
    sed -u -e 's/^\[ *\([0-9]*\)%\] .*/\1 compiling/; t' -e '/^ninja: Entering/d; /^ninja: build stopped/d; /^-- /d; w /dev/stderr' -e d |
    show_progress || die "the build failed (preset $preset); the compiler's messages stand above"
}

# build PRESET TESTS [TARGET…]: builds the targets (all without any) with TESTS ON or OFF. Reads nothing; all its
# output goes to standard error. Builds of one preset wait for each other. Where all is built nothing is written, so that
# any user may run it, and from a read-only place.
build() {
  local preset=$1 tests=$2 purposes=(build) lock
  shift 2
  ! is_configured "$preset" "$tests" || ! is_built "$preset" "$@" || return 0
  [[ -d $root/build ]] || mkdir -p "$root/build"
  exec {lock}>"$root/build/$preset.lock"
  if ! flock --nonblock "$lock"; then
    say "waiting for another build of preset $preset"
    flock "$lock"
  fi
  ! is_configured "$preset" ON || tests=ON
  [[ $tests == OFF ]] || purposes+=(test)
  need_packages "${purposes[@]}"
  is_configured "$preset" "$tests" || configure "$preset" "$tests"
  is_built "$preset" "$@" || ninja_in "$preset" "$@"
  exec {lock}>&-
} </dev/null >&2

# run_tests PRESET: builds everything and runs every test; prints the output of those that fail, and one summary line.
run_tests() {
  local preset=$1 log status=0 line
  build "$preset" ON
  log=$root/build/$preset/tests.log
  (cd "$root" && GTEST_BRIEF=1 ctest --preset "$preset" --parallel "$(nproc)" --no-tests=error) >"$log" 2>&1 </dev/null || status=$?
  ((status == 0)) || grep -vE '^ *Start +[0-9]+:|^ *[0-9]+/[0-9]+ Test .* Passed ' "$log" >&2 || true
  line=$(grep -E 'tests passed' "$log") || line='no test was run'
  printf '%s\n' "$line"
  return "$status"
}

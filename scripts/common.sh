# What every script of the project shares. Sourced, after set -euo pipefail.

# The checkout, whatever directory the caller stands in; the script that is started knows it.
root=${root:?}

say() {
  printf '%s: %s\n' "${0##*/}" "$*" >&2
}

die() {
  say "$@"
  exit 1
}

# quietly COMMAND…: its output is shown only when it fails.
quietly() {
  local output
  if ! output=$("$@" 2>&1); then
    printf '%s\n' "$output" >&2
    return 1
  fi
}

# in_checkout SUBCOMMAND…: git, also where the checkout belongs to another user than the one who runs the script.
in_checkout() {
  git -C "$root" -c safe.directory="$root" "$@"
}

# sources: the C++ files of the project, each ended by a zero byte.
sources() {
  in_checkout ls-files -z -- '*.cpp' '*.h'
}

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

# Whatever was under way when the user pressed Ctrl-C has ended, and says nothing of its own.
trap 'say interrupted; exit 130' INT

# quietly COMMAND…: its output is shown only when it fails.
quietly() {
  local output
  if ! output=$("$@" 2>&1); then
    printf '%s\n' "$output" >&2
    return 1
  fi
}

# show_progress: reads lines "PERCENT WHAT" and tells standard error how far it is, on a terminal in a line that moves,
# elsewhere at every quarter. What begins anew below what was told is no progress.
show_progress() {
  local what percent told='' quarter=-1 most=0
  while read -r percent what; do
    [[ $what == "$told" ]] || most=0
    ((percent >= most)) || continue
    most=$percent
    if [[ -t 2 ]]; then
      printf '\r%s: %s %d %%\e[K' "${0##*/}" "$what" "$percent" >&2
    elif [[ $what != "$told" ]] || ((percent / 25 > quarter)); then
      say "$what $percent %"
    fi
    told=$what quarter=$((percent / 25))
  done
  [[ ! -t 2 || -z $told ]] || printf '\r\e[K' >&2
}

# in_checkout SUBCOMMAND…: git, also where the checkout belongs to another user than the one who runs the script.
in_checkout() {
  git -C "$root" -c safe.directory="$root" "$@"
}

# sources: the C++ files of the project, each ended by a zero byte.
sources() {
  in_checkout ls-files -z -- '*.cpp' '*.h'
}

# Instructions counted by callgrind: the same program over the same recording takes the same number each time. Sourced.

source "${BASH_SOURCE[0]%/*}/../scripts/common.sh"

# row_instructions COUNTER [RECORDING]: the figures of all rows, as lines for the table, from the program that takes each.
row_instructions() {
  local scratch
  scratch=$(mktemp -d "$root/build/callgrind.XXXXXX")
  quietly valgrind --tool=callgrind --instr-atstart=no --callgrind-out-file="$scratch/out" "$@" ||
    die 'callgrind could not count the instructions; its messages stand above'
  # A dump tells its row and the number of events behind "desc: Trigger: Client Request:", its count behind "totals:".
  cat "$scratch"/out.* | awk '
    /^desc: Trigger:/ { row = $5; events = $6 }
    /^totals:/ && row != "" { printf "%s\t%d\tinstructions\t%.1f\n", row, events, $2 / events }'
  rm -r "$scratch"
}

# instructions_of PROGRAM ARGUMENT…: how many the program takes from start to end.
instructions_of() {
  local messages
  messages=$(valgrind --tool=callgrind --callgrind-out-file=/dev/null "$@" 2>&1 >/dev/null) || {
    printf '%s\n' "$messages" >&2
    die "callgrind could not run $1; its messages stand above"
  }
  awk '/ Collected : / { print $NF }' <<<"$messages"
}

# program_instructions ROW RECORDING PROGRAM ARGUMENT…: the figure of a program for the table: what an event of the
# recording, which is its last argument, takes beyond an empty one.
program_instructions() {
  local row=$1 recording=$2 whole start events
  shift 2
  whole=$(instructions_of "$@" "$recording")
  start=$(instructions_of "$@" /dev/null)
  events=$(wc -l <"$recording")
  printf '%s\t%d\tinstructions\t%d\n' "$row" "$events" $(((whole - start) / events))
}

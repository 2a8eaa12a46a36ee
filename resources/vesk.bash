# Completion of vesk's command line for bash.

# The menu, filled in by the build: a line for each category, with its area before it and a tab between.
_vesk_menu='@menu@'

_vesk_areas() {
  local area rest previous=''
  while IFS=$'\t' read -r area rest; do
    [[ $area == "$previous" ]] || printf '%s\n' "$area"
    previous=$area
  done <<<"$_vesk_menu"
}

# The categories of an area, one a line.
_vesk_categories() {
  local area category
  while IFS=$'\t' read -r area category; do
    [[ $area != "$1" ]] || printf '%s\n' "$category"
  done <<<"$_vesk_menu"
}

# Offers the lines of standard input that go on from the word at the cursor, quoted as the shell needs them.
_vesk_offer() {
  local line word
  # What is typed may be quoted already, and half a quotation cannot be read: then it is taken as it stands.
  word=${cur//[\\\'\"]/}
  while IFS= read -r line; do
    if [[ $line == "$word"* ]]; then
      case $cur in
        \'*) COMPREPLY+=("'$line'") ;;
        \"*) COMPREPLY+=("\"$line\"") ;;
        *) COMPREPLY+=("$(printf '%q' "$line")") ;;
      esac
    fi
  done
}

_vesk_files() {
  compopt -o filenames
  mapfile -t COMPREPLY < <(compgen -f -- "$cur")
}

_vesk() {
  local cur=${COMP_WORDS[COMP_CWORD]} previous=${COMP_WORDS[COMP_CWORD - 1]}
  local command='' word skip='' arguments=()
  local commands='decode stores show summary timeline series readings report serve redact simulate import'
  local sources='--diag --sim --replay --record --real-pauses --speed --seed --loop'
  local options="$sources --headless --seconds --rule --rules --redact --log --version"
  COMPREPLY=()

  for word in "${COMP_WORDS[@]:1:COMP_CWORD-1}"; do
    if [[ -n $skip ]]; then
      skip=''
    elif [[ $word == --@(diag|sim|replay|record|speed|seed|seconds|log|rule|rules|output|port|bind|host) || $word == -o ]]; then
      skip=1
    elif [[ $word != -?* && -z $command ]]; then
      command=$word
    elif [[ $word != -?* ]]; then
      arguments+=("${word//[\\\'\"]/}")
    fi
  done

  case $previous in
    --replay | --record | --rules | --output | -o) _vesk_files && return ;;
    --diag) mapfile -t COMPREPLY < <(compgen -G "${cur:-/dev/}*") && return ;;
    --speed) _vesk_offer < <(printf '%s\n' 1 2 5 10 max) && return ;;
    --log)
      _vesk_files
      _vesk_offer < <(printf '%s\n' syslog stderr none)
      return
      ;;
    --seed | --seconds | --sim | --rule | --port | --bind | --host) return ;;
  esac

  case $command in
    decode | stores) options='--sim --redact --log' ;;
    redact) options='--sim --log' ;;
    show | summary | readings) options='--json --sim --redact --log' ;;
    timeline) options='--json --rule --rules --sim --redact --log' ;;
    series) options='--csv --sim --redact --log' ;;
    report) options='--output --sim --redact --log' ;;
    serve) options="--port --bind --host $sources --rule --rules --redact --seconds --log" ;;
    simulate) options='--seed --seconds --log' ;;
    import) options='--sim --count --layouts --redact --log' ;;
  esac
  if [[ $cur == -* ]]; then
    mapfile -t COMPREPLY < <(compgen -W "$options --help" -- "$cur")
  elif [[ -z $command ]]; then
    mapfile -t COMPREPLY < <(compgen -W "$commands" -- "$cur")
  elif [[ $command == show && ${#arguments[@]} == 0 ]]; then
    _vesk_offer < <(_vesk_areas)
  elif [[ $command == show && ${#arguments[@]} == 1 ]]; then
    _vesk_offer < <(_vesk_categories "${arguments[0]}")
  elif [[ $command != simulate && $command != serve ]]; then
    _vesk_files
  fi
}

complete -F _vesk vesk

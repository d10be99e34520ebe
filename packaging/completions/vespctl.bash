# bash completion for vespctl

_vespctl_files() {
  compopt -o filenames
  mapfile -t COMPREPLY < <(compgen -f -- "$1")
}

_vespctl() {
  local word=${COMP_WORDS[COMP_CWORD]} previous=${COMP_WORDS[COMP_CWORD - 1]} command=${COMP_WORDS[1]:-}
  local options="--help" sources="diag: replay: scenario"
  COMPREPLY=()
  # A colon is a word of its own: behind it comes a file's name.
  if [[ $word == : || $previous == : ]]; then
    _vespctl_files "${word#:}"
    return
  fi
  if [ "$COMP_CWORD" -eq 1 ]; then
    mapfile -t COMPREPLY < <(compgen -W "decode state screens convert record doctor status --help --version" -- "$word")
    return
  fi
  case $command in
  decode | state | screens) options="--sim --help" ;;
  convert) options="--seconds --sim --report --unread --force --help" ;;
  record) options="--manager --sim --force --help" ;;
  doctor) options="--json --help" ;;
  status) options="--manager --help" ;;
  esac
  case $previous in
  --seconds) return ;;
  --unread)
    _vespctl_files "$word"
    return
    ;;
  --sim)
    mapfile -t COMPREPLY < <(compgen -W "1 2 3 4" -- "$word")
    return
    ;;
  --manager)
    compopt -o nospace
    mapfile -t COMPREPLY < <(compgen -W "system unix:path= ssh: embedded: auto" -- "$word")
    return
    ;;
  esac
  if [[ $word == -* ]]; then
    mapfile -t COMPREPLY < <(compgen -W "$options" -- "$word")
  elif [ "$command" = convert ] && [ "$COMP_CWORD" -eq 2 ]; then
    compopt -o nospace
    mapfile -t COMPREPLY < <(compgen -W "$sources" -- "$word")
  elif [ "$command" = screens ] && [ "$COMP_CWORD" -gt 2 ]; then
    mapfile -t COMPREPLY < <(compgen -W "LTE UMTS GSM" -- "$word")
  elif [ "$command" != status ]; then
    _vespctl_files "$word"
  fi
}
complete -F _vespctl vespctl

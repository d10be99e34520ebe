# bash completion for rhoxd

_rhoxd() {
  local word=${COMP_WORDS[COMP_CWORD]} previous=${COMP_WORDS[COMP_CWORD - 1]}
  local options="--system --listen --stdio --source --group --state --record --record-size --record-age --record-total
    --record-keep --help --version"
  COMPREPLY=()
  case $previous in
  --listen)
    compopt -o nospace
    mapfile -t COMPREPLY < <(compgen -W "unix:path=" -- "$word")
    ;;
  --source)
    compopt -o nospace
    mapfile -t COMPREPLY < <(compgen -W "scenario replay: diag: modemmanager" -- "$word")
    ;;
  --group) mapfile -t COMPREPLY < <(compgen -g -- "$word") ;;
  --state | --record)
    compopt -o filenames
    mapfile -t COMPREPLY < <(compgen -d -- "$word")
    ;;
  --record-*) ;;
  *) mapfile -t COMPREPLY < <(compgen -W "$options" -- "$word") ;;
  esac
}
complete -F _rhoxd rhoxd

# bash completion for vespscope

_vespscope() {
  local word=${COMP_WORDS[COMP_CWORD]} previous=${COMP_WORDS[COMP_CWORD - 1]}
  COMPREPLY=()
  case $previous in
  --manager)
    compopt -o nospace
    mapfile -t COMPREPLY < <(compgen -W "system unix:path= ssh: embedded: auto" -- "$word")
    ;;
  --sim) mapfile -t COMPREPLY < <(compgen -W "1 2 3 4" -- "$word") ;;
  --ui) mapfile -t COMPREPLY < <(compgen -W "quick terminal none" -- "$word") ;;
  *)
    if [[ $word == -* ]]; then
      mapfile -t COMPREPLY < <(compgen -W "--manager --ui --sim --help --version" -- "$word")
    else
      compopt -o filenames
      mapfile -t COMPREPLY < <(compgen -f -- "$word")
    fi
    ;;
  esac
}
complete -F _vespscope vespscope

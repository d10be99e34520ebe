# fish completion for vespscope

complete -c vespscope -l help -d 'Print a short help'
complete -c vespscope -l version -d 'Print the version'
complete -c vespscope -x -l manager -a 'system unix:path= ssh: embedded: auto' -d 'Where the manager is'
complete -c vespscope -x -l ui -a 'quick terminal none' -d 'The interface'
complete -c vespscope -x -l sim -a '1 2 3 4' -d 'The SIM card to show first'

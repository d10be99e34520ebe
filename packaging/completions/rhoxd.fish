# fish completion for rhoxd

complete -c rhoxd -f
complete -c rhoxd -l help -d 'Print a short help'
complete -c rhoxd -l version -d 'Print the version'
complete -c rhoxd -l system -d 'Serve on the system bus'
complete -c rhoxd -x -l listen -a unix:path= -d 'Serve on a socket'
complete -c rhoxd -l stdio -d 'Serve one client on standard input and output'
complete -c rhoxd -x -l source -a 'scenario replay: diag: modemmanager' -d 'Where events come from'
complete -c rhoxd -x -l group -a '(__fish_complete_groups)' -d 'The group that may use it'
complete -c rhoxd -x -l state -a '(__fish_complete_directories)' -d 'Where configurations are kept'
complete -c rhoxd -x -l record -a '(__fish_complete_directories)' -d 'Where events are recorded'
complete -c rhoxd -x -l record-size -d 'Size of one file'
complete -c rhoxd -x -l record-age -d 'Time that one file covers'
complete -c rhoxd -x -l record-total -d 'Size of all files'
complete -c rhoxd -x -l record-keep -d 'How long files are kept'

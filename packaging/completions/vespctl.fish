# fish completion for vespctl

complete -c vespctl -n __fish_use_subcommand -f -a decode -d 'Print one JSON object per packet'
complete -c vespctl -n __fish_use_subcommand -f -a state -d 'Print what the decoder holds after all events'
complete -c vespctl -n __fish_use_subcommand -f -a screens -d 'Print the screens after all events'
complete -c vespctl -n __fish_use_subcommand -f -a convert -d 'Run a source into a capture'
complete -c vespctl -n __fish_use_subcommand -f -a record -d 'Write what the manager delivers'
complete -c vespctl -n __fish_use_subcommand -f -a doctor -d 'Print what a recording or a port holds'
complete -c vespctl -n __fish_use_subcommand -f -a status -d 'Print the source and clients of the manager'
complete -c vespctl -n __fish_use_subcommand -l version -d 'Print the version'
complete -c vespctl -l help -d 'Print a short help'
complete -c vespctl -n '__fish_seen_subcommand_from convert' -a 'diag: replay: scenario'
complete -c vespctl -n '__fish_seen_subcommand_from convert' -x -l seconds -d 'Stop after so much'
complete -c vespctl -n '__fish_seen_subcommand_from convert' -l report -d 'Print how each record was handled'
complete -c vespctl -n '__fish_seen_subcommand_from convert' -r -l unread -d 'Folder for samples of records not read'
complete -c vespctl -n '__fish_seen_subcommand_from doctor' -l json -d 'Print one JSON object'
complete -c vespctl -n '__fish_seen_subcommand_from convert record' -l force -d 'Replace an existing file'
complete -c vespctl -n '__fish_seen_subcommand_from record status' -x -l manager -a 'system unix:path= ssh: embedded: auto' -d 'Where the manager is'
complete -c vespctl -n '__fish_seen_subcommand_from status' -f

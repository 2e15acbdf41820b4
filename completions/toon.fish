# Completion of `toon` for fish: put it into ~/.config/fish/completions.

set -l commands play edit show write check film trace
set -l stage '__fish_seen_subcommand_from film trace'

complete -c toon -f
complete -c toon -n "not __fish_seen_subcommand_from $commands" -a play -d 'shows a Toon on the whole screen, once'
complete -c toon -n "not __fish_seen_subcommand_from $commands" -a edit -d 'opens the Toon editor'
complete -c toon -n "not __fish_seen_subcommand_from $commands" -a show -d 'prints a Toon as JSON'
complete -c toon -n "not __fish_seen_subcommand_from $commands" -a write -d 'makes a Toon of JSON'
complete -c toon -n "not __fish_seen_subcommand_from $commands" -a check -d 'tells what the saver would do with Toons'
complete -c toon -n "not __fish_seen_subcommand_from $commands" -a film -d 'acts a Toon out and films it'
complete -c toon -n "not __fish_seen_subcommand_from $commands" -a trace -d 'prints what happens in a show'
complete -c toon -l help -d 'tells how it is used'
complete -c toon -n '__fish_seen_subcommand_from play edit show check film trace' -k -a '(__fish_complete_suffix .zkt)'
complete -c toon -n '__fish_seen_subcommand_from write' -k -a '(__fish_complete_suffix .json)'
complete -c toon -n '__fish_seen_subcommand_from write' -s o -r -F -d 'where to'
complete -c toon -n '__fish_seen_subcommand_from check' -l json -d 'for programs'
complete -c toon -n "$stage" -l size -x -a '640x480 1024x768 1920x1080' -d 'the stage in pixels'
complete -c toon -n "$stage" -l seed -x -d 'of the random numbers'
complete -c toon -n "$stage" -l walk-about -d 'a walk about in the place of a Toon'
complete -c toon -n '__fish_seen_subcommand_from film' -F
complete -c toon -n '__fish_seen_subcommand_from film' -l still -x -d 'the picture at a millisecond'
complete -c toon -n "$stage" -l mode -x -a 'saver player' -d 'who shows it'
complete -c toon -n '__fish_seen_subcommand_from trace' -l mode -x -a 'editor' -d 'who shows it'
complete -c toon -n '__fish_seen_subcommand_from trace' -l script -r -F -d 'what a user does in the editor'
complete -c toon -n '__fish_seen_subcommand_from trace' -l shows -x -d 'after how many the stage closes'
complete -c toon -n '__fish_seen_subcommand_from trace' -l paces -x -d 'the odometer at the start'

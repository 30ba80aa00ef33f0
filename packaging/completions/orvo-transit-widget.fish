# fish completion for orvo-transit-widget, written by `orvo-transit-widget --completion fish`

complete -c orvo-transit-widget -f
complete -c orvo-transit-widget -l print -d 'text, json (for scripts), or waybar (one object for a desktop bar)' -r -f -a 'text json waybar'
complete -c orvo-transit-widget -l payloads -d 'with --print json: what is handed over, data in base64' -f
complete -c orvo-transit-widget -l follow -d 'go on until Ctrl-C, and print again when something has changed' -f
complete -c orvo-transit-widget -l open -d 'tap that row, from 0: the map application opens what it is about' -r -f
complete -c orvo-transit-widget -l snapshot -d 'draw the widget'\''s card, all its rows, into a PNG file' -r -F
complete -c orvo-transit-widget -l pictures -d 'when printing: draw the widget in both modes besides, into files in that folder' -r -f
complete -c orvo-transit-widget -l dump -d 'what the picture is made of: views, constraints, or the archive that is kept between starts' -r -f -a 'views constraints archive'
complete -c orvo-transit-widget -l mode -d 'of the tapped row, the picture or the dump: compact or expanded; if you say nothing, expanded where there is more to show; of the window at its start, the one you chose last if you say nothing' -r -f -a 'compact expanded'
complete -c orvo-transit-widget -l width -d 'of the window or the picture, 160 to 2000, 359 if you say nothing' -r -f
complete -c orvo-transit-widget -l scale -d 'pixels a point: 1, 2 or 3' -r -f -a '1 2 3'
complete -c orvo-transit-widget -l text-size -d 'XS to XXXL, and AX1 to AX5; L if you say nothing' -r -f -a 'XS S M L XL XXL XXXL AX1 AX2 AX3 AX4 AX5'
complete -c orvo-transit-widget -l dark -d 'as on a dark desktop' -f
complete -c orvo-transit-widget -l contrast -d 'with more contrast' -f
complete -c orvo-transit-widget -l max-rows -d 'expanded rows at most, 0 for all; if you say nothing, five, and in a window what the screen has room for; what is too many becomes one row' -r -f
complete -c orvo-transit-widget -l completion -d 'print a shell'\''s completion script: bash, zsh or fish' -r -f -a 'bash zsh fish'
complete -c orvo-transit-widget -l version -d 'show the version' -f
complete -c orvo-transit-widget -l demo -d 'use the demonstration city'\''s profile instead of your own' -f
complete -c orvo-transit-widget -l at -d 'answer for that moment, as 2024-07-24T01:28:40Z; nothing is written' -r -f
complete -c orvo-transit-widget -l language -d 'the language to prefer in texts, as de or pt-BR' -r -f
complete -c orvo-transit-widget -l help -d 'show this text' -f

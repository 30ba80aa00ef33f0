# fish completion for orvo, written by `orvo completion fish`

# Whether the words so far, options left out, begin with exactly these.
function __orvo_at
    set -l given (string match -v -- '-*' (commandline -opc)[2..-1])
    test (count $given) -ge (count $argv); or return 1
    set -l n (count $argv)
    test $n -eq 0; or test "$given[1..$n]" = "$argv"
end
# The same, with exactly that number of words after them; with at least that number.
function __orvo_after -a number
    set -l given (string match -v -- '-*' (commandline -opc)[2..-1])
    test (count $given) -eq (math (count $argv) - 1 + $number); and __orvo_at $argv[2..-1]
end
function __orvo_from -a number
    set -l given (string match -v -- '-*' (commandline -opc)[2..-1])
    test (count $given) -ge (math (count $argv) - 1 + $number); and __orvo_at $argv[2..-1]
end
# The names that only this machine has, of the demonstration city where the line asks for it.
function __orvo_words -a kind
    orvo completion words $kind (string match -- --demo (commandline -opc))[1] 2>/dev/null
end

complete -c orvo -f
complete -c orvo -n '__orvo_after 0' -l version -d 'show the version'
complete -c orvo -n '__orvo_after 0' -a incidents -d 'Show what is known now of the favourite lines'
complete -c orvo -n '__orvo_after 0' -a lines -d 'Find lines in the schedules'
complete -c orvo -n '__orvo_after 0' -a favorites -d 'favorites …'
complete -c orvo -n '__orvo_after 0' -a feeds -d 'feeds …'
complete -c orvo -n '__orvo_after 0' -a open -d 'Open a URL of the map application'
complete -c orvo -n '__orvo_after 0' -a show -d 'Show what was handed over last'
complete -c orvo -n '__orvo_after 0' -a receive -d 'Take what another program hands over'
complete -c orvo -n '__orvo_after 0' -a service -d 'Serve the map application on the session bus'
complete -c orvo -n '__orvo_after 0' -a analytics -d 'List what the widget recorded of its own use'
complete -c orvo -n '__orvo_after 0' -a settings -d 'Show or change what you prefer'
complete -c orvo -n '__orvo_after 0' -a defaults -d 'defaults …'
complete -c orvo -n '__orvo_after 0' -a demo -d 'Write the demonstration city anew'
complete -c orvo -n '__orvo_after 0' -a completion -d 'Print a shell'\''s completion script'
complete -c orvo -n '__orvo_after 0' -a help -d 'Explain a command'
complete -c orvo -n '__orvo_after 0 defaults' -a read -d 'Show settings as they are kept'
complete -c orvo -n '__orvo_after 0 defaults' -a write -d 'Set one setting'
complete -c orvo -n '__orvo_after 0 defaults' -a delete -d 'Forget one setting'
complete -c orvo -n '__orvo_after 0 favorites' -a add -d 'Add lines, or a place, to the favourites'
complete -c orvo -n '__orvo_after 0 favorites' -a list -d 'List the favourites in their order'
complete -c orvo -n '__orvo_after 0 favorites' -a edit -d 'Edit the favourites in a window'
complete -c orvo -n '__orvo_after 0 favorites' -a move -d 'Give a favourite another place in the order'
complete -c orvo -n '__orvo_after 0 favorites' -a remove -d 'Remove favourites'
complete -c orvo -n '__orvo_after 0 feeds' -a add -d 'Add a feed: a schedule and its alerts'
complete -c orvo -n '__orvo_after 0 feeds' -a list -d 'List the feeds'
complete -c orvo -n '__orvo_after 0 feeds' -a update -d 'Import schedules anew'
complete -c orvo -n '__orvo_after 0 feeds' -a check -d 'Read the alerts now and say what they hold'
complete -c orvo -n '__orvo_after 0 feeds' -a remove -d 'Forget feeds'
complete -c orvo -n '__orvo_at incidents' -l all -d 'every line of every feed instead of the favourites' -f
complete -c orvo -n '__orvo_at incidents' -l json -d 'print JSON: times in UTC, incidents with their periods' -f
complete -c orvo -n '__orvo_at incidents' -l demo -d 'use the demonstration city'\''s profile instead of your own' -f
complete -c orvo -n '__orvo_at incidents' -l at -d 'answer for that moment, as 2024-07-24T01:28:40Z; nothing is written' -r -f
complete -c orvo -n '__orvo_at incidents' -l language -d 'the language to prefer in texts, as de or pt-BR' -r -f
complete -c orvo -n '__orvo_at incidents' -l help -d 'show this text' -f
complete -c orvo -n '__orvo_at lines' -l limit -d 'show at most so many lines; 0 for all' -r -f
complete -c orvo -n '__orvo_at lines' -l json -d 'print JSON: the lines, and in total how many there are' -f
complete -c orvo -n '__orvo_at lines' -l demo -d 'use the demonstration city'\''s profile instead of your own' -f
complete -c orvo -n '__orvo_at lines' -l at -d 'answer for that moment, as 2024-07-24T01:28:40Z; nothing is written' -r -f
complete -c orvo -n '__orvo_at lines' -l language -d 'the language to prefer in texts, as de or pt-BR' -r -f
complete -c orvo -n '__orvo_at lines' -l help -d 'show this text' -f
complete -c orvo -n '__orvo_from 0 lines' -f -a '(__orvo_words feeds)'
complete -c orvo -n '__orvo_at favorites add' -l place -d 'add a place of that name instead' -r -f
complete -c orvo -n '__orvo_at favorites add' -l location -d 'where the place is, in degrees' -r -f
complete -c orvo -n '__orvo_at favorites add' -l demo -d 'use the demonstration city'\''s profile instead of your own' -f
complete -c orvo -n '__orvo_at favorites add' -l at -d 'answer for that moment, as 2024-07-24T01:28:40Z; nothing is written' -r -f
complete -c orvo -n '__orvo_at favorites add' -l language -d 'the language to prefer in texts, as de or pt-BR' -r -f
complete -c orvo -n '__orvo_at favorites add' -l help -d 'show this text' -f
complete -c orvo -n '__orvo_from 0 favorites add' -f -a '(__orvo_words lines)'
complete -c orvo -n '__orvo_at favorites list' -l json -d 'print JSON' -f
complete -c orvo -n '__orvo_at favorites list' -l demo -d 'use the demonstration city'\''s profile instead of your own' -f
complete -c orvo -n '__orvo_at favorites list' -l at -d 'answer for that moment, as 2024-07-24T01:28:40Z; nothing is written' -r -f
complete -c orvo -n '__orvo_at favorites list' -l language -d 'the language to prefer in texts, as de or pt-BR' -r -f
complete -c orvo -n '__orvo_at favorites list' -l help -d 'show this text' -f
complete -c orvo -n '__orvo_at favorites edit' -l demo -d 'use the demonstration city'\''s profile instead of your own' -f
complete -c orvo -n '__orvo_at favorites edit' -l at -d 'answer for that moment, as 2024-07-24T01:28:40Z; nothing is written' -r -f
complete -c orvo -n '__orvo_at favorites edit' -l language -d 'the language to prefer in texts, as de or pt-BR' -r -f
complete -c orvo -n '__orvo_at favorites edit' -l help -d 'show this text' -f
complete -c orvo -n '__orvo_at favorites move' -l demo -d 'use the demonstration city'\''s profile instead of your own' -f
complete -c orvo -n '__orvo_at favorites move' -l at -d 'answer for that moment, as 2024-07-24T01:28:40Z; nothing is written' -r -f
complete -c orvo -n '__orvo_at favorites move' -l language -d 'the language to prefer in texts, as de or pt-BR' -r -f
complete -c orvo -n '__orvo_at favorites move' -l help -d 'show this text' -f
complete -c orvo -n '__orvo_after 0 favorites move' -f -a '(__orvo_words favorites)'
complete -c orvo -n '__orvo_after 1 favorites move' -f
complete -c orvo -n '__orvo_at favorites remove' -l demo -d 'use the demonstration city'\''s profile instead of your own' -f
complete -c orvo -n '__orvo_at favorites remove' -l at -d 'answer for that moment, as 2024-07-24T01:28:40Z; nothing is written' -r -f
complete -c orvo -n '__orvo_at favorites remove' -l language -d 'the language to prefer in texts, as de or pt-BR' -r -f
complete -c orvo -n '__orvo_at favorites remove' -l help -d 'show this text' -f
complete -c orvo -n '__orvo_from 0 favorites remove' -f -a '(__orvo_words favorites)'
complete -c orvo -n '__orvo_at feeds add' -l static -d 'the schedule' -r -F
complete -c orvo -n '__orvo_at feeds add' -l alerts -d 'where its alerts are' -r -F
complete -c orvo -n '__orvo_at feeds add' -l header -d 'an HTTP header to send' -r -f
complete -c orvo -n '__orvo_at feeds add' -l query -d 'a query parameter to send' -r -f
complete -c orvo -n '__orvo_at feeds add' -l user -d 'for basic authorization' -r -f
complete -c orvo -n '__orvo_at feeds add' -l replace -d 'take the place of a feed of that name' -f
complete -c orvo -n '__orvo_at feeds add' -l demo -d 'use the demonstration city'\''s profile instead of your own' -f
complete -c orvo -n '__orvo_at feeds add' -l at -d 'answer for that moment, as 2024-07-24T01:28:40Z; nothing is written' -r -f
complete -c orvo -n '__orvo_at feeds add' -l language -d 'the language to prefer in texts, as de or pt-BR' -r -f
complete -c orvo -n '__orvo_at feeds add' -l help -d 'show this text' -f
complete -c orvo -n '__orvo_after 0 feeds add' -f
complete -c orvo -n '__orvo_at feeds list' -l json -d 'print JSON' -f
complete -c orvo -n '__orvo_at feeds list' -l demo -d 'use the demonstration city'\''s profile instead of your own' -f
complete -c orvo -n '__orvo_at feeds list' -l at -d 'answer for that moment, as 2024-07-24T01:28:40Z; nothing is written' -r -f
complete -c orvo -n '__orvo_at feeds list' -l language -d 'the language to prefer in texts, as de or pt-BR' -r -f
complete -c orvo -n '__orvo_at feeds list' -l help -d 'show this text' -f
complete -c orvo -n '__orvo_at feeds update' -l force -d 'import in any case' -f
complete -c orvo -n '__orvo_at feeds update' -l demo -d 'use the demonstration city'\''s profile instead of your own' -f
complete -c orvo -n '__orvo_at feeds update' -l at -d 'answer for that moment, as 2024-07-24T01:28:40Z; nothing is written' -r -f
complete -c orvo -n '__orvo_at feeds update' -l language -d 'the language to prefer in texts, as de or pt-BR' -r -f
complete -c orvo -n '__orvo_at feeds update' -l help -d 'show this text' -f
complete -c orvo -n '__orvo_from 0 feeds update' -f -a '(__orvo_words feeds)'
complete -c orvo -n '__orvo_at feeds check' -l json -d 'print JSON' -f
complete -c orvo -n '__orvo_at feeds check' -l demo -d 'use the demonstration city'\''s profile instead of your own' -f
complete -c orvo -n '__orvo_at feeds check' -l at -d 'answer for that moment, as 2024-07-24T01:28:40Z; nothing is written' -r -f
complete -c orvo -n '__orvo_at feeds check' -l language -d 'the language to prefer in texts, as de or pt-BR' -r -f
complete -c orvo -n '__orvo_at feeds check' -l help -d 'show this text' -f
complete -c orvo -n '__orvo_from 0 feeds check' -f -a '(__orvo_words feeds)'
complete -c orvo -n '__orvo_at feeds remove' -l demo -d 'use the demonstration city'\''s profile instead of your own' -f
complete -c orvo -n '__orvo_at feeds remove' -l at -d 'answer for that moment, as 2024-07-24T01:28:40Z; nothing is written' -r -f
complete -c orvo -n '__orvo_at feeds remove' -l language -d 'the language to prefer in texts, as de or pt-BR' -r -f
complete -c orvo -n '__orvo_at feeds remove' -l help -d 'show this text' -f
complete -c orvo -n '__orvo_from 0 feeds remove' -f -a '(__orvo_words feeds)'
complete -c orvo -n '__orvo_at open' -l demo -d 'use the demonstration city'\''s profile instead of your own' -f
complete -c orvo -n '__orvo_at open' -l at -d 'answer for that moment, as 2024-07-24T01:28:40Z; nothing is written' -r -f
complete -c orvo -n '__orvo_at open' -l language -d 'the language to prefer in texts, as de or pt-BR' -r -f
complete -c orvo -n '__orvo_at open' -l help -d 'show this text' -f
complete -c orvo -n '__orvo_from 0 open' -f
complete -c orvo -n '__orvo_at show' -l json -d 'print JSON: the line and its incidents, or the incidents' -f
complete -c orvo -n '__orvo_at show' -l demo -d 'use the demonstration city'\''s profile instead of your own' -f
complete -c orvo -n '__orvo_at show' -l at -d 'answer for that moment, as 2024-07-24T01:28:40Z; nothing is written' -r -f
complete -c orvo -n '__orvo_at show' -l language -d 'the language to prefer in texts, as de or pt-BR' -r -f
complete -c orvo -n '__orvo_at show' -l help -d 'show this text' -f
complete -c orvo -n '__orvo_at receive' -l demo -d 'use the demonstration city'\''s profile instead of your own' -f
complete -c orvo -n '__orvo_at receive' -l at -d 'answer for that moment, as 2024-07-24T01:28:40Z; nothing is written' -r -f
complete -c orvo -n '__orvo_at receive' -l language -d 'the language to prefer in texts, as de or pt-BR' -r -f
complete -c orvo -n '__orvo_at receive' -l help -d 'show this text' -f
complete -c orvo -n '__orvo_after 0 receive' -f -a 'ContinueUserActivity'
complete -c orvo -n '__orvo_at service' -l idle -d 'after how long; 600 if you say nothing, 0 for never' -r -f
complete -c orvo -n '__orvo_at service' -l demo -d 'use the demonstration city'\''s profile instead of your own' -f
complete -c orvo -n '__orvo_at service' -l at -d 'answer for that moment, as 2024-07-24T01:28:40Z; nothing is written' -r -f
complete -c orvo -n '__orvo_at service' -l language -d 'the language to prefer in texts, as de or pt-BR' -r -f
complete -c orvo -n '__orvo_at service' -l help -d 'show this text' -f
complete -c orvo -n '__orvo_at analytics' -l limit -d 'how many; 20 if you say nothing' -r -f
complete -c orvo -n '__orvo_at analytics' -l json -d 'print JSON: times in UTC, also the single actions' -f
complete -c orvo -n '__orvo_at analytics' -l demo -d 'use the demonstration city'\''s profile instead of your own' -f
complete -c orvo -n '__orvo_at analytics' -l at -d 'answer for that moment, as 2024-07-24T01:28:40Z; nothing is written' -r -f
complete -c orvo -n '__orvo_at analytics' -l language -d 'the language to prefer in texts, as de or pt-BR' -r -f
complete -c orvo -n '__orvo_at analytics' -l help -d 'show this text' -f
complete -c orvo -n '__orvo_at settings' -l json -d 'print JSON' -f
complete -c orvo -n '__orvo_at settings' -l demo -d 'use the demonstration city'\''s profile instead of your own' -f
complete -c orvo -n '__orvo_at settings' -l at -d 'answer for that moment, as 2024-07-24T01:28:40Z; nothing is written' -r -f
complete -c orvo -n '__orvo_at settings' -l language -d 'the language to prefer in texts, as de or pt-BR' -r -f
complete -c orvo -n '__orvo_at settings' -l help -d 'show this text' -f
complete -c orvo -n '__orvo_after 0 settings' -f -a 'step-free'
complete -c orvo -n '__orvo_after 1 settings' -f -a 'on off'
complete -c orvo -n '__orvo_at defaults read' -l json -d 'print JSON' -f
complete -c orvo -n '__orvo_at defaults read' -l demo -d 'use the demonstration city'\''s profile instead of your own' -f
complete -c orvo -n '__orvo_at defaults read' -l at -d 'answer for that moment, as 2024-07-24T01:28:40Z; nothing is written' -r -f
complete -c orvo -n '__orvo_at defaults read' -l language -d 'the language to prefer in texts, as de or pt-BR' -r -f
complete -c orvo -n '__orvo_at defaults read' -l help -d 'show this text' -f
complete -c orvo -n '__orvo_after 0 defaults read' -f -a 'Orvo.TransitWidget.internal.injectFakeIncidents Orvo.TransitWidget.internal.randomNumberIncidents'
complete -c orvo -n '__orvo_at defaults write' -l type -d 'read VALUE as bool, integer, real or string' -r -f -a 'bool integer real string'
complete -c orvo -n '__orvo_at defaults write' -l demo -d 'use the demonstration city'\''s profile instead of your own' -f
complete -c orvo -n '__orvo_at defaults write' -l at -d 'answer for that moment, as 2024-07-24T01:28:40Z; nothing is written' -r -f
complete -c orvo -n '__orvo_at defaults write' -l language -d 'the language to prefer in texts, as de or pt-BR' -r -f
complete -c orvo -n '__orvo_at defaults write' -l help -d 'show this text' -f
complete -c orvo -n '__orvo_after 0 defaults write' -f -a 'Orvo.TransitWidget.internal.injectFakeIncidents Orvo.TransitWidget.internal.randomNumberIncidents'
complete -c orvo -n '__orvo_after 1 defaults write' -f
complete -c orvo -n '__orvo_at defaults delete' -l demo -d 'use the demonstration city'\''s profile instead of your own' -f
complete -c orvo -n '__orvo_at defaults delete' -l at -d 'answer for that moment, as 2024-07-24T01:28:40Z; nothing is written' -r -f
complete -c orvo -n '__orvo_at defaults delete' -l language -d 'the language to prefer in texts, as de or pt-BR' -r -f
complete -c orvo -n '__orvo_at defaults delete' -l help -d 'show this text' -f
complete -c orvo -n '__orvo_after 0 defaults delete' -f -a 'Orvo.TransitWidget.internal.injectFakeIncidents Orvo.TransitWidget.internal.randomNumberIncidents'
complete -c orvo -n '__orvo_at demo' -l serve -d 'serve live alerts over HTTP, to this machine only' -f
complete -c orvo -n '__orvo_at demo' -l demo -d 'use the demonstration city'\''s profile instead of your own' -f
complete -c orvo -n '__orvo_at demo' -l at -d 'answer for that moment, as 2024-07-24T01:28:40Z; nothing is written' -r -f
complete -c orvo -n '__orvo_at demo' -l language -d 'the language to prefer in texts, as de or pt-BR' -r -f
complete -c orvo -n '__orvo_at demo' -l help -d 'show this text' -f
complete -c orvo -n '__orvo_after 0 demo' -f
complete -c orvo -n '__orvo_at completion' -l demo -d 'use the demonstration city'\''s profile instead of your own' -f
complete -c orvo -n '__orvo_at completion' -l at -d 'answer for that moment, as 2024-07-24T01:28:40Z; nothing is written' -r -f
complete -c orvo -n '__orvo_at completion' -l language -d 'the language to prefer in texts, as de or pt-BR' -r -f
complete -c orvo -n '__orvo_at completion' -l help -d 'show this text' -f
complete -c orvo -n '__orvo_after 0 completion' -f -a 'bash zsh fish words'
complete -c orvo -n '__orvo_after 1 completion' -f -a 'feeds lines favorites'
complete -c orvo -n '__orvo_at help' -l demo -d 'use the demonstration city'\''s profile instead of your own' -f
complete -c orvo -n '__orvo_at help' -l at -d 'answer for that moment, as 2024-07-24T01:28:40Z; nothing is written' -r -f
complete -c orvo -n '__orvo_at help' -l language -d 'the language to prefer in texts, as de or pt-BR' -r -f
complete -c orvo -n '__orvo_at help' -l help -d 'show this text' -f
complete -c orvo -n '__orvo_from 0 help' -f
complete -c orvo -n '__orvo_after 0 help' -a incidents -d 'Show what is known now of the favourite lines'
complete -c orvo -n '__orvo_after 0 help' -a lines -d 'Find lines in the schedules'
complete -c orvo -n '__orvo_after 0 help' -a favorites -d 'favorites …'
complete -c orvo -n '__orvo_after 0 help' -a feeds -d 'feeds …'
complete -c orvo -n '__orvo_after 0 help' -a open -d 'Open a URL of the map application'
complete -c orvo -n '__orvo_after 0 help' -a show -d 'Show what was handed over last'
complete -c orvo -n '__orvo_after 0 help' -a receive -d 'Take what another program hands over'
complete -c orvo -n '__orvo_after 0 help' -a service -d 'Serve the map application on the session bus'
complete -c orvo -n '__orvo_after 0 help' -a analytics -d 'List what the widget recorded of its own use'
complete -c orvo -n '__orvo_after 0 help' -a settings -d 'Show or change what you prefer'
complete -c orvo -n '__orvo_after 0 help' -a defaults -d 'defaults …'
complete -c orvo -n '__orvo_after 0 help' -a demo -d 'Write the demonstration city anew'
complete -c orvo -n '__orvo_after 0 help' -a completion -d 'Print a shell'\''s completion script'
complete -c orvo -n '__orvo_after 0 help' -a help -d 'Explain a command'
complete -c orvo -n '__orvo_after 0 help defaults' -a read -d 'Show settings as they are kept'
complete -c orvo -n '__orvo_after 0 help defaults' -a write -d 'Set one setting'
complete -c orvo -n '__orvo_after 0 help defaults' -a delete -d 'Forget one setting'
complete -c orvo -n '__orvo_after 0 help favorites' -a add -d 'Add lines, or a place, to the favourites'
complete -c orvo -n '__orvo_after 0 help favorites' -a list -d 'List the favourites in their order'
complete -c orvo -n '__orvo_after 0 help favorites' -a edit -d 'Edit the favourites in a window'
complete -c orvo -n '__orvo_after 0 help favorites' -a move -d 'Give a favourite another place in the order'
complete -c orvo -n '__orvo_after 0 help favorites' -a remove -d 'Remove favourites'
complete -c orvo -n '__orvo_after 0 help feeds' -a add -d 'Add a feed: a schedule and its alerts'
complete -c orvo -n '__orvo_after 0 help feeds' -a list -d 'List the feeds'
complete -c orvo -n '__orvo_after 0 help feeds' -a update -d 'Import schedules anew'
complete -c orvo -n '__orvo_after 0 help feeds' -a check -d 'Read the alerts now and say what they hold'
complete -c orvo -n '__orvo_after 0 help feeds' -a remove -d 'Forget feeds'

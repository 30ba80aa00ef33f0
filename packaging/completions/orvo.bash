# bash completion for orvo, written by `orvo completion bash`

_orvo_words() {
    # The words come from schedules of strangers: they are compared and quoted, never expanded (as `compgen -W` would).
    local word
    while IFS= read -r word; do
        [[ $word == "$current"* ]] || continue
        # A colon begins a new word for readline: take away what stands before it.
        if [[ $current == *:* && $COMP_WORDBREAKS == *:* ]]; then
            word=${word#"${current%"${current##*:}"}"}
        fi
        printf -v word %q "$word"
        COMPREPLY+=("$word")
    done < <(orvo completion words "$1" $demo 2>/dev/null)
}

_orvo() {
    local line=${COMP_LINE:0:COMP_POINT} previous=$3 place= word skip= demo=
    local current=${line##* }
    local -a operands=()
    COMPREPLY=()
    for word in "${COMP_WORDS[@]:1:COMP_CWORD-1}"; do
        [[ $skip ]] && { skip=; continue; }
        [[ $word == --demo ]] && demo=--demo
        case $word in
        # Where readline broke a word in two.
        : | =) skip=1; continue ;;
        --alerts | --at | --header | --idle | --language | --limit | --location | --place | --query | --static | --type | --user) skip=1; continue ;;
        -*) continue ;;
        esac
        case $place in
        '') case $word in incidents|lines|favorites|feeds|open|show|receive|service|analytics|settings|defaults|demo|completion|help) place="${place:+$place }$word"; continue ;; esac ;;
        'defaults') case $word in read|write|delete) place="${place:+$place }$word"; continue ;; esac ;;
        'favorites') case $word in add|list|edit|move|remove) place="${place:+$place }$word"; continue ;; esac ;;
        'feeds') case $word in add|list|update|check|remove) place="${place:+$place }$word"; continue ;; esac ;;
        esac
        operands+=("$word")
    done
    case $place in
    '') COMPREPLY=($(compgen -W 'incidents lines favorites feeds open show receive service analytics settings defaults demo completion help --help --version' -- "$current")) ;;
    'defaults') COMPREPLY=($(compgen -W 'read write delete' -- "$current")) ;;
    'favorites') COMPREPLY=($(compgen -W 'add list edit move remove' -- "$current")) ;;
    'feeds') COMPREPLY=($(compgen -W 'add list update check remove' -- "$current")) ;;
    'incidents')
        case $previous in
        --at) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        --language) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        esac
        case $current in
        -*) COMPREPLY=($(compgen -W '--all --json --demo --at --language --help' -- "$current")) ;;
        esac ;;
    'lines')
        case $previous in
        --limit) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        --at) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        --language) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        esac
        case $current in
        -*) COMPREPLY=($(compgen -W '--limit --json --demo --at --language --help' -- "$current")) ;;
        *) case ${#operands[@]} in
            *) _orvo_words feeds ;;
            esac ;;
        esac ;;
    'favorites add')
        case $previous in
        --place) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        --location) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        --at) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        --language) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        esac
        case $current in
        -*) COMPREPLY=($(compgen -W '--place --location --demo --at --language --help' -- "$current")) ;;
        *) case ${#operands[@]} in
            *) _orvo_words lines ;;
            esac ;;
        esac ;;
    'favorites list')
        case $previous in
        --at) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        --language) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        esac
        case $current in
        -*) COMPREPLY=($(compgen -W '--json --demo --at --language --help' -- "$current")) ;;
        esac ;;
    'favorites edit')
        case $previous in
        --at) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        --language) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        esac
        case $current in
        -*) COMPREPLY=($(compgen -W '--demo --at --language --help' -- "$current")) ;;
        esac ;;
    'favorites move')
        case $previous in
        --at) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        --language) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        esac
        case $current in
        -*) COMPREPLY=($(compgen -W '--demo --at --language --help' -- "$current")) ;;
        *) case ${#operands[@]} in
            0) _orvo_words favorites ;;
            1) COMPREPLY=($(compgen -W '' -- "$current")) ;;
            esac ;;
        esac ;;
    'favorites remove')
        case $previous in
        --at) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        --language) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        esac
        case $current in
        -*) COMPREPLY=($(compgen -W '--demo --at --language --help' -- "$current")) ;;
        *) case ${#operands[@]} in
            *) _orvo_words favorites ;;
            esac ;;
        esac ;;
    'feeds add')
        case $previous in
        --static) mapfile -t COMPREPLY < <(compgen -f -- "$current"); compopt -o filenames 2>/dev/null; return ;;
        --alerts) mapfile -t COMPREPLY < <(compgen -f -- "$current"); compopt -o filenames 2>/dev/null; return ;;
        --header) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        --query) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        --user) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        --at) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        --language) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        esac
        case $current in
        -*) COMPREPLY=($(compgen -W '--static --alerts --header --query --user --replace --demo --at --language --help' -- "$current")) ;;
        *) case ${#operands[@]} in
            0) COMPREPLY=($(compgen -W '' -- "$current")) ;;
            esac ;;
        esac ;;
    'feeds list')
        case $previous in
        --at) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        --language) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        esac
        case $current in
        -*) COMPREPLY=($(compgen -W '--json --demo --at --language --help' -- "$current")) ;;
        esac ;;
    'feeds update')
        case $previous in
        --at) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        --language) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        esac
        case $current in
        -*) COMPREPLY=($(compgen -W '--force --demo --at --language --help' -- "$current")) ;;
        *) case ${#operands[@]} in
            *) _orvo_words feeds ;;
            esac ;;
        esac ;;
    'feeds check')
        case $previous in
        --at) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        --language) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        esac
        case $current in
        -*) COMPREPLY=($(compgen -W '--json --demo --at --language --help' -- "$current")) ;;
        *) case ${#operands[@]} in
            *) _orvo_words feeds ;;
            esac ;;
        esac ;;
    'feeds remove')
        case $previous in
        --at) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        --language) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        esac
        case $current in
        -*) COMPREPLY=($(compgen -W '--demo --at --language --help' -- "$current")) ;;
        *) case ${#operands[@]} in
            *) _orvo_words feeds ;;
            esac ;;
        esac ;;
    'open')
        case $previous in
        --at) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        --language) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        esac
        case $current in
        -*) COMPREPLY=($(compgen -W '--demo --at --language --help' -- "$current")) ;;
        *) case ${#operands[@]} in
            *) COMPREPLY=($(compgen -W '' -- "$current")) ;;
            esac ;;
        esac ;;
    'show')
        case $previous in
        --at) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        --language) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        esac
        case $current in
        -*) COMPREPLY=($(compgen -W '--json --demo --at --language --help' -- "$current")) ;;
        esac ;;
    'receive')
        case $previous in
        --at) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        --language) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        esac
        case $current in
        -*) COMPREPLY=($(compgen -W '--demo --at --language --help' -- "$current")) ;;
        *) case ${#operands[@]} in
            0) COMPREPLY=($(compgen -W 'ContinueUserActivity' -- "$current")) ;;
            esac ;;
        esac ;;
    'service')
        case $previous in
        --idle) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        --at) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        --language) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        esac
        case $current in
        -*) COMPREPLY=($(compgen -W '--idle --demo --at --language --help' -- "$current")) ;;
        esac ;;
    'analytics')
        case $previous in
        --limit) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        --at) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        --language) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        esac
        case $current in
        -*) COMPREPLY=($(compgen -W '--limit --json --demo --at --language --help' -- "$current")) ;;
        esac ;;
    'settings')
        case $previous in
        --at) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        --language) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        esac
        case $current in
        -*) COMPREPLY=($(compgen -W '--json --demo --at --language --help' -- "$current")) ;;
        *) case ${#operands[@]} in
            0) COMPREPLY=($(compgen -W 'step-free' -- "$current")) ;;
            1) COMPREPLY=($(compgen -W 'on off' -- "$current")) ;;
            esac ;;
        esac ;;
    'defaults read')
        case $previous in
        --at) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        --language) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        esac
        case $current in
        -*) COMPREPLY=($(compgen -W '--json --demo --at --language --help' -- "$current")) ;;
        *) case ${#operands[@]} in
            0) COMPREPLY=($(compgen -W 'Orvo.TransitWidget.internal.injectFakeIncidents Orvo.TransitWidget.internal.randomNumberIncidents' -- "$current")) ;;
            esac ;;
        esac ;;
    'defaults write')
        case $previous in
        --type) COMPREPLY=($(compgen -W 'bool integer real string' -- "$current")); return ;;
        --at) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        --language) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        esac
        case $current in
        -*) COMPREPLY=($(compgen -W '--type --demo --at --language --help' -- "$current")) ;;
        *) case ${#operands[@]} in
            0) COMPREPLY=($(compgen -W 'Orvo.TransitWidget.internal.injectFakeIncidents Orvo.TransitWidget.internal.randomNumberIncidents' -- "$current")) ;;
            1) COMPREPLY=($(compgen -W '' -- "$current")) ;;
            esac ;;
        esac ;;
    'defaults delete')
        case $previous in
        --at) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        --language) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        esac
        case $current in
        -*) COMPREPLY=($(compgen -W '--demo --at --language --help' -- "$current")) ;;
        *) case ${#operands[@]} in
            0) COMPREPLY=($(compgen -W 'Orvo.TransitWidget.internal.injectFakeIncidents Orvo.TransitWidget.internal.randomNumberIncidents' -- "$current")) ;;
            esac ;;
        esac ;;
    'demo')
        case $previous in
        --at) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        --language) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        esac
        case $current in
        -*) COMPREPLY=($(compgen -W '--serve --demo --at --language --help' -- "$current")) ;;
        *) case ${#operands[@]} in
            0) COMPREPLY=($(compgen -W '' -- "$current")) ;;
            esac ;;
        esac ;;
    'completion')
        case $previous in
        --at) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        --language) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        esac
        case $current in
        -*) COMPREPLY=($(compgen -W '--demo --at --language --help' -- "$current")) ;;
        *) case ${#operands[@]} in
            0) COMPREPLY=($(compgen -W 'bash zsh fish words' -- "$current")) ;;
            1) COMPREPLY=($(compgen -W 'feeds lines favorites' -- "$current")) ;;
            esac ;;
        esac ;;
    'help')
        case $previous in
        --at) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        --language) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        esac
        case $current in
        -*) COMPREPLY=($(compgen -W '--demo --at --language --help' -- "$current")) ;;
        *) case "${operands[*]}" in
            '') COMPREPLY=($(compgen -W 'incidents lines favorites feeds open show receive service analytics settings defaults demo completion help' -- "$current")) ;;
            'defaults') COMPREPLY=($(compgen -W 'read write delete' -- "$current")) ;;
            'favorites') COMPREPLY=($(compgen -W 'add list edit move remove' -- "$current")) ;;
            'feeds') COMPREPLY=($(compgen -W 'add list update check remove' -- "$current")) ;;
            esac ;;
        esac ;;
    esac
}

complete -F _orvo orvo

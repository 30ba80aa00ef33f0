# bash completion for orvo-transit-widget, written by `orvo-transit-widget --completion bash`

_orvo_transit_widget() {
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
        --at | --completion | --dump | --language | --max-rows | --mode | --open | --pictures | --print | --scale | --snapshot | --text-size | --width) skip=1; continue ;;
        -*) continue ;;
        esac
        operands+=("$word")
    done
    case $place in
    '')
        case $previous in
        --print) COMPREPLY=($(compgen -W 'text json waybar' -- "$current")); return ;;
        --open) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        --snapshot) mapfile -t COMPREPLY < <(compgen -f -- "$current"); compopt -o filenames 2>/dev/null; return ;;
        --pictures) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        --dump) COMPREPLY=($(compgen -W 'views constraints archive' -- "$current")); return ;;
        --mode) COMPREPLY=($(compgen -W 'compact expanded' -- "$current")); return ;;
        --width) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        --scale) COMPREPLY=($(compgen -W '1 2 3' -- "$current")); return ;;
        --text-size) COMPREPLY=($(compgen -W 'XS S M L XL XXL XXXL AX1 AX2 AX3 AX4 AX5' -- "$current")); return ;;
        --max-rows) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        --completion) COMPREPLY=($(compgen -W 'bash zsh fish' -- "$current")); return ;;
        --at) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        --language) COMPREPLY=($(compgen -W '' -- "$current")); return ;;
        esac
        case $current in
        -*) COMPREPLY=($(compgen -W '--print --payloads --follow --open --snapshot --pictures --dump --mode --width --scale --text-size --dark --contrast --max-rows --completion --version --demo --at --language --help' -- "$current")) ;;
        esac ;;
    esac
}

complete -F _orvo_transit_widget orvo-transit-widget

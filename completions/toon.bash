# Completion of `toon` for bash: source it, or put it into /usr/share/bash-completion/completions/toon.

_toon() {
    local word=${COMP_WORDS[COMP_CWORD]} before=${COMP_WORDS[COMP_CWORD - 1]} words files
    COMPREPLY=()
    if [ "$COMP_CWORD" -eq 1 ]; then
        COMPREPLY=($(compgen -W "play edit show write check film trace --help" -- "$word"))
        return
    fi
    case $before in
    --size)
        COMPREPLY=($(compgen -W "640x480 1024x768 1920x1080" -- "$word"))
        return
        ;;
    --mode)
        words="saver player"
        [ "${COMP_WORDS[1]}" != trace ] || words+=" editor"
        COMPREPLY=($(compgen -W "$words" -- "$word"))
        return
        ;;
    --script)
        compopt -o default
        return
        ;;
    --seed | --still | --shows | --paces) return ;;
    esac
    files='*.zkt'
    case ${COMP_WORDS[1]} in
    play | edit | show) words="--help" ;;
    write)
        words="-o --help"
        [ "$before" = -o ] || files='*.json'
        ;;
    check) words="--json --help" ;;
    film)
        words="--size --seed --mode --walk-about --still --help"
        [ "$COMP_CWORD" -le 2 ] || files='*'
        ;;
    trace) words="--size --seed --mode --script --walk-about --shows --paces --help" ;;
    *) return ;;
    esac
    if [[ $word == -* ]]; then
        COMPREPLY=($(compgen -W "$words" -- "$word"))
    else
        compopt -o filenames 2>/dev/null
        local IFS=$'\n'
        COMPREPLY=($(compgen -d -- "$word") $(compgen -f -X "!$files" -- "$word"))
    fi
}

complete -F _toon toon

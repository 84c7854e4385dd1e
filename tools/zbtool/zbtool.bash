# Completes the commands and options of zbtool in bash; what there is comes from its own help.

_zbtool() {
    local word current=${COMP_WORDS[COMP_CWORD]} words=() others=0 help
    help=$("$1" --help 2>/dev/null)
    for word in "${COMP_WORDS[@]:1:COMP_CWORD-1}"; do
        [[ $word != -* ]] || continue
        words+=("$word")
        others=$((others + 1))
        if _zbtool_commands <<<"$help" | grep -qxF -- "$word"; then
            help=$("$1" "${words[@]}" --help 2>/dev/null)
            others=0
        fi
    done
    COMPREPLY=()
    if [[ $current == -* ]]; then
        mapfile -t COMPREPLY < <(compgen -W "$(_zbtool_options <<<"$help")" -- "$current")
    elif [ $others -gt 0 ] || ! grep -q '^Positionals:' <<<"$help"; then
        mapfile -t COMPREPLY < <(compgen -W "$(_zbtool_commands <<<"$help")" -- "$current")
    fi # otherwise a file's name belongs here, which bash completes itself
}

_zbtool_options() { sed -nE 's/^  (-h,)?(--[a-z-]+).*/\2/p'; }

_zbtool_commands() { sed -n '/^Subcommands:/,$ s/^  \([a-z][a-z]*\) .*/\1/p'; }

complete -o bashdefault -o default -F _zbtool zbtool

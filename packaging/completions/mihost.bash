# bash completion for mihost, which itself knows what may come next.

_mihost() {
    local line=${COMP_LINE:0:COMP_POINT} words what candidates
    read -ra words <<<"$line"
    [[ $line == *[[:space:]] ]] && words+=('')
    local current=${words[-1]}
    { read -r what && mapfile -t candidates; } \
        < <("$1" __complete "${words[@]:1}" 2>/dev/null)

    case $what in
    files) mapfile -t COMPREPLY < <(compgen -f -- "$current") && compopt -o filenames ;;
    folders) mapfile -t COMPREPLY < <(compgen -d -- "$current") && compopt -o filenames ;;
    *)
        # Readline replaces only what follows the last character that breaks words.
        local kept=${current%"${current##*[:=]}"}
        candidates=("${candidates[@]%%$'\t'*}")
        COMPREPLY=("${candidates[@]#"$kept"}")
        [[ ${#COMPREPLY[@]} -eq 1 && ${COMPREPLY[0]} == *[:=] ]] && compopt -o nospace
        ;;
    esac
}
complete -F _mihost mihost

# bash completion for mihost, which itself knows what may come next and quotes it.

_mihost() {
    local what
    { read -r what && mapfile -t COMPREPLY; } \
        < <("$1" __complete-bash "${COMP_LINE:0:COMP_POINT}" "$COMP_WORDBREAKS" 2>/dev/null)

    case $what in
    files) mapfile -t COMPREPLY < <(compgen -f -- "$2") && compopt -o filenames ;;
    folders) mapfile -t COMPREPLY < <(compgen -d -- "$2") && compopt -o filenames ;;
    *)
        [[ ${#COMPREPLY[@]} -eq 1 && ${COMPREPLY[0]} == *[:=] ]] && compopt -o nospace
        ;;
    esac
}
complete -F _mihost mihost

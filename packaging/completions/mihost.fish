# fish completion for mihost, which itself knows what may come next. fish quotes what it inserts.

# The word being typed without its quotes, the last of which may still be open.
function __mihost_current
    set --local typed (commandline --cut-at-cursor --current-token)
    for quote in '' "'" '"'
        string unescape -- "$typed$quote" && return
    end
end

function __mihost_complete
    set --local words (commandline --tokenize --cut-at-cursor --current-process)
    set --local current (__mihost_current)
    set --local answer ($words[1] __complete $words[2..] "$current" 2>/dev/null)
    switch "$answer[1]"
        case files
            __fish_complete_path "$current"
        case folders
            __fish_complete_directories "$current"
        case '*'
            printf '%s\n' $answer[2..]
    end
end

complete --command mihost --no-files --arguments '(__mihost_complete)'

# Completion of nidus for fish. To have it in every session:
#   nidus completion fish > ~/.config/fish/completions/nidus.fish

function __nidus_complete
    set -l words (commandline -opc)
    set -l current (commandline -cto)
    test (count $current) -gt 0; or set current ''
    for line in ($words[1] complete -- $words[2..] $current[-1] 2>/dev/null)
        if test -n "$line"
            echo $line
        else
            __fish_complete_path (commandline -ct)
        end
    end
end

complete -c nidus -f -a '(__nidus_complete)'

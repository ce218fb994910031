# Completes what is typed behind koractl: the program itself says what fits.
function __koractl_candidates
    set -l words (commandline -opc)
    set -l program $words[1]
    set -e words[1]
    for line in ($program --complete $words (commandline -ct) 2>/dev/null)
        switch $line
            case \tfiles
                __fish_complete_path (commandline -ct)
            case \tfolders
                __fish_complete_directories (commandline -ct)
            case '*'
                printf '%s\n' $line
        end
    end
end
complete -c koractl -f -a '(__koractl_candidates)'

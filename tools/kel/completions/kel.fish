# Completion of kel for fish: `kel __complete` knows what may stand where.

# What a word of the command line names. Nothing in the word is run.
function __kel_plain
    set -l parts (string match -r '^([^$]*)\$\{?(\w+)\}?([^$]*)$' -- $argv[1])
    if set -q parts[3]; and set -q $parts[3]
        set -l name $parts[3]
        echo -- "$parts[2]$$name$parts[4]"
    else
        string replace -r '^~/' "$HOME/" -- $argv[1]
    end
end

function __kel
    set -l words
    for word in (commandline -opc) (commandline -ct | string unescape)
        set -a words (__kel_plain $word)
    end
    set -l lines (command $words[1] __complete $words[2..-1] 2>/dev/null </dev/null)
    if set -l lead (string match -r '^:directory\t(.*)$' -- "$lines")[2]
        string replace -r '^' -- $lead (__fish_complete_directories (string sub -s (math 1 + (string length -- $lead)) -- $words[-1]) '')
    else
        printf '%s\n' $lines
    end
end

complete -c kel -f -a '(__kel)'

# Completion of kel for fish.

# Sets __kel_verb, the number of arguments behind it in __kel_count, and __kel_libraries.
function __kel_read
    set -g __kel_verb ''
    set -g __kel_count 0
    set -g __kel_libraries
    set -l option ''
    set -l words (commandline -opc)
    for word in $words[2..-1]
        switch "$option,$word"
            case '-L,*' '--library,*'
                set -a __kel_libraries -L (__kel_plain $word)
                set option ''
            case '-*,*'
                set option ''
            case ,-L ,--library ,--section ,--for ,--format ,--relative-to ,--set ,--color ,-W
                set option $word
            case ',-L*'
                set -a __kel_libraries -L (__kel_plain (string sub -s 3 -- $word))
            case ',--library=*'
                set -a __kel_libraries -L (__kel_plain (string sub -s 11 -- $word))
            case ',-*'
            case '*'
                if test -z "$__kel_verb"
                    set __kel_verb $word
                else
                    set __kel_count (math $__kel_count + 1)
                end
        end
    end
end

# What a word of the command line names. Nothing in the word is run.
function __kel_plain
    set -l variable (string match -r '^\$(\w+)(/.*)?$' -- $argv[1])
    if set -q variable[2]; and set -q $variable[2]
        set -l name $variable[2]
        echo -- "$$name$variable[3]"
    else
        string replace -r '^~/' "$HOME/" -- $argv[1]
    end
end

function __kel_in
    __kel_read
    contains -- "$__kel_verb" $argv
end

function __kel_wants_verb
    __kel_in '' help; and test $__kel_count -eq 0
end

function __kel_wants_key
    __kel_in which check; and return 0
    contains -- "$__kel_verb" list show sources netlists; and test $__kel_count -eq 0
end

# Keys and bare names. They are asked from kel, and remembered for some seconds.
function __kel_keys
    __kel_read
    set -q __kel_libraries[1]; or return
    set -l command (__kel_plain (commandline -opc)[1])
    set -l call $PWD $command $__kel_libraries
    if test "$call" != "$__kel_call"; or test (date +%s) -gt "$__kel_until"
        set -g __kel_words (command $command $__kel_libraries --quiet list --all 2>/dev/null \
            </dev/null | string replace -r '\t.*' '')
        set -a __kel_words (string replace -r '_[vV]\d+_\d\d_.$' '' -- $__kel_words | uniq)
        set -g __kel_call "$call"
        set -g __kel_until (math (date +%s) + 10)
    end
    printf '%s\n' $__kel_words
end

# The codes of diagnostics.
function __kel_codes
    set -l command (__kel_plain (commandline -opc)[1])
    command $command help diagnostics 2>/dev/null | string match -r '^[a-z-]+(?= \()'
end

complete -c kel -f
complete -c kel -s L -l library -x -a '(__fish_complete_directories)' -d 'A repository'
complete -c kel -l json -d 'Write a JSON document'
complete -c kel -l trace -d 'Tell what is read'
complete -c kel -l quiet -d 'Say nothing on standard error'
complete -c kel -l color -x -a 'auto always never' -d 'Whether messages are coloured'
complete -c kel -s h -l help -d 'Show help'
complete -c kel -n '__kel_in ""' -l version -d 'Show the version'

complete -c kel -n __kel_wants_verb -a list -d 'List cores'
complete -c kel -n __kel_wants_verb -a which -d 'Tell where cores are'
complete -c kel -n __kel_wants_verb -a show -d 'Show all about a core'
complete -c kel -n __kel_wants_verb -a sources -d 'List HDL sources'
complete -c kel -n __kel_wants_verb -a netlists -d 'List netlists'
complete -c kel -n __kel_wants_verb -a check -d 'List what is wrong'
complete -c kel -n __kel_wants_verb -a help -d 'Show help'
complete -c kel -n __kel_wants_key -a '(__kel_keys)'

complete -c kel -n '__kel_in list' -l all -d 'List every version'
complete -c kel -n '__kel_in show' -l section -x -d 'Show this section' \
    -a 'place options parameters ports interfaces'
complete -c kel -n '__kel_in sources' -l for -x -a 'synthesis simulation' \
    -d 'What the sources are analysed for'
complete -c kel -n '__kel_in sources' -l format -x -a 'list json f ghdl edam vhdl_ls tcl' \
    -d 'How they are written'
complete -c kel -n '__kel_in sources' -l relative-to -x -a '(__fish_complete_directories)' \
    -d 'Write paths relative to this directory'
complete -c kel -n '__kel_in check' -l format -x -a 'text json sarif' -d 'How findings are written'
complete -c kel -n '__kel_in check' -l excerpts -d 'Show lines, help and related places'
complete -c kel -n '__kel_in check' -s W -x -a '(echo error; printf "no-%s\n" (__kel_codes))' \
    -d 'What counts as an error, or is left out'
complete -c kel -n '__kel_in check' -l relative-to -x -a '(__fish_complete_directories)' \
    -d 'Write paths relative to this directory'
complete -c kel -n '__kel_in help; and __kel_wants_verb' -a 'diagnostics (__kel_codes)'
complete -c kel -n '__kel_in netlists' -l set -x -d 'Set a parameter first'
complete -c kel -n '__kel_in netlists' -l table -d 'List the netlists for all values'

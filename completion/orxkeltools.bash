# Bash completion for orxkeltools, its command links and kelcache.
#
#   orxkeltools [-c|--cache FILE] COMMAND [ARGUMENTS]
#   COMMAND [ARGUMENTS]                 (a link named after the command)
#   kelcache build SNAPSHOT.json -o FILE | dump FILE | verify FILE | info FILE | --tool-build-date | ...
#
# Several command names are also names of Linux tools (ps, lspci, pkill, ...).
# The function is registered for them too, but completes them only when the
# word being run leads to orxkeltools; for any other program of that name it
# gives the name back to the system's own completion.

_orxkeltools_commands="lspci ps hwclock halvex irqinfo bootOption amldump pci-info
pidof userspaceof vdu lsof vdf pkill pgrep uptime"

_orxkeltools_signals="-HUP -INT -QUIT -ILL -TRAP -ABRT -IOT -BUS -EMT -FPE -KILL
-USR1 -SEGV -USR2 -PIPE -ALRM -TERM -STKFLT -CLD -CHLD -CONT -STOP -TSTP -TTIN
-TTOU -URG -XCPU -XFSZ -VTALRM -PROF -WINCH -POLL -IO -PWR -INFO -SYS"

# The options each command accepts.
_orxkeltools_options() {
    case $1 in
    lspci) echo "-p -n -d -e -v -h --pciinfo --nolookup --dump --extdump --verbose --help" ;;
    ps) echo "-C -P -T -c -g -i -j -n -N -s -t -u -U -v -Z -z -J -h --tree --help" ;;
    hwclock) echo "-t -d --time --date --help" ;;
    halvex) echo "-v -l -h --version --level --help" ;;
    bootOption)
        echo "-r -a -f -i -R -p -k -m -o -b -c -C -h --raw --all --fsck --audit" \
            "--rollback --pxeboot --kernel --modules --options --bootOptionFiles" \
            "--bootOptionContent --bootOptionFileContent --bootOptionFilesContent --help" ;;
    pci-info) echo "-n -b -s -f -i -c -e -S -h" ;;
    pidof) echo "-s -x -o" ;;
    vdu) echo "-a -d -s -h -i -u" ;;
    vdf) echo "-h -p" ;;
    pkill) echo "-f -h" ;;
    pgrep) echo "-f -l -v -h" ;;
    esac
    # irqinfo, amldump, userspaceof, lsof and uptime take no options.
}

# Sets COMPREPLY to the folders and the files ending in $2 whose names start
# with $1; to all files starting with $1 when there is none.
_orxkeltools_files() {
    local cur=$1 suffix=$2
    mapfile -t COMPREPLY < <(compgen -f -X "!*$suffix" -- "$cur"; compgen -d -- "$cur")
    [[ ${#COMPREPLY[@]} -eq 0 ]] && mapfile -t COMPREPLY < <(compgen -f -- "$cur")
    compopt -o filenames 2>/dev/null
    return 0
}

# Completes the word at index $3 of COMP_WORDS for command $1, whose own
# name stands at index $2.
_orxkeltools_command_args() {
    local command=$1 first=$2 index=$3
    local cur=${COMP_WORDS[index]} prev=${COMP_WORDS[index - 1]}

    # Option arguments.
    case $command:$prev in
    hwclock:-t | hwclock:--time | hwclock:-d | hwclock:--date | pci-info:-[nbsf] | vdu:-d | \
        bootOption:-c | bootOption:--bootOptionContent | bootOption:--bootOptionFileContent)
        return 0 ;;
    pidof:-o)
        mapfile -t COMPREPLY < <(compgen -W "%PPID" -- "$cur")
        return 0 ;;
    esac

    if [[ $command == pkill && $index -eq $((first + 1)) && $cur == -* ]]; then
        mapfile -t COMPREPLY < <(compgen -W "$_orxkeltools_signals $(_orxkeltools_options pkill)" -- "$cur")
        return 0
    fi
    if [[ $cur == -* ]]; then
        mapfile -t COMPREPLY < <(compgen -W "$(_orxkeltools_options "$command")" -- "$cur")
        return 0
    fi
    # vdu walks a path; the other commands take names, numbers or patterns.
    if [[ $command == vdu ]]; then
        mapfile -t COMPREPLY < <(compgen -f -- "$cur")
        compopt -o filenames 2>/dev/null
    fi
    return 0
}

# True when the program word $1 (a name looked up on PATH, or a path) leads
# to orxkeltools, through links or not.
_orxkeltools_is_ours() {
    local path=$1
    [[ $path == */* ]] || path=$(type -P -- "$path") || return 1
    path=$(readlink -f -- "$path" 2>/dev/null) || return 1
    [[ ${path##*/} == orxkeltools* ]]
}

_orxkeltools() {
    local word0=${COMP_WORDS[0]} cword=$COMP_CWORD
    local cur=${COMP_WORDS[cword]}
    local name=${word0##*/}
    COMPREPLY=()

    if [[ $name != orxkeltools* ]]; then
        # A command link: every argument belongs to the command.
        if ! _orxkeltools_is_ours "$word0"; then
            # Another program of that name: hand it back to the system's
            # completion (bash starts over with what the loader sets up), or
            # to readline's file names when there is no loader.
            complete -r -- "$name" 2>/dev/null
            if declare -F _completion_loader >/dev/null; then
                _completion_loader "$name"
                return $?
            fi
            compopt -o default 2>/dev/null
            return 0
        fi
        _orxkeltools_command_args "$name" 0 "$cword"
        return
    fi

    # The own name: an optional -c FILE or --cache FILE, then the command word.
    local first=1
    if [[ ${COMP_WORDS[1]} == -c || ${COMP_WORDS[1]} == --cache ]] && ((cword > 1)); then
        if ((cword == 2)); then
            _orxkeltools_files "$cur" .cache
            return
        fi
        first=3
    fi
    if ((cword == first)); then
        local words=$_orxkeltools_commands
        ((first == 1)) && words="-c --cache $words"
        mapfile -t COMPREPLY < <(compgen -W "$words" -- "$cur")
        return 0
    fi
    if ((cword > first)); then
        _orxkeltools_command_args "${COMP_WORDS[first]}" "$first" "$cword"
    fi
    return 0
}

_kelcache() {
    local cword=$COMP_CWORD
    local cur=${COMP_WORDS[cword]} prev=${COMP_WORDS[cword - 1]}
    COMPREPLY=()

    if ((cword == 1)); then
        mapfile -t COMPREPLY < <(compgen -W "build dump capture verify info --version --tool-build-date --tool-signature --help" -- "$cur")
        return 0
    fi
    case ${COMP_WORDS[1]} in
    build)
        if [[ $prev == -o ]]; then
            _orxkeltools_files "$cur" .cache
        elif [[ $cur == -* ]]; then
            mapfile -t COMPREPLY < <(compgen -W "-o" -- "$cur")
        else
            _orxkeltools_files "$cur" .json
        fi ;;
    capture)
        if [[ $prev == -o ]]; then
            _orxkeltools_files "$cur" .cache
        else
            mapfile -t COMPREPLY < <(compgen -W "-o --json" -- "$cur")
        fi ;;
    dump | verify | info)
        ((cword == 2)) && _orxkeltools_files "$cur" .cache ;;
    esac
    return 0
}

complete -F _orxkeltools orxkeltools lspci ps hwclock halvex irqinfo bootOption amldump \
    pci-info pidof userspaceof vdu lsof vdf pkill pgrep uptime
complete -F _kelcache kelcache

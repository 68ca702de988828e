#!/bin/bash
# Checks the manual pages and the bash completion script.
#
#   tests/man/check.sh [SOURCE_DIR]
#
# Every page under docs/man must format without a single groff warning, both
# as groff's default output and for a terminal, as man shows it.  The
# orxkeltools page and the completion script must know every command of the
# tool and every option in the commands' option strings.  The completion
# script must parse, and a few completions are tried in a bash subshell
# against a folder of made-up files.  Exits 0 when all pass, 1 on a failure,
# 77 when groff is missing (the page formatting is not checked; the rest
# still runs).
set -u

src=$(cd "${1:-$(dirname "$0")/../..}" && pwd)
failures=0
skipped=0

fail() {
    echo "FAIL: $*"
    failures=$((failures + 1))
}

# --- Pages ----------------------------------------------------------------

pages=("$src"/docs/man/*.[1-8])
if [[ ! -e ${pages[0]} ]]; then
    fail "no pages under $src/docs/man"
elif ! command -v groff >/dev/null; then
    echo "SKIP: groff is not installed (Debian package groff-base); pages not checked"
    skipped=1
else
    for page in "${pages[@]}"; do
        for device in ps utf8; do
            warnings=$(groff -ww -z -man -T"$device" "$page" 2>&1)
            if [[ $? -ne 0 || -n $warnings ]]; then
                fail "$(basename "$page") (-T$device): ${warnings:-groff failed}"
            fi
        done
    done
fi

# --- Commands and options ----------------------------------------------------
# The page and the completion must know every command of the tool's command
# table, in its order, and every option of each command's option strings.

script=$src/completion/orxkeltools.bash
page=$src/docs/man/orxkeltools.1
table=$(sed -n '/kCommands\[\] = {/,/^};/p' "$src/apps/orxkeltools/keltools.cpp" |
    grep -o '{"[^"]*"' | tr -d '{"' | tr '\n' ' ')
sections=$(grep '^\.SS' "$page" | sed 's/^\.SS //; s/\\%//g; s/\\-/-/g' |
    grep -xF -f <(tr ' ' '\n' <<<"$table" | grep .) | tr '\n' ' ')
[[ -n $table && $sections == "$table" ]] ||
    fail "orxkeltools.1 sections [$sections] differ from the command table [$table]"
listed=$(bash -c 'source "$1"; echo $_orxkeltools_commands' _ "$script")
[[ "$listed " == "$table" ]] ||
    fail "completion commands [$listed] differ from the command table [$table]"

# The section of one command in the page, escapes removed.
page_section() {
    sed 's/\\%//g; s/\\-/-/g' "$page" | awk -v cmd="$1" '
        /^\.S[SH] / { on = ($0 == ".SS " cmd) ; next }
        on'
}

sources=(lspci:pci/lspci.cpp ps:worlds/ps.cpp hwclock:sysinfo/hwclock.cpp
    halvex:sysinfo/halvex.cpp bootOption:sysinfo/bootoption.cpp pci-info:pci/pciinfo.cpp
    pidof:worlds/pidof.cpp vdu:corafsstats/vdu.cpp vdf:corafsstats/vdf.cpp
    pkill:worlds/pkill.cpp pgrep:worlds/pgrep.cpp)
for entry in "${sources[@]}"; do
    command=${entry%%:*}
    file=$src/apps/orxkeltools/${entry#*:}
    letters=$(grep -o 'k\(Short\)\?Options\[\] = "[^"]*"' "$file" | sed 's/.*"\(.*\)"/\1/; s/://g')
    longs=$(grep -o '{"[A-Za-z]*", [a-z_]*argument' "$file" | sed 's/{"\([A-Za-z]*\)".*/\1/')
    [[ -n $letters ]] || fail "$command: no option string found in $file"
    offered=" $(bash -c 'source "$1"; _orxkeltools_options "$2"' _ "$script" "$command") "
    text=$(page_section "$command")
    for ((i = 0; i < ${#letters}; i++)); do
        option=-${letters:i:1}
        grep -qE -- "(^|[^[:alnum:]-])$option([^[:alpha:]-]|\$)" <<<"$text" ||
            fail "$command: $option is not in orxkeltools.1"
        # bootOption's -u and -w only print the help: not worth offering.
        [[ $command$option == bootOption-[uw] || $offered == *" $option "* ]] ||
            fail "$command: $option is not completed"
    done
    for name in $longs; do
        [[ $text == *"--$name"* ]] || fail "$command: --$name is not in orxkeltools.1"
        [[ $offered == *" --$name "* ]] || fail "$command: --$name is not completed"
    done
done

# --- Completion ---------------------------------------------------------------

if ! bash -n "$script"; then
    fail "completion script does not parse"
else
    tmp=$(mktemp -d)
    trap 'rm -rf "$tmp"' EXIT
    mkdir -p "$tmp/work/caches" "$tmp/bin" "$tmp/other"
    touch "$tmp/work/host.cache" "$tmp/work/old host.cache" "$tmp/work/hosts.json" "$tmp/work/notes.txt"
    # A stand-in for the tool, a link to it named after a command, and an
    # unrelated program of the same name as another command.
    printf '#!/bin/sh\n' > "$tmp/bin/orxkeltools"
    chmod +x "$tmp/bin/orxkeltools"
    ln -s orxkeltools "$tmp/bin/pkill"
    printf '#!/bin/sh\n' > "$tmp/other/pgrep"
    chmod +x "$tmp/other/pgrep"

    # complete WORD... : the completions offered for the last word, one a
    # line, in byte order; then, when it is not 0, a blank line and the
    # status of the completion function; then a blank line and "released"
    # when the program no longer has a completion registered.
    complete_words() {
        (
            cd "$tmp/work" || exit 1
            PATH=$tmp/bin:$tmp/other:$PATH
            # shellcheck source=/dev/null
            source "$script"
            COMP_WORDS=("$@")
            COMP_CWORD=$(($# - 1))
            COMP_LINE="$*"
            COMP_POINT=${#COMP_LINE}
            if [[ ${1##*/} == kelcache ]]; then
                _kelcache
            else
                _orxkeltools
            fi
            status=$?
            if ((${#COMPREPLY[@]} > 0)); then printf '%s\n' "${COMPREPLY[@]}" | LC_ALL=C sort; fi
            if ((status != 0)); then printf '\nstatus %s\n' "$status"; fi
            complete -p -- "${1##*/}" >/dev/null 2>&1 || printf '\nreleased\n'
        ) 2>&1
    }

    # expect WANT WORD... : the completions must be exactly WANT (one a line).
    expect() {
        local want=$1
        shift
        local got
        got=$(complete_words "$@")
        if [[ $got != "$want" ]]; then
            fail "completing '$*': got [${got//$'\n'/ }], want [${want//$'\n'/ }]"
        fi
    }

    nl=$'\n'
    expect "--cache$nl-c" orxkeltools -
    expect "pci-info${nl}pgrep${nl}pidof${nl}pkill${nl}ps" orxkeltools p
    expect "caches${nl}host.cache${nl}old host.cache" orxkeltools -c ""
    expect "caches${nl}host.cache${nl}old host.cache" orxkeltools --cache ""
    expect "notes.txt" orxkeltools -c no
    expect "bootOption" orxkeltools -c host.cache boo
    expect "--tree" orxkeltools -c host.cache ps --t
    expect "-J" orxkeltools ps -J
    expect "--bootOptionContent${nl}--bootOptionFileContent${nl}--bootOptionFiles${nl}--bootOptionFilesContent" \
        orxkeltools bootOption --bootO
    expect "%PPID" orxkeltools pidof -o ""
    expect "" orxkeltools pci-info -b ""
    expect "-HUP" orxkeltools pkill -HU
    expect "" orxkeltools pkill -f -HU
    expect "caches${nl}host.cache${nl}hosts.json${nl}notes.txt${nl}old host.cache" orxkeltools vdu ""
    expect "" orxkeltools pgrep ""
    # Through a link the words are the command's: -c is pkill's own business.
    expect "-KILL" pkill -KI
    expect "-f" "$tmp/bin/pkill" -f
    # Another program named after a command gets its own completion back.
    expect "${nl}released" pgrep -
    expect "build" kelcache bu
    expect "caches${nl}hosts.json" kelcache build ""
    expect "-o" kelcache build hosts.json -
    expect "caches${nl}host.cache${nl}old host.cache" kelcache build hosts.json -o ""
    expect "old host.cache" kelcache dump o
    expect "" kelcache dump host.cache ""
fi

if ((failures > 0)); then
    echo "$failures check(s) failed"
    exit 1
fi
if ((skipped)); then exit 77; fi
echo "man pages and completion: all checks passed"
exit 0

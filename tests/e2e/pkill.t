pkill: signals real processes only in live mode (the simulator).  Most
cases run in the signal recording mode: ORXKEL_SIGNAL_RECORD names a file to
which each signal call appends "pid signal" instead of signalling, so the
cartel IDs are made up (above 2^22, the largest process ID Linux hands out,
so that even a signal sent by mistake reaches no process) and "nothing
signalled" means the file does not exist.
The cases that need the kernel's answer (delivery, ESRCH, EINVAL) signal
shells the case starts; a shell's cartel ID is its process ID, and each
shell writes the names of the signals it catches to NAME.sig.

=== snapshot recorded
{"buildDate": "Nov 30 2026", "simulator": {"signalAnyProcess": true},
 "tree": {"userworld": {"cartel": {
   "2147480001": {"cmdline": "/usr/sbin/crond -f"},
   "2147483000": {"cmdline": {"$status": "0xbad0062"}},
   "2147480002": {"cmdline": "sshd -D"}
 }}}}
=== snapshot bad-cmdline
{"buildDate": "Nov 30 2026", "simulator": {"signalAnyProcess": true},
 "tree": {"userworld": {"cartel": {
   "2147480001": {"cmdline": "/usr/sbin/crond -f"},
   "2147483000": {"cmdline": {"$status": "0xbad0003"}},
   "2147480002": {"cmdline": "crond"}
 }}}}
=== snapshot self
{"buildDate": "Nov 30 2026", "simulator": {"signalAnyProcess": true},
 "tree": {"userworld": {"cartel": {
   "$int:@SELF": {"cmdline": "crond"},
   "2147480001": {"cmdline": "crond"}
 }}}}
=== snapshot wide-key
{"buildDate": "Nov 30 2026", "simulator": {"signalAnyProcess": true},
 "tree": {"userworld": {"cartel": {
   "2147480001": {"cmdline": "crond"},
   "4294967297": {"cmdline": "crond"}
 }}}}
=== snapshot no-single-process
{"buildDate": "Nov 30 2026", "simulator": {"signalAnyProcess": true},
 "tree": {"userworld": {"cartel": {
   "0": {"cmdline": "crond"},
   "4294967295": {"cmdline": "crond"},
   "2147483648": {"cmdline": "crond"},
   "-5": {"cmdline": "crond"},
   "2147480001": {"cmdline": "crond"}
 }}}}
=== snapshot unlisted
{"buildDate": "Nov 30 2026", "simulator": {"signalAnyProcess": true},
 "tree": {"userworld": {"cartel": {"$listStatus": "0xbad0003"}}}}
=== snapshot two
{"buildDate": "Nov 30 2026", "simulator": {"signalAnyProcess": true},
 "tree": {"userworld": {"cartel": {
   "$int:@PID:a": {"cmdline": "/usr/sbin/crond -f"},
   "$int:@PID:b": {"cmdline": "sshd -D"}
 }}}}
=== snapshot ended
{"buildDate": "Nov 30 2026", "simulator": {"signalAnyProcess": true},
 "tree": {"userworld": {"cartel": {
   "$int:@DEAD": {"cmdline": "crond"},
   "$int:@PID:a": {"cmdline": "/usr/sbin/crond -f"}
 }}}}
=== case by name: TERM to the matching cartel only
snapshot: two
mode: sim
spawn: a for s in HUP INT USR1 USR2 TERM WINCH; do trap "echo $s >> a.sig" $s; done; touch a.ready; while :; do sleep 1 & wait $!; done
spawn: b for s in HUP INT USR1 USR2 TERM WINCH; do trap "echo $s >> b.sig" $s; done; touch b.ready; while :; do sleep 1 & wait $!; done
run: pkill crond
check: timeout 3 sh -c 'until grep -qsx TERM a.sig; do sleep 0.05; done' && test "$(cat a.sig)" = TERM
check: sleep 0.3; ! test -e b.sig
exit: 0
=== case -NAME names the signal
snapshot: recorded
mode: sim
env: ORXKEL_SIGNAL_RECORD=@TMP/signals
run: pkill -USR1 crond
check: test "$(cat signals)" = "2147480001 10"
exit: 0
=== case -KILL sends 9
snapshot: recorded
mode: sim
env: ORXKEL_SIGNAL_RECORD=@TMP/signals
run: pkill -KILL crond
check: test "$(cat signals)" = "2147480001 9"
exit: 0
=== case -kill is no signal: getopt reports its letters and TERM is sent
snapshot: recorded
mode: sim
env: ORXKEL_SIGNAL_RECORD=@TMP/signals
run: pkill -kill crond
check: test "$(cat signals)" = "2147480001 15"
exit: 0
--- stderr
pkill: invalid option -- 'k'
pkill: invalid option -- 'i'
pkill: invalid option -- 'l'
pkill: invalid option -- 'l'
=== case -0 is no signal: reported as an option, TERM is sent
snapshot: recorded
mode: sim
env: ORXKEL_SIGNAL_RECORD=@TMP/signals
run: pkill -0 crond
check: test "$(cat signals)" = "2147480001 15"
exit: 0
--- stderr
pkill: invalid option -- '0'
=== case an unknown option is passed over; only the first argument names a signal
snapshot: recorded
mode: sim
env: ORXKEL_SIGNAL_RECORD=@TMP/signals
run: pkill -z -INT crond
check: test "$(cat signals)" = "2147480001 15"
exit: 0
--- stderr
pkill: invalid option -- 'z'
pkill: invalid option -- 'I'
pkill: invalid option -- 'N'
pkill: invalid option -- 'T'
=== case without -f only the first word is searched
snapshot: recorded
mode: sim
env: ORXKEL_SIGNAL_RECORD=@TMP/signals
run: pkill 'crond -f'
check: ! test -e signals
exit: 0
=== case -f searches the whole command line
snapshot: recorded
mode: sim
env: ORXKEL_SIGNAL_RECORD=@TMP/signals
run: pkill -HUP -f 'crond -f$'
check: test "$(cat signals)" = "2147480001 1"
exit: 0
=== case several patterns, each over its own walk
snapshot: recorded
mode: sim
env: ORXKEL_SIGNAL_RECORD=@TMP/signals
run: pkill -WINCH '^/usr' '^ssh'
check: test "$(cat signals)" = "$(printf '2147480001 28\n2147480002 28')"
exit: 0
=== case a command line that reads 0xbad0062 is passed over
snapshot: recorded
mode: sim
env: ORXKEL_SIGNAL_RECORD=@TMP/signals
run: pkill sshd
check: test "$(cat signals)" = "2147480002 15"
exit: 0
=== case a cartel that has ended (ESRCH) is passed over
snapshot: ended
mode: sim
spawn: a for s in HUP INT USR1 USR2 TERM WINCH; do trap "echo $s >> a.sig" $s; done; touch a.ready; while :; do sleep 1 & wait $!; done
value: DEAD sh -c 'echo $$'
run: pkill crond
check: timeout 3 sh -c 'until grep -qsx TERM a.sig; do sleep 0.05; done' && test "$(cat a.sig)" = TERM
exit: 0
=== case a refused signal: two lines, status 1, no later cartel or pattern
snapshot: two
mode: sim
spawn: a for s in HUP INT USR1 USR2 TERM WINCH; do trap "echo $s >> a.sig" $s; done; touch a.ready; while :; do sleep 1 & wait $!; done
spawn: b for s in HUP INT USR1 USR2 TERM WINCH; do trap "echo $s >> b.sig" $s; done; touch b.ready; while :; do sleep 1 & wait $!; done
run: pkill -99 . sshd
check: sleep 0.3; ! test -e a.sig
check: sleep 0.3; ! test -e b.sig
exit: 1
--- stderr
pkill: failed to kill /usr/sbin/crond (@PID:a): Invalid argument
pkill: Failure
=== case a signal number beyond 32 bits is refused, not cut to 9
snapshot: two
mode: sim
spawn: a for s in HUP INT USR1 USR2 TERM WINCH; do trap "echo $s >> a.sig" $s; done; touch a.ready; while :; do sleep 1 & wait $!; done
spawn: b for s in HUP INT USR1 USR2 TERM WINCH; do trap "echo $s >> b.sig" $s; done; touch b.ready; while :; do sleep 1 & wait $!; done
run: pkill -4294967305 crond
check: kill -0 @PID:a && ! grep -qs '^State:.Z' /proc/@PID:a/status
exit: 1
--- stderr
pkill: failed to kill /usr/sbin/crond (@PID:a): Invalid argument
pkill: Failure
=== case pkill never signals itself
snapshot: self
mode: sim
env: ORXKEL_SIGNAL_RECORD=@TMP/signals
run: pkill -KILL crond
check: test "$(cat signals)" = "2147480001 9"
exit: 0
=== case a cartel key beyond 32 bits is refused, never cut to process 1
snapshot: wide-key
mode: sim
env: ORXKEL_SIGNAL_RECORD=@TMP/signals
exe: /usr/bin/unshare
argv: unshare --user --map-root-user --fork --pid sh -c 'trap "echo TERM >> init.sig" TERM; @BIN/orxkeltools pkill crond; s=$?; exit $s'
check: test "$(cat signals)" = "2147480001 15"
check: ! test -e init.sig
exit: 1
--- stderr
pkill: Bad parameter
=== case IDs below 1 name no single process and are never signalled
snapshot: no-single-process
mode: sim
env: ORXKEL_SIGNAL_RECORD=@TMP/signals
run: pkill -HUP crond
check: test "$(cat signals)" = "2147480001 1"
exit: 0
=== case another command-line failure stops the walk
snapshot: bad-cmdline
mode: sim
env: ORXKEL_SIGNAL_RECORD=@TMP/signals
run: pkill crond
check: test "$(cat signals)" = "2147480001 15"
exit: 1
--- stderr
pkill: Not found
=== case the cartel list cannot be read
snapshot: unlisted
mode: sim
run: pkill crond
exit: 1
--- stderr
pkill: Not found
=== case a pattern that does not compile
snapshot: recorded
mode: sim
env: ORXKEL_SIGNAL_RECORD=@TMP/signals
run: pkill 'a(b'
check: ! test -e signals
exit: 1
--- stderr (escaped)
pkill: Unmatched ( or \\(
=== case no arguments
snapshot: unlisted
mode: sim
run: pkill
exit: 1
--- stdout
Usage: pkill [-SIGNAL] [PATTERN]
--- stderr
pkill: No matching criteria specified
=== case a signal alone does nothing
snapshot: recorded
mode: sim
env: ORXKEL_SIGNAL_RECORD=@TMP/signals
run: pkill -HUP
check: ! test -e signals
exit: 0
=== case -h: usage on standard output
snapshot: unlisted
mode: sim
run: pkill -h crond
exit: 0
--- stdout
Usage: pkill [-SIGNAL] [PATTERN]
=== case cache mode is refused before anything else
snapshot: recorded
env: ORXKEL_SIGNAL_RECORD=@TMP/signals
run: pkill crond
check: ! test -e signals
exit: 1
--- stderr
Using KEL cache is unsupported
=== snapshot guarded
{"buildDate": "Nov 30 2026",
 "tree": {"userworld": {"cartel": {
   "$int:@PID:a": {"cmdline": "sleep 1000"},
   "$int:@PID:b": {"cmdline": "sleep 1001 --invented"},
   "2147480001": {"cmdline": "sleep 1002"}
 }}}}
=== case without signalAnyProcess the simulator signals only a process whose command line here is the cartel's
snapshot: guarded
mode: sim
env: ORXKEL_SIGNAL_RECORD=@TMP/signals
spawn: a touch a.ready; exec sleep 1000
spawn: b touch b.ready; exec sleep 1001
run: pkill -f sleep
check: test "$(cat signals)" = "@PID:a 15"
exit: 0
=== case without signalAnyProcess a real signal reaches the matching process, and only it
snapshot: guarded
mode: sim
spawn: a touch a.ready; exec sleep 1000
spawn: b touch b.ready; exec sleep 1001
run: pkill -f sleep
check: timeout 3 sh -c 'until ! test -e /proc/@PID:a || grep -q ") Z" /proc/@PID:a/stat; do sleep 0.05; done'
check: grep -q ") S" /proc/@PID:b/stat
exit: 0

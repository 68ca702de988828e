pkill: signals real processes, so these cases run in live mode (the
simulator) against shells the case starts; a shell's cartel ID is its process
ID.  Each shell writes the names of the signals it catches to NAME.sig.

=== snapshot two
{"buildDate": "Nov 30 2026",
 "tree": {"userworld": {"cartel": {
   "$int:@PID:a": {"cmdline": "/usr/sbin/crond -f"},
   "$int:@PID:b": {"cmdline": "sshd -D"}
 }}}}
=== snapshot one
{"buildDate": "Nov 30 2026",
 "tree": {"userworld": {"cartel": {"$int:@PID:a": {"cmdline": "/usr/sbin/crond -f"}}}}}
=== snapshot ended
{"buildDate": "Nov 30 2026",
 "tree": {"userworld": {"cartel": {
   "$int:@DEAD": {"cmdline": "crond"},
   "$int:@PID:a": {"cmdline": "/usr/sbin/crond -f"}
 }}}}
=== snapshot gone-cmdline
{"buildDate": "Nov 30 2026",
 "tree": {"userworld": {"cartel": {
   "2147483000": {"cmdline": {"$status": "0xbad0062"}},
   "$int:@PID:a": {"cmdline": "/usr/sbin/crond -f"}
 }}}}
=== snapshot bad-cmdline
{"buildDate": "Nov 30 2026",
 "tree": {"userworld": {"cartel": {
   "$int:@PID:a": {"cmdline": "/usr/sbin/crond -f"},
   "2147483000": {"cmdline": {"$status": "0xbad0003"}},
   "$int:@PID:b": {"cmdline": "crond"}
 }}}}
=== snapshot self
{"buildDate": "Nov 30 2026",
 "tree": {"userworld": {"cartel": {
   "$int:@SELF": {"cmdline": "crond"},
   "$int:@PID:a": {"cmdline": "crond"}
 }}}}
=== snapshot unlisted
{"buildDate": "Nov 30 2026",
 "tree": {"userworld": {"cartel": {"$listStatus": "0xbad0003"}}}}
=== snapshot wide-key
{"buildDate": "Nov 30 2026",
 "tree": {"userworld": {"cartel": {
   "1001": {"cmdline": "crond"},
   "4294967297": {"cmdline": "crond"}
 }}}}
=== snapshot no-single-process
{"buildDate": "Nov 30 2026",
 "tree": {"userworld": {"cartel": {
   "0": {"cmdline": "crond"},
   "4294967295": {"cmdline": "crond"},
   "2147483648": {"cmdline": "crond"},
   "-5": {"cmdline": "crond"},
   "1001": {"cmdline": "crond"}
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
snapshot: two
mode: sim
spawn: a for s in HUP INT USR1 USR2 TERM WINCH; do trap "echo $s >> a.sig" $s; done; touch a.ready; while :; do sleep 1 & wait $!; done
spawn: b for s in HUP INT USR1 USR2 TERM WINCH; do trap "echo $s >> b.sig" $s; done; touch b.ready; while :; do sleep 1 & wait $!; done
run: pkill -USR1 crond
check: timeout 3 sh -c 'until grep -qsx USR1 a.sig; do sleep 0.05; done' && test "$(cat a.sig)" = USR1
check: sleep 0.3; ! test -e b.sig
exit: 0
=== case -NUMBER names the signal
snapshot: two
mode: sim
spawn: a for s in HUP INT USR1 USR2 TERM WINCH; do trap "echo $s >> a.sig" $s; done; touch a.ready; while :; do sleep 1 & wait $!; done
spawn: b for s in HUP INT USR1 USR2 TERM WINCH; do trap "echo $s >> b.sig" $s; done; touch b.ready; while :; do sleep 1 & wait $!; done
run: pkill -12 crond
check: timeout 3 sh -c 'until grep -qsx USR2 a.sig; do sleep 0.05; done' && test "$(cat a.sig)" = USR2
check: sleep 0.3; ! test -e b.sig
exit: 0
=== case -KILL ends the process
snapshot: two
mode: sim
spawn: a for s in HUP INT USR1 USR2 TERM WINCH; do trap "echo $s >> a.sig" $s; done; touch a.ready; while :; do sleep 1 & wait $!; done
spawn: b for s in HUP INT USR1 USR2 TERM WINCH; do trap "echo $s >> b.sig" $s; done; touch b.ready; while :; do sleep 1 & wait $!; done
run: pkill -KILL crond
check: timeout 3 sh -c 'until grep -qs "^State:.Z" /proc/@PID:a/status; do sleep 0.05; done'
check: sleep 0.3; ! test -e b.sig
exit: 0
=== case -kill is no signal: getopt reports its letters and TERM is sent
snapshot: two
mode: sim
spawn: a for s in HUP INT USR1 USR2 TERM WINCH; do trap "echo $s >> a.sig" $s; done; touch a.ready; while :; do sleep 1 & wait $!; done
spawn: b for s in HUP INT USR1 USR2 TERM WINCH; do trap "echo $s >> b.sig" $s; done; touch b.ready; while :; do sleep 1 & wait $!; done
run: pkill -kill crond
check: timeout 3 sh -c 'until grep -qsx TERM a.sig; do sleep 0.05; done' && test "$(cat a.sig)" = TERM
check: sleep 0.3; ! test -e b.sig
exit: 0
--- stderr
pkill: invalid option -- 'k'
pkill: invalid option -- 'i'
pkill: invalid option -- 'l'
pkill: invalid option -- 'l'
=== case -SIGKILL is no signal either
snapshot: two
mode: sim
spawn: a for s in HUP INT USR1 USR2 TERM WINCH; do trap "echo $s >> a.sig" $s; done; touch a.ready; while :; do sleep 1 & wait $!; done
spawn: b for s in HUP INT USR1 USR2 TERM WINCH; do trap "echo $s >> b.sig" $s; done; touch b.ready; while :; do sleep 1 & wait $!; done
run: pkill -SIGKILL crond
check: timeout 3 sh -c 'until grep -qsx TERM a.sig; do sleep 0.05; done' && test "$(cat a.sig)" = TERM
check: sleep 0.3; ! test -e b.sig
exit: 0
--- stderr
pkill: invalid option -- 'S'
pkill: invalid option -- 'I'
pkill: invalid option -- 'G'
pkill: invalid option -- 'K'
pkill: invalid option -- 'I'
pkill: invalid option -- 'L'
pkill: invalid option -- 'L'
=== case -0 is no signal: reported as an option, TERM is sent
snapshot: two
mode: sim
spawn: a for s in HUP INT USR1 USR2 TERM WINCH; do trap "echo $s >> a.sig" $s; done; touch a.ready; while :; do sleep 1 & wait $!; done
spawn: b for s in HUP INT USR1 USR2 TERM WINCH; do trap "echo $s >> b.sig" $s; done; touch b.ready; while :; do sleep 1 & wait $!; done
run: pkill -0 crond
check: timeout 3 sh -c 'until grep -qsx TERM a.sig; do sleep 0.05; done' && test "$(cat a.sig)" = TERM
check: sleep 0.3; ! test -e b.sig
exit: 0
--- stderr
pkill: invalid option -- '0'
=== case without -f only the first word is searched
snapshot: two
mode: sim
spawn: a for s in HUP INT USR1 USR2 TERM WINCH; do trap "echo $s >> a.sig" $s; done; touch a.ready; while :; do sleep 1 & wait $!; done
spawn: b for s in HUP INT USR1 USR2 TERM WINCH; do trap "echo $s >> b.sig" $s; done; touch b.ready; while :; do sleep 1 & wait $!; done
run: pkill 'crond -f'
check: sleep 0.3; ! test -e a.sig
check: sleep 0.3; ! test -e b.sig
exit: 0
=== case -f searches the whole command line
snapshot: two
mode: sim
spawn: a for s in HUP INT USR1 USR2 TERM WINCH; do trap "echo $s >> a.sig" $s; done; touch a.ready; while :; do sleep 1 & wait $!; done
spawn: b for s in HUP INT USR1 USR2 TERM WINCH; do trap "echo $s >> b.sig" $s; done; touch b.ready; while :; do sleep 1 & wait $!; done
run: pkill -HUP -f 'crond -f$'
check: timeout 3 sh -c 'until grep -qsx HUP a.sig; do sleep 0.05; done' && test "$(cat a.sig)" = HUP
check: sleep 0.3; ! test -e b.sig
exit: 0
=== case several patterns, each over its own walk
snapshot: two
mode: sim
spawn: a for s in HUP INT USR1 USR2 TERM WINCH; do trap "echo $s >> a.sig" $s; done; touch a.ready; while :; do sleep 1 & wait $!; done
spawn: b for s in HUP INT USR1 USR2 TERM WINCH; do trap "echo $s >> b.sig" $s; done; touch b.ready; while :; do sleep 1 & wait $!; done
run: pkill -WINCH '^/usr' '^ssh'
check: timeout 3 sh -c 'until grep -qsx WINCH a.sig; do sleep 0.05; done' && test "$(cat a.sig)" = WINCH
check: timeout 3 sh -c 'until grep -qsx WINCH b.sig; do sleep 0.05; done' && test "$(cat b.sig)" = WINCH
exit: 0
=== case an unknown option is passed over
snapshot: two
mode: sim
spawn: a for s in HUP INT USR1 USR2 TERM WINCH; do trap "echo $s >> a.sig" $s; done; touch a.ready; while :; do sleep 1 & wait $!; done
spawn: b for s in HUP INT USR1 USR2 TERM WINCH; do trap "echo $s >> b.sig" $s; done; touch b.ready; while :; do sleep 1 & wait $!; done
run: pkill -z -INT crond
check: timeout 3 sh -c 'until grep -qsx TERM a.sig; do sleep 0.05; done' && test "$(cat a.sig)" = TERM
check: sleep 0.3; ! test -e b.sig
exit: 0
--- stderr
pkill: invalid option -- 'z'
pkill: invalid option -- 'I'
pkill: invalid option -- 'N'
pkill: invalid option -- 'T'
=== case a cartel that has ended (ESRCH) is passed over
snapshot: ended
mode: sim
spawn: a for s in HUP INT USR1 USR2 TERM WINCH; do trap "echo $s >> a.sig" $s; done; touch a.ready; while :; do sleep 1 & wait $!; done
value: DEAD sh -c 'echo $$'
run: pkill crond
check: timeout 3 sh -c 'until grep -qsx TERM a.sig; do sleep 0.05; done' && test "$(cat a.sig)" = TERM
exit: 0
=== case a command line that reads 0xbad0062 is passed over
snapshot: gone-cmdline
mode: sim
spawn: a for s in HUP INT USR1 USR2 TERM WINCH; do trap "echo $s >> a.sig" $s; done; touch a.ready; while :; do sleep 1 & wait $!; done
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
spawn: a for s in HUP INT USR1 USR2 TERM WINCH; do trap "echo $s >> a.sig" $s; done; touch a.ready; while :; do sleep 1 & wait $!; done
run: pkill -KILL crond
check: timeout 3 sh -c 'until grep -qs "^State:.Z" /proc/@PID:a/status; do sleep 0.05; done'
exit: 0
=== case another command-line failure stops the walk
snapshot: bad-cmdline
mode: sim
spawn: a for s in HUP INT USR1 USR2 TERM WINCH; do trap "echo $s >> a.sig" $s; done; touch a.ready; while :; do sleep 1 & wait $!; done
spawn: b for s in HUP INT USR1 USR2 TERM WINCH; do trap "echo $s >> b.sig" $s; done; touch b.ready; while :; do sleep 1 & wait $!; done
run: pkill crond
check: timeout 3 sh -c 'until grep -qsx TERM a.sig; do sleep 0.05; done' && test "$(cat a.sig)" = TERM
check: sleep 0.3; ! test -e b.sig
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
snapshot: one
mode: sim
spawn: a for s in HUP INT USR1 USR2 TERM WINCH; do trap "echo $s >> a.sig" $s; done; touch a.ready; while :; do sleep 1 & wait $!; done
run: pkill 'a(b'
check: sleep 0.3; ! test -e a.sig
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
snapshot: one
mode: sim
spawn: a for s in HUP INT USR1 USR2 TERM WINCH; do trap "echo $s >> a.sig" $s; done; touch a.ready; while :; do sleep 1 & wait $!; done
run: pkill -HUP
check: sleep 0.3; ! test -e a.sig
exit: 0
=== case -h: usage on standard output
snapshot: unlisted
mode: sim
run: pkill -h crond
exit: 0
--- stdout
Usage: pkill [-SIGNAL] [PATTERN]
=== case cache mode is refused before anything else
snapshot: one
spawn: a for s in HUP INT USR1 USR2 TERM WINCH; do trap "echo $s >> a.sig" $s; done; touch a.ready; while :; do sleep 1 & wait $!; done
run: pkill crond
check: sleep 0.3; ! test -e a.sig
exit: 1
--- stderr
Using KEL cache is unsupported
=== case a cartel key beyond 32 bits is refused, never cut to process 1
snapshot: wide-key
mode: sim
env: ORXKEL_SIGNAL_RECORD=@TMP/signals
exe: /usr/bin/unshare
argv: unshare --user --map-root-user --fork --pid sh -c 'trap "echo TERM >> init.sig" TERM; @BIN/orxkeltools pkill crond; s=$?; exit $s'
check: test "$(cat signals)" = "1001 15"
check: ! test -e init.sig
exit: 1
--- stderr
pkill: Bad parameter
=== case IDs below 1 name no single process and are never signalled
snapshot: no-single-process
mode: sim
env: ORXKEL_SIGNAL_RECORD=@TMP/signals
run: pkill -HUP crond
check: test "$(cat signals)" = "1001 1"
exit: 0

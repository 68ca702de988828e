pgrep: cartels whose first word (or, with -f, whole command line) matches a
POSIX extended expression.  Without -l each line is the ID, a space and a
backspace.

=== snapshot cartels
{"buildDate": "Nov 30 2026",
 "tree": {"userworld": {"cartel": {
   "1001": {"cmdline": "/usr/sbin/sshd -D"},
   "1002": {"cmdline": "bash --login"},
   "1003": {"cmdline": "/bin/sh /opt/job.sh"},
   "1004": {"cmdline": {"$status": "0xbad0062"}},
   "1005": {"cmdline": "sh"},
   "1006": {"cmdline": "crond -f -l 8"}
 }}}}
=== snapshot gone-only
{"buildDate": "Nov 30 2026",
 "tree": {"userworld": {"cartel": {"1004": {"cmdline": {"$status": "0xbad0062"}}}}}}
=== snapshot bad-read
{"buildDate": "Nov 30 2026",
 "tree": {"userworld": {"cartel": {
   "2001": {"cmdline": "agent -a"},
   "2002": {"cmdline": {"$status": "0xbad0003"}},
   "2003": {"cmdline": "agent -b"}
 }}}}
=== snapshot text-key
{"buildDate": "Nov 30 2026",
 "tree": {"userworld": {"cartel": {
   "2001": {"cmdline": "agent -a"},
   "$text:2002": {"cmdline": "agent -b"},
   "2003": {"cmdline": "agent -c"}
 }}}}
=== snapshot no-cartels
{"buildDate": "Nov 30 2026", "tree": {"userworld": {"cartel": {}}}}
=== snapshot unlisted extends cartels
{"tree": {"userworld": {"cartel": {"$listStatus": "0xbad0003"}}}}
=== snapshot self
{"buildDate": "Nov 30 2026",
 "tree": {"userworld": {"cartel": {
   "$int:@SELF": {"cmdline": "/usr/lib/orvik/bin/pgrep -f orvik"}
 }}}}
=== snapshot self-and-other extends self
{"tree": {"userworld": {"cartel": {"1001": {"cmdline": "orvikd --daemon"}}}}}
=== snapshot wide-key
{"buildDate": "Nov 30 2026",
 "tree": {"userworld": {"cartel": {
   "1001": {"cmdline": "crond"},
   "4294967297": {"cmdline": "crond"},
   "1002": {"cmdline": "crond"}
 }}}}
=== case no pattern after the options
snapshot: cartels
run: pgrep -l
exit: 2
--- stderr
pgrep: no matching criteria specified
=== case -h: usage on standard output, status 0
snapshot: cartels
run: pgrep -h
exit: 0
--- stdout
Usage: pgrep [-flv] [PATTERN]
=== case an unknown option: usage on standard output, status 2
snapshot: cartels
run: pgrep -z sh
exit: 2
--- stdout
Usage: pgrep [-flv] [PATTERN]
--- stderr
pgrep: invalid option -- 'z'
=== case anchors bind to the start and end of the first word
snapshot: cartels
run: pgrep '^sh$'
exit: 0
--- stdout (escaped)
1005 \x08
=== case -l prints the first word
snapshot: cartels
run: pgrep -l sh
exit: 0
--- stdout
1001 /usr/sbin/sshd
1002 bash
1003 /bin/sh
1005 sh
=== case without -f the rest of the line is not searched
snapshot: cartels
run: pgrep job
exit: 1
=== case -f searches the whole line and -l prints it
snapshot: cartels
run: pgrep -fl 'job\.sh$'
exit: 0
--- stdout
1003 /bin/sh /opt/job.sh
=== case extended syntax: alternation and repetition
snapshot: cartels
run: pgrep -l '^(crond|bash)$|s{2}'
exit: 0
--- stdout
1001 /usr/sbin/sshd
1002 bash
1006 crond
=== case only the first argument is the pattern
snapshot: cartels
run: pgrep -l crond sshd
exit: 0
--- stdout
1006 crond
=== case -v prints the cartels that do not match; some matched, so status 1
snapshot: cartels
run: pgrep -vl sh
exit: 1
--- stdout
1006 crond
=== case -v with every cartel matching: nothing, status 1
snapshot: cartels
run: pgrep -v .
exit: 1
=== case -v with no cartel matching: every cartel, status 0
snapshot: cartels
run: pgrep -v zzz
exit: 0
--- stdout (escaped)
1001 \x08
1002 \x08
1003 \x08
1005 \x08
1006 \x08
=== case a pattern that does not compile
snapshot: cartels
run: pgrep 'a(b'
exit: 2
--- stderr (escaped)
pgrep: Unmatched ( or \\(
=== case an ended cartel (0xbad0062) is passed over and does not count
snapshot: gone-only
run: pgrep .
exit: 1
=== case any other command-line failure ends with 3 after the lines printed
snapshot: bad-read
run: pgrep agent
exit: 3
--- stdout (escaped)
2001 \x08
=== case a cartel ID that cannot be read ends with 3 after the lines printed
snapshot: text-key
run: pgrep agent
exit: 3
--- stdout (escaped)
2001 \x08
=== case the cartel list cannot be read: status 3, no message
snapshot: unlisted
run: pgrep sh
exit: 3
=== case no cartels: status 1
snapshot: no-cartels
run: pgrep sh
exit: 1
=== case no cartels with -v: status 0
snapshot: no-cartels
run: pgrep -v sh
exit: 0
=== case live mode: its own cartel alone is neither printed nor counted
snapshot: self
mode: sim
run: pgrep -f orvik
exit: 1
=== case live mode: its own cartel does not count with -v either
snapshot: self
mode: sim
run: pgrep -vf orvik
exit: 0
=== case live mode: other matches are printed
snapshot: self-and-other
mode: sim
run: pgrep -fl orvik
exit: 0
--- stdout
1001 orvikd --daemon
=== case cache mode: its own ID is not special
snapshot: self
run: pgrep -f orvik
exit: 0
--- stdout (any)
=== case a cartel key beyond 32 bits is a failure, never cut to 1
snapshot: wide-key
run: pgrep -l crond
exit: 3
--- stdout
1001 crond

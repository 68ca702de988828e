Output that cannot be written fails the run: every command, with standard
output on a full disk (/dev/full) or closed, names the error on standard
error and ends with its failure status (3 for pgrep, 1 for the others),
whatever it would have returned.  Each row runs an invocation that writes.

=== snapshot host from ../../examples/host.json
=== snapshot live
{"buildDate": "Nov 30 2026",
 "tree": {"system": {"corafs": {"ramdisks": {"root": {}}}}},
 "simulator": {"corafsRoot": "@TMP/root", "corafsRules": [
   {"path": "", "kind": "ramdisk", "disk": "root", "flags": 0}]}}
=== case full: lspci
snapshot: host
stdout: full
run: lspci
exit: 1
--- stderr
lspci: write error on standard output: No space left on device
=== case full: ps
snapshot: host
stdout: full
run: ps -J -c -s -T
exit: 1
--- stderr
ps: write error on standard output: No space left on device
=== case full: hwclock
snapshot: host
stdout: full
run: hwclock
exit: 1
--- stderr
hwclock: write error on standard output: No space left on device
=== case full: halvex
snapshot: host
stdout: full
run: halvex -v
exit: 1
--- stderr
halvex: write error on standard output: No space left on device
=== case full: irqinfo
snapshot: host
stdout: full
run: irqinfo
exit: 1
--- stderr
irqinfo: write error on standard output: No space left on device
=== case full: bootOption
snapshot: host
stdout: full
run: bootOption -m
exit: 1
--- stderr
bootOption: write error on standard output: No space left on device
=== case full: amldump
snapshot: host
stdout: full
run: amldump
exit: 1
--- stderr
amldump: write error on standard output: No space left on device
=== case full: pci-info, raw bytes written with write()
snapshot: host
stdout: full
run: pci-info -b 0 -s 0 -f 0 -c
exit: 1
--- stderr
pci-info: write error on standard output: No space left on device
=== case full: pidof
snapshot: host
stdout: full
run: pidof initd
exit: 1
--- stderr
pidof: write error on standard output: No space left on device
=== case full: userspaceof
snapshot: host
stdout: full
run: userspaceof 1001
exit: 1
--- stderr
userspaceof: write error on standard output: No space left on device
=== case full: vdu
snapshot: live
mode: sim
setup: mkdir -p root/d && truncate -s 10 root/d/f
cwd: @TMP/root
stdout: full
run: vdu
exit: 1
--- stderr
vdu: write error on standard output: No space left on device
=== case full: lsof
snapshot: host
stdout: full
run: lsof
exit: 1
--- stderr
lsof: write error on standard output: No space left on device
=== case full: vdf
snapshot: host
stdout: full
run: vdf
exit: 1
--- stderr
vdf: write error on standard output: No space left on device
=== case full: pkill's help, which goes to standard output
snapshot: live
mode: sim
stdout: full
run: pkill -h
exit: 1
--- stderr
pkill: write error on standard output: No space left on device
=== case full: pgrep fails with 3, since 1 means "no match"
snapshot: host
stdout: full
run: pgrep -l sh
exit: 3
--- stderr
pgrep: write error on standard output: No space left on device
=== case full: uptime
snapshot: host
stdout: full
run: uptime
exit: 1
--- stderr
uptime: write error on standard output: No space left on device
=== case closed: ps
snapshot: host
stdout: closed
run: ps
exit: 1
--- stderr
ps: write error on standard output: Bad file descriptor
=== case closed: pgrep
snapshot: host
stdout: closed
run: pgrep sh
exit: 3
--- stderr
pgrep: write error on standard output: Bad file descriptor
=== case closed: pci-info
snapshot: host
stdout: closed
run: pci-info -b 0 -s 0 -f 0 -c
exit: 1
--- stderr
pci-info: write error on standard output: Bad file descriptor
=== case closed: amldump's files do not take the place of standard output
snapshot: host
stdout: closed
run: amldump
check: head -c 4 APIC.aml | grep -qx APIC && head -c 4 DSDT.aml | grep -qx DSDT
check: ! grep -q Writing *.aml
exit: 1
--- stderr
amldump: write error on standard output: Bad file descriptor

amldump: every ACPI table to "<signature>.aml" (then "-1", "-2", ...) in the
working folder, each case in its own folder.  File names and contents, the
never-overwrite open, silent KEL failures that leave written files in place,
and the refusal of signatures that would name a file elsewhere, look like an
option or carry control bytes, and of lengths that would reach outside the
record.

=== snapshot tables
{"buildDate": "Nov 30 2026",
 "tree": {"hardware": {"acpi": {"tables": {
   "1": {"buffers": {"0": {"signature": "SSDT", "length": 10, "text": "first ssdt"}}},
   "2": {"buffers": {"0": {"signature": "DSDT", "length": 5, "data": "00010203ff"},
                     "1": {"signature": "DSDT", "length": 0, "text": "not written"},
                     "2": {"signature": "DSDT", "length": 6, "text": "tail"}}},
   "3": {"buffers": {}},
   "4": {"buffers": {"0": {"signature": "SSDT", "length": 6, "text": "second"}}},
   "5": {"buffers": {"1": {"signature": "FACP", "length": 3, "text": "two"},
                     "0": {"signature": "FACP", "length": 3, "text": "one"}}},
   "6": {"buffers": {"0": {"signature": "SSDT", "length": 5, "text": "third"}}}}}}}}
=== snapshot no-tables
{"buildDate": "Nov 30 2026", "tree": {"hardware": {"acpi": {"tables": {}}}}}
=== snapshot tables-list-fails
{"buildDate": "Nov 30 2026", "tree": {"hardware": {"acpi": {"tables": {"$listStatus": "0xbad0001"}}}}}
=== snapshot big
{"buildDate": "Nov 30 2026",
 "tree": {"hardware": {"acpi": {"tables": {
   "7": {"buffers": {"0": {"signature": "APIC", "length": 131075, "text": "A"},
                     "1": {"signature": "APIC", "length": 3, "text": "end"}}}}}}}}
=== snapshot kel-fails-midway
{"buildDate": "Nov 30 2026",
 "tree": {"hardware": {"acpi": {"tables": {
   "1": {"buffers": {"0": {"signature": "FACP", "length": 4, "text": "facp"}}},
   "2": {"buffers": {"0": {"signature": "DSDT", "length": 5, "text": "part1"},
                     "1": {"$status": "0xbad0001"},
                     "2": {"signature": "DSDT", "length": 5, "text": "part3"}}},
   "3": {"buffers": {"0": {"signature": "HPET", "length": 4, "text": "hpet"}}}}}}}}
=== snapshot buffers-list-fails
{"buildDate": "Nov 30 2026",
 "tree": {"hardware": {"acpi": {"tables": {
   "1": {"buffers": {"0": {"signature": "FACP", "length": 4, "text": "facp"}}},
   "2": {"buffers": {"$listStatus": "0xbad0017", "0": {"signature": "DSDT", "length": 4, "text": "dsdt"}}}}}}}}
=== snapshot unsafe
{"buildDate": "Nov 30 2026",
 "tree": {"hardware": {"acpi": {"tables": {
   "1": {"buffers": {"0": {"signature": "DSDT", "length": 4, "text": "dsdt"}}},
   "2": {"buffers": {"0": {"signature": "\u001b[2J", "length": 4, "text": "evil"}}},
   "3": {"buffers": {"0": {"signature": "SSDT", "length": 4, "text": "ssdt"}}}}}}}}
=== snapshot long-later-buffer
{"buildDate": "Nov 30 2026",
 "tree": {"hardware": {"acpi": {"tables": {
   "1": {"buffers": {"0": {"signature": "HPET", "length": 4, "text": "hpet"},
                     "1": {"signature": "HPET", "length": 131076, "text": "more"}}}}}}}}
=== snapshot long-first-buffer
{"buildDate": "Nov 30 2026",
 "tree": {"hardware": {"acpi": {"tables": {
   "1": {"buffers": {"0": {"signature": "HPET", "length": 4294967295, "text": "hpet"}}}}}}}}
=== snapshot wide-keys
{"buildDate": "Nov 30 2026",
 "tree": {"hardware": {"acpi": {"tables": {
   "0xffffffffffffffff": {"buffers": {"0": {"signature": "MCFG", "length": 4, "text": "mcfg"}}},
   "0xffffffff": {"buffers": {"0": {"signature": "BERT", "length": 4, "text": "bert"}}}}}}}}
=== case tables named by signature and count; an empty table writes nothing; buffers read by index; arguments are ignored
snapshot: tables
run: amldump -h extra
check: printf 'first ssdt' | cmp - SSDT.aml
check: printf '\000\001\002\003\377tail\000\000' | cmp - DSDT.aml
check: printf 'second' | cmp - SSDT-1.aml
check: printf 'onetwo' | cmp - FACP.aml
check: printf 'third' | cmp - SSDT-2.aml
check: test "$(ls *.aml | tr '\n' ' ')" = "DSDT.aml FACP.aml SSDT-1.aml SSDT-2.aml SSDT.aml "
check: test "$(stat -c %a *.aml | sort -u)" = 600
exit: 0
--- stdout
Writing file SSDT.aml
Writing file DSDT.aml
Writing file SSDT-1.aml
Writing file FACP.aml
Writing file SSDT-2.aml
=== case an existing file is never overwritten: the run stops there, earlier files stay
snapshot: tables
setup: printf old > SSDT-1.aml
run: amldump
check: printf old | cmp - SSDT-1.aml
check: printf 'first ssdt' | cmp - SSDT.aml
check: printf '\000\001\002\003\377tail\000\000' | cmp - DSDT.aml
check: test ! -e FACP.aml && test ! -e SSDT-2.aml
exit: 1
--- stdout
Writing file SSDT.aml
Writing file DSDT.aml
Writing file SSDT-1.aml
--- stderr
amldump: : File exists
=== case a dangling link in the way is not followed
snapshot: tables
setup: ln -s @TMP/elsewhere SSDT.aml
run: amldump
check: test ! -e elsewhere
exit: 1
--- stdout
Writing file SSDT.aml
--- stderr
amldump: : File exists
=== case no tables: nothing written, status 0
snapshot: no-tables
run: amldump
check: test "$(ls -A | grep -v '^snapshot')" = ""
exit: 0
=== case the tables list fails silently
snapshot: tables-list-fails
run: amldump
exit: 1
=== case a table in many buffers: the file is the sum of their lengths, byte for byte
snapshot: big
run: amldump
check: test "$(stat -c %s APIC.aml)" = 131078
check: { printf A; head -c 131074 /dev/zero; printf end; } | cmp - APIC.aml
exit: 0
--- stdout
Writing file APIC.aml
=== case a KEL failure mid-way: silent, written files stay, the open one as far as written
snapshot: kel-fails-midway
run: amldump
check: printf facp | cmp - FACP.aml
check: printf part1 | cmp - DSDT.aml
check: test ! -e HPET.aml
exit: 1
--- stdout
Writing file FACP.aml
Writing file DSDT.aml
=== case a failing buffers list ends the run silently after the tables before it
snapshot: buffers-list-fails
run: amldump
check: printf facp | cmp - FACP.aml
check: test ! -e DSDT.aml
exit: 1
--- stdout
Writing file FACP.aml
=== case unsafe signatures are refused and nothing is written for them: '/', '.', '..', empty, a leading '-', bytes outside printable ASCII (shown escaped)
snapshot: unsafe
run: amldump
check: printf dsdt | cmp - DSDT.aml
check: test "$(ls -A | grep -v '^snapshot')" = "DSDT.aml"
check: for s in ../x /tmp . .. '' -rf '\u0001/\\a' 'a\nb' '\u007f' '\u00e9'; do rm -rf k && mkdir k && printf '{"buildDate": "Nov 30 2026", "tree": {"hardware": {"acpi": {"tables": {"1": {"buffers": {"0": {"signature": "%s", "text": "evil"}}}}}}}}' "$s" > k.json && @BIN/kelcache build k.json -o k.cache > /dev/null && (cd k && @BIN/orxkeltools -c ../k.cache amldump; echo "status $? files $(ls -A | wc -l)") 2>&1; done > kinds
check: printf '%s\n' 'amldump: table 1 has the unsafe signature "../x"; nothing written for it' 'status 1 files 0' 'amldump: table 1 has the unsafe signature "/tmp"; nothing written for it' 'status 1 files 0' 'amldump: table 1 has the unsafe signature "."; nothing written for it' 'status 1 files 0' 'amldump: table 1 has the unsafe signature ".."; nothing written for it' 'status 1 files 0' 'amldump: table 1 has the unsafe signature ""; nothing written for it' 'status 1 files 0' 'amldump: table 1 has the unsafe signature "-rf"; nothing written for it' 'status 1 files 0' 'amldump: table 1 has the unsafe signature "\x01/\x5ca"; nothing written for it' 'status 1 files 0' 'amldump: table 1 has the unsafe signature "a\x0ab"; nothing written for it' 'status 1 files 0' 'amldump: table 1 has the unsafe signature "\x7f"; nothing written for it' 'status 1 files 0' 'amldump: table 1 has the unsafe signature "\xc3\xa9"; nothing written for it' 'status 1 files 0' | diff - kinds
exit: 1
--- stdout
Writing file DSDT.aml
--- stderr
amldump: table 2 has the unsafe signature "\x1b[2J"; nothing written for it
=== case a later buffer longer than a record holds fails the table; what was written stays
snapshot: long-later-buffer
run: amldump
check: printf hpet | cmp - HPET.aml
exit: 1
--- stdout
Writing file HPET.aml
--- stderr
amldump: table 1 buffer 1 claims 131076 bytes, more than the 131075 a buffer holds
=== case a first buffer longer than a record holds: no file, no line
snapshot: long-first-buffer
run: amldump
check: test "$(ls -A | grep -v '^snapshot')" = ""
exit: 1
--- stderr
amldump: table 1 buffer 0 claims 4294967295 bytes, more than the 131075 a buffer holds
=== case table keys are read as 32-bit and sent back sign-extended: 0xffffffff reads table -1
snapshot: wide-keys
run: amldump
check: printf mcfg | cmp - MCFG.aml
check: printf mcfg | cmp - MCFG-1.aml
check: test ! -e BERT.aml
exit: 0
--- stdout
Writing file MCFG.aml
Writing file MCFG-1.aml

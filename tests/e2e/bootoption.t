bootOption: the boot switches, the command line split into kernel and
options, boot modules, boot option files and their contents, raw output,
the fixed order of the items, help paths and failures.

File contents are read live only, so those cases run in simulator mode; in
cache mode they are refused.

=== snapshot boot
{"buildDate": "Nov 30 2026",
 "tree": {"system": {
   "bootOption": {"audit": 1, "fsck": 0, "rollback": 2},
   "bootCmdLine": "b.b00 quiet nofb  com1_baud=115200",
   "bootMAC": {"pxe": 7},
   "bootOptionFiles": {
      "boot.cfg": {"content": "kernel=b.b00\nmodules=s.v00 --- tools.t00\n"},
      "empty.cfg": {"content": ""}},
   "corafs": {"tardisks": {
      "s.v00": {"stats": {"size": 4096, "bootModule": 1}},
      "state.tgz": {"stats": {"size": 100, "bootModule": 0}},
      "tools.t00": {"stats": {"size": 8192, "bootModule": 2}}}}}}}
=== snapshot one-word extends boot
{"tree": {"system": {"bootCmdLine": "b.b00", "bootMAC": {"pxe": 0}}}}
=== snapshot full-line extends boot
{"tree": {"system": {"bootCmdLine": "@LINE"}}}
=== snapshot big extends boot
{"tree": {"system": {"bootOptionFiles": {
   "big.cfg": {"content": {"pattern": "abcdef\n", "length": 6291556}},
   "trickle.cfg": {"content": {"text": "one\ntwo\nthree\n", "chunkLimit": 4}},
   "nul.cfg": {"content": {"pattern": "ab\u0000", "length": 3145730}}}}}}
=== snapshot stuck extends boot
{"tree": {"system": {"bootOptionFiles": {
   "stuck.cfg": {"content": {"text": "never read\n", "chunkLimit": 0}}}}}}
=== snapshot failing-file extends boot
{"tree": {"system": {"bootOptionFiles": {
   "bad.cfg": {"content": {"text": "unreadable\n", "readStatus": "0xbad0001"}}}}}}
=== snapshot no-switches extends boot
{"tree": {"system": {"bootOption": {"$status": "0xbad0003"}}}}
=== snapshot no-cmdline extends boot
{"tree": {"system": {"bootCmdLine": {"$status": "0xbad0003"}}}}
=== snapshot no-mac extends boot
{"tree": {"system": {"bootMAC": {"$status": "0xbad0003"}}}}
=== snapshot no-tardisks extends boot
{"tree": {"system": {"corafs": {"tardisks": {"$listStatus": "0xbad0001"}}}}}
=== snapshot bad-tardisk extends boot
{"tree": {"system": {"corafs": {"tardisks": {"state.tgz": {"stats": {"$status": "0xbad0003"}}}}}}}
=== snapshot no-files extends boot
{"tree": {"system": {"bootOptionFiles": {"$listStatus": "0xbad0001"}}}}
=== case no argument
snapshot: boot
run: bootOption
exit: 1
--- stderr
bootOption: no option specified
bootOption
  -r --raw                      Print w/o annotation
  -a --all                      Print f,i,u,w,R boot options
  -f --fsck                     FS Check Mode
  -i --audit                    Audit Mode
  -R --rollback                 Booted after a rollback
  -p --pxeboot                  Booted via (g)PXE
  -k --kernel                   Kernel used to boot
  -m --modules                  List of modules used to boot
  -o --options                  List of boot options used to boot
  -b --bootOptionFiles          List of boot option files to boot
  -c --bootOptionFileContent    Content of a boot option file used to boot
  -C --bootOptionFilesContent   Content of all boot option files used to boot
=== case operands alone print nothing
snapshot: boot
run: bootOption -r kernel
exit: 0
=== case -a: the three switches
snapshot: boot
run: bootOption -a
exit: 0
--- stdout
FS Check : 0
Audit Mode : 1
Booted after rollback : 2
=== case -a -r: three bare numbers
snapshot: boot
run: bootOption --raw --all
exit: 0
--- stdout
0
1
2
=== case every item in its fixed order, whatever the order of the options
snapshot: boot
mode: sim
run: bootOption -c empty.cfg -b -m -o -C -k -p -R -i -f -c boot.cfg
exit: 0
--- stdout
FS Check : 0
Audit Mode : 1
Booted after rollback : 2
Booted via (g)PXE : 1
Kernel : b.b00
Boot Option File Content boot.cfg : kernel=b.b00 modules=s.v00 --- tools.t00 
Boot Option File Content empty.cfg : 
Options : quiet nofb  com1_baud=115200
Modules : s.v00 tools.t00 
Boot Option Files : boot.cfg empty.cfg 
Boot Option File Content boot.cfg : kernel=b.b00 modules=s.v00 --- tools.t00 
=== case every item raw, long options
snapshot: boot
mode: sim
run: bootOption --bootOptionContent boot.cfg --bootOptionFiles --modules --options --bootOptionFilesContent --kernel --pxeboot --rollback --audit --fsck --raw
exit: 0
--- stdout
0
1
2
1
b.b00
kernel=b.b00 modules=s.v00 --- tools.t00   quiet nofb  com1_baud=115200
s.v00 tools.t00 
boot.cfg empty.cfg 
kernel=b.b00 modules=s.v00 --- tools.t00 
=== case a repeated option prints its item once
snapshot: boot
run: bootOption -k -k -f -a
exit: 0
--- stdout
FS Check : 0
Audit Mode : 1
Booted after rollback : 2
Kernel : b.b00
=== case a command line without a space: all kernel, no options
snapshot: one-word
run: bootOption -o -k -p
exit: 0
--- stdout
Booted via (g)PXE : 0
Kernel : b.b00
Options : 
=== case a command line that fills its record has no NUL
snapshot: full-line
value: LINE python3 -c 'print("k.gz" + " o" * 2046)'
run: bootOption -r -k -o
check: python3 -c 'print("k.gz"); print(" ".join(["o"] * 2046))' > want && @BIN/orxkeltools -c @CACHE bootOption -r -k -o | cmp - want
exit: 0
--- stdout (any)
=== case the help's long name for -c is accepted too
snapshot: boot
mode: sim
run: bootOption --bootOptionFileContent=boot.cfg -r
exit: 0
--- stdout
kernel=b.b00 modules=s.v00 --- tools.t00 
=== case the last -c counts
snapshot: boot
mode: sim
run: bootOption -c nosuch.cfg -c empty.cfg
exit: 0
--- stdout
Boot Option File Content empty.cfg : 
=== case -C -r: contents separated by spaces, no line break at the end
snapshot: boot
mode: sim
run: bootOption -C -r
exit: 0
--- stdout (no newline at end)
kernel=b.b00 modules=s.v00 --- tools.t00   
=== case a file over 3 MiB is read in several chunks
snapshot: big
mode: sim
run: bootOption -r -c big.cfg
check: ORXKEL_SIMULATOR=@CACHE @BIN/orxkeltools bootOption -r -c big.cfg > out && test $(wc -c < out) -eq 6291557
check: yes abcdef | head -c 6291556 | tr '\n' ' ' > want && echo >> want && ORXKEL_SIMULATOR=@CACHE @BIN/orxkeltools bootOption -r -c big.cfg | cmp - want
exit: 0
--- stdout (any)
=== case each chunk is 3 MiB and prints up to its first NUL
snapshot: big
mode: sim
run: bootOption -c nul.cfg
exit: 0
--- stdout
Boot Option File Content nul.cfg : abab
=== case a short read goes on from where it stopped
snapshot: big
mode: sim
run: bootOption -c trickle.cfg
exit: 0
--- stdout
Boot Option File Content trickle.cfg : one two three 
=== case a read that returns nothing before the end stops with an error
snapshot: stuck
mode: sim
run: bootOption -c stuck.cfg
timeout: 10
exit: 1
--- stdout (no newline at end)
Boot Option File Content stuck.cfg : 
--- stderr
Boot option file stuck.cfg: no data at byte 0 of 11
=== case a file that cannot be read stops -C after the files before it
snapshot: failing-file
mode: sim
run: bootOption -C -k
exit: 1
--- stdout (no newline at end)
Kernel : b.b00
Boot Option File Content boot.cfg : kernel=b.b00 modules=s.v00 --- tools.t00 
Boot Option File Content empty.cfg : 
Boot Option File Content bad.cfg : 
=== case an invalid file name
snapshot: boot
mode: sim
run: bootOption -k -c nosuch.cfg
exit: 1
--- stdout
Kernel : b.b00
Invalid boot option file name nosuch.cfg
=== case file contents are refused in cache mode
snapshot: boot
run: bootOption -k -c boot.cfg
exit: 1
--- stdout
Kernel : b.b00
--- stderr
Using KEL cache is unsupported
=== case all file contents are refused in cache mode
snapshot: boot
run: bootOption -C -o
exit: 1
--- stderr
Using KEL cache is unsupported
=== case names of boot option files in cache mode
snapshot: boot
run: bootOption -b
exit: 0
--- stdout
Boot Option Files : boot.cfg empty.cfg 
=== case the switches cannot be read
snapshot: no-switches
run: bootOption -k -R
exit: 1
=== case the command line cannot be read: -p fails too
snapshot: no-cmdline
run: bootOption -f -p
exit: 1
--- stdout
FS Check : 0
=== case the network boot record cannot be read
snapshot: no-mac
run: bootOption -p -k
exit: 1
=== case the tardisks cannot be listed
snapshot: no-tardisks
run: bootOption -m -k
exit: 1
--- stdout (no newline at end)
Kernel : b.b00
Modules : 
=== case a tardisk's stats cannot be read
snapshot: bad-tardisk
run: bootOption -r -m
exit: 1
--- stdout (no newline at end)
s.v00 
=== case the boot option files cannot be listed
snapshot: no-files
run: bootOption -b -o
exit: 1
--- stdout
Options : quiet nofb  com1_baud=115200
=== case -h; -u and -w, which the short options accept, the same
snapshot: boot
run: bootOption -k -h
check: for o in -u -w; do test "$(@BIN/orxkeltools -c @CACHE bootOption $o 2>&1; echo $?)" = "$(@BIN/orxkeltools -c @CACHE bootOption -h 2>&1; echo $?)" || exit 1; done
exit: 1
--- stderr
bootOption
  -r --raw                      Print w/o annotation
  -a --all                      Print f,i,u,w,R boot options
  -f --fsck                     FS Check Mode
  -i --audit                    Audit Mode
  -R --rollback                 Booted after a rollback
  -p --pxeboot                  Booted via (g)PXE
  -k --kernel                   Kernel used to boot
  -m --modules                  List of modules used to boot
  -o --options                  List of boot options used to boot
  -b --bootOptionFiles          List of boot option files to boot
  -c --bootOptionFileContent    Content of a boot option file used to boot
  -C --bootOptionFilesContent   Content of all boot option files used to boot
=== case an unknown option
snapshot: boot
run: bootOption --pxe-boot
exit: 1
--- stderr
bootOption: unrecognized option '--pxe-boot'
bootOption
  -r --raw                      Print w/o annotation
  -a --all                      Print f,i,u,w,R boot options
  -f --fsck                     FS Check Mode
  -i --audit                    Audit Mode
  -R --rollback                 Booted after a rollback
  -p --pxeboot                  Booted via (g)PXE
  -k --kernel                   Kernel used to boot
  -m --modules                  List of modules used to boot
  -o --options                  List of boot options used to boot
  -b --bootOptionFiles          List of boot option files to boot
  -c --bootOptionFileContent    Content of a boot option file used to boot
  -C --bootOptionFilesContent   Content of all boot option files used to boot

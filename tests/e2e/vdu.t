vdu in the simulator: each case builds a tree under @TMP/root, which the
snapshot names as the corafs root; rules charge its inodes to disks.

readdir order is the file system's, so every directory that holds more
than one counted entry is either below the printed depth with all its
entries on one disk, or holds one counted entry only.

The tree of most cases ("main"):
  .                  ramdisk root, bit 6 (directories charge no bytes)
  docs/              ramdisk root, bit 6
  docs/empty         ramdisk root, size 0
  docs/guide/        tardisk tools.t00, bit 6
  docs/guide/readme  ramdisk logs, 5000 bytes
  mnt/               another device: skipped with all below it

=== snapshot disks
{"buildDate": "Nov 30 2026",
 "tree": {"system": {"corafs": {
   "tardisks": {"base.v00": {}, "tools.t00": {}},
   "ramdisks": {"root": {}, "logs": {}, "tmpfs": {}}}}},
 "simulator": {"corafsRoot": "@TMP/root", "corafsRules": [
   {"path": "docs/guide/readme", "kind": "ramdisk", "disk": "logs", "flags": 0},
   {"path": "docs/guide", "kind": "tardisk", "disk": "tools.t00", "flags": 64},
   {"path": "mnt", "kind": "foreign", "disk": "", "flags": 0},
   {"path": "", "kind": "ramdisk", "disk": "root", "flags": 64}]}}
=== snapshot readme-not-charged extends disks
{"simulator": {"corafsRules": [
   {"path": "docs/guide/readme", "kind": "ramdisk", "disk": "logs", "flags": 64},
   {"path": "", "kind": "ramdisk", "disk": "root", "flags": 64}]}}
=== snapshot big-files extends disks
{"simulator": {"corafsRules": [
   {"path": "big/a", "kind": "ramdisk", "disk": "tmpfs", "flags": 0},
   {"path": "big/b", "kind": "ramdisk", "disk": "tmpfs", "flags": 0},
   {"path": "big/c", "kind": "ramdisk", "disk": "tmpfs", "flags": 0},
   {"path": "", "kind": "ramdisk", "disk": "root", "flags": 64}]}}
=== snapshot dirs-charged extends disks
{"simulator": {"corafsRules": [
   {"path": "", "kind": "tardisk", "disk": "base.v00", "flags": 0}]}}
=== snapshot two-buckets extends disks
{"tree": {"system": {"corafs": {
   "tardisks": {"base.v00": {}, "tools.t00": null},
   "ramdisks": {"root": {}, "logs": null, "tmpfs": null}}}}}
=== snapshot no-disks extends disks
{"tree": {"system": {"corafs": {
   "tardisks": {"base.v00": null, "tools.t00": null},
   "ramdisks": {"root": null, "logs": null, "tmpfs": null}}}}}
=== snapshot disks-unreadable extends disks
{"tree": {"system": {"corafs": {
   "tardisks": {"$listStatus": "0xbad0001"},
   "ramdisks": {"$listStatus": "0xbad0017"}}}}}
=== snapshot readme-unreadable extends disks
{"tree": {"system": {"corafs": {"inodes": {"@INO": {"stats": {"$status": "0xbad0001"}}}}}}}
=== snapshot long-root extends disks
{"simulator": {"corafsRoot": "@ROOT", "corafsRules": [
   {"path": "", "kind": "ramdisk", "disk": "root", "flags": 64}]}}
=== snapshot relative-root extends disks
{"simulator": {"corafsRoot": "root"}}
=== snapshot rule-below-foreign extends disks
{"simulator": {"corafsRules": [
   {"path": "mnt/data/big", "kind": "ramdisk", "disk": "tmpfs", "flags": 0},
   {"path": "mnt", "kind": "foreign", "disk": "", "flags": 0},
   {"path": "", "kind": "ramdisk", "disk": "root", "flags": 64}]}}
=== snapshot unlinked
{"buildDate": "Nov 30 2026",
 "tree": {"system": {"corafs": {
   "tardisks": {"base.v00": {}},
   "ramdisks": {"root": {}},
   "inodes": {
     "11": {"stats": {"flags": 1, "size": 4096, "tardisk": "base.v00", "name": "linked.txt"}},
     "12": {"stats": {"unlinked": true, "size": 3221225472, "ramdisk": "root", "name": "core.vmx-1234"}},
     "13": {"stats": {"$status": "0xbad0003"}},
     "14": {"stats": {"linkState": -4, "size": 3221225472, "ramdisk": "root", "name": "hostd.log"}},
     "15": {"stats": {"unlinked": true, "size": 1000, "ramdisk": "root", "name": "a-file-name-longer-than-the-thirty-eight-columns"}}}}}}}
=== snapshot unlinked-last-unreadable extends unlinked
{"tree": {"system": {"corafs": {"inodes": {"15": {"stats": {"$status": "0xbad0001"}}}}}}}
=== snapshot all-linked extends unlinked
{"tree": {"system": {"corafs": {"inodes": {"12": null, "13": null, "14": null, "15": null}}}}}
=== snapshot no-inodes extends unlinked
{"tree": {"system": {"corafs": {"inodes": {"11": null, "12": null, "13": null, "14": null, "15": null}}}}}
=== snapshot inodes-unreadable extends unlinked
{"tree": {"system": {"corafs": {"inodes": {"$listStatus": "0xbad0001"}}}}}
=== case default depth: the entries in "." and then "." itself; three disks in first-met order
snapshot: disks
mode: sim
setup: mkdir -p root/docs/guide root/mnt/data && truncate -s 5000 root/docs/guide/readme && : > root/docs/empty && truncate -s 7000 root/mnt/data/big
cwd: @TMP/root
run: vdu
exit: 0
--- stdout
For './docs':
                          ramdisk root:            0		(    1 inodes)
                     tardisk tools.t00:            0		(    1 inodes)
                          ramdisk logs:         5000		(    1 inodes)
For '.':
                          ramdisk root:            0		(    2 inodes)
                     tardisk tools.t00:            0		(    1 inodes)
                          ramdisk logs:         5000		(    1 inodes)
=== case -i counts the empty file
snapshot: disks
mode: sim
setup: mkdir -p root/docs/guide root/mnt/data && truncate -s 5000 root/docs/guide/readme && : > root/docs/empty && truncate -s 7000 root/mnt/data/big
cwd: @TMP/root
run: vdu -i
exit: 0
--- stdout
For './docs':
                          ramdisk root:            0		(    2 inodes)
                     tardisk tools.t00:            0		(    1 inodes)
                          ramdisk logs:         5000		(    1 inodes)
For '.':
                          ramdisk root:            0		(    3 inodes)
                     tardisk tools.t00:            0		(    1 inodes)
                          ramdisk logs:         5000		(    1 inodes)
=== case -s: the start only
snapshot: disks
mode: sim
setup: mkdir -p root/docs/guide root/mnt/data && truncate -s 5000 root/docs/guide/readme && : > root/docs/empty && truncate -s 7000 root/mnt/data/big
cwd: @TMP/root
run: vdu -s
exit: 0
--- stdout
For '.':
                          ramdisk root:            0		(    2 inodes)
                     tardisk tools.t00:            0		(    1 inodes)
                          ramdisk logs:         5000		(    1 inodes)
=== case -d 2 leaves out the depth of the readme
snapshot: disks
mode: sim
setup: mkdir -p root/docs/guide root/mnt/data && truncate -s 5000 root/docs/guide/readme && : > root/docs/empty && truncate -s 7000 root/mnt/data/big
cwd: @TMP/root
run: vdu -d 2
exit: 0
--- stdout
For './docs/guide':
                     tardisk tools.t00:            0		(    1 inodes)
                          ramdisk logs:         5000		(    1 inodes)
For './docs':
                          ramdisk root:            0		(    1 inodes)
                     tardisk tools.t00:            0		(    1 inodes)
                          ramdisk logs:         5000		(    1 inodes)
For '.':
                          ramdisk root:            0		(    2 inodes)
                     tardisk tools.t00:            0		(    1 inodes)
                          ramdisk logs:         5000		(    1 inodes)
=== case -a: every depth, in post-order; the other device is skipped silently
snapshot: disks
mode: sim
setup: mkdir -p root/docs/guide root/mnt/data && truncate -s 5000 root/docs/guide/readme && : > root/docs/empty && truncate -s 7000 root/mnt/data/big
cwd: @TMP/root
run: vdu -a
exit: 0
--- stdout
For './docs/guide/readme':
                          ramdisk logs:         5000
For './docs/guide':
                     tardisk tools.t00:            0		(    1 inodes)
                          ramdisk logs:         5000		(    1 inodes)
For './docs':
                          ramdisk root:            0		(    1 inodes)
                     tardisk tools.t00:            0		(    1 inodes)
                          ramdisk logs:         5000		(    1 inodes)
For '.':
                          ramdisk root:            0		(    2 inodes)
                     tardisk tools.t00:            0		(    1 inodes)
                          ramdisk logs:         5000		(    1 inodes)
=== case -d -1 is the largest depth; -h sizes; the last of -a, -d, -s wins
snapshot: disks
mode: sim
setup: mkdir -p root/docs/guide root/mnt/data && truncate -s 5000 root/docs/guide/readme && : > root/docs/empty && truncate -s 7000 root/mnt/data/big
cwd: @TMP/root
run: vdu -s -h -d -1
exit: 0
--- stdout
For './docs/guide/readme':
                          ramdisk logs:    4K
For './docs/guide':
                     tardisk tools.t00:    0B		(    1 inodes)
                          ramdisk logs:    4K		(    1 inodes)
For './docs':
                          ramdisk root:    0B		(    1 inodes)
                     tardisk tools.t00:    0B		(    1 inodes)
                          ramdisk logs:    4K		(    1 inodes)
For '.':
                          ramdisk root:    0B		(    2 inodes)
                     tardisk tools.t00:    0B		(    1 inodes)
                          ramdisk logs:    4K		(    1 inodes)
=== case a starting path that ends in a slash gets no second slash
snapshot: disks
mode: sim
setup: mkdir -p root/docs/guide root/mnt/data && truncate -s 5000 root/docs/guide/readme && : > root/docs/empty && truncate -s 7000 root/mnt/data/big
run: vdu root/docs/
exit: 0
--- stdout
For 'root/docs/guide':
                     tardisk tools.t00:            0		(    1 inodes)
                          ramdisk logs:         5000		(    1 inodes)
For 'root/docs/':
                          ramdisk root:            0		(    1 inodes)
                     tardisk tools.t00:            0		(    1 inodes)
                          ramdisk logs:         5000		(    1 inodes)
=== case a regular file as the start: one line, no inode count
snapshot: disks
mode: sim
setup: mkdir -p root/docs/guide root/mnt/data && truncate -s 5000 root/docs/guide/readme && : > root/docs/empty && truncate -s 7000 root/mnt/data/big
cwd: @TMP/root/docs
run: vdu guide/readme
exit: 0
--- stdout
For 'guide/readme':
                          ramdisk logs:         5000
=== case an empty file as the start: nothing without -i
snapshot: disks
mode: sim
setup: mkdir -p root/docs/guide root/mnt/data && truncate -s 5000 root/docs/guide/readme && : > root/docs/empty && truncate -s 7000 root/mnt/data/big
cwd: @TMP/root
run: vdu docs/empty
exit: 0
=== case flag bit 6: an inode counted, its bytes not
snapshot: readme-not-charged
mode: sim
setup: mkdir -p root/docs/guide root/mnt/data && truncate -s 5000 root/docs/guide/readme && : > root/docs/empty && truncate -s 7000 root/mnt/data/big
cwd: @TMP/root
run: vdu -a docs/guide
exit: 0
--- stdout
For 'docs/guide/readme':
                          ramdisk logs:            0
For 'docs/guide':
                          ramdisk root:            0		(    1 inodes)
                          ramdisk logs:            0		(    1 inodes)
=== case "/" is not the corafs root off the host: nothing counted
snapshot: disks
mode: sim
setup: mkdir -p root/docs/guide root/mnt/data && truncate -s 5000 root/docs/guide/readme && : > root/docs/empty && truncate -s 7000 root/mnt/data/big
run: vdu /
exit: 0
=== case a missing path is not counted
snapshot: disks
mode: sim
setup: mkdir -p root
cwd: @TMP/root
run: vdu -a nothing-here
exit: 0
=== case directories charge their own size
snapshot: dirs-charged
mode: sim
setup: mkdir -p root && truncate -s 100 root/notes
value: LINE printf 'base.v00: %12d' $(( $(stat -c %s root) + 100 ))
cwd: @TMP/root
run: vdu -s
exit: 0
--- stdout
For '.':
                      tardisk @LINE		(    2 inodes)
=== case sums past 4 GiB are not wrapped
snapshot: big-files
mode: sim
setup: mkdir -p root/big && truncate -s 3G root/big/a && truncate -s 3G root/big/b && truncate -s 4095M root/big/c
cwd: @TMP/root
run: vdu -s
exit: 0
--- stdout
For '.':
                          ramdisk root:            0		(    2 inodes)
                         ramdisk tmpfs:  10736369664		(    3 inodes)
=== case sums past 4 GiB with -h
snapshot: big-files
mode: sim
setup: mkdir -p root/big && truncate -s 3G root/big/a && truncate -s 3G root/big/b && truncate -s 4095M root/big/c
cwd: @TMP/root
run: vdu -s -h big
exit: 0
--- stdout
For 'big':
                          ramdisk root:    0B		(    1 inodes)
                         ramdisk tmpfs: 10239M		(    3 inodes)
=== case more disks in a subtree than buckets: the newest is dropped
snapshot: two-buckets
mode: sim
setup: mkdir -p root/docs/guide root/mnt/data && truncate -s 5000 root/docs/guide/readme && : > root/docs/empty && truncate -s 7000 root/mnt/data/big
cwd: @TMP/root
run: vdu
exit: 0
--- stdout
For './docs':
                          ramdisk root:            0		(    1 inodes)
                     tardisk tools.t00:            0		(    1 inodes)
For '.':
                          ramdisk root:            0		(    2 inodes)
                     tardisk tools.t00:            0		(    1 inodes)
--- stderr
Not enough dustats buckets
=== case an inode whose stats cannot be read is reported and not counted
snapshot: readme-unreadable
mode: sim
setup: mkdir -p root/docs/guide root/mnt/data && truncate -s 5000 root/docs/guide/readme && : > root/docs/empty && truncate -s 7000 root/mnt/data/big
value: INO printf '0x%x' $(stat -c %i root/docs/guide/readme)
cwd: @TMP/root
run: vdu -a
exit: 0
--- stdout
For './docs/guide':
                     tardisk tools.t00:            0		(    1 inodes)
For './docs':
                          ramdisk root:            0		(    1 inodes)
                     tardisk tools.t00:            0		(    1 inodes)
For '.':
                          ramdisk root:            0		(    2 inodes)
                     tardisk tools.t00:            0		(    1 inodes)
--- stderr
KEL_Get error for './docs/guide/readme' (Failure)
=== case both disk lists empty: no bucket space for the start
snapshot: no-disks
mode: sim
setup: mkdir -p root/docs/guide root/mnt/data && truncate -s 5000 root/docs/guide/readme && : > root/docs/empty && truncate -s 7000 root/mnt/data/big
cwd: @TMP/root
run: vdu -a
exit: 0
--- stderr
No bucket space for '.'
=== case both disk lists unreadable: as empty
snapshot: disks-unreadable
mode: sim
setup: mkdir -p root/docs/guide root/mnt/data && truncate -s 5000 root/docs/guide/readme && : > root/docs/empty && truncate -s 7000 root/mnt/data/big
cwd: @TMP/root
run: vdu
exit: 0
--- stderr
No bucket space for '.'
=== case a directory path of 4095 bytes leaves no room for the slash
snapshot: disks
mode: sim
setup: mkdir -p root/docs/guide root/mnt/data && truncate -s 5000 root/docs/guide/readme && : > root/docs/empty && truncate -s 7000 root/mnt/data/big
value: START printf '.'; printf '/.%.0s' $(seq 2047)
cwd: @TMP/root
run: vdu -a @START
exit: 0
--- stderr
path too long for '@START' (4096)
=== case a real directory at a start path of 4095 bytes is known: no room for the slash
snapshot: disks
mode: sim
setup: mkdir -p root && cd root && for i in $(seq 20); do d=$(printf 'd%.0s' $(seq 200)); mkdir $d && cd -P $d; done && mkdir $(printf 'e%.0s' $(seq 73))
value: START printf '.'; for i in $(seq 20); do printf '/'; printf 'd%.0s' $(seq 200); done; printf '/'; printf 'e%.0s' $(seq 73)
cwd: @TMP/root
run: vdu -s @START
exit: 0
--- stderr
path too long for '@START' (4096)
=== case a root with a long absolute path: what lies deep below it is counted
snapshot: long-root
mode: sim
setup: r=.; for i in $(seq 7); do r=$r/$(printf 'r%.0s' $(seq 250)); done; mkdir -p $r && cd $r && for i in $(seq 10); do d=$(printf 'd%.0s' $(seq 250)); mkdir $d && cd -P $d; done && truncate -s 10 f
value: ROOT printf '%s' @TMP; for i in $(seq 7); do printf '/'; printf 'r%.0s' $(seq 250); done
cwd: @ROOT
run: vdu -s
exit: 0
--- stdout
For '.':
                          ramdisk root:            0		(   12 inodes)
=== case an entry name that would take the path past 4095 bytes is skipped
snapshot: disks
mode: sim
setup: mkdir -p root && cd root && for i in $(seq 20); do d=$(printf 'd%.0s' $(seq 198)); mkdir $d && cd -P $d; done && truncate -s 10 $(printf 'n%.0s' $(seq 240)) && mkdir ok && truncate -s 20 ok/f
value: DEEP printf '.'; for i in $(seq 20); do printf '/'; printf 'd%.0s' $(seq 198); done
value: LONG printf 'n%.0s' $(seq 240)
cwd: @TMP/root
run: vdu -s
exit: 0
--- stdout
For '.':
                          ramdisk root:            0		(   23 inodes)
--- stderr
path too long for '@DEEP' '@LONG' (4222)
=== case a start path through a symbolic link and ".." is placed by where it leads
snapshot: disks
mode: sim
setup: mkdir -p root/docs/guide root/mnt/data elsewhere && truncate -s 5000 root/docs/guide/readme && : > root/docs/empty && truncate -s 7000 root/mnt/data/big && ln -s ../root/docs elsewhere/link
cwd: @TMP/elsewhere
run: vdu -a link/guide/..
exit: 0
--- stdout
For 'link/guide/../guide/readme':
                          ramdisk logs:         5000
For 'link/guide/../guide':
                     tardisk tools.t00:            0		(    1 inodes)
                          ramdisk logs:         5000		(    1 inodes)
For 'link/guide/..':
                          ramdisk root:            0		(    1 inodes)
                     tardisk tools.t00:            0		(    1 inodes)
                          ramdisk logs:         5000		(    1 inodes)
=== case what lies below a foreign folder is another file system, whatever rule names it
snapshot: rule-below-foreign
mode: sim
setup: mkdir -p root/docs/guide root/mnt/data && truncate -s 5000 root/docs/guide/readme && : > root/docs/empty && truncate -s 7000 root/mnt/data/big
cwd: @TMP/root
run: vdu -a mnt/data/big
exit: 0
=== case a relative root is taken relative to the snapshot file's folder, not the working folder
snapshot: relative-root
mode: sim
setup: mkdir -p root/docs/guide root/mnt/data && truncate -s 5000 root/docs/guide/readme && : > root/docs/empty && truncate -s 7000 root/mnt/data/big
cwd: @TMP/root
run: vdu -s
exit: 0
--- stdout
For '.':
                          ramdisk root:            0		(    2 inodes)
                     tardisk tools.t00:            0		(    1 inodes)
                          ramdisk logs:         5000		(    1 inodes)
=== case a relative root below a snapshot named by a relative path
snapshot: relative-root
mode: sim
setup: mkdir -p root/docs/guide root/mnt/data && truncate -s 5000 root/docs/guide/readme && : > root/docs/empty && truncate -s 7000 root/mnt/data/big
env: ORXKEL_SIMULATOR=../../snapshot.cache
cwd: @TMP/root/docs
run: vdu -d 0 guide
exit: 0
--- stdout
For 'guide':
                     tardisk tools.t00:            0		(    1 inodes)
                          ramdisk logs:         5000		(    1 inodes)
=== case -u: unlinked files, their count and total size
snapshot: unlinked
mode: sim
run: vdu -u
exit: 0
--- stdout
Unlinked files:
                         core.vmx-1234:   3221225472
                             hostd.log:   3221225472
a-file-name-longer-than-the-thirty-eight-columns:         1000
Total unlinked files: 3
Size of unlinked files:  6442451944
=== case -u -h; the operand is ignored
snapshot: unlinked
mode: sim
run: vdu -u -h /no/such/path
exit: 0
--- stdout
Unlinked files:
                         core.vmx-1234: 3072M
                             hostd.log: 3072M
a-file-name-longer-than-the-thirty-eight-columns: 1000B
Total unlinked files: 3
Size of unlinked files:  6144M
=== case -u: the last inode unreadable fails the report
snapshot: unlinked-last-unreadable
mode: sim
run: vdu -u
exit: 1
--- stdout
Unlinked files:
                         core.vmx-1234:   3221225472
                             hostd.log:   3221225472
Total unlinked files: 2
Size of unlinked files:  6442450944
=== case -u with no unlinked file
snapshot: all-linked
mode: sim
run: vdu -u
exit: 0
--- stdout
No unlinked files.
=== case -u with no inode at all
snapshot: no-inodes
mode: sim
run: vdu -u
exit: 0
--- stdout
No unlinked files.
=== case -u: inode list unreadable
snapshot: inodes-unreadable
mode: sim
run: vdu -u
exit: 1
=== case cache mode is refused
snapshot: disks
run: vdu -a
exit: 1
--- stderr
Using KEL cache is unsupported
=== case two operands: usage
snapshot: disks
mode: sim
run: vdu a b
exit: 1
--- stderr
Gather stats about corafs
corafsdu [filepath]
   -h       multiple instead of bytes
   -d depth reports for each element up to that depth (default 1)
   -a       equivalent to unlimited depth
   -s       equivalent to zero depth
   -u       display stats for unlinked files
=== case an unknown option: usage
snapshot: disks
mode: sim
run: vdu -x
exit: 1
--- stderr
vdu: invalid option -- 'x'
Gather stats about corafs
corafsdu [filepath]
   -h       multiple instead of bytes
   -d depth reports for each element up to that depth (default 1)
   -a       equivalent to unlimited depth
   -s       equivalent to zero depth
   -u       display stats for unlinked files

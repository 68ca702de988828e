vdf: the tardisk and ramdisk tables in the four views, the derived values
(rounding, Max of 0, more used than the minimum or the maximum, sizes of
4 GiB), SizeToString's boundaries, operands, and each failure.

Disks of the "disks" snapshot, by what they show:
  s.v00      5,000 bytes: 8 blocks of space, 4 used
  big.t00    4 GiB - 1 bytes: space 4 GiB exactly
  edge.m     1,048,576 bytes (1M)      edge.k   1,048,575 bytes (1023K)
  edge.kk    1,024 bytes (1K)          edge.b   1,023 bytes (1023B)
  gone.t00   its stats cannot be read: no row
  root       3 pages of a 1 MiB maximum: 1%; 36K peak
  zero       a maximum of 0: 100%
  over       4,096,000 bytes used of a 1 MiB minimum and 2 MiB maximum
  huge       4096 MiB minimum and maximum, 1 MiB used

=== snapshot disks
{"buildDate": "Nov 30 2026",
 "tree": {"system": {"corafs": {
   "tardisks": {
     "s.v00": {"stats": {"size": 5000, "bootModule": 1}},
     "big.t00": {"stats": {"size": 4294967295}},
     "edge.m": {"stats": {"size": 1048576}},
     "edge.k": {"stats": {"size": 1048575}},
     "edge.kk": {"stats": {"size": 1024}},
     "edge.b": {"stats": {"size": 1023}},
     "gone.t00": {"stats": {"$status": "0xbad0003"}}},
   "ramdisks": {
     "root": {"stats": {"minMiB": 1, "maxMiB": 1, "usedPages": 3, "peakPages": 9}},
     "zero": {"stats": {"minMiB": 0, "maxMiB": 0, "usedPages": 2, "peakPages": 2}},
     "over": {"stats": {"minMiB": 1, "maxMiB": 2, "usedPages": 1000, "peakPages": 1200}},
     "huge": {"stats": {"minMiB": 4096, "maxMiB": 4096, "usedPages": 256, "peakPages": 1048576}}}}}}}
=== snapshot empty
{"buildDate": "Nov 30 2026",
 "tree": {"system": {"corafs": {"tardisks": {}, "ramdisks": {}}}}}
=== snapshot no-tardisks extends disks
{"tree": {"system": {"corafs": {"tardisks": {"$listStatus": "0xbad0017"}}}}}
=== snapshot no-ramdisks extends disks
{"tree": {"system": {"corafs": {"ramdisks": {"$listStatus": "0xbad0014"}}}}}
=== case default view in 1 KiB blocks
snapshot: disks
run: vdf
exit: 0
--- stdout
Tardisk              1k-blocks      Used
s.v00                        8         4
big.t00                4194304   4194303
edge.m                    1024      1024
edge.k                    1024      1023
edge.kk                      4         1
edge.b                       4         0
-----
Ramdisk              1k-blocks      Used Available Use% Mounted on
root                      1024        12      1012   1% --
zero                         0         8         0 100% --
over                      2048      4000         0 195% --
huge                   4194304      1024   4193280   0% --
--- stderr
KEL_Get error for 'gone.t00' (Not found)
=== case -h: sizes as text, Space and Size headers
snapshot: disks
run: vdf -h
exit: 0
--- stdout
Tardisk                  Space      Used
s.v00                       8K        4K
big.t00                  4096M     4095M
edge.m                      1M        1M
edge.k                      1M     1023K
edge.kk                     4K        1K
edge.b                      4K     1023B
-----
Ramdisk                   Size      Used Available Use% Mounted on
root                        1M       12K     1012K   1% --
zero                        0B        8K        0B 100% --
over                        2M        3M        0B 195% --
huge                     4096M        1M     4095M   0% --
--- stderr
KEL_Get error for 'gone.t00' (Not found)
=== case -p: the resource-pool view
snapshot: disks
run: vdf -p
exit: 0
--- stdout
Tardisk                                       Used                         Space
s.v00                                            4                             8
big.t00                                    4194303                       4194304
edge.m                                        1024                          1024
edge.k                                        1023                          1024
edge.kk                                          1                             4
edge.b                                           0                             4
-----
Ramdisk                    Min       Max      Used  Sure avl Maybe avl Peak used
root                      1024      1024        12      1012      1012        36
zero                         0         0         8         0         0         8
over                      1024      2048      4000         0         0      4800
huge                   4194304   4194304      1024   4193280   4193280   4194304
--- stderr
KEL_Get error for 'gone.t00' (Not found)
=== case -p -h: the pool view in sizes; options may repeat
snapshot: disks
run: vdf -hp -h
exit: 0
--- stdout
Tardisk                                       Used                         Space
s.v00                                           4K                            8K
big.t00                                      4095M                         4096M
edge.m                                          1M                            1M
edge.k                                       1023K                            1M
edge.kk                                         1K                            4K
edge.b                                       1023B                            4K
-----
Ramdisk                    Min       Max      Used  Sure avl Maybe avl Peak used
root                        1M        1M       12K     1012K     1012K       36K
zero                        0B        0B        8K        0B        0B        8K
over                        1M        2M        3M        0B        0B        4M
huge                     4096M     4096M        1M     4095M     4095M     4096M
--- stderr
KEL_Get error for 'gone.t00' (Not found)
=== case empty lists: the two headers and the separator
snapshot: empty
run: vdf
exit: 0
--- stdout
Tardisk              1k-blocks      Used
-----
Ramdisk              1k-blocks      Used Available Use% Mounted on
=== case one operand is ignored after a note on the header's line
snapshot: empty
run: vdf /some/path
exit: 0
--- stdout
Argument not supported yet. Ignoring.Tardisk              1k-blocks      Used
-----
Ramdisk              1k-blocks      Used Available Use% Mounted on
=== case two operands: usage
snapshot: empty
run: vdf a b
exit: 1
--- stderr
Gather stats about corafs
corafsdf [filepath]
   -h       multiple instead of blocks
   -p       resource pool view
=== case an unknown option: getopt's word, then usage
snapshot: empty
run: vdf -x
exit: 1
--- stderr
vdf: invalid option -- 'x'
Gather stats about corafs
corafsdf [filepath]
   -h       multiple instead of blocks
   -p       resource pool view
=== case tardisk list not fetched: no separator, no ramdisk table
snapshot: no-tardisks
run: vdf
exit: 1
--- stdout
Tardisk              1k-blocks      Used
--- stderr
Error fetching tardisk list (Out of resources)
=== case ramdisk list not fetched: after its header
snapshot: no-ramdisks
run: vdf -h
exit: 1
--- stdout
Tardisk                  Space      Used
s.v00                       8K        4K
big.t00                  4096M     4095M
edge.m                      1M        1M
edge.k                      1M     1023K
edge.kk                     4K        1K
edge.b                      4K     1023B
-----
Ramdisk                   Size      Used Available Use% Mounted on
--- stderr
KEL_Get error for 'gone.t00' (Not found)
Error fetching ramdisk list (Out of memory)

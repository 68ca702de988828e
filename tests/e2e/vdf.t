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
=== case -h: sizes as text, Space and Size headers
snapshot: disks
run: vdf -h
=== case -p: the resource-pool view
snapshot: disks
run: vdf -p
=== case -p -h: the pool view in sizes; options may repeat
snapshot: disks
run: vdf -hp -h
=== case empty lists: the two headers and the separator
snapshot: empty
run: vdf
=== case one operand is ignored after a note on the header's line
snapshot: empty
run: vdf /some/path
=== case two operands: usage
snapshot: empty
run: vdf a b
=== case an unknown option: getopt's word, then usage
snapshot: empty
run: vdf -x
=== case tardisk list not fetched: no separator, no ramdisk table
snapshot: no-tardisks
run: vdf
=== case ramdisk list not fetched: after its header
snapshot: no-ramdisks
run: vdf -h
=== case live in the simulator as in cache mode
snapshot: empty
mode: sim
run: vdf -p

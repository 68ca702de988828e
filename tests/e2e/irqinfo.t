irqinfo: the interrupt table.  Header and per-CPU columns, the devices
column ("<ORX device>", "ORX device" for a key without text, the cut at 63
characters), a blank column for an unreadable count, the most CPUs the
table shows (4096), every failure message and the usage line.

=== snapshot three-cpus
{"buildDate": "Nov 30 2026",
 "tree": {"hardware": {
   "cpu": {"cpuInfo": {"numCpus": 3}},
   "interrupts": {"cookieList": {
     "0x10": {"UsageStatus": {"deviceFlag": 1},
              "PCPU": {"0": {"count": 5}, "1": {"count": 0}, "2": {"count": 12345678901}},
              "ORXDevices": {"ahci-0": {}, "nic-p1": {}}},
     "0x2": {"UsageStatus": {"deviceFlag": 0},
             "PCPU": {"0": {"count": 1}, "1": {"count": 2}, "2": {"count": 3}},
             "ORXDevices": {"timer": {}}},
     "0x11": {"UsageStatus": {"deviceFlag": 1},
              "PCPU": {"0": {"count": 7}, "1": {"count": 8}, "2": {"count": 9}},
              "ORXDevices": {"usb0": {}, "$int:4": {}}},
     "0x12345": {"UsageStatus": {"deviceFlag": 2},
                 "PCPU": {"0": {"count": 18446744073709551615}, "1": {"count": 1}, "2": {"count": 1}},
                 "ORXDevices": {}}}}}}}
=== snapshot no-cpus extends three-cpus
{"tree": {"hardware": {"cpu": {"cpuInfo": {"numCpus": 0}}}}}
=== snapshot many-devices
{"buildDate": "Nov 30 2026",
 "tree": {"hardware": {
   "cpu": {"cpuInfo": {"numCpus": 1}},
   "interrupts": {"cookieList": {
     "0x20": {"UsageStatus": {"deviceFlag": 1},
              "PCPU": {"0": {"count": 42}},
              "ORXDevices": {"ahci-0": {}, "ahci-1": {}, "nic-p0": {}, "nic-p1": {},
                             "nic-p2": {}, "nic-p3": {}, "nic-p4": {}, "nic-p5": {}}},
     "0x21": {"UsageStatus": {"deviceFlag": 1},
              "PCPU": {"0": {"count": 43}},
              "ORXDevices": {"a-device-name-that-is-long-enough-to-fill-the-column-by-itself": {}}}}}}}}
=== snapshot blank-count extends three-cpus
{"tree": {"hardware": {"interrupts": {"cookieList": {
   "0x10": {"PCPU": {"1": {"$status": "0xbad0001"}}},
   "0x11": {"PCPU": {"0": null}}}}}}}
=== snapshot no-cpu-record extends three-cpus
{"tree": {"hardware": {"cpu": null}}}
=== snapshot cookie-list-fails extends three-cpus
{"tree": {"hardware": {"interrupts": {"cookieList": {"$listStatus": "0xbad0017"}}}}}
=== snapshot usage-fails extends three-cpus
{"tree": {"hardware": {"interrupts": {"cookieList": {"0x11": {"UsageStatus": {"$status": 195887105}}}}}}}
=== snapshot devices-fail extends three-cpus
{"tree": {"hardware": {"interrupts": {"cookieList": {"0x2": {"ORXDevices": {"$listStatus": "0xbad0014"}}}}}}}
=== snapshot odd-cookie-kind extends three-cpus
{"tree": {"hardware": {"interrupts": {"cookieList": {"$kind:7:9": {}}}}}}
=== snapshot no-cookies
{"buildDate": "Nov 30 2026",
 "tree": {"hardware": {"cpu": {"cpuInfo": {"numCpus": 2}}, "interrupts": {"cookieList": {}}}}}
=== snapshot most-cpus extends three-cpus
{"tree": {"hardware": {"cpu": {"cpuInfo": {"numCpus": 4096}}}}}
=== snapshot too-many-cpus extends three-cpus
{"tree": {"hardware": {"cpu": {"cpuInfo": {"numCpus": 4097}}}}}
=== case three CPUs: counts, flag-zero cookie, key without text, no devices, wide cookie
snapshot: three-cpus
run: irqinfo
exit: 0
--- stdout
Cookie    PCPU  0    PCPU  1    PCPU  2 
0x0010:         5          0 12345678901 ORX ahci-0, ORX nic-p1
0x0002:         1          2          3 <ORX device>
0x0011:         7          8          9 ORX usb0, ORX device
0x12345:18446744073709551615          1          1 
=== case no CPUs: the header is "Cookie " alone and rows carry no counts
snapshot: no-cpus
run: irqinfo
exit: 0
--- stdout
Cookie 
0x0010:ORX ahci-0, ORX nic-p1
0x0002:<ORX device>
0x0011:ORX usb0, ORX device
0x12345:
=== case many devices are cut at 63 characters, even inside a name
snapshot: many-devices
run: irqinfo
exit: 0
--- stdout
Cookie    PCPU  0 
0x0020:        42 ORX ahci-0, ORX ahci-1, ORX nic-p0, ORX nic-p1, ORX nic-p2, ORX
0x0021:        43 ORX a-device-name-that-is-long-enough-to-fill-the-column-by-its
=== case an unreadable count leaves ten blanks and shifts the row left
snapshot: blank-count
run: irqinfo
exit: 0
--- stdout
Cookie    PCPU  0    PCPU  1    PCPU  2 
0x0010:         5           12345678901 ORX ahci-0, ORX nic-p1
0x0002:         1          2          3 <ORX device>
0x0011:                   8          9 ORX usb0, ORX device
0x12345:18446744073709551615          1          1 
=== case no cookies: the header alone
snapshot: no-cookies
run: irqinfo
exit: 0
--- stdout
Cookie    PCPU  0    PCPU  1 
=== case 4096 CPUs, the most the table shows: a column each, as for fewer
snapshot: most-cpus
run: irqinfo
check: @BIN/orxkeltools -c @CACHE irqinfo > out && test "$(wc -l < out)" = 5
check: { printf 'Cookie '; printf '   PCPU %2u ' $(seq 0 4095); echo; } > header && head -n 1 out | cmp - header
check: test "$(sed -n 2p out)" = "0x0010:         5          0 12345678901 $(printf '%40930s' '')ORX ahci-0, ORX nic-p1"
exit: 0
--- stdout (any)
=== case more than 4096 CPUs: refused before the header
snapshot: too-many-cpus
run: irqinfo
exit: 1
--- stderr
InterruptInfo: too many CPUs - 4097 (at most 4096)
=== case any argument, -h included, gives the usage line
snapshot: three-cpus
run: irqinfo -h
exit: 1
--- stderr
irqinfo:      List interrupt information
=== case the CPU record cannot be read
snapshot: no-cpu-record
run: irqinfo
exit: 1
--- stderr
InterruptInfo: error fetching number of CPUs - 0xbad0003
=== case the cookie list cannot be read: nothing on standard output
snapshot: cookie-list-fails
run: irqinfo
exit: 1
--- stderr
InterruptInfo: error fetching interrupt list - 0xbad0017
=== case a usage record cannot be read: the message names the cookie, earlier rows stay
snapshot: usage-fails
run: irqinfo
exit: 1
--- stdout
Cookie    PCPU  0    PCPU  1    PCPU  2 
0x0010:         5          0 12345678901 ORX ahci-0, ORX nic-p1
0x0002:         1          2          3 <ORX device>
--- stderr
InterruptInfo: error fetching interrupt info - 0x11
=== case the device list of a flag-zero cookie is still read and its failure ends the run
snapshot: devices-fail
run: irqinfo
exit: 1
--- stdout (no newline at end)
Cookie    PCPU  0    PCPU  1    PCPU  2 
0x0010:         5          0 12345678901 ORX ahci-0, ORX nic-p1
0x0002:         1          2          3 
--- stderr
InterruptInfo: error fetching interrupt device list - 0xbad0014
=== case a cookie key of an unsupported kind stops the tool
snapshot: odd-cookie-kind
run: irqinfo
exit: 1
--- stdout
Cookie    PCPU  0    PCPU  1    PCPU  2 
0x0010:         5          0 12345678901 ORX ahci-0, ORX nic-p1
0x0002:         1          2          3 <ORX device>
0x0011:         7          8          9 ORX usb0, ORX device
0x12345:18446744073709551615          1          1 
--- stderr
NOT_IMPLEMENTED apps/orxkeltools/keltools:178

lspci: the default, verbose, numeric and detailed forms, the module table,
the configuration space dumps, usage and every failure of the walk.

Names come from the machine's /usr/share/hwdata/pci.ids (Debian 12's
pci.ids 0.0~2023.04.11-1; see docs/pci-ids.md).  The cases use:
  8086 Intel Corporation: 1918 (host bridge), 1901 (PCIe controller),
    10fb with subsystem 8086:0003 "Ethernet Server Adapter X520-2" and
    without a known subsystem; ffee is no Intel device
  7777 is no vendor
  classes 0600 Host bridge, 0604 PCI bridge, 0200 Ethernet controller,
    0c0a (class 0c has no subclass 0a), 2000 (no such class)

=== snapshot pci
{"buildDate": "Nov 30 2026",
 "tree": {
  "hardware": {"pci": {"seg": {"0": {"bus": {
   "0": {"slot": {
    "0": {"func": {"0": {"pciConfigHeader": {
       "vendor": "0x8086", "device": "0x1918", "subvendor": "0x15d9", "subdevice": "0x0896",
       "classCode": "0x0600"}}}},
    "1": {"func": {"0": {"pciConfigHeader": {
       "vendor": "0x8086", "device": "0x1901", "subvendor": "0x15d9", "subdevice": "0x0896",
       "classCode": "0x0604", "isaIrq": 11, "irq": 16, "vector": 0, "intPin": 1,
       "irqFlags": 3, "spawnedBus": 1, "modeFlags": 4, "moduleId": "0xffffffff"}}}},
    "2": {"func": {
     "0": {"pciConfigHeader": {
       "vendor": "0x8086", "device": "0x10fb", "subvendor": "0x8086", "subdevice": "0x0003",
       "classCode": "0x0200", "isaIrq": 10, "irq": 255, "vector": "0x33", "intPin": 0,
       "irqFlags": 1, "modeFlags": 2, "moduleId": 6, "deviceName": "pnic0", "physSlot": 1}},
     "1": {"pciConfigHeader": {
       "vendor": "0x8086", "device": "0x10fb", "subvendor": "0x8086", "subdevice": "0x0000",
       "classCode": "0x0200", "isaIrq": 11, "irq": 17, "vector": "0x34", "intPin": 3,
       "irqFlags": 1, "modeFlags": 3, "moduleId": 99, "deviceName": "pnic1", "physSlot": 1}}}}}},
   "1": {"slot": {"0": {"func": {
     "0": {"pciConfigHeader": {
       "vendor": "0x8086", "device": "0xffee", "classCode": "0x0c0a", "modeFlags": 8,
       "moduleId": 5, "deviceName": "serial0"}},
     "1": {"pciConfigHeader": {
       "vendor": "0x7777", "device": "0x0001", "classCode": "0x2000",
       "deviceName": "abcdefghijklmnopqrstuvwxyz0123456"}}}}}}}}}}},
  "system": {"modules": {
   "5": {"general": {"name": "net-e1g", "id": 5}},
   "6": {"general": {"name": "net-x10g-with-a-long-module-nam", "id": 6}}}}}}
=== snapshot one
{"buildDate": "Nov 30 2026",
 "tree": {"hardware": {"pci": {"seg": {"0": {"bus": {"3": {"slot": {"0": {"func": {"0": {
   "pciConfigHeader": {"vendor": "0x144d", "device": "0xa808", "subvendor": "0x144d",
                       "subdevice": "0xa801", "classCode": "0x0108", "deviceName": "hba0"},
   "pciConfigSpace": {"bytes": "4d1408a8 06041000 01020801 10000000 008000fb 00000000 00000000 00000000 00000000 00000000 00000000 4d1401a8 00000000 40000000 00000000 0b010000"},
   "pciExtConfigSpace": {"bytes": "4d1408a8 06041000 01020801 10000000 01000100 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 00000000 01000300 000a0c00"}}}}}}}}}}}}}
=== snapshot example from ../../examples/host.json
=== snapshot modules-unlisted extends pci
{"tree": {"system": {"modules": {"$listStatus": "FAILURE"}}}}
=== snapshot module-unreadable extends pci
{"tree": {"system": {"modules": {"6": {"general": {"$status": "NOT_FOUND", "name": null, "id": null}}}}}}
=== snapshot no-modules extends pci
{"tree": {"system": {"modules": {"5": null, "6": null}}}}
=== snapshot one-no-config extends one
{"tree": {"hardware": {"pci": {"seg": {"0": {"bus": {"3": {"slot": {"0": {"func": {"0": {
   "pciConfigSpace": {"$status": "FAILURE", "bytes": null}}}}}}}}}}}}}
=== snapshot one-no-ext extends one
{"tree": {"hardware": {"pci": {"seg": {"0": {"bus": {"3": {"slot": {"0": {"func": {"0": {
   "pciExtConfigSpace": {"$status": "NO_MEMORY", "bytes": null}}}}}}}}}}}}}
=== snapshot seg-unlisted extends pci
{"tree": {"hardware": {"pci": {"seg": {"$listStatus": "FAILURE"}}}}}
=== snapshot no-segments extends pci
{"tree": {"hardware": {"pci": {"seg": {"0": null}}}}}
=== snapshot bus-unlisted extends pci
{"tree": {"hardware": {"pci": {"seg": {"0": {"bus": {"$listStatus": "0xbad0017"}}}}}}}
=== snapshot slot-unlisted extends pci
{"tree": {"hardware": {"pci": {"seg": {"0": {"bus": {"1": {"slot": {"$listStatus": "NOT_FOUND"}}}}}}}}}
=== snapshot func-unlisted extends pci
{"tree": {"hardware": {"pci": {"seg": {"0": {"bus": {"1": {"slot": {"0": {"func": {"$listStatus": "FAILURE"}}}}}}}}}}}
=== snapshot header-unreadable extends pci
{"tree": {"hardware": {"pci": {"seg": {"0": {"bus": {"1": {"slot": {"0": {"func": {"0": {
   "pciConfigHeader": {"$status": "NO_CARTEL", "vendor": null, "device": null, "classCode": null,
                       "modeFlags": null, "moduleId": null, "deviceName": null}}}}}}}}}}}}}
=== snapshot odd-key extends pci
{"tree": {"hardware": {"pci": {"seg": {"0": {"bus": {"1": {"slot": {"$kind:7:1": {}}}}}}}}}}
=== case the example host, default form
snapshot: example
run: lspci
exit: 0
--- stdout
0000:00:00.0 Host bridge: Intel Corporation Xeon E3-1200 v5/E3-1500 v5/6th Gen Core Processor Host Bridge/DRAM Registers 
0000:00:01.0 PCI bridge: Intel Corporation 6th-10th Gen Core Processor PCIe Controller (x16) 
0000:00:14.0 USB controller: Intel Corporation 100 Series/C230 Series Chipset Family USB 3.0 xHCI Controller [usb0]
0000:00:17.0 SATA controller: Intel Corporation Q170/Q150/B150/H170/H110/Z170/CM236 Chipset SATA Controller [AHCI Mode] [hba1]
0000:00:1c.0 PCI bridge: Intel Corporation 100 Series/C230 Series Chipset Family PCI Express Root Port #1 
0000:00:1c.1 PCI bridge: Intel Corporation 100 Series/C230 Series Chipset Family PCI Express Root Port #2 
0000:00:1f.0 ISA bridge: Intel Corporation C236 Chipset LPC/eSPI Controller 
0000:00:1f.4 SMBus: Intel Corporation 100 Series/C230 Series Chipset Family SMBus 
0000:01:00.0 Ethernet controller: Intel Corporation Ethernet Server Adapter X520-2 [pnic2]
0000:01:00.1 Ethernet controller: Intel Corporation Ethernet Server Adapter X520-2 [pnic3]
0000:02:00.0 Ethernet controller: Intel Corporation Ethernet Server Adapter I350-T2 [pnic0]
0000:02:00.1 Ethernet controller: Intel Corporation Ethernet Server Adapter I350-T2 [pnic1]
0000:03:00.0 Non-Volatile memory controller: Samsung Electronics Co Ltd SSD 970 EVO [hba0]
=== case names, the kernel's name in brackets, numeric stand-ins for unknown IDs
snapshot: pci
run: lspci
exit: 0
--- stdout
0000:00:00.0 Host bridge: Intel Corporation Xeon E3-1200 v5/E3-1500 v5/6th Gen Core Processor Host Bridge/DRAM Registers 
0000:00:01.0 PCI bridge: Intel Corporation 6th-10th Gen Core Processor PCIe Controller (x16) 
0000:00:02.0 Ethernet controller: Intel Corporation Ethernet Server Adapter X520-2 [pnic0]
0000:00:02.1 Ethernet controller: Intel Corporation 82599ES 10-Gigabit SFI/SFP+ Network Connection [pnic1]
0000:01:00.0 Serial bus controller: Intel Corporation Device ffee [serial0]
0000:01:00.1 Unknown class 2000: Vendor 7777 Device 0001 [abcdefghijklmnopqrstuvwxyz0123456]
=== case -v shows class and subclass names and adds a numeric line
snapshot: pci
run: lspci -v
exit: 0
--- stdout
0000:00:00.0 Bridge Host bridge: Intel Corporation Xeon E3-1200 v5/E3-1500 v5/6th Gen Core Processor Host Bridge/DRAM Registers 
	 Class 0600: 8086:1918

0000:00:01.0 Bridge PCI bridge: Intel Corporation 6th-10th Gen Core Processor PCIe Controller (x16) 
	 Class 0604: 8086:1901

0000:00:02.0 Network controller Ethernet controller: Intel Corporation Ethernet Server Adapter X520-2 [pnic0]
	 Class 0200: 8086:10fb

0000:00:02.1 Network controller Ethernet controller: Intel Corporation 82599ES 10-Gigabit SFI/SFP+ Network Connection [pnic1]
	 Class 0200: 8086:10fb

0000:01:00.0 Serial bus controller : Intel Corporation Device ffee [serial0]
	 Class 0c0a: 8086:ffee

0000:01:00.1 Unknown class 2000 : Vendor 7777 Device 0001 [abcdefghijklmnopqrstuvwxyz0123456]
	 Class 2000: 7777:0001

=== case long options; -n -v prints no verbose class line; words that are no options are passed over
snapshot: pci
run: lspci all --verbose of --nolookup them
exit: 0
--- stdout
0000:00:00.0 Class 0600: 8086:1918 
0000:00:01.0 Class 0604: 8086:1901 
0000:00:02.0 Class 0200: 8086:10fb [pnic0]
0000:00:02.1 Class 0200: 8086:10fb [pnic1]
0000:01:00.0 Class 0c0a: 8086:ffee [serial0]
0000:01:00.1 Class 2000: 7777:0001 [abcdefghijklmnopqrstuvwxyz0123456]
=== case -p (here --pciinfo, with -n and -v, which change nothing): every interrupt field form, mode letters, modules and the spawned bus
snapshot: pci
run: lspci --pciinfo -n -v
exit: 0
--- stdout
Segm:Bu:De.F Vend:Dvid Subv:Subd ISA/irq/Vect P M Module       Name    
                                 Spawned bus                           
0000:00:00.0 8086:1918 15d9:0896                U              
0000:00:01.0 8086:1901 15d9:0896  11/   /     B P              
                                  01           
0000:00:02.0 8086:10fb 8086:0003  10/   /0x33 A V net-x10g-with-a-long-module-nam pnic0
0000:00:02.1 8086:10fb 8086:0000  11/ 17/0x34 D C error        pnic1
0000:01:00.0 8086:ffee 0000:0000                U net-e1g      serial0
0000:01:00.1 7777:0001 0000:0000                U              abcdefghijklmnopqrstuvwxyz0123456
=== case usage with -h ends with status 1
snapshot: pci
run: lspci -h
exit: 1
--- stderr
lspci   -p --pciinfo   Print detailed info on all PCI devices
        -n --nolookup  Don't look up PCI device names and info
        -d --dump      Print hex dump of the standard config space
        -e --extdump   Print hex dump of the extended config space
        -v --verbose   Verbose information
        -h --help      Print this help message
=== case an unknown option
snapshot: pci
run: lspci -x
exit: 1
--- stderr
lspci: invalid option -- 'x'
lspci   -p --pciinfo   Print detailed info on all PCI devices
        -n --nolookup  Don't look up PCI device names and info
        -d --dump      Print hex dump of the standard config space
        -e --extdump   Print hex dump of the extended config space
        -v --verbose   Verbose information
        -h --help      Print this help message
=== case a module list that fails is tried again on every line that needs it
snapshot: modules-unlisted
run: lspci -p
exit: 0
--- stdout
Segm:Bu:De.F Vend:Dvid Subv:Subd ISA/irq/Vect P M Module       Name    
                                 Spawned bus                           
0000:00:00.0 8086:1918 15d9:0896                U              
0000:00:01.0 8086:1901 15d9:0896  11/   /     B P              
                                  01           
0000:00:02.0 8086:10fb 8086:0003  10/   /0x33 A V error        pnic0
0000:00:02.1 8086:10fb 8086:0000  11/ 17/0x34 D C error        pnic1
0000:01:00.0 8086:ffee 0000:0000                U error        serial0
0000:01:00.1 7777:0001 0000:0000                U              abcdefghijklmnopqrstuvwxyz0123456
--- stderr
ListModules: error fetching orvik module list - 0xbad0001
ListModules: error fetching orvik module list - 0xbad0001
ListModules: error fetching orvik module list - 0xbad0001
=== case an unreadable module record drops the table and is read again next time
snapshot: module-unreadable
run: lspci -p
exit: 0
--- stdout
Segm:Bu:De.F Vend:Dvid Subv:Subd ISA/irq/Vect P M Module       Name    
                                 Spawned bus                           
0000:00:00.0 8086:1918 15d9:0896                U              
0000:00:01.0 8086:1901 15d9:0896  11/   /     B P              
                                  01           
0000:00:02.0 8086:10fb 8086:0003  10/   /0x33 A V error        pnic0
0000:00:02.1 8086:10fb 8086:0000  11/ 17/0x34 D C error        pnic1
0000:01:00.0 8086:ffee 0000:0000                U error        serial0
0000:01:00.1 7777:0001 0000:0000                U              abcdefghijklmnopqrstuvwxyz0123456
--- stderr
ListModules: error fetching module info - 0xbad0003
ListModules: error fetching module info - 0xbad0003
ListModules: error fetching module info - 0xbad0003
=== case with no modules at all every module name is error, without a message
snapshot: no-modules
run: lspci -p
exit: 0
--- stdout
Segm:Bu:De.F Vend:Dvid Subv:Subd ISA/irq/Vect P M Module       Name    
                                 Spawned bus                           
0000:00:00.0 8086:1918 15d9:0896                U              
0000:00:01.0 8086:1901 15d9:0896  11/   /     B P              
                                  01           
0000:00:02.0 8086:10fb 8086:0003  10/   /0x33 A V error        pnic0
0000:00:02.1 8086:10fb 8086:0000  11/ 17/0x34 D C error        pnic1
0000:01:00.0 8086:ffee 0000:0000                U error        serial0
0000:01:00.1 7777:0001 0000:0000                U              abcdefghijklmnopqrstuvwxyz0123456
=== case -e -d: the standard space first, then the extended one
snapshot: one
run: lspci -e -d
exit: 0
--- stdout
0000:03:00.0 Non-Volatile memory controller: Samsung Electronics Co Ltd SSD 970 EVO [hba0]
00: 4d 14 08 a8 06 04 10 00 01 02 08 01 10 00 00 00
10: 00 80 00 fb 00 00 00 00 00 00 00 00 00 00 00 00
20: 00 00 00 00 00 00 00 00 00 00 00 00 4d 14 01 a8
30: 00 00 00 00 40 00 00 00 00 00 00 00 0b 01 00 00
40: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
50: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
60: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
70: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
80: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
90: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
a0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
b0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
c0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
d0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
e0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
f0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
00: 4d 14 08 a8 06 04 10 00 01 02 08 01 10 00 00 00
10: 01 00 01 00 00 00 00 00 00 00 00 00 00 00 00 00
20: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
30: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
40: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
50: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
60: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
70: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
80: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
90: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
a0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
b0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
c0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
d0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
e0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
f0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
100: 01 00 03 00 00 0a 0c 00 00 00 00 00 00 00 00 00
110: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
120: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
130: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
140: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
150: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
160: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
170: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
180: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
190: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
1a0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
1b0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
1c0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
1d0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
1e0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
1f0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
200: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
210: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
220: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
230: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
240: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
250: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
260: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
270: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
280: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
290: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
2a0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
2b0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
2c0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
2d0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
2e0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
2f0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
300: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
310: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
320: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
330: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
340: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
350: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
360: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
370: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
380: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
390: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
3a0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
3b0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
3c0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
3d0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
3e0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
3f0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
400: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
410: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
420: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
430: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
440: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
450: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
460: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
470: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
480: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
490: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
4a0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
4b0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
4c0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
4d0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
4e0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
4f0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
500: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
510: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
520: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
530: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
540: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
550: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
560: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
570: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
580: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
590: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
5a0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
5b0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
5c0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
5d0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
5e0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
5f0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
600: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
610: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
620: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
630: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
640: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
650: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
660: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
670: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
680: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
690: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
6a0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
6b0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
6c0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
6d0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
6e0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
6f0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
700: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
710: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
720: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
730: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
740: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
750: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
760: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
770: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
780: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
790: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
7a0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
7b0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
7c0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
7d0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
7e0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
7f0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
800: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
810: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
820: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
830: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
840: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
850: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
860: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
870: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
880: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
890: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
8a0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
8b0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
8c0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
8d0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
8e0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
8f0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
900: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
910: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
920: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
930: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
940: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
950: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
960: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
970: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
980: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
990: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
9a0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
9b0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
9c0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
9d0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
9e0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
9f0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
a00: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
a10: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
a20: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
a30: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
a40: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
a50: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
a60: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
a70: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
a80: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
a90: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
aa0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
ab0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
ac0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
ad0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
ae0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
af0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
b00: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
b10: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
b20: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
b30: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
b40: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
b50: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
b60: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
b70: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
b80: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
b90: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
ba0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
bb0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
bc0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
bd0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
be0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
bf0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
c00: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
c10: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
c20: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
c30: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
c40: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
c50: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
c60: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
c70: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
c80: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
c90: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
ca0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
cb0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
cc0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
cd0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
ce0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
cf0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
d00: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
d10: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
d20: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
d30: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
d40: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
d50: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
d60: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
d70: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
d80: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
d90: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
da0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
db0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
dc0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
dd0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
de0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
df0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
e00: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
e10: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
e20: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
e30: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
e40: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
e50: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
e60: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
e70: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
e80: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
e90: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
ea0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
eb0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
ec0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
ed0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
ee0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
ef0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
f00: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
f10: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
f20: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
f30: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
f40: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
f50: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
f60: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
f70: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
f80: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
f90: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
fa0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
fb0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
fc0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
fd0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
fe0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
ff0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
=== case -p -d reads the configuration space but dumps nothing
snapshot: one
run: lspci -p -d -e
exit: 0
--- stdout
Segm:Bu:De.F Vend:Dvid Subv:Subd ISA/irq/Vect P M Module       Name    
                                 Spawned bus                           
0000:03:00.0 144d:a808 144d:a801                U              hba0
=== case -p -d fails on a configuration space it cannot read
snapshot: one-no-config
run: lspci -p -d
exit: 1
--- stdout
Segm:Bu:De.F Vend:Dvid Subv:Subd ISA/irq/Vect P M Module       Name    
                                 Spawned bus                           
--- stderr
ListPCI: error fetching PCI configuration space 0xbad0001
=== case -d fails before the function's line
snapshot: one-no-config
run: lspci -d
exit: 1
--- stderr
ListPCI: error fetching PCI configuration space 0xbad0001
=== case -e fails on an extended space it cannot read
snapshot: one-no-ext
run: lspci -d -e
exit: 1
--- stderr
ListPCI: error fetching PCI configuration space 0xbad0014
=== case a failed segment list is a failure
snapshot: seg-unlisted
run: lspci
exit: 1
--- stderr
ListPCI: error fetching PCI seg list 0xbad0001
=== case no segments: nothing to list, status 0
snapshot: no-segments
run: lspci -p
exit: 0
--- stdout
Segm:Bu:De.F Vend:Dvid Subv:Subd ISA/irq/Vect P M Module       Name    
                                 Spawned bus                           
=== case a failed bus list is a failure
snapshot: bus-unlisted
run: lspci -p
exit: 1
--- stdout
Segm:Bu:De.F Vend:Dvid Subv:Subd ISA/irq/Vect P M Module       Name    
                                 Spawned bus                           
--- stderr
ListPCI: error fetching PCI bus list 0xbad0017
=== case a failed slot list ends the listing with status 1
snapshot: slot-unlisted
run: lspci
exit: 1
--- stdout
0000:00:00.0 Host bridge: Intel Corporation Xeon E3-1200 v5/E3-1500 v5/6th Gen Core Processor Host Bridge/DRAM Registers 
0000:00:01.0 PCI bridge: Intel Corporation 6th-10th Gen Core Processor PCIe Controller (x16) 
0000:00:02.0 Ethernet controller: Intel Corporation Ethernet Server Adapter X520-2 [pnic0]
0000:00:02.1 Ethernet controller: Intel Corporation 82599ES 10-Gigabit SFI/SFP+ Network Connection [pnic1]
--- stderr
ListPCI: error fetching PCI slot list 0xbad0003
=== case a failed function list ends the listing with status 1
snapshot: func-unlisted
run: lspci -n
exit: 1
--- stdout
0000:00:00.0 Class 0600: 8086:1918 
0000:00:01.0 Class 0604: 8086:1901 
0000:00:02.0 Class 0200: 8086:10fb [pnic0]
0000:00:02.1 Class 0200: 8086:10fb [pnic1]
--- stderr
ListPCI: error fetching PCI func list 0xbad0001
=== case a function record that cannot be read ends the listing with status 1
snapshot: header-unreadable
run: lspci
exit: 1
--- stdout
0000:00:00.0 Host bridge: Intel Corporation Xeon E3-1200 v5/E3-1500 v5/6th Gen Core Processor Host Bridge/DRAM Registers 
0000:00:01.0 PCI bridge: Intel Corporation 6th-10th Gen Core Processor PCIe Controller (x16) 
0000:00:02.0 Ethernet controller: Intel Corporation Ethernet Server Adapter X520-2 [pnic0]
0000:00:02.1 Ethernet controller: Intel Corporation 82599ES 10-Gigabit SFI/SFP+ Network Connection [pnic1]
--- stderr
ListPCI: error fetching PCI information 0xbad0062
=== case a key of a kind the tool cannot copy ends the process
snapshot: odd-key
run: lspci -n
exit: 1
--- stdout
0000:00:00.0 Class 0600: 8086:1918 
0000:00:01.0 Class 0604: 8086:1901 
0000:00:02.0 Class 0200: 8086:10fb [pnic0]
0000:00:02.1 Class 0200: 8086:10fb [pnic1]
0000:01:00.0 Class 0c0a: 8086:ffee [serial0]
0000:01:00.1 Class 2000: 7777:0001 [abcdefghijklmnopqrstuvwxyz0123456]
--- stderr
NOT_IMPLEMENTED apps/orxkeltools/keltools:178

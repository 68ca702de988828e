The shipped example host (examples/host.json): every command, with arguments
that find something, exits with 0 and prints what the host holds.

pkill, vdu and bootOption -c/-C need live mode and run through the simulator.
pkill runs with the recording mode, since the example's cartel IDs are made
up: the signals land in @TMP/sig and no process is signalled.  The example's
command lines are invented, so the simulator signals none of its cartels
unless a snapshot allows any process (example-any).  vdu walks a copy
of examples/corafs made next to the cache, where the example's relative
corafsRoot ("corafs") points; the cases name their paths from the case's
folder, so the root is the same whether it is taken relative to the snapshot
or to the working folder.  readdir order is the file system's, so the cases
print only directories whose report does not depend on it, and the whole
root's report is sorted.

Raw bytes (pci-info) go through od; the 4096-byte dumps of lspci -e leave out
their rows of zeros.

=== snapshot example from ../../examples/host.json
=== snapshot example-any extends example
{"simulator": {"signalAnyProcess": true}}
=== case ps: every world
snapshot: example
run: ps
exit: 0
--- stdout
WID   CID   WorldName       
1     0     idle0           
2     0     idle1           
3     0     idle2           
4     0     idle3           
5     0     tlbflush        
6     0     timer-wheel     
7     0     console         
8     0     logger          
9     0     netpoll-0       
10    0     netpoll-1       
11    0     netpoll-2       
12    0     netpoll-3       
13    0     storage-worker-0
14    0     storage-worker-1
15    0     storage-worker-2
16    0     storage-worker-3
17    0     nvme-completion 
18    0     ahci-completion 
19    0     usb-hub-event   
20    0     memsched        
21    0     page-reclaim    
22    0     corafs-flush    
23    0     heartbeat       
24    0     acpi-notify     
25    0     irq-balancer    
26    0     power-mgmt      
27    0     entropy         
28    0     helper-0        
29    0     helper-1        
30    0     helper-2        
31    0     smart-poller    
32    0     fs-journal      
1001  1001  initd           
1002  1002  hostd           
1003  1003  agentd          
1004  1004  sh              
1006  1006  bash            
1007  1007  python3         
1010  1002  hostd-worker    
1011  1002  hostd-worker    
1012  1002  hostd-io        
1013  1003  agentd-poll     
1014  1014  sleep           
1015  1015  cat             
2001  2001  initd           
2002  2002  syslogd         
2003  2003  ntpd            
2004  2002  syslogd-writer  

=== case ps: userworlds with state, used time and command line
snapshot: example
run: ps -u -s -T -c
exit: 0
--- stdout
WID   CID   WorldName       State   Wait    CPU   Time          Command
1001  1001  initd           WAIT    CHILD   0-3      38.337877  /sbin/initd
1002  1002  hostd           RUN     NONE    0-3      12.612811  /usr/sbin/hostd -c /etc/hostd/config.xml
1003  1003  agentd          WAIT    CHILD   0-3       6.543455  /usr/lib/agentd/agentd -d
1004  1004  sh              WAIT    CHILD   0-3      47.793944  /bin/sh /opt/scripts/collect.sh
1006  1006  bash            WAIT    CHILD   0-3      37.879115  /bin/bash /etc/init.d/watchdog.sh
1007  1007  python3         WAIT    EVENT   0-3      41.546030  /usr/bin/python3 /opt/scripts/parse.py --interval 30
1010  1002  hostd-worker    WAIT    TIMER   0-3      33.318812  /usr/sbin/hostd -c /etc/hostd/config.xml
1011  1002  hostd-worker    RUN     NONE    0-3      35.688141  /usr/sbin/hostd -c /etc/hostd/config.xml
1012  1002  hostd-io        SLEEP   TIMER   0-3      52.163940  /usr/sbin/hostd -c /etc/hostd/config.xml
1013  1003  agentd-poll                       /usr/lib/agentd/agentd -d
1014  1014  sleep           WAIT    TIMER   0-3      31.251012  /bin/sleep 60
1015  1015  cat             WAIT    SIGNAL  0-3      30.417688  /bin/cat /var/log/kernel.log
2001  2001  initd           WAIT    CHILD   0-3      20.122022  /sbin/initd
2002  2002  syslogd         WAIT    TIMER   0-3      53.314904  /usr/sbin/syslogd -n
2003  2003  ntpd            WAIT    TIMER   0-3      46.913722  /usr/sbin/ntpd -g -n -c /etc/ntp.conf
2004  2002  syslogd-writer  WAIT    IO      0-3      16.386039  /usr/sbin/syslogd -n

=== case ps: cartels with type, group and parent, and the summary
snapshot: example
run: ps -C -t -j -P -i
exit: 0
--- stdout
WID   CID   WorldName  GID  PCID  Type  
1001  1001  initd    7   0     U     
1002  1002  hostd    7   1001  U     
1003  1003  agentd   7   1001  U     
1004  1004  sh       7   1001  U     
1006  1006  bash     7   1001  U     
1007  1007  python3  7   1004  U     
1014  1014  sleep    7   1006  U     
1015  1015  cat      7   1007  U     
2001  2001  initd    8   0     U     
2002  2002  syslogd  8   2001  U     
2003  2003  ntpd     8   2001  U     

Total worlds:         11
Total printed worlds: 11
Total userspaces:     2
=== case pidof: two programs
snapshot: example
run: pidof hostd ntpd
exit: 0
--- stdout
1002 2003 
=== case pidof -x: the shell that runs a script
snapshot: example
run: pidof -x collect.sh
exit: 0
--- stdout
1004 
=== case pgrep -l: the cartels whose name matches, with their programs
snapshot: example
run: pgrep -l sh
exit: 0
--- stdout
1004 /bin/sh
1006 /bin/bash
=== case pgrep -f matches the command line
snapshot: example
run: pgrep -lf config.xml
exit: 0
--- stdout
1002 /usr/sbin/hostd -c /etc/hostd/config.xml
=== case pkill through the simulator: the example's invented command lines match no process here, so nothing is signalled
snapshot: example
mode: sim
env: ORXKEL_SIGNAL_RECORD=@TMP/sig
run: pkill -HUP agentd
check: test ! -e sig
exit: 0
=== case pkill through the simulator, recorded: HUP to agentd's cartel only
snapshot: example-any
mode: sim
env: ORXKEL_SIGNAL_RECORD=@TMP/sig
run: pkill -HUP agentd
check: test "$(cat sig)" = "1003 1"
exit: 0
=== case pkill -f: TERM to the shell that runs collect.sh
snapshot: example-any
mode: sim
env: ORXKEL_SIGNAL_RECORD=@TMP/sig
run: pkill -f collect.sh
check: test "$(cat sig)" = "1004 15"
exit: 0
=== case userspaceof
snapshot: example
run: userspaceof 2003
exit: 0
--- stdout
2 
=== case lsof: every cartel's descriptors and mappings
snapshot: example
run: lsof
exit: 0
--- stdout
Cartel    |      World name     |        Type         |   fd   |  Description     
----------+---------------------+---------------------+--------+------------------
1001        initd                 CHAR                        0   /dev/null
1001        initd                 CHAR                        1   /dev/null
1001        initd                 CHAR                        2   /dev/null
1001        initd                 CHAR                        3   /dev/console
1001        initd                 MMAP                        3   /sbin/initd (prot:R-/len:147456)
1001        initd                 MMAP                        3   /sbin/initd (prot:RW/len:12288)
1001        initd                 MMAP                        4   /lib/libc.so.6 (prot:R-/len:1798144)
1002        hostd                 CHAR                        0   /dev/null
1002        hostd                 CHAR                        1   /dev/null
1002        hostd                 CHAR                        2   /dev/null
1002        hostd                 FILE                        3   /var/log/hostd.log
1002        hostd                 SOCKET                      4   tcp 0.0.0.0:443 LISTEN
1002        hostd                 SOCKET                      5   unix /var/run/hostd.sock
1002        hostd                 PIPE                        7   pipe:[8123]
1002        hostd                 FILE                        9   /etc/hostd/config.xml
1002        hostd                 MMAP                        3   /usr/sbin/hostd (prot:R-/len:147456)
1002        hostd                 MMAP                        3   /usr/sbin/hostd (prot:RW/len:12288)
1002        hostd                 MMAP                        4   /lib/libc.so.6 (prot:R-/len:1798144)
1003        agentd                CHAR                        0   /dev/null
1003        agentd                CHAR                        1   /dev/null
1003        agentd                CHAR                        2   /dev/null
1003        agentd                FILE                        3   /var/log/agentd.log
1003        agentd                SOCKET                      4   tcp 10.20.0.15:52114 ESTABLISHED
1003        agentd                MMAP                        3   /usr/lib/agentd/agentd (prot:R-/len:147456)
1003        agentd                MMAP                        3   /usr/lib/agentd/agentd (prot:RW/len:12288)
1003        agentd                MMAP                        4   /lib/libc.so.6 (prot:R-/len:1798144)
1004        sh                    CHAR                        0   /dev/null
1004        sh                    FILE                        1   /var/log/collect.out
1004        sh                    CHAR                        2   /dev/null
1004        sh                    FILE                       10   /opt/scripts/collect.sh
1004        sh                    MMAP                        3   /bin/sh (prot:R-/len:147456)
1004        sh                    MMAP                        3   /bin/sh (prot:RW/len:12288)
1004        sh                    MMAP                        4   /lib/libc.so.6 (prot:R-/len:1798144)
1006        bash                  CHAR                        0   /dev/null
1006        bash                  CHAR                        1   /dev/null
1006        bash                  CHAR                        2   /dev/null
1006        bash                  FILE                      255   /etc/init.d/watchdog.sh
1006        bash                  MMAP                        3   /bin/bash (prot:R-/len:147456)
1006        bash                  MMAP                        3   /bin/bash (prot:RW/len:12288)
1006        bash                  MMAP                        4   /lib/libc.so.6 (prot:R-/len:1798144)
1007        python3               CHAR                        0   /dev/null
1007        python3               PIPE                        1   pipe:[9001]
1007        python3               CHAR                        2   /dev/null
1007        python3               FILE                        3   /opt/scripts/parse.py
1007        python3               MMAP                        3   /usr/bin/python3 (prot:R-/len:147456)
1007        python3               MMAP                        3   /usr/bin/python3 (prot:RW/len:12288)
1007        python3               MMAP                        4   /lib/libc.so.6 (prot:R-/len:1798144)
1014        sleep                 CHAR                        0   /dev/null
1014        sleep                 CHAR                        1   /dev/null
1014        sleep                 CHAR                        2   /dev/null
1015        cat                   CHAR                        0   /dev/null
1015        cat                   PIPE                        1   pipe:[9001]
1015        cat                   CHAR                        2   /dev/null
1015        cat                   FILE                        3   /var/log/kernel.log
2001        initd                 CHAR                        0   /dev/null
2001        initd                 CHAR                        1   /dev/null
2001        initd                 CHAR                        2   /dev/null
2001        initd                 MMAP                        3   /sbin/initd (prot:R-/len:147456)
2001        initd                 MMAP                        3   /sbin/initd (prot:RW/len:12288)
2001        initd                 MMAP                        4   /lib/libc.so.6 (prot:R-/len:1798144)
2002        syslogd               CHAR                        0   /dev/null
2002        syslogd               CHAR                        1   /dev/null
2002        syslogd               CHAR                        2   /dev/null
2002        syslogd               SOCKET                      3   unix /dev/log
2002        syslogd               FILE                        4   /var/log/messages
2002        syslogd               MMAP                        3   /usr/sbin/syslogd (prot:R-/len:147456)
2002        syslogd               MMAP                        3   /usr/sbin/syslogd (prot:RW/len:12288)
2002        syslogd               MMAP                        4   /lib/libc.so.6 (prot:R-/len:1798144)
2003        ntpd                  CHAR                        0   /dev/null
2003        ntpd                  CHAR                        1   /dev/null
2003        ntpd                  CHAR                        2   /dev/null
2003        ntpd                  SOCKET                      3   udp 0.0.0.0:123
2003        ntpd                  MMAP                        3   /usr/sbin/ntpd (prot:R-/len:147456)
2003        ntpd                  MMAP                        3   /usr/sbin/ntpd (prot:RW/len:12288)
2003        ntpd                  MMAP                        4   /lib/libc.so.6 (prot:R-/len:1798144)
=== case lspci -v
snapshot: example
run: lspci -v
exit: 0
--- stdout
0000:00:00.0 Bridge Host bridge: Intel Corporation Xeon E3-1200 v5/E3-1500 v5/6th Gen Core Processor Host Bridge/DRAM Registers 
	 Class 0600: 8086:1918

0000:00:01.0 Bridge PCI bridge: Intel Corporation 6th-10th Gen Core Processor PCIe Controller (x16) 
	 Class 0604: 8086:1901

0000:00:14.0 Serial bus controller USB controller: Intel Corporation 100 Series/C230 Series Chipset Family USB 3.0 xHCI Controller [usb0]
	 Class 0c03: 8086:a12f

0000:00:17.0 Mass storage controller SATA controller: Intel Corporation Q170/Q150/B150/H170/H110/Z170/CM236 Chipset SATA Controller [AHCI Mode] [hba1]
	 Class 0106: 8086:a102

0000:00:1c.0 Bridge PCI bridge: Intel Corporation 100 Series/C230 Series Chipset Family PCI Express Root Port #1 
	 Class 0604: 8086:a110

0000:00:1c.1 Bridge PCI bridge: Intel Corporation 100 Series/C230 Series Chipset Family PCI Express Root Port #2 
	 Class 0604: 8086:a111

0000:00:1f.0 Bridge ISA bridge: Intel Corporation C236 Chipset LPC/eSPI Controller 
	 Class 0601: 8086:a149

0000:00:1f.4 Serial bus controller SMBus: Intel Corporation 100 Series/C230 Series Chipset Family SMBus 
	 Class 0c05: 8086:a123

0000:01:00.0 Network controller Ethernet controller: Intel Corporation Ethernet Server Adapter X520-2 [pnic2]
	 Class 0200: 8086:10fb

0000:01:00.1 Network controller Ethernet controller: Intel Corporation Ethernet Server Adapter X520-2 [pnic3]
	 Class 0200: 8086:10fb

0000:02:00.0 Network controller Ethernet controller: Intel Corporation Ethernet Server Adapter I350-T2 [pnic0]
	 Class 0200: 8086:1521

0000:02:00.1 Network controller Ethernet controller: Intel Corporation Ethernet Server Adapter I350-T2 [pnic1]
	 Class 0200: 8086:1521

0000:03:00.0 Mass storage controller Non-Volatile memory controller: Samsung Electronics Co Ltd SSD 970 EVO [hba0]
	 Class 0108: 144d:a808

=== case lspci -p: interrupt routing, modules and the buses the bridges spawn
snapshot: example
run: lspci -p
exit: 0
--- stdout
Segm:Bu:De.F Vend:Dvid Subv:Subd ISA/irq/Vect P M Module       Name    
                                 Spawned bus                           
0000:00:00.0 8086:1918 15d9:0896                U              
0000:00:01.0 8086:1901 15d9:0896  11/   /     A U              
                                  01           
0000:00:14.0 8086:a12f 15d9:0896  11/ 16/0x37 A V usb-xhci     usb0
0000:00:17.0 8086:a102 15d9:0896  11/ 17/0x36 A V sata-ahci    hba1
0000:00:1c.0 8086:a110 15d9:0896  10/   /     A U              
                                  02           
0000:00:1c.1 8086:a111 15d9:0896  11/   /     B U              
                                  03           
0000:00:1f.0 8086:a149 15d9:0896                U              
0000:00:1f.4 8086:a123 15d9:0896   5/   /     A U              
0000:01:00.0 8086:10fb 8086:0003  11/ 16/0x33 A V net-x10g     pnic2
0000:01:00.1 8086:10fb 8086:0003  10/ 17/0x34 B V net-x10g     pnic3
0000:02:00.0 8086:1521 8086:0002  10/ 16/0x31 A V net-e1g      pnic0
0000:02:00.1 8086:1521 8086:0002  11/ 17/0x32 B V net-e1g      pnic1
0000:03:00.0 144d:a808 144d:a801  11/ 16/0x35 A V nvme-pcie    hba0
=== case lspci -d: every function's configuration space and its capability list
snapshot: example
run: lspci -d
exit: 0
--- stdout
0000:00:00.0 Host bridge: Intel Corporation Xeon E3-1200 v5/E3-1500 v5/6th Gen Core Processor Host Bridge/DRAM Registers 
00: 86 80 18 19 06 00 90 20 07 00 00 06 00 00 00 00
10: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
20: 00 00 00 00 00 00 00 00 00 00 00 00 d9 15 96 08
30: 00 00 00 00 e0 00 00 00 00 00 00 00 00 00 00 00
40: 00 00 00 00 00 00 00 00 01 00 d1 fe 00 00 00 00
50: c1 01 00 00 00 00 00 00 00 00 00 00 00 00 00 00
60: 01 00 00 e0 00 00 00 00 01 80 d1 fe 00 00 00 00
70: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
80: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
90: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
a0: 01 00 00 00 04 00 00 00 00 00 00 00 00 00 00 00
b0: 00 00 00 00 00 00 00 00 00 00 00 00 01 00 00 c0
c0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
d0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
e0: 09 00 10 01 00 00 00 00 00 00 00 00 00 00 00 00
f0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
0000:00:01.0 PCI bridge: Intel Corporation 6th-10th Gen Core Processor PCIe Controller (x16) 
00: 86 80 01 19 07 04 10 00 07 00 04 06 10 00 01 00
10: 00 00 00 00 00 00 00 00 00 01 01 00 e0 e0 00 20
20: e0 de f0 de f1 ff 01 00 00 00 00 00 00 00 00 00
30: 00 00 00 00 88 00 00 00 00 00 00 00 0b 01 02 00
40: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
50: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
60: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
70: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
80: 01 90 03 c8 08 00 00 00 0d 80 00 00 d9 15 96 08
90: 05 a0 80 00 00 00 00 00 00 00 00 00 00 00 00 00
a0: 10 00 42 01 01 80 00 00 2f 00 00 00 03 0d 10 02
b0: 40 00 82 30 80 25 08 00 00 00 40 00 00 00 00 00
c0: 00 00 00 00 36 08 00 00 20 04 00 00 0e 00 00 00
d0: 03 00 01 00 00 00 00 00 00 00 00 00 00 00 00 00
e0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
f0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
0000:00:14.0 USB controller: Intel Corporation 100 Series/C230 Series Chipset Family USB 3.0 xHCI Controller [usb0]
00: 86 80 2f a1 06 04 90 02 31 30 03 0c 00 00 00 00
10: 04 00 41 df 00 00 00 00 00 00 00 00 00 00 00 00
20: 00 00 00 00 00 00 00 00 00 00 00 00 d9 15 96 08
30: 00 00 00 00 70 00 00 00 00 00 00 00 0b 01 00 00
40: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
50: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
60: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
70: 01 80 c2 c1 08 00 00 00 00 00 00 00 00 00 00 00
80: 05 00 87 00 00 10 e0 fe 00 00 00 00 37 00 00 00
90: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
a0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
b0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
c0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
d0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
e0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
f0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
0000:00:17.0 SATA controller: Intel Corporation Q170/Q150/B150/H170/H110/Z170/CM236 Chipset SATA Controller [AHCI Mode] [hba1]
00: 86 80 02 a1 07 04 b0 02 31 01 06 01 00 00 00 00
10: 00 00 43 df 00 50 43 df 91 f0 00 00 81 f0 00 00
20: 61 f0 00 00 00 40 43 df 00 00 00 00 d9 15 96 08
30: 00 00 00 00 80 00 00 00 00 00 00 00 0b 01 00 00
40: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
50: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
60: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
70: 01 a8 03 00 08 00 00 00 00 00 00 00 00 00 00 00
80: 05 70 81 00 00 20 e0 fe 00 00 00 00 36 00 00 00
90: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
a0: 00 00 00 00 00 00 00 00 12 00 10 00 48 00 00 00
b0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
c0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
d0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
e0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
f0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
0000:00:1c.0 PCI bridge: Intel Corporation 100 Series/C230 Series Chipset Family PCI Express Root Port #1 
00: 86 80 10 a1 07 04 10 00 f1 00 04 06 10 00 81 00
10: 00 00 00 00 00 00 00 00 00 02 02 00 d0 d0 00 20
20: 10 df 30 df f1 ff 01 00 00 00 00 00 00 00 00 00
30: 00 00 00 00 40 00 00 00 00 00 00 00 0a 01 02 00
40: 10 80 42 01 01 80 00 00 2f 00 00 00 43 0c 10 01
50: 40 00 42 30 80 0c 10 00 00 00 40 00 00 00 00 00
60: 00 00 00 00 36 08 00 00 20 04 00 00 0e 00 00 00
70: 03 00 01 00 00 00 00 00 00 00 00 00 00 00 00 00
80: 05 90 80 00 00 00 00 00 00 00 00 00 00 00 00 00
90: 0d a0 00 00 d9 15 96 08 00 00 00 00 00 00 00 00
a0: 01 00 03 c8 08 00 00 00 00 00 00 00 00 00 00 00
b0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
c0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
d0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
e0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
f0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
0000:00:1c.1 PCI bridge: Intel Corporation 100 Series/C230 Series Chipset Family PCI Express Root Port #2 
00: 86 80 11 a1 07 04 10 00 f1 00 04 06 10 00 81 00
10: 00 00 00 00 00 00 00 00 00 03 03 00 f0 00 00 20
20: 00 df 00 df f1 ff 01 00 00 00 00 00 00 00 00 00
30: 00 00 00 00 40 00 00 00 00 00 00 00 0b 02 02 00
40: 10 80 42 01 01 80 00 00 2f 00 00 00 43 0c 10 02
50: 40 00 43 30 80 0c 18 00 00 00 40 00 00 00 00 00
60: 00 00 00 00 36 08 00 00 20 04 00 00 0e 00 00 00
70: 03 00 01 00 00 00 00 00 00 00 00 00 00 00 00 00
80: 05 90 80 00 00 00 00 00 00 00 00 00 00 00 00 00
90: 0d a0 00 00 d9 15 96 08 00 00 00 00 00 00 00 00
a0: 01 00 03 c8 08 00 00 00 00 00 00 00 00 00 00 00
b0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
c0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
d0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
e0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
f0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
0000:00:1f.0 ISA bridge: Intel Corporation C236 Chipset LPC/eSPI Controller 
00: 86 80 49 a1 07 04 10 02 31 00 01 06 00 00 80 00
10: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
20: 00 00 00 00 00 00 00 00 00 00 00 00 d9 15 96 08
30: 00 00 00 00 e0 00 00 00 00 00 00 00 00 00 00 00
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
e0: 09 00 0c 10 00 00 00 00 00 00 00 00 00 00 00 00
f0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
0000:00:1f.4 SMBus: Intel Corporation 100 Series/C230 Series Chipset Family SMBus 
00: 86 80 23 a1 03 00 90 02 31 00 05 0c 00 00 00 00
10: 04 60 43 df 00 00 00 00 00 00 00 00 00 00 00 00
20: a1 ef 00 00 00 00 00 00 00 00 00 00 d9 15 96 08
30: 00 00 00 00 50 00 00 00 00 00 00 00 05 01 00 00
40: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
50: 01 00 03 00 00 00 00 00 00 00 00 00 00 00 00 00
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
0000:01:00.0 Ethernet controller: Intel Corporation Ethernet Server Adapter X520-2 [pnic2]
00: 86 80 fb 10 07 04 10 00 01 00 00 02 10 00 80 00
10: 04 00 e8 de 00 00 00 00 21 e0 00 00 00 00 00 00
20: 04 40 f0 de 00 00 00 00 00 00 00 00 86 80 03 00
30: 00 00 00 00 40 00 00 00 00 00 00 00 0b 01 00 00
40: 01 50 23 c8 08 00 00 00 00 00 00 00 00 00 00 00
50: 05 70 80 00 00 00 00 00 00 00 00 00 00 00 00 00
60: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
70: 11 a0 3f 80 04 00 00 00 04 20 00 00 00 00 00 00
80: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
90: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
a0: 10 e0 02 00 c2 8c 00 10 3f 28 00 00 82 04 00 00
b0: 40 00 82 10 00 00 00 00 00 00 00 00 00 00 00 00
c0: 00 00 00 00 1f 00 00 00 00 00 00 00 00 00 00 00
d0: 02 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
e0: 03 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
f0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
0000:01:00.1 Ethernet controller: Intel Corporation Ethernet Server Adapter X520-2 [pnic3]
00: 86 80 fb 10 07 04 10 00 01 00 00 02 10 00 80 00
10: 04 00 e0 de 00 00 00 00 01 e0 00 00 00 00 00 00
20: 04 00 f0 de 00 00 00 00 00 00 00 00 86 80 03 00
30: 00 00 00 00 40 00 00 00 00 00 00 00 0a 02 00 00
40: 01 50 23 c8 08 00 00 00 00 00 00 00 00 00 00 00
50: 05 70 80 00 00 00 00 00 00 00 00 00 00 00 00 00
60: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
70: 11 a0 3f 80 04 00 00 00 04 20 00 00 00 00 00 00
80: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
90: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
a0: 10 e0 02 00 c2 8c 00 10 3f 28 00 00 82 04 00 00
b0: 40 00 82 10 00 00 00 00 00 00 00 00 00 00 00 00
c0: 00 00 00 00 1f 00 00 00 00 00 00 00 00 00 00 00
d0: 02 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
e0: 03 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
f0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
0000:02:00.0 Ethernet controller: Intel Corporation Ethernet Server Adapter I350-T2 [pnic0]
00: 86 80 21 15 07 04 10 00 01 00 00 02 10 00 80 00
10: 00 00 20 df 00 00 00 00 21 d0 00 00 00 40 30 df
20: 00 00 00 00 00 00 00 00 00 00 00 00 86 80 02 00
30: 00 00 00 00 40 00 00 00 00 00 00 00 0a 01 00 00
40: 01 50 23 c8 08 00 00 00 00 00 00 00 00 00 00 00
50: 05 70 80 00 00 00 00 00 00 00 00 00 00 00 00 00
60: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
70: 11 a0 09 80 03 00 00 00 03 20 00 00 00 00 00 00
80: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
90: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
a0: 10 e0 02 00 c2 8c 00 10 3f 28 00 00 42 0c 00 00
b0: 40 00 42 10 00 00 00 00 00 00 00 00 00 00 00 00
c0: 00 00 00 00 1f 00 00 00 00 00 00 00 00 00 00 00
d0: 02 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
e0: 03 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
f0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
0000:02:00.1 Ethernet controller: Intel Corporation Ethernet Server Adapter I350-T2 [pnic1]
00: 86 80 21 15 07 04 10 00 01 00 00 02 10 00 80 00
10: 00 00 10 df 00 00 00 00 01 d0 00 00 00 00 30 df
20: 00 00 00 00 00 00 00 00 00 00 00 00 86 80 02 00
30: 00 00 00 00 40 00 00 00 00 00 00 00 0b 02 00 00
40: 01 50 23 c8 08 00 00 00 00 00 00 00 00 00 00 00
50: 05 70 80 00 00 00 00 00 00 00 00 00 00 00 00 00
60: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
70: 11 a0 09 80 03 00 00 00 03 20 00 00 00 00 00 00
80: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
90: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
a0: 10 e0 02 00 c2 8c 00 10 3f 28 00 00 42 0c 00 00
b0: 40 00 42 10 00 00 00 00 00 00 00 00 00 00 00 00
c0: 00 00 00 00 1f 00 00 00 00 00 00 00 00 00 00 00
d0: 02 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
e0: 03 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
f0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
0000:03:00.0 Non-Volatile memory controller: Samsung Electronics Co Ltd SSD 970 EVO [hba0]
00: 4d 14 08 a8 06 04 10 00 00 02 08 01 10 00 00 00
10: 04 00 00 df 00 00 00 00 00 00 00 00 00 00 00 00
20: 00 00 00 00 00 00 00 00 00 00 00 00 4d 14 01 a8
30: 00 00 00 00 40 00 00 00 00 00 00 00 0b 01 00 00
40: 01 50 03 00 08 00 00 00 00 00 00 00 00 00 00 00
50: 05 70 8a 00 00 00 00 00 00 00 00 00 00 00 00 00
60: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
70: 10 b0 02 00 c1 8f 00 10 3f 28 00 00 43 0c 40 00
80: 40 00 43 10 00 00 00 00 00 00 00 00 00 00 00 00
90: 00 00 00 00 1f 00 70 00 00 04 00 00 0e 00 00 00
a0: 03 00 1e 00 00 00 00 00 00 00 00 00 00 00 00 00
b0: 11 00 20 80 00 30 00 00 00 20 00 00 00 00 00 00
c0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
d0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
e0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
f0: 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
=== case lspci -e: the extended spaces, rows of zeros left out
snapshot: example
exe: /bin/sh
argv: sh -c '"$0" -c "$1" lspci -e > dump && grep -E -v -x "[0-9a-f]+:( 00){16}" dump' @BIN/orxkeltools @CACHE
exit: 0
--- stdout
0000:00:00.0 Host bridge: Intel Corporation Xeon E3-1200 v5/E3-1500 v5/6th Gen Core Processor Host Bridge/DRAM Registers 
00: 86 80 18 19 06 00 90 20 07 00 00 06 00 00 00 00
20: 00 00 00 00 00 00 00 00 00 00 00 00 d9 15 96 08
30: 00 00 00 00 e0 00 00 00 00 00 00 00 00 00 00 00
40: 00 00 00 00 00 00 00 00 01 00 d1 fe 00 00 00 00
50: c1 01 00 00 00 00 00 00 00 00 00 00 00 00 00 00
60: 01 00 00 e0 00 00 00 00 01 80 d1 fe 00 00 00 00
a0: 01 00 00 00 04 00 00 00 00 00 00 00 00 00 00 00
b0: 00 00 00 00 00 00 00 00 00 00 00 00 01 00 00 c0
e0: 09 00 10 01 00 00 00 00 00 00 00 00 00 00 00 00
0000:00:01.0 PCI bridge: Intel Corporation 6th-10th Gen Core Processor PCIe Controller (x16) 
00: 86 80 01 19 07 04 10 00 07 00 04 06 10 00 01 00
10: 00 00 00 00 00 00 00 00 00 01 01 00 e0 e0 00 20
20: e0 de f0 de f1 ff 01 00 00 00 00 00 00 00 00 00
30: 00 00 00 00 88 00 00 00 00 00 00 00 0b 01 02 00
80: 01 90 03 c8 08 00 00 00 0d 80 00 00 d9 15 96 08
90: 05 a0 80 00 00 00 00 00 00 00 00 00 00 00 00 00
a0: 10 00 42 01 01 80 00 00 2f 00 00 00 03 0d 10 02
b0: 40 00 82 30 80 25 08 00 00 00 40 00 00 00 00 00
c0: 00 00 00 00 36 08 00 00 20 04 00 00 0e 00 00 00
d0: 03 00 01 00 00 00 00 00 00 00 00 00 00 00 00 00
100: 01 00 01 14 00 00 00 00 00 00 10 00 30 20 46 00
110: 00 00 00 00 00 20 00 00 a0 00 00 00 00 00 00 00
120: 00 00 00 00 00 00 00 00 00 00 00 00 07 00 00 00
140: 0d 00 01 22 1f 00 1d 00 00 00 00 00 00 00 00 00
220: 19 00 01 00 00 00 00 00 00 00 00 00 7f 7f 7f 7f
230: 7f 7f 7f 7f 7f 7f 7f 7f 7f 7f 7f 7f 7f 7f 7f 7f
240: 7f 7f 7f 7f 7f 7f 7f 7f 7f 7f 7f 7f 00 00 00 00
0000:00:14.0 USB controller: Intel Corporation 100 Series/C230 Series Chipset Family USB 3.0 xHCI Controller [usb0]
00: 86 80 2f a1 06 04 90 02 31 30 03 0c 00 00 00 00
10: 04 00 41 df 00 00 00 00 00 00 00 00 00 00 00 00
20: 00 00 00 00 00 00 00 00 00 00 00 00 d9 15 96 08
30: 00 00 00 00 70 00 00 00 00 00 00 00 0b 01 00 00
70: 01 80 c2 c1 08 00 00 00 00 00 00 00 00 00 00 00
80: 05 00 87 00 00 10 e0 fe 00 00 00 00 37 00 00 00
0000:00:17.0 SATA controller: Intel Corporation Q170/Q150/B150/H170/H110/Z170/CM236 Chipset SATA Controller [AHCI Mode] [hba1]
00: 86 80 02 a1 07 04 b0 02 31 01 06 01 00 00 00 00
10: 00 00 43 df 00 50 43 df 91 f0 00 00 81 f0 00 00
20: 61 f0 00 00 00 40 43 df 00 00 00 00 d9 15 96 08
30: 00 00 00 00 80 00 00 00 00 00 00 00 0b 01 00 00
70: 01 a8 03 00 08 00 00 00 00 00 00 00 00 00 00 00
80: 05 70 81 00 00 20 e0 fe 00 00 00 00 36 00 00 00
a0: 00 00 00 00 00 00 00 00 12 00 10 00 48 00 00 00
0000:00:1c.0 PCI bridge: Intel Corporation 100 Series/C230 Series Chipset Family PCI Express Root Port #1 
00: 86 80 10 a1 07 04 10 00 f1 00 04 06 10 00 81 00
10: 00 00 00 00 00 00 00 00 00 02 02 00 d0 d0 00 20
20: 10 df 30 df f1 ff 01 00 00 00 00 00 00 00 00 00
30: 00 00 00 00 40 00 00 00 00 00 00 00 0a 01 02 00
40: 10 80 42 01 01 80 00 00 2f 00 00 00 43 0c 10 01
50: 40 00 42 30 80 0c 10 00 00 00 40 00 00 00 00 00
60: 00 00 00 00 36 08 00 00 20 04 00 00 0e 00 00 00
70: 03 00 01 00 00 00 00 00 00 00 00 00 00 00 00 00
80: 05 90 80 00 00 00 00 00 00 00 00 00 00 00 00 00
90: 0d a0 00 00 d9 15 96 08 00 00 00 00 00 00 00 00
a0: 01 00 03 c8 08 00 00 00 00 00 00 00 00 00 00 00
100: 01 00 01 14 00 00 00 00 00 00 10 00 30 20 46 00
110: 00 00 00 00 00 20 00 00 a0 00 00 00 00 00 00 00
120: 00 00 00 00 00 00 00 00 00 00 00 00 07 00 00 00
140: 0d 00 01 22 1f 00 1d 00 00 00 00 00 00 00 00 00
220: 19 00 01 00 00 00 00 00 00 00 00 00 7f 7f 7f 7f
230: 7f 7f 7f 7f 00 00 00 00 00 00 00 00 00 00 00 00
0000:00:1c.1 PCI bridge: Intel Corporation 100 Series/C230 Series Chipset Family PCI Express Root Port #2 
00: 86 80 11 a1 07 04 10 00 f1 00 04 06 10 00 81 00
10: 00 00 00 00 00 00 00 00 00 03 03 00 f0 00 00 20
20: 00 df 00 df f1 ff 01 00 00 00 00 00 00 00 00 00
30: 00 00 00 00 40 00 00 00 00 00 00 00 0b 02 02 00
40: 10 80 42 01 01 80 00 00 2f 00 00 00 43 0c 10 02
50: 40 00 43 30 80 0c 18 00 00 00 40 00 00 00 00 00
60: 00 00 00 00 36 08 00 00 20 04 00 00 0e 00 00 00
70: 03 00 01 00 00 00 00 00 00 00 00 00 00 00 00 00
80: 05 90 80 00 00 00 00 00 00 00 00 00 00 00 00 00
90: 0d a0 00 00 d9 15 96 08 00 00 00 00 00 00 00 00
a0: 01 00 03 c8 08 00 00 00 00 00 00 00 00 00 00 00
100: 01 00 01 14 00 00 00 00 00 00 10 00 30 20 46 00
110: 00 00 00 00 00 20 00 00 a0 00 00 00 00 00 00 00
120: 00 00 00 00 00 00 00 00 00 00 00 00 07 00 00 00
140: 0d 00 01 22 1f 00 1d 00 00 00 00 00 00 00 00 00
220: 19 00 01 00 00 00 00 00 00 00 00 00 7f 7f 7f 7f
230: 7f 7f 7f 7f 00 00 00 00 00 00 00 00 00 00 00 00
0000:00:1f.0 ISA bridge: Intel Corporation C236 Chipset LPC/eSPI Controller 
00: 86 80 49 a1 07 04 10 02 31 00 01 06 00 00 80 00
20: 00 00 00 00 00 00 00 00 00 00 00 00 d9 15 96 08
30: 00 00 00 00 e0 00 00 00 00 00 00 00 00 00 00 00
e0: 09 00 0c 10 00 00 00 00 00 00 00 00 00 00 00 00
0000:00:1f.4 SMBus: Intel Corporation 100 Series/C230 Series Chipset Family SMBus 
00: 86 80 23 a1 03 00 90 02 31 00 05 0c 00 00 00 00
10: 04 60 43 df 00 00 00 00 00 00 00 00 00 00 00 00
20: a1 ef 00 00 00 00 00 00 00 00 00 00 d9 15 96 08
30: 00 00 00 00 50 00 00 00 00 00 00 00 05 01 00 00
50: 01 00 03 00 00 00 00 00 00 00 00 00 00 00 00 00
0000:01:00.0 Ethernet controller: Intel Corporation Ethernet Server Adapter X520-2 [pnic2]
00: 86 80 fb 10 07 04 10 00 01 00 00 02 10 00 80 00
10: 04 00 e8 de 00 00 00 00 21 e0 00 00 00 00 00 00
20: 04 40 f0 de 00 00 00 00 00 00 00 00 86 80 03 00
30: 00 00 00 00 40 00 00 00 00 00 00 00 0b 01 00 00
40: 01 50 23 c8 08 00 00 00 00 00 00 00 00 00 00 00
50: 05 70 80 00 00 00 00 00 00 00 00 00 00 00 00 00
70: 11 a0 3f 80 04 00 00 00 04 20 00 00 00 00 00 00
a0: 10 e0 02 00 c2 8c 00 10 3f 28 00 00 82 04 00 00
b0: 40 00 82 10 00 00 00 00 00 00 00 00 00 00 00 00
c0: 00 00 00 00 1f 00 00 00 00 00 00 00 00 00 00 00
d0: 02 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
e0: 03 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
100: 01 00 02 14 00 00 00 00 00 00 10 00 30 20 46 00
110: 00 00 00 00 00 20 00 00 a0 00 00 00 00 00 00 00
140: 03 00 01 15 40 3a 5e ff ff 21 1b 00 00 00 00 00
150: 0e 00 01 16 00 01 00 00 00 00 00 00 00 00 00 00
160: 10 00 01 00 02 00 00 00 00 00 00 00 40 00 40 00
170: 00 00 00 00 80 01 02 00 00 00 ed 10 53 05 00 00
180: 01 00 00 00 0c 00 00 00 00 00 00 00 00 00 00 00
190: 0c 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
0000:01:00.1 Ethernet controller: Intel Corporation Ethernet Server Adapter X520-2 [pnic3]
00: 86 80 fb 10 07 04 10 00 01 00 00 02 10 00 80 00
10: 04 00 e0 de 00 00 00 00 01 e0 00 00 00 00 00 00
20: 04 00 f0 de 00 00 00 00 00 00 00 00 86 80 03 00
30: 00 00 00 00 40 00 00 00 00 00 00 00 0a 02 00 00
40: 01 50 23 c8 08 00 00 00 00 00 00 00 00 00 00 00
50: 05 70 80 00 00 00 00 00 00 00 00 00 00 00 00 00
70: 11 a0 3f 80 04 00 00 00 04 20 00 00 00 00 00 00
a0: 10 e0 02 00 c2 8c 00 10 3f 28 00 00 82 04 00 00
b0: 40 00 82 10 00 00 00 00 00 00 00 00 00 00 00 00
c0: 00 00 00 00 1f 00 00 00 00 00 00 00 00 00 00 00
d0: 02 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
e0: 03 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
100: 01 00 02 14 00 00 00 00 00 00 10 00 30 20 46 00
110: 00 00 00 00 00 20 00 00 a0 00 00 00 00 00 00 00
140: 03 00 01 15 40 3a 5e ff ff 21 1b 00 00 00 00 00
150: 0e 00 01 16 00 00 00 00 00 00 00 00 00 00 00 00
160: 10 00 01 00 02 00 00 00 00 00 00 00 40 00 40 00
170: 00 00 00 00 80 01 02 00 00 00 ed 10 53 05 00 00
180: 01 00 00 00 0c 00 00 00 00 00 00 00 00 00 00 00
190: 0c 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
0000:02:00.0 Ethernet controller: Intel Corporation Ethernet Server Adapter I350-T2 [pnic0]
00: 86 80 21 15 07 04 10 00 01 00 00 02 10 00 80 00
10: 00 00 20 df 00 00 00 00 21 d0 00 00 00 40 30 df
20: 00 00 00 00 00 00 00 00 00 00 00 00 86 80 02 00
30: 00 00 00 00 40 00 00 00 00 00 00 00 0a 01 00 00
40: 01 50 23 c8 08 00 00 00 00 00 00 00 00 00 00 00
50: 05 70 80 00 00 00 00 00 00 00 00 00 00 00 00 00
70: 11 a0 09 80 03 00 00 00 03 20 00 00 00 00 00 00
a0: 10 e0 02 00 c2 8c 00 10 3f 28 00 00 42 0c 00 00
b0: 40 00 42 10 00 00 00 00 00 00 00 00 00 00 00 00
c0: 00 00 00 00 1f 00 00 00 00 00 00 00 00 00 00 00
d0: 02 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
e0: 03 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
100: 01 00 02 14 00 00 00 00 00 00 10 00 30 20 46 00
110: 00 00 00 00 00 20 00 00 a0 00 00 00 00 00 00 00
140: 03 00 01 15 10 6c 4a ff ff 21 1b 00 00 00 00 00
150: 0e 00 01 16 00 01 00 00 00 00 00 00 00 00 00 00
160: 10 00 01 00 02 00 00 00 00 00 00 00 08 00 08 00
170: 00 00 00 00 80 01 04 00 00 00 20 15 53 05 00 00
180: 01 00 00 00 0c 00 00 00 00 00 00 00 00 00 00 00
190: 0c 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
0000:02:00.1 Ethernet controller: Intel Corporation Ethernet Server Adapter I350-T2 [pnic1]
00: 86 80 21 15 07 04 10 00 01 00 00 02 10 00 80 00
10: 00 00 10 df 00 00 00 00 01 d0 00 00 00 00 30 df
20: 00 00 00 00 00 00 00 00 00 00 00 00 86 80 02 00
30: 00 00 00 00 40 00 00 00 00 00 00 00 0b 02 00 00
40: 01 50 23 c8 08 00 00 00 00 00 00 00 00 00 00 00
50: 05 70 80 00 00 00 00 00 00 00 00 00 00 00 00 00
70: 11 a0 09 80 03 00 00 00 03 20 00 00 00 00 00 00
a0: 10 e0 02 00 c2 8c 00 10 3f 28 00 00 42 0c 00 00
b0: 40 00 42 10 00 00 00 00 00 00 00 00 00 00 00 00
c0: 00 00 00 00 1f 00 00 00 00 00 00 00 00 00 00 00
d0: 02 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
e0: 03 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
100: 01 00 02 14 00 00 00 00 00 00 10 00 30 20 46 00
110: 00 00 00 00 00 20 00 00 a0 00 00 00 00 00 00 00
140: 03 00 01 15 10 6c 4a ff ff 21 1b 00 00 00 00 00
150: 0e 00 01 16 00 00 00 00 00 00 00 00 00 00 00 00
160: 10 00 01 00 02 00 00 00 00 00 00 00 08 00 08 00
170: 00 00 00 00 80 01 04 00 00 00 20 15 53 05 00 00
180: 01 00 00 00 0c 00 00 00 00 00 00 00 00 00 00 00
190: 0c 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
0000:03:00.0 Non-Volatile memory controller: Samsung Electronics Co Ltd SSD 970 EVO [hba0]
00: 4d 14 08 a8 06 04 10 00 00 02 08 01 10 00 00 00
10: 04 00 00 df 00 00 00 00 00 00 00 00 00 00 00 00
20: 00 00 00 00 00 00 00 00 00 00 00 00 4d 14 01 a8
30: 00 00 00 00 40 00 00 00 00 00 00 00 0b 01 00 00
40: 01 50 03 00 08 00 00 00 00 00 00 00 00 00 00 00
50: 05 70 8a 00 00 00 00 00 00 00 00 00 00 00 00 00
70: 10 b0 02 00 c1 8f 00 10 3f 28 00 00 43 0c 40 00
80: 40 00 43 10 00 00 00 00 00 00 00 00 00 00 00 00
90: 00 00 00 00 1f 00 70 00 00 04 00 00 0e 00 00 00
a0: 03 00 1e 00 00 00 00 00 00 00 00 00 00 00 00 00
b0: 11 00 20 80 00 30 00 00 00 20 00 00 00 00 00 00
100: 01 00 82 14 00 00 00 00 00 00 10 00 30 20 46 00
110: 00 00 00 00 00 20 00 00 a0 00 00 00 00 00 00 00
140: 00 00 00 00 00 00 00 00 04 00 81 15 00 00 00 00
150: 00 00 00 00 01 00 00 00 19 00 81 17 00 00 00 00
160: 00 00 00 00 7f 7f 7f 7f 7f 7f 7f 7f 00 00 00 00
170: 00 00 00 00 00 00 00 00 18 00 01 18 03 10 03 10
180: 1e 00 01 00 1f 28 28 00 0f 28 60 40 28 00 00 00
=== case pci-info -i -S: the NVMe drive's IRQ and physical slot
snapshot: example
run: pci-info -b 3 -s 0 -f 0 -i -S
exit: 0
--- stdout (no newline at end)
 16  3
=== case pci-info -c -e: raw bytes, the standard space first
snapshot: example
exe: /bin/sh
argv: sh -c '"$0" -c "$1" pci-info -b 2 -s 0 -f 0 -c -e > raw && od -A x -t x1 raw' @BIN/orxkeltools @CACHE
exit: 0
--- stdout
000000 86 80 21 15 07 04 10 00 01 00 00 02 10 00 80 00
000010 00 00 20 df 00 00 00 00 21 d0 00 00 00 40 30 df
000020 00 00 00 00 00 00 00 00 00 00 00 00 86 80 02 00
000030 00 00 00 00 40 00 00 00 00 00 00 00 0a 01 00 00
000040 01 50 23 c8 08 00 00 00 00 00 00 00 00 00 00 00
000050 05 70 80 00 00 00 00 00 00 00 00 00 00 00 00 00
000060 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
000070 11 a0 09 80 03 00 00 00 03 20 00 00 00 00 00 00
000080 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
*
0000a0 10 e0 02 00 c2 8c 00 10 3f 28 00 00 42 0c 00 00
0000b0 40 00 42 10 00 00 00 00 00 00 00 00 00 00 00 00
0000c0 00 00 00 00 1f 00 00 00 00 00 00 00 00 00 00 00
0000d0 02 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
0000e0 03 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
0000f0 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
000100 86 80 21 15 07 04 10 00 01 00 00 02 10 00 80 00
000110 00 00 20 df 00 00 00 00 21 d0 00 00 00 40 30 df
000120 00 00 00 00 00 00 00 00 00 00 00 00 86 80 02 00
000130 00 00 00 00 40 00 00 00 00 00 00 00 0a 01 00 00
000140 01 50 23 c8 08 00 00 00 00 00 00 00 00 00 00 00
000150 05 70 80 00 00 00 00 00 00 00 00 00 00 00 00 00
000160 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
000170 11 a0 09 80 03 00 00 00 03 20 00 00 00 00 00 00
000180 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
*
0001a0 10 e0 02 00 c2 8c 00 10 3f 28 00 00 42 0c 00 00
0001b0 40 00 42 10 00 00 00 00 00 00 00 00 00 00 00 00
0001c0 00 00 00 00 1f 00 00 00 00 00 00 00 00 00 00 00
0001d0 02 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
0001e0 03 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
0001f0 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
000200 01 00 02 14 00 00 00 00 00 00 10 00 30 20 46 00
000210 00 00 00 00 00 20 00 00 a0 00 00 00 00 00 00 00
000220 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
*
000240 03 00 01 15 10 6c 4a ff ff 21 1b 00 00 00 00 00
000250 0e 00 01 16 00 01 00 00 00 00 00 00 00 00 00 00
000260 10 00 01 00 02 00 00 00 00 00 00 00 08 00 08 00
000270 00 00 00 00 80 01 04 00 00 00 20 15 53 05 00 00
000280 01 00 00 00 0c 00 00 00 00 00 00 00 00 00 00 00
000290 0c 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
0002a0 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00 00
*
001100
=== case irqinfo: one row per vector, the devices of lspci -p
snapshot: example
run: irqinfo
exit: 0
--- stdout
Cookie    PCPU  0    PCPU  1    PCPU  2    PCPU  3 
0x0020:  35678901   35678744   35679012   35678650 <ORX device>
0x0031:   1204511         88          0        402 ORX pnic0
0x0032:         0      93412         17          0 ORX pnic1
0x0033:      5512          0    2210934          0 ORX pnic2
0x0034:         0          0          0       3123 ORX pnic3
0x0035:    812003     799412     801276     815990 ORX hba0
0x0036:     21877          0          0          0 ORX hba1
0x0037:       301          0         12          0 ORX usb0, ORX usbkbd0
=== case amldump writes the ACPI tables into the working folder
snapshot: example
run: amldump
check: for t in APIC FACP DSDT SSDT SSDT-1; do test -s $t.aml || exit 1; done
check: test "$(head -c 4 DSDT.aml)" = DSDT
exit: 0
--- stdout
Writing file APIC.aml
Writing file FACP.aml
Writing file DSDT.aml
Writing file SSDT.aml
Writing file SSDT-1.aml
=== case hwclock
snapshot: example
run: hwclock
exit: 0
--- stdout
14:03:27   11/16/2026   UTC
=== case hwclock -t through the simulator; the next run reads the new time
snapshot: example
mode: sim
run: hwclock -t 09:30:00
check: test "$(ORXKEL_SIMULATOR=@CACHE @BIN/orxkeltools hwclock)" = "09:30:00   11/16/2026   UTC"
exit: 0
--- stdout
Clock updated.
Time: 09:30:00   Date: 11/16/2026   UTC
=== case uptime: four days, the load of four PCPUs
snapshot: example
run: uptime
check: @SRC/tests/e2e/timeofday.sh ' hh:mm:ss up 4 days, 03:06:29, load average: 0.06, 0.04, 0.03\n' @BIN/orxkeltools -c @CACHE uptime
exit: 0
--- stdout (any)
=== case halvex -v
snapshot: example
run: halvex -v
exit: 0
--- stdout
Orvik 9.1.0 build-24151234
=== case halvex -l
snapshot: example
run: halvex -l
exit: 0
--- stdout
Orvik 9.1.0 GA
=== case bootOption: switches, kernel, options, boot modules and files
snapshot: example
run: bootOption -a -p -k -o -m -b
exit: 0
--- stdout
FS Check : 1
Audit Mode : 0
Booted after rollback : 0
Booted via (g)PXE : 1
Kernel : /boot/orvik.gz
Options : console=com1 noquiet
Modules : core.tgz drivers.tgz 
Boot Option Files : boot.cfg state.cfg 
=== case bootOption -C through the simulator: every boot option file
snapshot: example
mode: sim
run: bootOption -C
exit: 0
--- stdout
Boot Option File Content boot.cfg : bootstate=0 title=Loading Orvik timeout=5 prefix= kernel=/boot/orvik.gz kernelopt=console=com1 noquiet modules=/boot/core.tgz --- /boot/drivers.tgz build=9.1.0-24151234 updated=2 
Boot Option File Content state.cfg : # boot state, written at shutdown lastBoot=2026-11-12T06:41:09Z cleanShutdown=1 
=== case bootOption -c through the simulator, raw
snapshot: example
mode: sim
run: bootOption -r -c state.cfg
exit: 0
--- stdout
# boot state, written at shutdown lastBoot=2026-11-12T06:41:09Z cleanShutdown=1 
=== case vdf
snapshot: example
run: vdf
exit: 0
--- stdout
Tardisk              1k-blocks      Used
core.tgz                 57344     57344
drivers.tgz              22528     22528
tools.tgz                 9216      9216
agent.tgz                 4096      4096
-----
Ramdisk              1k-blocks      Used Available Use% Mounted on
root                     32768      7340     25428  22% --
etc                      49152      3908     45244   7% --
tmp                     196608        48    196560   0% --
var-log                  65536     24016     41520  36% --
=== case vdf -h -p
snapshot: example
run: vdf -h -p
exit: 0
--- stdout
Tardisk                                       Used                         Space
core.tgz                                       56M                           56M
drivers.tgz                                    22M                           22M
tools.tgz                                       9M                            9M
agent.tgz                                       4M                            4M
-----
Ramdisk                    Min       Max      Used  Sure avl Maybe avl Peak used
root                       32M       32M        7M       24M       24M        9M
etc                        28M       48M        3M       24M       44M        4M
tmp                         2M      192M       48K        1M      191M       16M
var-log                     0B       64M       23M        0B       40M       23M
=== case vdu -s on the whole root through the simulator, sorted: every disk
snapshot: example
mode: sim
setup: cp -R @SRC/examples/corafs corafs
exe: /bin/sh
argv: sh -c '"$0" vdu -s corafs > report && LC_ALL=C sort report' @BIN/orxkeltools
exit: 0
--- stdout
                           ramdisk etc:          767		(    8 inodes)
                           ramdisk tmp:            5		(    2 inodes)
                          ramdisk root:           15		(    6 inodes)
                       ramdisk var-log:         1114		(    6 inodes)
                      tardisk core.tgz:          528		(   15 inodes)
                     tardisk agent.tgz:           69		(    2 inodes)
                     tardisk tools.tgz:          903		(    6 inodes)
                   tardisk drivers.tgz:          306		(    6 inodes)
For 'corafs':
=== case vdu -h -s: a folder of the root ramdisk holding the log ramdisk
snapshot: example
mode: sim
setup: cp -R @SRC/examples/corafs corafs
run: vdu -h -s corafs/var
exit: 0
--- stdout
For 'corafs/var':
                          ramdisk root:   15B		(    5 inodes)
                       ramdisk var-log:    1K		(    6 inodes)
=== case vdu -s: the libraries on the core tardisk, the modules on the drivers tardisk
snapshot: example
mode: sim
setup: cp -R @SRC/examples/corafs corafs
run: vdu -s corafs/lib
exit: 0
--- stdout
For 'corafs/lib':
                      tardisk core.tgz:           61		(    2 inodes)
                   tardisk drivers.tgz:          306		(    6 inodes)
=== case vdu: the default depth, a file then its folder
snapshot: example
mode: sim
setup: cp -R @SRC/examples/corafs corafs
run: vdu corafs/usr/lib/agentd
exit: 0
--- stdout
For 'corafs/usr/lib/agentd/agentd':
                     tardisk agent.tgz:           69
For 'corafs/usr/lib/agentd':
                     tardisk agent.tgz:           69		(    2 inodes)
=== case vdu -u -h: the unlinked files
snapshot: example
mode: sim
run: vdu -u -h
exit: 0
--- stdout
Unlinked files:
                           collect.tmp:   64K
Total unlinked files: 1
Size of unlinked files:  64K

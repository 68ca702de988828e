ps --tree: the line-drawing set-up, one header and tree per userspace, the
glyphs of a three-level tree whose vertical lines depend on siblings still
to come, zombies, nThreads of a parent with a clone, the userspace root
table (two roots of one userspace, userspace 128, the not-running report),
a valid chain of more than a thousand cartels, drawn whole, the first of
two worlds with the same world ID as the parent, and a tree from a damaged
cache: a cycle through a world whose ID is 0.

=== snapshot host from ps-worlds.json
=== snapshot two-roots extends host
{"tree": {"world": {"1500": {"name": "init2",
                             "info": {"worldId": 1500, "userspaceId": 1, "cartelId": 1500,
                                      "processGroupId": 1500, "sessionId": 1500, "type": 4}},
                    "3000": {"name": "far-away",
                             "info": {"worldId": 3000, "userspaceId": 128, "cartelId": 3000, "type": 4}}},
          "userworld": {"cartel": {"1500": {"cmdline": "/sbin/init --second", "child": {}},
                                   "3000": {"cmdline": "far", "child": {}}}}}}
=== snapshot three-far-roots extends two-roots
{"tree": {"world": {"3100": {"name": "far-b",
                             "info": {"worldId": 3100, "userspaceId": 300, "cartelId": 3100, "type": 4}}},
          "userworld": {"cartel": {"3100": {"cmdline": "far b", "child": {}}}}}}
=== snapshot far-roots-then-failure extends three-far-roots
{"tree": {"userworld": {"cartel": {"3100": {"child": {"3101": {"$status": "0xbad0062"}}}}}}}
=== snapshot four-levels extends host
{"tree": {"world": {"1220": {"name": "tail",
                             "info": {"worldId": 1220, "userspaceId": 1, "cartelId": 1220,
                                      "parentCartelId": 1100, "type": 4}},
                    "1211": {"name": "grep",
                             "info": {"worldId": 1211, "userspaceId": 1, "cartelId": 1211,
                                      "parentCartelId": 1210, "type": 4}}},
          "userworld": {"cartel": {"1220": {"cmdline": "tail -f", "child": {}},
                                   "1211": {"cmdline": "grep x", "child": {}}}}}}
=== snapshot roots-only
{"buildDate": "Nov 30 2026",
 "tree": {"world": {
   "10": {"name": "init", "info": {"worldId": 10, "userspaceId": 1, "cartelId": 10}},
   "20": {"name": "init", "info": {"worldId": 20, "userspaceId": 3, "cartelId": 20}}},
  "userworld": {"cartel": {"10": {"cmdline": "init", "child": {}},
                           "20": {"cmdline": "init", "child": {}}}}}}
=== snapshot many-userspaces
{"buildDate": "Nov 30 2026",
 "tree": {"world": {
   "1": {"name": "u1", "info": {"worldId": 1, "userspaceId": 1}},
   "2": {"name": "u2", "info": {"worldId": 2, "userspaceId": 2}},
   "3": {"name": "u3", "info": {"worldId": 3, "userspaceId": 3}},
   "4": {"name": "u4", "info": {"worldId": 4, "userspaceId": 4}},
   "5": {"name": "u5", "info": {"worldId": 5, "userspaceId": 5}},
   "6": {"name": "u6", "info": {"worldId": 6, "userspaceId": 6}},
   "7": {"name": "u7", "info": {"worldId": 7, "userspaceId": 7}},
   "8": {"name": "u8", "info": {"worldId": 8, "userspaceId": 8}},
   "9": {"name": "u9", "info": {"worldId": 9, "userspaceId": 9}},
   "10": {"name": "u10", "info": {"worldId": 10, "userspaceId": 10}},
   "11": {"name": "u11", "info": {"worldId": 11, "userspaceId": 11}},
   "12": {"name": "u12", "info": {"worldId": 12, "userspaceId": 12}},
   "21": {"name": "u21", "info": {"worldId": 21, "userspaceId": 21}},
   "22": {"name": "u22", "info": {"worldId": 22, "userspaceId": 22}},
   "31": {"name": "u31", "info": {"worldId": 31, "userspaceId": 31}},
   "127": {"name": "u127", "info": {"worldId": 127, "userspaceId": 127}},
   "128": {"name": "u128", "info": {"worldId": 128, "userspaceId": 128}}}}}
=== snapshot cycle
{"buildDate": "Nov 30 2026",
 "tree": {"world": {
   "10": {"name": "init", "info": {"worldId": 10, "userspaceId": 1, "cartelId": 10, "parentCartelId": 0}},
   "11": {"name": "child", "info": {"worldId": 11, "userspaceId": 1, "cartelId": 11, "parentCartelId": 10}},
   "0": {"name": "ghost", "info": {"worldId": 0, "userspaceId": 1, "cartelId": 5, "parentCartelId": 11}},
   "20": {"name": "loop-a", "info": {"worldId": 20, "userspaceId": 2, "cartelId": 20, "parentCartelId": 21}},
   "21": {"name": "loop-b", "info": {"worldId": 21, "userspaceId": 2, "cartelId": 21, "parentCartelId": 20}}},
  "userworld": {"cartel": {"5": {"cmdline": "ghost", "child": {}},
                           "10": {"cmdline": "init", "child": {}},
                           "11": {"cmdline": "child", "child": {}},
                           "20": {"cmdline": "a", "child": {}},
                           "21": {"cmdline": "b", "child": {}}}}}}
=== snapshot twin-parents
{"buildDate": "Nov 30 2026",
 "tree": {"world": {
   "10": {"name": "init", "info": {"worldId": 10, "userspaceId": 1, "cartelId": 10}},
   "40": {"name": "child", "info": {"worldId": 40, "userspaceId": 1, "cartelId": 40, "parentCartelId": 30}},
   "30": {"name": "first", "info": {"worldId": 30, "userspaceId": 1, "cartelId": 30, "parentCartelId": 10}},
   "31": {"name": "second", "info": {"worldId": 30, "userspaceId": 1, "cartelId": 31, "parentCartelId": 10}}},
  "userworld": {"cartel": {"10": {"cmdline": "init", "child": {}}, "30": {"cmdline": "a", "child": {}},
                           "31": {"cmdline": "b", "child": {}}, "40": {"cmdline": "c", "child": {}}}}}}
=== snapshot chain
{"buildDate": "Nov 30 2026", "tree": @CHAIN}
=== snapshot example from ../../examples/host.json
=== case --tree: the line-drawing set-up, then one header and tree per userspace
snapshot: host
run: ps --tree
exit: 0
--- stdout (escaped)
\x1b)0
  WID   CID   WorldName    
1
\x0em\x0f\x0eq\x0f1001  1001  init         
  \x0et\x0f\x0eq\x0f1100  1100  sh           
  \x0ex\x0f \x0et\x0f\x0eq\x0f1150  1150  <zombie>     
  \x0ex\x0f \x0et\x0f\x0eq\x0f1101  1100  sh-worker    
  \x0ex\x0f \x0em\x0f\x0eq\x0f1200  1200  sleep        
  \x0ex\x0f   \x0em\x0f\x0eq\x0f1210  1210  cat          
  \x0em\x0f\x0eq\x0f1300  1300  vmx          
    \x0et\x0f\x0eq\x0f1350  1350  <zombie>     
    \x0em\x0f\x0eq\x0f1351  1351  <zombie>     

  WID   CID   WorldName    
2
\x0em\x0f\x0eq\x0f2001  2001  init         
  \x0em\x0f\x0eq\x0f2050  2050  logger-daemon

=== case every tree column, and the summary
snapshot: host
run: ps -J -n -N -j -g -P -t -s -T -Z -U -c -i
exit: 0
--- stdout (escaped)
\x1b)0
  WID   CID   WorldName      nChildren  nThreads  GID  PGID  SID  PCID  Type    State   Wait    CPU   Time          SecurityDomain  UserSpace  Command
1
\x0em\x0f\x0eq\x0f1001  1001  init           2          1         1001  1001  1001  0     U       WAIT    CHILD   0-63  123456.789012  3               1          /sbin/init
  \x0et\x0f\x0eq\x0f1100  1100  sh             3          2         1100  1100  1001  1001  U       WAIT    CHILD   0-63      2.500000  3               1          /bin/sh -l
  \x0ex\x0f \x0et\x0f\x0eq\x0f1150  1150  <zombie>       1100  1001  1100                  
  \x0ex\x0f \x0et\x0f\x0eq\x0f1101  1100  sh-worker      0          1         1100  1100  1001  1100  UX      SLEEP   EVENT   0-63      0.999999  3               1          /bin/sh -l
  \x0ex\x0f \x0em\x0f\x0eq\x0f1200  1200  sleep          1          1         1200  1100  1001  1100  U       WAIT    TIMER   0-63      0.1000    3               1          sleep 100
  \x0ex\x0f   \x0em\x0f\x0eq\x0f1210  1210  cat            0          1         1210  1100  1001  1200  U       READY   NONE    1        60.0       3               1          cat /var/log/messages
  \x0em\x0f\x0eq\x0f1300  1300  vmx            2          1         1300  1300  1300  1001  UV      RUN     NONE    4-7,12  86400.0       -1              1          vmx -s vm1.cfg
    \x0et\x0f\x0eq\x0f1350  1350  <zombie>       1300  1300  1300                  
    \x0em\x0f\x0eq\x0f1351  1351  <zombie>       1300  1300  1300                  

  WID   CID   WorldName      nChildren  nThreads  GID  PGID  SID  PCID  Type    State   Wait    CPU   Time          SecurityDomain  UserSpace  Command
2
\x0em\x0f\x0eq\x0f2001  2001  init           1          1         2001  2001  2001  0     U       WAIT    CHILD   0-63      0.42      7               2          /sbin/init
  \x0em\x0f\x0eq\x0f2050  2050  logger-daemon  0          1         2050  2001  2001  2001  U                       0-63      7.0       7               2          logger-daemon --syslog

Total worlds:         11
Total printed worlds: 8
Deepest child:        4
Zombie worlds:        3
Total userspaces:     2
=== case vertical lines stand under every ancestor whose parent has children still to come
snapshot: four-levels
run: ps -J -n -N -i
exit: 0
--- stdout (escaped)
\x1b)0
  WID   CID   WorldName      nChildren  nThreads
1
\x0em\x0f\x0eq\x0f1001  1001  init           2          1       
  \x0et\x0f\x0eq\x0f1100  1100  sh             4          2       
  \x0ex\x0f \x0et\x0f\x0eq\x0f1150  1150  <zombie>     
  \x0ex\x0f \x0et\x0f\x0eq\x0f1101  1100  sh-worker      0          1       
  \x0ex\x0f \x0et\x0f\x0eq\x0f1200  1200  sleep          1          1       
  \x0ex\x0f \x0ex\x0f \x0em\x0f\x0eq\x0f1210  1210  cat            1          1       
  \x0ex\x0f \x0ex\x0f   \x0em\x0f\x0eq\x0f1211  1211  grep           0          1       
  \x0ex\x0f \x0em\x0f\x0eq\x0f1220  1220  tail           0          1       
  \x0em\x0f\x0eq\x0f1300  1300  vmx            2          1       
    \x0et\x0f\x0eq\x0f1350  1350  <zombie>     
    \x0em\x0f\x0eq\x0f1351  1351  <zombie>     

  WID   CID   WorldName      nChildren  nThreads
2
\x0em\x0f\x0eq\x0f2001  2001  init           1          1       
  \x0em\x0f\x0eq\x0f2050  2050  logger-daemon  0          1       

Total worlds:         13
Total printed worlds: 10
Deepest child:        5
Zombie worlds:        3
Total userspaces:     2
=== case -J -U2 draws only userspace 2
snapshot: host
run: ps -J -U2 -i
exit: 0
--- stdout (escaped)
\x1b)0
  WID   CID   WorldName      UserSpace
2
\x0em\x0f\x0eq\x0f2001  2001  init           2        
  \x0em\x0f\x0eq\x0f2050  2050  logger-daemon  2        

Total worlds:         11
Total printed worlds: 8
Deepest child:        2
Zombie worlds:        3
Total userspaces:     2
=== case the later root of a userspace wins; userspace 128 is warned about and not drawn
snapshot: two-roots
run: ps -J -c -i
exit: 0
--- stdout (escaped)
\x1b)0
  WID   CID   WorldName      Command
1
\x0em\x0f\x0eq\x0f1500  1500  init2          /sbin/init --second

  WID   CID   WorldName      Command
2
\x0em\x0f\x0eq\x0f2001  2001  init           /sbin/init
  \x0em\x0f\x0eq\x0f2050  2050  logger-daemon  logger-daemon --syslog

Total worlds:         13
Total printed worlds: 10
Deepest child:        2
Zombie worlds:        3
Total userspaces:     2
--- stderr
Warning: maximum number of userspaces reached...
=== case both roots stay rows of the flat table
snapshot: two-roots
run: ps -u -U -i
exit: 0
--- stdout
WID   CID   WorldName      UserSpace
1001  1001  init           1        
1100  1100  sh             1        
1101  1100  sh-worker      1        
1200  1200  sleep          1        
1210  1210  cat            1        
1300  1300  vmx            1        
2001  2001  init           2        
2050  2050  logger-daemon  2        
1500  1500  init2          1        
3000  3000  far-away       128      

Total worlds:         13
Total printed worlds: 10
Total userspaces:     2
--- stderr
Warning: maximum number of userspaces reached...
=== case only roots: the deepest child is 1
snapshot: roots-only
run: ps -J -i
exit: 0
--- stdout (escaped)
\x1b)0
  WID  CID  WorldName
1
\x0em\x0f\x0eq\x0f10  10  init

  WID  CID  WorldName
3
\x0em\x0f\x0eq\x0f20  20  init

Total worlds:         2
Total printed worlds: 2
Deepest child:        1
Zombie worlds:        0
Total userspaces:     2
=== case the not-running report breaks its line after 11, 21, 31, ...
snapshot: many-userspaces
run: ps -U50
exit: 1
--- stderr
Warning: maximum number of userspaces reached...
Requested userspace (50) is not running.
Available userspaces:
   1   2   3   4   5   6   7   8   9  10  11 
 12  21 
 22  31 
127 
=== case -U127 is the last userspace that can be asked for
snapshot: many-userspaces
run: ps -U127
exit: 0
--- stdout
WID  CID  WorldName  UserSpace
127  0    u127  127      

--- stderr
Warning: maximum number of userspaces reached...
=== case -U128 is past the table: not running, like any other absent one
snapshot: many-userspaces
run: ps -U128
exit: 1
--- stderr
Warning: maximum number of userspaces reached...
Requested userspace (128) is not running.
Available userspaces:
   1   2   3   4   5   6   7   8   9  10  11 
 12  21 
 22  31 
127 
=== case a cycle back to the root through a world whose ID is 0 is drawn once
snapshot: cycle
run: ps -J -P -i
exit: 0
--- stdout (escaped)
\x1b)0
  WID  CID  WorldName  PCID
1
\x0em\x0f\x0eq\x0f10  10  init    0 
  \x0em\x0f\x0eq\x0f11  11  child   10
    \x0em\x0f\x0eq\x0f0   5  ghost   11

Total worlds:         5
Total printed worlds: 5
Deepest child:        3
Zombie worlds:        0
Total userspaces:     1
=== case a chain of 1113 cartels is drawn whole, each level two columns further in
value: CHAIN python3 -c 'import json; n = 1113; print(json.dumps({"world": {str(i): {"name": "w%d" % i, "info": {"worldId": i, "userspaceId": 1, "cartelId": i, "parentCartelId": i - 1}} for i in range(1, n + 1)}, "userworld": {"cartel": {str(i): {"cmdline": "x", "child": {}} for i in range(1, n + 1)}}}))'
snapshot: chain
run: ps -J -i
check: @BIN/orxkeltools -c @CACHE ps -J -i > out && grep -qx 'Deepest child:        1113' out
check: python3 -c 'import sys; rows = [l for l in open("out", encoding="latin-1") if "\x0eq" in l]; sys.exit(not (len(rows) == 1113 and all(r.startswith(" " * 2 * i + "\x0em\x0f\x0eq\x0f%-4d" % (i + 1)) for i, r in enumerate(rows))))'
exit: 0
--- stdout (any)
=== case of two worlds with the parent's world ID, the first listed is the parent
snapshot: twin-parents
run: ps -J -n -P
exit: 0
--- stdout (escaped)
\x1b)0
  WID  CID  WorldName  nChildren  PCID
1
\x0em\x0f\x0eq\x0f10  10  init    2          0 
  \x0et\x0f\x0eq\x0f30  30  first   1          10
  \x0ex\x0f \x0em\x0f\x0eq\x0f40  40  child   0          30
  \x0em\x0f\x0eq\x0f30  31  second  0          10

=== case the example host
snapshot: example
run: ps -J -c -s -T
exit: 0
--- stdout (escaped)
\x1b)0
  WID   CID   WorldName       State   Wait    CPU   Time          Command
1
\x0em\x0f\x0eq\x0f1001  1001  initd           WAIT    CHILD   0-3      38.337877  /sbin/initd
  \x0et\x0f\x0eq\x0f1002  1002  hostd           RUN     NONE    0-3      12.612811  /usr/sbin/hostd -c /etc/hostd/config.xml
  \x0ex\x0f \x0et\x0f\x0eq\x0f1010  1002  hostd-worker    WAIT    TIMER   0-3      33.318812  /usr/sbin/hostd -c /etc/hostd/config.xml
  \x0ex\x0f \x0et\x0f\x0eq\x0f1011  1002  hostd-worker    RUN     NONE    0-3      35.688141  /usr/sbin/hostd -c /etc/hostd/config.xml
  \x0ex\x0f \x0em\x0f\x0eq\x0f1012  1002  hostd-io        SLEEP   TIMER   0-3      52.163940  /usr/sbin/hostd -c /etc/hostd/config.xml
  \x0et\x0f\x0eq\x0f1003  1003  agentd          WAIT    CHILD   0-3       6.543455  /usr/lib/agentd/agentd -d
  \x0ex\x0f \x0em\x0f\x0eq\x0f1013  1003  agentd-poll                       /usr/lib/agentd/agentd -d
  \x0et\x0f\x0eq\x0f1004  1004  sh              WAIT    CHILD   0-3      47.793944  /bin/sh /opt/scripts/collect.sh
  \x0ex\x0f \x0et\x0f\x0eq\x0f1009  1009  <zombie>                        
  \x0ex\x0f \x0em\x0f\x0eq\x0f1007  1007  python3         WAIT    EVENT   0-3      41.546030  /usr/bin/python3 /opt/scripts/parse.py --interval 30
  \x0ex\x0f   \x0em\x0f\x0eq\x0f1015  1015  cat             WAIT    SIGNAL  0-3      30.417688  /bin/cat /var/log/kernel.log
  \x0em\x0f\x0eq\x0f1006  1006  bash            WAIT    CHILD   0-3      37.879115  /bin/bash /etc/init.d/watchdog.sh
    \x0em\x0f\x0eq\x0f1014  1014  sleep           WAIT    TIMER   0-3      31.251012  /bin/sleep 60

  WID   CID   WorldName       State   Wait    CPU   Time          Command
2
\x0em\x0f\x0eq\x0f2001  2001  initd           WAIT    CHILD   0-3      20.122022  /sbin/initd
  \x0et\x0f\x0eq\x0f2002  2002  syslogd         WAIT    TIMER   0-3      53.314904  /usr/sbin/syslogd -n
  \x0ex\x0f \x0em\x0f\x0eq\x0f2004  2002  syslogd-writer  WAIT    IO      0-3      16.386039  /usr/sbin/syslogd -n
  \x0em\x0f\x0eq\x0f2003  2003  ntpd            WAIT    TIMER   0-3      46.913722  /usr/sbin/ntpd -g -n -c /etc/ntp.conf

=== case each root beyond the table is warned about once
snapshot: three-far-roots
run: ps -u -U2 -i
exit: 0
--- stdout
WID   CID   WorldName      UserSpace
2001  2001  init           2        
2050  2050  logger-daemon  2        

Total worlds:         14
Total printed worlds: 11
Total userspaces:     2
--- stderr
Warning: maximum number of userspaces reached...
Warning: maximum number of userspaces reached...
=== case a gathering that fails after such roots writes no warning
snapshot: far-roots-then-failure
run: ps -J
exit: 1
--- stderr
failed to get child info for child 3101, status No such cartel

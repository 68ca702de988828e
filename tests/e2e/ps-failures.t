ps when the tree fails it: listings and reads that fail, worlds that vanish
between the listing and their reads, the latest status rule, failures of
the zombie gathering, and texts that fill their buffers without a NUL.
The snapshots patch ps-worlds.json (see ps-flat.t).

=== snapshot host from ps-worlds.json
=== snapshot no-world-list extends host
{"tree": {"world": {"$listStatus": "0xbad0001"}}}
=== snapshot no-cartel-list extends host
{"tree": {"userworld": {"cartel": {"$listStatus": "0xbad0017"}}}}
=== snapshot vanished extends host
{"tree": {"world": {"1200": {"name": {"$status": "0xbad0003"}},
                    "3": {"info": {"$status": "0xbad0003"}},
                    "1101": {"info": {"$status": "0xbad0003"}}},
          "sched": {"Vcpus": {"2": {"stats": {"summaryStats": {"$status": "0xbad0003"}}},
                              "1300": {"stats": {"affinity": {"$status": "0xbad0003"}}},
                              "2050": {"stats": {"stateTimes": {"$status": "0xbad0003"}}}}}}}
=== snapshot last-cmdline-fails extends host
{"tree": {"userworld": {"cartel": {"2050": {"cmdline": {"$status": "0xbad0062"}}}}}}
=== snapshot middle-cmdline-fails extends host
{"tree": {"userworld": {"cartel": {"1200": {"cmdline": {"$status": "0xbad0062"}}}}}}
=== snapshot last-children-fail extends host
{"tree": {"userworld": {"cartel": {"2050": {"child": {"$listStatus": "0xbad0062"}}}}}}
=== snapshot middle-children-fail extends host
{"tree": {"userworld": {"cartel": {"1300": {"child": {"$listStatus": "0xbad0062"}}}}}}
=== snapshot late-clone-children-fail extends host
{"tree": {"world": {"1102": {"name": "sh-late",
                             "info": {"worldId": 1102, "userspaceId": 1, "cartelId": 1100, "parentCartelId": 1001,
                                      "type": 36}}},
          "userworld": {"cartel": {"1100": {"child": {"$listStatus": "0xbad0062"}}}}}}
=== snapshot child-record-fails extends host
{"tree": {"userworld": {"cartel": {"1300": {"child": {"1351": {"$status": "0xbad0062"}}}}}}}
=== snapshot child-id-text extends host
{"tree": {"userworld": {"cartel": {"1300": {"child": {"$text:not-a-number": {"state": 1}}}}}}}
=== snapshot odd-world-key extends host
{"tree": {"world": {"$kind:5:7": {"name": "odd"}}}}
=== snapshot long-texts
{"buildDate": "Nov 30 2026",
 "tree": {"world": {"7": {"name": "@LONGNAME", "info": {"worldId": 7, "cartelId": 7}}},
          "userworld": {"cartel": {"7": {"cmdline": "@LONGCMD", "child": {}}}}}}
=== case the world listing fails
snapshot: no-world-list
run: ps
exit: 1
--- stderr
WorldList: error fetching world list 0xbad0001
=== case the cartel listing of -C fails
snapshot: no-cartel-list
run: ps -C
exit: 1
--- stderr
WorldList: error fetching world list 0xbad0017
=== case worlds whose name, information or state times vanish are skipped
snapshot: vanished
run: ps -s -T -c -i
exit: 0
--- stdout
WID   CID   WorldName  State   Wait    CPU   Time          Command
1     0     idle0    RUN     NONE    0         1.500000
2     0     console                  
1001  1001  init     WAIT    CHILD   0-63  123456.789012  /sbin/init
1100  1100  sh       WAIT    CHILD   0-63      2.500000  /bin/sh -l
1210  1210  cat      READY   NONE    1        60.0       cat /var/log/messages
1300  1300  vmx                        vmx -s vm1.cfg
2001  2001  init     WAIT    CHILD   0-63      0.42      /sbin/init

Total worlds:         11
Total printed worlds: 7
Total userspaces:     2
=== case worlds without scheduler summary or affinity stay, and their columns shift
snapshot: vanished
run: ps -J -s -T -U -i
exit: 0
--- stdout (escaped)
\x1b)0
  WID   CID   WorldName  State   Wait    CPU   Time          UserSpace
1
\x0em\x0f\x0eq\x0f1001  1001  init  WAIT    CHILD   0-63  123456.789012  1        
  \x0et\x0f\x0eq\x0f1100  1100  sh    WAIT    CHILD   0-63      2.500000  1        
  \x0ex\x0f \x0em\x0f\x0eq\x0f1150  1150  <zombie>                  
  \x0em\x0f\x0eq\x0f1300  1300  vmx                     1        
    \x0et\x0f\x0eq\x0f1350  1350  <zombie>                  
    \x0em\x0f\x0eq\x0f1351  1351  <zombie>                  

  WID   CID   WorldName  State   Wait    CPU   Time          UserSpace
2
\x0em\x0f\x0eq\x0f2001  2001  init  WAIT    CHILD   0-63      0.42      2        

Total worlds:         11
Total printed worlds: 5
Deepest child:        3
Zombie worlds:        3
Total userspaces:     2
=== case an unreadable command line read last fails ps
snapshot: last-cmdline-fails
run: ps -u -c
exit: 1
--- stdout
WID   CID   WorldName      Command
1001  1001  init           /sbin/init
1100  1100  sh             /bin/sh -l
1101  1100  sh-worker      /bin/sh -l
1200  1200  sleep          sleep 100
1210  1210  cat            cat /var/log/messages
1300  1300  vmx            vmx -s vm1.cfg
2001  2001  init           /sbin/init
2050  2050  logger-daemon  <unavailable>

=== case an unreadable command line read earlier does not
snapshot: middle-cmdline-fails
run: ps -u -c
exit: 0
--- stdout
WID   CID   WorldName      Command
1001  1001  init           /sbin/init
1100  1100  sh             /bin/sh -l
1101  1100  sh-worker      /bin/sh -l
1200  1200  sleep          <unavailable>
1210  1210  cat            cat /var/log/messages
1300  1300  vmx            vmx -s vm1.cfg
2001  2001  init           /sbin/init
2050  2050  logger-daemon  logger-daemon --syslog

=== case a child listing that fails last fails ps, with no message
snapshot: last-children-fail
run: ps -z -u
exit: 1
--- stdout
WID   CID   WorldName    
1001  1001  init         
1100  1100  sh           
1150  1150  <zombie>     
1101  1100  sh-worker    
1200  1200  sleep        
1210  1210  cat          
1300  1300  vmx          
1350  1350  <zombie>     
1351  1351  <zombie>     
2001  2001  init         
2050  2050  logger-daemon

=== case a child listing that fails earlier only loses those zombies
snapshot: middle-children-fail
run: ps -J
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

  WID   CID   WorldName    
2
\x0em\x0f\x0eq\x0f2001  2001  init         
  \x0em\x0f\x0eq\x0f2050  2050  logger-daemon

=== case a failed child listing counts again at a later world of the same cartel
snapshot: late-clone-children-fail
run: ps -z -U1
exit: 1
--- stdout
WID   CID   WorldName      UserSpace
1001  1001  init           1        
1100  1100  sh             1        
1101  1100  sh-worker      1        
1200  1200  sleep          1        
1210  1210  cat            1        
1300  1300  vmx            1        
1350  1350  <zombie>     
1351  1351  <zombie>     
1102  1100  sh-late        1        

=== case a child record that cannot be read ends ps before any output
snapshot: child-record-fails
run: ps -J
exit: 1
--- stderr
failed to get child info for child 1351, status No such cartel
=== case without zombies the child records are not read
snapshot: child-record-fails
run: ps -u
exit: 0
--- stdout
WID   CID   WorldName    
1001  1001  init         
1100  1100  sh           
1101  1100  sh-worker    
1200  1200  sleep        
1210  1210  cat          
1300  1300  vmx          
2001  2001  init         
2050  2050  logger-daemon

=== case a child key that is not a number
snapshot: child-id-text
run: ps -z
exit: 1
--- stderr
failed to get child ID
=== case a world key of a kind the tool does not know
snapshot: odd-world-key
run: ps
exit: 1
--- stderr
NOT_IMPLEMENTED apps/orxkeltools/keltools:178
=== case a name and a command line that fill their buffers without a NUL
value: LONGNAME python3 -c 'print("n" * 126 + "<>")'
value: LONGCMD python3 -c 'print("c" * 1022 + "<>")'
snapshot: long-texts
run: ps -c
exit: 0
--- stdout
WID  CID  WorldName                                                                                                                         Command
7  7  nnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnnn<>  cccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccccc<>


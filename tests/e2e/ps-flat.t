ps in the flat layout: the columns and their paddings, type names, zombie
rows, the filters, worlds that vanish while they are read, the latest
status, and the option errors.  ps-worlds.json is a small host: three
kernel worlds, userspace 1 (init, sh with a clone worker and a zombie,
sleep, cat, vmx with two zombies) and userspace 2 (init, logger-daemon).

=== snapshot host from ps-worlds.json
=== snapshot empty
{"buildDate": "Nov 30 2026", "tree": {"world": {}}}
=== snapshot types
{"buildDate": "Nov 30 2026",
 "tree": {"world": {
   "1": {"name": "none", "info": {"worldId": 1, "type": 0}},
   "2": {"name": "sys-user", "info": {"worldId": 2, "type": 5}},
   "3": {"name": "bit-0x80", "info": {"worldId": 3, "type": 128}},
   "4": {"name": "sys-0x200", "info": {"worldId": 4, "type": 513}},
   "5": {"name": "all-eight", "info": {"worldId": 5, "type": 383}},
   "6": {"name": "helper-high", "info": {"worldId": 6, "type": 2147483664}},
   "7": {"name": "assistant", "info": {"worldId": 7, "type": 256}}}}}
=== snapshot wide
{"buildDate": "Nov 30 2026",
 "tree": {"world": {
   "7": {"name": "tiny", "info": {"worldId": 7, "groupId": 7}},
   "88": {"name": "cartel", "info": {"worldId": 88, "groupId": 88, "cartelId": 123, "parentCartelId": 1,
                                     "processGroupId": 123, "sessionId": 4, "userspaceId": 1}},
   "12345": {"name": "big", "info": {"worldId": 12345, "groupId": -5}}},
  "userworld": {"cartel": {"123": {"cmdline": "x"}}}}}
=== snapshot clone-first extends host
{"tree": {"world": {"7001": {"name": "job-worker",
                             "info": {"worldId": 7001, "userspaceId": 2, "cartelId": 7000, "parentCartelId": 2001,
                                      "type": 36}},
                    "7000": {"name": "job",
                             "info": {"worldId": 7000, "userspaceId": 2, "cartelId": 7000, "parentCartelId": 2001,
                                      "processGroupId": 7000, "sessionId": 2001, "type": 4}}},
          "userworld": {"cartel": {"7000": {"cmdline": "job", "child": {"7100": {"state": 1}, "7101": {"state": 0},
                                                                        "7102": {"state": 1}}}}}}}
=== case no options: WID, CID and WorldName of every world, then an empty line
snapshot: host
run: ps
exit: 0
--- stdout
WID   CID   WorldName    
1     0     idle0        
2     0     console      
3     0     helper-7     
1001  1001  init         
1100  1100  sh           
1101  1100  sh-worker    
1200  1200  sleep        
1210  1210  cat          
1300  1300  vmx          
2001  2001  init         
2050  2050  logger-daemon

=== case every flat column
snapshot: host
run: ps -j -g -P -t -s -T -Z -U -c
exit: 0
--- stdout
WID   CID   WorldName      GID  PGID  SID  PCID  Type    State   Wait    CPU   Time          SecurityDomain  UserSpace  Command
1     0     idle0          0   0   0   0     I       RUN     NONE    0         1.500000  0               0        
2     0     console        2   0   0   0     S       WAIT    TIMER   0-3       1.1       0               0        
3     0     helper-7       2   0   0   0     SH      MIGRAT  REQUES  2         0.0       0               0        
1001  1001  init           1001  1001  1001  0     U       WAIT    CHILD   0-63  123456.789012  3               1          /sbin/init
1100  1100  sh             1100  1100  1001  1001  U       WAIT    CHILD   0-63      2.500000  3               1          /bin/sh -l
1101  1100  sh-worker      1100  1100  1001  1100  UX      SLEEP   EVENT   0-63      0.999999  3               1          /bin/sh -l
1200  1200  sleep          1200  1100  1001  1100  U       WAIT    TIMER   0-63      0.1000    3               1          sleep 100
1210  1210  cat            1210  1100  1001  1200  U       READY   NONE    1        60.0       3               1          cat /var/log/messages
1300  1300  vmx            1300  1300  1300  1001  UV      RUN     NONE    4-7,12  86400.0       -1              1          vmx -s vm1.cfg
2001  2001  init           2001  2001  2001  0     U       WAIT    CHILD   0-63      0.42      7               2          /sbin/init
2050  2050  logger-daemon  2050  2001  2001  2001  U                       0-63      7.0       7               2          logger-daemon --syslog

=== case type letters, and the Invalid walk for unnamed bits or none
snapshot: types
run: ps -t
exit: 0
--- stdout
WID  CID  WorldName    Type  
1  0  none         Invalid      
2  0  sys-user     SU    
3  0  bit-0x80     Invalid      
4  0  sys-0x200    SInvalid     
5  0  all-eight    SIUVHXTA
6  0  helper-high  HInvalid     
7  0  assistant    A     

=== case type names with -v, and the Invalid walk
snapshot: types
run: ps -t -v
exit: 0
--- stdout
WID  CID  WorldName    Type  
1  0  none         Invalid  
2  0  sys-user     System,User  
3  0  bit-0x80     Invalid  
4  0  sys-0x200    System,Invalid  
5  0  all-eight    System,Idle,User,VMM,Helper,Clone,Test,Assistant  
6  0  helper-high  Helper,Invalid  
7  0  assistant    Assistant  

=== case a five-digit largest world ID: header and row paddings differ
snapshot: wide
run: ps -j -g -P
exit: 0
--- stdout
WID    CID    WorldName  GID   PGID  SID   PCID 
7      0      tiny    7    0    0    0    
88     123  cartel  88   123  4  1    
12345  0      big     -5   0    0    0    

=== case no worlds: ID width 1 and name width 0
snapshot: empty
run: ps -j -i
exit: 0
--- stdout
WID  CID  WorldName  GID

Total worlds:         0
Total printed worlds: 0
Total userspaces:     0
=== case -u keeps userworlds only; -i counts them
snapshot: host
run: ps -u -i
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

Total worlds:         11
Total printed worlds: 8
Total userspaces:     2
=== case zombie rows: no name, type, time or command, 18 blanks for the state
snapshot: host
run: ps -z -j -g -P -t -s -T -Z -U -c -i
exit: 0
--- stdout
WID   CID   WorldName      GID  PGID  SID  PCID  Type    State   Wait    CPU   Time          SecurityDomain  UserSpace  Command
1     0     idle0          0   0   0   0     I       RUN     NONE    0         1.500000  0               0        
2     0     console        2   0   0   0     S       WAIT    TIMER   0-3       1.1       0               0        
3     0     helper-7       2   0   0   0     SH      MIGRAT  REQUES  2         0.0       0               0        
1001  1001  init           1001  1001  1001  0     U       WAIT    CHILD   0-63  123456.789012  3               1          /sbin/init
1100  1100  sh             1100  1100  1001  1001  U       WAIT    CHILD   0-63      2.500000  3               1          /bin/sh -l
1150  1150  <zombie>       1100  1001  1100                  
1101  1100  sh-worker      1100  1100  1001  1100  UX      SLEEP   EVENT   0-63      0.999999  3               1          /bin/sh -l
1200  1200  sleep          1200  1100  1001  1100  U       WAIT    TIMER   0-63      0.1000    3               1          sleep 100
1210  1210  cat            1210  1100  1001  1200  U       READY   NONE    1        60.0       3               1          cat /var/log/messages
1300  1300  vmx            1300  1300  1300  1001  UV      RUN     NONE    4-7,12  86400.0       -1              1          vmx -s vm1.cfg
1350  1350  <zombie>       1300  1300  1300                  
1351  1351  <zombie>       1300  1300  1300                  
2001  2001  init           2001  2001  2001  0     U       WAIT    CHILD   0-63      0.42      7               2          /sbin/init
2050  2050  logger-daemon  2050  2001  2001  2001  U                       0-63      7.0       7               2          logger-daemon --syslog

Total worlds:         11
Total printed worlds: 11
Zombie worlds:        3
Total userspaces:     2
=== case a cartel's main world keeps its zombies when another of its worlds is listed first
snapshot: clone-first
run: ps -z -U2 -g -i
exit: 0
--- stdout
WID   CID   WorldName      PGID  SID  UserSpace
2001  2001  init           2001  2001  2        
2050  2050  logger-daemon  2001  2001  2        
7001  7000  job-worker     0  0  2        
7000  7000  job            7000  2001  2        
7100  7100  <zombie>       7000  2001
7102  7102  <zombie>       7000  2001

Total worlds:         13
Total printed worlds: 13
Zombie worlds:        5
Total userspaces:     2
=== case -C lists the main world of every cartel
snapshot: host
run: ps -C -c -i
exit: 0
--- stdout
WID   CID   WorldName      Command
1001  1001  init           /sbin/init
1100  1100  sh             /bin/sh -l
1200  1200  sleep          sleep 100
1210  1210  cat            cat /var/log/messages
1300  1300  vmx            vmx -s vm1.cfg
2001  2001  init           /sbin/init
2050  2050  logger-daemon  logger-daemon --syslog

Total worlds:         7
Total printed worlds: 7
Total userspaces:     2
=== case -U2 shows only userspace 2
snapshot: host
run: ps -U2 -c
exit: 0
--- stdout
WID   CID   WorldName      UserSpace  Command
2001  2001  init           2          /sbin/init
2050  2050  logger-daemon  2          logger-daemon --syslog

=== case -U followed by a separate number is refused
snapshot: host
run: ps -U 2
exit: 1
--- stderr
ps: no non-option arguments
ps
    -C           Display only cartels
    -P           Display PCID
    -T           Display used time
    -c           Display verbose command line
    -g           Display session ID and process group
    -i           Display summary information
    -j           Display GID
    -n           Display nChildren (only with --tree)
    -N           Display nThreads  (only with --tree)
    -s           Display state
    -t           Display type
    -u           Display only userworlds
    -U [N]       Display [only] userspace ID
    -v           Display non truncated values
    -Z           Display the security domain
    -z           Display zombie cartels
    -J or --tree Display userworlds in a tree layout
=== case -U with a userspace that is not running
snapshot: host
run: ps -U3 -i
exit: 1
--- stderr
Requested userspace (3) is not running.
Available userspaces:
   1   2 
=== case -h, and --help, which wins over the options that follow it
snapshot: host
run: ps -h
check: test "$(@BIN/orxkeltools -c @CACHE ps --help -x 2>&1; echo $?)" = "$(@BIN/orxkeltools -c @CACHE ps -h 2>&1; echo $?)"
exit: 0
--- stderr
ps
    -C           Display only cartels
    -P           Display PCID
    -T           Display used time
    -c           Display verbose command line
    -g           Display session ID and process group
    -i           Display summary information
    -j           Display GID
    -n           Display nChildren (only with --tree)
    -N           Display nThreads  (only with --tree)
    -s           Display state
    -t           Display type
    -u           Display only userworlds
    -U [N]       Display [only] userspace ID
    -v           Display non truncated values
    -Z           Display the security domain
    -z           Display zombie cartels
    -J or --tree Display userworlds in a tree layout
=== case an unknown option
snapshot: host
run: ps -x
exit: 1
--- stderr
ps: invalid option -- 'x'
ps
    -C           Display only cartels
    -P           Display PCID
    -T           Display used time
    -c           Display verbose command line
    -g           Display session ID and process group
    -i           Display summary information
    -j           Display GID
    -n           Display nChildren (only with --tree)
    -N           Display nThreads  (only with --tree)
    -s           Display state
    -t           Display type
    -u           Display only userworlds
    -U [N]       Display [only] userspace ID
    -v           Display non truncated values
    -Z           Display the security domain
    -z           Display zombie cartels
    -J or --tree Display userworlds in a tree layout
=== case --tree takes no argument
snapshot: host
run: ps --tree=1
exit: 1
--- stderr
ps: option '--tree' doesn't allow an argument
ps
    -C           Display only cartels
    -P           Display PCID
    -T           Display used time
    -c           Display verbose command line
    -g           Display session ID and process group
    -i           Display summary information
    -j           Display GID
    -n           Display nChildren (only with --tree)
    -N           Display nThreads  (only with --tree)
    -s           Display state
    -t           Display type
    -u           Display only userworlds
    -U [N]       Display [only] userspace ID
    -v           Display non truncated values
    -Z           Display the security domain
    -z           Display zombie cartels
    -J or --tree Display userworlds in a tree layout
=== case -N needs --tree
snapshot: host
run: ps -N
exit: 1
--- stderr
nThreads needs --tree
=== case -n is reported before -N
snapshot: host
run: ps -N -n
exit: 1
--- stderr
nChildren needs --tree
=== case -U with a negative number reads it as a 32-bit strtoul does
snapshot: host
run: ps -U-5
exit: 1
--- stderr
Requested userspace (-5) is not running.
Available userspaces:
   1   2 

lsof: each cartel's fd rows, then its mapping rows of kind 2.

=== snapshot files
{"buildDate": "Nov 30 2026",
 "tree": {
  "world": {
   "1001": {"name": "crond"},
   "1002": {"name": {"$status": "0xbad0003"}},
   "1003": {"name": "hostd"},
   "1004": {"name": "a-world-name-of-24-chars"},
   "1005": {"name": "exactly-twenty-chars"}
  },
  "userworld": {"cartel": {
   "1001": {
    "fd": {"fds": {
     "0": {"type": "CHARACTER", "description": "/dev/null"},
     "1": {"type": "REGULAR", "description": "/var/log/crond.log"},
     "7": {"type": "SOCKET", "description": "unix:/var/run/crond.sock"}}},
    "mem": {"mmaps": {
     "0": {"length": 4096, "kind": 2, "prot": 3, "fd": 1, "description": "/var/log/crond.log"},
     "1": {"length": 8192, "kind": 1, "prot": 3, "fd": -1, "description": "[anonymous]"},
     "2": {"length": 65536, "kind": 2, "prot": 1, "fd": 7, "description": "/lib/libc.so.6"},
     "3": {"length": 12288, "kind": 2, "prot": 2, "fd": 0, "description": "/dev/null"},
     "4": {"length": 4294967295, "kind": 2, "prot": 0, "fd": -1, "description": "guard"}}}},
   "1002": {
    "fd": {"fds": {"0": {"type": "CHARACTER", "description": "/dev/null"}}},
    "mem": {"mmaps": {"0": {"length": 4096, "kind": 2, "prot": 1, "fd": 0, "description": "x"}}}},
   "1003": {
    "fd": {"fds": {"$listStatus": "0xbad0003"}},
    "mem": {"mmaps": {"0": {"length": 4096, "kind": 2, "prot": 1, "fd": 0, "description": "x"}}}},
   "1004": {
    "fd": {"fds": {
     "3": {"type": "a-type-text-of-twenty", "description": "/tmp/long"},
     "4": {"$status": "0xbad0062"},
     "123456": {"type": "PIPE", "description": ""}}},
    "mem": {"mmaps": {"$listStatus": "0xbad0003"}}},
   "1005": {
    "fd": {"fds": {}},
    "mem": {"mmaps": {
     "0": {"$status": "0xbad0003"},
     "9": {"length": 1, "kind": 2, "prot": 7, "fd": 2147483647, "description": "/etc/motd"}}}}
  }}}}
=== snapshot no-cartels
{"buildDate": "Nov 30 2026", "tree": {"userworld": {"cartel": {}}}}
=== snapshot unlisted extends files
{"tree": {"userworld": {"cartel": {"$listStatus": "0xbad0003"}}}}
=== snapshot unlisted-256 extends files
{"tree": {"userworld": {"cartel": {"$listStatus": "0xbad0100"}}}}
=== case the table: fd rows, mapping rows of kind 2, unreadable items passed over
snapshot: files
run: lsof
exit: 0
--- stdout
Cartel    |      World name     |        Type         |   fd   |  Description     
----------+---------------------+---------------------+--------+------------------
1001        crond                 CHARACTER                   0   /dev/null
1001        crond                 REGULAR                     1   /var/log/crond.log
1001        crond                 SOCKET                      7   unix:/var/run/crond.sock
1001        crond                 MMAP                        1   /var/log/crond.log (prot:RW/len:4096)
1001        crond                 MMAP                        7   /lib/libc.so.6 (prot:R-/len:65536)
1001        crond                 MMAP                        0   /dev/null (prot:-W/len:12288)
1001        crond                 MMAP                       -1   guard (prot:--/len:4294967295)
1004        a-world-name-of-24-chars  a-type-text-of-twenty        3   /tmp/long
1004        a-world-name-of-24-chars  PIPE                   123456   
1005        exactly-twenty-chars  MMAP                   2147483647   /etc/motd (prot:RW/len:1)
=== case no cartels: the two header lines (live mode; arguments are ignored)
snapshot: no-cartels
mode: sim
run: lsof -a some words
exit: 0
--- stdout
Cartel    |      World name     |        Type         |   fd   |  Description     
----------+---------------------+---------------------+--------+------------------
=== case the cartel list cannot be read: no output, the status's low 8 bits
snapshot: unlisted
run: lsof
exit: 3
--- stderr
WalkWorldList: error fetching world list 0xbad0003
=== case a failing status whose low 8 bits are 0 still fails
snapshot: unlisted-256
run: lsof
exit: 1
--- stderr
WalkWorldList: error fetching world list 0xbad0100

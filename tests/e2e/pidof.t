pidof: the name rule, shells with -x, the omit list, single shot, and the
fresh cartel list read for every name.

=== snapshot cartels
{"buildDate": "Nov 30 2026",
 "tree": {
  "world": {
   "1001": {"name": "crond", "info": {"worldId": 1001, "cartelId": 1001}},
   "1002": {"name": "crond", "info": {"worldId": 1002, "cartelId": 1002}},
   "1003": {"name": "crond", "info": {"worldId": 1003, "cartelId": 1003}},
   "1004": {"name": "sh", "info": {"worldId": 1004, "cartelId": 1004}},
   "1005": {"name": "bash", "info": {"worldId": 1005, "cartelId": 1005}},
   "1006": {"name": "bash", "info": {"worldId": 1006, "cartelId": 1006}},
   "1007": {"name": "ash", "info": {"worldId": 1007, "cartelId": 1007}},
   "1008": {"name": "bash", "info": {"worldId": 1008, "cartelId": 1008}},
   "1009": {"name": "sh", "info": {"worldId": 1009, "cartelId": 1009}},
   "1010": {"name": "kernelwd", "info": {"worldId": 1010, "cartelId": 0}},
   "1011": {"name": "crond", "info": {"$status": "0xbad0062"}},
   "1012": {"name": "crond", "info": {"worldId": 1012, "cartelId": 1012}}
  },
  "userworld": {"cartel": {
   "1001": {"cmdline": "/usr/sbin/crond -f"},
   "1002": {"cmdline": "crond"},
   "1003": {"cmdline": "/sbin/crond"},
   "1004": {"cmdline": "/bin/sh /opt/job.sh --now"},
   "1005": {"cmdline": "/usr/bin/bash job.sh"},
   "1006": {"cmdline": "bash job.sh"},
   "1007": {"cmdline": "/bin/ash /opt/job.sh"},
   "1008": {"cmdline": "/bin/bash job.sh"},
   "1009": {"cmdline": "/bin/sh"},
   "1010": {"cmdline": "crond"},
   "1011": {"cmdline": "crond"},
   "1012": {"cmdline": {"$status": "0xbad0062"}}
  }}}}
=== snapshot no-cartels
{"buildDate": "Nov 30 2026", "tree": {"userworld": {"cartel": {}}}}
=== snapshot unlisted extends cartels
{"tree": {"userworld": {"cartel": {"$listStatus": "0xbad0003"}}}}
=== snapshot parent
{"buildDate": "Nov 30 2026",
 "tree": {
  "world": {
   "$int:@PP": {"name": "sh", "info": {"worldId": "@PP", "cartelId": "@PP"}},
   "1004": {"name": "sh", "info": {"worldId": 1004, "cartelId": 1004}}
  },
  "userworld": {"cartel": {
   "$int:@PP": {"cmdline": "/bin/sh -c pidof"},
   "1004": {"cmdline": "sh"}
  }}}}
=== case no arguments: usage, status 1
snapshot: cartels
run: pidof
exit: 1
--- stderr
find the process ID of running programs
pidof program program ...
      -s   Single shot, only return one pid
      -x   Scripts too, would also return ids of shells
      -o   Pid to omit
=== case a bare name matches the name and every path ending in it
snapshot: cartels
run: pidof crond
exit: 0
--- stdout
1001 1002 1003 
=== case an absolute name matches that path and the bare name only
snapshot: cartels
run: pidof /usr/sbin/crond
exit: 0
--- stdout
1001 1002 
=== case the same cartel is printed once for each name it matches
snapshot: cartels
run: pidof crond /usr/sbin/crond
exit: 0
--- stdout
1001 1002 1003 1001 1002 
=== case nothing found: nothing written, status 1
snapshot: cartels
run: pidof ntpd
exit: 1
=== case single shot stops at the first ID of the first name
snapshot: cartels
run: pidof -s crond sh
exit: 0
--- stdout
1001 
=== case single shot goes on to a later name when the first finds nothing
snapshot: cartels
run: pidof -s ntpd sh
exit: 0
--- stdout
1004 
=== case a name with a '/' not at the start is skipped; the others are searched
snapshot: cartels
run: pidof bin/crond sh
exit: 0
--- stdout
1004 1009 
=== case without -x a script name finds nothing
snapshot: cartels
run: pidof job.sh
exit: 1
=== case -x finds scripts of /bin/sh, /bin/ash and /bin/bash only
snapshot: cartels
run: pidof -x job.sh
exit: 0
--- stdout
1004 1007 1008 
=== case -x with the script's path
snapshot: cartels
run: pidof -x /opt/job.sh
exit: 0
--- stdout
1004 1007 1008 
=== case -o omits an ID
snapshot: cartels
run: pidof -o 1002 crond
exit: 0
--- stdout
1001 1003 
=== case omitting every match writes nothing, status 1
snapshot: cartels
run: pidof -o 1001 -o 1002 -o 1003 crond
exit: 1
=== case 256 omits are accepted
snapshot: cartels
run: pidof -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 crond
exit: 0
--- stdout
1001 1002 1003 
=== case the 257th omit ends the command before any search
snapshot: cartels
run: pidof -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 -o 1 crond
exit: 1
--- stderr
Too many omits
=== case -o %PPID omits the process that started pidof
snapshot: parent
mode: sim
value: PP echo $PPID
run: pidof -o %PPID sh
exit: 0
--- stdout
1004 
=== case without -o %PPID the parent is found
snapshot: parent
mode: sim
value: PP echo $PPID
run: pidof sh
exit: 0
--- stdout
@PP 1004 
=== case an unknown option: usage, status 1
snapshot: cartels
run: pidof -z crond
exit: 1
--- stderr
pidof: invalid option -- 'z'
find the process ID of running programs
pidof program program ...
      -s   Single shot, only return one pid
      -x   Scripts too, would also return ids of shells
      -o   Pid to omit
=== case options and no name: nothing written, status 1
snapshot: cartels
run: pidof -s -x
exit: 1
=== case no cartels
snapshot: no-cartels
run: pidof crond
exit: 1
=== case the cartel list cannot be read: one message per name
snapshot: unlisted
run: pidof crond sh
exit: 1
--- stderr
CartelList: error fetching cartel list 0xbad0003
CartelList: error fetching cartel list 0xbad0003

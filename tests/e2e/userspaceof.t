userspaceof: the userspace ID of every world with the given world ID.

=== snapshot worlds
{"buildDate": "Nov 30 2026",
 "tree": {"world": {
   "1": {"info": {"worldId": 1, "userspaceId": 0}},
   "12": {"info": {"worldId": 12, "userspaceId": 3}},
   "13": {"info": {"$status": "0xbad0003"}},
   "14": {"info": {"worldId": 14, "userspaceId": -2}},
   "40": {"info": {"worldId": 12, "userspaceId": 5}},
   "4294967295": {"info": {"worldId": 4294967295, "userspaceId": 7}}
 }}}
=== snapshot no-worlds
{"buildDate": "Nov 30 2026", "tree": {"world": {}}}
=== snapshot unlisted extends worlds
{"tree": {"world": {"$listStatus": "0xbad0017"}}}
=== case no argument: usage on standard error
snapshot: worlds
run: userspaceof
exit: 1
--- stderr
find the userspace ID of running programs
userspaceof WID
=== case every world with the ID is printed, not just the first
snapshot: worlds
run: userspaceof 12
exit: 0
--- stdout
3 5 
=== case the userspace ID prints signed; further arguments are ignored
snapshot: worlds
run: userspaceof 14 12
exit: 0
--- stdout
-2 
=== case a world whose record cannot be read is passed over
snapshot: worlds
run: userspaceof 13
exit: 1
=== case 0 is a bad world ID
snapshot: worlds
run: userspaceof 0
exit: 1
--- stdout
bad world ID
=== case a world that does not exist: nothing written, status 1
snapshot: worlds
run: userspaceof 99
exit: 1
=== case -1 wraps to the largest world ID
snapshot: worlds
run: userspaceof -1
exit: 0
--- stdout
7 
=== case an ID beyond 32 bits is the largest world ID, not cut to world 12
snapshot: worlds
run: userspaceof 4294967308
exit: 0
--- stdout
7 
=== case no worlds: status 1, no message
snapshot: no-worlds
run: userspaceof 12
exit: 1
=== case the world list cannot be read
snapshot: unlisted
run: userspaceof 12
exit: 1
--- stderr
CartelList: error fetching cartel list 0xbad0017

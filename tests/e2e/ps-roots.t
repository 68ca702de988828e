ps: the roots whose userspace ID is beyond the root table.  Each such root
is warned about once, after the whole gathering and before any output; a
gathering that fails on a later world writes no warning.  The snapshots
patch ps-worlds.json (see ps-flat.t) with two such roots, listed after the
host's worlds.

=== snapshot host from ps-worlds.json
=== snapshot far-roots extends host
{"tree": {"world": {"1250": {"name": "far-a",
                             "info": {"worldId": 1250, "userspaceId": 128, "cartelId": 1250, "type": 4}},
                    "1260": {"name": "far-b",
                             "info": {"worldId": 1260, "userspaceId": 300, "cartelId": 1260, "type": 4}}},
          "userworld": {"cartel": {"1250": {"cmdline": "far a", "child": {}},
                                   "1260": {"cmdline": "far b", "child": {}}}}}}
=== snapshot far-roots-then-failure extends far-roots
{"tree": {"userworld": {"cartel": {"1260": {"child": {"1261": {"$status": "0xbad0062"}}}}}}}
=== case one warning per root beyond the table
snapshot: far-roots
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
1250  1250  far-a          128      
1260  1260  far-b          300      

Total worlds:         13
Total printed worlds: 10
Total userspaces:     2
--- stderr
Warning: maximum number of userspaces reached...
Warning: maximum number of userspaces reached...
=== case a gathering that fails after such roots writes no warning
snapshot: far-roots-then-failure
run: ps -J
exit: 1
--- stderr
failed to get child info for child 1261, status No such cartel

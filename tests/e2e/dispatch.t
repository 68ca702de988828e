Start-up: own name, cache and live modes, the signature check, the command
table and both usage listings.  halvex -v stands in for any command.

=== snapshot tiny
{"buildDate": "Nov 30 2026",
 "tree": {"system": {"version": {"product": "Orvik", "version": "9.1.0",
                                 "releaseLevel": "Release", "update": "0", "build": 42}}}}
=== snapshot other-build extends tiny
{"signature": "00112233445566778899aabbccddeeff", "buildDate": "Dec 24 2026"}
=== case ordinary machine, no arguments: short usage with all sixteen names
mode: plain
exit: 1
--- stderr
usage: orxkeltools -c cache function
  available functions:
   lspci
   ps
   hwclock
   halvex
   irqinfo
   bootOption
   amldump
   pci-info
   pidof
   userspaceof
   vdu
   lsof
   vdf
   pkill
   pgrep
   uptime
=== case ordinary machine, three words are still too few
mode: plain
run: -c @TMP/x.cache halvex
exit: 1
--- stderr (any)
=== case ordinary machine, first argument not a cache word
mode: plain
run: halvex -v -l
exit: 1
--- stderr
error: must be invoked with cache when not on Nerio
=== case ordinary machine, --cache joined to its path is not a cache word
snapshot: tiny
mode: plain
run: --cache=@CACHE halvex -v
exit: 1
--- stderr
error: must be invoked with cache when not on Nerio
=== case cache mode with -c
snapshot: tiny
run: halvex -v
exit: 0
--- stdout
Orvik 9.1.0 build-00042
=== case cache mode with --cache
snapshot: tiny
argv: orxkeltools --cache @CACHE halvex -l
exit: 0
--- stdout
Orvik 9.1.0 GA
=== case a base name that begins with the own name counts as the own name
snapshot: tiny
argv: /opt/tools/orxkeltools-32 -c @CACHE halvex -v
exit: 0
--- stdout
Orvik 9.1.0 build-00042
=== case the own name in other letter case is not the own name
snapshot: tiny
argv: OrxKelTools -c @CACHE halvex -v
exit: 1
--- stderr
usage: OrxKelTools [options] [function] [arguments]
       or [function] [arguments]

Options:
   --cache, -c    Perform the operation on a given KEL cache file

Functions:
   lspci
   ps
   hwclock
   halvex
   irqinfo
   bootOption
   amldump
   pci-info
   pidof
   userspaceof
   vdu
   lsof
   vdf
   pkill
   pgrep
   uptime
=== case a missing cache file
mode: plain
run: -c @TMP/missing.cache halvex
exit: 1
--- stderr
Couldn't use specifed cache file @TMP/missing.cache: No such file
=== case a file that is not a cache file
mode: plain
setup: printf 'not a cache file at all, just some text that is long enough to pass the size test\n' > junk
run: -c @TMP/junk halvex
exit: 1
--- stderr
Couldn't use specifed cache file @TMP/junk: Not a KEL cache file
=== case a truncated cache file
snapshot: tiny
mode: plain
derive: HALF sh -c 'f=@TMP/snapshot.cache; n=$(($(stat -c %s $f) - 7)); head -c $n $f > @TMP/half.cache; echo @TMP/half.cache'
run: -c @HALF halvex -v
exit: 1
--- stderr
Couldn't use specifed cache file @TMP/half.cache: Truncated cache file
=== case a cache file with one byte changed
snapshot: tiny
mode: plain
derive: BAD sh -c 'cp @TMP/snapshot.cache @TMP/bad.cache; printf "\377" | dd of=@TMP/bad.cache bs=1 seek=90 conv=notrunc 2>/dev/null; echo @TMP/bad.cache'
run: -c @BAD halvex -v
exit: 1
--- stderr
Couldn't use specifed cache file @TMP/bad.cache: Corrupt cache file
=== case a cache from another build fails the signature check
snapshot: other-build
run: halvex -v
exit: 1
--- stderr
error: md5 signature mismatch with running orvik built on Dec 24 2026 (my build date: @BUILD_DATE)
=== case a simulator on another build fails the signature check
snapshot: other-build
mode: sim
run: halvex -v
exit: 1
--- stderr
error: md5 signature mismatch with running orvik built on Dec 24 2026 (my build date: @BUILD_DATE)
=== case an unknown command in cache mode names the re-based word
snapshot: tiny
run: nosuch -v
exit: 1
--- stderr
usage: nosuch [options] [function] [arguments]
       or [function] [arguments]

Options:
   --cache, -c    Perform the operation on a given KEL cache file

Functions:
   lspci
   ps
   hwclock
   halvex
   irqinfo
   bootOption
   amldump
   pci-info
   pidof
   userspaceof
   vdu
   lsof
   vdf
   pkill
   pgrep
   uptime
=== case simulator live mode
snapshot: tiny
mode: sim
run: halvex -v
exit: 0
--- stdout
Orvik 9.1.0 build-00042
=== case simulator, no arguments: the lookup fails on the tool's own name as given
snapshot: tiny
mode: sim
argv: /usr/lib/orvik/bin/orxkeltools
exit: 1
--- stderr
usage: /usr/lib/orvik/bin/orxkeltools [options] [function] [arguments]
       or [function] [arguments]

Options:
   --cache, -c    Perform the operation on a given KEL cache file

Functions:
   lspci
   ps
   hwclock
   halvex
   irqinfo
   bootOption
   amldump
   pci-info
   pidof
   userspaceof
   vdu
   lsof
   vdf
   pkill
   pgrep
   uptime
=== case simulator, three words stay live and -c is looked up as a command
snapshot: tiny
mode: sim
run: -c @CACHE
exit: 1
--- stderr
usage: -c [options] [function] [arguments]
       or [function] [arguments]

Options:
   --cache, -c    Perform the operation on a given KEL cache file

Functions:
   lspci
   ps
   hwclock
   halvex
   irqinfo
   bootOption
   amldump
   pci-info
   pidof
   userspaceof
   vdu
   lsof
   vdf
   pkill
   pgrep
   uptime
=== case simulator, --cache joined to its path is looked up by its base name
snapshot: tiny
mode: sim
run: --cache=@TMP/halvex -v
exit: 0
--- stdout
Orvik 9.1.0 build-00042
=== case a command word given as a path is found by its base name
snapshot: tiny
mode: sim
run: /usr/bin/halvex -l
exit: 0
--- stdout
Orvik 9.1.0 GA
=== case a command reached through its link
snapshot: tiny
mode: sim
exe: halvex
argv: halvex -v
exit: 0
--- stdout
Orvik 9.1.0 build-00042
=== case ordinary machine, a link with -c passes the cache demand but runs live
mode: plain
exe: halvex
argv: halvex -c a b
exit: 1
--- stderr
halvex: invalid option -- 'c'
halvex      -v, --version         Get version information for orvik
            -l, --level           Get release level information
            -h, --help            Print this menu
=== case a folder as the cache file
mode: plain
run: -c @TMP halvex -v
exit: 1
--- stderr
Couldn't use specifed cache file @TMP: Is a folder, not a cache file
=== case a JSON snapshot given as the cache file gets the hint to build one
snapshot: tiny
mode: plain
run: -c @CACHE.json halvex -v
exit: 1
--- stderr
Couldn't use specifed cache file @CACHE.json: A JSON snapshot, not a cache file (build one with: kelcache build SNAPSHOT -o FILE)
=== case a cache file of the previous format version
snapshot: tiny
mode: plain
derive: OLD sh -c 'cp @CACHE old.cache && printf "\001" | dd of=old.cache bs=1 seek=8 conv=notrunc 2>/dev/null && echo @TMP/old.cache'
run: -c @OLD halvex -v
exit: 1
--- stderr
Couldn't use specifed cache file @TMP/old.cache: Unsupported cache file version
=== case a simulator whose snapshot cannot be loaded names it before the signature message
mode: plain
env: ORXKEL_SIMULATOR=@TMP/missing.cache
run: halvex -v
exit: 1
--- stderr
Couldn't load simulator snapshot @TMP/missing.cache: No such file
error: md5 signature mismatch with running orvik built on unavailable (my build date: @BUILD_DATE)
=== case a simulator given a JSON snapshot says so
snapshot: tiny
mode: plain
env: ORXKEL_SIMULATOR=@CACHE.json
run: halvex -v
exit: 1
--- stderr
Couldn't load simulator snapshot @CACHE.json: A JSON snapshot, not a cache file (build one with: kelcache build SNAPSHOT -o FILE)
error: md5 signature mismatch with running orvik built on unavailable (my build date: @BUILD_DATE)
=== case a damaged data byte passes opening and kelcache verify finds it
snapshot: tiny
exe: kelcache
derive: BAD sh -c 'cp @CACHE bad.cache && n=$(($(stat -c %s bad.cache) - 1)) && printf "\377" | dd of=bad.cache bs=1 seek=$n conv=notrunc 2>/dev/null && echo @TMP/bad.cache'
argv: kelcache verify @BAD
check: @BIN/kelcache verify @CACHE >/dev/null
check: ! @BIN/kelcache dump @BAD 2>/dev/null
exit: 1
--- stderr
kelcache: @TMP/bad.cache: Corrupt cache file

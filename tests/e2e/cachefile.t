Cache files as files: what the tool and kelcache do with hostile paths in
place of a cache file or a snapshot (a FIFO, a link, a folder, a huge sparse
file), and how kelcache replaces its output.  Every target lies in the case's
own folder.  A FIFO must end the run at once with a message and a failure;
its text is not the point (the FIFO cases only check that there is one).

=== snapshot tiny
{"buildDate": "Nov 30 2026",
 "tree": {"system": {"version": {"product": "Orvik", "version": "9.1.0",
                                 "releaseLevel": "Release", "update": "0", "build": 42}}}}
=== case a FIFO as the cache file ends at once
mode: plain
setup: mkfifo fifo
run: -c @TMP/fifo halvex -v
timeout: 10
check: [ -n "$(timeout 10 @BIN/orxkeltools -c @TMP/fifo halvex -v 2>&1 >/dev/null </dev/null)" ]
exit: 1
--- stderr (any)
=== case a FIFO as the simulator's snapshot ends at once
mode: plain
setup: mkfifo fifo
env: ORXKEL_SIMULATOR=@TMP/fifo
run: halvex -v
timeout: 10
check: [ -n "$(ORXKEL_SIMULATOR=@TMP/fifo timeout 10 @BIN/orxkeltools halvex -v 2>&1 >/dev/null </dev/null)" ]
exit: 1
--- stderr (any)
=== case kelcache dump of a FIFO ends at once
exe: kelcache
setup: mkfifo fifo
argv: kelcache dump @TMP/fifo
timeout: 10
check: [ -n "$(timeout 10 @BIN/kelcache dump @TMP/fifo 2>&1 >/dev/null </dev/null)" ]
exit: 1
--- stderr (any)
=== case kelcache build from a FIFO ends at once and writes nothing
exe: kelcache
setup: mkfifo fifo
argv: kelcache build @TMP/fifo -o @TMP/out.cache
timeout: 10
check: [ ! -e out.cache ] && [ -p fifo ]
check: [ -n "$(timeout 10 @BIN/kelcache build @TMP/fifo -o @TMP/out.cache 2>&1 >/dev/null </dev/null)" ]
exit: 1
--- stderr (any)
=== case kelcache build refuses a FIFO as its target and leaves it
snapshot: tiny
exe: kelcache
setup: mkfifo fifo
argv: kelcache build @CACHE.json -o @TMP/fifo
timeout: 10
check: [ -p fifo ]
exit: 1
--- stderr
kelcache: @TMP/fifo: exists and is not a regular file
=== case kelcache build refuses a link as its target and writes nothing through it
snapshot: tiny
exe: kelcache
setup: echo keep > victim && ln -s victim out.cache
argv: kelcache build @CACHE.json -o @TMP/out.cache
check: [ -L out.cache ] && [ "$(cat victim)" = keep ]
exit: 1
--- stderr
kelcache: @TMP/out.cache: exists and is not a regular file
=== case kelcache build refuses a dangling link and a folder as its target
snapshot: tiny
exe: kelcache
setup: ln -s nowhere out.cache
argv: kelcache build @CACHE.json -o @TMP/out.cache
check: [ -L out.cache ] && [ ! -e nowhere ]
check: mkdir dir && ! @BIN/kelcache build @CACHE.json -o dir 2>/dev/null && [ -d dir ] && [ -z "$(ls -A dir)" ]
exit: 1
--- stderr
kelcache: @TMP/out.cache: exists and is not a regular file
=== case kelcache build ignores a link planted where a fixed temporary name would be
snapshot: tiny
exe: kelcache
setup: echo keep > victim && ln -s victim out.cache.tmp && echo old > out.cache
argv: kelcache build @CACHE.json -o @TMP/out.cache
check: [ "$(cat victim)" = keep ] && [ -L out.cache.tmp ] && [ ! -L out.cache ]
check: cmp -s out.cache @CACHE
check: [ -z "$(ls -A | grep '^\.kelcache')" ]
exit: 0
=== case kelcache build writes a new file in the current folder
snapshot: tiny
exe: kelcache
argv: kelcache build @CACHE.json -o out.cache
check: cmp -s out.cache @CACHE && [ -z "$(ls -A | grep '^\.kelcache')" ]
exit: 0
=== case kelcache build - reads the snapshot from standard input
snapshot: tiny
exe: /bin/sh
argv: sh -c 'cat @CACHE.json | @BIN/kelcache build - -o piped.cache'
check: cmp -s piped.cache @CACHE
exit: 0
=== case a 4 GiB sparse cache file with a valid header is refused at once
snapshot: tiny
mode: plain
derive: BIG sh -c 'cp @CACHE big.cache && printf "\000\020\000\000\001\000\000\000" | dd of=big.cache bs=1 seek=64 conv=notrunc 2>/dev/null && truncate -s 4294971392 big.cache && echo @TMP/big.cache'
run: -c @BIG halvex -v
timeout: 5
exit: 1
--- stderr
Couldn't use specifed cache file @TMP/big.cache: Corrupt cache file
=== case kelcache dump refuses the same file at once
snapshot: tiny
exe: kelcache
derive: BIG sh -c 'cp @CACHE big.cache && printf "\000\020\000\000\001\000\000\000" | dd of=big.cache bs=1 seek=64 conv=notrunc 2>/dev/null && truncate -s 4294971392 big.cache && echo @TMP/big.cache'
argv: kelcache dump @BIG
timeout: 5
exit: 1
--- stderr
kelcache: @TMP/big.cache: Corrupt cache file
=== case a cache through a pipe on standard input is read whole
snapshot: tiny
exe: /bin/sh
argv: sh -c 'cat @CACHE | @BIN/orxkeltools -c /dev/stdin halvex -v'
exit: 0
--- stdout
Orvik 9.1.0 build-00042
=== case a cache through a process substitution is read whole
snapshot: tiny
exe: /bin/bash
argv: bash -c '@BIN/orxkeltools -c <(gzip -c @CACHE | gzip -dc) halvex -v'
exit: 0
--- stdout
Orvik 9.1.0 build-00042
=== case a pipe that ends inside the cache is a truncated file
snapshot: tiny
exe: /bin/sh
argv: sh -c 'head -c 200 @CACHE | @BIN/orxkeltools -c /dev/stdin halvex -v'
exit: 1
--- stderr
Couldn't use specifed cache file /dev/stdin: Truncated cache file
=== case a FIFO nobody writes to says so
mode: plain
setup: mkfifo fifo
run: -c @TMP/fifo halvex -v
timeout: 10
exit: 1
--- stderr
Couldn't use specifed cache file @TMP/fifo: Nothing was written to the pipe
=== case a character device is refused with its own status
mode: plain
run: -c /dev/null halvex -v
exit: 1
--- stderr
Couldn't use specifed cache file /dev/null: Not a regular file or a pipe
=== case kelcache info shows what a cache holds and for which build
snapshot: tiny
exe: kelcache
value: SIG @BIN/kelcache --tool-signature
argv: kelcache info @CACHE
exit: 0
--- stdout
file:        @CACHE
signature:   @SIG (matches this build)
build date:  Nov 30 2026
size:        428 bytes
entries:     1
node                                      listings     reads      sets      data
system_version                                   0         1         0         0
=== case kelcache verify passes a built cache
snapshot: tiny
exe: kelcache
argv: kelcache verify @CACHE
exit: 0
--- stdout
@CACHE: OK, 1 entries, 428 bytes
=== case kelcache --version names the version, the tree signature and the build date
exe: kelcache
value: SIG @BIN/kelcache --tool-signature
argv: kelcache --version
exit: 0
--- stdout
kelcache 1.0.0
tree signature: @SIG
build date: @BUILD_DATE

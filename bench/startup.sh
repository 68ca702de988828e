#!/bin/sh
# Start-up cost: orxkeltools running a command that prints little on the
# example host's cache, against a plain C program that prints one line.
#   bench/startup.sh [build folder, default build]
set -eu
cd "$(dirname "$0")/.."
build=${1:-build}
tmp=$(mktemp -d)
trap 'rm -rf "$tmp"' EXIT
printf '#include <stdio.h>\nint main(void) { puts("hello"); return 0; }\n' > "$tmp/hello.c"
cc -O2 -o "$tmp/hello" "$tmp/hello.c"
tool="$build/bin/orxkeltools -c $build/examples/host.cache halvex -v"
if command -v hyperfine >/dev/null; then
   hyperfine -N --warmup 50 --runs 1000 --export-json "$tmp/r.json" "$tmp/hello" "$tool" >/dev/null
   python3 - "$tmp/r.json" <<'PY'
import json, sys
r = json.load(open(sys.argv[1]))["results"]
c, t = r[0]["mean"] * 1e3, r[1]["mean"] * 1e3
print("plain C program: %.3f ms\norxkeltools halvex -v: %.3f ms\nratio: %.2f" % (c, t, t / c))
PY
else
   for cmd in "$tmp/hello" "$tool"; do
      start=$(date +%s%N)
      i=0; while [ $i -lt 500 ]; do $cmd >/dev/null; i=$((i + 1)); done
      echo "$cmd: $(( ($(date +%s%N) - start) / 500000 )) us per run"
   done
fi

#!/bin/sh
# Builds the libFuzzer targets with clang and runs each for a while:
#   scripts/fuzz.sh [seconds per target, default 300]
set -eu
cd "$(dirname "$0")/.."
seconds=${1:-300}
scripts/setup.sh
CC=clang CXX=clang++ scripts/build.sh build-fuzz -DORXKEL_FUZZ=ON -DORXKEL_TESTS=OFF \
   -DCMAKE_CXX_FLAGS="-fsanitize=fuzzer-no-link,address,undefined"
mkdir -p fuzz-out/cache fuzz-out/snapshot
# Seeds: the example host as JSON and as a cache file, and the test snapshots.
cp examples/host.json fuzz-out/snapshot/ 2>/dev/null || true
cp build-fuzz/examples/host.cache fuzz-out/cache/ 2>/dev/null || true
for t in cache snapshot; do
   echo "fuzz_$t: $seconds s"
   build-fuzz/bin/fuzz_$t -max_total_time="$seconds" -max_len=65536 fuzz-out/$t 2>&1 | tail -n 3
done

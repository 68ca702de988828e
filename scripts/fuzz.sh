#!/bin/sh
# Builds the libFuzzer targets with clang, replays each target's committed
# corpus (fuzz/corpus/<target>/) and then fuzzes it for a while:
#   scripts/fuzz.sh [seconds per target, default 300]
# New inputs go to fuzz-out/<target>/; a crashing input is saved in fuzz-out/
# and the script fails.  The seed is fixed, so that a run can be repeated.
set -eu
cd "$(dirname "$0")/.."
seconds=${1:-300}
scripts/setup.sh
CC=clang CXX=clang++ scripts/build.sh build-fuzz -DORXKEL_FUZZ=ON -DORXKEL_TESTS=OFF \
   -DCMAKE_CXX_FLAGS="-fsanitize=fuzzer-no-link,address,undefined"
status=0
for t in cache snapshot pciids; do
   mkdir -p "fuzz-out/$t"
   log="fuzz-out/$t.log"
   # The loader's own messages on standard error are expected: -close_fd_mask=2 hides them.
   flags="-max_len=65536 -close_fd_mask=2 -artifact_prefix=fuzz-out/$t- -seed=1"
   echo "fuzz_$t: the corpus, then $seconds s"
   # shellcheck disable=SC2086
   if build-fuzz/bin/fuzz_$t $flags -runs=0 "fuzz/corpus/$t" >"$log" 2>&1 &&
      build-fuzz/bin/fuzz_$t $flags -max_total_time="$seconds" "fuzz-out/$t" "fuzz/corpus/$t" >>"$log" 2>&1; then
      tail -n 1 "$log"
   else
      echo "fuzz_$t FAILED (fuzz-out/$t.log):"
      tail -n 30 "$log"
      status=1
   fi
done
exit $status

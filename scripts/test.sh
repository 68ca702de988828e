#!/bin/sh
# Sets up, builds, and runs every test: the plain build; the build with
# AddressSanitizer and UndefinedBehaviorSanitizer; a 32-bit build, as the host
# runs the tool; each fuzz target over its corpus and for a short while; and
# the install layout and the Debian package, from a build with CMake's
# default generator.
#   scripts/test.sh [seconds of fuzzing per target, default 30]
set -eu
cd "$(dirname "$0")/.."
fuzz_seconds=${1:-30}
scripts/setup.sh
jobs=$(nproc)
scripts/build.sh build
ctest --test-dir build --output-on-failure -j "$jobs"
scripts/build.sh build-asan -DORXKEL_SANITIZE=ON -DCMAKE_BUILD_TYPE=Debug
ASAN_OPTIONS=detect_leaks=1 UBSAN_OPTIONS=print_stacktrace=1 \
   ctest --test-dir build-asan --output-on-failure -j "$jobs"
scripts/build.sh build-m32 -DCMAKE_TOOLCHAIN_FILE="$PWD/cmake/i386-linux-gnu.cmake"
ctest --test-dir build-m32 --output-on-failure -j "$jobs"
scripts/fuzz.sh "$fuzz_seconds"
scripts/install-check.sh build-make

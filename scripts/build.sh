#!/bin/sh
# Builds orxkeltools into build/ (or into the folder given), with extra CMake
# options after it: scripts/build.sh build-asan -DORXKEL_SANITIZE=ON
set -eu
cd "$(dirname "$0")/.."
dir=${1:-build}
[ $# -gt 0 ] && shift
cmake -S . -B "$dir" -G Ninja "$@" >/dev/null
cmake --build "$dir"

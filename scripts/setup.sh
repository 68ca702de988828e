#!/bin/sh
# Installs what building and testing orxkeltools needs, from Debian's packages.
# Safe to run again: packages already present are left alone.
set -eu
packages="g++ clang libclang-rt-14-dev cmake ninja-build make python3 googletest libgtest-dev
libbenchmark-dev nlohmann-json3-dev hwdata pciutils coreutils hyperfine"
missing=""
for p in $packages; do
   dpkg-query -W -f='${Status}' "$p" 2>/dev/null | grep -q "install ok installed" || missing="$missing $p"
done
if [ -n "$missing" ]; then
   echo "setup: installing$missing"
   export DEBIAN_FRONTEND=noninteractive
   apt-get update -qq
   # shellcheck disable=SC2086
   apt-get install -y -qq --no-install-recommends $missing >/dev/null
fi

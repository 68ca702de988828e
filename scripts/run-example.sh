#!/bin/sh
# Sets up, builds, and runs ps on the shipped example host.
set -eu
cd "$(dirname "$0")/.."
scripts/setup.sh
scripts/build.sh build
exec build/bin/orxkeltools -c build/examples/host.cache ps -J -c -s -T

#!/bin/sh
# Usage: timeofday.sh EXPECTED COMMAND [ARG...]
#
# Runs COMMAND (uptime) and compares its standard output byte for byte with
# EXPECTED, a printf format in which " hh:mm:ss " stands for the time of day
# that starts the line.  That time must be the local one: its hour (padded to
# two columns with a space) and minute must be what date +%k:%M shows in the
# same time zone just before or just after the run.
expected=$1
shift
dir=$(mktemp -d) || exit 2
trap 'rm -rf "$dir"' EXIT

before=$(date +%k:%M)
"$@" > "$dir/out" 2>/dev/null
after=$(date +%k:%M)

shown=$(head -c 6 "$dir/out" | cut -c 2-)
if [ "$shown" != "$before" ] && [ "$shown" != "$after" ]; then
   echo "time of day '$shown', local time '$before'"
   exit 1
fi
sed -E '1s/^ ( [0-9]|1[0-9]|2[0-3]):[0-5][0-9]:[0-5][0-9] / hh:mm:ss /' "$dir/out" > "$dir/masked"
printf "$expected" > "$dir/expected"
if ! cmp -s "$dir/expected" "$dir/masked"; then
   echo "expected:"; od -c "$dir/expected"
   echo "actual:"; od -c "$dir/masked"
   exit 1
fi

#!/bin/sh
# Keeps parse.py's summaries, each with the time it was written.
exec >> /var/log/collect.out
/usr/bin/python3 /opt/scripts/parse.py --interval 30 | while read -r line; do
   echo "$(date -u +%FT%TZ) $line"
done

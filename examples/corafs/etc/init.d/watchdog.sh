#!/bin/bash
# Restarts hostd when it stops answering on its socket.
while true; do
   if ! test -S /var/run/hostd.sock; then
      echo "$(date -u +%FT%TZ) hostd socket missing" >> /var/log/messages
   fi
   sleep 60
done

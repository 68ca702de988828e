hwclock: showing the clock, setting its time and/or date, malformed input,
refused sets and a clock that cannot be read.

Sets run in simulator mode, where the clock is kept beside the snapshot: a
check runs hwclock again to see what the clock holds afterwards.  In cache
mode the snapshot's clock is read-only.

=== snapshot clock
{"buildDate": "Nov 30 2026",
 "tree": {"hardware": {"chipset": {"rtc": {"hours": 7, "minutes": 5, "seconds": 9,
                                           "day": 3, "month": 2, "year": 2026}}}}}
=== snapshot refusing extends clock
{"tree": {"hardware": {"chipset": {"rtc": {"$setStatus": "0xbad0001"}}}}}
=== snapshot unreadable
{"buildDate": "Nov 30 2026",
 "tree": {"hardware": {"chipset": {"rtc": {"$status": "0xbad0003"}}}}}
=== case show the clock
snapshot: clock
run: hwclock
exit: 0
--- stdout
07:05:09   02/03/2026   UTC
=== case operands are ignored
snapshot: clock
run: hwclock now
exit: 0
--- stdout
07:05:09   02/03/2026   UTC
=== case -t alone keeps the date; single digits are padded
snapshot: clock
mode: sim
run: hwclock -t 1:2:3
check: ORXKEL_SIMULATOR=@CACHE @BIN/orxkeltools hwclock | grep -qx '01:02:03   02/03/2026   UTC'
exit: 0
--- stdout
Clock updated.
Time: 01:02:03   Date: 02/03/2026   UTC
=== case -d alone keeps the time
snapshot: clock
mode: sim
run: hwclock --date 12/31/2027
check: ORXKEL_SIMULATOR=@CACHE @BIN/orxkeltools hwclock | grep -qx '07:05:09   12/31/2027   UTC'
exit: 0
--- stdout
Clock updated.
Time: 07:05:09   Date: 12/31/2027   UTC
=== case -t and -d together
snapshot: clock
mode: sim
run: hwclock -d 2/29/2028 --time 23:59:58
check: ORXKEL_SIMULATOR=@CACHE @BIN/orxkeltools hwclock | grep -qx '23:59:58   02/29/2028   UTC'
exit: 0
--- stdout
Clock updated.
Time: 23:59:58   Date: 02/29/2028   UTC
=== case the last -t counts; text after the third number is ignored
snapshot: clock
mode: sim
run: hwclock -t 1:1:1 -t 10:20:30xyz
check: ORXKEL_SIMULATOR=@CACHE @BIN/orxkeltools hwclock | grep -qx '10:20:30   02/03/2026   UTC'
exit: 0
--- stdout
Clock updated.
Time: 10:20:30   Date: 02/03/2026   UTC
=== case a field of -1 keeps the clock's value
snapshot: clock
mode: sim
run: hwclock -t -1:00:00
check: ORXKEL_SIMULATOR=@CACHE @BIN/orxkeltools hwclock | grep -qx '07:00:00   02/03/2026   UTC'
exit: 0
--- stdout
Clock updated.
Time: 07:00:00   Date: 02/03/2026   UTC
=== case -1 fields with both -t and -d also keep the clock's values
snapshot: clock
mode: sim
run: hwclock -t 10:-1:00 -d -1/15/-1
check: ORXKEL_SIMULATOR=@CACHE @BIN/orxkeltools hwclock | grep -qx '10:05:00   02/15/2026   UTC'
exit: 0
--- stdout
Clock updated.
Time: 10:05:00   Date: 02/15/2026   UTC
=== case a time of two fields is malformed
snapshot: clock
mode: sim
run: hwclock -t 12:30
check: ORXKEL_SIMULATOR=@CACHE @BIN/orxkeltools hwclock | grep -qx '07:05:09   02/03/2026   UTC'
exit: 1
--- stdout
Invalid time format: 12:30
=== case a date with other separators is malformed
snapshot: clock
mode: sim
run: hwclock -d 2026-02-03 -t 1:2:3
exit: 1
--- stdout
Invalid date format: 2026-02-03
=== case a number beyond int is malformed
snapshot: clock
mode: sim
run: hwclock -t 99999999999:0:0
exit: 1
--- stdout
Invalid time format: 99999999999:0:0
=== case the simulator refuses an impossible date; the clock is unchanged
snapshot: clock
mode: sim
run: hwclock -d 13/45/2026
check: ORXKEL_SIMULATOR=@CACHE @BIN/orxkeltools hwclock | grep -qx '07:05:09   02/03/2026   UTC'
exit: 1
--- stdout
KEL_Set error: 0xbad0040
=== case the simulator refuses an impossible time
snapshot: clock
mode: sim
run: hwclock -t 24:00:00
exit: 1
--- stdout
KEL_Set error: 0xbad0040
=== case a snapshot's clock is read-only
snapshot: clock
run: hwclock -t 1:2:3
exit: 1
--- stdout
KEL_Set error: 0xbad000c
=== case a stored set status refuses the set
snapshot: refusing
run: hwclock -t 1:2:3 -d 4/5/2026
exit: 1
--- stdout
KEL_Set error: 0xbad0001
=== case a clock that cannot be read is not shown
snapshot: unreadable
mode: sim
run: hwclock
exit: 1
--- stderr
Failed to read the hardware clock: Not found
=== case a clock that cannot be read gives no current values to keep
snapshot: unreadable
mode: sim
run: hwclock -t 1:2:3
exit: 1
--- stderr
Failed to read the hardware clock: Not found
=== case with both -t and -d in full the clock is not read
snapshot: unreadable
mode: sim
run: hwclock -t 1:2:3 -d 4/5/2026
check: ORXKEL_SIMULATOR=@CACHE @BIN/orxkeltools hwclock | grep -qx '01:02:03   04/05/2026   UTC'
exit: 0
--- stdout
Clock updated.
Time: 01:02:03   Date: 04/05/2026   UTC
=== case --help
snapshot: clock
run: hwclock --help
exit: 1
--- stderr
hwclock     -d --date <date>         Set date
            -t --time <time>         Set time

Valid date format: MM/DD/YYYY
Valid time format: HH:MM:SS
=== case -h is no option of hwclock
snapshot: clock
run: hwclock -h
exit: 1
--- stderr
hwclock: invalid option -- 'h'
hwclock     -d --date <date>         Set date
            -t --time <time>         Set time

Valid date format: MM/DD/YYYY
Valid time format: HH:MM:SS

uptime: the time of day, the uptime in its short and days forms, the load
averages, and each failure with the partial line it leaves.

The time of day comes from the wall clock, so each case compares standard
error and the status directly and leaves standard output to a check:
timeofday.sh runs uptime again, requires the first piece to be the local time
(as date shows it, in the same TZ) and compares the rest byte for byte, with
" hh:mm:ss " standing for the time of day.

=== snapshot base
{"buildDate": "Nov 30 2026",
 "tree": {"system": {"ntpclock": {"upTime": {"seconds": 59}}},
          "sched": {"globalStats": {"numPcpus": {"numPcpus": 4}},
                    "groups": {"0": {"stats": {"cpuStatsDir": {"cpuLoadHistory": {
                       "cpuLoadHistory1MinInPct": {"loadPct": 400},
                       "cpuLoadHistory5MinInPct": {"loadPct": 200},
                       "cpuLoadHistory15MinInPct": {"loadPct": 100}}}}}}}}}
=== snapshot day-less-1s extends base
{"tree": {"system": {"ntpclock": {"upTime": {"seconds": 86399}}}}}
=== snapshot one-day extends base
{"tree": {"system": {"ntpclock": {"upTime": {"seconds": 86400}}}}}
=== snapshot day-hour-minute-second extends base
{"tree": {"system": {"ntpclock": {"upTime": {"seconds": 90061}}}}}
=== snapshot long extends base
{"tree": {"system": {"ntpclock": {"upTime": {"seconds": 4294967295}}}}}
=== snapshot idle extends base
{"tree": {"sched": {"groups": {"0": {"stats": {"cpuStatsDir": {"cpuLoadHistory": {
   "cpuLoadHistory1MinInPct": {"loadPct": 0},
   "cpuLoadHistory5MinInPct": {"loadPct": 0},
   "cpuLoadHistory15MinInPct": {"loadPct": 0}}}}}}}}}
=== snapshot two-pcpus extends base
{"tree": {"sched": {"globalStats": {"numPcpus": {"numPcpus": 2}},
                    "groups": {"0": {"stats": {"cpuStatsDir": {"cpuLoadHistory": {
                       "cpuLoadHistory1MinInPct": {"loadPct": 150},
                       "cpuLoadHistory5MinInPct": {"loadPct": 1},
                       "cpuLoadHistory15MinInPct": {"loadPct": 333}}}}}}}}}
=== snapshot no-pcpus extends base
{"tree": {"sched": {"globalStats": {"numPcpus": {"numPcpus": 0}}}}}
=== snapshot no-uptime extends base
{"tree": {"system": {"ntpclock": {"upTime": {"$status": "0xbad0003"}}}}}
=== snapshot uptime-status-low-byte-zero extends base
{"tree": {"system": {"ntpclock": {"upTime": {"$status": "0xbad0100"}}}}}
=== snapshot no-pcpu-count extends base
{"tree": {"sched": {"globalStats": {"numPcpus": {"$status": "0xbad0001"}}}}}
=== snapshot no-1min extends base
{"tree": {"sched": {"groups": {"0": {"stats": {"cpuStatsDir": {"cpuLoadHistory": {
   "cpuLoadHistory1MinInPct": {"$status": "0xbad0017"}}}}}}}}}
=== snapshot no-5min extends base
{"tree": {"sched": {"groups": {"0": {"stats": {"cpuStatsDir": {"cpuLoadHistory": {
   "cpuLoadHistory5MinInPct": {"$status": "0xbad0014"}}}}}}}}}
=== snapshot no-15min extends base
{"tree": {"sched": {"groups": {"0": {"stats": {"cpuStatsDir": {"cpuLoadHistory": {
   "cpuLoadHistory15MinInPct": null}}}}}}}}
=== case 59 seconds: the short form; four PCPUs with 400, 200 and 100
snapshot: base
run: uptime
check: @SRC/tests/e2e/timeofday.sh ' hh:mm:ss up 00:00:59, load average: 1.00, 0.50, 0.25\n' @BIN/orxkeltools -c @CACHE uptime
exit: 0
--- stdout (any)
=== case arguments are ignored
snapshot: base
run: uptime -x --bogus operand
check: @SRC/tests/e2e/timeofday.sh ' hh:mm:ss up 00:00:59, load average: 1.00, 0.50, 0.25\n' @BIN/orxkeltools -c @CACHE uptime -x --bogus operand
exit: 0
--- stdout (any)
=== case 86399 seconds: still the short form
snapshot: day-less-1s
run: uptime
check: @SRC/tests/e2e/timeofday.sh ' hh:mm:ss up 23:59:59, load average: 1.00, 0.50, 0.25\n' @BIN/orxkeltools -c @CACHE uptime
exit: 0
--- stdout (any)
=== case 86400 seconds: the days form, "days" for one day too
snapshot: one-day
run: uptime
check: @SRC/tests/e2e/timeofday.sh ' hh:mm:ss up 1 days, 00:00:00, load average: 1.00, 0.50, 0.25\n' @BIN/orxkeltools -c @CACHE uptime
exit: 0
--- stdout (any)
=== case 90061 seconds: one day, one hour, one minute, one second
snapshot: day-hour-minute-second
run: uptime
check: @SRC/tests/e2e/timeofday.sh ' hh:mm:ss up 1 days, 01:01:01, load average: 1.00, 0.50, 0.25\n' @BIN/orxkeltools -c @CACHE uptime
exit: 0
--- stdout (any)
=== case the largest uptime
snapshot: long
run: uptime
check: @SRC/tests/e2e/timeofday.sh ' hh:mm:ss up 49710 days, 06:28:15, load average: 1.00, 0.50, 0.25\n' @BIN/orxkeltools -c @CACHE uptime
exit: 0
--- stdout (any)
=== case no load at all
snapshot: idle
run: uptime
check: @SRC/tests/e2e/timeofday.sh ' hh:mm:ss up 00:00:59, load average: 0.00, 0.00, 0.00\n' @BIN/orxkeltools -c @CACHE uptime
exit: 0
--- stdout (any)
=== case two PCPUs: 150 gives 0.75, 1 rounds to 0.01, 333 to 1.67
snapshot: two-pcpus
run: uptime
check: @SRC/tests/e2e/timeofday.sh ' hh:mm:ss up 00:00:59, load average: 0.75, 0.01, 1.67\n' @BIN/orxkeltools -c @CACHE uptime
exit: 0
--- stdout (any)
=== case the time of day is local: a zone where it is now about half past nine
snapshot: base
value: ZONE python3 -c 'import time; t = time.gmtime(); m = t.tm_hour * 60 + t.tm_min - 570; print("NINE%s%d:%02d" % ("-" if m < 0 else "", abs(m) // 60, abs(m) % 60))'
env: TZ=@ZONE
run: uptime
check: TZ=@ZONE @SRC/tests/e2e/timeofday.sh ' hh:mm:ss up 00:00:59, load average: 1.00, 0.50, 0.25\n' @BIN/orxkeltools -c @CACHE uptime
check: TZ=@ZONE @BIN/orxkeltools -c @CACHE uptime | grep -q '^  9:[0-5][0-9]:[0-5][0-9] up '
exit: 0
--- stdout (any)
=== case the uptime cannot be read: the time of day only
snapshot: no-uptime
run: uptime
check: @SRC/tests/e2e/timeofday.sh ' hh:mm:ss ' @BIN/orxkeltools -c @CACHE uptime
exit: 3
--- stdout (any)
--- stderr
Failed to get ntpclock_uptime.
=== case a failing status whose low byte is 0 still fails
snapshot: uptime-status-low-byte-zero
run: uptime
exit: 1
--- stdout (any)
--- stderr
Failed to get ntpclock_uptime.
=== case the PCPU count cannot be read
snapshot: no-pcpu-count
run: uptime
check: @SRC/tests/e2e/timeofday.sh ' hh:mm:ss up 00:00:59, ' @BIN/orxkeltools -c @CACHE uptime
exit: 1
--- stdout (any)
--- stderr
Failed to get number of pcups.
=== case no PCPUs: no division by zero
snapshot: no-pcpus
run: uptime
check: @SRC/tests/e2e/timeofday.sh ' hh:mm:ss up 00:00:59, ' @BIN/orxkeltools -c @CACHE uptime
exit: 1
--- stdout (any)
--- stderr
Cannot average the load over 0 pcpus.
=== case the 1-minute load history cannot be read
snapshot: no-1min
run: uptime
check: @SRC/tests/e2e/timeofday.sh ' hh:mm:ss up 00:00:59, ' @BIN/orxkeltools -c @CACHE uptime
exit: 23
--- stdout (any)
--- stderr
Failed to get 1 minute cpu load history.
=== case the 5-minute load history cannot be read
snapshot: no-5min
run: uptime
check: @SRC/tests/e2e/timeofday.sh ' hh:mm:ss up 00:00:59, ' @BIN/orxkeltools -c @CACHE uptime
exit: 20
--- stdout (any)
--- stderr
Failed to get 5 minute cpu load history.
=== case the 15-minute load history is missing
snapshot: no-15min
run: uptime
check: @SRC/tests/e2e/timeofday.sh ' hh:mm:ss up 00:00:59, ' @BIN/orxkeltools -c @CACHE uptime
exit: 3
--- stdout (any)
--- stderr
Failed to get 15 minute cpu load history.

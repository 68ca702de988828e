#!/usr/bin/env python3
"""kelcache capture against the number of processes: starts N, then 10N
extra processes (sleep), times the best of a few captures each, and checks
that ten times the processes cost at most eleven times as long (a capture
reads each process once).

usage: bench/capture_scale.py --bin BUILD/bin [-n N] [--runs R]
"""
import argparse
import os
import subprocess
import sys
import tempfile
import time


def best_capture(kelcache, out, runs):
    best = None
    for _ in range(runs):
        start = time.perf_counter()
        subprocess.run([kelcache, "capture", "-o", out], check=True, stderr=subprocess.DEVNULL)
        took = time.perf_counter() - start
        best = took if best is None else min(best, took)
    return best


def with_extra(count, kelcache, out, runs):
    extra = [subprocess.Popen(["sleep", "600"]) for _ in range(count)]
    try:
        time.sleep(0.2)
        procs = sum(1 for p in os.listdir("/proc") if p.isdigit())
        return procs, best_capture(kelcache, out, runs)
    finally:
        for p in extra:
            p.kill()
        for p in extra:
            p.wait()


def main():
    ap = argparse.ArgumentParser()
    ap.add_argument("--bin", required=True)
    ap.add_argument("-n", type=int, default=50)
    ap.add_argument("--runs", type=int, default=5)
    args = ap.parse_args()
    kelcache = os.path.abspath(os.path.join(args.bin, "kelcache"))
    with tempfile.TemporaryDirectory() as work:
        out = os.path.join(work, "me.cache")
        p0, t0 = with_extra(0, kelcache, out, args.runs)
        p1, t1 = with_extra(args.n, kelcache, out, args.runs)
        p10, t10 = with_extra(10 * args.n, kelcache, out, args.runs)
    print("processes %5d  capture %7.1f ms" % (p0, t0 * 1000))
    print("processes %5d  capture %7.1f ms  (N = %d extra)" % (p1, t1 * 1000, args.n))
    print("processes %5d  capture %7.1f ms  (10N extra)" % (p10, t10 * 1000))
    ratio = t10 / t1
    print("10N / N: %.2fx (at most 11x)" % ratio)
    return 0 if ratio <= 11 else 1


if __name__ == "__main__":
    sys.exit(main())

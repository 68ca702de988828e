#!/usr/bin/python3
"""Counts the kernel log's lines per module and prints the counts every interval."""
import argparse, collections, subprocess, time

parser = argparse.ArgumentParser()
parser.add_argument("--interval", type=int, default=30)
args = parser.parse_args()
log = subprocess.Popen(["/bin/cat", "/var/log/kernel.log"], stdout=subprocess.PIPE, text=True)
counts, last = collections.Counter(), time.time()
for line in log.stdout:
    counts[line.split()[1].rstrip(":")] += 1
    if time.time() - last >= args.interval:
        print(dict(counts), flush=True)
        counts.clear()
        last = time.time()

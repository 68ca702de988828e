#!/usr/bin/env python3
"""vdu -a over a tree of 100,000 entries in simulator mode, beside du -a.

    bench/vdu_walk.py --bin BUILD/bin [--entries N] [--runs R]

Builds the tree in a temporary folder (100 directories of files with sparse
sizes, charged to four disks by rules), a snapshot whose corafs root is that
tree, then times each command R times with its output sent to /dev/null and
prints the best and median wall-clock times.
"""
import argparse
import json
import os
import shutil
import statistics
import subprocess
import tempfile
import time

DISKS = [("tardisk", "base.v00"), ("tardisk", "tools.t00"), ("ramdisk", "root"), ("ramdisk", "tmpfs")]


def build_tree(root, entries):
    dirs = 100
    files = entries - dirs
    made = 0
    for d in range(dirs):
        path = os.path.join(root, "d%03d" % d)
        os.mkdir(path)
        n = files // dirs + (1 if d < files % dirs else 0)
        for f in range(n):
            name = os.path.join(path, "f%05d" % f)
            with open(name, "wb"):
                pass
            os.truncate(name, 1 + (made * 7919) % 100000)
            made += 1


def snapshot(root):
    tree = {"system": {"corafs": {
        "tardisks": {name: {"stats": {"size": 1 << 20}} for kind, name in DISKS if kind == "tardisk"},
        "ramdisks": {name: {"stats": {"minMiB": 1, "maxMiB": 64, "usedPages": 1, "peakPages": 1}}
                     for kind, name in DISKS if kind == "ramdisk"},
    }}}
    # Each top directory goes to one disk in turn; the root itself to the last.
    rules = [{"path": "d%03d" % d, "kind": DISKS[d % 4][0], "disk": DISKS[d % 4][1], "flags": 0}
             for d in range(100)]
    rules.append({"path": "", "kind": "ramdisk", "disk": "root", "flags": 0})
    return {"buildDate": "bench", "tree": tree, "simulator": {"corafsRoot": root, "corafsRules": rules}}


def timed(argv, env, cwd, runs):
    times = []
    for _ in range(runs):
        start = time.perf_counter()
        r = subprocess.run(argv, env=env, cwd=cwd, stdout=subprocess.DEVNULL, stderr=subprocess.PIPE)
        times.append(time.perf_counter() - start)
        if r.returncode != 0 or r.stderr:
            raise SystemExit("%s failed (%d): %s" % (argv[0], r.returncode, r.stderr.decode()))
    return min(times), statistics.median(times)


def main():
    ap = argparse.ArgumentParser()
    ap.add_argument("--bin", required=True, help="folder of orxkeltools and kelcache")
    ap.add_argument("--entries", type=int, default=100000)
    ap.add_argument("--runs", type=int, default=5)
    args = ap.parse_args()
    bindir = os.path.abspath(args.bin)
    work = tempfile.mkdtemp(prefix="orxkel-bench-")
    try:
        root = os.path.join(work, "root")
        os.mkdir(root)
        build_tree(root, args.entries)
        json_path = os.path.join(work, "snapshot.json")
        cache = os.path.join(work, "snapshot.cache")
        with open(json_path, "w") as f:
            json.dump(snapshot(root), f)
        subprocess.run([os.path.join(bindir, "kelcache"), "build", json_path, "-o", cache], check=True)
        env = dict(os.environ, ORXKEL_SIMULATOR=cache)
        lines = subprocess.run([os.path.join(bindir, "orxkeltools"), "vdu", "-a"], env=env, cwd=root,
                               capture_output=True, check=True).stdout.count(b"For '")
        vdu = timed([os.path.join(bindir, "orxkeltools"), "vdu", "-a"], env, root, args.runs)
        du = timed(["du", "-a"], os.environ, root, args.runs)
        print("tree: %d entries below the start, %d reports from vdu -a" % (args.entries, lines))
        print("vdu -a (simulator): best %.3f s, median %.3f s" % vdu)
        print("du -a (coreutils):  best %.3f s, median %.3f s" % du)
    finally:
        shutil.rmtree(work, ignore_errors=True)


if __name__ == "__main__":
    main()

#!/usr/bin/env python3
"""vdu -a over a tree of 100,000 entries in simulator mode, beside du -a.

    bench/vdu_walk.py --bin BUILD/bin [--entries N] [--runs R]

Builds the tree in a temporary folder (100 directories of files with sparse
sizes, charged to four disks by rules), a snapshot whose corafs root is that
tree, then runs vdu -a and du -a R times each, taking turns so that both
meet the same load, with their output sent to /dev/null. It prints, for
each, the median CPU time (user + system, from the child's resource usage:
the figure least disturbed by other work on the machine) and the median
wall-clock time, and the ratio of ours to du's. With strace installed it
also counts the system calls of one run of each (strace -c -f), the stat
family apart.

measure() returns the same figures to a caller that reports several
benchmarks together.
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


def run_once(argv, env, cwd):
    """One run: (wall seconds, CPU seconds of the child)."""
    start = time.perf_counter()
    p = subprocess.Popen(argv, env=env, cwd=cwd, stdout=subprocess.DEVNULL, stderr=subprocess.PIPE)
    err = p.stderr.read()
    p.stderr.close()
    _, status, usage = os.wait4(p.pid, 0)
    wall = time.perf_counter() - start
    p.returncode = os.waitstatus_to_exitcode(status)
    if p.returncode != 0 or err:
        raise SystemExit("%s failed (%d): %s" % (argv[0], p.returncode, err.decode()))
    return wall, usage.ru_utime + usage.ru_stime


def syscall_counts(argv, env, cwd, work):
    """(stat-family calls, all calls) of one run under strace -c -f, or None."""
    strace = shutil.which("strace")
    if strace is None:
        return None
    out = os.path.join(work, "strace.txt")
    subprocess.run([strace, "-c", "-f", "-o", out] + argv, env=env, cwd=cwd,
                   stdout=subprocess.DEVNULL, stderr=subprocess.DEVNULL, check=True)
    stats = total = 0
    with open(out) as f:
        for line in f:
            fields = line.split()
            # "% time  seconds  usecs/call  calls  [errors]  syscall"; the total line has no usecs/call.
            if len(fields) >= 5 and fields[-1] != "total" and fields[0][0].isdigit():
                calls = int(fields[3])
                total += calls
                if "stat" in fields[-1]:
                    stats += calls
    return stats, total


def measure(bindir, entries=100000, runs=7):
    """Builds the tree and snapshot, runs both commands; a dict of the figures."""
    bindir = os.path.abspath(bindir)
    work = tempfile.mkdtemp(prefix="orxkel-bench-")
    try:
        root = os.path.join(work, "root")
        os.mkdir(root)
        build_tree(root, entries)
        json_path = os.path.join(work, "snapshot.json")
        cache = os.path.join(work, "snapshot.cache")
        with open(json_path, "w") as f:
            json.dump(snapshot(root), f)
        subprocess.run([os.path.join(bindir, "kelcache"), "build", json_path, "-o", cache], check=True)
        env = dict(os.environ, ORXKEL_SIMULATOR=cache)
        vdu = [os.path.join(bindir, "orxkeltools"), "vdu", "-a"]
        du = ["du", "-a"]
        reports = subprocess.run(vdu, env=env, cwd=root, capture_output=True, check=True).stdout.count(b"For '")
        # A first run of each warms the caches; then they take turns.
        run_once(vdu, env, root)
        run_once(du, os.environ, root)
        ours, theirs = [], []
        for _ in range(runs):
            ours.append(run_once(vdu, env, root))
            theirs.append(run_once(du, os.environ, root))
        figures = {
            "entries": entries, "reports": reports, "runs": runs,
            "vdu_cpu": statistics.median(c for _, c in ours),
            "vdu_wall": statistics.median(w for w, _ in ours),
            "du_cpu": statistics.median(c for _, c in theirs),
            "du_wall": statistics.median(w for w, _ in theirs),
            "vdu_calls": syscall_counts(vdu, env, root, work),
            "du_calls": syscall_counts(du, os.environ, root, work),
        }
        figures["cpu_ratio"] = figures["vdu_cpu"] / figures["du_cpu"]
        figures["wall_ratio"] = figures["vdu_wall"] / figures["du_wall"]
        return figures
    finally:
        shutil.rmtree(work, ignore_errors=True)


def main():
    ap = argparse.ArgumentParser()
    ap.add_argument("--bin", required=True, help="folder of orxkeltools and kelcache")
    ap.add_argument("--entries", type=int, default=100000)
    ap.add_argument("--runs", type=int, default=7)
    args = ap.parse_args()
    f = measure(args.bin, args.entries, args.runs)
    print("tree: %d entries below the start, %d reports from vdu -a; medians of %d runs, load %.2f"
          % (f["entries"], f["reports"], f["runs"], os.getloadavg()[0]))
    print("%-22s %10s %10s" % ("", "CPU s", "wall s"))
    print("%-22s %10.3f %10.3f" % ("vdu -a (simulator)", f["vdu_cpu"], f["vdu_wall"]))
    print("%-22s %10.3f %10.3f" % ("du -a (coreutils)", f["du_cpu"], f["du_wall"]))
    print("%-22s %9.2fx %9.2fx   (goal: at most 1.2x)" % ("ratio", f["cpu_ratio"], f["wall_ratio"]))
    if f["vdu_calls"] is not None:
        print("system calls (strace -c -f): vdu %d stat-family of %d, du %d stat-family of %d"
              % (f["vdu_calls"] + f["du_calls"]))
    else:
        print("system calls: strace not installed, not counted")


if __name__ == "__main__":
    main()

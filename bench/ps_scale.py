#!/usr/bin/env python3
"""How `ps -J -i -c` grows with the number of worlds.

Builds snapshots of 1,000, 10,000 and 100,000 worlds with kelcache and
times `orxkeltools -c CACHE ps -J -i -c` on each (best and median wall
time of several runs, and the median CPU time, which a busy machine
disturbs less; output thrown away).  The time per world should stay about
the same from one size to the next.

    bench/ps_scale.py --bin build/bin [--runs 5] [--sizes 1000,10000,100000]

The hosts are made alike: one world in twenty is a kernel world outside
user space; the rest belong to cartels of one main world and zero to three
clone threads (whose parent cartel is their own cartel); cartels form four userspaces, each a tree below its init
cartel, a new cartel's parent picked among the cartels of its userspace
that are less than six levels deep (shallow, bushy trees, as on a real
host, so that the drawing's indentation does not grow with the size); one
cartel in fifty has a zombie child.
"""
import argparse
import json
import os
import random
import resource
import statistics
import subprocess
import sys
import tempfile
import time

USERSPACES = 4


def snapshot(n_worlds, seed=1):
    rnd = random.Random(seed)
    worlds, sched, cartels = {}, {}, {}
    last_id = [0]

    def new_id():
        last_id[0] += rnd.randint(1, 3)
        return last_id[0]

    def add_world(wid, name, cartel, parent, userspace, kind):
        worlds[str(wid)] = {
            "name": name,
            "info": {"worldId": wid, "groupId": wid, "userspaceId": userspace,
                     "cartelId": cartel, "parentCartelId": parent,
                     "processGroupId": cartel, "sessionId": cartel, "type": kind},
        }
        sched[str(wid)] = {"stats": {
            "summaryStats": {"runState": rnd.choice([1, 2, 3, 5]), "waitState": rnd.randint(0, 11)},
            "affinity": "0-63",
            "stateTimes": {"usedTime": rnd.randint(0, 10 ** 10)},
        }}

    MAX_PARENT_DEPTH = 5
    # Per userspace: the cartels that may still take children.
    parents = {u: [] for u in range(1, USERSPACES + 1)}
    depth = {}
    count = 0
    while count < n_worlds:
        if count % 20 == 0:
            add_world(new_id(), "kernel-%d" % count, 0, 0, 0, 0x1)
            count += 1
            continue
        userspace = rnd.randint(1, USERSPACES)
        cid = new_id()
        parent = rnd.choice(parents[userspace]) if parents[userspace] else 0
        depth[cid] = depth[parent] + 1 if parent else 0
        if depth[cid] <= MAX_PARENT_DEPTH:
            parents[userspace].append(cid)
        add_world(cid, "proc-%d" % cid, cid, parent, userspace, 0x4)
        count += 1
        cartels[str(cid)] = {"cmdline": "/usr/bin/proc-%d --serve --port %d" % (cid, cid % 65536),
                             "child": {}}
        if parent:
            cartels[str(parent)]["child"][str(cid)] = {"state": 0}
        for _ in range(rnd.randint(0, 3)):
            if count >= n_worlds:
                break
            add_world(new_id(), "proc-%d-thread" % cid, cid, cid, userspace, 0x24)
            count += 1
        if rnd.randint(1, 50) == 1:
            cartels[str(cid)]["child"][str(new_id())] = {"state": 1}
    return {"buildDate": "bench", "tree": {"world": worlds, "sched": {"Vcpus": sched},
                                          "userworld": {"cartel": cartels}}}


def cpu_seconds():
    usage = resource.getrusage(resource.RUSAGE_CHILDREN)
    return usage.ru_utime + usage.ru_stime


def time_ps(tool, cache, runs):
    """Best and median wall time, and median CPU time (less disturbed by a busy machine)."""
    walls, cpus = [], []
    for _ in range(runs):
        cpu, start = cpu_seconds(), time.perf_counter()
        subprocess.run([tool, "-c", cache, "ps", "-J", "-i", "-c"], check=True,
                       stdout=subprocess.DEVNULL)
        walls.append(time.perf_counter() - start)
        cpus.append(cpu_seconds() - cpu)
    return min(walls), statistics.median(walls), statistics.median(cpus)


def main():
    ap = argparse.ArgumentParser(description=__doc__.split("\n")[0])
    ap.add_argument("--bin", required=True, help="build/bin with orxkeltools and kelcache")
    ap.add_argument("--runs", type=int, default=5)
    ap.add_argument("--sizes", default="1000,10000,100000")
    args = ap.parse_args()
    tool = os.path.join(args.bin, "orxkeltools")
    kelcache = os.path.join(args.bin, "kelcache")
    print("%8s  %8s  %8s  %8s  %14s" % ("worlds", "best s", "median s", "cpu s", "cpu us/world"))
    with tempfile.TemporaryDirectory(prefix="ps-scale-") as tmp:
        for n in (int(s) for s in args.sizes.split(",")):
            src = os.path.join(tmp, "w%d.json" % n)
            cache = os.path.join(tmp, "w%d.cache" % n)
            with open(src, "w") as f:
                json.dump(snapshot(n), f)
            subprocess.run([kelcache, "build", src, "-o", cache], check=True)
            best, median, cpu = time_ps(tool, cache, args.runs)
            print("%8d  %8.4f  %8.4f  %8.4f  %14.2f" % (n, best, median, cpu, cpu / n * 1e6))
            sys.stdout.flush()


if __name__ == "__main__":
    main()

#!/usr/bin/env python3
"""Captures this machine with `kelcache capture` and compares what the tool
reads from the capture with what the Linux tools and sources say, in the same
moments.  Each comparison prints "ok: ...", "skipped: <why>" (the machine
lacks the tool or source, or reading it needs root) or "FAIL: ...".  The case
starts its own processes (sleep) and signals only those.

usage: compare.py --bin BUILD/bin
"""
import argparse
import os
import re
import shutil
import subprocess
import sys
import tempfile
import time

failures = 0


def ok(what):
    print("ok: " + what)


def skipped(what):
    print("skipped: " + what)


def fail(what):
    global failures
    failures += 1
    print("FAIL: " + what)


def run(argv, **kw):
    return subprocess.run(argv, capture_output=True, text=True, **kw)


def user_tasks():
    """The thread IDs of every user process now (kernel threads left out)."""
    tids = set()
    for pid in os.listdir("/proc"):
        if not pid.isdigit():
            continue
        try:
            with open("/proc/%s/stat" % pid) as f:
                flags = int(f.read().rsplit(")", 1)[1].split()[6])
            if flags & 0x00200000:
                continue
            tids.update(int(t) for t in os.listdir("/proc/%s/task" % pid))
        except (OSError, IndexError, ValueError):
            pass
    return tids


def read_interrupts():
    rows = {}
    with open("/proc/interrupts") as f:
        cpus = len(f.readline().split())
        for line in f:
            head, _, rest = line.partition(":")
            if not head.strip().isdigit():
                continue
            words = rest.split()
            rows[int(head)] = [int(w) for w in words[:cpus]]
    return rows


def df_ramdisks():
    r = run(["df", "-k", "--output=target,size,used", "-t", "tmpfs", "-t", "ramfs"])
    out = {}
    for line in r.stdout.splitlines()[1:]:
        target, size, used = line.rsplit(None, 2)
        out[target.strip()] = (int(size), int(used))
    return out


def main():
    ap = argparse.ArgumentParser()
    ap.add_argument("--bin", required=True)
    args = ap.parse_args()
    tool = os.path.abspath(os.path.join(args.bin, "orxkeltools"))
    kelcache = os.path.abspath(os.path.join(args.bin, "kelcache"))
    work = tempfile.mkdtemp(prefix="capture-compare-")
    started = []
    try:
        held = os.path.join(work, "held-open.txt")
        with open(held, "w") as f:
            f.write("held\n")
        tag = str(40000 + os.getpid() % 20000)
        # Two sleeps with an argument no other process has, and one that
        # holds a file open on descriptor 7.
        for _ in range(2):
            started.append(subprocess.Popen(["sleep", tag]))
        holder = subprocess.Popen(["sh", "-c", 'exec 7<"$1"; exec sleep %s1' % tag, "sh", held])
        started.append(holder)
        time.sleep(0.3)

        cache = os.path.join(work, "me.cache")
        tasks_before = user_tasks()
        up_before = float(open("/proc/uptime").read().split()[0])
        load_before = [float(x) for x in open("/proc/loadavg").read().split()[:3]]
        irq_before = read_interrupts() if os.path.exists("/proc/interrupts") else None
        df_before = df_ramdisks() if shutil.which("df") else None
        r = run([kelcache, "capture", "-o", cache])
        up_after = float(open("/proc/uptime").read().split()[0])
        load_after = [float(x) for x in open("/proc/loadavg").read().split()[:3]]
        irq_after = read_interrupts() if irq_before is not None else None
        df_after = df_ramdisks() if df_before is not None else None
        tasks_after = user_tasks()
        if r.returncode != 0:
            fail("kelcache capture: status %d: %s" % (r.returncode, r.stderr))
            return 1
        ok("kelcache capture (%s)" % (r.stderr.strip().replace("\n", "; ") or "nothing skipped"))

        def tool_out(*words, cwd=None):
            return run([tool, "-c", cache] + list(words), cwd=cwd)

        # A dump builds back to the same bytes.
        dump = os.path.join(work, "me.json")
        again = os.path.join(work, "again.cache")
        with open(dump, "w") as f:
            subprocess.run([kelcache, "dump", cache], stdout=f, check=True)
        subprocess.run([kelcache, "build", dump, "-o", again], check=True)
        if open(cache, "rb").read() == open(again, "rb").read():
            ok("kelcache dump of the capture builds back byte-identical")
        else:
            fail("kelcache dump of the capture does not build back byte-identical")

        # lspci -n and lspci against pciutils.
        pci_ids = "/usr/share/hwdata/pci.ids"
        if not shutil.which("lspci"):
            skipped("lspci: pciutils is not installed")
        elif not os.listdir("/sys/bus/pci/devices") if os.path.isdir("/sys/bus/pci/devices") else True:
            skipped("lspci: the machine has no PCI functions")
        else:
            mine = set()
            for line in tool_out("lspci", "-n").stdout.splitlines():
                m = re.match(r"(\S+) Class (\w+): (\w+:\w+)", line)
                if m:
                    mine.add(m.groups())
            theirs = set()
            for line in run(["lspci", "-nD"]).stdout.splitlines():
                w = line.split()
                theirs.add((w[0], w[1].rstrip(":"), w[2]))
            if mine == theirs:
                ok("lspci -n: %d functions, same IDs and classes as pciutils" % len(mine))
            else:
                fail("lspci -n differs: only ours %s, only pciutils' %s" % (sorted(mine - theirs), sorted(theirs - mine)))
            if not os.path.exists(pci_ids):
                skipped("lspci names: %s is missing" % pci_ids)
            else:
                names = {}
                for line in tool_out("lspci").stdout.splitlines():
                    addr, _, rest = line.partition(" ")
                    names[addr] = rest.partition(": ")[2].strip()
                r = run(["lspci", "-D", "-mm", "-i", pci_ids])
                bad = []
                for line in r.stdout.splitlines():
                    q = re.findall(r'"([^"]*)"', line)
                    addr = line.split()[0]
                    want = (q[1] + " " + q[2]).strip()
                    if names.get(addr) != want:
                        bad.append((addr, names.get(addr), want))
                if bad:
                    fail("lspci names differ: %s" % bad)
                else:
                    ok("lspci: same vendor and device names as pciutils for every function")

        # amldump against the tables.
        tables = "/sys/firmware/acpi/tables"
        if not os.path.isdir(tables):
            skipped("amldump: the machine has no ACPI tables")
        elif os.geteuid() != 0:
            skipped("amldump: reading %s needs root" % tables)
        else:
            out = os.path.join(work, "aml")
            os.mkdir(out)
            tool_out("amldump", cwd=out)
            bad = []
            count = 0
            for name in sorted(os.listdir(tables)):
                path = os.path.join(tables, name)
                if not os.path.isfile(path):
                    continue
                number = int(name[4:]) if name[4:].isdigit() else 1
                file = name[:4] + (".aml" if number == 1 else "-%d.aml" % (number - 1))
                count += 1
                got = os.path.join(out, file)
                if not os.path.exists(got) or open(got, "rb").read() != open(path, "rb").read():
                    bad.append(name)
            if bad:
                fail("amldump: not byte-identical: %s" % bad)
            else:
                ok("amldump: %d tables byte-identical to %s" % (count, tables))

        # pidof and pgrep -f find the sleeps the case started, as procps does.
        ours = {p.pid for p in started[:2]}
        pidof = set(int(x) for x in re.findall(r"\d+", tool_out("pidof", "sleep").stdout))
        pgrep = set(int(x) for x in re.findall(r"\d+", tool_out("pgrep", "-f", "^sleep %s$" % tag).stdout))
        if shutil.which("pidof"):
            procps = set(int(x) for x in run(["pidof", "sleep"]).stdout.split())
            if ours <= pidof and ours <= procps:
                ok("pidof sleep: finds the case's processes %s, as procps does" % sorted(ours))
            else:
                fail("pidof sleep: ours %s, procps %s, started %s" % (sorted(pidof), sorted(procps), sorted(ours)))
        else:
            skipped("pidof: procps' pidof is not installed")
        if shutil.which("pgrep"):
            procps = set(int(x) for x in run(["pgrep", "-f", "^sleep %s$" % tag]).stdout.split())
            if pgrep == ours == procps:
                ok("pgrep -f: the case's processes %s, as procps" % sorted(ours))
            else:
                fail("pgrep -f: ours %s, procps %s, started %s" % (sorted(pgrep), sorted(procps), sorted(ours)))
        else:
            skipped("pgrep: procps is not installed")

        # ps -u lists every task that lived through the capture.
        listed = set()
        for line in tool_out("ps", "-u").stdout.splitlines()[1:]:
            w = line.split()
            if w and w[0].isdigit():
                listed.add(int(w[0]))
        lived = tasks_before & tasks_after
        missing = lived - listed
        if missing:
            fail("ps -u: %d tasks that lived through the capture are missing: %s" % (len(missing), sorted(missing)[:20]))
        else:
            ok("ps -u: all %d tasks that lived through the capture are listed" % len(lived))

        # PID 1 of the /proc read is the first process of userspace 1, and
        # so are the case's own processes when they share its namespace.
        with open("/proc/%d/status" % os.getpid()) as f:
            nspid = [l for l in f if l.startswith("NSpid:")]
        same = not nspid or len(nspid[0].split()) == 2
        spaces = tool_out("userspaceof", "1").stdout.split() + tool_out("userspaceof", str(holder.pid)).stdout.split()
        if spaces == ["1", "1"] or (not same and spaces[:1] == ["1"]):
            ok("userspaceof: PID 1 and the case's process are in userspace 1")
        else:
            fail("userspaceof 1, userspaceof %d: %r" % (holder.pid, spaces))

        # lsof shows the held file on descriptor 7.
        rows = [l.split() for l in tool_out("lsof").stdout.splitlines()]
        if any(r[:1] == [str(holder.pid)] and "7" in r and held in r for r in rows):
            ok("lsof: %s open on descriptor 7 of %d" % (held, holder.pid))
        else:
            fail("lsof: no row for %s on descriptor 7 of %d" % (held, holder.pid))

        # uptime against /proc/uptime and /proc/loadavg.
        line = tool_out("uptime").stdout
        m = re.search(r"up (?:(\d+) days, )?(\d+):(\d+):(\d+), load average: ([\d.]+), ([\d.]+), ([\d.]+)", line)
        if not m:
            fail("uptime: unexpected output %r" % line)
        else:
            g = m.groups()
            seconds = int(g[0] or 0) * 86400 + int(g[1]) * 3600 + int(g[2]) * 60 + int(g[3])
            loads = [float(x) for x in g[4:]]
            within = int(up_before) <= seconds <= up_after + 1
            loads_ok = all(min(a, b) - 0.011 <= x <= max(a, b) + 0.011 for x, a, b in zip(loads, load_before, load_after))
            if within and loads_ok:
                ok("uptime: %d s and load %s agree with /proc/uptime and /proc/loadavg" % (seconds, loads))
            else:
                fail("uptime: %r against uptime %s..%s, load %s..%s" % (line, up_before, up_after, load_before, load_after))

        # irqinfo against /proc/interrupts.
        if irq_before is None:
            skipped("irqinfo: /proc/interrupts is missing")
        else:
            bad = []
            rows = 0
            for line in tool_out("irqinfo").stdout.splitlines()[1:]:
                m = re.match(r"0x([0-9a-f]+):((?:\s+\d+)*)", line)
                if not m:
                    continue
                irq = int(m.group(1), 16)
                counts = [int(x) for x in m.group(2).split()]
                rows += 1
                lo, hi = irq_before.get(irq), irq_after.get(irq)
                if lo is None or hi is None or len(counts) != len(lo) or not all(a <= c <= b for c, a, b in zip(counts, lo, hi)):
                    bad.append((irq, counts, lo, hi))
            if bad or rows != len(set(irq_before) & set(irq_after)):
                fail("irqinfo: %d rows, /proc/interrupts %d; differing %s" % (rows, len(irq_before), bad[:5]))
            else:
                ok("irqinfo: %d interrupts, counts within /proc/interrupts before and after" % rows)

        # vdf against df for the tmpfs and ramfs mounts.
        if df_before is None:
            skipped("vdf: df is not installed")
        else:
            bad = []
            rows = 0
            section = False
            for line in tool_out("vdf").stdout.splitlines():
                if line.startswith("Ramdisk"):
                    section = True
                    continue
                w = line.split()
                if not section or len(w) < 4 or w[0] not in df_before:
                    continue
                rows += 1
                size, used = int(w[1]), int(w[2])
                (s1, u1), (s2, u2) = df_before[w[0]], df_after.get(w[0], df_before[w[0]])
                # Sizes are whole MiB; used is whole 4 KiB pages.
                if not (min(s1, s2) - 1024 < size <= max(s1, s2)) or not (min(u1, u2) - 4 <= used <= max(u1, u2) + 4):
                    bad.append((w[0], size, used, df_before[w[0]]))
            if bad or rows != len(df_before):
                fail("vdf: %d rows against df's %d; differing %s" % (rows, len(df_before), bad))
            else:
                ok("vdf: %d ramdisks agree with df" % rows)
    finally:
        for p in started:
            p.kill()
            p.wait()
        shutil.rmtree(work, ignore_errors=True)
    return 1 if failures else 0


if __name__ == "__main__":
    sys.exit(main())

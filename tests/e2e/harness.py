#!/usr/bin/env python3
"""End-to-end golden cases for orxkeltools.

A case file (*.t) holds snapshots and cases; see tests/e2e/README.md.
Each case runs the tool once and compares standard output, standard error
and the exit status byte for byte.

    harness.py --bin BUILD/bin FILE.t...          run the cases
    harness.py --bin BUILD/bin --update FILE.t    rewrite the expected blocks
"""
import argparse
import difflib
import json
import os
import re
import shlex
import shutil
import signal
import subprocess
import sys
import tempfile
import time

SELF_SENTINEL = "@SELF"


class Case:
    def __init__(self, title, line):
        self.title = title
        self.line = line
        self.directives = []   # (key, value) in file order
        self.raw = []          # directive and comment lines, kept for --update
        self.blocks = {}       # name -> (bytes, flags)

    def get(self, key, default=None):
        values = [v for k, v in self.directives if k == key]
        return values[-1] if values else default

    def all(self, key):
        return [v for k, v in self.directives if k == key]


def unescape(text):
    out = bytearray()
    i = 0
    data = text.encode()
    while i < len(data):
        c = data[i]
        if c == 0x5C and i + 1 < len(data):  # backslash
            n = chr(data[i + 1])
            if n == "x":
                out.append(int(data[i + 2:i + 4], 16))
                i += 4
                continue
            out += {"n": b"\n", "t": b"\t", "\\": b"\\", "e": b"\x1b", "b": b"\b"}[n]
            i += 2
            continue
        out.append(c)
        i += 1
    return bytes(out)


def escape(data):
    out = []
    for b in data:
        if b == 0x5C:
            out.append("\\\\")
        elif b == 0x0A:
            out.append("\n")
        elif b == 0x09:
            out.append("\t")
        elif b < 0x20 or b >= 0x7F:
            out.append("\\x%02x" % b)
        else:
            out.append(chr(b))
    return "".join(out)


def needs_escape(data):
    return any((b < 0x20 and b not in (0x09, 0x0A)) or b >= 0x7F or b == 0x5C for b in data)


def block_text(lines, flags):
    text = "".join(line + "\n" for line in lines)
    if "no newline at end" in flags:
        text = text[:-1]
    return unescape(text) if "escaped" in flags else text.encode()


def parse(path):
    """Returns (snapshots, cases, preamble lines)."""
    snapshots, cases, preamble = {}, [], []
    with open(path, encoding="utf-8") as f:
        lines = f.read().split("\n")
    if lines and lines[-1] == "":
        lines.pop()
    i = 0
    while i < len(lines) and not lines[i].startswith("=== "):
        preamble.append(lines[i])
        i += 1
    while i < len(lines):
        head = lines[i][4:]
        start = i
        i += 1
        body = []
        while i < len(lines) and not lines[i].startswith("=== "):
            body.append(lines[i])
            i += 1
        if head.startswith("snapshot "):
            words = head.split()
            name = words[1]
            if len(words) == 4 and words[2] == "from":
                snapshots[name] = ("file", os.path.join(os.path.dirname(path), words[3]), body)
            elif len(words) == 4 and words[2] == "extends":
                snapshots[name] = ("extends", words[3], "\n".join(body))
            else:
                snapshots[name] = ("json", None, "\n".join(body))
        elif head.startswith("case "):
            case = Case(head[5:], start + 1)
            block, flags, block_lines = None, "", []
            for line in body:
                if line.startswith("--- "):
                    if block:
                        case.blocks[block] = (block_lines, flags)
                    m = re.match(r"--- (\w+)\s*(\((.*)\))?$", line)
                    block, flags, block_lines = m.group(1), m.group(3) or "", []
                elif block:
                    block_lines.append(line)
                else:
                    case.raw.append(line)
                    m = re.match(r"(\w[\w-]*):\s?(.*)$", line)
                    if m and not line.startswith("#"):
                        case.directives.append((m.group(1), m.group(2)))
            if block:
                case.blocks[block] = (block_lines, flags)
            cases.append(case)
        else:
            raise SystemExit("%s:%d: unknown item '%s'" % (path, start + 1, head))
    return snapshots, cases, preamble


def merge(base, patch):
    """JSON merge patch: objects merge member by member, null deletes."""
    if not isinstance(patch, dict) or not isinstance(base, dict):
        return patch
    out = dict(base)
    for k, v in patch.items():
        if v is None:
            out.pop(k, None)
        else:
            out[k] = merge(out.get(k), v)
    return out


class Runner:
    def __init__(self, bindir, case_path):
        self.bin = os.path.abspath(bindir)
        self.tool = os.path.join(self.bin, "orxkeltools")
        self.kelcache = os.path.join(self.bin, "kelcache")
        self.case_path = case_path
        self.snapshots, self.cases, self.preamble = parse(case_path)
        self.build_date = self.tool_build_date()

    def tool_build_date(self):
        # The mismatch message shows the tool's build date; cases write @BUILD_DATE.
        out = subprocess.run([self.kelcache, "--tool-build-date"], capture_output=True, text=True)
        return out.stdout.strip()

    def snapshot_json(self, name, seen=()):
        if name in seen:
            raise SystemExit("snapshot %s extends itself" % name)
        kind, where, text = self.snapshots[name]
        if kind == "file":
            with open(where, encoding="utf-8") as f:
                return f.read()
        if kind == "extends":
            base = json.loads(self.snapshot_json(where, seen + (name,)))
            return json.dumps(merge(base, json.loads(text)), indent=1)
        return text

    def substitute(self, text, values, json_mode=False):
        if json_mode:
            # A quoted placeholder standing alone as a value (not as a member
            # name) becomes a bare number.
            def bare(m):
                v = values.get(m.group(1))
                return v if v is not None and re.fullmatch(r"-?\d+", v) else m.group(0)
            text = re.sub(r'"(@[A-Z_]+(?::[\w.-]+)?)"(?!\s*:)', bare, text)
        return re.sub(r"@[A-Z_]+(?::[\w.-]+)?", lambda m: values.get(m.group(0), m.group(0)), text)

    def build_cache(self, json_text, out):
        src = out + ".json"
        with open(src, "w", encoding="utf-8") as f:
            f.write(json_text)
        r = subprocess.run([self.kelcache, "build", src, "-o", out], capture_output=True, text=True)
        if r.returncode != 0:
            raise RuntimeError("kelcache build failed: " + r.stderr)

    def run_case(self, case, tmp):
        values = {"@TMP": tmp, "@BIN": self.bin, "@BUILD_DATE": self.build_date,
                  "@SRC": os.path.abspath(os.path.join(os.path.dirname(__file__), "..", ".."))}
        spawned, ready = [], []
        try:
            for entry in case.all("spawn"):
                name, command = entry.split(None, 1)
                p = subprocess.Popen(["sh", "-c", self.substitute(command, values)], cwd=tmp,
                                     stdin=subprocess.DEVNULL, stdout=subprocess.DEVNULL,
                                     start_new_session=True)
                spawned.append(p)
                values["@PID:" + name] = str(p.pid)
                if name + ".ready" in command:
                    ready.append((name, command))
            # A spawned command that mentions NAME.ready touches it once it is
            # ready (its traps installed); the others get a moment to start.
            for name, command in ready:
                deadline = time.time() + 10
                while not os.path.exists(os.path.join(tmp, name + ".ready")) and time.time() < deadline:
                    time.sleep(0.01)
            if len(ready) < len(spawned):
                time.sleep(0.2)
            for command in case.all("setup"):
                r = subprocess.run(["sh", "-c", self.substitute(command, values)], cwd=tmp,
                                   capture_output=True, text=True)
                if r.returncode != 0:
                    raise RuntimeError("setup failed: %s\n%s" % (command, r.stderr))
            for entry in case.all("value"):
                # value: NAME shell command -> @NAME holds its output
                name, command = entry.split(None, 1)
                r = subprocess.run(["sh", "-c", self.substitute(command, values)], cwd=tmp,
                                   capture_output=True, text=True)
                values["@" + name] = r.stdout.strip()

            cache = os.path.join(tmp, "snapshot.cache")
            snap = case.get("snapshot")
            json_text = None
            if snap:
                json_text = self.substitute(self.snapshot_json(snap), values, json_mode=True)
            self_pid = json_text is not None and SELF_SENTINEL in json_text
            if json_text is not None and not self_pid:
                self.build_cache(json_text, cache)
            values["@CACHE"] = cache
            for entry in case.all("derive"):
                # derive: NAME shell command -> @NAME, run once the cache exists
                name, command = entry.split(None, 1)
                r = subprocess.run(["sh", "-c", self.substitute(command, values)], cwd=tmp,
                                   capture_output=True, text=True)
                values["@" + name] = r.stdout.strip()

            mode = case.get("mode", "cache")
            words = shlex.split(self.substitute(case.get("run", ""), values))
            if case.get("argv") is not None:
                argv = shlex.split(self.substitute(case.get("argv"), values))
            elif mode == "cache":
                argv = ["orxkeltools", "-c", cache] + words
            else:
                argv = ["orxkeltools"] + words
            env = {k: v for k, v in os.environ.items() if not k.startswith("ORXKEL_")}
            env.setdefault("TZ", "UTC")
            if mode == "sim":
                env["ORXKEL_SIMULATOR"] = cache
            for entry in case.all("env"):
                k, v = self.substitute(entry, values).split("=", 1)
                env[k] = v
            exe = self.tool
            if case.get("exe"):
                exe = os.path.join(self.bin, case.get("exe"))
            cwd = self.substitute(case.get("cwd", tmp), values)
            if self_pid:
                # The wrapper writes the snapshot with its own process ID and
                # then becomes the tool, which keeps that ID.
                with open(cache + ".template", "w", encoding="utf-8") as f:
                    f.write(json_text)
                argv = [sys.executable, os.path.abspath(__file__), "--self-exec", self.kelcache,
                        cache, exe] + argv
                exe = sys.executable
            stdin = subprocess.DEVNULL
            timeout = float(case.get("timeout", "60"))
            target = case.get("stdout")
            if target is None:
                r = subprocess.run(argv, executable=exe, env=env, cwd=cwd, stdin=stdin,
                                   capture_output=True, timeout=timeout)
            else:
                r = run_with_stdout(target, argv, exe, env, cwd, stdin, timeout)
            values["@STATUS"] = str(r.returncode)
            failures = []
            for command in case.all("check"):
                c = subprocess.run(["sh", "-c", self.substitute(command, values)], cwd=tmp,
                                   capture_output=True, text=True)
                if c.returncode != 0:
                    failures.append("check failed: %s\n%s%s" % (command, c.stdout, c.stderr))
            return r, values, failures
        finally:
            for p in spawned:
                try:
                    os.killpg(p.pid, signal.SIGKILL)
                except ProcessLookupError:
                    pass
                p.wait()

    def expected(self, case, name, values):
        if name not in case.blocks:
            return b""
        lines, flags = case.blocks[name]
        if "any" in flags:
            return None
        text = block_text(lines, flags)
        if "@" in text.decode("latin-1"):
            text = self.substitute(text.decode("latin-1"), values).encode("latin-1")
        return text

    def run(self, update=False, only=None):
        passed = failed = 0
        for case in self.cases:
            if only and only not in case.title:
                continue
            tmp = tempfile.mkdtemp(prefix="orxkel-e2e-")
            try:
                try:
                    r, values, failures = self.run_case(case, tmp)
                except (RuntimeError, subprocess.TimeoutExpired) as e:
                    print("FAIL %s:%d %s\n  %s" % (self.case_path, case.line, case.title, e))
                    failed += 1
                    continue
                if update:
                    self.record(case, r, values)
                    continue
                problems = list(failures)
                for name, actual in (("stdout", r.stdout), ("stderr", r.stderr)):
                    want = self.expected(case, name, values)
                    if want is not None and want != actual:
                        problems.append(diff(name, want, actual))
                want_status = int(case.get("exit", "0"))
                if r.returncode != want_status:
                    problems.append("exit status %d, expected %d" % (r.returncode, want_status))
                if problems:
                    failed += 1
                    print("FAIL %s:%d %s" % (self.case_path, case.line, case.title))
                    for p in problems:
                        print("  " + p.replace("\n", "\n  "))
                else:
                    passed += 1
            finally:
                shutil.rmtree(tmp, ignore_errors=True)
        if update:
            self.write()
        return passed, failed

    def record(self, case, r, values):
        reverse = {v: k for k, v in values.items()
                   if k in ("@TMP", "@CACHE", "@BUILD_DATE") or k.startswith("@PID:")}
        case.directives = [(k, v) for k, v in case.directives if k != "exit"]
        case.raw = [l for l in case.raw if not l.startswith("exit:")]
        while case.raw and case.raw[-1] == "":
            case.raw.pop()
        case.raw.append("exit: %d" % r.returncode)
        for name, data in (("stdout", r.stdout), ("stderr", r.stderr)):
            old = case.blocks.get(name)
            if old and "any" in old[1]:
                continue
            if not data:
                case.blocks.pop(name, None)
                continue
            text = data.decode("latin-1")
            for value in sorted(reverse, key=len, reverse=True):
                if len(value) > 3:
                    text = text.replace(value, reverse[value])
            data = text.encode("latin-1")
            flags = []
            if needs_escape(data):
                flags.append("escaped")
                body = escape(data)
            else:
                body = data.decode("latin-1")
            if not body.endswith("\n"):
                flags.append("no newline at end")
                body += "\n"
            case.blocks[name] = (body[:-1].split("\n"), ", ".join(flags))

    def write(self):
        out = list(self.preamble)
        for name, (kind, where, text) in self.snapshots.items():
            if kind == "file":
                out.append("=== snapshot %s from %s" % (name, os.path.relpath(where, os.path.dirname(self.case_path))))
                out += text
            elif kind == "extends":
                out.append("=== snapshot %s extends %s" % (name, where))
                out.append(text)
            else:
                out.append("=== snapshot %s" % name)
                out.append(text)
        for case in self.cases:
            out.append("=== case " + case.title)
            out += case.raw
            for name in ("stdout", "stderr"):
                if name in case.blocks:
                    lines, flags = case.blocks[name]
                    out.append("--- %s%s" % (name, " (%s)" % flags if flags else ""))
                    out += lines
        with open(self.case_path, "w", encoding="utf-8") as f:
            f.write("\n".join(out) + "\n")


def diff(name, want, actual):
    a = escape(want).splitlines(keepends=True)
    b = escape(actual).splitlines(keepends=True)
    lines = difflib.unified_diff(a, b, "expected " + name, "actual " + name, lineterm="")
    return "".join(l if l.endswith("\n") else l + "\n" for l in lines).rstrip("\n")


def run_with_stdout(target, argv, exe, env, cwd, stdin, timeout):
    """Runs the tool with standard output on /dev/full ("full") or closed
    ("closed"); the captured standard output is then empty."""
    if target == "full":
        with open("/dev/full", "wb") as full:
            r = subprocess.run(argv, executable=exe, env=env, cwd=cwd, stdin=stdin, stdout=full,
                               stderr=subprocess.PIPE, timeout=timeout)
    elif target == "closed":
        r = subprocess.run(argv, executable=exe, env=env, cwd=cwd, stdin=stdin,
                           stdout=subprocess.DEVNULL, stderr=subprocess.PIPE, timeout=timeout,
                           preexec_fn=lambda: os.close(1))
    else:
        raise RuntimeError("stdout: full or closed, not %r" % target)
    r.stdout = b""
    return r


def self_exec(kelcache, cache, exe, argv):
    with open(cache + ".template", encoding="utf-8") as f:
        text = f.read().replace('"%s"' % SELF_SENTINEL, str(os.getpid())).replace(SELF_SENTINEL, str(os.getpid()))
    with open(cache + ".json", "w", encoding="utf-8") as f:
        f.write(text)
    r = subprocess.run([kelcache, "build", cache + ".json", "-o", cache], capture_output=True)
    if r.returncode != 0:
        sys.stderr.buffer.write(r.stderr)
        sys.exit(125)
    os.execve(exe, argv, os.environ)


def main():
    if len(sys.argv) > 1 and sys.argv[1] == "--self-exec":
        kelcache, cache, exe = sys.argv[2:5]
        self_exec(kelcache, cache, exe, sys.argv[5:])
    ap = argparse.ArgumentParser()
    ap.add_argument("--bin", required=True, help="folder of orxkeltools and kelcache")
    ap.add_argument("--update", action="store_true", help="rewrite expected blocks from actual output")
    ap.add_argument("--only", help="run the cases whose title contains this text")
    ap.add_argument("files", nargs="+")
    args = ap.parse_args()
    passed = failed = 0
    for path in args.files:
        p, f = Runner(args.bin, path).run(args.update, args.only)
        passed += p
        failed += f
    print("%d passed, %d failed" % (passed, failed))
    sys.exit(1 if failed else 0)


if __name__ == "__main__":
    main()

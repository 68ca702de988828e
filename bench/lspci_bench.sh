#!/bin/sh
# Times orxkeltools' lspci beside pciutils' lspci on this machine.
#
# lspci, lspci -v, lspci -n and lspci -p run on the example host's cache and
# on a generated cache of 300 PCI functions; pciutils' lspci, lspci -v,
# lspci -n and lspci -nk (IDs and kernel modules, the job nearest to -p) run
# on the machine's own devices.  Both tools read the full
# /usr/share/hwdata/pci.ids.
#
# The floor is what no lspci can go below: a small static C program that
# starts, maps pci.ids and finds each of its lines once.  Beside it stands
# our own start-up: halvex -v on the example host's cache.
#
# Times are the mean and, in brackets, the fastest run: on a busy machine
# the fastest runs are the steadier figure.  Uses hyperfine when it is
# installed, else a timed loop (mean only).  With valgrind installed, the
# instruction counts of the example host's runs and of the floor follow;
# they do not depend on the machine's load.
#
#   bench/lspci_bench.sh [BUILD_DIR] [RUNS]     (defaults: build, 100)
set -eu
cd "$(dirname "$0")/.."
build=${1:-build}
runs=${2:-100}
tool=$build/bin/orxkeltools
example=$build/examples/host.cache
reference=$(command -v lspci || echo /usr/bin/lspci)
work=$(mktemp -d)
trap 'rm -rf "$work"' EXIT

# A host of 300 functions on ten buses: NICs, GPUs, storage and bridges of
# long-established vendors, with and without known subsystems, and eight
# kernel modules.
python3 - "$work/host300.json" <<'EOF'
import json, sys
kinds = [
    # vendor, device, subvendor, subdevice, class, module
    (0x8086, 0x1572, 0x8086, 0x0007, 0x0200, 1),
    (0x15b3, 0x1017, 0x15b3, 0x0020, 0x0200, 2),
    (0x10de, 0x1eb8, 0x10de, 0x12a2, 0x0302, 3),
    (0x1000, 0x0097, 0x1000, 0x3090, 0x0107, 4),
    (0x8086, 0x2030, 0x0000, 0x0000, 0x0604, 0),
    (0x144d, 0xa808, 0x144d, 0xa801, 0x0108, 5),
    (0x14e4, 0x16d7, 0x14e4, 0x1402, 0x0200, 6),
    (0x1af4, 0x1041, 0x1af4, 0x1100, 0x0200, 7),
    (0x102b, 0x0536, 0x15d9, 0x0898, 0x0300, 8),
    (0x8086, 0x10fb, 0x8086, 0x000c, 0x0200, 1),
]
buses = {}
for n in range(300):
    bus, slot = divmod(n, 30)
    v, d, sv, sd, cls, module = kinds[n % len(kinds)]
    header = {"vendor": v, "device": d, "subvendor": sv, "subdevice": sd, "classCode": cls,
              "isaIrq": n % 16, "irq": 0xff if n % 7 == 0 else 32 + n % 200,
              "vector": 0 if n % 11 == 0 else 0x30 + n % 0xc0, "intPin": n % 4,
              "irqFlags": 3 if cls == 0x0604 else 1, "spawnedBus": bus + 1,
              "modeFlags": 1 << (n % 3), "moduleId": module, "deviceName": "hba%d" % n,
              "physSlot": n}
    func = {"pciConfigHeader": header, "pciConfigSpace": {"bytes": "%04x%04x" % (v, d) + "00" * 252}}
    buses.setdefault(str(bus), {"slot": {}})["slot"][str(slot)] = {"func": {"0": func}}
modules = {str(m): {"general": {"name": "driver%d" % m, "id": m}} for m in range(1, 9)}
snapshot = {"buildDate": "Nov 30 2026",
            "tree": {"hardware": {"pci": {"seg": {"0": {"bus": buses}}}},
                     "system": {"modules": modules}}}
json.dump(snapshot, open(sys.argv[1], "w"))
EOF
"$build/bin/kelcache" build "$work/host300.json" -o "$work/host300.cache"

# The floor: map pci.ids and find each line once.  Static, as orxkeltools
# is, when the C library allows it.
cat > "$work/floor.c" <<'EOF'
#include <fcntl.h>
#include <stdio.h>
#include <string.h>
#include <sys/mman.h>
#include <sys/stat.h>
#include <unistd.h>
int main(void) {
   int fd = open("/usr/share/hwdata/pci.ids", O_RDONLY);
   struct stat st;
   if (fd < 0 || fstat(fd, &st) != 0) return 1;
   const char *p = mmap(NULL, st.st_size, PROT_READ, MAP_PRIVATE | MAP_POPULATE, fd, 0);
   if (p == MAP_FAILED) return 1;
   const char *end = p + st.st_size;
   long lines = 0;
   for (const char *q = p; q < end; lines++) {
      const char *newline = memchr(q, '\n', end - q);
      q = newline ? newline + 1 : end;
   }
   printf("%ld\n", lines);
   return 0;
}
EOF
cc -O2 -static -o "$work/floor" "$work/floor.c" 2>/dev/null || cc -O2 -o "$work/floor" "$work/floor.c"

# Wall time of one run of a command in milliseconds: "mean (fastest)".
time_ms() {
   if command -v hyperfine >/dev/null 2>&1; then
      hyperfine -N --style none --warmup 5 --runs "$runs" --export-json "$work/t.json" "$1" >/dev/null 2>&1
      python3 -c 'import json, sys; r = json.load(open(sys.argv[1]))["results"][0]
print("%.2f (%.2f)" % (r["mean"] * 1000, r["min"] * 1000))' "$work/t.json"
   else
      start=$(date +%s%N)
      i=0
      while [ "$i" -lt "$runs" ]; do
         $1 >/dev/null 2>&1 || true
         i=$((i + 1))
      done
      end=$(date +%s%N)
      echo "$start $end $runs" | awk '{ printf "%.2f\n", ($2 - $1) / $3 / 1e6 }'
   fi
}

# case, our time, reference, its time: the ratio of the means and, in
# brackets, of the fastest runs.
report() {
   printf '%-20s %17s ms   %-12s %17s ms %13s\n' "$1" "$2" "$3" "$4" \
      "$(echo "$2 $4" | tr -d '()' | awk '{ if (NF == 4) printf "%.2f (%.2f)", $1 / $3, $2 / $4; else printf "%.2f", $1 / $2 }')"
}

ref_plain=$(time_ms "$reference")
ref_v=$(time_ms "$reference -v")
ref_n=$(time_ms "$reference -n")
ref_nk=$(time_ms "$reference -nk")
floor=$(time_ms "$work/floor")
startup=$(time_ms "$tool -c $example halvex -v")

printf '%-20s %20s   %-12s %20s %13s\n' "orxkeltools" "" "reference" "" "ratio"
for cache in example host300; do
   if [ "$cache" = example ]; then file=$example; else file=$work/host300.cache; fi
   ours=$(time_ms "$tool -c $file lspci")
   report "lspci ($cache)" "$ours" "lspci" "$ref_plain"
   if [ "$cache" = example ]; then
      report "lspci ($cache)" "$ours" "floor" "$floor"
      report "lspci ($cache)" "$ours" "halvex -v" "$startup"
   fi
   ours=$(time_ms "$tool -c $file lspci -v")
   report "lspci -v ($cache)" "$ours" "lspci -v" "$ref_v"
   ours=$(time_ms "$tool -c $file lspci -n")
   report "lspci -n ($cache)" "$ours" "lspci -n" "$ref_n"
   # -p shows no names but loads them all the same; pciutils' -nk skips them.
   ours=$(time_ms "$tool -c $file lspci -p")
   report "lspci -p ($cache)" "$ours" "lspci -nk" "$ref_nk"
   report "" "$ours" "lspci" "$ref_plain"
done
report "floor" "$floor" "halvex -v" "$startup"

# Instructions, which a busy machine does not change.
if command -v valgrind >/dev/null 2>&1; then
   count() {
      valgrind --tool=callgrind --callgrind-out-file=/dev/null "$@" 2>&1 >/dev/null |
         sed -n 's/.*Collected : *\([0-9]*\).*/\1/p'
   }
   printf '\n%-36s %14s\n' "instructions (callgrind)" ""
   printf '%-36s %14s\n' "lspci (example)" "$(count "$tool" -c "$example" lspci)"
   printf '%-36s %14s\n' "lspci -n (example)" "$(count "$tool" -c "$example" lspci -n)"
   printf '%-36s %14s\n' "halvex -v (example)" "$(count "$tool" -c "$example" halvex -v)"
   printf '%-36s %14s\n' "floor" "$(count "$work/floor")"
fi

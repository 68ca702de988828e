#!/bin/sh
# Installs what building and testing orxkeltools needs, from Debian's packages.
# Safe to run again: packages already present are left alone.
# The 32-bit build needs the multilib compilers and, through multiarch, the
# i386 GoogleTest libraries (a static library without other i386 packages).
set -eu
packages="g++ g++-multilib clang libclang-rt-14-dev cmake ninja-build make python3 googletest libgtest-dev
libgtest-dev:i386 libbenchmark-dev nlohmann-json3-dev hwdata pciutils coreutils hyperfine qemu-user-static
groff-base man-db dpkg-dev"
export DEBIAN_FRONTEND=noninteractive
updated=""
if ! dpkg --print-foreign-architectures | grep -qx i386; then
   echo "setup: adding the i386 architecture"
   dpkg --add-architecture i386
   apt-get update -qq
   updated=yes
fi
missing=""
for p in $packages; do
   dpkg-query -W -f='${Status}' "$p" 2>/dev/null | grep -q "install ok installed" || missing="$missing $p"
done
if [ -n "$missing" ]; then
   echo "setup: installing$missing"
   [ -n "$updated" ] || apt-get update -qq
   # shellcheck disable=SC2086
   apt-get install -y -qq --no-install-recommends $missing >/dev/null
fi

# Some kernels do not run 32-bit programs (their IA32 emulation is switched
# off at boot).  There 32-bit x86 programs run through qemu's user-mode
# emulator, registered with binfmt_misc; flag P keeps argv[0], which the
# tool's dispatch reads.
probe=$(mktemp -d)
printf 'int main(void) { return 0; }\n' > "$probe/probe.c"
if gcc -m32 "$probe/probe.c" -o "$probe/probe" 2>/dev/null && ! "$probe/probe" 2>/dev/null; then
   misc=/proc/sys/fs/binfmt_misc
   [ -e "$misc/register" ] || mount -t binfmt_misc binfmt_misc "$misc"
   if [ ! -e "$misc/qemu-i386" ]; then
      echo "setup: running 32-bit x86 programs through qemu-i386-static"
      printf '%s' ':qemu-i386:M::\x7fELF\x01\x01\x01\x00\x00\x00\x00\x00\x00\x00\x00\x00\x02\x00\x03\x00:\xff\xff\xff\xff\xff\xfe\xfe\x00\xff\xff\xff\xff\xff\xff\xff\xff\xfe\xff\xff\xff:/usr/bin/qemu-i386-static:PF' \
         > "$misc/register"
   fi
   "$probe/probe" || { echo "setup: 32-bit programs still do not run" >&2; rm -rf "$probe"; exit 1; }
fi
rm -rf "$probe"

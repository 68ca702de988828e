#!/bin/sh
# Builds with CMake's default generator (Makefiles), installs into a staging
# folder and checks the layout, then builds the Debian package and checks its
# contents and metadata.
#   scripts/install-check.sh [BUILD_DIR]      (default: build-make)
set -eu
cd "$(dirname "$0")/.."
dir=${1:-build-make}
src=$PWD
cmake -S . -B "$dir" -DORXKEL_TESTS=OFF >/dev/null
cmake --build "$dir" -j "$(nproc)" >/dev/null
cd "$dir"
rm -rf stage ./*.deb
DESTDIR=$PWD/stage cmake --install . >/dev/null
prefix=stage/usr/local
failures=0
fail() {
   echo "install-check: $*" >&2
   failures=$((failures + 1))
}

# bin holds the tool and kelcache, and nothing named after a command.
bin=$(ls "$prefix/bin" | tr '\n' ' ')
[ "$bin" = "kelcache orxkeltools " ] || fail "bin holds: $bin"
commands="lspci ps hwclock halvex irqinfo bootOption amldump pci-info pidof userspaceof vdu lsof vdf pkill pgrep uptime"
for cmd in $commands; do
   link=$prefix/libexec/orxkeltools/$cmd
   [ "$(readlink "$link")" = ../../bin/orxkeltools ] || fail "$link is not a link to ../../bin/orxkeltools"
   [ -x "$link" ] || fail "$link does not resolve"
done
for page in man1/orxkeltools.1 man1/kelcache.1 man5/orxkel-snapshot.5; do
   [ -f "$prefix/share/man/$page" ] || fail "no $page"
done
[ -f "$prefix/share/bash-completion/completions/orxkeltools" ] || fail "no bash completion"
# Everything installed is in the manifest, and nothing else.
find stage -type f -o -type l | sed "s|^stage||" | sort > installed.txt
sort install_manifest.txt > manifest.txt
cmp -s installed.txt manifest.txt || fail "manifest and installed files differ: $(diff manifest.txt installed.txt | head -5)"
# The installed tool reads the installed example (a relative corafs root
# resolves beside the installed cache file).
examples=$prefix/share/orxkeltools/examples
"$prefix/bin/orxkeltools" -c "$examples/host.cache" halvex -v >/dev/null || fail "installed tool cannot read the example"
ORXKEL_SIMULATOR=$examples/host.cache "$prefix/libexec/orxkeltools/vdu" -s "$examples/corafs" | grep -q ramdisk ||
   fail "vdu through the installed link finds nothing in the example corafs"

# The Debian package.
cpack -G DEB >cpack.log 2>&1 || { cat cpack.log >&2; exit 1; }
deb=$(ls ./*.deb)
dpkg-deb -c "$deb" > contents.txt
for path in ./usr/bin/orxkeltools ./usr/bin/kelcache ./usr/share/man/man1/orxkeltools.1 \
            ./usr/share/man/man5/orxkel-snapshot.5 ./usr/share/orxkeltools/examples/host.cache; do
   grep -q " $path\$" contents.txt || fail "package lacks $path"
done
grep -q " ./usr/libexec/orxkeltools/ps -> ../../bin/orxkeltools\$" contents.txt || fail "package lacks the ps link"
grep -Eq " ./usr/bin/(ps|lspci|pkill)( |\$)" contents.txt && fail "package puts a command link into /usr/bin"
dpkg-deb -I "$deb" > info.txt
grep -q "^ Package: orxkeltools\$" info.txt || fail "package name"
grep -q "^ Version: $(sed -n 's/^project(orxkeltools VERSION \([0-9.]*\).*/\1/p' "$src/CMakeLists.txt")\$" info.txt ||
   fail "package version"
grep -q "^ Depends: .*hwdata" info.txt || fail "package does not depend on hwdata"

if [ "$failures" -ne 0 ]; then
   echo "install-check: $failures failure(s)" >&2
   exit 1
fi
echo "install-check: layout, manifest and package as expected ($deb)"

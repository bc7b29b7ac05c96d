#!/usr/bin/env bash
# SPDX-License-Identifier: MIT
#
# tests/package/chroot.sh FOLDER PACKAGE...
#
# Makes a bare Debian 12 in FOLDER, which must not be there, installs the packages there, and uses
# them as a first user does: the programs, their man pages, the CMake function, the library. Shows what
# comes out. Takes the folder away afterwards. Needs root.
set -euo pipefail
root=$(cd "$(dirname "${BASH_SOURCE[0]}")/../.." && pwd -P)
if (($# < 2)) || [[ -e $1 ]]; then
    printf 'usage: tests/package/chroot.sh FOLDER PACKAGE...  (FOLDER must not be there)\n' >&2
    exit 1
fi
folder=$1
shift
trap 'rm -rf --one-file-system "$folder"' EXIT

debootstrap --variant=minbase bookworm "$folder" >/dev/null
cp "$@" "$folder/root/"
cp -r "$root/examples" "$folder/root/"

# in_chroot TITLE: runs the commands on standard input there.
in_chroot() {
    printf '== %s\n' "$1"
    chroot "$folder" env -i HOME=/root PATH=/usr/sbin:/usr/bin:/sbin:/bin DEBIAN_FRONTEND=noninteractive \
        LC_ALL=C.UTF-8 bash -eu -o pipefail -c "cd /root; $(cat)" </dev/null
}

in_chroot "install the programs: nothing else is needed" <<'END'
dpkg -i umpre_*.deb
END
in_chroot "run them" <<'END'
cd examples
umpre main.src
umpre-deps main.src
umpre main.src | umpre-lines --gnu | head -n 5
umpre main.src | umpre-lines --strip --map
umpre -v || true
END
in_chroot "man umpre" <<'END'
{ apt-get update && apt-get install -y --no-install-recommends man-db g++ cmake ninja-build; } >install.log 2>&1 \
    || { tail install.log && false; }
for page in umpre umpre-deps umpre-lines; do
    MANWIDTH=80 man "$page" | col -b >page
    head -n 12 page
done
END
in_chroot "build with the CMake function" <<'END'
cp -r examples/cmake texts && cd texts
cmake -G Ninja -B build >/dev/null
build() { printf '%s:\n' "$1" && cmake --build build; }
build "first build"
tail -n 1 build/leds.txt
build "nothing changed" | tee output && grep -q 'no work to do' output
echo '#define PIN(port, n) n##port' >inc/pins.inc
build "nested file changed" | tee output && grep -q leds.src output && ! grep -q clock.src output
tail -n 1 build/leds.txt
END
in_chroot "build the embedding example with the library" <<'END'
dpkg -i libumpre-dev_*.deb
cmake -G Ninja -S examples/embed -B embed >/dev/null && cmake --build embed
embed/embed | tee output && diff output examples/embed/expected.txt
END
in_chroot "remove all" <<'END'
dpkg --purge libumpre-dev umpre
! command -v umpre
END

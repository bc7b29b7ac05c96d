#!/usr/bin/env bash
# SPDX-License-Identifier: MIT
#
# tests/package/chroot.sh FOLDER PACKAGE...
#
# Makes a bare Debian 12 in FOLDER, installs the packages there, and uses them as a first user does:
# the programs, their man pages, the library. Takes the folder away afterwards. Needs root.
set -euo pipefail
folder=$1
shift
trap 'rm -rf --one-file-system "$folder"' EXIT

debootstrap --variant=minbase bookworm "$folder" >/dev/null
cp "$@" "$folder/root/"

in_chroot() {
    chroot "$folder" env -i HOME=/root PATH=/usr/sbin:/usr/bin:/sbin:/bin DEBIAN_FRONTEND=noninteractive \
        LC_ALL=C.UTF-8 bash -euc "$1"
}

printf '== install the programs: nothing else is needed\n'
in_chroot 'dpkg -i /root/umpre_*.deb'
printf '== run them\n'
in_chroot 'cd /root
printf "#include \"pins.inc\"\nled = PIN(P, 7);\n" >main.src
printf "#define PIN(port, n) port##n\n" >pins.inc
umpre main.src
umpre-deps main.src
umpre main.src | umpre-lines --gnu
umpre main.src | umpre-lines --strip --map
umpre -v || true'
printf '== man umpre\n'
in_chroot '{ apt-get update && apt-get install -y --no-install-recommends man-db g++; } >/dev/null 2>&1
for page in umpre umpre-deps umpre-lines; do MANWIDTH=80 man "$page" | col -b | head -n 12; done'
printf '== build with the library\n'
in_chroot 'dpkg -i /root/libumpre-dev_*.deb
cat >/root/embed.cc <<END
#include <cstdio>
#include <umpre/preprocessing.h>
int main() { std::printf("%s\n", umpre::Preprocessing::version()); }
END
g++ -std=c++17 /root/embed.cc -lumpre -o /root/embed && /root/embed'
printf '== remove all\n'
in_chroot 'dpkg --purge libumpre-dev umpre && ! command -v umpre'

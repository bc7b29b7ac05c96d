#!/usr/bin/env bash
# SPDX-License-Identifier: MIT
#
# Builds the packages twice, from copies of the sources in two folders, in two surroundings, with the
# same SOURCE_DATE_EPOCH, and compares them byte for byte.
set -euo pipefail
root=$(cd "$(dirname "${BASH_SOURCE[0]}")/../.." && pwd -P)
work=$(mktemp -d)
trap 'rm -rf "$work"' EXIT

# build_in FOLDER [VARIABLE=VALUE...]: copies the sources there and builds the packages.
build_in() {
    local folder=$1
    mkdir -p "$folder"
    git -C "$root" ls-files -z | (cd "$root" && xargs -0 cp --parents -t "$folder")
    env SOURCE_DATE_EPOCH=1700000000 CCACHE_DISABLE=1 "${@:2}" "$folder/script/package" >"$folder/packages"
}

build_in "$work/one" TZ=UTC LC_ALL=C
build_in "$work/another/folder with a blank" TZ=Asia/Tokyo LC_ALL=C.UTF-8 HOME=/nonexistent

status=0
while read -r package; do
    name=${package##*/}
    other="$work/another/folder with a blank/build/package/$name"
    sha256sum "$package" "$other"
    cmp "$package" "$other" || status=1
done <"$work/one/packages"
exit "$status"

# SPDX-License-Identifier: MIT
# shellcheck shell=bash disable=SC2034
# What the scripts of this folder and .ci/run share: tools, builds, running tests. It is sourced.

root=$(cd "$(dirname "${BASH_SOURCE[0]}")/.." && pwd -P)
build=$root/build

# Every package with what shows that it is there (a command or a file) and what it is for.
build_packages=(
    "g++|g++|compiles the program"
    "cmake|cmake|configures the build"
    "ninja-build|ninja|runs the build"
    "flex|flex|makes the scanner from its rules"
    "libfl-dev|/usr/include/FlexLexer.h|the scanner's header"
    "libsimde-dev|/usr/include/simde/x86/sse2.h|SSE2 on every machine"
)
test_packages=(
    "python3|python3|runs the golden cases"
    "make|make|builds a sample, by its own rules and by those of CMake"
    "meson|meson|builds a sample by its own rules"
    "time|/usr/bin/time|takes the memory of a program, which a shell cannot"
    "libgtest-dev|/usr/include/gtest/gtest.h|the unit tests' framework"
    "zlib1g-dev|/usr/include/zlib.h|headers to preprocess"
    "libbz2-dev|/usr/include/bzlib.h|headers to preprocess"
    "libexpat1-dev|/usr/include/expat.h|headers to preprocess"
    "liblzma-dev|/usr/include/lzma.h|headers to preprocess"
    "libpng-dev|/usr/include/png.h|headers to preprocess"
    "pkg-config|pkg-config|flags to build with the library"
    "libsqlite3-dev|/usr/include/sqlite3.h|headers to preprocess"
)
# Only for what script/package does.
package_packages=(
    "dpkg-dev|dpkg-shlibdeps|finds what the programs depend on"
)

say() {
    printf '%s\n' "$*" >&2
}

die() {
    say "$*"
    exit 1
}

# Is there this command, or this file?
found() {
    if [[ $1 == /* ]]; then
        [[ -e $1 ]]
    else
        type -P "$1" >/dev/null
    fi
}

# Installs those of the packages that are missing, or says which they are and ends.
need() {
    local entry package probe why
    local -a packages=() lines=()
    for entry in "$@"; do
        IFS='|' read -r package probe why <<<"$entry"
        if ! found "$probe"; then
            packages+=("$package")
            lines+=("  $package: $why")
        fi
    done
    if ((${#packages[@]} == 0)); then
        return
    fi
    say "Missing on this machine:"
    printf '%s\n' "${lines[@]}" >&2
    if ((EUID != 0)) || ! type -P apt-get >/dev/null; then
        die "Cannot install without root and apt-get. On Debian: sudo apt-get install ${packages[*]}"
    fi
    say "Installing with apt-get (log: build/install.log) ..."
    export DEBIAN_FRONTEND=noninteractive
    {
        apt-get update && apt-get install -y --no-install-recommends "${packages[@]}"
    } </dev/null >"$build/install.log" 2>&1 || {
        tail -n 20 "$build/install.log" >&2
        die "apt-get failed. Needed: ${packages[*]}"
    }
}

# Is the preset's build folder ready? One that was made for another place, before the tree was moved,
# is not.
is_configured() {
    [[ -e $build/$1/build.ninja ]] \
        && grep -qxF "CMAKE_HOME_DIRECTORY:INTERNAL=$root" "$build/$1/CMakeCache.txt"
}

# configure PRESET [OPTION...]: makes the preset's build folder ready.
configure() {
    local preset=$1
    local -a options=("${@:2}")
    if ! is_configured "$preset"; then
        rm -rf "${build:?}/$preset"
    fi
    if found ccache; then
        options+=(-DCMAKE_CXX_COMPILER_LAUNCHER=ccache)
    fi
    if found /usr/bin/python3; then
        options+=(-DPython3_EXECUTABLE=/usr/bin/python3)
    fi
    (cd "$root" && cmake --preset "$preset" "${options[@]}") </dev/null
}

# Waits until no other script builds in this tree, and keeps others waiting until this one ends.
lock_builds() {
    { mkdir -p "$build" && exec 9>"$build/.lock"; } || die "Cannot write to $build"
    flock -n 9 || { say "Waiting for another build in this tree ..." && flock 9; }
}

# show_first COUNT LOG: passes so many lines on, and says where the others are.
show_first() {
    awk -v count="$1" -v name="$2" 'NR <= count { print }
        END { if (NR > count) { printf "... and %d lines more in %s\n", NR - count, name } }'
}

# Shows how far a run of ctest has come, from what it prints.
show_progress() {
    awk '/^ *[0-9]+\/[0-9]+ Test / {
        split($1, at, "/")
        if (at[1] % 100 == 0 || at[1] == at[2]) { printf "  %s of %s\n", at[1], at[2]; fflush() }
    }'
}

# build_tests PRESET [TARGET]: builds all of a preset, or a part. Shows what was printed only if that
# fails.
build_tests() {
    local log=$build/build-$1.log
    printf '%s: building\n' "$1"
    { configure "$1" -DUMPRE_TESTS=ON && cmake --build "$build/$1" --target "${2:-all}"; } </dev/null >"$log" 2>&1 || {
        grep -E -A 20 'error|Error|FAILED' "$log" | show_first 100 "$log" || true
        return 1
    }
}

# The three below add to what script/test counts: `passed` and `failed`.
passed=0
failed=0

count() {
    printf '  %d passed, %d failed\n' "$1" "$2"
    passed=$((passed + $1))
    failed=$((failed + $2))
}

# run_ctest PRESET [OPTION...]: runs the tests that these options of ctest choose. A test that was
# skipped has failed, because script/test has installed what any of them wants; but a robustness row
# may want a machine of another kind.
run_ctest() {
    local log=$build/test-$1.log bad of
    printf '%s: running tests\n' "$1"
    (cd "$root" && ctest --preset "$1" -j "$(nproc)" "${@:2}") </dev/null 2>&1 \
        | tee "$log" | show_progress || true
    read -r bad of < <(sed -n 's/.*tests passed, \([0-9]*\) tests failed out of \([0-9]*\)$/\1 \2/p' \
        "$log") || { bad=1 && of=1; }
    bad=$((bad + $(grep '^ *[0-9]*/[0-9]* Test .*\*\*\*Skipped' "$log" | grep -cv ' robust/' || true)))
    if ((bad > 0)); then
        grep -vE '^ *[0-9]+/[0-9]+ Test .* Passed |^ +Start ' "$log" | show_first 300 "$log" || true
    fi
    count $((of - bad)) "$bad"
}

# run_cases PRESET: runs the golden cases by their own runner, in seconds. A division fault is an
# outcome that some of them ask for; the sanitizer must not turn it into a report.
run_cases() {
    local log=$build/cases-$1.log good bad
    printf '%s: running golden cases\n' "$1"
    ASAN_OPTIONS=handle_sigfpe=0 python3 "$root/tests/run_cases.py" \
        --umpre "$build/$1/umpre" </dev/null >"$log" 2>&1 \
        || grep '' "$log" | show_first 300 "$log"
    read -r good bad < <(sed -n 's/^\([0-9]*\) passed, \([0-9]*\) failed$/\1 \2/p' "$log") \
        || { good=0 && bad=1; }
    count "$good" "$bad"
}

#!/usr/bin/env bash
# Builds and runs the benchmarks and prints their tables:
#
#     bench/run.sh [COUNT...]            everything on this machine: whole runs over 10, 100, 1,000 and 10,000 hot
#                                        folders or the given counts, a large preset, the parts; a quarter of an hour
#     bench/run.sh windows [COUNT...]    whole runs of the Windows program under Wine, over 10, 100 and 1,000
#
# On Debian 12 it first installs what it needs. The tables are kept in build/bench/results.md and windows.md, the
# chart in build/bench/results.svg. The machine should have nothing else to do, and /dev/shm needs 1 GB of free space.
set -euo pipefail
cd "$(dirname "${BASH_SOURCE[0]}")/.."

build=build/bench
compared=b6c3480

# Shows the output of a command only if it fails.
quietly() {
    "$@" >"$build/build.log" 2>&1 || { cat "$build/build.log" >&2; exit 1; }
}

machine() {
    local name memory system
    name=$(sed -n 's/^model name\s*: //p' /proc/cpuinfo | head -n 1)
    memory=$(awk '/^MemTotal/ { printf "%.0f", $2 / 1048576 }' /proc/meminfo)
    system=$(sed -n 's/^PRETTY_NAME="\(.*\)"/\1/p' /etc/os-release)
    echo "$(date -I), $(nproc) cores of $name, $memory GiB of memory, $system, temporary folder on" \
        "$(df --output=fstype "${TMPDIR:-/tmp}" | tail -n 1), load $(cut -d ' ' -f 1 /proc/loadavg) at the start"
    echo
}

# The program of an earlier commit, from the history.
build_compared() {
    if ! git cat-file -e "$compared^{commit}" 2>/dev/null; then
        echo "$compared is not in the history of this clone, so nothing is compared with it." >&2
        return
    fi
    mkdir -p "build/$compared"
    git archive "$compared" | tar -x -C "build/$compared"
    quietly cmake -S "build/$compared" -B "build/$compared/build" -G Ninja -DCMAKE_BUILD_TYPE=Release -DBUILD_TESTING=OFF
    quietly cmake --build "build/$compared/build" --target FolderUpgrade
    echo "build/$compared/build/FolderUpgrade"
}

what=native
if [ "${1:-}" = windows ]; then
    what=windows
    shift
fi
mkdir -p "$build"
cmake/install_packages.sh build bench

if [ "$what" = windows ]; then
    cmake/install_packages.sh mingw windows
    quietly cmake --preset windows
    quietly cmake --build --preset windows
    { machine && bench/measure.py windows build/windows '' '' "$@"; } | tee "$build/windows.md"
    exit
fi

quietly cmake --preset bench
quietly cmake --build --preset bench
old_tool=$(build_compared)
{
    machine
    bench/measure.py native "$build" "$old_tool" "$build/results.svg" "$@"
    printf '\nThe parts\n\n'
    "$build/bench/parts"
} | tee "$build/results.md"

#!/usr/bin/env bash
# Builds and runs all benchmarks and prints their tables:
#
#     bench/run.sh [--log-limit SECONDS] [COUNT...]
#
#     COUNT        numbers of hot folders of the whole runs (10, 100, 1,000 and 10,000)
#     --log-limit  how long a single run with the log on may be expected to take (120); 10,000 folders take longer
#
# On Debian 12 it first installs what it needs. The tables are kept in build/bench/results.md, the picture of the whole
# runs in build/bench/results.svg. With all counts it takes a quarter of an hour and 2 GB in the temporary folder; the
# machine should have nothing else to do.
set -euo pipefail
cd "$(dirname "${BASH_SOURCE[0]}")/.."

build=build/bench

machine() {
    local cores name memory system
    cores=$(nproc)
    name=$(sed -n 's/^model name\s*: //p' /proc/cpuinfo | head -n 1)
    memory=$(awk '/^MemTotal/ { printf "%.0f", $2 / 1048576 }' /proc/meminfo)
    system=$(sed -n 's/^PRETTY_NAME="\(.*\)"/\1/p' /etc/os-release)
    echo "$(date -I), $cores cores of $name, $memory GiB of memory, $system, temporary folder on" \
        "$(df --output=fstype "${TMPDIR:-/tmp}" | tail -n 1), load $(cut -d ' ' -f 1 /proc/loadavg) at the start"
}

cmake/install_packages.sh build bench
mkdir -p "$build"
{ cmake --preset bench && cmake --build --preset bench; } >"$build/build.log" || {
    cat "$build/build.log"
    exit 1
}

{
    machine
    printf '\nWhole runs\n\n'
    bench/whole_runs.py "$build" "$build/results.svg" "$@"
    printf '\nA preset file of 64 MiB\n\n'
    bench/preset_runs.py "$build"
    printf '\nParts\n\n'
    "$build/parts"
} | tee "$build/results.md"

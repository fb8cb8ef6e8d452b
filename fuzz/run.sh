#!/usr/bin/env bash
# Runs a fuzz target, as a test:
#
#     fuzz/run.sh corpus|fuzz PROGRAM [SAMPLES]
#
#     corpus   over its corpus, and over those files of the sample workstation whose name is SAMPLES
#     fuzz     over inputs derived from them, for FUZZ_SECONDS (default 20)
#
# An input that breaks a promise is kept in findings/ beside the program; once fixed, it goes into the target's corpus
# and stays a test.
set -euo pipefail
cd "$(dirname "${BASH_SOURCE[0]}")/.."

program=$2
target=${program##*/fuzz_}
findings=${program%/*}/findings
# In memory if possible, because every input is written to a file.
TMPDIR=$(mktemp -d -p "$([ -w /dev/shm ] && echo /dev/shm || echo "${TMPDIR:-/tmp}")")
export TMPDIR
trap 'rm -rf "$TMPDIR"' EXIT

mkdir -p "$findings" "$TMPDIR"/{found,samples}
find samples/workstation -name "${3-}" -exec cp --backup=numbered -t "$TMPDIR/samples" {} +
inputs=(fuzz/corpus/"$target" "$TMPDIR/samples")
limits=(-runs=0)
if [ "$1" = fuzz ]; then
    inputs=("$TMPDIR/found" "${inputs[@]}") # new ones go to the first
    limits=(-max_len=16384 -max_total_time="${FUZZ_SECONDS:-20}")
fi
"$program" -dict=fuzz/"$target".dict -artifact_prefix="$findings/$target-" -timeout=10 -print_final_stats=1 \
    "${limits[@]}" "${inputs[@]}" >"$TMPDIR/log" 2>&1 || {
    tail -n 60 "$TMPDIR/log"
    exit 1
}
grep number_of_executed_units "$TMPDIR/log"

#!/usr/bin/env bash
# Runs the fuzz targets: each over its whole corpus, and then for a time over what it makes of it.
#
#     fuzz/run.sh [SECONDS]
#
# SECONDS for each target, 20 if not given; with 0 the corpora alone. An input that breaks a promise is kept in
# build/fuzz/findings; once mended, it goes into the target's corpus and stays a test.
set -euo pipefail
cd "$(dirname "${BASH_SOURCE[0]}")/.."

seconds=${1-20}
findings=build/fuzz/findings
# The target, and those files of the sample workstation that are its seeds as well.
declare -A samples=([folder_cfg]=Folder.cfg [preset_text]='' [profile]=Desktop.ini)

# In memory where there is such a place, since every input is a file.
scratch=$(mktemp -d -p "$([ -w /dev/shm ] && echo /dev/shm || echo "${TMPDIR:-/tmp}")")
trap 'rm -rf "$scratch"' EXIT

fuzz() {
    local program=build/fuzz/fuzz/fuzz_$1 sample number=0
    local options=(-dict=fuzz/"$1".dict -artifact_prefix="$findings/$1-" -timeout=10 -print_final_stats=1)
    export TMPDIR=$scratch/$1
    mkdir -p "$TMPDIR"/{found,samples}
    find samples/workstation -name "${samples[$1]}" -print0 | while IFS= read -r -d '' sample; do
        cp "$sample" "$TMPDIR/samples/$((number += 1))"
    done
    "$program" "${options[@]}" -runs=0 fuzz/corpus/"$1" "$TMPDIR/samples" || return
    [ "$seconds" = 0 ] || "$program" "${options[@]}" -max_len=16384 -max_total_time="$seconds" \
        "$TMPDIR/found" fuzz/corpus/"$1" "$TMPDIR/samples"
}

cmake/install_packages.sh g++ clang libclang-rt-dev cmake ninja-build libwxgtk3.2-dev
{ cmake --preset fuzz && cmake --build --preset fuzz; } >"$scratch/build" 2>&1 || { cat "$scratch/build" >&2; exit 1; }
mkdir -p "$findings"
passed=0 failed=0
declare -A running=()
finish() {
    local target
    for target in "${!running[@]}"; do
        if wait "${running[$target]}"; then
            passed=$((passed + 1))
            echo "$target: $(awk '/number_of_executed_units/ { n += $2 } END { print n }' "$scratch/$target.log") inputs"
        else
            failed=$((failed + 1))
            tail -n 60 "$scratch/$target.log" >&2
            echo "$target: FAILED"
        fi
    done
    running=()
}
for target in "${!samples[@]}"; do
    fuzz "$target" >"$scratch/$target.log" 2>&1 &
    running[$target]=$!
    [ ${#running[@]} -lt "$(nproc)" ] || finish
done
finish
echo "$passed passed, $failed failed"
[ "$failed" = 0 ]

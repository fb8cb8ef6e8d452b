#!/usr/bin/env bash
# Runs a fuzz target, as a test:
#
#     fuzz/run.sh corpus|fuzz PROGRAM [SAMPLES]
#
#     corpus   over its corpus, and over those files of the sample workstation whose name is SAMPLES
#     fuzz     over inputs derived from them, for FUZZ_SECONDS (default 10)
#
# An input that breaks a promise is kept in findings/ beside the program; once fixed, it goes into the target's corpus
# and stays a test.
set -euo pipefail
cd "$(dirname "${BASH_SOURCE[0]}")/.."

target=${2##*/fuzz_}
findings=${2%/*}/findings
scratch=$(mktemp -d)
trap 'rm -rf "$scratch"' EXIT
mkdir -p "$findings" "$scratch"/{found,samples}
find samples/workstation -name "${3-}" -exec cp --backup=numbered -t "$scratch/samples" {} +
limits=(-runs=0)
[ "$1" = corpus ] || limits=(-max_len=16384 -max_total_time="${FUZZ_SECONDS:-10}")
# New inputs go to the first folder.
"$2" -dict=fuzz/"$target".dict -artifact_prefix="$findings/$target-" -timeout=10 "${limits[@]}" \
    "$scratch"/{found,samples} fuzz/corpus/"$target"

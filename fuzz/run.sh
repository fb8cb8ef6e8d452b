#!/usr/bin/env bash
# fuzz/run.sh PROGRAM
# Runs the fuzz target over its corpus and the sample workstation, and over inputs derived from them for FUZZ_SECONDS.
# An input that breaks a promise is kept in findings/ beside the program; once fixed, it goes into the corpus and stays
# a test.
set -euo pipefail
cd "$(dirname "${BASH_SOURCE[0]}")/.."
findings=${1%/*}/findings
scratch=$(mktemp -d)
trap 'rm -rf "$scratch"' EXIT
mkdir -p "$findings" "$scratch"/{found,samples}
find samples/workstation -type f -exec cp --backup=numbered -t "$scratch/samples" {} +
# New inputs go to the first folder.
"$1" -dict=fuzz/stored_file.dict -artifact_prefix="$findings/" -timeout=10 -max_len=16384 \
    -max_total_time="${FUZZ_SECONDS:-10}" "$scratch"/{found,samples} fuzz/corpus/stored_file

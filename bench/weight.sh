#!/usr/bin/env bash
# Prints how many lines the product and its tests have, without empty ones, and the share of the tests.
set -euo pipefail
cd "$(dirname "$0")/.."
count() {
    git ls-files "${@:2}" | grep -E "$1" | tr '\n' '\0' | xargs -0 cat | grep -c '[^[:space:]]'
}
kinds='\.(cpp|h|sh|py)$'
product=$(count "$kinds" app call check run store migrate appearance platform)
tests=$(count "$kinds" tests fuzz)
awk -v p="$product" -v t="$tests" 'BEGIN { printf "product %d, tests %d: %.1f %%\n", p, t, 100 * t / (p + t) }'

#!/usr/bin/env bash
# Prints how many lines (without empty ones) and characters the product and its tests have, and the tests' share.
set -euo pipefail
cd "$(dirname "$0")/.."
count() {
    git ls-files -z "$@" | grep -zE '\.(cpp|h|sh|py)$' | xargs -0 cat | grep '[^[:space:]]' | wc -lm
}
read -r product_lines product < <(count app call check run store migrate appearance platform)
read -r test_lines tests < <(count tests fuzz samples/installer_test.py)
awk -v a="$product_lines" -v b="$product" -v c="$test_lines" -v d="$tests" 'BEGIN {
    printf "product: %d lines, %d characters\ntests: %d lines, %d characters\n", a, b, c, d
    printf "share of the tests: %.1f %% of the lines, %.1f %% of the characters\n", 100 * c / (a + c), 100 * d / (b + d)
}'

#!/usr/bin/env bash
# Format and static checks of everything hand-written; each tool that is quiet counts as passed.
set -euo pipefail
cd "$(dirname "$0")/.."
passed=0
failed=0
check() {
    local log
    log=$(mktemp)
    if "${@:2}" >"$log" 2>&1; then
        passed=$((passed + 1))
    else
        echo "$1:"
        cat "$log"
        failed=$((failed + 1))
    fi
    rm -f "$log"
}

rooms=(app appearance migrate platform store)
mapfile -t sources < <(find "${rooms[@]}" bench fuzz tests -name '*.cpp' -o -name '*.h')
mapfile -t scripts < <(find . -path ./build -prune -o -name '*.sh' -print; echo .ci/run)
mapfile -t native < <(find "${rooms[@]}" -name '*.cpp' -not -path 'platform/windows/*')

tidy() {
    printf '%s\n' "${native[@]}" | xargs -P "$(nproc)" -n 2 clang-tidy -p build/native --quiet
}

cmake --preset native -DBUILD_TESTING=OFF >/dev/null # the compile commands
check "clang-format" clang-format --dry-run --Werror "${sources[@]}"
check "clang-tidy" tidy
check "cppcheck" cppcheck --quiet --std=c++17 --enable=warning,performance,portability -I . \
    --inline-suppr --suppress=missingIncludeSystem --error-exitcode=1 "${native[@]}"
check "shellcheck" shellcheck "${scripts[@]}"
echo "$passed passed, $failed failed"
[ "$failed" = 0 ]

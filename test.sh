#!/usr/bin/env bash
# Installs what the tests need, builds and runs them, and ends with their count.
#
#     ./test.sh             every test of this machine's program, with the sanitizers, fuzzing, faults and checks
#     ./test.sh windows     the same scenarios with the Windows programs, under Wine
#     ./test.sh coverage    the lines of the program that the tests run
#     ./test.sh checks      format and static checks alone
set -euo pipefail
cd "$(dirname "$0")"

passed=0
failed=0
skipped=0

say() {
    printf '== %s (%d s)\n' "$1" "$SECONDS"
}

quietly() {
    local log
    log=$(mktemp)
    if "$@" >"$log" 2>&1; then
        rm -f "$log"
    else
        cat "$log"
        rm -f "$log"
        echo "failed: $*" >&2
        return 1
    fi
}

build() {
    say "Building the preset $1"
    quietly cmake --preset "$1"
    quietly cmake --build --preset "$1"
}

# Reads what CTest wrote about its tests: prints the skipped ones and the line 'N passed, N failed, N skipped'. A test
# whose own output ends with such a line counts as many times as the line says.
count() {
    awk '
        /<testcase / { status = $0; sub(/.* status="/, "", status); sub(/".*/, "", status); own = "" }
        { sub(/^[ \t]*<system-out>/, "") }
        /^\[  SKIPPED \] .* ms\)$/ { sub(/.*\//, "", $4); print "skipped " $4 ": " reason }
        NF { reason = $0 }
        /^[0-9]+ passed, [0-9]+ failed, [0-9]+ skipped$/ { own = $0 }
        /<skipped message/ { status = "skipped" }
        /<\/testcase>/ {
            if (split(own, number, " ")) { passed += number[1]; failed += number[3]; skipped += number[5] }
            else if (status == "run") ++passed
            else if (status == "skipped") ++skipped
            else ++failed
        }
        END { printf "%d passed, %d failed, %d skipped\n", passed, failed, skipped }' "$1"
}

# Runs all tests of a preset.
run_tests() {
    local results=$PWD/build/$1/ctest.xml log=build/$1/ctest.txt outcome=0 number
    say "Testing the preset $1"
    rm -f "$results"
    ctest --preset "$1" --parallel "$(nproc)" --test-output-size-passed 100000 --output-junit "$results" \
        >"$log" 2>&1 || outcome=$?
    [ "$outcome" = 0 ] || grep -vE ' Passed | Start ' "$log" | sed '/^\[ RUN /{N;/\n\[       OK /d}' || true
    count "$results" | tee "build/$1/count.txt"
    read -ra number < <(tail -n 1 "build/$1/count.txt")
    [ "$outcome" = 0 ] || [ "${number[2]}" != 0 ] || number[2]=1
    passed=$((passed + number[0]))
    failed=$((failed + number[2]))
    skipped=$((skipped + number[4]))
}

native() {
    cmake/install_packages.sh build test fuzz bench
    build sanitize
    run_tests sanitize
    checks
}

windows() {
    cmake/install_packages.sh build test bench mingw windows
    say "Building wxWidgets for Windows, unless it is there"
    cmake/windows/build_wxwidgets.sh
    build windows
    run_tests windows
}

# The counters are put where runs as another user can also write them.
coverage() {
    local counters file
    cmake/install_packages.sh build test coverage
    build coverage
    counters=$(mktemp -d)
    chmod a+x "$counters"
    find "$PWD/build/coverage" -name '*.gcda' -delete
    while read -r file; do
        install -D -m 666 /dev/null "$counters${file%.gcno}.gcda"
    done < <(find "$PWD/build/coverage" -name '*.gcno')
    GCOV_PREFIX=$counters run_tests coverage
    find "$counters" -name '*.gcda' -empty -delete
    cp -r "$counters$PWD/build/coverage/." build/coverage/
    rm -r "$counters"
    gcovr --root . --filter '(app|appearance|call|check|migrate|platform|run|store)/' --exclude-throw-branches \
        --fail-under-line 95 --txt - build/coverage || failed=$((failed + 1))
}

checks() {
    cmake/install_packages.sh build checks
    quietly cmake --preset checks
    run_tests checks
}

case ${1:-} in
"") native ;;
windows) windows ;;
coverage) coverage ;;
checks) checks ;;
*)
    sed -n '2,7s/^# \{0,1\}//p' "$0" >&2
    exit 2
    ;;
esac
echo "$passed passed, $failed failed, $skipped skipped"
[ "$failed" = 0 ]

#!/usr/bin/env bash
# Builds and runs the tests and closes with their count.
#
#     ./test.sh             every test of this machine's program, with the sanitizers, fuzzing and faults
#     ./test.sh windows     the same table of scenarios against the Windows program, under Wine
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

# Runs a part of the tests whose output closes with a line 'N passed, N failed'.
part() {
    say "$1"
    shift
    local log counts
    log=$(mktemp)
    if ! "$@" >"$log" 2>&1; then
        cat "$log"
    fi
    counts=$(grep -oE '^[0-9]+ passed, [0-9]+ failed' "$log" | tail -n 1) || counts="0 passed, 1 failed"
    grep '^skipped ' "$log" || true
    tail -n 1 "$log"
    skipped=$((skipped + $(grep -c '^skipped ' "$log" || true)))
    rm -f "$log"
    passed=$((passed + ${counts%% *}))
    counts=${counts#*, }
    failed=$((failed + ${counts%% *}))
}

# Turns CTest's closing words into the one line that part() reads.
run_ctest() {
    local out=0 total failures
    ctest --preset "$1" --parallel "$(nproc)" --no-tests=error >"build/$1/ctest.txt" 2>&1 || out=$?
    total=$(sed -n 's/.* tests failed out of \([0-9]*\)$/\1/p' "build/$1/ctest.txt")
    failures=$(sed -n 's/.*, \([0-9]*\) tests failed out of .*/\1/p' "build/$1/ctest.txt")
    [ "$out" = 0 ] || grep -vE ' Passed | Start ' "build/$1/ctest.txt" || true
    echo "$((${total:-0} - ${failures:-1})) passed, ${failures:-1} failed"
    return "$out"
}

native() {
    cmake/install_packages.sh g++ cmake ninja-build libwxgtk3.2-dev libgtest-dev
    say "Building with the sanitizers"
    quietly cmake --preset sanitize
    quietly cmake --build --preset sanitize
    part "Scenarios and unit tests" run_ctest sanitize
    cmake/install_packages.sh clang libclang-rt-dev python3
    part "Fuzzing, each corpus and 20 s of each target" fuzz/run.sh 20
    part "Faults, each call of a run failing once with each of four errors" tests/faults/run.py
    part "Benchmarks, each program once over 10 folders" bench/run.sh once
    checks
}

windows() {
    cmake/install_packages.sh g++ cmake ninja-build libwxgtk3.2-dev libgtest-dev googletest \
        g++-mingw-w64-x86-64-posix wine64 xvfb xauth xdotool zip
    say "Building wxWidgets for Windows, unless it is there"
    cmake/windows/build_wxwidgets.sh
    say "Building the Windows program and this machine's"
    quietly cmake --preset windows
    quietly cmake --build --preset windows
    quietly cmake --preset native -DBUILD_TESTING=ON
    quietly cmake --build --preset native
    part "Import tables" tests/import_tables.sh build/windows/FolderUpgrade.exe
    part "Scenarios and unit tests under Wine" tests/under_wine.sh build/windows build/native
}

# The counters go where the runs of another user can write them, too.
coverage() {
    local counters file
    cmake/install_packages.sh g++ cmake ninja-build libwxgtk3.2-dev libgtest-dev gcovr python3
    say "Building with counters"
    quietly cmake --preset coverage
    quietly cmake --build --preset coverage
    counters=$(mktemp -d)
    chmod a+x "$counters"
    find "$PWD/build/coverage" -name '*.gcda' -delete
    while read -r file; do
        install -D -m 666 /dev/null "$counters${file%.gcno}.gcda"
    done < <(find "$PWD/build/coverage" -name '*.gcno')
    GCOV_PREFIX=$counters part "Scenarios and unit tests" run_ctest coverage
    find "$counters" -name '*.gcda' -empty -delete
    cp -r "$counters$PWD/build/coverage/." build/coverage/
    rm -r "$counters"
    gcovr --root . --filter '(app|store|migrate|appearance|platform)/' --exclude-throw-branches \
        --fail-under-line 95 --json build/coverage.json --txt - build/coverage || failed=$((failed + 1))
    tests/uncovered.py <build/coverage.json || failed=$((failed + 1))
}

checks() {
    cmake/install_packages.sh g++ cmake ninja-build libwxgtk3.2-dev libgtest-dev clang-format \
        clang-tidy cppcheck shellcheck
    part "Format, clang-tidy, cppcheck and shellcheck" tests/static_checks.sh
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

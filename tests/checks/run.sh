#!/usr/bin/env bash
# Runs one of the format and static checks, as a test:
#
#     tests/checks/run.sh CHECK BUILD_DIR
#
# CHECK is one of the names below; BUILD_DIR has the compile commands.
set -euo pipefail
check=$1
build=$(realpath "$2")
cd "$(dirname "$0")/../.."

find_files() {
    find . -path ./build -prune -o -path ./.git -prune -o -type f "$@" -print
}
mapfile -t sources < <(find_files \( -name '*.cpp' -o -name '*.h' \))
mapfile -t scripts < <(find_files -name '*.sh'; echo .ci/run)
# What this machine's program is built from.
mapfile -t native < <(find_files -name '*.cpp' -not -path './platform/windows/*' \
    -not -path './bench/*' -not -path './fuzz/*' -not -path './tests/*')

case $check in
    clang-format) clang-format --dry-run --Werror "${sources[@]}" ;;
    clang-tidy) find "$build" -name 'unity_*.cxx' -print0 | xargs -0 -P "$(nproc)" -n 1 clang-tidy -p "$build" --quiet ;;
    cppcheck)
        cppcheck --quiet --std=c++17 --enable=warning,performance,portability -I . --inline-suppr \
            --suppress=missingIncludeSystem --error-exitcode=1 "${native[@]}"
        ;;
    shellcheck) shellcheck "${scripts[@]}" ;;
    pyflakes) find_files -name '*.py' | tr '\n' '\0' | xargs -0 pyflakes3 ;;
    directions) tests/checks/directions.py ;;
    *) echo "No such check: $check" >&2; exit 2 ;;
esac

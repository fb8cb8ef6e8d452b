#!/usr/bin/env bash
# tests/checks/run.sh CHECK BUILD_DIR
# Runs one of the format and static checks that are named below. BUILD_DIR has the compile commands.
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
    directions) # the table first, then each include in quotes, or of one of our folders
        awk -F '[<">]' '
            FNR == NR { count = split($0, row, /[: ]+/); ours[row[1]]; while (count) allowed[row[1], row[count--]]; next }
            /^[ \t]*#[ \t]*include/ {
                folder = FILENAME; gsub(/^\.\/|\/[^\/]*$/, "", folder)
                other = $2; if (!sub(/\/[^\/]*$/, "", other)) other = ""
                if ((/include[ \t]*"/ || other in ours) && !((folder, other) in allowed) && !((folder, "*") in allowed)) {
                    print FILENAME ":" FNR ": " folder " must not include " $2; wrong = 1 }
            }
            END { exit wrong }' tests/checks/directions.txt "${sources[@]}"
        ;;
    *) echo "No such check: $check" >&2; exit 2 ;;
esac

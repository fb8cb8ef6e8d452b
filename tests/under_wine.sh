#!/usr/bin/env bash
# Runs the scenarios with the Windows programs under Wine.
#
#     tests/under_wine.sh PROGRAM_DIR TEST_DIR
#
# PROGRAM_DIR holds the programs, TEST_DIR this machine's tests/scenario_test. Makes two
# prefixes, root's and another user's, and its own display.
set -euo pipefail
[ "$(id -u)" = 0 ] || { echo "needs root: the scenarios about refusals run as another user" >&2; exit 1; }
program_dir=$(realpath "$1")
test_dir=$(realpath "$2")
wine=/usr/lib/wine/wine64
server=/usr/lib/wine/wineserver64

if [ -z "${UNDER_WINE_DISPLAY:-}" ]; then
    # Without access control, because the other user has no cookie.
    UNDER_WINE_DISPLAY=1 exec xvfb-run -a -s "-ac -screen 0 1024x768x24" "$0" "$@"
fi

prefixes=$(mktemp -d)
chmod 755 "$prefixes"
export FOLDER_UPGRADE_PROGRAMS=$program_dir
export FOLDER_UPGRADE_WINE_PREFIX=$prefixes/root FOLDER_UPGRADE_WINE_PREFIX_OTHER=$prefixes/other
export WINEDEBUG=-all WINEDLLOVERRIDES="mscoree=;mshtml=" LC_ALL=C.UTF-8
as_other() {
    setpriv --reuid=65534 --regid=65534 --clear-groups env HOME="$prefixes/other" USER=nobody \
        WINEPREFIX="$prefixes/other" XAUTHORITY=/dev/null "$@"
}
clean() {
    WINEPREFIX=$prefixes/root "$server" -k || true
    as_other "$server" -k || true
    rm -rf "$prefixes"
}
trap clean EXIT

mkdir "$prefixes/root" "$prefixes/other"
chown 65534:65534 "$prefixes/other"
cd "$prefixes" # which the other user can enter
WINEPREFIX=$prefixes/root timeout 120 "$wine" wineboot --init 2>/dev/null &
as_other timeout 120 "$wine" wineboot --init 2>/dev/null &
wait
# The servers keep running between the runs. Starting one fails if wineboot's is still running, which is just as good.
WINEPREFIX=$prefixes/root "$server" -p || true
as_other "$server" -p || true

outcome=0
timeout 1500 "$test_dir/tests/scenario_test" | tee "$prefixes/log" || outcome=$?
# What test.sh counts, and what it shows of the skipped ones. The reason is the line before.
awk '
    /^\[  SKIPPED \] .* ms\)$/ { sub(/.*\//, "", $4); print "skipped " $4 ": " reason; ++skipped }
    /^\[       OK \]/ { ++passed }
    /^\[  FAILED  \] .* ms\)$/ { ++failed }
    NF { reason = $0 }
    END { printf "%d passed, %d failed, %d skipped\n", passed, failed, skipped }' "$prefixes/log"
[ "$outcome" = 0 ]

#!/usr/bin/env bash
# tests/under_wine.sh KIT USER [ARGUMENT...]
# Unpacks the trial's kit in a new Wine prefix, runs trial.cmd there as a person would, and prints what it writes. Before
# that, trial.cmd has to refuse to run where the client seems to be installed. Another user than one's own needs root.
set -euo pipefail
kit=$(realpath "$1") user=$2
shift 2
wine=/usr/lib/wine/wine64 server=/usr/lib/wine/wineserver64
home=$(mktemp -d)
as_user() {
    (cd "$home" && setpriv --reuid="$user" --regid="$(id -g "$user")" --clear-groups \
        env -u DISPLAY HOME="$home" USER="$user" TMPDIR="$home" WINEPREFIX="$home" WINEDEBUG=-all LC_ALL=C.UTF-8 \
        WINEDLLOVERRIDES="mscoree=;mshtml=" timeout 1500 "$@")
}
trap 'as_user "$server" -k || true; rm -rf "$home"' EXIT
chown "$user" "$home"
as_user "$wine" wineboot --init 2>/dev/null
# Windows that nobody sees need no display. The driver is chosen when the server starts.
as_user "$wine" reg add 'HKCU\Software\Wine\Drivers' /v Graphics /d null /f >/dev/null
as_user "$server" -k
(cd "$home/drive_c" && cmake -E tar xf "$kit" && mv FolderUpgrade-*-trial trial && chown -R "$user" trial)
output=$home/drive_c/trial/trial.txt
try() {
    outcome=0
    as_user "$wine" cmd /c 'C:\trial\trial.cmd' "$@" >/dev/null || outcome=$?
}
refuse() {
    try
    if [ $outcome != 3 ] || ! grep -q "$1" "$output"; then cat "$output"; exit 1; fi
}
as_user "$wine" reg add 'HKLM\SOFTWARE\Vantorix\QZA' /v InstallPath /d kept /f >/dev/null
refuse Vantorix
as_user "$wine" reg delete 'HKLM\SOFTWARE\Vantorix\QZA' /v InstallPath /f >/dev/null # fails if it is not there any more
try '--gtest_filter=*VLeavesTheLogAlone'
[ $outcome = 1 ] # the key that is left stays
as_user "$wine" reg delete 'HKLM\SOFTWARE\Vantorix' /f >/dev/null
trial="$home/drive_c/Program Files/FolderUpgrade trial"
for folder in "$home/drive_c/ProgramData/hotfolder" "$trial"; do # the second of another account
    as_user mkdir "$folder"
    refuse "${folder##*/}"
    as_user rmdir "$folder"
done
as_user "$wine" cmd /c 'C:\trial\sandbox.cmd' </dev/null >/dev/null
grep -q '<HostFolder>C:.trial</HostFolder>' "$home/drive_c/trial/trial.wsb"
try "$@" & # a trial that is interrupted
until [ -e "$trial/account" ]; do
    sleep 0.5
done
as_user "$server" -k
wait || true
try "$@"
tr -d '\r' <"$output"
exit $outcome

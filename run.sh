#!/usr/bin/env bash
# Builds the tool, runs it on a sample workstation and shows what it logged and changed there, and what the check says
# before and after:
#
#     ./run.sh [--fresh] [I|U] [V]
#
#     --fresh  first creates the sample workstation again; otherwise it stays as the last run left it
#     I        upgrade (the default)
#     U        downgrade; after an upgrade it shows the way back
#     V        without the run log
#
# On Debian 12 it first installs what the build needs. The workstation is build/sample workstation.
set -euo pipefail
cd "$(dirname "${BASH_SOURCE[0]}")"

workstation="$PWD/build/sample workstation"
programs=build/program
log="$workstation/user/ORX_Installers/UpgradeDowngrade.log"
finished=255 # the tool's exit status of -1, on every path

usage() {
    sed -n '/\.\/run/,/V  /s/^# \{0,5\}//p' "${BASH_SOURCE[0]}" | sed '1s/^/Usage: /' >&2
    exit 2
}

# Shows the output of a command only if it fails.
quietly() {
    "$@" >"$scratch/output" 2>&1 || { cat "$scratch/output" >&2; exit 1; }
}

on_workstation() {
    XDG_CONFIG_DIRS="$workstation/machine" XDG_CONFIG_HOME="$workstation/user" "$@"
}

# The names of the attributes of a file or folder of the workstation, "-" for none.
attributes() {
    local bits names=''
    bits=$(getfattr --only-values -n user.DOSATTRIB -- "$1" 2>/dev/null) || bits=0
    [ -d "$1" ] || [ $((0$(stat -c %a -- "$1") & 0200)) != 0 ] || bits=$((bits | 1))
    [ $((bits & 1)) = 0 ] || names+=' READONLY'
    [ $((bits & 2)) = 0 ] || names+=' HIDDEN'
    [ $((bits & 4)) = 0 ] || names+=' SYSTEM'
    [ $((bits & 0x20)) = 0 ] || names+=' ARCHIVE'
    [ $((bits & 0x80)) = 0 ] || names+=' NORMAL'
    names=${names# }
    echo "${names:--}"
}

# The texts have many paths on the workstation; their common beginning is shortened.
shorten() {
    local text
    while IFS= read -r text; do
        printf '%s\n' "${text//"$workstation"/WORKSTATION}"
    done
}

check() {
    local status=0
    echo "== FolderUpgradeCheck $switch, $1 the run"
    on_workstation "$programs/FolderUpgradeCheck" "$switch" >"$scratch/report" || status=$?
    shorten <"$scratch/report"
    case $status in
        0) echo "Exit status 0: nothing to change, and every template is there" ;;
        1) echo "Exit status 1: changes" ;;
        2) echo "Exit status 2: problems" ;;
        *) exit 1 ;;
    esac
}

# Everything on the workstation except the run log, which is shown separately.
list() {
    find "$workstation" -mindepth 1 ! -path "$log" -printf '%P\n' | LC_ALL=C sort
}

remember() {
    cp -R "$workstation" "$scratch/before"
    list | while IFS= read -r name; do
        printf '%s\t%s\n' "$name" "$(attributes "$workstation/$name")"
    done >"$scratch/attributes"
}

show_content() {
    local before="$scratch/before/$1" after="$workstation/$1" kind=changed
    if [ ! -e "$after" ]; then
        echo "removed     $1"
        return
    elif [ ! -e "$before" ]; then
        kind='new    '
        before=/dev/null
    elif [ -d "$after" ] || cmp -s "$before" "$after"; then
        return
    fi
    if [ -d "$after" ]; then
        echo "$kind     $1/"
    elif ! grep -Iq . "$after"; then
        echo "$kind     $1, $(stat -c %s "$after") bytes"
    elif diff -U 1 <(tr -d '\r' <"$before") <(tr -d '\r' <"$after") >"$scratch/diff"; then
        echo "$kind     $1, line ends only"
    else
        echo "$kind     $1"
        sed '1,2d; s/^/    /' "$scratch/diff"
    fi
}

show_attributes() {
    local before=- after=-
    before=$(awk -F '\t' -v name="$1" '$1 == name { print $2 }' "$scratch/attributes")
    [ ! -e "$workstation/$1" ] || after=$(attributes "$workstation/$1")
    [ "${before:=-}" = "$after" ] || echo "attributes  $1: $before -> $after"
}

show_changes() {
    { list; cut -f 1 "$scratch/attributes"; } | LC_ALL=C sort -u | while IFS= read -r name; do
        show_content "$name"
        show_attributes "$name"
    done
}

fresh=no switch=I verbosity=()
[ "${1-}" != --fresh ] || { fresh=yes; shift; }
case ${1-} in
    [IiUu]) switch=$1; shift ;;
esac
case ${1-} in
    [Vv]) verbosity=("$1"); shift ;;
esac
[ $# = 0 ] || usage

scratch=$(mktemp -d)
trap 'rm -rf "$scratch"' EXIT
cmake/install_packages.sh build sample
quietly cmake --preset program
quietly cmake --build --preset program
if [ "$fresh" = yes ]; then
    samples/lay_out.py --fresh "$workstation"
elif [ ! -e "$workstation" ]; then
    samples/lay_out.py "$workstation"
fi
remember

echo "WORKSTATION is $workstation"
echo
check before
echo
echo "== FolderUpgrade $switch${verbosity[0]+ ${verbosity[0]}}"
status=0
on_workstation "$programs/FolderUpgrade" "$switch" ${verbosity[@]+"${verbosity[@]}"} || status=$?
if [ $status != $finished ]; then
    echo "Exit status $status, not $finished: the run did not finish." >&2
    exit 1
fi
echo "Exit status $status (that is -1), as on every run"
echo
if [ ${#verbosity[@]} = 0 ]; then
    echo "== The run log"
    tr -d '\r' <"$log" | shorten
else
    echo "== The run log was off (V)"
fi
echo
echo "== What changed on the workstation"
show_changes >"$scratch/changes"
if [ -s "$scratch/changes" ]; then
    shorten <"$scratch/changes"
else
    echo nothing
fi
echo
check after

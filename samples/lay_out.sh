#!/usr/bin/env bash
# Creates in a folder what a hot folder user's machine looks like before an upgrade:
#
#     samples/lay_out.sh [--fresh] DIR
#
# Use DIR/machine as $XDG_CONFIG_DIRS and DIR/user as $XDG_CONFIG_HOME. The texts come from samples/workstation/, where
# @ROOT@ is replaced with DIR and @/@ with the path separator (@//@ with its form in a .reg file); the icons come from
# appearance/icons/. DIR has to be missing or empty. --fresh first removes what an earlier call created there, never
# another folder.
set -euo pipefail
shopt -s extglob

samples=$(cd "$(dirname "${BASH_SOURCE[0]}")" && pwd -P)
icons=$samples/../appearance/icons
marker=.sample-workstation
private='[_ORX_HotFolder_]'

# Hot folder | the icon in its private directory | the picture in this outdated copy
stale_icons='
Flyers A4       | hf_folder          | hf_folder_disabled
Broschüren Köln | hf_folder_disabled | hf_folder
名刺 両面       | hf_error_active    | hf_folder
Plakate A2      | hf_error_inactive  | hf_error_active
Wedding Cards   | hf_folder          | hf_error_active
Manuals 2019    | hf_folder          | hf_folder_disabled
Manuals 2019    | hf_folder_disabled | hf_error_inactive
Proofs          | hf_folder          | hf_folder_disabled
New Hot Folder  | hf_folder_disabled | hf_folder'

# File or folder | attribute bits: 1 read-only (of a file: its write permission), 2 hidden, 4 system
attributes='
Flyers A4                | 4
Flyers A4/Desktop.ini    | 5
名刺 両面                | 5
名刺 両面/Desktop.ini    | 5
Manuals 2019             | 4
Manuals 2019/Desktop.ini | 5
Letterheads              | 4
Letterheads/Desktop.ini  | 5'

fail() {
    echo "lay_out.sh: $1" >&2
    exit 1
}

# Calls a command with the fields of each row of a table.
for_each_row() {
    local row fields
    while read -r row; do
        IFS="|" read -ra fields <<<"${row//*( )|*( )/|}"
        [ -z "$row" ] || "$2" "${fields[@]}"
    done <<<"$1"
}

# The text, escaped as the replacement in a sed command.
replacement() {
    printf %s "$1" | sed 's/[\\&|]/\\&/g'
}

render() {
    local target=$dir/$1 line_end=''
    case $1 in
        *.reg | *.ini | *.log | *.xml) line_end='s/$/\r/' ;;
    esac
    mkdir -p "${target%/*}"
    sed -e "s|@//@|/|g; s|@/@|/|g; s|@ROOT@|$(replacement "$dir")|g" -e "$line_end" "$samples/workstation/$1" >"$target"
}

put_icon() {
    mkdir -p "$dir/Hot Folders/$1/$private"
    cp "$icons/$3.ico" "$dir/Hot Folders/$1/$private/$2.ico"
}

# The bits go into the extended attribute first: the owner cannot set it on a read-only file.
set_attributes() {
    local path="$dir/Hot Folders/$1" bits=$2
    [ -d "$path" ] || bits=$((bits & ~1))
    setfattr -n user.DOSATTRIB -v "$(printf '"0x%x"' "$bits")" "$path" || fail "this file system does not support extended attributes: $dir"
    if [ "$bits" != "$2" ]; then
        chmod a-w "$path"
    fi
}

# The folder itself may be the user's own, so it stays.
clear_dir() {
    find "$dir" -mindepth 1 -delete
}

fresh=no
if [ "${1-}" = --fresh ]; then
    fresh=yes
    shift
fi
if [ $# != 1 ] || [ -z "$1" ]; then
    sed -n 's/^# *\(samples.*\)/Usage: \1/p' "$0" >&2
    exit 2
fi
command -v setfattr >/dev/null || fail 'setfattr is missing (package attr)'
dir=$(realpath -m -- "$1")
case $dir in
    *[\\\"\<\>\&]* | *$'\n'*) fail "a path with one of \\ \" < > & or a line break would need escapes in the files: $dir" ;;
esac

if [ "$fresh" = yes ] && [ -f "$dir/$marker" ]; then
    clear_dir
fi
if [ -e "$dir/$marker" ]; then
    fail "already created (--fresh creates it again): $dir"
elif [ -e "$dir" ] && { [ ! -d "$dir" ] || [ -n "$(ls -A -- "$dir")" ]; }; then
    fail "already exists, but is not a sample workstation: $dir"
fi

mkdir -p -- "$dir"
echo 'Laid out by samples/lay_out.sh, which may remove this folder.' >"$dir/$marker"
trap clear_dir EXIT
while IFS= read -r -d '' file; do
    render "$file"
done < <(cd "$samples/workstation" && find . -type f -printf '%P\0')
for_each_row "$stale_icons" put_icon
for folder in "$dir/Hot Folders"/*/; do
    mkdir -p "$folder$private"/{Work,Fail,Done}
    set_attributes "$(basename "$folder")/$private" 2
done
for_each_row "$attributes" set_attributes
trap - EXIT

#!/usr/bin/env bash
# Reads the import tables of Windows programs. Windows loads what they name before any line of the
# program runs, and looks beside the program first, except for the DLLs below.
#
#     tests/import_tables.sh PROGRAM...
set -euo pipefail
export LC_ALL=C

[ $# -gt 0 ] || { sed -n '5s/^# *//p' "$0" >&2; exit 2; }

# The DLLs in the registry's list KnownDLLs, which Windows always loads from its own directory; and comctl32, if the
# program's manifest asks for version 6.
known='advapi32|combase|comdlg32|gdi32|imagehlp|imm32|kernel32|msctf|msvcrt|normaliz|nsi|ole32|oleaut32|psapi'
known+='|rpcrt4|sechost|setupapi|shcore|shell32|shlwapi|user32|wldap32|ws2_32'
# DLLs that are loaded on first use: the program names them, but not in an import table.
on_first_use=(VERSION UxTheme)
version_6='name="Microsoft.Windows.Common-Controls" version="6.'

passed=0
failed=0
expect() {
    if "${@:2}"; then
        passed=$((passed + 1))
    else
        echo "$program: $1"
        failed=$((failed + 1))
    fi
}

imports_known_only() { ! grep -vixE "($known|comctl32)\.dll" "$tables"; }
asks_for_version_6() { ! grep -qix 'comctl32\.dll' "$tables" || grep -qaF "$version_6" "$program"; }
loads_on_first_use() { grep -qa "$1\.dll" "$program" && ! grep -qix "$1\.dll" "$tables"; }

tables=$(mktemp)
trap 'rm -f "$tables"' EXIT
for program; do
    x86_64-w64-mingw32-objdump -p "$program" | sed -n 's/^\tDLL Name: //p' >"$tables"
    expect "has no import table" [ -s "$tables" ]
    expect "imports the DLLs above, for which Windows looks beside it" imports_known_only
    expect "imports comctl32 without a manifest that asks for version 6" asks_for_version_6
    for dll in "${on_first_use[@]}"; do
        expect "does not load $dll.dll on its first use" loads_on_first_use "$dll"
    done
done
echo "$passed passed, $failed failed, 0 skipped"
[ "$failed" = 0 ]

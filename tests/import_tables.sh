#!/usr/bin/env bash
# tests/import_tables.sh PROGRAM...
# Reads the import tables of Windows programs. Windows loads what they name before any line of the program runs, and
# looks beside the program first, except for the DLLs below.
set -euo pipefail

# Windows always loads KnownDLLs from its own directory; and comctl32, if the manifest asks for version 6.
known='advapi32|combase|comctl32|comdlg32|gdi32|imagehlp|imm32|kernel32|msctf|msvcrt|normaliz|nsi'
known+='|ole32|oleaut32|psapi|rpcrt4|sechost|setupapi|shcore|shell32|shlwapi|user32|wldap32|ws2_32'
version_6='name="Microsoft.Windows.Common-Controls" version="6.'

fail() { echo "$program: $1"; exit 1; }

for program; do
    tables=$(x86_64-w64-mingw32-objdump -p "$program" | sed -n 's/^\tDLL Name: //p')
    grep -qi '^kernel32\.dll$' <<<"$tables" || fail "has no import table"
    ! grep -vixE "($known)\.dll" <<<"$tables" || fail "imports the DLLs above"
    ! grep -qi '^comctl32' <<<"$tables" || grep -qaF "$version_6" "$program" || fail "imports an old comctl32"
    for dll in VERSION UxTheme; do # the program names them, but not in an import table
        grep -qa "$dll\.dll" "$program" || fail "does not load $dll.dll on its first use"
    done
done

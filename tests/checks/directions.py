#!/usr/bin/env python3
"""Fails for an include of a folder that the table in directions.txt does not allow."""
import pathlib
import re
import sys

HERE = pathlib.Path(__file__).resolve().parent
ROOT = HERE.parents[1]
INCLUDE = re.compile(r'^\s*#\s*include\s*([<"])([^>"]+)[>"]')


def read_table():
    lines = (HERE / 'directions.txt').read_text(encoding='utf-8').splitlines()
    rows = (line.split(':') for line in lines if not line.startswith('#'))
    return {folder.strip(): allowed.split() for folder, allowed in rows}


def wrong_includes(table):
    for path in sorted((*ROOT.glob('*/**/*.h'), *ROOT.glob('*/**/*.cpp'))):
        folder = path.parent.relative_to(ROOT).as_posix()
        allowed = {folder, *table.get(folder, [])}
        for number, line in enumerate(path.read_text(encoding='utf-8').splitlines(), 1):
            match = INCLUDE.match(line)
            other = pathlib.PurePosixPath(match[2]).parent.as_posix() if match else folder
            is_ours = match and match[1] == '"' or other in table
            if is_ours and allowed.isdisjoint({other, '*'}) and not folder.startswith(('build', '.')):
                yield f'{path.relative_to(ROOT)}:{number}: {folder} must not include {match[2]}'


def main():
    wrong = list(wrong_includes(read_table()))
    print(*wrong, sep='\n', end='\n' * bool(wrong))
    return bool(wrong)


if __name__ == '__main__':
    sys.exit(main())

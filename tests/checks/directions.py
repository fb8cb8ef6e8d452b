#!/usr/bin/env python3
"""Checks includes and links against the table of directions in directions.txt.

Fails for an include of a folder that the table does not allow, for a library of such a folder in a
target_link_libraries(), and for any target_...() of a CMakeLists.txt on a target of another folder.
"""
import pathlib
import re
import sys

HERE = pathlib.Path(__file__).resolve().parent
ROOT = HERE.parents[1]
INCLUDE = re.compile(r'^\s*#\s*include\s*([<"])([^>"]+)[>"]')
MAKES_TARGET = re.compile(r'\badd_(?:library|executable|module|custom_target)\s*\(\s*([^\s)]+)')
CHANGES_TARGET = re.compile(r'\btarget_(\w+)\s*\(\s*([^\s)]+)([^)]*)\)')


def read_table():
    lines = (HERE / 'directions.txt').read_text(encoding='utf-8').splitlines()
    rows = (line.split(':') for line in lines if not line.startswith('#'))
    return {folder.strip(): allowed.split() for folder, allowed in rows}


def files(pattern):
    """The files of the table's folders and of new ones, with the folder of each."""
    for path in sorted(ROOT.glob(f'*/**/{pattern}')):
        folder = path.parent.relative_to(ROOT).as_posix()
        if not folder.startswith(('build', '.')):
            yield path.relative_to(ROOT), folder, path.read_text(encoding='utf-8')


def is_allowed(table, folder, other):
    return other == folder or not {other, '*'}.isdisjoint(table.get(folder, []))


def wrong_includes(table):
    for path, folder, text in (*files('*.h'), *files('*.cpp')):
        for number, line in enumerate(text.splitlines(), 1):
            match = INCLUDE.match(line)
            other = pathlib.PurePosixPath(match[2]).parent.as_posix() if match else folder
            is_ours = match and match[1] == '"' or other in table
            if is_ours and not is_allowed(table, folder, other):
                yield f'{path}:{number}: {folder} must not include {match[2]}'


def wrong_links(table):
    for path, folder, text in files('CMakeLists.txt'):
        text = re.sub(r'#.*', '', text)
        for command, target, words in CHANGES_TARGET.findall(text):
            if target not in MAKES_TARGET.findall(text):
                yield f'{path}: target_{command} on {target}, which is of another folder'
            for library in words.split() if command == 'link_libraries' else ():
                if library in table and not is_allowed(table, folder, library):
                    yield f'{path}: {folder} must not link {library}'


def main():
    table = read_table()
    wrong = [*wrong_includes(table), *wrong_links(table)]
    print(*wrong, sep='\n', end='\n' * bool(wrong))
    return bool(wrong)


if __name__ == '__main__':
    sys.exit(main())

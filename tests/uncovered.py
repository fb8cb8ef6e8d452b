#!/usr/bin/python3
"""Prints the lines that a coverage run leaves out, each with its reason in uncovered.txt.

    gcovr --json ... | tests/uncovered.py

Fails for a line that has no reason there, and for a reason whose line is run.
"""
import json
import os
import sys


def reasons():
    """The reasons in their order, by file and text of the line."""
    found = {}
    with open(os.path.join(os.path.dirname(__file__), 'uncovered.txt'), encoding='utf-8') as file:
        for entry in file:
            if not entry.startswith('#'):
                path, text, reason = entry.rstrip('\n').split('\t')
                found.setdefault((path, text), []).append(reason)
    return found


def uncovered(report):
    for file in report['files']:
        counts = {}  # a template's line comes once for each instance
        for line in file['lines']:
            if not line.get('gcovr/noncode'):
                counts[line['line_number']] = counts.get(line['line_number'], 0) + line['count']
        with open(file['file'], encoding='utf-8') as source:
            texts = source.read().splitlines()
        for number in sorted(counts):
            if counts[number] == 0:
                yield file['file'], number, texts[number - 1].strip()


def main():
    known, is_explained = reasons(), True
    for path, number, text in uncovered(json.load(sys.stdin)):
        words = known.get((path, text))
        is_explained = is_explained and bool(words)
        print(f"{path}:{number}: {text}  ({words.pop(0) if words else 'NO REASON'})")
    left = [f'{path}: {text}  (is run)' for (path, text), words in known.items() for _ in words]
    print(*left, sep='\n', end='\n' * bool(left))
    return 0 if is_explained and not left else 1


sys.exit(main())

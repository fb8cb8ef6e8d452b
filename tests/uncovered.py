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
        yield from ((file['file'], number, texts[number - 1].strip()) for number in sorted(counts) if counts[number] == 0)


def main():
    known = reasons()
    used, unknown = set(), 0
    for path, number, text in uncovered(json.load(sys.stdin)):
        words = known.get((path, text), ['NO REASON'])
        unknown += words == ['NO REASON']
        print(f'{path}:{number}: {text}  ({words[0] if len(words) == 1 else words.pop(0)})')
        used.add((path, text))
    for path, text in sorted(set(known) - used):
        print(f'{path}: {text}  (is run)')
    return 1 if unknown or set(known) - used else 0


sys.exit(main())

#!/usr/bin/python3
"""Measures whole runs and the migration of a large preset, and prints the tables: see run.sh.

    bench/measure.py native|once|windows BUILD OLD_TOOL PICTURE [COUNT...]

BUILD is a build with the benchmarks, OLD_TOOL a program to compare with or empty, PICTURE an SVG file to write. Each
figure is the minimum of several rounds, in which the programs take turns.
"""
import contextlib
import os
import shutil
import statistics
import sys
import tempfile
import time

import picture
import preset
from workstation import ICON, PRIVATE, WineWorkstation, Workstation

TMPFS, DISK = '/dev/shm', None  # None: the temporary folder
COUNTS = {'native': [10, 100, 1000, 10000], 'once': [10], 'windows': [10, 100, 1000]}
MOST_ON_DISK = 1000
FOLDERS_IN_ALL_ROUNDS, MOST_ROUNDS, FEWEST_ROUNDS = 7000, 30, 3
ROUNDS_UNDER_WINE = 3  # where a run takes much longer


@contextlib.contextmanager
def workstation(where, kind, *arguments):
    with tempfile.TemporaryDirectory(prefix='bench ', dir=where) as root:
        station = kind(root)
        try:
            station.lay_out(*arguments)
            yield station
        finally:
            station.close()


def measure(station, count, names, rounds=None):
    """The minimum time of each program in seconds. All but the floor move the templates, which are then moved back."""
    times = dict.fromkeys(names, float('inf'))
    for _ in range(rounds or min(max(FOLDERS_IN_ALL_ROUNDS // count, FEWEST_ROUNDS), MOST_ROUNDS)):
        for name in names:
            times[name] = min(times[name], getattr(station, name)())
            if name != 'floor':
                station.back()
    return dict(times, count=count)


def check_outcome(build):
    """Checks that the tool and the script change everything, in the same way, and that the floor does its work."""
    outcomes = []
    with tempfile.TemporaryDirectory(prefix='bench ', dir=TMPFS) as root:
        station = Workstation(f'{root}/same')
        for name in ('script', 'tool'):
            shutil.rmtree(station.root, ignore_errors=True)
            station.lay_out(build, 3)
            before = station.outcome()
            getattr(station, name)()
            outcomes.append(station.outcome())
            unchanged = {os.path.basename(path) for path, state in outcomes[-1].items() if state == before.get(path)}
            if unchanged & {'Folder.cfg', ICON, 'Desktop.ini'}:
                raise SystemExit(f'the {name} left something unchanged')
        if outcomes[0] != outcomes[1]:
            raise SystemExit('the tool and the script leave different files')
        folder = f'Hot Folders/Jobs 00003/{PRIVATE}'
        cfg = station.root / folder / 'Folder.cfg'
        os.utime(cfg, (0, 0))
        station.put(f'{folder}/{ICON}', b'')
        station.floor()
        if os.stat(cfg).st_mtime == 0 or station.outcome() != outcomes[1]:
            raise SystemExit('the floor does not do its work')


def wait_cost():
    """The median time in seconds of a wait for the disk after writing as much as a Folder.cfg."""
    costs = []
    with tempfile.NamedTemporaryFile(dir=DISK) as file:
        for _ in range(51):
            os.pwrite(file.fileno(), os.urandom(7000), 0)
            start = time.perf_counter()
            os.fsync(file.fileno())
            costs.append(time.perf_counter() - start)
    return statistics.median(costs)


def find_crossing(build, results):
    """The number of folders from which the script is quicker, found by bisection; infinite if it never is."""
    quicker = [now['count'] for now in results if now['script'] < now['tool']]
    if not quicker:
        return float('inf')
    high = quicker[0]
    low = max((now['count'] for now in results if now['count'] < high), default=0)
    while high - low > 1:
        middle = (low + high) // 2
        with workstation(TMPFS, Workstation, build, middle) as station:
            times = measure(station, middle, ('tool', 'script'))
        low, high = (low, middle) if times['script'] < times['tool'] else (middle, high)
    return high


def milliseconds(seconds):
    return f'{seconds * 1e3:,.1f}' if seconds < 10 else f'{seconds * 1e3:,.0f}'


def print_table(titles, rows):
    aligned = ('---:|' if cell[0] in '0123456789' else ':---|' for cell in rows[0])
    print('\n| ' + ' | '.join(titles) + ' |\n|' + ''.join(aligned))
    for row in rows:
        print('| ' + ' | '.join(row) + ' |', flush=True)


def print_runs(results, ratios):
    """The tool's times; and for each ratio the other program's time, and the tool's divided by it."""
    titles = ['Folders', 'Tool, log off (ms)', 'per folder (ms)']
    for title in ratios.values():
        titles += [f'{title} (ms)', 'log on / off' if title == 'Tool, log on' else f'tool / {title}']
    rows = []
    for now in results:
        row = [f"{now['count']:,}", milliseconds(now['tool']), f"{now['tool'] / now['count'] * 1e3:.2f}"]
        for name in ratios:
            ratio = now['logged'] / now['tool'] if name == 'logged' else now['tool'] / now.get(name, float('nan'))
            row += [milliseconds(now[name]), f'{ratio:.2f}'] if name in now else ['-', '-']
        rows.append(row)
    print_table(titles, rows)


def print_limits(results, crossing, presets):
    at = {now['count']: now for now in results}

    def ratio(count, name, other):
        now = at.get(count, {})
        return now[name] / now[other] if name in now and other in now else None

    growth = at[10000]['tool'] / 10000 / (at[10]['tool'] / 10) if {10, 10000} <= set(at) else None
    limits = [('tool / b6c3480, log off, 1,000 folders', 'most', 0.55, ratio(1000, 'tool', 'old')),
              ('log on / off, 1,000 folders', 'most', 1.1, ratio(1000, 'logged', 'tool')),
              ('log on / off, 10,000 folders', 'most', 1.1, ratio(10000, 'logged', 'tool')),
              ('tool / floor, log off, 1,000 folders', 'most', 1.15, ratio(1000, 'tool', 'floor')),
              ('time per folder, 10,000 / 10 folders', 'most', 1.1, growth),
              ('folders from which the script is quicker', 'least', 40, crossing),
              ('60 MiB preset: tool / floor', 'most', 1.1, max(tool[0] / floor[0] for _, tool, floor in presets)),
              ('60 MiB preset: bytes of memory per byte', 'most', 10, max(tool[1] for _, tool, _ in presets))]
    rows = []
    for what, bound, allowed, value in limits:
        measured = 'not measured'
        if value is not None:
            is_kept = value <= allowed if bound == 'most' else value >= allowed
            measured = 'none' if value == float('inf') else f'{value:.2f}' if isinstance(value, float) else str(value)
            measured += '' if is_kept else ', **not kept**'
        rows.append([what, f'at {bound} {allowed}', measured])
    print_table(['', 'Limit', 'Measured'], rows)


def measure_native(build, old_tool, picture_path, counts):
    results, on_disk = [], []
    for count in counts:
        print(f'{count:,} hot folders', file=sys.stderr, flush=True)
        names = ['tool', 'logged', 'floor', 'script'] + ['old'] * (bool(old_tool) and count <= MOST_ON_DISK)
        with workstation(TMPFS, Workstation, build, count, old_tool) as station:
            results.append(measure(station, count, names))
        if count <= MOST_ON_DISK:
            with workstation(DISK, Workstation, build, count) as station:
                on_disk.append(measure(station, count, ('tool', 'floor', 'script')))
    print('On a tmpfs, where a wait for the disk costs nothing')
    print_runs(results, {'logged': 'Tool, log on', 'floor': 'Floor', 'script': 'Script', 'old': 'b6c3480'})
    crossing = find_crossing(build, results)
    print('\n' + (f'The script is quicker from {crossing:,} folders on.' if crossing < float('inf')
                   else 'The script is slower at each of these counts.'))
    print(f'\nOn disk, where one wait costs {milliseconds(wait_cost())} ms')
    print_table(['Folders', 'Tool, log off (ms)', 'Floor (ms)', 'Script (ms)'],
                [[f"{now['count']:,}", *(milliseconds(now[name]) for name in ('tool', 'floor', 'script'))]
                 for now in on_disk])
    with tempfile.TemporaryDirectory(prefix='bench ', dir=TMPFS) as root:
        presets = list(preset.measure(build, root))
    print('\nA preset file of 60 MiB')
    print_table(['60 MiB with', 'Tool (ms)', 'Floor (ms)', 'Tool / floor', 'Tool, memory per byte', 'Floor, memory'],
                [[name, f'{tool[0] * 1e3:.0f}', f'{floor[0] * 1e3:.0f}', f'{tool[0] / floor[0]:.2f}', f'{tool[1]:.1f}',
                  f'{floor[1]:.1f}'] for name, tool, floor in presets])
    print('\nThe limits')
    print_limits(results, crossing, presets)
    with open(picture_path, 'w', encoding='utf-8') as file:
        file.write(picture.draw(results))


def measure_windows(build, counts):
    results = []
    for count in counts:
        print(f'{count:,} hot folders under Wine', file=sys.stderr, flush=True)
        with workstation(TMPFS, WineWorkstation, build, count) as station:
            station.tool()
            if station.moved() != count:
                raise SystemExit('the tool does not move the templates')
            station.back()
            results.append(measure(station, count, ('tool', 'logged', 'floor'), ROUNDS_UNDER_WINE))
    print('The Windows program under Wine, on a tmpfs')
    print_runs(results, {'logged': 'Tool, log on', 'floor': 'Floor'})


def main(what, build, old_tool, picture_path, *counts):
    build, counts = os.path.abspath(build), [int(count) for count in counts] or COUNTS[what]
    if what == 'windows':
        measure_windows(build, counts)
        return
    check_outcome(build)
    if what == 'native':
        measure_native(build, os.path.abspath(old_tool) if old_tool else None, picture_path, counts)
        return
    with workstation(TMPFS, Workstation, build, counts[0]) as station:
        print_runs([measure(station, counts[0], ('tool', 'logged', 'floor', 'script'), rounds=1)],
                   {'logged': 'Tool, log on', 'floor': 'Floor', 'script': 'Script'})


main(*sys.argv[1:])

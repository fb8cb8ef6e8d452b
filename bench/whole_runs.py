#!/usr/bin/python3
"""Times whole runs over more and more hot folders, beside the library's floor and a script, and prints the tables.

    bench/whole_runs.py [--log-limit SECONDS] BUILD_DIR PICTURE [COUNT...]

BUILD_DIR is a build with the benchmarks; the counts are 10, 100, 1,000 and 10,000 unless others are given; PICTURE is
an SVG file to write. Each figure is the least of several runs, the programs taken in turn; all of them include the
start of the process. With the log on a run takes a time that grows with the square of the folders: one that is
expected to take longer than --log-limit (120 seconds) is left out, and the table says so.
"""
import argparse
import filecmp
import os
import shutil
import subprocess
import sys
import tempfile
import time

import lay_out
import picture
from lxml import etree

HERE = os.path.dirname(os.path.abspath(__file__))
FINISHED = 255  # the tool's exit status on every path
FOLDERS_IN_ALL_ROUNDS, MOST_ROUNDS, FEWEST_ROUNDS = 7000, 30, 3
PRIVATE = '[_ORX_HotFolder_]'
ATTRIBUTES = 'user.DOSATTRIB'


class Workstation:
    """Hot folders in a temporary folder, and the commands that move their templates forth and back."""

    def __init__(self, root, build, count):
        lay_out.lay_out(root, count, f'{build}/FolderUpgrade')
        shutil.copy(f'{build}/bench/FolderUpgradeTimed', f'{root}/program')
        self.root, self.build, self.count = root, build, count
        self.rounds = min(max(FOLDERS_IN_ALL_ROUNDS // count, FEWEST_ROUNDS), MOST_ROUNDS)
        self.last = f'{root}/Hot Folders/Jobs {count:05}'
        self.old, self.new = f'{root}/{lay_out.OLD_TEMPLATES}', f'{root}/{lay_out.NEW_TEMPLATES}'

    def seconds(self, *command, status=0):
        env = {'XDG_CONFIG_HOME': f'{self.root}/user', 'XDG_CONFIG_DIRS': f'{self.root}/machine'}
        start = time.perf_counter()
        result = subprocess.run(command, env=env, capture_output=True, text=True, check=False)
        elapsed = time.perf_counter() - start
        if result.returncode != status or result.stderr:
            raise SystemExit(f'{command[0]}: status {result.returncode} {result.stderr!r}')
        return elapsed, result.stdout

    def tool(self, *switches, program='FolderUpgrade'):
        return self.seconds(f'{self.root}/program/{program}', *switches, status=FINISHED)

    def floor(self, save='buffered'):
        return self.seconds(f'{self.build}/bench/floor', f'{self.root}/folders.txt',
                            f'{self.root}/program/{lay_out.ICON}', save)

    def script(self):
        return self.seconds(sys.executable, f'{HERE}/administrator.py',
                            f'{self.root}/machine/hotfolder/HotFolderList.cfg', f'{self.root}/program', self.old,
                            self.new, f'{self.root}/user/ORX/JPData')

    def spoil(self):
        """Gives the last folder another icon, InfoTip and attributes."""
        ini = f'{self.last}/Desktop.ini'
        os.chmod(ini, 0o644)
        with open(ini, 'w', encoding='utf-8', newline='') as file:
            file.write(lay_out.DESKTOP_INI.replace('InfoTip=', 'InfoTip=Spoilt. '))
        for path in (ini, self.last):
            os.removexattr(path, ATTRIBUTES)
        with open(f'{self.last}/{PRIVATE}/{lay_out.ICON}', 'wb') as file:
            file.write(b'spoilt')

    def outcome(self):
        """What stands there: every settings file as a canonical document, the presets, one folder's appearance."""
        with open(f'{self.root}/folders.txt', encoding='utf-8') as file:
            documents = [etree.tostring(etree.parse(f'{folder}/{PRIVATE}/Folder.cfg'), method='c14n')
                         for folder in file.read().splitlines()]
        ini = f'{self.last}/Desktop.ini'
        texts = []
        for path in [*sorted(self.presets()), ini, f'{self.last}/{PRIVATE}/{lay_out.ICON}']:
            with open(path, 'rb') as file:
                texts.append(file.read())
        return documents, texts[:-2], texts[-2], texts[-1], self.attributes(self.last), self.attributes(ini)

    @staticmethod
    def attributes(path):
        stored = os.getxattr(path, ATTRIBUTES) if ATTRIBUTES in os.listxattr(path) else b''
        return stored, os.stat(path).st_mode

    def presets(self):
        data = f'{self.root}/user/ORX/JPData'
        return (f'{data}/{name}/Presets/presets.xml' for name in os.listdir(data))


def check_outcome(station):
    """The tool and the script have to leave the same of what they find, and the floor has to do its work."""
    outcomes = []
    for run in (lambda: station.tool('I', 'V'), station.script):
        station.tool('U', 'V')
        station.spoil()
        found = station.outcome()
        run()
        outcomes.append(station.outcome())
        if any(now == before for now, before in zip(outcomes[-1], found)):
            raise SystemExit('a run has left what it should change')
    if outcomes[0] != outcomes[1]:
        raise SystemExit('the tool and the script do not leave the same')
    station.spoil()
    icon, cfg = (f'{station.last}/{PRIVATE}/{name}' for name in (lay_out.ICON, 'Folder.cfg'))
    os.utime(cfg, (0, 0))
    station.floor()
    if not filecmp.cmp(icon, f'{station.root}/program/{lay_out.ICON}', False) or os.stat(cfg).st_mtime == 0:
        raise SystemExit('the floor does not do its work')
    station.tool('U', 'V')


def shares(station, *switches):
    """The microseconds of each kind of work, with the log off in the quicker of two runs; the rest is no kind's."""
    best = None
    for _ in range(1 if len(switches) == 1 else 2):
        elapsed, output = station.tool(*switches, program='FolderUpgradeTimed')
        kinds = {name: int(spent) for spent, name in (line.split(' ', 1) for line in output.splitlines())}
        kinds['the rest'] = 0
        kinds['the rest'] = round(elapsed * 1e6) - sum(kinds.values())
        best = min(best or kinds, kinds, key=lambda each: sum(each.values()))
        station.tool('U', 'V')
    return best


def measure_unlogged(station):
    """The seconds of each program with the log off."""
    times = {'count': station.count}
    for _ in range(station.rounds):
        # Each leaves the folders as the next one wants to find them.
        for name, run in (('tool', lambda: station.tool('I', 'V')), ('floor', station.floor),
                          ('unsynced', lambda: station.floor('unsynced')), ('named', lambda: station.floor('named')),
                          ('back', lambda: station.tool('U', 'V')), ('script', station.script)):
            times[name] = min(times.get(name, float('inf')), run()[0])
        station.tool('U', 'V')
    return times


def measure_logged(station, times, previous, log_limit):
    """Adds the seconds of the tool with the log on, or those to be expected where they pass the limit.

    previous is the result over fewer folders that was measured last; without one a single run is measured.
    """
    expected = previous['logged'] * (station.count / previous['count']) ** 2 if previous else log_limit
    if expected > log_limit:
        times['expected'] = expected
        return
    is_short = expected <= log_limit / 10 or station.count <= 100
    for _ in range(station.rounds if is_short else 1):
        times['logged'] = min(times.get('logged', float('inf')), station.tool('I')[0])
        station.tool('U', 'V')
    if expected <= log_limit / 2:
        times['logged shares'] = shares(station, 'I')


def measure(build, count, previous, log_limit):
    with tempfile.TemporaryDirectory(prefix='bench ') as root:
        station = Workstation(root, build, count)
        check_outcome(station)
        times = measure_unlogged(station)
        times['shares'] = shares(station, 'I', 'V')
        measure_logged(station, times, previous, log_limit)
        return times


def find_crossing(build, low, high):
    """The least count, above the first and up to the second, at which the script is the quicker one."""
    while high - low > 1:
        middle = (low + high) // 2
        with tempfile.TemporaryDirectory(prefix='bench ') as root:
            times = measure_unlogged(Workstation(root, build, middle))
        low, high = (low, middle) if times['script'] < times['tool'] else (middle, high)
    return high


def milliseconds(seconds):
    return f'{seconds * 1e3:,.1f}' if seconds < 10 else f'{seconds * 1e3:,.0f}'


def print_times(results):
    print('| Folders | Tool, log off (ms) | per folder (ms) | per folder, growth | Floor (ms) | Tool / floor '
          '| Script (ms) | Tool / script | Tool, log on (ms) | growth | On / off |')
    print('|---:' * 11 + '|')
    first, previous = results[0], None
    for now in results:
        tool, each = now['tool'], now['tool'] / now['count']
        cells = [f"{now['count']:,}", milliseconds(tool), f'{each * 1e3:.2f}',
                 f"{each / (first['tool'] / first['count']):.2f}", milliseconds(now['floor']),
                 f"**{tool / now['floor']:.2f}**", milliseconds(now['script']), f"{tool / now['script']:.2f}"]
        if 'logged' in now:
            grown = f"{now['logged'] / previous['logged']:.1f}" if previous and 'logged' in previous else '-'
            cells += [milliseconds(now['logged']), grown, f"{now['logged'] / tool:.1f}"]
        else:
            cells += [f"left out, some {now['expected']:,.0f} s", '-', '-']
        print('| ' + ' | '.join(cells) + ' |')
        previous = now


def print_floors(results):
    """The tool beside floors that save through another of the library's streams."""
    print('\n| Folders | Floor without wait for the disk (ms) | Tool / that '
          '| Floor with save by name (ms) | Tool / that |')
    print('|---:' * 5 + '|')
    for now in results:
        print(f"| {now['count']:,} | " + ' | '.join(f"{milliseconds(now[name])} | {now['tool'] / now[name]:.2f}"
                                                  for name in ('unsynced', 'named')) + ' |')


def print_shares(results):
    columns = [(f"{now['count']:,}{text}", now[key]) for key, text in
               (('shares', ''), ('logged shares', ', log on')) for now in results if key in now]
    print('\n| Share of the time (%) | ' + ' | '.join(name for name, _ in columns) + ' |')
    print('|:---' + '|---:' * len(columns) + '|')
    for kind in results[0]['shares']:
        print(f'| {kind} | ' + ' | '.join(f'{100 * kinds[kind] / sum(kinds.values()):.1f}' for _, kinds in columns)
              + ' |')


def print_crossing(build, results):
    for now, after in zip(results, results[1:]):
        if now['script'] >= now['tool'] and after['script'] < after['tool']:
            crossing = find_crossing(build, now['count'], after['count'])
            print(f'\nThe script overtakes the tool at {crossing:,} folders.')
            return
    quicker = 'script' if results[0]['script'] < results[0]['tool'] else 'tool'
    print(f'\nAt these counts the {quicker} is always quicker.')


def main():
    parser = argparse.ArgumentParser()
    parser.add_argument('--log-limit', type=float, default=120)
    parser.add_argument('build')
    parser.add_argument('picture')
    parser.add_argument('counts', nargs='*', type=int, default=[10, 100, 1000, 10000])
    options = parser.parse_intermixed_args()
    build, results = os.path.abspath(options.build), []
    for count in options.counts:
        print(f'{count:,} hot folders', file=sys.stderr, flush=True)
        logged = [each for each in results if 'logged' in each]
        results.append(measure(build, count, logged[-1] if logged else None, options.log_limit))
    print_times(results)
    print_floors(results)
    print_shares(results)
    print_crossing(build, results)
    with open(options.picture, 'w', encoding='utf-8') as file:
        file.write(picture.draw(results))


main()

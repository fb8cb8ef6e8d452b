#!/usr/bin/python3
"""Times whole runs over more and more hot folders, beside the library's floor and a script.

    bench/whole_runs.py BUILD_DIR [COUNT...]      (10, 100 and 1,000 folders if none is given)

Each figure is the least of several runs, the three taken in turn. The script's time includes its start.
"""
import os
import re
import subprocess
import sys
import tempfile
import time

HERE = os.path.dirname(os.path.abspath(__file__))
ROUNDS = {10: 20, 100: 10}
FEWEST_ROUNDS = 5


def seconds(*command, env=None, status=0):
    start = time.perf_counter()
    result = subprocess.run(command, env=env, stderr=subprocess.PIPE, check=False)
    elapsed = time.perf_counter() - start
    if result.returncode != status or result.stderr:
        raise SystemExit(f'{command[0]}: status {result.returncode} {result.stderr!r}')
    return elapsed


def registry(root, hive, value):
    with open(f'{root}/{hive}', encoding='utf-8') as file:
        return re.search(f'"{value}"="([^"]*)"', file.read()).group(1).replace('\\\\', '\\')


def measure(build, count):
    with tempfile.TemporaryDirectory(prefix='bench ') as root:
        subprocess.run([f'{HERE}/lay_out.py', root, str(count), f'{build}/FolderUpgrade'], check=True)
        tool = f'{root}/program/FolderUpgrade'
        env = {'XDG_CONFIG_HOME': f'{root}/user', 'XDG_CONFIG_DIRS': f'{root}/machine'}
        common = [f'{root}/folders.txt', f'{root}/program/hf_folder.ico']
        old = registry(root, 'user/registry/HKEY_CURRENT_USER.reg', 'Path')
        new = registry(root, 'machine/registry/HKEY_LOCAL_MACHINE.reg', 'InstallPath') + '/template'
        best = {}
        for _ in range(ROUNDS.get(count, FEWEST_ROUNDS)):
            # Each leaves the folders as the next one wants to find them.
            times = {'tool': seconds(tool, 'I', 'V', env=env, status=255),
                     'back': seconds(tool, 'U', 'V', env=env, status=255),
                     'floor': seconds(f'{build}/bench/floor', *common),
                     'script': seconds('/usr/bin/python3', f'{HERE}/administrator.py', *common, old, new)}
            seconds(tool, 'U', 'V', env=env, status=255)
            best = {name: min(value, best.get(name, value)) for name, value in times.items()}
        logged = seconds(tool, 'I', env=env, status=255)
        return best, logged


def main():
    build = sys.argv[1]
    print('folders   tool ms   per folder   with log ms   floor ms   tool/floor   script ms   tool/script')
    for count in [int(text) for text in sys.argv[2:]] or [10, 100, 1000]:
        best, logged = measure(build, count)
        print(f"{count:7} {best['tool'] * 1e3:9.1f} {best['tool'] * 1e3 / count:12.3f} {logged * 1e3:13.1f} "
              f"{best['floor'] * 1e3:10.1f} {best['tool'] / best['floor']:12.2f} {best['script'] * 1e3:11.1f} "
              f"{best['tool'] / best['script']:13.2f}", flush=True)


main()

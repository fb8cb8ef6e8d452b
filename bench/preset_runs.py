#!/usr/bin/python3
"""Times the migration of one preset file of 64 MiB, beside the library's read, one replacement and write.

    bench/preset_runs.py BUILD_DIR

The tool runs with its log off and without hot folders; the two are taken in turn, and the least of several runs counts
(of the memory, the most). The paths grow as they move, which is what takes the most memory.
"""
import os
import sys
import tempfile
import time

MIB = 1024 * 1024
BYTES = 64 * MIB
ROUNDS = 7
KEY = 'ORXImposeTemplate">"'
PATH = f'    <Setting Key="{KEY}/old/Booklet"</Setting>\r\n'.encode()
LINE = b'    <Setting Key="ORXMediaType">"Plain"</Setting>\r\n'
TEXTS = {'no hits': LINE,
         '8 hits': PATH + LINE * (BYTES // 8 // len(LINE)),
         'a hit each KiB': PATH + LINE * (1024 // len(LINE))}
HIVE = 'Windows Registry Editor Version 5.00\n\n[HKEY_{}]\n"{}"="{}"\n'


def write(path, content):
    os.makedirs(os.path.dirname(path), exist_ok=True)
    with open(path, 'wb') as file:
        file.write(content)


def run(command, env, preset, text):
    """The seconds of a run, and its bytes of memory for each byte of the file."""
    write(preset, text)
    start = time.perf_counter()
    _, _, usage = os.wait4(os.spawnve(os.P_NOWAIT, command[0], command, env), 0)
    elapsed = time.perf_counter() - start
    with open(preset, 'rb') as file:
        if file.read() != text.replace(b'"/old/', b'"/new/template/'):
            raise SystemExit(f'{command[0]} did not migrate the preset')
    return elapsed, usage.ru_maxrss * 1024 / len(text)


def measure(build, root, text):
    env = {'XDG_CONFIG_HOME': f'{root}/user', 'XDG_CONFIG_DIRS': f'{root}/machine'}
    preset = f'{root}/user/ORX/JPData/P/Presets/presets.xml'
    commands = ([f'{build}/FolderUpgrade', 'I', 'V'],
                [f'{build}/bench/preset_floor', preset, f'{KEY}/old', f'{KEY}/new/template'])
    runs = [[run(command, env, preset, text) for command in commands] for _ in range(ROUNDS)]
    return [(min(each[i][0] for each in runs), max(each[i][1] for each in runs)) for i in range(len(commands))]


def main():
    build = os.path.abspath(sys.argv[1])
    print('| 64 MiB with | Tool (ms) | Floor (ms) | Tool / floor | Tool, memory per byte of file | Floor, memory |')
    print('|:---|---:|---:|---:|---:|---:|')
    with tempfile.TemporaryDirectory(prefix='bench ') as root:
        write(f'{root}/user/registry/HKEY_CURRENT_USER.reg',
              HIVE.format('CURRENT_USER\\SOFTWARE\\HF', 'Path', '/old').encode())
        write(f'{root}/machine/registry/HKEY_LOCAL_MACHINE.reg',
              HIVE.format('LOCAL_MACHINE\\SOFTWARE\\Vantorix\\QZA', 'InstallPath', '/new').encode())
        for name, part in TEXTS.items():
            tool, floor = measure(build, root, (part * (BYTES // len(part) + 1))[:BYTES])
            print(f'| {name} | {tool[0] * 1e3:.0f} | {floor[0] * 1e3:.0f} | **{tool[0] / floor[0]:.2f}** '
                  f'| {tool[1]:.1f} bytes | {floor[1]:.1f} bytes |', flush=True)


main()

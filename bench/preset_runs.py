#!/usr/bin/python3
"""Times the migration of one preset file of 64 MiB, beside the library's read, one replacement and write.

    bench/preset_runs.py BUILD_DIR
"""
import os
import sys
import tempfile
import time

MIB = 1024 * 1024
ROUNDS = 5
PATH = b'ORXImposeTemplate">"/old/Booklet" '
TEXT = (PATH + b'text and more text\r\n' * 50) * (64 * MIB // 1034)
HIVE = 'Windows Registry Editor Version 5.00\n\n[HKEY_{}]\n"{}"="{}"\n'


def write(path, content):
    os.makedirs(os.path.dirname(path), exist_ok=True)
    with open(path, 'wb') as file:
        file.write(content)


def measure(command, preset, env):
    best = None
    for _ in range(ROUNDS):
        write(preset, TEXT)
        start = time.perf_counter()
        _, _, usage = os.wait4(os.spawnve(os.P_NOWAIT, command[0], command, env), 0)
        elapsed = time.perf_counter() - start
        with open(preset, 'rb') as file:
            if file.read() != TEXT.replace(b'"/old/', b'"/new/template/'):
                raise SystemExit(f'{command[0]} did not migrate the preset')
        now = (elapsed, usage.ru_maxrss * 1024 / len(TEXT))
        best = min(best, now) if best else now
    return best


def main():
    build = os.path.abspath(sys.argv[1])
    with tempfile.TemporaryDirectory(prefix='bench ') as root:
        env = {'XDG_CONFIG_HOME': f'{root}/user', 'XDG_CONFIG_DIRS': f'{root}/machine'}
        write(f'{root}/user/registry/HKEY_CURRENT_USER.reg',
              HIVE.format('CURRENT_USER\\SOFTWARE\\HF', 'Path', '/old').encode())
        write(f'{root}/machine/registry/HKEY_LOCAL_MACHINE.reg',
              HIVE.format('LOCAL_MACHINE\\SOFTWARE\\Vantorix\\QZA', 'InstallPath', '/new').encode())
        preset = f'{root}/user/ORX/JPData/P/Presets/presets.xml'
        tool = measure([f'{build}/FolderUpgrade', 'I', 'V'], preset, env)
        floor = measure([f'{build}/bench/preset_floor', preset, PATH[:24].decode(), 'ORXImposeTemplate">"/new/template'],
                        preset, env)
    for name, (elapsed, memory) in (('tool', tool), ('floor', floor)):
        print(f'{name}: {elapsed * 1e3:.0f} ms, {memory:.1f} bytes of memory per byte of file')
    print(f'tool/floor: {tool[0] / floor[0]:.2f}')


main()

"""The migration of a preset file of 60 MiB, compared with the library's reading, one replacement and writing."""
import os
import time

from workstation import lay_out

BYTES = 60 * 1024 * 1024
ROUNDS = 7
KEY = 'ORXImposeTemplate">"'
PATH = f'    <Setting Key="{KEY}/old/Booklet"</Setting>\r\n'.encode()
LINE = b'    <Setting Key="ORXMediaType">"Plain"</Setting>\r\n'
TEXTS = {'no hits': LINE, '8 hits': PATH + LINE * (BYTES // 8 // len(LINE)),
         'a hit every KiB': PATH + LINE * (1024 // len(LINE))}
PRESET = 'user/ORX/JPData/P/Presets/presets.xml'
HIVE = 'Windows Registry Editor Version 5.00\n\n[HKEY_{}]\n"{}"="{}"\n'


def run(command, station, text):
    """The seconds that a run takes, and its bytes of memory for each byte of the file."""
    station.put(PRESET, text)
    start = time.perf_counter()
    _, _, usage = os.wait4(os.spawnve(os.P_NOWAIT, command[0], command, station.environment), 0)
    elapsed = time.perf_counter() - start
    with open(station.root / PRESET, 'rb') as file:
        if file.read() != text.replace(b'"/old/', b'"/new/template/'):
            raise SystemExit(f'{command[0]} did not migrate the preset')
    return elapsed, usage.ru_maxrss * 1024 / len(text)


def measure(build, root):
    """Each text's name, and the minimum time and maximum memory of the tool and of the floor.

    The paths get longer when they move, which takes the most memory; the file stays below the longest that is migrated.
    """
    station = lay_out.Workstation(root)
    station.put('user/registry/HKEY_CURRENT_USER.reg', HIVE.format('CURRENT_USER\\SOFTWARE\\HF', 'Path', '/old'))
    station.put('machine/registry/HKEY_LOCAL_MACHINE.reg',
                HIVE.format('LOCAL_MACHINE\\SOFTWARE\\Vantorix\\QZA', 'InstallPath', '/new'))
    commands = ([f'{build}/FolderUpgrade', 'I', 'V'],
                [f'{build}/bench/floor', f'{root}/{PRESET}', f'{KEY}/old', f'{KEY}/new/template'])
    for name, part in TEXTS.items():
        text = (part * (BYTES // len(part) + 1))[:BYTES]
        runs = [[run(command, station, text) for command in commands] for _ in range(ROUNDS)]
        yield name, *((min(each[i][0] for each in runs), max(each[i][1] for each in runs)) for i in (0, 1))

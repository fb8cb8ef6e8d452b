"""A workstation with any number of hot folders whose templates an upgrade moves, and the programs that run on it."""
import glob
import os
import shutil
import subprocess
import sys
import tempfile
import time

from lxml import etree

HERE = os.path.dirname(os.path.abspath(__file__))
SAMPLES = f'{HERE}/../samples/workstation'
SAMPLE = 'Flyers A4'
PRIVATE = '[_ORX_HotFolder_]'
ICON = 'hf_folder.ico'
ICON_BYTES = 60 * 1024
ATTRIBUTES = 'user.DOSATTRIB'
STALE_INI = '[.ShellClassInfo]\r\nIconFile=.\\[_ORX_HotFolder_]\\hf_folder.ico\r\nIconIndex=00\r\nInfoTip=Stale\r\n'
FINISHED = 255  # the tool's exit status on every path


def write(path, content):
    os.makedirs(os.path.dirname(path), exist_ok=True)
    with open(path, 'wb') as file:
        file.write(content)


class Workstation:
    """On this machine, below root: each hot folder is a copy of the sample's, with an icon of 60 KB.

    Each program is a method that returns the seconds it took, including the start of its process.
    """
    separator, executable, hive_encoding, is_quiet = '/', '', 'utf-8', True

    def __init__(self, root):
        self.root = self.seen_root = root
        self.user, self.machine = f'{root}/user', f'{root}/machine'
        self.environment = {'XDG_CONFIG_HOME': self.user, 'XDG_CONFIG_DIRS': self.machine}

    def seen(self, *names):
        """A path below root as the programs see it."""
        return self.separator.join((self.seen_root, *names))

    def render(self, relative, name=SAMPLE):
        with open(f'{SAMPLES}/{relative}', encoding='utf-8') as file:
            text = file.read()
        escaped = self.separator.replace('\\', '\\\\')
        return (text.replace(f'@Hot Folders@/@{SAMPLE}', f'@Hot Folders@/@{name}').replace('@//@', escaped)
                .replace('@/@', self.separator).replace('@ROOT@', self.seen_root))

    def lay_out(self, build, count, old_tool=None):
        for path in ('machine/registry/HKEY_LOCAL_MACHINE.reg', 'user/registry/HKEY_CURRENT_USER.reg'):
            self.add_hive(path, self.render(path).replace('\n', '\r\n').encode(self.hive_encoding))
        for path in glob.glob('user/ORX/JPData/*/Presets/presets.xml', root_dir=SAMPLES):
            write(f'{self.user}/{path[5:]}', self.render(path).encode())
        os.makedirs(f'{self.user}/ORX_Installers', exist_ok=True)

        with open(f'{HERE}/../appearance/icons/{ICON}', 'rb') as file:
            icon = (file.read() * 4)[:ICON_BYTES]
        for directory in ('program', 'program/BundleIcons'):
            write(f'{self.root}/{directory}/{ICON}', icon)
        programs = {'FolderUpgrade': f'{build}/FolderUpgrade', 'floor': f'{build}/bench/floor', 'old': old_tool}
        for name, path in programs.items():
            if path:
                shutil.copy(path + self.executable, f'{self.root}/program/{name}{self.executable}')

        names = [f'Jobs {number:05}' for number in range(1, count + 1)]
        for name in names:
            self.add_folder(name, icon)
        folders = [self.seen('Hot Folders', name) for name in names]
        write(f'{self.machine}/hotfolder/HotFolderList.cfg',
              ('<HotFolderList>' + ''.join(f'<HotFolder path="{folder}"/>\n' for folder in folders)
               + '</HotFolderList>\n').encode())
        write(f'{self.root}/folders.txt', '\n'.join(folders).encode())

    def add_hive(self, path, content):
        write(f'{self.root}/{path}', content)

    def add_folder(self, name, icon):
        folder = f'{self.root}/Hot Folders/{name}'
        write(f'{folder}/{PRIVATE}/Folder.cfg', self.render(f'Hot Folders/{SAMPLE}/{PRIVATE}/Folder.cfg', name).encode())
        write(f'{folder}/{PRIVATE}/{ICON}', icon[::-1])
        write(f'{folder}/Desktop.ini', STALE_INI.encode())

    def run(self, *command, status=0):
        with tempfile.TemporaryFile() as errors:  # not a pipe, because Wine's services would keep it open
            start = time.perf_counter()
            found = subprocess.run(command, env=self.environment, stdout=errors, stderr=errors, check=False).returncode
            elapsed = time.perf_counter() - start
            errors.seek(0)
            text = errors.read()
        if found != status or (text and self.is_quiet):
            raise SystemExit(f'{command}: status {found} {text!r}')
        return elapsed

    def start(self, program, *arguments, status=FINISHED):
        return self.run(f'{self.root}/program/{program}', *arguments, status=status)

    def tool(self):
        return self.start('FolderUpgrade', 'I', 'V')

    def logged(self):
        return self.start('FolderUpgrade', 'I')

    def back(self):
        return self.start('FolderUpgrade', 'U', 'V')

    def old(self):
        return self.start('old', 'I', 'V')

    def floor(self):
        return self.start('floor', self.seen('folders.txt'), self.seen('program', ICON), status=0)

    def script(self):
        return self.run(sys.executable, f'{HERE}/administrator.py', f'{self.machine}/hotfolder/HotFolderList.cfg',
                        f'{self.root}/program', self.seen('Program Files (x86)', 'Vantorix', 'HF', 'Templates'),
                        self.seen('Program Files', 'Vantorix', 'QZA', 'template'), f'{self.user}/ORX/JPData')

    def outcome(self):
        """The state of each file and folder after a run: content, attributes and mode."""
        found = {}
        for path in (path for place in ('Hot Folders', 'user/ORX') for path in
                     glob.glob(f'{self.root}/{place}/**', recursive=True)):
            content = None
            if path.endswith('/Folder.cfg'):  # canonical, because the programs' quotes and the like differ
                content = etree.tostring(etree.parse(path), method='c14n')
            elif os.path.isfile(path):
                with open(path, 'rb') as file:
                    content = file.read()
            attributes = os.getxattr(path, ATTRIBUTES) if ATTRIBUTES in os.listxattr(path) else None
            found[path] = (content, attributes, os.stat(path).st_mode)
        return found

    def close(self):
        pass


class WineWorkstation(Workstation):
    """In a Wine prefix whose drive C: is the root for the programs."""
    separator, executable, hive_encoding, is_quiet = '\\', '.exe', 'utf-16', False
    wine, server = '/usr/lib/wine/wine64', '/usr/lib/wine/wineserver64'

    def __init__(self, root):
        super().__init__(f'{root}/drive_c')
        self.seen_root = 'C:'
        self.user, self.machine = f'{self.root}/users/root/AppData/Roaming', f'{self.root}/ProgramData'
        self.environment = dict(os.environ, WINEPREFIX=root, HOME=root, USER='root', LC_ALL='C.UTF-8', WINEDEBUG='-all',
                                WINEDLLOVERRIDES='mscoree=;mshtml=')

    def lay_out(self, build, count, old_tool=None):
        self.run(self.server, '-p')  # it keeps running between the runs
        self.run(self.wine, 'wineboot', '--init')
        super().lay_out(build, count)

    def add_hive(self, path, content):
        super().add_hive('hive.reg', content)
        self.run(self.wine, 'regedit', '/S', self.seen('hive.reg'))

    def start(self, program, *arguments, status=FINISHED):
        return self.run(self.wine, self.seen('program', f'{program}.exe'), *arguments, status=status)

    def close(self):
        subprocess.run([self.server, '-k'], env=self.environment, check=False)

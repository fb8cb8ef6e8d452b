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
sys.path.insert(0, f'{HERE}/../samples')
import lay_out
from lay_out import ATTRIBUTES, PRIVATE

SAMPLE = 'Flyers A4'
ICON = 'hf_folder.ico'
ICON_BYTES = 60 * 1024
STALE_INI = '[.ShellClassInfo]\r\nIconFile=.\\[_ORX_HotFolder_]\\hf_folder.ico\r\nIconIndex=00\r\nInfoTip=Stale\r\n'
FINISHED = 255  # the tool's exit status on every path


class Workstation(lay_out.Workstation):
    """On this machine: each hot folder is a copy of the sample's, with an icon of 60 KB.

    Each program is a method that returns the seconds it took, including the start of its process.
    """
    executable, is_quiet = '', True

    def lay_out(self, build, count, old_tool=None):
        for name in ('machine/registry/HKEY_LOCAL_MACHINE.reg', 'user/registry/HKEY_CURRENT_USER.reg'):
            self.put_hive(name, lay_out.sample(name))
        for name in glob.glob('user/ORX/JPData/*/Presets/presets.xml', root_dir=lay_out.TEXTS):
            self.put(name, lay_out.sample(name))
        (self.user / 'ORX_Installers').mkdir(exist_ok=True)

        icon = ((lay_out.ICONS / ICON).read_bytes() * 4)[:ICON_BYTES]
        for directory in ('program', 'program/BundleIcons'):
            self.put(f'{directory}/{ICON}', icon)
        programs = {'FolderUpgrade': f'{build}/FolderUpgrade', 'floor': f'{build}/bench/floor', 'old': old_tool}
        for name, path in programs.items():
            if path:
                shutil.copy(path + self.executable, f'{self.root}/program/{name}{self.executable}')

        cfg = lay_out.sample(f'Hot Folders/{SAMPLE}/{PRIVATE}/Folder.cfg')
        names = [f'Jobs {number:05}' for number in range(1, count + 1)]
        for name in names:
            folder = f'Hot Folders/{name}'
            self.put(f'{folder}/{PRIVATE}/Folder.cfg', cfg.replace(f'@Hot Folders@/@{SAMPLE}', f'@Hot Folders@/@{name}'))
            self.put(f'{folder}/{PRIVATE}/{ICON}', icon[::-1])
            self.put(f'{folder}/Desktop.ini', STALE_INI)
        folders = [self.seen('Hot Folders', name) for name in names]
        self.put('machine/hotfolder/HotFolderList.cfg', '<HotFolderList>'
                 + ''.join(f'<HotFolder path="{folder}"/>\n' for folder in folders) + '</HotFolderList>\n')
        self.put('folders.txt', '\n'.join(folders))

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

    def moved(self):
        """The number of hot folders whose template is in the new folder."""
        new = self.seen('Program Files', 'Vantorix', 'QZA', 'template').encode()
        return sum(new in path.read_bytes() for path in self.root.glob(f'Hot Folders/*/{glob.escape(PRIVATE)}/Folder.cfg'))

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


class WineWorkstation(lay_out.WineWorkstation, Workstation):
    """In a Wine prefix whose drive C: is the root for the programs."""
    executable, is_quiet = '.exe', False

    def start(self, program, *arguments, status=FINISHED):
        return self.run(self.loader, self.seen('program', f'{program}.exe'), *arguments, status=status)

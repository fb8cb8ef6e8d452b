#!/usr/bin/env python3
"""Signs and packs the Windows programs, builds both sample installers and runs them under Wine.

    samples/installer_test.py BUILD_DIR

BUILD_DIR is that of the preset "windows". Wine gets its own prefix. The workstation has two hot
folders (one template moves) and a job preset. Nobody presses the button of a message box.
"""
import pathlib
import re
import shutil
import subprocess
import sys
import tempfile
import time
import unittest

import lay_out

ROOT = pathlib.Path(__file__).resolve().parents[1]
PROGRAMS = ("FolderUpgrade.exe", "FolderUpgradeCheck.exe", "FolderUpgradeRun.exe")
PRODUCT = r"C:\Program Files\Vantorix\QZA"
PREVIOUS, DEFAULT, ELSEWHERE = r"C:\Previous", PRODUCT + r"\template", r"C:\Elsewhere"
SIGN = ('sh;-c;osslsigncode sign -key "{0}/key" -certs "{0}/cert" -h sha256 -in "$0" -out "$0.new"'
        ' && mv "$0.new" "$0"')


def run(*command, **options):
    return subprocess.run(command, check=True, timeout=120, capture_output=True, **options).stdout


def files_below(folder):
    """Name relative to the folder -> content."""
    return {str(path.relative_to(folder)): path.read_bytes()
            for path in folder.rglob("*") if path.is_file()}


def pack(folder, sign=""):
    """Makes a package outside the build folder, whose settings stay as they are, and unpacks it."""
    run("cpack", "--config", BUILD / "CPackConfig.cmake", "-B", f"{folder} package",
        "-D", f"CPACK_FOLDER_UPGRADE_SIGN_COMMAND={sign}")
    (package,) = pathlib.Path(f"{folder} package").glob("FolderUpgrade-*-win64.zip")
    folder.mkdir()
    run("cmake", "-E", "tar", "xf", package, cwd=folder)
    return package.read_bytes()


class Workstation(lay_out.WineWorkstation):
    def install(self, *command):
        """The exit status."""
        status = self.wine(*command)
        # Now and then Wine itself ends with 1 before the program has begun; none of ours does.
        return self.wine(*command) if status == 1 and command[0] == "msiexec" else status

    def files(self, template_dir, icon):
        path = rf'<K n="ORXImposeTemplate">"{template_dir}\Sub\Booklet"</K>'
        files = {"Hot Folders/A/[_ORX_HotFolder_]/hf_folder.ico": icon,
                 "user/ORX/JPData/P/Presets/presets.xml": path.encode() + b"\r\n"}
        cfg = (ROOT / "tests/data/written.cfg").read_text(encoding="utf-8")
        cfg = cfg.replace("{{filter}}", "  <FilterSetting/>\n")
        for name, folder in (("A", template_dir), ("B", ELSEWHERE)):
            text = cfg.replace("{{path}}", rf"{folder}\Booklet").encode()
            files[f"Hot Folders/{name}/[_ORX_HotFolder_]/Folder.cfg"] = text
        return files

    def lay_out(self, template_dir, previous):
        """Restores the state before a step, without logs; previous: in the registry, or None."""
        for name, text in self.files(template_dir, b"an older picture").items():
            self.put(name, text)
        self.put("Elsewhere/Booklet", b"a template")
        folders = "".join(rf'<HotFolder path="C:\Hot Folders\{name}"/>' for name in "AB")
        self.put("machine/hotfolder/HotFolderList.cfg", f"<L>{folders}</L>")
        shutil.rmtree(self.user / "ORX_Installers", ignore_errors=True)
        self.wine("reg", "delete", r"HKCU\SOFTWARE\HF", "/f")
        if previous:
            self.wine("reg", "add", r"HKCU\SOFTWARE\HF", "/v", "Path", "/d", previous, "/f")

    def look(self):
        """The files of the hot folders and the preset, except Desktop.ini, which Wine changes."""
        folders = {"Hot Folders": self.root / "Hot Folders", "user/ORX": self.user / "ORX"}
        return {f"{name}/{path}": text for name, folder in folders.items()
                for path, text in files_below(folder).items() if not path.endswith("Desktop.ini")}


def build_msi(package, version):
    msi = package.parent / f"{version}.msi"
    run("wixl", "-a", "x64", "-D", f"Version={version}", "-o", msi, ROOT / "samples/installer.wxs",
        cwd=package)
    path = "Z:" + str(msi).replace("/", "\\")
    return [["msiexec", option, path, "/qn"] for option in ("/i", "/x")]


def build_setup(package, version):
    setup = package.parent / f"{version}.exe"
    run("makensis", "-V2", "-WX", f"-DPACKAGE={package}", f"-DVERSION={version}",
        f"-DOUTPUT={setup}", ROOT / "samples/installer.nsi")
    return [[str(setup), "/S"], [PRODUCT + r"\uninstall.exe", "/S"]]


class Installers(unittest.TestCase):
    maxDiff = 2000

    def setUp(self):
        self.scratch = pathlib.Path(self.enterContext(tempfile.TemporaryDirectory()))
        self.package = self.scratch / "unsigned"
        self.unsigned = pack(self.package)

    def test_signing(self):
        run("openssl", "req", "-x509", "-newkey", "rsa:2048", "-nodes", "-days", "2", "-subj",
            "/CN=Trial", "-addext", "extendedKeyUsage=codeSigning", "-keyout", self.scratch / "key",
            "-out", self.scratch / "cert")
        signed = self.scratch / "signed"
        pack(signed, SIGN.format(self.scratch))
        self.assertEqual(pack(self.scratch / "again"), self.unsigned)
        for folder, status in ((signed, 0), (self.package, 1)):
            for program in PROGRAMS:
                found = subprocess.run(["osslsigncode", "verify", "-CAfile", self.scratch / "cert",
                                        "-in", folder / program], check=False, capture_output=True)
                self.assertEqual(min(found.returncode, 1), status, (folder, program))
        notices = (signed / "THIRD-PARTY-NOTICES.txt").read_text(encoding="utf-8")
        for name in ("wxWindows Library Licence", "Thai Open Source Software Center", "winpthreads",
                     "GCC RUNTIME LIBRARY EXCEPTION", "GNU GENERAL PUBLIC LICENSE"):
            self.assertIn(name, notices)

    def test_msi(self):
        self.try_installer(build_msi)
        table = run("msiinfo", "export", self.scratch / "1.2.0.msi", "CustomAction", text=True)
        kinds = re.findall(r"\n\w+grade\w*\t(\d+)\t", table)
        # All run as the user, their status ignored.
        self.assertEqual([int(kind) & 0x840 for kind in kinds], [0x40] * 2)

    def test_setup(self):
        self.try_installer(build_setup)

    def try_installer(self, build):
        station = Workstation(self.scratch / "prefix")
        self.addCleanup(station.close)
        install_old, _ = build(self.package, "1.1.0")
        install_new, remove = build(self.package, "1.2.0")
        shipped = {name: text for name, text in files_below(self.package).items()
                   if name.endswith((".exe", ".ico", "NOTICES.txt"))}
        icon = shipped["hf_folder.ico"]

        def check_step(command, files, mode="", status=0):
            """mode and status: those of the run, if there is one."""
            is_installed = mode != "downgrade"
            self.assertEqual(station.install(*command), 0)
            product = station.root / "Program Files/Vantorix/QZA"
            for _ in range(300):  # the uninstaller continues as a copy
                if not is_installed and (product / "uninstall.exe").exists():
                    time.sleep(0.1)
            installed = {name: text for name, text in files_below(product).items()
                         if name in shipped or not name.startswith(("template", "uninstall.exe"))}
            self.assertEqual(installed, shipped if is_installed else {})
            key = station.wine("reg", "query", r"HKLM\SOFTWARE\Vantorix\QZA", "/reg:64")
            self.assertEqual(key == 0, is_installed)
            self.assertEqual(station.look(), files)
            logs = files_below(station.user / "ORX_Installers")
            names = [f"FolderUpgrade-{mode}{end}" for end in (".log", "-before.txt", "-after.txt")]
            self.assertEqual(logs.keys(), {"UpgradeDowngrade.log", *names} if mode else set())
            if mode:
                last = logs[names[2]].splitlines()[-1].decode()
                self.assertEqual(last, f"Exit status of FolderUpgradeRun: {status}")

        station.lay_out(PREVIOUS, None)
        malformed = "Hot Folders/B/[_ORX_HotFolder_]/Folder.cfg"
        station.put(malformed, b"")  # causes a message box
        check_step(install_old, {**station.files(PREVIOUS, icon), malformed: b""}, "upgrade", 2)
        station.lay_out(PREVIOUS, PREVIOUS)
        for template in ("Booklet", "Sub/Booklet"):  # the samples install no templates
            station.put(f"Program Files/Vantorix/QZA/template/{template}", b"")
        check_step(install_new, station.files(DEFAULT, icon), "upgrade")
        station.lay_out(PREVIOUS, PREVIOUS)  # the same version again
        check_step(install_new, station.files(PREVIOUS, b"an older picture"))
        station.lay_out(DEFAULT, PREVIOUS)
        check_step(remove, station.files(PREVIOUS, icon), "downgrade")


if __name__ == "__main__":
    BUILD = pathlib.Path(sys.argv.pop()).resolve()
    unittest.main()

#!/usr/bin/env python3
"""Signs and packs the Windows programs, builds both sample installers and runs them under Wine.

    samples/installer_test.py BUILD_DIR

BUILD_DIR is the build folder of the preset "windows". Wine gets its own prefix and display. The workstation has two hot
folders (one template moves) and a job preset. Nobody presses the button of a message box.
"""
import functools
import os
import pathlib
import re
import subprocess
import sys
import tempfile
import time

import lay_out

ROOT = pathlib.Path(__file__).resolve().parents[1]
PROGRAMS = ("FolderUpgrade.exe", "FolderUpgradeCheck.exe", "FolderUpgradeRun.exe")
PRODUCT = r"C:\Program Files\Vantorix\QZA"
PREVIOUS, DEFAULT, ELSEWHERE = r"C:\Previous", PRODUCT + r"\template", r"C:\Elsewhere"
NO_PATH = "Unable to read: Previous Version  Default Impose Template Path"
SIGN = '#!/bin/sh -e\nosslsigncode sign -key "{0}/key" -certs "{0}/cert" -h sha256 -in "$1" -out "$1.signed"\nmv "$1.signed" "$1"\n'

failures = []
passed = 0


def check(name, found, wanted):
    global passed
    if found == wanted:
        passed += 1
        return
    if isinstance(found, dict) and isinstance(wanted, dict):  # show only the differences
        names = [key for key in found.keys() | wanted.keys() if found.get(key) != wanted.get(key)]
        found, wanted = ({key: files.get(key) for key in names} for files in (found, wanted))
    failures.append(name)
    print(f"FAILED: {name}\n  found  {found!r:.2000}\n  wanted {wanted!r:.2000}")


def run(*command, **options):
    return subprocess.run(command, check=True, timeout=120, capture_output=True, **options).stdout


def succeeds(*command):
    return subprocess.run(command, check=False, timeout=120, capture_output=True).returncode == 0


def files_below(folder):
    """Name relative to the folder -> content."""
    return {str(path.relative_to(folder)): path.read_bytes() for path in folder.rglob("*") if path.is_file()}


# Package ------------------------------------------------------------------------------------------

def pack(build, scratch, sign):
    """Makes a package outside the build folder, whose settings stay as they are."""
    run("cpack", "--config", build / "CPackConfig.cmake", "-D", f"CPACK_FOLDER_UPGRADE_SIGN_COMMAND={sign}", "-B", scratch / "packing")
    (package,) = (scratch / "packing").glob("FolderUpgrade-*-win64.zip")
    return package.read_bytes()


def unpack(package, folder):
    folder.mkdir()
    (folder / "package.zip").write_bytes(package)
    run("cmake", "-E", "tar", "xf", "package.zip", cwd=folder)
    (folder / "package.zip").unlink()


def try_signing(build, scratch):
    """Leaves the unsigned package in the folder "package"."""
    run("openssl", "req", "-x509", "-newkey", "rsa:2048", "-nodes", "-days", "2", "-subj", "/CN=Trial", "-addext",
        "extendedKeyUsage=codeSigning", "-keyout", scratch / "key", "-out", scratch / "cert")
    (scratch / "sign").write_text(SIGN.format(scratch))
    (scratch / "sign").chmod(0o755)
    unsigned = pack(build, scratch, "")
    signed = pack(build, scratch, scratch / "sign")
    check("without a command two packages are identical", pack(build, scratch, "") == unsigned, True)
    unpack(unsigned, scratch / "package")
    unpack(signed, scratch / "signed package")
    for program in PROGRAMS:
        for folder, is_signed in (("package", False), ("signed package", True)):
            check(f"{program} in the {folder}: its signature verifies",
                  succeeds("osslsigncode", "verify", "-CAfile", scratch / "cert", "-in", scratch / folder / program), is_signed)
    left, signed_left = ({name for name, text in files_below(scratch / folder).items() if name not in PROGRAMS and text}
                         for folder in ("package", "signed package"))
    check("nothing else is packed when signing", signed_left, left)
    notices = (scratch / "package/THIRD-PARTY-NOTICES.txt").read_text(encoding="utf-8")
    for phrase in ("wxWindows Library Licence", "Thai Open Source Software Center", "GCC RUNTIME LIBRARY EXCEPTION",
                   "winpthreads", "GNU GENERAL PUBLIC LICENSE\n                       Version 3"):
        check(f"the notices hold: {phrase}", phrase in notices, True)


# Workstation --------------------------------------------------------------------------------------

class Workstation(lay_out.WineWorkstation):
    def __init__(self, prefix):
        super().__init__(prefix)
        self.logs = self.user / "ORX_Installers"
        self.product = self.root / "Program Files/Vantorix/QZA"

    def install(self, *command):
        """The exit status."""
        status = self.wine(*command)
        # Now and then Wine itself ends with 1 before the program has begun; none of ours gives that.
        return self.wine(*command) if status == 1 and command[0] == "msiexec" else status

    def files(self, template_dir, icon):
        cfg = (ROOT / "tests/data/written.cfg").read_text(encoding="utf-8")
        cfg = cfg.replace("{{filter}}", '  <FilterSetting mode="2" name="&lt;">\n    <a/>\n  </FilterSetting>\n')
        return {"Hot Folders/A/[_ORX_HotFolder_]/Folder.cfg": cfg.replace("{{path}}", template_dir + r"\Booklet").encode(),
                "Hot Folders/A/[_ORX_HotFolder_]/hf_folder.ico": icon,
                "Hot Folders/B/[_ORX_HotFolder_]/Folder.cfg": cfg.replace("{{path}}", ELSEWHERE + r"\Booklet").encode(),
                "user/ORX/JPData/P/Presets/presets.xml":
                    rf'<K n="ORXImposeTemplate">"{template_dir}\Sub\Booklet"</K>'.encode() + b"\r\n"}

    def lay_out(self, previous):
        """Restores the state before an upgrade, without reports and logs; previous is the registry's text or None."""
        for name, text in {**self.files(PREVIOUS, b"an older picture"), "Elsewhere/Booklet": b"", "machine/hotfolder/HotFolderList.cfg":
                           rb'<L><HotFolder path="C:\Hot Folders\A"/><HotFolder path="C:\Hot Folders\B"/></L>'}.items():
            self.put(name, text)
        for path in self.logs.glob("*"):
            path.unlink()
        self.wine("reg", "delete", r"HKCU\SOFTWARE\HF", "/f")
        if previous:
            self.wine("reg", "add", r"HKCU\SOFTWARE\HF", "/v", "Path", "/d", previous, "/f")

    def look(self):
        """The files of the hot folders and presets, except Desktop.ini, which Wine changes."""
        return {f"{name}/{path}": text for name, folder in (("Hot Folders", self.root / "Hot Folders"), ("user/ORX", self.user / "ORX"))
                for path, text in files_below(folder).items() if not path.endswith("Desktop.ini")}

    def registry(self):
        with tempfile.TemporaryFile("w+") as output:
            self.wine("reg", "query", r"HKLM\SOFTWARE\Vantorix\QZA", "/reg:64", output=output)
            output.seek(0)
            return dict(re.findall(r"^ +(\w+) +REG_SZ +(.*)$", output.read(), re.MULTILINE))

    def report(self, name):
        """A report's direction, the kinds of its lines, and its text."""
        text = (self.logs / name).read_text(encoding="utf-8") if (self.logs / name).exists() else ""
        direction = re.match(r"FolderUpgradeCheck \d+\.\d+\.\d+, (\w+), ", text)
        return direction and direction[1], set(re.findall(r"^  (change|problem)  ", text, re.MULTILINE)), text


def log_lines(user, switch, icon_dir, stored, complaint=None):
    """The expected run log; with a complaint about A's template, the Folder.cfg of B cannot be read."""
    call = {"I": "Installation : Upgrade call with switch: I", "U": "Un-installation : Downgrade call with switch: U"}[switch]
    icon, copy = rf"{icon_dir}\hf_folder.ico", r"C:\Hot Folders\A\[_ORX_HotFolder_]\hf_folder.ico"
    preset = rf"{user}\ORX\JPData\P\Presets\presets.xml"
    return [call, "Start: HF updation",
            f"Icon  copied from : {icon} To {copy} ", r"Updated icon for hfC:\Hot Folders\A count:  1",
            rf"Imposepath:C:\Hot Folders\Ais: {stored}\Booklet", *([complaint] if complaint else []),
            r"updated Impose path for hfC:\Hot Folders\A count:  1",
            rf"Icon path  not exist: {icon_dir}\hf_folder{'_disabled' if complaint else ''}.ico",
            r"Updated icon for hfC:\Hot Folders\B count:  2",
            *([] if complaint else [rf"Imposepath:C:\Hot Folders\Bis: {ELSEWHERE}\Booklet"]),
            r"updated Impose path for hfC:\Hot Folders\B count:  2",
            "End: HF updation", "Start: Updating Impose path for JP Presets",
            complaint or f"Updated preset.xml  : {preset}", "End: Updating Impose path for JP Presets", ""]


# Installers ---------------------------------------------------------------------------------------

def build_msi(scratch, version):
    msi = scratch / f"{version}.msi"
    run("wixl", "-a", "x64", "-D", f"Version={version}", "-o", msi, ROOT / "samples/installer.wxs", cwd=scratch / "package")
    actions = re.findall(r"^\w+grade\w*\t(\d+)\t", run("msiinfo", "export", msi, "CustomAction", text=True), re.MULTILINE)
    check("both actions of the MSI run as the user, their status ignored", [int(kind) & 0x840 for kind in actions], [0x40] * 2)
    path = "Z:" + str(msi).replace("/", "\\")
    return [["msiexec", option, path, "/qn"] for option in ("/i", "/x")]


def build_setup(scratch, version):
    setup = scratch / f"{version}.exe"
    run("makensis", "-V2", "-WX", f"-DPACKAGE={scratch}/package", f"-DVERSION={version}", f"-DOUTPUT={setup}",
        ROOT / "samples/installer.nsi")
    return [[str(setup), "/S"], [PRODUCT + r"\uninstall.exe", "/S"]]


def try_installer(name, build_installer, scratch, station):
    (install_old, _), (install_new, remove) = (build_installer(scratch, version) for version in ("1.1.0", "1.2.0"))
    shipped = {file: text for file, text in files_below(scratch / "package").items()
               if file.endswith((".exe", ".ico", "NOTICES.txt"))}
    new_icon, user = shipped["hf_folder.ico"], r"C:\users\root\AppData\Roaming"

    def check_step(step, command, version, files, reports=None, log=None):
        """reports: the direction, and the kinds of lines in both."""
        step = f"{name}, {step}"
        before = files_below(station.logs)
        check(f"{step}: exit status", station.install(*command), 0)
        for _ in range(300 if version is None else 0):  # the uninstaller continues as a copy of itself
            if not station.product.exists():
                break
            time.sleep(0.1)
        installed = files_below(station.product)
        installed.pop("uninstall.exe", None)
        check(f"{step}: files", installed, shipped if version else {})
        check(f"{step}: registry", station.registry(), {"InstallPath": PRODUCT, "Version": version} if version else {})
        check(f"{step}: hot folders and presets", station.look(), files)
        after = files_below(station.logs)
        if not reports:
            check(f"{step}: reports and logs", after, before)
            return
        direction, *kinds = reports
        names = [f"FolderUpgrade-{direction}{end}" for end in ("-before.txt", "-after.txt", ".log")]
        check(f"{step}: names of reports and logs", after.keys(), before.keys() | {"UpgradeDowngrade.log", *names})
        for copy in ("UpgradeDowngrade.log", names[2]):
            check(f"{step}: {copy}", after.get(copy, b"").decode("utf-8").split("\r\n"), log)
        for file, kind in zip(names, kinds):
            check(f"{step}: {file}", station.report(file)[:2], (direction, kind))
        check(f"{step}: status", station.report(names[1])[2].splitlines()[-1:],
              [f"Exit status of FolderUpgradeRun: {2 if kinds[1] else 0}"])

    upgrade_log = functools.partial(log_lines, user, "I", PRODUCT, PREVIOUS)
    station.lay_out(None)
    malformed = ("Hot Folders/B/[_ORX_HotFolder_]/Folder.cfg", b"")
    station.put(*malformed)
    check_step("message box", install_old, "1.1.0", {**station.files(PREVIOUS, new_icon), malformed[0]: malformed[1]},
               ("upgrade", {"change", "problem"}, {"problem"}), upgrade_log(NO_PATH))

    station.lay_out(PREVIOUS)
    check_step("newer version", install_new, "1.2.0", station.files(DEFAULT, new_icon), ("upgrade", {"change"}, set()), upgrade_log())
    check(f"{name}, newer version: the report names the move",
          rf"{PREVIOUS}\Booklet -> {DEFAULT}\Booklet" in station.report("FolderUpgrade-upgrade-before.txt")[2], True)

    station.lay_out(PREVIOUS)
    check_step("same version again", install_new, "1.2.0", station.files(PREVIOUS, b"an older picture"))

    for file, text in station.files(DEFAULT, b"an older picture").items():
        station.put(file, text)
    check_step("removal", remove, None, station.files(PREVIOUS, new_icon), ("downgrade", {"change"}, set()),
               log_lines(user, "U", PRODUCT + r"\BundleIcons", DEFAULT))


def main():
    if not os.environ.get("INSTALLER_TEST_DISPLAY"):
        os.environ["INSTALLER_TEST_DISPLAY"] = "1"
        os.execvp("xvfb-run", ["xvfb-run", "-a", sys.executable, *sys.argv])
    with tempfile.TemporaryDirectory() as folder:
        scratch = pathlib.Path(folder)
        try_signing(pathlib.Path(sys.argv[1]).resolve(), scratch)
        station = Workstation(scratch / "prefix")
        try:
            try_installer("MSI", build_msi, scratch, station)
            try_installer("NSIS", build_setup, scratch, station)
        finally:
            station.close()
    print(f"{passed} passed, {len(failures)} failed, 0 skipped")
    sys.exit(bool(failures))


if __name__ == "__main__":
    main()

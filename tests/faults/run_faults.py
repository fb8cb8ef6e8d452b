#!/usr/bin/env python3
"""Runs the tool over and over on a small workstation, and each time another call of it fails:

    run_faults.py PROGRAM LIBRARY [--left]

PROGRAM is FolderUpgrade with its icons beside it, built with clang's sanitizers, LIBRARY what
failing_calls.cpp makes. Whatever call fails, with each of four errors: the run ends with -1 and
without a report of a sanitizer, only what the call concerned differs from a run without a fault,
and no file that is only read has changed. --left lists what was left neither as before nor as after.
"""
import concurrent.futures
import errno
import os
import pathlib
import shutil
import stat
import subprocess
import sys
import tempfile

ERRORS = (errno.ENOSPC, errno.EIO, errno.EACCES, errno.EINTR)
WORKERS = os.cpu_count() or 1
FINISHED = 255  # the tool's exit status of -1, on every path
ATTRIBUTES = "user.DOSATTRIB"
LOG = "user/ORX_Installers"

CFG = """<?xml version="1.0" encoding="UTF-8"?>
<HotFolder name="{name}" description="" server_ip="192.0.2.40" server_name="PRESS1" server_version="620"
 BaseVirtualPrinter="" BaseVirtualPrinterName="" BaseVirtualPrinterDisplayName="" HFPresetName="" PPDVersion=""
 ServerTypeAndJPDefaultKeyInfo="" Enable="{enable}" Centralized="0" Isjobpresetattached="0" IsCustomInterval="0"
 TimeInterval="10"><Paths><Hotfolder path="{name}"/></Paths>
 <JobSetting><K Key="ORXCopies" Value="1" D="{filler}" L="1"/></JobSetting>
 <ImposeSetting><K Key="ORXImposeTemplate" Value="{root}/previous/Booklet" D="Booklet"/></ImposeSetting>
 <FilterSetting>text<Filter/></FilterSetting></HotFolder>
"""
PRESET = '<Presets><Setting Key="ORXImposeTemplate">"{root}/previous/Booklet"</Setting></Presets>\r\n'
HIVE = 'Windows Registry Editor Version 5.00\r\n\r\n[{key}]\r\n"{name}"="{value}"\r\n'


def lay_out(root):
    """The files by their path, and the attributes of those that have some."""
    program = root / "program"
    files = {
        "machine/hotfolder/HotFolderList.cfg": "<HotFolderList>"
        + "".join(f'<HotFolder path="{root}/Hot Folders/{name}"/>' for name in "ABC") + "</HotFolderList>",
        "machine/registry/HKEY_LOCAL_MACHINE.reg": HIVE.format(
            key=r"HKEY_LOCAL_MACHINE\SOFTWARE\Vantorix\QZA", name="InstallPath", value=root),
        "user/registry/HKEY_CURRENT_USER.reg": HIVE.format(
            key=r"HKEY_CURRENT_USER\SOFTWARE\HF", name="Path", value=root / "previous"),
        "user/ORX/JPData/P/Presets/presets.xml": PRESET.format(root=root),
        "user/ORX/JPData/Q/Presets/presets.xml": PRESET.format(root=root),
        "previous/Booklet": "a template",
        "template/Booklet": "a template",
        LOG + "/UpgradeDowngrade.log": "an older run's\r\n",
        "Hot Folders/B/Desktop.ini": "[.ShellClassInfo]\nIconFile=mine.ico\n[ViewState]\nMode=4\n",
        "Hot Folders/B/[_ORX_HotFolder_]/Error.er": "",
    }
    for name, icon in (("A", "hf_folder"), ("B", "hf_error_inactive"), ("C", "hf_folder")):
        private = f"Hot Folders/{name}/[_ORX_HotFolder_]/"
        files[private + icon + ".ico"] = "an old picture"
        files[private + "Folder.cfg"] = CFG.format(root=root, name=name, enable=int(name != "B"), filler="x" * 400)
    for name, text in files.items():
        (root / name).parent.mkdir(parents=True, exist_ok=True)
        (root / name).write_bytes(text.encode())
    os.setxattr(root / "Hot Folders/B/Desktop.ini", ATTRIBUTES, b"0x4")
    (root / "Hot Folders/B/Desktop.ini").chmod(0o444)
    return program


def look(root):
    """Everything on the workstation but the run log, with content, mode and attributes."""
    found = {}
    for path in root.rglob("*"):
        name = str(path.relative_to(root))
        if name.startswith((LOG, "program/FolderUpgrade")):
            continue
        attributes = os.getxattr(path, ATTRIBUTES) if ATTRIBUTES in os.listxattr(path) else b""
        found[name] = (path.read_bytes() if path.is_file() else None, stat.S_IMODE(path.stat().st_mode), attributes)
    return found


def part(name):
    """The hot folder or job preset directory that the path belongs to; else the path itself."""
    pieces = pathlib.PurePath(name).parts
    if pieces[:1] == ("Hot Folders",):
        return "/".join(pieces[:2])
    return "/".join(pieces[:4]) if pieces[:3] == ("user", "ORX", "JPData") else name


def judge(hit, before, after, now):
    """What is wrong with the workstation after the call concerned the path; nothing if all is well."""
    changed = {name for name in after.keys() | now.keys() if now.get(name) != after.get(name)}
    parts = {part(name) for name in changed}
    own = part(hit)
    if hit.startswith(LOG) or own != hit:
        return sorted(parts - {own})
    # A file or folder that all share: a step of one hot folder was not taken or, the source being at
    # fault, its icon is incomplete; or one of the list or of all job presets.
    wrong = {name for name in changed if now.get(name) != before.get(name) and not name.endswith(".ico")}
    isFew = len(parts) <= 1 or hit.startswith("machine/hotfolder") or all("JPData" in name for name in parts)
    return sorted(wrong) if isFew else sorted(parts)


class Workstation:
    def __init__(self, folder, program, library):
        self.root = folder / "work station"
        self.original = folder / "original"
        self.report = folder / "report"
        self.program = lay_out(self.root) / "FolderUpgrade"
        shutil.copytree(self.root, self.original)
        self.program.parent.mkdir()
        for file in [program, *program.parent.glob("*.ico")]:
            shutil.copy2(file, self.program.parent)
        self.before = look(self.root)
        self.environment = {
            **os.environ, "XDG_CONFIG_DIRS": f"{self.root}/machine", "XDG_CONFIG_HOME": f"{self.root}/user",
            "LD_PRELOAD": str(library), "FAULT_ROOT": str(self.root), "FAULT_REPORT": str(self.report)}

    def run(self, number, error):
        """The finished process, and the call and path that failed, or none."""
        for item in self.root.iterdir():
            if item != self.program.parent:
                shutil.rmtree(item)
        shutil.copytree(self.original, self.root, dirs_exist_ok=True)
        self.report.unlink(missing_ok=True)
        process = subprocess.run([self.program, "I"], env={**self.environment, "FAULT_NUMBER": str(number),
                                 "FAULT_ERROR": str(error)}, capture_output=True, text=True, timeout=60)
        return process, self.report.read_text().split("\t") if self.report.exists() else None


def try_faults(worker, program, library):
    """Of every error, each call whose turn this worker has: the number of good runs, and the others."""
    passed, failures = 0, []
    with tempfile.TemporaryDirectory() as folder:
        workstation = Workstation(pathlib.Path(folder), program, library)
        process, hit = workstation.run(0, 0)
        after = look(workstation.root)
        if process.returncode != FINISHED or hit or len({part(name) for name in after if after[name] != workstation.before.get(name)}) != 5:
            return 0, ["the run without a fault does not migrate 3 hot folders and 2 job presets"]
        for error in ERRORS:
            number = 1 + worker
            while True:
                process, hit = workstation.run(number, error)
                if not hit:
                    break
                name = str(pathlib.PurePath(hit[1]).relative_to(workstation.root))
                wrong = judge(name, workstation.before, after, look(workstation.root))
                if process.returncode != FINISHED or "Sanitizer" in process.stderr or "runtime error" in process.stderr:
                    wrong.append(f"exit status {process.returncode}: {process.stderr}")
                passed += not wrong
                if wrong:
                    failures.append(f"{hit[0]} number {number} fails with {errno.errorcode[error]} ({name}): {wrong}")
                number += WORKERS
    return passed, failures


if __name__ == "__main__":
    with concurrent.futures.ProcessPoolExecutor(WORKERS) as pool:
        results = list(pool.map(try_faults, range(WORKERS), *([pathlib.Path(a).resolve()] * WORKERS for a in sys.argv[1:3])))
    failed = [failure for _, failures in results for failure in failures]
    print("\n".join(failed), file=sys.stderr)
    print(f"{sum(passed for passed, _ in results)} passed, {len(failed)} failed")
    sys.exit(bool(failed))

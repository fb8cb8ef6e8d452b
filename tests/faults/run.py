#!/usr/bin/env python3
"""Runs the tool over and over on a small workstation, and each time another of its calls fails.

    tests/faults/run.py ERROR PROGRAM FAILING_CALLS

Whichever call it is (see failing_calls.cpp, which FAILING_CALLS is built of), with an ERROR such as
ENOSPC: the run ends with -1 and no report of a sanitizer, only what the call concerned differs from
a run without a fault, and no file that is only read has changed.
"""
import errno
import itertools
import os
import pathlib
import shutil
import subprocess
import sys
import tempfile

FINISHED = 255  # the tool's exit status of -1, on every path
ATTRIBUTES = "user.DOSATTRIB"
LOG = "user/ORX_Installers"

CFG = """<HotFolder name="%s" description="%s" server_ip="" server_name="PRESS1" Enable="%d">
<JobSetting><KEYVALUE Key="ORXCopies" Value="500" KeyDisplayValue="" LocDisplayValue=""/></JobSetting>
<ImposeSetting><KEYVALUE Key="ORXImposeTemplate" Value="@/old/Booklet" KeyDisplayValue=""/></ImposeSetting>
<FilterSetting>text<Filter/></FilterSetting></HotFolder>"""
PRESET = '<Presets><Setting Key="ORXImposeTemplate">"@/old/Booklet"</Setting></Presets>\r\n'
HIVE = 'Windows Registry Editor Version 5.00\r\n\r\n[HKEY_%s]\r\n"%s"="@%s"\r\n'
LIST = "<HotFolderList>" + "".join(f'<HotFolder path="@/Hot Folders/{name}"/>' for name in "ABC") + "</HotFolderList>"
FILES = {
    "machine/hotfolder/HotFolderList.cfg": LIST,
    "machine/registry/HKEY_LOCAL_MACHINE.reg": HIVE % (r"LOCAL_MACHINE\SOFTWARE\Vantorix\QZA", "InstallPath", ""),
    "user/registry/HKEY_CURRENT_USER.reg": HIVE % (r"CURRENT_USER\SOFTWARE\HF", "Path", "/old"),
    "user/ORX/JPData/P/Presets/presets.xml": PRESET,
    "user/ORX/JPData/Q/Presets/presets.xml": PRESET,
    LOG + "/UpgradeDowngrade.log": "an older run's\r\n",
    "old/Booklet": "a template",
    "template/Booklet": "a template",
    "Hot Folders/B/Desktop.ini": "[.ShellClassInfo]\nIconFile=mine.ico\n[ViewState]\nMode=4\n",
    "Hot Folders/B/[_ORX_HotFolder_]/Error.er": "",
}
for name, icon in (("A", "hf_folder"), ("B", "hf_error_inactive"), ("C", "hf_folder")):
    # Longer than the piece in which the library reads, so that a read can fail half way.
    FILES[f"Hot Folders/{name}/[_ORX_HotFolder_]/Folder.cfg"] = CFG % (name, "long " * 300, name != "B")
    FILES[f"Hot Folders/{name}/[_ORX_HotFolder_]/{icon}.ico"] = "an older picture"


def part(name):
    """The hot folder or job preset directory to which the path belongs; else the path itself."""
    pieces = name.split("/")
    length = {"Hot Folders": 2, "user": 4 if pieces[1:3] == ["ORX", "JPData"] else 0}.get(pieces[0])
    return "/".join(pieces[:length or None])


def look(root):
    """Everything on the workstation but the run log and the program: content, mode, attributes."""
    return {name: (path.is_file() and path.read_bytes(), path.stat().st_mode,
                   ATTRIBUTES in os.listxattr(path) and os.getxattr(path, ATTRIBUTES))
            for path in root.rglob("*") for name in [str(path.relative_to(root))]
            if not name.startswith((LOG, "program/FolderUpgrade"))}


def judge(hit, before, after, now):
    """What should not differ from the run without a fault, when the call concerned that path."""
    changed = {name for name in after.keys() | now.keys() if now.get(name) != after.get(name)}
    parts = {part(name) for name in changed}
    if hit.startswith(LOG) or part(hit) != hit or hit in parts:
        return parts - {part(hit)}
    # What all share: steps were not taken, at most those of one hot folder or of all job presets, but for
    # the list itself; a source icon that cannot be read leaves a part of its copy.
    if len(parts) > 1 and not hit.startswith("machine/hotfolder") and not all("JPData" in name for name in parts):
        return parts
    return {name for name in changed if now.get(name) != before.get(name) and not name.endswith(".ico")}


class Workstation:
    def __init__(self, folder, program, failing_calls):
        self.failing_calls = failing_calls
        self.root, self.original, self.report = folder / "work station", folder / "original", folder / "report"
        for name, text in FILES.items():
            path = self.original / name
            path.parent.mkdir(parents=True, exist_ok=True)
            path.write_bytes(text.replace("@", str(self.root)).encode())
        os.setxattr(self.original / "Hot Folders/B/Desktop.ini", ATTRIBUTES, b"0x4")
        (self.original / "Hot Folders/B/Desktop.ini").chmod(0o444)
        (self.root / "program").mkdir(parents=True)
        for file in [program, *program.parent.glob("*.ico")]:
            shutil.copy2(file, self.root / "program")

    def run(self, number, error):
        """The finished process, and the call that failed with its path, or neither."""
        for item in self.root.iterdir():
            if item.name != "program":
                shutil.rmtree(item)
        shutil.copytree(self.original, self.root, dirs_exist_ok=True)
        self.report.unlink(missing_ok=True)
        process = subprocess.run(
            [self.root / "program/FolderUpgrade", "I"], capture_output=True, text=True, timeout=60, check=False,
            env={**os.environ, "XDG_CONFIG_DIRS": f"{self.root}/machine", "XDG_CONFIG_HOME": f"{self.root}/user",
                 "LD_PRELOAD": self.failing_calls, "FAULT_ROOT": str(self.root),
                 "FAULT_NUMBER": str(number), "FAULT_ERROR": str(error), "FAULT_REPORT": str(self.report)})
        return process, self.report.read_text().split("\t") if self.report.exists() else [None, None]


def try_faults(station, error):
    """With every call failing in its turn: the number of good runs, and what was wrong with the others."""
    passed, failures = 0, []
    station.run(0, 0)
    after = look(station.root)
    before = look(station.original)
    if len({part(name) for name in before if after[name] != before[name]}) != 5:
        return 0, ["without a fault not all 3 hot folders and 2 job presets change"]
    for number in itertools.count(1):
        process, (call, path) = station.run(number, error)
        if not call:
            return passed, failures
        hit = os.path.relpath(path, station.root)
        wrong = judge(hit, before, after, look(station.root))
        if process.returncode != FINISHED or "Sanitizer" in process.stderr or "runtime error" in process.stderr:
            wrong.add(f"exit status {process.returncode}, {process.stderr}")
        passed += not wrong
        if wrong:
            failures.append(f"{call} number {number} fails, {hit}: {wrong}")


def main():
    error, program, failing_calls = sys.argv[1:]
    with tempfile.TemporaryDirectory() as folder:
        station = Workstation(pathlib.Path(folder), pathlib.Path(program), failing_calls)
        passed, failures = try_faults(station, getattr(errno, error))
    print(*failures, sep="\n", end="\n" * bool(failures))
    print(f"{passed} passed, {len(failures)} failed, 0 skipped")
    return bool(failures) or not passed


if __name__ == "__main__":
    sys.exit(main())

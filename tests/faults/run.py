#!/usr/bin/env python3
"""Runs the tool many times on a small workstation; each time, something happens at a different call.

    tests/faults/run.py MODE PROGRAM FAILING_CALLS

FAILING_CALLS is built from failing_calls.cpp. Except in END, a run ends with -1; in all modes, no sanitizer reports
anything, and each Folder.cfg and each job preset is exactly the old one or the new one. MODE is one of
    EIO, ENOSPC, EACCES, EINTR   the call fails; only what it concerns differs from a run without a fault
    SHORT, SHORT_ENOSPC          only half of a write is done; in the second, the write that should continue it also fails
    END                          the process is ended; a content may be followed by line feeds up to the old length
    SWAP                         a file or directory is replaced with a link; nothing outside the workstation changes
    FULL_DISK                    the disk (which only root can make) is full; a line that was logged stays
"""
import contextlib
import errno
import itertools
import os
import pathlib
import shutil
import subprocess
import sys
import tempfile

sys.path.insert(0, str(pathlib.Path(__file__).resolve().parents[2] / "samples"))
import lay_out
from lay_out import ATTRIBUTES, PRIVATE, READ_ONLY, SYSTEM

FINISHED = 255  # the tool's exit status of -1, on every path
KILLED = -9
LOG_DIR = "user/ORX_Installers"
LOG = LOG_DIR + "/UpgradeDowngrade.log"
REWRITTEN = ("Folder.cfg", "presets.xml")

# The event of failing_calls.cpp, and the calls at which it happens, "" for all of them.
MODES = {
    "EIO": ("f", ""),
    "ENOSPC": ("f", "open64 pwrite64 fallocate64 ftruncate64 setxattr "),
    "EACCES": ("f", "open64 opendir access unlink chmod fchmod setxattr "),
    "EINTR": ("f", "open64 close pread64 pwrite64 fallocate64 ftruncate64 fsync "),
    "SHORT": ("s", "pwrite64 "),
    "SHORT_ENOSPC": ("sf", "pwrite64 "),
    "END": ("e", ""),
    "SWAP": ("x", "open64 opendir access stat64 lstat64 fstatat64 unlink chmod getxattr setxattr removexattr "),
}

CFG = """<HotFolder name="%s" description="%s" server_ip="" server_name="PRESS1" Enable="%d" unknown="%s">
<JobSetting><KEYVALUE Key="ORXCopies" Value="500" KeyDisplayValue="" LocDisplayValue=""/></JobSetting>
<ImposeSetting><KEYVALUE Key="ORXImposeTemplate" Value="@ROOT@/old/Booklet" KeyDisplayValue=""/></ImposeSetting>
<FilterSetting>text<Filter/></FilterSetting></HotFolder>"""
PRESET = '<Presets><Setting Key="ORXImposeTemplate">"@ROOT@/old/Booklet"</Setting></Presets>\r\n'
HIVE = 'Windows Registry Editor Version 5.00\r\n\r\n[HKEY_%s]\r\n"%s"="@ROOT@%s"\r\n'
INI = "[.ShellClassInfo]\nIconFile=mine.ico\n[ViewState]\nMode=4\n"
# The icon that a folder gets, the length of its description, and the length of an attribute that is lost.
FOLDERS = {"A": ("hf_folder", 1500, 0), "B": ("hf_error_inactive", 1500, 2000)}
# The F folders need one more page on the disk when they are written.
MANY_FOLDERS = {**FOLDERS, **{f"F{number}": ("hf_folder", 3500, 0) for number in range(20)}}


def files_of(folders):
    """The workstation's files."""
    files = {
        "machine/hotfolder/HotFolderList.cfg":
            "<HotFolderList>" + "".join(f'<HotFolder path="@ROOT@/Hot Folders/{name}"/>' for name in folders) + "</HotFolderList>",
        "machine/registry/HKEY_LOCAL_MACHINE.reg": HIVE % (r"LOCAL_MACHINE\SOFTWARE\Vantorix\QZA", "InstallPath", ""),
        "user/registry/HKEY_CURRENT_USER.reg": HIVE % (r"CURRENT_USER\SOFTWARE\HF", "Path", "/old"),
        "user/ORX/JPData/P/Presets/presets.xml": PRESET,
        "user/ORX/JPData/Q/Presets/presets.xml": "\ufeff" + 40 * PRESET,
        LOG: "an older run's\r\n",
        "old/Booklet": "a template",
        "template/Booklet": "a template",
        "Hot Folders/B/Desktop.ini": INI,
        f"Hot Folders/B/{PRIVATE}/Error.er": "",
    }
    for name, (icon, described, lost) in folders.items():
        files[f"Hot Folders/{name}/{PRIVATE}/Folder.cfg"] = CFG % (name, described * "d", name != "B", lost * "x")
        files[f"Hot Folders/{name}/{PRIVATE}/{icon}.ico"] = "an older picture"
    return files


def part(name):
    """The hot folder or job preset directory to which the path belongs; else the path itself."""
    pieces = name.split("/")
    length = {"Hot Folders": 2, "user": 4 if pieces[1:3] == ["ORX", "JPData"] else 0}.get(pieces[0])
    return "/".join(pieces[:length or None])


def look(root, but=(LOG, "program/FolderUpgrade")):
    """Everything below the directory except these names: content, mode, attributes."""
    return {name: (path.is_file() and path.read_bytes(), path.stat().st_mode,
                   ATTRIBUTES in os.listxattr(path) and os.getxattr(path, ATTRIBUTES))
            for path in root.rglob("*") for name in [str(path.relative_to(root))] if not name.startswith(but)}


def differences(left, right):
    return {name for name in left.keys() | right.keys() if left.get(name) != right.get(name)}


def torn(before, after, now, may_end_in_line_feeds):
    """The files that are neither the old ones nor the new ones."""
    def is_whole(name):
        old, new, content = before[name][0], after[name][0], now[name][0]
        return content in (old, new) or (may_end_in_line_feeds and content == new.ljust(len(old), b"\n"))
    return {f"{name} is torn" for name in now if name.endswith(REWRITTEN) and not is_whole(name)}


def judge(hit, before, after, now):
    """What differs from the run without a fault but should not, given the path that the call concerned."""
    changed = differences(after, now)
    parts = {part(name) for name in changed}
    if hit.startswith(LOG_DIR) or part(hit) != hit or hit in parts:
        return parts - {part(hit)}
    # A path that several parts share: at most one hot folder, or all job presets, may be skipped (without the list,
    # everything); a fault at a source icon may change its copy.
    if len(parts) > 1 and not hit.startswith("machine/hotfolder") and not all("JPData" in name for name in parts):
        return parts
    return {name for name in changed if now.get(name) != before.get(name) and not name.endswith(".ico")}


class Workstation:
    def __init__(self, folder, program, failing_calls, folders):
        self.failing_calls = failing_calls
        self.root, self.original, self.report = folder / "work station", folder / "original", folder / "report"
        self.outside, self.outside_before = folder / "outside", folder / "outside before"
        original = lay_out.Workstation(self.original, self.root)
        for name, text in files_of(folders).items():
            original.put(name, text)
        original.set_attributes("Hot Folders/B/Desktop.ini", READ_ONLY | SYSTEM)
        self.environment = lay_out.Workstation(self.root).environment
        (self.root / "program").mkdir(parents=True)
        for file in [program, *program.parent.glob("*.ico")]:
            shutil.copy2(file, self.root / "program")
        outside = lay_out.Workstation(self.outside_before, self.root)
        outside.put("empty/other", "a file")  # a hot folder without a private directory
        for name, text in files_of(folders).items():
            if name.startswith(("Hot", "user/ORX")):  # hot folders, job presets, the log's folder
                outside.put(name, text)
        self.before = look(self.original)
        self.run(0, "f")
        self.after = look(self.root)
        self.log = (self.root / LOG).read_bytes()
        moved = {name for name, (content, *_) in self.after.items() if content and b"/template/Booklet\"" in content}
        if moved != {name for name in self.before if name.endswith(REWRITTEN)}:
            sys.exit(f"without a fault only these are rewritten: {moved}")

    def restore(self):
        for item in self.root.iterdir():
            if item.name != "program":
                shutil.rmtree(item)
        shutil.copytree(self.original, self.root, dirs_exist_ok=True)
        shutil.rmtree(self.outside, ignore_errors=True)
        shutil.copytree(self.outside_before, self.outside)
        self.report.unlink(missing_ok=True)

    def run(self, number, events, calls="", error=0, below="", victim="", target="", prepare=lambda _: None):
        """The finished process, and the call at which something happened and its path, or two Nones."""
        self.restore()
        prepare(self.root)
        process = subprocess.run(
            [self.root / "program/FolderUpgrade", "I"], capture_output=True, text=True, timeout=60, check=False,
            env={**os.environ, **self.environment,
                 "LD_PRELOAD": self.failing_calls, "FAULT_ROOT": f"{self.root}/{below}", "FAULT_NUMBER": str(number),
                 "FAULT_EVENTS": events, "FAULT_CALLS": calls, "FAULT_ERROR": str(error),
                 "FAULT_VICTIM": f"{self.root}/{victim}", "FAULT_TARGET": f"{self.outside}/{target}",
                 "FAULT_REPORT": str(self.report)})
        return process, self.report.read_text().split("\t") if self.report.exists() else [None, None]

    def has_torn_line(self):
        """Whether the log is neither that of the earlier run nor made of complete lines."""
        log = (self.root / LOG).read_bytes()
        return log != (self.original / LOG).read_bytes() and not log.endswith(b"\r\n") and log != b""


def complaints(process, status=FINISHED):
    is_good = process.returncode == status and "Sanitizer" not in process.stderr and "runtime error" not in process.stderr
    return set() if is_good else {f"exit status {process.returncode}, {process.stderr}"}


def try_calls(station, mode):
    """Makes each call fail in turn; returns what was wrong in each run."""
    events, calls = MODES[mode]
    ends = mode == "END"
    for number in itertools.count(1):
        process, (call, path) = station.run(number, events, calls, getattr(errno, mode.split("_")[-1], 0))
        if not call:
            return
        hit = os.path.relpath(path, station.root)
        now = look(station.root)
        wrong = torn(station.before, station.after, now, ends) | complaints(process, KILLED if ends else FINISHED)
        if not ends:
            wrong |= judge(hit, station.before, station.after, now)
        if station.has_torn_line():
            wrong.add("a line of the log is torn")
        yield f"{call} number {number}, {hit}", wrong


def victims():
    """What is replaced, and the target of the link that replaces it; a place's second target does not exist."""
    for folder, (icon, *_) in FOLDERS.items():
        hot = f"Hot Folders/{folder}"
        yield hot, "empty"
        yield f"{hot}/{PRIVATE}", f"{hot}/{PRIVATE}"
        for name, directory in (("Folder.cfg", f"{hot}/{PRIVATE}"), (f"{icon}.ico", f"{hot}/{PRIVATE}"), ("Desktop.ini", hot)):
            target = f"Hot Folders/B/{name}" if name == "Desktop.ini" else f"{directory}/{name}"
            yield f"{directory}/{name}", target
            yield f"{directory}/{name}", "empty/missing"
    yield "user/ORX/JPData/P/Presets", "user/ORX/JPData/P/Presets"
    yield "user/ORX/JPData/P/Presets/presets.xml", "user/ORX/JPData/P/Presets/presets.xml"
    yield LOG_DIR, LOG_DIR
    yield LOG, LOG
    yield LOG, "empty/missing"


def try_swaps(station):
    """Replaces each victim at each call by path that its step makes; returns what was wrong in each run."""
    outside = look(station.outside, ())
    for victim, target in victims():
        below = LOG_DIR if victim.startswith(LOG_DIR) else part(victim)
        for number in itertools.count(1):
            process, (call, path) = station.run(number, *MODES["SWAP"], below=below, victim=victim, target=target)
            if not call:
                break
            wrong = complaints(process) | {f"outside/{name} differs" for name in differences(outside, look(station.outside, ()))}
            yield f"{victim} becomes a link to {target} before {call} number {number}, {os.path.relpath(path, station.root)}", wrong


def fill_up(directory):
    with contextlib.suppress(OSError), open(directory / "program/rest", "wb", buffering=0) as file:
        while True:
            file.write(bytes(4096))


def try_full_disk(station):
    """Fills the disk; returns what was wrong in the run."""
    process, _ = station.run(0, "f", prepare=fill_up)
    now = look(station.root)
    wrong = torn(station.before, station.after, now, False) | complaints(process)
    if not any(now[name] == station.before[name] for name in station.before if name.endswith("Folder.cfg")):
        wrong.add("the disk was not full")
    lines = iter(station.log.splitlines(keepends=True))
    log = (station.root / LOG).read_bytes()
    if len(log) < 3500 or len(log) >= len(station.log) or not all(line in lines for line in log.splitlines(keepends=True)):
        wrong.add(f"the log is {log}")
    yield "a full disk", wrong


def keeps_attributes(directory):
    try:
        with tempfile.NamedTemporaryFile(dir=directory) as file:
            os.setxattr(file.name, ATTRIBUTES, b"0x4")
    except OSError:
        return False
    return True


def main():
    mode, program, failing_calls = sys.argv[1:]
    in_memory = "/dev/shm" if keeps_attributes("/dev/shm") else None
    if mode == "FULL_DISK" and not (in_memory and os.geteuid() == 0):
        print("skipped faults.FULL_DISK: needs root, and a tmpfs that keeps attributes\n"
              "0 passed, 0 failed, 1 skipped")
        return 0
    passed = failed = 0
    with tempfile.TemporaryDirectory(dir=in_memory) as name, contextlib.ExitStack() as disk:
        folder, folders, runs = pathlib.Path(name), FOLDERS, {"SWAP": try_swaps, "FULL_DISK": try_full_disk}
        if mode == "FULL_DISK":
            folder, folders = folder / "disk", MANY_FOLDERS
            folder.mkdir()
            subprocess.run(["mount", "-t", "tmpfs", "-o", "size=64m", "tmpfs", folder], check=True)
            disk.callback(subprocess.run, ["umount", folder], check=True)
        station = Workstation(folder, pathlib.Path(program), failing_calls, folders)
        for what, wrong in runs[mode](station) if mode in runs else try_calls(station, mode):
            passed += not wrong
            failed += bool(wrong)
            if wrong:
                print(f"{what}: {wrong}")
    print(f"{passed} passed, {failed} failed, 0 skipped")
    return failed or not passed


if __name__ == "__main__":
    sys.exit(bool(main()))

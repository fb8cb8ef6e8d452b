#!/usr/bin/env python3
"""Creates in DIR a hot folder user's machine as it is before an upgrade:

    samples/lay_out.py [--fresh] DIR

Use DIR/machine as $XDG_CONFIG_DIRS and DIR/user as $XDG_CONFIG_HOME. The texts come from samples/workstation/, the icons
from appearance/icons/. DIR has to be missing or empty. --fresh first empties DIR, but only if an earlier call
created it.

As a module, it lays out the workstations of the tests and benchmarks that are not written in C++.
"""
import errno
import os
import pathlib
import re
import shutil
import subprocess
import sys

SAMPLES = pathlib.Path(__file__).resolve().parent
TEXTS = SAMPLES / "workstation"
ICONS = SAMPLES.parent / "appearance/icons"
PRIVATE = "[_ORX_HotFolder_]"
ATTRIBUTES = "user.DOSATTRIB"
READ_ONLY, HIDDEN, SYSTEM = 1, 2, 4
MARKER = ".sample-workstation"

# Hot folder, the icon in its private directory, and whose image this outdated copy has.
STALE_ICONS = (
    ("Flyers A4", "hf_folder", "hf_folder_disabled"),
    ("Broschüren Köln", "hf_folder_disabled", "hf_folder"),
    ("名刺 両面", "hf_error_active", "hf_folder"),
    ("Plakate A2", "hf_error_inactive", "hf_error_active"),
    ("Wedding Cards", "hf_folder", "hf_error_active"),
    ("Manuals 2019", "hf_folder", "hf_folder_disabled"),
    ("Manuals 2019", "hf_folder_disabled", "hf_error_inactive"),
    ("Proofs", "hf_folder", "hf_folder_disabled"),
    ("New Hot Folder", "hf_folder_disabled", "hf_folder"))
# Hot folder with a Desktop.ini of its own: its attributes. Those of Desktop.ini are READ_ONLY and SYSTEM.
SHOWN = {"Flyers A4": SYSTEM, "名刺 両面": READ_ONLY | SYSTEM, "Manuals 2019": SYSTEM, "Letterheads": SYSTEM}


class Workstation:
    """A workstation of this machine's programs in a folder, which need not exist yet."""
    separator = "/"

    def __init__(self, root, seen_root=None):
        """The programs see the folder under the name seen_root, by default under its own."""
        self.root = pathlib.Path(root)
        self.seen_root = str(seen_root or root)
        self.user, self.machine = self.root / "user", self.root / "machine"
        self.environment = {"XDG_CONFIG_HOME": str(self.user), "XDG_CONFIG_DIRS": str(self.machine)}

    def seen(self, *names):
        """A path below the root as the programs see it."""
        return self.separator.join((self.seen_root, *names))

    def render(self, text):
        """Replaces @ROOT@ with the root, @/@ with the path separator, @//@ with its form in a .reg file."""
        escaped = self.separator.replace("\\", "\\\\")
        return text.replace("@//@", escaped).replace("@/@", self.separator).replace("@ROOT@", self.seen_root)

    def put(self, name, content):
        """Writes a file. Names user/... and machine/... are in those folders.

        A text is rendered and written in UTF-8, or in UTF-16 if it starts with a byte-order mark.
        """
        top, _, rest = name.partition("/")
        path = {"user": self.user, "machine": self.machine}.get(top, self.root / top) / rest
        path.parent.mkdir(parents=True, exist_ok=True)
        if isinstance(content, str):
            content = self.render(content).encode("utf-16-le" if content.startswith("\ufeff") else "utf-8")
        path.write_bytes(content)

    def put_hive(self, name, text):
        """Makes the text, in the registry editor's form, a part of the registry."""
        self.put(name, text)

    def set_attributes(self, name, attributes):
        """Sets READ_ONLY, HIDDEN and SYSTEM of a file or folder where this machine's programs look for them."""
        path = self.root / name
        is_file = path.is_file()
        # The attribute comes first, because the owner cannot set it on a read-only file.
        os.setxattr(path, ATTRIBUTES, b"0x%x" % (attributes & ~READ_ONLY if is_file else attributes))
        if is_file and attributes & READ_ONLY:
            path.chmod(0o444)


class WineWorkstation(Workstation):
    """Drive C: of a new Wine prefix, whose windows nobody sees."""
    separator = "\\"
    loader, server = "/usr/lib/wine/wine64", "/usr/lib/wine/wineserver64"

    def __init__(self, prefix):
        super().__init__(f"{prefix}/drive_c", "C:")
        self.root.mkdir(parents=True, exist_ok=True)
        self.user, self.machine = self.root / "users/root/AppData/Roaming", self.root / "ProgramData"
        self.environment = {**os.environ, "WINEPREFIX": str(prefix), "HOME": str(prefix), "USER": "root", "LC_ALL": "C.UTF-8",
                            "WINEDEBUG": "-all", "WINEDLLOVERRIDES": "mscoree=;mshtml="}
        self.environment.pop("DISPLAY", None)
        for command in (("wineboot", "--init"),
                        ("reg", "add", r"HKCU\Software\Wine\Drivers", "/v", "Graphics", "/d", "null", "/f")):
            if self.wine(*command) != 0:
                self.close()
                raise RuntimeError("Wine made no prefix")
        self.close()  # the driver is chosen when the server starts
        subprocess.run([self.server, "-p"], env=self.environment, check=True)  # it keeps running between the programs

    def wine(self, *command, output=subprocess.DEVNULL):
        """The exit status. The output must not be a pipe, because Wine's services keep it open."""
        return subprocess.run([self.loader, *command], env=self.environment, check=False, timeout=120, stdout=output,
                              stderr=output).returncode

    def put_hive(self, name, text):
        self.put("hive.reg", "\ufeff" + text)
        self.wine("regedit", "/S", self.seen("hive.reg"))
        if self.wine("reg", "query", re.search(r"^\[(.*)\]", text, re.MULTILINE)[1]) != 0:
            raise RuntimeError(f"{name} was not imported")

    def close(self):
        subprocess.run([self.server, "-k"], env=self.environment, check=False)


def sample(name):
    """A text of the sample workstation, with the line ends that the client writes."""
    text = (TEXTS / name).read_text(encoding="utf-8")
    return text.replace("\n", "\r\n") if name.endswith((".reg", ".ini", ".log", ".xml")) else text


def lay_out_sample(station):
    for path in TEXTS.rglob("*"):
        if path.is_file():
            name = str(path.relative_to(TEXTS))
            station.put(name, sample(name))
    for folder, icon, picture in STALE_ICONS:
        station.put(f"Hot Folders/{folder}/{PRIVATE}/{icon}.ico", (ICONS / f"{picture}.ico").read_bytes())
    for folder in (station.root / "Hot Folders").iterdir():
        for name in ("Work", "Fail", "Done"):
            (folder / PRIVATE / name).mkdir(parents=True)
        station.set_attributes(folder / PRIVATE, HIDDEN)
    for folder, attributes in SHOWN.items():
        station.set_attributes(f"Hot Folders/{folder}", attributes)
        station.set_attributes(f"Hot Folders/{folder}/Desktop.ini", READ_ONLY | SYSTEM)


def clear(directory):
    """Empties a directory, which may be the user's own."""
    for path in directory.iterdir():
        if path.is_dir() and not path.is_symlink():
            shutil.rmtree(path)
        else:
            path.unlink()


def main(arguments):
    is_fresh = arguments[:1] == ["--fresh"]
    if len(arguments) != 1 + is_fresh or not arguments[-1]:
        print("Usage: samples/lay_out.py [--fresh] DIR", file=sys.stderr)
        return 2
    directory = pathlib.Path(arguments[-1]).resolve()
    marker = directory / MARKER
    if any(character in str(directory) for character in '\\"<>&\n'):
        return f'lay_out.py: a path with one of \\ " < > & or a line break cannot be stored in the files: {directory}'
    if is_fresh and marker.is_file():
        clear(directory)
    if marker.exists():
        return f"lay_out.py: already created (--fresh creates it again): {directory}"
    if directory.exists() and not (directory.is_dir() and not any(directory.iterdir())):
        return f"lay_out.py: already exists, but is not a sample workstation: {directory}"
    try:
        directory.mkdir(parents=True, exist_ok=True)
        marker.write_text("Created by samples/lay_out.py, which may remove this folder.\n", encoding="utf-8")
        lay_out_sample(Workstation(directory))
    except BaseException as error:
        if marker.is_file():
            clear(directory)
        if isinstance(error, OSError):
            hint = " (the file system has to support extended attributes)" if error.errno == errno.ENOTSUP else ""
            return f"lay_out.py: {error}{hint}"
        raise
    return 0


if __name__ == "__main__":
    sys.exit(main(sys.argv[1:]))

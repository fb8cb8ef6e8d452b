#!/usr/bin/env python3
"""Runs both builds on random workstations, and compares what they leave and what FolderUpgradeCheck says.

    bench/parity.py [COUNT [FIRST]]

COUNT (100) workstations are laid out twice by one generator: for the programs of the preset "native", and for those of
the preset "windows" under Wine. Both presets have to be built. What differs by docs/development.md is left out or
compared by its meaning: the letter case of paths, links, the line ends of presets, Desktop.ini.
"""
import pathlib
import random
import shutil
import subprocess
import sys
import tempfile
from xml.sax.saxutils import quoteattr

ROOT = pathlib.Path(__file__).resolve().parents[1]
sys.path.insert(0, str(ROOT / "samples"))
import lay_out

TOPS = ("hot", "old", "app", "elsewhere", "user/ORX", "user/ORX_Installers", "machine/hotfolder")
SHAPES = ("apart", "apart", "apart", "new below old", "old below new", "no new folder")
ATTRIBUTES = ("name", "description", "server_ip", "server_name", "Enable", "BaseVirtualPrinter", "TimeInterval",
              "server_version", "Quickset", "IsWidthBased", "Mine")


def host(station, name):
    top, _, rest = name.partition("/")
    return {"user": station.user, "machine": station.machine}.get(top, station.root / top) / rest


def template_path(rng, station, old, new):
    folder = rng.choice([old] * 4 + [new, new, ["elsewhere"], ["nowhere"], [*old, "sub"], [old[0] + "2"]])
    path = station.seen(*folder, rng.choice(["T1", "T1", "T2", "T & 3", "Größe 版"]))
    return rng.choice([path] * 12 + ["", "T1", path + station.separator, path.replace("T1", "..T1")])


def folder_cfg(rng, path):
    attributes = "".join(f" {name}={quoteattr(rng.choice(['', '0', '1', ' 7', 'x', 'ü & <']))}"
                         for name in ATTRIBUTES if rng.random() < 0.9)
    entry = f'<K k="ORXImposeTemplate" v={quoteattr(path)} d=""/>'
    inside = "".join(rng.sample([f"<ImposeSetting>{entry}</ImposeSetting>", "<JobSetting><K k='a' v='b'/></JobSetting>",
                                 "<FilterSetting a='1'>\n  text<b/></FilterSetting>", "<Mine/>", "<!-- c -->"], 4))
    text = f"<HotFolder{attributes}>{inside}</HotFolder>"
    if rng.random() < 0.1:
        return rng.choice(["", "<broken", text[:-3], text.replace("ORX", "orx")])
    declared = '<?xml version="1.0" encoding="UTF-16"?>' if rng.random() < 0.1 else ""
    return ("\ufeff" if declared else "") + declared + text


def lay_out_random(rng, station):
    for top in TOPS:
        shutil.rmtree(host(station, top), ignore_errors=True)
    shape = rng.choice(SHAPES)
    app = ["old"] if shape == "new below old" else ["app"]
    new = [*app, "template"]
    old = [*new, "old"] if shape == "old below new" else ["old"]
    for folder in (old, new, ["elsewhere"]):
        for template in ("T1", "T2", "T & 3"):
            if rng.random() < 0.7 and not (folder is new and shape == "no new folder"):
                station.put("/".join([*folder, template]), "a template")
    for hive, key, name, value in (("machine/registry/HKEY_LOCAL_MACHINE.reg", r"HKEY_LOCAL_MACHINE\SOFTWARE\Vantorix\QZA",
                                    "InstallPath", station.seen(*app)),
                                   ("user/registry/HKEY_CURRENT_USER.reg", r"HKEY_CURRENT_USER\SOFTWARE\HF",
                                    "Path", station.seen(*old))):
        escaped = value.replace("\\", "\\\\")
        station.put_hive(hive, f'Windows Registry Editor Version 5.00\r\n\r\n[{key}]\r\n"{name}"="{escaped}"\r\n')
    listed = ""
    for number in range(rng.randint(0, 4)):
        private = f"hot/F{number}/{lay_out.PRIVATE}"
        station.put(f"{private}/x", "")
        listed += f"<HotFolder path={quoteattr(station.seen('hot', f'F{number}'))}/>" * rng.choice([1, 1, 1, 2])
        if rng.random() < 0.9:
            station.put(f"{private}/Folder.cfg", folder_cfg(rng, template_path(rng, station, old, new)))
        if rng.random() < 0.3:
            station.put(f"{private}/Error.er", "")
        for icon in ("hf_folder", "hf_folder_disabled", "hf_error_active", "hf_error_inactive"):
            if rng.random() < 0.5:
                station.put(f"{private}/{icon}.ico", "an older picture")
        if rng.random() < 0.5:
            station.put(f"hot/F{number}/Desktop.ini", rng.choice(["", "[.ShellClassInfo]\r\nIconFile=mine.ico\r\n",
                                                                 "[ViewState]\r\nMode=\r\n"]))
    station.put("machine/hotfolder/HotFolderList.cfg", rng.choice([f"<l>{listed}</l>"] * 12 + ["", "<l>"]))
    station.put("user/ORX/JPData/x", "")
    station.put("user/ORX_Installers/UpgradeDowngrade.log", "an earlier log\r\n")
    for number in range(rng.randint(0, 3)):
        paths = [template_path(rng, station, old, new) for _ in range(rng.randint(0, 4))]
        text = "".join('<S Key="ORXImposeTemplate">"%s"</S>\r\n' % (path.replace("&", "&amp;").replace("<", "&lt;")
                                                                   if rng.random() < 0.5 else path) for path in paths)
        station.put(f"user/ORX/JPData/P{number}/Presets/presets.xml", rng.choice(["", "", "", "\ufeff"]) + text)


def comparable(station, name, data):
    if name.endswith(".ico"):
        return data
    text = data.decode("utf-16" if data.startswith(b"\xff\xfe") else "utf-8").replace("\r\n", "\n")
    for folder, word in ((station.user, "user"), (station.machine, "machine")):
        seen = station.seen(*folder.relative_to(station.root).parts)
        text = text.replace(seen, word)
    lines = text.replace(station.seen_root, "ROOT").replace("\\", "/").split("\n")
    if name.endswith("Desktop.ini"):
        return sorted({line.lower() for line in lines if line and not line.startswith("IconResource")})
    if name.endswith(("before.txt", "after.txt")):  # the first line has the time and the account
        return sorted(lines[1:])
    # The file system has its own order of the directories with presets.
    return [line for line in lines if "preset.xml" not in line] + sorted(line for line in lines if "preset.xml" in line)


def outcome(station, switch):
    """The files that FolderUpgradeRun leaves, its reports and the run log among them."""
    program = station.root / "tool/FolderUpgradeRun"
    if isinstance(station, lay_out.WineWorkstation):
        for _ in range(3):  # now and then Wine itself ends before the program has begun
            station.wine(station.seen("tool", "FolderUpgradeRun.exe"), switch)
            if any(host(station, "user/ORX_Installers").glob("*-after.txt")):
                break
    else:
        subprocess.run([program, switch], env=station.environment, check=False, stderr=subprocess.DEVNULL)
    found = {}
    for top in TOPS:
        for path in host(station, top).rglob("*"):
            name = f"{top}/{path.relative_to(host(station, top))}"
            found[name] = comparable(station, name, path.read_bytes()) if path.is_file() else None
    return found


def main():
    count, first = (int(text) for text in (sys.argv[1:] + ["100", "1"][len(sys.argv) - 1:])[:2])
    different = moved = 0
    with tempfile.TemporaryDirectory() as scratch:
        stations = {"native": lay_out.Workstation(f"{scratch}/native"), "windows": lay_out.WineWorkstation(f"{scratch}/wine")}
        for preset, station in stations.items():
            for program in (ROOT / "build" / preset).glob("FolderUpgrade*"):
                if program.suffix in ("", ".exe") and program.is_file():
                    (station.root / "tool").mkdir(exist_ok=True, parents=True)
                    shutil.copy(program, station.root / "tool")
            for folder in ("tool", "tool/BundleIcons"):
                shutil.copytree(lay_out.ICONS, station.root / folder, dirs_exist_ok=True)
        for number in range(first, first + count):
            outcomes = []
            for station in stations.values():
                rng = random.Random(number)
                lay_out_random(rng, station)
                outcomes.append(outcome(station, rng.choice("IU")))
            native, windows = outcomes
            moved += any("  change   Folder.cfg" in line for name, text in native.items() if name.endswith("before.txt")
                         for line in text)
            names = [name for name in sorted(native.keys() | windows.keys()) if native.get(name, 0) != windows.get(name, 0)]
            different += bool(names)
            for name in names:
                print(f"number {number}, {name}")
                for preset, here, there in (("native", native, windows), ("windows", windows, native)):
                    print(f"  {preset}: ", [line for line in here.get(name) or [] if line not in (there.get(name) or [])])
        stations["windows"].close()
    print(f"{count} workstations, from number {first} on: {different} different; a template moved on {moved}")
    return different > 0


if __name__ == "__main__":
    sys.exit(main())

#!/usr/bin/python3
"""Lays out a workstation with any number of hot folders, for the whole runs:

    bench/lay_out.py DIR COUNT TOOL

TOOL is copied to DIR/program, beside icons of 60 KB. Every hot folder is a copy of a sample workstation's
first one; its template lies in the previous version's template folder, so an upgrade moves all of them.
"""
import os
import shutil
import sys

SAMPLES = os.path.join(os.path.dirname(os.path.abspath(__file__)), '..', 'samples', 'workstation')
SAMPLE = 'Flyers A4'
PRIVATE = '[_ORX_HotFolder_]'
ICON = 'hf_folder.ico'
ICON_BYTES = 60 * 1024
OLD_TEMPLATES = 'Program Files (x86)/Vantorix/HF/Templates'  # as the sample's registry has it
NEW_TEMPLATES = 'Program Files/Vantorix/QZA/template'
DESKTOP_INI = ('[.ShellClassInfo]\r\nIconFile=.\\[_ORX_HotFolder_]\\hf_folder.ico\r\nIconIndex=00\r\n'
               'InfoTip=This folder has been configured as an ORX hot folder.\r\n')


def render(root, relative, name=SAMPLE):
    with open(os.path.join(SAMPLES, relative), encoding='utf-8') as file:
        text = file.read()
    return (text.replace(f'@Hot Folders@/@{SAMPLE}', f'@Hot Folders@/@{name}')
            .replace('@//@', '/').replace('@/@', '/').replace('@ROOT@', root))


def write(path, text):
    os.makedirs(os.path.dirname(path), exist_ok=True)
    with open(path, 'w', encoding='utf-8', newline='') as file:
        file.write(text)


def lay_out_folder(root, name, icon):
    folder = f'{root}/Hot Folders/{name}'
    write(f'{folder}/{PRIVATE}/Folder.cfg', render(root, f'Hot Folders/{SAMPLE}/{PRIVATE}/Folder.cfg', name))
    with open(f'{folder}/{PRIVATE}/{ICON}', 'wb') as file:
        file.write(icon[::-1])
    write(f'{folder}/Desktop.ini', DESKTOP_INI)
    os.setxattr(folder, 'user.DOSATTRIB', b'0x4')
    os.setxattr(f'{folder}/Desktop.ini', 'user.DOSATTRIB', b'0x4')
    os.chmod(f'{folder}/Desktop.ini', 0o444)
    return folder


def lay_out(root, count, tool):
    for hive in ('machine/registry/HKEY_LOCAL_MACHINE.reg', 'user/registry/HKEY_CURRENT_USER.reg'):
        write(f'{root}/{hive}', render(root, hive).replace('\n', '\r\n'))
    presets = 'user/ORX/JPData/{}/Presets/presets.xml'
    for name in ('Default', 'PRESS1 Bindery', 'PRESS2 Großformat'):
        write(f'{root}/{presets.format(name)}', render(root, presets.format(name)))
    os.makedirs(f'{root}/user/ORX_Installers', exist_ok=True)

    os.makedirs(f'{root}/program/BundleIcons', exist_ok=True)
    shutil.copy(tool, f'{root}/program/FolderUpgrade')
    with open(os.path.join(SAMPLES, '..', '..', 'appearance', 'icons', ICON), 'rb') as file:
        icon = (file.read() * 4)[:ICON_BYTES]
    for directory in ('program', 'program/BundleIcons'):
        with open(f'{root}/{directory}/{ICON}', 'wb') as file:
            file.write(icon)

    folders = [lay_out_folder(root, f'Jobs {number:05}', icon) for number in range(1, count + 1)]
    write(f'{root}/machine/hotfolder/HotFolderList.cfg',
          '<?xml version="1.0" encoding="UTF-8"?>\n<HotFolderList version="4">\n'
          + ''.join(f'  <HotFolder name="{os.path.basename(folder)}" path="{folder}" server="PRESS1"/>\n'
                    for folder in folders)
          + '</HotFolderList>\n')
    write(f'{root}/folders.txt', '\n'.join(folders) + '\n')


if __name__ == '__main__':
    lay_out(os.path.abspath(sys.argv[1]), int(sys.argv[2]), sys.argv[3])

#!/usr/bin/python3
"""The same upgrade as an administrator would script it today: it loads each Folder.cfg once, with lxml.

    administrator.py LIST ICON_DIR OLD NEW PRESET_DIR

LIST is HotFolderList.cfg; template paths move from the folder OLD to the folder NEW, in the hot folders and in the
presets below PRESET_DIR. Like the tool it waits for the disk after each rewrite. It keeps no log and does not read the
registry.
"""
import glob
import os
import shutil
import sys

from lxml import etree

KEY = 'ORXImposeTemplate'
INI = {'InfoTip': 'This folder has been configured as an ORX hot folder.'}


def read(path):
    with open(path, encoding='utf-8', newline='') as file:
        return file.read()


def rewrite(path, content):
    with open(path, 'wb') as file:
        file.write(content)
        file.flush()
        os.fsync(file.fileno())


def refresh_icon(folder, private, enabled, icon_dir):
    error = os.path.isfile(f'{private}/Error.er')
    name = {(True, False): 'hf_folder', (False, False): 'hf_folder_disabled',
            (True, True): 'hf_error_active', (False, True): 'hf_error_inactive'}[enabled, error] + '.ico'
    if not os.path.isfile(f'{private}/{name}'):
        return
    shutil.copyfile(f'{icon_dir}/{name}', f'{private}/{name}')
    ini = f'{folder}/Desktop.ini'
    values = dict(INI, IconFile=f'.\\[_ORX_HotFolder_]\\{name}')
    before = read(ini)
    text = '\r\n'.join(f'{key}={values[key]}' if (key := line.partition('=')[0]) in values else line
                        for line in before.split('\r\n'))
    os.chmod(ini, 0o644)
    if text != before:
        rewrite(ini, text.encode())
    os.setxattr(ini, 'user.DOSATTRIB', b'0x4')
    os.chmod(ini, 0o444)
    os.setxattr(folder, 'user.DOSATTRIB', b'0x4')


def move_template(path, document, old, new):
    for entry in document.iterfind(f'.//ImposeSetting/KEYVALUE[@Key="{KEY}"]'):
        directory, name = os.path.split(entry.get('Value'))
        if directory == old:
            entry.set('Value', os.path.join(new, name))
            rewrite(path, etree.tostring(document, encoding='UTF-8', xml_declaration=True))


def main(hot_folder_list, icon_dir, old, new, preset_dir):
    for element in etree.parse(hot_folder_list).iterfind('HotFolder'):
        folder = element.get('path')
        private = f'{folder}/[_ORX_HotFolder_]'
        document = etree.parse(f'{private}/Folder.cfg')
        refresh_icon(folder, private, document.getroot().get('Enable') == '1', icon_dir)
        move_template(f'{private}/Folder.cfg', document, old, new)
    for path in glob.glob(f'{preset_dir}/*/Presets/presets.xml'):
        rewrite(path, read(path).replace(f'{KEY}">"{old}/', f'{KEY}">"{new}/').encode())


main(*sys.argv[1:])

#!/usr/bin/python3
"""The same upgrade the way an administrator would write it today: one load of each Folder.cfg with lxml.

    administrator.py FOLDERS ICON FROM TO
"""
import os
import shutil
import sys

from lxml import etree

INFO_TIP = 'InfoTip=This folder has been configured as an ORX hot folder.'

folders, icon, old, new = sys.argv[1:]
for folder in open(folders, encoding='utf-8').read().splitlines():
    private = os.path.join(folder, '[_ORX_HotFolder_]')
    cfg = os.path.join(private, 'Folder.cfg')
    document = etree.parse(cfg)
    shutil.copyfile(icon, os.path.join(private, os.path.basename(icon)))
    ini = os.path.join(folder, 'Desktop.ini')
    os.chmod(ini, 0o644)
    with open(ini, encoding='utf-8', newline='') as file:
        lines = file.read().split('\r\n')
    with open(ini, 'w', encoding='utf-8', newline='') as file:
        file.write('\r\n'.join(INFO_TIP if line.startswith('InfoTip=') else line for line in lines))
    os.chmod(ini, 0o444)
    for entry in document.iterfind('.//ImposeSetting/KEYVALUE[@Key="ORXImposeTemplate"]'):
        if os.path.dirname(entry.get('Value')) == old:
            entry.set('Value', os.path.join(new, os.path.basename(entry.get('Value'))))
            document.write(cfg, encoding='UTF-8', xml_declaration=True)

// A hot folder's icon in Explorer.
#pragma once

#include "appearance/desktop_ini.h"
#include "run/folder_upgrade_app.h"

/// Copies the icon that DecideIconCopy chooses over the one of the same name in the private
/// directory, and refreshes Desktop.ini, attributes and Explorer. If either icon is missing,
/// nothing changes. Reports to the run log; the library reports a Folder.cfg that cannot be read
/// and a failed copy.
void UpdateFolderIcon(const FolderUpgradeApp& app, HotFolder& folder);

/// Writes or refreshes the folder's Desktop.ini, makes the folder a system folder that is not
/// read-only, notifies the shell, and makes Desktop.ini read-only and system. Before shell version
/// 4.72 it does only the last of these. Returns the success flag of the last attribute write;
/// nothing else is reported.
bool ApplyFolderIcon(const HotFolder& folder, const wxString& iconName);

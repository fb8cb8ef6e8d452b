// Moving the template path of one hot folder.
#pragma once

#include "run/folder_upgrade_app.h"
#include "store/hot_folder.h"

/// If the template path in the hot folder's Folder.cfg is directly in the template folder of the
/// version being left, changes it to the same name in the template folder of the version being
/// installed, and rewrites Folder.cfg. The template itself is not accessed. In every other case
/// Folder.cfg stays as it is. Reports to the run log; the library reports a file that cannot be
/// read or written.
void UpdateHotFolderImposePath(const FolderUpgradeApp& app, HotFolder& folder);

// Moving the template path of one hot folder.
#pragma once

#include "run/folder_upgrade_app.h"
#include "store/hot_folder.h"

/// If the template path in the hot folder's Folder.cfg is directly in the template folder of the
/// version being left, changes it to the same name in that of the version being installed, and
/// rewrites Folder.cfg; otherwise Folder.cfg stays as it is. Does not access the template. Reports
/// to the run log; the library reports a file that cannot be read or written.
void UpdateHotFolderImposePath(const FolderUpgradeApp& app, HotFolder& folder);

// Moving the template path of one hot folder.
#pragma once

#include "run/folder_upgrade_app.h"

#include <wx/string.h>

/// If the template path in the hot folder's Folder.cfg is directly in the template folder of the
/// version being left, changes it to the same name in the template folder of the version being
/// installed, and rewrites Folder.cfg. The template itself is not accessed. In every other case
/// Folder.cfg stays as it is. Reports to the run log.
void UpdateHotFolderImposePath(const FolderUpgradeApp& app, const wxString& hotFolder);

// Moving the template path of one hot folder.
#pragma once

#include "run/folder_upgrade_app.h"

#include <wx/string.h>

/// Points the template path in the hot folder's Folder.cfg, when it lies directly in the template
/// folder of the version being left, at the file of the same name in that of the version being
/// installed, and rewrites Folder.cfg; the template itself is not looked at. In every other case
/// Folder.cfg stays as it is. Reports to the run log only.
void UpdateHotFolderImposePath(const FolderUpgradeApp& app, const wxString& hotFolder);

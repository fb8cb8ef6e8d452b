// Moving the template paths in the current user's job presets.
#pragma once

#include "run/folder_upgrade_app.h"

#include <wx/arrstr.h>

/// Moves the template paths of every job preset file, as MovePresetPaths does, from the template
/// folder of the version being left to that of the version being installed. A file that can be
/// opened for reading and writing is rewritten in place, as UTF-8 without byte-order mark, whether
/// or not it held such a path; one that cannot be read, decoded or encoded again stays as it was.
/// Reports to the run log.
void UpdateJobPresetImposePath(const FolderUpgradeApp& app);

/// Appends the full paths of the job preset directories; see ListJobPresetDirs.
void FindJobPresetDirs(wxArrayString& directories);

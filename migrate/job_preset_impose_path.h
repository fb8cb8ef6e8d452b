// Moving the template paths in the current user's job presets.
#pragma once

#include "run/folder_upgrade_app.h"

#include <wx/arrstr.h>

/// Moves every template path that lies in the template folder of the version being left, at any
/// depth, to that of the version being installed, in the text of every job preset file. Reports to
/// the run log.
///
/// A path is the text directly after the search text ORXImposeTemplate">". It moves if it begins
/// with the folder's text, followed by a path separator or the closing double quote. A preset file
/// that can be opened for reading and writing is rewritten, in place and as UTF-8 without
/// byte-order mark, whether or not it held such a path; one that cannot be read, decoded or encoded
/// again stays as it was.
void UpdateJobPresetImposePath(const FolderUpgradeApp& app);

/// Appends the full paths of the job preset directories, the direct sub-directories (hidden ones
/// too) of ORX/JPData in the per-user application data folder, in the order of the listing.
void FindJobPresetDirs(wxArrayString& directories);

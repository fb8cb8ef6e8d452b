// The choice of the icon that shows a hot folder's state in Explorer.
#pragma once

#include "store/hot_folder.h"

/// Gives the file name, without a directory, of the icon for the folder's current state, which
/// depends on whether its Folder.cfg enables it and whether its private directory holds a file
/// "Error.er". A folder whose Folder.cfg cannot be read is not enabled; one whose private directory
/// is missing or cannot be listed is not in error. Changes nothing; returns true.
bool GetFolderIconName(HotFolder& folder, wxString& iconName);

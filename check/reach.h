// Whether a run gets at what is in a directory.
#pragma once

#include "platform/pinned_directory.h"

#include <wx/string.h>

bool MayEnter(const PinnedDirectory& directory);

/// Why a run does not get at what is in the directory, as the end of a sentence. Empty if it does,
/// and if there is no such directory.
wxString WhyOutOfReach(const wxString& directory);

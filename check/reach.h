// Whether a run can reach the contents of a directory.
#pragma once

#include "platform/pinned_directory.h"

bool MayEnter(const PinnedDirectory& directory);

/// Why a run cannot reach the contents of the directory, as the end of a sentence. Empty if it can,
/// or if there is no such directory.
wxString WhyOutOfReach(const wxString& directory);

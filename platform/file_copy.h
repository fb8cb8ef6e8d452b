// Copying a file over another one.
#pragma once

#include "platform/pinned_directory.h"

#include <wx/string.h>

/// Copies the source's content and attributes over an existing file, as wxCopyFile does. Writes in
/// place. Elsewhere than on Windows, a file that cannot be written is replaced by a new one: its
/// own permissions do not prevent that. Never writes through a link in place of the destination.
/// Returns false if the copy fails; a destination that was written in place then has its old
/// content, unless that could not be read. Does not wait for the disk.
bool CopyOver(const wxString& source, const PinnedDirectory& directory, const wxString& name);

/// Whether CopyOver could read the source and write the destination. Changes nothing.
bool MayCopyOver(const wxString& source, const PinnedDirectory& directory, const wxString& name);

/// Whether the destination already has the source's content and attributes.
bool IsCopy(const wxString& source, const PinnedDirectory& directory, const wxString& name);

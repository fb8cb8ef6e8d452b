// Copying a file over another one.
#pragma once

#include <wx/string.h>

/// Makes the content and attributes of an existing file those of the source, as wxCopyFile does: in
/// place, and off Windows, where a file's own permissions do not protect it from that, in a new
/// file where it cannot be written. Through a link in the destination's place nothing is written.
/// False when that fails; a destination that was written in place then has its old content. Does
/// not wait for the disk.
bool CopyOver(const wxString& source, const wxString& destination);

/// Whether CopyOver would be let at the destination, and could read the source. Changes nothing.
bool MayCopyOver(const wxString& source, const wxString& destination);

/// Whether the destination has the source's content and attributes already.
bool IsCopy(const wxString& source, const wxString& destination);

// Copying a file over another one.
#pragma once

#include "platform/regular_file.h"

#include <optional>

/// Copies the source's content and attributes, except read-only, over an existing file, as
/// wxCopyFile does, whatever its length. Writes in place; but elsewhere than on Windows, where its
/// own permissions do not prevent that, a file that cannot be written is replaced by a new one.
/// Never writes through a link. If the disk has no room, the destination stays as it was; if
/// another call fails, it may hold a part of the copy. Does not wait for the disk.
std::optional<FailedCall> CopyOver(const wxString& source, const PinnedDirectory& directory,
                                   const wxString& name);

/// Why CopyOver cannot open the source or the destination; nothing if it can. Changes nothing.
std::optional<FailedCall> WhyNotCopied(const wxString& source, const PinnedDirectory& directory,
                                       const wxString& name);

/// Whether the destination already has the source's content and attributes. False if the content is
/// longer than LongestFile.
bool IsCopy(const wxString& source, const PinnedDirectory& directory, const wxString& name);

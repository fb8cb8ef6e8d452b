// What the process is permitted to do, found out without doing it; one source for each system.
#pragma once

#include "platform/regular_file.h"

#include <optional>

/// Whether SetFileAttributesW would be permitted. Changes nothing and does not follow a link.
bool MayChangeAttributes(const wxString& path);

/// Whether a file can be created in the directory.
bool MayCreateIn(const wxString& directory);

/// Why the names in an existing directory cannot be listed; nothing if they can.
std::optional<FailedCall> WhyNotListed(const wxString& directory);

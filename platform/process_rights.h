// Whose rights the process has; one source for each system.
#pragma once

#include <wx/string.h>

/// Whether the process has an administrator's rights: an elevated token, as SYSTEM also has, or the
/// effective user root. Can be called before static objects are constructed.
bool IsElevated();

/// The account that the process runs as, for example "DESK7\anna" or "NT AUTHORITY\SYSTEM".
/// Elsewhere: the host and the effective user, or the user ID if there is no name. Empty if the
/// system does not say.
wxString AccountName();

/// Whether the process refuses to follow links made by processes without administrator's rights: an
/// elevated process does on Windows 11 and Windows 10 22H2.
bool RefusesLinksOfOthers();

/// Whether that account is SYSTEM, which has a profile and a registry of its own. Elsewhere than on
/// Windows never.
bool IsSystemAccount();

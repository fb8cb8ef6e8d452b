// Which paths can be looked at without asking another machine; one source for each system.
#pragma once

#include <wx/string.h>

/// Whether a path is complete and on a drive of this machine, by GetDriveTypeW of its drive letter,
/// elsewhere by the type of the file system that is mounted there.
bool IsOnLocalDrive(const wxString& path);

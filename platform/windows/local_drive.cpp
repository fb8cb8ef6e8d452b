#include "platform/local_drive.h"

#include "platform/system.h"

#include <wx/filename.h>

bool IsOnLocalDrive(const wxString& path)
{
    if (path.length() < 3 || path[1] != ':' || !wxFileName::IsPathSeparator(path[2]))
        return false;
    const UINT type = GetDriveTypeW((path.Left(2) + "\\").wc_str());
    return type != DRIVE_REMOTE && type != DRIVE_NO_ROOT_DIR && type != DRIVE_UNKNOWN;
}

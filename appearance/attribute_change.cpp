#include "appearance/attribute_change.h"

bool ChangeAttributes(const wxString& path, DWORD add, DWORD remove)
{
    const DWORD attributes = GetFileAttributesW(path.wc_str());
    if (attributes == INVALID_FILE_ATTRIBUTES)
        return false;
    const DWORD wanted = (attributes | add) & ~remove;
    return wanted == attributes || SetFileAttributesW(path.wc_str(), wanted) != 0;
}

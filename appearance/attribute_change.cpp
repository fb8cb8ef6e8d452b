#include "appearance/attribute_change.h"

namespace
{

constexpr DWORD Changeable = FILE_ATTRIBUTE_READONLY | FILE_ATTRIBUTE_HIDDEN |
                             FILE_ATTRIBUTE_SYSTEM | FILE_ATTRIBUTE_TEMPORARY |
                             FILE_ATTRIBUTE_OFFLINE | FILE_ATTRIBUTE_NOT_CONTENT_INDEXED;

} // namespace

bool ChangeAttributes(const wxString& path, DWORD add, DWORD remove)
{
    const DWORD attributes = GetFileAttributesW(path.wc_str());
    if (attributes == INVALID_FILE_ATTRIBUTES)
        return false;
    const DWORD wanted = (attributes | add) & ~remove;
    return wanted == attributes || SetFileAttributesW(path.wc_str(), wanted) != 0;
}

AttributeChange DecideAttributes(const wxString& path, DWORD add, DWORD remove)
{
    const DWORD attributes = GetFileAttributesW(path.wc_str());
    if (attributes == INVALID_FILE_ATTRIBUTES)
        return {};
    return {attributes & Changeable, ((attributes | add) & ~remove) & Changeable};
}

#include "platform/linux/native_path.h"

#include <wx/string.h>

#include <algorithm>

std::string NativePath(const wchar_t* path)
{
    std::string native = wxString(path).utf8_string();
    std::replace(native.begin(), native.end(), '\\', '/');
    return native;
}

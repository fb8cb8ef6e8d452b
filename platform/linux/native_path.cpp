#include "platform/linux/native_path.h"

wxString NativePath(const wxString& path)
{
    wxString native = path;
    native.Replace("\\", "/");
    return native;
}

#include "tests/recording_shell.h"

#include <wx/string.h>

std::vector<std::string> ShellCalls;
DWORD ShellMajorVersion = 6;
DWORD ShellMinorVersion = 0;
HRESULT ShellVersionResult = 0;

namespace
{

HRESULT GetVersion(DLLVERSIONINFO* version)
{
    if (version->cbSize != 20 || version->dwMajorVersion != 0)
        return -1;
    version->dwMajorVersion = ShellMajorVersion;
    version->dwMinorVersion = ShellMinorVersion;
    return ShellVersionResult;
}

void Record(const wxString& call)
{
    ShellCalls.push_back(call.utf8_string());
}

} // namespace

HMODULE LoadLibraryW(LPCWSTR name)
{
    Record("load " + wxString(name));
    return reinterpret_cast<HMODULE>(1);
}

FARPROC GetProcAddress(HMODULE /*module*/, const char* name)
{
    Record("find " + wxString(name));
    return reinterpret_cast<FARPROC>(reinterpret_cast<void*>(GetVersion));
}

BOOL FreeLibrary(HMODULE /*module*/)
{
    Record("free");
    return 1;
}

void SHChangeNotify(LONG event, UINT flags, const void* item1, const void* item2)
{
    wxString item =
        wxString::Format("%lld", static_cast<long long>(reinterpret_cast<std::intptr_t>(item1)));
    if ((flags & 0xFF) == SHCNF_PATHW)
        item = static_cast<const wchar_t*>(item1);
    Record(wxString::Format("notify %x %x %s%s", static_cast<unsigned>(event), flags, item,
                            item2 ? " and more" : ""));
}

std::uintptr_t SHGetFileInfoW(LPCWSTR path, DWORD attributes, SHFILEINFOW* info, UINT size,
                              UINT flags)
{
    Record(wxString::Format("info %s %u %d %x", path, attributes, size == sizeof *info ? 1 : 0,
                            flags));
    info->iIcon = -7;
    return 1;
}

HRESULT SHGetSetFolderCustomSettings(SHFOLDERCUSTOMSETTINGS* settings, LPCWSTR path,
                                     DWORD readOrWrite)
{
    Record(wxString::Format("force %s %x %s %u %d %x", path, settings->dwMask,
                            settings->pszIconFile, settings->cchIconFile, settings->iIconIndex,
                            readOrWrite));
    return settings->dwSize == sizeof *settings ? 0 : -1;
}

// The shell of a machine without one: every call is accepted, and nothing happens.
#include "platform/system.h"

struct Module
{
};

namespace
{

Module shell32;

HRESULT GetShellVersion(DLLVERSIONINFO* version)
{
    version->dwMajorVersion = 6;
    version->dwMinorVersion = 0;
    return 0;
}

} // namespace

HMODULE LoadLibraryW(LPCWSTR /*name*/)
{
    return &shell32;
}

FARPROC GetProcAddress(HMODULE /*module*/, const char* /*name*/)
{
    return reinterpret_cast<FARPROC>(reinterpret_cast<void*>(GetShellVersion));
}

BOOL FreeLibrary(HMODULE /*module*/)
{
    return 1;
}

void SHChangeNotify(LONG /*event*/, UINT /*flags*/, const void* /*item1*/, const void* /*item2*/)
{
}

std::uintptr_t SHGetFileInfoW(LPCWSTR /*path*/, DWORD /*attributes*/, SHFILEINFOW* /*info*/,
                              UINT /*size*/, UINT /*flags*/)
{
    return 0;
}

HRESULT SHGetSetFolderCustomSettings(SHFOLDERCUSTOMSETTINGS* /*settings*/, LPCWSTR /*path*/,
                                     DWORD /*readOrWrite*/)
{
    return 0;
}

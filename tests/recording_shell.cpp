// A shell of the version in $SHELL_VERSION that prints its calls, in place of the silent one.
#include "platform/system.h"

#include <cstdio>
#include <cstdlib>

namespace
{

HRESULT GetVersion(DLLVERSIONINFO* version)
{
    auto& [size, major, minor, build, platform] = *version;
    const char* const given = size == 20 && major == 0 ? std::getenv("SHELL_VERSION") : "";
    return std::sscanf(given, "%u.%u", &major, &minor) == 2 ? 0 : -1;
}

} // namespace

HMODULE LoadLibraryW(LPCWSTR name)
{
    std::printf("load %ls\n", name);
    return reinterpret_cast<HMODULE>(1);
}

FARPROC GetProcAddress(HMODULE /*module*/, const char* name)
{
    std::printf("find %s\n", name);
    return reinterpret_cast<FARPROC>(reinterpret_cast<void*>(GetVersion));
}

BOOL FreeLibrary(HMODULE /*module*/)
{
    return std::puts("free");
}

void SHChangeNotify(LONG event, UINT flags, const void* item, const void* /*second*/)
{
    const bool isPath = (flags & 0xFF) == SHCNF_PATHW;
    std::printf("notify %x %x %ls %d\n", static_cast<unsigned>(event), flags,
                isPath ? static_cast<const wchar_t*>(item) : L"",
                isPath ? 0 : static_cast<int>(reinterpret_cast<std::intptr_t>(item)));
}

std::uintptr_t SHGetFileInfoW(LPCWSTR path, DWORD attributes, SHFILEINFOW* info, UINT size,
                              UINT flags)
{
    std::printf("info %ls %u %d %x\n", path, attributes, size == sizeof *info, flags);
    info->iIcon = -7;
    return 1;
}

HRESULT SHGetSetFolderCustomSettings(SHFOLDERCUSTOMSETTINGS* settings, LPCWSTR path, DWORD action)
{
    std::printf("force %ls %x %ls %u %d %x\n", path, settings->dwMask, settings->pszIconFile,
                settings->cchIconFile, settings->iIconIndex, action);
    return settings->dwSize == sizeof *settings ? 0 : -1;
}

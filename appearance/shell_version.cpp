#include "appearance/shell_version.h"

#include "platform/system.h"

std::uint32_t GetPackedShellVersion()
{
    const HMODULE shell = LoadLibraryW(L"shell32.dll");
    if (!shell)
        return 0;
    std::uint32_t packed = 0;
    const FARPROC entry = GetProcAddress(shell, "DllGetVersion");
    if (entry)
    {
        DLLVERSIONINFO version = {};
        version.cbSize = sizeof version;
        // By way of void*, since the two function types are unrelated.
        const auto getVersion = reinterpret_cast<DLLGETVERSIONPROC>(reinterpret_cast<void*>(entry));
        if (SUCCEEDED(getVersion(&version)))
            packed = (version.dwMajorVersion & 0xFFFF) << 16 | (version.dwMinorVersion & 0xFFFF);
    }
    FreeLibrary(shell);
    return packed;
}

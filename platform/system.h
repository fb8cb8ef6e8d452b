// The operating system calls that the tool makes, under their real names.
//
// On Windows this header only includes the system's own. Elsewhere it declares the same names with
// the same contracts, and platform/linux/ implements them: the hives are text files, attributes
// live in file modes and extended attributes, a profile file is a file, and there is no shell. Of
// the shell's structures only the fields that the tool knows are there.
#pragma once

#ifdef _WIN32

#ifndef NOMINMAX
#define NOMINMAX
#endif
#include <windows.h>

#include <shellapi.h>
#include <shlobj.h>
#include <shlwapi.h>

#else

#include <cstdint>

using BYTE = std::uint8_t;
using DWORD = std::uint32_t;
using UINT = std::uint32_t;
using LONG = std::int32_t;
using BOOL = int;
using LSTATUS = LONG;
using REGSAM = DWORD;
using LPCWSTR = const wchar_t*;
using LPWSTR = wchar_t*;

// Registry -----------------------------------------------------------------------------------

struct RegistryKey;
using HKEY = RegistryKey*;

inline const HKEY HKEY_CURRENT_USER = reinterpret_cast<HKEY>(std::uintptr_t{0x80000001});
inline const HKEY HKEY_LOCAL_MACHINE = reinterpret_cast<HKEY>(std::uintptr_t{0x80000002});

constexpr REGSAM KEY_READ = 0x20019;
constexpr LSTATUS ERROR_SUCCESS = 0;
constexpr LSTATUS ERROR_FILE_NOT_FOUND = 2;
constexpr LSTATUS ERROR_MORE_DATA = 234;

LSTATUS RegOpenKeyExW(HKEY hive, LPCWSTR path, DWORD options, REGSAM access, HKEY* key);
LSTATUS RegQueryValueExW(HKEY key, LPCWSTR name, DWORD* reserved, DWORD* type, BYTE* data,
                         DWORD* size);
LSTATUS RegCloseKey(HKEY key);

// File attributes ----------------------------------------------------------------------------

constexpr DWORD FILE_ATTRIBUTE_READONLY = 0x1;
constexpr DWORD FILE_ATTRIBUTE_HIDDEN = 0x2;
constexpr DWORD FILE_ATTRIBUTE_SYSTEM = 0x4;
constexpr DWORD FILE_ATTRIBUTE_DIRECTORY = 0x10;
constexpr DWORD FILE_ATTRIBUTE_NORMAL = 0x80;
constexpr DWORD FILE_ATTRIBUTE_TEMPORARY = 0x100;
constexpr DWORD FILE_ATTRIBUTE_OFFLINE = 0x1000;
constexpr DWORD FILE_ATTRIBUTE_NOT_CONTENT_INDEXED = 0x2000;
constexpr DWORD INVALID_FILE_ATTRIBUTES = 0xFFFFFFFF;

DWORD GetFileAttributesW(LPCWSTR path);
BOOL SetFileAttributesW(LPCWSTR path, DWORD attributes);

// Profile files ------------------------------------------------------------------------------

BOOL WritePrivateProfileStringW(LPCWSTR section, LPCWSTR key, LPCWSTR value, LPCWSTR path);
DWORD GetPrivateProfileStringW(LPCWSTR section, LPCWSTR key, LPCWSTR defaultValue, LPWSTR buffer,
                               DWORD capacity, LPCWSTR path);

// Shell --------------------------------------------------------------------------------------

constexpr int MAX_PATH = 260; // characters, including the terminating NUL

using HMODULE = struct Module*;
using FARPROC = std::intptr_t (*)();

HMODULE LoadLibraryW(LPCWSTR name);
FARPROC GetProcAddress(HMODULE module, const char* name);
BOOL FreeLibrary(HMODULE module);

using HRESULT = LONG;
constexpr bool SUCCEEDED(HRESULT result)
{
    return result >= 0;
}

struct DLLVERSIONINFO
{
    DWORD cbSize;
    DWORD dwMajorVersion;
    DWORD dwMinorVersion;
    DWORD dwBuildNumber;
    DWORD dwPlatformID;
};
using DLLGETVERSIONPROC = HRESULT (*)(DLLVERSIONINFO*);

struct SHFILEINFOW
{
    int iIcon;
};

struct SHFOLDERCUSTOMSETTINGS
{
    DWORD dwSize;
    DWORD dwMask;
    LPWSTR pszIconFile;
    DWORD cchIconFile;
    int iIconIndex;
};

constexpr LONG SHCNE_MKDIR = 0x00000008;
constexpr LONG SHCNE_ATTRIBUTES = 0x00000800;
constexpr LONG SHCNE_UPDATEIMAGE = 0x00008000;
constexpr LONG SHCNE_ASSOCCHANGED = 0x08000000;
constexpr UINT SHCNF_IDLIST = 0x0000;
constexpr UINT SHCNF_DWORD = 0x0003;
constexpr UINT SHCNF_PATHW = 0x0005;
constexpr UINT SHCNF_FLUSH = 0x1000;
constexpr UINT SHGFI_SYSICONINDEX = 0x4000;
constexpr DWORD FCSM_ICONFILE = 0x10;
constexpr DWORD FCS_FORCEWRITE = 0x2;

void SHChangeNotify(LONG event, UINT flags, const void* item1, const void* item2);
std::uintptr_t SHGetFileInfoW(LPCWSTR path, DWORD attributes, SHFILEINFOW* info, UINT size,
                              UINT flags);
HRESULT SHGetSetFolderCustomSettings(SHFOLDERCUSTOMSETTINGS* settings, LPCWSTR path,
                                     DWORD readOrWrite);

#endif

// The operating system calls that the tool makes, under their real names.
//
// On Windows this is the system's own headers. Elsewhere it declares the same names with the same
// contracts, and platform/posix/ answers them: the hives are text files, attributes live in file
// modes and extended attributes, a profile file is a file, and there is no shell to tell.
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
using WORD = std::uint16_t;
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
constexpr LSTATUS ERROR_INVALID_HANDLE = 6;
constexpr LSTATUS ERROR_MORE_DATA = 234;

LSTATUS RegOpenKeyExW(HKEY hive, LPCWSTR path, DWORD options, REGSAM access, HKEY* key);
LSTATUS RegQueryValueExW(HKEY key, LPCWSTR name, DWORD* reserved, DWORD* type, BYTE* data,
                         DWORD* size);
LSTATUS RegCloseKey(HKEY key);

#endif

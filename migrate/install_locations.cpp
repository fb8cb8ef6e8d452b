#include "migrate/install_locations.h"

#include "platform/system.h"
#include "platform/unicode_text.h"

#include <algorithm>
#include <array>

namespace
{

constexpr DWORD ValueCapacity = 517; // bytes

const wchar_t* const DefaultKeys[] = {L"SOFTWARE\\Wow6432Node\\Vantorix\\QZA",
                                      L"SOFTWARE\\Vantorix\\QZA"};
const wchar_t* const PreviousKeys[] = {L"SOFTWARE\\Wow6432Node\\HF", L"SOFTWARE\\HF"};
const wchar_t* const DefaultValue = L"InstallPath";
const wchar_t* const PreviousValue = L"Path";
const char* const TemplateDirName = "template";

bool QueryText(HKEY key, const wchar_t* name, wxString& text)
{
    std::array<BYTE, ValueCapacity> data{};
    DWORD type = 0;
    DWORD size = ValueCapacity;
    if (RegQueryValueExW(key, name, nullptr, &type, data.data(), &size) != ERROR_SUCCESS)
        return false;
    text = FromUtf16Bytes(data.data(), std::min(size, ValueCapacity));
    return true;
}

// Only the opening falls back to the second key, not a missing value.
bool ReadText(HKEY hive, const wchar_t* const (&keys)[2], const wchar_t* name, wxString& text)
{
    HKEY key = nullptr;
    if (RegOpenKeyExW(hive, keys[0], 0, KEY_READ, &key) != ERROR_SUCCESS &&
        RegOpenKeyExW(hive, keys[1], 0, KEY_READ, &key) != ERROR_SUCCESS)
        return false;
    const bool found = QueryText(key, name, text);
    RegCloseKey(key);
    return found;
}

} // namespace

bool GetDefaultImposeTemplatePath(wxFileName& folder)
{
    wxString path;
    if (!ReadText(HKEY_LOCAL_MACHINE, DefaultKeys, DefaultValue, path))
        return false;
    path += wxFileName::GetPathSeparator();
    path += TemplateDirName;
    folder.Assign(path, wxPATH_NATIVE);
    return true;
}

bool GetPreviousImposeTemplatePath(wxFileName& folder)
{
    wxString path;
    const bool found = ReadText(HKEY_CURRENT_USER, PreviousKeys, PreviousValue, path);
    folder.Assign(path, wxPATH_NATIVE);
    return found;
}

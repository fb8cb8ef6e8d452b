#include "migrate/install_locations.h"

#include "platform/system.h"
#include "platform/unicode_text.h"

#include <algorithm>
#include <array>
#include <vector>

namespace
{

// Bytes. Every version has passed a buffer of this size to the registry; a longer value counts as
// missing.
constexpr DWORD ValueCapacity = 517;

// A value, and the keys to look for it in: only the first that can be opened is used.
struct Location
{
    HKEY hive;
    std::vector<const wchar_t*> keys;
    const wchar_t* value;
};

const Location& DefaultFolder()
{
    static const Location location = {
        HKEY_LOCAL_MACHINE,
        {L"SOFTWARE\\Wow6432Node\\Vantorix\\QZA", L"SOFTWARE\\Vantorix\\QZA"},
        L"InstallPath"};
    return location;
}

const Location& PreviousFolder()
{
    static const Location location = {
        HKEY_CURRENT_USER, {L"SOFTWARE\\Wow6432Node\\HF", L"SOFTWARE\\HF"}, L"Path"};
    return location;
}

const char* const TemplateDirName = "template";

} // namespace

const char* const DefaultFolderSource =
    "InstallPath in HKEY_LOCAL_MACHINE\\SOFTWARE[\\Wow6432Node]\\Vantorix\\QZA";
const char* const PreviousFolderSource = "Path in HKEY_CURRENT_USER\\SOFTWARE[\\Wow6432Node]\\HF";

namespace
{

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

// The next key is tried only if a key cannot be opened, not if its value is missing.
bool ReadText(const Location& location, wxString& text)
{
    for (const wchar_t* path : location.keys)
    {
        HKEY key = nullptr;
        if (RegOpenKeyExW(location.hive, path, 0, KEY_READ, &key) != ERROR_SUCCESS)
            continue;
        const bool found = QueryText(key, location.value, text);
        RegCloseKey(key);
        return found;
    }
    return false;
}

} // namespace

bool GetDefaultImposeTemplatePath(wxFileName& folder)
{
    wxString path;
    if (!ReadText(DefaultFolder(), path))
        return false;
    path += wxFileName::GetPathSeparator();
    path += TemplateDirName;
    folder.Assign(path, wxPATH_NATIVE);
    return true;
}

bool GetPreviousImposeTemplatePath(wxFileName& folder)
{
    wxString path;
    const bool found = ReadText(PreviousFolder(), path);
    folder.Assign(path, wxPATH_NATIVE);
    return found;
}

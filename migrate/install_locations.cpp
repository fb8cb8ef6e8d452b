#include "migrate/install_locations.h"

#include "platform/system.h"
#include "platform/unicode_text.h"

#include <wx/log.h>

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
    const char* hiveName;
    std::vector<const wchar_t*> keys;
    const wchar_t* value;
};

const Location DefaultFolder = {
    HKEY_LOCAL_MACHINE,
    "HKEY_LOCAL_MACHINE",
    {L"SOFTWARE\\Wow6432Node\\Vantorix\\QZA", L"SOFTWARE\\Vantorix\\QZA"},
    L"InstallPath"};

const Location PreviousFolder = {HKEY_CURRENT_USER,
                                 "HKEY_CURRENT_USER",
                                 {L"SOFTWARE\\Wow6432Node\\HF", L"SOFTWARE\\HF"},
                                 L"Path"};

const char* const TemplateDirName = "template";

LSTATUS QueryText(HKEY key, const wchar_t* name, wxString& text)
{
    std::array<BYTE, ValueCapacity> data{};
    DWORD size = ValueCapacity;
    const LSTATUS status = RegQueryValueExW(key, name, nullptr, nullptr, data.data(), &size);
    if (status == ERROR_SUCCESS)
        text = FromUtf16Bytes(data.data(), std::min(size, ValueCapacity));
    return status;
}

// The name of the value with the key that was opened, or with all keys if none was.
wxString NameOf(const Location& location, const wxString& opened)
{
    wxString name = wxString("registry value ") + location.value + " in " + location.hiveName;
    if (!opened.empty())
        return name + "\\" + opened;
    for (const wchar_t* key : location.keys)
        name += (key == location.keys.front() ? "\\" : " or \\") + wxString(key);
    return name;
}

wxString WhyNotRead(const Location& location, const wxString& opened, LSTATUS status)
{
    if (status == ERROR_SUCCESS)
        return {};
    if (opened.empty())
        return "there is no such key";
    if (status == ERROR_MORE_DATA)
        return "longer than 257 characters";
    if (status != ERROR_FILE_NOT_FOUND)
        return wxSysErrorMsgStr(static_cast<unsigned long>(status));
    return opened == location.keys.back() ? "missing" : "missing, and no other key is looked at";
}

// The next key is tried only if a key cannot be opened, not if its value is missing.
bool ReadText(const Location& location, wxString& text, ValueSource& source)
{
    wxString opened;
    LSTATUS status = ERROR_FILE_NOT_FOUND;
    for (const wchar_t* path : location.keys)
    {
        HKEY key = nullptr;
        if (RegOpenKeyExW(location.hive, path, 0, KEY_READ, &key) != ERROR_SUCCESS)
            continue;
        opened = path;
        status = QueryText(key, location.value, text);
        RegCloseKey(key);
        break;
    }
    source = {NameOf(location, opened), WhyNotRead(location, opened, status)};
    return status == ERROR_SUCCESS;
}

} // namespace

bool GetDefaultImposeTemplatePath(wxFileName& folder, ValueSource& source)
{
    wxString path;
    if (!ReadText(DefaultFolder, path, source))
        return false;
    folder.Assign(path + wxFileName::GetPathSeparator() + TemplateDirName, wxPATH_NATIVE);
    return true;
}

bool GetPreviousImposeTemplatePath(wxFileName& folder, ValueSource& source)
{
    wxString path;
    const bool found = ReadText(PreviousFolder, path, source);
    folder.Assign(path, wxPATH_NATIVE);
    return found;
}

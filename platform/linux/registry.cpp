// The registry of a machine without one: a hive is a file exported by the registry editor, in UTF-8
// or UTF-16, and is read again each time a key is opened.
#include "platform/linux/profile_text.h"
#include "platform/regular_file.h"
#include "platform/standard_folders.h"
#include "platform/system.h"

#include <wx/string.h>

#include <algorithm>
#include <cstdlib>
#include <memory>
#include <string>

struct RegistryKey
{
    ProfileText hive;
    std::wstring section;
};

namespace
{

// UTF-16LE with a NUL. Each backslash and quote in the text has a backslash before it.
std::string TextData(const std::wstring& text, bool isUtf8)
{
    std::wstring plain;
    for (size_t i = 1; i < text.size() && text[i] != L'"'; ++i)
    {
        i += text[i] == L'\\' && i + 1 < text.size() ? 1 : 0;
        plain += text[i];
    }
    std::string data;
    if (isUtf8)
        plain = wxString::FromUTF8(std::string(plain.begin(), plain.end())).ToStdWstring();
    const wxCharBuffer units = wxString(plain).mb_str(wxMBConvUTF16LE());
    data.assign(units.data(), units.length());
    return data + std::string(2, '\0');
}

// Bytes separated by commas; after a comma, a backslash continues them on the next line.
std::string BytesData(const std::wstring& text)
{
    const wchar_t* at = text.c_str() + std::min(text.find(L':') + 1, text.size());
    std::string data;
    wchar_t* end = nullptr;
    for (auto byte = std::wcstoul(at, &end, 16); end != at; byte = std::wcstoul(at, &end, 16))
    {
        data += static_cast<char>(byte);
        at = end + std::wcsspn(end, L",\\");
    }
    return data;
}

std::string NumberData(const std::wstring& text)
{
    const unsigned long number = std::wcstoul(text.c_str() + text.find(L':') + 1, nullptr, 16);
    std::string data;
    for (unsigned shift = 0; shift < 32; shift += 8)
        data += static_cast<char>(number >> shift);
    return data;
}

} // namespace

LSTATUS RegOpenKeyExW(HKEY hive, LPCWSTR path, DWORD options, REGSAM /*access*/, HKEY* key)
{
    const bool isMachine = hive == HKEY_LOCAL_MACHINE;
    const wxString name = isMachine ? "HKEY_LOCAL_MACHINE" : "HKEY_CURRENT_USER";
    const wxString folder = isMachine ? GetMachineDataFolder() : GetUserDataFolder();
    RegularFile file;
    std::string bytes;
    if (options != 0 || // none is supported
        file.OpenForReading(folder + "/registry/" + name + ".reg") != RegularFile::Status::Open ||
        !file.Read(bytes))
        return ERROR_FILE_NOT_FOUND;
    auto opened = std::make_unique<RegistryKey>(
        RegistryKey{ProfileText(bytes), (name + "\\" + path).ToStdWstring()});
    if (!FindInProfile(opened->hive.text, opened->section, {}).hasSection)
        return ERROR_FILE_NOT_FOUND;
    *key = opened.release(); // owned by the caller until RegCloseKey
    return ERROR_SUCCESS;
}

LSTATUS RegQueryValueExW(HKEY key, LPCWSTR name, DWORD* /*reserved*/, DWORD* /*type*/, BYTE* data,
                         DWORD* size)
{
    const std::wstring& text = key->hive.text;
    const ProfilePlace place =
        FindInProfile(text, key->section, L"\"" + std::wstring(name) + L"\"");
    if (!place.hasKey)
        return ERROR_FILE_NOT_FOUND;
    const wchar_t form = place.value.empty() ? L'\0' : place.value[0];
    const std::string value = form == L'"'   ? TextData(place.value, key->hive.width == 1)
                              : form == L'd' ? NumberData(place.value)
                                             : BytesData(text.substr(place.begin));
    const bool fits = value.size() <= *size;
    *size = static_cast<DWORD>(value.size());
    if (fits)
        std::copy(value.begin(), value.end(), data);
    return fits ? ERROR_SUCCESS : ERROR_MORE_DATA;
}

LSTATUS RegCloseKey(HKEY key)
{
    delete key;
    return ERROR_SUCCESS;
}

// The registry of a machine without one: a hive is a file exported by the registry editor, in UTF-8
// or UTF-16, and is read again each time a key is opened.
#include "platform/linux/profile_text.h"
#include "platform/regular_file.h"
#include "platform/standard_folders.h"
#include "platform/system.h"

#include <wx/strconv.h>
#include <wx/tokenzr.h>

#include <algorithm>
#include <memory>

struct RegistryKey
{
    ProfileText hive;
    wxString section;
};

namespace
{

// UTF-16LE with a NUL. Each backslash and quote in the text has a backslash before it.
std::string TextData(const wxString& text, bool isUtf8)
{
    wxString plain;
    for (size_t i = 1; i < text.length() && text[i] != '"'; ++i)
    {
        i += text[i] == '\\' && i + 1 < text.length() ? 1 : 0;
        plain += text[i];
    }
    if (isUtf8)
        plain = wxString::FromUTF8(plain.To8BitData());
    const wxCharBuffer units = plain.mb_str(wxMBConvUTF16LE());
    return std::string(units.data(), units.length()) + std::string(2, '\0');
}

// Bytes separated by commas; after a comma, a backslash continues them on the next line.
std::string BytesData(const wxString& text)
{
    wxStringTokenizer bytes(text.AfterFirst(':'), ",\\ \t\r\n", wxTOKEN_STRTOK);
    std::string data;
    for (unsigned long byte = 0; bytes.GetNextToken().ToULong(&byte, 16);)
        data += static_cast<char>(byte);
    return data;
}

std::string NumberData(const wxString& text)
{
    unsigned long number = 0;
    text.AfterFirst(':').ToULong(&number, 16);
    return std::string(reinterpret_cast<const char*>(&number), sizeof(DWORD));
}

} // namespace

LSTATUS RegOpenKeyExW(HKEY hive, LPCWSTR path, DWORD /*options*/, REGSAM /*access*/, HKEY* key)
{
    const bool isMachine = hive == HKEY_LOCAL_MACHINE;
    const wxString name = isMachine ? "HKEY_LOCAL_MACHINE" : "HKEY_CURRENT_USER";
    const wxString folder = isMachine ? GetMachineDataFolder() : GetUserDataFolder();
    RegularFile file;
    std::string bytes;
    if (file.OpenForReading(folder + "/registry/" + name + ".reg") != RegularFile::Status::Open ||
        !file.Read(bytes))
        return ERROR_FILE_NOT_FOUND;
    auto opened =
        std::make_unique<RegistryKey>(RegistryKey{ProfileText(bytes), name + "\\" + path});
    if (!FindInProfile(opened->hive.text, opened->section, {}).hasSection)
        return ERROR_FILE_NOT_FOUND;
    *key = opened.release(); // owned by the caller until RegCloseKey
    return ERROR_SUCCESS;
}

LSTATUS RegQueryValueExW(HKEY key, LPCWSTR name, DWORD* /*reserved*/, DWORD* /*type*/, BYTE* data,
                         DWORD* size)
{
    const wxString& text = key->hive.text;
    const ProfilePlace place = FindInProfile(text, key->section, "\"" + wxString(name) + "\"");
    if (!place.hasKey)
        return ERROR_FILE_NOT_FOUND;
    const std::string value = place.value.StartsWith("\"")
                                  ? TextData(place.value, key->hive.width == 1)
                              : place.value.StartsWith("d") ? NumberData(place.value)
                                                            : BytesData(text.Mid(place.begin));
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

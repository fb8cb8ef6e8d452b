// The registry of a machine without one: a hive is a file exported by the registry editor, and is
// read again each time a key is opened.
#include "platform/linux/registry_export.h"
#include "platform/regular_file.h"
#include "platform/standard_folders.h"
#include "platform/system.h"

#include <wx/string.h>

#include <algorithm>
#include <memory>
#include <utility>

struct RegistryKey
{
    std::string hive;
    const char* lines = nullptr; // the key's lines in the hive
};

LSTATUS RegOpenKeyExW(HKEY hive, LPCWSTR path, DWORD options, REGSAM /*access*/, HKEY* key)
{
    const bool isMachine = hive == HKEY_LOCAL_MACHINE;
    const wxString name = isMachine ? "HKEY_LOCAL_MACHINE" : "HKEY_CURRENT_USER";
    const wxString folder = isMachine ? GetMachineDataFolder() : GetUserDataFolder();
    auto opened = std::make_unique<RegistryKey>();
    RegularFile file;
    if (options != 0 || // none is supported
        file.OpenForReading(folder + "/registry/" + name + ".reg") != RegularFile::Status::Open ||
        !file.Read(opened->hive))
        return ERROR_FILE_NOT_FOUND;
    opened->hive = DecodeRegistryExport(std::move(opened->hive));
    opened->lines = FindRegistryKey(opened->hive, (name + "\\" + path).utf8_string());
    *key = opened->lines ? opened.release() : nullptr; // owned by the caller until RegCloseKey
    return *key ? ERROR_SUCCESS : ERROR_FILE_NOT_FOUND;
}

LSTATUS RegQueryValueExW(HKEY key, LPCWSTR name, DWORD* /*reserved*/, DWORD* type, BYTE* data,
                         DWORD* size)
{
    const auto value = FindRegistryValue(key->lines, wxString(name).utf8_string());
    if (!value)
        return ERROR_FILE_NOT_FOUND;
    *type = value->type;
    const bool fits = value->data.size() <= *size;
    *size = static_cast<DWORD>(value->data.size());
    if (fits)
        std::copy(value->data.begin(), value->data.end(), data);
    return fits ? ERROR_SUCCESS : ERROR_MORE_DATA;
}

LSTATUS RegCloseKey(HKEY key)
{
    delete key;
    return ERROR_SUCCESS;
}

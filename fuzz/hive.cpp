// Any bytes as a hive file: queries keep to their contract, and no content hides a value that the
// registry editor wrote behind it.
#include "fuzz/fuzzing.h"
#include "platform/system.h"

#include <memory>
#include <vector>

namespace
{

constexpr DWORD Capacity = 517; // bytes

std::vector<BYTE> Query(LPCWSTR path, LPCWSTR name)
{
    HKEY key = nullptr;
    if (RegOpenKeyExW(HKEY_CURRENT_USER, path, 0, KEY_READ, &key) != ERROR_SUCCESS)
        return {};
    // Of just this size, so that the sanitizer sees a byte too many.
    const auto data = std::make_unique<BYTE[]>(Capacity);
    DWORD type = 0;
    DWORD size = Capacity;
    const LSTATUS status = RegQueryValueExW(key, name, nullptr, &type, data.get(), &size);
    RegCloseKey(key);
    Check(status == ERROR_FILE_NOT_FOUND || (status == ERROR_SUCCESS) == (size <= Capacity), "a value is given if it fits");
    return {data.get(), data.get() + (status == ERROR_SUCCESS ? size : 0)};
}

std::string NewHive()
{
    const std::string folder = NewFile() + ".d";
    setenv("XDG_CONFIG_HOME", folder.c_str(), 1);
    wxFileName::Mkdir(folder + "/registry", wxS_DIR_DEFAULT, wxPATH_MKDIR_FULL);
    return folder + "/registry/HKEY_CURRENT_USER.reg";
}

} // namespace

void Try(const std::string& input)
{
    static const std::string path = NewHive();
    WriteBytes(path, input);
    Query(L"SOFTWARE\\Wow6432Node\\HF", L"Path");
    Query(L"SOFTWARE\\HF", L"Path");

    // The comment takes the place of the line with which an unfinished value would go on.
    WriteBytes(path, "Windows Registry Editor Version 5.00\r\n" + input +
                         "\r\n;\r\n[HKEY_CURRENT_USER\\SOFTWARE\\HF]\r\n\"Path\"=\"C:\\\\A\"\r\n");
    Check(Query(L"SOFTWARE\\HF", L"Path") == std::vector<BYTE>{'C', 0, ':', 0, '\\', 0, 'A', 0, 0, 0},
          "a value behind any content is read");
}

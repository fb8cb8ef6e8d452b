// The registry of a machine without one: a hive is a file in the registry editor's own text form,
// "Windows Registry Editor Version 5.00", read afresh each time a key is opened.
#include "platform/standard_folders.h"
#include "platform/system.h"

#include <wx/convauto.h>
#include <wx/ffile.h>
#include <wx/filename.h>
#include <wx/string.h>
#include <wx/tokenzr.h>

#include <algorithm>
#include <map>
#include <memory>
#include <vector>

namespace
{

constexpr DWORD TypeText = 1;
constexpr DWORD TypeExpandableText = 2;
constexpr DWORD TypeBinary = 3;
constexpr DWORD TypeNumber = 4;

const char* const HiveFormat = "Windows Registry Editor Version 5.00";

struct Value
{
    DWORD type;
    std::vector<BYTE> data;
};

} // namespace

struct RegistryKey
{
    std::map<wxString, Value> values; // by lower-case name
};

namespace
{

wxString HiveName(HKEY hive)
{
    if (hive == HKEY_LOCAL_MACHINE)
        return "HKEY_LOCAL_MACHINE";
    return hive == HKEY_CURRENT_USER ? wxString("HKEY_CURRENT_USER") : wxString();
}

wxString ReadHive(HKEY hive)
{
    const wxString folder =
        hive == HKEY_LOCAL_MACHINE ? GetMachineDataFolder() : GetUserDataFolder();
    const wxString path = folder + "/registry/" + HiveName(hive) + ".reg";
    wxString text;
    if (!wxFileName::IsFileReadable(path) || !wxFileExists(path))
        return text;
    wxFFile file(path, "rb");
    if (file.IsOpened())
        file.ReadAll(&text, wxConvAuto());
    return text;
}

void AppendUnit(std::vector<BYTE>& data, unsigned unit)
{
    data.push_back(static_cast<BYTE>(unit & 0xFF));
    data.push_back(static_cast<BYTE>((unit >> 8) & 0xFF));
}

// UTF-16LE, as the registry stores text, with its terminating NUL.
std::vector<BYTE> StoredText(const wxString& text)
{
    std::vector<BYTE> data;
    for (const wxUniChar character : text)
    {
        const unsigned code = character.GetValue();
        if (code < 0x10000)
        {
            AppendUnit(data, code);
            continue;
        }
        AppendUnit(data, 0xD800 + ((code - 0x10000) >> 10));
        AppendUnit(data, 0xDC00 + ((code - 0x10000) & 0x3FF));
    }
    AppendUnit(data, 0);
    return data;
}

// The editor ends text that arrives as bytes without a NUL; other bytes stay as they are.
void TerminateText(Value& value)
{
    const std::vector<BYTE>& data = value.data;
    const bool isText = value.type == TypeText || value.type == TypeExpandableText;
    if (!isText || data.size() % 2 != 0)
        return;
    if (data.empty() || data[data.size() - 1] != 0 || data[data.size() - 2] != 0)
        AppendUnit(value.data, 0);
}

// Reads "hex:" and "hex(type):" with their comma-separated bytes.
bool ParseBytes(const wxString& text, Value& value)
{
    unsigned long type = TypeBinary;
    const wxString kind = text.BeforeFirst(':');
    if (kind.StartsWith("hex(") && !kind.Mid(4).BeforeFirst(')').ToULong(&type, 16))
        return false;
    value.type = static_cast<DWORD>(type);
    wxStringTokenizer bytes(text.AfterFirst(':'), ", \t");
    while (bytes.HasMoreTokens())
    {
        const wxString token = bytes.GetNextToken();
        unsigned long byte = 0;
        if (token.empty())
            continue;
        if (!token.ToULong(&byte, 16) || byte > 0xFF)
            return false;
        value.data.push_back(static_cast<BYTE>(byte));
    }
    TerminateText(value);
    return true;
}

bool ParseNumber(const wxString& text, Value& value)
{
    unsigned long number = 0;
    if (!text.AfterFirst(':').ToULong(&number, 16) || number > 0xFFFFFFFF)
        return false;
    value.type = TypeNumber;
    for (unsigned shift = 0; shift < 32; shift += 8)
        value.data.push_back(static_cast<BYTE>((number >> shift) & 0xFF));
    return true;
}

// Takes a quoted text with its escapes from the front of rest; false when there is none.
bool TakeQuoted(wxString& rest, wxString& text)
{
    if (!rest.StartsWith("\""))
        return false;
    for (size_t i = 1; i < rest.length(); ++i)
    {
        if (rest[i] == '"')
        {
            rest = rest.Mid(i + 1);
            return true;
        }
        if (rest[i] == '\\' && i + 1 < rest.length())
            ++i;
        text += rest[i];
    }
    return false;
}

// One line of the form "Name"=data or @=data; lines that are not of it change nothing.
void ParseValue(wxString line, RegistryKey& key)
{
    wxString name;
    if (line.StartsWith("@"))
        line = line.Mid(1);
    else if (!TakeQuoted(line, name))
        return;
    line.Trim(false);
    if (!line.StartsWith("="))
        return;
    line = line.Mid(1).Trim(false).Trim();
    name.MakeLower();

    Value value{TypeText, {}};
    wxString text;
    if (line == "-")
        key.values.erase(name);
    else if (line.StartsWith("\"") && TakeQuoted(line, text))
        key.values[name] = Value{TypeText, StoredText(text)};
    else if (line.StartsWith("hex") && ParseBytes(line, value))
        key.values[name] = value;
    else if (line.StartsWith("dword:") && ParseNumber(line, value))
        key.values[name] = value;
}

// The next line without its end; a line of bytes that ends in a backslash goes on in the next one.
wxString NextLine(wxStringTokenizer& lines)
{
    wxString line = lines.GetNextToken().Trim().Trim(false);
    while (line.EndsWith("\\") && line.Contains("=hex") && lines.HasMoreTokens())
        line = line.RemoveLast() + lines.GetNextToken().Trim().Trim(false);
    return line;
}

// The key of that full path (hive name first) in the hive's text, or none.
std::unique_ptr<RegistryKey> FindKey(const wxString& hive, const wxString& wanted)
{
    wxStringTokenizer lines(hive, "\n");
    if (!lines.HasMoreTokens() || NextLine(lines) != HiveFormat)
        return nullptr;
    std::unique_ptr<RegistryKey> key;
    const wxString wantedParent = wanted + "\\";
    bool isInKey = false;
    while (lines.HasMoreTokens())
    {
        const wxString line = NextLine(lines);
        if (!line.StartsWith("["))
        {
            if (isInKey)
                ParseValue(line, *key);
            continue;
        }
        const bool isRemoval = line.StartsWith("[-");
        const wxString path = line.Mid(isRemoval ? 2 : 1).BeforeLast(']').Lower();
        isInKey = path == wanted && !isRemoval;
        if (isRemoval && (wanted == path || wanted.StartsWith(path + "\\")))
            key.reset();
        else if (!isRemoval && !key && (isInKey || path.StartsWith(wantedParent)))
            key = std::make_unique<RegistryKey>();
    }
    return key;
}

} // namespace

LSTATUS RegOpenKeyExW(HKEY hive, LPCWSTR path, DWORD /*options*/, REGSAM /*access*/, HKEY* key)
{
    const wxString name = HiveName(hive);
    if (name.empty())
        return ERROR_INVALID_HANDLE;
    std::unique_ptr<RegistryKey> found = FindKey(ReadHive(hive), (name + "\\" + path).Lower());
    if (!found)
        return ERROR_FILE_NOT_FOUND;
    *key = found.release(); // the caller's until RegCloseKey
    return ERROR_SUCCESS;
}

LSTATUS RegQueryValueExW(HKEY key, LPCWSTR name, DWORD* /*reserved*/, DWORD* type, BYTE* data,
                         DWORD* size)
{
    const auto found = key->values.find(wxString(name).Lower());
    if (found == key->values.end())
        return ERROR_FILE_NOT_FOUND;
    const Value& value = found->second;
    *type = value.type;
    const DWORD capacity = *size;
    *size = static_cast<DWORD>(value.data.size());
    if (*size > capacity)
        return ERROR_MORE_DATA;
    std::copy(value.data.begin(), value.data.end(), data);
    return ERROR_SUCCESS;
}

LSTATUS RegCloseKey(HKEY key)
{
    delete key;
    return ERROR_SUCCESS;
}

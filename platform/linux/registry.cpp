// The registry of a machine without one: a hive is a file in the registry editor's own text form,
// "Windows Registry Editor Version 5.00", read afresh each time a key is opened.
#include "platform/linux/file_bytes.h"
#include "platform/standard_folders.h"
#include "platform/system.h"

#include <wx/convauto.h>
#include <wx/string.h>
#include <wx/tokenzr.h>

#include <algorithm>
#include <cwctype>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace
{

constexpr DWORD TypeText = 1;
constexpr DWORD TypeExpandableText = 2;
constexpr DWORD TypeBinary = 3;
constexpr DWORD TypeNumber = 4;

const wchar_t* const Blanks = L" \t\n\v\f\r";
const wchar_t* const HiveFormat = L"Windows Registry Editor Version 5.00";

struct Value
{
    DWORD type;
    std::vector<BYTE> data;
};

} // namespace

struct RegistryKey
{
    std::vector<std::wstring> lines; // parsed when a value is asked for
};

namespace
{

wxString HiveName(HKEY hive)
{
    if (hive == HKEY_LOCAL_MACHINE)
        return L"HKEY_LOCAL_MACHINE";
    return hive == HKEY_CURRENT_USER ? wxString(L"HKEY_CURRENT_USER") : wxString();
}

// In UTF-8, or in what its byte-order mark says; text of ASCII alone needs no conversion.
std::wstring Decode(const std::string& bytes)
{
    const bool isAscii =
        std::all_of(bytes.begin(), bytes.end(),
                    [](char byte) { return static_cast<unsigned char>(byte) < 0x80; });
    if (isAscii)
        return {bytes.begin(), bytes.end()};
    return wxString(bytes.data(), wxConvAuto(), bytes.size()).ToStdWstring();
}

std::wstring ReadHive(HKEY hive)
{
    const wxString folder =
        hive == HKEY_LOCAL_MACHINE ? GetMachineDataFolder() : GetUserDataFolder();
    const wxString path = folder + L"/registry/" + HiveName(hive) + L".reg";
    std::string bytes;
    return ReadFileBytes(path.utf8_string(), bytes) ? Decode(bytes) : std::wstring();
}

void AppendUnit(std::vector<BYTE>& data, unsigned unit)
{
    data.push_back(static_cast<BYTE>(unit & 0xFF));
    data.push_back(static_cast<BYTE>((unit >> 8) & 0xFF));
}

// UTF-16LE, as the registry stores text, with its terminating NUL.
std::vector<BYTE> StoredText(const std::wstring& text)
{
    std::vector<BYTE> data;
    for (const wchar_t character : text)
    {
        const auto code = static_cast<unsigned>(character);
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
bool TakeQuoted(std::wstring& rest, std::wstring& text)
{
    if (rest.empty() || rest.front() != L'"')
        return false;
    for (size_t i = 1; i < rest.length(); ++i)
    {
        if (rest[i] == L'"')
        {
            rest.erase(0, i + 1);
            return true;
        }
        if (rest[i] == L'\\' && i + 1 < rest.length())
            ++i;
        text += rest[i];
    }
    return false;
}

// Splits a line of the form "Name"=data or @=data; false when it is not of it.
bool SplitLine(std::wstring line, std::wstring& name, std::wstring& data)
{
    name.clear();
    if (!line.empty() && line.front() == L'@')
        line.erase(0, 1);
    else if (!TakeQuoted(line, name))
        return false;
    const size_t sign = std::min(line.find_first_not_of(Blanks), line.length());
    if (sign == line.length() || line[sign] != L'=')
        return false;
    const size_t begin = std::min(line.find_first_not_of(Blanks, sign + 1), line.length());
    data.assign(line, begin, line.find_last_not_of(Blanks) + 1 - begin);
    return true;
}

// Sets the value from its data in a line, or removes it; data of another form changes nothing.
void ParseData(std::wstring data, std::optional<Value>& value)
{
    Value parsed{TypeText, {}};
    std::wstring text;
    if (data == L"-")
        value.reset();
    else if (TakeQuoted(data, text))
        value = Value{TypeText, StoredText(text)};
    else if (data.compare(0, 3, L"hex") == 0 && ParseBytes(data, parsed))
        value = parsed;
    else if (data.compare(0, 6, L"dword:") == 0 && ParseNumber(data, parsed))
        value = parsed;
}

// The lines of a hive without the blanks around them; empty ones are left out. Most lines are
// passed over, so one costs no more than a look at its characters.
class Lines
{
  public:
    explicit Lines(std::wstring text) : m_text(std::move(text))
    {
        SkipLineEnds();
    }

    // A line of bytes that ends in a backslash goes on in the next one.
    bool Next(std::wstring& line)
    {
        line.clear();
        if (!HasMore())
            return false;
        Append(line);
        while (HasMore() && !line.empty() && line.back() == L'\\' &&
               line.find(L"=hex") != std::wstring::npos)
        {
            line.pop_back();
            Append(line);
        }
        return true;
    }

  private:
    bool HasMore() const
    {
        return m_next < m_text.length();
    }

    void SkipLineEnds()
    {
        m_next = std::min(m_text.find_first_not_of(L'\n', m_next), m_text.length());
    }

    void Append(std::wstring& line)
    {
        const size_t end = std::min(m_text.find(L'\n', m_next), m_text.length());
        const size_t first = std::min(m_text.find_first_not_of(Blanks, m_next), end);
        if (first < end)
            line.append(m_text, first, m_text.find_last_not_of(Blanks, end - 1) - first + 1);
        m_next = end;
        SkipLineEnds();
    }

    std::wstring m_text;
    size_t m_next = 0;
};

bool IsSameLetter(wchar_t left, wchar_t right)
{
    return left == right ||
           std::towlower(static_cast<wint_t>(left)) == std::towlower(static_cast<wint_t>(right));
}

// The number of characters with which both texts begin, in any letter case.
size_t CommonLength(std::wstring_view left, std::wstring_view right)
{
    const auto [end, _] =
        std::mismatch(left.begin(), left.end(), right.begin(), right.end(), IsSameLetter);
    return static_cast<size_t>(end - left.begin());
}

bool IsSameName(std::wstring_view left, std::wstring_view right)
{
    return left.length() == right.length() && CommonLength(left, right) == left.length();
}

bool IsBelow(std::wstring_view path, std::wstring_view parent)
{
    return path.length() > parent.length() && path[parent.length()] == L'\\' &&
           CommonLength(path, parent) == parent.length();
}

// The path of a key's line, hive name first: empty when the line is not whole.
std::wstring_view KeyPath(std::wstring_view line, bool isRemoval)
{
    const size_t bracket = line.rfind(L']');
    const size_t begin = isRemoval ? 2 : 1;
    return bracket == std::wstring_view::npos ? L"" : line.substr(begin, bracket - begin);
}

// The key of that full path in the hive's text, or none.
std::unique_ptr<RegistryKey> FindKey(std::wstring hive, const std::wstring& wanted)
{
    Lines lines(std::move(hive));
    std::wstring line;
    if (!lines.Next(line) || line != HiveFormat)
        return nullptr;
    std::unique_ptr<RegistryKey> key;
    bool isInKey = false;
    while (lines.Next(line))
    {
        if (line.empty() || line.front() != L'[')
        {
            if (isInKey)
                key->lines.push_back(line);
            continue;
        }
        const bool isRemoval = line.compare(0, 2, L"[-") == 0;
        const std::wstring_view path = KeyPath(line, isRemoval);
        const bool isWanted = IsSameName(path, wanted);
        isInKey = isWanted && !isRemoval;
        if (isRemoval && (isWanted || IsBelow(wanted, path)))
            key.reset();
        else if (!isRemoval && !key && (isInKey || IsBelow(path, wanted)))
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
    std::unique_ptr<RegistryKey> found =
        FindKey(ReadHive(hive), (name + L"\\" + path).ToStdWstring());
    if (!found)
        return ERROR_FILE_NOT_FOUND;
    *key = found.release(); // the caller's until RegCloseKey
    return ERROR_SUCCESS;
}

LSTATUS RegQueryValueExW(HKEY key, LPCWSTR name, DWORD* /*reserved*/, DWORD* type, BYTE* data,
                         DWORD* size)
{
    std::optional<Value> found;
    std::wstring lineName;
    std::wstring lineData;
    for (const std::wstring& line : key->lines)
    {
        if (SplitLine(line, lineName, lineData) && IsSameName(lineName, name))
            ParseData(lineData, found);
    }
    if (!found)
        return ERROR_FILE_NOT_FOUND;
    const Value& value = *found;
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

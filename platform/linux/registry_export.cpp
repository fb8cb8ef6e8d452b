#include "platform/linux/registry_export.h"

#include <wx/convauto.h>
#include <wx/string.h>

#include <cstdlib>
#include <cstring>

namespace
{

constexpr DWORD TypeText = 1;
constexpr DWORD TypeExpandableText = 2;
constexpr DWORD TypeBinary = 3;
constexpr DWORD TypeNumber = 4;

// The text after a prefix, which is compared ignoring case; null if the text does not begin with
// it.
const char* After(const std::string& beginning, const char* text)
{
    const bool begins = strncasecmp(text, beginning.c_str(), beginning.length()) == 0;
    return begins ? text + beginning.length() : nullptr;
}

// Where the next line begins; the end of the text if there is none.
const char* NextLine(const char* text)
{
    const char* end = std::strchr(text, '\n');
    return end ? end + 1 : text + std::strlen(text);
}

// Text up to the closing quote; each backslash and quote in it has a backslash before it.
std::vector<BYTE> ReadText(const char* at)
{
    std::string text;
    for (; *at != '"' && *at != '\0'; ++at)
    {
        if (*at == '\\' && at[1] != '\0')
            ++at;
        text += *at;
    }
    const wxCharBuffer bytes =
        wxString(text.data(), wxConvAuto(), text.length()).mb_str(wxMBConvUTF16LE());
    return {bytes.data(), bytes.data() + bytes.length()};
}

// Bytes separated by commas; after a comma, a backslash continues them on the next line.
std::vector<BYTE> ReadBytes(const char* at)
{
    std::vector<BYTE> bytes;
    char* end = nullptr;
    for (auto byte = std::strtoul(at, &end, 16); end != at; byte = std::strtoul(at, &end, 16))
    {
        bytes.push_back(static_cast<BYTE>(byte));
        at = end + std::strspn(end, ",\\");
    }
    return bytes;
}

// The editor leaves out the NUL at the end of a text, and adds one to a text given as bytes that
// lacks it.
RegistryValue Terminated(RegistryValue value)
{
    std::vector<BYTE>& data = value.data;
    const bool isText = value.type == TypeText || value.type == TypeExpandableText;
    const bool hasNul = data.size() > 1 && data.back() == 0 && data[data.size() - 2] == 0;
    if (isText && data.size() % 2 == 0 && !hasNul)
        data.insert(data.end(), 2, 0);
    return value;
}

std::optional<RegistryValue> ReadValue(const char* data)
{
    char* end = nullptr;
    if (const char* text = After("\"", data))
        return Terminated({TypeText, ReadText(text)});
    if (const char* bytes = After("hex:", data))
        return RegistryValue{TypeBinary, ReadBytes(bytes)};
    if (const char* digits = After("hex(", data))
    {
        const auto type = static_cast<DWORD>(std::strtoul(digits, &end, 16));
        return Terminated({type, ReadBytes(end + std::strspn(end, "):"))});
    }
    if (const char* digits = After("dword:", data))
    {
        RegistryValue value{TypeNumber, {}};
        const unsigned long number = std::strtoul(digits, &end, 16);
        for (unsigned shift = 0; shift < 32; shift += 8)
            value.data.push_back(static_cast<BYTE>(number >> shift));
        return value;
    }
    return {};
}

} // namespace

std::string DecodeRegistryExport(std::string bytes)
{
    if (!bytes.empty() && (bytes[0] & 0x80) != 0) // a byte-order mark
        bytes = wxString(bytes.data(), wxConvAuto(), bytes.length()).utf8_string();
    return After("Windows Registry Editor Version 5.00", bytes.c_str()) ? bytes : std::string();
}

const char* FindRegistryKey(const std::string& hive, const std::string& path)
{
    const std::string wanted = "[" + path;
    const char* found = nullptr;
    for (const char* line = hive.c_str(); *line != '\0'; line = NextLine(line))
    {
        const char* rest = After(wanted, line);
        if (rest && *rest == ']')
            return NextLine(rest);
        if (rest && *rest == '\\')
            found = hive.c_str() + hive.length();
    }
    return found;
}

std::optional<RegistryValue> FindRegistryValue(const char* lines, const std::string& name)
{
    const std::string wanted = "\"" + name + "\"=";
    for (const char* line = lines; *line != '\0' && *line != '['; line = NextLine(line))
        if (const char* data = After(wanted, line))
            return ReadValue(data);
    return {};
}

// Profile files (.ini): one key is read or changed; every other byte of the file stays.
//
// The text is processed in units of one byte, or of two after a UTF-16LE byte-order mark, so that
// text in any encoding is preserved. Of a repeated section or key, the first counts.
#include "platform/linux/native_path.h"
#include "platform/regular_file.h"
#include "platform/system.h"

#include <wx/string.h>

#include <algorithm>
#include <string>

namespace
{

using Units = std::u16string;

const Units LineEnd = u"\r\n";
constexpr size_t NotFound = Units::npos;

struct Text
{
    Units units;
    bool isUtf16 = false;
    bool hasUtf8Mark = false;
    std::string rest; // half a unit at the end, if any
};

Text Decode(const std::string& bytes)
{
    Text text;
    text.isUtf16 = bytes.compare(0, 2, "\xFF\xFE") == 0;
    text.hasUtf8Mark = bytes.compare(0, 3, "\xEF\xBB\xBF") == 0;
    const auto byteAt = [&](size_t i)
    {
        return static_cast<unsigned char>(bytes[i]);
    };
    if (!text.isUtf16)
    {
        for (size_t i = text.hasUtf8Mark ? 3 : 0; i < bytes.size(); ++i)
            text.units += static_cast<char16_t>(byteAt(i));
        return text;
    }
    size_t i = 2;
    for (; i + 1 < bytes.size(); i += 2)
        text.units += static_cast<char16_t>(byteAt(i) | byteAt(i + 1) << 8);
    text.rest = bytes.substr(std::min(i, bytes.size()));
    return text;
}

std::string Encode(const Text& text)
{
    std::string bytes = text.isUtf16 ? "\xFF\xFE" : text.hasUtf8Mark ? "\xEF\xBB\xBF" : "";
    for (const char16_t unit : text.units)
    {
        bytes += static_cast<char>(unit & 0xFF);
        if (text.isUtf16)
            bytes += static_cast<char>(unit >> 8);
    }
    return bytes + text.rest;
}

// The caller's string in the units of the file.
Units ToUnits(LPCWSTR string, bool isUtf16)
{
    Units units;
    if (isUtf16)
    {
        const wxCharBuffer bytes = wxString(string).mb_str(wxMBConvUTF16LE());
        for (size_t i = 0; i + 1 < bytes.length(); i += 2)
            units += static_cast<char16_t>(static_cast<unsigned char>(bytes[i]) |
                                           static_cast<unsigned char>(bytes[i + 1]) << 8);
        return units;
    }
    for (const char byte : wxString(string).utf8_string())
        units += static_cast<char16_t>(static_cast<unsigned char>(byte));
    return units;
}

wxString FromUnits(const Text& text, size_t begin, size_t end)
{
    Text part = text;
    part.units = text.units.substr(begin, end - begin);
    part.hasUtf8Mark = false;
    part.rest.clear();
    const std::string bytes = Encode(part);
    if (text.isUtf16)
        return wxString(bytes.data() + 2, wxMBConvUTF16LE(), bytes.size() - 2);
    const wxString utf8 = wxString::FromUTF8(bytes.data(), bytes.size());
    return utf8.empty() ? wxString::From8BitData(bytes.data(), bytes.size()) : utf8;
}

bool IsBlank(char16_t unit)
{
    return unit == ' ' || unit == '\t' || unit == '\r';
}

char16_t Fold(char16_t unit)
{
    return unit >= 'A' && unit <= 'Z' ? static_cast<char16_t>(unit + 32) : unit;
}

// One line of the text: its content without surrounding white space, and where the next one begins.
struct Line
{
    size_t begin;
    size_t end;
    size_t next;
};

Line LineAt(const Units& units, size_t start)
{
    const size_t lineFeed = units.find(u'\n', start);
    Line line{start, std::min(lineFeed, units.size()),
              lineFeed == NotFound ? units.size() : lineFeed + 1};
    while (line.begin < line.end && IsBlank(units[line.begin]))
        ++line.begin;
    while (line.end > line.begin && IsBlank(units[line.end - 1]))
        --line.end;
    return line;
}

bool Equals(const Units& units, size_t begin, size_t end, const Units& name)
{
    while (end > begin && IsBlank(units[end - 1]))
        --end;
    return end - begin == name.size() &&
           std::equal(name.begin(), name.end(), units.begin() + static_cast<std::ptrdiff_t>(begin),
                      [](char16_t left, char16_t right) { return Fold(left) == Fold(right); });
}

// Where a key is, or where it has to be added.
struct Place
{
    bool hasSection = false;
    bool hasKey = false;
    size_t valueBegin = 0; // after the equals sign, if there is one
    size_t valueEnd = 0;   // without white space and line end
    bool hasEqualsSign = false;
    size_t addAt = 0; // after the section's last non-empty line
};

Place Find(const Units& units, const Units& section, const Units& key)
{
    Place place;
    for (size_t start = 0; start < units.size();)
    {
        const Line line = LineAt(units, start);
        start = line.next;
        if (line.begin == line.end)
            continue;
        if (units[line.begin] == '[')
        {
            if (place.hasSection)
                break;
            const size_t bracket = units.rfind(u']', line.end - 1);
            place.hasSection = bracket != NotFound && bracket > line.begin &&
                               Equals(units, line.begin + 1, bracket, section);
        }
        if (!place.hasSection)
            continue;
        place.addAt = line.next;
        const size_t sign = std::min(units.find(u'=', line.begin), line.end);
        if (units[line.begin] == '[' || units[line.begin] == ';' ||
            !Equals(units, line.begin, sign, key))
            continue;
        place.hasKey = true;
        place.hasEqualsSign = sign < line.end;
        place.valueBegin = place.hasEqualsSign ? sign + 1 : line.end;
        place.valueEnd = line.end;
        break;
    }
    return place;
}

void SkipBlanks(const Units& units, size_t& begin, size_t end)
{
    while (begin < end && IsBlank(units[begin]))
        ++begin;
}

struct ProfilePath
{
    explicit ProfilePath(const wxString& path)
        : directory(path.BeforeLast('/'), Links::Follow), name(path.AfterLast('/'))
    {
    }

    explicit ProfilePath(LPCWSTR path) : ProfilePath(wxString::FromUTF8(NativePath(path)))
    {
    }

    const PinnedDirectory directory;
    const wxString name;
};

// Returns false for a read-only file, even for root; creates a missing file.
bool OpenForWriting(LPCWSTR path, RegularFile& file)
{
    const ProfilePath profile(path);
    const DWORD attributes = GetFileAttributesW(path);
    if (attributes == INVALID_FILE_ATTRIBUTES)
        return file.CreateNew(profile.directory, profile.name) == RegularFile::Status::Open;
    return (attributes & FILE_ATTRIBUTE_READONLY) == 0 &&
           file.OpenForUpdate(profile.directory, profile.name) == RegularFile::Status::Open;
}

// Inserts lines, after a line end if the text before them lacks one.
void Insert(Units& units, size_t at, const Units& lines)
{
    const bool needsEnd = at > 0 && units[at - 1] != '\n';
    units.insert(at, (needsEnd ? LineEnd : Units()) + lines + LineEnd);
}

} // namespace

BOOL WritePrivateProfileStringW(LPCWSTR section, LPCWSTR key, LPCWSTR value, LPCWSTR path)
{
    RegularFile file;
    std::string bytes;
    if (!OpenForWriting(path, file) || !file.Read(bytes))
        return 0;
    Text text = Decode(bytes);
    const Units newValue = ToUnits(value, text.isUtf16);
    const Units keyName = ToUnits(key, text.isUtf16);
    const Units sectionName = ToUnits(section, text.isUtf16);
    const Place place = Find(text.units, sectionName, keyName);
    if (place.hasKey)
    {
        const size_t nextLine = LineAt(text.units, place.valueEnd).next;
        text.units.replace(place.valueBegin, nextLine - place.valueBegin,
                           (place.hasEqualsSign ? Units() : Units(u"=")) + newValue + LineEnd);
    }
    else if (place.hasSection)
        Insert(text.units, place.addAt, keyName + u"=" + newValue);
    else
        Insert(text.units, text.units.size(),
               u"[" + sectionName + u"]" + LineEnd + keyName + u"=" + newValue);
    const std::string changed = Encode(text);
    return changed == bytes || file.Rewrite(bytes, changed) ? 1 : 0;
}

DWORD GetPrivateProfileStringW(LPCWSTR section, LPCWSTR key, LPCWSTR defaultValue, LPWSTR buffer,
                               DWORD capacity, LPCWSTR path)
{
    std::string bytes;
    wxString value = defaultValue;
    const ProfilePath profile(path);
    RegularFile file;
    if (file.OpenForReading(profile.directory, profile.name) == RegularFile::Status::Open &&
        file.Read(bytes))
    {
        const Text text = Decode(bytes);
        Place place = Find(text.units, ToUnits(section, text.isUtf16), ToUnits(key, text.isUtf16));
        SkipBlanks(text.units, place.valueBegin, place.valueEnd);
        if (place.hasKey)
            value = FromUnits(text, place.valueBegin, place.valueEnd);
    }
    const size_t length = std::min<size_t>(value.length(), capacity - 1);
    std::copy_n(value.wc_str(), length, buffer);
    buffer[length] = L'\0';
    return static_cast<DWORD>(length);
}

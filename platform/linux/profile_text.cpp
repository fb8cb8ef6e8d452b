#include "platform/linux/profile_text.h"

#include <wx/string.h>

#include <algorithm>

namespace
{

const std::wstring Blanks = L" \t\r";

std::wstring Trim(const std::wstring& text)
{
    const size_t begin = std::min(text.find_first_not_of(Blanks), text.size());
    return text.substr(begin, text.find_last_not_of(Blanks) + 1 - begin);
}

bool IsSame(const std::wstring& left, const std::wstring& right)
{
    return wxString(Trim(left)).CmpNoCase(right) == 0;
}

} // namespace

ProfileText::ProfileText(const std::string& bytes)
    : start(bytes.compare(0, 2, "\xFF\xFE") == 0       ? "\xFF\xFE"
            : bytes.compare(0, 3, "\xEF\xBB\xBF") == 0 ? "\xEF\xBB\xBF"
                                                       : ""),
      width(start.size() == 2 ? 2 : 1)
{
    const auto byteAt = [&](size_t i)
    {
        return static_cast<wchar_t>(static_cast<unsigned char>(bytes[i]));
    };
    size_t i = start.size();
    for (; i + width <= bytes.size(); i += width)
        text += width == 1 ? byteAt(i) : static_cast<wchar_t>(byteAt(i) | byteAt(i + 1) << 8);
    end = bytes.substr(i);
}

std::string ProfileText::Bytes() const
{
    std::string bytes = start;
    for (const wchar_t character : text)
    {
        bytes += static_cast<char>(character);
        if (width == 2)
            bytes += static_cast<char>(character >> 8);
    }
    return bytes + end;
}

ProfilePlace FindInProfile(const std::wstring& text, const std::wstring& section,
                           const std::wstring& key)
{
    ProfilePlace place;
    for (size_t begin = 0, next = 0; begin < text.size(); begin = next)
    {
        const size_t lineFeed = text.find(L'\n', begin);
        next = lineFeed == std::wstring::npos ? text.size() : lineFeed + 1;
        const std::wstring line = Trim(text.substr(begin, std::min(lineFeed, text.size()) - begin));
        if (line.empty())
            continue;
        if (line[0] == L'[')
        {
            if (place.hasSection)
                break;
            const size_t bracket = line.rfind(L']');
            place.hasSection =
                bracket != std::wstring::npos && IsSame(line.substr(1, bracket - 1), section);
        }
        if (!place.hasSection)
            continue;
        const size_t sign = std::min(line.find(L'='), line.size());
        place.hasKey = line[0] != L'[' && line[0] != L';' && IsSame(line.substr(0, sign), key);
        place.begin = place.hasKey ? begin : next;
        place.next = next;
        if (place.hasKey)
        {
            place.value = Trim(line.substr(std::min(sign + 1, line.size())));
            break;
        }
    }
    return place;
}

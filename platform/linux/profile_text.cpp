#include "platform/linux/profile_text.h"

#include <algorithm>

ProfileText::ProfileText(const std::string& bytes)
    : width(bytes.compare(0, 2, "\xFF\xFE") == 0 ? 2 : 1), end(bytes, bytes.size() / width * width)
{
    const auto byteAt = [&](size_t i)
    {
        return static_cast<wchar_t>(static_cast<unsigned char>(bytes[i]));
    };
    for (size_t i = 0; i + width <= bytes.size(); i += width)
        text += width == 1 ? byteAt(i) : static_cast<wchar_t>(byteAt(i) | byteAt(i + 1) << 8);
}

std::string ProfileText::Bytes() const
{
    std::string bytes;
    for (const wchar_t character : text.ToStdWstring())
    {
        bytes += static_cast<char>(character);
        if (width == 2)
            bytes += static_cast<char>(character >> 8);
    }
    return bytes + end;
}

ProfilePlace FindInProfile(const wxString& text, const wxString& section, const wxString& key)
{
    const wxString byteOrderMarks = L"\xFEFF\xEF\xBB\xBF";
    ProfilePlace place;
    for (size_t begin = text.find_first_not_of(byteOrderMarks), next = 0; begin < text.length();
         begin = next)
    {
        next = std::min(text.find('\n', begin), text.length() - 1) + 1;
        const wxString line = text.substr(begin, next - begin).Trim().Trim(false);
        if (line.empty())
            continue;
        if (line[0] == '[')
        {
            if (place.hasSection)
                break;
            place.hasSection =
                line.Mid(1).BeforeLast(']').Trim().Trim(false).CmpNoCase(section) == 0;
        }
        if (!place.hasSection)
            continue;
        place.hasKey =
            line[0] != '[' && line[0] != ';' && line.BeforeFirst('=').Trim().CmpNoCase(key) == 0;
        place.begin = place.hasKey ? begin : next;
        place.next = next;
        if (place.hasKey)
        {
            place.value = line.AfterFirst('=').Trim(false);
            break;
        }
    }
    return place;
}

#include "platform/unicode_text.h"

namespace
{

constexpr bool WideCharIsUtf16 = sizeof(wchar_t) == 2;

bool IsHigh(unsigned long unit)
{
    return unit >= 0xD800 && unit < 0xDC00;
}

bool IsLow(unsigned long unit)
{
    return unit >= 0xDC00 && unit < 0xE000;
}

// The position of the first wide character, from the given start, that is not part of Unicode text.
size_t FindOffender(const wchar_t* text, size_t length, size_t start)
{
    for (size_t i = start; i < length; ++i)
    {
        const auto unit = static_cast<unsigned long>(text[i]);
        if (unit < 0xD800)
            continue;
        if (WideCharIsUtf16 && IsHigh(unit) && i + 1 < length &&
            IsLow(static_cast<unsigned long>(text[i + 1])))
            ++i;
        else if (IsHigh(unit) || IsLow(unit) || unit > 0x10FFFF)
            return i;
    }
    return length;
}

} // namespace

bool IsUnicodeText(const wxString& text)
{
    return FindOffender(text.wc_str(), text.length(), 0) == text.length();
}

wxString FromUtf16Bytes(const unsigned char* bytes, size_t count)
{
    wxString text;
    unsigned long high = 0;
    for (size_t i = 0; i + 1 < count; i += 2)
    {
        const unsigned long unit = bytes[i] | static_cast<unsigned long>(bytes[i + 1]) << 8;
        if (unit == 0)
            break;
        if (!WideCharIsUtf16 && high != 0 && IsLow(unit))
        {
            text.RemoveLast();
            text += static_cast<wchar_t>(0x10000 + ((high - 0xD800) << 10) + (unit - 0xDC00));
            high = 0;
            continue;
        }
        text += static_cast<wchar_t>(unit);
        high = IsHigh(unit) ? unit : 0;
    }
    return text;
}

wxString ToOneLine(const wxString& text)
{
    wxString result = text;
    for (size_t i = 0; (i = FindOffender(result.wc_str(), result.length(), i)) < result.length();)
        result[i] = wxUniChar(0xFFFD);
    for (auto character = result.begin(); character != result.end(); ++character)
    {
        const auto code = static_cast<unsigned long>((*character).GetValue());
        if ((code < 0x20 && code != '\t') || (code >= 0x7F && code < 0xA0) || code == 0x2028 ||
            code == 0x2029)
            *character = wxUniChar(0xFFFD);
    }
    return result;
}

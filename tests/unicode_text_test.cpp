// What counts as text, in UTF-16 as the registry has it.
#include "platform/unicode_text.h"
#include "store/xml_document.h"

#include <gtest/gtest.h>

namespace
{

using Units = std::vector<unsigned>;

wxString TextOf(const Units& units)
{
    std::vector<unsigned char> bytes;
    for (const unsigned unit : units)
        bytes.insert(bytes.end(),
                     {static_cast<unsigned char>(unit), static_cast<unsigned char>(unit >> 8)});
    bytes.push_back('x'); // half a unit
    return FromUtf16Bytes(bytes.data(), bytes.size());
}

TEST(UnicodeText, ALoneSurrogateIsNotText)
{
    const Units pairs = {'a', 0xD834, 0xDD1E, 'b', 0xDBFF, 0xDFFF, 0xD800, 0xDC00, 0, 'c'};
    EXPECT_EQ(wxString::FromUTF8("a\U0001D11Eb\U0010FFFF\U00010000"), TextOf(pairs));
    for (const Units& units : {pairs, {0xD7FF, 0xE000, 0xFFFD}, {0x20, '\t', '\r', '\n'}})
        EXPECT_TRUE(IsXmlText(TextOf(units))) << std::hex << units[0];
    for (const Units& units : {Units{0xD834, 'a'}, {0xDC00, 0xD800}, {0xDFFF}, {0xD834, 0xE000}})
        EXPECT_FALSE(IsUnicodeText(TextOf(units)) || IsXmlText(TextOf(units))) << units[0];
    for (const unsigned unit : {0x1FU, 1U, 8U, 0xBU, 0xFFFEU, 0xFFFFU})
        EXPECT_TRUE(IsUnicodeText(TextOf({unit})) && !IsXmlText(TextOf({unit}))) << unit;
    EXPECT_EQ(wxString::FromUTF8("\uFFFD~\uFFFD"), ToOneLine(TextOf({0x1F, '~', 0xD834})));
}

} // namespace

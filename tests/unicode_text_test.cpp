// What counts as text, in UTF-16 as the registry has it.
#include "platform/unicode_text.h"
#include "store/xml_document.h"

#include <gtest/gtest.h>

namespace
{

using Units = std::u16string;

wxString TextOf(const Units& units)
{
    const Units more = units + u'x'; // of which half is read
    return FromUtf16Bytes(reinterpret_cast<const unsigned char*>(more.data()),
                          2 * units.size() + 1);
}

TEST(UnicodeText, ALoneSurrogateIsNotText)
{
    const Units pairs = {'a', 0xD834, 0xDD1E, 'b', 0xDBFF, 0xDFFF, 0xD800, 0xDC00, 0, 'c'};
    EXPECT_EQ(wxString::FromUTF8("a\U0001D11Eb\U0010FFFF\U00010000"), TextOf(pairs));
    for (const Units& units : {pairs, {0xD7FF, 0xE000, 0xFFFD}, {0x20, '\t', '\r', '\n'}})
        EXPECT_TRUE(IsXmlText(TextOf(units))) << std::hex << units[0];
    for (const Units& units : {Units{0xD834, 'a'}, {0xDC00, 0xD800}, {0xDFFF}, {0xD834, 0xE000}})
        EXPECT_FALSE(IsUnicodeText(TextOf(units)) || IsXmlText(TextOf(units))) << units[0];
    for (const char16_t unit : Units{0x1F, 1, 8, 0xB, 0xFFFE, 0xFFFF})
        EXPECT_TRUE(IsUnicodeText(TextOf({unit})) && !IsXmlText(TextOf({unit}))) << unit;
    EXPECT_EQ(wxString::FromUTF8("\uFFFD~\uFFFD"), ToOneLine(TextOf({0x1F, '~', 0xD834})));
}

} // namespace

#include "store/xml_text.h"

#include "platform/unicode_text.h"

#include <algorithm>

bool IsXmlText(const wxString& text)
{
    if (!IsUnicodeText(text))
        return false;
    return std::none_of(text.begin(), text.end(),
                        [](wxUniChar character)
                        {
                            const auto code = character.GetValue();
                            return (code < 0x20 && code != '\t' && code != '\n' && code != '\r') ||
                                   code == 0xFFFE || code == 0xFFFF;
                        });
}

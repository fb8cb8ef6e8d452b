// Any job preset text and any two folders, which are the input's first two lines: only the folder's
// text in template paths changes.
#include "migrate/preset_text.h"

#include "fuzz/fuzzing.h"
#include "store/xml_document.h"

namespace
{

std::wstring TakeFolder(std::wstring& text)
{
    std::wstring line = text.substr(0, text.find(L'\n'));
    text.erase(0, line.size() + 1);
    return line.erase(line.find_last_not_of(L'/') + 1);
}

// The text with every path in the folder moved, computed one character at a time.
std::wstring Moved(const std::wstring& text, const std::wstring& from, const std::wstring& to)
{
    const std::wstring search = L"ORXImposeTemplate\">\"";
    std::wstring moved;
    for (size_t i = 0; i < text.size();)
    {
        const size_t end = i + search.size() + from.size();
        const bool isPath = text.compare(i, end - i, search + from) == 0 && end < text.size() &&
                            (text[end] == L'/' || text[end] == L'"');
        moved += isPath ? search + to : text.substr(i, 1);
        i = isPath ? end : i + 1;
    }
    return moved;
}

} // namespace

void Try(const std::string& input)
{
    std::wstring text = wxString::FromUTF8(input.data(), input.size()).ToStdWstring();
    const std::wstring from = TakeFolder(text);
    const std::wstring to = TakeFolder(text);
    wxString preset = text;
    MovePresetPaths(preset, from + L"/", to);
    const bool canMove = !from.empty() && !to.empty() && IsXmlText(to);
    Check(preset == (canMove ? Moved(text, from, to) : text), "only the paths in the folder move");
}

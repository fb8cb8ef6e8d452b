// Any job preset text and any two folders, which are the input's first two lines: only the folder's
// text in template paths changes, and moving back restores the text.
#include "migrate/preset_text.h"

#include "fuzz/fuzzing.h"
#include "store/xml_text.h"

namespace
{

const std::wstring Key = L"ORXImposeTemplate";
const std::wstring SearchText = Key + L"\">\"";

std::wstring TakeLine(std::wstring& text)
{
    const std::wstring line = text.substr(0, text.find(L'\n'));
    text.erase(0, line.size() + 1);
    return line;
}

std::wstring WithoutFinalSeparators(std::wstring folder)
{
    return folder.erase(folder.find_last_not_of(L'/') + 1);
}

// The text with every path in the folder moved, computed one character at a time.
std::wstring Moved(const std::wstring& text, const std::wstring& from, const std::wstring& to)
{
    std::wstring moved;
    const std::wstring path = SearchText + from;
    for (size_t i = 0; i < text.size();)
    {
        const size_t end = i + path.size();
        const bool isPath = text.compare(i, path.size(), path) == 0 && end < text.size() &&
                            (text[end] == L'/' || text[end] == L'"');
        moved += isPath ? SearchText + to : text.substr(i, 1);
        i = isPath ? end : i + 1;
    }
    return moved;
}

bool LiesIn(const std::wstring& folder, const std::wstring& outer)
{
    return (folder + L"/").compare(0, outer.size() + 1, outer + L"/") == 0;
}

// Whether the folder can exist on a disk, and does not end with what could be the beginning of a
// search text.
bool IsPlain(const std::wstring& folder)
{
    return IsXmlText(folder) && folder.find(L'"') == std::wstring::npos &&
           !wxString(folder).EndsWith(Key);
}

} // namespace

void Try(const std::string& input)
{
    std::wstring text = wxString::FromUTF8(input.data(), input.size()).ToStdWstring();
    const std::wstring from = TakeLine(text);
    const std::wstring to = TakeLine(text);
    const std::wstring left = WithoutFinalSeparators(from);
    const std::wstring entered = WithoutFinalSeparators(to);
    const bool canMove = !left.empty() && !entered.empty() && IsXmlText(entered);

    wxString preset = text;
    MovePresetPaths(preset, from, to);
    const std::wstring upgraded = canMove ? Moved(text, left, entered) : text;
    Check(preset == upgraded, "only the paths in the folder move");
    if (!canMove || !IsPlain(left) || !IsPlain(entered) || LiesIn(left, entered) ||
        LiesIn(entered, left))
        return;
    Check(MovePresetPaths(preset, from, to) == 0 && preset == upgraded,
          "a second upgrade changes nothing");
    MovePresetPaths(preset, to, from);
    Check(preset == text || Moved(text, entered, left) != text, "a downgrade restores the text");
}

// Arbitrary bytes as a profile file: a write changes one line and no other byte, and a read returns the value.
#include "fuzz/fuzzing.h"
#include "platform/system.h"

#include <algorithm>
#include <array>

namespace
{

constexpr LPCWSTR Section = L".ShellClassInfo";
constexpr LPCWSTR Value = L".\\[_ORX_HotFolder_]\\hf_folder.ico";
// The number of line feeds between begin and end, in UTF-16 or in bytes.
int CountLineFeeds(const std::string& bytes, size_t begin, size_t end)
{
    const size_t unit = bytes.compare(0, 2, "\xFF\xFE") == 0 ? 2 : 1;
    int count = 0;
    for (size_t i = begin - begin % unit; i < end; i += unit)
        count += bytes.compare(i, unit, "\n\0", unit) == 0 ? 1 : 0;
    return count;
}

void CheckOneLineChanged(const std::string& before, const std::string& after)
{
    const size_t shorter = std::min(before.size(), after.size());
    size_t same = 0;
    while (same < shorter && before[same] == after[same])
        ++same;
    size_t rest = 0;
    while (rest < shorter - same && before[before.size() - 1 - rest] == after[after.size() - 1 - rest])
        ++rest;
    Check(CountLineFeeds(before, same, before.size() - rest) == 0, "only one line loses text");
    Check(CountLineFeeds(after, same, after.size() - rest) <= 3, "at most a line end, a section and a key are added");
}

} // namespace

void Try(const std::string& input)
{
    static const std::string path = NewFile();
    const std::wstring widePath(path.begin(), path.end());
    for (const LPCWSTR key : {L"IconFile", L"IconIndex", L"InfoTip"})
    {
        WriteBytes(path, input);
        const auto write = [&]()
        {
            return WritePrivateProfileStringW(Section, key, Value, widePath.c_str()) != 0;
        };
        Check(write(), "a writable file is written");
        const std::string after = ReadBytes(path);
        CheckOneLineChanged(input, after);

        std::array<wchar_t, 200> read{};
        GetPrivateProfileStringW(Section, key, L"00", read.data(), 200, widePath.c_str());
        Check(std::wstring(read.data()) == Value, "the value is read back");
        Check(write() && ReadBytes(path) == after, "a second write changes nothing");
    }
}

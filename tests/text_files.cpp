#include "tests/text_files.h"

#include <fstream>
#include <sstream>
#include <stdexcept>

Text ReadFile(const std::filesystem::path& path)
{
    std::ostringstream text;
    text << std::ifstream(path, std::ios::binary).rdbuf();
    return text.str();
}

void WriteFile(const std::filesystem::path& path, const Text& text)
{
    std::filesystem::create_directories(path.parent_path());
    if (!(std::ofstream(path, std::ios::binary) << text))
        throw std::runtime_error("cannot write " + path.string());
}

Text Replaced(Text text, const Text& from, const Text& to)
{
    for (size_t at = text.find(from); at != Text::npos; at = text.find(from, at + to.size()))
        text.replace(at, from.size(), to);
    return text;
}

bool StartsWith(const Text& text, const Text& start)
{
    return text.compare(0, start.size(), start) == 0;
}

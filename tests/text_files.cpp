#include "tests/text_files.h"

#include <fstream>
#include <sstream>
#include <stdexcept>

std::string ReadFile(const std::filesystem::path& path)
{
    std::ifstream file(path, std::ios::binary);
    if (!file || std::filesystem::is_directory(path))
        throw std::runtime_error("cannot read " + path.string());
    std::ostringstream text;
    text << file.rdbuf();
    return text.str();
}

void WriteFile(const std::filesystem::path& path, const std::string& text)
{
    std::filesystem::create_directories(path.parent_path());
    if (!(std::ofstream(path, std::ios::binary) << text))
        throw std::runtime_error("cannot write " + path.string());
}

void ReplaceAll(std::string& text, const std::string& from, const std::string& to)
{
    for (size_t at = text.find(from); at != std::string::npos; at = text.find(from, at + to.size()))
        text.replace(at, from.size(), to);
}

bool StartsWith(const std::string& text, const std::string& start)
{
    return text.compare(0, start.size(), start) == 0;
}

std::string ToUtf16(const std::string& text)
{
    std::string result = "\xFF\xFE";
    for (const char16_t unit :
         std::filesystem::path(text).u16string()) // as the names of files are in UTF-8
        result += {static_cast<char>(unit & 0xFF), static_cast<char>(unit >> 8)};
    return result;
}

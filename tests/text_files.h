// Texts, and files that are read and written whole, byte for byte.
#pragma once

#include <filesystem>
#include <fstream>
#include <map>
#include <sstream>
#include <stdexcept>
#include <string>

namespace fs = std::filesystem;

using Text = std::string;
using Files = std::map<Text, Text>; // place -> text

/// Empty if there is no such file.
inline Text ReadFile(const fs::path& path)
{
    std::ostringstream text;
    text << std::ifstream(path, std::ios::binary).rdbuf();
    return text.str();
}

/// Also creates the directories above the file.
inline void WriteFile(const fs::path& path, const Text& text)
{
    fs::create_directories(path.parent_path());
    if (!(std::ofstream(path, std::ios::binary) << text))
        throw std::runtime_error("cannot write " + path.string());
}

inline Text Replaced(Text text, const Text& from, const Text& to)
{
    for (size_t at = text.find(from); at != Text::npos; at = text.find(from, at + to.size()))
        text.replace(at, from.size(), to);
    return text;
}

inline bool StartsWith(const Text& text, const Text& start)
{
    return text.compare(0, start.size(), start) == 0;
}

// Texts, and files that are read and written whole, byte for byte.
#pragma once

#include <filesystem>
#include <map>
#include <string>

using Text = std::string;
using Files = std::map<Text, Text>; // place -> text

/// Empty if there is no such file.
Text ReadFile(const std::filesystem::path& path);
/// Also creates the directories above the file.
void WriteFile(const std::filesystem::path& path, const Text& text);
Text Replaced(Text text, const Text& from, const Text& to);
bool StartsWith(const Text& text, const Text& start);

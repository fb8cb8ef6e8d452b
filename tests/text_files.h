// Files and texts as the tests handle them: whole, and byte for byte.
#pragma once

#include <filesystem>
#include <string>

/// Throws, with the name, when there is no such file.
std::string ReadFile(const std::filesystem::path& path);
/// Makes the directories above the file as well.
void WriteFile(const std::filesystem::path& path, const std::string& text);
void ReplaceAll(std::string& text, const std::string& from, const std::string& to);
bool StartsWith(const std::string& text, const std::string& start);

/// UTF-8 as UTF-16LE with a byte-order mark; characters beyond U+FFFF are not among it.
std::string ToUtf16(const std::string& text);

// Files and texts as the tests handle them: whole, and byte for byte.
#pragma once

#include <filesystem>
#include <string>

std::string ReadFile(const std::filesystem::path& path);
void WriteFile(const std::filesystem::path& path, const std::string& text);
void ReplaceAll(std::string& text, const std::string& from, const std::string& to);

/// UTF-8 as UTF-16LE with a byte-order mark; characters beyond U+FFFF are not among it.
std::string ToUtf16(const std::string& text);

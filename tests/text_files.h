// Reading and writing whole files, byte for byte.
#pragma once

#include <filesystem>
#include <string>

/// If there is no such file, throws an error with its name.
std::string ReadFile(const std::filesystem::path& path);
/// Also creates the directories above the file.
void WriteFile(const std::filesystem::path& path, const std::string& text);
void ReplaceAll(std::string& text, const std::string& from, const std::string& to);
bool StartsWith(const std::string& text, const std::string& start);

/// Converts UTF-8 to UTF-16LE with a byte-order mark.
std::string ToUtf16(const std::string& text);

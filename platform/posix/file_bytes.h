// Whole files, as the stand-ins read them.
#pragma once

#include <string>

/// Reads the regular file at that path, in UTF-8. False when there is none or it cannot be read;
/// nobody is told.
bool ReadFileBytes(const std::string& path, std::string& bytes);

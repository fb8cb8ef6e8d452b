// Paths as the system calls of this platform take them.
#pragma once

#include <string>

/// The path in UTF-8, whatever the locale, with every backslash turned into a slash.
std::string NativePath(const wchar_t* path);

// The version of the Windows shell.
#pragma once

#include <cstdint>

/// The first shell that takes a folder's settings from Desktop.ini: version 4.72.
constexpr std::uint32_t CustomFolderVersion = 0x00040048;

/// The version of shell32.dll (DllGetVersion), major in the upper 16 bits and minor in the lower; 0
/// if it cannot be determined.
std::uint32_t GetPackedShellVersion();

// A hive in the text form that the registry editor exports.
#pragma once

#include "platform/system.h"

#include <optional>
#include <string>
#include <vector>

struct RegistryValue
{
    DWORD type;
    std::vector<BYTE> data;
};

/// The text, in UTF-8, of an export in UTF-8 or UTF-16; empty if the bytes are not an export.
std::string DecodeRegistryExport(std::string bytes);

/// The first line after a key's line; the end of the text if only a key below it exists; else null.
/// The path begins with the hive's full name. Names of keys and values are ASCII and compared
/// ignoring case.
const char* FindRegistryKey(const std::string& hive, const std::string& path);

/// The value of that name in the lines of a key.
std::optional<RegistryValue> FindRegistryValue(const char* lines, const std::string& name);

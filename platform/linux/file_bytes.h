// Whole files, as the stand-ins read and write them: like the calls that they stand for, they tell
// nobody but the caller when that fails.
#pragma once

#include <string>
#include <sys/types.h>

/// Reads the regular file at that path, in UTF-8. False when there is none or it cannot be read.
/// mode, where given, receives the file's type and permissions.
bool ReadFileBytes(const std::string& path, std::string& bytes, mode_t* mode = nullptr);

/// Makes the bytes the whole content of the file, which need not be there. False when that fails;
/// the file may then be empty.
bool WriteFileBytes(const std::string& path, const std::string& bytes);

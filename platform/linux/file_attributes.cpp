// File attributes where the file system has none: READONLY of a file is its missing write
// permission; every other one, and READONLY of a directory, stands as hexadecimal text in the
// extended attribute in which Wine and Samba keep them.
#include "platform/linux/native_path.h"
#include "platform/system.h"

#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <sys/stat.h>
#include <sys/xattr.h>

namespace
{

const char* const AttributeName = "user.DOSATTRIB";
constexpr mode_t AnyWrite = S_IWUSR | S_IWGRP | S_IWOTH;

bool IsDirectory(const struct stat& status)
{
    return S_ISDIR(status.st_mode);
}

DWORD ReadStored(const std::string& path)
{
    char text[256] = {}; // Samba puts more behind the text and a NUL
    const ssize_t length = getxattr(path.c_str(), AttributeName, text, sizeof text - 1);
    return length > 0 ? static_cast<DWORD>(std::strtoul(text, nullptr, 16)) : 0;
}

bool WriteStored(const std::string& path, DWORD attributes)
{
    if (attributes == 0)
        return removexattr(path.c_str(), AttributeName) == 0 || errno == ENODATA ||
               errno == ENOTSUP;
    char text[16] = {};
    const int length = std::snprintf(text, sizeof text, "0x%x", attributes);
    return setxattr(path.c_str(), AttributeName, text, static_cast<size_t>(length), 0) == 0;
}

mode_t FileModeMask()
{
    static const mode_t mask = []()
    {
        const mode_t current = umask(0);
        umask(current);
        return current;
    }();
    return mask;
}

// Write permission for those who may read, as far as the mask for new files lets it.
mode_t Writable(mode_t mode)
{
    return mode | ((S_IRUSR | S_IWUSR | ((mode & (S_IRGRP | S_IROTH)) >> 1)) & ~FileModeMask());
}

bool ChangeMode(const std::string& path, mode_t from, mode_t to)
{
    return from == to || chmod(path.c_str(), to & 07777) == 0;
}

} // namespace

DWORD GetFileAttributesW(LPCWSTR path)
{
    const std::string native = NativePath(path);
    struct stat status = {};
    if (stat(native.c_str(), &status) != 0)
        return INVALID_FILE_ATTRIBUTES;
    DWORD attributes = ReadStored(native) & ~(FILE_ATTRIBUTE_NORMAL | FILE_ATTRIBUTE_DIRECTORY);
    if (IsDirectory(status))
        return attributes | FILE_ATTRIBUTE_DIRECTORY;
    attributes &= ~FILE_ATTRIBUTE_READONLY;
    if ((status.st_mode & AnyWrite) == 0)
        attributes |= FILE_ATTRIBUTE_READONLY;
    return attributes != 0 ? attributes : FILE_ATTRIBUTE_NORMAL;
}

BOOL SetFileAttributesW(LPCWSTR path, DWORD attributes)
{
    const std::string native = NativePath(path);
    struct stat status = {};
    if (stat(native.c_str(), &status) != 0)
        return 0;
    DWORD stored = attributes & ~(FILE_ATTRIBUTE_NORMAL | FILE_ATTRIBUTE_DIRECTORY);
    mode_t mode = status.st_mode;
    if (!IsDirectory(status))
    {
        stored &= ~FILE_ATTRIBUTE_READONLY;
        const bool isReadOnly = (attributes & FILE_ATTRIBUTE_READONLY) != 0;
        const mode_t writable = (mode & AnyWrite) != 0 ? mode : Writable(mode);
        mode = isReadOnly ? mode & ~AnyWrite : writable;
    }
    if (stored == ReadStored(native))
        return ChangeMode(native, status.st_mode, mode) ? 1 : 0;
    // Not even its owner can change an extended attribute of a file without write permission.
    const mode_t between =
        (status.st_mode & S_IWUSR) != 0 ? status.st_mode : status.st_mode | S_IWUSR;
    const bool done = ChangeMode(native, status.st_mode, between) && WriteStored(native, stored);
    return ChangeMode(native, between, done ? mode : status.st_mode) && done ? 1 : 0;
}

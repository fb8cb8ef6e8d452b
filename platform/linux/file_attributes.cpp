// Windows file attributes on Linux: a file is READONLY if nobody may write it; every other
// attribute, and READONLY of a directory, is kept as hexadecimal text in the extended attribute
// that Wine and Samba use.
#include "platform/linux/native_path.h"
#include "platform/system.h"

#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <fcntl.h>
#include <string>
#include <sys/stat.h>
#include <sys/xattr.h>
#include <unistd.h>

namespace
{

const char* const AttributeName = "user.DOSATTRIB";
constexpr mode_t AnyWrite = S_IWUSR | S_IWGRP | S_IWOTH;

// A file or directory that is accessed more than once, never through a link: as on Windows,
// attributes are not those of a link's target.
class Node
{
  public:
    explicit Node(LPCWSTR path)
        : m_descriptor(open(NativePath(path).c_str(), O_PATH | O_NOFOLLOW | O_CLOEXEC)),
          m_path("/proc/self/fd/" + std::to_string(m_descriptor))
    {
    }

    ~Node()
    {
        if (m_descriptor >= 0)
            close(m_descriptor);
    }

    Node(const Node&) = delete;
    Node& operator=(const Node&) = delete;

    bool GetStatus(struct stat& status) const
    {
        return m_descriptor >= 0 && fstat(m_descriptor, &status) == 0 && !S_ISLNK(status.st_mode);
    }

    bool ChangeMode(mode_t from, mode_t to) const
    {
        return from == to || chmod(m_path.c_str(), to & 07777) == 0;
    }

    DWORD ReadStored() const
    {
        char text[256] = {}; // Samba adds more after the text and a NUL
        const ssize_t length = getxattr(m_path.c_str(), AttributeName, text, sizeof text - 1);
        return length > 0 ? static_cast<DWORD>(std::strtoul(text, nullptr, 16)) : 0;
    }

    bool WriteStored(DWORD attributes) const
    {
        if (attributes == 0)
            return removexattr(m_path.c_str(), AttributeName) == 0 || errno == ENODATA ||
                   errno == ENOTSUP;
        char text[16] = {};
        const int length = std::snprintf(text, sizeof text, "0x%x", attributes);
        return setxattr(m_path.c_str(), AttributeName, text, static_cast<size_t>(length), 0) == 0;
    }

  private:
    const int m_descriptor;
    const std::string m_path;
};

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

// The mode with write permission for those who may read, as far as the umask permits.
mode_t Writable(mode_t mode)
{
    return mode | ((S_IRUSR | S_IWUSR | ((mode & (S_IRGRP | S_IROTH)) >> 1)) & ~FileModeMask());
}

} // namespace

DWORD GetFileAttributesW(LPCWSTR path)
{
    const Node node(path);
    struct stat status = {};
    if (!node.GetStatus(status))
        return INVALID_FILE_ATTRIBUTES;
    DWORD attributes = node.ReadStored() & ~(FILE_ATTRIBUTE_NORMAL | FILE_ATTRIBUTE_DIRECTORY);
    if (S_ISDIR(status.st_mode))
        return attributes | FILE_ATTRIBUTE_DIRECTORY;
    attributes &= ~FILE_ATTRIBUTE_READONLY;
    if ((status.st_mode & AnyWrite) == 0)
        attributes |= FILE_ATTRIBUTE_READONLY;
    return attributes != 0 ? attributes : FILE_ATTRIBUTE_NORMAL;
}

BOOL SetFileAttributesW(LPCWSTR path, DWORD attributes)
{
    const Node node(path);
    struct stat status = {};
    if (!node.GetStatus(status))
        return 0;
    DWORD stored = attributes & ~(FILE_ATTRIBUTE_NORMAL | FILE_ATTRIBUTE_DIRECTORY);
    mode_t mode = status.st_mode;
    if (!S_ISDIR(status.st_mode))
    {
        stored &= ~FILE_ATTRIBUTE_READONLY;
        const bool isReadOnly = (attributes & FILE_ATTRIBUTE_READONLY) != 0;
        const mode_t writable = (mode & AnyWrite) != 0 ? mode : Writable(mode);
        mode = isReadOnly ? mode & ~AnyWrite : writable;
    }
    if (stored == node.ReadStored())
        return node.ChangeMode(status.st_mode, mode) ? 1 : 0;
    // Not even the owner can change an extended attribute of a file without write permission.
    const mode_t between =
        (status.st_mode & S_IWUSR) != 0 ? status.st_mode : status.st_mode | S_IWUSR;
    const DWORD before = node.ReadStored();
    const bool isStored = node.ChangeMode(status.st_mode, between) && node.WriteStored(stored);
    if (isStored && node.ChangeMode(between, mode))
        return 1;
    if (isStored)
        node.WriteStored(before);
    node.ChangeMode(between, status.st_mode);
    return 0;
}

// Windows file attributes on Linux: a file is READONLY if nobody may write it; every other
// attribute, and READONLY of a directory, is kept as hexadecimal text in the extended attribute
// that Wine and Samba use.
#include "platform/linux/native_path.h"
#include "platform/system.h"

#include <cerrno>
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
        : m_descriptor(open(NativePath(path).utf8_str(), O_PATH | O_NOFOLLOW | O_CLOEXEC)),
          m_path("/proc/self/fd/" + std::to_string(m_descriptor))
    {
        if (fstat(m_descriptor, &m_status) != 0)
            m_status = {};
    }

    ~Node()
    {
        close(m_descriptor);
    }

    Node(const Node&) = delete;
    Node& operator=(const Node&) = delete;

    // 0 if there is nothing, or a link.
    mode_t Mode() const
    {
        return S_ISLNK(m_status.st_mode) ? 0 : m_status.st_mode;
    }

    bool ChangeMode(mode_t mode)
    {
        if (mode != m_status.st_mode && chmod(m_path.c_str(), mode & 07777) != 0)
            return false;
        m_status.st_mode = mode;
        return true;
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
        const std::string text = wxString::Format("0x%x", attributes).utf8_string();
        return setxattr(m_path.c_str(), AttributeName, text.data(), text.size(), 0) == 0;
    }

  private:
    const int m_descriptor;
    const std::string m_path;
    struct stat m_status = {};
};

// Those that are in the extended attribute.
DWORD Stored(DWORD attributes, mode_t mode)
{
    const DWORD others = FILE_ATTRIBUTE_NORMAL | FILE_ATTRIBUTE_DIRECTORY |
                         (S_ISDIR(mode) ? 0 : FILE_ATTRIBUTE_READONLY);
    return attributes & ~others;
}

} // namespace

DWORD GetFileAttributesW(LPCWSTR path)
{
    const Node node(path);
    const mode_t mode = node.Mode();
    if (mode == 0)
        return INVALID_FILE_ATTRIBUTES;
    DWORD attributes = Stored(node.ReadStored(), mode);
    if (S_ISDIR(mode))
        return attributes | FILE_ATTRIBUTE_DIRECTORY;
    if ((mode & AnyWrite) == 0)
        attributes |= FILE_ATTRIBUTE_READONLY;
    return attributes != 0 ? attributes : FILE_ATTRIBUTE_NORMAL;
}

BOOL SetFileAttributesW(LPCWSTR path, DWORD attributes)
{
    Node node(path);
    const mode_t before = node.Mode();
    // Not even the owner can change an extended attribute of a file without write permission.
    const mode_t writable = before | S_IWUSR;
    mode_t after = before;
    if (!S_ISDIR(before))
        after = (attributes & FILE_ATTRIBUTE_READONLY) != 0 ? before & ~AnyWrite : writable;
    if (before == 0)
        return 0;
    if (node.ChangeMode(writable) && node.WriteStored(Stored(attributes, before)) &&
        node.ChangeMode(after))
        return 1;
    node.ChangeMode(before);
    return 0;
}

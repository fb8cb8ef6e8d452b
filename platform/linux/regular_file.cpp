#include "platform/regular_file.h"

#include "platform/access_rights.h"

#include <wx/log.h>

#include <cerrno>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace
{

bool IsRegular(int descriptor, struct stat& status)
{
    return fstat(descriptor, &status) == 0 && S_ISREG(status.st_mode);
}

// Opened so that a pipe in place of the file does not block the tool.
int OpenDescriptor(const wxString& path, Links links, int flags)
{
    return open(path.utf8_str(),
                flags | O_NONBLOCK | O_CLOEXEC | (links == Links::Refuse ? O_NOFOLLOW : 0));
}

// Whether the name leads to that file and is not a link. Preserves errno.
bool IsSameFile(const wxString& path, int descriptor)
{
    const int error = errno;
    struct stat named = {};
    struct stat ours = {};
    const bool isSame = lstat(path.utf8_str(), &named) == 0 && fstat(descriptor, &ours) == 0 &&
                        named.st_dev == ours.st_dev && named.st_ino == ours.st_ino;
    errno = error;
    return isSame;
}

// Why the file did not open. Preserves errno.
RegularFile::Status ReasonNotOpen(const wxString& path, Links links)
{
    const int error = errno;
    struct stat status = {};
    const int found = fstatat(AT_FDCWD, path.utf8_str(), &status,
                              links == Links::Refuse ? AT_SYMLINK_NOFOLLOW : 0);
    errno = error;
    return found == 0 && S_ISREG(status.st_mode) ? RegularFile::Status::Refused
                                                 : RegularFile::Status::NotThere;
}

} // namespace

RegularFile::Status RegularFile::Open(const wxString& path, Links links, bool forUpdate)
{
    Close();
    m_path = path;
    m_links = links;
    m_descriptor = OpenDescriptor(path, links, forUpdate ? O_RDWR : O_RDONLY);
    struct stat status = {};
    if (m_descriptor < 0)
        return m_status = ReasonNotOpen(path, links);
    m_status = Status::Open;
    if (!IsRegular(m_descriptor, status))
    {
        Close();
        m_status = Status::NotThere;
    }
    return m_status;
}

RegularFile::Status RegularFile::ReopenForUpdate()
{
    struct stat before = {};
    struct stat now = {};
    const int descriptor = OpenDescriptor(m_path, m_links, O_RDWR);
    m_error = wxSysErrorCode();
    if (descriptor < 0)
        return IsSameFile(m_path, m_descriptor) ? Status::Refused : Status::Gone;
    if (!IsRegular(m_descriptor, before) || !IsRegular(descriptor, now) ||
        before.st_dev != now.st_dev || before.st_ino != now.st_ino)
    {
        close(descriptor);
        return Status::Gone;
    }
    close(m_descriptor);
    m_descriptor = descriptor;
    return Status::Open;
}

RegularFile::Status RegularFile::CreateNew(const wxString& path)
{
    constexpr mode_t Everybody = S_IRUSR | S_IWUSR | S_IRGRP | S_IWGRP | S_IROTH | S_IWOTH;
    Close();
    m_path = path;
    m_descriptor = open(path.utf8_str(), O_RDWR | O_CREAT | O_EXCL | O_CLOEXEC, Everybody);
    return m_status = m_descriptor < 0 ? Status::Refused : Status::Open;
}

RegularFile::Status RegularFile::Replace(const wxString& path)
{
    return unlink(path.utf8_str()) == 0 ? CreateNew(path) : m_status = Status::Refused;
}

bool RegularFile::MayReplace(const wxString& path)
{
    return MayCreateIn(path.BeforeLast('/'));
}

bool RegularFile::Close()
{
    const bool isDone = m_descriptor < 0 || close(m_descriptor) == 0;
    m_descriptor = -1;
    m_status = Status::NotOpen;
    return isDone;
}

std::int64_t RegularFile::Length() const
{
    struct stat status = {};
    return fstat(m_descriptor, &status) == 0 ? static_cast<std::int64_t>(status.st_size) : -1;
}

bool RegularFile::Read(std::string& bytes, std::int64_t most) const
{
    const std::int64_t length = Length();
    if (length < 0 || length > most)
        return false;
    bytes.resize(static_cast<size_t>(length));
    for (size_t done = 0; done < bytes.size();)
    {
        const ssize_t count =
            pread(m_descriptor, &bytes[done], bytes.size() - done, static_cast<off_t>(done));
        if (count > 0)
            done += static_cast<size_t>(count);
        else if (count == 0 || errno != EINTR)
            return false;
    }
    return true;
}

bool RegularFile::Reserve(std::int64_t from, std::int64_t length)
{
    // Most file systems support this; if one does not, only the error of a full disk matters.
    return length == 0 || fallocate(m_descriptor, FALLOC_FL_KEEP_SIZE, from, length) == 0 ||
           (errno != ENOSPC && errno != EDQUOT);
}

bool RegularFile::Write(std::int64_t offset, const std::string& bytes)
{
    for (size_t done = 0; done < bytes.size();)
    {
        const ssize_t count = pwrite(m_descriptor, &bytes[done], bytes.size() - done,
                                     static_cast<off_t>(offset) + static_cast<off_t>(done));
        if (count > 0)
            done += static_cast<size_t>(count);
        else if (count == 0 || errno != EINTR)
            return false;
    }
    return true;
}

bool RegularFile::SetLength(std::int64_t length)
{
    return ftruncate(m_descriptor, static_cast<off_t>(length)) == 0;
}

void RegularFile::WaitForDisk()
{
    fsync(m_descriptor);
}

void RegularFile::TakeAttributes(const RegularFile& source)
{
    struct stat status = {};
    if (fstat(source.m_descriptor, &status) == 0)
        fchmod(m_descriptor, status.st_mode & 07777);
}

bool RegularFile::HasAttributesOf(const RegularFile& source) const
{
    struct stat ours = {};
    struct stat theirs = {};
    return fstat(m_descriptor, &ours) == 0 && fstat(source.m_descriptor, &theirs) == 0 &&
           (ours.st_mode & 07777) == (theirs.st_mode & 07777);
}

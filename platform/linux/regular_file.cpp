#include "platform/regular_file.h"

#include <cerrno>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace
{

// Opened so that a pipe in place of the file does not block the tool.
int OpenDescriptor(const wxString& path, bool followsLinks, int flags)
{
    return open(path.utf8_str(), flags | O_NONBLOCK | O_CLOEXEC | (followsLinks ? 0 : O_NOFOLLOW));
}

// Whether both are the same regular file.
bool IsSameFile(const struct stat& left, const struct stat& right)
{
    return S_ISREG(left.st_mode) && S_ISREG(right.st_mode) && left.st_dev == right.st_dev &&
           left.st_ino == right.st_ino;
}

mode_t ModeOfCopy(const struct stat& source)
{
    return (source.st_mode & 07777) | S_IWUSR;
}

} // namespace

RegularFile::Status RegularFile::Open(const PinnedDirectory* directory, const wxString& path,
                                      bool forUpdate)
{
    Close();
    m_path = path;
    m_followsLinks = !directory;
    m_descriptor = OpenDescriptor(path, m_followsLinks, forUpdate ? O_RDWR : O_RDONLY);
    m_failure = FailedCall::Now(FailedCall::Open);
    struct stat status = {};
    if (m_descriptor < 0)
    {
        const int flags = m_followsLinks ? 0 : AT_SYMLINK_NOFOLLOW;
        return fstatat(AT_FDCWD, path.utf8_str(), &status, flags) == 0 && S_ISREG(status.st_mode)
                   ? Status::Refused
                   : Status::NotThere;
    }
    if (fstat(m_descriptor, &status) == 0 && S_ISREG(status.st_mode))
        return Status::Open;
    Close();
    m_failure = {FailedCall::Open, EINVAL};
    return Status::NotThere;
}

RegularFile::Status RegularFile::ReopenForUpdate()
{
    struct stat ours = {};
    struct stat now = {};
    const int descriptor = OpenDescriptor(m_path, m_followsLinks, O_RDWR);
    m_failure = FailedCall::Now(FailedCall::Open);
    const bool isFound =
        descriptor < 0 ? lstat(m_path.utf8_str(), &now) == 0 : fstat(descriptor, &now) == 0;
    const bool isSame = isFound && fstat(m_descriptor, &ours) == 0 && IsSameFile(ours, now);
    if (descriptor < 0)
        return isSame ? Status::Refused : Status::NotThere;
    close(isSame ? m_descriptor : descriptor);
    if (!isSame)
        return Status::NotThere;
    m_descriptor = descriptor;
    return Status::Open;
}

RegularFile::Status RegularFile::CreateNew(const PinnedDirectory& directory, const wxString& name)
{
    constexpr mode_t Everybody = S_IRUSR | S_IWUSR | S_IRGRP | S_IWGRP | S_IROTH | S_IWOTH;
    Close();
    m_path = directory.Reach(name);
    m_descriptor = open(m_path.utf8_str(), O_RDWR | O_CREAT | O_EXCL | O_CLOEXEC, Everybody);
    m_failure = FailedCall::Now(FailedCall::Open);
    return m_descriptor < 0 ? Status::Refused : Status::Open;
}

const bool RegularFile::CanReplace = true;

RegularFile::Status RegularFile::Replace(const PinnedDirectory& directory, const wxString& name)
{
    return unlink(directory.Reach(name).utf8_str()) == 0 ? CreateNew(directory, name)
                                                         : Status::Refused;
}

void RegularFile::Close()
{
    if (m_descriptor >= 0)
        close(m_descriptor);
    m_descriptor = -1;
}

std::int64_t RegularFile::Length() const
{
    struct stat status = {};
    return fstat(m_descriptor, &status) == 0 ? static_cast<std::int64_t>(status.st_size) : -1;
}

size_t RegularFile::ReadSome(std::int64_t offset, char* bytes, size_t count) const
{
    const auto done = TEMP_FAILURE_RETRY(pread(m_descriptor, bytes, count, offset));
    return done > 0 ? static_cast<size_t>(done) : 0;
}

size_t RegularFile::WriteSome(std::int64_t offset, const char* bytes, size_t count)
{
    const auto done = TEMP_FAILURE_RETRY(pwrite(m_descriptor, bytes, count, offset));
    return done > 0 ? static_cast<size_t>(done) : 0;
}

bool RegularFile::Reserve(std::int64_t from, std::int64_t length)
{
    // Most file systems support this; if one does not, only the error of a full disk matters.
    return length == 0 || fallocate(m_descriptor, FALLOC_FL_KEEP_SIZE, from, length) == 0 ||
           (errno != ENOSPC && errno != EDQUOT);
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
        fchmod(m_descriptor, ModeOfCopy(status));
}

bool RegularFile::HasAttributesOf(const RegularFile& source) const
{
    struct stat ours = {};
    struct stat theirs = {};
    return fstat(m_descriptor, &ours) == 0 && fstat(source.m_descriptor, &theirs) == 0 &&
           (ours.st_mode & 07777) == ModeOfCopy(theirs);
}

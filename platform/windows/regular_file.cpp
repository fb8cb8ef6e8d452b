#include "platform/regular_file.h"

#include "platform/windows/link_handle.h"

namespace
{

// The same sharing as when the C library opens a file: others may read and write it.
constexpr DWORD Sharing = FILE_SHARE_READ | FILE_SHARE_WRITE;

HANDLE OpenHandle(const wxString& path, DWORD access, DWORD flags,
                  DWORD disposition = OPEN_EXISTING)
{
    const HANDLE handle =
        CreateFileW(path.wc_str(), access, Sharing, nullptr, disposition, flags, nullptr);
    return handle == INVALID_HANDLE_VALUE ? nullptr : handle;
}

// Opens by its name a file that is already open. Null if the name leads to another one by now.
HANDLE OpenAgain(const wxString& path, DWORD access, HANDLE file)
{
    const HANDLE again = OpenHandle(path, access, 0);
    if (!again)
        return nullptr;
    BY_HANDLE_FILE_INFORMATION ours = {};
    BY_HANDLE_FILE_INFORMATION now = {};
    if (GetFileInformationByHandle(file, &ours) != 0 &&
        GetFileInformationByHandle(again, &now) != 0 &&
        ours.dwVolumeSerialNumber == now.dwVolumeSerialNumber &&
        ours.nFileIndexHigh == now.nFileIndexHigh && ours.nFileIndexLow == now.nFileIndexLow)
        return again;
    CloseHandle(again);
    SetLastError(ERROR_FILE_INVALID);
    return nullptr;
}

OVERLAPPED At(std::int64_t offset)
{
    OVERLAPPED place = {};
    place.Offset = static_cast<DWORD>(offset & 0xFFFFFFFF);
    place.OffsetHigh = static_cast<DWORD>(offset >> 32);
    return place;
}

} // namespace

// A link is opened as such, so that it can be distinguished from a file. A file whose content is
// elsewhere (in the cloud) is then opened again.
RegularFile::Status RegularFile::Open(const PinnedDirectory* directory, const wxString& path,
                                      bool forUpdate)
{
    Close();
    m_path = path;
    const DWORD access = forUpdate ? GENERIC_READ | GENERIC_WRITE : GENERIC_READ;
    const DWORD flags = directory ? FILE_FLAG_OPEN_REPARSE_POINT : 0;
    m_handle = OpenHandle(path, access, flags);
    m_failure = FailedCall::Now(FailedCall::Open);
    if (!m_handle)
    {
        const DWORD attributes = GetFileAttributesW(path.wc_str());
        return attributes == INVALID_FILE_ATTRIBUTES || (attributes & FILE_ATTRIBUTE_DIRECTORY) != 0
                   ? Status::NotThere
                   : Status::Refused;
    }
    if (GetFileType(m_handle) != FILE_TYPE_DISK ||
        (directory && (IsLinkHandle(m_handle) || IsLink(path) || !directory->Holds(m_handle))))
    {
        Close();
        m_failure = {FailedCall::Open, ERROR_FILE_INVALID};
        return Status::NotThere;
    }
    if (!directory || (AttributesOf(m_handle) & FILE_ATTRIBUTE_REPARSE_POINT) == 0)
        return Status::Open;
    const HANDLE content = OpenAgain(path, access, m_handle);
    m_failure = FailedCall::Now(FailedCall::Open);
    CloseHandle(m_handle);
    m_handle = content;
    return content ? Status::Open : Status::Refused;
}

RegularFile::Status RegularFile::ReopenForUpdate()
{
    HANDLE handle = ReOpenFile(m_handle, GENERIC_READ | GENERIC_WRITE, Sharing, 0);
    if (handle == INVALID_HANDLE_VALUE) // not every file system supports that
        handle = OpenAgain(m_path, GENERIC_READ | GENERIC_WRITE, m_handle);
    m_failure = FailedCall::Now(FailedCall::Open);
    if (!handle)
        return Status::Refused;
    CloseHandle(m_handle);
    m_handle = handle;
    return Status::Open;
}

RegularFile::Status RegularFile::CreateNew(const PinnedDirectory& directory, const wxString& name)
{
    Close();
    m_path = directory.Reach(name);
    m_handle = OpenHandle(m_path, GENERIC_READ | GENERIC_WRITE,
                          FILE_ATTRIBUTE_NORMAL | FILE_FLAG_OPEN_REPARSE_POINT, CREATE_NEW);
    m_failure = FailedCall::Now(FailedCall::Open);
    if (m_handle && !directory.Holds(m_handle))
        Close();
    return m_handle ? Status::Open : Status::Refused;
}

const bool RegularFile::CanReplace = false;

RegularFile::Status RegularFile::Replace(const PinnedDirectory& /*directory*/,
                                         const wxString& /*name*/)
{
    return Status::Refused;
}

void RegularFile::Close()
{
    if (m_handle)
        CloseHandle(m_handle);
    m_handle = nullptr;
}

std::int64_t RegularFile::Length() const
{
    LARGE_INTEGER length = {};
    return GetFileSizeEx(m_handle, &length) != 0 ? length.QuadPart : -1;
}

size_t RegularFile::ReadSome(std::int64_t offset, char* bytes, size_t count) const
{
    OVERLAPPED place = At(offset);
    DWORD done = 0;
    return ReadFile(m_handle, bytes, static_cast<DWORD>(count), &done, &place) != 0 ? done : 0;
}

size_t RegularFile::WriteSome(std::int64_t offset, const char* bytes, size_t count)
{
    OVERLAPPED place = At(offset);
    DWORD done = 0;
    return WriteFile(m_handle, bytes, static_cast<DWORD>(count), &done, &place) != 0 ? done : 0;
}

bool RegularFile::Reserve(std::int64_t from, std::int64_t length)
{
    if (Length() >= from + length)
        return true; // allocating less than the current size would cut the file
    FILE_ALLOCATION_INFO room = {};
    room.AllocationSize.QuadPart = from + length;
    if (SetFileInformationByHandle(m_handle, FileAllocationInfo, &room, sizeof room) != 0)
        return true;
    // If the file system does not support this, only the error of a full disk matters.
    const DWORD error = GetLastError();
    return error != ERROR_DISK_FULL && error != ERROR_HANDLE_DISK_FULL &&
           error != ERROR_NOT_ENOUGH_QUOTA;
}

bool RegularFile::SetLength(std::int64_t length)
{
    FILE_END_OF_FILE_INFO end = {};
    end.EndOfFile.QuadPart = length;
    return SetFileInformationByHandle(m_handle, FileEndOfFileInfo, &end, sizeof end) != 0;
}

void RegularFile::WaitForDisk()
{
    FlushFileBuffers(m_handle);
}

void RegularFile::TakeAttributes(const RegularFile& source)
{
    FILE_BASIC_INFO theirs = {};
    FILE_BASIC_INFO ours = {}; // what is 0 stays as it is
    if (GetFileInformationByHandleEx(source.m_handle, FileBasicInfo, &theirs, sizeof theirs) == 0)
        return;
    ours.LastWriteTime = theirs.LastWriteTime;
    ours.FileAttributes = theirs.FileAttributes & ~DWORD{FILE_ATTRIBUTE_READONLY};
    if (ours.FileAttributes == 0)
        ours.FileAttributes = FILE_ATTRIBUTE_NORMAL;
    SetFileInformationByHandle(m_handle, FileBasicInfo, &ours, sizeof ours);
}

bool RegularFile::HasAttributesOf(const RegularFile& source) const
{
    constexpr DWORD Copied = FILE_ATTRIBUTE_HIDDEN | FILE_ATTRIBUTE_SYSTEM;
    BY_HANDLE_FILE_INFORMATION ours = {};
    BY_HANDLE_FILE_INFORMATION theirs = {};
    return GetFileInformationByHandle(m_handle, &ours) != 0 &&
           GetFileInformationByHandle(source.m_handle, &theirs) != 0 &&
           (ours.dwFileAttributes & (Copied | FILE_ATTRIBUTE_READONLY)) ==
               (theirs.dwFileAttributes & Copied);
}
